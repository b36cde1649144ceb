#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

#include "frame/Object.h"
#include "frame/child/TreeNodes.h"

namespace tessel::child {

class TreeView;
class TreeNode;
using TreeNodeRef = std::shared_ptr<TreeNode>;

/// A node of a tree, named weakly: when the node or its tree has gone every member fails with error 91. Two of them that name the
/// same node are equal.
class TreeNode final : public frame::Object {
  public:
    TreeNode(TreeView& tree, NodeRef node);

    std::string Text() const;
    void SetText(const std::string& value);
    /// Unique in its tree without regard to case; empty for none. Error 35602 for a key that another node has.
    std::string Key() const;
    frame::Status SetKey(const std::string& value);
    /// From 1: the place in `Nodes`. It falls when a node that was added earlier goes.
    std::int32_t Index() const;
    frame::Variant Tag() const;
    void SetTag(const frame::Variant& value);

    // The key or the index (from 1) of an image of the bound image list; empty for none. Error 35601 for a key that the list lacks,
    // 35600 for such an index.
    frame::Variant Image() const;
    frame::Status SetImage(const frame::Variant& value);
    frame::Variant SelectedImage() const;
    frame::Status SetSelectedImage(const frame::Variant& value);
    frame::Variant ExpandedImage() const;
    frame::Status SetExpandedImage(const frame::Variant& value);

    // The family; null where there is none. A node without others at its level is its own first and last sibling.
    TreeNodeRef Parent() const;
    TreeNodeRef Child() const;
    TreeNodeRef Next() const;
    TreeNodeRef Previous() const;
    TreeNodeRef FirstSibling() const;
    TreeNodeRef LastSibling() const;
    TreeNodeRef Root() const;
    /// The number of its children, those below them not among them.
    std::int32_t Children() const;
    /// The texts from the top level down to the node, joined by the tree's `PathSeparator`.
    std::string FullPath() const;

    bool Expanded() const;
    /// Raises `Expand` or `Collapse` of the tree where this is new.
    void SetExpanded(bool value);
    bool Selected() const;
    /// Selecting takes the selection from the node that had it; false leaves none selected where this was.
    void SetSelected(bool value);
    /// Whether the children stand by their texts; a set to true sorts them anew.
    bool Sorted() const;
    void SetSorted(bool value);
    /// A mark of the program's own, which the user may set where the tree has `Checkboxes`.
    bool Checked() const;
    void SetChecked(bool value);
    bool Bold() const;
    void SetBold(bool value);
    /// The tree's colours until they are set.
    frame::OLE_COLOR BackColor() const;
    void SetBackColor(frame::OLE_COLOR value);
    frame::OLE_COLOR ForeColor() const;
    void SetForeColor(frame::OLE_COLOR value);
    /// Whether the node is within the window of the tree, in whole or in part.
    bool Visible() const;
    /// Expands the node's ancestors, from the top level down, and scrolls just so far that it is in view.
    void EnsureVisible() const;

    NodeRef Ref() const { return node_; }
    bool IsOf(const TreeView& tree) const;

    const frame::ClassTable& Table() const override;
    std::string Path() const override;
    bool EqualsObject(const frame::Object& other) const override;

  private:
    /// The tree, when the node is still in it.
    TreeView& View() const;
    TreeNodes& Nodes() const;
    TreeNodeRef Other(NodeId node) const;

    frame::Handle<TreeView> tree_;
    NodeRef node_;
};

/// The nodes of a tree as a collection, in the order of their adding. A node is named by its index from 1, by its key, without
/// regard to case, or by itself: a string is always a key. Error 35600 for an index outside, 35601 for a key that is not there
/// and for a node of another tree, 91 for one that has gone.
class Nodes final : public frame::Object {
  public:
    explicit Nodes(TreeView& tree) : tree_(tree) {}

    std::int32_t Count() const;
    /// Adds a node behind all others of the collection: as a child of `relative`, beside it (right behind where no relationship is
    /// given) or first or last among its siblings; without a relative first or last at the top level. Among sorted siblings the
    /// text alone decides. Error 35602 for a key that is there already, and the errors of the images; nothing is added then.
    TreeNodeRef Add(const std::optional<frame::Variant>& relative, std::optional<TreeRelationshipConstants> relationship,
                    const std::optional<std::string>& key, const std::optional<std::string>& text,
                    const std::optional<frame::Variant>& image = {}, const std::optional<frame::Variant>& selectedImage = {});
    TreeNodeRef Item(const frame::Variant& indexOrKey) const;
    /// With all nodes below it.
    void Remove(const frame::Variant& indexOrKey);
    void Clear();

    /// The node at an index.
    NodeId At(std::int32_t index) const;

    const frame::ClassTable& Table() const override;
    std::string Path() const override;

  private:
    NodeId NodeOf(const frame::Variant& indexOrKey) const;

    TreeView& tree_;
};

}  // namespace tessel::child
