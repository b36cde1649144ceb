#include "fileservices/CommonFile.h"

#include <gtest/gtest.h>

#include "frame/DragData.h"
#include "frame/Error.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/ErrorOf.h"

namespace tessel::fileservices {
namespace {

using frame::Variant;
using test::ErrorOf;
namespace types = frame::driveTypes;

class CommonFileTest : public testing::Test {
  protected:
    std::string NameOf(const char* letter, const headless::MemoryDisk::DriveFacts& facts) {
        host.files.SetDrive(letter, facts).Check();
        return common.DriveDisplayName(files.GetDrive(*letter ? letter : *facts.share));
    }
    headless::Log::Entry Box() { return host.log.Of("msgbox").back(); }

    headless::HeadlessHost host;
    CommonFile& common = host.Frame().Module<CommonFile>();
    FileSystemObject files{host};
};

TEST_F(CommonFileTest, ADriveIsNamedByItsLabelElseByItsType) {
    EXPECT_EQ(NameOf("C", {}), "Local Disk (C:)");
    EXPECT_EQ(NameOf("D", {.volume = "Work"}), "Work (D:)");
    EXPECT_EQ(NameOf("E", {.type = types::compactDisk}), "Compact Disk (E:)");
}

TEST_F(CommonFileTest, ADriveOfAShareIsNamedByTheShare) {
    EXPECT_EQ(NameOf("N", {.type = types::network, .volume = "Work", .share = "\\\\server\\name"}), "name on 'server' (N:)");
    EXPECT_EQ(NameOf("N", {.ready = false}), "name on 'server' (N:)");
    EXPECT_EQ(NameOf("", {.share = "\\\\server\\docs"}), "docs on 'server' ");
}

TEST_F(CommonFileTest, ADriveThatIsNotReadyIsItsLetterAlone) {
    EXPECT_EQ(NameOf("A", {.type = types::removable, .ready = false}), "(A:)");
}

TEST_F(CommonFileTest, ADriveThatIsNotReadyAndHasNoLetterHasAnEmptyName) {
    frame::DriveRecord record;
    record.isReady = false;
    EXPECT_EQ(common.DriveDisplayName(std::make_shared<Drive>(record)), "");
    record.isReady = true;
    record.volumeName = "usb";
    EXPECT_EQ(common.DriveDisplayName(std::make_shared<Drive>(record)), "usb ");
}

TEST_F(CommonFileTest, AShareIsItsThirdPartOnItsSecond) {
    EXPECT_EQ(common.ShareDisplayName("\\\\server\\name"), "name on 'server' ");
    EXPECT_EQ(common.ShareDisplayName("\\\\server\\name\\more"), "name on 'server' ");
    EXPECT_EQ(common.ShareDisplayName("\\\\server\\"), " on 'server' ");
}

TEST_F(CommonFileTest, AShareOfAnotherFormIsOutsideTheBounds) {
    for (const char* share : {"", "server", "\\\\server", "a\\b\\c"})
        EXPECT_EQ(ErrorOf([&] { common.ShareDisplayName(share); }), frame::errors::subscript) << share;
}

TEST_F(CommonFileTest, AFolderIsNamedByItsNameAndADriveRootByItsDrive) {
    host.files.SetFolder("C:\\x", {}).Check();
    EXPECT_EQ(common.FolderDisplayName(files.GetFolder("C:\\x")), "x");
    EXPECT_EQ(common.FolderDisplayName(files.GetFolder("C:\\")), "Local Disk (C:)");
}

TEST_F(CommonFileTest, ARootWhoseDriveHasGoneIsUnknown) {
    host.files.SetDrive("D", {}).Check();
    const FolderRef root = files.GetFolder("D:\\");
    host.files.Remove("D:\\").Check();
    EXPECT_EQ(common.FolderDisplayName(root), "Unknown drive or folder");
}

TEST_F(CommonFileTest, ANewFolderIsNumberedUntilItsPathIsFree) {
    host.files.SetFolder("C:\\x", {}).Check();
    EXPECT_EQ(common.UniqueFolderPath("C:\\x", ""), "C:\\x\\New Folder");
    host.files.SetFolder("C:\\x\\New Folder", {}).Check();
    EXPECT_EQ(common.UniqueFolderPath("C:\\x", ""), "C:\\x\\New Folder (1)");
    host.files.SetFolder("C:\\x\\New Folder (1)", {}).Check();
    EXPECT_EQ(common.UniqueFolderPath("C:\\x\\", ""), "C:\\x\\New Folder (2)");
}

TEST_F(CommonFileTest, AFolderWithANameBecomesACopyOfIt) {
    EXPECT_EQ(common.UniqueFolderPath("C:\\x", "a"), "C:\\x\\a");
    host.files.SetFolder("C:\\x\\a", {}).Check();
    EXPECT_EQ(common.UniqueFolderPath("C:\\x", "a"), "C:\\x\\Copy (1) of a");
    host.files.SetFolder("C:\\x\\Copy (1) of a", {}).Check();
    EXPECT_EQ(common.UniqueFolderPath("C:\\x", "a"), "C:\\x\\Copy (2) of a");
}

TEST_F(CommonFileTest, AFileOfTheNameDoesNotMoveTheCounter) {
    host.files.SetFile("C:\\x\\New Folder", {}).Check();
    EXPECT_EQ(common.UniqueFolderPath("C:\\x", ""), "C:\\x\\New Folder");
}

TEST_F(CommonFileTest, TheFilesOfADragAreJoinedByCommas) {
    const auto data = std::make_shared<frame::DragData>();
    std::string list = "before";
    common.DataObjectFileList(data, list);
    EXPECT_EQ(list, "");
    data->Files.Add("C:\\a");
    common.DataObjectFileList(data, list);
    EXPECT_EQ(list, "C:\\a");
    data->Files.Add("C:\\b");
    Variant arguments[] = {data, "before"};
    EXPECT_TRUE(common.Call("DataObjectFileList", arguments).IsEmpty());
    EXPECT_EQ(arguments[1], Variant("C:\\a,C:\\b"));
}

TEST_F(CommonFileTest, ADragObjectMustHaveFiles) {
    Variant arguments[] = {frame::ObjectRef(common), ""};
    EXPECT_EQ(ErrorOf([&] { common.Call("DataObjectFileList", arguments); }), frame::errors::objectGone);
}

TEST_F(CommonFileTest, AnExtensionIsChangedOnlyAfterAQuestion) {
    host.dialogs.answers = {frame::msgbox::answerNo};
    EXPECT_EQ(common.ConfirmExtensionChange(), frame::msgbox::answerNo);
    EXPECT_EQ(Box(), (headless::Log::Entry{"msgbox",
                                           "If you change a filename extension, the file may become unusable.\r\n\r\nAre you sure "
                                           "you want to change it?",
                                           52, "Rename"}));
}

TEST_F(CommonFileTest, AFolderThatHasGoneIsReported) {
    Variant path[] = {"C:\\x"};
    EXPECT_EQ(common.Call("ShowFolderNotAccessible", path), Variant(frame::msgbox::answerOk));
    EXPECT_EQ(Box(), (headless::Log::Entry{"msgbox", "C:\\x is not accessible.\r\n\r\nThis folder was moved or removed.", 16,
                                           "Folder Not Accessible"}));
}

TEST_F(CommonFileTest, BadCharactersOfANameAreReported) {
    EXPECT_EQ(common.Call("ShowBadNameCharacters"), Variant(frame::msgbox::answerOk));
    EXPECT_EQ(Box(),
              (headless::Log::Entry{"msgbox",
                                    "A file cannot contain any of the following characters:\r\n              \\ / : * ? \" < "
                                    "> |",
                                    16, "Rename"}));
}

TEST_F(CommonFileTest, DrivesAndFoldersAreTakenByName) {
    Variant drive[] = {files.GetDrive("C")};
    EXPECT_EQ(common.Call("DriveDisplayName", drive), Variant("Local Disk (C:)"));
    Variant folder[] = {files.GetFolder("C:\\Temp")};
    EXPECT_EQ(common.Call("FolderDisplayName", folder), Variant("Temp"));
    Variant none[] = {frame::ObjectRef()};
    EXPECT_EQ(ErrorOf([&] { common.Call("FolderDisplayName", none); }), frame::errors::objectGone);
    EXPECT_EQ(ErrorOf([&] { common.Call("DriveDisplayName", none); }), frame::errors::objectGone);
}

}  // namespace
}  // namespace tessel::fileservices
