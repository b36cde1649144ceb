#include <QElapsedTimer>
#include <utility>

#include "frame/Text.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/TreeWidget.h"

/// What the user does with a tree.
namespace tessel::qt {

using child::NodeId;
using child::NodeRef;
using child::noNode;

// The mouse.

void TreeWidget::mousePressEvent(QMouseEvent* event) {
    expandTimer_.stop();
    expanding_.clear();
    RowView::mousePressEvent(event);
}

void TreeWidget::PressAt(const QMouseEvent&) {
    const auto row = layout_.At(ToContents(pressedAt_));
    if (!row || *row >= Nodes().RowCount()) return;
    if (SignPlace(*row).contains(pressedAt_)) return TurnSign(*row);
    if (BoxPlace(*row).contains(pressedAt_)) return TurnCheck(*row);
    if (HitRow(pressedAt_)) PressNode(*row);
}

void TreeWidget::PressNode(Position row) {
    const NodeRef node = Nodes().Ref(NodeAt(row));
    const NodeId selected = Nodes().Selected();
    const NodeRef before = selected == noNode ? NodeRef() : Nodes().Ref(selected);
    const bool isText = LabelOf(row, LabelText(row)).text.contains(ToContents(pressedAt_));
    if (node == before && isText && tree_->LabelEdit() == child::TreeLabelEditConstants::Automatic) EditByClick(row);
    tree_->NodeClickInput(IndexOf(node.node));
    if (tree_ && tree_->SingleSel()) ExpandBySelecting(node, before);
}

void TreeWidget::ExpandBySelecting(NodeRef node, NodeRef before) {
    if (!Settle() || !Nodes().Lives(node)) return;
    if (node != before && Nodes().Lives(before) && Nodes().Expanded(before.node) && !Nodes().IsWithin(node.node, before.node))
        tree_->CollapseInput(IndexOf(before.node));
    if (!Settle() || !Nodes().Lives(node) || !Nodes().HasChildren(node.node) || Nodes().Expanded(node.node)) return;
    tree_->ExpandInput(IndexOf(node.node));
}

void TreeWidget::DoubleClickAt(const QMouseEvent& event) {
    const QPoint at = event.position().toPoint();
    const auto row = layout_.At(ToContents(at));
    if (!row || *row >= Nodes().RowCount()) return;
    if (BoxPlace(*row).contains(at)) return TurnCheck(*row);
    const bool isLabel = HitRow(at) && Nodes().HasChildren(NodeAt(*row)) && !tree_->SingleSel();
    if (isLabel || SignPlace(*row).contains(at)) TurnSign(*row);
}

void TreeWidget::TurnSign(Position row) {
    const NodeId node = NodeAt(row);
    if (Nodes().Expanded(node))
        tree_->CollapseInput(IndexOf(node));
    else
        tree_->ExpandInput(IndexOf(node));
}

// The keyboard.

void TreeWidget::keyPressEvent(QKeyEvent* event) {
    expandTimer_.stop();
    expanding_.clear();
    RowView::keyPressEvent(event);
}

bool TreeWidget::ActByKey(const QKeyEvent& event) { return MoveByKey(event) || TurnByKey(event); }

bool TreeWidget::MoveByKey(const QKeyEvent& event) {
    using Step = ListLayout::Step;
    const auto step = StepOf(event);
    if (!step) return false;
    if (Nodes().RowCount() == 0) return true;
    const auto focus = FocusPosition();
    if (*step == Step::Left || *step == Step::Right) {
        if (focus) MoveSideways(*focus, *step);
        return true;
    }
    const bool isJump = *step == Step::First || *step == Step::Last;
    SelectByKeyboard(focus || isJump ? layout_.Next(focus.value_or(0), *step) : 0, event.modifiers());
    return true;
}

void TreeWidget::MoveSideways(Position from, ListLayout::Step step) {
    const NodeId node = NodeAt(from);
    const bool isOpen = Nodes().HasChildren(node) && Nodes().Expanded(node);
    if (step == ListLayout::Step::Left) {
        isOpen ? TurnSign(from) : GoTo(Nodes().Parent(node));
    } else if (isOpen) {
        GoTo(Nodes().FirstChild(node));
    } else if (Nodes().HasChildren(node)) {
        TurnSign(from);
    }
}

void TreeWidget::GoTo(NodeId node) {
    const auto row = node == noNode ? std::nullopt : Nodes().RowOf(node);
    if (row) SelectByKeyboard(*row, Qt::NoModifier);
}

void TreeWidget::ReportSelection(Position row, Qt::KeyboardModifiers) { tree_->SelectInput(IndexAt(row)); }

bool TreeWidget::TurnByKey(const QKeyEvent& event) {
    const auto focus = FocusPosition();
    if (!focus || (event.modifiers() & (Qt::ControlModifier | Qt::AltModifier))) return false;
    const NodeId node = NodeAt(*focus);
    if (event.key() == Qt::Key_Backspace) {
        GoTo(Nodes().Parent(node));
        return true;
    }
    if (event.key() == Qt::Key_F2) {
        if (node == Nodes().Selected()) ReportEditWanted(*focus);
        return true;
    }
    if (!typed_.isEmpty()) return false;  // a name goes on
    const bool turns = Nodes().HasChildren(node), isOpen = Nodes().Expanded(node);
    switch (event.key()) {
        case Qt::Key_Plus:
            if (turns && !isOpen) TurnSign(*focus);
            return true;
        case Qt::Key_Minus:
            if (turns && isOpen) TurnSign(*focus);
            return true;
        case Qt::Key_Asterisk:
            ExpandAll(node);
            return true;
        case Qt::Key_Space:
            if (view_.boxes) TurnCheck(*focus);
            return view_.boxes;
        default:
            return false;
    }
}

void TreeWidget::ExpandAll(NodeId node) {
    expanding_ = {Nodes().Ref(node)};
    ExpandMore();
}

// A handler of `Expand` may load what stands below: what comes by that is shown, and stays as it came.
void TreeWidget::ExpandMore() {
    constexpr qint64 slice = 20;  // milliseconds between which the program goes on
    QElapsedTimer spent;
    spent.start();
    while (!expanding_.empty() && spent.elapsed() < slice) {
        const NodeRef node = expanding_.front();
        expanding_.pop_front();
        if (!Nodes().Lives(node) || !Nodes().HasChildren(node.node)) continue;
        for (NodeId child = Nodes().LastChild(node.node); child != noNode; child = Nodes().Previous(child))
            if (Nodes().HasChildren(child)) expanding_.push_front(Nodes().Ref(child));
        if (!Nodes().Expanded(node.node)) tree_->ExpandInput(IndexOf(node.node));
        if (!Settle()) return;
    }
    if (expanding_.empty())
        expandTimer_.stop();
    else if (!expandTimer_.isActive())
        expandTimer_.start(0, this);
}

void TreeWidget::timerEvent(QTimerEvent* event) {
    if (event->timerId() != expandTimer_.timerId()) return RowView::timerEvent(event);
    if (Settle()) ExpandMore();
}

std::optional<TreeWidget::Position> TreeWidget::FindFrom(Position first, const QString& text) const {
    const std::string wanted = FromQt(text);
    const Position count = Nodes().RowCount();
    for (Position step = 0; step < count; ++step) {
        const Position row = (first + step) % count;
        if (frame::StartsWithNoCase(Nodes().Text(NodeAt(row)), wanted)) return row;
    }
    return std::nullopt;
}

void TreeWidget::BeginEdit(NodeId node) {
    const auto row = tree_ ? Nodes().RowOf(node) : std::nullopt;
    if (!row) return;
    RowView::BeginEdit(*row);
    editor_->setFont(FontOf(node));
    PlaceEditor();
}

}  // namespace tessel::qt
