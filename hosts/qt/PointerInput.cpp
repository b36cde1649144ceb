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
    if (!target_ || ButtonsOf(event.button()) == 0) return;
    held_ |= event.button();
    doubleClicked_ = false;
    inside_ = true;
    const auto [x, y] = PointOf(event);
    target_->MouseDownInput(ButtonsOf(event.button()), ShiftOf(event.modifiers()), x, y);
}

bool PointerInput::Move(const QMouseEvent& event) {
    if (!target_) return false;
    const bool lost = (held_ & Qt::LeftButton) && !(event.buttons() & Qt::LeftButton);
    inside_ = widget_.rect().contains(event.position().toPoint());
    const auto [x, y] = PointOf(event);
    // Another window had the release: a box that came meanwhile.
    for (const Qt::MouseButton button : {Qt::LeftButton, Qt::RightButton, Qt::MiddleButton}) {
        if (!target_ || !(held_ & button) || (event.buttons() & button)) continue;
        held_ &= ~Qt::MouseButtons(button);
        target_->MouseUpInput(ButtonsOf(button), ShiftOf(event.modifiers()), x, y);
    }
    if (!target_) return lost;
    target_->MouseMoveInput(ButtonsOf(event.buttons()), ShiftOf(event.modifiers()), x, y);
    return lost;
}

void PointerInput::Release(const QMouseEvent& event) {
    if (ReleaseAlone(event)) Click();
}

bool PointerInput::ReleaseAlone(const QMouseEvent& event) {
    if (!target_ || !(held_ & event.button())) return false;
    held_ &= ~Qt::MouseButtons(event.button());
    const bool clicks = event.button() == Qt::LeftButton && !doubleClicked_ && widget_.rect().contains(event.position().toPoint());
    const auto [x, y] = PointOf(event);
    target_->MouseUpInput(ButtonsOf(event.button()), ShiftOf(event.modifiers()), x, y);
    return clicks && target_;
}

void PointerInput::Click() {
    if (target_) target_->ClickInput();
}

void PointerInput::DoubleClick(const QMouseEvent& event) {
    if (!target_ || ButtonsOf(event.button()) == 0) return;
    held_ |= event.button();
    doubleClicked_ = true;
    target_->DblClickInput();
}

void PointerInput::Leave() {
    if (!target_ || !inside_) return;
    inside_ = false;
    const QPointF at = widget_.mapFromGlobal(QPointF(QCursor::pos()));
    const auto [right, bottom] = target_->InputExtent();
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
    const auto [unitX, unitY] = target_->InputPoint(x, y);
    target_->MouseMoveInput(0, ShiftOf(QGuiApplication::keyboardModifiers()), unitX, unitY);
}

std::pair<float, float> PointerInput::PointOf(const QMouseEvent& event) const {
    return target_->InputPoint(Twips(event.position().x()), Twips(event.position().y()));
}

}  // namespace tessel::qt
