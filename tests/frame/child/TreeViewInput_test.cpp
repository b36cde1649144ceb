#include <gtest/gtest.h>

#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "frame/child/TreeView.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/ErrorOf.h"
#include "tests/frame/child/TreeOwner.h"

namespace tessel::child {
namespace {

using frame::Variant;
using test::ErrorOf;
using test::TreeOwner;
using Relationship = TreeRelationshipConstants;
namespace errors = frame::errors;

class TreeInputTest : public testing::Test {
  protected:
    TreeInputTest() : owner(&host.Create<TreeOwner>("FolderView1")) {
        for (const char* text : {"r", "s"}) Tree().Nodes.Add({}, {}, text, text);
        for (const char* text : {"a", "b"}) Tree().Nodes.Add("r", Relationship::Child, text, text);
        Tree().Nodes.Add("a", Relationship::Child, "x", "x");
    }

    TreeView& Tree() { return owner->tree; }
    TreeNodeRef Item(const Variant& indexOrKey) { return Tree().Nodes.Item(indexOrKey); }
    std::vector<Variant> Fire(const char* event, std::vector<Variant> arguments) {
        Tree().Table().FindInput(event)->call(Tree(), arguments);
        return arguments;
    }
    std::string Error() {
        std::string text;
        for (const auto& report : std::exchange(host.errors.reports, {}))
            text += report.where + " " + frame::Decimal(report.error.Number());
        return text;
    }
    std::string Selected() { return Tree().SelectedItem() ? Tree().SelectedItem()->Text() : "-"; }

