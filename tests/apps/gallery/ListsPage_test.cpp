#include "apps/gallery/ListsPage.h"

#include <gtest/gtest.h>

#include <QAbstractItemView>
#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QDir>
#include <QFile>
#include <QGridLayout>
#include <QLabel>
#include <QPlainTextEdit>
#include <QSqlQuery>
#include <QStandardPaths>
#include <QTemporaryDir>
#include <QTest>
#include <QWheelEvent>

namespace tessel::gallery {
namespace {

constexpr const char* listNames[] = {"countries", "subdivisions", "languages"};

class ListsPageTest : public testing::Test {
  protected:
    ListsPageTest() { KeepDataIn(folder_.path()); }
    ~ListsPageTest() override {
        page_.reset();
        KeepDataIn(before_);
    }

    /// The folder of the user's data.
    static void KeepDataIn(const QString& folder) { qputenv("XDG_DATA_HOME", QFile::encodeName(folder)); }
    static QString DatabaseFile() {
        return QStandardPaths::writableLocation(QStandardPaths::AppDataLocation) + "/iso-codes.sqlite";
    }
    /// Runs statements on the database file beside the page; gives the first value of the last one.
    static QVariant Run(const QStringList& statements) {
        QVariant result;
        {
            QSqlDatabase database = QSqlDatabase::addDatabase("QSQLITE", "test");
            database.setDatabaseName(DatabaseFile());
            EXPECT_TRUE(database.open());
            QSqlQuery query(database);
            for (const QString& statement : statements) EXPECT_TRUE(query.exec(statement)) << statement.toStdString();
            if (query.next()) result = query.value(0);
        }
        QSqlDatabase::removeDatabase("test");
        return result;
    }
    /// A database as an earlier start left it, of a small world.
    static void WriteSmallWorld() {
        EXPECT_TRUE(QDir().mkpath(QFileInfo(DatabaseFile()).path()));
        Run({"CREATE TABLE countries (id INTEGER PRIMARY KEY, name TEXT)",
             "INSERT INTO countries VALUES (512, 'Oman'), (554, 'New Zealand'), (620, 'Portugal'), (724, 'Spain')",
             "CREATE TABLE subdivisions (id INTEGER PRIMARY KEY, name TEXT, country INTEGER)",
             "INSERT INTO subdivisions VALUES (1, 'Porto', 620), (2, 'Lisboa', 620), (3, 'Beja', 620), (4, 'Otago', 554)",
             "CREATE TABLE languages (id INTEGER PRIMARY KEY, name TEXT)",
             "INSERT INTO languages VALUES (1, 'Portuguese'), (2, 'Spanish'), (3, 'Maori')"});
    }
    void Open() {
        page_ = std::make_unique<ListsPage>();
        page_->resize(820, 500);
        page_->show();
        page_->activateWindow();
        EXPECT_TRUE(QTest::qWaitForWindowActive(page_.get()));
    }
    void OpenSmallWorld() {
        WriteSmallWorld();
        Open();
    }
    static QByteArray Bytes() {
        QFile file(DatabaseFile());
        EXPECT_TRUE(file.open(QIODevice::ReadOnly));
        return file.readAll();
    }

