#include "frame/FileSystem.h"

#include <gtest/gtest.h>

#include <functional>

#include "hosts/headless/MemoryDisk.h"
#include "hosts/posix/DiskFileSystem.h"
#include "tests/hosts/TestFolder.h"

/// What holds on every file system.
namespace tessel {
namespace {

using frame::FileRecord;
using frame::Status;
namespace attributes = frame::attributes;

/// A file system with an empty folder on it, and what a test needs to fill that behind the file system's back.
class Stage {
  public:
    virtual ~Stage() = default;
    virtual frame::FileSystem& Files() = 0;
    virtual std::string Root() = 0;
    virtual void WriteAt(const std::string& path, std::string_view contents) = 0;
    virtual void MakeAt(const std::string& path) = 0;
    virtual void RemoveAt(const std::string& path) = 0;
    virtual void SetTimesAt(const std::string& path, std::int64_t modified, std::int64_t accessed) = 0;
};

class MemoryStage final : public Stage {
  public:
    MemoryStage() { disk_.SetFolder(Root(), {}).Check(); }
    frame::FileSystem& Files() override { return disk_; }
    std::string Root() override { return "C:\\Stage"; }
    void WriteAt(const std::string& path, std::string_view contents) override {
        disk_.SetFile(path, {.contents = std::string(contents)}).Check();
    }
    void MakeAt(const std::string& path) override { disk_.SetFolder(path, {}).Check(); }
    void RemoveAt(const std::string& path) override { disk_.Remove(path).Check(); }
    void SetTimesAt(const std::string& path, std::int64_t modified, std::int64_t accessed) override {
        disk_.SetFile(path, {.modified = modified, .accessed = accessed}).Check();
    }

  private:
    headless::MemoryDisk disk_;
};

class DiskStage final : public Stage {
  public:
    explicit DiskStage(bool useStatx) : disk_(Settings(useStatx)) {}
    frame::FileSystem& Files() override { return disk_; }
    std::string Root() override { return folder_.Path(); }
    void WriteAt(const std::string& path, std::string_view contents) override { folder_.Write(Name(path), contents); }
    void MakeAt(const std::string& path) override { folder_.Make(Name(path)); }
    void RemoveAt(const std::string& path) override { std::filesystem::remove_all(path); }
    void SetTimesAt(const std::string& path, std::int64_t modified, std::int64_t accessed) override {
        folder_.SetTimes(Name(path), modified, accessed);
    }

  private:
    static posix::DiskSettings Settings(bool useStatx) {
        auto settings = posix::DiskSettings::OfThisProcess();
        settings.useStatx = useStatx;
        settings.mountTable = [] { return "1 0 8:1 / / rw - ext4 /dev/sda1 rw\n"; };
        return settings;
    }
    std::string Name(const std::string& path) const { return path.substr(folder_.Path().size() + 1); }

    test::TestFolder folder_;
    posix::DiskFileSystem disk_;
};

struct Kind {
    const char* name;
    std::function<std::unique_ptr<Stage>()> make;
    friend void PrintTo(const Kind& kind, std::ostream* out) { *out << kind.name; }
};

class FileSystemTest : public testing::TestWithParam<Kind> {
  protected:
    FileSystemTest() : stage_(GetParam().make()), files_(stage_->Files()) {}

    /// A path below the stage, "a/b" with the separator that is right.
    std::string At(std::string_view names) const {
        std::string path = stage_->Root() + "/" + std::string(names);
        for (std::size_t i = stage_->Root().size(); i < path.size(); ++i)
            if (path[i] == '/') path[i] = files_.Separator();
        return path;
    }
    void Write(std::string_view names, std::string_view contents = "") { stage_->WriteAt(At(names), contents); }
    void Make(std::string_view names) { stage_->MakeAt(At(names)); }
    void Remove(std::string_view names) { stage_->RemoveAt(At(names)); }

    /// "src/ a.txt b.txt"; the error's number when the folder cannot be listed.
    std::string Rows(const std::string& path) {
        std::unique_ptr<frame::FolderListing> listing;
        if (const Status status = files_.List(path, listing); status.Failed()) return std::to_string(status.Number());
        std::string rows;
        for (std::size_t i = 0; i < listing->Count(); ++i)
            rows += (i > 0 ? " " : "") + std::string(listing->Name(i)) + (listing->IsFolder(i) ? "/" : "");
        return rows;
    }
    FileRecord RecordOf(std::string_view names) {
        FileRecord record;
        EXPECT_FALSE(files_.Stat(At(names), record).Failed()) << names;
        return record;
    }
    std::string Read(std::string_view names) {
        std::unique_ptr<frame::BinaryFile> file;
        if (const Status status = files_.OpenForReading(At(names), file); status.Failed()) return std::to_string(status.Number());
        std::string bytes(static_cast<std::size_t>(file->Size()) + 1, '?');
        std::size_t read = 0;
        file->Read(0, bytes.data(), bytes.size(), read).Check();
        bytes.resize(read);
        return bytes;
    }
    std::int32_t AttributesOf(std::string_view names) { return RecordOf(names).attributes; }

