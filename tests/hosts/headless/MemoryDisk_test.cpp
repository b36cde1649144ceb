#include "hosts/headless/MemoryDisk.h"

#include <gtest/gtest.h>

#include "frame/Dates.h"
#include "hosts/headless/HeadlessHost.h"
#include "hosts/headless/Services.h"

namespace tessel::headless {
namespace {

namespace attributes = frame::attributes;
using frame::FileOperation;

class MemoryDiskTest : public testing::Test {
  protected:
    MemoryDiskTest() { disk_.Remove("C:\\Temp").Check(); }

    void File(const std::string& path, std::string contents = "") {
        disk_.SetFile(path, {.contents = std::move(contents)}).Check();
    }
    void Folder(const std::string& path) { disk_.SetFolder(path, {}).Check(); }
    /// "x a.txt:3": names below a folder, without the folder's path, files with their sizes.
    std::string Tree(const std::string& folder = "C:\\") {
        std::vector<MemoryDisk::Listed> all;
        disk_.ListTree(folder, all).Check();
        std::string text;
        for (const auto& entry : all) {
            text += (text.empty() ? "" : " ") + entry.path.substr(folder.size());
            if ((entry.attributes & attributes::directory) == 0) text += ":" + std::to_string(entry.size);
        }
        return text;
    }
    std::string Contents(const std::string& path) {
        std::unique_ptr<frame::BinaryFile> file;
        if (const auto status = disk_.OpenForReading(path, file); status.Failed()) return std::to_string(status.Number());
        std::string bytes(static_cast<std::size_t>(file->Size()), '?');
        std::size_t read = 0;
        file->Read(0, bytes.data(), bytes.size(), read).Check();
        return bytes;
    }
    int Run(FileOperation::Kind kind, std::vector<std::string> from, std::vector<std::string> to, int flags = renameOnCollision) {
        return disk_.Run({.kind = kind, .flags = flags, .from = std::move(from), .to = std::move(to)}).code;
    }
    int Copy(std::vector<std::string> from, const std::string& to, int flags = renameOnCollision) {
        return Run(FileOperation::Kind::Copy, std::move(from), {to}, flags);
    }
    int Move(std::vector<std::string> from, const std::string& to, int flags = renameOnCollision) {
        return Run(FileOperation::Kind::Move, std::move(from), {to}, flags);
    }
    int Delete(std::vector<std::string> from, int flags = allowUndo) {
        return Run(FileOperation::Kind::Delete, std::move(from), {}, flags);
    }
    frame::FileRecord RecordOf(const std::string& path) {
        frame::FileRecord record;
        disk_.Stat(path, record).Check();
        return record;
    }

