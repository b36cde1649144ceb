#include "apps/gallery/FilesPage.h"

#include <gtest/gtest.h>

#include <QAbstractItemView>
#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QFile>
#include <QLabel>
#include <QLineEdit>
#include <QRegularExpression>
#include <QTemporaryDir>
#include <QTest>
#include <QToolButton>

#include "hosts/qt/FileView.h"

namespace tessel::gallery {
namespace {

class FilesPageTest : public testing::Test {
  protected:
    FilesPageTest() {
        EXPECT_TRUE(QDir(folder_.path()).mkpath("letters/old"));
        Write("notes.txt", 100);
        Write("plan.pdf", 200);
        Write(".secret", 1);
        Write("letters/thanks.txt", 300);
        Write("letters/old/first.txt", 400);
        page_ = std::make_unique<FilesPage>();
        page_->resize(800, 500);
        page_->show();
        EXPECT_TRUE(QTest::qWaitForWindowExposed(page_.get()));
    }

    void Write(const QString& name, int size) {
        QFile file(folder_.filePath(name));
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(QByteArray(size, 'x'));
    }
    template <class T>
    T* Find(const char* name) {
        return page_->findChild<T*>(name);
    }
    qt::FileView* Files() { return Find<qt::FileView>("files"); }
    QAbstractItemView* List() { return Files()->findChild<QAbstractItemView*>(); }
    QString Text(const char* label) { return Find<QLabel>(label)->text(); }
    QStringList Names() {
        QStringList names;
        for (int i = 1; i <= Files()->itemCount(); ++i) {
            Files()->setItemIndex(i);
            names << Files()->itemName();
        }
        Files()->setItemIndex(1);
        return names;
    }
    void Type(const char* box, const QString& text) {
        auto* edit = Find<QLineEdit>(box);
        edit->setFocus();
        edit->selectAll();
        QTest::keyClicks(edit, text);
        QTest::keyClick(edit, Qt::Key_Return);
    }
    void Show(const QString& folder) { Type("path", folder); }
    void Click(const char* button) { QTest::mouseClick(Find<QToolButton>(button), Qt::LeftButton); }

    QTemporaryDir folder_;
    std::unique_ptr<FilesPage> page_;
};

TEST_F(FilesPageTest, BeginsInTheHomeFolder) {
    EXPECT_EQ(Find<QLineEdit>("path")->text(), QDir::homePath());
    EXPECT_EQ(Files()->path(), QDir::homePath());
}

TEST_F(FilesPageTest, TheFolderTypedIsShownWithItsNumberAndSize) {
    Show(folder_.path());
    EXPECT_EQ(Names(), (QStringList{"letters", "notes.txt", "plan.pdf"}));
    EXPECT_EQ(Text("count"), "3 items");
    EXPECT_TRUE(QTest::qWaitFor([&] { return Text("size") == "1,001 bytes in all"; })) << Text("size").toStdString();
}

TEST_F(FilesPageTest, AFolderThatIsNotThereIsSaidInTheList) {
    Show(folder_.filePath("nowhere"));
    EXPECT_EQ(Text("count"), "0 items");
    EXPECT_EQ(Files()->control().txtMessage.Text(), "Folder '" + folder_.filePath("nowhere").toStdString() + "' does not exist.");
}

TEST_F(FilesPageTest, UpLeadsToTheFolderAboveAsTheKeysDo) {
    Show(folder_.filePath("letters/old"));
    Click("up");
    EXPECT_EQ(Find<QLineEdit>("path")->text(), folder_.filePath("letters"));
    QTest::keyClick(List(), Qt::Key_Backspace);
    EXPECT_TRUE(QTest::qWaitFor([&] { return Files()->path() == folder_.path(); }));
    Show("/");
    EXPECT_FALSE(Find<QToolButton>("up")->isEnabled());
}

TEST_F(FilesPageTest, EnterAndADoubleClickGoIntoAFolder) {
    Show(folder_.path());
    List()->setFocus();
    QTest::keyClick(List(), Qt::Key_Home);
    QTest::keyClick(List(), Qt::Key_Return);
    EXPECT_TRUE(QTest::qWaitFor([&] { return Files()->path() == folder_.filePath("letters"); }));
    EXPECT_EQ(Names(), (QStringList{"old", "thanks.txt"}));
    const QRect first = List()->visualRect(List()->model()->index(0, 0));
    QTest::mouseClick(List()->viewport(), Qt::LeftButton, {}, first.center());
    QTest::mouseDClick(List()->viewport(), Qt::LeftButton, {}, first.center());
    EXPECT_TRUE(QTest::qWaitFor([&] { return Files()->path() == folder_.filePath("letters/old"); }));
}

TEST_F(FilesPageTest, TheFilterAndTheHiddenFilesAreChosen) {
    Show(folder_.path());
    Find<QCheckBox>("hidden")->click();
    EXPECT_EQ(Names(), (QStringList{"letters", ".secret", "notes.txt", "plan.pdf"}));
    Find<QComboBox>("filter")->setEditText("*.t?t");
    QTest::keyClick(Find<QComboBox>("filter")->lineEdit(), Qt::Key_Return);
    EXPECT_EQ(Names(), QStringList{"notes.txt"});
    Find<QComboBox>("filter")->setEditText("*");
    QTest::keyClick(Find<QComboBox>("filter")->lineEdit(), Qt::Key_Return);
    EXPECT_EQ(Files()->itemCount(), 4);
}

TEST_F(FilesPageTest, TheViewIsChosenByItsButtons) {
    for (QAbstractButton* button : page_->findChildren<QAbstractButton*>(QRegularExpression("^view-"))) {
        const auto before = Files()->view();
        const bool was = button->isChecked();
        button->click();
        EXPECT_TRUE(button->isChecked());
        EXPECT_EQ(Files()->view() == before, was);
    }
}

TEST_F(FilesPageTest, ASearchListsWhatItFindsBelowAndAnEmptyBoxLeadsBack) {
    Show(folder_.path());
    Type("search", ".txt");
    EXPECT_EQ(Names(), (QStringList{"notes.txt", "thanks.txt", "first.txt"}));
    EXPECT_EQ(Text("count"), "3 files found below " + folder_.path());
    EXPECT_EQ(Text("size"), "800 bytes in all");
    EXPECT_EQ(Find<QLineEdit>("path")->text(), folder_.path());
    Find<QLineEdit>("search")->clear();
    EXPECT_EQ(Names(), (QStringList{"letters", "notes.txt", "plan.pdf"}));
}

TEST_F(FilesPageTest, ASearchCanBeStoppedAndNothingElseBeginsMeanwhile) {
    Show(folder_.path());
    QString pathMeanwhile;
    bool upMeanwhile = true;
    QObject::connect(Files(), &qt::FileView::afterAddItem, page_.get(), [&] {
        upMeanwhile = Find<QToolButton>("up")->isEnabled();
        if (Files()->itemCount() == 1) Click("find");
    });
    Type("search", "*.txt");
    EXPECT_EQ(Files()->itemCount(), 1);
    EXPECT_FALSE(upMeanwhile);
    EXPECT_TRUE(Find<QToolButton>("up")->isEnabled());
}

TEST_F(FilesPageTest, ThePageMayGoWhileItFills) {
    Show(folder_.path());
    QObject::connect(Files(), &qt::FileView::afterAddItem, qApp, [&] { page_.reset(); });
    QTest::keyClick(page_.get(), Qt::Key_F5);
    EXPECT_EQ(page_, nullptr);
}

}  // namespace
}  // namespace tessel::gallery
