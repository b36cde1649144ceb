#include "hosts/posix/MountTable.h"

#include <gtest/gtest.h>

#include "tests/hosts/TestFolder.h"

namespace tessel::posix {
namespace {

std::string Line(const std::string& device, const std::string& point, const std::string& type, const std::string& source = "none",
                 const std::string& root = "/") {
    return "36 35 " + device + " " + root + " " + point + " rw,noatime master:1 - " + type + " " + source + " rw,errors=continue\n";
}

/// The mount points of what a user would call drives, parted by blanks.
std::string Points(const std::string& text) {
    std::string points;
    for (const Mount& mount : UserMounts(ParseMountInfo(text))) points += (points.empty() ? "" : " ") + mount.point;
    return points;
}

TEST(MountTable, IsReadWithItsOptionalFieldsAndEscapes) {
    const auto mounts = ParseMountInfo(
        "36 35 98:0 /mnt1 /mnt/a\\040b\\134 rw,noatime master:1 shared:2 - ext3 /dev/root rw\n"
        "37 35 98:1 / /c rw - fuse.sshfs me@host:/x\\011y rw\n");
    ASSERT_EQ(mounts.size(), 2u);
    EXPECT_EQ(mounts[0], (Mount{"98:0", "/mnt1", "/mnt/a b\\", "ext3", "/dev/root"}));
    EXPECT_EQ(mounts[1], (Mount{"98:1", "/", "/c", "fuse.sshfs", "me@host:/x\ty"}));
}

TEST(MountTable, LinesThatMakeNoSenseArePassedOver) {
    EXPECT_TRUE(ParseMountInfo("").empty());
    for (const char* text :
         {"\n\n", "one two", "36 35 98:0 / /a rw master:1", "36 35 98:0 / /a rw -", "36 35 98:0 / /a rw - ext3", "- - - - - -"})
        EXPECT_TRUE(ParseMountInfo(text).empty()) << text;
    EXPECT_EQ(ParseMountInfo("nonsense\n" + Line("8:1", "/a", "ext4")).size(), 1u);
}

TEST(MountTable, DrivesAreWhereAUserKeepsFiles) {
    EXPECT_EQ(
        Points(Line("8:1", "/", "ext4", "/dev/sda1") + Line("0:5", "/proc", "proc") + Line("0:6", "/sys", "sysfs") +
               Line("0:7", "/dev", "devtmpfs") + Line("0:8", "/run", "tmpfs") + Line("0:9", "/run/user/1000", "tmpfs") +
               Line("7:1", "/snap/core/1", "squashfs", "/dev/loop1") + Line("8:2", "/boot/efi", "vfat", "/dev/sda2") +
               Line("8:3", "/home", "xfs", "/dev/sda3") + Line("8:17", "/run/media/me/USB", "vfat", "/dev/sdb1") +
               Line("11:0", "/media/disc", "iso9660", "/dev/sr0") + Line("0:50", "/mnt/net", "cifs", "//server/data") +
               Line("0:51", "/run/user/1000/gvfs", "fuse.gvfsd-fuse") + Line("8:1", "/etc/hosts", "ext4", "/dev/sda1", "/x/hosts") +
               Line("8:4", "/var/lib/data", "ext4", "/dev/sda4") + Line("0:60", "/homes", "tmpfs")),
        "/ /home /media/disc /mnt/net /run/media/me/USB");
}

TEST(MountTable, TheTopIsADriveWhateverItsFileSystem) {
    EXPECT_EQ(Points(Line("0:30", "/", "overlay")), "/");
    EXPECT_EQ(Points(Line("0:1", "/", "rootfs") + Line("0:31", "/", "tmpfs")), "/");
    EXPECT_EQ(UserMounts(ParseMountInfo(Line("0:1", "/", "rootfs") + Line("0:31", "/", "tmpfs")))[0].type, "tmpfs");
}

TEST(MountTable, AFileSystemIsOneDriveHoweverOftenItIsMounted) {
    EXPECT_EQ(Points(Line("0:30", "/srv", "btrfs", "/dev/sda1", "/@srv") + Line("0:30", "/", "btrfs", "/dev/sda1", "/@") +
                     Line("0:30", "/home", "btrfs", "/dev/sda1", "/@home")),
              "/");
}

TEST(MountTable, WhatIsMountedOverCountsNoMore) {
    EXPECT_EQ(Points(Line("8:1", "/", "ext4") + Line("8:2", "/mnt", "ext4") + Line("8:3", "/mnt/a", "ext4") +
                     Line("8:4", "/mntb", "ext4") + Line("0:9", "/mnt", "tmpfs")),
              "/ /mntb");
}

TEST(MountTable, SharesAreNamedByServerAndName) {
    EXPECT_EQ(ShareName("//server/data"), "\\\\server\\data");
    EXPECT_EQ(ShareName("//server/data/sub/"), "\\\\server\\data/sub");
    EXPECT_EQ(ShareName("server:/export/home"), "\\\\server\\export/home");
    EXPECT_EQ(ShareName("server:/"), "\\\\server\\/");
    EXPECT_EQ(ShareName("[fe80::1]:/x"), "\\\\[fe80::1]\\x");
    for (const char* source : {"", "/dev/sda1", "none", "//server", "//", ":/x", "server:", "[fe80"})
        EXPECT_EQ(ShareName(source), "") << source;
}

TEST(MountTable, TypesOfDrivesAreToldApart) {
    test::TestFolder folder;
    folder.Make("devices/8:1");
    folder.Make("disk/part");
    folder.Write("devices/8:1/removable", "0\n");
    folder.Write("disk/removable", "1\n");
    std::filesystem::create_directory_symlink(folder / "disk/part", folder / "devices/8:17");
    const auto type = [&](const std::string& device, const std::string& point, const std::string& kind) {
        return DriveTypeOf({device, "/", point, kind, ""}, folder / "devices");
    };
    EXPECT_EQ(type("8:1", "/", "ext4"), 2);
    EXPECT_EQ(type("8:17", "/mnt/x", "vfat"), 1);
    EXPECT_EQ(type("8:33", "/media/x", "vfat"), 1);
    EXPECT_EQ(type("8:33", "/mediax", "vfat"), 2);
    EXPECT_EQ(type("11:0", "/media/x", "iso9660"), 4);
    EXPECT_EQ(type("0:9", "/media/x", "nfs4"), 3);
    EXPECT_EQ(type("0:9", "/", "tmpfs"), 5);
}

TEST(MountProbe, AnswersForEachMount) {
    MountProbe probe([](const std::string& point) { return point != "/bad"; }, std::chrono::seconds(10));
    EXPECT_EQ(probe.Ask({"/a", "/bad", "/b"}), (std::vector<bool>{true, false, true}));
    EXPECT_EQ(probe.Ask({}), std::vector<bool>());
    EXPECT_EQ(probe.Ask({"/bad"}), std::vector<bool>{false});
}

TEST(MountProbe, IsNotHeldUpByMountsThatAreLeftBehind) {
    const auto gate = std::make_shared<std::mutex>();
    std::unique_lock closed(*gate);
    {
        MountProbe probe([gate](const std::string& point) { return point != "/hangs" || (std::lock_guard(*gate), true); },
                         std::chrono::milliseconds(20));
        EXPECT_FALSE(probe.Ask({"/hangs"})[0]);
    }
    closed.unlock();  // the thread ends after its probe
}

TEST(Drives, AreNamedByTheirLabelOrTheLastPartOfTheirPlace) {
    MountProbe probe([](const std::string& point) { return point != "/mnt/off"; }, std::chrono::seconds(10));
    const auto mounts = ParseMountInfo(Line("8:1", "/", "ext4") + Line("8:2", "/mnt/a", "ext4") + Line("8:3", "/mnt/b", "ext4") +
                                       Line("8:4", "/mnt/off", "ext4"));
    const auto drives = DrivesOf(
        mounts, probe, [](const Mount& mount) { return mount.point == "/mnt/b" ? std::string("Work") : std::string(); }, "/none");
    ASSERT_EQ(drives.size(), 4u);
    EXPECT_EQ(drives[0].volumeName, "");
    EXPECT_EQ(drives[1].volumeName, "a");
    EXPECT_EQ(drives[2].volumeName, "Work");
    EXPECT_EQ(drives[3].volumeName, "");
    EXPECT_FALSE(drives[3].isReady);
    EXPECT_EQ(drives[2].root, "/mnt/b/");
    EXPECT_EQ(drives[2].path, "/mnt/b/");
}

TEST(Drives, HaveNoLabelWithoutABlockDevice) {
    test::TestFolder folder;
    folder.Write("Work", "");
    EXPECT_EQ(LabelOf({"8:1", "/", "/", "ext4", folder / "Work"}, folder.Path()), "");
    EXPECT_EQ(LabelOf({"8:1", "/", "/", "ext4", "server:/x"}, folder.Path()), "");
    EXPECT_EQ(LabelOf({"8:1", "/", "/", "ext4", "/dev/none"}, folder / "none"), "");
}

}  // namespace
}  // namespace tessel::posix
