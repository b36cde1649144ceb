#pragma once

#include "frame/Font.h"
#include "frame/Picture.h"
#include "frame/child/DragChild.h"
#include "frame/child/ImageList.h"
#include "frame/child/Label.h"
#include "frame/child/TreeConstants.h"
#include "frame/child/TreeNode.h"
#include "frame/child/TreeNodes.h"
#include "frame/child/TreeViewPeer.h"

namespace tessel::child {

/// A tree of nodes with a text, images and a key each, made for 100,000 nodes. Code that handles many nodes uses `Tree()`; `Nodes`
/// and `TreeNode` are the same nodes for late-bound callers and for those who keep a node across an event.
///
/// One node at most is selected. Selecting expands and scrolls nothing, nor does collapsing a branch move the selection out of it.
///
/// Without a screen a fixed rule answers for it: rows of 255 twips, one below the other, found by their height alone.
///
/// What a peer must do:
/// - In each `Update` read `Tree().TakeChanges()`, which starts with all rows, and compare everything else with what it shows: the
///   selection, marks, images and signs come as changed rows, the image list has a `Revision`. A row is a node whose ancestors
///   are all expanded: `Tree().AtRow`, `RowOf`, `Level`, `HasChildren`, `Expanded`. Its image is
///   `ImageList()->ListImages.Find(Tree().ShownImage(node))`; null shows none. It draws `ShownPicture` at the list's image size.
/// - It keeps no texts. `Tree()` may be read at any time; a row that it holds is good until the next `Update`.
/// - Before it turns what the user does into an input it lets the host settle (`Host::Flush`). Inputs name a node by its index.
/// - It derives from `TreeViewPeer` to answer for the screen and to open the label edit; one that does not is a plain follower.
/// - Mouse and keys first, then what the tree does by itself: `MouseDownInput`, the click on a node, `ClickInput` at the release.
///   A press on a label or an image is `NodeClickInput`, one on a sign `ExpandInput` or `CollapseInput`, as is a double click on a
///   label where the node has children; one on a check box is `CheckInput`. The right button selects nothing by itself. Keys move
///   by `SelectInput`; from a selection without a row they start at its nearest ancestor that has one. With `SingleSel` a click on
///   a node with children expands it.
/// - With `LabelEdit` automatic a click on the label of the selected node that becomes no double click is `EditInput`. An open edit
///   belongs to the node `EditedNode`, wherever it moves: accepting it is `EndEditInput`, Escape `GiveUpEditInput`. Keys typed into
///   it, and their releases, are not reported as keys of the tree.
/// - `DropHighlight` is shown as if it were selected.
/// - It drags by what `DragChild` says.
class TreeView final : public DragChild {
  public:
    static constexpr float rowHeightTwips = 255;

    TreeView(frame::Control& owner, std::string name);

    TreeNodes& Tree() { return nodes_; }
    const TreeNodes& Tree() const { return nodes_; }
    child::Nodes& Items() { return Nodes; }

    /// Whether the nodes of the top level stand by their texts; a set to true sorts them anew.
    bool Sorted() const { return nodes_.Sorted(noNode); }
    void SetSorted(bool value) { nodes_.SetSorted(noNode, value); }
    /// The images of the nodes; null for none. An image that names a key which has gone shows nothing, and shows again when it
    /// comes back.
    child::ImageList* ImageList() const { return images_.Get(); }
    void SetImageList(child::ImageList* value);

