#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>

#include "frame/Event.h"
#include "frame/Member.h"
#include "frame/host.h"

namespace tessel::frame {

/// What takes the mouse: a child, or the surface that a control itself is. A screen reports what the user does by the functions
/// whose names end in `Input`, through the one way in; the events go to the control.
class PointerTarget {
  public:
    // Coordinates are in twips of the child, and in its own scale on a control's own surface. Buttons: 1 left, 2 right, 4
    // middle; in a move, the sum of those held. Shift: the sum of 1 Shift, 2 Ctrl, 4 Alt.
    void MouseDownInput(std::int16_t button, std::int16_t shift, float x, float y);
    void MouseMoveInput(std::int16_t button, std::int16_t shift, float x, float y);
    void MouseUpInput(std::int16_t button, std::int16_t shift, float x, float y);
    void ClickInput();
    void DblClickInput();

    // Where the events go.
    Slot<std::int16_t, std::int16_t, float, float> MouseDown, MouseMove, MouseUp;
    Slot<> Click, DblClick;

    /// Whether the control has asked for any of the events.
    virtual bool Listens() const;
    virtual Host& InputHost() const = 0;
    /// The size in twips.
    virtual TextSize InputExtent() const = 0;
    /// A point in twips from the left top corner, in the units in which it is reported.
    virtual std::pair<float, float> InputPoint(float x, float y) const { return {x, y}; }

  protected:
    PointerTarget() = default;
    PointerTarget(const PointerTarget&) = delete;
    PointerTarget& operator=(const PointerTarget&) = delete;
    ~PointerTarget() = default;

    /// Whether the host has not let go of the control.
    virtual bool TakesInput() const = 0;
    /// Where an error is said to have happened.
    virtual std::string InputPath() const = 0;
    template <class F>
    void Report(std::string_view event, F&& call) {
        if (!TakesInput()) return;
        Entry::Run(
            InputHost(), [&] { return InputPath() + "." + std::string(event); }, call);
    }
};

/// What takes the keys too.
class KeyTarget : public PointerTarget {
  public:
    // A key's code, and the character that it types.
    void KeyDownInput(std::int16_t keyCode, std::int16_t shift);
    void KeyPressInput(std::int16_t keyAscii);
    void KeyUpInput(std::int16_t keyCode, std::int16_t shift);

    Slot<std::int16_t, std::int16_t> KeyDown, KeyUp;
    Slot<std::int16_t> KeyPress;

    bool Listens() const override;

  protected:
    ~KeyTarget() = default;
};

namespace detail {
// What is reported to an object by name: a child takes it itself, a control's own surface takes what is reported to the control.
template <>
PointerTarget& As<PointerTarget>(Object& self);
template <>
KeyTarget& As<KeyTarget>(Object& self);
}  // namespace detail

/// The rows of what a screen reports, as tables of such children and of controls with such a surface have them.
inline constexpr std::array pointerInputs = {
    input<&PointerTarget::MouseDownInput>("MouseDown", {"Button", "Shift", "X", "Y"}),
    input<&PointerTarget::MouseMoveInput>("MouseMove", {"Button", "Shift", "X", "Y"}),
    input<&PointerTarget::MouseUpInput>("MouseUp", {"Button", "Shift", "X", "Y"}),
    input<&PointerTarget::ClickInput>("Click"),
    input<&PointerTarget::DblClickInput>("DblClick"),
};
inline constexpr auto keyInputs = Join(pointerInputs, std::array{
                                                          input<&KeyTarget::KeyDownInput>("KeyDown", {"KeyCode", "Shift"}),
                                                          input<&KeyTarget::KeyPressInput>("KeyPress", {"KeyAscii"}),
                                                          input<&KeyTarget::KeyUpInput>("KeyUp", {"KeyCode", "Shift"}),
                                                      });

}  // namespace tessel::frame
