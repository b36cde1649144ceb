#include "hosts/posix/DiskFileSystem.h"

#include <gtest/gtest.h>
#include <sys/resource.h>
#include <sys/xattr.h>

#include <csignal>
#include <ctime>

#include "tests/hosts/TestFolder.h"

namespace tessel::posix {
namespace {

using frame::FileRecord;
using test::LesserUser;
namespace attributes = frame::attributes;
namespace fs = std::filesystem;

std::size_t OpenFiles() { return static_cast<std::size_t>(std::distance(fs::directory_iterator("/proc/self/fd"), {})); }

class DiskFileSystemTest : public testing::Test {
  protected:
    DiskFileSystemTest() { umask(022); }

    static DiskSettings SettingsFor(const test::TestFolder& folder) {
        auto settings = DiskSettings::OfThisProcess();
        settings.home = folder / "home";
        settings.configHome = folder / "home/config";
        settings.dataHome = folder / "home/data";
        settings.temporaryFolder = folder / "tmp";
        return settings;
    }
    /// With the user who runs now.
    DiskFileSystem Disk() const { return DiskFileSystem(SettingsFor(folder_)); }

    std::string Rows(std::string_view path) {
        std::unique_ptr<frame::FolderListing> listing;
        if (const auto status = disk_.List(path, listing); status.Failed()) return std::to_string(status.Number());
        std::string rows;
        for (std::size_t i = 0; i < listing->Count(); ++i)
            rows += (i > 0 ? "|" : "") + std::string(listing->Name(i)) + (listing->IsFolder(i) ? "/" : "");
        return rows;
    }
    FileRecord RecordOf(std::string_view name) {
        FileRecord record;
        EXPECT_EQ(disk_.Stat(folder_ / name, record).Number(), 0) << name;
        return record;
    }
    std::string Contents(const std::string& path) {
        std::unique_ptr<frame::BinaryFile> file;
        if (const auto status = disk_.OpenForReading(path, file); status.Failed()) return std::to_string(status.Number());
        std::string bytes(static_cast<std::size_t>(file->Size()), '?');
        std::size_t read = 0;
        file->Read(0, bytes.data(), bytes.size(), read).Check();
        return bytes;
    }

