#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/inotify.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

#include <array>
#include <string>

#include "frame/Text.h"
#include "tests/controls/fileview/FileViewTestHelp.h"
#include "tests/hosts/RealDisk.h"

/// The list over the disk of this machine: what no other file system has.
namespace tessel::controls {
namespace {

using namespace fileviewtest;
using frame::Variant;
namespace fs = std::filesystem;

class FileViewOnDisk : public testing::Test {
  protected:
    FileViewOnDisk() { folder.Make("x"); }

    std::string At(const std::string& name = {}) const { return folder / (name.empty() ? "x" : "x/" + name); }
    void Write(const std::string& name, std::string_view contents = "") { folder.Write("x/" + name, contents); }
    void Make(const std::string& name) { folder.Make("x/" + name); }
    void Link(const std::string& target, const std::string& name) { fs::create_symlink(target, At(name)); }
    void Show(const std::string& name = {}) { stage.ShowPath(At(name)); }
    std::string Sub(std::int32_t index, int column) { return SubItem(view, index, column); }
    bool IsFolderRow(std::int32_t index) { return Sub(index, 12).starts_with(' '); }

    test::RealDisk real;
    test::TestFolder& folder = real.folder;
    Stage stage{{.files = &real.files}};
    FileView& view = stage.View();
};

// Names.

TEST_F(FileViewOnDisk, AnyBytesMakeAName) {
    const std::string longest = std::string(250, 'x') + "\xE4.txt";
    const std::array names = {std::string("-rf"),         std::string("-rf.txt"), std::string("a\nb.txt"),
                              std::string("a\\b:*?"),     std::string("comma,,"), longest,
                              std::string("\xFF\xFE.txt")};
    std::string all;
    for (const std::string& name : names) {
        Write(name, "1");
        all += (all.empty() ? "" : " | ") + name;
    }
    Show();
    EXPECT_EQ(Rows(view), all);
    EXPECT_EQ(Rows(view, 10), all);
    EXPECT_EQ(view.TotalSize(), Variant(7));
    for (std::int32_t index = 1; index <= view.ItemCount(); ++index) {
        view.SetItemIndex(index);
        EXPECT_EQ(view.ItemPath(), At(names[static_cast<std::size_t>(index - 1)]));
    }
    stage.Tick();
    EXPECT_EQ(Rows(view), all) << "each is found again under its name";
    view.Search("*.TXT", At(), false);
    EXPECT_EQ(Rows(view), "-rf.txt | a\nb.txt | " + longest + " | \xFF\xFE.txt");
}

TEST_F(FileViewOnDisk, NamesOfAnyBytesAreFilteredAndRenamed) {
    for (const char* name : {"\xFF.txt", "\xC3\xA4.txt", "a.txt", "ab.txt", "-r.txt"}) Write(name);
    view.SetFilter("?.txt");
    Show();
    EXPECT_EQ(Rows(view), "a.txt | \xC3\xA4.txt | \xFF.txt") << "a byte that is no part of a character counts as one";
    view.SetItemIndex(3);
    view.SetItemName("\xFE.txt");
    EXPECT_TRUE(fs::exists(At("\xFE.txt")));
    EXPECT_FALSE(fs::exists(At("\xFF.txt")));
    view.SetFilter("-*");
    Show();
    view.SetItemName("--help.txt");
    EXPECT_TRUE(fs::exists(At("--help.txt")));
}

TEST_F(FileViewOnDisk, APathMayBeLongerThanTheSystemTakesAtOnce) {
    std::string path = At();
    while (path.size() < 9'000) {
        path += "/" + std::string(200, static_cast<char>('a' + path.size() % 26));
        real.files.CreateFolder(path).Check();
    }
    real.files.WriteOver(path + "/a.txt", "12345").Check();
    stage.ShowPath(path);
    EXPECT_EQ(Rows(view), "a.txt");
    EXPECT_EQ(view.TotalSize(), Variant(5));
    EXPECT_EQ(view.ItemPath(), path + "/a.txt");
    real.files.CreateFile(path + "/b.txt", false).Check();
    real.files.CreateFolder(path + "/sub").Check();
    stage.Tick();
    EXPECT_EQ(Rows(view), "a.txt | sub | b.txt");
    view.SetItemName("c.txt");
    EXPECT_TRUE(real.files.FileExists(path + "/c.txt"));
    real.files.DeleteFile(path + "/c.txt", false).Check();
    stage.Tick();
    EXPECT_EQ(Rows(view), "sub | b.txt");
    view.SetLimitToRoot(false);
    view.GoUp();
    EXPECT_EQ(view.ItemCount(), 1);
    EXPECT_EQ(view.FolderPath() + "/" + Rows(view), path);
    view.Search("b*", At(), true);
    EXPECT_EQ(Sub(1, 6), path);
    EXPECT_EQ(view.ItemAddNew(path + "/b.txt"), 2);
}

// Permissions.

TEST_F(FileViewOnDisk, AFolderThatMayNotBeReadHasARowAndIsEmpty) {
    Make("closed");
    Write("closed/a", "123");
    Make("open");
    Write("open/a", "12");
    folder.SetMode("x/closed", 0);
    const test::LesserUser lesser(folder);
    view.SetShowFolderDetails(true);
    Show();
    EXPECT_EQ(Rows(view), "closed | open");
    EXPECT_EQ(Rows(view, 7), " | 000000000001");
    EXPECT_EQ(Rows(view, 1), " | 1");
    EXPECT_EQ(view.TotalSize(), Variant(2));
    stage.Tick();
    EXPECT_EQ(stage.Events(), "AfterPaint");
    view.Search("a", At(), true);
    EXPECT_EQ(Rows(view, 6), At("open"));
    stage.ShowPath(At("closed"));
    EXPECT_EQ(Rows(view), "");
    EXPECT_EQ(Message(view), "There are no items to show in this folder.");
    EXPECT_EQ(view.TotalSize(), Variant(0));
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

TEST_F(FileViewOnDisk, WhatMayOnlyBeNamedIsLeftOut) {
    Make("names");
    Write("names/a");
    Make("names/sub");
    folder.SetMode("x/names", 0444);
    const test::LesserUser lesser(folder);
    Show("names");
    EXPECT_EQ(Rows(view), "");
    EXPECT_EQ(Message(view), "There are no items to show in this folder.");
    view.Search("*", At("names"), true);
    EXPECT_EQ(Rows(view), "");
}

TEST_F(FileViewOnDisk, PermissionMayGoWhileAFolderIsListed) {
    for (const char* name : {"a", "b", "c"}) Write(name);
    const test::LesserUser lesser(folder);
    stage.handlers.On(fileview::AfterAddItem, [&](std::int32_t&) { folder.SetMode("x", 0); });
    Show();
    EXPECT_EQ(Rows(view), "a");
    stage.handlers = {};
    stage.Tick();
    EXPECT_EQ(Rows(view), "") << "what cannot be seen counts as gone";
    folder.SetMode("x", 0755);
    view.Show();
    EXPECT_EQ(Rows(view), "a | b | c");
}

TEST_F(FileViewOnDisk, WithoutPermissionARenameLeavesTheDiskAlone) {
    Write("a");
    folder.SetMode("x", 0555);
    const test::LesserUser lesser(folder);
    Show();
    EXPECT_THROW(view.SetItemName("b"), frame::ControlError);
    EXPECT_TRUE(fs::exists(At("a")));
    EXPECT_EQ(view.ItemName(), "a");
}

TEST_F(FileViewOnDisk, ReadOnlyFilesAreShownAndRenamed) {
    Write("a", "1");
    folder.SetMode("x/a", 0444);
    Show();
    EXPECT_EQ(Rows(view), "a");
    EXPECT_FALSE(view.ListFiles.ListItems.Item(1)->Ghosted());
    view.SetItemName("b");
    EXPECT_EQ(folder.Mode("x/b"), 0444u);
}

// Links.

TEST_F(FileViewOnDisk, ALinkIsShownAsWhatItLeadsTo) {
    Make("sub");
    Write("sub/a", "123");
    Link("sub", "tosub");
    Link("sub/a", "toa");
    Link("nowhere", "dangling");
    Link("round", "round");
    Show();
    EXPECT_EQ(Rows(view), "sub | tosub | dangling | round | toa");
    EXPECT_TRUE(IsFolderRow(2));
    EXPECT_FALSE(IsFolderRow(3));
    EXPECT_EQ(Sub(2, 7), "000000000001");
    EXPECT_EQ(Sub(3, 7), "000000000007") << "a link that leads nowhere is a file: itself";
    EXPECT_EQ(Sub(5, 7), "000000000003");
    EXPECT_EQ(view.TotalSize(), Variant(3)) << "links count nothing";
    stage.Tick();
    EXPECT_EQ(view.ItemCount(), 5);
    stage.ShowPath(At("tosub"));
    EXPECT_EQ(Rows(view), "a");
    EXPECT_EQ(Sub(1, 6), At("tosub"));
}

TEST_F(FileViewOnDisk, ALinkThatLosesItsTargetBecomesAFile) {
    Make("sub");
    Link("sub", "link");
    Show();
    EXPECT_TRUE(IsFolderRow(1));
    fs::remove(At("sub"));
    stage.Tick();
    EXPECT_EQ(stage.Events(), "AfterPaint RefreshFoundChanges");
    EXPECT_EQ(Rows(view), "link");
    view.Show();
    EXPECT_FALSE(IsFolderRow(1));
}

TEST_F(FileViewOnDisk, TheTotalOfATreeWithALinkThatLeadsBackUpIsThatOfItsFiles) {
    Make("sub");
    Write("sub/a", "123");
    Link(At(), "sub/up");
    Show();
    EXPECT_EQ(view.TotalSize(), Variant(3));
    EXPECT_EQ(Sub(1, 7), "000000000001");
}

TEST_F(FileViewOnDisk, ASearchPassesLinksToFoldersOverAndFindsEachFileOnce) {
    Make("sub");
    Write("sub/a", "123");
    // Two ways back up: with each level twice as many, if they were gone.
    Link(At(), "sub/up");
    Link("..", "sub/upagain");
    Link("sub/a", "toa");
    view.Search("*a", At(), true);
    EXPECT_EQ(Rows(view), "toa | a");
    EXPECT_EQ(view.TotalSize(), Variant(6));
    view.Search("a", At("sub/up"), true);
    EXPECT_EQ(Rows(view, 6), At("sub/up/sub")) << "but the folder asked for may be one";
}

// What is neither file nor folder.

/// Tells whether anybody opens a file.
class Opens {
  public:
    explicit Opens(const std::string& path) : queue_(inotify_init1(IN_NONBLOCK | IN_CLOEXEC)) {
        if (inotify_add_watch(queue_, path.c_str(), IN_OPEN) < 0) ADD_FAILURE() << "no watch";
    }
    Opens(const Opens&) = delete;
    Opens& operator=(const Opens&) = delete;
    ~Opens() { close(queue_); }

    bool Happened() const {
        alignas(inotify_event) std::array<char, 4096> told{};
        return read(queue_, told.data(), told.size()) > 0;
    }

  private:
    int queue_;
};

TEST_F(FileViewOnDisk, PipesAndSocketsAreListedAndNeverOpened) {
    ASSERT_EQ(mkfifo(At("pipe.txt").c_str(), 0644), 0);
    const int server = socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    At("socket").copy(address.sun_path, sizeof(address.sun_path) - 1);
    ASSERT_EQ(bind(server, reinterpret_cast<const sockaddr*>(&address), sizeof(address)), 0);
    const Opens pipe(At("pipe.txt"));
    Show();
    EXPECT_EQ(Rows(view), "pipe.txt | socket");
    EXPECT_EQ(Rows(view, 1), "0 KB | 0 KB");
    EXPECT_EQ(view.ItemSetupIcon(1), "txt");
    EXPECT_EQ(view.TotalSize(), Variant(0));
    stage.Tick();
    view.Search("*", At(), true);
    EXPECT_EQ(Rows(view), "pipe.txt | socket");
    EXPECT_EQ(view.ItemAddNew(At("pipe.txt")), 3);
    EXPECT_FALSE(pipe.Happened());
    close(open(At("pipe.txt").c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
    EXPECT_TRUE(pipe.Happened()) << "an open is seen";
    close(server);
}

// Times.

TEST_F(FileViewOnDisk, TimesLieBefore1970AndAfter2038) {
    constexpr std::int64_t day = 86'400, year2100 = 4'102'444'800;
    for (const char* name : {"future", "now", "past"}) Write(name);
    folder.SetTimes("x/past", -day, -day);
    folder.SetTimes("x/future", year2100, year2100);
    struct stat facts {};
    stat(At("past").c_str(), &facts);
    if (facts.st_mtime != -day) GTEST_SKIP() << "the disk of the test keeps no such times";
    Show();
    EXPECT_EQ(Sub(1, 8), "2100-01-01 00:00:00");
    EXPECT_EQ(Sub(1, 3), "1/1/2100");
    EXPECT_EQ(Sub(3, 8), "1969-12-31 00:00:00");
    EXPECT_EQ(Sub(3, 3), "12/31/1969");
    constexpr int modifiedColumn = 4;
    view.ListFiles.ColumnClickInput(modifiedColumn);
    view.ListFiles.Rows().TakeChanges();
    EXPECT_EQ(Rows(view), "past | now | future");
}

// Case.

TEST_F(FileViewOnDisk, NamesThatDifferInCaseAloneAreTwoFiles) {
    Write("a.txt");
    Write("A.TXT");
    Show();
    EXPECT_EQ(Rows(view), "A.TXT | a.txt");
    fs::remove(At("A.TXT"));
    stage.Tick();
    EXPECT_EQ(Rows(view), "a.txt");
}

// Drives.

TEST_F(FileViewOnDisk, MyComputerListsTheMounts) {
    real.mounts +=
        "2 1 8:17 / /media/usb rw - ext4 /dev/sdb1 rw\n"
        "3 1 0:44 / /mnt/net rw - nfs4 server:/export rw\n"
        "4 1 0:45 / /mnt/gone rw - nfs4 server:/gone rw\n";
    real.deadMounts = {"/mnt/gone"};
    view.SetPathRoot("My Computer");
    EXPECT_EQ(Rows(view, 10), "/ | /media/usb/ | /mnt/gone/ | /mnt/net/");
    EXPECT_EQ(Rows(view), "Local Disk  | usb  | gone on 'server'  | export on 'server' ");
    EXPECT_EQ(view.ListFiles.ListItems.Item(3)->SmallIcon().ToText(), "Drive Unavailable");
    EXPECT_EQ(stage.EventsOfPaints(), "ChangedFolder(False) BeforePaint(False) AfterPaint");
    view.SetFolderPath("/");
    view.Show();
    EXPECT_GT(view.ItemCount(), 0);
    view.GoUp();
    EXPECT_EQ(view.FolderPath(), "My Computer");
    EXPECT_EQ(view.ItemCount(), 4);
    stage.ShowPath("/mnt/gone/");
    EXPECT_EQ(Message(view), "Folder '/mnt/gone/' does not exist.");
}

TEST_F(FileViewOnDisk, TheRootIsKnownByItsPath) {
    stage.handlers.On(fileview::NeedMyFolders, [](Variant& folders) { folders = frame::VariantArray(1, {"/"}); });
    stage.ShowPath("My Folders");
    EXPECT_EQ(Rows(view), "Local Disk ");
    EXPECT_EQ(Rows(view, 10), "/");
    EXPECT_EQ(Rows(view, 6), "");
}

TEST_F(FileViewOnDisk, SeparatorsAtTheEndOfAPathDoNotCount) {
    Make("sub");
    Write("sub/a");
    stage.ShowPath(At("sub//"));
    EXPECT_EQ(Rows(view), "a");
    EXPECT_EQ(Sub(1, 6), At("sub"));
    stage.Tick();
    EXPECT_EQ(Rows(view), "a");
    view.SetLimitToRoot(false);
    view.GoUp();
    EXPECT_EQ(Rows(view), "sub");
}

TEST_F(FileViewOnDisk, TheUsersDocumentsAreListed) {
    folder.Write("documents/letter.txt", "1");
    stage.ShowPath("My Documents");
    EXPECT_EQ(Rows(view), "letter.txt");
    view.GoUp();
    EXPECT_EQ(view.FolderPath(), folder / "documents");
}

}  // namespace
}  // namespace tessel::controls
