#include "apps/gallery/BrowserPage.h"

#include <gtest/gtest.h>

#include <QAbstractItemView>
#include <QApplication>
#include <QComboBox>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QLineEdit>
#include <QSettings>
#include <QSplitter>
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
    auto* filter = page_->findChild<QComboBox*>("browserFilter");
    filter->setEditText("*.pdf");
    QTest::keyClick(filter->lineEdit(), Qt::Key_Return);
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
    page_->findChild<QSplitter*>()->setSizes({300, 500});
    const QList<int> sizes = page_->findChild<QSplitter*>()->sizes();
    page_.reset();
    Open();
    EXPECT_TRUE(Shows(folder_.filePath("letters")));
    EXPECT_EQ(Files()->view(), qt::FileView::List);
    EXPECT_EQ(page_->findChild<QSplitter*>()->sizes(), sizes);
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
