#include "frame/child/NodeShape.h"

#include <cassert>
#include <utility>

namespace tessel::child {

void NodeShape::Insert(NodeId node, NodeId parent, Place place) {
    links_.MakeRoom(node);
    links_[node] = Links();
    PutBack(node, parent, place);
}

void NodeShape::Remove(NodeId node) {
    // Down to where it has one neighbour at most below it, which then takes its place.
    while (links_[node].left != noNode && links_[node].right != noNode)
        RotateUp(StandsAbove(links_[node].left, links_[node].right) ? links_[node].left : links_[node].right);
    const NodeId below = links_[node].left != noNode ? links_[node].left : links_[node].right;
    const NodeId up = links_[node].up;
    LinkTo(node) = below;
    if (below != noNode) links_[below].up = up;
    CountSibling(up, -1);
    CountRows(up, links_[node].parent, -static_cast<int>(RowsWith(node)));
    links_[node].parent = links_[node].up = links_[node].left = links_[node].right = noNode;
}

void NodeShape::PutBack(NodeId node, NodeId parent, Place place) {
    links_[node].parent = parent;
    SumUp(node);
    assert(place <= ChildCount(parent));
    NodeId* link = &links_[parent].children;
    NodeId up = noNode;
    while (*link != noNode) {
        up = *link;
        const Place before = Siblings(links_[up].left);
        if (place <= before) {
            link = &links_[up].left;
        } else {
            place -= before + 1;
            link = &links_[up].right;
        }
    }
    *link = node;
    links_[node].up = up;
    CountSibling(up, 1);
    CountRows(up, parent, static_cast<int>(RowsWith(node)));
    while (links_[node].up != noNode && StandsAbove(node, links_[node].up)) RotateUp(node);
}

void NodeShape::Clear() { links_.Clear(); }

NodeId NodeShape::FirstChild(NodeId parent) const { return Leftmost(Top(parent)); }
NodeId NodeShape::LastChild(NodeId parent) const { return Rightmost(Top(parent)); }

NodeId NodeShape::Next(NodeId node) const {
    if (links_[node].right != noNode) return Leftmost(links_[node].right);
    NodeId up = links_[node].up;
    while (up != noNode && links_[up].right == node) node = std::exchange(up, links_[up].up);
    return up;
}

NodeId NodeShape::Previous(NodeId node) const {
    if (links_[node].left != noNode) return Rightmost(links_[node].left);
    NodeId up = links_[node].up;
    while (up != noNode && links_[up].left == node) node = std::exchange(up, links_[up].up);
    return up;
}

NodeId NodeShape::ChildAt(NodeId parent, Place place) const {
    NodeId node = Top(parent);
    while (true) {
        const Place before = Siblings(links_[node].left);
        if (place == before) return node;
        node = place < before ? links_[node].left : links_[node].right;
        if (place > before) place -= before + 1;
    }
}

NodeShape::Place NodeShape::PlaceOf(NodeId node) const {
    Place place = Siblings(links_[node].left);
    for (NodeId up = links_[node].up; up != noNode; node = std::exchange(up, links_[up].up))
        if (links_[up].right == node) place += Siblings(links_[up].left) + 1;
    return place;
}

bool NodeShape::IsWithin(NodeId node, NodeId ancestor) const {
    while (node != noNode && node != ancestor) node = links_[node].parent;
    return node == ancestor;
}

int NodeShape::Level(NodeId node) const {
    int level = 0;
    while ((node = links_[node].parent) != noNode) ++level;
    return level;
}

NodeId NodeShape::NextWithin(NodeId node, NodeId top) const {
    if (const NodeId child = FirstChild(node); child != noNode) return child;
    for (; node != top; node = links_[node].parent)
        if (const NodeId next = Next(node); next != noNode) return next;
    return noNode;
}

std::vector<NodeId> NodeShape::Children(NodeId parent) const {
    std::vector<NodeId> children;
    children.reserve(ChildCount(parent));
    for (NodeId child = FirstChild(parent); child != noNode; child = Next(child)) children.push_back(child);
    return children;
}

void NodeShape::SetChildren(NodeId parent, std::span<const NodeId> children) {
    // The right edge of what is built so far; who leaves it has its neighbours below it and can be summed.
    std::vector<NodeId> edge;
    for (const NodeId node : children) {
        NodeId below = noNode;
        while (!edge.empty() && StandsAbove(node, edge.back())) {
            below = edge.back();
            SumUp(below);
            edge.pop_back();
        }
        links_[node].left = below;
        links_[node].right = noNode;
        links_[node].up = edge.empty() ? noNode : edge.back();
        if (below != noNode) links_[below].up = node;
        if (!edge.empty()) links_[edge.back()].right = node;
        edge.push_back(node);
    }
    links_[parent].children = edge.empty() ? noNode : edge.front();
    for (; !edge.empty(); edge.pop_back()) SumUp(edge.back());
}

NodeId NodeShape::Leftmost(NodeId node) const {
    while (node != noNode && links_[node].left != noNode) node = links_[node].left;
    return node;
}

NodeId NodeShape::Rightmost(NodeId node) const {
    while (node != noNode && links_[node].right != noNode) node = links_[node].right;
    return node;
}

/// Where the node hangs.
NodeId& NodeShape::LinkTo(NodeId node) {
    const NodeId up = links_[node].up;
    if (up == noNode) return links_[links_[node].parent].children;
    return links_[up].left == node ? links_[up].left : links_[up].right;
}

void NodeShape::SumUp(NodeId node) {
    Links& links = links_[node];
    links.siblings = Siblings(links.left) + 1 + Siblings(links.right);
    links.rows = Rows(links.left) + RowsWith(node) + Rows(links.right);
}

/// Changes place with the one above it; the order stays.
void NodeShape::RotateUp(NodeId node) {
    const NodeId up = links_[node].up;
    LinkTo(up) = node;
    links_[node].up = links_[up].up;
    NodeId& inner = links_[up].left == node ? links_[node].right : links_[node].left;
    NodeId& outer = links_[up].left == node ? links_[up].left : links_[up].right;
    outer = inner;
    if (inner != noNode) links_[inner].up = up;
    inner = up;
    links_[up].up = node;
    SumUp(up);
    SumUp(node);
}

void NodeShape::CountSibling(NodeId node, int change) {
    for (; node != noNode; node = links_[node].up) links_[node].siblings += static_cast<Place>(change);
}

/// A balance that is as good as one by chance: the numbers of the nodes, well mixed.
bool NodeShape::StandsAbove(NodeId a, NodeId b) {
    const auto mix = [](std::uint32_t number) {
        number = (number ^ number >> 16) * 0x7FEB352Du;
        number = (number ^ number >> 15) * 0x846CA68Bu;
        return number ^ number >> 16;
    };
    return mix(a) > mix(b);
}

}  // namespace tessel::child