    std::unique_ptr<Stage> stage_;
    frame::FileSystem& files_;
};

INSTANTIATE_TEST_SUITE_P(Hosts, FileSystemTest,
                         testing::Values(Kind{"Memory", [] { return std::make_unique<MemoryStage>(); }},
                                         Kind{"Disk", [] { return std::make_unique<DiskStage>(true); }},
                                         Kind{"DiskWithoutStatx", [] { return std::make_unique<DiskStage>(false); }}),
                         [](const auto& kind) { return kind.param.name; });

// What exists.

TEST_P(FileSystemTest, FilesAndFoldersAreToldApart) {
    Write("a.txt");
    Make("sub");
    EXPECT_TRUE(files_.FileExists(At("a.txt")));
    EXPECT_FALSE(files_.FolderExists(At("a.txt")));
    EXPECT_TRUE(files_.FolderExists(At("sub")));
    EXPECT_FALSE(files_.FileExists(At("sub")));
    EXPECT_TRUE(files_.FolderExists(At("sub/")));
}

TEST_P(FileSystemTest, WhatIsNotThereDoesNotExist) {
    Write("a.txt");
    for (const std::string& path : {At("b.txt"), At("sub/b.txt"), At("a.txt/b.txt"), std::string()}) {
        EXPECT_FALSE(files_.FileExists(path)) << path;
        EXPECT_FALSE(files_.FolderExists(path)) << path;
        EXPECT_FALSE(files_.DriveExists(path)) << path;
    }
}

TEST_P(FileSystemTest, ADriveIsKnownByItsRootAlone) {
    const auto drives = files_.Drives();
    ASSERT_EQ(drives.size(), 1u);
    EXPECT_EQ(drives[0].root.back(), files_.Separator());
    EXPECT_TRUE(files_.DriveExists(drives[0].root));
    EXPECT_TRUE(files_.FolderExists(drives[0].root));
    EXPECT_FALSE(files_.DriveExists(stage_->Root()));
    EXPECT_FALSE(files_.DriveExists(At("")));
}

TEST_P(FileSystemTest, TheErrorTellsWhetherTheFileOrItsFolderIsMissing) {
    FileRecord record;
    EXPECT_EQ(files_.Stat(At("a.txt"), record).Number(), 53);
    EXPECT_EQ(files_.Stat(At("sub/a.txt"), record).Number(), 76);
    std::unique_ptr<frame::BinaryFile> file;
    EXPECT_EQ(files_.OpenForReading(At("a.txt"), file).Number(), 53);
    EXPECT_EQ(files_.OpenForReading(At("sub/a.txt"), file).Number(), 76);
    EXPECT_EQ(file, nullptr);
}

// Listing.

TEST_P(FileSystemTest, AListingHasFoldersFirstAndNamesInOrder) {
    for (const char* name : {"c.txt", "a.txt", "b.txt", "aa.txt", "a"}) Write(name);
    for (const char* name : {"z", "y", "yy"}) Make(name);
    EXPECT_EQ(Rows(stage_->Root()), "y/ yy/ z/ a a.txt aa.txt b.txt c.txt");
    EXPECT_EQ(Rows(At("")), "y/ yy/ z/ a a.txt aa.txt b.txt c.txt");
}

TEST_P(FileSystemTest, NamesAlikeForLongAreInOrderToo) {
    const std::string start(100, 'n');
    std::string wanted;
    for (int i = 10; i < 60; ++i) wanted += (i > 10 ? " " : "") + start + std::to_string(i) + start;
    for (int i = 59; i >= 10; --i) Write(start + std::to_string(i) + start);
    EXPECT_EQ(Rows(stage_->Root()), wanted);
}

TEST_P(FileSystemTest, OneNameTheBeginningOfOthersComesFirst) {
    for (const char* name : {"ab.12345678x", "ab.12345678", "ab.1234567", "ab", "ab."}) {
        if (files_.IgnoresCase() && std::string_view(name).ends_with('.')) continue;  // a point at the end counts nothing there
        Write(name);
    }
    const char* wanted =
        files_.IgnoresCase() ? "ab ab.1234567 ab.12345678 ab.12345678x" : "ab ab. ab.1234567 ab.12345678 ab.12345678x";
    EXPECT_EQ(Rows(stage_->Root()), wanted);
}

TEST_P(FileSystemTest, AnEmptyFolderHasNoEntries) {
    EXPECT_EQ(Rows(stage_->Root()), "");
    frame::FolderCounts counts{7, 7};
    files_.Count(stage_->Root(), counts).Check();
    EXPECT_EQ(counts, frame::FolderCounts());
}

TEST_P(FileSystemTest, OnlyAFolderCanBeListed) {
    Write("a.txt");
    frame::FolderCounts counts;
    for (const char* names : {"a.txt", "none", "none/sub"}) {
        EXPECT_EQ(Rows(At(names)), "76") << names;
        EXPECT_EQ(files_.Count(At(names), counts).Number(), 76) << names;
    }
    EXPECT_EQ(Rows(""), "76");
}

TEST_P(FileSystemTest, AListingsRecordsAreThoseOfTheEntries) {
    Write("a.txt", "12345");
    stage_->SetTimesAt(At("a.txt"), 1'000'000'000, 1'100'000'000);
    Make("sub");
    std::unique_ptr<frame::FolderListing> listing;
    files_.List(stage_->Root(), listing).Check();
    ASSERT_EQ(listing->Count(), 2u);
    FileRecord folder, file;
    listing->Stat(0, folder).Check();
    listing->Stat(1, file).Check();
    EXPECT_EQ(folder, RecordOf("sub"));
    EXPECT_EQ(file, RecordOf("a.txt"));
    EXPECT_TRUE(folder.IsFolder());
    EXPECT_FALSE(file.IsFolder());
    EXPECT_EQ(file.size, 5);
    EXPECT_EQ(file.modified, 1'000'000'000);
    EXPECT_EQ(file.accessed, 1'100'000'000);
    EXPECT_EQ(folder.size, 0);
}

TEST_P(FileSystemTest, AListingTellsTheNamesOfItsTimeAndTheFactsOfNow) {
    Write("a.txt", "1");
    Write("b.txt", "1");
    std::unique_ptr<frame::FolderListing> listing;
    files_.List(stage_->Root(), listing).Check();
    Remove("a.txt");
    Write("b.txt", "12");
    Write("c.txt");
    FileRecord record;
    EXPECT_EQ(listing->Count(), 2u);
    EXPECT_EQ(listing->Name(0), "a.txt");
    EXPECT_EQ(listing->Stat(0, record).Number(), 53);
    listing->Stat(1, record).Check();
    EXPECT_EQ(record.size, 2);
}

TEST_P(FileSystemTest, AListingGoesOnAfterARest) {
    Write("a.txt", "123");
    std::unique_ptr<frame::FolderListing> listing;
    files_.List(stage_->Root(), listing).Check();
    listing->Rest();
    FileRecord record;
    listing->Stat(0, record).Check();
    EXPECT_EQ(record.size, 3);
}

TEST_P(FileSystemTest, AFolderThatVanishesWhileItIsListedLosesItsEntries) {
    Make("sub");
    Write("sub/a.txt");
    std::unique_ptr<frame::FolderListing> listing;
    files_.List(At("sub"), listing).Check();
    Remove("sub");
    FileRecord record;
    EXPECT_EQ(listing->Stat(0, record).Number(), 53);
    listing->Rest();
    EXPECT_EQ(listing->Stat(0, record).Number(), 53);
    EXPECT_EQ(Rows(At("sub")), "76");
}

TEST_P(FileSystemTest, EntriesAreCountedByKindAndNotBelow) {
    for (int i = 0; i < 300; ++i) Write("f" + std::to_string(i));
    Make("a/deep/er");
    Make("b");
    Write("a/x.txt");
    frame::FolderCounts counts;
    files_.Count(stage_->Root(), counts).Check();
    EXPECT_EQ(counts, (frame::FolderCounts{300, 2}));
}

TEST_P(FileSystemTest, TheSizeOfATreeSumsAllFilesBelow) {
    Write("a.txt", "12345");
    Make("sub/deep/er");
    Make("empty");
    Write("sub/b.txt", "123");
    Write("sub/deep/er/c.txt", std::string(1000, 'x'));
    EXPECT_EQ(files_.MeasureTree(stage_->Root())->Finish(), 1008);
    EXPECT_EQ(files_.MeasureTree(At("sub"))->Finish(), 1003);
    EXPECT_EQ(files_.MeasureTree(At("empty"))->Finish(), 0);
    EXPECT_EQ(files_.MeasureTree(At("none"))->Finish(), 0);
}

TEST_P(FileSystemTest, ATreeIsMeasuredInSteps) {
    for (int i = 0; i < 50; ++i) {
        Make("d" + std::to_string(i));
        Write("d" + std::to_string(i) + "/f", "12");
    }
    const auto tree = files_.MeasureTree(stage_->Root());
    EXPECT_TRUE(tree->Step(1));
    EXPECT_EQ(tree->Bytes(), 0);
    int steps = 1;
    while (tree->Step(5)) ++steps;
    EXPECT_EQ(tree->Bytes(), 100);
    EXPECT_GT(steps, 10);
    EXPECT_FALSE(tree->Step(5)) << "the end stays the end";
}

TEST_P(FileSystemTest, ATreeThatShrinksWhileItIsMeasuredIsMeasuredToItsEnd) {
    for (const char* name : {"a", "b", "c"}) {
        Make(name);
        Write(std::string(name) + "/f", "1");
    }
    const auto tree = files_.MeasureTree(stage_->Root());
    tree->Step(4);
    for (const char* name : {"a", "b", "c"}) Remove(name);
    EXPECT_LE(tree->Finish(), 3);
}

TEST_P(FileSystemTest, ADeepTreeIsMeasuredWhole) {
    std::string path = "d";
    Make(path);
    for (int depth = 0; depth < 120; ++depth) {
        Write(path + "/f", "1");
        Write(path + "/g", "1");
        path += "/d";
        Make(path);
        Make(path + "/e");
    }
    EXPECT_EQ(files_.MeasureTree(At("d"))->Finish(), 240);
}

// Types.

TEST_P(FileSystemTest, TheTypeFollowsTheExtensionWithoutRegardToCase) {
    for (const char* name : {"a.qqz", "b.QQZ", "c.qqy", "d", ".qqz"}) Write(name);
    Make("sub");
    EXPECT_EQ(RecordOf("a.qqz").typeId, RecordOf("a.qqz").typeId);
    EXPECT_EQ(files_.TypeText(RecordOf("a.qqz").typeId), "QQZ File");
    EXPECT_EQ(files_.TypeText(RecordOf("b.QQZ").typeId), "QQZ File");
    EXPECT_EQ(files_.TypeText(RecordOf("c.qqy").typeId), "QQY File");
    EXPECT_EQ(files_.TypeText(RecordOf("d").typeId), "File");
    EXPECT_EQ(files_.TypeText(RecordOf("sub").typeId), "File Folder");
    EXPECT_EQ(files_.TypeText(-1), "");
    EXPECT_EQ(files_.TypeText(1'000'000), "");
}

// Changing.

TEST_P(FileSystemTest, AFolderIsCreatedOnce) {
    EXPECT_FALSE(files_.CreateFolder(At("sub")).Failed());
    EXPECT_TRUE(files_.FolderExists(At("sub")));
    EXPECT_EQ(files_.CreateFolder(At("sub")).Number(), 58);
    Write("a.txt");
    EXPECT_EQ(files_.CreateFolder(At("a.txt")).Number(), 58);
    EXPECT_EQ(files_.CreateFolder(At("none/sub")).Number(), 76);
    EXPECT_EQ(files_.CreateFolder(At("a.txt/sub")).Number(), 76);
}

TEST_P(FileSystemTest, ANameThatIsTooLongIsRefused) {
    const std::string longest(255, 'n');
    EXPECT_FALSE(files_.CreateFolder(At(longest)).Failed());
    EXPECT_EQ(files_.CreateFolder(At(longest + "n")).Number(), 52);
    EXPECT_EQ(files_.CreateFile(At(longest + "n"), true).Number(), 52);
    EXPECT_EQ(files_.Rename(At(longest), longest + "n").Number(), 52);
    EXPECT_EQ(Rows(stage_->Root()), longest + "/");
}

TEST_P(FileSystemTest, AnEmptyFileIsCreatedAndOverwrittenOnlyWhenAsked) {
    EXPECT_FALSE(files_.CreateFile(At("a.txt"), false).Failed());
    EXPECT_EQ(Read("a.txt"), "");
    Write("a.txt", "123");
    EXPECT_EQ(files_.CreateFile(At("a.txt"), false).Number(), 58);
    EXPECT_EQ(Read("a.txt"), "123");
    EXPECT_FALSE(files_.CreateFile(At("a.txt"), true).Failed());
    EXPECT_EQ(Read("a.txt"), "");
    Make("sub");
    EXPECT_EQ(files_.CreateFile(At("sub"), true).Number(), 70);
    EXPECT_EQ(files_.CreateFile(At("none/a.txt"), true).Number(), 76);
}

TEST_P(FileSystemTest, AFileIsDeletedAReadOnlyOneByForce) {
    Write("a.txt");
    Write("b.txt");
    Make("sub");
    files_.SetAttributes(At("b.txt"), attributes::readOnly).Check();
    EXPECT_FALSE(files_.DeleteFile(At("a.txt"), false).Failed());
    EXPECT_EQ(files_.DeleteFile(At("b.txt"), false).Number(), 70);
    EXPECT_TRUE(files_.FileExists(At("b.txt")));
    EXPECT_FALSE(files_.DeleteFile(At("b.txt"), true).Failed());
    EXPECT_EQ(files_.DeleteFile(At("a.txt"), true).Number(), 53);
    EXPECT_EQ(files_.DeleteFile(At("sub"), true).Number(), 53);
    EXPECT_EQ(files_.DeleteFile(At("none/a.txt"), true).Number(), 76);
    EXPECT_EQ(Rows(stage_->Root()), "sub/");
}

TEST_P(FileSystemTest, RenamingKeepsWhatIsRenamed) {
    Write("a.txt", "123");
    Make("sub");
    Write("sub/c.txt");
    EXPECT_FALSE(files_.Rename(At("a.txt"), "b.doc").Failed());
    EXPECT_FALSE(files_.Rename(At("sub"), "other").Failed());
    EXPECT_EQ(Rows(stage_->Root()), "other/ b.doc");
    EXPECT_EQ(Read("b.doc"), "123");
    EXPECT_TRUE(files_.FileExists(At("other/c.txt")));
}

TEST_P(FileSystemTest, RenamingReplacesNothing) {
    Write("a.txt", "1");
    Write("b.txt", "2");
    Make("sub");
    EXPECT_EQ(files_.Rename(At("a.txt"), "b.txt").Number(), 58);
    EXPECT_EQ(files_.Rename(At("a.txt"), "sub").Number(), 58);
    EXPECT_EQ(files_.Rename(At("sub"), "a.txt").Number(), 58);
    EXPECT_FALSE(files_.Rename(At("a.txt"), "a.txt").Failed());
    EXPECT_EQ(Read("a.txt") + Read("b.txt"), "12");
}

TEST_P(FileSystemTest, RenamingNeedsSomethingAndAName) {
    Write("a.txt");
    EXPECT_EQ(files_.Rename(At("none.txt"), "b.txt").Number(), 53);
    EXPECT_EQ(files_.Rename(At("none/a.txt"), "b.txt").Number(), 76);
    const std::string separated = std::string("x") + files_.Separator() + "y";
    for (const std::string& name : {std::string(), std::string("."), std::string(".."), separated, std::string("x\0y", 3)})
        EXPECT_EQ(files_.Rename(At("a.txt"), name).Number(), 52) << name;
    EXPECT_EQ(Rows(stage_->Root()), "a.txt");
}

TEST_P(FileSystemTest, TheRootOfADriveKeepsItsName) { EXPECT_EQ(files_.Rename(files_.Drives()[0].root, "other").Number(), 70); }

TEST_P(FileSystemTest, ReadOnlyIsSetAndCleared) {
    Write("a.txt");
    Make("sub");
    for (const char* name : {"a.txt", "sub"}) {
        EXPECT_EQ(AttributesOf(name) & attributes::readOnly, 0);
        EXPECT_FALSE(files_.SetAttributes(At(name), AttributesOf(name) | attributes::readOnly).Failed());
        EXPECT_EQ(AttributesOf(name) & attributes::readOnly, attributes::readOnly);
        EXPECT_FALSE(files_.SetAttributes(At(name), AttributesOf(name) & ~attributes::readOnly).Failed());
        EXPECT_EQ(AttributesOf(name) & attributes::readOnly, 0);
    }
    EXPECT_EQ(AttributesOf("sub"), attributes::directory);
    EXPECT_FALSE(files_.SetAttributes(At("sub"), 0).Failed()) << "the directory bit is passed over";
    EXPECT_EQ(AttributesOf("sub"), attributes::directory);
    EXPECT_EQ(files_.SetAttributes(At("none"), 0).Number(), 53);
    EXPECT_EQ(files_.SetAttributes(At("a.txt"), 1 << 10).Number(), 5);
}

// Contents.

TEST_P(FileSystemTest, ContentsAreReadFromAnyPosition) {
    Write("a.bin", std::string("01\0"
                               "345",
                               6));
    std::unique_ptr<frame::BinaryFile> file;
    files_.OpenForReading(At("a.bin"), file).Check();
    EXPECT_EQ(file->Size(), 6);
    std::string bytes(3, '?');
    std::size_t read = 9;
    file->Read(1, bytes.data(), 3, read).Check();
    EXPECT_EQ(bytes, std::string("1\0"
                                 "3",
                                 3));
    file->Read(5, bytes.data(), 3, read).Check();
    EXPECT_EQ(read, 1u);
    file->Read(6, bytes.data(), 3, read).Check();
    EXPECT_EQ(read, 0u);
    EXPECT_EQ(file->Read(-1, bytes.data(), 3, read).Number(), 5);
}

TEST_P(FileSystemTest, AFolderHasNoContents) {
    Make("sub");
    EXPECT_EQ(Read("sub"), "75");
    EXPECT_EQ(files_.WriteOver(At("sub"), "x").Number(), 75);
}

TEST_P(FileSystemTest, WritingOverMakesTheFile) {
    EXPECT_FALSE(files_
                     .WriteOver(At("a.bin"), std::string("1\0"
                                                         "2",
                                                         3))
                     .Failed());
    EXPECT_EQ(Read("a.bin"), std::string("1\0"
                                         "2",
                                         3));
    EXPECT_EQ(files_.WriteOver(At("none/a.bin"), "x").Number(), 76);
    EXPECT_EQ(files_.WriteOver("", "x").Failed(), true);
    EXPECT_EQ(Rows(stage_->Root()), "a.bin") << "nothing else stays behind";
}

TEST_P(FileSystemTest, WritingOverKeepsWhatStandsBehind) {
    Write("a.bin", "0123456789");
    EXPECT_FALSE(files_.WriteOver(At("a.bin"), "abc").Failed());
    EXPECT_EQ(Read("a.bin"), "abc3456789");
    EXPECT_FALSE(files_.WriteOver(At("a.bin"), "").Failed());
    EXPECT_EQ(Read("a.bin"), "abc3456789");
    EXPECT_FALSE(files_.WriteOver(At("a.bin"), "a much longer text").Failed());
    EXPECT_EQ(Read("a.bin"), "a much longer text");
    EXPECT_EQ(Rows(stage_->Root()), "a.bin");
}

TEST_P(FileSystemTest, ALargeFileIsWrittenOverWhole) {
    std::string contents;
    for (int i = 0; i < 100'000; ++i) contents += std::to_string(i);
    Write("a.bin", contents);
    EXPECT_FALSE(files_.WriteOver(At("a.bin"), "start").Failed());
    EXPECT_EQ(Read("a.bin"), "start" + contents.substr(5));
}

TEST_P(FileSystemTest, TheTemporaryFolderIsThereWithoutASeparatorAtItsEnd) {
    EXPECT_TRUE(files_.FolderExists(files_.TemporaryFolder()));
    EXPECT_NE(files_.TemporaryFolder().back(), files_.Separator());
}

TEST_P(FileSystemTest, NamesThatAreNoUtf8AreNamesLikeOthers) {
    const std::string name = "\xFF\xC3z";
    Write(name, "12");
    EXPECT_EQ(Rows(stage_->Root()), name);
    EXPECT_EQ(Read(name), "12");
    EXPECT_FALSE(files_.Rename(At(name), "\xFE").Failed());
    EXPECT_EQ(Rows(stage_->Root()), "\xFE");
}

TEST_P(FileSystemTest, APathWithANulNamesNothing) {
    const std::string path = At(std::string("a\0b", 3));
    FileRecord record;
    EXPECT_FALSE(files_.FileExists(path));
    EXPECT_TRUE(files_.Stat(path, record).Failed());
    EXPECT_EQ(files_.CreateFolder(path).Number(), 52);
    EXPECT_EQ(files_.CreateFile(path, true).Number(), 52);
    EXPECT_EQ(files_.WriteOver(path, "x").Number(), 52);
    EXPECT_EQ(Rows(stage_->Root()), "");
}

}  // namespace
}  // namespace tessel
