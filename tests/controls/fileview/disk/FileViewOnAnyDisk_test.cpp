#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "frame/Text.h"
#include "tests/ErrorOf.h"
#include "tests/controls/fileview/FileViewTestHelp.h"
#include "tests/hosts/RealDisk.h"

/// What holds of the list on every file system.
namespace tessel::controls {
namespace {

using namespace fileviewtest;
using frame::Variant;
using frame::VariantArray;
using test::ErrorOf;

enum class Disk { Memory, Real };

/// A list of files, and a folder "x" to fill behind its back. Names below it are told with "/" on every disk.
class FileViewOnAnyDisk : public testing::TestWithParam<Disk> {
  protected:
    FileViewOnAnyDisk() { Make(""); }

    std::string At(const std::string& names) const {
        std::string path = root_ + (names.empty() ? "" : "/" + names);
        for (std::size_t i = root_.size(); i < path.size(); ++i)
            if (path[i] == '/') path[i] = separator_;
        return path;
    }
    /// A name that begins with a point is hidden on every disk.
    void Write(const std::string& names, std::int64_t size = 0) {
        if (!real_) return stage.File(At(names), size, 0, 0, AttributesOf(names));
        real_->folder.Write("x/" + names, "");
        std::filesystem::resize_file(At(names), static_cast<std::uintmax_t>(size));
    }
    void Make(const std::string& names) {
        if (real_)
            real_->folder.Make("x/" + names);
        else
            stage.Folder(At(names), AttributesOf(names));
    }
    void Remove(const std::string& names) {
        if (real_)
            std::filesystem::remove_all(At(names));
        else
            stage.Remove(At(names));
    }
    bool Exists(const std::string& names) { return stage.Frame().Files().FileExists(At(names)); }
    void Show(const std::string& names = "") { stage.ShowPath(At(names)); }

    /// Texts with paths as names below "x": "BeforeAddItem(False, /sub)".
    std::string Told(std::string text) const {
        for (std::size_t at = 0; (at = text.find(root_, at)) != std::string::npos;) text.erase(at, root_.size());
        for (char& byte : text)
            if (byte == separator_) byte = '/';
        return text;
    }
    std::string Events() { return Told(stage.Events()); }

  private:
    static std::int32_t AttributesOf(const std::string& names) {
        return names.empty() || names[names.rfind('/') + 1] != '.' ? 0 : frame::attributes::hidden;
    }

  protected:
    std::unique_ptr<test::RealDisk> real_ = GetParam() == Disk::Real ? std::make_unique<test::RealDisk>() : nullptr;

  private:
    std::string root_ = real_ ? real_->folder / "x" : "C:\\x";
    char separator_ = real_ ? '/' : '\\';

