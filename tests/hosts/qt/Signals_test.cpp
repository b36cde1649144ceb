#include <QLineEdit>

#include "tests/hosts/qt/QtTest.h"

namespace tessel::qt {
namespace {

class SignalsTest : public test::QtTest {};

TEST_F(SignalsTest, AClickIsDownUpClick) {
    Link* link = Shown();
    Listen(link);
    Click(link, {100, 20});
    EXPECT_EQ(Events(), "MouseDown MouseUp Click");
}

TEST_F(SignalsTest, ADoubleClickEndsWithDblClickAndUp) {
    Link* link = Shown();
    Listen(link);
    DoubleClick(link, {100, 20});
    EXPECT_EQ(Events(), "MouseDown MouseUp Click DblClick MouseUp");
}

TEST_F(SignalsTest, ADoubleClickRunsTheActionOnce) {
    Link* link = Shown();
    DoubleClick(link, {100, 20});
    EXPECT_EQ(Executed(), "open a.txt");
}

TEST_F(SignalsTest, TwoSlowClicksAreTwoClicks) {
    Link* link = Shown();
    Listen(link);
    Click(link, {100, 20});
    Click(link, {100, 20});
    EXPECT_EQ(Events(), "MouseDown MouseUp Click MouseDown MouseUp Click");
    EXPECT_EQ(Executed(), "open a.txt open a.txt");
}

TEST_F(SignalsTest, TheActionRunsAtThePressAfterItsSignal) {
    Link* link = Shown();
    QObject::connect(link, &Link::mouseDown, link, [link] { link->setLinkTo("other.txt"); });
    Press(link, {100, 20});
    EXPECT_EQ(Executed(), "open other.txt");
    Release(link, {100, 20});
    EXPECT_EQ(Executed(), "");
}

TEST_F(SignalsTest, ThePlaceIsInTwipsOfTheLink) {
    Link* link = Shown();
    std::string told;
    const auto note = [&told](const char* what) {
        return [&told, what](short& button, short& shift, float& x, float& y) {
            told += std::string(what) + " " + std::to_string(button) + " " + std::to_string(shift) + " " +
                    std::to_string(static_cast<int>(x)) + "," + std::to_string(static_cast<int>(y)) + "; ";
        };
    };
    QObject::connect(link, &Link::mouseDown, link, note("down"));
    QObject::connect(link, &Link::mouseUp, link, note("up"));
    Press(link, {10, 7});
    Release(link, {12, 8});
    EXPECT_EQ(told, "down 1 0 150,105; up 1 0 180,120; ");
}

TEST_F(SignalsTest, ButtonsAndKeysAreNumbered) {
    Link* link = Shown();
    link->setClickAction(Link::Do_nothing);
    std::string told;
    QObject::connect(link, &Link::mouseDown, link, [&](short& button, short& shift, float&, float&) {
        told += std::to_string(button) + "/" + std::to_string(shift) + " ";
    });
    Press(link, {10, 7}, Qt::LeftButton, Qt::ShiftModifier);
    Release(link, {10, 7});
    Press(link, {10, 7}, Qt::MiddleButton, Qt::ControlModifier | Qt::AltModifier);
    Release(link, {10, 7}, Qt::MiddleButton);
    EXPECT_EQ(told, "1/1 4/6 ");
}

TEST_F(SignalsTest, AMiddlePressRunsTheActionAndMarksTheLinkUsed) {
    Link* link = Shown();
    Listen(link);
    Press(link, {100, 20}, Qt::MiddleButton);
    Release(link, {100, 20}, Qt::MiddleButton);
    EXPECT_THAT(Events(), testing::StartsWith("MouseDown MouseUp"));
    EXPECT_EQ(Executed(), "open a.txt");
    MoveAway();
    EXPECT_EQ(link->control().Label1.ForeColor(), link->control().UsedColor());
}

TEST_F(SignalsTest, ARightPressIsReportedWithButtonTwo) {
    Link* link = Shown();
    int button = 0;
    QObject::connect(link, &Link::mouseDown, link, [&](short& which, short&, float&, float&) { button = which; });
    Listen(link);
    WithMenu([&] { Click(link, {100, 20}, Qt::RightButton); }, [](QWidget*) {});
    test::Settle();
    EXPECT_EQ(button, 2);
    EXPECT_THAT(Events(), testing::StartsWith("MouseDown"));
    EXPECT_EQ(Executed(), "open a.txt");
}

TEST_F(SignalsTest, AfterAContextMenuTheNextClickIsAWholeClick) {
    Link* link = Shown();
    WithMenu([&] { Click(link, {100, 20}, Qt::RightButton); }, [](QWidget*) {});
    test::Settle();
    Listen(link);
    Click(link, {100, 20});
    EXPECT_EQ(Events(), "MouseDown MouseUp Click");
}

TEST_F(SignalsTest, AReleaseOutsideIsNoClick) {
    Link* link = Shown();
    Listen(link);
    float x = 0;
    QObject::connect(link, &Link::mouseUp, link, [&](short&, short&, float& where, float&) { x = where; });
    Press(link, {100, 20});
    MoveTo(link, {300, 20});
    Release(link, {300, 20});
    EXPECT_EQ(Events(), "MouseDown MouseUp");
    EXPECT_EQ(x, 4500);
}

TEST_F(SignalsTest, DraggedOutAndBackIsAClick) {
    Link* link = Shown();
    Listen(link);
    Press(link, {100, 20});
    MoveTo(link, {300, 20});
    MoveTo(link, {90, 20});
    Release(link, {90, 20});
    EXPECT_EQ(Events(), "MouseDown MouseUp Click");
}

TEST_F(SignalsTest, APressElsewhereThatIsReleasedOnTheLinkIsNothing) {
    Link* link = Shown();
    Listen(link);
    QTest::mousePress(window->windowHandle(), Qt::LeftButton, {}, {300, 200});
    Release(link, {100, 20});
    EXPECT_EQ(Events(), "");
}

TEST_F(SignalsTest, MovesTellTheButtonsHeld) {
    Link* link = Shown();
    std::vector<std::string> buttons;
    QObject::connect(link, &Link::mouseMove, link,
                     [&](short& button, short&, float&, float&) { buttons.push_back(std::to_string(button)); });
    MoveTo(link, {100, 20});
    Press(link, {100, 20});
    MoveTo(link, {101, 20});
    Release(link, {101, 20});
    EXPECT_EQ(test::Joined(buttons), "0 1");
}

TEST_F(SignalsTest, LeavingIsAMoveToTheNearestPointOfTheEdge) {
    Link* link = Shown();
    float x = -1, y = -1;
    QObject::connect(link, &Link::mouseMove, link, [&](short&, short&, float& toX, float& toY) { x = toX, y = toY; });
    MoveTo(link, {100, 20});
    MoveTo(link, {100, 200});
    EXPECT_GE(y, link->control().Label1.Height() - 30);
    EXPECT_LE(y, link->control().Label1.Height());
    EXPECT_EQ(x, 1500);
}

TEST_F(SignalsTest, ArgumentsAreReferencesThatTheNextSlotSees) {
    Link* link = Shown();
    short seen = 0;
    float at = 0;
    QObject::connect(link, &Link::mouseDown, link, [](short& button, short&, float& x, float&) { button = 77, x = 5; });
    QObject::connect(link, &Link::mouseDown, link, [&](short& button, short&, float& x, float&) { seen = button, at = x; });
    Press(link, {100, 20});
    EXPECT_EQ(seen, 77);
    EXPECT_EQ(at, 5);
    // What the control does with the place is what the user did.
    MoveAway();
    EXPECT_EQ(link->control().Label1.ForeColor(), link->control().UsedColor());
}

TEST_F(SignalsTest, SlotsMayTakeFewerOrPlainArguments) {
    Link* link = Shown();
    float x = 0;
    int downs = 0;
    QObject::connect(link, &Link::mouseDown, link, [&](short, short, float place) { x = place; });
    QObject::connect(link, SIGNAL(mouseDown(short&, short&, float&, float&)), link, SLOT(refresh()));
    QObject::connect(link, &Link::mouseDown, [&] { ++downs; });
    Press(link, {100, 20});
    EXPECT_EQ(x, 1500);
    EXPECT_EQ(downs, 1);
}

TEST_F(SignalsTest, WhatTheLinkTakesDoesNotReachTheForm) {
    Link* link = Shown();
    struct Presses final : QObject {
        bool eventFilter(QObject*, QEvent* event) override {
            if (event->type() == QEvent::MouseButtonPress || event->type() == QEvent::MouseButtonRelease) ++count;
            return false;
        }
        int count = 0;
    } presses;
    window->installEventFilter(&presses);
    Click(link, {100, 20});
    EXPECT_EQ(presses.count, 0);
}

TEST_F(SignalsTest, ATwoButtonPressIsTwoPressesAndOneClick) {
    Link* link = Shown();
    link->setClickAction(Link::Do_nothing);
    Listen(link);
    Press(link, {100, 20}, Qt::LeftButton);
    Press(link, {100, 20}, Qt::MiddleButton);
    Release(link, {100, 20}, Qt::MiddleButton);
    Release(link, {100, 20}, Qt::LeftButton);
    EXPECT_EQ(Events(), "MouseDown MouseDown MouseUp MouseUp Click");
}

TEST_F(SignalsTest, ALinkHiddenUnderItsPressIsWholeAgainWhenItIsShown) {
    Link* link = Shown();
    Press(link, {100, 20});
    link->hide();
    Release(window, {300, 200});
    link->show();
    test::Settle();
    Listen(link);
    Click(link, {100, 20});
    EXPECT_EQ(Events(), "MouseDown MouseUp Click");
}

TEST_F(SignalsTest, KeysAreNeverReported) {
    Link* link = Shown();
    Listen(link);
    link->setFocus();
    for (const int key : {int(Qt::Key_A), int(Qt::Key_Return), int(Qt::Key_Space), int(Qt::Key_Tab), int(Qt::Key_Escape)}) {
        QTest::keyClick(link, static_cast<Qt::Key>(key));
    }
    const std::string events = Events();
    EXPECT_EQ(events.find("Key"), std::string::npos) << events;
}

TEST_F(SignalsTest, ADisconnectedSlotHearsNothing) {
    Link* link = Shown();
    int count = 0;
    const auto connection = QObject::connect(link, &Link::click, [&] { ++count; });
    Click(link, {100, 20});
    QObject::disconnect(connection);
    Click(link, {100, 20});
    EXPECT_EQ(count, 1);
}

TEST_F(SignalsTest, BlockedSignalsAreNotHeardAndTheLinkStillWorks) {
    Link* link = Shown();
    Listen(link);
    link->blockSignals(true);
    Click(link, {100, 20});
    EXPECT_EQ(Events(), "");
    EXPECT_EQ(Executed(), "open a.txt");
}

TEST_F(SignalsTest, AtDesignTimeALinkTakesNoInput) {
    host->setUserMode(false);
    Link* link = Shown();
    Listen(link);
    MoveTo(link, {100, 20});
    Click(link, {100, 20});
    link->setFocus();
    QTest::keyClick(window.data(), Qt::Key_Return);
    EXPECT_EQ(Events(), "");
    EXPECT_EQ(Executed(), "");
    EXPECT_EQ(link->control().Label1.ForeColor(), link->control().ForeColor());
}

TEST_F(SignalsTest, ALinkThatBecomesLiveTakesInput) {
    host->setUserMode(false);
    Link* link = Shown();
    host->setUserMode(true);
    Listen(link);
    Click(link, {100, 20});
    EXPECT_EQ(Events(), "MouseDown MouseUp Click");
}

TEST_F(SignalsTest, ADisabledLinkTakesNothing) {
    Link* link = Shown();
    Listen(link);
    link->setEnabled(false);
    MoveTo(link, {100, 20});
    Click(link, {100, 20});
    QTest::keyClick(window.data(), Qt::Key_Return);
    EXPECT_EQ(Events(), "");
    EXPECT_EQ(Executed(), "");
    EXPECT_EQ(link->control().Label1.ForeColor(), link->control().ForeColor());
}

TEST_F(SignalsTest, ALinkDisabledByItsPressDoesNotClick) {
    Link* link = Shown();
    Listen(link);
    QObject::connect(link, &Link::mouseDown, link, [link] { link->setEnabled(false); });
    Click(link, {100, 20});
    EXPECT_EQ(Events(), "MouseDown");
    link->setEnabled(true);
    QObject::disconnect(link, &Link::mouseDown, nullptr, nullptr);
    Listen(link);
    heard.clear();
    Click(link, {100, 20});
    EXPECT_THAT(Events(), testing::HasSubstr("Click"));
}

}  // namespace
}  // namespace tessel::qt
