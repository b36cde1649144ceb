#include "fileservices/FileSystemObject.h"

#include <gtest/gtest.h>

#include "frame/Dates.h"
#include "frame/Error.h"
#include "hosts/headless/HeadlessHost.h"
#include "hosts/posix/DiskFileSystem.h"
#include "tests/ErrorOf.h"

namespace tessel::fileservices {
namespace {

using frame::ObjectRef;
using frame::Variant;
using test::ErrorOf;
namespace errors = frame::errors;
namespace attributes = frame::attributes;

class FileSystemObjectTest : public testing::Test {
  protected:
    FileSystemObjectTest() {
        host.files.SetFile("C:\\x\\a.txt", {.attributes = attributes::hidden, .size = 10}).Check();
        host.files.SetFile("C:\\x\\b.txt", {.contents = "abc"}).Check();
        host.files.SetFile("C:\\x\\sub\\deep\\c.txt", {.size = 100}).Check();
        host.files.SetDrive("F", {.type = frame::driveTypes::removable, .ready = false}).Check();
        host.files.SetDrive("", {.type = frame::driveTypes::network, .volume = "", .share = "\\\\server\\name"}).Check();
    }

    /// What a late-bound call of the file system object gives.
    template <class... Args>
    Variant Call(const char* name, Args... args) {
        Variant arguments[] = {Variant(args)...};
        return fso.Call(name, arguments);
    }

