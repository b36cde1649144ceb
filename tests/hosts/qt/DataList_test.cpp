#include "hosts/qt/DataList.h"

#include <QAbstractItemView>
#include <QAccessible>
#include <QComboBox>
#include <QElapsedTimer>
#include <QVBoxLayout>
#include <QWheelEvent>

#include "frame/Text.h"
#include "hosts/qt/Convert.h"
#include "tests/hosts/qt/QtTest.h"

namespace tessel::qt {
namespace {

/// A list of pairs in a window, and who sits before it.
class DataListTest : public test::QtTest {
  protected:
    DataList& Shown(bool sorted = false) {
        list = new DataList(window);
        list->setObjectName("DataList1");
        list->setGeometry(20, 20, 200, 30);
        const auto note = [this](const char* name) { return [this, name] { heard.push_back(name); }; };
        QObject::connect(list, &DataList::click, list, note("Click"));
        QObject::connect(list, &DataList::dblClick, list, note("DblClick"));
        QObject::connect(list, &DataList::keyDown, list, note("KeyDown"));
        QObject::connect(list, &DataList::keyPress, list, note("KeyPress"));
        QObject::connect(list, &DataList::keyUp, list, note("KeyUp"));
        list->setSorted(sorted);
        for (const char* text : {"Red", "Green", "Blue", "Grey"}) list->addItem(text, ++values);
        Show();
        combo().setFocus();
        test::Settle();
        Events();
        return *list;
    }
    child::ComboList& rows() { return list->control().listItems[list->sorted() ? 1 : 0]; }
    QComboBox& combo() { return *list->findChild<QComboBox*>(list->sorted() ? "listItems(1)" : "listItems(0)"); }
    QWidget& label() { return *list->findChild<QWidget*>("labItem"); }
    /// Fills the list with "row 0" and so on.
    void Fill(int count) {
        for (int row = 0; row < count; ++row) rows().Add("row " + frame::Decimal(row), row);
        test::Settle();
    }