    test::TestFolder folder_;
    DiskFileSystem disk_{SettingsFor(folder_)};
};

// Records.

TEST_F(DiskFileSystemTest, WhatBeginsWithAPointIsHidden) {
    folder_.Write(".a", "");
    folder_.Write("b.a", "");
    folder_.Make(".sub");
    EXPECT_EQ(RecordOf(".a").attributes, attributes::hidden);
    EXPECT_EQ(RecordOf("b.a").attributes, 0);
    EXPECT_EQ(RecordOf(".sub").attributes, attributes::hidden | attributes::directory);
}

TEST_F(DiskFileSystemTest, WhatCannotBeKeptIsRefusedAndChangesNothing) {
    folder_.Write("a", "");
    folder_.Write(".b", "");
    for (const int bit : {attributes::hidden, attributes::system, attributes::archive}) {
        EXPECT_EQ(disk_.SetAttributes(folder_ / "a", bit).Number(), 5);
        EXPECT_EQ(disk_.SetAttributes(folder_ / "a", bit | attributes::readOnly).Number(), 5);
    }
    EXPECT_EQ(disk_.SetAttributes(folder_ / ".b", 0).Number(), 5) << "hidden cannot be cleared either";
    EXPECT_EQ(folder_.Mode("a"), 0644u);
    EXPECT_FALSE(disk_.SetAttributes(folder_ / ".b", attributes::hidden | attributes::readOnly).Failed());
    EXPECT_EQ(folder_.Mode(".b"), 0444u);
}

TEST_F(DiskFileSystemTest, ReadOnlyTakesWritingFromAllAndClearingGivesItToTheOwner) {
    folder_.Write("a", "");
    folder_.SetMode("a", 04766);
    disk_.SetAttributes(folder_ / "a", attributes::readOnly).Check();
    EXPECT_EQ(folder_.Mode("a"), 04544u);
    disk_.SetAttributes(folder_ / "a", attributes::readOnly).Check();
    EXPECT_EQ(folder_.Mode("a"), 04544u);
    disk_.SetAttributes(folder_ / "a", 0).Check();
    EXPECT_EQ(folder_.Mode("a"), 04744u);
    folder_.SetMode("a", 0622);
    disk_.SetAttributes(folder_ / "a", 0).Check();
    EXPECT_EQ(folder_.Mode("a"), 0622u) << "no bit differs";
}

TEST(DiskUser, MayWriteAsTheOwnerTheGroupOrAnyoneElse) {
    const DiskUser user{.user = 1000, .groups = {100, 50}};
    EXPECT_TRUE(user.MayWrite(0200, 1000, 7));
    EXPECT_FALSE(user.MayWrite(0066, 1000, 100)) << "the owner's own bit counts alone";
    EXPECT_TRUE(user.MayWrite(0020, 7, 50));
    EXPECT_FALSE(user.MayWrite(0606, 7, 50));
    EXPECT_TRUE(user.MayWrite(0002, 7, 7));
    EXPECT_FALSE(user.MayWrite(0664, 7, 7));
    const DiskUser super{.user = 0, .groups = {0}};
    EXPECT_TRUE(super.MayWrite(0002, 7, 7));
    EXPECT_TRUE(super.MayWrite(0200, 7, 7));
    EXPECT_FALSE(super.MayWrite(0555, 0, 0)) << "so that what it has set read-only shows as that";
}

TEST_F(DiskFileSystemTest, SizesGoBeyondFourGibibytes) {
    folder_.Write("a", "1");
    fs::resize_file(folder_ / "a", 6'000'000'000);
    EXPECT_EQ(RecordOf("a").size, 6'000'000'000);
    EXPECT_EQ(disk_.MeasureTree(folder_.Path())->Finish(), 6'000'000'000);
    std::unique_ptr<frame::BinaryFile> file;
    disk_.OpenForReading(folder_ / "a", file).Check();
    char byte = '?';
    std::size_t read = 0;
    file->Read(5'999'999'999, &byte, 1, read).Check();
    EXPECT_EQ(read, 1u);
    EXPECT_EQ(byte, '\0');
}

TEST_F(DiskFileSystemTest, TimesAreWholeSecondsCutNotRounded) {
    folder_.Write("a", "");
    folder_.SetTimes("a", 1'000'000'000, -5);
    EXPECT_EQ(RecordOf("a").modified, 1'000'000'000);
    EXPECT_EQ(RecordOf("a").accessed, -5);
}

TEST_F(DiskFileSystemTest, TheTimeOfCreationIsTheBirthOfTheFileOrElseItsChange) {
    folder_.Write("a", "");
    folder_.SetTimes("a", 1'000'000'000, 1'000'000'000);
    struct statx told {};
    ASSERT_EQ(statx(AT_FDCWD, (folder_ / "a").c_str(), 0, STATX_BTIME, &told), 0);
    const bool hasBirth = (told.stx_mask & STATX_BTIME) != 0;
    EXPECT_EQ(RecordOf("a").created, hasBirth ? told.stx_btime.tv_sec : 1'000'000'000);
    auto settings = SettingsFor(folder_);
    settings.useStatx = false;
    DiskFileSystem older(settings);
    FileRecord record;
    older.Stat(folder_ / "a", record).Check();
    EXPECT_EQ(record.created, 1'000'000'000);
}

// Names and paths.

TEST_F(DiskFileSystemTest, AnyBytesMakeAName) {
    const std::string longest = std::string(254, 'x') + "\xE4";
    for (const std::string& name : {std::string("a\nb"), std::string("\xFF\xFE.txt"), longest, std::string("-rf"),
                                    std::string(" a ."), std::string("a\\b:*?")})
        folder_.Write(name, "1");
    EXPECT_EQ(Rows(folder_.Path()), " a .|-rf|a\nb|a\\b:*?|" + longest + "|\xFF\xFE.txt");
    for (const std::string& name : {std::string("a\nb"), std::string("\xFF\xFE.txt"), longest}) {
        EXPECT_EQ(RecordOf(name).size, 1);
        EXPECT_EQ(Contents(folder_ / name), "1");
    }
}

TEST_F(DiskFileSystemTest, CaseCounts) {
    folder_.Write("a", "");
    folder_.Write("B", "");
    EXPECT_EQ(Rows(folder_.Path()), "B|a");
    EXPECT_FALSE(disk_.FileExists(folder_ / "A"));
    EXPECT_FALSE(disk_.Rename(folder_ / "a", "A").Failed());
    EXPECT_EQ(Rows(folder_.Path()), "A|B");
}

TEST_F(DiskFileSystemTest, APathMayBeLongerThanTheSystemTakesAtOnce) {
    const std::size_t before = OpenFiles();
    std::string path = folder_.Path();
    while (path.size() < 15'000) {
        path += "/" + std::string(200, static_cast<char>('a' + path.size() % 26));
        ASSERT_FALSE(disk_.CreateFolder(path).Failed()) << path.size();
    }
    EXPECT_TRUE(disk_.FolderExists(path));
    EXPECT_FALSE(disk_.FileExists(path));
    EXPECT_FALSE(disk_.CreateFile(path + "/empty", false).Failed());
    EXPECT_FALSE(disk_.WriteOver(path + "/a.txt", "12345").Failed());
    EXPECT_FALSE(disk_.WriteOver(path + "/a.txt", "67").Failed());
    EXPECT_EQ(Contents(path + "/a.txt"), "67345");
    EXPECT_EQ(Rows(path), "a.txt|empty");
    EXPECT_EQ(Rows(path + "/"), "a.txt|empty");
    FileRecord record;
    disk_.Stat(path + "/a.txt", record).Check();
    EXPECT_EQ(record.size, 5);
    EXPECT_EQ(disk_.Stat(path + "/none", record).Number(), 53);
    EXPECT_EQ(disk_.Stat(path + "/none/none", record).Number(), 76);
    disk_.SetAttributes(path + "/a.txt", attributes::readOnly).Check();
    disk_.Stat(path + "/a.txt", record).Check();
    EXPECT_EQ(record.attributes, attributes::readOnly);
    EXPECT_FALSE(disk_.Rename(path + "/a.txt", "b.txt").Failed());
    EXPECT_FALSE(disk_.DeleteFile(path + "/empty", false).Failed());
    frame::FolderCounts counts;
    disk_.Count(path, counts).Check();
    EXPECT_EQ(counts, (frame::FolderCounts{1, 0}));
    EXPECT_EQ(disk_.MeasureTree(path)->Finish(), 5);
    EXPECT_EQ(disk_.MeasureTree(folder_.Path())->Finish(), 5);
    EXPECT_FALSE(disk_.FolderExists(folder_.Path() + "/" + std::string(5000, 'x')));
    EXPECT_EQ(OpenFiles(), before);
}

TEST_F(DiskFileSystemTest, ManySeparatorsAreOne) {
    folder_.Make("sub");
    folder_.Write("sub/a", "1");
    const std::string separators(5000, '/');
    EXPECT_EQ(Contents(folder_.Path() + separators + "sub" + separators + "a"), "1");
    EXPECT_EQ(Rows(folder_.Path() + separators + "sub" + separators), "a");
}

// Links.

TEST_F(DiskFileSystemTest, ALinkIsWhatItLeadsTo) {
    folder_.Make("sub");
    folder_.Write("sub/a.txt", "123");
    fs::create_symlink(folder_ / "sub", folder_ / "tosub");
    fs::create_symlink("sub/a.txt", folder_ / "toa");
    fs::create_symlink("none", folder_ / "tonone");
    fs::create_symlink("loop", folder_ / "loop");
    EXPECT_EQ(Rows(folder_.Path()), "sub/|tosub/|loop|toa|tonone");
    EXPECT_TRUE(disk_.FolderExists(folder_ / "tosub"));
    EXPECT_EQ(Rows(folder_ / "tosub"), "a.txt");
    std::unique_ptr<frame::FolderListing> listing;
    disk_.List(folder_.Path(), listing).Check();
    EXPECT_FALSE(listing->IsLink(0));
    EXPECT_TRUE(listing->IsLink(1));
    EXPECT_EQ(RecordOf("toa").size, 3);
    EXPECT_TRUE(disk_.FileExists(folder_ / "tonone"));
    EXPECT_EQ(RecordOf("tonone").size, 4) << "itself";
    EXPECT_TRUE(disk_.FileExists(folder_ / "loop"));
    frame::FolderCounts counts;
    disk_.Count(folder_.Path(), counts).Check();
    EXPECT_EQ(counts, (frame::FolderCounts{3, 2}));
    std::unique_ptr<frame::BinaryFile> file;
    EXPECT_EQ(disk_.OpenForReading(folder_ / "tonone", file).Number(), 53);
}

TEST_F(DiskFileSystemTest, AListingTellsWhichEntriesAreLinks) {
    folder_.Make("sub");
    folder_.Write("a.txt", "a");
    fs::create_symlink("sub", folder_ / "tosub");
    fs::create_symlink("a.txt", folder_ / "toa");
    fs::create_symlink("none", folder_ / "tonone");
    fs::create_hard_link(folder_ / "a.txt", folder_ / "b.txt");
    std::unique_ptr<frame::FolderListing> listing;
    disk_.List(folder_.Path(), listing).Check();
    std::string links;
    for (std::size_t i = 0; i < listing->Count(); ++i)
        if (listing->IsLink(i)) links += std::string(listing->Name(i)) + (listing->IsFolder(i) ? "/ " : " ");
    EXPECT_EQ(links, "tosub/ toa tonone ");
}

TEST_F(DiskFileSystemTest, HidingIsToldByTheNameAlone) {
    folder_.Make(".git");
    folder_.Make("sub");
    std::unique_ptr<frame::FolderListing> listing;
    disk_.List(folder_.Path(), listing).Check();
    for (std::size_t i = 0; i < listing->Count(); ++i) {
        std::int32_t hiding = -1;
        FileRecord record;
        listing->StatHiding(i, hiding).Check();
        listing->Stat(i, record).Check();
        EXPECT_EQ(hiding, record.attributes & (attributes::hidden | attributes::system)) << listing->Name(i);
    }
}

TEST_F(DiskFileSystemTest, TreesAreMeasuredWithoutLinks) {
    folder_.Make("sub");
    folder_.Write("sub/a.txt", "123");
    fs::create_symlink(folder_.Path(), folder_ / "sub/up");
    fs::create_symlink("sub/a.txt", folder_ / "toa");
    EXPECT_EQ(disk_.MeasureTree(folder_.Path())->Finish(), 3);
    fs::create_symlink(folder_ / "sub", folder_ / "tosub");
    EXPECT_EQ(disk_.MeasureTree(folder_ / "tosub")->Finish(), 3) << "but the folder asked for may be one";
}

TEST_F(DiskFileSystemTest, DeletingAndRenamingMeanTheLinkItself) {
    folder_.Make("sub");
    folder_.Write("a.txt", "123");
    fs::create_symlink("a.txt", folder_ / "toa");
    fs::create_symlink("sub", folder_ / "tosub");
    EXPECT_FALSE(disk_.Rename(folder_ / "toa", "tob").Failed());
    EXPECT_FALSE(disk_.DeleteFile(folder_ / "tob", false).Failed());
    EXPECT_FALSE(disk_.DeleteFile(folder_ / "tosub", false).Failed());
    EXPECT_EQ(Rows(folder_.Path()), "sub/|a.txt");
}

TEST_F(DiskFileSystemTest, RenamingOntoALinkThatLeadsNowhereIsRefused) {
    folder_.Write("a", "1");
    fs::create_symlink("none", folder_ / "b");
    EXPECT_EQ(disk_.Rename(folder_ / "a", "b").Number(), 58);
    EXPECT_EQ(Contents(folder_ / "a"), "1");
}

// Permissions.

TEST_F(DiskFileSystemTest, AFolderThatMayNotBeReadIsThereButNotListed) {
    folder_.Make("sub");
    folder_.Write("sub/a.txt", "123");
    folder_.Write("b.txt", "12");
    folder_.SetMode("sub", 0);
    const LesserUser lesser(folder_);
    DiskFileSystem disk = Disk();
    std::unique_ptr<frame::FolderListing> listing;
    frame::FolderCounts counts;
    FileRecord record;
    EXPECT_TRUE(disk.FolderExists(folder_ / "sub"));
    EXPECT_EQ(disk.List(folder_ / "sub", listing).Number(), 70);
    EXPECT_EQ(disk.Count(folder_ / "sub", counts).Number(), 70);
    EXPECT_EQ(disk.Stat(folder_ / "sub/a.txt", record).Number(), 70);
    EXPECT_EQ(disk.MeasureTree(folder_.Path())->Finish(), 2);
    EXPECT_EQ(disk.MeasureTree(folder_ / "sub")->Finish(), 0);
}

TEST_F(DiskFileSystemTest, AFolderThatMayOnlyBeReadGivesNamesWithoutFacts) {
    folder_.Make("sub");
    folder_.Write("sub/a.txt", "123");
    folder_.SetMode("sub", 0444);
    const LesserUser lesser(folder_);
    DiskFileSystem disk = Disk();
    std::unique_ptr<frame::FolderListing> listing;
    ASSERT_FALSE(disk.List(folder_ / "sub", listing).Failed());
    ASSERT_EQ(listing->Count(), 1u);
    FileRecord record;
    EXPECT_EQ(listing->Name(0), "a.txt");
    EXPECT_EQ(listing->Stat(0, record).Number(), 70);
}

TEST_F(DiskFileSystemTest, WithoutPermissionNothingIsChanged) {
    folder_.Make("sub");
    folder_.Write("sub/a.txt", "123");
    folder_.SetMode("sub", 0555);
    const LesserUser lesser(folder_);
    DiskFileSystem disk = Disk();
    EXPECT_EQ(disk.CreateFolder(folder_ / "sub/x").Number(), 70);
    EXPECT_EQ(disk.CreateFile(folder_ / "sub/x", true).Number(), 70);
    EXPECT_EQ(disk.DeleteFile(folder_ / "sub/a.txt", true).Number(), 70);
    EXPECT_EQ(disk.Rename(folder_ / "sub/a.txt", "b.txt").Number(), 70);
    EXPECT_EQ(disk.WriteOver(folder_ / "sub/x", "1").Number(), 70);
    EXPECT_EQ(disk.CreateFolder("/").Number(), 58);
}

TEST_F(DiskFileSystemTest, FilesOfOthersShowAsReadOnlyAndCannotBeSet) {
    const LesserUser lesser(folder_);
    DiskFileSystem disk = Disk();
    FileRecord record;
    disk.Stat("/etc/passwd", record).Check();
    EXPECT_EQ(record.attributes, attributes::readOnly);
    EXPECT_EQ(disk.SetAttributes("/etc/passwd", 0).Number(), 70);
    EXPECT_EQ(disk.WriteOver("/etc/passwd", "x").Number(), 70);
}

// What is neither file nor folder.

TEST_F(DiskFileSystemTest, PipesAreListedAndNeverOpened) {
    ASSERT_EQ(mkfifo((folder_ / "pipe").c_str(), 0644), 0);
    EXPECT_EQ(Rows(folder_.Path()), "pipe");
    EXPECT_EQ(Contents(folder_ / "pipe"), "75");
    EXPECT_EQ(disk_.WriteOver(folder_ / "pipe", "x").Number(), 75);
    EXPECT_EQ(disk_.MeasureTree(folder_.Path())->Finish(), 0);
}

TEST_F(DiskFileSystemTest, PseudoFileSystemsHaveNoSize) {
    EXPECT_EQ(disk_.MeasureTree("/proc")->Finish(), 0);
    EXPECT_EQ(disk_.MeasureTree("/proc/self")->Finish(), 0);
}

TEST_F(DiskFileSystemTest, AnotherDiskInsideATreeIsNotMeasured) {
    struct stat outer {
    }, inner{};
    if (stat("/dev", &outer) != 0 || stat("/dev/shm", &inner) != 0 || outer.st_dev == inner.st_dev)
        GTEST_SKIP() << "nothing else is mounted below /dev here";
    const auto before = disk_.MeasureTree("/dev")->Finish();
    std::string name = "/dev/shm/tessel-test-XXXXXX";
    const int file = mkstemp(name.data());
    ASSERT_GE(file, 0);
    EXPECT_EQ(write(file, name.data(), name.size()), static_cast<ssize_t>(name.size()));
    close(file);
    EXPECT_EQ(disk_.MeasureTree("/dev")->Finish(), before);
    EXPECT_GE(disk_.MeasureTree("/dev/shm")->Finish(), static_cast<std::int64_t>(name.size()));
    unlink(name.c_str());
}

TEST_F(DiskFileSystemTest, AFolderMovedAwayWhileItIsMeasuredEndsTheWalk) {
    std::string path = "d";
    for (int depth = 0; depth < 80; ++depth) path += "/d";
    folder_.Make(path);
    folder_.Write(path + "/f", "1");
    const std::size_t before = OpenFiles();
    const auto tree = disk_.MeasureTree(folder_ / "d");
    while (tree->Bytes() == 0) ASSERT_TRUE(tree->Step(1));
    EXPECT_LT(OpenFiles(), before + 40);
    folder_.Make("other");
    fs::rename(folder_ / "d/d/d/d", folder_ / "other/d");
    EXPECT_EQ(tree->Finish(), 1);
    EXPECT_EQ(OpenFiles(), before);
}

TEST_F(DiskFileSystemTest, AListingHoldsOneFileOpenAndNoneWhileItRests) {
    folder_.Write("a", "");
    const std::size_t before = OpenFiles();
    std::unique_ptr<frame::FolderListing> listing;
    disk_.List(folder_.Path(), listing).Check();
    EXPECT_EQ(OpenFiles(), before + 1);
    listing->Rest();
    EXPECT_EQ(OpenFiles(), before);
}

TEST_F(DiskFileSystemTest, ManyEntriesAreListedInOrder) {
    constexpr int count = 5'000;
    for (int i = 0; i < count; ++i) folder_.Write("file" + std::to_string(10'000 + i * 7919 % count) + ".txt", "");
    std::unique_ptr<frame::FolderListing> listing;
    disk_.List(folder_.Path(), listing).Check();
    ASSERT_EQ(listing->Count(), static_cast<std::size_t>(count));
    FileRecord record;
    for (std::size_t i = 0; i < listing->Count(); ++i) {
        ASSERT_EQ(listing->Name(i), "file" + std::to_string(10'000 + i) + ".txt");
        ASSERT_FALSE(listing->Stat(i, record).Failed());
    }
}

// Special folders.

TEST_F(DiskFileSystemTest, SpecialFoldersFollowTheUsersSettings) {
    folder_.Make("home/config");
    folder_.Write("home/config/user-dirs.dirs",
                  "# a comment\nXDG_DESKTOP_DIR=\"$HOME/Schreibtisch\"\nXDG_DOCUMENTS_DIR=\"/data/my \\\"docs\\\"/\"\n"
                  "XDG_TEMPLATES_DIR=\"rel\"\n");
    EXPECT_EQ(disk_.SpecialFolder(0), folder_ / "home/Schreibtisch");
    EXPECT_EQ(disk_.SpecialFolder(16), folder_ / "home/Schreibtisch");
    EXPECT_EQ(disk_.SpecialFolder(5), "/data/my \"docs\"");
    EXPECT_EQ(disk_.SpecialFolder(21), folder_ / "home");
    EXPECT_EQ(disk_.SpecialFolder(17), "");
}

TEST_F(DiskFileSystemTest, WithoutSettingsTheUsualFoldersCountWhereTheyExist) {
    EXPECT_EQ(disk_.SpecialFolder(5), folder_ / "home");
    folder_.Make("home/Documents");
    EXPECT_EQ(disk_.SpecialFolder(5), folder_ / "home/Documents");
    EXPECT_EQ(disk_.SpecialFolder(20), folder_ / "home/data/fonts");
    disk_.SetSpecialFolder(5, "/other");
    EXPECT_EQ(disk_.SpecialFolder(5), "/other");
    disk_.SetSpecialFolder(5, "");
    EXPECT_EQ(disk_.SpecialFolder(5), "");
}

TEST(UserFolders, AreReadLineByLine) {
    const auto folders = ParseUserFolders(
        "XDG_A_DIR=\"$HOME\"\n  XDG_B_DIR=\"/b/\"\nXDG_C_DIR=/c\nXDG_D_DIR=\"/d\nB_DIR=\"/x\"\nXDG_E_DIR=\"$HOMEx/e\"", "/h");
    EXPECT_EQ(folders, (std::map<std::string, std::string>{{"A", "/h"}, {"B", "/b"}}));
}

// Drives.

constexpr const char* twoDrives =
    "21 1 8:1 / / rw - ext4 /dev/nodisk1 rw\n"
    "22 21 0:5 / /proc rw - proc proc rw\n"
    "23 21 0:44 / /mnt/net rw - nfs4 server:/export rw\n";

TEST_F(DiskFileSystemTest, DrivesComeFromTheTableOfMounts) {
    auto settings = SettingsFor(folder_);
    settings.mountTable = [] { return twoDrives; };
    settings.askMount = [](const std::string&) { return true; };
    settings.deviceFolder = folder_ / "devices";
    DiskFileSystem disk(settings);
    const auto drives = disk.Drives();
    ASSERT_EQ(drives.size(), 2u);
    EXPECT_EQ(drives[0], (frame::DriveRecord{"/", "/", "", 2, "", "", true}));
    EXPECT_EQ(drives[1], (frame::DriveRecord{"/mnt/net/", "/mnt/net/", "", 3, R"(\\server\export)", "net", true}));
    for (const char* root : {"/", "/mnt/net/"}) EXPECT_TRUE(disk.DriveExists(root)) << root;
    for (const char* other : {"/mnt/net", "/proc/", "/mnt/", "//", "", "mnt/net/"}) EXPECT_FALSE(disk.DriveExists(other)) << other;
}

TEST_F(DiskFileSystemTest, AMountThatHangsIsNotReadyAndIsNotAskedAgain) {
    std::mutex mutex;
    std::condition_variable released, left;
    bool open = false;
    int asked = 0, inside = 0;
    auto settings = SettingsFor(folder_);
    settings.mountTable = [] { return twoDrives; };
    settings.mountWait = std::chrono::milliseconds(50);
    settings.askMount = [&](const std::string& point) {
        std::unique_lock lock(mutex);
        if (point == "/") return true;
        ++asked;
        ++inside;
        released.wait(lock, [&] { return open; });
        --inside;
        left.notify_all();
        return true;
    };
    DiskFileSystem disk(settings);
    const auto ready = [&] {
        std::string text;
        for (const auto& drive : disk.Drives()) text += drive.root + (drive.isReady ? "+ " : "- ");
        return text;
    };
    EXPECT_EQ(ready(), "/+ /mnt/net/- ");
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(ready(), "/+ /mnt/net/- ");
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(10));
    EXPECT_EQ(asked, 1);
    {
        std::unique_lock lock(mutex);
        open = true;
        released.notify_all();
        left.wait(lock, [&] { return inside == 0; });
    }
    std::string now;
    for (int i = 0; i < 1000 && now != "/+ /mnt/net/+ "; ++i) now = ready();  // until the thread has noted that it came back
    EXPECT_EQ(now, "/+ /mnt/net/+ ");
}

// Writing over.

class WriteOverTest : public DiskFileSystemTest {
  protected:
    WriteOverTest() { folder_.Make("tmp"); }
    struct stat Facts(std::string_view name) const {
        struct stat facts {};
        lstat((folder_ / name).c_str(), &facts);
        return facts;
    }
    std::size_t Count(std::string_view name) const {
        return static_cast<std::size_t>(std::distance(fs::directory_iterator(folder_ / name), {}));
    }
};

TEST_F(WriteOverTest, ANewFileHasTheUsualMode) {
    umask(027);
    disk_.WriteOver(folder_ / "a", "1").Check();
    EXPECT_EQ(folder_.Mode("a"), 0640u);
}

TEST_F(WriteOverTest, TheNewContentsTakeTheNameInOneStep) {
    folder_.Write("a", "12345");
    folder_.SetMode("a", 0640);
    const auto before = Facts("a");
    disk_.WriteOver(folder_ / "a", "ab").Check();
    EXPECT_EQ(folder_.Read("a"), "ab345");
    const auto after = Facts("a");
    EXPECT_NE(after.st_ino, before.st_ino);
    EXPECT_EQ(after.st_mode, before.st_mode);
    EXPECT_EQ(folder_.EntryCount(), 2u) << "the file and tmp";
}

TEST_F(WriteOverTest, ALinkStaysAndItsTargetIsWritten) {
    folder_.Make("sub");
    folder_.Write("sub/a", "12345");
    fs::create_symlink("sub/a", folder_ / "link");
    fs::create_symlink(folder_ / "link", folder_ / "linklink");
    disk_.WriteOver(folder_ / "linklink", "ab").Check();
    EXPECT_TRUE(fs::is_symlink(folder_ / "link") && fs::is_symlink(folder_ / "linklink"));
    EXPECT_EQ(folder_.Read("sub/a"), "ab345");
    fs::create_symlink("sub/new", folder_ / "tonew");
    disk_.WriteOver(folder_ / "tonew", "1").Check();
    EXPECT_EQ(folder_.Read("sub/new"), "1");
    fs::create_symlink("loop", folder_ / "loop");
    EXPECT_TRUE(disk_.WriteOver(folder_ / "loop", "1").Failed());
}

TEST_F(WriteOverTest, AFileWithSeveralNamesKeepsThemAll) {
    folder_.Write("a", "12345");
    fs::create_hard_link(folder_ / "a", folder_ / "b");
    disk_.WriteOver(folder_ / "a", "ab").Check();
    EXPECT_EQ(folder_.Read("b"), "ab345");
    disk_.WriteOver(folder_ / "b", "longer than before").Check();
    EXPECT_EQ(folder_.Read("a"), "longer than before");
    EXPECT_EQ(Facts("a").st_nlink, 2u);
    EXPECT_EQ(folder_.EntryCount(), 3u) << "nothing else stays";
}

TEST_F(WriteOverTest, AttributesOfItsOwnStayWithTheFile) {
    folder_.Write("a", "12345");
    if (setxattr((folder_ / "a").c_str(), "user.note", "x", 1, 0) != 0) GTEST_SKIP() << "no such attributes here";
    disk_.WriteOver(folder_ / "a", "ab").Check();
    char value = '?';
    EXPECT_EQ(getxattr((folder_ / "a").c_str(), "user.note", &value, 1), 1);
    EXPECT_EQ(value, 'x');
    EXPECT_EQ(folder_.Read("a"), "ab345");
}

TEST_F(WriteOverTest, InAFolderThatTakesNothingTheFileIsWrittenInPlace) {
    folder_.Make("sub");
    folder_.Write("sub/a", "12345");
    folder_.SetMode("sub", 0555);
    const LesserUser lesser(folder_);
    DiskFileSystem disk = Disk();
    const auto before = Facts("sub/a");
    EXPECT_FALSE(disk.WriteOver(folder_ / "sub/a", "abcdefg").Failed());
    EXPECT_EQ(folder_.Read("sub/a"), "abcdefg");
    EXPECT_EQ(Facts("sub/a").st_ino, before.st_ino);
    EXPECT_EQ(Count("tmp"), 0u) << "the copy on the side has gone";
    folder_.SetMode("tmp", 0555);
    EXPECT_EQ(disk.WriteOver(folder_ / "sub/a", "x").Number(), 70) << "not without a copy on the side";
    EXPECT_EQ(folder_.Read("sub/a"), "abcdefg");
}

TEST_F(WriteOverTest, TheOwnerStaysTheOwner) {
    if (geteuid() != 0) GTEST_SKIP() << "only the superuser writes files of others here";
    folder_.Write("a", "12345");
    ASSERT_EQ(chown((folder_ / "a").c_str(), 1234, 2345), 0);
    folder_.SetMode("a", 06755);
    disk_.WriteOver(folder_ / "a", "ab").Check();
    EXPECT_EQ(Facts("a").st_uid, 1234u);
    EXPECT_EQ(Facts("a").st_gid, 2345u);
    EXPECT_EQ(folder_.Mode("a"), 06755u);
}

TEST_F(WriteOverTest, AReadOnlyFileIsLeftAlone) {
    folder_.Write("a", "12345");
    folder_.SetMode("a", 0444);
    const LesserUser lesser(folder_);
    DiskFileSystem disk = Disk();
    EXPECT_EQ(disk.WriteOver(folder_ / "a", "x").Number(), 70);
    EXPECT_EQ(folder_.Read("a"), "12345");
}

/// Lets no file grow beyond a size: what a full disk does.
class Full {
  public:
    explicit Full(rlim_t bytes) : old_(signal(SIGXFSZ, SIG_IGN)) {
        getrlimit(RLIMIT_FSIZE, &limit_);
        const rlimit less{bytes, limit_.rlim_max};
        setrlimit(RLIMIT_FSIZE, &less);
    }
    Full(const Full&) = delete;
    Full& operator=(const Full&) = delete;
    ~Full() {
        setrlimit(RLIMIT_FSIZE, &limit_);
        signal(SIGXFSZ, old_);
    }

  private:
    rlimit limit_{};
    void (*old_)(int);
};

TEST_F(WriteOverTest, AFullDiskLeavesTheOldFileAndNothingElse) {
    folder_.Write("a", "12345");
    folder_.Write("b", "12345");
    fs::create_hard_link(folder_ / "b", folder_ / "b2");
    const std::string much(100'000, 'x');
    {
        const Full full(50'000);
        EXPECT_EQ(disk_.WriteOver(folder_ / "a", much).Number(), 61);
        EXPECT_EQ(disk_.WriteOver(folder_ / "b", much).Number(), 61);
        EXPECT_EQ(disk_.WriteOver(folder_ / "new", much).Number(), 61);
    }
    EXPECT_EQ(folder_.Read("a"), "12345");
    EXPECT_EQ(folder_.Read("b"), "12345");
    EXPECT_EQ(Rows(folder_.Path()), "tmp/|a|b|b2");
    EXPECT_EQ(Count("tmp"), 0u);
}

TEST_F(WriteOverTest, ALongNameLeavesRoomForTheNewFilesOwn) {
    const std::string name(255, 'n');
    disk_.WriteOver(folder_ / name, "1").Check();
    disk_.WriteOver(folder_ / name, "2").Check();
    EXPECT_EQ(folder_.Read(name), "2");
    EXPECT_EQ(disk_.WriteOver(folder_ / (name + "n"), "2").Number(), 52);
}

}  // namespace
}  // namespace tessel::posix
