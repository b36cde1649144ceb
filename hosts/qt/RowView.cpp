#include "hosts/qt/RowView.h"

#include <QAccessible>
#include <QCoreApplication>
#include <QResizeEvent>
#include <QScopedValueRollback>
#include <QScrollBar>
#include <QStyle>
#include <algorithm>

#include "frame/child/ImageList.h"
#include "hosts/qt/Cursors.h"
#include "hosts/qt/RowAccessible.h"

/// How rows are followed, where they stand, and the edit of a label.
namespace tessel::qt {

using child::RowChange;
using Flow = ListLayout::Flow;

RowView::RowView(child::DragChild& child, const RowModel& rows)
    : rows_(rows), pointer_(child, *this), keys_(new KeyInput(child, this)), drops_(child) {
    setSelectionMode(NoSelection);
    setAutoScroll(false);
    setTabKeyNavigation(false);
    setEditTriggers(NoEditTriggers);
    setMouseTracking(true);
    viewport()->setMouseTracking(true);
    viewport()->setAttribute(Qt::WA_OpaquePaintEvent);
    setFocusPolicy(Qt::StrongFocus);
}

void RowView::Disconnect() {
    pointer_.Disconnect();
    keys_->Disconnect();
    drops_.Disconnect();
    EndEditor();
    for (QBasicTimer* timer : {&editTimer_, &typeTimer_}) timer->stop();
    layout_.count = 0;
    seen_.clear();
    icons_.clear();
}

// Following.

void RowView::TakeLook(const Look& look) {
    look_ = look;
    icons_.clear();
    if (!look_.border)
        setFrameStyle(QFrame::NoFrame);
    else if (look_.flat)
        setFrameStyle(QFrame::Box | QFrame::Plain);
    else
        setFrameStyle(QFrame::StyledPanel | QFrame::Sunken);
    if (font() != look_.font) setFont(look_.font);
    viewport()->setAcceptDrops(look_.takesDrops);
    if (look_.pointer != 0)
        viewport()->setCursor(CursorOf(look_.pointer, look_.pointerIcon));
    else
        viewport()->unsetCursor();
}

void RowView::TakeSize() {
    if (!testAttribute(Qt::WA_PendingResizeEvent)) return;
    QResizeEvent resized(size(), size());
    QCoreApplication::sendEvent(this, &resized);
}

bool RowView::IsBehindView(const std::vector<RowChange>& changes) const {
    Position end = 0;
    for (const child::RowRange range : layout_.Touched(QRect(Scrolled(), layout_.window)))
        end = std::max(end, range.first + range.count);
    return std::all_of(changes.begin(), changes.end(), [&](const RowChange& change) {
        return !Moves(change) || (change.kind == RowChange::Kind::Inserted && change.first >= end);
    });
}

void RowView::FollowScroll(const std::vector<RowChange>& changes) {
    const auto has = [&](RowChange::Kind kind) {
        return std::any_of(changes.begin(), changes.end(), [&](const RowChange& change) { return change.kind == kind; });
    };
    const bool isReset = has(RowChange::Kind::Reset);
    if (!isReset && (has(RowChange::Kind::Reordered) || !std::any_of(changes.begin(), changes.end(), Moves))) return;
    const bool isDown = layout_.flow == Flow::Down;
    const auto along = [&](QPoint point) { return isDown ? point.x() : point.y(); };
    if (along(Scrolled()) == 0) return;
    const auto lives = [&](const Seen& seen) { return rows_.PositionOf(seen.row).has_value(); };
    const auto stays = std::find_if(seen_.begin(), seen_.end(), lives);
    int offset = isReset ? 0 : along(Scrolled());
    if (stays != seen_.end()) offset = std::max(0, along(layout_.CellOf(*rows_.PositionOf(stays->row)).topLeft()) - stays->place);
    Scroll(isDown ? QPoint(offset, Scrolled().y()) : QPoint(Scrolled().x(), offset));
}

void RowView::RememberSeen() {
    seen_.clear();
    if (!Child()) return;
    const bool isDown = layout_.flow == Flow::Down;
    for (const child::RowRange range : layout_.Touched(QRect(Scrolled(), layout_.window)))
        for (Position row = range.first; row < range.first + range.count && row < rows_.HeldRows(); ++row) {
            const QPoint place = layout_.CellOf(row).topLeft() - Scrolled();
            seen_.push_back({rows_.KeyAt(row), isDown ? place.x() : place.y()});
        }
    // A row that is in view as a whole is the one to stay with.
    std::stable_partition(seen_.begin(), seen_.end(), [](const Seen& seen) { return seen.place >= 0; });
}

void RowView::FollowFocus() {
    const auto focus = FocusPosition();
    const QModelIndex index = focus ? rows_.index(static_cast<int>(*focus), 0) : QModelIndex();
    if (index == currentIndex()) return;
    const QModelIndex before = currentIndex();
    selectionModel()->setCurrentIndex(index, QItemSelectionModel::NoUpdate);
    for (const QModelIndex& changed : {before, index})
        if (changed.isValid()) UpdateRows(static_cast<Position>(changed.row()), 1);
    if (QAccessible::isActive() && index.isValid()) RowAccessible::TellFocus(*this, index);
}

void RowView::FollowEdit() {
    if (!editor_) return;
    if (EditedRow() == edited_ && rows_.PositionOf(edited_)) return PlaceEditor();
    EndEditor();
    // What is edited may still be there, without a row. The report waits until all that happens now has been followed.
    const auto giveUp = [this] {
        if (Child() && !editor_ && EditedRow() == edited_) ReportEditGivenUp();
    };
    if (EditedRow() == edited_) QMetaObject::invokeMethod(this, giveUp, Qt::QueuedConnection);
}

void RowView::dataChanged(const QModelIndex& first, const QModelIndex& last, const QList<int>&) {
    UpdateRows(static_cast<Position>(first.row()), static_cast<Position>(last.row() - first.row() + 1));
}

void RowView::UpdateRows(Position first, Position count) {
    const Position end = first + count;
    for (const child::RowRange range : layout_.Touched(QRect(Scrolled(), layout_.window)))
        for (Position row = std::max(first, range.first); row < std::min(end, range.first + range.count); ++row)
            viewport()->update(ToViewport(layout_.CellOf(row)));
}

// Cells and scroll bars.

QSize RowView::ImageSize() const {
    const child::ImageList* images = Child() ? Images() : nullptr;
    return images ? QSize(images->ImageWidth(), images->ImageHeight()) : QSize(0, 0);
}

int RowView::LineHeight() const { return std::max(fontMetrics().height() + edge, ImageSize().height() + edge / 2); }

int RowView::SidewaysStep() const {
    constexpr int step = 20;
    return step;
}

void RowView::LayOut() {
    if (!Child()) return;
    const QScopedValueRollback following(following_, true);
    const bool keepsFocus = size() == laidOutFor_ && IsFocusInView();
    laidOutFor_ = size();
    FitCells();
    // A bar that comes takes room, and may make the other one come.
    constexpr int rounds = 3;
    for (int round = 0; round < rounds; ++round) {
        layout_.window = viewport()->size();
        const QPoint limit = layout_.Limit();
        verticalScrollBar()->setSingleStep(layout_.cell.height());
        verticalScrollBar()->setPageStep(std::max(1, layout_.window.height()));
        verticalScrollBar()->setRange(0, limit.y());
        horizontalScrollBar()->setSingleStep(SidewaysStep());
        horizontalScrollBar()->setPageStep(std::max(1, layout_.window.width()));
        horizontalScrollBar()->setRange(0, limit.x());
        if (layout_.window == viewport()->size()) break;
    }
    if (keepsFocus) MakeFocusVisible();
    if (editor_) PlaceEditor();
}

void RowView::MakeFocusVisible() {
    const auto row = FocusPosition();
    if (row && *row < layout_.count) Scroll(layout_.IntoView(*row, Scrolled()));
}

bool RowView::IsFocusInView() const {
    const auto row = FocusPosition();
    return row && *row < layout_.count && layout_.IntoView(*row, Scrolled()) == Scrolled();
}

void RowView::resizeEvent(QResizeEvent* event) {
    QAbstractScrollArea::resizeEvent(event);
    updateGeometries();
    RememberSeen();
}

void RowView::changeEvent(QEvent* event) {
    QAbstractItemView::changeEvent(event);
    switch (event->type()) {
        case QEvent::FontChange:
        case QEvent::StyleChange:
        case QEvent::LayoutDirectionChange:
            updateGeometries();
            [[fallthrough]];
        case QEvent::PaletteChange:
        case QEvent::EnabledChange:
        case QEvent::ActivationChange:
            viewport()->update();
            break;
        default:
            break;
    }
}

// Scrolling.

QPoint RowView::Scrolled() const { return {horizontalScrollBar()->value(), verticalScrollBar()->value()}; }

void RowView::Scroll(QPoint offset) {
    const QScopedValueRollback following(following_, true);
    horizontalScrollBar()->setValue(offset.x());
    verticalScrollBar()->setValue(offset.y());
}

void RowView::ScrollToTop(Position row) {
    if (row >= layout_.count) return;
    const QPoint offset = layout_.ToTop(row);
    Scroll(layout_.flow == Flow::Down ? offset : QPoint(Scrolled().x(), offset.y()));
}

void RowView::MakeVisible(Position row) {
    if (row < layout_.count) Scroll(layout_.IntoView(row, Scrolled()));
}

void RowView::scrollContentsBy(int dx, int dy) {
    if (!ScrollsPixels() || hot_)
        viewport()->update();
    else
        viewport()->scroll(isRightToLeft() ? -dx : dx, dy);
    hot_.reset();
    editTimer_.stop();
    if (editor_) PlaceEditor();
    RememberSeen();
    if (following_ || !Child() || layout_.count == 0) return;
    const Position top = FirstVisible();
    if (top < rows_.HeldRows()) ReportScroll(top);
}

// Places.

QRect RowView::ToViewport(QRect contents) const {
    return QStyle::visualRect(layoutDirection(), QRect(QPoint(), layout_.window), contents.translated(-Scrolled()));
}

QPoint RowView::ToContents(QPoint viewport) const {
    return QStyle::visualPos(layoutDirection(), QRect(QPoint(), layout_.window), viewport) + Scrolled();
}

QPointF RowView::InsideOffset() const { return viewport()->geometry().topLeft() - contentsRect().topLeft(); }

RowView::Label RowView::LineLabel(QRect cell, int textWidth) const {
    const QSize image = ImageSize();
    Label label;
    if (cell.isEmpty()) return label;
    label.icon = QRect(QPoint(cell.left() + edge, cell.top() + (cell.height() - image.height()) / 2), image);
    const int start = image.width() > 0 ? label.icon.right() + 1 + edge : cell.left() + edge;
    label.text = QRect(start, cell.top(), std::max(0, cell.right() + 1 - edge - start), cell.height());
    const int width = std::min(label.text.width(), textWidth + 1);
    label.mark = QRect(start - edge / 2, cell.top(), width + edge, cell.height()).intersected(cell);
    // The strips before the icon and between icon and text are the row's too.
    label.reach = label.icon.adjusted(-edge, 0, edge, 0).united(label.mark);
    return label;
}

std::optional<RowView::Position> RowView::HitRow(QPoint at) const {
    if (!Child()) return std::nullopt;
    const QPoint point = ToContents(at);
    const auto row = layout_.At(point);
    if (!row || *row >= rows_.HeldRows()) return std::nullopt;
    const Label label = LabelOf(*row, LabelText(*row));
    const bool isHit = label.mark.contains(point) || label.icon.contains(point) || label.reach.contains(point);
    return isHit ? row : std::nullopt;
}

std::optional<RowView::Position> RowView::RowAtInside(QPointF point) const {
    const QPoint at = (point - InsideOffset()).toPoint();
    return viewport()->rect().contains(at) ? HitRow(at) : std::nullopt;
}

QRectF RowView::PlaceInside(Position row) const { return QRectF(ToViewport(layout_.CellOf(row))).translated(InsideOffset()); }

QRect RowView::visualRect(const QModelIndex& index) const {
    return index.isValid() && Child() ? ToViewport(layout_.CellOf(static_cast<Position>(index.row()))) : QRect();
}

void RowView::scrollTo(const QModelIndex& index, ScrollHint) {
    if (index.isValid()) MakeVisible(static_cast<Position>(index.row()));
}

QModelIndex RowView::indexAt(const QPoint& point) const {
    const auto row = layout_.At(ToContents(point));
    return row ? rows_.index(static_cast<int>(*row), 0) : QModelIndex();
}

QModelIndex RowView::moveCursor(CursorAction, Qt::KeyboardModifiers) { return currentIndex(); }

// The label edit.

void RowView::BeginEdit(Position row) {
    if (!Child()) return;
    EndEditor();
    MakeVisible(row);
    edited_ = rows_.KeyAt(row);
    editor_ = new LabelEditor(rows_.Text(static_cast<int>(row), 0), viewport());
    editor_->setFont(font());
    connect(editor_, &LabelEditor::accepted, this, [this](const QString& text) {
        if (Child()) ReportEditEnd(FromQt(text));
    });
    connect(editor_, &LabelEditor::givenUp, this, [this] {
        if (Child()) ReportEditGivenUp();
    });
    connect(editor_, &QLineEdit::textEdited, this, [this] { PlaceEditor(); });
    PlaceEditor();
    editor_->show();
    editor_->setFocus(Qt::OtherFocusReason);
}

int RowView::WantedEditorWidth() const {
    constexpr int frame = 4, spare = 12;
    return fontMetrics().horizontalAdvance(editor_->text()) + 2 * frame + spare;
}

QRect RowView::LineEditorPlace(Position row, int least) const {
    constexpr int frame = 4;
    const Label label = LabelOf(row, editor_->text());
    const int height = std::max(fontMetrics().height() + frame, layout_.cell.height());
    const int left = label.text.left() - frame;
    const int room = layout_.window.width() + Scrolled().x() - left - 2;
    return {left, label.text.top() - (height - label.text.height()) / 2,
            std::clamp(WantedEditorWidth(), least, std::max(least, room)), height};
}

QRect RowView::EditorPlace(Position row) const {
    return LineEditorPlace(row, std::min(WantedEditorWidth(), 10 * fontMetrics().averageCharWidth()));
}

void RowView::PlaceEditor() {
    const auto row = Child() ? rows_.PositionOf(edited_) : std::nullopt;
    if (row) editor_->setGeometry(ToViewport(EditorPlace(*row)));
}

void RowView::EndEditor() {
    if (!editor_) return;
    LabelEditor* const leaving = editor_;
    editor_ = nullptr;
    disconnect(leaving, nullptr, this, nullptr);
    const bool hadFocus = leaving->hasFocus();
    leaving->hide();
    leaving->deleteLater();  // its key may be on the stack
    if (hadFocus) setFocus(Qt::OtherFocusReason);
}

}  // namespace tessel::qt
