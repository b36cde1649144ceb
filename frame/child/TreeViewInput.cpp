#include "frame/child/TreeView.h"

/// What the user does with a tree.
namespace tessel::child {

void TreeView::NodeClickInput(std::int32_t index) {
    Enter("NodeClick", [&] { ClickNode(Nodes.At(index)); });
}

void TreeView::SelectInput(std::int32_t index) {
    Enter("Select", [&] {
        const NodeId node = Nodes.At(index);
        if (node != nodes_.Selected()) ClickNode(node);
    });
}

void TreeView::ExpandInput(std::int32_t index) {
    Enter("Expand", [&] {
        const NodeId node = Nodes.At(index);
        nodes_.SetExpanded(node, true);
        Report(Expand, node);
    });
}

void TreeView::CollapseInput(std::int32_t index) {
    Enter("Collapse", [&] {
        const NodeId node = Nodes.At(index);
        nodes_.SetExpanded(node, false);
        Report(Collapse, node);
    });
}

void TreeView::CheckInput(std::int32_t index) {
    Enter("NodeCheck", [&] {
        const NodeId node = Nodes.At(index);
        nodes_.SetChecked(node, !nodes_.Checked(node));
        Report(NodeCheck, node);
    });
}

void TreeView::ScrollInput(std::int32_t index) {
    Enter("Scroll", [&] {
        if (const auto row = nodes_.RowOf(Nodes.At(index))) Store(top_, *row);
    });
}

void TreeView::EditInput(std::int32_t index) {
    Enter("Edit", [&] {
        const NodeId node = Nodes.At(index);
        if (labelEdit_ != TreeLabelEditConstants::Automatic) return;
        nodes_.SetSelected(node);
        StartLabelEdit();
    });
}

void TreeView::EndEditInput(const std::string& text) {
    Enter("EndEdit", [&] {
        bool cancel = false;
        std::string newString = text;
        if (Editing()) CloseEdit(edited_, cancel, newString);
    });
}

void TreeView::GiveUpEditInput() {
    Enter("GiveUpEdit", [&] { GiveUpEdit(); });
}

void TreeView::LabelEditInput(std::string& newString) {
    Enter("LabelEdit", [&] {
        const NodeRef node = SelectedRef();
        std::string typed = newString;
        if (nodes_.Lives(node)) newString = nodes_.Text(node.node);
        bool cancel = false;
        if (!OpenEdit(node, cancel)) return;
        CloseEdit(node, cancel, typed);
        if (!cancel) newString = typed;
    });
}

void TreeView::BeforeLabelEditInput(bool& cancel) {
    Enter("BeforeLabelEdit", [&] { OpenEdit(SelectedRef(), cancel); });
}

void TreeView::AfterLabelEditInput(bool& cancel, std::string& newString) {
    Enter("AfterLabelEdit", [&] { CloseEdit(Editing() ? edited_ : SelectedRef(), cancel, newString); });
}

void TreeView::Report(const frame::Slot<const TreeNodeRef&>& event, NodeId node) {
    if (event) event(NodeOf(node));
}

void TreeView::ClickNode(NodeId node) {
    nodes_.SetSelected(node);
    Report(NodeClick, node);
}

bool TreeView::OpenEdit(NodeRef node, bool& cancel) {
    struct Opening {
        ~Opening() { mark = {}; }
        NodeRef& mark;
    };
    GiveUpEdit();
    {
        const Opening opening{opening_ = node};
        BeforeLabelEdit(cancel);
    }
    if (cancel) return false;
    if (nodes_.Lives(node)) EnsureVisible(node.node);
    if (!nodes_.Lives(node)) return node == NodeRef{};
    Store(edited_, node);
    if (auto* peer = dynamic_cast<TreeViewPeer*>(Peer())) {
        Host().Flush();
        if (nodes_.RowOf(node.node)) peer->EditBegan(node.node);
    }
    return true;
}

void TreeView::CloseEdit(NodeRef node, bool& cancel, std::string& newString) {
    Store(edited_, NodeRef{});
    AfterLabelEdit(cancel, newString);
    if (!cancel && nodes_.Lives(node)) nodes_.SetText(node.node, newString);
}

void TreeView::GiveUpEdit() {
    const bool wasOpen = Editing();
    Store(edited_, NodeRef{});
    if (wasOpen) LabelEditGivenUp();
}

NodeRef TreeView::SelectedRef() const { return nodes_.Selected() != noNode ? nodes_.Ref(nodes_.Selected()) : NodeRef(); }

}  // namespace tessel::child
