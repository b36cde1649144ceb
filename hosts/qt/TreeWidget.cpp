#include "hosts/qt/TreeWidget.h"

#include <QAccessible>
#include <QScopedValueRollback>
#include <QScrollBar>
#include <QStyle>
#include <algorithm>

#include "hosts/qt/Convert.h"
#include "hosts/qt/TreeAccessible.h"

namespace tessel::qt {

using child::NodeId;
using child::NodeRef;
using child::noNode;
using child::RowChange;
using child::TreeStyleConstants;

namespace {

bool ShowsPictures(TreeStyleConstants style) { return (static_cast<int>(style) & 1) != 0; }
bool ShowsLines(TreeStyleConstants style) { return style >= TreeStyleConstants::TreelinesText; }
bool ShowsSigns(TreeStyleConstants style) { return (static_cast<int>(style) & 2) != 0; }

}  // namespace

TreeWidget::TreeWidget(child::TreeView& tree) : RowView(tree, model_), tree_(&tree), model_(tree) {
    TreeAccessible::Install();
    setModel(&model_);
}

TreeWidget::~TreeWidget() {
    tree_ = nullptr;
    setModel(nullptr);
}

void TreeWidget::Disconnect() {
    tree_ = nullptr;
    RowView::Disconnect();
    expandTimer_.stop();
    expanding_.clear();
    model_.Disconnect();
}

// Following.

TreeWidget::TreeLook TreeWidget::TreeLookNow() const {
    const auto highlight = tree_->DropHighlight();
    return {.lines = ShowsLines(tree_->Style()),
            .signs = ShowsSigns(tree_->Style()),
            .pictures = ShowsPictures(tree_->Style()),
            .atTop = tree_->LineStyle() == child::TreeLineStyleConstants::RootLines,
            .boxes = tree_->Checkboxes(),
            .scrolls = tree_->Scroll(),
            .indent = Pixels(tree_->Indentation()),
            .dropHighlight = highlight ? highlight->Ref() : NodeRef()};
}

void TreeWidget::Follow() {
    if (!tree_) return;
    const QScopedValueRollback following(following_, true);
    TakeSize();
    const std::vector<RowChange> changes = tree_->Tree().TakeChanges();
    const TreeLook view = TreeLookNow();
    bool isNewLook = !followedOnce_ || view != view_;
    view_ = view;
    const Look look = LookOf(*tree_, Images());
    isNewLook = isNewLook || look != look_;
    followedOnce_ = true;
    const bool rowsMoved = std::any_of(changes.begin(), changes.end(), Moves);
    const auto narrows = [](const RowChange& change) {
        return change.kind == RowChange::Kind::Removed || change.kind == RowChange::Kind::Reset;
    };
    if (isNewLook) {
        TakeLook(look);
        const Qt::ScrollBarPolicy policy = view_.scrolls ? Qt::ScrollBarAsNeeded : Qt::ScrollBarAlwaysOff;
        setHorizontalScrollBarPolicy(policy);
        setVerticalScrollBarPolicy(policy);
    }
    if (isNewLook || std::any_of(changes.begin(), changes.end(), narrows)) seenWidth_ = 0;
    model_.Follow(changes);
    if (rowsMoved || isNewLook) {
        updateGeometries();
        FollowScroll(changes);
        hot_.reset();
        viewport()->update();
        RememberSeen();
        if (rowsMoved && QAccessible::isActive()) RowAccessible::TellRows(*this);
    }
    if (!changes.empty()) LayOut();  // other rows are in view, or the same read otherwise
    FollowFocus();
    FollowEdit();
    TellStates(changes);
}

void TreeWidget::TellStates(const std::vector<RowChange>& changes) {
    if (!QAccessible::isActive()) return;
    QAccessible::State changed;
    changed.selected = changed.expanded = changed.collapsed = changed.checked = true;
    constexpr Position most = 64;
    for (const RowChange& change : changes)
        if (change.kind == RowChange::Kind::Changed && change.count <= most)
            for (Position row = change.first; row < change.first + change.count; ++row)
                RowAccessible::TellState(*this, model_.index(static_cast<int>(row), 0), changed);
}

std::optional<TreeWidget::Position> TreeWidget::FocusPosition() const {
    NodeId node = Nodes().Selected();
    while (node != noNode && !Nodes().RowOf(node)) node = Nodes().Parent(node);
    return node == noNode ? std::nullopt : Nodes().RowOf(node);
}

std::optional<TreeWidget::RowKey> TreeWidget::EditedRow() const {
    const auto node = tree_->EditedNode();
    return node ? std::optional(model_.KeyOf(*node)) : std::nullopt;
}

// Cells.

void TreeWidget::FitCells() {
    layout_.flow = ListLayout::Flow::Rows;
    layout_.count = static_cast<Position>(model_.rowCount());
    layout_.cell = {1, LineHeight()};
    layout_.window = viewport()->size();
    seenWidth_ = std::max(seenWidth_, WidestInView());
    layout_.contentWidth = seenWidth_;
}

int TreeWidget::WidestInView() const {
    int widest = 0;
    const child::RowRange rows = InView();
    for (Position row = rows.first; row < rows.first + rows.count && row < Nodes().RowCount(); ++row)
        widest = std::max(widest, LabelOf(row, LabelText(row)).text.right() + 1 + edge);
    return widest;
}

child::RowRange TreeWidget::InView() const {
    const int height = layout_.cell.height();
    const auto first = static_cast<Position>(Scrolled().y() / height);
    const auto end = static_cast<Position>((Scrolled().y() + viewport()->height() + height - 1) / height);
    return first < layout_.count ? child::RowRange{first, std::min(end, layout_.count) - first} : child::RowRange{};
}

void TreeWidget::changeEvent(QEvent* event) {
    seenWidth_ = event->type() == QEvent::FontChange || event->type() == QEvent::StyleChange ? 0 : seenWidth_;
    RowView::changeEvent(event);
}

void TreeWidget::scrollContentsBy(int dx, int dy) {
    RowView::scrollContentsBy(dx, dy);
    if (!tree_ || dy == 0 || following_ || WidestInView() <= seenWidth_) return;
    LayOut();
    viewport()->update();
}

void TreeWidget::MakeVisible(Position row) {
    if (row >= layout_.count) return;
    RowView::MakeVisible(row);
    LayOut();
    const Label label = LabelOf(row, LabelText(row));
    const int first = (label.icon.isEmpty() ? label.text.left() : label.icon.left()) - edge, end = label.text.right() + 1 + edge;
    int x = Scrolled().x();
    x = std::max(x, end - layout_.window.width());
    x = std::min(x, first);
    Scroll({std::clamp(x, 0, layout_.Limit().x()), Scrolled().y()});
}

// Where the parts of a row stand.

int TreeWidget::ColumnsBefore(int level) const { return level + (view_.atTop && (view_.lines || view_.signs) ? 1 : 0); }

int TreeWidget::ColumnWidth() const {
    constexpr int sign = 9;  // pixels that a sign needs
    return view_.signs ? std::max(view_.indent, sign) : view_.indent;
}

TreeWidget::Parts TreeWidget::PartsOf(Position row) const {
    Parts parts;
    const NodeId node = NodeAt(row);
    const QRect cell = layout_.CellOf(row);
    const int columns = ColumnsBefore(Nodes().Level(node));
    const int width = ColumnWidth();
    parts.label = columns * width;
    if (columns > 0) parts.sign = QRect(parts.label - width, cell.top(), width, cell.height());
    if (!view_.signs || !Nodes().HasChildren(node)) parts.sign = {};
    if (!view_.boxes) return parts;
    const QSize box(style()->pixelMetric(QStyle::PM_IndicatorWidth, nullptr, this),
                    style()->pixelMetric(QStyle::PM_IndicatorHeight, nullptr, this));
    parts.box = QRect(QPoint(parts.label + edge / 2, cell.top() + (cell.height() - box.height()) / 2), box);
    parts.label = parts.box.right() + 1;
    return parts;
}

QFont TreeWidget::FontOf(NodeId node) const {
    QFont result = font();
    if (Nodes().Bold(node)) result.setBold(true);
    return result;
}

int TreeWidget::TextWidth(NodeId node, const QString& text) const {
    const bool isBold = Nodes().Bold(node);
    return (isBold ? QFontMetrics(FontOf(node)) : fontMetrics()).horizontalAdvance(text);
}

TreeWidget::Label TreeWidget::LabelOf(Position row, const QString& text) const {
    const QRect cell = layout_.CellOf(row);
    const int width = TextWidth(NodeAt(row), text), start = PartsOf(row).label;
    constexpr int spare = 1;
    const int room = 2 * edge + (ImageSize().width() > 0 ? ImageSize().width() + edge : 0) + width + spare;
    Label label = LineLabel(QRect(start, cell.top(), room, cell.height()), width);
    if (!look_.fullRow) return label;
    label.mark = cell;
    label.reach = QRect(QPoint(start, cell.top()), cell.bottomRight());
    return label;
}

std::optional<TreeWidget::Position> TreeWidget::HitRow(QPoint at) const {
    const auto row = RowView::HitRow(at);
    return row && !SignPlace(*row).contains(at) && !BoxPlace(*row).contains(at) ? row : std::nullopt;
}

}  // namespace tessel::qt
