#pragma once

#include <QMouseEvent>
#include <QPointer>
#include <QWidget>
#include <cstdint>

#include "frame/child/PointerChild.h"

namespace tessel::qt {

std::int16_t ButtonsOf(Qt::MouseButtons buttons);
std::int16_t ShiftOf(Qt::KeyboardModifiers modifiers);

/// Reports the mouse over a widget to the child that it shows. A press and its release are MouseDown and MouseUp, and with the left
/// button over the child Click; the second press of a double click is DblClick alone, and its release MouseUp alone. A pointer that
/// leaves is reported as a move to the nearest point of the edge, so that a child which senses the leaving by its edge strip always
/// does.
///
/// An input may end the child and its peer: the peer disconnects this object, which lives as long as the widget.
class PointerInput {
  public:
    PointerInput(child::PointerChild& child, QWidget& widget) : child_(&child), widget_(widget) {}
    virtual ~PointerInput() = default;
    /// From now on nothing is reported.
    void Disconnect() { child_ = nullptr; }

    void Press(const QMouseEvent& event);
    void Move(const QMouseEvent& event);
    void Release(const QMouseEvent& event);
    /// The two halves of it: MouseUp, and whether a click follows; then the click.
    bool ReleaseAlone(const QMouseEvent& event);
    void Click();
    void DoubleClick(const QMouseEvent& event);
    void Leave();

  protected:
    struct Place {
        float x = 0, y = 0;
    };
    /// What is reported of a place on the widget, which is given in twips.
    virtual Place PlaceOf(float xTwips, float yTwips) const { return {xTwips, yTwips}; }

  private:
    void ReportMove(Qt::MouseButtons buttons, Qt::KeyboardModifiers modifiers, float x, float y);

    child::PointerChild* child_;  // null once it has gone
    QWidget& widget_;
    Qt::MouseButtons held_;       // whose press was reported
    bool doubleClicked_ = false;  // the release that comes now makes no click
    bool inside_ = false;         // a move inside was reported
};

}  // namespace tessel::qt
