#include "frame/child/NodeShape.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <random>
#include <string>
#include <vector>

#include "frame/Text.h"

namespace tessel::child {
namespace {

/// The same shape, by the plainest means.
class PlainShape {
  public:
    std::map<NodeId, std::vector<NodeId>> children;
    std::map<NodeId, NodeId> parent;
    std::map<NodeId, bool> expanded;

    void Rows(NodeId node, std::vector<NodeId>& rows) {
        for (const NodeId child : children[node]) {
            rows.push_back(child);
            if (expanded[child]) Rows(child, rows);
        }
    }
    void Below(NodeId node, std::vector<NodeId>& all) {
        all.push_back(node);
        for (const NodeId child : children[node]) Below(child, all);
    }
};

TEST(NodeShapeTest, AnEmptyShapeHasNeitherRowsNorChildren) {
    const NodeShape shape;
    EXPECT_EQ(shape.RowCount(), 0u);
    EXPECT_EQ(shape.ChildCount(noNode), 0u);
    EXPECT_EQ(shape.FirstChild(noNode), noNode);
    EXPECT_EQ(shape.LastChild(noNode), noNode);
}

TEST(NodeShapeTest, AfterAnyChangesItIsWhatPlainListsSay) {
    std::mt19937 numbers(17);
    const auto below = [&](std::size_t end) { return std::uniform_int_distribution<std::size_t>(0, end - 1)(numbers); };
    NodeShape shape;
    PlainShape plain;
    std::vector<NodeId> nodes, free;
    for (NodeId id = 400; id > 0; --id) free.push_back(id);

    for (int step = 0; step < 6'000; ++step) {
        const auto kind = below(10);
        if ((kind < 5 || nodes.empty()) && !free.empty()) {
            const NodeId parent = nodes.empty() || below(4) == 0 ? noNode : nodes[below(nodes.size())];
            auto& siblings = plain.children[parent];
            const auto place = below(siblings.size() + 1);
            const NodeId node = free.back();
            free.pop_back();
            siblings.insert(siblings.begin() + static_cast<std::ptrdiff_t>(place), node);
            plain.parent[node] = parent;
            plain.expanded[node] = false;
            nodes.push_back(node);
            shape.Insert(node, parent, static_cast<NodeShape::Place>(place));
        } else if (kind < 8) {
            const NodeId node = nodes[below(nodes.size())];
            plain.expanded[node] = !plain.expanded[node];
            shape.SetExpanded(node, plain.expanded[node]);
        } else if (kind == 8) {
            const NodeId parent = plain.parent[nodes[below(nodes.size())]];
            std::shuffle(plain.children[parent].begin(), plain.children[parent].end(), numbers);
            shape.SetChildren(parent, plain.children[parent]);
        } else if (below(4) == 0) {
            const NodeId node = nodes[below(nodes.size())];
            std::vector<NodeId> leaving, walked;
            plain.Below(node, leaving);
            for (NodeId each = node; each != noNode; each = shape.NextWithin(each, node)) walked.push_back(each);
            ASSERT_EQ(walked, leaving);
            std::erase(plain.children[plain.parent[node]], node);
            shape.Remove(node);
            for (const NodeId each : leaving) {
                plain.children.erase(each);
                std::erase(nodes, each);
                free.push_back(each);
            }
        } else {
            const NodeId node = nodes[below(nodes.size())];
            auto& siblings = plain.children[plain.parent[node]];
            std::erase(siblings, node);
            shape.Remove(node);
            const auto place = below(siblings.size() + 1);
            siblings.insert(siblings.begin() + static_cast<std::ptrdiff_t>(place), node);
            shape.PutBack(node, plain.parent[node], static_cast<NodeShape::Place>(place));
        }
        if (step % 10 != 0) continue;

        std::vector<NodeId> rows;
        plain.Rows(noNode, rows);
        ASSERT_EQ(shape.RowCount(), rows.size()) << step;
        for (std::size_t row = 0; row < rows.size(); ++row) {
            ASSERT_EQ(shape.AtRow(static_cast<NodeShape::Row>(row)), rows[row]) << step;
            ASSERT_EQ(shape.RowOf(rows[row]), row) << step;
        }
        for (const NodeId node : nodes) {
            ASSERT_EQ(shape.IsShown(node), std::find(rows.begin(), rows.end(), node) != rows.end());
            const auto& siblings = plain.children[plain.parent[node]];
            const auto place = static_cast<std::size_t>(std::find(siblings.begin(), siblings.end(), node) - siblings.begin());
            ASSERT_EQ(shape.PlaceOf(node), place);
            ASSERT_EQ(shape.ChildAt(plain.parent[node], static_cast<NodeShape::Place>(place)), node);
            ASSERT_EQ(shape.Next(node), place + 1 < siblings.size() ? siblings[place + 1] : noNode);
            ASSERT_EQ(shape.Previous(node), place > 0 ? siblings[place - 1] : noNode);
            ASSERT_EQ(shape.Children(node), plain.children[node]);
            ASSERT_EQ(shape.ChildCount(node), plain.children[node].size());
        }
    }
}

TEST(NodeShapeTest, AChainOf100000NodesIsWalkedWithoutRecursion) {
    NodeShape shape;
    constexpr NodeId depth = 100'000;
    for (NodeId node = 1; node <= depth; ++node) shape.Insert(node, node - 1, 0);
    EXPECT_EQ(shape.Level(depth), static_cast<int>(depth) - 1);
    EXPECT_TRUE(shape.IsWithin(depth, 1));
    EXPECT_FALSE(shape.IsShown(depth));
    NodeId last = noNode;
    for (NodeId node = 1; node != noNode; node = shape.NextWithin(node, 1)) last = node;
    EXPECT_EQ(last, depth);
    for (NodeId node = depth; node > 0; --node) shape.SetExpanded(node, true);
    EXPECT_EQ(shape.RowOf(depth), depth - 1);
    EXPECT_EQ(shape.AtRow(depth - 1), depth);
}

}  // namespace
}  // namespace tessel::child