    template <class T>
    T* Find(const QString& name) {
        return page_->findChild<T*>(name);
    }
    qt::DataList* List(const QString& name) { return Find<qt::DataList>(name); }
    QComboBox* Combo(const QString& list) {
        return List(list)->findChild<QComboBox*>(List(list)->sorted() ? "listItems(1)" : "listItems(0)");
    }
    std::string Rows(const QString& list) {
        QStringList rows;
        for (int row = 0; row < Combo(list)->count(); ++row) rows << Combo(list)->itemText(row);
        return rows.join(" | ").toStdString();
    }
    /// What is said beside a list.
    std::string Says(const QString& list) {
        auto* grid = page_->findChild<QGridLayout*>();
        int row = 0, column = 0, rows = 0, columns = 0;
        grid->getItemPosition(grid->indexOf(List(list)), &row, &column, &rows, &columns);
        return static_cast<QLabel*>(grid->itemAtPosition(row, column + 1)->widget())->text().toStdString();
    }
    std::string Chosen() {
        QStringList texts;
        for (const char* list : listNames) texts << List(list)->text();
        return texts.join(" | ").toStdString();
    }
    std::string Problem() {
        return (Find<QLabel>("problem")->isVisible() ? Find<QLabel>("problem")->text() : QString()).toStdString();
    }
    /// What was written of the events since the last time.
    std::string Log() {
        auto* log = page_->findChild<QPlainTextEdit*>();
        const std::string lines = log->toPlainText().replace('\n', " | ").toStdString();
        log->clear();
        return lines;
    }
    void Type(const QString& list, const QString& letters) {
        Combo(list)->setFocus();
        QTest::keyClicks(Combo(list), letters);
        QCoreApplication::processEvents();
    }
    void Click(const QString& box) {
        Find<QCheckBox>(box)->click();
        QCoreApplication::processEvents();
    }

  private:
    QTemporaryDir folder_;
    const QString before_ = qEnvironmentVariable("XDG_DATA_HOME");

