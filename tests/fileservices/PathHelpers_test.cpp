#include "fileservices/PathHelpers.h"

#include <gtest/gtest.h>

#include "hosts/headless/MemoryDisk.h"
#include "hosts/posix/DiskFileSystem.h"

namespace tessel::fileservices {
namespace {

constexpr char backslash = '\\', slash = '/';

TEST(BuildPath, PutsExactlyOneSeparatorBetweenItsParts) {
    EXPECT_EQ(BuildPath("C:\\x", "a", backslash), "C:\\x\\a");
    EXPECT_EQ(BuildPath("C:\\", "a", backslash), "C:\\a");
    EXPECT_EQ(BuildPath("C:", "a", backslash), "C:\\a");
    EXPECT_EQ(BuildPath("C:\\x\\\\", "\\\\a", backslash), "C:\\x\\a");
    EXPECT_EQ(BuildPath("\\\\server\\name\\", "a", backslash), "\\\\server\\name\\a");
    EXPECT_EQ(BuildPath("/", "a", slash), "/a");
    EXPECT_EQ(BuildPath("/home/", "/a/b", slash), "/home/a/b");
    EXPECT_EQ(BuildPath("C:", "", backslash), "C:\\");
}

TEST(BuildPath, OfAnEmptyParentIsTheName) {
    EXPECT_EQ(BuildPath("", "a", backslash), "a");
    EXPECT_EQ(BuildPath("", "C:\\", backslash), "C:\\");
    EXPECT_EQ(BuildPath("", "", backslash), "");
}

TEST(GetFileName, IsTheLastName) {
    EXPECT_EQ(GetFileName("C:\\x\\a.txt", backslash), "a.txt");
    EXPECT_EQ(GetFileName("C:\\x\\\\", backslash), "x");
    EXPECT_EQ(GetFileName("C:a", backslash), "a");
    EXPECT_EQ(GetFileName("a", backslash), "a");
    EXPECT_EQ(GetFileName("\\\\server\\name\\a", backslash), "a");
    EXPECT_EQ(GetFileName("/home/a/", slash), "a");
    EXPECT_EQ(GetFileName("/a\\b", slash), "a\\b");
}

TEST(GetFileName, IsEmptyAtARoot) {
    for (const char* root : {"", "C:", "C:\\", "c:\\\\", "\\", "\\\\server\\name", "\\\\server\\name\\"})
        EXPECT_EQ(GetFileName(root, backslash), "") << root;
    for (const char* root : {"", "/", "//"}) EXPECT_EQ(GetFileName(root, slash), "") << root;
}

TEST(GetExtensionName, StandsBehindTheLastPointOfTheLastName) {
    EXPECT_EQ(GetExtensionName("C:\\x\\a.tar.gz", backslash), "gz");
    EXPECT_EQ(GetExtensionName("a.TXT", backslash), "TXT");
    EXPECT_EQ(GetExtensionName("C:\\x.y\\a", backslash), "");
    EXPECT_EQ(GetExtensionName("C:\\x.y\\", backslash), "y");
    EXPECT_EQ(GetExtensionName("a.", backslash), "");
    EXPECT_EQ(GetExtensionName(".profile", slash), "profile");
    EXPECT_EQ(GetExtensionName("/a.b\\c", slash), "b\\c");
    EXPECT_EQ(GetExtensionName("..", slash), "");
    EXPECT_EQ(GetExtensionName("", slash), "");
}

TEST(GetParentFolderName, KeepsTheSeparatorOfARootAlone) {
    EXPECT_EQ(GetParentFolderName("C:\\x\\a.txt", backslash), "C:\\x");
    EXPECT_EQ(GetParentFolderName("C:\\x\\\\a\\", backslash), "C:\\x");
    EXPECT_EQ(GetParentFolderName("C:\\x", backslash), "C:\\");
    EXPECT_EQ(GetParentFolderName("\\\\server\\name\\a", backslash), "\\\\server\\name\\");
    EXPECT_EQ(GetParentFolderName("\\x", backslash), "\\");
    EXPECT_EQ(GetParentFolderName("/home", slash), "/");
    EXPECT_EQ(GetParentFolderName("/home/a", slash), "/home");
}

TEST(GetParentFolderName, IsEmptyAtARootAndForALoneName) {
    for (const char* path : {"", "C:", "C:\\", "\\", "\\\\server\\name", "\\\\server\\name\\", "a", "a\\"})
        EXPECT_EQ(GetParentFolderName(path, backslash), "") << path;
    EXPECT_EQ(GetParentFolderName("/", slash), "");
}

TEST(GetParentFolderName, TakesASeparatorBeforeAServerWithoutANameForARoot) {
    EXPECT_EQ(GetParentFolderName("\\\\server", backslash), "\\");
    EXPECT_EQ(GetParentFolderName("\\\\\\server\\a", backslash), "\\\\\\server");
    EXPECT_EQ(GetFileName("\\\\server\\\\name", backslash), "");
}

TEST(PathHelpers, CarryAnyBytes) {
    using namespace std::string_view_literals;
    constexpr std::string_view path = "/\xFF\0x/\xC3.\x80\n"sv;
    EXPECT_EQ(GetFileName(path, slash), "\xC3.\x80\n"sv);
    EXPECT_EQ(GetExtensionName(path, slash), "\x80\n"sv);
    EXPECT_EQ(GetParentFolderName(path, slash), "/\xFF\0x"sv);
    EXPECT_EQ(BuildPath("/\xFF\0x"sv, "\xC3.\x80\n"sv, slash), path);
}

TEST(GetParentFolderName, OnADiskIsEmptyAtTheRootOfADriveAlone) {
    headless::MemoryDisk disk;
    EXPECT_EQ(GetParentFolderName("C:\\", disk), "");
    EXPECT_EQ(GetParentFolderName("c:\\x", disk), "c:\\");
    EXPECT_EQ(GetParentFolderName("C:\\x\\a", disk), "C:\\x");
}

TEST(GetParentFolderName, SpellsAParentThatIsADriveAsOne) {
    posix::DiskSettings settings;
    settings.mountTable = [] { return "1 0 8:1 / / rw - ext4 /dev/sda1 rw\n2 1 8:17 / /media/usb rw - vfat /dev/sdb1 rw\n"; };
    posix::DiskFileSystem disk(settings);
    ASSERT_TRUE(disk.DriveExists("/media/usb/"));
    EXPECT_EQ(GetParentFolderName("/media/usb/", disk), "");
    EXPECT_EQ(GetParentFolderName("/media/usb/a", disk), "/media/usb/");
    EXPECT_EQ(GetParentFolderName("/media/usb", disk), "/media");
    EXPECT_EQ(GetParentFolderName("/home", disk), "/");
}

}  // namespace
}  // namespace tessel::fileservices
