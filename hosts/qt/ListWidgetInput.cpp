#include <QApplication>
#include <QScrollBar>
#include <QStyle>
#include <algorithm>

#include "hosts/qt/Convert.h"
#include "hosts/qt/ListWidget.h"

/// What the user does with a list.
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

// The mouse.

void ListWidget::mousePressEvent(QMouseEvent* event) {
    hoverTimer_.stop();
    pressedSelected_.reset();
    pressedBeside_.reset();
    RowView::mousePressEvent(event);
}

void ListWidget::PressAt(const QMouseEvent& event) {
    if (const auto row = HitRow(pressedAt_))
        PressRow(*row, event);
    else
        PressBeside(event);
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
    const bool isLabel = (IsLargeIcons() ? label.mark : text).contains(at);
    if (isOnly && isLabel && list_->LabelEdit() == child::ListLabelEditConstants::Automatic) EditByClick(row);
}

void ListWidget::PressBeside(const QMouseEvent& event) {
    pressedBeside_ = ToContents(pressedAt_);
    if ((event.modifiers() & selecting) == 0) list_->SelectNoneInput();
}

void ListWidget::DragTo(bool isFar) {
    if (band_)
        MoveBand();
    else if (isFar && pressedBeside_ && list_->MultiSelect())
        BeginBand();
}

void ListWidget::ReleaseAt(const QMouseEvent& event) {
    const auto row = HitRow(event.position().toPoint());
    const auto waiting = pressedSelected_;
    LosePress();
    if (waiting && waiting == row) list_->ItemClickInput(IndexOf(*row), ShiftOf(pressedWith_));
}

void ListWidget::LosePress() {
    pressedSelected_.reset();
    EndBand();
    pressedBeside_.reset();
}

void ListWidget::Hover(QPoint at) {
    const auto before = hot_;
    RowView::Hover(at);
    if (hot_ == before) return;
    hoverTimer_.stop();
    if (hot_ && list_->HoverSelection()) hoverTimer_.start(style()->styleHint(QStyle::SH_ToolTip_WakeUpDelay), this);
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
    } else {
        RowView::timerEvent(event);
    }
}

// The keyboard.

bool ListWidget::MoveByKey(const QKeyEvent& event) {
    using Step = ListLayout::Step;
    const auto wanted = StepOf(event);
    if (!wanted) return false;
    const Step step = *wanted;
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

void ListWidget::ReportSelection(Position row, Qt::KeyboardModifiers modifiers) {
    const bool extends = modifiers & Qt::ShiftModifier, keeps = modifiers & Qt::ControlModifier;
    if (!list_->MultiSelect() || (!extends && !keeps))
        list_->SelectInput(IndexOf(row), ListSelectConstants::Only);
    else if (extends)
        list_->SelectInput(IndexOf(row), keeps ? ListSelectConstants::AddRange : ListSelectConstants::Range);
    else
        list_->FocusInput(IndexOf(row));
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

std::optional<ListWidget::Position> ListWidget::FindFrom(Position first, const QString& text) const {
    using Where = child::ListFindWhereConstants;
    using How = child::ListFindHowConstants;
    auto found = list_->FindItem(FromQt(text), Where::Text, IndexOf(first), How::Partial);
    if (!found && first > 0) found = list_->FindItem(FromQt(text), Where::Text, 1, How::Partial);
    return found ? std::optional(static_cast<Position>(found->Index() - 1)) : std::nullopt;
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