  protected:
    std::unique_ptr<ListsPage> page_;
};

TEST_F(ListsPageTest, TheFirstStartMakesTheDatabaseAndFillsTheLists) {
    EXPECT_FALSE(QFile::exists(DatabaseFile()));
    Open();
    EXPECT_EQ(Problem(), "");
    EXPECT_TRUE(QFile::exists(DatabaseFile()));
    int pairs = 0;
    for (const QString list : listNames) {
        const int count = Run({"SELECT COUNT(*) FROM " + list}).toInt();
        EXPECT_EQ(Combo(list)->count(), count + 1) << "with the default pair";
        EXPECT_EQ(Says(list), QString("Value 0, text \"(all)\", of %L1 items").arg(count + 1).toStdString());
        pairs += count;
    }
    EXPECT_GT(pairs, 13'000);
    Type("countries", "portug");
    EXPECT_EQ(List("countries")->value(), 620);
    EXPECT_GE(Combo("subdivisions")->findText("Lisboa"), 0);
    EXPECT_LT(Combo("subdivisions")->count(), 40);
    EXPECT_GE(Combo("languages")->findText("Portuguese"), 0);
}

TEST_F(ListsPageTest, TheNextStartReadsTheFileAsItIs) {
    WriteSmallWorld();
    const QByteArray written = Bytes();
    Open();
    EXPECT_EQ(Problem(), "");
    EXPECT_EQ(Rows("countries"), "(all) | New Zealand | Oman | Portugal | Spain");
    EXPECT_EQ(Rows("subdivisions"), "(all) | Beja | Lisboa | Otago | Porto");
    EXPECT_EQ(Rows("languages"), "(all) | Maori | Portuguese | Spanish");
    page_.reset();
    EXPECT_EQ(Bytes(), written);
}

TEST_F(ListsPageTest, ADamagedFileIsSaidAndLeftAsItIs) {
    WriteSmallWorld();
    QFile file(DatabaseFile());
    ASSERT_TRUE(file.open(QIODevice::WriteOnly | QIODevice::Truncate));
    const QByteArray damaged(5000, 'x');
    file.write(damaged);
    file.close();
    Open();
    EXPECT_TRUE(Problem().starts_with("The database of names cannot be written: file is not a database")) << Problem();
    EXPECT_NE(Problem().find(DatabaseFile().toStdString()), std::string::npos) << Problem();
    for (const char* choice : {"sorted", "locked", "locked", "defaults"}) Click(choice);
    QTest::keyClick(Find<QComboBox>("style"), Qt::Key_Down);
    for (const char* list : listNames) EXPECT_EQ(Rows(list), "") << list;
    EXPECT_EQ(Bytes(), damaged);
}

TEST_F(ListsPageTest, AFolderThatCannotBeMadeIsSaid) {
    const QTemporaryDir folder;
    QFile file(folder.filePath("file"));
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    KeepDataIn(file.fileName());
    Open();
    const std::string begin = "The database of names cannot be opened: ";
    EXPECT_TRUE(Problem().starts_with(begin)) << Problem();
    EXPECT_GT(Problem().size(), begin.size()) << "the reason";
    for (const char* list : listNames) EXPECT_EQ(Rows(list), "") << list;
}

TEST_F(ListsPageTest, ACountryLeavesItsSubdivisionsAndNoneLeavesAll) {
    OpenSmallWorld();
    Type("countries", "po");
    EXPECT_EQ(Says("countries"), "Value 620, text \"Portugal\", of 5 items");
    EXPECT_EQ(Rows("subdivisions"), "(all) | Beja | Lisboa | Porto");
    Type("subdivisions", "l");
    EXPECT_EQ(Says("subdivisions"), "Value 2, text \"Lisboa\", of 4 items");
    QTest::keyClick(Combo("countries"), Qt::Key_Up);
    EXPECT_EQ(List("countries")->text(), "Oman");
    EXPECT_EQ(Combo("subdivisions")->findText("Lisboa"), -1);
    QTest::keyClick(Combo("countries"), Qt::Key_Home);
    EXPECT_EQ(Rows("subdivisions"), "(all) | Beja | Lisboa | Otago | Porto");
}

TEST_F(ListsPageTest, LettersChooseInAClosedListAndInAnOpenOne) {
    OpenSmallWorld();
    Type("languages", "sp");
    EXPECT_EQ(Says("languages"), "Value 2, text \"Spanish\", of 4 items");
    Combo("countries")->showPopup();
    QAbstractItemView* view = Combo("countries")->view();
    ASSERT_TRUE(view->isVisible());
    QTest::keyClicks(view, "ne");
    EXPECT_EQ(List("countries")->value(), 0) << "not before Enter";
    QTest::keyClick(view, Qt::Key_Return);
    QCoreApplication::processEvents();
    EXPECT_FALSE(view->isVisible());
    EXPECT_EQ(Says("countries"), "Value 554, text \"New Zealand\", of 5 items");
    EXPECT_EQ(Rows("subdivisions"), "(all) | Otago");
}

TEST_F(ListsPageTest, TheWheelOverAClosedListChangesNothing) {
    OpenSmallWorld();
    Type("countries", "o");
    const std::string said = Says("countries");
    EXPECT_NE(Log(), "");
    for (const int turn : {-120, 120}) {
        const QPoint middle = Combo("countries")->rect().center();
        QWheelEvent wheel(middle, Combo("countries")->mapToGlobal(middle), {}, {0, turn}, Qt::NoButton, {}, Qt::NoScrollPhase,
                          false);
        QCoreApplication::sendEvent(Combo("countries"), &wheel);
        QCoreApplication::processEvents();
        EXPECT_EQ(Says("countries"), said);
    }
    EXPECT_EQ(List("countries")->text(), "Oman");
    EXPECT_EQ(Log(), "");
}

TEST_F(ListsPageTest, LockedTheListsAreTheirTextsAndUnlockedTheyAreListsAgain) {
    OpenSmallWorld();
    Type("countries", "po");
    Type("languages", "m");
    const auto labels = [&] {
        QStringList texts;
        for (const char* list : listNames) {
            EXPECT_NE(Combo(list)->isVisible(), List(list)->findChild<QWidget*>("labItem")->isVisible()) << list;
            if (Combo(list)->isVisible()) continue;
            texts << QString::fromStdString(List(list)->control().labItem.Caption());
        }
        return texts.join(" | ").toStdString();
    };
    EXPECT_EQ(labels(), "");
    Click("locked");
    EXPECT_EQ(labels(), "Portugal | (all) | Maori");
    Click("locked");
    EXPECT_EQ(labels(), "");
    EXPECT_EQ(Combo("countries")->currentText(), "Portugal");
    QTest::keyClick(Combo("countries"), Qt::Key_Down);
    EXPECT_EQ(List("countries")->text(), "Spain");
}

TEST_F(ListsPageTest, WhatIsChosenStaysWhileTheListsChange) {
    OpenSmallWorld();
    Type("countries", "po");
    Type("subdivisions", "l");
    Type("languages", "m");
    for (const char* choice : {"sorted", "defaults", "locked", "sorted", "defaults", "locked"}) {
        Click(choice);
        EXPECT_EQ(Chosen(), "Portugal | Lisboa | Maori") << choice;
        EXPECT_EQ(Combo("subdivisions")->findText("Otago"), -1) << choice;
    }
}

TEST_F(ListsPageTest, UnsortedTheRowsStandAsInTheDatabase) {
    OpenSmallWorld();
    Click("sorted");
    EXPECT_EQ(Rows("countries"), "(all) | Oman | New Zealand | Portugal | Spain");
    EXPECT_EQ(Rows("subdivisions"), "(all) | Porto | Lisboa | Beja | Otago");
    Click("sorted");
    EXPECT_EQ(Rows("countries"), "(all) | New Zealand | Oman | Portugal | Spain");
}

TEST_F(ListsPageTest, WithoutTheDefaultPairNothingIsChosenAtFirst) {
    OpenSmallWorld();
    Click("defaults");
    EXPECT_EQ(Rows("countries"), "New Zealand | Oman | Portugal | Spain");
    EXPECT_EQ(Rows("languages"), "Maori | Portuguese | Spanish");
    EXPECT_EQ(Combo("countries")->currentIndex(), -1);
    QTest::keyClick(Combo("countries"), Qt::Key_Down);
    EXPECT_EQ(Says("countries"), "Value 554, text \"New Zealand\", of 4 items");
    EXPECT_EQ(Rows("subdivisions"), "Otago");
}

TEST_F(ListsPageTest, TheStylePutsTheNumberOrTheCountBeforeTheText) {
    OpenSmallWorld();
    Type("languages", "m");
    QTest::keyClick(Find<QComboBox>("style"), Qt::Key_Down);
    EXPECT_EQ(Rows("countries"), "   0 - (all) |  512 - Oman |  554 - New Zealand |  620 - Portugal |  724 - Spain");
    EXPECT_EQ(Says("languages"), "Value 3, text \"   3 - Maori\", of 4 items");
    QTest::keyClick(Find<QComboBox>("style"), Qt::Key_Down);
    EXPECT_EQ(Rows("languages"), "   1 - (all) |    2 - Portuguese |    3 - Spanish |    4 - Maori");
    QTest::keyClick(Find<QComboBox>("style"), Qt::Key_Home);
    EXPECT_EQ(Rows("languages"), "(all) | Maori | Portuguese | Spanish");
}

TEST_F(ListsPageTest, WhatAListTellsIsWritten) {
    OpenSmallWorld();
    Log();
    Type("languages", "m");
    QTest::mouseDClick(Combo("subdivisions"), Qt::LeftButton);
    Combo("subdivisions")->hidePopup();
    EXPECT_EQ(Log(), "languages: KeyDown 77 0 | languages: Click | subdivisions: DblClick");
}

TEST_F(ListsPageTest, APageThatGoesLeavesTheOthersTheirDatabase) {
    const QStringList connections = QSqlDatabase::connectionNames();
    OpenSmallWorld();
    auto other = std::make_unique<ListsPage>();
    EXPECT_EQ(QSqlDatabase::connectionNames().size(), connections.size() + 2);
    other.reset();
    Type("countries", "po");
    EXPECT_EQ(Rows("subdivisions"), "(all) | Beja | Lisboa | Porto");
    page_.reset();
    EXPECT_EQ(QSqlDatabase::connectionNames(), connections);
}

}  // namespace
}  // namespace tessel::gallery
