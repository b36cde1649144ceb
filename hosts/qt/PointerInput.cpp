#include "hosts/qt/PointerInput.h"

#include <QCursor>
#include <QGuiApplication>
#include <algorithm>

#include "hosts/qt/Convert.h"

namespace tessel::qt {

std::int16_t ButtonsOf(Qt::MouseButtons buttons) {
    return static_cast<std::int16_t>((buttons & Qt::LeftButton ? 1 : 0) | (buttons & Qt::RightButton ? 2 : 0) |
                                     (buttons & Qt::MiddleButton ? 4 : 0));
}

std::int16_t ShiftOf(Qt::KeyboardModifiers modifiers) {
    return static_cast<std::int16_t>((modifiers & Qt::ShiftModifier ? 1 : 0) | (modifiers & Qt::ControlModifier ? 2 : 0) |
                                     (modifiers & Qt::AltModifier ? 4 : 0));
}

void PointerInput::Press(const QMouseEvent& event) {
    if (!child_ || ButtonsOf(event.button()) == 0) return;
    held_ |= event.button();
    doubleClicked_ = false;
    inside_ = true;
    const Place at = PlaceOf(Twips(event.position().x()), Twips(event.position().y()));
    child_->MouseDownInput(ButtonsOf(event.button()), ShiftOf(event.modifiers()), at.x, at.y);
}

void PointerInput::Move(const QMouseEvent& event) {
    if (!child_) return;
    inside_ = widget_.rect().contains(event.position().toPoint());
    ReportMove(event.buttons(), event.modifiers(), Twips(event.position().x()), Twips(event.position().y()));
}

void PointerInput::Release(const QMouseEvent& event) {
    if (ReleaseAlone(event)) Click();
}

bool PointerInput::ReleaseAlone(const QMouseEvent& event) {
    if (!child_ || !(held_ & event.button())) return false;
    held_ &= ~Qt::MouseButtons(event.button());
    const bool clicks = event.button() == Qt::LeftButton && !doubleClicked_ && widget_.rect().contains(event.position().toPoint());
    const Place at = PlaceOf(Twips(event.position().x()), Twips(event.position().y()));
    child_->MouseUpInput(ButtonsOf(event.button()), ShiftOf(event.modifiers()), at.x, at.y);
    return clicks && child_;
}

void PointerInput::Click() {
    if (child_) child_->ClickInput();
}

void PointerInput::DoubleClick(const QMouseEvent& event) {
    if (!child_ || ButtonsOf(event.button()) == 0) return;
    held_ |= event.button();
    doubleClicked_ = true;
    child_->DblClickInput();
}

void PointerInput::Leave() {
    if (!child_ || !inside_) return;
    inside_ = false;
    const QPointF at = widget_.mapFromGlobal(QPointF(QCursor::pos()));
    const float right = child_->Width(), bottom = child_->Height();
    float x = std::clamp(Twips(at.x()), 0.0f, right), y = std::clamp(Twips(at.y()), 0.0f, bottom);
    // Something came over the widget while the pointer stood still: it goes out by the nearest edge.
    const float toEdge = std::min({x, right - x, y, bottom - y});
    if (toEdge == x)
        x = 0;
    else if (toEdge == right - x)
        x = right;
    else if (toEdge == y)
        y = 0;
    else
        y = bottom;
    ReportMove(Qt::NoButton, QGuiApplication::keyboardModifiers(), x, y);
}

void PointerInput::ReportMove(Qt::MouseButtons buttons, Qt::KeyboardModifiers modifiers, float x, float y) {
    const Place at = PlaceOf(x, y);
    child_->MouseMoveInput(ButtonsOf(buttons), ShiftOf(modifiers), at.x, at.y);
}

}  // namespace tessel::qt