    TreeStyleConstants Style() const { return style_; }
    void SetStyle(TreeStyleConstants value) { Store(style_, value); }
    TreeLineStyleConstants LineStyle() const { return lineStyle_; }
    void SetLineStyle(TreeLineStyleConstants value) { Store(lineStyle_, value); }
    /// Whether the user may edit labels by clicking them; `StartLabelEdit` does either way.
    TreeLabelEditConstants LabelEdit() const { return labelEdit_; }
    void SetLabelEdit(TreeLabelEditConstants value) { Store(labelEdit_, value); }
    /// How far a level is set in, in twips. Error 380 below 0.
    float Indentation() const { return indentation_; }
    void SetIndentation(float value);
    /// What joins the texts of `FullPath`.
    const std::string& PathSeparator() const { return pathSeparator_; }
    void SetPathSeparator(const std::string& value) { Store(pathSeparator_, value); }
    /// Whether the selection is not shown while the tree has not the focus.
    bool HideSelection() const { return hideSelection_; }
    void SetHideSelection(bool value) { Store(hideSelection_, value); }
    bool FullRowSelect() const { return fullRowSelect_; }
    void SetFullRowSelect(bool value) { Store(fullRowSelect_, value); }
    /// Whether the node under the pointer is highlighted.
    bool HotTracking() const { return hotTracking_; }
    void SetHotTracking(bool value) { Store(hotTracking_, value); }
    /// Whether the tree has scroll bars where its nodes do not fit.
    bool Scroll() const { return scroll_; }
    void SetScroll(bool value) { Store(scroll_, value); }
    /// Whether a click expands the node and collapses the one that was selected.
    bool SingleSel() const { return singleSel_; }
    void SetSingleSel(bool value) { Store(singleSel_, value); }
    bool Checkboxes() const { return checkboxes_; }
    void SetCheckboxes(bool value) { Store(checkboxes_, value); }

    frame::OLE_COLOR BackColor() const { return backColor_; }
    void SetBackColor(frame::OLE_COLOR value) { Store(backColor_, value); }
    frame::OLE_COLOR ForeColor() const { return foreColor_; }
    void SetForeColor(frame::OLE_COLOR value) { Store(foreColor_, value); }
    /// Never null: a set to null gives a font of the default name and size.
    const frame::FontRef& Font() const { return font_.Get(); }
    void SetFont(const frame::FontRef& value);
    TreeBorderConstants BorderStyle() const { return borderStyle_; }
    void SetBorderStyle(TreeBorderConstants value) { Store(borderStyle_, value); }
    AppearanceConstants Appearance() const { return appearance_; }
    void SetAppearance(AppearanceConstants value) { Store(appearance_, value); }
    std::int16_t MousePointer() const { return mousePointer_; }
    void SetMousePointer(std::int16_t value) { Store(mousePointer_, value); }
    const frame::PictureRef& MouseIcon() const { return mouseIcon_; }
    void SetMouseIcon(const frame::PictureRef& value) { Store(mouseIcon_, value); }

    /// Null for none. Selects a node of this tree (error 35601 for one of another, 91 for one that has gone); raises nothing.
    TreeNodeRef SelectedItem() const { return NodeOrNull(nodes_.Selected()); }
    void SetSelectedItem(const TreeNodeRef& value) { nodes_.SetSelected(value ? IdOf(value) : noNode); }
    /// The node that is shown as the target of a drop; null for none. The same errors.
    TreeNodeRef DropHighlight() const;
    void SetDropHighlight(const TreeNodeRef& value);
    void SetFocus() { Host().Focus().Set(*this); }

    /// Stores it and, where it is new, raises `Expand` or `Collapse`.
    void SetExpanded(NodeId node, bool value);

    /// The node at a point in twips of the tree; null beside the nodes.
    TreeNodeRef HitTest(float x, float y) const;
    /// Whether a node is within the window, in whole or in part.
    bool IsInView(NodeId node) const;
    /// Expands the node's ancestors from the top level down, raising `Expand`, and scrolls just so far that it is in view.
    void EnsureVisible(NodeId node);
    TreeNodeRef NodeOf(NodeId node) const;
    /// A node of this tree: error 35601 for one of another, 91 for null and for one that has gone.
    NodeId IdOf(const TreeNodeRef& value) const;

    /// Opens the edit of the selected node's label: `BeforeLabelEdit` comes first and may cancel it, then the node is made visible.
    /// Nothing happens without a selected node, or when its edit is open; an edit of another node is given up.
    void StartLabelEdit();
    /// Whether a label edit is open.
    bool Editing() const { return EditedNode().has_value(); }
    /// The node whose label edit is open.
    std::optional<NodeId> EditedNode() const;

