#include "apps/gallery/BrowserPage.h"

#include <gtest/gtest.h>

#include <QAbstractItemView>
#include <QApplication>
#include <QComboBox>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QSettings>
#include <QTemporaryDir>
#include <QTest>
#include <QToolButton>

#include "hosts/qt/Convert.h"

namespace tessel::gallery {
namespace {

class BrowserPageTest : public testing::Test {
  protected:
    BrowserPageTest() {
        EXPECT_TRUE(QDir(folder_.path()).mkpath("letters/old"));
        EXPECT_TRUE(QDir(folder_.path()).mkpath("music"));
        for (const char* name : {"notes.txt", "plan.pdf", "letters/thanks.txt"}) {
            QFile file(folder_.filePath(name));
            EXPECT_TRUE(file.open(QIODevice::WriteOnly));
        }
        QSettings(stateFile(), QSettings::IniFormat).setValue("folder", folder_.path());
    }

    QString stateFile() const { return settings_.filePath("state/browser.ini"); }
    void Open() {
        page_ = std::make_unique<BrowserPage>(stateFile());
        page_->resize(900, 500);
        page_->show();
        EXPECT_TRUE(QTest::qWaitForWindowExposed(page_.get()));
        EXPECT_TRUE(QTest::qWaitFor([&] { return Files()->itemCount() > 0; }));
    }
    qt::FileView* Files() { return page_->findChild<qt::FileView*>("browserFiles"); }
    qt::FolderView* Tree() { return page_->findChild<qt::FolderView*>("browserTree"); }
    qt::Link* FolderLink() { return page_->findChild<qt::Link*>("browserLink"); }
    QAbstractItemView* List() { return Files()->findChild<QAbstractItemView*>(); }
    bool Shows(const QString& folder) {
        return QTest::qWaitFor([&] { return Files()->path() == folder; }) && Tree()->path() == folder &&
               FolderLink()->linkTo() == folder && SelectedPath() == folder;
    }
    QString SelectedPath() {
        const auto node = Tree()->control().TreeFolders.SelectedItem();
        return node ? qt::ToQt(node->Key()) : QString();
    }
    /// As the user clicks a node.
    void ClickNode(const QString& path) {
        child::TreeView& tree = Tree()->control().TreeFolders;
        const auto node = tree.Nodes.Item(frame::Variant(qt::FromQt(path)));
        node->EnsureVisible();
        tree.NodeClickInput(node->Index());
    }

    QTemporaryDir folder_, settings_;
    std::unique_ptr<BrowserPage> page_;
};

TEST_F(BrowserPageTest, BeginsInTheFolderWhereItWasLeft) {
    Open();
    EXPECT_TRUE(Shows(folder_.path()));
    EXPECT_EQ(Files()->itemCount(), 4);
}

TEST_F(BrowserPageTest, AFolderChosenInTheTreeIsListed) {
    Open();
    ClickNode(folder_.filePath("letters"));
    EXPECT_TRUE(Shows(folder_.filePath("letters")));
    EXPECT_TRUE(QTest::qWaitFor([&] { return Files()->itemCount() == 2; }));
}

TEST_F(BrowserPageTest, EnteringAFolderInTheListMovesTheTree) {
    Open();
    List()->setFocus();
    QTest::keyClick(List(), Qt::Key_Home);
    QTest::keyClick(List(), Qt::Key_Return);
    EXPECT_TRUE(Shows(folder_.filePath("letters"))) << SelectedPath().toStdString();
    QTest::keyClick(List(), Qt::Key_Home);
    QTest::keyClick(List(), Qt::Key_Return);
    EXPECT_TRUE(Shows(folder_.filePath("letters/old"))) << SelectedPath().toStdString();
    page_->findChild<QToolButton*>("browserUp")->click();
    EXPECT_TRUE(Shows(folder_.filePath("letters"))) << SelectedPath().toStdString();
}

TEST_F(BrowserPageTest, TheFilterCountsForTheList) {
    Open();
    // Typed ahead: the documents.
    QTest::keyClick(page_->findChild<qt::DataList*>("browserFilter")->findChild<QComboBox*>("listItems(0)"), Qt::Key_D);
    EXPECT_TRUE(QTest::qWaitFor([&] { return Files()->itemCount() == 1; }));
}

TEST_F(BrowserPageTest, ALaterWishReplacesOneThatIsNotYetListed) {
    Open();
    ClickNode(folder_.filePath("music"));
    ClickNode(folder_.filePath("letters"));
    EXPECT_TRUE(Shows(folder_.filePath("letters")));
}

TEST_F(BrowserPageTest, ItsStateComesBack) {
    Open();
    ClickNode(folder_.filePath("letters"));
    ASSERT_TRUE(Shows(folder_.filePath("letters")));
    Files()->setView(qt::FileView::List);
    page_->findChild<qt::Splitter*>("browserBar")->moveTo(300);
    EXPECT_EQ(Tree()->width(), 300);
    EXPECT_EQ(Files()->x(), 308);
    page_->findChild<qt::DataList*>("browserFilter")->setValue(1);
    page_.reset();
    Open();
    EXPECT_TRUE(Shows(folder_.filePath("letters")));
    EXPECT_EQ(Files()->view(), qt::FileView::List);
    EXPECT_EQ(Tree()->width(), 300);
    EXPECT_EQ(page_->findChild<qt::DataList*>("browserFilter")->text(), "Texts (*.txt)");
}

TEST_F(BrowserPageTest, TheBarPartsTheTreeAndTheList) {
    Open();
    auto* bar = page_->findChild<qt::Splitter*>("browserBar");
    const int width = Tree()->width() + bar->width() + Files()->width();
    QTest::keyClick(bar, Qt::Key_Right);
    EXPECT_EQ(bar->x(), Tree()->width());
    EXPECT_EQ(Files()->x(), bar->x() + bar->width());
    EXPECT_EQ(Tree()->width() + bar->width() + Files()->width(), width);
    const int tree = Tree()->width();
    page_->resize(page_->width() + 100, page_->height());
    QApplication::processEvents();
    EXPECT_EQ(Tree()->width(), tree);
    EXPECT_EQ(Tree()->width() + bar->width() + Files()->width(), width + 100);
}

TEST_F(BrowserPageTest, FromRightToLeftTheTreeStandsOnTheRight) {
    Open();
    page_->setLayoutDirection(Qt::RightToLeft);
    QApplication::processEvents();
    auto* bar = page_->findChild<qt::Splitter*>("browserBar");
    EXPECT_EQ(Files()->x(), 0);
    EXPECT_EQ(Tree()->x(), bar->x() + bar->width());
    QTest::keyClick(bar, Qt::Key_Left);
    EXPECT_EQ(Files()->width(), bar->x());
    EXPECT_EQ(Tree()->x(), bar->x() + bar->width());
}

TEST_F(BrowserPageTest, AFolderThatHasGoneAndADamagedStateBeginAtHome) {
    QSettings state(stateFile(), QSettings::IniFormat);
    state.setValue("folder", folder_.filePath("gone"));
    state.setValue("tree", QByteArray("nonsense"));
    state.setValue("files", QByteArray("\0\1\2", 3));
    state.sync();
    page_ = std::make_unique<BrowserPage>(stateFile());
    page_->show();
    EXPECT_TRUE(QTest::qWaitFor([&] { return Files()->path() == QDir::homePath(); }));
}

}  // namespace
}  // namespace tessel::gallery
