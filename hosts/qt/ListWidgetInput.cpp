#include <QApplication>
#include <QHelpEvent>
#include <QScrollBar>
#include <QStyle>
#include <QToolTip>
#include <algorithm>

#include "hosts/qt/Convert.h"
#include "hosts/qt/ListWidget.h"

/// What the user does with a list: the mouse and the keys are reported first, then what they mean to the list. Any report may end
/// the list.
namespace tessel::qt {

using child::ListSelectConstants;
using child::RowRange;

namespace {

constexpr Qt::KeyboardModifiers selecting = Qt::ShiftModifier | Qt::ControlModifier;

/// The rows of `from` that are not in `without`.
std::vector<RowRange> Less(const std::vector<RowRange>& from, const std::vector<RowRange>& without) {
    std::vector<RowRange> result;
    for (const RowRange range : from) {
        auto first = range.first;
        const auto end = range.first + range.count;
        for (const RowRange hole : without) {
            const auto holeEnd = hole.first + hole.count;
            if (holeEnd <= first || hole.first >= end) continue;
            if (hole.first > first) result.push_back({first, hole.first - first});
            first = std::min(end, holeEnd);
        }
        if (first < end) result.push_back({first, end - first});
    }
    return result;
}

}  // namespace

bool ListWidget::Settle() {
    if (list_) list_->Host().Flush();
    return list_ != nullptr;
}

QMouseEvent ListWidget::Inside(const QMouseEvent& event) const {
    const QPointF moved = event.position() + InsideOffset();
    return {event.type(), moved, event.scenePosition(), event.globalPosition(), event.button(), event.buttons(), event.modifiers()};
}

// The mouse.

void ListWidget::mousePressEvent(QMouseEvent* event) {
    if (!Settle()) return;
    editTimer_.stop();
    hoverTimer_.stop();
    pressedSelected_.reset();
    clickEdits_.reset();
    pressedBeside_.reset();
    pressedAt_ = event->position().toPoint();
    pressedWith_ = event->modifiers();
    const bool bringsFocus = std::exchange(focusedByMouse_, false);
    pointer_.Press(Inside(*event));
    if (event->button() != Qt::LeftButton || !Settle()) return;
    if (const auto row = HitRow(pressedAt_))
        PressRow(*row, *event);
    else
        PressBeside(*event);
    if (bringsFocus) clickEdits_.reset();  // a click that comes from elsewhere only comes here
}

void ListWidget::PressRow(Position row, const QMouseEvent& event) {
    const child::RowId id = list_->Rows().At(row);
    const bool isPlain = (event.modifiers() & selecting) == 0;
    if (!list_->Rows().Selected(id) || !isPlain) return list_->ItemClickInput(IndexOf(row), ShiftOf(event.modifiers()));
    pressedSelected_ = row;
    const bool isOnly = list_->Rows().SelectedCount() == 1 && list_->FocusRow() == id;
    const Label label = LabelOf(row, LabelText(row));
    const QPoint at = ToContents(pressedAt_);
    const QRect text(label.text.left(), label.text.top(),
                     std::min(label.text.width(), fontMetrics().horizontalAdvance(LabelText(row))), label.text.height());
    if (isOnly && (IsLargeIcons() ? label.mark : text).contains(at)) clickEdits_ = list_->Rows().Ref(id);
}

void ListWidget::PressBeside(const QMouseEvent& event) {
    pressedBeside_ = ToContents(pressedAt_);
    if ((event.modifiers() & selecting) == 0) list_->SelectNoneInput();
}

void ListWidget::mouseMoveEvent(QMouseEvent* event) {
    if (!Settle()) return;
    pointerAt_ = event->position().toPoint();
    pointer_.Move(Inside(*event));
    if (!Settle()) return;
    Hover(pointerAt_);
    const bool isFar = (pointerAt_ - pressedAt_).manhattanLength() >= QApplication::startDragDistance();
    if (isFar && (event->buttons() & Qt::LeftButton)) clickEdits_.reset();
    if (band_)
        MoveBand();
    else if (isFar && pressedBeside_ && (event->buttons() & Qt::LeftButton) && list_->MultiSelect())
        BeginBand();
}

void ListWidget::mouseReleaseEvent(QMouseEvent* event) {
    if (!Settle()) return;
    const bool clicks = pointer_.ReleaseAlone(Inside(*event));
    if (event->button() == Qt::LeftButton && Settle()) {
        const auto row = HitRow(event->position().toPoint());
        const auto waiting = std::exchange(pressedSelected_, std::nullopt);
        EndBand();
        pressedBeside_.reset();
        if (waiting && waiting == row) list_->ItemClickInput(IndexOf(*row), ShiftOf(pressedWith_));
    }
    if (clicks) pointer_.Click();
    if (!Settle() || !clicks || !clickEdits_ || !list_->Rows().Lives(*clickEdits_)) return;
    OpenEditSoon(list_->Rows().PositionOf(clickEdits_->row));
}

void ListWidget::mouseDoubleClickEvent(QMouseEvent* event) {
    if (!Settle()) return;
    editTimer_.stop();
    clickEdits_.reset();
    pointer_.DoubleClick(Inside(*event));
}

void ListWidget::OpenEditSoon(Position row) {
    if (list_->LabelEdit() != child::ListLabelEditConstants::Automatic) return;
    clickEdits_ = list_->Rows().Ref(list_->Rows().At(row));
    editTimer_.start(QApplication::doubleClickInterval(), this);
}

void ListWidget::Hover(QPoint at) {
    const bool wanted = list_->HotTracking() || list_->HoverSelection();
    const auto row = wanted && viewport()->rect().contains(at) ? HitRow(at) : std::nullopt;
    if (row == hot_) return;
    for (const auto changed : {hot_, row})
        if (changed) UpdateRows(*changed, 1);
    hot_ = row;
    hoverTimer_.stop();
    if (row && list_->HoverSelection()) hoverTimer_.start(style()->styleHint(QStyle::SH_ToolTip_WakeUpDelay), this);
}

bool ListWidget::viewportEvent(QEvent* event) {
    switch (event->type()) {
        case QEvent::Leave:
            if (list_) Hover({-1, -1});
            pointer_.Leave();
            break;
        case QEvent::ToolTip: {
            const auto& help = static_cast<const QHelpEvent&>(*event);
            const QString full = toolTip().isEmpty() ? FullTextAt(help.pos()) : toolTip();
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

// The rubber band.

void ListWidget::BeginBand() {
    constexpr int interval = 40;
    bandRows_.clear();
    bandKeeps_.clear();
    band_ = QRect(*pressedBeside_, QSize(1, 1));
    bandTimer_.start(interval, this);
    MoveBand();
}

std::vector<RowRange> ListWidget::BandRows() const {
    const std::vector<RowRange> cells = layout_.Touched(*band_);
    constexpr Position most = 10'000;  // of a greater band whole cells count, since each label takes some time
    Position count = 0;
    for (const RowRange range : cells) count += range.count;
    if (count > most || (IsReport() && look_.fullRow)) return cells;
    std::vector<RowRange> rows;
    for (const RowRange range : cells)
        for (Position row = range.first; row < range.first + range.count; ++row) {
            const Label label = LabelOf(row, LabelText(row));
            if (!band_->intersects(label.icon) && !band_->intersects(label.mark)) continue;
            if (!rows.empty() && rows.back().first + rows.back().count == row)
                ++rows.back().count;
            else
                rows.push_back({row, 1});
        }
    return rows;
}

void ListWidget::MoveBand() {
    const QRect before = *band_;
    band_ = QRect(*pressedBeside_, ToContents(pointerAt_)).normalized();
    viewport()->update(ToViewport(before.united(*band_)).adjusted(-1, -1, 1, 1));
    std::vector<RowRange> rows = BandRows();
    const std::vector<RowRange> come = Less(rows, bandRows_);
    std::vector<RowRange> gone;
    const bool keeps = (pressedWith_ & selecting) != 0;
    for (const RowRange range : come)
        for (Position row = range.first; keeps && row < range.first + range.count; ++row)
            if (list_->Rows().Selected(list_->Rows().At(row))) bandKeeps_.insert(row);
    for (const RowRange range : Less(bandRows_, rows)) {
        if (bandKeeps_.empty()) {
            gone.push_back(range);
            continue;
        }
        for (Position row = range.first; row < range.first + range.count; ++row)
            if (!bandKeeps_.contains(row)) gone.push_back({row, 1});
    }
    bandRows_ = std::move(rows);
    if (!come.empty() || !gone.empty()) list_->SelectionInput(come, gone);
}

void ListWidget::EndBand() {
    bandTimer_.stop();
    if (!band_) return;
    viewport()->update(ToViewport(*band_).adjusted(-1, -1, 1, 1));
    band_.reset();
    pressedBeside_.reset();
}

void ListWidget::timerEvent(QTimerEvent* event) {
    const int id = event->timerId();
    if (id == bandTimer_.timerId()) {
        if (!Settle() || !band_) return EndBand();
        // A pointer outside pulls the contents along.
        const auto pull = [](int at, int size) { return at < 0 ? at : at >= size ? at - size + 1 : 0; };
        const QPoint by(pull(pointerAt_.x(), viewport()->width()), pull(pointerAt_.y(), viewport()->height()));
        if (by.isNull()) return;
        horizontalScrollBar()->setValue(horizontalScrollBar()->value() + (isRightToLeft() ? -by.x() : by.x()));
        verticalScrollBar()->setValue(verticalScrollBar()->value() + by.y());
        if (list_ && band_) MoveBand();
    } else if (id == hoverTimer_.timerId()) {
        hoverTimer_.stop();
        if (!Settle() || !hot_ || *hot_ >= list_->Rows().Count() || QApplication::mouseButtons() != Qt::NoButton) return;
        if (list_->HoverSelection()) list_->SelectInput(IndexOf(*hot_), ListSelectConstants::Only);
    } else if (id == editTimer_.timerId()) {
        editTimer_.stop();
        const auto row = std::exchange(clickEdits_, std::nullopt);
        if (!Settle() || !row || !list_->Rows().Lives(*row) || !list_->Rows().Selected(row->row)) return;
        list_->EditInput(IndexOf(list_->Rows().PositionOf(row->row)));
    } else if (id == typeTimer_.timerId()) {
        typeTimer_.stop();
        typed_.clear();
    } else {
        QAbstractItemView::timerEvent(event);
    }
}

// Drops.

void ListWidget::dragEnterEvent(QDragEnterEvent* event) {
    if (Settle()) drops_.Enter(*event, event->position() + InsideOffset());
}

void ListWidget::dragMoveEvent(QDragMoveEvent* event) {
    if (Settle()) drops_.Over(*event, event->position() + InsideOffset());
}

void ListWidget::dragLeaveEvent(QDragLeaveEvent*) {
    if (Settle()) drops_.Leave();
}

void ListWidget::dropEvent(QDropEvent* event) {
    if (Settle()) drops_.Drop(*event, event->position() + InsideOffset());
}

// The keyboard.

void ListWidget::keyPressEvent(QKeyEvent* event) {
    if (!Settle()) return;
    editTimer_.stop();
    const bool wasEditing = editor_ != nullptr;
    keys_->Press(*event);
    event->accept();
    if (!Settle() || (editor_ && !wasEditing)) return;
    if (MoveByKey(*event) || SelectByKey(*event)) return;
    const bool types = !event->text().isEmpty() && event->text().front().isPrint() &&
                       !(event->modifiers() & (Qt::ControlModifier | Qt::AltModifier | Qt::MetaModifier));
    if (types)
        TypeAhead(event->text());
    else
        event->ignore();
}

bool ListWidget::MoveByKey(const QKeyEvent& event) {
    using Step = ListLayout::Step;
    const bool mirrored = isRightToLeft();
    Step step = Step::First;
    switch (event.key()) {
        case Qt::Key_Up:
            step = Step::Up;
            break;
        case Qt::Key_Down:
            step = Step::Down;
            break;
        case Qt::Key_Left:
            step = mirrored ? Step::Right : Step::Left;
            break;
        case Qt::Key_Right:
            step = mirrored ? Step::Left : Step::Right;
            break;
        case Qt::Key_PageUp:
            step = Step::PageUp;
            break;
        case Qt::Key_PageDown:
            step = Step::PageDown;
            break;
        case Qt::Key_Home:
            step = Step::First;
            break;
        case Qt::Key_End:
            step = Step::Last;
            break;
        default:
            return false;
    }
    const bool sideways = step == Step::Left || step == Step::Right;
    if (IsReport() && sideways) {  // there is no row at the side
        QScrollBar& bar = *horizontalScrollBar();
        bar.setValue(bar.value() + (step == Step::Left ? -bar.singleStep() : bar.singleStep()));
        return true;
    }
    if (list_->Rows().Count() == 0) return true;
    const auto focus = FocusPosition();
    const bool isJump = step == Step::First || step == Step::Last;
    SelectByKeyboard(focus || isJump ? layout_.Next(focus.value_or(0), step) : 0, event.modifiers());
    return true;
}

void ListWidget::SelectByKeyboard(Position row, Qt::KeyboardModifiers modifiers) {
    const bool extends = modifiers & Qt::ShiftModifier, keeps = modifiers & Qt::ControlModifier;
    const child::RowRef target = list_->Rows().Ref(list_->Rows().At(row));
    if (!list_->MultiSelect() || (!extends && !keeps))
        list_->SelectInput(IndexOf(row), ListSelectConstants::Only);
    else if (extends)
        list_->SelectInput(IndexOf(row), keeps ? ListSelectConstants::AddRange : ListSelectConstants::Range);
    else
        list_->FocusInput(IndexOf(row));
    if (!Settle() || !list_->Rows().Lives(target)) return;
    const Position before = FirstVisible();
    MakeVisible(list_->Rows().PositionOf(target.row));
    if (FirstVisible() != before) list_->ScrollInput(IndexOf(FirstVisible()));
}

bool ListWidget::SelectByKey(const QKeyEvent& event) {
    const bool ctrl = event.modifiers() & Qt::ControlModifier;
    if (event.matches(QKeySequence::SelectAll)) {
        list_->SelectAllInput();
        return true;
    }
    if (event.key() != Qt::Key_Space || !typed_.isEmpty()) return false;
    const auto focus = FocusPosition();
    if (!focus) return true;
    const auto how = !list_->MultiSelect()                   ? ListSelectConstants::Only
                     : ctrl                                  ? ListSelectConstants::Toggle
                     : event.modifiers() & Qt::ShiftModifier ? ListSelectConstants::Range
                                                             : ListSelectConstants::Only;
    list_->SelectInput(IndexOf(*focus), how);
    return true;
}

void ListWidget::TypeAhead(const QString& typed) {
    const Position count = list_->Rows().Count();
    if (count == 0) return;
    typeTimer_.start(QApplication::keyboardInputInterval(), this);
    typed_ += typed;
    // The same letter again and again goes from row to row.
    const bool isOneLetter = typed_ == QString(typed_.size(), typed_.front());
    const QString wanted = isOneLetter ? typed_.left(1) : typed_;
    const auto focus = FocusPosition();
    const Position first = !focus ? 0 : isOneLetter ? (*focus + 1) % count : *focus;
    using Where = child::ListFindWhereConstants;
    using How = child::ListFindHowConstants;
    auto found = list_->FindItem(FromQt(wanted), Where::Text, IndexOf(first), How::Partial);
    if (!found && first > 0) found = list_->FindItem(FromQt(wanted), Where::Text, 1, How::Partial);
    if (found) SelectByKeyboard(static_cast<Position>(found->Index() - 1), Qt::NoModifier);
}

void ListWidget::focusInEvent(QFocusEvent* event) {
    QAbstractScrollArea::focusInEvent(event);
    focusedByMouse_ = event->reason() == Qt::MouseFocusReason;
    viewport()->update();
}

void ListWidget::focusOutEvent(QFocusEvent* event) {
    QAbstractScrollArea::focusOutEvent(event);
    editTimer_.stop();
    viewport()->update();
}

void ListWidget::FitColumn(int column) {
    constexpr int beside = 12;
    if (!Settle()) return;
    int width = header_.sectionSizeHint(column);
    for (const RowRange range : layout_.Touched(QRect(Scrolled(), layout_.window)))
        for (Position row = range.first; row < range.first + range.count; ++row)
            width = std::max(width, fontMetrics().horizontalAdvance(OneLine(model_.Text(static_cast<int>(row), column))) + beside +
                                        (column == 0 ? LabelOf(row, {}).icon.width() + 4 : 0));
    list_->ColumnWidthInput(column + 1, Twips(width));
}

}  // namespace tessel::qt
