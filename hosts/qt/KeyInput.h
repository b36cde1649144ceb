#pragma once

#include <QKeyEvent>
#include <QObject>
#include <QWidget>
#include <cstdint>
#include <vector>

#include "frame/PointerTarget.h"

namespace tessel::qt {

/// The classic code of a key: its place on the keyboard as far as the toolkit tells it, so that a digit with Shift is still the
/// digit's key. 0 for a key that has none.
std::int16_t KeyCodeOf(const QKeyEvent& event);

/// The character that a key types in the narrow character set of a host, or, where that lacks it, in UTF-16; 0 for none. Ctrl with
/// a letter types 1 to 26.
std::int16_t KeyAsciiOf(const QKeyEvent& event, frame::CodePage& codePage);

/// The shift keys after a key has been pressed or released: the sum of 1 Shift, 2 Ctrl, 4 Alt.
std::int16_t ShiftOf(const QKeyEvent& event);

/// Reports the keys that a widget gets to the child, or the control's own surface, that it shows. Auto-repeat reports presses
/// alone, and the release of a key goes to the one that got its press, wherever the focus is by then.
///
/// An input may end the target and its peer: the peer disconnects this object, which lives as long as the widget.
class KeyInput final : public QObject {
  public:
    KeyInput(frame::KeyTarget& target, QWidget* widget) : QObject(widget), target_(&target) {}
    ~KeyInput() override;
    /// From now on nothing is reported.
    void Disconnect();
    bool IsConnected() const { return target_ != nullptr; }

    /// KeyDown, and KeyPress for a key that types.
    void Press(const QKeyEvent& event);

  protected:
    /// Releases of the keys held are seen wherever they go.
    bool eventFilter(QObject* receiver, QEvent* event) override;

  private:
    bool Holds(std::int16_t code) const;
    bool IsElsewhere(const QWidget& receiver) const;
    void LetGo(std::int16_t code);

    frame::KeyTarget* target_;        // null once it has gone
    std::vector<std::int16_t> held_;  // the keys whose press was reported
};

}  // namespace tessel::qt
