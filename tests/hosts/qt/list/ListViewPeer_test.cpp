#include "hosts/qt/ListViewPeer.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QAccessible>
#include <QMimeData>
#include <QUrl>
#include <array>

#include "tests/hosts/qt/list/ListOnScreen.h"

namespace tessel::qt::test {
namespace {

using child::ListSortOrderConstants;
using child::ListViewConstants;

constexpr std::array allViews = {ListViewConstants::Report, ListViewConstants::Icon, ListViewConstants::SmallIcon,
                                 ListViewConstants::List};

/// A list of twenty rows with the columns "Name" and "Number".
struct Rows20 : ListOnScreen {
    Rows20() {
        list.Headers().Add({}, {}, "Name", 1500.0f);
        list.Headers().Add({}, {}, "Number", 1500.0f);
        list.SetMultiSelect(true);
        AddRows(20);
        owner.Heard();
    }
    int Height() { return CellOf(0).height(); }
    int Top() { return list.TopIndex(); }
    /// A point beside all rows.
    QPoint Beside() { return {port()->width() - 8, port()->height() - 8}; }
    void Drag(QPoint from, QPoint to, Qt::KeyboardModifiers modifiers = {}) {
        QTest::mousePress(port(), Qt::LeftButton, modifiers, from);
        for (int step = 1; step <= 4; ++step) Move(from + (to - from) * step / 4, modifiers);
    }
    void Move(QPoint to, Qt::KeyboardModifiers modifiers = {}) {
        QMouseEvent moved(QEvent::MouseMove, to, port()->mapToGlobal(to), Qt::NoButton, Qt::LeftButton, modifiers);
        QCoreApplication::sendEvent(port(), &moved);
    }
    void Release(QPoint at) { QTest::mouseRelease(port(), Qt::LeftButton, {}, at); }
};

// Following.

TEST(ListViewPeer, TheListIsAWidgetUnderItsName) {
    ListOnScreen screen;
    EXPECT_EQ(screen.view().objectName(), "ListFiles");
    EXPECT_EQ(screen.view().size(), QSize(400, 200));
    EXPECT_TRUE(screen.view().isVisible());
}

TEST(ListViewPeer, AnUpdateOfHundredThousandRowsAsksForFewTexts) {
    struct Counting final : child::RowSource {
        std::string Text(child::RowId row, int column) const override {
            ++asked;
            return frame::Decimal(row) + "/" + frame::Decimal(column);
        }
        mutable int asked = 0;
    };
    Counting source;  // must outlive the list
    ListOnScreen screen;
    screen.list.Headers().Add({}, {}, "Name");
    screen.rows().SetSource(&source);
    for (int row = 0; row < 100'000; ++row) screen.rows().AddFromSource();
    source.asked = 0;
    for (const auto view : allViews) {
        screen.list.SetView(view);
        screen.Settle();
        screen.window.grab();
        EXPECT_LT(source.asked, 1200) << static_cast<int>(view);
        source.asked = 0;
    }
    screen.rows().SetSource(nullptr);
}

TEST(ListViewPeer, HeadersHaveTheWidthsOrderAndTextsOfTheColumns) {
    Rows20 screen;
    const ListHeader& header = screen.view().Header();
    EXPECT_TRUE(header.isVisible());
    EXPECT_EQ(header.count(), 2);
    EXPECT_EQ(header.sectionSize(0), 100);
    screen.list.Headers().Add(1, {}, "Unseen", 0.0f);
    screen.list.Headers().Item(2).SetPosition(3);
    screen.list.Headers().Item(2).SetWidth(900);
    screen.Settle();
    EXPECT_TRUE(header.isSectionHidden(0));
    EXPECT_EQ(header.sectionSize(1), 60);
    EXPECT_EQ(header.visualIndex(1), 2);
    EXPECT_EQ(header.model()->headerData(2, Qt::Horizontal).toString(), "Number");
    screen.list.SetHideColumnHeaders(true);
    screen.Settle();
    EXPECT_FALSE(header.isVisible());
    screen.list.SetHideColumnHeaders(false);
    screen.list.SetView(ListViewConstants::List);
    screen.Settle();
    EXPECT_FALSE(header.isVisible());
}

TEST(ListViewPeer, DraggingTheEdgeOfAHeaderSetsItsWidth) {
    Rows20 screen;
    QWidget* const header = screen.view().Header().viewport();
    QTest::mousePress(header, Qt::LeftButton, {}, {99, 8});
    QMouseEvent moved(QEvent::MouseMove, QPointF(139, 8), header->mapToGlobal(QPointF(139, 8)), Qt::NoButton, Qt::LeftButton, {});
    QCoreApplication::sendEvent(header, &moved);
    QTest::mouseRelease(header, Qt::LeftButton, {}, {139, 8});
    EXPECT_FLOAT_EQ(screen.list.Headers().Item(1).Width(), 140 * 15);
    EXPECT_EQ(screen.owner.Heard(), "");
}

TEST(ListViewPeer, AHeaderIsClickedAndWhereAllowedMoved) {
    Rows20 screen;
    QWidget* const header = screen.view().Header().viewport();
    QTest::mouseClick(header, Qt::LeftButton, {}, {150, 8});
    EXPECT_EQ(screen.owner.Heard(), "ColumnClick 2");
    const auto drag = [&] {
        QTest::mousePress(header, Qt::LeftButton, {}, {20, 8});
        for (const int x : {60, 120, 180}) {
            QMouseEvent moved(QEvent::MouseMove, QPointF(x, 8), header->mapToGlobal(QPointF(x, 8)), Qt::NoButton, Qt::LeftButton,
                              {});
            QCoreApplication::sendEvent(header, &moved);
        }
        QTest::mouseRelease(header, Qt::LeftButton, {}, {180, 8});
    };
    drag();
    EXPECT_EQ(screen.list.Headers().Item(1).Position(), 1);
    screen.list.SetAllowColumnReorder(true);
    screen.Settle();
    drag();
    EXPECT_EQ(screen.list.Headers().Item(1).Position(), 2);
    EXPECT_EQ(screen.view().Header().visualIndex(0), 1);
}

TEST(ListViewPeer, ClickingTheEdgeOfAHeaderTwiceFitsTheColumn) {
    Rows20 screen;
    screen.rows().SetText(screen.rows().At(3), 0, "a name that is by far wider than the column was before");
    screen.Settle();
    emit screen.view().Header().sectionHandleDoubleClicked(0);
    const int text = screen.view().fontMetrics().horizontalAdvance("a name that is by far wider than the column was before");
    EXPECT_GT(screen.list.Headers().Item(1).Width(), text * 15);
    EXPECT_LT(screen.list.Headers().Item(1).Width(), (text + 40) * 15);
}

// What the screen answers.

TEST(ListViewPeer, ThePlaceOfARowIsWhereItIsHit) {
    for (const auto view : allViews) {
        Rows20 screen;
        screen.list.SetView(view);
        screen.Settle();
        for (const int row : {0, 1, 3}) {
            const QPoint at = screen.LabelPoint(row) + screen.port()->geometry().topLeft() - screen.view().contentsRect().topLeft();
            const auto hit = screen.list.HitTest(Twips(at.x()), Twips(at.y()));
            if (view == ListViewConstants::Icon) continue;  // its label stands in the middle
            ASSERT_TRUE(hit) << static_cast<int>(view);
            EXPECT_EQ(hit->Index(), row + 1);
            EXPECT_LE(hit->Top(), Twips(at.y()));
            EXPECT_GE(hit->Top() + hit->Height(), Twips(at.y()));
        }
        EXPECT_FALSE(screen.list.HitTest(-10, -10));
    }
}

TEST(ListViewPeer, BesideTheLabelNoRowIsHitUnlessWholeRowsAreSelected) {
    Rows20 screen;
    const float y = Twips(screen.Height() + screen.view().Header().height() + 5);
    EXPECT_FALSE(screen.list.HitTest(Twips(150), y));
    screen.list.SetFullRowSelect(true);
    ASSERT_TRUE(screen.list.HitTest(Twips(150), y));
    EXPECT_EQ(screen.list.HitTest(Twips(150), y)->Index(), 2);
    EXPECT_FALSE(screen.list.HitTest(Twips(300), y));
}

TEST(ListViewPeer, ALargeIconIsHitFromItsTopToItsLabelsEnd) {
    ListOnScreen screen;
    screen.owner.Image32.SetUseMaskColor(false);
    screen.owner.Image32.Images().Add({}, "icon", Square(32, 0xFF0000FF));
    screen.list.SetIcons(&screen.owner.Image32);
    screen.list.SetView(ListViewConstants::Icon);
    screen.AddRows(3);
    const QRect cell = screen.CellOf(1);
    const auto hits = [&](int y) {
        const QPoint at =
            QPoint(cell.center().x(), y) + screen.port()->geometry().topLeft() - screen.view().contentsRect().topLeft();
        const auto row = screen.list.HitTest(Twips(at.x()), Twips(at.y()));
        return row && row->Index() == 2;
    };
    const int labelEnd = cell.top() + 4 + 32 + 4 + screen.view().fontMetrics().lineSpacing();
    for (int y = cell.top() + 4; y < labelEnd; ++y) EXPECT_TRUE(hits(y)) << y;
    EXPECT_FALSE(hits(cell.top()));
    EXPECT_FALSE(hits(cell.bottom()));
}

TEST(ListViewPeer, ScrollingGoesBothWays) {
    Rows20 screen;
    EXPECT_EQ(screen.Top(), 1);
    screen.list.SetTopIndex(5);
    EXPECT_EQ(screen.Top(), 5);
    EXPECT_EQ(screen.view().verticalScrollBar()->value(), 4 * screen.Height());
    screen.view().verticalScrollBar()->setValue(6 * screen.Height());
    EXPECT_EQ(screen.Top(), 7);
    screen.list.EnsureVisible(1);
    EXPECT_EQ(screen.Top(), 2);
    screen.list.EnsureVisible(19);
    EXPECT_TRUE(screen.port()->rect().contains(screen.CellOf(19)));
}

TEST(ListViewPeer, TheScrollPositionSurvivesSortingAndRefreshing) {
    Rows20 screen;
    screen.list.SetTopIndex(5);
    screen.rows().SetSortOrder(ListSortOrderConstants::Descending);
    screen.list.SetSorted(true);
    screen.Settle();
    EXPECT_EQ(screen.Top(), 5);
    const std::string top = screen.list.GetFirstVisible()->Text();
    screen.rows().Remove(screen.rows().At(0));
    screen.rows().Add("row 99");
    screen.rows().Add("row 98");
    screen.Settle();
    EXPECT_EQ(screen.list.GetFirstVisible()->Text(), top);
    EXPECT_EQ(screen.Top(), 6);
}

TEST(ListViewPeer, ManyScatteredChangesLeaveTheRowsInView) {
    ListOnScreen screen;
    screen.AddRows(3000);
    screen.list.SetTopIndex(1002);
    for (int row = 0; row < 1200; row += 4) screen.rows().Remove(screen.rows().At(static_cast<unsigned>(row)));
    screen.Settle();
    EXPECT_EQ(screen.list.GetFirstVisible()->Text(), "row 1001");
    EXPECT_EQ(screen.list.TopIndex(), 1002 - 201);
}

TEST(ListViewPeer, ANewListingBeginsAtItsTop) {
    ListOnScreen screen;
    screen.AddRows(100);
    screen.list.SetTopIndex(50);
    screen.rows().Clear();
    for (int row = 0; row < 100; ++row) screen.rows().Add("other");
    screen.Settle();
    EXPECT_EQ(screen.list.TopIndex(), 1);
}

TEST(ListViewPeer, AtItsStartAListStaysThereWhenRowsComeBefore) {
    Rows20 screen;
    screen.rows().Add("before all", 0);
    screen.Settle();
    EXPECT_EQ(screen.Top(), 1);
}

TEST(ListViewPeer, AnotherViewShowsTheSameRows) {
    ListOnScreen screen;
    screen.AddRows(1000);
    screen.list.SetTopIndex(500);
    for (const auto view : {ListViewConstants::List, ListViewConstants::SmallIcon, ListViewConstants::Report}) {
        screen.list.SetView(view);
        screen.Settle();
        EXPECT_TRUE(screen.port()->rect().intersects(screen.CellOf(499))) << static_cast<int>(view);
    }
}

// The mouse.

TEST(ListViewPeer, APressSelectsAfterTheMouseWasReported) {
    Rows20 screen;
    screen.Click(2);
    const std::string heard = screen.owner.Heard();
    EXPECT_THAT(heard, testing::StartsWith("MouseDown 1 "));
    EXPECT_THAT(heard, testing::EndsWith(" | ItemClick row 2 3"));
    EXPECT_EQ(screen.Selection(), "row 2*");
}

TEST(ListViewPeer, ShiftAndCtrlExtendTheSelection) {
    Rows20 screen;
    screen.Click(2);
    screen.Click(5, Qt::ShiftModifier);
    EXPECT_EQ(screen.Selection(), "row 2, row 3, row 4, row 5*");
    screen.Click(3, Qt::ControlModifier);
    EXPECT_EQ(screen.Selection(), "row 2, (row 3), row 4, row 5");
    screen.Click(1);
    EXPECT_EQ(screen.Selection(), "row 1*");
    screen.list.SetMultiSelect(false);
    screen.Click(4, Qt::ControlModifier);
    EXPECT_EQ(screen.Selection(), "row 4*");
}

TEST(ListViewPeer, OnASelectedRowTheSelectionWaitsForTheRelease) {
    Rows20 screen;
    screen.Click(1);
    screen.Click(3, Qt::ShiftModifier);
    QTest::mousePress(screen.port(), Qt::LeftButton, {}, screen.LabelPoint(2));
    EXPECT_EQ(screen.Selection(), "row 1, row 2, row 3*");
    QTest::mouseRelease(screen.port(), Qt::LeftButton, {}, screen.LabelPoint(2));
    EXPECT_EQ(screen.Selection(), "row 2*");
}

TEST(ListViewPeer, TheRightButtonSelectsNothing) {
    Rows20 screen;
    QTest::mouseClick(screen.port(), Qt::RightButton, {}, screen.LabelPoint(2));
    EXPECT_EQ(screen.Selection(), "");
    EXPECT_THAT(screen.owner.Heard(), testing::StartsWith("MouseDown 2"));
}

TEST(ListViewPeer, APressBesideTheRowsClearsTheSelection) {
    Rows20 screen;
    screen.Click(2);
    QTest::mouseClick(screen.port(), Qt::LeftButton, {}, screen.Beside());
    EXPECT_EQ(screen.Selection(), "(row 2)");
}

TEST(ListViewPeer, ADoubleClickIsReportedOnce) {
    Rows20 screen;
    screen.Click(2);
    screen.owner.Heard();
    QTest::mouseDClick(screen.port(), Qt::LeftButton, {}, screen.LabelPoint(2));
    EXPECT_THAT(screen.owner.Heard(), testing::HasSubstr("DblClick"));
}

TEST(ListViewPeer, ARubberBandSelectsWhatItTouches) {
    Rows20 screen;
    screen.list.SetFullRowSelect(true);
    screen.Settle();
    const QPoint from(screen.port()->width() - 30, screen.CellOf(5).center().y());
    screen.Drag(from, {20, screen.CellOf(2).center().y()});
    EXPECT_EQ(screen.Selection(), "row 2, row 3, row 4, row 5");
    screen.Move({20, screen.CellOf(4).center().y()});
    EXPECT_EQ(screen.Selection(), "row 4, row 5");
    screen.Release({20, screen.CellOf(4).center().y()});
    EXPECT_EQ(screen.Selection(), "row 4, row 5");
}

TEST(ListViewPeer, ARubberBandEndsWhenAnotherWindowHadTheRelease) {
    struct Releases {
        void Hear(std::int16_t button, std::int16_t, float, float) { buttons.push_back(button); }
        std::vector<int> buttons;
    } releases;
    Rows20 screen;
    screen.list.MouseUp.To<&Releases::Hear>(releases);
    screen.list.SetFullRowSelect(true);
    screen.Settle();
    const QPoint from(screen.port()->width() - 30, screen.CellOf(5).center().y());
    screen.Drag(from, {20, screen.CellOf(4).center().y()});
    EXPECT_EQ(screen.Selection(), "row 4, row 5");
    const QPointF back(20, screen.CellOf(1).center().y());
    QMouseEvent move(QEvent::MouseMove, back, back, screen.port()->mapToGlobal(back), Qt::NoButton, Qt::NoButton, {});
    QCoreApplication::sendEvent(screen.port(), &move);
    EXPECT_EQ(releases.buttons, std::vector<int>{1});
    EXPECT_EQ(screen.Selection(), "row 4, row 5");
    screen.Move({20, screen.CellOf(0).center().y()});  // the button goes down elsewhere and comes in
    EXPECT_EQ(screen.Selection(), "row 4, row 5");
}

TEST(ListViewPeer, ARubberBandWithCtrlKeepsWhatWasSelected) {
    Rows20 screen;
    screen.list.SetFullRowSelect(true);
    screen.Settle();
    screen.Click(1);
    screen.Click(3, Qt::ControlModifier);
    const QPoint from(screen.port()->width() - 30, screen.CellOf(5).center().y());
    screen.Drag(from, {20, screen.CellOf(2).center().y()}, Qt::ControlModifier);
    EXPECT_EQ(screen.Selection(), "row 1, row 2, row 3*, row 4, row 5");
    screen.Move({20, screen.CellOf(5).center().y()}, Qt::ControlModifier);
    screen.Release({20, screen.CellOf(5).center().y()});
    EXPECT_EQ(screen.Selection(), "row 1, row 3*, row 5");
}

TEST(ListViewPeer, WithoutMultiSelectThereIsNoRubberBand) {
    Rows20 screen;
    screen.list.SetMultiSelect(false);
    screen.list.SetFullRowSelect(true);
    screen.Settle();
    screen.Drag({screen.port()->width() - 30, screen.CellOf(5).center().y()}, {20, 10});
    EXPECT_EQ(screen.Selection(), "");
    screen.Release({20, 10});
}

TEST(ListViewPeer, RestingOnARowSelectsItWhereThatIsWanted) {
    Rows20 screen;
    screen.list.SetHoverSelection(true);
    screen.Settle();
    QMouseEvent moved(QEvent::MouseMove, screen.LabelPoint(3), screen.port()->mapToGlobal(screen.LabelPoint(3)), Qt::NoButton,
                      Qt::NoButton, {});
    QCoreApplication::sendEvent(screen.port(), &moved);
    EXPECT_EQ(screen.Selection(), "");
    EXPECT_TRUE(QTest::qWaitFor([&] { return screen.Selection() == "row 3*"; }));
}

// The keyboard.

TEST(ListViewPeer, ArrowsMoveAndSelect) {
    Rows20 screen;
    screen.Key(Qt::Key_Down);
    EXPECT_EQ(screen.Selection(), "row 0*");
    screen.Key(Qt::Key_Down);
    screen.Key(Qt::Key_Down, Qt::ShiftModifier);
    EXPECT_EQ(screen.Selection(), "row 1, row 2*");
    screen.Key(Qt::Key_Down, Qt::ControlModifier);
    EXPECT_EQ(screen.Selection(), "row 1, row 2, (row 3)");
    screen.Key(Qt::Key_Space, Qt::ControlModifier);
    EXPECT_EQ(screen.Selection(), "row 1, row 2, row 3*");
    screen.Key(Qt::Key_Up);
    EXPECT_EQ(screen.Selection(), "row 2*");
    EXPECT_THAT(screen.owner.Heard(),
                testing::StartsWith("KeyDown 40 0 | KeyDown 40 0 | KeyDown 16 1 | KeyDown 40 1 | KeyDown 17 2 | "
                                    "KeyDown 40 2"));
}

TEST(ListViewPeer, HomeEndAndPagesMoveFarAndScroll) {
    Rows20 screen;
    screen.Key(Qt::Key_End);
    EXPECT_EQ(screen.Selection(), "row 19*");
    EXPECT_TRUE(screen.port()->rect().contains(screen.CellOf(19)));
    screen.Key(Qt::Key_PageUp);
    EXPECT_NE(screen.Selection(), "row 19*");
    screen.Key(Qt::Key_Home, Qt::ShiftModifier);
    EXPECT_TRUE(screen.rows().Selected(screen.rows().At(0)));
    EXPECT_EQ(screen.Top(), 1);
    screen.Key(Qt::Key_A, Qt::ControlModifier);
    EXPECT_EQ(screen.rows().SelectedCount(), 20u);
}

TEST(ListViewPeer, TypingFindsRowsByTheirBeginning) {
    ListOnScreen screen;
    for (const char* text : {"apple", "banana", "berry", "bilberry", "cherry"}) screen.rows().Add(text);
    screen.Settle();
    QTest::keyClicks(&screen.view(), "bi");
    EXPECT_EQ(screen.Selection(), "bilberry*");
    EXPECT_THAT(screen.owner.Heard(), "KeyDown 66 0 | KeyDown 73 0");
}

TEST(ListViewPeer, TheSameLetterGoesFromRowToRow) {
    ListOnScreen screen;
    for (const char* text : {"apple", "banana", "berry", "cherry"}) screen.rows().Add(text);
    screen.Settle();
    QTest::keyClicks(&screen.view(), "b");
    EXPECT_EQ(screen.Selection(), "banana*");
    QTest::keyClicks(&screen.view(), "b");
    EXPECT_EQ(screen.Selection(), "berry*");
    QTest::keyClicks(&screen.view(), "b");
    EXPECT_EQ(screen.Selection(), "banana*");
}

TEST(ListViewPeer, SidewaysKeysFollowTheDirectionOfTheView) {
    Rows20 screen;
    screen.list.SetView(ListViewConstants::SmallIcon);
    screen.Settle();
    screen.Click(0);
    screen.Key(Qt::Key_Right);
    EXPECT_EQ(screen.Selection(), "row 1*");
    screen.view().setLayoutDirection(Qt::RightToLeft);
    EXPECT_GT(screen.CellOf(0).left(), screen.CellOf(1).left());
    screen.Key(Qt::Key_Right);
    EXPECT_EQ(screen.Selection(), "row 0*");
    QTest::mouseClick(screen.port(), Qt::LeftButton, {}, screen.CellOf(1).topRight() + QPoint(-12, 8));
    EXPECT_EQ(screen.Selection(), "row 1*");
}

// Selection and focus survive.

TEST(ListViewPeer, SelectionAndCurrentRowSurviveSorting) {
    Rows20 screen;
    screen.Click(2);
    screen.Click(4, Qt::ControlModifier);
    screen.rows().SetSortOrder(ListSortOrderConstants::Descending);
    screen.list.SetSorted(true);
    screen.Settle();
    EXPECT_EQ(screen.Selection(), "row 4*, row 2");
    EXPECT_EQ(screen.view().currentIndex().data().toString(), "row 4");
    screen.Key(Qt::Key_Up);
    EXPECT_EQ(screen.Selection(), "row 5*");
}

// The label edit.

struct Edited : Rows20 {
    Edited() {
        Click(2);
        owner.Heard();
        list.StartLabelEdit();
        Settle();
    }
    LabelEditor* editor() {
        auto* editor = window.findChild<LabelEditor*>();
        return editor && editor->isVisible() ? editor : nullptr;
    }
};

TEST(ListViewPeer, AnEditIsAcceptedByEnter) {
    Edited screen;
    ASSERT_TRUE(screen.editor());
    EXPECT_TRUE(screen.editor()->hasFocus());
    EXPECT_EQ(screen.editor()->selectedText(), "row 2");
    QTest::keyClicks(screen.editor(), "new");
    QTest::keyClick(screen.editor(), Qt::Key_Down);
    QTest::keyClick(screen.editor(), Qt::Key_Return);
    EXPECT_EQ(screen.owner.Heard(), "BeforeLabelEdit | AfterLabelEdit new");
    EXPECT_FALSE(screen.editor());
    EXPECT_TRUE(screen.view().hasFocus());
    EXPECT_EQ(screen.rows().Text(screen.rows().At(2), 0), "new");
}

TEST(ListViewPeer, AKeyMayOpenTheEditAndDoesNothingElseThen) {
    Rows20 screen;
    struct Opener {
        void Down(std::int16_t key, std::int16_t) {
            if (key == 40) list.StartLabelEdit();
        }
        child::ListView& list;
    } opener{screen.list};
    screen.Click(2);
    screen.list.KeyDown.To<&Opener::Down>(opener);
    screen.Key(Qt::Key_Down);
    EXPECT_TRUE(screen.list.Editing());
    EXPECT_EQ(screen.Selection(), "row 2*");
}

TEST(ListViewPeer, AnEditIsGivenUpByEscape) {
    Edited screen;
    QTest::keyClicks(screen.editor(), "new");
    QTest::keyClick(screen.editor(), Qt::Key_Escape);
    EXPECT_EQ(screen.owner.Heard(), "BeforeLabelEdit | LabelEditGivenUp");
    EXPECT_FALSE(screen.editor());
    EXPECT_EQ(screen.rows().Text(screen.rows().At(2), 0), "row 2");
}

TEST(ListViewPeer, AnEditTakesWhatAnInputMethodComposes) {
    Edited screen;
    QInputMethodEvent composed;
    composed.setCommitString(QString::fromUtf8("\xE6\x97\xA5\xE6\x9C\xAC"));
    QCoreApplication::sendEvent(screen.editor(), &composed);
    QTest::keyClick(screen.editor(), Qt::Key_Return);
    EXPECT_EQ(screen.rows().Text(screen.rows().At(2), 0), "\xE6\x97\xA5\xE6\x9C\xAC");
}

TEST(ListViewPeer, AnEditThatLosesTheFocusIsAccepted) {
    Edited screen;
    QTest::keyClicks(screen.editor(), "new");
    screen.Click(5);
    EXPECT_THAT(screen.owner.Heard(), testing::StartsWith("BeforeLabelEdit | AfterLabelEdit new | MouseDown"));
    EXPECT_FALSE(screen.editor());
    EXPECT_EQ(screen.Selection(), "row 5*");
}

TEST(ListViewPeer, AnOpenEditSurvivesSortingAndFollowsItsRow) {
    Edited screen;
    QTest::keyClicks(screen.editor(), "half");
    const int before = screen.editor()->y();
    screen.rows().SetSortOrder(ListSortOrderConstants::Descending);
    screen.list.SetSorted(true);
    screen.rows().Add("row 00");
    screen.Settle();
    ASSERT_TRUE(screen.editor());
    EXPECT_EQ(screen.editor()->text(), "half");
    EXPECT_NE(screen.editor()->y(), before);
    QTest::keyClick(screen.editor(), Qt::Key_Return);
    EXPECT_TRUE(screen.rows().Find("half"));
    EXPECT_FALSE(screen.rows().Find("row 2"));
}

TEST(ListViewPeer, AnEditOfARowThatGoesIsOver) {
    Edited screen;
    screen.rows().Remove(screen.rows().At(2));
    screen.Settle();
    EXPECT_FALSE(screen.editor());
    EXPECT_TRUE(screen.view().hasFocus());
}

TEST(ListViewPeer, ASlowSecondClickOnTheLabelOpensItsEdit) {
    Rows20 screen;
    screen.Click(2);
    QTest::qWait(1);
    screen.Click(2);
    EXPECT_FALSE(screen.list.Editing());
    EXPECT_TRUE(QTest::qWaitFor([&] { return screen.list.Editing(); }));
}

TEST(ListViewPeer, AClickThatBringsTheFocusOpensNoEdit) {
    Rows20 screen;
    QLineEdit other(&screen.window);
    other.show();
    screen.Click(2);
    other.setFocus();
    screen.view().setFocus(Qt::MouseFocusReason);  // as a click does before its press
    screen.Click(2);
    QTest::qWait(QApplication::doubleClickInterval() + 50);
    EXPECT_FALSE(screen.list.Editing());
}

TEST(ListViewPeer, AManualListOpensNoEditByClicks) {
    Rows20 screen;
    screen.list.SetLabelEdit(child::ListLabelEditConstants::Manual);
    screen.Click(2);
    screen.Click(2);
    QTest::qWait(QApplication::doubleClickInterval() + 50);
    EXPECT_FALSE(screen.list.Editing());
}

// Drops.

TEST(ListViewPeer, WhatIsDraggedOverTheListAndDroppedIsReported) {
    Rows20 screen;
    QMimeData mime;
    mime.setUrls({QUrl::fromLocalFile("/a"), QUrl::fromLocalFile("/b"), QUrl("https://example.org/c")});
    const QPoint at = screen.LabelPoint(1);
    const auto enter = [&] {
        QDragEnterEvent entered(at, Qt::CopyAction | Qt::MoveAction, &mime, Qt::LeftButton, Qt::ShiftModifier);
        QCoreApplication::sendEvent(screen.port(), &entered);
        return entered.isAccepted() ? entered.dropAction() : Qt::IgnoreAction;
    };
    EXPECT_FALSE(screen.port()->acceptDrops());
    screen.list.SetOLEDropMode(child::OLEDropConstants::Manual);
    screen.Settle();
    EXPECT_TRUE(screen.port()->acceptDrops());
    EXPECT_EQ(enter(), Qt::CopyAction);
    const std::string y = frame::Decimal(15 * (at.y() + screen.view().Header().height()));
    EXPECT_EQ(screen.owner.Heard(), "OLEDragOver 2 1 " + y + " 0");
    QDragLeaveEvent left;
    QCoreApplication::sendEvent(screen.port(), &left);
    EXPECT_EQ(screen.owner.Heard(), "OLEDragOver 2 0 " + y + " 1");
    enter();
    screen.owner.Heard();
    QDropEvent dropped(at, Qt::CopyAction, &mime, Qt::NoButton, Qt::NoModifier);
    QCoreApplication::sendEvent(screen.port(), &dropped);
    EXPECT_THAT(screen.owner.Heard(), testing::StartsWith("OLEDragDrop 2 "));
    EXPECT_FALSE(dropped.isAccepted());  // the handler takes none
}

// Looks.

TEST(ListViewPeer, PaintsTheRowsTheirMarkAndTheirIcons) {
    ListOnScreen screen;
    screen.owner.Image16.SetUseMaskColor(false);
    screen.owner.Image16.Images().Add({}, "red", Square(16, 0xFF0000FF));
    screen.list.SetSmallIcons(&screen.owner.Image16);
    screen.list.Headers().Add({}, {}, "Name", 3000.0f);
    screen.list.SetFullRowSelect(true);
    screen.AddRows(4);
    screen.rows().SetIconKey(screen.rows().At(0), child::IconSize::Small, "red").Check();
    screen.rows().SetIconKey(screen.rows().At(1), child::IconSize::Small, "red").Check();
    screen.rows().SetGhosted(screen.rows().At(1), true);
    screen.list.Select(screen.rows().At(2), true);
    screen.list.FocusInput(4);
    screen.Settle();
    const auto at = [&](int row, int x) { return screen.Pixel(x, screen.CellOf(row).center().y()); };
    EXPECT_EQ(at(0, 12), QColor(Qt::red));
    EXPECT_EQ(at(0, 190), screen.view().palette().color(QPalette::Base));
    EXPECT_EQ(at(1, 12).red(), 255);
    EXPECT_NEAR(at(1, 12).green(), 255 * 0.55, 4);
    EXPECT_EQ(at(2, 190), screen.view().palette().color(QPalette::Active, QPalette::Highlight));
    EXPECT_EQ(screen.Pixel(300, screen.CellOf(2).center().y()), screen.view().palette().color(QPalette::Base));
}

TEST(ListViewPeer, AHiddenSelectionShowsOnlyWithTheFocus) {
    ListOnScreen screen;
    screen.list.Headers().Add({}, {}, "Name", 3000.0f);
    screen.list.SetFullRowSelect(true);
    screen.list.SetHideSelection(true);
    screen.AddRows(2);
    screen.list.Select(screen.rows().At(0), true);
    screen.Settle();
    const auto mark = [&] { return screen.Pixel(190, screen.CellOf(0).center().y()); };
    const QColor base = screen.view().palette().color(QPalette::Base);
    EXPECT_NE(mark(), base);
    screen.view().clearFocus();
    EXPECT_EQ(mark(), base);
    screen.list.SetHideSelection(false);
    screen.Settle();
    EXPECT_NE(mark(), base);
}

TEST(ListViewPeer, IconsAreSharpOnAScreenOfDoubleScale) {
    ListOnScreen screen;
    const auto image = [&](double scale) { return IconOf(&screen.owner.Image16, frame::Variant("icon"), scale); };
    screen.owner.Image16.SetUseMaskColor(false);
    auto planes = std::vector<frame::PixelPlane>{{1, 16, 16, std::vector<std::uint32_t>(256, 0xFF0000FF)},
                                                 {2, 32, 32, std::vector<std::uint32_t>(1024, 0xFF00FF00)}};
    screen.owner.Image16.Images().Add({}, "icon", std::make_shared<frame::Picture>(std::move(planes), ""));
    EXPECT_EQ(image(1).size(), QSize(16, 16));
    EXPECT_EQ(image(1).toImage().pixelColor(8, 8), QColor(Qt::red));
    EXPECT_EQ(image(2).size(), QSize(32, 32));
    EXPECT_EQ(image(2).toImage().pixelColor(8, 8), QColor(Qt::green));
    EXPECT_EQ(image(2).deviceIndependentSize(), QSizeF(16, 16));
    EXPECT_TRUE(IconOf(&screen.owner.Image16, frame::Variant("none"), 1).isNull());
}

TEST(ListViewPeer, ThePictureStandsBehindTheRows) {
    ListOnScreen screen;
    screen.list.SetPicture(Square(20, 0xFF00FF00));
    const auto at = [&](QPoint point) { return screen.Pixel(point); };
    const QColor base = screen.view().palette().color(QPalette::Base), green = Qt::green;
    const QPoint last(screen.port()->width() - 3, screen.port()->height() - 3);
    screen.Settle();
    EXPECT_EQ(at({3, 3}), green);
    EXPECT_EQ(at(last), base);
    screen.list.SetPictureAlignment(child::ListPictureAlignmentConstants::BottomRight);
    screen.Settle();
    EXPECT_EQ(at({3, 3}), base);
    EXPECT_EQ(at(last), green);
    screen.list.SetPictureAlignment(child::ListPictureAlignmentConstants::Center);
    screen.Settle();
    EXPECT_EQ(at(last), base);
    EXPECT_EQ(at({screen.port()->width() / 2, screen.port()->height() / 2}), green);
    screen.list.SetPictureAlignment(child::ListPictureAlignmentConstants::Tile);
    screen.Settle();
    EXPECT_EQ(at({3, 3}), green);
    EXPECT_EQ(at(last), green);
}

TEST(ListViewPeer, HotTrackingShowsTheRowUnderThePointer) {
    Rows20 screen;
    screen.list.SetHotTracking(true);
    screen.list.SetFullRowSelect(true);
    screen.Settle();
    const auto at = [&](int row) { return screen.Pixel(90, screen.CellOf(row).center().y()); };
    const QColor base = screen.view().palette().color(QPalette::Base);
    const auto move = [&](QPoint to) {
        QMouseEvent moved(QEvent::MouseMove, to, screen.port()->mapToGlobal(to), Qt::NoButton, Qt::NoButton, {});
        QCoreApplication::sendEvent(screen.port(), &moved);
    };
    move(screen.LabelPoint(3));
    EXPECT_NE(at(3), base);
    EXPECT_EQ(at(4), base);
    move(screen.LabelPoint(4));
    EXPECT_EQ(at(3), base);
    EXPECT_NE(at(4), base);
    QEvent left(QEvent::Leave);
    QCoreApplication::sendEvent(screen.port(), &left);
    EXPECT_EQ(at(4), base);
}

TEST(ListViewPeer, GridLinesPartRowsAndColumns) {
    Rows20 screen;
    screen.list.SetGridLines(true);
    screen.Settle();
    const QColor base = screen.view().palette().color(QPalette::Base);
    EXPECT_NE(screen.Pixel(250, screen.Height() - 1), base);
    EXPECT_EQ(screen.Pixel(250, screen.Height() / 2), base);
    EXPECT_NE(screen.Pixel(99, screen.Height() / 2), base);
}

TEST(ListViewPeer, SystemColoursAreThoseOfThePalette) {
    ListOnScreen screen;
    QPalette dark;
    dark.setColor(QPalette::Base, QColor(20, 20, 20));
    dark.setColor(QPalette::Text, QColor(240, 240, 240));
    screen.window.setPalette(dark);
    EXPECT_EQ(screen.Pixel(100, 100), QColor(20, 20, 20));
    screen.list.SetBackColor(frame::Rgb(10, 200, 30));
    screen.Settle();
    EXPECT_EQ(screen.Pixel(100, 100), QColor(10, 200, 30));
}

// Assistive programs.

TEST(ListViewPeer, AReportIsATableWithItsHeaders) {
    Rows20 screen;
    screen.Click(2);
    QAccessibleInterface* const table = QAccessible::queryAccessibleInterface(&screen.view());
    ASSERT_TRUE(table && table->tableInterface());
    EXPECT_EQ(table->role(), QAccessible::Table);
    EXPECT_EQ(table->tableInterface()->rowCount(), 20);
    EXPECT_EQ(table->tableInterface()->columnCount(), 2);
    EXPECT_EQ(table->childCount(), 42);
    EXPECT_EQ(table->child(1)->role(), QAccessible::ColumnHeader);
    EXPECT_EQ(table->child(1)->text(QAccessible::Name), "Number");
    QAccessibleInterface* const cell = table->tableInterface()->cellAt(2, 1);
    EXPECT_EQ(cell->text(QAccessible::Name), "2");
    EXPECT_TRUE(cell->state().selected);
    EXPECT_EQ(table->indexOfChild(cell), 7);
    EXPECT_EQ(table->child(7), cell);
    EXPECT_TRUE(table->tableInterface()->cellAt(19, 0)->state().offscreen);
    EXPECT_EQ(table->focusChild()->text(QAccessible::Name), "row 2");
    EXPECT_EQ(table->childAt(cell->rect().center().x(), cell->rect().center().y()), cell);
    EXPECT_EQ(table->tableInterface()->selectedRows(), QList<int>{2});
    EXPECT_TRUE(table->tableInterface()->selectRow(4));
    EXPECT_TRUE(screen.rows().Selected(screen.rows().At(4)));
    screen.list.Headers().Item(1).SetWidth(0);
    screen.Settle();
    EXPECT_EQ(table->tableInterface()->columnCount(), 1);
    EXPECT_EQ(table->tableInterface()->cellAt(2, 0)->text(QAccessible::Name), "2");
}

TEST(ListViewPeer, AnAccessibleRowStaysThatRowAndEndsWithIt) {
    Rows20 screen;
    screen.list.SetView(ListViewConstants::List);
    screen.Settle();
    QAccessibleInterface* const list = QAccessible::queryAccessibleInterface(&screen.view());
    EXPECT_EQ(list->role(), QAccessible::List);
    QAccessibleInterface* const row = list->child(3);
    EXPECT_EQ(row->role(), QAccessible::ListItem);
    screen.rows().SetSortOrder(ListSortOrderConstants::Descending);
    screen.list.SetSorted(true);
    screen.Settle();
    EXPECT_EQ(row->text(QAccessible::Name), "row 3");
    EXPECT_EQ(list->indexOfChild(row), 6);
    screen.rows().Clear();
    screen.Settle();
    EXPECT_FALSE(row->isValid());
    EXPECT_TRUE(row->state().invalid);
}

// Handlers that end or change the list.

TEST(ListViewPeer, AControlThatItsOwnClickEndsBreaksNothing) {
    for (const auto view : allViews) {
        Rows20 screen;
        screen.list.SetView(view);
        screen.Settle();
        bool clicked = false;
        screen.owner.atItemClick = [&] {
            clicked = true;
            screen.widget.reset();
        };
        const QPoint at = screen.CellOf(1).center();
        const QPoint label = view == ListViewConstants::Icon ? at : screen.LabelPoint(1);
        QTest::mouseClick(screen.port(), Qt::LeftButton, {}, label);
        EXPECT_TRUE(clicked) << static_cast<int>(view);
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }
}

TEST(ListViewPeer, AControlThatItsEditEndsBreaksNothing) {
    Edited screen;
    screen.owner.atEditEnd = [&](bool&, std::string&) { screen.widget.reset(); };
    QTest::keyClick(screen.editor(), Qt::Key_Return);
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    EXPECT_FALSE(screen.window.findChild<ListWidget*>());
}

TEST(ListViewPeer, RowsClearedByAClickAreGone) {
    Rows20 screen;
    screen.owner.atItemClick = [&] { screen.rows().Clear(); };
    screen.Click(2);
    EXPECT_EQ(screen.view().model()->rowCount(), 0);
    screen.Click(2);
    screen.Key(Qt::Key_Down);
    screen.Key(Qt::Key_PageDown);
    QTest::keyClicks(&screen.view(), "x");
    EXPECT_EQ(screen.list.TopIndex(), 0);
    EXPECT_TRUE(screen.errors.reports.empty());
}

}  // namespace
}  // namespace tessel::qt::test
