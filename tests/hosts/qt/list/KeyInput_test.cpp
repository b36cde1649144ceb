#include "hosts/qt/KeyInput.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QTest>
#include <memory>
#include <string>

#include "frame/Text.h"
#include "frame/Windows1252.h"
#include "frame/child/TextBox.h"
#include "tests/hosts/qt/list/ListOnScreen.h"

namespace tessel::qt::test {
namespace {

QKeyEvent Pressed(int key, Qt::KeyboardModifiers modifiers = {}, const QString& text = {}) {
    return {QEvent::KeyPress, key, modifiers, text};
}

TEST(KeyInput, LettersDigitsAndFunctionKeysHaveTheirClassicCodes) {
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_A)), 65);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_Z, Qt::ShiftModifier)), 90);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_0)), 48);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_F1)), 112);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_F2)), 113);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_F24)), 135);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_F25)), 0);
}

TEST(KeyInput, KeysWithNamesHaveTheirClassicCodes) {
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_Backspace)), 8);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_Return)), 13);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_Enter, Qt::KeypadModifier)), 13);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_Escape)), 27);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_Space)), 32);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_PageUp)), 33);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_Left)), 37);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_Down)), 40);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_Delete)), 46);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_Shift)), 16);
}

TEST(KeyInput, ASignBelongsToTheKeyThatHasIt) {
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_Exclam, Qt::ShiftModifier, "!")), '1');
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_Comma)), 188);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_Less, Qt::ShiftModifier)), 188);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_BracketLeft)), 219);
}

TEST(KeyInput, TheNumberPadHasCodesOfItsOwn) {
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_7, Qt::KeypadModifier)), 103);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_Plus, Qt::KeypadModifier)), 107);
    EXPECT_EQ(KeyCodeOf(Pressed(Qt::Key_Home, Qt::KeypadModifier)), 36);
}

TEST(KeyInput, TypedCharactersAreThoseOfTheNarrowSet) {
    frame::Windows1252 codePage;
    EXPECT_EQ(KeyAsciiOf(Pressed(Qt::Key_A, {}, "a"), codePage), 'a');
    EXPECT_EQ(KeyAsciiOf(Pressed(Qt::Key_A, Qt::ControlModifier, "\x01"), codePage), 1);
    EXPECT_EQ(KeyAsciiOf(Pressed(Qt::Key_Return, {}, "\r"), codePage), 13);
    EXPECT_EQ(KeyAsciiOf(Pressed(Qt::Key_Delete, {}, "\x7F"), codePage), 0);
    EXPECT_EQ(KeyAsciiOf(Pressed(Qt::Key_Left), codePage), 0);
    EXPECT_EQ(KeyAsciiOf(Pressed(Qt::Key_A, Qt::AltModifier, "a"), codePage), 0);
    EXPECT_EQ(KeyAsciiOf(Pressed(0, {}, QString(QChar(0x20AC))), codePage), 0x80);
    EXPECT_EQ(KeyAsciiOf(Pressed(0, {}, QString(QChar(0x0416))), codePage), 0x0416);
}

TEST(KeyInput, AShiftKeyIsHeldFromItsPressToItsRelease) {
    EXPECT_EQ(ShiftOf(QKeyEvent(QEvent::KeyPress, Qt::Key_Shift, Qt::NoModifier)), 1);
    EXPECT_EQ(ShiftOf(QKeyEvent(QEvent::KeyRelease, Qt::Key_Shift, Qt::ShiftModifier)), 0);
    EXPECT_EQ(ShiftOf(QKeyEvent(QEvent::KeyPress, Qt::Key_A, Qt::ControlModifier | Qt::AltModifier)), 6);
}

/// Two text boxes that write down the keys that they hear.
class TwoBoxes final : public frame::Control {
  public:
    explicit TwoBoxes(frame::Host& host) : Control(host) {
        first.KeyDown.To<&TwoBoxes::FirstDown>(*this);
        first.KeyPress.To<&TwoBoxes::FirstPress>(*this);
        first.KeyUp.To<&TwoBoxes::FirstUp>(*this);
        second.KeyDown.To<&TwoBoxes::SecondDown>(*this);
        second.KeyUp.To<&TwoBoxes::SecondUp>(*this);
        first.Move(0, 0, 1500, 300);
        second.Move(0, 400, 1500, 300);
    }
    frame::TextSize DesignSize() const override { return {3000, 2000}; }
    const frame::ClassTable& Table() const override {
        static constexpr frame::ClassTable table{.name = "TwoBoxes", .members = {}};
        return table;
    }
    std::string Heard() { return std::exchange(heard_, ""); }

    child::TextBox first{*this, "first"}, second{*this, "second"};
    bool movesFocus = false;
    std::function<void()> atFirstDown;

