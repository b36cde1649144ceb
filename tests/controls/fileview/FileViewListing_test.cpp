#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

#include "tests/ErrorOf.h"
#include "tests/controls/fileview/FileViewTestHelp.h"

/// How a folder, the drives and the user's folders are listed.
namespace tessel::controls {
namespace {

using namespace fileviewtest;
using frame::Variant;
using frame::VariantArray;
using testing::ElementsAre;
using testing::IsEmpty;

constexpr std::int64_t day = 86'400;
constexpr std::int64_t march = 951'868'800;  // 2000-03-01 00:00:00
constexpr std::int32_t hidden = frame::attributes::hidden, systemFile = frame::attributes::system;
constexpr std::string_view nothingToShow = "There are no items to show in this folder.";

class FileViewListing : public testing::Test {
  protected:
    Stage stage;
    FileView& view = stage.View();
};

// Rows.

TEST_F(FileViewListing, AFileRowHoldsWhatTheDiskTells) {
    stage.File("C:\\x\\a.txt", 1025, march, march + day + 3661);
    stage.ShowPath("C:\\x");
    EXPECT_EQ(Row(view, 1),
              "a.txt|2 KB|TXT File|3/2/2000 1:01:01 AM|3/1/2000|Yes|C:\\x|000000001025|2000-03-02 01:01:01|2000-03-01 00:00:00|"
              "a.txt||a.txt");
}

TEST_F(FileViewListing, AFileThatWasNeverChangedHasAnEmptyChangedColumn) {
    stage.File("C:\\x\\a.txt", 0, march, march);
    stage.ShowPath("C:\\x");
    EXPECT_EQ(SubItem(view, 1, 5), "");
    EXPECT_EQ(SubItem(view, 1, 1), "0 KB");
}

TEST_F(FileViewListing, AFolderRowShowsNoDetailsAtFirst) {
    stage.File("C:\\x\\sub\\one", 1, march, march);
    stage.File("C:\\x\\sub\\two", 1, march, march);
    stage.Folder("C:\\x\\sub\\below");
    stage.Disk().SetFolder("C:\\x\\sub", {.created = march, .modified = march + day}).Check();
    stage.ShowPath("C:\\x");
    EXPECT_EQ(Row(view, 1), "sub||File Folder||||C:\\x|000000000002|2000-03-02 00:00:00|2000-03-01 00:00:00|sub|| sub");
}

TEST_F(FileViewListing, AFolderRowShowsDetailsFromThePaintAfterTheyWereWantedOn) {
    stage.File("C:\\x\\sub\\one", 1, march, march);
    stage.Disk().SetFolder("C:\\x\\sub", {.created = march, .modified = march + day}).Check();
    stage.ShowPath("C:\\x");
    view.SetShowFolderDetails(true);
    EXPECT_EQ(SubItem(view, 1, 1), "");
    stage.ShowPath("C:\\x");
    EXPECT_EQ(Row(view, 1),
              "sub|1|File Folder|3/2/2000|3/1/2000|Yes|C:\\x|000000000001|2000-03-02 00:00:00|2000-03-01 00:00:00|sub|| sub");
    view.SetShowFolderDetails(false);
    EXPECT_EQ(SubItem(view, 1, 1), "1");
}

TEST_F(FileViewListing, AFolderThatCannotBeCountedHasNoCount) {
    stage.Disk().SetFolder("C:\\x\\locked", {.unreadable = true}).Check();
    view.SetShowFolderDetails(true);
    stage.ShowPath("C:\\x");
    EXPECT_EQ(SubItem(view, 1, 1), "");
    EXPECT_EQ(SubItem(view, 1, 7), "");
    EXPECT_EQ(SubItem(view, 1, 10), "locked");
}

TEST_F(FileViewListing, MoreFoldersThanAreCountedAtOnceHaveTheirCountsWhenRead) {
    for (int number = 100; number < 200; ++number) {
        const std::string folder = "C:\\x\\f" + std::to_string(number);
        stage.Folder(folder);
        for (int file = 0; file < number % 3; ++file) stage.File(folder + "\\" + std::to_string(file));
    }
    stage.ShowPath("C:\\x");
    for (std::int32_t index = 1; index <= 100; ++index)
        EXPECT_EQ(SubItem(view, index, 7), "00000000000" + std::to_string((index + 99) % 3)) << index;
}

TEST_F(FileViewListing, FoldersAreCountedInIdleTime) {
    for (int number = 100; number < 200; ++number) stage.File("C:\\x\\f" + std::to_string(number) + "\\one");
    stage.ShowPath("C:\\x");
    stage.host.clock.Advance(60'000);
    for (int number = 100; number < 200; ++number) stage.File("C:\\x\\f" + std::to_string(number) + "\\two");
    EXPECT_EQ(SubItem(view, 100, 7), "000000000001");
}

TEST_F(FileViewListing, FoldersComeBeforeFilesAndBothInNameOrder) {
    for (const char* name : {"b.txt", "A.txt"}) stage.File(std::string("C:\\x\\") + name);
    for (const char* name : {"z", "Y"}) stage.Folder(std::string("C:\\x\\") + name);
    stage.ShowPath("C:\\x");
    EXPECT_EQ(Rows(view), "Y | z | A.txt | b.txt");
}

TEST_F(FileViewListing, SizesAboveThirtyTwoBitsAreTold) {
    constexpr std::int64_t fiveGiB = 5LL << 30;
    stage.File("C:\\x\\big", fiveGiB);
    stage.ShowPath("C:\\x");
    EXPECT_EQ(SubItem(view, 1, 1), "5,242,880 KB");
    EXPECT_EQ(SubItem(view, 1, 7), "005368709120");
    EXPECT_EQ(view.ItemSize(), 0);
    EXPECT_EQ(view.TotalSize().ToDouble(), static_cast<double>(fiveGiB));
}

TEST_F(FileViewListing, ASizeOfMoreThanTwelveDigitsIsLonger) {
    stage.File("C:\\x\\huge", 1'234'567'890'123);
    stage.ShowPath("C:\\x");
    EXPECT_EQ(SubItem(view, 1, 7), "1234567890123");
}

TEST_F(FileViewListing, ADateOutsideTheCalendarLeavesItsColumnsEmpty) {
    constexpr std::int64_t tooLate = 400'000'000'000;
    stage.File("C:\\x\\a", 1, march, tooLate);
    stage.ShowPath("C:\\x");
    EXPECT_EQ(Row(view, 1), "a|1 KB|File||3/1/2000|Yes|C:\\x|000000000001||2000-03-01 00:00:00|a||a");
}

// Events.

TEST_F(FileViewListing, AListingRaisesItsEventsInOrder) {
    stage.File("C:\\x\\a.txt");
    stage.Folder("C:\\x\\sub");
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(stage.Events(),
              "ChangedFolder(False) BeforePaint(False) BeforeAddItem(False, C:\\x\\sub) AfterAddItem(1) "
              "BeforeAddItem(False, C:\\x\\a.txt) AfterAddItem(2) AfterPaint");
    EXPECT_EQ(view.FolderPath(), "C:\\x");
    EXPECT_EQ(stage.Changes().back(), "PathRoot");
}

TEST_F(FileViewListing, AListingWithoutListenersGivesTheSameRows) {
    stage.File("C:\\x\\a.txt", 5, march, march);
    stage.Folder("C:\\x\\sub");
    stage.ShowPath("C:\\x");
    Stage unheard({.heard = false});
    unheard.File("C:\\x\\a.txt", 5, march, march);
    unheard.Folder("C:\\x\\sub");
    unheard.ShowPath("C:\\x");
    EXPECT_EQ(Row(unheard.View(), 1), Row(view, 1));
    EXPECT_EQ(Row(unheard.View(), 2), Row(view, 2));
    EXPECT_EQ(unheard.Events(), "");
}

TEST_F(FileViewListing, CancellingChangedFolderKeepsTheRowsAndTheNewPath) {
    stage.File("C:\\x\\a.txt");
    stage.Folder("C:\\y");
    stage.ShowPath("C:\\x");
    stage.handlers.On(fileview::ChangedFolder, [](bool& cancel) { cancel = true; });
    view.SetPathRoot("C:\\y");
    EXPECT_EQ(stage.Events(), "ChangedFolder(False)");
    EXPECT_EQ(Rows(view), "a.txt");
    EXPECT_EQ(view.FolderPath(), "C:\\y");
}

TEST_F(FileViewListing, CancellingBeforePaintKeepsTheRowsAndTheNewPath) {
    stage.File("C:\\x\\a.txt");
    stage.Folder("C:\\y");
    stage.ShowPath("C:\\x");
    stage.handlers.On(fileview::BeforePaint, [](bool& cancel) { cancel = true; });
    view.SetPathRoot("C:\\y");
    EXPECT_EQ(stage.Events(), "ChangedFolder(False) BeforePaint(False)");
    EXPECT_EQ(Rows(view), "a.txt");
    EXPECT_EQ(view.FolderPath(), "C:\\y");
}

TEST_F(FileViewListing, ACancelledFileOrFolderIsLeftOut) {
    for (const char* name : {"a", "b", "c"}) stage.File(std::string("C:\\x\\") + name);
    stage.Folder("C:\\x\\sub");
    stage.handlers.On(fileview::BeforeAddItem,
                      [](bool& cancel, std::string& path) { cancel = path == "C:\\x\\b" || path == "C:\\x\\sub"; });
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(Rows(view), "a | c");
    EXPECT_EQ(
        stage.Events(),
        "ChangedFolder(False) BeforePaint(False) BeforeAddItem(False, C:\\x\\sub) BeforeAddItem(False, C:\\x\\a) AfterAddItem(1) "
        "BeforeAddItem(False, C:\\x\\b) BeforeAddItem(False, C:\\x\\c) AfterAddItem(2) AfterPaint");
}

TEST_F(FileViewListing, AHiddenFileRaisesNothingAHiddenFolderIsOfferedFirst) {
    stage.File("C:\\x\\a", 0, 0, 0, hidden);
    stage.File("C:\\x\\b", 0, 0, 0, systemFile);
    stage.Folder("C:\\x\\f", hidden);
    stage.Folder("C:\\x\\g", systemFile);
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(stage.Events(),
              "ChangedFolder(False) BeforePaint(False) BeforeAddItem(False, C:\\x\\f) BeforeAddItem(False, C:\\x\\g) AfterPaint");
    EXPECT_EQ(Rows(view), "");
}

TEST_F(FileViewListing, HiddenAndSystemFilesAreListedWhereTheyAreAllowed) {
    stage.File("C:\\x\\a", 0, 0, 0, hidden);
    stage.File("C:\\x\\b", 0, 0, 0, systemFile);
    stage.File("C:\\x\\c", 0, 0, 0, hidden | systemFile);
    stage.Folder("C:\\x\\f", hidden);
    view.SetAllowHiddenFiles(true);
    EXPECT_EQ(Rows(view), "");
    stage.ShowPath("C:\\x");
    EXPECT_EQ(Rows(view), "f | a");
    view.SetAllowSystemFiles(true);
    stage.ShowPath("C:\\x");
    EXPECT_EQ(Rows(view), "f | a | b | c");
    EXPECT_TRUE(view.ListFiles.ListItems.Item(1)->Ghosted());
    EXPECT_TRUE(view.ListFiles.ListItems.Item(2)->Ghosted());
    EXPECT_FALSE(view.ListFiles.ListItems.Item(3)->Ghosted());
    view.SetAllowHiddenFiles(false);
    stage.ShowPath("C:\\x");
    EXPECT_EQ(Rows(view), "b");
}

TEST_F(FileViewListing, ThePathThatTheApplicationSetsBeforeAFolderIsAddedCounts) {
    stage.Folder("C:\\x\\sub");
    stage.Folder("C:\\other\\instead");
    stage.handlers.On(fileview::BeforeAddItem, [](bool&, std::string& path) { path = "C:\\other\\instead"; });
    stage.ShowPath("C:\\x");
    EXPECT_EQ(Rows(view), "instead");
    EXPECT_EQ(SubItem(view, 1, 6), "C:\\other");
}

TEST_F(FileViewListing, ThePathThatTheApplicationSetsBeforeAFileIsAddedChangesNothing) {
    stage.File("C:\\x\\a");
    stage.handlers.On(fileview::BeforeAddItem, [](bool&, std::string& path) { path = "C:\\gone"; });
    stage.ShowPath("C:\\x");
    EXPECT_EQ(Rows(view), "a");
}

TEST_F(FileViewListing, TheMessageIsGoneAtTheFirstRow) {
    stage.ShowPath("C:\\missing");
    ASSERT_NE(Message(view), "");
    stage.File("C:\\x\\a");
    std::string seen = "none";
    stage.handlers.On(fileview::AfterAddItem, [&](std::int32_t&) { seen = Message(view); });
    stage.ShowPath("C:\\x");
    EXPECT_EQ(seen, "");
}

TEST_F(FileViewListing, ItemIndexIsOneAfterAPaintWithRowsAndZeroWithout) {
    stage.File("C:\\x\\a");
    stage.Folder("C:\\y");
    stage.ShowPath("C:\\x");
    EXPECT_EQ(view.ItemIndex(), 1);
    stage.ShowPath("C:\\y");
    EXPECT_EQ(view.ItemIndex(), 0);
}

// Paths.

TEST_F(FileViewListing, AnEmptyPathClearsTheListAndTellsNoEnd) {
    stage.File("C:\\x\\a");
    stage.ShowPath("C:\\x");
    view.SetFolderPath("");
    view.Show();
    EXPECT_EQ(stage.Events(), "ChangedFolder(False) BeforePaint(False)");
    EXPECT_EQ(view.ItemCount(), 0);
}

TEST_F(FileViewListing, AMissingFolderLeavesItsMessage) {
    view.SetPathRoot("C:\\missing");
    EXPECT_EQ(stage.Events(), "ChangedFolder(False) BeforePaint(False) AfterPaint");
    EXPECT_EQ(Message(view), "Folder 'C:\\missing' does not exist.");
    EXPECT_EQ(view.ItemIndex(), 0);
}

TEST_F(FileViewListing, AFolderThatCannotBeReadIsEmpty) {
    stage.File("C:\\x\\a");
    stage.Disk().SetFolder("C:\\x", {.unreadable = true}).Check();
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(stage.Events(), "ChangedFolder(False) BeforePaint(False) AfterPaint");
    EXPECT_EQ(Message(view), nothingToShow);
}

TEST_F(FileViewListing, AnEmptyFolderShowsTheMessage) {
    stage.Folder("C:\\x");
    stage.ShowPath("C:\\x");
    EXPECT_EQ(Message(view), nothingToShow);
    EXPECT_EQ(view.ItemIndex(), 0);
}

TEST_F(FileViewListing, TheMessageLooksAsTheListAndStandsBelowTheHeaders) {
    view.SetFont(std::make_shared<frame::Font>("Arial", 10));
    view.SetBackColor(frame::OLE_COLOR(0x112233));
    view.SetForeColor(frame::OLE_COLOR(0x445566));
    stage.ShowPath("C:\\missing");
    EXPECT_EQ(view.txtMessage.Left(), 120);
    EXPECT_EQ(view.txtMessage.Top(), 180 + 30 * 10);
    EXPECT_EQ(view.txtMessage.Width(), width - 240);
    EXPECT_EQ(view.txtMessage.Font()->Name(), "Arial");
    EXPECT_EQ(view.txtMessage.BackColor(), frame::OLE_COLOR(0x112233));
    EXPECT_EQ(view.txtMessage.ForeColor(), frame::OLE_COLOR(0x445566));
    view.SetView(child::ListViewConstants::Icon);
    EXPECT_EQ(view.txtMessage.Top(), 480);
    stage.ShowPath("C:\\missing");
    EXPECT_EQ(view.txtMessage.Top(), 120);
}

TEST_F(FileViewListing, AShownListIsPaintedAtEachShow) {
    stage.File("C:\\x\\a");
    stage.ShowPath("C:\\x");
    stage.File("C:\\x\\b");
    stage.TheSite().Show();
    EXPECT_EQ(stage.EventsOfPaints(), "ChangedFolder(False) BeforePaint(False) AfterPaint");
    EXPECT_EQ(Rows(view), "a | b");
}

TEST_F(FileViewListing, ASetOfPathShowsNothingByItself) {
    stage.File("C:\\x\\a");
    stage.File("C:\\y\\b");
    stage.ShowPath("C:\\x");
    view.Put("Path", "C:\\y");
    EXPECT_EQ(stage.Events(), "");
    EXPECT_EQ(Rows(view), "a");
    EXPECT_EQ(view.Get("path").ToText(), "C:\\y");
    EXPECT_EQ(stage.Changes().back(), "Path");
}

TEST_F(FileViewListing, MyDocumentsIsTheFolderOfTheUser) {
    stage.File("C:\\My Documents\\letter.doc");
    stage.ShowPath("my DOCUMENTS");
    EXPECT_EQ(view.FolderPath(), "C:\\My Documents");
    EXPECT_EQ(view.PathRoot(), "my DOCUMENTS");
    EXPECT_EQ(Rows(view), "letter.doc");
}

TEST(FileViewWithoutDocuments, ShowsThatTheEmptyPathDoesNotExist) {
    test::HostUnderTest host;
    host.files.SetSpecialFolder(5, "");
    FileView& view = host.Create<FileView>("FileView1");
    view.SetPathRoot("My Documents");
    EXPECT_EQ(Message(view), "Folder '' does not exist.");
}

TEST_F(FileViewListing, MyComputerListsTheDrives) {
    stage.Disk().SetDrive("A", {.type = frame::driveTypes::removable, .ready = false}).Check();
    stage.Disk().SetDrive("D", {.volume = "Work"}).Check();
    stage.Disk().SetDrive("N", {.type = frame::driveTypes::network, .share = "\\\\server\\docs"}).Check();
    view.SetPathRoot("my computer");
    EXPECT_EQ(Rows(view), "(A:) | Local Disk (C:) | Work (D:) | docs on 'server' (N:)");
    EXPECT_EQ(Rows(view, 10), "A:\\ | C:\\ | D:\\ | N:\\");
    EXPECT_EQ(Row(view, 2), "Local Disk (C:)||||||||||C:\\||");
    EXPECT_EQ(
        stage.Events(),
        "ChangedFolder(False) BeforePaint(False) BeforeAddItem(False, A:) AfterAddItem(1) BeforeAddItem(False, C:) AfterAddItem(2) "
        "BeforeAddItem(False, D:) AfterAddItem(3) BeforeAddItem(False, N:) AfterAddItem(4) AfterPaint");
    EXPECT_EQ(view.ListFiles.ListItems.Item(2)->SmallIcon().ToText(), "Local Disk");
    view.SetItemIndex(2);
    EXPECT_EQ(view.ItemName(), "C:\\");
}

TEST_F(FileViewListing, TheFilterDoesNotApplyToDrivesAndTheTotalStays) {
    stage.File("C:\\x\\a", 7);
    stage.ShowPath("C:\\x");
    view.SetFilter("*.txt");
    stage.ShowPath("My Computer");
    EXPECT_EQ(Rows(view), "Local Disk (C:)");
    EXPECT_EQ(view.TotalSize(), Variant(7));
}

TEST_F(FileViewListing, ACancelledDriveIsLeftOut) {
    stage.Disk().SetDrive("D", {}).Check();
    stage.handlers.On(fileview::BeforeAddItem, [](bool& cancel, std::string& path) { cancel = path == "C:"; });
    stage.ShowPath("My Computer");
    EXPECT_EQ(Rows(view), "Local Disk (D:)");
}

TEST_F(FileViewListing, MyFoldersAsksForTheFoldersAndListsThem) {
    stage.File("C:\\x\\one\\a", 10);
    stage.File("C:\\two\\b", 20);
    stage.handlers.On(fileview::NeedMyFolders, [](Variant& folders) {
        folders = VariantArray(1, {"C:\\x\\one", "C:\\gone", "C:\\two"});
    });
    view.SetPathRoot("My Folders");
    EXPECT_EQ(Rows(view), "one | C:\\gone (Unavailable) | two");
    EXPECT_EQ(Rows(view, 6), "C:\\x |  | C:\\");
    EXPECT_EQ(Row(view, 2), "C:\\gone (Unavailable)|||||||||||| C:\\gone");
    EXPECT_EQ(view.ListFiles.ListItems.Item(2)->Icon().ToText(), "FolderUnavailable");
    EXPECT_EQ(view.ListFiles.ListItems.Item(2)->SmallIcon().ToText(), "FolderUnavailable");
    EXPECT_EQ(view.TotalSize(), Variant(30));
    EXPECT_EQ(stage.Events(),
              "ChangedFolder(False) BeforePaint(False) NeedMyFolders(array) BeforeAddItem(False, C:\\x\\one) AfterAddItem(1) "
              "BeforeAddItem(False, C:\\two) AfterAddItem(3) AfterPaint");
}

TEST_F(FileViewListing, MyFoldersAsksOnlyWhenItHasNone) {
    stage.Folder("C:\\two");
    stage.handlers.On(fileview::NeedMyFolders, [](Variant& folders) { folders = VariantArray(1, {"C:\\two"}); });
    stage.ShowPath("My Folders");
    view.Show();
    EXPECT_EQ(stage.EventsOfPaints(), "ChangedFolder(False) BeforePaint(False) AfterPaint");
    view.Refresh();
    EXPECT_EQ(stage.EventsOfPaints(), "NeedMyFolders(array)");
    EXPECT_EQ(Rows(view), "two");
}

TEST_F(FileViewListing, MyFoldersWithoutAnyShowsTheMessage) {
    stage.ShowPath("My Folders");
    EXPECT_EQ(Message(view), nothingToShow);
}

TEST_F(FileViewListing, AFolderThatIsTheRootOfADriveShowsTheDrivesName) {
    stage.handlers.On(fileview::NeedMyFolders, [](Variant& folders) { folders = VariantArray(1, {"C:\\"}); });
    stage.File("C:\\a");
    stage.ShowPath("My Folders");
    EXPECT_EQ(SubItem(view, 1, 10), "C:\\");
    EXPECT_EQ(Rows(view), "Local Disk (C:)");
    EXPECT_EQ(SubItem(view, 1, 6), "");
    EXPECT_EQ(SubItem(view, 1, 7), "000000000001");
    EXPECT_EQ(SubItem(view, 1, 12), " Local Disk (C:)");
}

TEST_F(FileViewListing, AnErrorOfTheApplicationsListPassesToTheCaller) {
    stage.handlers.On(fileview::NeedMyFolders, [](Variant& folders) { folders = "no array"; });
    EXPECT_EQ(test::ErrorOf([&] { view.SetPathRoot("My Folders"); }), frame::errors::typeMismatch);
}

// Filter and folders.

TEST_F(FileViewListing, TheFilterAppliesToFilesAndFolders) {
    for (const char* name : {"a.txt", "b.doc", "C.TXT"}) stage.File(std::string("C:\\x\\") + name);
    stage.Folder("C:\\x\\sub");
    stage.Folder("C:\\x\\sub.txt");
    view.SetFilter("*.txt");
    stage.ShowPath("C:\\x");
    EXPECT_EQ(Rows(view), "sub.txt | a.txt | C.TXT");
    view.SetFilter("nothing");
    EXPECT_EQ(view.ItemCount(), 3);
    stage.ShowPath("C:\\x");
    EXPECT_EQ(Message(view), nothingToShow);
}

TEST_F(FileViewListing, WithoutFoldersOnlyFilesAreListedAtOnce) {
    stage.File("C:\\x\\a");
    stage.Folder("C:\\x\\sub");
    stage.ShowPath("C:\\x");
    view.SetShowFolders(false);
    EXPECT_EQ(Rows(view), "a");
    EXPECT_EQ(stage.EventsOfPaints(), "ChangedFolder(False) BeforePaint(False) AfterPaint");
    view.SetShowFolders(true);
    EXPECT_EQ(Rows(view), "sub | a");
}

// Turns.

TEST_F(FileViewListing, TheMessageLoopHasATurnAfterEachHundredEntries) {
    for (int number = 1000; number < 1250; ++number) stage.File("C:\\x\\" + std::to_string(number));
    for (int number = 1000; number < 1150; ++number) stage.Folder("C:\\x\\f" + std::to_string(number));
    stage.ShowPath("C:\\x");
    stage.turns = 0;
    view.Show();
    EXPECT_EQ(stage.turns, 1 + 2);
    view.SetFilter("no such name");
    view.Show();
    EXPECT_EQ(stage.turns, 2 * (1 + 2));
}

TEST_F(FileViewListing, RowsAppearWhileAListingGoesOn) {
    for (int number = 1000; number < 1250; ++number) stage.File("C:\\x\\" + std::to_string(number));
    std::vector<std::int32_t> seen;
    stage.onTurn = [&] { seen.push_back(view.ItemCount()); };
    stage.ShowPath("C:\\x");
    EXPECT_THAT(seen, ElementsAre(100, 200));
}

TEST_F(FileViewListing, NothingIsRefreshedDuringAListing) {
    for (int number = 1000; number < 1250; ++number) stage.File("C:\\x\\" + std::to_string(number));
    stage.onTurn = [&] {
        stage.Tick();
        view.Refresh();
    };
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(stage.EventsOfPaints(), "ChangedFolder(False) BeforePaint(False) AfterPaint");
    EXPECT_EQ(view.ItemCount(), 250);
}

// Going up.

TEST_F(FileViewListing, GoUpShowsTheParent) {
    stage.Folder("C:\\x\\y");
    stage.ShowPath("C:\\x");
    view.SetFolderPath("C:\\x\\y");
    EXPECT_TRUE(view.GoUp().IsEmpty());
    EXPECT_EQ(view.FolderPath(), "C:\\x");
    EXPECT_EQ(Rows(view), "y");
    EXPECT_EQ(stage.EventsOfPaints(), "ChangedFolder(False) BeforePaint(False) AfterPaint");
}

TEST_F(FileViewListing, GoUpStopsAtTheRoot) {
    stage.Folder("C:\\x");
    stage.ShowPath("C:\\X");
    view.SetFolderPath("C:\\x");
    view.GoUp();
    EXPECT_EQ(view.FolderPath(), "C:\\x");
    EXPECT_EQ(stage.Events(), "");
}

TEST_F(FileViewListing, GoUpComparesTheFirstCharactersWithTheRootOnly) {
    stage.Folder("C:\\xyz\\below");
    stage.ShowPath("C:\\x");
    view.SetFolderPath("C:\\xyz\\below");
    view.GoUp();
    EXPECT_EQ(view.FolderPath(), "C:\\xyz");
}

TEST_F(FileViewListing, GoUpLeavesTheRootFreelyWithoutLimit) {
    stage.Folder("C:\\x");
    stage.ShowPath("C:\\x");
    view.SetLimitToRoot(false);
    view.GoUp();
    EXPECT_EQ(view.FolderPath(), "C:\\");
    view.GoUp();
    EXPECT_EQ(view.FolderPath(), "C:\\x");
}

TEST_F(FileViewListing, GoUpFromADriveShowsTheDrivesWhereTheyAreTheRoot) {
    stage.ShowPath("My Computer");
    view.SetFolderPath("C:\\");
    view.GoUp();
    EXPECT_EQ(view.FolderPath(), "My Computer");
    EXPECT_EQ(Rows(view), "Local Disk (C:)");
}

TEST_F(FileViewListing, GoUpStopsAtMyDocumentsWhateverTheLimit) {
    stage.Folder("C:\\My Documents\\below");
    stage.ShowPath("My Documents");
    view.SetLimitToRoot(false);
    view.GoUp();
    EXPECT_EQ(view.FolderPath(), "C:\\My Documents");
    view.SetFolderPath("C:\\My Documents\\below");
    view.GoUp();
    EXPECT_EQ(view.FolderPath(), "C:\\My Documents");
}

TEST_F(FileViewListing, GoUpFromAnEmptyPathAimsAtMyFolders) {
    stage.ShowPath("My Folders");
    view.SetFolderPath("");
    view.GoUp();
    EXPECT_EQ(view.FolderPath(), "My Folders");
}

TEST_F(FileViewListing, GoUpThatIsCancelledHasSetThePath) {
    stage.Folder("C:\\x\\y");
    stage.ShowPath("C:\\x");
    view.SetFolderPath("C:\\x\\y");
    stage.handlers.On(fileview::BeforePaint, [](bool& cancel) { cancel = true; });
    view.GoUp();
    EXPECT_EQ(view.FolderPath(), "C:\\x");
}

// Design time.

TEST(FileViewAtDesignTime, ShowsItsRootAndListsNothing) {
    Stage stage({.designTime = true});
    FileView& view = stage.View();
    stage.File("C:\\x\\a");
    EXPECT_EQ(Message(view), "FileView1: PathRoot set to ''");
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(Message(view), "FileView1: PathRoot set to 'C:\\x'");
    EXPECT_EQ(view.ItemCount(), 0);
    stage.Tick();
    EXPECT_EQ(stage.Events(), "");
}

// Size and columns.

TEST_F(FileViewListing, TheListFillsTheControl) {
    EXPECT_EQ(view.ListFiles.Width(), width);
    EXPECT_EQ(view.ListFiles.Height(), height);
    stage.TheSite().SetSize(1234, 567);
    EXPECT_EQ(view.ListFiles.Width(), 1234);
    EXPECT_EQ(view.ListFiles.Height(), 567);
}

TEST_F(FileViewListing, APaintOfTheSurfaceAlignsTheSizesToTheRight) {
    view.ListFiles.ColumnHeaders.Item(2).SetAlignment(child::AlignmentConstants::LeftJustify);
    stage.TheSite().Paint();
    EXPECT_EQ(view.ListFiles.ColumnHeaders.Item(2).Alignment(), child::AlignmentConstants::RightJustify);
}

}  // namespace
}  // namespace tessel::controls