  protected:
    Stage stage{{.files = real_ ? &real_->files : nullptr}};
    FileView& view = stage.View();
};

INSTANTIATE_TEST_SUITE_P(Disks, FileViewOnAnyDisk, testing::Values(Disk::Memory, Disk::Real),
                         [](const auto& kind) { return kind.param == Disk::Real ? "Real" : "Memory"; });

// Listing.

TEST_P(FileViewOnAnyDisk, AListingRaisesItsEventsInOrder) {
    Write("b.txt");
    Write("a.txt");
    Make("sub");
    view.SetPathRoot(At(""));
    EXPECT_EQ(Events(),
              "ChangedFolder(False) BeforePaint(False) BeforeAddItem(False, /sub) AfterAddItem(1) BeforeAddItem(False, /a.txt) "
              "AfterAddItem(2) BeforeAddItem(False, /b.txt) AfterAddItem(3) AfterPaint");
    EXPECT_EQ(Rows(view), "sub | a.txt | b.txt");
    EXPECT_EQ(Told(Rows(view, 6)), " |  | ");
    EXPECT_EQ(Rows(view, 10), "sub | a.txt | b.txt");
    EXPECT_EQ(Rows(view, 12), " sub | a.txt | b.txt");
    EXPECT_EQ(view.ItemIndex(), 1);
    EXPECT_EQ(Told(view.ItemPath()), "/sub");
}

TEST_P(FileViewOnAnyDisk, ARowTellsTheSize) {
    Write("a.txt", 1025);
    Write("b.txt", 0);
    Show();
    EXPECT_EQ(Rows(view, 1), "2 KB | 0 KB");
    EXPECT_EQ(Rows(view, 7), "000000001025 | 000000000000");
    EXPECT_EQ(view.ItemSize(), 1025);
    EXPECT_EQ(view.TotalSize(), Variant(1025));
}

TEST_P(FileViewOnAnyDisk, SizesGoBeyondFourGibibytes) {
    Write("a", 6'000'000'000);
    Write("b", 5'999'999'999);
    Show();
    EXPECT_EQ(Rows(view, 1), "5,859,375 KB | 5,859,375 KB");
    EXPECT_EQ(Rows(view, 7), "006000000000 | 005999999999");
    EXPECT_EQ(view.ItemSize(), 0) << "more than 32 bits hold";
    EXPECT_EQ(view.TotalSize().ToDouble(), 11'999'999'999.0);
    constexpr int sizeColumn = 2;
    view.ListFiles.ColumnClickInput(sizeColumn);
    view.ListFiles.Rows().TakeChanges();
    EXPECT_EQ(Rows(view), "b | a");
}

TEST_P(FileViewOnAnyDisk, AFolderRowCountsTheFilesInIt) {
    for (const char* name : {"sub/a", "sub/b", "sub/.c"}) {
        Make("sub");
        Write(name);
    }
    Make("sub/below");
    Show();
    EXPECT_EQ(SubItem(view, 1, 7), "000000000003");
    EXPECT_EQ(SubItem(view, 1, 1), "");
    view.SetShowFolderDetails(true);
    Show();
    EXPECT_EQ(SubItem(view, 1, 1), "3");
    EXPECT_NE(SubItem(view, 1, 3), "");
    EXPECT_EQ(SubItem(view, 1, 2), "File Folder");
}

TEST_P(FileViewOnAnyDisk, TheFilterHoldsForFilesAndFolders) {
    for (const char* name : {"a1.txt", "aX.txt", "b2.txt", "c.doc", "[x].txt"}) Write(name);
    Make("d3.txt");
    Make("other");
    const auto filtered = [&](const char* filter) {
        view.SetFilter(filter);
        Show();
        return Rows(view);
    };
    EXPECT_EQ(filtered("?#.TXT"), "d3.txt | a1.txt | b2.txt");
    EXPECT_EQ(filtered("[ac]*"), "a1.txt | aX.txt | c.doc");
    EXPECT_EQ(filtered("[!ac]*.txt"), "d3.txt | [x].txt | b2.txt");
    EXPECT_EQ(filtered("[[]*"), "[x].txt");
    EXPECT_EQ(filtered("none"), "");
    EXPECT_EQ(Message(view), "There are no items to show in this folder.");
}

TEST_P(FileViewOnAnyDisk, HiddenEntriesAreShownPaleWhereTheyAreAllowed) {
    Write(".file");
    Make(".folder");
    Write("seen");
    Show();
    EXPECT_EQ(Rows(view), "seen");
    view.SetAllowHiddenFiles(true);
    Show();
    EXPECT_EQ(Rows(view), ".folder | .file | seen");
    for (std::int32_t index = 1; index <= 3; ++index) EXPECT_EQ(view.ListFiles.ListItems.Item(index)->Ghosted(), index < 3);
}

TEST_P(FileViewOnAnyDisk, AnEmptyFolderAndAMissingOneHaveTheirMessages) {
    Show();
    EXPECT_EQ(Message(view), "There are no items to show in this folder.");
    EXPECT_EQ(view.ItemIndex(), 0);
    Show("none");
    EXPECT_EQ(Message(view), "Folder '" + At("none") + "' does not exist.");
    Write("a");
    Show("a");
    EXPECT_EQ(Message(view), "Folder '" + At("a") + "' does not exist.") << "a file is no folder";
    Show();
    EXPECT_EQ(Message(view), "");
}

TEST_P(FileViewOnAnyDisk, TheMessageLoopHasATurnAfterEachHundredEntries) {
    for (int number = 100; number < 350; ++number) Write(frame::Decimal(number));
    Show();
    stage.turns = 0;
    view.Show();
    EXPECT_EQ(stage.turns, 2);
    EXPECT_EQ(view.ItemCount(), 250);
}

TEST_P(FileViewOnAnyDisk, GoUpStaysBelowTheRoot) {
    Make("one/two");
    Show("one");
    view.SetFolderPath(At("one/two"));
    view.GoUp();
    EXPECT_EQ(Told(view.FolderPath()), "/one");
    EXPECT_EQ(Rows(view), "two");
    view.GoUp();
    EXPECT_EQ(Told(view.FolderPath()), "/one");
    view.SetLimitToRoot(false);
    view.GoUp();
    EXPECT_EQ(Told(view.FolderPath()), "");
    EXPECT_EQ(Rows(view), "one");
}

TEST_P(FileViewOnAnyDisk, MyFoldersListsThoseThatExistAndTellsOfTheOthers) {
    Make("one");
    Write("one/a", 3);
    Make("two");
    Write("two/b", 4);
    stage.handlers.On(fileview::NeedMyFolders, [&](Variant& folders) {
        folders = VariantArray(1, {At("two"), At("none"), At("one")});
    });
    stage.ShowPath("My Folders");
    EXPECT_EQ(Told(Rows(view)), "two | /none (Unavailable) | one");
    EXPECT_EQ(view.TotalSize(), Variant(7));
    EXPECT_EQ(view.ListFiles.ListItems.Item(2)->SmallIcon().ToText(), "FolderUnavailable");
}

TEST_P(FileViewOnAnyDisk, MyDocumentsAreTheUsers) {
    constexpr int documents = 5;
    const std::string path = stage.Frame().Files().SpecialFolder(documents);
    if (!real_) stage.Folder(path);
    stage.Frame().Files().CreateFile(path + stage.Frame().Files().Separator() + "letter.txt", false).Check();
    stage.ShowPath("My Documents");
    EXPECT_EQ(Rows(view), "letter.txt");
    EXPECT_EQ(view.FolderPath(), path);
    EXPECT_TRUE(view.GoUp().IsEmpty());
    EXPECT_EQ(view.FolderPath(), path);
}

TEST_P(FileViewOnAnyDisk, AFolderMayBeEmptiedWhileItIsListed) {
    for (const char* name : {"a", "b", "c"}) Write(name);
    stage.handlers.On(fileview::AfterAddItem, [&](std::int32_t& index) {
        if (index != 1) return;
        Remove("b");
        Remove("c");
        Write("d");
    });
    Show();
    EXPECT_EQ(Rows(view), "a");
    stage.handlers = {};
    stage.Tick();
    EXPECT_EQ(Rows(view), "a | d");
}

TEST_P(FileViewOnAnyDisk, AFolderMayVanishWhileItIsListed) {
    for (const char* name : {"a", "b", "c"}) Write(name);
    Make("sub");
    stage.handlers.On(fileview::BeforeAddItem, [&](bool&, std::string& path) {
        if (path == At("b")) Remove("");
    });
    view.SetPathRoot(At(""));
    EXPECT_EQ(Rows(view), "sub | a | b") << "what was asked of the disk before stands";
    EXPECT_EQ(stage.EventsOfPaints(), "ChangedFolder(False) BeforePaint(False) AfterPaint");
    stage.Tick();
    EXPECT_EQ(Rows(view), "");
    EXPECT_EQ(stage.Events(), "AfterPaint RefreshFoundChanges");
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

TEST_P(FileViewOnAnyDisk, AFolderMayVanishInATurnOfItsListing) {
    for (int number = 100; number < 350; ++number) Write(frame::Decimal(number));
    stage.onTurn = [&] {
        if (stage.turns == 1) Remove("");
    };
    stage.turns = 0;
    view.SetPathRoot(At(""));
    EXPECT_EQ(view.ItemCount(), 100);
    EXPECT_EQ(stage.EventsOfPaints(), "ChangedFolder(False) BeforePaint(False) AfterPaint");
    for (int tick = 0; tick < 20 && view.ItemCount() > 0; ++tick) stage.Tick();
    EXPECT_EQ(Message(view), "There are no items to show in this folder.");
}

// Refreshing.

TEST_P(FileViewOnAnyDisk, ARefreshTakesWhatHasGoneAndAddsWhatHasCome) {
    for (const char* name : {"a", "b", "c"}) Write(name);
    Make("sub");
    Show();
    Remove("b");
    Remove("sub");
    Write("new");
    Make("folder");
    Write(".hidden");
    stage.Tick();
    EXPECT_EQ(Rows(view), "a | c | folder | new");
    EXPECT_EQ(Events(),
              "BeforeAddItem(False, /folder) AfterAddItem(3) BeforeAddItem(False, /new) AfterAddItem(4) AfterPaint "
              "RefreshFoundChanges")
        << "nobody is asked about a file that is not allowed";
}

TEST_P(FileViewOnAnyDisk, FoldersThatHaveNotChangedCountAsUnchanged) {
    Make("sub");
    Write("sub/a");
    view.SetShowFolderDetails(true);
    Show();
    stage.Tick();
    EXPECT_EQ(stage.Events(), "AfterPaint");
    Write("sub/b");
    stage.Tick();
    EXPECT_EQ(stage.Events(), "AfterPaint RefreshFoundChanges");
    EXPECT_EQ(SubItem(view, 1, 1), "1") << "until the next paint";
}

TEST_P(FileViewOnAnyDisk, AFileBelowTheViewStaysUntilItComesIntoView) {
    for (int number = 100; number < 300; ++number) Write(frame::Decimal(number));
    Show();
    Remove("299");
    stage.Tick();
    EXPECT_EQ(view.ItemCount(), 200);
    view.ListFiles.SetTopIndex(195);
    stage.Tick();
    EXPECT_EQ(view.ItemCount(), 199);
}

TEST_P(FileViewOnAnyDisk, AFileThatBecameAFolderIsFoundChanged) {
    Write("a", 5);
    Write("b");
    Show();
    Remove("a");
    Make("a");
    stage.Tick();
    EXPECT_EQ(stage.Events(), "AfterPaint RefreshFoundChanges");
    EXPECT_EQ(Rows(view), "a | b");
    EXPECT_EQ(SubItem(view, 1, 1), "1 KB");
    view.Show();
    EXPECT_EQ(Rows(view, 12), " a | b");
}

TEST_P(FileViewOnAnyDisk, AFolderThatBecameAFileIsFoundChanged) {
    Make("a");
    Show();
    Remove("a");
    Write("a", 5);
    stage.Tick();
    EXPECT_EQ(stage.Events(), "AfterPaint RefreshFoundChanges");
    EXPECT_EQ(Rows(view, 12), " a");
    view.Show();
    EXPECT_EQ(Rows(view, 1), "1 KB");
}

TEST_P(FileViewOnAnyDisk, AFileThatBecomesAFolderWhileItIsOfferedStandsAsItWas) {
    Write("a", 5);
    stage.handlers.On(fileview::BeforeAddItem, [&](bool&, std::string&) {
        Remove("a");
        Make("a");
    });
    Show();
    EXPECT_EQ(Rows(view, 1), "1 KB");
    stage.handlers = {};
    view.Show();
    EXPECT_EQ(Rows(view, 12), " a");
}

TEST_P(FileViewOnAnyDisk, AFolderThatBecomesAFileWhileItIsOfferedComesWithTheNextRefresh) {
    Make("a");
    Write("b");
    stage.handlers.On(fileview::BeforeAddItem, [&](bool&, std::string& path) {
        if (path != At("a")) return;
        Remove("a");
        Write("a", 5);
    });
    Show();
    EXPECT_EQ(Rows(view), "b");
    stage.handlers = {};
    stage.Tick();
    EXPECT_EQ(Rows(view, 1), "0 KB | 1 KB");
}

TEST_P(FileViewOnAnyDisk, AFolderThatHasGoneAndComeBackIsFollowed) {
    Write("a");
    Show();
    Remove("");
    Make("");
    Write("a");
    Write("b");
    stage.Tick();
    EXPECT_EQ(Rows(view), "a | b");
}

TEST_P(FileViewOnAnyDisk, TheTotalFollowsTheDisk) {
    Write("a", 10);
    Make("sub");
    Write("sub/b", 5);
    Show();
    EXPECT_EQ(view.TotalSize(), Variant(15));
    Write("sub/c", 100);
    EXPECT_EQ(view.TotalSize(), Variant(15));
    stage.Tick();
    EXPECT_EQ(view.TotalSize(), Variant(115));
}

TEST_P(FileViewOnAnyDisk, TheTotalOfALargeTreeComesInIdleTime) {
    for (int number = 0; number < 400; ++number) {
        const std::string folder = frame::Decimal(number);
        Make(folder);
        Write(folder + "/a", 1);
    }
    Show();
    EXPECT_FALSE(view.TotalSizeKnown());
    stage.host.clock.Advance(1'000);
    EXPECT_TRUE(view.TotalSizeKnown());
    EXPECT_EQ(view.TotalSize(), Variant(400));
}

// Searching.

TEST_P(FileViewOnAnyDisk, ASearchGoesIntoEachFolderAfterItsFiles) {
    for (const char* folder : {"one/deep", "two.txt"}) Make(folder);
    Write("a.txt", 1);
    Write("b.doc", 2);
    Write("one/c.txt", 4);
    Write("one/deep/d.txt", 8);
    Write("two.txt/e.txt", 16);
    view.Search("*.txt", At(""), true);
    EXPECT_EQ(Rows(view), "a.txt | c.txt | d.txt | e.txt");
    EXPECT_EQ(Told(Rows(view, 6)), " | /one | /one/deep | /two.txt");
    EXPECT_EQ(view.TotalSize(), Variant(29));
    EXPECT_EQ(view.FolderPath(), "");
    EXPECT_EQ(stage.EventsOfPaints(), "AfterPaint");
    view.Search("*.txt", At(""), false);
    EXPECT_EQ(Rows(view), "a.txt");
}

TEST_P(FileViewOnAnyDisk, ASearchPassesHiddenFoldersOver) {
    Make(".git");
    Write(".git/a");
    Make("sub");
    Write("sub/a");
    view.Search("a", At(""), true);
    EXPECT_EQ(Told(Rows(view, 6)), "/sub");
    view.SetAllowHiddenFiles(true);
    view.Search("a", At(""), true);
    EXPECT_EQ(Told(Rows(view, 6)), "/.git | /sub");
}

TEST_P(FileViewOnAnyDisk, ATreeMayVanishWhileItIsSearched) {
    for (const char* name : {"one/a", "two/a", "three/a"}) {
        Make(std::string(name).substr(0, std::string(name).size() - 2));
        Write(name);
    }
    stage.handlers.On(fileview::AfterAddItem, [&](std::int32_t&) { Remove(""); });
    view.Search("a", At(""), true);
    EXPECT_EQ(Told(Rows(view, 6)), "/one");
    EXPECT_EQ(stage.EventsOfPaints(), "AfterPaint");
}

TEST_P(FileViewOnAnyDisk, ATreeOfThreeHundredFoldersIsSearchedToItsEnd) {
    std::string names;
    for (int level = 100; level < 400; ++level) {
        names += (names.empty() ? "" : "/") + ("a folder called " + frame::Decimal(level));
        stage.Frame().Files().CreateFolder(At(names)).Check();
        stage.Frame().Files().CreateFile(At(names + "/leaf"), false).Check();
    }
    EXPECT_GT(At(names).size(), 5'000u);
    view.Search("leaf", At(""), true);
    EXPECT_EQ(view.ItemCount(), 300);
    EXPECT_EQ(SubItem(view, 300, 6), At(names));
}

// Changing the disk.

TEST_P(FileViewOnAnyDisk, AnItemIsRenamedUnlessTheNameIsTaken) {
    Write("a.txt", 7);
    Write("b.txt");
    Show();
    view.SetItemName("c.txt");
    EXPECT_TRUE(Exists("c.txt"));
    EXPECT_FALSE(Exists("a.txt"));
    EXPECT_EQ(Rows(view), "c.txt | b.txt");
    EXPECT_EQ(ErrorOf([&] { view.SetItemName("b.txt"); }), 58);
    EXPECT_TRUE(Exists("c.txt"));
}

TEST_P(FileViewOnAnyDisk, TheIconOfATypeLeavesNoFileBehind) {
    const std::string temporary = stage.Frame().Files().TemporaryFolder();
    EXPECT_TRUE(view.ImageLoadFileType("zip"));
    frame::FolderCounts counts;
    stage.Frame().Files().Count(temporary, counts).Check();
    EXPECT_EQ(counts, frame::FolderCounts());
    EXPECT_NE(view.Image16.ListImages.FindKey("zip"), nullptr);
}

}  // namespace
}  // namespace tessel::controls
