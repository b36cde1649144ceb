#include "hosts/qt/KeyInput.h"

#include <QCoreApplication>
#include <QWidget>
#include <algorithm>

#include "frame/host.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/PointerInput.h"

namespace tessel::qt {

namespace {

struct KeyCode {
    int key;
    std::int16_t code;
};

constexpr KeyCode namedKeys[] = {
    {Qt::Key_Cancel, 3},       {Qt::Key_Backspace, 8}, {Qt::Key_Tab, 9},       {Qt::Key_Backtab, 9},  {Qt::Key_Clear, 12},
    {Qt::Key_Return, 13},      {Qt::Key_Enter, 13},    {Qt::Key_Shift, 16},    {Qt::Key_Control, 17}, {Qt::Key_Alt, 18},
    {Qt::Key_AltGr, 18},       {Qt::Key_Pause, 19},    {Qt::Key_CapsLock, 20}, {Qt::Key_Escape, 27},  {Qt::Key_Space, 32},
    {Qt::Key_PageUp, 33},      {Qt::Key_PageDown, 34}, {Qt::Key_End, 35},      {Qt::Key_Home, 36},    {Qt::Key_Left, 37},
    {Qt::Key_Up, 38},          {Qt::Key_Right, 39},    {Qt::Key_Down, 40},     {Qt::Key_Select, 41},  {Qt::Key_Execute, 43},
    {Qt::Key_Print, 44},       {Qt::Key_SysReq, 44},   {Qt::Key_Insert, 45},   {Qt::Key_Delete, 46},  {Qt::Key_Help, 47},
    {Qt::Key_Super_L, 91},     {Qt::Key_Super_R, 92},  {Qt::Key_Menu, 93},     {Qt::Key_Sleep, 95},   {Qt::Key_NumLock, 144},
    {Qt::Key_ScrollLock, 145},
};

// What stands on the keys of the common layout, without Shift and with it.
constexpr KeyCode printedKeys[] = {
    {'!', '1'}, {'@', '2'}, {'#', '3'},  {'$', '4'}, {'%', '5'}, {'^', '6'}, {'&', '7'},  {'*', '8'},
    {'(', '9'}, {')', '0'}, {';', 186},  {':', 186}, {'=', 187}, {'+', 187}, {',', 188},  {'<', 188},
    {'-', 189}, {'_', 189}, {'.', 190},  {'>', 190}, {'/', 191}, {'?', 191}, {'`', 192},  {'~', 192},
    {'[', 219}, {'{', 219}, {'\\', 220}, {'|', 220}, {']', 221}, {'}', 221}, {'\'', 222}, {'"', 222},
};

constexpr KeyCode padKeys[] = {
    {'*', 106}, {'+', 107}, {',', 108}, {'-', 109}, {'.', 110}, {'/', 111},
};

template <std::size_t N>
std::int16_t CodeIn(const KeyCode (&keys)[N], int key) {
    const auto* const found =
        std::find_if(std::begin(keys), std::end(keys), [&](const KeyCode& known) { return known.key == key; });
    return found != std::end(keys) ? found->code : std::int16_t{0};
}

bool IsBetween(int value, int first, int last) { return value >= first && value <= last; }

}  // namespace

std::int16_t KeyCodeOf(const QKeyEvent& event) {
    constexpr int firstFunctionCode = 112, lastFunctionKey = Qt::Key_F24, padDigits = 96;
    const int key = event.key();
    if (event.modifiers() & Qt::KeypadModifier) {
        if (IsBetween(key, Qt::Key_0, Qt::Key_9)) return static_cast<std::int16_t>(padDigits + key - Qt::Key_0);
        if (const std::int16_t code = CodeIn(padKeys, key)) return code;
    }
    if (IsBetween(key, Qt::Key_0, Qt::Key_9) || IsBetween(key, Qt::Key_A, Qt::Key_Z)) return static_cast<std::int16_t>(key);
    if (IsBetween(key, Qt::Key_F1, lastFunctionKey)) return static_cast<std::int16_t>(firstFunctionCode + key - Qt::Key_F1);
    const std::int16_t code = CodeIn(namedKeys, key);
    return code != 0 ? code : CodeIn(printedKeys, key);
}

std::int16_t KeyAsciiOf(const QKeyEvent& event, frame::CodePage& codePage) {
    constexpr char16_t lastControl = 0x1F, rubout = 0x7F;
    const QString text = event.text();
    if (text.isEmpty() || (event.modifiers() & (Qt::AltModifier | Qt::MetaModifier))) return 0;
    const char16_t unit = text.front().unicode();
    if (unit == rubout) return 0;  // the key that deletes types nothing
    if (unit <= lastControl) return static_cast<std::int16_t>(unit);
    const auto narrow = codePage.ToNarrow(FromQt(text));
    if (narrow && narrow->size() == 1) return static_cast<std::uint8_t>(narrow->front());
    return static_cast<std::int16_t>(unit);
}

std::int16_t ShiftOf(const QKeyEvent& event) {
    const auto own = [&]() -> Qt::KeyboardModifiers {
        switch (event.key()) {
            case Qt::Key_Shift:
                return Qt::ShiftModifier;
            case Qt::Key_Control:
                return Qt::ControlModifier;
            case Qt::Key_Alt:
                return Qt::AltModifier;
            default:
                return {};
        }
    }();
    const bool isPress = event.type() == QEvent::KeyPress;
    return ShiftOf(isPress ? event.modifiers() | own : event.modifiers() & ~own);
}

KeyInput::~KeyInput() { Disconnect(); }

void KeyInput::Disconnect() {
    target_ = nullptr;
    held_.clear();
    if (qApp) qApp->removeEventFilter(this);
}

void KeyInput::Press(const QKeyEvent& event) {
    if (!target_) return;
    const std::int16_t code = KeyCodeOf(event);
    const std::int16_t ascii = KeyAsciiOf(event, target_->InputHost().CodePage());
    if (code != 0) {
        if (held_.empty()) qApp->installEventFilter(this);
        if (!Holds(code)) held_.push_back(code);
        target_->KeyDownInput(code, ShiftOf(event));
    }
    if (ascii != 0 && target_) target_->KeyPressInput(ascii);
}

bool KeyInput::eventFilter(QObject* receiver, QEvent* event) {
    const bool isRelease = event->type() == QEvent::KeyRelease;
    if (!target_ || !receiver->isWidgetType() || (!isRelease && event->type() != QEvent::KeyPress)) return false;
    const auto& key = static_cast<const QKeyEvent&>(*event);
    const std::int16_t code = KeyCodeOf(key);
    if (key.isAutoRepeat() || !Holds(code)) return false;
    // Pressed again elsewhere: its release went to another program.
    if (isRelease || IsElsewhere(static_cast<QWidget&>(*receiver))) LetGo(code);
    if (isRelease) target_->KeyUpInput(code, ShiftOf(key));
    return false;
}

/// A press goes on from a widget to those that it stands on.
bool KeyInput::IsElsewhere(const QWidget& receiver) const {
    const auto* own = static_cast<const QWidget*>(parent());
    return &receiver != own && !own->isAncestorOf(&receiver) && !receiver.isAncestorOf(own);
}

bool KeyInput::Holds(std::int16_t code) const { return std::find(held_.begin(), held_.end(), code) != held_.end(); }

void KeyInput::LetGo(std::int16_t code) {
    std::erase(held_, code);
    if (held_.empty()) qApp->removeEventFilter(this);
}

}  // namespace tessel::qt
