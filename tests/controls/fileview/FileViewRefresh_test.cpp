#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

#include "tests/controls/fileview/FileViewTestHelp.h"

/// How the list follows the disk.
namespace tessel::controls {
namespace {

using namespace fileviewtest;
using frame::Variant;
using frame::VariantArray;

constexpr std::int32_t hidden = frame::attributes::hidden;

class FileViewRefresh : public testing::Test {
  protected:
    void Files(int first, int end, const std::string& folder = "C:\\x\\") {
        for (int number = first; number < end; ++number) stage.File(folder + std::to_string(number));
    }
    Stage stage;
    FileView& view = stage.View();
};

TEST_F(FileViewRefresh, ADeletedFileInViewGoesAndTheApplicationHearsOfIt) {
    for (const char* name : {"a", "b", "c"}) stage.File(std::string("C:\\x\\") + name);
    stage.ShowPath("C:\\x");
    view.SetItemIndex(3);
    stage.Remove("C:\\x\\b");
    stage.Tick();
    EXPECT_EQ(Rows(view), "a | c");
    EXPECT_EQ(stage.Events(), "AfterPaint RefreshFoundChanges");
    EXPECT_EQ(view.ItemIndex(), 3);
}

TEST_F(FileViewRefresh, ADeletedFileBelowTheViewStaysUntilItComesIntoView) {
    Files(100, 300);
    stage.ShowPath("C:\\x");
    stage.Remove("C:\\x\\299");
    stage.Tick();
    EXPECT_EQ(view.ItemCount(), 200);
    view.ListFiles.SetTopIndex(195);
    stage.Tick();
    EXPECT_EQ(view.ItemCount(), 199);
}

TEST_F(FileViewRefresh, AMarkedRowPushesTheLastOneInViewDown) {
    // Rows are 255 high below a header of 300: eleven begin within the height of 3000, and one more for each that is marked.
    Files(100, 300);
    stage.ShowPath("C:\\x");
    stage.Remove("C:\\x\\110");
    stage.Remove("C:\\x\\111");
    stage.Tick();
    EXPECT_EQ(view.ItemCount(), 198);
    EXPECT_EQ(SubItem(view, 11, 10), "112");
    stage.Remove("C:\\x\\112");
    stage.Remove("C:\\x\\114");
    stage.Tick();
    EXPECT_EQ(view.ItemCount(), 197);
    EXPECT_EQ(SubItem(view, 12, 10), "114");
}

TEST_F(FileViewRefresh, AnyFileInViewCountsAsChangedAtEachTick) {
    stage.File("C:\\x\\a");
    stage.ShowPath("C:\\x");
    for (int tick = 0; tick < 3; ++tick) {
        stage.Tick();
        EXPECT_EQ(stage.Events(), "AfterPaint RefreshFoundChanges");
    }
}

TEST_F(FileViewRefresh, FoldersThatHaveNotChangedCountAsUnchanged) {
    stage.File("C:\\x\\sub\\a");
    view.SetShowFolderDetails(true);
    stage.ShowPath("C:\\x");
    stage.Tick();
    EXPECT_EQ(stage.Events(), "AfterPaint");
}

TEST_F(FileViewRefresh, AFolderWithAnotherNumberOfFilesCountsAsChangedWhereDetailsAreShown) {
    stage.File("C:\\x\\sub\\a");
    stage.ShowPath("C:\\x");
    const std::string before = SubItem(view, 1, 7);
    EXPECT_EQ(before, "000000000001");
    stage.File("C:\\x\\sub\\b");
    stage.Tick();
    EXPECT_EQ(stage.Events(), "AfterPaint");
    view.SetShowFolderDetails(true);
    stage.Tick();
    EXPECT_EQ(stage.Events(), "AfterPaint RefreshFoundChanges");
    EXPECT_EQ(SubItem(view, 1, 7), before);
    EXPECT_EQ(SubItem(view, 1, 1), "");
}

TEST_F(FileViewRefresh, AFolderWithAnotherDateCountsAsChangedWhereDetailsAreShown) {
    stage.Folder("C:\\x\\sub");
    view.SetShowFolderDetails(true);
    stage.ShowPath("C:\\x");
    stage.Disk().SetFolder("C:\\x\\sub", {.modified = 86'400}).Check();
    stage.Tick();
    EXPECT_EQ(stage.Events(), "AfterPaint RefreshFoundChanges");
}

TEST_F(FileViewRefresh, AFolderWithAnotherLabelCountsAsChanged) {
    stage.Folder("C:\\x\\sub");
    stage.ShowPath("C:\\x");
    view.SetItemDisplayName("other");
    stage.Tick();
    // Under its own name it is a new folder, too: the label is what rows are looked for by.
    EXPECT_EQ(stage.Events(), "BeforeAddItem(False, C:\\x\\sub) AfterAddItem(2) AfterPaint RefreshFoundChanges");
    EXPECT_EQ(Rows(view), "other | sub");
}

TEST_F(FileViewRefresh, ARowKeepsItsTextsUntilTheNextPaint) {
    stage.File("C:\\x\\a", 1, 100, 100);
    stage.ShowPath("C:\\x");
    const std::string before = Row(view, 1);
    stage.File("C:\\x\\a", 5000, 100, 999);
    stage.Tick();
    EXPECT_EQ(Row(view, 1), before);
    view.Show();
    EXPECT_EQ(SubItem(view, 1, 1), "5 KB");
}

TEST_F(FileViewRefresh, WhetherARowIsPaleFollowsTheDisk) {
    stage.File("C:\\x\\a");
    stage.Folder("C:\\x\\sub");
    stage.ShowPath("C:\\x");
    stage.File("C:\\x\\a", 0, 0, 0, hidden);
    stage.Folder("C:\\x\\sub", hidden);
    stage.Tick();
    EXPECT_TRUE(view.ListFiles.ListItems.Item(1)->Ghosted());
    EXPECT_TRUE(view.ListFiles.ListItems.Item(2)->Ghosted());
    stage.File("C:\\x\\a");
    stage.Folder("C:\\x\\sub");
    stage.Tick();
    EXPECT_FALSE(view.ListFiles.ListItems.Item(1)->Ghosted());
    EXPECT_FALSE(view.ListFiles.ListItems.Item(2)->Ghosted());
}

TEST_F(FileViewRefresh, TheMarkOfARowThatStandsIsTakenAway) {
    stage.File("C:\\x\\a");
    stage.ShowPath("C:\\x");
    view.ListFiles.ListItems.Item(1)->SetSubItems(11, "RemoveThis");
    stage.Tick();
    EXPECT_EQ(SubItem(view, 1, 11), "");
    EXPECT_EQ(view.ItemCount(), 1);
}

TEST_F(FileViewRefresh, NewFilesAndFoldersAppearBehindTheOthers) {
    stage.File("C:\\x\\m");
    stage.ShowPath("C:\\x");
    stage.File("C:\\x\\a");
    stage.Folder("C:\\x\\sub");
    stage.Tick();
    EXPECT_EQ(Rows(view), "m | sub | a");
    EXPECT_EQ(stage.Events(),
              "BeforeAddItem(False, C:\\x\\sub) AfterAddItem(2) BeforeAddItem(False, C:\\x\\a) AfterAddItem(3) AfterPaint "
              "RefreshFoundChanges");
}

TEST_F(FileViewRefresh, NewEntriesAloneAreNotReportedAsChanges) {
    stage.Folder("C:\\x\\m");
    stage.ShowPath("C:\\x");
    stage.File("C:\\x\\a");
    stage.Tick();
    EXPECT_EQ(stage.Events(), "BeforeAddItem(False, C:\\x\\a) AfterAddItem(2) AfterPaint");
}

TEST_F(FileViewRefresh, NewEntriesAreFilteredAndFoldersWantedOnly) {
    stage.File("C:\\x\\m.txt");
    view.SetFilter("*.txt");
    view.SetShowFolders(false);
    stage.ShowPath("C:\\x");
    stage.File("C:\\x\\a.doc");
    stage.File("C:\\x\\b.txt");
    stage.Folder("C:\\x\\sub.txt");
    stage.Tick();
    EXPECT_EQ(Rows(view), "m.txt | b.txt");
}

TEST_F(FileViewRefresh, AFileWhoseLabelWasChangedAppearsAgain) {
    stage.File("C:\\x\\a");
    stage.ShowPath("C:\\x");
    view.SetItemDisplayName("nicer");
    stage.Tick();
    EXPECT_EQ(Rows(view), "nicer | a");
    stage.Tick();
    EXPECT_EQ(Rows(view), "nicer | a");
}

TEST_F(FileViewRefresh, ALongListLooksForNewEntriesOnlyWithItsEndInView) {
    Files(100, 200);
    stage.ShowPath("C:\\x");
    stage.File("C:\\x\\new");
    stage.Tick();
    EXPECT_EQ(view.ItemCount(), 100);
    view.ListFiles.SetTopIndex(95);
    stage.Tick();
    EXPECT_EQ(view.ItemCount(), 101);
}

TEST_F(FileViewRefresh, AListThatIsShorterThanAHundredLooksForNewEntriesAlways) {
    Files(100, 199);
    stage.ShowPath("C:\\x");
    stage.File("C:\\x\\new");
    stage.Tick();
    EXPECT_EQ(view.ItemCount(), 100);
}

TEST_F(FileViewRefresh, ARemovedRowMayMakeAListShort) {
    Files(100, 200);
    stage.ShowPath("C:\\x");
    stage.Remove("C:\\x\\100");
    stage.File("C:\\x\\new");
    stage.Tick();
    EXPECT_EQ(view.ItemCount(), 100);
    EXPECT_EQ(SubItem(view, 100, 10), "new");
}

TEST_F(FileViewRefresh, TheTotalFollowsTheDisk) {
    stage.File("C:\\x\\a", 10);
    stage.File("C:\\x\\sub\\b", 5);
    stage.ShowPath("C:\\x");
    EXPECT_EQ(view.TotalSize(), Variant(15));
    stage.File("C:\\x\\sub\\c", 100);
    EXPECT_EQ(view.TotalSize(), Variant(15));
    stage.Tick();
    EXPECT_EQ(view.TotalSize(), Variant(115));
}

TEST_F(FileViewRefresh, TheLastRowThatGoesBringsTheMessage) {
    stage.File("C:\\x\\a");
    stage.ShowPath("C:\\x");
    stage.Remove("C:\\x\\a");
    stage.Tick();
    EXPECT_EQ(Message(view), "There are no items to show in this folder.");
    EXPECT_EQ(stage.Events(), "AfterPaint RefreshFoundChanges");
    EXPECT_EQ(view.ItemIndex(), 1);
    stage.File("C:\\x\\b");
    stage.Tick();
    EXPECT_EQ(stage.Events(), "");
}

TEST_F(FileViewRefresh, AFolderThatHasGoneLosesItsRows) {
    stage.File("C:\\x\\a", 3);
    stage.Folder("C:\\x\\sub");
    stage.ShowPath("C:\\x");
    stage.Remove("C:\\x");
    stage.Tick();
    EXPECT_EQ(view.ItemCount(), 0);
    EXPECT_EQ(stage.Events(), "AfterPaint RefreshFoundChanges");
}

TEST_F(FileViewRefresh, NothingIsRefreshedAfterAMissingFolder) {
    stage.File("C:\\x\\a");
    stage.ShowPath("C:\\missing");
    view.SetFolderPath("C:\\x");
    view.ItemAddNew("C:\\x\\a");
    stage.Events();
    stage.Tick();
    view.Refresh();
    EXPECT_EQ(stage.Events(), "");
    stage.ShowPath("C:\\x");
    stage.Tick();
    EXPECT_EQ(stage.Events(), "AfterPaint RefreshFoundChanges");
}

TEST_F(FileViewRefresh, AnEmptyListAndAnEmptyPathAreNotRefreshed) {
    stage.Folder("C:\\x");
    stage.ShowPath("C:\\x");
    stage.File("C:\\x\\a");
    stage.Tick();
    EXPECT_EQ(stage.Events(), "");
    view.ItemAddNew("C:\\x\\a");
    view.SetFolderPath("");
    stage.Events();
    stage.Tick();
    EXPECT_EQ(stage.Events(), "");
}

TEST_F(FileViewRefresh, TheTickLeavesDrivesAndMyFoldersAlone) {
    stage.ShowPath("MY COMPUTER");
    stage.Tick();
    view.Refresh();
    EXPECT_EQ(stage.Events(), "");
    EXPECT_EQ(view.ItemCount(), 1);
    stage.handlers.On(fileview::NeedMyFolders, [](Variant& folders) { folders = VariantArray(1, {"C:\\Temp"}); });
    stage.ShowPath("MY FOLDERS");
    stage.Tick();
    EXPECT_EQ(stage.Events(), "");
}

TEST_F(FileViewRefresh, RefreshGoesByTheRootAndNotByThePath) {
    stage.Folder("C:\\x\\sub");
    stage.ShowPath("My Computer");
    view.SetFolderPath("C:\\x");
    view.Show();
    stage.Events();
    stage.Remove("C:\\x\\sub");
    view.Refresh();
    EXPECT_EQ(stage.Events(), "");
    EXPECT_EQ(Rows(view), "sub");
}

TEST_F(FileViewRefresh, TheTimerTicksByItsInterval) {
    stage.Folder("C:\\x\\sub");
    stage.ShowPath("C:\\x");
    stage.host.clock.Advance(60'000);
    EXPECT_EQ(stage.Events(), "");
    view.SetRefreshInterval(1'000);
    stage.host.clock.Advance(3'500);
    EXPECT_EQ(stage.Events(), "AfterPaint AfterPaint AfterPaint");
}

TEST_F(FileViewRefresh, ASortedListTakesNewEntriesWhereTheySort) {
    stage.File("C:\\x\\b");
    stage.File("C:\\x\\d");
    stage.ShowPath("C:\\x");
    view.ListFiles.SetSortKey(12);
    view.ListFiles.SetSorted(true);
    stage.File("C:\\x\\a");
    stage.File("C:\\x\\c");
    stage.Tick();
    view.ListFiles.Rows().TakeChanges();
    EXPECT_EQ(Rows(view), "a | b | c | d");
}

TEST_F(FileViewRefresh, NewFilesHaveTurnsAfterAHundredAndFoldersAfterThirty) {
    stage.Folder("C:\\x\\sub");
    stage.ShowPath("C:\\x");
    Files(1000, 1250);
    for (int number = 100; number < 199; ++number) stage.Folder("C:\\x\\f" + std::to_string(number));
    stage.turns = 0;
    stage.Tick();
    EXPECT_EQ(stage.turns, 3 + 2);
    stage.turns = 0;
    view.SetFilter("sub");
    view.ListFiles.SetTopIndex(view.ItemCount());
    stage.Tick();
    EXPECT_EQ(stage.turns, 3);
}

}  // namespace
}  // namespace tessel::controls