    headless::HeadlessHost host;
    TreeOwner* owner;
};

using TreeClickTest = TreeInputTest;
using TreeExpansionTest = TreeInputTest;
using TreeEditTest = TreeInputTest;
using TreeScreenTest = TreeInputTest;

TEST_F(TreeClickTest, AClickSelectsBeforeItsEventAndComesAgainForTheSameNode) {
    Fire("NodeClick", {2});
    EXPECT_EQ(owner->Heard(), "NodeClick s*");
    Fire("NodeClick", {2});
    EXPECT_EQ(owner->Heard(), "NodeClick s*");
    EXPECT_EQ(Selected(), "s");
}

TEST_F(TreeClickTest, TheKeyboardClicksWhatWasNotSelected) {
    Tree().SelectInput(2);
    EXPECT_EQ(owner->Heard(), "NodeClick s*");
    Tree().SelectInput(2);
    EXPECT_EQ(owner->Heard(), "");
}

TEST_F(TreeClickTest, TheProgramSelectsWithoutAnEventAndWithoutExpanding) {
    Tree().SetSelectedItem(Item("x"));
    EXPECT_TRUE(Item("x")->Selected());
    EXPECT_FALSE(Item("r")->Expanded());
    Item("b")->SetSelected(false);
    EXPECT_EQ(Selected(), "x");
    Item("x")->SetSelected(false);
    EXPECT_EQ(Selected(), "-");
    EXPECT_EQ(owner->Heard(), "");
}

TEST_F(TreeClickTest, AnIndexOutsideIsReported) {
    Fire("NodeClick", {6});
    EXPECT_EQ(Error(), "FolderView1.TreeFolders.NodeClick 35600");
    Fire("Expand", {0});
    EXPECT_EQ(Error(), "FolderView1.TreeFolders.Expand 35600");
    EXPECT_EQ(owner->Heard(), "");
}

TEST_F(TreeClickTest, AHandlerMayRemoveTheNodeThatWasClicked) {
    owner->atClick = [&](const TreeNodeRef& node) {
        Tree().Nodes.Remove(Variant(node));
        EXPECT_EQ(ErrorOf([&] { node->Text(); }), errors::objectGone);
    };
    Fire("NodeClick", {1});
    EXPECT_EQ(Tree().Nodes.Count(), 1);
    EXPECT_EQ(Selected(), "s");
    EXPECT_EQ(Error(), "");
}

TEST_F(TreeClickTest, ACheckTurnsTheMarkRound) {
    Fire("NodeCheck", {2});
    Fire("NodeCheck", {2});
    Item("s")->SetChecked(true);
    EXPECT_EQ(owner->Heard(), "NodeCheck s on | NodeCheck s off");
}

TEST_F(TreeClickTest, RawInputAndDragsAreThoseOfEveryChild) {
    Fire("MouseDown", {std::int16_t{1}, std::int16_t{0}, 10.0f, 300.0f});
    Fire("KeyUp", {std::int16_t{113}, std::int16_t{0}});
    const auto given = Fire("OLEStartDrag", {Variant(std::make_shared<frame::DragData>()), 0});
    EXPECT_EQ(owner->Heard(), "MouseDown 1 300 | KeyUp 113 | OLEStartDrag");
    EXPECT_EQ(given[1].ToLong(), 3);
    EXPECT_EQ(Selected(), "-");
}

TEST_F(TreeExpansionTest, TheEventComesAfterTheExpansionForProgramAndUser) {
    Item("r")->SetExpanded(true);
    Item("r")->SetExpanded(true);
    EXPECT_EQ(owner->Heard(), "Expand r -");
    Item("r")->SetExpanded(false);
    EXPECT_EQ(owner->Heard(), "Collapse r +");
    Fire("Expand", {1});
    Fire("Expand", {1});
    Fire("Collapse", {1});
    EXPECT_EQ(owner->Heard(), "Expand r - | Expand r - | Collapse r +");
}

TEST_F(TreeExpansionTest, ANodeThatIsFilledAsItExpandsShowsItsChildrenAtOnce) {
    owner->atExpand = [&](const TreeNodeRef& node) { Tree().Nodes.Add(Variant(node), Relationship::Child, {}, "new"); };
    Item("s")->SetExpanded(true);
    EXPECT_EQ(Tree().Tree().RowCount(), 3u);
    EXPECT_EQ(Item("s")->Children(), 1);
}

TEST_F(TreeExpansionTest, CollapsingLeavesTheSelectionInside) {
    Item("r")->SetExpanded(true);
    Tree().NodeClickInput(3);
    Item("r")->SetExpanded(false);
    EXPECT_EQ(Selected(), "a");
}

TEST_F(TreeExpansionTest, EnsureVisibleSurvivesAHandlerThatRemovesTheNode) {
    owner->atExpand = [&](const TreeNodeRef& node) {
        if (node->Key() == "r") Tree().Nodes.Remove("a");
    };
    Item("x")->EnsureVisible();
    EXPECT_EQ(owner->Heard(), "Expand r -");
    EXPECT_EQ(Tree().Nodes.Count(), 3);
}

TEST_F(TreeEditTest, AnEditIsOpenFromItsBeginningToItsEnd) {
    Tree().StartLabelEdit();
    EXPECT_EQ(owner->Heard(), "");
    Tree().SetSelectedItem(Item("s"));
    Tree().StartLabelEdit();
    EXPECT_TRUE(Tree().Editing());
    EXPECT_EQ(Tree().EditedNode(), Item("s")->Ref().node);
    Tree().StartLabelEdit();
    Tree().EndEditInput("new");
    EXPECT_FALSE(Tree().Editing());
    EXPECT_EQ(owner->Heard(), "BeforeLabelEdit | AfterLabelEdit new");
    EXPECT_EQ(Item("s")->Text(), "new");
}

TEST_F(TreeEditTest, ItsNodeIsMadeVisibleOnceTheEditIsAllowed) {
    Tree().Move(0, 0, 3000, 2000);
    Tree().SetSelectedItem(Item("x"));
    owner->atEditBegin = [](bool& cancel) { cancel = true; };
    Tree().StartLabelEdit();
    EXPECT_FALSE(Item("x")->Visible());
    owner->atEditBegin = nullptr;
    Tree().StartLabelEdit();
    EXPECT_TRUE(Item("x")->Visible());
    EXPECT_EQ(owner->Heard(), "BeforeLabelEdit | BeforeLabelEdit | Expand r - | Expand a -");
}

TEST_F(TreeEditTest, TheHandlersMayRefuseOrChangeTheText) {
    Tree().SetSelectedItem(Item("s"));
    owner->atEditEnd = [](bool&, std::string& newString) { newString += "!"; };
    EXPECT_EQ(Fire("LabelEdit", {"new"})[0].Text(), "new!");
    owner->atEditEnd = [](bool& cancel, std::string&) { cancel = true; };
    EXPECT_EQ(Fire("LabelEdit", {"other"})[0].Text(), "new!");
    EXPECT_EQ(Item("s")->Text(), "new!");
    owner->atEditBegin = [](bool& cancel) { cancel = true; };
    owner->Heard();
    EXPECT_EQ(Fire("LabelEdit", {"other"})[0].Text(), "new!");
    EXPECT_EQ(owner->Heard(), "BeforeLabelEdit");
}

TEST_F(TreeEditTest, AnEditThatIsGivenUpChangesNothing) {
    Tree().SetSelectedItem(Item("s"));
    Tree().StartLabelEdit();
    Tree().GiveUpEditInput();
    Tree().EndEditInput("late");
    EXPECT_EQ(owner->Heard(), "BeforeLabelEdit | LabelEditGivenUp");
    EXPECT_EQ(Item("s")->Text(), "s");
}

TEST_F(TreeEditTest, AnEditEndsWithItsNode) {
    Tree().SetSelectedItem(Item("s"));
    Tree().StartLabelEdit();
    Tree().Nodes.Remove("s");
    EXPECT_FALSE(Tree().Editing());
    Tree().EndEditInput("late");
    EXPECT_EQ(owner->Heard(), "BeforeLabelEdit");
}

TEST_F(TreeEditTest, AClickOpensAnEditOnlyWhereTheTreeAllowsIt) {
    Tree().SetLabelEdit(TreeLabelEditConstants::Manual);
    Tree().EditInput(2);
    EXPECT_FALSE(Tree().Editing());
    Tree().SetLabelEdit(TreeLabelEditConstants::Automatic);
    Tree().EditInput(2);
    EXPECT_TRUE(Tree().Editing());
    EXPECT_EQ(Selected(), "s");
}

TEST_F(TreeEditTest, TheHalvesOfAnEditStandByThemselves) {
    EXPECT_FALSE(Fire("BeforeLabelEdit", {false})[0].ToBoolean());
    Tree().SetSelectedItem(Item("s"));
    owner->atEditBegin = [](bool& cancel) { cancel = true; };
    EXPECT_TRUE(Fire("BeforeLabelEdit", {false})[0].ToBoolean());
    Fire("AfterLabelEdit", {false, "by itself"});
    EXPECT_EQ(Item("s")->Text(), "by itself");
}

/// A screen of two rows of 100 twips.
class Window final : public TreeViewPeer, public TreeScreen {
  public:
    explicit Window(TreeView& tree) : tree_(tree) {}

