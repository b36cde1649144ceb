#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/controls/folderview/FolderViewTestHelp.h"

/// How the tree is built, and which folders it takes.
namespace tessel::controls {
namespace {

using namespace foldertest;
using frame::Variant;
using testing::ElementsAre;
using testing::IsEmpty;
namespace attributes = frame::attributes;

class FolderViewFill : public testing::Test {
  protected:
    Stage stage;
    FolderView& view = stage.View();
};

// Building

TEST_F(FolderViewFill, ARealRootIsFilledOneLevelDeep) {
    for (const char* path : {"C:\\x\\a\\deep", "C:\\x\\b"}) stage.Folder(path);
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(Labels(view), "x {a, b}");
    EXPECT_EQ(Keys(view), "C:\\x | C:\\x\\a | C:\\x\\b");
    EXPECT_FALSE(stage.Node("C:\\x")->Expanded());
    EXPECT_EQ(stage.Selected(), "");
}

TEST_F(FolderViewFill, FilesAreNoNodes) {
    stage.Folder("C:\\x\\a");
    stage.Disk().SetFile("C:\\x\\file", {}).Check();
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(Labels(view), "x {a}");
}

TEST_F(FolderViewFill, ABuildTellsItsStepsInOrder) {
    for (const char* path : {"C:\\x\\a", "C:\\x\\b"}) stage.Folder(path);
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(stage.Events(),
              "BeforePaint(False) BeforeAddItem(False) AfterAddItem(1) BeforeAddItem(False) AfterAddItem(2) BeforeAddItem(False) "
              "AfterAddItem(3) AfterPaint ChangedFolder");
    EXPECT_THAT(stage.Changes(), ElementsAre("PathRoot"));
}

TEST_F(FolderViewFill, WhatEachStepOfABuildSees) {
    stage.Folder("C:\\x\\a");
    stage.ShowRoot("C:\\Temp");
    std::vector<std::string> seen;
    const auto note = [&](const char* step) {
        seen.push_back(std::string(step) + ": " + Labels(view) + " / " + view.PathRoot() + " / " + view.FolderPath() + " / " +
                       std::to_string(stage.Changes().size()));
    };
    stage.handlers.On(folderview::BeforePaint, [&](bool&) { note("BeforePaint"); });
    stage.handlers.On(folderview::BeforeAddItem, [&](bool&) { note("BeforeAddItem"); });
    stage.handlers.On(folderview::AfterAddItem, [&](std::int32_t&) { note("AfterAddItem"); });
    stage.handlers.On(folderview::AfterPaint, [&] { note("AfterPaint"); });
    stage.handlers.On(folderview::ChangedFolder, [&] { note("ChangedFolder"); });
    view.SetPathRoot("C:\\x");
    EXPECT_THAT(seen, ElementsAre("BeforePaint: Temp / C:\\x / C:\\Temp / 0", "BeforeAddItem:  / C:\\x / C:\\Temp / 0",
                                  "AfterAddItem: x / C:\\x / C:\\Temp / 0", "BeforeAddItem: x / C:\\x / C:\\Temp / 0",
                                  "AfterAddItem: x {a} / C:\\x / C:\\Temp / 0", "AfterPaint: x {a} / C:\\x / C:\\x / 0",
                                  "ChangedFolder: x {a} / C:\\x / C:\\x / 0"));
}

TEST_F(FolderViewFill, ANodeIsCompleteWhenItsAddingIsTold) {
    stage.Folder("C:\\x\\a");
    std::vector<std::string> seen;
    stage.handlers.On(folderview::AfterAddItem, [&](std::int32_t& index) {
        const child::TreeNodeRef node = stage.Tree().Nodes.Item(index);
        seen.push_back(node->Key() + "/" + node->Text() + "/" + node->Image().ToText() + "/" + node->SelectedImage().ToText() +
                       (node->Sorted() ? "/sorted" : ""));
    });
    view.SetPathRoot("C:\\x");
    EXPECT_THAT(seen, ElementsAre("C:\\x/x/File Folder/OPEN_File Folder/sorted", "C:\\x\\a/a/File Folder/OPEN_File Folder/sorted"));
}

TEST_F(FolderViewFill, EachShowBuildsTheTreeAnew) {
    stage.Folder("C:\\x\\a");
    stage.ShowRoot("C:\\x");
    stage.Folder("C:\\x\\b");
    stage.TheSite().Hide();
    stage.TheSite().Show();
    EXPECT_EQ(Labels(view), "x {a, b}");
    EXPECT_EQ(stage.EventsButAdding(), "BeforePaint(False) AfterPaint ChangedFolder");
}

TEST_F(FolderViewFill, ABuildClearsTheOldTree) {
    stage.Folder("C:\\x\\a");
    stage.Folder("C:\\y\\b");
    stage.ShowRoot("C:\\x");
    stage.ShowRoot("C:\\y");
    EXPECT_EQ(Keys(view), "C:\\y | C:\\y\\b");
}

TEST_F(FolderViewFill, ABuildThatIsCancelledLeavesTheOldTreeAndThePath) {
    stage.Folder("C:\\x\\a");
    stage.Folder("C:\\y");
    stage.ShowRoot("C:\\x");
    stage.handlers.On(folderview::BeforePaint, [](bool& cancel) { cancel = true; });
    view.SetPathRoot("C:\\y");
    EXPECT_EQ(Labels(view), "x {a}");
    EXPECT_EQ(view.FolderPath(), "C:\\x");
    EXPECT_EQ(view.PathRoot(), "C:\\y");
    EXPECT_EQ(stage.Events(), "BeforePaint(False)");
    EXPECT_THAT(stage.Changes(), ElementsAre("PathRoot"));
}

TEST_F(FolderViewFill, AnEmptyRootGivesAnEmptyTreeAndIsToldAllTheSame) {
    stage.ShowRoot("C:\\Temp");
    view.SetPathRoot("");
    EXPECT_EQ(view.ItemCount(), 0);
    EXPECT_EQ(view.FolderPath(), "");
    EXPECT_EQ(stage.Events(), "BeforePaint(False) AfterPaint ChangedFolder");
}

TEST_F(FolderViewFill, ARootThatNamesNoFolderGivesAnEmptyTreeWithoutAMessage) {
    stage.Disk().SetFile("C:\\file", {}).Check();
    for (const char* path : {"C:\\none", "Q:\\", "nonsense", "C:\\file", "\\\\"}) {
        view.SetPathRoot(path);
        EXPECT_EQ(view.ItemCount(), 0) << path;
        EXPECT_EQ(view.FolderPath(), path);
        EXPECT_EQ(stage.Messages(), "");
        EXPECT_EQ(stage.Events(), "BeforePaint(False) AfterPaint ChangedFolder") << path;
    }
}

TEST_F(FolderViewFill, TheSameRootAgainBuildsAgain) {
    stage.ShowRoot("C:\\Temp");
    view.SetPathRoot("C:\\Temp");
    EXPECT_EQ(stage.EventsButAdding(), "BeforePaint(False) AfterPaint ChangedFolder");
}

TEST_F(FolderViewFill, ADriveCanBeTheRoot) {
    stage.Folder("C:\\a");
    stage.ShowRoot("C:\\");
    EXPECT_EQ(Labels(view), "Local Disk (C:) {a, Temp}");
    EXPECT_TRUE(stage.Has("C:\\"));
    EXPECT_TRUE(stage.Has("C:\\a"));
}

TEST_F(FolderViewFill, ADriveAsTheRootShowsAnImage) {
    stage.ShowRoot("C:\\");
    EXPECT_NE(stage.Node("C:\\")->Image().ToText(), "");
}

TEST_F(FolderViewFill, ARootIsFoundInAnyCase) {
    stage.Folder("C:\\x\\a");
    stage.ShowRoot("c:\\X");
    EXPECT_EQ(view.ItemCount(), 2);
    EXPECT_TRUE(stage.Has("C:\\x\\a"));
    EXPECT_EQ(view.FolderPath(), "c:\\X");
}

TEST_F(FolderViewFill, ASelectionGoesWithTheOldTree) {
    stage.Folder("C:\\x\\a");
    stage.ShowRoot("C:\\x");
    stage.Select("C:\\x\\a");
    view.Show();
    EXPECT_EQ(stage.Selected(), "");
    EXPECT_EQ(view.SelectedItem(), 0);
}

// Which folders

TEST_F(FolderViewFill, HiddenAndSystemFoldersAreLeftOutUnlessAllowed) {
    stage.Folder("C:\\x\\hidden", attributes::hidden);
    stage.Folder("C:\\x\\system", attributes::system);
    stage.Folder("C:\\x\\both", attributes::hidden | attributes::system);
    stage.Folder("C:\\x\\locked", attributes::readOnly);
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(Labels(view), "x {locked}");
    view.SetAllowHiddenFolders(true);
    view.Show();
    EXPECT_EQ(Labels(view), "x {hidden, locked}");
    view.SetAllowSystemFolders(true);
    view.Show();
    EXPECT_EQ(Labels(view), "x {both, hidden, locked, system}");
    view.SetAllowHiddenFolders(false);
    view.Show();
    EXPECT_EQ(Labels(view), "x {locked, system}");
}

TEST_F(FolderViewFill, AFolderThatTheFilterLeavesOutIsNotAskedFor) {
    stage.Folder("C:\\x\\hidden", attributes::hidden);
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(stage.Events(), "BeforePaint(False) BeforeAddItem(False) AfterAddItem(1) AfterPaint ChangedFolder");
}

TEST_F(FolderViewFill, ARootOfADriveIsShownWhateverItsAttributes) {
    stage.Folder("C:\\", attributes::hidden | attributes::system);
    stage.ShowRoot("C:\\");
    EXPECT_EQ(Labels(view), "Local Disk (C:) {Temp}");
    EXPECT_EQ(stage.Node("C:\\")->Image().ToText().find("HIDDEN_"), std::string::npos);
}

TEST_F(FolderViewFill, AHiddenFolderAsTheRootIsNotShown) {
    stage.Folder("C:\\x", attributes::hidden);
    stage.Folder("C:\\x\\a");
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(view.ItemCount(), 0);
    EXPECT_EQ(view.FolderPath(), "C:\\x");
}

TEST_F(FolderViewFill, LeavingAFolderOutByTheEventLeavesTheOthers) {
    for (const char* path : {"C:\\x\\a", "C:\\x\\b", "C:\\x\\c"}) stage.Folder(path);
    int asked = 0;
    stage.handlers.On(folderview::BeforeAddItem, [&](bool& cancel) { cancel = ++asked == 3; });
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(Labels(view), "x {a, c}");
    EXPECT_EQ(stage.Events(),
              "BeforePaint(False) BeforeAddItem(False) AfterAddItem(1) BeforeAddItem(False) AfterAddItem(2) BeforeAddItem(False) "
              "BeforeAddItem(False) AfterAddItem(3) AfterPaint ChangedFolder");
}

TEST_F(FolderViewFill, LeavingTheRootOutByTheEventLeavesAnEmptyTree) {
    stage.Folder("C:\\x\\a");
    int asked = 0;
    stage.handlers.On(folderview::BeforeAddItem, [&](bool& cancel) { cancel = ++asked == 1; });
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(view.ItemCount(), 0);
}

TEST_F(FolderViewFill, AFolderThatWasLeftOutIsAskedForAtTheNextFill) {
    stage.Folder("C:\\x\\a");
    stage.handlers.On(folderview::BeforeAddItem, [&](bool& cancel) { cancel = view.ItemCount() > 0; });
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(Labels(view), "x");
    stage.Click("C:\\x");
    EXPECT_EQ(stage.Events(), "NodeClick(C:\\x) BeforeAddItem(False)");
}

TEST_F(FolderViewFill, NobodyWhoListensChangesNothing) {
    Stage unheard({.heard = false});
    for (const char* path : {"C:\\x\\a", "C:\\x\\b"}) unheard.Folder(path);
    unheard.View().SetPathRoot("C:\\x");
    EXPECT_EQ(Labels(unheard.View()), "x {a, b}");
    EXPECT_EQ(unheard.View().FolderPath(), "C:\\x");
}

// Order and doubles

TEST_F(FolderViewFill, SiblingsStandByTheirTexts) {
    for (const char* path : {"C:\\x\\b", "C:\\x\\C", "C:\\x\\a"}) stage.Folder(path);
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(Labels(view), "x {a, b, C}");
    stage.Folder("C:\\x\\aa");
    stage.Click("C:\\x");
    EXPECT_EQ(Labels(view), "x {a, aa, b, C}");
    EXPECT_EQ(Keys(view), "C:\\x | C:\\x\\a | C:\\x\\b | C:\\x\\C | C:\\x\\aa");
}

TEST_F(FolderViewFill, FillingAgainAddsNothingTwice) {
    for (const char* path : {"C:\\x\\a", "C:\\x\\b"}) stage.Folder(path);
    stage.ShowRoot("C:\\x");
    for (int times = 0; times < 3; ++times) stage.Click("C:\\x");
    EXPECT_EQ(Labels(view), "x {a, b}");
    EXPECT_EQ(stage.Events(), "NodeClick(C:\\x) NodeClick(C:\\x) NodeClick(C:\\x)");
}

TEST_F(FolderViewFill, DoublesAreToldByTheLabelWithoutRegardToCase) {
    for (const char* path : {"C:\\x\\a", "C:\\x\\b"}) stage.Folder(path);
    stage.ShowRoot("C:\\x");
    stage.Node("C:\\x\\a")->SetText("NEW");
    stage.Folder("C:\\x\\new");
    stage.Click("C:\\x");
    EXPECT_FALSE(stage.Has("C:\\x\\new"));
    view.Refresh();
    EXPECT_FALSE(stage.Has("C:\\x\\new"));
    stage.Node("C:\\x\\a")->SetText("a");
    stage.Click("C:\\x");
    EXPECT_TRUE(stage.Has("C:\\x\\new"));
}

TEST_F(FolderViewFill, AFolderWithAnotherLabelIsOfferedAgainButStandsOnce) {
    stage.Folder("C:\\x\\a");
    stage.ShowRoot("C:\\x");
    stage.Node("C:\\x\\a")->SetText("Label");
    stage.Click("C:\\x");
    EXPECT_EQ(Labels(view), "x {Label}");
    EXPECT_THAT(stage.Events(), testing::HasSubstr("BeforeAddItem(False)"));
}

TEST_F(FolderViewFill, AFillThrowsOutWhatHasGone) {
    for (const char* path : {"C:\\x\\a", "C:\\x\\b\\deep", "C:\\x\\c"}) stage.Folder(path);
    stage.ShowRoot("C:\\x");
    stage.Click("C:\\x\\b");
    for (const char* path : {"C:\\x\\a", "C:\\x\\b", "C:\\x\\c"}) stage.Remove(path);
    stage.Folder("C:\\x\\d");
    stage.Click("C:\\x");
    EXPECT_EQ(Labels(view), "x {d}");
}

TEST_F(FolderViewFill, AFillThrowsOutWhatTheHostHasAddedWithoutAFolder) {
    stage.Folder("C:\\x\\a");
    stage.ShowRoot("C:\\x");
    stage.Tree().Nodes.Add(Variant("C:\\x"), child::TreeRelationshipConstants::Child, "own", "own");
    stage.Tree().Nodes.Add(Variant("C:\\x"), child::TreeRelationshipConstants::Child, "C:\\Temp", "elsewhere");
    stage.Click("C:\\x");
    EXPECT_EQ(Labels(view), "x {a, elsewhere}");
}

TEST_F(FolderViewFill, AFolderThatTheFilterNoLongerAllowsStays) {
    stage.Folder("C:\\x\\h", attributes::hidden);
    view.SetAllowHiddenFolders(true);
    stage.ShowRoot("C:\\x");
    view.SetAllowHiddenFolders(false);
    stage.Click("C:\\x");
    view.Refresh();
    EXPECT_EQ(Labels(view), "x {h}");
}

// Special roots

TEST_F(FolderViewFill, MyComputerShowsTheDrivesAndTheirFolders) {
    stage.Drive("D", {.volume = "Work"});
    stage.Folder("D:\\d\\deep");
    view.SetPathRoot("My Computer");
    EXPECT_EQ(Labels(view), "My Computer {Local Disk (C:) {Temp}, Work (D:) {d}}");
    EXPECT_EQ(Keys(view), "My Computer | C:\\ | C:\\Temp | D:\\ | D:\\d");
    EXPECT_EQ(stage.Events(),
              "BeforePaint(False) BeforeAddItem(False) AfterAddItem(2) BeforeAddItem(False) AfterAddItem(3) BeforeAddItem(False) "
              "AfterAddItem(4) BeforeAddItem(False) AfterAddItem(5) AfterPaint ChangedFolder");
    EXPECT_EQ(view.FolderPath(), "My Computer");
    EXPECT_TRUE(stage.Node("My Computer")->Sorted());
}

TEST_F(FolderViewFill, ADriveThatIsLeftOutIsNotRead) {
    stage.Drive("D", {.volume = "Work"});
    stage.Folder("D:\\d");
    stage.handlers.On(folderview::BeforeAddItem, [&](bool& cancel) { cancel = view.ItemCount() == 1; });
    stage.watched.listed.clear();
    view.SetPathRoot("My Computer");
    EXPECT_EQ(view.ItemCount(), 1);
    EXPECT_THAT(stage.watched.listed, IsEmpty());
    EXPECT_EQ(stage.Events(), "BeforePaint(False) BeforeAddItem(False) BeforeAddItem(False) AfterPaint ChangedFolder");
}

TEST_F(FolderViewFill, ADriveThatIsNotReadyStandsWithoutFolders) {
    stage.Drive("A", {.type = frame::driveTypes::removable, .ready = false});
    stage.ShowRoot("My Computer");
    EXPECT_EQ(Labels(view), "My Computer {(A:), Local Disk (C:) {Temp}}");
}

TEST_F(FolderViewFill, MyDocumentsIsKeyedByItsPath) {
    stage.Folder("C:\\My Documents\\letters\\deep");
    view.SetPathRoot("My Documents");
    EXPECT_EQ(Labels(view), "My Documents {letters}");
    EXPECT_EQ(Keys(view), "C:\\My Documents | C:\\My Documents\\letters");
    EXPECT_EQ(view.FolderPath(), "My Documents");
    EXPECT_EQ(stage.Events(), "BeforePaint(False) BeforeAddItem(False) AfterAddItem(2) AfterPaint ChangedFolder");
    EXPECT_TRUE(stage.Node("C:\\My Documents")->Sorted());
}

TEST_F(FolderViewFill, MyDocumentsIsAskedForOnceWhenTheControlIsMade) {
    stage.Disk().SetSpecialFolder(5, "C:\\Elsewhere");
    stage.Folder("C:\\My Documents\\letters");
    stage.Folder("C:\\Elsewhere\\others");
    stage.ShowRoot("My Documents");
    EXPECT_EQ(Labels(view), "My Documents {letters}");
}

TEST_F(FolderViewFill, MyDocumentsWithoutAFolderStandsAlone) {
    stage.ShowRoot("My Documents");
    EXPECT_EQ(Labels(view), "My Documents");
    EXPECT_EQ(Keys(view), "C:\\My Documents");
    EXPECT_EQ(stage.Messages(), "");
}

TEST_F(FolderViewFill, MyFoldersIsSelectedAndUnderTheCursor) {
    view.SetPathRoot("My Folders");
    EXPECT_EQ(Labels(view), "My Folders");
    EXPECT_EQ(Keys(view), "My Folders");
    EXPECT_EQ(stage.Selected(), "My Folders");
    EXPECT_EQ(view.ItemIndex(), 1);
    EXPECT_EQ(view.FolderPath(), "My Folders");
    EXPECT_EQ(stage.Events(), "BeforePaint(False) AfterPaint ChangedFolder");
    EXPECT_TRUE(stage.Node("My Folders")->Sorted());
}

TEST_F(FolderViewFill, SpecialRootsAreKnownInAnyCase) {
    stage.Folder("C:\\My Documents\\letters");
    stage.ShowRoot("my computer");
    EXPECT_EQ(Labels(view), "My Computer {Local Disk (C:) {My Documents, Temp}}");
    EXPECT_EQ(view.FolderPath(), "my computer");
    stage.ShowRoot("MY DOCUMENTS");
    EXPECT_EQ(Labels(view), "My Documents {letters}");
    stage.ShowRoot("mY fOLDERS");
    EXPECT_EQ(Labels(view), "My Folders");
    EXPECT_EQ(Keys(view), "My Folders");
}

TEST_F(FolderViewFill, AWordWithBlanksAroundItIsAPath) {
    view.SetPathRoot(" My Computer");
    EXPECT_EQ(view.ItemCount(), 0);
}

// Design time

class FolderViewDesign : public testing::Test {
  protected:
    Stage stage{Stage::Options{.designTime = true}};
    FolderView& view = stage.View();
};

TEST_F(FolderViewDesign, TheTreeShowsItsRootAsText) {
    for (const char* root : {"C:\\Temp", "My Folders", "C:\\none"}) {
        view.SetPathRoot(root);
        EXPECT_EQ(Labels(view), root);
        EXPECT_EQ(stage.Tree().Nodes.Item(1)->Image(), Variant("My Computer"));
    }
}

TEST_F(FolderViewDesign, WithoutARootTheTreeIsEmpty) {
    view.SetPathRoot("C:\\Temp");
    view.SetPathRoot("");
    EXPECT_EQ(view.ItemCount(), 0);
}

TEST_F(FolderViewDesign, ABuildTouchesNothingOnTheDisk) {
    for (const char* root : {"C:\\Temp", "My Computer", "My Documents", "My Folders"}) {
        stage.watched.calls = 0;
        view.SetPathRoot(root);
        view.Show();
        EXPECT_EQ(stage.watched.calls, 0) << root;
    }
    EXPECT_THAT(stage.Asked(), IsEmpty());
}

TEST_F(FolderViewDesign, ABuildIsToldAndCanBeCancelled) {
    view.SetPathRoot("C:\\Temp");
    EXPECT_EQ(stage.Events(), "BeforePaint(False) AfterPaint ChangedFolder");
    EXPECT_EQ(view.FolderPath(), "C:\\Temp");
    stage.handlers.On(folderview::BeforePaint, [](bool& cancel) { cancel = true; });
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(Labels(view), "C:\\Temp");
}

TEST_F(FolderViewDesign, ATickDoesNothing) {
    view.SetPathRoot("C:\\Temp");
    stage.watched.calls = 0;
    stage.Tick();
    EXPECT_EQ(Labels(view), "C:\\Temp");
    EXPECT_EQ(stage.watched.calls, 0);
    stage.SetUserMode(true);
    stage.Tick();
    EXPECT_NE(stage.watched.calls, 0);
}

}  // namespace
}  // namespace tessel::controls
