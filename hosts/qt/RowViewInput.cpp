#include <QApplication>
#include <QHelpEvent>
#include <QToolTip>
#include <utility>

#include "hosts/qt/RowView.h"

/// What the user does with rows: the mouse and the keys are reported first, then what they mean to the child.
namespace tessel::qt {

bool RowView::Settle() {
    if (Child()) Child()->Host().Flush();
    return Child() != nullptr;
}

QMouseEvent RowView::Inside(const QMouseEvent& event) const {
    const QPointF moved = event.position() + InsideOffset();
    return {event.type(), moved, event.scenePosition(), event.globalPosition(), event.button(), event.buttons(), event.modifiers()};
}

// The mouse.

void RowView::mousePressEvent(QMouseEvent* event) {
    if (!Settle()) return;
    editTimer_.stop();
    clickEdits_.reset();
    pressedAt_ = event->position().toPoint();
    pressedWith_ = event->modifiers();
    const bool bringsFocus = std::exchange(focusedByMouse_, false);
    pointer_.Press(Inside(*event));
    if (event->button() != Qt::LeftButton || !Settle()) return;
    PressAt(*event);
    if (bringsFocus) clickEdits_.reset();  // a click that comes from elsewhere only comes here
}

void RowView::mouseMoveEvent(QMouseEvent* event) {
    if (!Settle()) return;
    pointerAt_ = event->position().toPoint();
    if (pointer_.Move(Inside(*event))) LosePress();
    if (!Settle()) return;
    Hover(pointerAt_);
    const bool isFar = (pointerAt_ - pressedAt_).manhattanLength() >= QApplication::startDragDistance();
    if (!(event->buttons() & Qt::LeftButton)) return;
    if (isFar) clickEdits_.reset();
    DragTo(isFar);
}

void RowView::mouseReleaseEvent(QMouseEvent* event) {
    if (!Settle()) return;
    const bool clicks = pointer_.ReleaseAlone(Inside(*event));
    if (event->button() == Qt::LeftButton && Settle()) ReleaseAt(*event);
    if (clicks) pointer_.Click();
    if (!Settle() || !clicks || !clickEdits_ || !rows_.PositionOf(*clickEdits_)) return;
    editTimer_.start(QApplication::doubleClickInterval(), this);
}

void RowView::mouseDoubleClickEvent(QMouseEvent* event) {
    if (!Settle()) return;
    editTimer_.stop();
    clickEdits_.reset();
    pointer_.DoubleClick(Inside(*event));
    if (event->button() == Qt::LeftButton && Settle()) DoubleClickAt(*event);
}

void RowView::Hover(QPoint at) {
    const auto row = SensesRows() && viewport()->rect().contains(at) ? HitRow(at) : std::nullopt;
    if (row == hot_) return;
    for (const auto changed : {hot_, row})
        if (changed) UpdateRows(*changed, 1);
    hot_ = row;
}

bool RowView::viewportEvent(QEvent* event) {
    switch (event->type()) {
        case QEvent::Leave:
            if (Child()) Hover({-1, -1});
            pointer_.Leave();
            break;
        case QEvent::ToolTip: {
            const auto& help = static_cast<const QHelpEvent&>(*event);
            const QString full = toolTip().isEmpty() && Child() ? FullTextAt(help.pos()) : toolTip();
            QToolTip::showText(help.globalPos(), full, viewport());
            return true;
        }
        case QEvent::HoverEnter:
        case QEvent::HoverMove:
        case QEvent::HoverLeave:
            return QAbstractScrollArea::viewportEvent(event);
        default:
            break;
    }
    return QAbstractItemView::viewportEvent(event);
}

void RowView::timerEvent(QTimerEvent* event) {
    const int id = event->timerId();
    if (id == editTimer_.timerId()) {
        editTimer_.stop();
        const auto wanted = std::exchange(clickEdits_, std::nullopt);
        const auto row = wanted && Settle() ? rows_.PositionOf(*wanted) : std::nullopt;
        if (row && IsSelected(*row)) ReportEditWanted(*row);
    } else if (id == typeTimer_.timerId()) {
        typeTimer_.stop();
        typed_.clear();
    } else {
        QAbstractItemView::timerEvent(event);
    }
}

// Drops.

void RowView::dragEnterEvent(QDragEnterEvent* event) {
    if (Settle()) drops_.Enter(*event, event->position() + InsideOffset());
}

void RowView::dragMoveEvent(QDragMoveEvent* event) {
    if (Settle()) drops_.Over(*event, event->position() + InsideOffset());
}

void RowView::dragLeaveEvent(QDragLeaveEvent*) {
    if (Settle()) drops_.Leave();
}

void RowView::dropEvent(QDropEvent* event) {
    if (Settle()) drops_.Drop(*event, event->position() + InsideOffset());
}

// The keyboard.

void RowView::keyPressEvent(QKeyEvent* event) {
    if (!Settle()) return;
    editTimer_.stop();
    const bool wasEditing = editor_ != nullptr;
    keys_->Press(*event);
    event->accept();
    if (!Settle() || (editor_ && !wasEditing)) return;
    if (ActByKey(*event)) return;
    const bool types = !event->text().isEmpty() && event->text().front().isPrint() &&
                       !(event->modifiers() & (Qt::ControlModifier | Qt::AltModifier | Qt::MetaModifier));
    if (types)
        TypeAhead(event->text());
    else
        event->ignore();
}

std::optional<ListLayout::Step> RowView::StepOf(const QKeyEvent& event) const {
    using Step = ListLayout::Step;
    switch (event.key()) {
        case Qt::Key_Up:
            return Step::Up;
        case Qt::Key_Down:
            return Step::Down;
        case Qt::Key_Left:
            return isRightToLeft() ? Step::Right : Step::Left;
        case Qt::Key_Right:
            return isRightToLeft() ? Step::Left : Step::Right;
        case Qt::Key_PageUp:
            return Step::PageUp;
        case Qt::Key_PageDown:
            return Step::PageDown;
        case Qt::Key_Home:
            return Step::First;
        case Qt::Key_End:
            return Step::Last;
        default:
            return std::nullopt;
    }
}

void RowView::SelectByKeyboard(Position row, Qt::KeyboardModifiers modifiers) {
    const RowKey target = rows_.KeyAt(row);
    ReportSelection(row, modifiers);
    const auto stands = Settle() ? rows_.PositionOf(target) : std::nullopt;
    if (!stands) return;
    const Position before = FirstVisible();
    MakeVisible(*stands);
    if (FirstVisible() != before) ReportScroll(FirstVisible());
}

void RowView::TypeAhead(const QString& typed) {
    const Position count = rows_.HeldRows();
    if (count == 0) return;
    typeTimer_.start(QApplication::keyboardInputInterval(), this);
    typed_ += typed;
    // The same letter again and again goes from row to row.
    const bool isOneLetter = typed_ == QString(typed_.size(), typed_.front());
    const QString wanted = isOneLetter ? typed_.left(1) : typed_;
    const auto focus = FocusPosition();
    const Position first = !focus ? 0 : isOneLetter ? (*focus + 1) % count : *focus;
    if (const auto found = FindFrom(first, wanted)) SelectByKeyboard(*found, Qt::NoModifier);
}

void RowView::focusInEvent(QFocusEvent* event) {
    QAbstractScrollArea::focusInEvent(event);
    focusedByMouse_ = event->reason() == Qt::MouseFocusReason;
    viewport()->update();
}

void RowView::focusOutEvent(QFocusEvent* event) {
    QAbstractScrollArea::focusOutEvent(event);
    editTimer_.stop();
    viewport()->update();
}

}  // namespace tessel::qt
