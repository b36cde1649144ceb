#include "frame/child/TreeView.h"

#include <algorithm>
#include <cmath>
#include <vector>

#include "frame/ClassTable.h"
#include "frame/Surface.h"

namespace tessel::child {

using frame::ControlError;
namespace errors = frame::errors;

TreeView::TreeView(frame::Control& owner, std::string name) : DragChild(owner, std::move(name)) {
    font_.Set(std::make_shared<frame::Font>());
}

void TreeView::SetImageList(child::ImageList* value) {
    images_.Set(value);
    ImagesChanged();
}

void TreeView::SetIndentation(float value) {
    if (!(value >= 0)) throw ControlError(errors::invalidValue);
    Store(indentation_, value);
}

void TreeView::SetFont(const frame::FontRef& value) {
    font_.Set(value ? value : std::make_shared<frame::Font>());
    Changed();
}

TreeNodeRef TreeView::DropHighlight() const { return nodes_.Lives(dropHighlight_) ? NodeOf(dropHighlight_.node) : nullptr; }

void TreeView::SetDropHighlight(const TreeNodeRef& value) { Store(dropHighlight_, value ? nodes_.Ref(IdOf(value)) : NodeRef()); }

void TreeView::SetExpanded(NodeId node, bool value) {
    if (nodes_.Expanded(node) == value) return;
    nodes_.SetExpanded(node, value);
    Report(value ? Expand : Collapse, node);
}

TreeNodeRef TreeView::HitTest(float x, float y) const {
    std::optional<Row> row;
    if (TreeScreen* screen = Screen()) {
        row = screen->RowAt(x, y);
    } else {
        const float rows = std::floor(y / rowHeightTwips);
        if (rows >= 0 && rows < static_cast<float>(nodes_.RowCount())) row = TopRow() + static_cast<Row>(rows);
    }
    return row && *row < nodes_.RowCount() ? NodeOf(nodes_.AtRow(*row)) : nullptr;
}

bool TreeView::IsInView(NodeId node) const {
    const auto row = nodes_.RowOf(node);
    if (!row) return false;
    TreeScreen::RowsInView inView;
    if (TreeScreen* screen = Screen())
        inView = screen->InView();
    else
        inView = {TopRow(), static_cast<Row>(std::ceil(InnerHeight() / rowHeightTwips))};
    return *row >= inView.first && *row - inView.first < inView.count;
}

void TreeView::EnsureVisible(NodeId node) {
    const NodeRef ref = nodes_.Ref(node);
    std::vector<NodeRef> above;
    for (NodeId parent = nodes_.Parent(node); parent != noNode; parent = nodes_.Parent(parent)) above.push_back(nodes_.Ref(parent));
    for (auto parent = above.rbegin(); parent != above.rend(); ++parent)
        if (nodes_.Lives(*parent)) SetExpanded(parent->node, true);

    // The handlers of `Expand` may have removed the node or collapsed a branch again.
    const auto row = nodes_.Lives(ref) ? nodes_.RowOf(node) : std::nullopt;
    if (!row) return;
    if (TreeScreen* screen = Screen())
        screen->MakeVisible(*row);
    else
        ShowFixed(*row);
}

TreeNodeRef TreeView::NodeOf(NodeId node) const {
    return std::make_shared<TreeNode>(const_cast<TreeView&>(*this),  // NOLINT: who may read a node may change it
                                      nodes_.Ref(node));
}

NodeId TreeView::IdOf(const TreeNodeRef& value) const {
    if (!value) frame::ThrowObjectGone();
    if (!value->IsOf(*this)) throw ControlError(errors::elementNotFound);
    if (!nodes_.Lives(value->Ref())) frame::ThrowObjectGone();
    return value->Ref().node;
}

void TreeView::StartLabelEdit() {
    const NodeRef selected = SelectedRef();
    if (!nodes_.Lives(selected) || edited_ == selected || opening_ == selected) return;
    bool cancel = false;
    OpenEdit(selected, cancel);
}

std::optional<NodeId> TreeView::EditedNode() const { return nodes_.Lives(edited_) ? std::optional(edited_.node) : std::nullopt; }

void TreeView::NodesChanged() {
    if (nodes_.Count() == 0) top_ = 0;
    if (!Peer()) nodes_.Unfollow();
    Changed();
}

void TreeView::ImagesChanged() {
    nodes_.BindImages(images_.Get() ? &images_.Get()->Keys() : nullptr);
    Changed();
}

TreeScreen* TreeView::Screen() const {
    auto* peer = dynamic_cast<TreeViewPeer*>(Peer());
    if (!peer) return nullptr;
    Host().Flush();
    return peer->Screen();
}

float TreeView::InnerHeight() const {
    const float border = borderStyle_ != TreeBorderConstants::None ? 2 * frame::borderTwips : 0;
    return std::max(Height() - border, 0.0f);
}

/// By the fixed rule.
TreeView::Row TreeView::TopRow() const { return nodes_.RowCount() > 0 ? std::min(top_, nodes_.RowCount() - 1) : 0; }

void TreeView::ShowFixed(Row row) {
    const float rows = std::floor(InnerHeight() / rowHeightTwips);
    const auto whole = static_cast<Row>(std::clamp(rows, 1.0f, static_cast<float>(nodes_.RowCount())));
    const Row top = TopRow();
    if (row < top)
        Store(top_, row);
    else if (row - top >= whole)
        Store(top_, row - whole + 1);
}

namespace {

constexpr auto lookMembers = std::array{
    frame::property<&TreeView::BackColor, &TreeView::SetBackColor>("BackColor", "The colour behind the nodes."),
    frame::property<&TreeView::ForeColor, &TreeView::SetForeColor>("ForeColor", "The colour of the texts."),
    frame::property<&TreeView::Font, &TreeView::SetFont>("Font", "The font of the texts."),
    frame::property<&TreeView::BorderStyle, &TreeView::SetBorderStyle>("BorderStyle", "Whether the tree has a border."),
    frame::property<&TreeView::Appearance, &TreeView::SetAppearance>("Appearance", "Flat or raised."),
    frame::property<&TreeView::MousePointer, &TreeView::SetMousePointer>("MousePointer", "The pointer's shape over the tree."),
    frame::property<&TreeView::MouseIcon, &TreeView::SetMouseIcon>("MouseIcon", "A pointer of the program's own."),
    frame::property<&TreeView::Style, &TreeView::SetStyle>("Style", "Whether lines, signs and images are shown."),
    frame::property<&TreeView::LineStyle, &TreeView::SetLineStyle>("LineStyle", "Whether the top level has lines and signs."),
    frame::property<&TreeView::Indentation, &TreeView::SetIndentation>("Indentation", "How far a level is set in, in twips."),
    frame::property<&TreeView::HideSelection, &TreeView::SetHideSelection>("HideSelection",
                                                                           "Whether the selection shows only with the focus."),
    frame::property<&TreeView::FullRowSelect, &TreeView::SetFullRowSelect>("FullRowSelect",
                                                                           "Whether the selected node is marked in its whole row."),
    frame::property<&TreeView::HotTracking, &TreeView::SetHotTracking>("HotTracking",
                                                                       "Whether the node under the pointer is highlighted."),
    frame::property<&TreeView::Scroll, &TreeView::SetScroll>("Scroll", "Whether there are scroll bars where they are needed."),
    frame::property<&TreeView::Checkboxes, &TreeView::SetCheckboxes>("Checkboxes", "Whether each node has a box to mark it."),
};

constexpr auto ownMembers = std::array{
    frame::property<&TreeView::Items>("Nodes", "The nodes."),
    frame::property<&TreeView::ImageList, &TreeView::SetImageList>("ImageList", "The images of the nodes."),
    frame::property<&TreeView::Sorted, &TreeView::SetSorted>("Sorted", "Whether the top level is sorted by the texts."),
    frame::property<&TreeView::LabelEdit, &TreeView::SetLabelEdit>("LabelEdit", "Whether a click on a label may edit it."),
    frame::property<&TreeView::PathSeparator, &TreeView::SetPathSeparator>("PathSeparator", "What joins the texts of a full path."),
    frame::property<&TreeView::SingleSel, &TreeView::SetSingleSel>("SingleSel", "Whether a click expands the node."),
    frame::property<&TreeView::SelectedItem, &TreeView::SetSelectedItem>("SelectedItem", "The node that is selected."),
    frame::property<&TreeView::DropHighlight, &TreeView::SetDropHighlight>("DropHighlight",
                                                                           "The node that is shown as the target of a drop."),
    frame::property<&TreeView::Editing>("Editing", "Whether a label edit is open."),
    frame::method<&TreeView::HitTest>("HitTest", "The node at a point.", {"X", "Y"}),
    frame::method<&TreeView::StartLabelEdit>("StartLabelEdit", "Lets the user edit the selected node's text."),
    frame::method<&TreeView::SetFocus>("SetFocus", "Gives the tree the focus."),
};

constexpr auto members = Join(Join(frame::childMembers, dragMembers), frame::Join(ownMembers, lookMembers));

constexpr auto inputs =
    frame::Join(dragInputs, std::array{
                                frame::input<&TreeView::NodeClickInput>("NodeClick", {"Index"}),
                                frame::input<&TreeView::SelectInput>("Select", {"Index"}),
                                frame::input<&TreeView::ExpandInput>("Expand", {"Index"}),
                                frame::input<&TreeView::CollapseInput>("Collapse", {"Index"}),
                                frame::input<&TreeView::CheckInput>("NodeCheck", {"Index"}),
                                frame::input<&TreeView::ScrollInput>("Scroll", {"Index"}),
                                frame::input<&TreeView::EditInput>("Edit", {"Index"}),
                                frame::input<&TreeView::EndEditInput>("EndEdit", {"NewString"}),
                                frame::input<&TreeView::GiveUpEditInput>("GiveUpEdit"),
                                frame::input<&TreeView::LabelEditInput>("LabelEdit", {"NewString"}),
                                frame::input<&TreeView::BeforeLabelEditInput>("BeforeLabelEdit", {"Cancel"}),
                                frame::input<&TreeView::AfterLabelEditInput>("AfterLabelEdit", {"Cancel", "NewString"}),
                            });
constexpr frame::ClassTable table{.name = "TreeView", .members = members, .inputs = inputs};

}  // namespace

const frame::ClassTable& TreeView::Table() const { return table; }

}  // namespace tessel::child
