#include "frame/child/TreeNode.h"

#include "frame/ClassTable.h"
#include "frame/Text.h"
#include "frame/child/TreeView.h"

namespace tessel::child {

using frame::ControlError;
using frame::OLE_COLOR;
using frame::Status;
using frame::Variant;
namespace errors = frame::errors;

TreeNode::TreeNode(TreeView& tree, NodeRef node) : tree_(tree), node_(node) {}

bool TreeNode::IsOf(const TreeView& tree) const { return tree_.Get() == &tree; }

TreeView& TreeNode::View() const {
    TreeView& tree = *tree_;
    if (!tree.Tree().Lives(node_)) frame::ThrowObjectGone();
    return tree;
}

TreeNodes& TreeNode::Nodes() const { return View().Tree(); }

TreeNodeRef TreeNode::Other(NodeId node) const { return node == noNode ? nullptr : View().NodeOf(node); }

std::string TreeNode::Text() const { return std::string(Nodes().Text(node_.node)); }
void TreeNode::SetText(const std::string& value) { Nodes().SetText(node_.node, value); }
std::string TreeNode::Key() const { return std::string(Nodes().Key(node_.node)); }
Status TreeNode::SetKey(const std::string& value) { return Nodes().SetKey(node_.node, value); }
std::int32_t TreeNode::Index() const { return static_cast<std::int32_t>(Nodes().PositionOf(node_.node)) + 1; }
Variant TreeNode::Tag() const { return Nodes().Tag(node_.node); }
void TreeNode::SetTag(const Variant& value) { Nodes().SetTag(node_.node, value); }

Variant TreeNode::Image() const { return Nodes().Image(node_.node, NodeImage::Plain); }
Status TreeNode::SetImage(const Variant& value) { return Nodes().SetImage(node_.node, NodeImage::Plain, value); }
Variant TreeNode::SelectedImage() const { return Nodes().Image(node_.node, NodeImage::Selected); }
Status TreeNode::SetSelectedImage(const Variant& value) { return Nodes().SetImage(node_.node, NodeImage::Selected, value); }
Variant TreeNode::ExpandedImage() const { return Nodes().Image(node_.node, NodeImage::Expanded); }
Status TreeNode::SetExpandedImage(const Variant& value) { return Nodes().SetImage(node_.node, NodeImage::Expanded, value); }

TreeNodeRef TreeNode::Parent() const { return Other(Nodes().Parent(node_.node)); }
TreeNodeRef TreeNode::Child() const { return Other(Nodes().FirstChild(node_.node)); }
TreeNodeRef TreeNode::Next() const { return Other(Nodes().Next(node_.node)); }
TreeNodeRef TreeNode::Previous() const { return Other(Nodes().Previous(node_.node)); }
TreeNodeRef TreeNode::FirstSibling() const { return Other(Nodes().FirstChild(Nodes().Parent(node_.node))); }
TreeNodeRef TreeNode::LastSibling() const { return Other(Nodes().LastChild(Nodes().Parent(node_.node))); }
TreeNodeRef TreeNode::Root() const { return Other(Nodes().Root(node_.node)); }
std::int32_t TreeNode::Children() const { return static_cast<std::int32_t>(Nodes().ChildCount(node_.node)); }
std::string TreeNode::FullPath() const { return Nodes().FullPath(node_.node, View().PathSeparator()); }

bool TreeNode::Expanded() const { return Nodes().Expanded(node_.node); }
void TreeNode::SetExpanded(bool value) { View().SetExpanded(node_.node, value); }
bool TreeNode::Selected() const { return Nodes().Selected() == node_.node; }

void TreeNode::SetSelected(bool value) {
    if (value || Selected()) Nodes().SetSelected(value ? node_.node : noNode);
}

bool TreeNode::Sorted() const { return Nodes().Sorted(node_.node); }
void TreeNode::SetSorted(bool value) { Nodes().SetSorted(node_.node, value); }
bool TreeNode::Checked() const { return Nodes().Checked(node_.node); }
void TreeNode::SetChecked(bool value) { Nodes().SetChecked(node_.node, value); }
bool TreeNode::Bold() const { return Nodes().Bold(node_.node); }
void TreeNode::SetBold(bool value) { Nodes().SetBold(node_.node, value); }

OLE_COLOR TreeNode::BackColor() const { return Nodes().ColorsOf(node_.node).back.value_or(View().BackColor()); }

void TreeNode::SetBackColor(OLE_COLOR value) {
    TreeNodes::Colors colors = Nodes().ColorsOf(node_.node);
    colors.back = value;
    Nodes().SetColors(node_.node, colors);
}

OLE_COLOR TreeNode::ForeColor() const { return Nodes().ColorsOf(node_.node).fore.value_or(View().ForeColor()); }

void TreeNode::SetForeColor(OLE_COLOR value) {
    TreeNodes::Colors colors = Nodes().ColorsOf(node_.node);
    colors.fore = value;
    Nodes().SetColors(node_.node, colors);
}

bool TreeNode::Visible() const { return View().IsInView(node_.node); }
void TreeNode::EnsureVisible() const { View().EnsureVisible(node_.node); }

std::string TreeNode::Path() const {
    const TreeView* tree = tree_.Get();
    if (!tree || !tree->Tree().Lives(node_)) return {};
    return tree->Nodes.Path() + "(" + frame::Decimal(Index()) + ")";
}

bool TreeNode::EqualsObject(const frame::Object& other) const {
    const auto* node = dynamic_cast<const TreeNode*>(&other);
    return node && node->node_ == node_ && node->tree_.Get() == tree_.Get();
}

std::int32_t Nodes::Count() const { return static_cast<std::int32_t>(tree_.Tree().Count()); }

TreeNodeRef Nodes::Add(const std::optional<Variant>& relative, std::optional<TreeRelationshipConstants> relationship,
                       const std::optional<std::string>& key, const std::optional<std::string>& text,
                       const std::optional<Variant>& image, const std::optional<Variant>& selectedImage) {
    TreeNodes& nodes = tree_.Tree();
    const bool hasRelative = relative && !relative->IsEmpty();
    const NodeId beside = hasRelative ? NodeOf(*relative) : noNode;
    const auto usual = hasRelative ? TreeRelationshipConstants::Next : TreeRelationshipConstants::Last;
    if (image) nodes.CheckImage(*image).Check();
    if (selectedImage) nodes.CheckImage(*selectedImage).Check();

    NodeId added = noNode;
    nodes.Add(added, text.value_or(""), key.value_or(""), beside, relationship.value_or(usual)).Check();
    if (image) nodes.SetImage(added, NodeImage::Plain, *image).Check();
    if (selectedImage) nodes.SetImage(added, NodeImage::Selected, *selectedImage).Check();
    return tree_.NodeOf(added);
}

TreeNodeRef Nodes::Item(const Variant& indexOrKey) const { return tree_.NodeOf(NodeOf(indexOrKey)); }
void Nodes::Remove(const Variant& indexOrKey) { tree_.Tree().Remove(NodeOf(indexOrKey)); }
void Nodes::Clear() { tree_.Tree().Clear(); }

NodeId Nodes::NodeOf(const Variant& indexOrKey) const {
    if (indexOrKey.Type() == frame::VarType::Object) return tree_.IdOf(frame::FromVariant<TreeNodeRef>(indexOrKey));
    if (!indexOrKey.IsString()) return At(indexOrKey.ToLong());
    const auto node = tree_.Tree().FindKey(indexOrKey.Text());
    if (!node) throw ControlError(errors::elementNotFound);
    return *node;
}

NodeId Nodes::At(std::int32_t index) const {
    if (index < 1 || index > Count()) throw ControlError(errors::indexOutOfBounds);
    return tree_.Tree().At(static_cast<TreeNodes::Position>(index - 1));
}

std::string Nodes::Path() const { return tree_.Path() + ".Nodes"; }

namespace {

constexpr std::array nodeMembers = {
    frame::property<&TreeNode::Text, &TreeNode::SetText>("Text", "The text of the node."),
    frame::property<&TreeNode::Key, &TreeNode::SetKey>("Key", "The name of the node in its tree; empty for none."),
    frame::property<&TreeNode::Index>("Index", "The place of the node in the collection, from 1."),
    frame::property<&TreeNode::Tag, &TreeNode::SetTag>("Tag", "Whatever the program keeps with the node."),
    frame::property<&TreeNode::Image, &TreeNode::SetImage>("Image", "The key or index of the node's image."),
    frame::property<&TreeNode::SelectedImage, &TreeNode::SetSelectedImage>("SelectedImage",
                                                                           "The key or index of its image while it is selected."),
    frame::property<&TreeNode::ExpandedImage, &TreeNode::SetExpandedImage>("ExpandedImage",
                                                                           "The key or index of its image while it is expanded."),
    frame::property<&TreeNode::Parent>("Parent", "The node above it."),
    frame::property<&TreeNode::Child>("Child", "The first node below it."),
    frame::property<&TreeNode::Next>("Next", "The next node beside it."),
    frame::property<&TreeNode::Previous>("Previous", "The node before it."),
    frame::property<&TreeNode::FirstSibling>("FirstSibling", "The first node beside it."),
    frame::property<&TreeNode::LastSibling>("LastSibling", "The last node beside it."),
    frame::property<&TreeNode::Root>("Root", "The node of the top level under which it stands."),
    frame::property<&TreeNode::Children>("Children", "The number of its children."),
    frame::property<&TreeNode::FullPath>("FullPath", "The texts from the top level down to it."),
    frame::property<&TreeNode::Expanded, &TreeNode::SetExpanded>("Expanded", "Whether its children are shown."),
    frame::property<&TreeNode::Selected, &TreeNode::SetSelected>("Selected", "Whether the node is selected."),
    frame::property<&TreeNode::Sorted, &TreeNode::SetSorted>("Sorted", "Whether its children are sorted by their texts."),
    frame::property<&TreeNode::Checked, &TreeNode::SetChecked>("Checked", "Whether the node is marked."),
    frame::property<&TreeNode::Bold, &TreeNode::SetBold>("Bold", "Whether the text is bold."),
    frame::property<&TreeNode::BackColor, &TreeNode::SetBackColor>("BackColor", "The colour behind the text."),
    frame::property<&TreeNode::ForeColor, &TreeNode::SetForeColor>("ForeColor", "The colour of the text."),
    frame::property<&TreeNode::Visible>("Visible", "Whether the node is within the window of the tree."),
    frame::method<&TreeNode::EnsureVisible>("EnsureVisible", "Expands and scrolls the tree so that the node is in view."),
};
constexpr frame::ClassTable nodeTable{.name = "Node", .members = nodeMembers, .defaultMember = "Text"};

constexpr std::array nodesMembers = {
    frame::property<&Nodes::Count>("Count", "The number of nodes."),
    frame::property<&Nodes::Item>("Item", "A node by its index, from 1, or its key."),
    frame::method<&Nodes::Add>("Add", "Adds a node and gives it.",
                               {"Relative", "Relationship", "Key", "Text", "Image", "SelectedImage"}),
    frame::method<&Nodes::Remove>("Remove", "Removes a node by its index or key, with all nodes below it.", {"Index"}),
    frame::method<&Nodes::Clear>("Clear", "Removes all nodes."),
};
constexpr frame::ClassTable nodesTable{.name = "Nodes", .members = nodesMembers, .defaultMember = "Item"};

}  // namespace

const frame::ClassTable& TreeNode::Table() const { return nodeTable; }
const frame::ClassTable& Nodes::Table() const { return nodesTable; }

}  // namespace tessel::child
