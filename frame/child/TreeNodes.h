#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "frame/Color.h"
#include "frame/Error.h"
#include "frame/Variant.h"
#include "frame/child/NodeNames.h"
#include "frame/child/NodeShape.h"
#include "frame/child/RowIcons.h"
#include "frame/child/RowIndex.h"
#include "frame/child/RowJournal.h"
#include "frame/child/RowOrder.h"
#include "frame/child/TreeConstants.h"

namespace tessel::child {

/// A node that may have gone, in which case its number may already name another.
struct NodeRef {
    NodeId node = noNode;
    std::uint32_t serial = 0;  ///< 0 names no node
    friend bool operator==(const NodeRef&, const NodeRef&) = default;
};

/// The images that a node names: the usual one, that of the selected and that of an expanded node.
enum class NodeImage : std::uint8_t { Plain, Selected, Expanded };

/// The nodes of a tree, made for 100,000 of them: their order in the collection, which is that of their adding, their family,
/// names and states, and the rows that a screen shows. A node takes about 105 bytes besides its text and key, 12 more once a child
/// was looked for by its text. Positions in the collection, places among siblings and rows count from 0. A `NodeId` must name a
/// node that is in the tree; where `noNode` is allowed it is said.
///
/// Sorted siblings stand by their texts without regard to case; those with equal texts keep their order. A node that is added goes
/// where it belongs, and so does then a sibling whose text was set since; setting a text moves nothing by itself. Setting
/// `Sorted` again sorts anew.
class TreeNodes {
  public:
    using Position = RowOrder::Position;
    using Row = NodeShape::Row;

    /// `changed` is told after each change.
    explicit TreeNodes(std::function<void()> changed) : changed_(std::move(changed)) {}

    Position Count() const { return order_.Size(); }
    NodeId At(Position position) const { return order_.At(position); }
    Position PositionOf(NodeId node) const { return order_.PositionOf(node); }
    NodeRef Ref(NodeId node) const { return {node, nodes_[node].serial}; }
    bool Lives(NodeRef ref) const { return ref.serial != 0 && ref.node < nodes_.Size() && nodes_[ref.node].serial == ref.serial; }

    /// Adds a node behind all others of the collection, related to another; without one, first or last at the top level. Among
    /// sorted siblings the text alone decides. Error 35602 for a key that is there already; the empty key is none.
    frame::Status Add(NodeId& added, std::string_view text, std::string_view key = {}, NodeId relative = noNode,
                      TreeRelationshipConstants relationship = TreeRelationshipConstants::Last);
    /// With all below it. Where the selected node goes, the next sibling of the one that was removed is selected, else the previous
    /// one, else the parent.
    void Remove(NodeId node);
    void Clear();

    // The family; `noNode` where there is none.
    NodeId Parent(NodeId node) const { return shape_.Parent(node); }
    NodeId FirstChild(NodeId parentOrNone) const { return shape_.FirstChild(parentOrNone); }
    NodeId LastChild(NodeId parentOrNone) const { return shape_.LastChild(parentOrNone); }
    NodeId Next(NodeId node) const { return shape_.Next(node); }
    NodeId Previous(NodeId node) const { return shape_.Previous(node); }
    NodeId Root(NodeId node) const;
    std::uint32_t ChildCount(NodeId parentOrNone) const { return shape_.ChildCount(parentOrNone); }
    bool HasChildren(NodeId node) const { return shape_.ChildCount(node) > 0; }
    bool IsWithin(NodeId node, NodeId ancestor) const { return shape_.IsWithin(node, ancestor); }
    /// How many ancestors a node has.
    int Level(NodeId node) const { return shape_.Level(node); }

    /// Good until the next change of the tree.
    std::string_view Text(NodeId node) const { return names_.Text(node); }
    void SetText(NodeId node, std::string_view text);
    /// The first child whose text is this, without regard to case: what walking them finds, at constant cost.
    std::optional<NodeId> FindChild(NodeId parentOrNone, std::string_view text) const;
    /// Unique in the tree without regard to case; empty for none.
    std::string_view Key(NodeId node) const { return names_.Key(node); }
    /// Error 35602 for a key that another node has.
    frame::Status SetKey(NodeId node, std::string_view key);
    std::optional<NodeId> FindKey(std::string_view key) const { return names_.FindKey(key); }
    /// The texts from the top level down to the node.
    std::string FullPath(NodeId node, std::string_view separator) const;

    /// Whether the children are sorted; of `noNode`, the top level.
    bool Sorted(NodeId parentOrNone) const;
    void SetSorted(NodeId parentOrNone, bool value);

