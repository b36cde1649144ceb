#pragma once

#include "frame/ChildControl.h"

namespace tessel::child {

/// The base of children that take the mouse. A peer reports what the user does; the events go to the child's control.
class PointerChild : public frame::ChildControl {
  public:
    using ChildControl::ChildControl;

    // What a peer reports. Coordinates are in twips of the child, in the surface's own scale for one that is drawn on. Buttons: 1
    // left, 2 right, 4 middle; in a move, the sum of those held. Shift: the sum of 1 Shift, 2 Ctrl, 4 Alt.
    void MouseDownInput(std::int16_t button, std::int16_t shift, float x, float y);
    void MouseMoveInput(std::int16_t button, std::int16_t shift, float x, float y);
    void MouseUpInput(std::int16_t button, std::int16_t shift, float x, float y);
    void ClickInput();
    void DblClickInput();

    // Where the events go.
    frame::Slot<std::int16_t, std::int16_t, float, float> MouseDown, MouseMove, MouseUp;
    frame::Slot<> Click, DblClick;
};

/// The base of children that take the keys too.
class KeyChild : public PointerChild {
  public:
    using PointerChild::PointerChild;

    // What a peer reports: a key's code, and the character that it types.
    void KeyDownInput(std::int16_t keyCode, std::int16_t shift);
    void KeyPressInput(std::int16_t keyAscii);
    void KeyUpInput(std::int16_t keyCode, std::int16_t shift);

    frame::Slot<std::int16_t, std::int16_t> KeyDown, KeyUp;
    frame::Slot<std::int16_t> KeyPress;
};

/// The rows of what a peer reports, as tables of such children have them.
inline constexpr std::array pointerInputs = {
    frame::input<&PointerChild::MouseDownInput>("MouseDown", {"Button", "Shift", "X", "Y"}),
    frame::input<&PointerChild::MouseMoveInput>("MouseMove", {"Button", "Shift", "X", "Y"}),
    frame::input<&PointerChild::MouseUpInput>("MouseUp", {"Button", "Shift", "X", "Y"}),
    frame::input<&PointerChild::ClickInput>("Click"),
    frame::input<&PointerChild::DblClickInput>("DblClick"),
};
inline constexpr auto keyInputs =
    frame::Join(pointerInputs, std::array{
                                   frame::input<&KeyChild::KeyDownInput>("KeyDown", {"KeyCode", "Shift"}),
                                   frame::input<&KeyChild::KeyPressInput>("KeyPress", {"KeyAscii"}),
                                   frame::input<&KeyChild::KeyUpInput>("KeyUp", {"KeyCode", "Shift"}),
                               });

}  // namespace tessel::child
