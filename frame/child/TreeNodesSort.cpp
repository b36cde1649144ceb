#include <algorithm>

#include "frame/Text.h"
#include "frame/child/TreeNodes.h"

/// The order of sorted siblings.
namespace tessel::child {

bool TreeNodes::Sorted(NodeId parent) const { return parent == noNode ? topSorted_ : Has(parent, sorted); }

void TreeNodes::SetSorted(NodeId parent, bool value) {
    unsettled_.erase(parent);
    if (value) SortChildren(parent);
    if (parent == noNode)
        topSorted_ = value;
    else if (Sorted(parent) != value)
        nodes_[parent].flags ^= sorted;
    changed_();
}

void TreeNodes::SortChildren(NodeId parent) {
    const std::vector<NodeId> before = shape_.Children(parent);
    std::vector<NodeId> after = before;
    std::stable_sort(after.begin(), after.end(), [this](NodeId a, NodeId b) { return frame::CompareNoCase(Text(a), Text(b)) < 0; });
    if (after == before) return;
    shape_.SetChildren(parent, after);
    const bool hasRows = parent == noNode || (Expanded(parent) && shape_.IsShown(parent));
    if (hasRows && Journals()) journal_.Reordered(RowCount());
}

void TreeNodes::Unsettle(NodeId node) {
    const NodeId parent = Parent(node);
    if (!Sorted(parent)) return;
    const NodeRef ref = Ref(node);
    const auto [known, isFirst] = unsettled_.emplace(parent, ref);
    if (!isFirst && known->second != ref) known->second = NodeRef();
}

/// Brings the children whose texts were set to where they belong: one alone by itself, several by sorting all.
void TreeNodes::Settle(NodeId parent) {
    const auto known = unsettled_.find(parent);
    if (known == unsettled_.end()) return;
    const NodeRef moving = known->second;
    unsettled_.erase(known);
    if (moving == NodeRef()) return SortChildren(parent);
    if (!Lives(moving)) return;

    const NodeId node = moving.node;
    const auto from = RowOf(node);
    const NodeShape::Row rows = shape_.RowsWith(node);
    const NodeShape::Place stay = shape_.PlaceOf(node);
    shape_.Remove(node);
    const NodeShape::Place place = SortedPlace(parent, Text(node), stay);
    shape_.PutBack(node, parent, place);
    if (place == stay || !from || !Journals()) return;
    journal_.Removed(*from, rows);
    journal_.Inserted(*RowOf(node), rows);
}

/// Where a child with this text belongs, when without a reason it would stay at a place. The last place is tried first: folders
/// come in order.
NodeShape::Place TreeNodes::SortedPlace(NodeId parent, std::string_view text, NodeShape::Place stay) const {
    const auto standsBefore = [&](NodeId child, NodeShape::Place place) {
        const int order = frame::CompareNoCase(Text(child), text);
        return order < 0 || (order == 0 && place < stay);
    };
    const NodeShape::Place count = ChildCount(parent);
    if (count == 0 || standsBefore(LastChild(parent), count - 1)) return count;
    return shape_.CountBefore(parent, standsBefore);
}

}  // namespace tessel::child
