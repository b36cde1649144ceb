#pragma once

#include <QMouseEvent>
#include <QPointer>
#include <QWidget>
#include <cstdint>

#include "frame/PointerTarget.h"

namespace tessel::qt {

std::int16_t ButtonsOf(Qt::MouseButtons buttons);
std::int16_t ShiftOf(Qt::KeyboardModifiers modifiers);

/// Reports the mouse over a widget to the child, or the control's own surface, that it shows. A press and its release are MouseDown
/// and MouseUp, and with the left button over the child Click; the second press of a double click is DblClick alone, and its
/// release MouseUp alone. A pointer that leaves is reported as a move to the nearest point of the edge, so that one who senses the
/// leaving by its edge strip always does. A release that another window had is reported at the next move, and makes no click.
///
/// An input may end the target and its peer: the peer disconnects this object, which lives as long as the widget.
class PointerInput {
  public:
    PointerInput(frame::PointerTarget& target, QWidget& widget) : target_(&target), widget_(widget) {}
    /// From now on nothing is reported.
    void Disconnect() { target_ = nullptr; }

    void Press(const QMouseEvent& event);
    /// Whether the left button's release had been lost.
    bool Move(const QMouseEvent& event);
    void Release(const QMouseEvent& event);
    /// The two halves of it: MouseUp, and whether a click follows; then the click.
    bool ReleaseAlone(const QMouseEvent& event);
    void Click();
    void DoubleClick(const QMouseEvent& event);
    void Leave();

  private:
    /// A point in twips, in the target's own units.
    std::pair<float, float> PointOf(const QMouseEvent& event) const;

    frame::PointerTarget* target_;  // null once it has gone
    QWidget& widget_;
    Qt::MouseButtons held_;       // whose press was reported
    bool doubleClicked_ = false;  // the release that comes now makes no click
    bool inside_ = false;         // a move inside was reported
};

}  // namespace tessel::qt