    static constexpr int renameOnCollision = 8, allowUndo = 64;
    std::int64_t now_ = 5000;
    MemoryDisk disk_{[this] { return now_; }};
};

TEST(MemoryDisk, AtFirstHasADriveWithTheTemporaryFolder) {
    MemoryDisk disk;
    EXPECT_TRUE(disk.DriveExists("C:\\"));
    EXPECT_TRUE(disk.FolderExists("C:\\Temp"));
    EXPECT_EQ(disk.TemporaryFolder(), "C:\\Temp");
    EXPECT_EQ(disk.SpecialFolder(5), "C:\\My Documents");
    EXPECT_FALSE(disk.FolderExists("C:\\My Documents"));
    EXPECT_EQ(disk.SpecialFolder(0), "");
}

TEST(MemoryDisk, ItsTimesAreThoseOfTheHeadlessLocale) {
    FixedLocale locale;
    for (const char* text :
         {"2001-02-03 04:05:06", "1899-12-29 06:00:00", "1899-12-30 00:00:00", "1970-01-01 00:00:00", "1850-07-01 23:59:59"})
        EXPECT_EQ(frame::SortableDateText(locale.LocalTime(SecondsOf(*frame::ParseDate(text)))), text);
    EXPECT_EQ(SecondsOf(*frame::ParseDate("1970-01-02 00:00:01")), 86'401);
}

TEST_F(MemoryDiskTest, NamesAreFoundWithoutRegardToCaseAndKeepTheirOwn) {
    File("C:\\Sub\\\xC3\x84rger.TXT", "1");
    EXPECT_TRUE(disk_.FileExists("c:\\SUB\\\xC3\xA4rger.txt"));
    EXPECT_TRUE(disk_.DriveExists("c:\\"));
    EXPECT_EQ(disk_.CreateFolder("C:\\sub").Number(), 58);
    EXPECT_EQ(Tree(), "Sub Sub\\\xC3\x84rger.TXT:1");
    disk_.Rename("C:\\sub", "SUB").Check();
    EXPECT_EQ(Tree(), "SUB SUB\\\xC3\x84rger.TXT:1");
}

TEST_F(MemoryDiskTest, NamesAreInOrderWithoutRegardToCase) {
    for (const char* name : {"C:\\b", "C:\\A", "C:\\C", "C:\\_"}) File(name);
    EXPECT_EQ(Tree(), "_:0 A:0 b:0 C:0");
}

TEST_F(MemoryDiskTest, PathsMayTakeDetours) {
    File("C:\\Sub\\a.txt");
    for (const char* path :
         {"C:\\Sub\\\\a.txt", "C:\\.\\Sub\\a.txt", "C:\\none\\..\\Sub\\a.txt", "C:\\..\\Sub\\a.txt. ", "C:\\Sub.\\a.txt"})
        EXPECT_TRUE(disk_.FileExists(path)) << path;
    for (const char* path :
         {"Sub\\a.txt", "C:Sub\\a.txt", "C:/Sub/a.txt", "\\Sub\\a.txt", "D:\\Sub\\a.txt", "C:\\Sub\\...", "CC:\\"})
        EXPECT_FALSE(disk_.FileExists(path) || disk_.FolderExists(path)) << path;
}

TEST_F(MemoryDiskTest, NamesHaveNoneOfTheForbiddenCharacters) {
    for (const char* name : {"a/b", "a:b", "a*b", "a?b", "a\"b", "a<b", "a>b", "a|b", "a\x01z", "a\tb"}) {
        EXPECT_EQ(disk_.CreateFolder(std::string("C:\\") + name).Number(), 52) << name;
        EXPECT_EQ(disk_.SetFile(std::string("C:\\") + name, {}).Number(), 52) << name;
    }
    File("C:\\a");
    EXPECT_EQ(disk_.Rename("C:\\a", "a\\b").Number(), 52);
    disk_.Rename("C:\\a", "b. ").Check();
    EXPECT_EQ(Tree(), "b:0");
}

TEST_F(MemoryDiskTest, DrivesComeByLetterAndThenShares) {
    disk_.SetDrive("", {.share = "\\\\server\\music"}).Check();
    disk_.SetDrive("d:\\", {.type = 4, .volume = "DISC"}).Check();
    disk_.SetDrive("A", {.type = 1, .volume = "X", .ready = false}).Check();
    disk_.SetDrive("N:", {.type = 3, .share = "\\\\server\\data"}).Check();
    const auto drives = disk_.Drives();
    ASSERT_EQ(drives.size(), 5u);
    EXPECT_EQ(drives[0], (frame::DriveRecord{"A:", "A:\\", "A", 1, "", "", false})) << "a drive that is not ready tells no volume";
    EXPECT_EQ(drives[1], (frame::DriveRecord{"C:", "C:\\", "C", 2, "", "", true}));
    EXPECT_EQ(drives[2], (frame::DriveRecord{"D:", "D:\\", "D", 4, "", "DISC", true}));
    EXPECT_EQ(drives[3], (frame::DriveRecord{"N:", "N:\\", "N", 3, "\\\\server\\data", "", true}));
    EXPECT_EQ(drives[4], (frame::DriveRecord{"\\\\server\\music", "\\\\server\\music\\", "", 3, "\\\\server\\music", "", true}));
}

TEST_F(MemoryDiskTest, AShareWithoutALetterHoldsFiles) {
    disk_.SetDrive("", {.share = "\\\\server\\music"}).Check();
    File("\\\\server\\music\\a\\b.txt", "12");
    EXPECT_TRUE(disk_.FileExists("\\\\SERVER\\music\\a\\b.txt"));
    EXPECT_TRUE(disk_.FolderExists("\\\\server\\music"));
    EXPECT_TRUE(disk_.DriveExists("\\\\server\\music\\"));
    EXPECT_FALSE(disk_.FolderExists("\\\\server\\musical"));
    EXPECT_EQ(disk_.SetDrive("", {}).Number(), 52);
    EXPECT_EQ(disk_.SetDrive("", {.share = "\\\\server"}).Number(), 52);
    EXPECT_EQ(disk_.SetDrive("7", {}).Number(), 52);
    EXPECT_EQ(disk_.SetDrive("CD", {}).Number(), 52);
}

TEST_F(MemoryDiskTest, ADriveThatIsNotReadyHoldsNothingUntilItIs) {
    File("A:\\a.txt", "1");
    disk_.SetDrive("A", {.ready = false}).Check();
    frame::FileRecord record;
    std::unique_ptr<frame::FolderListing> listing;
    frame::FolderCounts counts;
    EXPECT_TRUE(disk_.DriveExists("A:\\"));
    EXPECT_FALSE(disk_.FolderExists("A:\\") || disk_.FileExists("A:\\a.txt"));
    EXPECT_EQ(disk_.Stat("A:\\a.txt", record).Number(), 71);
    EXPECT_EQ(disk_.List("A:\\", listing).Number(), 71);
    EXPECT_EQ(disk_.Count("A:\\", counts).Number(), 71);
    EXPECT_EQ(disk_.CreateFolder("A:\\x").Number(), 71);
    disk_.SetDrive("A", {.ready = true}).Check();
    EXPECT_TRUE(disk_.FileExists("A:\\a.txt"));
}

TEST_F(MemoryDiskTest, AReadOnlyDriveTakesNothing) {
    File("D:\\a.txt", "1");
    disk_.SetDrive("D", {.readOnly = true}).Check();
    EXPECT_EQ(disk_.CreateFolder("D:\\x").Number(), 70);
    EXPECT_EQ(disk_.CreateFile("D:\\x", true).Number(), 70);
    EXPECT_EQ(disk_.CreateFile("D:\\a.txt", true).Number(), 70);
    EXPECT_EQ(disk_.DeleteFile("D:\\a.txt", true).Number(), 70);
    EXPECT_EQ(disk_.Rename("D:\\a.txt", "b").Number(), 70);
    EXPECT_EQ(disk_.SetAttributes("D:\\a.txt", 2).Number(), 70);
    EXPECT_FALSE(disk_.SetAttributes("D:\\a.txt", 0).Failed()) << "nothing differs";
    EXPECT_EQ(disk_.WriteOver("D:\\a.txt", "2").Number(), 70);
    EXPECT_EQ(Contents("D:\\a.txt"), "1");
}

TEST_F(MemoryDiskTest, AllAttributesAreKept) {
    File("C:\\a.txt");
    constexpr int all = attributes::readOnly | attributes::hidden | attributes::system | attributes::archive;
    disk_.SetAttributes("C:\\a.txt", all).Check();
    EXPECT_EQ(RecordOf("C:\\a.txt").attributes, all);
    disk_.SetAttributes("C:\\a.txt", attributes::hidden).Check();
    EXPECT_EQ(RecordOf("C:\\a.txt").attributes, attributes::hidden);
}

TEST_F(MemoryDiskTest, SettingUpUpdatesOnlyWhatIsGiven) {
    disk_.SetFile("C:\\a.txt", {.attributes = 2, .contents = "123", .created = 1, .modified = 2, .accessed = 3, .type = "Letter"})
        .Check();
    disk_.SetFile("C:\\A.TXT", {.modified = 20}).Check();
    const auto record = RecordOf("C:\\a.txt");
    EXPECT_EQ(record.attributes, 2);
    EXPECT_EQ(record.size, 3);
    EXPECT_EQ(record.created, 1);
    EXPECT_EQ(record.modified, 20);
    EXPECT_EQ(record.accessed, 3);
    EXPECT_EQ(disk_.TypeText(record.typeId), "Letter");
    EXPECT_EQ(Contents("C:\\a.txt"), "123");
    EXPECT_EQ(disk_.SetFolder("C:\\a.txt", {}).Number(), 58);
    EXPECT_EQ(disk_.SetFile("C:\\", {}).Number(), 52);
}

TEST_F(MemoryDiskTest, ASizeNeedsNoContents) {
    disk_.SetFile("C:\\a.bin", {.size = 5'000'000'000}).Check();
    EXPECT_EQ(RecordOf("C:\\a.bin").size, 5'000'000'000);
    EXPECT_EQ(disk_.MeasureTree("C:\\")->Finish(), 5'000'000'000);
    disk_.SetFile("C:\\b.bin", {.size = 4, .contents = "12"}).Check();
    EXPECT_EQ(Contents("C:\\b.bin"), std::string("12\0\0", 4));
    disk_.SetFile("C:\\b.bin", {.size = 1}).Check();
    EXPECT_EQ(Contents("C:\\b.bin"), "1");
    disk_.WriteOver("C:\\a.bin", "start").Check();
    EXPECT_EQ(RecordOf("C:\\a.bin").size, 5'000'000'000) << "what stood behind stays";
}

TEST_F(MemoryDiskTest, WhatIsMadeHasTheTimeOfNow) {
    disk_.CreateFolder("C:\\sub").Check();
    disk_.WriteOver("C:\\a.txt", "1").Check();
    now_ = 6000;
    disk_.WriteOver("C:\\a.txt", "2").Check();
    EXPECT_EQ(RecordOf("C:\\sub").created, 5000);
    EXPECT_EQ(RecordOf("C:\\a.txt").created, 5000);
    EXPECT_EQ(RecordOf("C:\\a.txt").modified, 6000);
}

TEST_F(MemoryDiskTest, WhatCannotBeReadIsStillThere) {
    File("C:\\sub\\a.txt", "123");
    File("C:\\b.txt", "12");
    disk_.SetFolder("C:\\sub", {.unreadable = true}).Check();
    disk_.SetFile("C:\\b.txt", {.unreadable = true}).Check();
    std::unique_ptr<frame::FolderListing> listing;
    frame::FolderCounts counts;
    EXPECT_TRUE(disk_.FolderExists("C:\\sub"));
    EXPECT_EQ(disk_.List("C:\\sub", listing).Number(), 70);
    EXPECT_EQ(disk_.Count("C:\\sub", counts).Number(), 70);
    EXPECT_EQ(Contents("C:\\b.txt"), "70");
    EXPECT_EQ(disk_.WriteOver("C:\\b.txt", "x").Number(), 70);
    EXPECT_EQ(RecordOf("C:\\b.txt").size, 2);
    EXPECT_EQ(disk_.MeasureTree("C:\\")->Finish(), 2) << "the folder that cannot be read is left out";
}

TEST_F(MemoryDiskTest, AReadOnlyFileIsNotWrittenOver) {
    File("C:\\a.txt", "1");
    disk_.SetAttributes("C:\\a.txt", attributes::readOnly).Check();
    EXPECT_EQ(disk_.WriteOver("C:\\a.txt", "2").Number(), 70);
    EXPECT_EQ(disk_.CreateFile("C:\\a.txt", true).Number(), 70);
    EXPECT_EQ(Contents("C:\\a.txt"), "1");
}

TEST_F(MemoryDiskTest, TheFreeSpaceLimitsWhatIsStillWritten) {
    disk_.SetFree(10);
    EXPECT_FALSE(disk_.WriteOver("C:\\a.txt", "123456").Failed());
    EXPECT_EQ(disk_.WriteOver("C:\\a.txt", "abcde").Number(), 61);
    EXPECT_EQ(Contents("C:\\a.txt"), "123456");
    EXPECT_EQ(disk_.WriteOver("C:\\b.txt", "abcde").Number(), 61);
    EXPECT_FALSE(disk_.FileExists("C:\\b.txt"));
    EXPECT_FALSE(disk_.WriteOver("C:\\a.txt", "abcd").Failed());
    disk_.SetFree({});
    EXPECT_FALSE(disk_.WriteOver("C:\\b.txt", std::string(1000, 'x')).Failed());
}

TEST_F(MemoryDiskTest, ThingsAreRemovedAndDrivesToo) {
    File("C:\\sub\\a.txt");
    EXPECT_FALSE(disk_.Remove("c:\\SUB").Failed());
    EXPECT_EQ(Tree(), "");
    EXPECT_EQ(disk_.Remove("C:\\sub").Number(), 53);
    EXPECT_EQ(disk_.Remove("C:\\sub\\a.txt").Number(), 76);
    EXPECT_FALSE(disk_.Remove("C:\\").Failed());
    EXPECT_FALSE(disk_.DriveExists("C:\\"));
    EXPECT_EQ(disk_.Remove("C:\\").Number(), 76);
    EXPECT_EQ(disk_.TemporaryFolder(), "");
}

TEST(MemoryDisk, AnEarlierDriveDoesNotTakeTheTemporaryFolderOver) {
    MemoryDisk disk;
    disk.SetDrive("A", {.type = frame::driveTypes::removable}).Check();
    EXPECT_EQ(disk.TemporaryFolder(), "C:\\Temp");
    disk.Remove("C:\\Temp").Check();
    EXPECT_EQ(disk.TemporaryFolder(), "A:\\Temp") << "where it would be made";
}

TEST_F(MemoryDiskTest, PicturesHaveASize) {
    disk_.SetFile("C:\\p.bmp", {.picture = std::pair(1500.0f, 900.0f)}).Check();
    EXPECT_EQ(disk_.PictureSize("C:\\p.bmp"), std::pair(1500.0f, 900.0f));
    EXPECT_EQ(disk_.PictureSize("C:\\q.bmp"), std::nullopt);
}

TEST_F(MemoryDiskTest, ATreeIsListedWithEachFolderBeforeWhatItHolds) {
    File("C:\\b.txt", "1");
    File("C:\\sub\\deep\\c.txt", "12");
    File("C:\\sub\\a.txt");
    Folder("C:\\zub");
    EXPECT_EQ(Tree(), "sub sub\\deep sub\\deep\\c.txt:2 sub\\a.txt:0 zub b.txt:1");
    std::vector<MemoryDisk::Listed> all;
    EXPECT_EQ(disk_.ListTree("C:\\b.txt", all).Number(), 76);
    EXPECT_EQ(disk_.ListTree("C:\\none", all).Number(), 76);
}

// Operations.

TEST_F(MemoryDiskTest, FilesAndFoldersAreCopiedIntoAFolder) {
    File("C:\\a.txt", "1");
    File("C:\\sub\\b.txt", "12");
    Folder("C:\\to");
    EXPECT_EQ(Copy({"C:\\a.txt", "C:\\sub"}, "C:\\to"), 0);
    EXPECT_EQ(Tree(), "sub sub\\b.txt:2 to to\\sub to\\sub\\b.txt:2 to\\a.txt:1 a.txt:1");
    EXPECT_EQ(Contents("C:\\to\\sub\\b.txt"), "12");
}

TEST_F(MemoryDiskTest, ACopyIsCreatedNowAndKeepsTheRest) {
    disk_
        .SetFile("C:\\a.txt",
                 {.attributes = 3, .size = 7, .contents = "1", .created = 1, .modified = 2, .accessed = 3, .type = "T"})
        .Check();
    EXPECT_EQ(Copy({"C:\\a.txt"}, "C:\\b.txt"), 0);
    const auto copy = RecordOf("C:\\b.txt");
    EXPECT_EQ(copy.attributes, 3);
    EXPECT_EQ(copy.size, 7);
    EXPECT_EQ(copy.created, 5000);
    EXPECT_EQ(copy.modified, 2);
    EXPECT_EQ(copy.accessed, 5000);
    EXPECT_EQ(disk_.TypeText(copy.typeId), "T");
}

TEST_F(MemoryDiskTest, WhatIsMovedKeepsAll) {
    disk_.SetFile("C:\\sub\\a.txt", {.contents = "1", .created = 1, .modified = 2, .accessed = 3}).Check();
    Folder("D:\\to");
    const auto before = RecordOf("C:\\sub\\a.txt");
    EXPECT_EQ(Move({"C:\\sub"}, "D:\\to"), 0);
    EXPECT_EQ(Tree(), "");
    EXPECT_EQ(Tree("D:\\"), "to to\\sub to\\sub\\a.txt:1");
    EXPECT_EQ(RecordOf("D:\\to\\sub\\a.txt"), before);
}

TEST_F(MemoryDiskTest, ATargetThatIsMissingBecomesTheNameOfOneOrTheFolderOfSeveral) {
    File("C:\\a.txt", "1");
    File("C:\\b.txt", "2");
    EXPECT_EQ(Copy({"C:\\a.txt"}, "C:\\x\\y.txt"), 0);
    EXPECT_EQ(Copy({"C:\\a.txt", "C:\\b.txt"}, "C:\\z"), 0);
    EXPECT_EQ(Tree(), "x x\\y.txt:1 z z\\a.txt:1 z\\b.txt:1 a.txt:1 b.txt:1");
    EXPECT_EQ(Copy({"C:\\a.txt", "C:\\b.txt"}, "C:\\x\\y.txt"), 80) << "several into a file";
    EXPECT_EQ(Copy({"C:\\a.txt"}, "C:\\x*y"), 123);
}

TEST_F(MemoryDiskTest, ANameInUseGetsCopyBeforeIt) {
    File("C:\\a.txt", "1");
    File("C:\\to\\A.txt", "2");
    EXPECT_EQ(Copy({"C:\\a.txt"}, "C:\\to"), 0);
    EXPECT_EQ(Copy({"C:\\a.txt"}, "C:\\to"), 0);
    EXPECT_EQ(Move({"C:\\a.txt"}, "C:\\to\\a.txt"), 0);
    EXPECT_EQ(Tree("C:\\to\\"), "A.txt:1 Copy (2) of a.txt:1 Copy (3) of a.txt:1 Copy of a.txt:1");
    EXPECT_EQ(Contents("C:\\to\\A.txt"), "2");
    EXPECT_EQ(Copy({"C:\\to"}, "C:\\"), 0);
    EXPECT_TRUE(disk_.FileExists("C:\\Copy of to\\A.txt"));
}

TEST_F(MemoryDiskTest, WithoutRenamingFilesAreReplacedAndFoldersMerged) {
    File("C:\\from\\s\\a.txt", "new");
    File("C:\\from\\s\\b.txt", "b");
    File("C:\\to\\s\\a.txt", "old!");
    File("C:\\to\\s\\c.txt", "c");
    EXPECT_EQ(Copy({"C:\\from\\s"}, "C:\\to", 0), 0);
    EXPECT_EQ(Tree("C:\\to\\"), "s s\\a.txt:3 s\\b.txt:1 s\\c.txt:1");
    disk_.SetFile("C:\\to\\s\\a.txt", {.contents = "older"}).Check();
    EXPECT_EQ(Move({"C:\\from\\s"}, "C:\\to", 0), 0);
    EXPECT_EQ(Tree(), "from to to\\s to\\s\\a.txt:3 to\\s\\b.txt:1 to\\s\\c.txt:1");
    File("C:\\s\\x.txt");
    File("C:\\to2\\s");
    EXPECT_EQ(Move({"C:\\s"}, "C:\\to2", 0), 80) << "a folder does not replace a file";
}

TEST_F(MemoryDiskTest, ACopyInItsOwnFolderGetsAnotherNameAndAMoveIsRefused) {
    File("C:\\a.txt", "1");
    Folder("C:\\sub");
    EXPECT_EQ(Copy({"C:\\a.txt"}, "C:\\"), 0);
    EXPECT_EQ(Move({"C:\\a.txt"}, "C:\\"), 113);
    EXPECT_EQ(Copy({"C:\\a.txt"}, "C:\\", 0), 113);
    EXPECT_EQ(Copy({"C:\\sub"}, "C:\\"), 0);
    EXPECT_EQ(Tree(), "Copy of sub sub a.txt:1 Copy of a.txt:1");
}

TEST_F(MemoryDiskTest, AFolderDoesNotGoIntoItself) {
    File("C:\\sub\\deep\\a.txt");
    for (const char* to : {"C:\\sub", "C:\\sub\\deep", "C:\\sub\\new", "C:\\sub\\deep\\new"}) {
        EXPECT_EQ(Copy({"C:\\sub"}, to), 125) << to;
        EXPECT_EQ(Move({"C:\\sub"}, to), 125) << to;
    }
}

TEST_F(MemoryDiskTest, AFolderMayBeMergedWithTheOneThatHoldsIt) {
    File("C:\\a\\a\\a\\x.txt", "1");
    File("C:\\a\\a\\y.txt", "2");
    EXPECT_EQ(Move({"C:\\a\\a"}, "C:\\", 0), 0);
    EXPECT_TRUE(disk_.FileExists("C:\\a\\y.txt"));
    EXPECT_EQ(disk_.MeasureTree("C:\\")->Finish(), 2);
}

TEST_F(MemoryDiskTest, AnOperationIsRefusedWholeBeforeAnythingIsTouched) {
    File("C:\\a.txt");
    Folder("C:\\to");
    EXPECT_EQ(Copy({"C:\\a.txt", "C:\\none.txt"}, "C:\\to"), 2);
    EXPECT_EQ(Delete({"C:\\a.txt", "C:\\none.txt"}), 2);
    EXPECT_EQ(Delete({"C:\\a.txt", "C:\\none\\x.txt"}), 3);
    EXPECT_EQ(Delete({"C:\\a.txt", "a.txt"}), 3);
    EXPECT_EQ(Delete({"C:\\a.txt", "C:\\"}), 5) << "a drive";
    EXPECT_EQ(Delete({}), 87);
    EXPECT_EQ(Move({"C:\\a.txt"}, "to"), 3);
    EXPECT_EQ(Run(FileOperation::Kind::Move, {"C:\\a.txt"}, {}), 87);
    EXPECT_EQ(Run(FileOperation::Kind::Move, {"C:\\a.txt"}, {"C:\\to", "C:\\to"}), 87);
    disk_.SetDrive("A", {.ready = false}).Check();
    EXPECT_EQ(Move({"C:\\a.txt"}, "A:\\"), 21);
    EXPECT_EQ(Tree(), "to a.txt:0");
}

TEST_F(MemoryDiskTest, ProtectedDrivesAndFilesThatCannotBeReadStopAnOperation) {
    File("C:\\a.txt", "1");
    File("D:\\b.txt", "2");
    disk_.SetDrive("D", {.readOnly = true}).Check();
    EXPECT_EQ(Copy({"C:\\a.txt"}, "D:\\"), 19);
    EXPECT_EQ(Move({"D:\\b.txt"}, "C:\\"), 19);
    EXPECT_EQ(Delete({"D:\\b.txt"}), 19);
    EXPECT_EQ(Copy({"D:\\b.txt"}, "C:\\"), 0);
    disk_.SetFile("C:\\a.txt", {.unreadable = true}).Check();
    EXPECT_EQ(Copy({"C:\\a.txt"}, "C:\\x.txt"), 5);
    EXPECT_EQ(Tree(), "a.txt:1 b.txt:1");
}

TEST_F(MemoryDiskTest, AFullDiskStopsACopyAndKeepsWhatWasDone) {
    File("C:\\a.txt", "123");
    File("C:\\b.txt", "123");
    Folder("C:\\to");
    disk_.SetFree(4);
    EXPECT_EQ(Copy({"C:\\a.txt", "C:\\b.txt"}, "C:\\to"), 112);
    EXPECT_EQ(Tree("C:\\to\\"), "a.txt:3");
    EXPECT_EQ(Move({"C:\\b.txt"}, "C:\\to"), 0) << "moving writes no bytes";
}

TEST_F(MemoryDiskTest, WhatIsDeletedCanBeRestoredUnlessItIsForGood) {
    File("C:\\sub\\a.txt", "1");
    File("C:\\b.txt", "2");
    disk_.SetAttributes("C:\\b.txt", attributes::readOnly).Check();
    EXPECT_EQ(Delete({"C:\\SUB"}), 0);
    EXPECT_EQ(Delete({"C:\\b.txt"}, 0), 0);
    EXPECT_EQ(Tree(), "");
    EXPECT_EQ(disk_.Recycled(), std::vector<std::string>{"C:\\sub"});
    EXPECT_EQ(disk_.Restore("C:\\b.txt").Number(), 53);
    Folder("C:\\sub");
    EXPECT_EQ(disk_.Restore("C:\\sub").Number(), 58);
    disk_.Remove("C:\\sub").Check();
    EXPECT_FALSE(disk_.Restore("C:\\sub").Failed());
    EXPECT_EQ(Tree(), "sub sub\\a.txt:1");
    EXPECT_TRUE(disk_.Recycled().empty());
}

// In a host.

TEST(HeadlessDisk, CarriesOutWhatTheShellIsAskedUnlessAResultIsQueued) {
    HeadlessHost host;
    host.files.SetFile("C:\\a.txt", {}).Check();
    host.shell.operationResults = {{.code = 7}};
    const FileOperation operation{.kind = FileOperation::Kind::Copy, .flags = 8, .from = {"C:\\a.txt"}, .to = {"C:\\Temp"}};
    EXPECT_EQ(host.Frame().Run(operation).code, 7);
    EXPECT_FALSE(host.files.FileExists("C:\\Temp\\a.txt"));
    EXPECT_EQ(host.Frame().Run(operation).code, 0);
    EXPECT_TRUE(host.files.FileExists("C:\\Temp\\a.txt"));
    EXPECT_EQ(host.log.Of("operation").size(), 2u);
}

TEST(HeadlessDisk, TakesItsTimeFromTheHostsClock) {
    HeadlessHost host;
    host.clock.SetNow(*frame::ParseDate("2001-02-03 04:05:06"));
    host.Frame().Files().CreateFolder("C:\\x").Check();
    frame::FileRecord record;
    host.Frame().Files().Stat("C:\\x", record).Check();
    EXPECT_EQ(frame::SortableDateText(host.locale.LocalTime(record.created)), "2001-02-03 04:05:06");
}

TEST(HeadlessDisk, GivesWayToAnotherFileSystem) {
    MemoryDisk other;
    other.SetFile("C:\\other.txt", {}).Check();
    HeadlessHost host(&other);
    EXPECT_TRUE(host.Frame().Files().FileExists("C:\\other.txt"));
    const FileOperation operation{.kind = FileOperation::Kind::Delete, .flags = 0, .from = {"C:\\other.txt"}, .to = {}};
    EXPECT_EQ(host.Frame().Run(operation).systemError, 120);
    EXPECT_TRUE(other.FileExists("C:\\other.txt"));
}

}  // namespace
}  // namespace tessel::headless