    DataList* list = nullptr;
    int values = 0;
};

TEST_F(DataListTest, TheComboBoxShowsTheItemsAndTheChosenOne) {
    Shown();
    EXPECT_EQ(combo().count(), 4);
    EXPECT_EQ(combo().itemText(2), "Blue");
    EXPECT_EQ(combo().currentIndex(), -1);
    list->setValue(2);
    test::Settle();
    EXPECT_EQ(combo().currentText(), "Green");
    list->removeItem(2);
    test::Settle();
    EXPECT_EQ(combo().count(), 3);
    EXPECT_EQ(combo().currentIndex(), -1);
}

TEST_F(DataListTest, AClickOpensTheItemsAndAnotherChoosesOne) {
    Shown();
    Click(&combo(), combo().rect().center());
    QAbstractItemView* view = combo().view();
    ASSERT_TRUE(view->isVisible());
    test::Settle();
    // A combo box takes an early release for the end of the click that opened it.
    QTest::qWait(QApplication::doubleClickInterval() + 50);
    const QPoint place = view->visualRect(view->model()->index(2, 0)).center();
    QTest::mouseMove(view->viewport(), place);
    QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, place);
    test::Settle();
    EXPECT_FALSE(view->isVisible());
    EXPECT_EQ(Events(), "Click");
    EXPECT_EQ(list->value(), 3);
    EXPECT_EQ(list->text(), "Blue");
    EXPECT_EQ(list->control().labItem.Caption(), "Blue");
}

TEST_F(DataListTest, KeysChooseAndAreReported) {
    Shown();
    QTest::keyClick(&combo(), Qt::Key_Down);
    EXPECT_EQ(list->text(), "Red");
    EXPECT_EQ(Events(), "KeyDown Click KeyUp");
    QTest::keyClick(&combo(), Qt::Key_End);
    EXPECT_EQ(list->text(), "Grey");
}

TEST_F(DataListTest, LettersFindAnItemInTheClosedList) {
    Shown();
    QTest::keyClicks(&combo(), "gre");
    EXPECT_EQ(list->text(), "Green");
    QTest::keyClicks(&combo(), "y");
    EXPECT_EQ(list->text(), "Grey");
}

TEST_F(DataListTest, LettersFindAnItemInTheOpenListAndEnterTakesIt) {
    Shown();
    combo().showPopup();
    QAbstractItemView* view = combo().view();
    ASSERT_TRUE(view->isVisible());
    QTest::keyClicks(view, "bl");
    EXPECT_EQ(view->currentIndex().row(), 2);
    EXPECT_EQ(list->control().Value(), 0);
    QTest::keyClick(view, Qt::Key_Return);
    test::Settle();
    EXPECT_FALSE(view->isVisible());
    EXPECT_EQ(list->text(), "Blue");
}

TEST_F(DataListTest, EscapeClosesTheOpenListAndChoosesNothing) {
    Shown();
    combo().showPopup();
    QAbstractItemView* view = combo().view();
    QTest::keyClick(view, Qt::Key_Down);
    QTest::keyClick(view, Qt::Key_Escape);
    test::Settle();
    EXPECT_FALSE(view->isVisible());
    EXPECT_EQ(list->control().listItems[0].ListIndex(), -1);
}

TEST_F(DataListTest, TheWheelOverTheClosedListChangesNothing) {
    Shown();
    list->setValue(2);
    test::Settle();
    Events();
    QWheelEvent wheel(combo().rect().center(), combo().mapToGlobal(combo().rect().center()), {}, {0, -120}, Qt::NoButton, {},
                      Qt::NoScrollPhase, false);
    QCoreApplication::sendEvent(&combo(), &wheel);
    test::Settle();
    EXPECT_EQ(list->value(), 2);
    EXPECT_EQ(Events(), "");
}

TEST_F(DataListTest, TheSortedListTakesThePlaceAndTheFocus) {
    Shown();
    list->setSorted(true);
    test::Settle();
    EXPECT_TRUE(combo().isVisible());
    EXPECT_FALSE(list->findChild<QComboBox*>("listItems(0)")->isVisible());
    EXPECT_EQ(combo().itemText(0), "Blue");
    EXPECT_EQ(QApplication::focusWidget(), &combo());
}

TEST_F(DataListTest, ALockedListIsALabelOfTheChosenText) {
    Shown();
    list->setValue(1);
    list->setLocked(true);
    test::Settle();
    EXPECT_TRUE(combo().isVisible());
    list->setBag(list->bag());
    test::Settle();
    EXPECT_TRUE(label().isVisible());
    EXPECT_FALSE(combo().isVisible());
}

TEST_F(DataListTest, TheHeightIsThatOfTheComboBoxAndFollowsTheFont) {
    Shown();
    const int natural = combo().sizeHint().height();
    EXPECT_EQ(list->height(), natural);
    EXPECT_EQ(combo().height(), natural);
    list->resize(150, 90);
    EXPECT_EQ(list->height(), natural);
    QFont large = list->font();
    large.setPointSize(30);
    list->setFont(large);
    test::Settle();
    EXPECT_GT(combo().sizeHint().height(), natural);
    EXPECT_EQ(list->height(), combo().sizeHint().height());
    EXPECT_EQ(label().height(), list->height());
}

TEST_F(DataListTest, ALayoutGivesItItsHeight) {
    list = new DataList;
    auto* layout = new QVBoxLayout(window);
    layout->addWidget(list);
    layout->addStretch(1);
    Show();
    EXPECT_EQ(list->height(), combo().sizeHint().height());
    EXPECT_EQ(combo().width(), list->width());
}

TEST_F(DataListTest, ColoursAndTheFontReachTheComboBox) {
    Shown();
    list->setBackColor(QColor(255, 250, 200));
    list->setForeColor(QColor(200, 0, 0));
    test::Settle();
    EXPECT_EQ(combo().palette().color(QPalette::Base), QColor(255, 250, 200));
    EXPECT_EQ(combo().palette().color(QPalette::Active, QPalette::Text), QColor(200, 0, 0));
    list->setEnabled(false);
    test::Settle();
    EXPECT_FALSE(combo().isEnabled());
    EXPECT_FALSE(list->property("Enabled").toBool());
}

TEST_F(DataListTest, AssistiveProgramsReadAComboBoxWithItsValue) {
    Shown();
    list->setValue(3);
    test::Settle();
    QAccessibleInterface* seen = QAccessible::queryAccessibleInterface(&combo());
    ASSERT_NE(seen, nullptr);
    EXPECT_EQ(seen->role(), QAccessible::ComboBox);
    EXPECT_EQ(seen->text(QAccessible::Value), "Blue");
}

TEST_F(DataListTest, AHundredThousandItemsAreFoundAndChosen) {
    Shown();
    list->clear();
    Fill(100'000);
    combo().showPopup();
    QAbstractItemView* view = combo().view();
    ASSERT_TRUE(view->isVisible());
    EXPECT_LT(view->window()->height(), 700);
    EXPECT_EQ(view->model()->rowCount(), 100'000);
    QTest::keyClicks(view, "row 99998");
    EXPECT_EQ(view->currentIndex().row(), 99'998);
    EXPECT_TRUE(view->viewport()->rect().contains(view->visualRect(view->currentIndex()).center()));
    QTest::keyClick(view, Qt::Key_Return);
    test::Settle();
    EXPECT_EQ(list->value(), 99'998);
}

TEST_F(DataListTest, AHandlerMayEndTheList) {
    Shown();
    QObject::connect(list, &DataList::click, list, [this] { delete list; });
    QComboBox* box = &combo();
    QTest::keyClick(box, Qt::Key_Down);
    test::Settle();
    EXPECT_EQ(Events(), "KeyDown Click");
    EXPECT_EQ(Errors(), "");
}

TEST_F(DataListTest, AtDesignTimeItShowsItsName) {
    host->setUserMode(false);
    list = new DataList(window);
    list->setObjectName("Countries1");
    Show();
    EXPECT_EQ(combo().currentText(), "Countries1");
    list->setObjectName("Countries2");
    test::Settle();
    EXPECT_EQ(combo().currentText(), "Countries2");
    list->setProperty("Value", 3);
    EXPECT_EQ(Errors(), "387 Countries2.Value");
}

}  // namespace
}  // namespace tessel::qt
