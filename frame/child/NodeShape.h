#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <vector>

#include "frame/child/RowPages.h"

namespace tessel::child {

/// A node by its number in the tree's storage. A number is used again once its node has gone.
using NodeId = RowId;
/// No node: what stands above the nodes of the top level.
inline constexpr NodeId noNode = 0;

/// Who stands under whom, in which order, and which rows a screen shows of it: a node whose ancestors are all expanded has a row,
/// from 0. Places among siblings count from 0 too. `parent` may be `noNode`, which stands for the top level and is always expanded.
///
/// The children of a node are a balanced tree of their own, in which each knows how many siblings and how many rows are below it:
/// all questions and changes cost the logarithm of the number of siblings, those of rows once for each level. Its balance comes
/// from the numbers of the nodes. 32 bytes a node.
class NodeShape {
  public:
    using Row = std::uint32_t;
    using Place = std::uint32_t;

    /// `node` is not in the tree yet; `place` from 0 to the number of children.
    void Insert(NodeId node, NodeId parent, Place place);
    /// Takes a node out with all that is below it.
    void Remove(NodeId node);
    /// Brings a node back that was taken out, with what is still below it.
    void PutBack(NodeId node, NodeId parent, Place place);
    void Clear();

    NodeId Parent(NodeId node) const { return links_[node].parent; }
    Place ChildCount(NodeId parent) const { return Siblings(Top(parent)); }
    /// `noNode` where there is none.
    NodeId FirstChild(NodeId parent) const;
    NodeId LastChild(NodeId parent) const;
    NodeId Next(NodeId node) const;
    NodeId Previous(NodeId node) const;
    NodeId ChildAt(NodeId parent, Place place) const;
    Place PlaceOf(NodeId node) const;
    /// How many children come first for which `standsBefore(child, place)` is true; it is false for all behind them.
    template <class F>
    Place CountBefore(NodeId parent, F&& standsBefore) const {
        Place count = 0;
        for (NodeId node = Top(parent); node != noNode;) {
            const Place place = count + Siblings(links_[node].left);
            const bool goesOn = standsBefore(node, place);
            if (goesOn) count = place + 1;
            node = goesOn ? links_[node].right : links_[node].left;
        }
        return count;
    }
    bool IsWithin(NodeId node, NodeId ancestor) const;
    /// How many ancestors a node has.
    int Level(NodeId node) const;
    /// The node behind this one when a node comes before its children, among those below `top` and itself.
    NodeId NextWithin(NodeId node, NodeId top) const;

    std::vector<NodeId> Children(NodeId parent) const;
    /// The same children in another order.
    void SetChildren(NodeId parent, std::span<const NodeId> children);

    bool Expanded(NodeId node) const { return node == noNode || links_[node].expanded; }
    void SetExpanded(NodeId node, bool value);

    Row RowCount() const { return Rows(Top(noNode)); }
    NodeId AtRow(Row row) const;
    /// Nothing for a node that stands in a branch which is not expanded.
    std::optional<Row> RowOf(NodeId node) const;
    /// Whether the node has a row.
    bool IsShown(NodeId node) const;
    /// The rows of a node that has one, its own and those below it.
    Row RowsWith(NodeId node) const { return 1 + (links_[node].expanded ? Rows(links_[node].children) : 0); }

  private:
    struct Links {
        NodeId parent = noNode;
        NodeId children = noNode;                           // the top of their balanced tree
        NodeId up = noNode, left = noNode, right = noNode;  // in that of its siblings
        Place siblings = 0;                                 // there, at and below it
        Row rows = 0;                                       // of those
        bool expanded = false;
    };

    Place Siblings(NodeId node) const { return node == noNode ? 0 : links_[node].siblings; }
    Row Rows(NodeId node) const { return node == noNode ? 0 : links_[node].rows; }
    NodeId Top(NodeId parent) const { return links_.Size() == 0 ? noNode : links_[parent].children; }
    NodeId Leftmost(NodeId node) const;
    NodeId Rightmost(NodeId node) const;
    NodeId& LinkTo(NodeId node);
    void SumUp(NodeId node);
    void RotateUp(NodeId node);
    void CountSibling(NodeId node, int change);
    void CountRows(NodeId sibling, NodeId parent, int change);
    static bool StandsAbove(NodeId a, NodeId b);

    RowPages<Links> links_;
};

}  // namespace tessel::child