    // What a peer reports. Indexes count from 1; error 35600 outside.
    /// The user has clicked a node: it is selected, then `NodeClick` comes.
    void NodeClickInput(std::int32_t index);
    /// The user has selected a node by the keyboard: the same, where it was not selected already.
    void SelectInput(std::int32_t index);
    /// The user has expanded or collapsed a node. The event comes even where the node was so already.
    void ExpandInput(std::int32_t index);
    void CollapseInput(std::int32_t index);
    /// The user has turned the mark of a node round: `NodeCheck` comes.
    void CheckInput(std::int32_t index);
    /// The user has scrolled: the node at this index is the first in view. Passed over for one without a row.
    void ScrollInput(std::int32_t index);
    /// The user has asked for the edit of a label by clicking it. Passed over when `LabelEdit` is manual.
    void EditInput(std::int32_t index);
    /// The user has accepted the text of the open edit: it is closed, `AfterLabelEdit` comes, and unless that cancels the node
    /// takes the text as the event leaves it.
    void EndEditInput(const std::string& text);
    /// The user has given the open edit up: `LabelEditGivenUp` comes and no `AfterLabelEdit`.
    void GiveUpEditInput();
    /// A whole edit of the selected node: `BeforeLabelEdit`, and unless that cancels `AfterLabelEdit`. `newString` is the node's
    /// label afterwards, so that it tells whether the text was kept.
    void LabelEditInput(std::string& newString);
    /// The two halves of it by themselves.
    void BeforeLabelEditInput(bool& cancel);
    void AfterLabelEditInput(bool& cancel, std::string& newString);

    // Where the events go.
    frame::Slot<const TreeNodeRef&> NodeClick, NodeCheck, Expand, Collapse;
    frame::Slot<bool&> BeforeLabelEdit;
    frame::Slot<bool&, std::string&> AfterLabelEdit;
    frame::Slot<> LabelEditGivenUp;

    const frame::ClassTable& Table() const override;

    child::Nodes Nodes{*this};

  protected:
    void PeerAttached() override { nodes_.Follow(); }

  private:
    using Row = TreeNodes::Row;

    void NodesChanged();
    void ImagesChanged();
    TreeNodeRef NodeOrNull(NodeId node) const { return node == noNode ? nullptr : NodeOf(node); }
    /// The screen, told of every change; null where the fixed rule stands in.
    TreeScreen* Screen() const;
    float InnerHeight() const;
    Row TopRow() const;
    void ShowFixed(Row row);

    void Report(const frame::Slot<const TreeNodeRef&>& event, NodeId node);
    void ClickNode(NodeId node);

    /// False when the edit was refused, or its node has gone meanwhile. No node at all raises the event alone.
    bool OpenEdit(NodeRef node, bool& cancel);
    void CloseEdit(NodeRef node, bool& cancel, std::string& newString);
    void GiveUpEdit();
    NodeRef SelectedRef() const;

    TreeNodes nodes_{[this] { NodesChanged(); }};
    ImageListHolder images_{[this] { ImagesChanged(); }};
    frame::FontHolder font_{[this] { Changed(); }};
    frame::PictureRef mouseIcon_;
    NodeRef dropHighlight_;
    NodeRef edited_;
    NodeRef opening_;  // while `BeforeLabelEdit` asks
    Row top_ = 0;      // by the fixed rule; may stand behind the end after rows have gone

    std::string pathSeparator_ = "\\";
    float indentation_ = 285;
    frame::OLE_COLOR backColor_ = frame::colors::windowBackground;
    frame::OLE_COLOR foreColor_ = frame::colors::windowText;
    TreeStyleConstants style_ = TreeStyleConstants::TreelinesPlusMinusPictureText;
    TreeLineStyleConstants lineStyle_ = TreeLineStyleConstants::RootLines;
    TreeLabelEditConstants labelEdit_ = TreeLabelEditConstants::Automatic;
    TreeBorderConstants borderStyle_ = TreeBorderConstants::None;
    AppearanceConstants appearance_ = AppearanceConstants::ThreeD;
    std::int16_t mousePointer_ = 0;
    bool hideSelection_ = true, fullRowSelect_ = false, hotTracking_ = false, scroll_ = true;
    bool singleSel_ = false, checkboxes_ = false;
};

}  // namespace tessel::child
