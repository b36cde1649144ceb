#include "frame/child/TreeView.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <random>
#include <string>
#include <utility>
#include <vector>

#include "frame/ResumeNext.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/ErrorOf.h"
#include "tests/frame/child/TreeOwner.h"

namespace tessel::child {
namespace {

using frame::ObjectRef;
using frame::Variant;
using test::ErrorOf;
using test::TreeOwner;
using Relationship = TreeRelationshipConstants;
namespace errors = frame::errors;

/// Follows a tree as a screen does, and keeps its texts.
class Follower final : public frame::Peer {
  public:
    explicit Follower(TreeView& tree) : tree_(tree) {}
    void Update() override {
        const std::vector<RowChange> changes = tree_.Tree().TakeChanges();
        for (const RowChange& change : changes) Apply(change);
        ASSERT_EQ(rows.size(), tree_.Tree().RowCount());
        for (std::size_t row = 0; row < rows.size(); ++row)
            if (rows[row] == toRead) rows[row] = Shown(tree_.Tree(), static_cast<TreeNodes::Row>(row));
        seen.insert(seen.end(), changes.begin(), changes.end());
    }
    /// What a screen shows of a row.
    static std::string Shown(const TreeNodes& nodes, TreeNodes::Row row) {
        const NodeId node = nodes.AtRow(row);
        std::string text = std::string(static_cast<std::size_t>(nodes.Level(node)), '.') + std::string(nodes.Text(node));
        if (nodes.HasChildren(node)) text += nodes.Expanded(node) ? " -" : " +";
        return text + (nodes.Selected() == node ? "*" : "");
    }
    std::vector<std::string> rows;
    std::vector<RowChange> seen;

  private:
    static constexpr const char* toRead = "(to be read)";

    void Apply(const RowChange& change) {
        const auto first = rows.begin() + change.first;
        switch (change.kind) {
            case RowChange::Kind::Inserted:
                rows.insert(first, change.count, toRead);
                break;
            case RowChange::Kind::Removed:
                rows.erase(first, first + change.count);
                break;
            case RowChange::Kind::Changed:
                std::fill(first, first + change.count, toRead);
                break;
            case RowChange::Kind::Reordered:
                std::fill(rows.begin(), rows.end(), toRead);
                break;
            case RowChange::Kind::Reset:
                rows.assign(tree_.Tree().RowCount(), toRead);
                break;
        }
    }

    TreeView& tree_;
};

class TreeViewTest : public testing::Test {
  protected:
    TreeViewTest() : owner(&host.Create<TreeOwner>("FolderView1")) {}

    TreeView& Tree() { return owner->tree; }
    TreeNodes& Held() { return Tree().Tree(); }
    TreeNodeRef Item(const Variant& indexOrKey) { return Tree().Nodes.Item(indexOrKey); }
    /// Adds nodes whose keys are their texts, under the node of a key or at the top level.
    void Add(const char* parent, std::initializer_list<const char*> texts) {
        const std::string under = parent;
        for (const char* text : texts)
            Tree().Nodes.Add(under.empty() ? std::nullopt : std::optional<Variant>(under), Relationship::Child, text, text);
    }
    /// The texts in their order, each with those below it in parentheses.
    std::string Shape(NodeId parent = noNode) {
        std::string shape;
        for (NodeId node = Held().FirstChild(parent); node != noNode; node = Held().Next(node)) {
            shape += (shape.empty() ? "" : " ") + std::string(Held().Text(node));
            if (Held().HasChildren(node)) shape += "(" + Shape(node) + ")";
        }
        return shape;
    }
    /// The texts by index.
    std::string Collection() {
        std::string texts;
        for (int index = 1; index <= Tree().Nodes.Count(); ++index) {
            EXPECT_EQ(Item(index)->Index(), index);
            texts += (index > 1 ? " " : "") + Item(index)->Text();
        }
        return texts;
    }
    std::string Rows() {
        std::string rows;
        for (TreeNodes::Row row = 0; row < Held().RowCount(); ++row) rows += (row > 0 ? " | " : "") + Follower::Shown(Held(), row);
        return rows;
    }
    static std::string TextOf(const TreeNodeRef& node) { return node ? node->Text() : "-"; }
    void AddImages(std::initializer_list<const char*> keys) {
        for (const char* key : keys) owner->Image16.ListImages.Add({}, key, std::make_shared<frame::Picture>(240.0f, 240.0f, ""));
        Tree().SetImageList(&owner->Image16);
    }

