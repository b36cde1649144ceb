#include "controls/folderview/FolderView.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "tests/ErrorOf.h"
#include "tests/HostUnderTest.h"
#include "tests/controls/folderview/FolderViewTestHelp.h"

/// The main ways through the tree of folders, as a user and an application go them.
namespace tessel::controls {
namespace {

using child::NodeId;
using child::noNode;

constexpr float width = 3000, height = 2550;  // twips: ten rows

/// A host with one tree on a memory disk, of which a test sees each event with its arguments.
class FolderViewTest : public testing::Test {
  protected:
    FolderView& Make(const std::string& root = {}, bool designTime = false) {
        headless::Placing placing{.designTime = designTime, .width = width, .height = height};
        placing.onEvent = [this](const std::string&, const frame::EventInfo& event, frame::EventArguments arguments) {
            std::string line(event.name);
            for (std::size_t i = 0; i < arguments.size(); ++i) {
                const frame::Variant value = arguments[i].Get();
                const bool isNode = value.Type() == frame::VarType::Object;
                line += (i == 0 ? "(" : ", ") + (isNode ? value.ToObject()->Get("Key").ToText() : value.ToText());
            }
            events.push_back(line + (arguments.empty() ? "" : ")"));
        };
        auto& made = host.Create<FolderView>("FolderView1", placing);
        view = &made;
        if (!root.empty()) made.SetPathRoot(root);
        Events();
        return made;
    }
    void Folder(const std::string& path, std::int32_t attributes = 0) {
        host.files.SetFolder(path, {.attributes = attributes}).Check();
    }
    child::TreeNodes& Tree() { return view->TreeFolders.Tree(); }
    NodeId Node(const std::string& key) { return Tree().FindKey(key).value_or(noNode); }
    std::int32_t Index(const std::string& key) { return static_cast<std::int32_t>(Tree().PositionOf(Node(key))) + 1; }

    /// "C:\w(a b(c))": the texts of the nodes with those below them.
    std::string Shape(NodeId parent = noNode) {
        std::string line;
        for (NodeId node = Tree().FirstChild(parent); node != noNode; node = Tree().Next(node)) {
            line += (line.empty() ? "" : " ") + std::string(Tree().Text(node));
            if (Tree().HasChildren(node)) line += "(" + Shape(node) + ")";
        }
        return line;
    }
    std::string Images(const std::string& key) {
        return Tree().Image(Node(key), child::NodeImage::Plain).ToText() + " " +
               Tree().Image(Node(key), child::NodeImage::Selected).ToText();
    }
    void ClickNode(const std::string& key) { view->TreeFolders.NodeClickInput(Index(key)); }
    void ExpandNode(const std::string& key) { view->TreeFolders.ExpandInput(Index(key)); }

    std::string Events() {
        std::string line;
        for (const std::string& event : std::exchange(events, {})) line += (line.empty() ? "" : " ") + event;
        return line;
    }
    frame::Handlers& Handlers() { return host.SiteOf(*view)->ApplicationHandlers(); }
    std::size_t Boxes() { return host.log.Of("msgbox").size(); }