    /// A node without children may be expanded too: those that come are shown at once.
    bool Expanded(NodeId node) const { return shape_.Expanded(node); }
    void SetExpanded(NodeId node, bool value);
    /// `noNode` for none. The selected node may stand in a branch that is not expanded.
    NodeId Selected() const { return selected_; }
    void SetSelected(NodeId nodeOrNone);
    bool Checked(NodeId node) const { return Has(node, checked); }
    void SetChecked(NodeId node, bool value) { SetFlag(node, checked, value); }
    bool Bold(NodeId node) const { return Has(node, bold); }
    void SetBold(NodeId node, bool value) { SetFlag(node, bold, value); }
    frame::Variant Tag(NodeId node) const;
    void SetTag(NodeId node, frame::Variant value);
    /// Nothing where the node has the colours of its tree.
    struct Colors {
        std::optional<frame::OLE_COLOR> back, fore;
        friend bool operator==(const Colors&, const Colors&) = default;
    };
    Colors ColorsOf(NodeId node) const;
    void SetColors(NodeId node, const Colors& colors);

    void BindImages(const KeySet* keys) { icons_.Bind(IconSize::Small, keys); }
    frame::Variant Image(NodeId node, NodeImage which) const { return icons_.Value(ImageOf(node, which)); }
    /// The image that a screen shows: that of the selected or else the expanded node where it has one, the usual one otherwise.
    frame::Variant ShownImage(NodeId node) const;
    /// The errors of `RowIcons`: 35601 for a key that the image list lacks, 35600 for an index outside of it.
    frame::Status SetImage(NodeId node, NodeImage which, const frame::Variant& value);
    frame::Status SetImageKey(NodeId node, NodeImage which, std::string_view key);
    /// Whether `SetImage` would take this.
    frame::Status CheckImage(const frame::Variant& value);

    // What a screen shows: the nodes whose ancestors are all expanded.
    Row RowCount() const { return shape_.RowCount(); }
    NodeId AtRow(Row row) const { return shape_.AtRow(row); }
    /// Nothing for a node in a branch that is not expanded.
    std::optional<Row> RowOf(NodeId node) const { return shape_.RowOf(node); }

    /// From now on changes of the rows are kept for one who follows and begins with all of them; `Unfollow` ends that.
    void Follow();
    void Unfollow();
    /// What has changed since the last call.
    std::vector<RowChange> TakeChanges() { return journal_.Take(); }

  private:
    struct Node {
        std::uint32_t serial = 0;  // 0 for a node that has gone
        std::array<RowIcons::IconId, 3> images{};
        std::uint8_t flags = 0;
    };
    static constexpr std::uint8_t sorted = 1, checked = 2, bold = 4, tagged = 8, colored = 16;

    bool Has(NodeId node, std::uint8_t flag) const { return (nodes_[node].flags & flag) != 0; }
    void SetFlag(NodeId node, std::uint8_t flag, bool value);
    RowIcons::IconId ImageOf(NodeId node, NodeImage which) const { return nodes_[node].images[static_cast<std::size_t>(which)]; }
    void StoreImage(NodeId node, NodeImage which, RowIcons::IconId image);

    NodeId TakeId();
    void Forget(NodeId node);
    void SelectBeside(NodeId leaving);
    NodeShape::Place PlaceFor(NodeId parent, NodeId relative, TreeRelationshipConstants relationship) const;
    std::uint32_t ChildHash(NodeId parent, std::string_view text) const;

    void Unsettle(NodeId node);
    void Settle(NodeId parent);
    void SortChildren(NodeId parent);
    NodeShape::Place SortedPlace(NodeId parent, std::string_view text, NodeShape::Place stay) const;

    bool Journals() const { return followed_ && !journal_.IsReset(); }
    void NodeChanged(NodeId node);
    void JournalRow(NodeId nodeOrNone);

    std::function<void()> changed_;
    RowPages<Node> nodes_;
    NodeId lastId_ = noNode;
    std::vector<NodeId> free_;
    std::uint32_t lastSerial_ = 0;
    RowOrder order_;
    NodeShape shape_;
    NodeNames names_;
    mutable std::unique_ptr<HashIndex> childTexts_;  // made when first asked
    RowIcons icons_;
    std::unordered_map<NodeId, frame::Variant> tags_;
    std::unordered_map<NodeId, Colors> colors_;
    bool topSorted_ = false;
    std::unordered_map<NodeId, NodeRef> unsettled_;  // by parent: the child whose text was set; no node where several were
    NodeId selected_ = noNode;

    bool followed_ = false;
    RowJournal journal_;
};

}  // namespace tessel::child