    headless::HeadlessHost host;
    TreeOwner* owner;
};

using TreeNodesTest = TreeViewTest;
using TreeFamilyTest = TreeViewTest;
using TreeSortTest = TreeViewTest;
using TreeRemovalTest = TreeViewTest;
using TreeImageTest = TreeViewTest;
using TreeRowsTest = TreeViewTest;
using TreeDoorTest = TreeViewTest;

TEST_F(TreeNodesTest, ANodeStandsWhereItsRelationshipSays) {
    Nodes& nodes = Tree().Nodes;
    nodes.Add({}, {}, "b", "b");
    nodes.Add({}, {}, "c", "c");
    nodes.Add({}, Relationship::First, "a", "a");
    nodes.Add("b", {}, {}, "b+");
    nodes.Add("b", Relationship::Next, {}, "b++");
    nodes.Add("b", Relationship::Previous, {}, "-b");
    nodes.Add("b", Relationship::Last, {}, "z");
    nodes.Add("b", Relationship::First, {}, "0");
    nodes.Add("b", Relationship::Child, {}, "b1");
    nodes.Add(Variant(1), Relationship::Child, {}, "b2");
    nodes.Add(Variant(Item("b")), Relationship::Child, "b3", "b3");
    nodes.Add("b3", Relationship::First, {}, "b0");
    EXPECT_EQ(Shape(), "0 a -b b(b0 b1 b2 b3) b++ b+ c z");
    EXPECT_EQ(Collection(), "b c a b+ b++ -b z 0 b1 b2 b3 b0");
}

TEST_F(TreeNodesTest, KeysAreUniqueWithoutRegardToCase) {
    Add("", {"Root"});
    EXPECT_EQ(ErrorOf([&] { Add("", {"ROOT"}); }), errors::keyNotUnique);
    EXPECT_EQ(ErrorOf([&] { Item("other"); }), errors::elementNotFound);
    EXPECT_EQ(Item("rOOT")->Key(), "Root");
    Tree().Nodes.Add({}, {}, "", "without");
    Tree().Nodes.Add({}, {}, {}, "without too");
    EXPECT_EQ(Tree().Nodes.Count(), 3);
    EXPECT_EQ(Item(2)->Key(), "");
    EXPECT_EQ(ErrorOf([&] { Item(""); }), errors::elementNotFound);
}

TEST_F(TreeNodesTest, AKeyMovesWithItsSettingAndARefusedOneStays) {
    Add("", {"a", "b"});
    EXPECT_TRUE(Item("a")->SetKey("B").Failed());
    EXPECT_EQ(Item(1)->Key(), "a");
    EXPECT_FALSE(Item("a")->SetKey("A").Failed());
    EXPECT_FALSE(Item("A")->SetKey("/home/a").Failed());
    EXPECT_EQ(ErrorOf([&] { Item("a"); }), errors::elementNotFound);
    EXPECT_EQ(Item("/HOME/a")->Index(), 1);
    EXPECT_EQ(Item(1)->Text(), "a");
    EXPECT_FALSE(Item(1)->SetKey("").Failed());
    EXPECT_EQ(ErrorOf([&] { Item("/home/a"); }), errors::elementNotFound);
    EXPECT_FALSE(Held().SetKey(Held().At(1), Held().Key(Held().At(1))).Failed());
    EXPECT_EQ(Item("b")->Index(), 2);
    Item(2)->SetText("another text");
    EXPECT_EQ(Item("b")->Text(), "another text");
}

TEST_F(TreeNodesTest, WhatDoesNotExistIsRefusedAndNothingIsAdded) {
    Add("", {"a"});
    EXPECT_EQ(ErrorOf([&] { Item(0); }), errors::indexOutOfBounds);
    EXPECT_EQ(ErrorOf([&] { Item(2); }), errors::indexOutOfBounds);
    EXPECT_EQ(ErrorOf([&] { Tree().Nodes.Add("x", Relationship::Child, "k", "k"); }), errors::elementNotFound);
    EXPECT_EQ(ErrorOf([&] { Tree().Nodes.Add({}, {}, "k", "k", Variant("no such image")); }), errors::elementNotFound);
    EXPECT_EQ(ErrorOf([&] { Tree().Nodes.Add({}, {}, "k", "k", {}, Variant(1)); }), errors::indexOutOfBounds);
    EXPECT_EQ(ErrorOf([&] { Tree().Nodes.Remove("x"); }), errors::elementNotFound);
    auto& other = host.Create<TreeOwner>("FolderView2");
    const TreeNodeRef stranger = other.tree.Nodes.Add({}, {}, "s", "s");
    EXPECT_EQ(ErrorOf([&] { Tree().Nodes.Add(Variant(stranger), Relationship::Child, "k", "k"); }), errors::elementNotFound);
    EXPECT_EQ(ErrorOf([&] { Tree().SetSelectedItem(stranger); }), errors::elementNotFound);
    EXPECT_EQ(Collection(), "a");
}

TEST_F(TreeFamilyTest, EachNodeKnowsItsRelatives) {
    Add("", {"r", "s"});
    Add("r", {"a", "b", "c"});
    Add("b", {"x"});
    EXPECT_EQ(TextOf(Item("b")->Parent()), "r");
    EXPECT_EQ(TextOf(Item("r")->Parent()), "-");
    EXPECT_EQ(TextOf(Item("r")->Child()), "a");
    EXPECT_EQ(TextOf(Item("x")->Child()), "-");
    EXPECT_EQ(TextOf(Item("a")->Next()), "b");
    EXPECT_EQ(TextOf(Item("c")->Next()), "-");
    EXPECT_EQ(TextOf(Item("b")->Previous()), "a");
    EXPECT_EQ(TextOf(Item("a")->Previous()), "-");
    EXPECT_EQ(TextOf(Item("b")->FirstSibling()), "a");
    EXPECT_EQ(TextOf(Item("b")->LastSibling()), "c");
    EXPECT_EQ(TextOf(Item("x")->LastSibling()), "x");
    EXPECT_EQ(TextOf(Item("x")->Root()), "r");
    EXPECT_EQ(TextOf(Item("s")->Root()), "s");
    EXPECT_EQ(Item("r")->Children(), 3);
    EXPECT_EQ(Item("x")->FullPath(), "r\\b\\x");
    Tree().SetPathSeparator("/");
    EXPECT_EQ(Item("b")->FullPath(), "r/b");
}

TEST_F(TreeFamilyTest, AChildIsFoundByItsTextAsAWalkFindsIt) {
    Add("", {"r", "s"});
    for (const char* text : {"Src", "doc", "SRC"}) Tree().Nodes.Add("r", Relationship::Child, {}, text);
    const NodeId r = Item("r")->Ref().node, s = Item("s")->Ref().node;
    EXPECT_EQ(Held().FindChild(r, "src"), Item(3)->Ref().node);
    EXPECT_EQ(Held().FindChild(s, "src"), std::nullopt);
    EXPECT_EQ(Held().FindChild(noNode, "R"), r);
    Tree().Nodes.Add(Variant(3), Relationship::First, {}, "src");
    EXPECT_EQ(Held().FindChild(r, "src"), Item(6)->Ref().node);
    Item(6)->SetText("other");
    EXPECT_EQ(Held().FindChild(r, "src"), Item(3)->Ref().node);
    EXPECT_EQ(Held().FindChild(r, "OTHER"), Item(6)->Ref().node);
    Tree().Nodes.Remove(3);
    EXPECT_EQ(Held().FindChild(r, "src"), Item(4)->Ref().node);
    Tree().Nodes.Clear();
    EXPECT_EQ(Held().FindChild(noNode, "r"), std::nullopt);
}

TEST_F(TreeSortTest, NewNodesGoWhereTheySortWhateverTheirRelationship) {
    Add("", {"r"});
    Item("r")->SetSorted(true);
    Add("r", {"m", "B", "z", "a"});
    Tree().Nodes.Add("z", Relationship::Next, {}, "b");
    Tree().Nodes.Add("z", Relationship::First, {}, "n");
    EXPECT_EQ(Shape(), "r(a B b m n z)");
    EXPECT_EQ(Collection(), "r m B z a b n");
    Tree().SetSorted(true);
    Add("", {"q"});
    EXPECT_EQ(Shape(), "q r(a B b m n z)");
}

TEST_F(TreeSortTest, SettingSortedSortsStablyAndOnlyTheChildren) {
    Add("", {"r"});
    Add("r", {"b", "a"});
    Add("b", {"y", "x"});
    Tree().Nodes.Add("r", Relationship::Child, {}, "B");
    Tree().Nodes.Add("r", Relationship::Child, {}, "A");
    Item("r")->SetSorted(true);
    EXPECT_TRUE(Item("r")->Sorted());
    EXPECT_FALSE(Item("b")->Sorted());
    EXPECT_EQ(Shape(), "r(a A b(y x) B)");
    Item("r")->SetSorted(false);
    Add("r", {"0"});
    EXPECT_EQ(Shape(), "r(a A b(y x) B 0)");
}

TEST_F(TreeSortTest, ATextMovesItsNodeWhenTheNextSiblingComes) {
    Add("", {"r"});
    Item("r")->SetSorted(true);
    Add("r", {"a", "b", "c"});
    Add("a", {"x"});
    Item("a")->SetText("d");
    EXPECT_EQ(Shape(), "r(d(x) b c)");
    Add("r", {"e"});
    EXPECT_EQ(Shape(), "r(b c d(x) e)");
    Item("b")->SetText("y");
    Item("c")->SetText("x");
    Add("r", {"f"});
    EXPECT_EQ(Shape(), "r(d(x) e f x y)");
    Item("e")->SetText("0");
    Item("r")->SetSorted(true);
    EXPECT_EQ(Shape(), "r(0 d(x) f x y)");
}

TEST_F(TreeSortTest, ANodeThatMovesStaysBehindItsEqualsWhereItStoodBehindThem) {
    Add("", {"r"});
    Item("r")->SetSorted(true);
    Add("r", {"a", "b", "c"});
    Item("c")->SetText("B");
    Add("r", {"d"});
    EXPECT_EQ(Shape(), "r(a b B d)");
    Item("a")->SetText("B!");
    Item("a")->SetText("b");
    Add("r", {"e"});
    EXPECT_EQ(Item("r")->Child()->Key(), "a");
}

TEST_F(TreeSortTest, AnUnsettledNodeThatGoesIsForgotten) {
    Add("", {"r"});
    Item("r")->SetSorted(true);
    Add("r", {"a", "b"});
    Item("a")->SetText("z");
    Tree().Nodes.Remove("a");
    Add("r", {"0"});
    EXPECT_EQ(Shape(), "r(0 b)");
    Item("b")->SetText("!");
    Tree().Nodes.Remove("r");
    Add("", {"r"});
    Add("r", {"2", "1"});
    EXPECT_EQ(Shape(), "r(2 1)");
}

TEST_F(TreeRemovalTest, ANodeGoesWithAllBelowItAndLaterIndexesFall) {
    Add("", {"r"});
    Add("r", {"a", "b"});
    Add("a", {"x", "y"});
    Add("x", {"deep"});
    Add("b", {"z"});
    const TreeNodeRef deep = Item("deep"), z = Item("z");
    Tree().Nodes.Remove("a");
    EXPECT_EQ(Shape(), "r(b(z))");
    EXPECT_EQ(Collection(), "r b z");
    EXPECT_EQ(z->Index(), 3);
    EXPECT_EQ(ErrorOf([&] { deep->Text(); }), errors::objectGone);
    EXPECT_EQ(ErrorOf([&] { deep->Next(); }), errors::objectGone);
    EXPECT_EQ(ErrorOf([&] { Item("deep"); }), errors::elementNotFound);
    EXPECT_EQ(deep->Path(), "");
    Add("b", {"a", "x", "y", "deep"});
    EXPECT_EQ(ErrorOf([&] { deep->Text(); }), errors::objectGone);
    EXPECT_EQ(Shape(), "r(b(z a x y deep))");
    EXPECT_EQ(ErrorOf([&] { Tree().SetSelectedItem(deep); }), errors::objectGone);
    EXPECT_EQ(ErrorOf([&] { Tree().Nodes.Add(Variant(deep), {}, {}, "n"); }), errors::objectGone);
}

TEST_F(TreeRemovalTest, TheSelectionGoesToTheNextSiblingThePreviousOneOrTheParent) {
    Add("", {"r"});
    Add("r", {"a", "b", "c"});
    Add("b", {"x"});
    Tree().SetSelectedItem(Item("x"));
    Tree().Nodes.Remove("b");
    EXPECT_EQ(TextOf(Tree().SelectedItem()), "c");
    Tree().Nodes.Remove("c");
    EXPECT_EQ(TextOf(Tree().SelectedItem()), "a");
    Tree().Nodes.Remove("a");
    EXPECT_EQ(TextOf(Tree().SelectedItem()), "r");
    Tree().Nodes.Remove("r");
    EXPECT_EQ(Tree().SelectedItem(), nullptr);
    EXPECT_EQ(owner->Heard(), "");
}

TEST_F(TreeRemovalTest, ClearLeavesNothingButTheSettings) {
    Tree().SetSorted(true);
    Add("", {"b", "a"});
    Add("a", {"x"});
    Item("a")->SetTag(Variant(7));
    Item("a")->SetBackColor(frame::OLE_COLOR(255));
    Item("x")->SetSelected(true);
    const TreeNodeRef a = Item("a");
    Tree().Nodes.Clear();
    EXPECT_EQ(Tree().Nodes.Count(), 0);
    EXPECT_EQ(Tree().SelectedItem(), nullptr);
    EXPECT_EQ(Held().RowCount(), 0u);
    EXPECT_EQ(ErrorOf([&] { a->Text(); }), errors::objectGone);
    Add("", {"b", "a"});
    EXPECT_EQ(Shape(), "a b");
    EXPECT_TRUE(Item("a")->Tag().IsEmpty());
    EXPECT_TRUE(Item("b")->Tag().IsEmpty());
    EXPECT_EQ(Item("b")->BackColor(), Tree().BackColor());
}

TEST_F(TreeRemovalTest, AWalkByNextFailsAtARemovedNodeAndGoesOnInResumeNextMode) {
    Add("", {"a", "b"});
    const TreeNodeRef a = Item("a");
    Tree().Nodes.Remove("a");
    frame::ResumeNext next;
    TreeNodeRef after = Item("b");
    next([&] { after = a->Next(); });
    EXPECT_TRUE(next.Failed());
    EXPECT_EQ(TextOf(after), "b");
}

TEST_F(TreeRemovalTest, ManyStepsLeaveKeysIndexesAndFamiliesTrue) {
    std::mt19937 numbers(23);
    const auto below = [&](std::size_t end) { return std::uniform_int_distribution<std::size_t>(0, end - 1)(numbers); };
    std::vector<std::string> order;
    for (int step = 0; step < 3'000; ++step) {
        if (order.empty() || below(3) > 0) {
            const std::string key = "k" + frame::Decimal(step);
            const bool isTop = order.empty() || below(20) == 0;
            const std::string parent = isTop ? "" : order[below(order.size())];
            Add(parent.c_str(), {key.c_str()});
            order.push_back(key);
        } else {
            Tree().Nodes.Remove(Variant(order[below(order.size())]));
            std::erase_if(order, [&](const std::string& key) { return !Held().FindKey(key); });
        }
        ASSERT_EQ(static_cast<std::size_t>(Tree().Nodes.Count()), order.size());
        if (step % 50 != 0) continue;
        std::size_t walked = 0;
        for (std::size_t place = 0; place < order.size(); ++place) {
            ASSERT_EQ(Item(static_cast<std::int32_t>(place + 1))->Key(), order[place]);
            ASSERT_EQ(Item(order[place])->Index(), static_cast<std::int32_t>(place + 1));
            walked += Held().ChildCount(Held().At(static_cast<TreeNodes::Position>(place)));
        }
        ASSERT_EQ(walked + Held().ChildCount(noNode), order.size());
    }
}

TEST_F(TreeImageTest, ImagesAreKeysOrIndexesOfTheList) {
    AddImages({"Folder", "OPEN_Folder", "Big"});
    const TreeNodeRef node = Tree().Nodes.Add({}, {}, "a", "a", Variant("Folder"), Variant(2));
    EXPECT_EQ(node->Image().Text(), "Folder");
    EXPECT_EQ(node->SelectedImage().ToLong(), 2);
    EXPECT_TRUE(node->ExpandedImage().IsEmpty());
    EXPECT_EQ(node->SetImage(Variant("gone")).Number(), errors::elementNotFound);
    EXPECT_EQ(node->SetSelectedImage(Variant(4)).Number(), errors::indexOutOfBounds);
    EXPECT_EQ(node->Image().Text(), "Folder");
    EXPECT_EQ(Held().SetImageKey(node->Ref().node, NodeImage::Plain, "").Number(), errors::elementNotFound);
    EXPECT_FALSE(node->SetExpandedImage(Variant("big")).Failed());
    EXPECT_FALSE(node->SetSelectedImage(Variant(0)).Failed());
    EXPECT_TRUE(node->SelectedImage().IsEmpty());
}

TEST_F(TreeImageTest, TheShownImageIsThatOfTheSelectionThenOfTheExpansion) {
    AddImages({"Folder", "OPEN_Folder", "Expanded"});
    const TreeNodeRef node = Tree().Nodes.Add({}, {}, "a", "a", Variant("Folder"), Variant("OPEN_Folder"));
    const auto shown = [&] { return Held().ShownImage(node->Ref().node).Text(); };
    EXPECT_EQ(shown(), "Folder");
    node->SetExpanded(true);
    EXPECT_EQ(shown(), "Folder");
    node->SetExpandedImage(Variant("Expanded")).Check();
    EXPECT_EQ(shown(), "Expanded");
    node->SetSelected(true);
    EXPECT_EQ(shown(), "OPEN_Folder");
    node->SetSelectedImage(Variant(0)).Check();
    EXPECT_EQ(shown(), "Expanded");
}

TEST_F(TreeImageTest, ATreeWithoutAnImageListLacksEveryKeyAndAListThatGoesIsHeldNoMore) {
    Add("", {"a"});
    EXPECT_EQ(Item("a")->SetImage(Variant("Folder")).Number(), errors::elementNotFound);
    {
        ImageList images(*owner, "Other");
        images.ListImages.Add({}, "Folder", std::make_shared<frame::Picture>(240.0f, 240.0f, ""));
        Tree().SetImageList(&images);
        EXPECT_FALSE(Item("a")->SetImage(Variant("Folder")).Failed());
    }
    EXPECT_EQ(Tree().ImageList(), nullptr);
    EXPECT_EQ(Item("a")->Image().Text(), "Folder");
    EXPECT_EQ(Item("a")->SetImage(Variant("Folder")).Number(), errors::elementNotFound);
}

TEST_F(TreeRowsTest, OnlyExpandedBranchesHaveRows) {
    Add("", {"r", "s"});
    Add("r", {"a", "b"});
    Add("a", {"x"});
    EXPECT_EQ(Rows(), "r + | s");
    Item("r")->SetExpanded(true);
    EXPECT_EQ(Rows(), "r - | .a + | .b | s");
    Item("r")->SetExpanded(false);
    Item("a")->SetExpanded(true);
    EXPECT_EQ(Rows(), "r + | s");
    Item("r")->SetExpanded(true);
    EXPECT_EQ(Rows(), "r - | .a - | ..x | .b | s");
    EXPECT_EQ(Held().RowOf(Item("b")->Ref().node), 3u);
    Item("r")->SetExpanded(false);
    EXPECT_EQ(Held().RowOf(Item("b")->Ref().node), std::nullopt);
}

TEST_F(TreeRowsTest, AFollowerAppliesFewStepsAndHoldsTheRows) {
    Add("", {"r", "s"});
    auto made = std::make_unique<Follower>(Tree());
    Follower& follower = *made;
    Tree().AttachPeer(std::move(made));
    host.Frame().Flush();
    follower.seen.clear();

    Item("r")->SetExpanded(true);
    host.Frame().Flush();
    EXPECT_EQ(std::exchange(follower.seen, {}), (std::vector<RowChange>{{RowChange::Kind::Changed, 0, 1}}));
    for (int number = 0; number < 1'000; ++number) Tree().Nodes.Add("r", Relationship::Child, {}, frame::Decimal(number));
    host.Frame().Flush();
    ASSERT_LE(follower.seen.size(), 3u);
    EXPECT_EQ(follower.rows.size(), 1'002u);
    EXPECT_EQ(follower.rows[0], "r -");
    EXPECT_EQ(follower.rows[1'000], ".999");
    follower.seen.clear();
    Item("r")->SetExpanded(false);
    host.Frame().Flush();
    EXPECT_EQ(follower.rows, (std::vector<std::string>{"r +", "s"}));
    EXPECT_EQ(std::exchange(follower.seen, {}),
              (std::vector<RowChange>{{RowChange::Kind::Removed, 1, 1'000}, {RowChange::Kind::Changed, 0, 1}}));
}

TEST_F(TreeRowsTest, WhateverHappensAFollowerHoldsTheRows) {
    std::mt19937 numbers(31);
    const auto below = [&](std::size_t end) { return std::uniform_int_distribution<std::size_t>(0, end - 1)(numbers); };
    auto made = std::make_unique<Follower>(Tree());
    Follower& follower = *made;
    Tree().AttachPeer(std::move(made));
    host.Frame().Flush();
    for (int step = 0; step < 8'000; ++step) {
        const auto any = [&] { return Held().At(static_cast<TreeNodes::Position>(below(Held().Count()))); };
        const std::string text(1, static_cast<char>('a' + below(26)));
        const auto kind = below(16);
        NodeId added = noNode;
        if (Held().Count() == 0 || (kind < 7 && Held().Count() < 60))
            Held().Add(added, text, {}, Held().Count() == 0 || below(9) == 0 ? noNode : any(), Relationship::Child).Check();
        else if (kind < 8)
            Held().Remove(any());
        else if (kind < 11)
            Held().SetExpanded(any(), below(3) > 0);
        else if (kind < 12)
            Held().SetSelected(any());
        else if (kind < 14)
            Held().SetText(any(), text);
        else
            Held().SetSorted(below(4) == 0 ? noNode : any(), below(3) > 0);
        if (below(5) != 0) continue;
        host.Frame().Flush();
        std::vector<std::string> rows;
        for (TreeNodes::Row row = 0; row < Held().RowCount(); ++row) rows.push_back(Follower::Shown(Held(), row));
        ASSERT_EQ(follower.rows, rows) << step;
        if (below(200) == 0) Held().Clear();
    }
    EXPECT_TRUE(std::any_of(follower.seen.begin(), follower.seen.end(),
                            [](const RowChange& change) { return change.kind == RowChange::Kind::Reordered; }));
}

TEST_F(TreeRowsTest, VisibleIsWhatTheHeightHoldsAndEnsureVisibleExpandsAndScrolls) {
    Tree().Move(0, 0, 3000, 4 * TreeView::rowHeightTwips);
    Add("", {"r", "s"});
    Add("r", {"a", "b", "c", "d", "e"});
    Add("e", {"x"});
    EXPECT_TRUE(Item("s")->Visible());
    EXPECT_FALSE(Item("a")->Visible());
    Item("r")->SetExpanded(true);
    EXPECT_TRUE(Item("c")->Visible());
    EXPECT_FALSE(Item("d")->Visible());
    owner->Heard();
    Item("x")->EnsureVisible();
    EXPECT_EQ(owner->Heard(), "Expand e -");
    EXPECT_EQ(TextOf(Tree().HitTest(0, 0)), "c");
    EXPECT_EQ(TextOf(Tree().HitTest(0, 4 * TreeView::rowHeightTwips - 1)), "x");
    EXPECT_FALSE(Item("r")->Visible());
    Item("b")->EnsureVisible();
    EXPECT_EQ(TextOf(Tree().HitTest(0, 0)), "b");
    Tree().SetHeight(4 * TreeView::rowHeightTwips + 1);
    EXPECT_TRUE(Item("x")->Visible());
    Tree().SetHeight(0);
    EXPECT_FALSE(Item("b")->Visible());
}

TEST_F(TreeRowsTest, HitTestFindsNodesByTheirHeight) {
    Add("", {"a", "b"});
    EXPECT_EQ(TextOf(Tree().HitTest(5000, 254)), "a");
    EXPECT_EQ(TextOf(Tree().HitTest(0, 255)), "b");
    EXPECT_EQ(Tree().HitTest(0, 510), nullptr);
    EXPECT_EQ(Tree().HitTest(0, -1), nullptr);
}

TEST_F(TreeDoorTest, NodesAreReadAndWrittenByName) {
    AddImages({"Folder"});
    auto nodes = Tree().Get("Nodes").ToObject();
    std::vector<Variant> arguments{Variant::Missing(), Variant::Missing(), "C:\\", "Local Disk (C:)", "Folder"};
    const ObjectRef root = nodes->Call("Add", arguments).ToObject();
    EXPECT_EQ(root->Path(), "FolderView1.TreeFolders.Nodes(1)");
    arguments = {Variant(root), 4, "C:\\x", "x"};
    nodes->Call("Add", arguments);
    arguments = {"c:\\X"};
    const ObjectRef child = nodes->Get("Item", arguments).ToObject();
    EXPECT_EQ(child->Get("Text").Text(), "x");
    EXPECT_TRUE(child->Get("Parent").ToObject()->EqualsObject(*root));
    EXPECT_TRUE(root->Get("Parent").ToObject().IsNothing());
    child->Put("Checked", true);
    child->Put("Tag", 12);
    EXPECT_TRUE(Item("C:\\x")->Checked());
    EXPECT_EQ(Item("C:\\x")->Tag().ToLong(), 12);
    EXPECT_EQ(ErrorOf([&] { child->Put("Image", "none"); }), errors::elementNotFound);
    EXPECT_EQ(ErrorOf([&] { child->Put("Key", "C:\\"); }), errors::keyNotUnique);
    Tree().Put("SelectedItem", Variant(child));
    EXPECT_TRUE(Item(2)->Selected());
    Tree().Put("SelectedItem", Variant(ObjectRef()));
    EXPECT_EQ(Tree().SelectedItem(), nullptr);
    Tree().Put("DropHighlight", Variant(child));
    EXPECT_EQ(TextOf(Tree().DropHighlight()), "x");
    nodes->Call("Clear");
    EXPECT_EQ(Tree().DropHighlight(), nullptr);
    EXPECT_EQ(ErrorOf([&] { child->Get("Text"); }), errors::objectGone);
}

TEST_F(TreeDoorTest, PropertiesOfTheTreeKeepWhatIsSet) {
    for (const auto& [name, value] : std::vector<std::pair<const char*, Variant>>{{"Style", std::int16_t{3}},
                                                                                  {"LineStyle", std::int16_t{0}},
                                                                                  {"LabelEdit", std::int16_t{1}},
                                                                                  {"Indentation", 300.0f},
                                                                                  {"PathSeparator", "/"},
                                                                                  {"HideSelection", false},
                                                                                  {"FullRowSelect", true},
                                                                                  {"HotTracking", true},
                                                                                  {"Scroll", false},
                                                                                  {"SingleSel", true},
                                                                                  {"Checkboxes", true},
                                                                                  {"Sorted", true},
                                                                                  {"BorderStyle", std::int16_t{1}},
                                                                                  {"Appearance", std::int16_t{0}},
                                                                                  {"MousePointer", std::int16_t{11}},
                                                                                  {"Enabled", false}}) {
        EXPECT_NE(Tree().Get(name).ToText(), value.ToText()) << name;
        Tree().Put(name, value);
        EXPECT_EQ(Tree().Get(name).ToText(), value.ToText()) << name;
    }
    EXPECT_EQ(ErrorOf([&] { Tree().SetIndentation(-1); }), errors::invalidValue);
    Tree().SetFont(nullptr);
    EXPECT_NE(Tree().Font(), nullptr);
}

TEST_F(TreeDoorTest, ANodeOfATreeThatHasGoneIsGone) {
    auto tree = std::make_unique<TreeView>(*owner, "Other");
    const TreeNodeRef node = tree->Nodes.Add({}, {}, "a", "a");
    tree.reset();
    EXPECT_EQ(ErrorOf([&] { node->Text(); }), errors::objectGone);
    EXPECT_EQ(node->Path(), "");
}

TEST_F(TreeDoorTest, MarksAndColoursOfANodeAreItsOwn) {
    Add("", {"a", "b"});
    Item("a")->SetBold(true);
    Item("a")->SetForeColor(frame::OLE_COLOR(255));
    EXPECT_TRUE(Item("a")->Bold());
    EXPECT_FALSE(Item("b")->Bold());
    EXPECT_EQ(Item("a")->ForeColor(), frame::OLE_COLOR(255));
    EXPECT_EQ(Item("a")->BackColor(), Tree().BackColor());
    EXPECT_EQ(Item("b")->ForeColor(), Tree().ForeColor());
}

}  // namespace
}  // namespace tessel::child
