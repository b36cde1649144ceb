#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/controls/folderview/FolderViewTestHelp.h"

/// The folders that the application adds to "My Folders", and new folders elsewhere.
namespace tessel::controls {
namespace {

using namespace foldertest;
using frame::Variant;
using testing::ElementsAre;
using testing::IsEmpty;

class FolderViewMyFolders : public testing::Test {
  protected:
    FolderViewMyFolders() {
        for (const char* path : {"C:\\x\\a\\deep", "C:\\x\\b", "C:\\y"}) stage.Folder(path);
        stage.ShowRoot("My Folders");
    }
    Stage stage;
    FolderView& view = stage.View();
};

// The list

TEST_F(FolderViewMyFolders, TheListStartsWithOneEmptyText) {
    const Variant list = view.GetMyFolders();
    const frame::VariantArray& folders = list.ToArray();
    EXPECT_EQ(folders.LowerBound(), 0);
    EXPECT_EQ(folders.UpperBound(), 0);
    EXPECT_EQ(folders.At(0).Type(), frame::VarType::String);
    EXPECT_EQ(folders.At(0), Variant(""));
}

TEST_F(FolderViewMyFolders, AControlOfAnyRootHasTheEmptyList) {
    Stage fresh;
    EXPECT_EQ(MyFolders(fresh.View()), "");
    EXPECT_EQ(fresh.View().GetMyFolders().ToArray().items.size(), 1u);
}

TEST_F(FolderViewMyFolders, EachFolderThatIsAddedComesLast) {
    view.AddNewFolder("C:\\y");
    view.AddNewFolder("C:\\none");
    view.AddNewFolder("C:\\x");
    EXPECT_EQ(MyFolders(view), " | C:\\y | C:\\none | C:\\x");
    EXPECT_EQ(view.GetMyFolders().ToArray().UpperBound(), 3);
}

TEST_F(FolderViewMyFolders, TheListIsACopy) {
    const Variant before = view.GetMyFolders();
    view.AddNewFolder("C:\\y");
    EXPECT_EQ(before.ToArray().items.size(), 1u);
}

TEST_F(FolderViewMyFolders, ABuildEmptiesTheList) {
    view.AddNewFolder("C:\\y");
    view.Show();
    EXPECT_EQ(Labels(view), "My Folders");
    EXPECT_EQ(MyFolders(view), "");
    EXPECT_EQ(view.ItemIndex(), 1);
    EXPECT_EQ(stage.Selected(), "My Folders");
}

TEST_F(FolderViewMyFolders, AnotherRootKeepsTheList) {
    view.AddNewFolder("C:\\y");
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(MyFolders(view), " | C:\\y");
}

TEST_F(FolderViewMyFolders, AHostCanAddItsFoldersAgain) {
    for (const char* path : {"C:\\x", "C:\\y", "C:\\none"}) view.AddNewFolder(path);
    const Variant kept = view.GetMyFolders();
    const std::string labels = Labels(view);
    view.Show();
    const frame::VariantArray& folders = kept.ToArray();
    for (int index = 1; index <= folders.UpperBound(); ++index) {
        view.SetItemIndex(1);
        view.AddNewFolder(folders.At(index).ToText());
    }
    EXPECT_EQ(Labels(view), labels);
    EXPECT_EQ(view.GetMyFolders(), kept);
}

// Adding

TEST_F(FolderViewMyFolders, AFolderThatExistsIsShownWithItsFolders) {
    EXPECT_EQ(view.AddNewFolder("C:\\x"), 2);
    EXPECT_EQ(Labels(view), "My Folders {x {a, b}}");
    EXPECT_EQ(Keys(view), "My Folders | C:\\x | C:\\x\\a | C:\\x\\b");
    EXPECT_EQ(stage.Events(),
              "BeforeAddItem(False) AfterAddItem(2) BeforeAddItem(False) AfterAddItem(3) BeforeAddItem(False) AfterAddItem(4)");
    EXPECT_FALSE(stage.Node("C:\\x")->Checked());
    EXPECT_EQ(stage.Node("C:\\x")->Image().ToText(), "File Folder");
}

TEST_F(FolderViewMyFolders, AFolderThatDoesNotExistIsShownAsUnavailable) {
    EXPECT_EQ(view.AddNewFolder("C:\\none"), 2);
    EXPECT_EQ(Labels(view), "My Folders {C:\\none (Unavailable)}");
    const child::TreeNodeRef node = stage.Node("C:\\none");
    EXPECT_TRUE(node->Checked());
    EXPECT_EQ(node->Image().ToText(), "FolderUnavailable");
    EXPECT_EQ(MyFolders(view), " | C:\\none");
    EXPECT_EQ(stage.Messages(), "");
}

TEST_F(FolderViewMyFolders, EntriesStandByTheirTexts) {
    for (const char* path : {"C:\\y", "C:\\none", "C:\\x"}) view.AddNewFolder(path);
    EXPECT_EQ(Labels(view), "My Folders {C:\\none (Unavailable), x {a, b}, y}");
}

TEST_F(FolderViewMyFolders, AddingLeavesSelectionPathAndCursor) {
    view.AddNewFolder("C:\\x");
    view.AddNewFolder("C:\\none");
    EXPECT_EQ(stage.Selected(), "My Folders");
    EXPECT_EQ(view.FolderPath(), "My Folders");
    EXPECT_EQ(view.ItemIndex(), 1);
}

TEST_F(FolderViewMyFolders, AFolderThatTheEventLeavesOutIsListedAllTheSame) {
    stage.handlers.On(folderview::BeforeAddItem, [](bool& cancel) { cancel = true; });
    EXPECT_EQ(view.AddNewFolder("C:\\x"), 0);
    EXPECT_EQ(Labels(view), "My Folders");
    EXPECT_EQ(MyFolders(view), " | C:\\x");
}

TEST_F(FolderViewMyFolders, TheFilterCountsForEntries) {
    stage.Folder("C:\\h", frame::attributes::hidden);
    view.AddNewFolder("C:\\h");
    EXPECT_EQ(Labels(view), "My Folders");
    EXPECT_EQ(MyFolders(view), " | C:\\h");
}

TEST_F(FolderViewMyFolders, TheSameFolderStandsOnceAndIsListedTwice) {
    view.AddNewFolder("C:\\y");
    view.AddNewFolder("C:\\y");
    EXPECT_EQ(Labels(view), "My Folders {y}");
    EXPECT_EQ(MyFolders(view), " | C:\\y | C:\\y");
}

TEST_F(FolderViewMyFolders, TheSameUnavailableFolderStandsOnceAndIsListedTwice) {
    view.AddNewFolder("C:\\none");
    view.AddNewFolder("C:\\none");
    EXPECT_EQ(Labels(view), "My Folders {C:\\none (Unavailable)}");
    EXPECT_EQ(MyFolders(view), " | C:\\none | C:\\none");
}

TEST_F(FolderViewMyFolders, AnotherFolderOfTheSameNameIsTakenForADouble) {
    stage.Folder("C:\\x\\y");
    view.AddNewFolder("C:\\y");
    view.AddNewFolder("C:\\x\\y");
    EXPECT_EQ(Labels(view), "My Folders {y}");
    EXPECT_FALSE(stage.Has("C:\\x\\y"));
}

TEST_F(FolderViewMyFolders, AFolderThatStandsBelowAnotherEntryAlreadyStandsOnlyThere) {
    view.AddNewFolder("C:\\x");
    view.AddNewFolder("C:\\x\\a");
    EXPECT_EQ(Labels(view), "My Folders {x {a, b}}");
    EXPECT_EQ(MyFolders(view), " | C:\\x | C:\\x\\a");
}

TEST_F(FolderViewMyFolders, ADriveCanBeAnEntry) {
    view.AddNewFolder("C:\\");
    EXPECT_EQ(Labels(view), "My Folders {Local Disk (C:) {Temp, x, y}}");
    EXPECT_TRUE(stage.Has("C:\\"));
}

TEST_F(FolderViewMyFolders, TheCursorDecidesWhereAFolderIsAdded) {
    view.SetItemIndex(0);
    EXPECT_EQ(view.AddNewFolder("C:\\x"), 0);
    EXPECT_EQ(Labels(view), "My Folders");
    EXPECT_EQ(MyFolders(view), "");
}

TEST_F(FolderViewMyFolders, OnMyComputerNothingIsAdded) {
    stage.ShowRoot("My Computer");
    view.SetItemIndex(1);
    stage.Select("My Computer");
    EXPECT_EQ(view.AddNewFolder("new"), 0);
    EXPECT_EQ(view.AddNewFolder(), 0);
    EXPECT_EQ(stage.Events(), "");
    EXPECT_EQ(MyFolders(view), "");
}

// What becomes of entries

TEST_F(FolderViewMyFolders, AnEntryThatHasGoneReadsAsUnavailableAfterTheNextRefresh) {
    view.AddNewFolder("C:\\y");
    stage.Remove("C:\\y");
    EXPECT_EQ(Labels(view), "My Folders {y}");
    view.Refresh();
    EXPECT_EQ(Labels(view), "My Folders {C:\\y (Unavailable)}");
    EXPECT_TRUE(stage.Node("C:\\y")->Checked());
    view.Refresh();
    EXPECT_EQ(Labels(view), "My Folders {C:\\y (Unavailable)}");
    EXPECT_EQ(stage.EventsButAdding(), "");
    EXPECT_EQ(stage.Messages(), "");
}

TEST_F(FolderViewMyFolders, AnEntryThatComesBackHasItsNameAgain) {
    view.AddNewFolder("C:\\none");
    stage.Folder("C:\\none");
    view.Refresh();
    const child::TreeNodeRef node = stage.Node("C:\\none");
    EXPECT_EQ(node->Text(), "none");
    EXPECT_FALSE(node->Checked());
    EXPECT_EQ(node->Image().ToText(), "File Folder");
    EXPECT_EQ(node->SelectedImage().ToText(), "OPEN_File Folder");
}

TEST_F(FolderViewMyFolders, AnEntryThatComesBackHasItsFoldersInOrder) {
    view.AddNewFolder("C:\\none");
    stage.Expand("My Folders");
    for (const char* path : {"C:\\none\\b", "C:\\none\\c", "C:\\none\\a"}) {
        stage.Folder(path);
        view.Refresh();
    }
    EXPECT_EQ(Labels(view), "My Folders {none {a, b, c}}");
    EXPECT_TRUE(stage.Node("C:\\none")->Sorted());
}

TEST_F(FolderViewMyFolders, AnEntryOnADiskThatWasTakenOutComesBackWithTheDisk) {
    stage.Drive("D", {.type = frame::driveTypes::removable});
    stage.Folder("D:\\d\\deep");
    view.AddNewFolder("D:\\d");
    EXPECT_EQ(Labels(view), "My Folders {d {deep}}");
    stage.Drive("D", {.ready = false});
    view.Refresh();
    EXPECT_EQ(Labels(view), "My Folders {D:\\d (Unavailable)}");
    stage.Drive("D", {.ready = true});
    stage.Expand("My Folders");
    view.Refresh();
    EXPECT_EQ(Labels(view), "My Folders {d {deep}}");
}

TEST_F(FolderViewMyFolders, ALabelThatTheHostGaveAnEntryStaysWhileItIsThere) {
    view.AddNewFolder("C:\\y");
    stage.Node("C:\\y")->SetText("own");
    view.Refresh();
    EXPECT_EQ(Labels(view), "My Folders {own}");
    stage.Remove("C:\\y");
    view.Refresh();
    EXPECT_EQ(Labels(view), "My Folders {C:\\y (Unavailable)}");
}

TEST_F(FolderViewMyFolders, FoldersBelowAnEntryAreTakenOutWhenTheyGo) {
    view.AddNewFolder("C:\\x");
    stage.Remove("C:\\x\\a");
    view.Refresh();
    EXPECT_EQ(Labels(view), "My Folders {x {b}}");
}

TEST_F(FolderViewMyFolders, ARefreshKeepsTheList) {
    view.AddNewFolder("C:\\y");
    stage.Remove("C:\\y");
    view.Refresh();
    EXPECT_EQ(MyFolders(view), " | C:\\y");
}

TEST_F(FolderViewMyFolders, ClickingAnUnavailableEntryShowsTheMessageAndTakesItOut) {
    view.AddNewFolder("C:\\none");
    stage.Clear();
    stage.Click("C:\\none");
    EXPECT_EQ(stage.Messages(), Stage::NotAccessible("C:\\none (Unavailable)"));
    EXPECT_EQ(Labels(view), "My Folders");
    EXPECT_EQ(view.FolderPath(), "My Folders");
    EXPECT_EQ(MyFolders(view), " | C:\\none");
}

TEST_F(FolderViewMyFolders, ExpandingAnUnavailableEntryShowsTheMessageAndTakesItOut) {
    view.AddNewFolder("C:\\none");
    stage.Clear();
    stage.Expand("C:\\none");
    EXPECT_EQ(stage.Messages(), Stage::NotAccessible("C:\\none (Unavailable)"));
    EXPECT_EQ(Labels(view), "My Folders");
}

TEST_F(FolderViewMyFolders, ClickingAnEntryGoesThere) {
    view.AddNewFolder("C:\\y");
    stage.Clear();
    stage.Click("C:\\y");
    EXPECT_EQ(view.FolderPath(), "C:\\y");
    EXPECT_EQ(stage.Events(), "NodeClick(C:\\y) ChangedFolder");
    EXPECT_EQ(view.GoUp(), 1);
    EXPECT_EQ(view.FolderPath(), "My Folders");
}

TEST_F(FolderViewMyFolders, ClickingMyFoldersThrowsOutEntriesThatAreNotThere) {
    view.AddNewFolder("C:\\none");
    view.AddNewFolder("C:\\y");
    stage.Click("My Folders");
    EXPECT_EQ(Labels(view), "My Folders {y}");
    EXPECT_EQ(stage.Messages(), "");
}

TEST_F(FolderViewMyFolders, ClickingMyComputerThrowsOutDrivesThatAreNotReady) {
    stage.Drive("A", {.type = frame::driveTypes::removable, .ready = false});
    stage.ShowRoot("My Computer");
    stage.Click("My Computer");
    EXPECT_EQ(Labels(view), "My Computer {Local Disk (C:) {Temp, x, y}}");
}

// New folders elsewhere

TEST_F(FolderViewMyFolders, ElsewhereAFolderIsMadeInTheSelectedOne) {
    stage.ShowRoot("C:\\x");
    view.SetItemIndex(stage.IndexOf("C:\\x\\b"));
    stage.Select("C:\\x\\a");
    EXPECT_EQ(view.AddNewFolder("new"), 4);
    EXPECT_TRUE(stage.Disk().FolderExists("C:\\x\\a\\new"));
    EXPECT_EQ(Labels(view), "x {a {new}, b}");
    EXPECT_EQ(stage.Events(), "BeforeAddItem(False) AfterAddItem(4) AfterAddItem(4)");
    EXPECT_EQ(stage.Selected(), "C:\\x\\a");
    EXPECT_FALSE(stage.Tree().Editing());
}

TEST_F(FolderViewMyFolders, WithoutANameTheNewFolderIsSelectedForItsLabelEdit) {
    stage.ShowRoot("C:\\x");
    view.SetItemIndex(1);
    stage.Select("C:\\x\\b");
    EXPECT_EQ(view.AddNewFolder(), 4);
    EXPECT_EQ(stage.Selected(), "C:\\x\\b\\New Folder");
    EXPECT_TRUE(stage.Disk().FolderExists("C:\\x\\b\\New Folder"));
    view.AddNewFolder("");
    EXPECT_TRUE(stage.Disk().FolderExists("C:\\x\\b\\New Folder\\New Folder"));
}

TEST_F(FolderViewMyFolders, AFolderThatCannotBeMadeTellsNothing) {
    stage.ShowRoot("C:\\x");
    view.SetItemIndex(1);
    stage.Select("C:\\x");
    EXPECT_EQ(view.AddNewFolder("a"), 0);
    EXPECT_EQ(view.AddNewFolder("a?b"), 0);
    EXPECT_EQ(stage.Events(), "");
    EXPECT_EQ(Labels(view), "x {a, b}");
    EXPECT_EQ(stage.Messages(), "");
}

TEST_F(FolderViewMyFolders, WithoutASelectionNoFolderIsMade) {
    stage.ShowRoot("C:\\x");
    view.SetItemIndex(1);
    EXPECT_EQ(view.AddNewFolder("new"), 0);
    EXPECT_FALSE(stage.Disk().FolderExists("C:\\x\\new"));
    stage.Select("C:\\x");
    stage.Remove("C:\\x");
    EXPECT_EQ(view.AddNewFolder("new"), 0);
    EXPECT_EQ(stage.Events(), "");
}

TEST_F(FolderViewMyFolders, ADriveMayHoldNewFolders) {
    stage.ShowRoot("My Computer");
    view.SetItemIndex(stage.IndexOf("C:\\"));
    stage.Select("C:\\");
    EXPECT_NE(view.AddNewFolder("new"), 0);
    EXPECT_TRUE(stage.Has("C:\\new"));
}

}  // namespace
}  // namespace tessel::controls
