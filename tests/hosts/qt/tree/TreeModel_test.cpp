#include "hosts/qt/TreeModel.h"

#include <gtest/gtest.h>

#include <QAbstractItemModelTester>
#include <QPersistentModelIndex>
#include <QSignalSpy>
#include <random>
#include <string>

#include "frame/Text.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/frame/child/TreeOwner.h"

namespace tessel::qt {
namespace {

using child::NodeId;
using child::noNode;

/// A tree that a model follows, without a screen.
struct Followed {
    Followed() {
        struct Watching final : frame::Peer {
            void Update() override {}
        };
        tree.AttachPeer(std::make_unique<Watching>());
        Follow();
    }
    void Follow() { model.Follow(tree.Tree().TakeChanges()); }
    NodeId Add(const std::string& text, NodeId parent = noNode) {
        NodeId node = noNode;
        tree.Tree().Add(node, text, {}, parent, child::TreeRelationshipConstants::Child).Check();
        return node;
    }
    std::string Shown() const {
        std::string texts;
        for (int row = 0; row < model.rowCount(); ++row)
            texts += (row > 0 ? " " : "") + model.index(row, 0).data().toString().toStdString();
        return texts;
    }
    /// The texts of the rows by the tree itself.
    std::string Held() const {
        std::string texts;
        const child::TreeNodes& nodes = tree.Tree();
        for (child::TreeNodes::Row row = 0; row < nodes.RowCount(); ++row)
            texts += (row > 0 ? " " : "") + std::string(nodes.Text(nodes.AtRow(row)));
        return texts;
    }

    headless::HeadlessHost host;
    test::TreeOwner owner{host};
    child::TreeView& tree = owner.tree;
    TreeModel model{tree};
};

TEST(TreeModel, RowsAreTheNodesWhoseAncestorsAreExpanded) {
    Followed followed;
    const NodeId a = followed.Add("a");
    followed.Add("a1", a);
    followed.Add("b");
    followed.Follow();
    EXPECT_EQ(followed.Shown(), "a b");
    followed.tree.Tree().SetExpanded(a, true);
    EXPECT_EQ(followed.model.rowCount(), 2);  // until it follows
    followed.Follow();
    EXPECT_EQ(followed.Shown(), "a a1 b");
}

TEST(TreeModel, FiftyThousandNewRowsAreToldOnce) {
    Followed followed;
    const NodeId a = followed.Add("a");
    followed.Follow();
    QSignalSpy inserted(&followed.model, &QAbstractItemModel::rowsInserted);
    for (int child = 0; child < 50'000; ++child) followed.Add("x", a);
    followed.Follow();
    EXPECT_EQ(inserted.size(), 0);
    followed.tree.Tree().SetExpanded(a, true);
    followed.Follow();
    EXPECT_EQ(inserted.size(), 1);
    EXPECT_EQ(followed.model.rowCount(), 50'001);
}

TEST(TreeModel, APersistentIndexStaysWithItsNodeUntilThatLosesItsRow) {
    Followed followed;
    const NodeId a = followed.Add("a"), b = followed.Add("b"), b1 = followed.Add("b1", b);
    followed.tree.Tree().SetExpanded(b, true);
    followed.Add("a1", a);
    followed.Follow();
    const QPersistentModelIndex index(followed.model.index(2, 0));
    ASSERT_EQ(index.data().toString(), "b1");
    followed.tree.Tree().SetExpanded(a, true);
    followed.Follow();
    EXPECT_EQ(index.row(), 3);
    EXPECT_EQ(index.data().toString(), "b1");
    EXPECT_EQ(followed.model.PositionOf(followed.model.KeyOf(b1)), 3u);
    followed.tree.Tree().SetExpanded(b, false);
    followed.Follow();
    EXPECT_FALSE(index.isValid());
    EXPECT_FALSE(followed.model.PositionOf(followed.model.KeyOf(b1)));
}

TEST(TreeModel, AnyChangesLeaveTheModelRight) {
    Followed followed;
    const QAbstractItemModelTester tester(&followed.model, QAbstractItemModelTester::FailureReportingMode::Fatal);
    std::mt19937 numbers(7);  // NOLINT: the same on every run
    child::TreeNodes& nodes = followed.tree.Tree();
    const auto any = [&](std::size_t below) { return static_cast<std::uint32_t>(numbers() % below); };
    for (int round = 0; round < 600; ++round) {
        for (std::uint32_t steps = any(4); steps > 0; --steps) {
            const NodeId node = nodes.Count() > 0 ? nodes.At(any(nodes.Count())) : noNode;
            const auto what = any(10);
            if (node == noNode || what < 5)
                followed.Add(frame::Decimal(any(1000)), what < 3 ? node : noNode);
            else if (what < 8)
                nodes.SetExpanded(node, !nodes.Expanded(node));
            else if (what < 9)
                nodes.Remove(node);
            else
                nodes.SetSorted(any(2) == 0 ? noNode : node, true);
        }
        followed.Follow();
        ASSERT_EQ(followed.Shown(), followed.Held()) << round;
    }
}

TEST(TreeModel, AModelWithoutItsTreeIsEmpty) {
    Followed followed;
    followed.Add("a");
    followed.Follow();
    followed.model.Disconnect();
    EXPECT_EQ(followed.model.rowCount(), 0);
    EXPECT_FALSE(followed.model.index(0, 0).isValid());
}

}  // namespace
}  // namespace tessel::qt
