#include "hosts/qt/ListWidget.h"

#include <QAccessible>
#include <QCoreApplication>
#include <QResizeEvent>
#include <QScopedValueRollback>
#include <QScrollBar>
#include <QStyle>
#include <algorithm>

#include "hosts/qt/Convert.h"
#include "hosts/qt/Cursors.h"
#include "hosts/qt/ListAccessible.h"

namespace tessel::qt {

using child::ListViewConstants;
using child::RowChange;
using child::RowRef;
using Flow = ListLayout::Flow;

namespace {

ListLayout::Flow FlowOf(ListViewConstants view, child::ListArrangeConstants arrange) {
    switch (view) {
        case ListViewConstants::List:
            return Flow::Down;
        case ListViewConstants::Icon:
        case ListViewConstants::SmallIcon:
            return arrange == child::ListArrangeConstants::Left ? Flow::Down : Flow::Across;
        case ListViewConstants::Report:
            break;
    }
    return Flow::Rows;
}

bool Moves(const RowChange& change) { return change.kind != RowChange::Kind::Changed; }

}  // namespace

ListWidget::ListWidget(child::ListView& list)
    : list_(&list), model_(list), header_(list, this), pointer_(list, *this), keys_(new KeyInput(list, this)), drops_(list) {
    ListAccessible::Install();
    setModel(&model_);
    header_.setModel(&model_);
    header_.hide();
    setSelectionMode(NoSelection);
    setAutoScroll(false);
    setTabKeyNavigation(false);
    setEditTriggers(NoEditTriggers);
    setMouseTracking(true);
    viewport()->setMouseTracking(true);
    viewport()->setAttribute(Qt::WA_OpaquePaintEvent);
    setFocusPolicy(Qt::StrongFocus);
    connect(&header_, &ListHeader::fitWanted, this, [this](int column) { FitColumn(column); });
    const auto columnsMoved = [this] {
        LayOut();
        viewport()->update();
    };
    connect(&header_, &QHeaderView::sectionResized, this, columnsMoved);
    connect(&header_, &QHeaderView::sectionMoved, this, columnsMoved);
}

ListWidget::~ListWidget() {
    list_ = nullptr;
    setModel(nullptr);
    header_.setModel(nullptr);
}

void ListWidget::Disconnect() {
    list_ = nullptr;
    pointer_.Disconnect();
    keys_->Disconnect();
    drops_.Disconnect();
    header_.Disconnect();
    EndEditor();
    for (QBasicTimer* timer : {&hoverTimer_, &editTimer_, &bandTimer_, &typeTimer_}) timer->stop();
    model_.Disconnect();
    layout_.count = 0;
    seen_.clear();
    icons_.clear();
}

// Following.

ListWidget::Look ListWidget::LookNow() const {
    const child::ListView& list = *list_;
    const child::ImageList* const images = list.View() == ListViewConstants::Icon ? list.Icons() : list.SmallIcons();
    return {.view = list.View(),
            .arrange = list.Arrange(),
            .wrap = list.LabelWrap(),
            .hideHeaders = list.HideColumnHeaders(),
            .hideSelection = list.HideSelection(),
            .fullRow = list.FullRowSelect(),
            .grid = list.GridLines(),
            .hot = list.HotTracking(),
            .enabled = list.Enabled(),
            .back = list.BackColor(),
            .fore = list.ForeColor(),
            .border = list.BorderStyle(),
            .appearance = list.Appearance(),
            .font = ToQt(*list.Font()),
            .picture = list.Picture(),
            .alignment = list.PictureAlignment(),
            .images = images,
            .imagesRevision = images ? images->Revision() : 0,
            .takesDrops = list.OLEDropMode() != child::OLEDropConstants::None,
            .pointer = list.MousePointer(),
            .pointerIcon = list.MouseIcon()};
}

void ListWidget::TakeLook() {
    if (look_.border == child::ListBorderConstants::None)
        setFrameStyle(QFrame::NoFrame);
    else if (look_.appearance == child::AppearanceConstants::Flat)
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

void ListWidget::Follow() {
    if (!list_) return;
    const QScopedValueRollback following(following_, true);
    if (testAttribute(Qt::WA_PendingResizeEvent)) {  // a widget that is not shown yet has its size all the same
        QResizeEvent resized(size(), size());
        QCoreApplication::sendEvent(this, &resized);
    }
    const std::int32_t firstTop = followedOnce_ ? 0 : list_->TopIndex();
    const std::vector<RowChange> changes = list_->Rows().TakeChanges();
    const Look look = LookNow();
    const bool isNewLook = !followedOnce_ || look != look_;
    const bool isNewView = followedOnce_ && (look.view != look_.view || look.arrange != look_.arrange);
    const RowRef top = isNewView && !seen_.empty() ? seen_.front().row : RowRef{};
    const bool rowsMoved = std::any_of(changes.begin(), changes.end(), Moves);
    look_ = look;
    followedOnce_ = true;
    if (isNewLook) {
        TakeLook();
        icons_.clear();
        sampledFor_ = 0;
    }
    if (rowsMoved) EndBand();
    if (rowsMoved && changes.front().kind == RowChange::Kind::Reset) sampledFor_ = 0;
    model_.Follow(changes);
    const bool newColumns = header_.Follow();
    if (rowsMoved || isNewLook || newColumns) {
        updateGeometries();
        FollowScroll(changes);
        if (isNewView && list_->Rows().Lives(top)) ScrollToTop(list_->Rows().PositionOf(top.row));
        if (firstTop > 1) ScrollToTop(static_cast<Position>(firstTop - 1));
        hot_.reset();
        viewport()->update();
        RememberSeen();
        if (rowsMoved && QAccessible::isActive()) ListAccessible::TellRows(*this);
    }
    FollowFocus();
    FollowEdit();
}

void ListWidget::FollowScroll(const std::vector<RowChange>& changes) {
    const auto has = [&](RowChange::Kind kind) {
        return std::any_of(changes.begin(), changes.end(), [&](const RowChange& change) { return change.kind == kind; });
    };
    const bool isReset = has(RowChange::Kind::Reset);
    if (!isReset && (has(RowChange::Kind::Reordered) || !std::any_of(changes.begin(), changes.end(), Moves))) return;
    const bool isDown = layout_.flow == Flow::Down;
    const auto along = [&](QPoint point) { return isDown ? point.x() : point.y(); };
    if (along(Scrolled()) == 0) return;
    const auto lives = [&](const Seen& seen) { return list_->Rows().Lives(seen.row); };
    const auto stays = std::find_if(seen_.begin(), seen_.end(), lives);
    int offset = isReset ? 0 : along(Scrolled());
    if (stays != seen_.end())
        offset = std::max(0, along(layout_.CellOf(list_->Rows().PositionOf(stays->row.row)).topLeft()) - stays->place);
    Scroll(isDown ? QPoint(offset, Scrolled().y()) : QPoint(Scrolled().x(), offset));
}

void ListWidget::RememberSeen() {
    seen_.clear();
    if (!list_) return;
    const bool isDown = layout_.flow == Flow::Down;
    for (const child::RowRange range : layout_.Touched(QRect(Scrolled(), layout_.window)))
        for (Position row = range.first; row < range.first + range.count && row < list_->Rows().Count(); ++row) {
            const QPoint place = layout_.CellOf(row).topLeft() - Scrolled();
            seen_.push_back({list_->Rows().Ref(list_->Rows().At(row)), isDown ? place.x() : place.y()});
        }
    // A row that is in view as a whole is the one to stay with.
    std::stable_partition(seen_.begin(), seen_.end(), [](const Seen& seen) { return seen.place >= 0; });
}

std::optional<ListWidget::Position> ListWidget::FocusPosition() const {
    const auto row = list_->FocusRow();
    return row ? std::optional(list_->Rows().PositionOf(*row)) : std::nullopt;
}

void ListWidget::FollowFocus() {
    const auto focus = FocusPosition();
    const QModelIndex index = focus ? model_.index(static_cast<int>(*focus), 0) : QModelIndex();
    if (index == currentIndex()) return;
    const QModelIndex before = currentIndex();
    selectionModel()->setCurrentIndex(index, QItemSelectionModel::NoUpdate);
    for (const QModelIndex& changed : {before, index})
        if (changed.isValid()) UpdateRows(static_cast<Position>(changed.row()), 1);
    if (QAccessible::isActive() && index.isValid()) ListAccessible::TellFocus(*this, index);
}

void ListWidget::FollowEdit() {
    if (!editor_) return;
    if (list_->EditedRow() != edited_.row || !list_->Rows().Lives(edited_)) return EndEditor();
    PlaceEditor();
}

void ListWidget::dataChanged(const QModelIndex& first, const QModelIndex& last, const QList<int>&) {
    UpdateRows(static_cast<Position>(first.row()), static_cast<Position>(last.row() - first.row() + 1));
}

void ListWidget::UpdateRows(Position first, Position count) {
    const Position end = first + count;
    for (const child::RowRange range : layout_.Touched(QRect(Scrolled(), layout_.window)))
        for (Position row = std::max(first, range.first); row < std::min(end, range.first + range.count); ++row)
            viewport()->update(ToViewport(layout_.CellOf(row)));
}

// Cells and scroll bars.

child::ImageList* ListWidget::Images() const {
    if (!list_) return nullptr;
    return IsLargeIcons() ? list_->Icons() : list_->SmallIcons();
}

QSize ListWidget::ImageSize() const {
    const child::ImageList* images = Images();
    return images ? QSize(images->ImageWidth(), images->ImageHeight()) : QSize(0, 0);
}

int ListWidget::SampledTextWidth() const {
    constexpr Position samples = 64;
    constexpr int leastCharacters = 6, mostCharacters = 36;
    const QFontMetrics metrics = fontMetrics();
    int width = leastCharacters * metrics.averageCharWidth();
    const Position count = list_->Rows().Count();
    for (Position sample = 0; sample < std::min(samples, count); ++sample) {
        const auto row = static_cast<Position>(static_cast<std::uint64_t>(sample) * count / std::min(samples, count));
        width = std::max(width, metrics.horizontalAdvance(LabelText(row)) + 2);
    }
    return std::min(width, mostCharacters * metrics.averageCharWidth());
}

void ListWidget::FitCells() {
    const QFontMetrics metrics = fontMetrics();
    const QSize image = ImageSize();
    const int lineHeight = std::max(metrics.height() + edge, image.height() + edge / 2);
    if (IsReport()) {
        layout_.cell = {1, lineHeight};
        return;
    }
    if (IsLargeIcons()) {
        constexpr int characters = 15, least = 75;
        const int lines = look_.wrap ? 2 : 1;
        layout_.cell = {std::max({least, image.width() + 8 * edge, characters * metrics.averageCharWidth() + 2 * edge}),
                        edge + image.height() + edge + lines * metrics.lineSpacing() + 2 * edge};
        return;
    }
    // Labels decide how wide cells are; some of the rows stand for all.
    const Position count = list_->Rows().Count();
    if (sampledFor_ == 0 || count >= 2 * sampledFor_) {
        sampledWidth_ = std::max(sampledFor_ == 0 ? 0 : sampledWidth_, SampledTextWidth());
        sampledFor_ = count;
    }
    const int icon = image.width() > 0 ? image.width() + edge : 0;
    layout_.cell = {edge + icon + sampledWidth_ + 3 * edge, lineHeight};
}

void ListWidget::updateGeometries() {
    const bool hasHeader =
        IsReport() && !look_.hideHeaders && model_.columnCount() > 0 && list_ && list_->ColumnHeaders.Count() > 0;
    const int height = hasHeader ? header_.sizeHint().height() : 0;
    if (viewportMargins().top() != height) setViewportMargins(0, height, 0, 0);
    const QRect seen = viewport()->geometry();
    header_.setGeometry(seen.left(), seen.top() - height, seen.width(), height);
    header_.setVisible(hasHeader);
    LayOut();
}

void ListWidget::LayOut() {
    if (!list_) return;
    const QScopedValueRollback following(following_, true);
    layout_.flow = FlowOf(look_.view, look_.arrange);
    layout_.count = static_cast<Position>(model_.rowCount());
    layout_.contentWidth = list_->ColumnHeaders.Count() > 0 ? header_.length() : 0;
    FitCells();
    // A bar that comes takes room, and may make the other one come.
    constexpr int rounds = 3;
    for (int round = 0; round < rounds; ++round) {
        layout_.window = viewport()->size();
        FitScrollBars();
        if (layout_.window == viewport()->size()) break;
    }
    if (header_.isVisibleTo(this) && header_.width() != viewport()->width()) header_.resize(viewport()->width(), header_.height());
    header_.setOffset(IsReport() ? horizontalScrollBar()->value() : 0);
    if (editor_) PlaceEditor();
}

void ListWidget::FitScrollBars() {
    const QPoint limit = layout_.Limit();
    constexpr int columnStep = 20;
    const bool isDown = layout_.flow == Flow::Down;
    verticalScrollBar()->setSingleStep(layout_.cell.height());
    verticalScrollBar()->setPageStep(std::max(1, layout_.window.height()));
    verticalScrollBar()->setRange(0, limit.y());
    horizontalScrollBar()->setSingleStep(isDown ? layout_.cell.width() : columnStep);
    horizontalScrollBar()->setPageStep(std::max(1, layout_.window.width()));
    horizontalScrollBar()->setRange(0, limit.x());
}

void ListWidget::resizeEvent(QResizeEvent* event) {
    QAbstractScrollArea::resizeEvent(event);
    updateGeometries();
    RememberSeen();
}

void ListWidget::changeEvent(QEvent* event) {
    QAbstractItemView::changeEvent(event);
    switch (event->type()) {
        case QEvent::FontChange:
        case QEvent::StyleChange:
        case QEvent::LayoutDirectionChange:
            sampledFor_ = 0;
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

QPoint ListWidget::Scrolled() const { return {horizontalScrollBar()->value(), verticalScrollBar()->value()}; }

void ListWidget::Scroll(QPoint offset) {
    const QScopedValueRollback following(following_, true);
    horizontalScrollBar()->setValue(offset.x());
    verticalScrollBar()->setValue(offset.y());
}

void ListWidget::ScrollToTop(Position row) {
    if (row >= layout_.count) return;
    const QPoint offset = layout_.ToTop(row);
    Scroll(layout_.flow == Flow::Down ? offset : QPoint(Scrolled().x(), offset.y()));
}

void ListWidget::MakeVisible(Position row) {
    if (row < layout_.count) Scroll(layout_.IntoView(row, Scrolled()));
}

void ListWidget::scrollContentsBy(int dx, int dy) {
    header_.setOffset(IsReport() ? horizontalScrollBar()->value() : 0);
    if (look_.picture || hot_)
        viewport()->update();
    else
        viewport()->scroll(isRightToLeft() ? -dx : dx, dy);
    hot_.reset();
    editTimer_.stop();
    if (editor_) PlaceEditor();
    RememberSeen();
    if (following_ || !list_ || layout_.count == 0) return;
    const Position top = FirstVisible();
    if (top < list_->Rows().Count()) list_->ScrollInput(IndexOf(top));
}

void ListWidget::wheelEvent(QWheelEvent* event) {
    // A view that only goes on to the right is turned through by any wheel.
    const QPoint turned = event->angleDelta();
    if (verticalScrollBar()->maximum() > 0 || turned.x() != 0 || horizontalScrollBar()->maximum() == 0)
        return QAbstractScrollArea::wheelEvent(event);
    QWheelEvent sideways(event->position(), event->globalPosition(), event->pixelDelta(), turned, event->buttons(),
                         event->modifiers(), event->phase(), event->inverted(), event->source());
    QCoreApplication::sendEvent(horizontalScrollBar(), &sideways);
    event->setAccepted(sideways.isAccepted());
}

}  // namespace tessel::qt
