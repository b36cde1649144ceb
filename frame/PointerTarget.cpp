#include "frame/PointerTarget.h"

#include "frame/Control.h"

namespace tessel::frame {

void PointerTarget::MouseDownInput(std::int16_t button, std::int16_t shift, float x, float y) {
    Report("MouseDown", [&] { MouseDown(button, shift, x, y); });
}
void PointerTarget::MouseMoveInput(std::int16_t button, std::int16_t shift, float x, float y) {
    Report("MouseMove", [&] { MouseMove(button, shift, x, y); });
}
void PointerTarget::MouseUpInput(std::int16_t button, std::int16_t shift, float x, float y) {
    Report("MouseUp", [&] { MouseUp(button, shift, x, y); });
}
void PointerTarget::ClickInput() {
    Report("Click", [&] { Click(); });
}
void PointerTarget::DblClickInput() {
    Report("DblClick", [&] { DblClick(); });
}

bool PointerTarget::Listens() const { return MouseDown || MouseMove || MouseUp || Click || DblClick; }

void KeyTarget::KeyDownInput(std::int16_t keyCode, std::int16_t shift) {
    Report("KeyDown", [&] { KeyDown(keyCode, shift); });
}
void KeyTarget::KeyPressInput(std::int16_t keyAscii) {
    Report("KeyPress", [&] { KeyPress(keyAscii); });
}
void KeyTarget::KeyUpInput(std::int16_t keyCode, std::int16_t shift) {
    Report("KeyUp", [&] { KeyUp(keyCode, shift); });
}

bool KeyTarget::Listens() const { return PointerTarget::Listens() || KeyDown || KeyPress || KeyUp; }

namespace detail {

namespace {
template <class Target>
Target& TargetIn(Object& self) {
    if (auto* control = dynamic_cast<Control*>(&self)) return control->Surface();
    return dynamic_cast<Target&>(self);
}
}  // namespace

template <>
PointerTarget& As<PointerTarget>(Object& self) {
    return TargetIn<PointerTarget>(self);
}
template <>
KeyTarget& As<KeyTarget>(Object& self) {
    return TargetIn<KeyTarget>(self);
}

}  // namespace detail

}  // namespace tessel::frame