    void Update() override {
        tree_.Tree().TakeChanges();
        rows = tree_.Tree().RowCount();
    }
    TreeScreen* Screen() override { return shown ? this : nullptr; }
    void EditBegan(NodeId node) override { asked += "EditBegan " + std::string(tree_.Tree().Text(node)) + ";"; }
    std::optional<Row> RowAt(float x, float y) override {
        EXPECT_EQ(rows, tree_.Tree().RowCount()) << "asked before it was told";
        return x < 1000 ? std::optional(static_cast<Row>(y / 100) + top) : std::nullopt;
    }
    RowsInView InView() override { return {top, 2}; }
    void MakeVisible(Row row) override {
        EXPECT_EQ(rows, tree_.Tree().RowCount()) << "asked before it was told";
        top = row;
    }

    Row rows = 0, top = 0;
    bool shown = true;
    std::string asked;

  private:
    TreeView& tree_;
};

TEST_F(TreeScreenTest, AScreenAnswersOnceItWasToldOfEveryChange) {
    auto made = std::make_unique<Window>(Tree());
    Window& window = *made;
    Tree().AttachPeer(std::move(made));
    Item("r")->SetExpanded(true);
    EXPECT_EQ(Tree().HitTest(0, 150)->Text(), "a");
    EXPECT_EQ(Tree().HitTest(1000, 150), nullptr);
    EXPECT_EQ(Tree().HitTest(0, 900), nullptr);
    EXPECT_TRUE(Item("a")->Visible());
    EXPECT_FALSE(Item("b")->Visible());
    Item("x")->EnsureVisible();
    EXPECT_EQ(window.top, 2u);
    EXPECT_FALSE(Item("a")->Visible());
    Tree().SetSelectedItem(Item("b"));
    Tree().StartLabelEdit();
    EXPECT_EQ(window.asked, "EditBegan b;");
}

TEST_F(TreeScreenTest, WithoutAScreenThePeersScrollingIsKept) {
    auto made = std::make_unique<Window>(Tree());
    made->shown = false;
    Tree().AttachPeer(std::move(made));
    Tree().ScrollInput(2);
    EXPECT_EQ(Tree().HitTest(0, 0)->Text(), "s");
    Tree().ScrollInput(3);
    EXPECT_EQ(Tree().HitTest(0, 0)->Text(), "s");
}

TEST_F(TreeScreenTest, TheHeadlessHostTellsOfAnEditThatOpens) {
    Tree().SetSelectedItem(Item("s"));
    host.log.Take();
    Tree().StartLabelEdit();
    ASSERT_EQ(host.log.Of("edit").size(), 1u);
    EXPECT_EQ(host.log.Of("edit")[0][1].ToText(), "FolderView1.TreeFolders");
}

}  // namespace
}  // namespace tessel::child