    test::HostUnderTest host;
    FolderView* view = nullptr;
    std::vector<std::string> events;
};

TEST_F(FolderViewTest, AFolderIsTheRootWithItsSubFoldersInTextOrder) {
    Folder("C:\\w\\b");
    Folder("C:\\w\\a\\deep");
    Make();
    view->SetPathRoot("C:\\w\\");
    EXPECT_EQ(Shape(), "w(a b)");
    EXPECT_EQ(Tree().Key(Tree().FirstChild(noNode)), "C:\\w");
    EXPECT_EQ(view->FolderPath(), "C:\\w\\");
    EXPECT_EQ(Events(),
              "BeforePaint(False) BeforeAddItem(False) AfterAddItem(1) BeforeAddItem(False) AfterAddItem(2) "
              "BeforeAddItem(False) AfterAddItem(3) AfterPaint ChangedFolder");
}

TEST_F(FolderViewTest, WordsAreRootsInAnyCase) {
    Folder("C:\\My Documents\\letters");
    host.files.SetDrive("A", {.type = frame::driveTypes::removable, .ready = false}).Check();
    Make("my computer");
    EXPECT_EQ(Shape(), "My Computer((A:) Local Disk (C:)(My Documents Temp))");
    EXPECT_EQ(Tree().Key(Tree().FirstChild(Node("My Computer"))), "A:\\");
    view->SetPathRoot("MY DOCUMENTS");
    EXPECT_EQ(Shape(), "My Documents(letters)");
    EXPECT_EQ(Tree().Key(Tree().FirstChild(noNode)), "C:\\My Documents");
    view->SetPathRoot("my folders");
    EXPECT_EQ(Shape(), "My Folders");
    EXPECT_EQ(view->ItemIndex(), 1);
    EXPECT_TRUE(view->ItemSelected());
    EXPECT_EQ(view->GetMyFolders(), frame::Variant(frame::VariantArray(0, {frame::Variant("")})));
}

TEST_F(FolderViewTest, ARootThatIsNoFolderGivesNoNodes) {
    Make("C:\\missing");
    EXPECT_EQ(Shape(), "");
    EXPECT_EQ(view->FolderPath(), "C:\\missing");
    EXPECT_EQ(Boxes(), 0U);
}

TEST_F(FolderViewTest, AtDesignTimeTheRootIsAnEntryAndTheDiskIsLeftAlone) {
    Folder("C:\\w\\a");
    Make("C:\\w", true);
    EXPECT_EQ(Shape(), "C:\\w");
    EXPECT_EQ(Tree().Image(Tree().At(0), child::NodeImage::Plain).ToText(), "My Computer");
    EXPECT_EQ(test::ErrorOf([&] { view->SetItemIndex(1); }), frame::errors::notPermitted);
}

TEST_F(FolderViewTest, APaintThatIsCancelledLeavesTreeAndPath) {
    Folder("C:\\w\\a");
    Folder("C:\\v");
    Make("C:\\w");
    Handlers().On(folderview::BeforePaint, [](bool& cancel) { cancel = true; });
    view->SetPathRoot("C:\\v");
    EXPECT_EQ(Shape(), "w(a)");
    EXPECT_EQ(view->FolderPath(), "C:\\w");
    EXPECT_EQ(view->PathRoot(), "C:\\v");
}

TEST_F(FolderViewTest, HiddenAndSystemFoldersNeedLeaveAndHiddenOnesArePale) {
    Folder("C:\\w\\h", frame::attributes::hidden);
    Folder("C:\\w\\s", frame::attributes::system);
    Folder("C:\\w\\v");
    Make("C:\\w");
    EXPECT_EQ(Shape(), "w(v)");
    EXPECT_EQ(Images("C:\\w\\v"), "File Folder OPEN_File Folder");
    view->SetAllowHiddenFolders(true);
    ClickNode("C:\\w");
    EXPECT_EQ(Shape(), "w(h v)");
    EXPECT_EQ(Images("C:\\w\\h"), "HIDDEN_File Folder HIDDEN_OPEN_File Folder");
    const auto& plain = view->Image16.ListImages.Item("File Folder").Picture();
    const auto& pale = view->Image16.ListImages.Item("HIDDEN_File Folder").Picture();
    EXPECT_NE(plain->Plane(1)->pixels, pale->Plane(1)->pixels);
    view->SetAllowSystemFolders(true);
    ClickNode("C:\\w");
    EXPECT_EQ(Shape(), "w(h s v)");
}

TEST_F(FolderViewTest, AClickReachesTheApplicationTwiceAndThePathOnce) {
    Folder("C:\\w\\a\\deep");
    Make("C:\\w");
    Tree().SetExpanded(Node("C:\\w"), true);
    const frame::TextSize place = foldertest::PlaceOn(view->TreeFolders, "C:\\w\\a");
    view->TreeFolders.MouseDownInput(1, 0, place.width, place.height);
    ClickNode("C:\\w\\a");
    view->TreeFolders.MouseUpInput(1, 0, 100, 300);
    EXPECT_THAT(Events(), testing::EndsWith(" NodeClick(C:\\w\\a) BeforeAddItem(False) AfterAddItem(3) ChangedFolder "
                                            "NodeClick(C:\\w\\a) MouseUp(1, 0, 100, 300)"));
    EXPECT_EQ(view->FolderPath(), "C:\\w\\a");
    EXPECT_EQ(view->ItemIndex(), 2);
    EXPECT_EQ(Shape(), "w(a(deep))");
}

TEST_F(FolderViewTest, TheRightButtonSelectsAndOneBesideTheNodesDoesNothing) {
    Folder("C:\\w\\a");
    Make("C:\\w");
    Tree().SetExpanded(Node("C:\\w"), true);
    const frame::TextSize place = foldertest::PlaceOn(view->TreeFolders, "C:\\w\\a");
    view->TreeFolders.MouseDownInput(2, 0, place.width, place.height);
    EXPECT_EQ(view->SelectedItem(), 2);
    EXPECT_THAT(Events(), testing::EndsWith(") NodeClick(C:\\w\\a) ChangedFolder"));
    view->TreeFolders.MouseDownInput(2, 0, 100, 2000);
    EXPECT_EQ(Events(), "MouseDown(2, 0, 100, 2000)");
}

TEST_F(FolderViewTest, ExpandingFillsOneLevelAndTwoWithAutoFill) {
    Folder("C:\\w\\a\\b\\c\\d");
    Make("C:\\w");
    ExpandNode("C:\\w\\a");
    EXPECT_EQ(Shape(), "w(a(b))");
    view->SetAutoFillSubFolders(true);
    ExpandNode("C:\\w\\a");
    EXPECT_EQ(Shape(), "w(a(b(c)))");
}

TEST_F(FolderViewTest, ExpandingAFolderThatHasGoneShowsTheBoxAndTakesItOut) {
    Folder("C:\\w\\a");
    Make("C:\\w");
    host.files.Remove("C:\\w\\a").Check();
    ExpandNode("C:\\w\\a");
    EXPECT_EQ(Boxes(), 1U);
    EXPECT_EQ(Shape(), "w");
}

TEST_F(FolderViewTest, AClickOnAFolderThatHasGoneKeepsThePath) {
    Folder("C:\\w\\a");
    Make("C:\\w");
    host.files.Remove("C:\\w\\a").Check();
    ClickNode("C:\\w\\a");
    EXPECT_EQ(Boxes(), 1U);
    EXPECT_EQ(Shape(), "w");
    EXPECT_EQ(view->FolderPath(), "C:\\w");
    EXPECT_EQ(Events(), "NodeClick(C:\\w\\a)");
}

TEST_F(FolderViewTest, GoingUpSelectsTheParentAndEndsAtTheRoot) {
    Folder("C:\\w\\a");
    Make("C:\\w");
    ClickNode("C:\\w\\a");
    Events();
    EXPECT_EQ(view->GoUp(), 1);
    EXPECT_EQ(view->FolderPath(), "C:\\w");
    EXPECT_EQ(Events(), "ChangedFolder");
    EXPECT_EQ(view->GoUp(), 0);
    EXPECT_EQ(Events(), "");
}

TEST_F(FolderViewTest, APathThatIsSetSelectsItsNodeAndIsKeptInAnyCase) {
    Folder("C:\\w\\a\\deep");
    Make("C:\\w");
    view->SetFolderPath("c:\\W\\A");
    EXPECT_EQ(view->SelectedItem(), Index("C:\\w\\a"));
    view->SetFolderPath("C:\\w\\a\\deep");
    EXPECT_EQ(view->FolderPath(), "C:\\w\\a\\deep");
    EXPECT_EQ(view->SelectedItem(), Index("C:\\w\\a"));
    EXPECT_EQ(Shape(), "w(a)");
    EXPECT_EQ(Events(), "");
}

TEST_F(FolderViewTest, ItemsAreReadAndWrittenAtTheCursor) {
    Folder("C:\\w\\a");
    Make("C:\\w");
    view->SetItemIndex(2);
    view->SetItemTag("mine");
    view->SetItemSelected(true);
    view->SetItemSelected(false);
    EXPECT_EQ(view->ItemTag(), "mine");
    EXPECT_TRUE(view->ItemSelected());
    EXPECT_EQ(view->ItemPath(), "C:\\w\\a");
    view->SetItemName("b");
    EXPECT_TRUE(host.files.FolderExists("C:\\w\\b"));
    EXPECT_EQ(view->ItemDisplayName(), "b");
    EXPECT_EQ(view->ItemPath(), "C:\\w\\a");
    EXPECT_EQ(view->ItemName(), "");  // nothing stands at the old path
    view->SetItemIndex(3);
    EXPECT_EQ(view->ItemIndex(), 0);
    EXPECT_EQ(view->ItemPath(), "");
    EXPECT_FALSE(view->ItemSelected());
}

TEST_F(FolderViewTest, ALabelThatWasChangedLetsItsFolderBeOfferedAgain) {
    Folder("C:\\w\\a");
    Make("C:\\w");
    view->SetItemIndex(2);
    view->SetItemDisplayName("other");
    ClickNode("C:\\w");
    EXPECT_EQ(Events(), "NodeClick(C:\\w) BeforeAddItem(False)");  // its key is in use: nothing is added
    EXPECT_EQ(Shape(), "w(other)");
}

TEST_F(FolderViewTest, ARefreshTakesOutWhatHasGoneAndAddsWhatIsNewBelowNodesInView) {
    Folder("C:\\w\\a\\deep");
    Folder("C:\\w\\b");
    Make("C:\\w");
    ClickNode("C:\\w\\a");
    host.files.Remove("C:\\w\\b").Check();
    Folder("C:\\w\\c");
    Folder("C:\\w\\a\\new");
    Events();
    view->Refresh();
    EXPECT_EQ(Shape(), "w(a(deep) c)");
    EXPECT_EQ(Events(), "BeforeAddItem(False) AfterAddItem(4)");
    ExpandNode("C:\\w");
    view->RefreshTimer.TimerInput();
    EXPECT_EQ(Shape(), "w(a(deep new) c)");
}

TEST_F(FolderViewTest, MyFoldersShowsWhatIsThereAndMarksWhatIsNot) {
    Folder("C:\\w\\a");
    host.files.SetDrive("E", {}).Check();
    Folder("E:\\kept");
    Make("My Folders");
    EXPECT_EQ(view->AddNewFolder("C:\\w"), 2);
    EXPECT_EQ(view->AddNewFolder("C:\\missing"), 4);
    EXPECT_EQ(view->AddNewFolder("E:\\kept"), 5);
    EXPECT_EQ(Shape(), "My Folders(C:\\missing (Unavailable) kept w(a))");
    EXPECT_TRUE(Tree().Checked(Node("C:\\missing")));
    EXPECT_EQ(view->GetMyFolders().ToArray().UpperBound(), 3);

    host.files.SetDrive("E", {.ready = false}).Check();
    view->Refresh();
    EXPECT_EQ(Tree().Text(Node("E:\\kept")), "E:\\kept (Unavailable)");
    host.files.SetDrive("E", {.ready = true}).Check();
    Folder("C:\\missing");
    view->Refresh();
    EXPECT_EQ(Tree().Text(Node("E:\\kept")), "kept");
    EXPECT_EQ(Tree().Text(Node("C:\\missing")), "missing");
    EXPECT_EQ(Images("C:\\missing"), "File Folder OPEN_File Folder");
    EXPECT_FALSE(Tree().Checked(Node("C:\\missing")));
    EXPECT_TRUE(Tree().Sorted(Node("C:\\missing")));
}

TEST_F(FolderViewTest, AClickOnAWordTakesOutEntriesThatAreNotThere) {
    Folder("C:\\w");
    Make("My Folders");
    view->AddNewFolder("C:\\missing");
    view->AddNewFolder("C:\\w");
    ClickNode("My Folders");
    EXPECT_EQ(Shape(), "My Folders(w)");
}

TEST_F(FolderViewTest, ANewFolderIsMadeInTheSelectedOneAndToldTwice) {
    Folder("C:\\w\\a");
    Make("C:\\w");
    ClickNode("C:\\w\\a");
    Events();
    EXPECT_EQ(view->AddNewFolder("n"), 3);
    EXPECT_TRUE(host.files.FolderExists("C:\\w\\a\\n"));
    EXPECT_EQ(Events(), "BeforeAddItem(False) AfterAddItem(3) AfterAddItem(3)");
    EXPECT_FALSE(view->TreeFolders.Editing());
    EXPECT_EQ(view->AddNewFolder(), 4);
    EXPECT_EQ(view->SelectedItem(), 4);
    EXPECT_TRUE(view->TreeFolders.Editing());
    view->SetPathRoot("My Computer");
    view->SetItemIndex(1);
    EXPECT_EQ(view->AddNewFolder("x"), 0);
}

TEST_F(FolderViewTest, AHandlerMayBuildTheTreeAnewInTheMiddleOfAFill) {
    for (const char* name : {"a", "b", "c"}) Folder(std::string("C:\\w\\") + name);
    Folder("C:\\v\\x");
    Make();
    bool once = true;
    Handlers().On(folderview::AfterAddItem, [&](std::int32_t& index) {
        if (index == 3 && std::exchange(once, false)) view->SetPathRoot("C:\\v");
    });
    view->SetPathRoot("C:\\w");
    EXPECT_EQ(Shape(), "v(x)");
    EXPECT_EQ(view->FolderPath(), "C:\\v");
}

TEST_F(FolderViewTest, AHandlerMayRemoveTheNodeInHandOrLetGoOfTheControl) {
    Folder("C:\\w\\a\\b");
    Make("C:\\w");
    Handlers().On(folderview::NodeClick, [&](child::TreeNodeRef& node) { Tree().Remove(node->Ref().node); });
    ClickNode("C:\\w\\a");
    EXPECT_EQ(Shape(), "w");
    Handlers().On(folderview::NodeClick, [&](child::TreeNodeRef&) { host.Destroy(*view); });
    view->TreeFolders.NodeClickInput(1);
    EXPECT_EQ(host.FindSite("FolderView1"), nullptr);
}

TEST_F(FolderViewTest, AFolderThatMayNotBeReadHasNoChildrenAndGivesNoError) {
    Folder("C:\\w\\locked\\in");
    Make("C:\\w");
    host.files.SetFolder("C:\\w\\locked", {.unreadable = true}).Check();
    ExpandNode("C:\\w\\locked");
    EXPECT_EQ(Shape(), "w(locked)");
    EXPECT_EQ(Boxes(), 0U);
}

TEST_F(FolderViewTest, ImagesAreAddedRemovedAndNamedByTheCursor) {
    Make();
    EXPECT_EQ(view->ImageCount(), 4);
    EXPECT_EQ(view->ImageAddNew(std::make_shared<frame::Picture>(240.0f, 240.0f, ""), "own"), 5);
    EXPECT_EQ(view->ImageAddNew(std::make_shared<frame::Picture>(240.0f, 240.0f, ""), "own"), frame::errors::keyNotUnique);
    view->SetImageIndex(5);
    view->SetImageKey("changed");
    EXPECT_EQ(view->ImageKey(), "own");
    EXPECT_EQ(view->ImageRemove("own"), frame::Variant(std::int32_t{0}));
    EXPECT_EQ(view->ImageRemove("own"), frame::Variant(std::int32_t{frame::errors::elementNotFound}));
    EXPECT_EQ(view->ImageKey(), "");
}

}  // namespace
}  // namespace tessel::controls
