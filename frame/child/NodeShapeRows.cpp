#include <utility>

#include "frame/child/NodeShape.h"

/// The rows that a screen shows of the nodes.
namespace tessel::child {

void NodeShape::SetExpanded(NodeId node, bool value) {
    if (std::exchange(links_[node].expanded, value) == value) return;
    const auto below = static_cast<int>(Rows(links_[node].children));
    CountRows(node, links_[node].parent, value ? below : -below);
}

NodeId NodeShape::AtRow(Row row) const {
    NodeId node = Top(noNode);
    while (true) {
        const Row before = Rows(links_[node].left);
        if (row < before) {
            node = links_[node].left;
            continue;
        }
        row -= before;
        if (row == 0) return node;
        if (const Row own = RowsWith(node); row < own) {
            row -= 1;
            node = links_[node].children;
        } else {
            row -= own;
            node = links_[node].right;
        }
    }
}

std::optional<NodeShape::Row> NodeShape::RowOf(NodeId node) const {
    if (!IsShown(node)) return std::nullopt;
    Row row = 0;
    while (true) {
        row += Rows(links_[node].left);
        for (NodeId up = links_[node].up; up != noNode; node = std::exchange(up, links_[up].up))
            if (links_[up].right == node) row += Rows(links_[up].left) + RowsWith(up);
        node = links_[node].parent;
        if (node == noNode) return row;
        ++row;  // the parent's own
    }
}

bool NodeShape::IsShown(NodeId node) const {
    for (node = links_[node].parent; node != noNode; node = links_[node].parent)
        if (!links_[node].expanded) return false;
    return true;
}

/// Rows have come or gone below `parent`: in its sibling tree from `sibling` up, and wherever they are seen above.
void NodeShape::CountRows(NodeId sibling, NodeId parent, int change) {
    while (true) {
        for (; sibling != noNode; sibling = links_[sibling].up) links_[sibling].rows += static_cast<Row>(change);
        if (parent == noNode || !links_[parent].expanded) return;
        sibling = std::exchange(parent, links_[parent].parent);
    }
}

}  // namespace tessel::child
