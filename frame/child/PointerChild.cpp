#include "frame/child/PointerChild.h"

namespace tessel::child {

void PointerChild::MouseDownInput(std::int16_t button, std::int16_t shift, float x, float y) {
    Enter("MouseDown", [&] { MouseDown(button, shift, x, y); });
}
void PointerChild::MouseMoveInput(std::int16_t button, std::int16_t shift, float x, float y) {
    Enter("MouseMove", [&] { MouseMove(button, shift, x, y); });
}
void PointerChild::MouseUpInput(std::int16_t button, std::int16_t shift, float x, float y) {
    Enter("MouseUp", [&] { MouseUp(button, shift, x, y); });
}
void PointerChild::ClickInput() {
    Enter("Click", [&] { Click(); });
}
void PointerChild::DblClickInput() {
    Enter("DblClick", [&] { DblClick(); });
}

void KeyChild::KeyDownInput(std::int16_t keyCode, std::int16_t shift) {
    Enter("KeyDown", [&] { KeyDown(keyCode, shift); });
}
void KeyChild::KeyPressInput(std::int16_t keyAscii) {
    Enter("KeyPress", [&] { KeyPress(keyAscii); });
}
void KeyChild::KeyUpInput(std::int16_t keyCode, std::int16_t shift) {
    Enter("KeyUp", [&] { KeyUp(keyCode, shift); });
}

}  // namespace tessel::child
