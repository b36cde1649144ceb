#include "hosts/qt/ListWidget.h"

#include <QAccessible>
#include <QCoreApplication>
#include <QScopedValueRollback>
#include <QScrollBar>
#include <QWheelEvent>
#include <algorithm>

#include "hosts/qt/ListAccessible.h"

namespace tessel::qt {

using child::ListViewConstants;
using child::RowChange;
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

}  // namespace

ListWidget::ListWidget(child::ListView& list) : RowView(list, model_), list_(&list), model_(list), header_(list, this) {
    ListAccessible::Install();
    setModel(&model_);
    header_.setModel(&model_);
    header_.hide();
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
    header_.Disconnect();
    RowView::Disconnect();
    hoverTimer_.stop();
    bandTimer_.stop();
    model_.Disconnect();
}

// Following.

ListWidget::ViewLook ListWidget::ViewLookNow() const {
    return {.view = list_->View(),
            .arrange = list_->Arrange(),
            .wrap = list_->LabelWrap(),
            .hideHeaders = list_->HideColumnHeaders(),
            .grid = list_->GridLines(),
            .picture = list_->Picture(),
            .alignment = list_->PictureAlignment()};
}

void ListWidget::Follow() {
    if (!list_) return;
    const QScopedValueRollback following(following_, true);
    TakeSize();
    const std::int32_t firstTop = followedOnce_ ? 0 : list_->TopIndex();
    const std::vector<RowChange> changes = list_->Rows().TakeChanges();
    const ViewLook view = ViewLookNow();
    const bool isNewView = followedOnce_ && (view.view != view_.view || view.arrange != view_.arrange);
    bool isNewLook = !followedOnce_ || view != view_;
    view_ = view;
    const Look look = LookOf(*list_, Images());
    isNewLook = isNewLook || look != look_;
    const RowKey top = isNewView ? FirstSeen() : 0;
    const bool rowsMoved = std::any_of(changes.begin(), changes.end(), Moves);
    followedOnce_ = true;
    if (isNewLook) {
        TakeLook(look);
        sampledFor_ = 0;
    }
    if (rowsMoved) EndBand();
    if (rowsMoved && changes.front().kind == RowChange::Kind::Reset) sampledFor_ = 0;
    model_.Follow(changes);
    const bool newColumns = header_.Follow();
    const ListLayout before = layout_;
    if (rowsMoved || isNewLook || newColumns) updateGeometries();
    const bool isUnseen = !isNewLook && !newColumns && layout_.StandsAs(before) && IsBehindView(changes);
    if ((rowsMoved && !isUnseen) || isNewLook || newColumns) {
        FollowScroll(changes);
        if (const auto row = model_.PositionOf(top); row && isNewView) ScrollToTop(*row);
        if (firstTop > 1) ScrollToTop(static_cast<Position>(firstTop - 1));
        hot_.reset();
        viewport()->update();
        RememberSeen();
    }
    if (rowsMoved && QAccessible::isActive()) RowAccessible::TellRows(*this);
    FollowFocus();
    FollowEdit();
}

std::optional<ListWidget::Position> ListWidget::FocusPosition() const {
    const auto row = list_->FocusRow();
    return row ? std::optional(list_->Rows().PositionOf(*row)) : std::nullopt;
}

std::optional<ListWidget::RowKey> ListWidget::EditedRow() const {
    const auto row = list_->EditedRow();
    return row ? std::optional(model_.KeyOf(*row)) : std::nullopt;
}

// Cells and scroll bars.

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
    const int lineHeight = LineHeight();
    layout_.flow = FlowOf(view_.view, view_.arrange);
    layout_.count = static_cast<Position>(model_.rowCount());
    layout_.contentWidth = list_->ColumnHeaders.Count() > 0 ? header_.length() : 0;
    if (IsReport()) {
        layout_.cell = {1, lineHeight};
        return;
    }
    if (IsLargeIcons()) {
        constexpr int characters = 15, least = 75;
        const int lines = view_.wrap ? 2 : 1;
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
        IsReport() && !view_.hideHeaders && model_.columnCount() > 0 && list_ && list_->ColumnHeaders.Count() > 0;
    const int height = hasHeader ? header_.sizeHint().height() : 0;
    if (viewportMargins().top() != height) setViewportMargins(0, height, 0, 0);
    const QRect seen = viewport()->geometry();
    header_.setGeometry(seen.left(), seen.top() - height, seen.width(), height);
    header_.setVisible(hasHeader);
    LayOut();
}

int ListWidget::SidewaysStep() const { return layout_.flow == Flow::Down ? layout_.cell.width() : RowView::SidewaysStep(); }

void ListWidget::LayOut() {
    if (!list_) return;
    const QScopedValueRollback following(following_, true);
    RowView::LayOut();
    if (header_.isVisibleTo(this) && header_.width() != viewport()->width()) header_.resize(viewport()->width(), header_.height());
    header_.setOffset(IsReport() ? horizontalScrollBar()->value() : 0);
}

void ListWidget::changeEvent(QEvent* event) {
    switch (event->type()) {
        case QEvent::FontChange:
        case QEvent::StyleChange:
        case QEvent::LayoutDirectionChange:
            sampledFor_ = 0;
            break;
        default:
            break;
    }
    RowView::changeEvent(event);
}

void ListWidget::scrollContentsBy(int dx, int dy) {
    header_.setOffset(IsReport() ? horizontalScrollBar()->value() : 0);
    RowView::scrollContentsBy(dx, dy);
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
