#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/controls/folderview/FolderViewTestHelp.h"

/// How the user and the host go through the tree: expanding, clicking, the current path, the way up.
namespace tessel::controls {
namespace {

using namespace foldertest;
using frame::Variant;
using testing::ElementsAre;
using testing::IsEmpty;

class FolderViewPath : public testing::Test {
  protected:
    FolderViewPath() {
        for (const char* path : {"C:\\x\\a\\s\\deep", "C:\\x\\a\\t", "C:\\x\\b"}) stage.Folder(path);
        stage.ShowRoot("C:\\x");
    }
    Stage stage;
    FolderView& view = stage.View();
};

// Expanding

TEST_F(FolderViewPath, ExpandingTellsAndThenFills) {
    std::string labels;
    stage.handlers.On(folderview::Expand, [&](child::TreeNodeRef&) { labels = Labels(view); });
    stage.Expand("C:\\x\\a");
    EXPECT_EQ(labels, "x {a, b}");
    EXPECT_EQ(Labels(view), "x {a {s, t}, b}");
    EXPECT_EQ(stage.Events(), "Expand(C:\\x\\a) BeforeAddItem(False) AfterAddItem(4) BeforeAddItem(False) AfterAddItem(5)");
}

TEST_F(FolderViewPath, ExpandingChangesNeitherPathNorSelectionNorCursor) {
    view.SetItemIndex(1);
    stage.Expand("C:\\x\\a");
    EXPECT_EQ(view.FolderPath(), "C:\\x");
    EXPECT_EQ(stage.Selected(), "");
    EXPECT_EQ(view.ItemIndex(), 1);
    EXPECT_TRUE(stage.Node("C:\\x\\a")->Expanded());
}

TEST_F(FolderViewPath, ExpandingAgainFindsWhatIsNew) {
    stage.Expand("C:\\x\\a");
    stage.Collapse("C:\\x\\a");
    stage.Folder("C:\\x\\a\\new");
    stage.Remove("C:\\x\\a\\t");
    stage.Clear();
    stage.Expand("C:\\x\\a");
    EXPECT_EQ(Labels(view), "x {a {new, s}, b}");
    EXPECT_EQ(stage.Events(), "Expand(C:\\x\\a) BeforeAddItem(False) AfterAddItem(6)");
}

TEST_F(FolderViewPath, CollapsingIsToldAndDoesNothingElse) {
    stage.Expand("C:\\x\\a");
    stage.Remove("C:\\x\\a\\t");
    stage.Clear();
    stage.watched.calls = 0;
    stage.Collapse("C:\\x\\a");
    EXPECT_EQ(stage.Events(), "Collapse(C:\\x\\a)");
    EXPECT_EQ(Labels(view), "x {a {s, t}, b}");
    EXPECT_EQ(stage.watched.calls, 0);
}

TEST_F(FolderViewPath, ExpandingAFolderThatWasDeletedShowsTheMessageAndTakesTheNodeOut) {
    stage.Expand("C:\\x\\a");
    stage.Clear();
    stage.Remove("C:\\x\\a");
    stage.Expand("C:\\x\\a");
    EXPECT_EQ(stage.Messages(), Stage::NotAccessible("a"));
    EXPECT_EQ(Labels(view), "x {b}");
    EXPECT_EQ(stage.Events(), "Expand(C:\\x\\a)");
    EXPECT_EQ(view.FolderPath(), "C:\\x");
}

TEST_F(FolderViewPath, TheMessageNamesTheLabel) {
    stage.Node("C:\\x\\b")->SetText("Label");
    stage.Remove("C:\\x\\b");
    stage.Expand("C:\\x\\b");
    EXPECT_EQ(stage.Messages(), Stage::NotAccessible("Label"));
}

TEST_F(FolderViewPath, TheNodeIsStillThereWhileTheMessageIsShown) {
    stage.Remove("C:\\x\\b");
    std::string labels;
    stage.onMessage = [&] { labels = Labels(view); };
    stage.Expand("C:\\x\\b");
    EXPECT_EQ(labels, "x {a, b}");
    EXPECT_EQ(Labels(view), "x {a}");
}

TEST_F(FolderViewPath, ExpandingMyComputerReadsNothing) {
    stage.ShowRoot("My Computer");
    stage.Drive("D", {.volume = "Work"});
    stage.watched.calls = 0;
    stage.Expand("My Computer");
    EXPECT_EQ(stage.Events(), "Expand(My Computer)");
    EXPECT_EQ(stage.watched.calls, 0);
    EXPECT_FALSE(stage.Has("D:\\"));
}

TEST_F(FolderViewPath, ExpandingMyFoldersReadsNothing) {
    stage.ShowRoot("My Folders");
    view.AddNewFolder("C:\\none");
    stage.Clear();
    stage.Expand("My Folders");
    EXPECT_EQ(stage.Events(), "Expand(My Folders)");
    EXPECT_TRUE(stage.Has("C:\\none"));
    EXPECT_EQ(stage.Messages(), "");
}

TEST_F(FolderViewPath, ExpandingMyDocumentsFillsItLikeAFolder) {
    stage.Folder("C:\\My Documents\\letters");
    stage.ShowRoot("My Documents");
    stage.Folder("C:\\My Documents\\new");
    stage.Expand("C:\\My Documents");
    EXPECT_EQ(Labels(view), "My Documents {letters, new}");
    stage.Clear();
    stage.Remove("C:\\My Documents");
    stage.Expand("C:\\My Documents");
    EXPECT_EQ(stage.Messages(), Stage::NotAccessible("My Documents"));
    EXPECT_EQ(view.ItemCount(), 0);
}

TEST_F(FolderViewPath, ExpandingADriveThatIsNotReadyLosesItsFoldersButNotTheDrive) {
    stage.Drive("D", {.type = frame::driveTypes::removable});
    stage.Folder("D:\\d");
    stage.ShowRoot("My Computer");
    stage.Drive("D", {.ready = false});
    stage.Expand("D:\\");
    EXPECT_EQ(stage.Messages(), "");
    EXPECT_TRUE(stage.Has("D:\\"));
    EXPECT_FALSE(stage.Has("D:\\d"));
}

TEST_F(FolderViewPath, AutoFillReadsOneLevelAheadOfTheUser) {
    view.SetAutoFillSubFolders(true);
    stage.Expand("C:\\x");
    EXPECT_EQ(Labels(view), "x {a {s, t}, b}");
    stage.Expand("C:\\x\\a");
    EXPECT_EQ(Labels(view), "x {a {s {deep}, t}, b}");
}

TEST_F(FolderViewPath, WithoutAutoFillOneLevelIsRead) {
    stage.Expand("C:\\x");
    EXPECT_EQ(Labels(view), "x {a, b}");
}

TEST_F(FolderViewPath, AutoFillDoesNotCountForClicksAndBuilds) {
    view.SetAutoFillSubFolders(true);
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(Labels(view), "x {a, b}");
    stage.Click("C:\\x");
    EXPECT_EQ(Labels(view), "x {a, b}");
}

TEST_F(FolderViewPath, AutoFillThrowsOutWhatHasGoneBelowTheChildren) {
    view.SetAutoFillSubFolders(true);
    stage.Expand("C:\\x");
    stage.Remove("C:\\x\\a\\t");
    stage.Expand("C:\\x");
    EXPECT_EQ(Labels(view), "x {a {s}, b}");
}

TEST_F(FolderViewPath, AutoFillOfMyComputerReadsNothing) {
    view.SetAutoFillSubFolders(true);
    stage.ShowRoot("My Computer");
    stage.Expand("My Computer");
    EXPECT_EQ(Labels(view), "My Computer {Local Disk (C:) {Temp, x}}");
}

// Clicking

TEST_F(FolderViewPath, AClickTellsFillsAndMovesThePath) {
    stage.Click("C:\\x\\a");
    EXPECT_EQ(stage.Events(),
              "NodeClick(C:\\x\\a) BeforeAddItem(False) AfterAddItem(4) BeforeAddItem(False) AfterAddItem(5) ChangedFolder");
    EXPECT_EQ(view.FolderPath(), "C:\\x\\a");
    EXPECT_EQ(view.ItemIndex(), stage.IndexOf("C:\\x\\a"));
    EXPECT_EQ(stage.Selected(), "C:\\x\\a");
    EXPECT_FALSE(stage.Node("C:\\x\\a")->Expanded());
    EXPECT_THAT(stage.Changes(), IsEmpty());
}

TEST_F(FolderViewPath, WhatTheStepsOfAClickSee) {
    std::vector<std::string> seen;
    view.SetItemIndex(3);
    const auto note = [&](const char* step) {
        seen.push_back(std::string(step) + ": " + view.FolderPath() + " / " + std::to_string(view.ItemIndex()) + " / " +
                       std::to_string(view.ItemCount()));
    };
    stage.handlers.On(folderview::NodeClick, [&](child::TreeNodeRef&) { note("NodeClick"); });
    stage.handlers.On(folderview::ChangedFolder, [&] { note("ChangedFolder"); });
    stage.Click("C:\\x\\a");
    EXPECT_THAT(seen, ElementsAre("NodeClick: C:\\x / 3 / 3", "ChangedFolder: C:\\x\\a / 2 / 5"));
}

TEST_F(FolderViewPath, ClickingTheSameFolderTwiceChangesTheFolderOnce) {
    stage.Click("C:\\x\\b");
    stage.Click("C:\\x\\b");
    EXPECT_EQ(stage.Events(), "NodeClick(C:\\x\\b) ChangedFolder NodeClick(C:\\x\\b)");
}

TEST_F(FolderViewPath, ClickingTheRootOfTheTreeIsNoChange) {
    stage.Click("C:\\x");
    EXPECT_EQ(stage.Events(), "NodeClick(C:\\x)");
}

TEST_F(FolderViewPath, APathIsTheSameInAnyCase) {
    stage.ShowRoot("c:\\X");
    stage.Click("C:\\X");
    EXPECT_EQ(stage.EventsButAdding(), "NodeClick(" + stage.Selected() + ")");
    EXPECT_EQ(view.FolderPath(), "c:\\X");
}

TEST_F(FolderViewPath, APressAndItsClickTellOfTheNodeTwiceAndOfTheChangeOnce) {
    stage.Press("C:\\x");
    stage.Click("C:\\x");
    stage.Expand("C:\\x");
    stage.Clear();
    stage.Press("C:\\x\\b");
    EXPECT_THAT(stage.Events(), testing::MatchesRegex("MouseDown\\(1, 0, .*\\) NodeClick\\(C:.x.b\\) ChangedFolder"));
    stage.Click("C:\\x\\b");
    EXPECT_EQ(stage.Events(), "NodeClick(C:\\x\\b)");
}

TEST_F(FolderViewPath, APressFillsAndMovesTheCursorButSelectsNothing) {
    stage.Expand("C:\\x");
    stage.Press("C:\\x\\a");
    EXPECT_EQ(Labels(view), "x {a {s, t}, b}");
    EXPECT_EQ(view.ItemIndex(), stage.IndexOf("C:\\x\\a"));
    EXPECT_EQ(stage.Selected(), "");
}

TEST_F(FolderViewPath, APressBesideTheNodesIsOnlyTold) {
    stage.Tree().MouseDownInput(1, 0, 10, 20'000);
    EXPECT_EQ(stage.Events(), "MouseDown(1, 0, 10, 20000)");
    EXPECT_EQ(view.FolderPath(), "C:\\x");
}

TEST_F(FolderViewPath, SelectingByTheKeyboardIsAClick) {
    stage.Tree().SelectInput(stage.IndexOf("C:\\x\\b"));
    EXPECT_EQ(stage.Events(), "NodeClick(C:\\x\\b) ChangedFolder");
    EXPECT_EQ(view.FolderPath(), "C:\\x\\b");
}

TEST_F(FolderViewPath, AClickAddsAFolderThatWasMadeMeanwhile) {
    stage.Folder("C:\\x\\new");
    stage.Click("C:\\x");
    EXPECT_EQ(Labels(view), "x {a, b, new}");
}

TEST_F(FolderViewPath, ClickingAFolderThatWasDeletedShowsTheMessageAndKeepsThePath) {
    stage.Remove("C:\\x\\a");
    stage.Click("C:\\x\\a");
    EXPECT_EQ(stage.Messages(), Stage::NotAccessible("a"));
    EXPECT_EQ(Labels(view), "x {b}");
    EXPECT_EQ(view.FolderPath(), "C:\\x");
    EXPECT_EQ(stage.Events(), "NodeClick(C:\\x\\a)");
}

TEST_F(FolderViewPath, ClickingTheCurrentFolderAfterItWasDeletedIsNotNoticed) {
    stage.Click("C:\\x\\a");
    stage.Remove("C:\\x\\a");
    stage.Clear();
    stage.Click("C:\\x\\a");
    EXPECT_EQ(stage.Messages(), "");
    EXPECT_EQ(Labels(view), "x {a, b}");
    EXPECT_EQ(view.FolderPath(), "C:\\x\\a");
    EXPECT_EQ(stage.Events(), "NodeClick(C:\\x\\a)");
}

TEST_F(FolderViewPath, APressOnAFolderThatWasDeletedShowsTheMessageOnce) {
    stage.Expand("C:\\x");
    stage.Remove("C:\\x\\a");
    stage.Clear();
    stage.Press("C:\\x\\a");
    EXPECT_EQ(stage.Messages(), Stage::NotAccessible("a"));
    EXPECT_FALSE(stage.Has("C:\\x\\a"));
}

TEST_F(FolderViewPath, ClickingMyDocumentsGoesToItsRealPath) {
    stage.Folder("C:\\My Documents\\letters");
    stage.ShowRoot("My Documents");
    EXPECT_EQ(view.FolderPath(), "My Documents");
    stage.Click("C:\\My Documents");
    EXPECT_EQ(stage.Events(), "NodeClick(C:\\My Documents) ChangedFolder");
    EXPECT_EQ(view.FolderPath(), "C:\\My Documents");
}

TEST_F(FolderViewPath, ClickingADriveGoesThere) {
    stage.ShowRoot("My Computer");
    stage.Click("C:\\");
    EXPECT_EQ(view.FolderPath(), "C:\\");
    EXPECT_EQ(stage.Events(), "NodeClick(C:\\) ChangedFolder");
    stage.Click("My Computer");
    EXPECT_EQ(view.FolderPath(), "My Computer");
    EXPECT_EQ(stage.Events(), "NodeClick(My Computer) ChangedFolder");
}

TEST_F(FolderViewPath, ClickingADriveThatIsNotReadyGoesThere) {
    stage.Drive("A", {.type = frame::driveTypes::removable, .ready = false});
    stage.ShowRoot("My Computer");
    stage.Click("A:\\");
    EXPECT_EQ(view.FolderPath(), "A:\\");
    EXPECT_EQ(stage.Messages(), "");
    EXPECT_EQ(stage.Events(), "NodeClick(A:\\) ChangedFolder");
    EXPECT_TRUE(stage.Has("A:\\"));
}

TEST_F(FolderViewPath, ClickingADriveThatWasTakenAwayShowsTheMessage) {
    stage.Drive("D", {.volume = "Work"});
    stage.ShowRoot("My Computer");
    stage.Disk().Remove("D:").Check();
    stage.Click("D:\\");
    EXPECT_EQ(stage.Messages(), Stage::NotAccessible("Work (D:)"));
    EXPECT_FALSE(stage.Has("D:\\"));
    EXPECT_EQ(view.FolderPath(), "My Computer");
}

TEST_F(FolderViewPath, ANodeOfTheHostWithoutAKeyIsNoPath) {
    stage.Tree().Nodes.Add({}, {}, {}, "own");
    stage.Tree().NodeClickInput(view.ItemCount());
    EXPECT_EQ(stage.Events(), "NodeClick()");
    EXPECT_EQ(stage.Messages(), "");
    EXPECT_EQ(view.FolderPath(), "C:\\x");
    EXPECT_EQ(Labels(view), "x {a, b}, own");
}

TEST_F(FolderViewPath, ANodeOfTheHostThatIsKeyedByAWordIsAPath) {
    for (const char* word : {"My Computer", "my folders", "My Documents"}) {
        stage.ShowRoot("C:\\x");
        stage.Tree().Nodes.Add({}, {}, word, "own");
        stage.Click(word);
        EXPECT_EQ(stage.Events(), std::string("NodeClick(") + word + ") ChangedFolder");
        EXPECT_EQ(view.FolderPath(), word);
    }
}

// The path

TEST_F(FolderViewPath, SettingThePathSelectsTheNodeWithoutTellingOfAChange) {
    view.SetFolderPath("C:\\x\\b");
    EXPECT_EQ(view.FolderPath(), "C:\\x\\b");
    EXPECT_EQ(stage.Selected(), "C:\\x\\b");
    EXPECT_EQ(stage.Events(), "");
    EXPECT_THAT(stage.Changes(), ElementsAre("Path"));
}

TEST_F(FolderViewPath, SettingThePathFindsTheNodeInAnyCase) {
    view.SetFolderPath("c:\\X\\B");
    EXPECT_EQ(stage.Selected(), "C:\\x\\b");
    EXPECT_EQ(view.FolderPath(), "c:\\X\\B");
}

TEST_F(FolderViewPath, SettingThePathToAFolderThatIsNotInTheTreeStoresItAlone) {
    stage.Select("C:\\x\\b");
    view.SetFolderPath("C:\\x\\a\\s");
    EXPECT_EQ(view.FolderPath(), "C:\\x\\a\\s");
    EXPECT_EQ(stage.Selected(), "C:\\x\\b");
    EXPECT_EQ(Labels(view), "x {a, b}");
    EXPECT_EQ(stage.Events(), "");
    EXPECT_EQ(stage.Messages(), "");
    EXPECT_THAT(stage.Changes(), ElementsAre("Path"));
}

TEST_F(FolderViewPath, SettingThePathToNothingThatExistsStoresIt) {
    view.SetFolderPath("no such thing");
    EXPECT_EQ(view.FolderPath(), "no such thing");
    view.SetFolderPath("");
    EXPECT_EQ(view.FolderPath(), "");
}

TEST_F(FolderViewPath, SettingTheSamePathInAnotherCaseDoesNothing) {
    view.SetFolderPath("c:\\X");
    EXPECT_EQ(view.FolderPath(), "C:\\x");
    EXPECT_EQ(stage.Selected(), "");
    EXPECT_THAT(stage.Changes(), IsEmpty());
}

TEST_F(FolderViewPath, AfterAPathThatWasSetAClickOnItIsNoChange) {
    view.SetFolderPath("C:\\x\\b");
    stage.Click("C:\\x\\b");
    EXPECT_EQ(stage.Events(), "NodeClick(C:\\x\\b)");
    stage.Click("C:\\x");
    EXPECT_EQ(stage.Events(), "NodeClick(C:\\x) ChangedFolder");
}

// The way up

TEST_F(FolderViewPath, GoUpSelectsTheParentAndGivesItsIndex) {
    stage.Expand("C:\\x\\a");
    stage.Click("C:\\x\\a\\s");
    stage.Clear();
    EXPECT_EQ(view.GoUp(), stage.IndexOf("C:\\x\\a"));
    EXPECT_EQ(stage.Selected(), "C:\\x\\a");
    EXPECT_EQ(view.FolderPath(), "C:\\x\\a");
    EXPECT_EQ(stage.Events(), "ChangedFolder");
    EXPECT_EQ(view.GoUp(), 1);
    EXPECT_EQ(view.FolderPath(), "C:\\x");
}

TEST_F(FolderViewPath, GoUpAtTheRootGivesZeroAndChangesNothing) {
    stage.Click("C:\\x");
    stage.Clear();
    EXPECT_EQ(view.GoUp(), 0);
    EXPECT_EQ(stage.Selected(), "C:\\x");
    EXPECT_EQ(view.FolderPath(), "C:\\x");
    EXPECT_EQ(stage.Events(), "");
}

TEST_F(FolderViewPath, GoUpWithoutASelectionGivesZero) {
    EXPECT_EQ(view.GoUp(), 0);
    stage.ShowRoot("");
    EXPECT_EQ(view.GoUp(), 0);
    EXPECT_EQ(stage.Events(), "");
}

TEST_F(FolderViewPath, GoUpToTheCurrentPathTellsNothing) {
    stage.Select("C:\\x\\a");
    EXPECT_EQ(view.GoUp(), 1);
    EXPECT_EQ(stage.Events(), "");
}

TEST_F(FolderViewPath, GoUpReachesSpecialRoots) {
    stage.ShowRoot("My Computer");
    stage.Click("C:\\");
    stage.Clear();
    EXPECT_EQ(view.GoUp(), 1);
    EXPECT_EQ(view.FolderPath(), "My Computer");
    EXPECT_EQ(stage.Events(), "ChangedFolder");
}

TEST_F(FolderViewPath, GoUpToAFolderThatWasDeletedShowsTheMessage) {
    stage.Expand("C:\\x\\a");
    stage.Click("C:\\x\\a\\s");
    stage.Remove("C:\\x\\a");
    stage.Clear();
    (void)view.GoUp();
    EXPECT_EQ(stage.Messages(), Stage::NotAccessible("a"));
    EXPECT_EQ(Labels(view), "x {b}");
    EXPECT_EQ(view.FolderPath(), "C:\\x\\a\\s");
    EXPECT_EQ(stage.Events(), "");
}

TEST_F(FolderViewPath, GoUpNeitherFillsNorMovesTheCursor) {
    stage.Expand("C:\\x\\a");
    stage.Click("C:\\x\\a\\s");
    const int cursor = view.ItemIndex();
    stage.Folder("C:\\x\\a\\new");
    view.GoUp();
    EXPECT_FALSE(stage.Has("C:\\x\\a\\new"));
    EXPECT_EQ(view.ItemIndex(), cursor);
}

}  // namespace
}  // namespace tessel::controls