    headless::HeadlessHost host;
    FileSystemObject fso{host};
};

TEST_F(FileSystemObjectTest, ADriveRootIsAFolderAndADriveAndAFolderIsNoDrive) {
    EXPECT_TRUE(fso.DriveExists("C:\\"));
    EXPECT_TRUE(fso.FolderExists("C:\\"));
    EXPECT_FALSE(fso.FileExists("C:\\"));
    EXPECT_FALSE(fso.DriveExists("C:\\x"));
    EXPECT_TRUE(fso.FolderExists("C:\\x"));
    EXPECT_TRUE(fso.FileExists("C:\\x\\a.txt"));
    EXPECT_FALSE(fso.FolderExists("C:\\x\\a.txt"));
}

TEST_F(FileSystemObjectTest, ADriveThatIsNotReadyIsADriveButNoFolder) {
    EXPECT_TRUE(fso.DriveExists("F:\\"));
    EXPECT_FALSE(fso.FolderExists("F:\\"));
    EXPECT_EQ(ErrorOf([&] { fso.GetFolder("F:\\"); }), errors::diskNotReady);
}

TEST_F(FileSystemObjectTest, WhatIsAbsentFails) {
    EXPECT_EQ(ErrorOf([&] { fso.GetFile("C:\\x\\none"); }), errors::fileNotFound);
    EXPECT_EQ(ErrorOf([&] { fso.GetFile("C:\\x"); }), errors::fileNotFound);
    EXPECT_EQ(ErrorOf([&] { fso.GetFolder("C:\\none"); }), errors::pathNotFound);
    EXPECT_EQ(ErrorOf([&] { fso.GetFolder("C:\\x\\a.txt"); }), errors::pathNotFound);
    EXPECT_EQ(ErrorOf([&] { fso.GetFolder(""); }), errors::pathNotFound);
    EXPECT_EQ(ErrorOf([&] { fso.GetDrive("Z"); }), errors::pathNotFound);
    EXPECT_EQ(ErrorOf([&] { fso.GetDrive(""); }), errors::pathNotFound);
}

TEST_F(FileSystemObjectTest, AFileTellsWhatTheDiskTells) {
    const std::int64_t made = headless::SecondsOf(frame::DateFrom({2001, 2, 3, 4, 5, 6}));
    host.files.SetFile("C:\\x\\a.txt", {.created = made, .modified = made + 1, .accessed = made + 2}).Check();
    const FileRef file = fso.GetFile("C:\\x\\a.txt");
    EXPECT_EQ(file->Name(), "a.txt");
    EXPECT_EQ(file->FullPath(), "C:\\x\\a.txt");
    EXPECT_EQ(file->Size(), Variant(10));
    EXPECT_EQ(file->Type(), "TXT File");
    EXPECT_EQ(file->Attributes(), attributes::hidden);
    EXPECT_EQ(frame::DateText(file->DateCreated()), "2/3/2001 4:05:06 AM");
    EXPECT_EQ(frame::DateText(file->DateLastModified()), "2/3/2001 4:05:07 AM");
    EXPECT_EQ(frame::DateText(file->DateLastAccessed()), "2/3/2001 4:05:08 AM");
    EXPECT_EQ(file->ParentFolder()->FullPath(), "C:\\x");
}

TEST_F(FileSystemObjectTest, AFileOfMoreThanTwoGigabytesHasItsSizeAsAFloat) {
    host.files.SetFile("C:\\big", {.size = 3'000'000'000}).Check();
    const Variant size = fso.GetFile("C:\\big")->Size();
    EXPECT_EQ(size.Type(), frame::VarType::Double);
    EXPECT_EQ(size.ToDouble(), 3e9);
}

TEST_F(FileSystemObjectTest, SettingANameRenamesAndTheObjectGoesAlong) {
    const FileRef file = fso.GetFile("C:\\x\\a.txt");
    file->Put("Name", "z.txt");
    EXPECT_EQ(file->FullPath(), "C:\\x\\z.txt");
    EXPECT_EQ(file->Size(), Variant(10));
    EXPECT_FALSE(fso.FileExists("C:\\x\\a.txt"));
    const FolderRef folder = fso.GetFolder("C:\\x");
    folder->SetName("y");
    EXPECT_EQ(folder->FullPath(), "C:\\y");
    EXPECT_TRUE(fso.FileExists("C:\\y\\z.txt"));
}

TEST_F(FileSystemObjectTest, SettingANameNeverReplacesAnotherFile) {
    const FileRef file = fso.GetFile("C:\\x\\a.txt");
    EXPECT_EQ(ErrorOf([&] { file->SetName("b.txt"); }), errors::fileExists);
    EXPECT_EQ(file->FullPath(), "C:\\x\\a.txt");
    EXPECT_EQ(fso.GetFile("C:\\x\\b.txt")->Size(), Variant(3));
    EXPECT_EQ(ErrorOf([&] { fso.GetFolder("C:\\")->SetName("y"); }), errors::permissionDenied);
}

TEST_F(FileSystemObjectTest, AttributesAreSetByTheirBits) {
    const FileRef file = fso.GetFile("C:\\x\\a.txt");
    file->Put("Attributes", attributes::readOnly | attributes::system);
    EXPECT_EQ(file->Get("Attributes"), Variant(5));
    const FolderRef folder = fso.GetFolder("C:\\x");
    folder->SetAttributes(folder->Attributes() | attributes::hidden);
    EXPECT_EQ(folder->Attributes(), attributes::directory | attributes::hidden);
}

TEST_F(FileSystemObjectTest, AnObjectWhoseEntryHasGoneFails) {
    const FileRef file = fso.GetFile("C:\\x\\a.txt");
    const FolderRef folder = fso.GetFolder("C:\\x\\sub");
    host.files.Remove("C:\\x").Check();
    EXPECT_EQ(file->Name(), "a.txt");
    EXPECT_EQ(ErrorOf([&] { file->Size(); }), errors::pathNotFound);
    EXPECT_EQ(ErrorOf([&] { folder->Size(); }), errors::pathNotFound);
    EXPECT_EQ(ErrorOf([&] { folder->Files()->Count(); }), errors::pathNotFound);
}

TEST_F(FileSystemObjectTest, TheSizeOfAFolderSumsTheWholeTree) {
    EXPECT_EQ(fso.GetFolder("C:\\x")->Size(), Variant(113));
    EXPECT_EQ(fso.GetFolder("C:\\x\\sub")->Size(), Variant(100));
}

TEST_F(FileSystemObjectTest, AFolderAtADriveRootHasNoNameAndNoParent) {
    for (const char* spelling : {"C:\\", "C:", "c:\\\\"}) {
        const FolderRef root = fso.GetFolder(spelling);
        EXPECT_EQ(root->Name(), "") << spelling;
        EXPECT_EQ(root->ParentFolder(), nullptr) << spelling;
    }
    EXPECT_EQ(fso.GetFolder("C:")->FullPath(), "C:\\");
    EXPECT_EQ(fso.GetFolder("\\\\server\\name")->FullPath(), "\\\\server\\name\\");
    EXPECT_EQ(fso.GetFolder("C:\\x\\\\")->FullPath(), "C:\\x");
}

TEST(FileSystemObjectOnMountedDrives, TheFolderOfADriveHasNoNameAndNoParent) {
    posix::DiskSettings settings;
    settings.mountTable = [] { return "1 0 8:1 / / rw - ext4 /dev/sda1 rw\n2 1 8:17 / /media/usb rw - vfat /dev/sdb1 rw\n"; };
    posix::DiskFileSystem disk(settings);
    headless::HeadlessHost host(&disk);
    const FileSystemObject fso(host);
    EXPECT_EQ(Folder(host, "/media/usb/").Name(), "");
    EXPECT_EQ(Folder(host, "/media/usb/").ParentFolder(), nullptr);
    EXPECT_EQ(Folder(host, "/media/usb/x").Name(), "x");
    EXPECT_EQ(Folder(host, "/media/usb/x").ParentFolder()->FullPath(), "/media/usb/");
    EXPECT_EQ(fso.GetParentFolderName("/media/usb/"), "");
    EXPECT_EQ(fso.GetDrive("/media/usb/")->RootPath(), "/media/usb/");
    EXPECT_EQ(fso.GetFolder("/")->FullPath(), "/");
}

TEST_F(FileSystemObjectTest, FilesAndSubFoldersAreWalkedInNameOrder) {
    const FolderRef folder = fso.GetFolder("C:\\x");
    const FilesRef files = folder->Files();
    ASSERT_EQ(files->Count(), 2);
    EXPECT_EQ(files->At(1)->FullPath(), "C:\\x\\a.txt");
    EXPECT_EQ(files->At(2)->Name(), "b.txt");
    const FoldersRef folders = folder->SubFolders();
    ASSERT_EQ(folders->Count(), 1);
    EXPECT_EQ(folders->At(1)->FullPath(), "C:\\x\\sub");
    EXPECT_EQ(folders->At(1)->Type(), "File Folder");
    EXPECT_EQ(fso.GetFolder("C:\\")->SubFolders()->At(2)->FullPath(), "C:\\x");
}

TEST_F(FileSystemObjectTest, ACollectionStaysAsItWasListed) {
    const FilesRef files = fso.GetFolder("C:\\x")->Files();
    EXPECT_EQ(files->At(1)->Name(), "a.txt");
    host.files.SetFile("C:\\x\\0.txt", {}).Check();
    EXPECT_EQ(files->Count(), 2);
    EXPECT_EQ(files->At(1)->Name(), "a.txt");
    EXPECT_EQ(fso.GetFolder("C:\\x")->Files()->Count(), 3);
}

TEST_F(FileSystemObjectTest, ACollectionRefusesWhatItDoesNotHold) {
    const FilesRef files = fso.GetFolder("C:\\x")->Files();
    EXPECT_EQ(files->Item("B.TXT")->Size(), Variant(3));
    EXPECT_EQ(ErrorOf([&] { files->At(0); }), errors::subscript);
    EXPECT_EQ(ErrorOf([&] { files->At(3); }), errors::subscript);
    EXPECT_EQ(ErrorOf([&] { files->Item("sub"); }), errors::fileNotFound);
    host.files.SetFolder("C:\\x", {.unreadable = true}).Check();
    EXPECT_EQ(ErrorOf([&] { fso.GetFolder("C:\\x")->Files()->Count(); }), errors::permissionDenied);
    EXPECT_EQ(ErrorOf([&] { fso.GetFolder("C:\\x")->Files()->At(1); }), errors::permissionDenied);
}

TEST_F(FileSystemObjectTest, DrivesTellWhatTheyAre) {
    host.files.SetDrive("C", {.volume = "Work"}).Check();
    const DriveRef fixed = fso.GetDrive("c:");
    EXPECT_EQ(fixed->DrivePath(), "C:");
    EXPECT_EQ(fixed->DriveLetter(), "C");
    EXPECT_EQ(fixed->DriveType(), frame::driveTypes::fixed);
    EXPECT_EQ(fixed->VolumeName(), "Work");
    EXPECT_TRUE(fixed->IsReady());
    EXPECT_FALSE(fso.GetDrive("F:\\")->IsReady());
    const DriveRef share = fso.GetDrive("\\\\server\\name");
    EXPECT_EQ(share->DriveLetter(), "");
    EXPECT_EQ(share->ShareName(), "\\\\server\\name");
}

TEST_F(FileSystemObjectTest, DrivesAreWalkedByNumber) {
    const DrivesRef drives = fso.Drives();
    ASSERT_EQ(drives->Count(), 3);
    EXPECT_EQ(drives->Item(1)->DriveLetter(), "C");
    EXPECT_EQ(drives->Item(2)->DriveLetter(), "F");
    EXPECT_EQ(drives->Item(3)->DrivePath(), "\\\\server\\name");
    EXPECT_EQ(ErrorOf([&] { drives->Item(0); }), errors::subscript);
    EXPECT_EQ(ErrorOf([&] { drives->Item(4); }), errors::subscript);
}

TEST_F(FileSystemObjectTest, TheTemporaryFolderIsNumberTwo) {
    EXPECT_EQ(fso.GetSpecialFolder(2)->FullPath(), "C:\\Temp");
    EXPECT_EQ(ErrorOf([&] { fso.GetSpecialFolder(0); }), errors::invalidCall);
}

TEST_F(FileSystemObjectTest, ATemporaryNameComesFromTheHostsRandomNumbers) {
    host.random.queue = {0, 0.0625f, 0.5f, 0.999f, 1, -1, 1e30f, 0.125f};
    EXPECT_EQ(fso.GetTempName(), "tmp018f0002.tmp");
    EXPECT_NE(fso.GetTempName(), fso.GetTempName());
}

TEST_F(FileSystemObjectTest, TheDiskIsChangedByName) {
    Call("CreateFolder", "C:\\new");
    EXPECT_TRUE(fso.FolderExists("C:\\new"));
    EXPECT_EQ(ErrorOf([&] { fso.CreateFolder("C:\\new"); }), errors::fileExists);
    Call("CreateTextFile", "C:\\new\\a.txt", true, false).ToObject()->Call("Close");
    EXPECT_EQ(fso.GetFile("C:\\new\\a.txt")->Size(), Variant(0));
    Call("CreateTextFile", "C:\\new\\u.txt", true, true);
    EXPECT_EQ(fso.GetFile("C:\\new\\u.txt")->Size(), Variant(2));
    EXPECT_EQ(ErrorOf([&] { Call("CreateTextFile", "C:\\new\\a.txt"); }), errors::fileExists);
    fso.GetFile("C:\\new\\a.txt")->SetAttributes(attributes::readOnly);
    EXPECT_EQ(ErrorOf([&] { Call("DeleteFile", "C:\\new\\a.txt"); }), errors::permissionDenied);
    Call("DeleteFile", "C:\\new\\a.txt", true);
    EXPECT_FALSE(fso.FileExists("C:\\new\\a.txt"));
    EXPECT_EQ(ErrorOf([&] { Call("DeleteFile", "C:\\new\\a.txt", true); }), errors::fileNotFound);
}

TEST_F(FileSystemObjectTest, EverythingIsReachedByName) {
    EXPECT_EQ(Call("BuildPath", "C:\\x", "a.txt"), Variant("C:\\x\\a.txt"));
    EXPECT_EQ(Call("GetExtensionName", "C:\\x\\a.txt"), Variant("txt"));
    EXPECT_EQ(Call("GetFileName", "C:\\x\\a.txt"), Variant("a.txt"));
    EXPECT_EQ(Call("GetParentFolderName", "C:\\x"), Variant("C:\\"));
    EXPECT_EQ(Call("FileExists", "C:\\x\\A.TXT"), Variant(true));
    const ObjectRef folder = Call("GetFolder", "C:\\x").ToObject();
    EXPECT_EQ(folder->Inner("Files")->Get("Count"), Variant(2));
    Variant first[] = {1};
    EXPECT_EQ(folder->Inner("SubFolders")->Get("Item", first).ToObject()->Get("Name"), Variant("sub"));
    EXPECT_EQ(folder->Get("ParentFolder").ToObject()->Get("Path"), Variant("C:\\"));
    EXPECT_TRUE(Call("GetFolder", "C:\\").ToObject()->Get("ParentFolder").ToObject().IsNothing());
    EXPECT_EQ(fso.Inner("Drives")->Get("Count"), Variant(3));
    EXPECT_EQ(ErrorOf([&] { folder->Put("Size", 1); }), errors::notAtRunTime);
}

TEST_F(FileSystemObjectTest, TwoObjectsOfOneEntryAreEqual) {
    EXPECT_EQ(ObjectRef(fso.GetFile("C:\\x\\a.txt")), ObjectRef(fso.GetFile("c:\\X\\A.txt")));
    EXPECT_FALSE(ObjectRef(fso.GetFile("C:\\x\\a.txt")) == ObjectRef(fso.GetFile("C:\\x\\b.txt")));
    EXPECT_EQ(ObjectRef(fso.GetDrive("C")), ObjectRef(fso.GetDrive("C:\\")));
    EXPECT_FALSE(ObjectRef(fso.GetDrive("C")) == ObjectRef(fso.GetDrive("F")));
}

}  // namespace
}  // namespace tessel::fileservices
