#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

#include "tests/controls/folderview/FolderViewTestHelp.h"

/// How a refresh makes the tree true to the disk.
namespace tessel::controls {
namespace {

using namespace foldertest;
using frame::Variant;
using testing::ElementsAre;
using testing::IsEmpty;
namespace attributes = frame::attributes;

class FolderViewRefresh : public testing::Test {
  protected:
    FolderViewRefresh() {
        for (const char* path : {"C:\\x\\a\\s", "C:\\x\\b"}) stage.Folder(path);
        stage.ShowRoot("C:\\x");
    }
    Stage stage;
    FolderView& view = stage.View();
};

TEST_F(FolderViewRefresh, ARefreshOfWhatHasNotChangedTellsNothing) {
    view.Refresh();
    EXPECT_EQ(stage.Events(), "");
    EXPECT_EQ(Labels(view), "x {a, b}");
    EXPECT_THAT(stage.Changes(), IsEmpty());
}

TEST_F(FolderViewRefresh, ANewFolderComesUnderANodeInView) {
    stage.Folder("C:\\x\\new");
    view.Refresh();
    EXPECT_EQ(Labels(view), "x {a, b, new}");
    EXPECT_EQ(stage.Events(), "BeforeAddItem(False) AfterAddItem(4)");
}

TEST_F(FolderViewRefresh, ANewFolderUnderANodeOutOfViewComesWithTheClickOnIt) {
    stage.Click("C:\\x\\a");
    stage.Folder("C:\\x\\a\\new");
    stage.Clear();
    view.Refresh();
    EXPECT_EQ(Labels(view), "x {a {s}, b}");
    EXPECT_EQ(stage.Events(), "");
    stage.Click("C:\\x\\a");
    EXPECT_EQ(Labels(view), "x {a {new, s}, b}");
}

TEST_F(FolderViewRefresh, NodesInViewAreReadOneLevelAhead) {
    stage.Expand("C:\\x");
    stage.Clear();
    view.Refresh();
    EXPECT_EQ(Labels(view), "x {a {s}, b}");
    EXPECT_EQ(stage.Events(), "BeforeAddItem(False) AfterAddItem(4)");
    EXPECT_FALSE(stage.Node("C:\\x\\a")->Expanded());
}

TEST_F(FolderViewRefresh, NodesThatAreScrolledOutOfViewAreNotReadAhead) {
    Stage low({.height = 5 * rowHeight});
    for (char name = 'a'; name <= 'z'; ++name) low.Folder(std::string("C:\\x\\") + name + "\\deep");
    low.ShowRoot("C:\\x");
    low.Expand("C:\\x");
    low.View().Refresh();
    EXPECT_TRUE(low.Has("C:\\x\\a\\deep"));
    EXPECT_TRUE(low.Has("C:\\x\\d\\deep"));
    EXPECT_FALSE(low.Has("C:\\x\\z\\deep"));
}

TEST_F(FolderViewRefresh, AFolderThatHasGoneIsTakenOutWithoutAWord) {
    stage.Remove("C:\\x\\a");
    view.Refresh();
    EXPECT_EQ(Labels(view), "x {b}");
    EXPECT_EQ(stage.Events(), "");
    EXPECT_EQ(stage.Messages(), "");
}

TEST_F(FolderViewRefresh, AFolderThatHasGoneOutOfViewIsTakenOutToo) {
    stage.Click("C:\\x\\a");
    stage.Remove("C:\\x\\a\\s");
    view.Refresh();
    EXPECT_EQ(Labels(view), "x {a, b}");
}

TEST_F(FolderViewRefresh, AFolderTakesAllBelowItAlong) {
    stage.Folder("C:\\x\\a\\s\\deep");
    stage.Click("C:\\x\\a");
    stage.Click("C:\\x\\a\\s");
    stage.Remove("C:\\x\\a");
    view.Refresh();
    EXPECT_EQ(Keys(view), "C:\\x | C:\\x\\b");
}

TEST_F(FolderViewRefresh, ManyFoldersThatHaveGoneAreAllTakenOut) {
    for (char name = 'c'; name <= 'z'; ++name) stage.Folder(std::string("C:\\x\\") + name);
    stage.Click("C:\\x");
    for (char name = 'a'; name <= 'y'; ++name) stage.Remove(std::string("C:\\x\\") + name);
    view.Refresh();
    EXPECT_EQ(Labels(view), "x {z}");
}

TEST_F(FolderViewRefresh, ARootThatHasGoneIsTakenOutAndComesBackOnlyWithABuild) {
    stage.Remove("C:\\x");
    view.Refresh();
    EXPECT_EQ(view.ItemCount(), 0);
    EXPECT_EQ(view.FolderPath(), "C:\\x");
    stage.Folder("C:\\x");
    view.Refresh();
    EXPECT_EQ(view.ItemCount(), 0);
    view.Show();
    EXPECT_EQ(Labels(view), "x");
}

TEST_F(FolderViewRefresh, ARenamedFolderGivesWayToItsNewName) {
    stage.Disk().Rename("C:\\x\\a", "new").Check();
    view.Refresh();
    EXPECT_EQ(Labels(view), "x {b, new}");
}

TEST_F(FolderViewRefresh, SelectionExpansionAndPathStay) {
    stage.Expand("C:\\x");
    stage.Expand("C:\\x\\a");
    stage.Click("C:\\x\\b");
    stage.Folder("C:\\x\\new");
    stage.Clear();
    view.Refresh();
    EXPECT_EQ(stage.Selected(), "C:\\x\\b");
    EXPECT_TRUE(stage.Node("C:\\x\\a")->Expanded());
    EXPECT_TRUE(stage.Node("C:\\x")->Expanded());
    EXPECT_EQ(view.FolderPath(), "C:\\x\\b");
    EXPECT_EQ(stage.EventsButAdding(), "");
}

TEST_F(FolderViewRefresh, ThePathStaysWhenItsFolderGoes) {
    stage.Click("C:\\x\\b");
    stage.Remove("C:\\x\\b");
    stage.Clear();
    view.Refresh();
    EXPECT_EQ(view.FolderPath(), "C:\\x\\b");
    EXPECT_EQ(stage.Events(), "");
}

TEST_F(FolderViewRefresh, TheFilterCountsForNewFolders) {
    stage.Folder("C:\\x\\hidden", attributes::hidden);
    view.Refresh();
    EXPECT_EQ(stage.Events(), "");
    view.SetAllowHiddenFolders(true);
    view.Refresh();
    EXPECT_EQ(Labels(view), "x {a, b, hidden}");
    EXPECT_EQ(stage.Node("C:\\x\\hidden")->Image().ToText(), "HIDDEN_File Folder");
}

TEST_F(FolderViewRefresh, ANewFolderCanBeLeftOut) {
    stage.Folder("C:\\x\\new");
    stage.handlers.On(folderview::BeforeAddItem, [](bool& cancel) { cancel = true; });
    view.Refresh();
    EXPECT_EQ(Labels(view), "x {a, b}");
    view.Refresh();
    EXPECT_EQ(stage.Events(), "BeforeAddItem(False) BeforeAddItem(False)");
}

TEST_F(FolderViewRefresh, ANodeWithAnotherLabelIsFoundByItsKey) {
    stage.Node("C:\\x\\a")->SetText("Label");
    view.Refresh();
    EXPECT_EQ(stage.Events(), "");
    EXPECT_EQ(stage.Node("C:\\x\\a")->Text(), "Label");
}

TEST_F(FolderViewRefresh, NodesOfTheHostWithoutAKeyStay) {
    stage.Tree().Nodes.Add(Variant("C:\\x"), child::TreeRelationshipConstants::Child, {}, "own");
    stage.Tree().Nodes.Add(Variant("C:\\x"), child::TreeRelationshipConstants::Child, "keyed", "keyed");
    stage.Tree().Nodes.Add(Variant("C:\\x"), child::TreeRelationshipConstants::Child, "my documents", "word");
    view.Refresh();
    EXPECT_EQ(Labels(view), "x {a, b, own, word}");
}

TEST_F(FolderViewRefresh, AnEmptyTreeStaysEmpty) {
    stage.ShowRoot("");
    view.Refresh();
    EXPECT_EQ(view.ItemCount(), 0);
    EXPECT_EQ(stage.Events(), "");
}

// The timer

TEST_F(FolderViewRefresh, TheTimerRefreshesAtItsInterval) {
    view.SetRefreshInterval(1000);
    stage.Folder("C:\\x\\new");
    stage.host.clock.Advance(999);
    EXPECT_EQ(stage.Events(), "");
    stage.host.clock.Advance(1);
    EXPECT_EQ(stage.Events(), "BeforeAddItem(False) AfterAddItem(4)");
    stage.Folder("C:\\x\\newer");
    stage.host.clock.Advance(1000);
    EXPECT_EQ(stage.Events(), "BeforeAddItem(False) AfterAddItem(5)");
    EXPECT_THAT(stage.Changes(), ElementsAre("RefreshInterval"));
}

TEST_F(FolderViewRefresh, AnIntervalOfZeroMeansNoRefreshes) {
    view.SetRefreshInterval(1000);
    view.SetRefreshInterval(0);
    stage.Folder("C:\\x\\new");
    stage.host.clock.Advance(100'000);
    EXPECT_EQ(stage.Events(), "");
}

TEST_F(FolderViewRefresh, ALoadedIntervalRefreshes) {
    const frame::MemoryBag bag(frame::MemoryBag::Contents{{"PathRoot", Variant("C:\\Temp")}, {"RefreshInterval", Variant(500)}});
    Stage loaded({.saved = &bag});
    loaded.Folder("C:\\Temp\\new");
    loaded.host.clock.Advance(500);
    EXPECT_EQ(loaded.Events(), "BeforeAddItem(False) AfterAddItem(2)");
}

// Drives

class FolderViewRefreshDrives : public testing::Test {
  protected:
    FolderViewRefreshDrives() {
        stage.Drive("D", {.type = frame::driveTypes::removable, .volume = "Stick"});
        stage.Folder("D:\\d");
        stage.ShowRoot("My Computer");
    }
    Stage stage;
    FolderView& view = stage.View();
};

TEST_F(FolderViewRefreshDrives, AnotherDiskInADriveGivesItAnotherLabel) {
    EXPECT_EQ(stage.Node("D:\\")->Text(), "Stick (D:)");
    stage.Drive("D", {.volume = "Other"});
    view.Refresh();
    EXPECT_EQ(stage.Node("D:\\")->Text(), "Other (D:)");
    EXPECT_EQ(stage.Events(), "");
}

TEST_F(FolderViewRefreshDrives, AnotherKindOfDriveGivesItAnotherImage) {
    stage.Drive("D", {.type = frame::driveTypes::compactDisk});
    view.Refresh();
    EXPECT_EQ(stage.Node("D:\\")->Image().ToText(), "Compact Disk");
    EXPECT_EQ(stage.Node("D:\\")->SelectedImage().ToText(), "OPEN_Compact Disk");
}

TEST_F(FolderViewRefreshDrives, ADiskThatWasTakenOutLeavesTheDriveAndLosesItsFolders) {
    stage.Drive("D", {.ready = false});
    view.Refresh();
    EXPECT_EQ(stage.Node("D:\\")->Text(), "(D:)");
    EXPECT_FALSE(stage.Has("D:\\d"));
}

TEST_F(FolderViewRefreshDrives, ADiskThatComesBackBringsItsFoldersWhileTheDriveIsInView) {
    stage.Expand("My Computer");
    stage.Drive("D", {.ready = false});
    view.Refresh();
    stage.Drive("D", {.ready = true});
    stage.Clear();
    view.Refresh();
    EXPECT_EQ(stage.Node("D:\\")->Text(), "Stick (D:)");
    EXPECT_TRUE(stage.Has("D:\\d"));
}

TEST_F(FolderViewRefreshDrives, ADriveThatWasTakenAwayIsTakenOut) {
    stage.Disk().Remove("D:").Check();
    view.Refresh();
    EXPECT_FALSE(stage.Has("D:\\"));
    EXPECT_EQ(stage.Messages(), "");
}

TEST_F(FolderViewRefreshDrives, ANewDriveComesOnlyWithABuild) {
    stage.Drive("E", {.volume = "New"});
    stage.Expand("My Computer");
    view.Refresh();
    EXPECT_FALSE(stage.Has("E:\\"));
    view.Show();
    EXPECT_TRUE(stage.Has("E:\\"));
}

TEST_F(FolderViewRefreshDrives, TheRootOfTheDrivesStays) {
    for (const char* letter : {"C:", "D:"}) stage.Disk().Remove(letter).Check();
    view.Refresh();
    EXPECT_EQ(Labels(view), "My Computer");
}

TEST_F(FolderViewRefreshDrives, ALabelThatTheHostGaveADriveIsReplaced) {
    stage.Node("D:\\")->SetText("own");
    view.Refresh();
    EXPECT_EQ(stage.Node("D:\\")->Text(), "Stick (D:)");
}

TEST_F(FolderViewRefreshDrives, MyDocumentsIsAFolderToARefresh) {
    stage.Folder("C:\\My Documents\\letters");
    stage.ShowRoot("My Documents");
    stage.Folder("C:\\My Documents\\new");
    view.Refresh();
    EXPECT_EQ(Labels(view), "My Documents {letters, new}");
    stage.Remove("C:\\My Documents");
    view.Refresh();
    EXPECT_EQ(view.ItemCount(), 0);
}

}  // namespace
}  // namespace tessel::controls
