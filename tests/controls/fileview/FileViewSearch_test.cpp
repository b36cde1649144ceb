#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

#include "tests/controls/fileview/FileViewTestHelp.h"

/// Searching.
namespace tessel::controls {
namespace {

using namespace fileviewtest;
using frame::Variant;
using frame::VariantArray;

constexpr std::int32_t hidden = frame::attributes::hidden, systemFile = frame::attributes::system;

class FileViewSearch : public testing::Test {
  protected:
    FileViewSearch() {
        stage.File("C:\\x\\a.txt", 1);
        stage.File("C:\\x\\b.doc", 2);
        stage.File("C:\\x\\one\\c.txt", 4);
        stage.File("C:\\x\\one\\deep\\d.txt", 8);
        stage.File("C:\\x\\two.txt\\e.txt", 16);
        stage.turns = 0;
    }
    Stage stage;
    FileView& view = stage.View();
};

TEST_F(FileViewSearch, DeeperMatchesComeBeforeTheSiblingsOfTheirFolder) {
    EXPECT_TRUE(view.Search("*.txt", "C:\\x", true).IsEmpty());
    EXPECT_EQ(Rows(view), "a.txt | c.txt | d.txt | e.txt");
    EXPECT_EQ(Rows(view, 6), "C:\\x | C:\\x\\one | C:\\x\\one\\deep | C:\\x\\two.txt");
    EXPECT_EQ(
        stage.Events(),
        "BeforeAddItem(False, C:\\x\\a.txt) AfterAddItem(1) BeforeAddItem(False, C:\\x\\one\\c.txt) AfterAddItem(2) "
        "BeforeAddItem(False, C:\\x\\one\\deep\\d.txt) AfterAddItem(3) BeforeAddItem(False, C:\\x\\two.txt\\e.txt) AfterAddItem(4) "
        "AfterPaint");
    EXPECT_EQ(view.TotalSize(), Variant(1 + 4 + 8 + 16));
    EXPECT_EQ(view.ItemIndex(), 1);
}

TEST_F(FileViewSearch, AnEmptyPatternWithoutSubdirectoriesListsTheFilesOfTheRoot) {
    view.Search("", "C:\\x", false);
    EXPECT_EQ(Rows(view), "a.txt | b.doc");
}

TEST_F(FileViewSearch, FoldersAreNeverListedAndNotOffered) {
    view.Search("two*", "C:\\x", true);
    EXPECT_EQ(Rows(view), "");
    EXPECT_EQ(stage.Events(), "AfterPaint");
    EXPECT_EQ(Message(view), "There are no items to show in this folder.");
}

TEST_F(FileViewSearch, TheMessageLoopHasATurnAfterEachMatchAndEachFolder) {
    view.Search("*.txt", "C:\\x", true);
    // Four matches, the folder two.txt, and the ends of four folders.
    EXPECT_EQ(stage.turns, 4 + 1 + 4);
    stage.turns = 0;
    view.Search("*.txt", "C:\\x", false);
    EXPECT_EQ(stage.turns, 1 + 1 + 1);
    stage.turns = 0;
    view.Search("nothing", "C:\\missing", true);
    EXPECT_EQ(stage.turns, 1);
}

TEST_F(FileViewSearch, HiddenAndSystemFilesAreLeftOutAndSuchFoldersNotEntered) {
    stage.File("C:\\x\\h.txt", 32, 0, 0, hidden);
    stage.File("C:\\x\\s.txt", 32, 0, 0, systemFile);
    stage.Folder("C:\\x\\one", hidden);
    view.Search("*.txt", "C:\\x", true);
    EXPECT_EQ(Rows(view), "a.txt | e.txt");
    EXPECT_EQ(view.TotalSize(), Variant(17));
    view.SetAllowHiddenFiles(true);
    view.SetAllowSystemFiles(true);
    view.Search("*.txt", "C:\\x", true);
    EXPECT_EQ(Rows(view), "a.txt | h.txt | s.txt | c.txt | d.txt | e.txt");
}

TEST_F(FileViewSearch, PathIsEmptyAndTheRootStays) {
    stage.ShowPath("C:\\x");
    view.Search("*.txt", "C:\\x", true);
    EXPECT_EQ(view.FolderPath(), "");
    EXPECT_EQ(view.PathRoot(), "C:\\x");
    view.SetItemIndex(2);
    EXPECT_EQ(view.ItemPath(), "c.txt");
    EXPECT_EQ(SubItem(view, 2, 6), "C:\\x\\one");
    EXPECT_TRUE(stage.Changes().back() == "ItemIndex");
}

TEST_F(FileViewSearch, ResultsAreNotRefreshed) {
    stage.ShowPath("C:\\x");
    view.Search("*.txt", "C:\\x", true);
    stage.Remove("C:\\x\\a.txt");
    stage.Events();
    stage.Tick();
    view.Refresh();
    EXPECT_EQ(stage.Events(), "");
    EXPECT_EQ(view.ItemCount(), 4);
}

TEST_F(FileViewSearch, CancellingAFileEndsTheSearchAfterItsFolder) {
    stage.File("C:\\x\\z.txt", 32);
    stage.handlers.On(fileview::BeforeAddItem, [](bool& cancel, std::string& path) { cancel = path == "C:\\x\\a.txt"; });
    view.Search("*.txt", "C:\\x", true);
    EXPECT_EQ(Rows(view), "z.txt");
    EXPECT_EQ(stage.Events(), "BeforeAddItem(False, C:\\x\\a.txt) BeforeAddItem(False, C:\\x\\z.txt) AfterAddItem(1) AfterPaint");
    EXPECT_EQ(view.TotalSize(), Variant(1 + 32));
}

TEST_F(FileViewSearch, CancellingDeepInTheTreeEntersNoFurtherFolder) {
    stage.File("C:\\x\\one\\f.txt");
    stage.handlers.On(fileview::BeforeAddItem, [](bool& cancel, std::string& path) { cancel = path == "C:\\x\\one\\c.txt"; });
    view.Search("*.txt", "C:\\x", true);
    EXPECT_EQ(Rows(view), "a.txt | f.txt");
    view.Search("e*", "C:\\x", true);
    EXPECT_EQ(Rows(view), "e.txt");
}

TEST_F(FileViewSearch, CancellingOnOneDriveEntersNoOther) {
    stage.File("D:\\x\\g.txt");
    stage.File("D:\\h.txt");
    stage.handlers.On(fileview::BeforeAddItem, [](bool& cancel, std::string& path) { cancel = path == "C:\\x\\a.txt"; });
    view.Search("*.txt", "My Computer", true);
    EXPECT_EQ(stage.Events(), "BeforeAddItem(False, C:\\x\\a.txt) AfterPaint");
}

TEST_F(FileViewSearch, NothingIsRefreshedDuringASearch) {
    stage.onTurn = [&] {
        view.SetFolderPath("C:\\x");
        stage.Tick();
    };
    view.Search("*.txt", "C:\\x", true);
    EXPECT_EQ(stage.EventsOfPaints(), "AfterPaint");
}

TEST_F(FileViewSearch, MyDocumentsIsSearchedInTheUsersFolder) {
    stage.File("C:\\My Documents\\letter.doc");
    view.Search("*.doc", "MY DOCUMENTS", true);
    EXPECT_EQ(Rows(view), "letter.doc");
}

TEST_F(FileViewSearch, MyComputerIsSearchedDriveByDrive) {
    stage.File("D:\\x\\g.txt");
    stage.Disk().SetDrive("A", {.ready = false}).Check();
    view.Search("*.txt", "my computer", true);
    EXPECT_EQ(Rows(view), "a.txt | c.txt | d.txt | e.txt | g.txt");
    EXPECT_EQ(SubItem(view, 5, 6), "D:\\x");
}

TEST_F(FileViewSearch, MyFoldersAreSearchedAsTheLastListingLeftThem) {
    view.Search("*.txt", "My Folders", true);
    EXPECT_EQ(Rows(view), "");
    EXPECT_EQ(stage.Events(), "AfterPaint");
    stage.handlers.On(fileview::NeedMyFolders, [](Variant& folders) {
        folders = VariantArray(1, {"C:\\x\\one", "C:\\gone", "C:\\x\\two.txt"});
    });
    stage.ShowPath("My Folders");
    view.Search("*.txt", "my folders", true);
    EXPECT_EQ(Rows(view), "c.txt | d.txt | e.txt");
    EXPECT_EQ(stage.EventsOfPaints(), "AfterPaint");
}

TEST_F(FileViewSearch, AFolderThatCannotBeReadIsPassedOver) {
    stage.Disk().SetFolder("C:\\x\\one", {.unreadable = true}).Check();
    view.Search("*.txt", "C:\\x", true);
    EXPECT_EQ(Rows(view), "a.txt | e.txt");
}

TEST_F(FileViewSearch, AVeryDeepTreeIsSearchedToItsEnd) {
    std::string folder = "C:\\deep";
    for (int level = 0; level < 2'000; ++level) folder += "\\f";
    stage.File(folder + "\\last.txt");
    view.Search("last*", "C:\\deep", true);
    EXPECT_EQ(Rows(view, 6), folder);
}

TEST_F(FileViewSearch, ASearchInsideASearchIsInterleaved) {
    bool once = true;
    stage.handlers.On(fileview::AfterAddItem, [&](std::int32_t&) {
        if (std::exchange(once, false)) view.Search("b*", "C:\\x", false);
    });
    view.Search("*.txt", "C:\\x", true);
    EXPECT_EQ(Rows(view), "b.doc | c.txt | d.txt | e.txt");
    EXPECT_EQ(stage.EventsOfPaints(), "AfterPaint AfterPaint");
}

TEST_F(FileViewSearch, GoUpAfterASearchAimsAtMyFolders) {
    stage.ShowPath("C:\\x");
    view.Search("*.txt", "C:\\x", true);
    view.GoUp();
    EXPECT_EQ(view.FolderPath(), "");
    view.SetLimitToRoot(false);
    view.GoUp();
    EXPECT_EQ(view.FolderPath(), "My Folders");
}

TEST_F(FileViewSearch, TheArgumentsMayBePlacesThatTheSearchItselfChanges) {
    stage.ShowPath("C:\\x");
    view.Search("*.txt", view.FolderPath(), false);
    EXPECT_EQ(Rows(view), "a.txt");
}

}  // namespace
}  // namespace tessel::controls