  private:
    void Hear(const std::string& what, std::int32_t key, std::int32_t shift) {
        heard_ += (heard_.empty() ? "" : " | ") + what + " " + frame::Decimal(key) + " " + frame::Decimal(shift);
    }
    void FirstDown(std::int16_t key, std::int16_t shift) {
        Hear("first down", key, shift);
        if (movesFocus) Host().Focus().Set(second);
        if (atFirstDown) atFirstDown();
    }
    void FirstPress(std::int16_t key) { Hear("first press", key, 0); }
    void FirstUp(std::int16_t key, std::int16_t shift) { Hear("first up", key, shift); }
    void SecondDown(std::int16_t key, std::int16_t shift) { Hear("second down", key, shift); }
    void SecondUp(std::int16_t key, std::int16_t shift) { Hear("second up", key, shift); }

    std::string heard_;
};

struct TwoBoxesOnScreen : OnScreen<TwoBoxes> {
    TwoBoxesOnScreen() : OnScreen(200, 100) {
        Settle();
        host->frameHost().Focus().Set(owner.first);
    }
    TwoBoxes& owner = widget->owner();
};

TEST(KeyInput, APressTypesAndItsReleaseFollows) {
    TwoBoxesOnScreen screen;
    QTest::keyClick(QApplication::focusWidget(), 'a');
    EXPECT_EQ(screen.owner.Heard(), "first down 65 0 | first press 97 0 | first up 65 0");
    EXPECT_EQ(screen.owner.first.Text(), "a");
}

TEST(KeyInput, AutoRepeatGivesPressesButNoRelease) {
    TwoBoxesOnScreen screen;
    QWidget* const edit = QApplication::focusWidget();
    for (const auto type : {QEvent::KeyPress, QEvent::KeyRelease, QEvent::KeyPress, QEvent::KeyRelease}) {
        QKeyEvent repeated(type, Qt::Key_Down, Qt::NoModifier, {}, true);
        QCoreApplication::sendEvent(edit, &repeated);
    }
    QKeyEvent released(QEvent::KeyRelease, Qt::Key_Down, Qt::NoModifier);
    QCoreApplication::sendEvent(edit, &released);
    EXPECT_EQ(screen.owner.Heard(), "first down 40 0 | first down 40 0 | first up 40 0");
}

TEST(KeyInput, AReleaseGoesToTheChildThatGotThePress) {
    TwoBoxesOnScreen screen;
    screen.owner.movesFocus = true;
    QTest::keyPress(QApplication::focusWidget(), Qt::Key_F2);
    EXPECT_EQ(QApplication::focusWidget()->parentWidget()->objectName(), "second");
    QTest::keyRelease(QApplication::focusWidget(), Qt::Key_F2);
    EXPECT_EQ(screen.owner.Heard(), "first down 113 0 | first up 113 0");
}

TEST(KeyInput, ADigitReleasedAfterShiftIsTheSameKey) {
    TwoBoxesOnScreen screen;
    QWidget* const edit = QApplication::focusWidget();
    QKeyEvent pressed(QEvent::KeyPress, Qt::Key_Exclam, Qt::ShiftModifier, "!");
    QKeyEvent released(QEvent::KeyRelease, Qt::Key_1, Qt::NoModifier, "1");
    QCoreApplication::sendEvent(edit, &pressed);
    QCoreApplication::sendEvent(edit, &released);
    EXPECT_EQ(screen.owner.Heard(), "first down 49 1 | first press 33 0 | first up 49 0");
}

TEST(KeyInput, AReleaseThatNeverCameIsNotMadeUpLater) {
    TwoBoxesOnScreen screen;
    QTest::keyPress(QApplication::focusWidget(), Qt::Key_Down);
    screen.host->frameHost().Focus().Set(screen.owner.second);
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Down);
    EXPECT_EQ(screen.owner.Heard(), "first down 40 0 | second down 40 0 | second up 40 0");
}

TEST(KeyInput, AControlThatAKeyEndsHearsNoMore) {
    TwoBoxesOnScreen screen;
    const QPointer<QWidget> edit = QApplication::focusWidget();
    std::string heard;
    screen.owner.atFirstDown = [&] {
        heard = screen.owner.Heard();
        screen.widget.reset();
    };
    QTest::keyPress(edit, 'a');
    QKeyEvent released(QEvent::KeyRelease, Qt::Key_A, Qt::NoModifier, "a");
    if (edit) QCoreApplication::sendEvent(edit, &released);
    EXPECT_EQ(heard, "first down 65 0");
    EXPECT_TRUE(screen.errors.reports.empty());
}

}  // namespace
}  // namespace tessel::qt::test
