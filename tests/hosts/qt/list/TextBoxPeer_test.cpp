#include "hosts/qt/TextBoxPeer.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <functional>

#include "tests/hosts/qt/list/ListOnScreen.h"

namespace tessel::qt::test {
namespace {

class BoxOwner final : public frame::Control {
  public:
    explicit BoxOwner(frame::Host& host) : Control(host) {
        box.Change.To<&BoxOwner::Changed>(*this);
        box.MouseDown.To<&BoxOwner::Pressed>(*this);
        box.Click.To<&BoxOwner::Clicked>(*this);
        box.Move(0, 0, 3000, 600);
    }
    frame::TextSize DesignSize() const override { return {3000, 600}; }
    const frame::ClassTable& Table() const override {
        static constexpr frame::ClassTable table{.name = "BoxOwner", .members = {}};
        return table;
    }
    child::TextBox box{*this, "Text1"};
    std::string heard;
    std::function<void()> atChange;

  private:
    void Changed() {
        heard += "Change " + box.Text() + " | ";
        if (atChange) atChange();
    }
    void Pressed(std::int16_t button, std::int16_t, float, float) { heard += "MouseDown " + std::to_string(button) + " | "; }
    void Clicked() { heard += "Click | "; }
};

struct BoxOnScreen : OnScreen<BoxOwner> {
    BoxOnScreen() : OnScreen(200, 60) { Settle(); }
    QLineEdit* line() { return window.findChild<QLineEdit*>(); }
    QPlainTextEdit* lines() { return window.findChild<QPlainTextEdit*>(); }
    BoxOwner& owner = widget->owner();
    child::TextBox& box = owner.box;
};

TEST(TextBoxPeer, ShowsTheTextAndReportsWhatIsTyped) {
    BoxOnScreen screen;
    screen.box.SetText("abc");
    screen.Settle();
    ASSERT_TRUE(screen.line());
    EXPECT_EQ(screen.line()->text(), "abc");
    screen.owner.heard.clear();
    screen.host->frameHost().Focus().Set(screen.box);
    EXPECT_TRUE(screen.line()->hasFocus());
    QTest::keyClick(screen.line(), Qt::Key_End);
    QTest::keyClicks(screen.line(), "de");
    EXPECT_EQ(screen.owner.heard, "Change abcd | Change abcde | ");
    EXPECT_EQ(screen.box.Text(), "abcde");
}

TEST(TextBoxPeer, TypedTextKeepsTheCursorWhereItIs) {
    BoxOnScreen screen;
    screen.box.SetText("ad");
    screen.Settle();
    screen.line()->setCursorPosition(1);
    QTest::keyClicks(screen.line(), "bc");
    EXPECT_EQ(screen.box.Text(), "abcd");
    EXPECT_EQ(screen.line()->cursorPosition(), 3);
}

TEST(TextBoxPeer, AHandlerMayPutAnotherText) {
    BoxOnScreen screen;
    screen.owner.atChange = [&] {
        if (screen.box.Text() != "fixed") screen.box.SetText("fixed");
    };
    QTest::keyClicks(screen.line(), "x");
    EXPECT_EQ(screen.box.Text(), "fixed");
    EXPECT_EQ(screen.line()->text(), "fixed");
    QTest::keyClick(screen.line(), Qt::Key_Backspace);
    EXPECT_EQ(screen.line()->text(), "fixed");
}

TEST(TextBoxPeer, SeveralLinesAreAnotherEditWithTheSameText) {
    BoxOnScreen screen;
    screen.box.SetText("one");
    screen.box.SetMultiLine(true);
    screen.Settle();
    ASSERT_TRUE(screen.lines());
    EXPECT_EQ(screen.lines()->toPlainText(), "one");
    screen.lines()->moveCursor(QTextCursor::End);
    QTest::keyClick(screen.lines(), Qt::Key_Return);
    QTest::keyClicks(screen.lines(), "two");
    EXPECT_EQ(screen.box.Text(), "one\ntwo");
    screen.box.SetMultiLine(false);
    screen.Settle();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    EXPECT_FALSE(screen.lines());
    EXPECT_TRUE(screen.line()->isVisible());
}

TEST(TextBoxPeer, ALockedTextIsOnlyRead) {
    BoxOnScreen screen;
    screen.box.SetText("abc");
    screen.box.SetLocked(true);
    screen.Settle();
    QTest::keyClicks(screen.line(), "x");
    EXPECT_EQ(screen.box.Text(), "abc");
}

TEST(TextBoxPeer, FollowsAlignmentColoursAndWhetherItIsEnabled) {
    BoxOnScreen screen;
    screen.box.SetAlignment(child::AlignmentConstants::RightJustify);
    screen.box.SetBackColor(frame::Rgb(1, 2, 3));
    screen.box.SetForeColor(frame::Rgb(250, 240, 230));
    screen.box.SetEnabled(false);
    screen.Settle();
    EXPECT_TRUE(screen.line()->alignment() & Qt::AlignRight);
    EXPECT_EQ(screen.line()->palette().color(QPalette::Base), QColor(1, 2, 3));
    EXPECT_EQ(screen.line()->palette().color(QPalette::Active, QPalette::Text), QColor(250, 240, 230));
    EXPECT_FALSE(screen.line()->isEnabled());
}

TEST(TextBoxPeer, ReportsTheMouse) {
    BoxOnScreen screen;
    QTest::mouseClick(screen.line(), Qt::LeftButton, {}, {10, 10});
    EXPECT_EQ(screen.owner.heard, "MouseDown 1 | Click | ");
}

TEST(TextBoxPeer, AControlThatItsOwnChangeEndsBreaksNothing) {
    for (const bool lines : {false, true}) {
        BoxOnScreen screen;
        screen.box.SetMultiLine(lines);
        screen.Settle();
        bool changed = false;
        screen.owner.atChange = [&] {
            changed = true;
            screen.widget.reset();
        };
        const QPointer<QWidget> edit = lines ? static_cast<QWidget*>(screen.lines()) : screen.line();
        QTest::keyClick(edit, 'x');
        EXPECT_TRUE(changed);
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        EXPECT_FALSE(edit);
    }
}

}  // namespace
}  // namespace tessel::qt::test
