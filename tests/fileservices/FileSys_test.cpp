#include "fileservices/FileSys.h"

#include <gtest/gtest.h>

#include "fileservices/FileSystemObject.h"
#include "frame/Error.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/ErrorOf.h"

namespace tessel::fileservices {
namespace {

using frame::Variant;
using test::ErrorOf;
using namespace std::string_literals;

class FileSysTest : public testing::Test {
  protected:
    static frame::DriveRecord Record(int type, bool ready = true, const std::string& letter = "N") {
        frame::DriveRecord record;
        record.type = type;
        record.letter = letter;
        record.isReady = ready;
        return record;
    }
    std::string WordOf(const frame::DriveRecord& record) const { return fileSys.DriveTypeWord(std::make_shared<Drive>(record)); }
    static Variant Array(std::vector<Variant> items, int lower = 0) { return frame::VariantArray(lower, std::move(items)); }
    /// The operations that reached the shell, as "kind flags [from|from] [to]".
    std::string Operations() {
        std::string text;
        for (const auto& entry : host.log.Of("operation")) {
            if (!text.empty()) text += ", ";
            text += entry[1].ToText() + " " + entry[2].ToText() + " " + List(entry[3]) + " " + List(entry[4]);
        }
        return text;
    }
    static std::string List(const Variant& list) {
        std::string text;
        for (const Variant& item : list.ToArray().items) text += (text.empty() ? "" : "|") + item.ToText();
        return "[" + text + "]";
    }

    headless::HeadlessHost host;
    FileSys& fileSys = host.Frame().Module<FileSys>();
};

TEST_F(FileSysTest, SizesRoundUpToTheNextKilobyte) {
    EXPECT_EQ(fileSys.FileSizeText(0), "0 KB");
    EXPECT_EQ(fileSys.FileSizeText(1), "1 KB");
    EXPECT_EQ(fileSys.FileSizeText(1023), "1 KB");
    EXPECT_EQ(fileSys.FileSizeText(1024), "1 KB");
    EXPECT_EQ(fileSys.FileSizeText(1025), "2 KB");
    EXPECT_EQ(fileSys.FileSizeText(1'048'576), "1,024 KB");
    EXPECT_EQ(fileSys.FileSizeKB(1'048'577), 1025);
}

TEST_F(FileSysTest, ASizeThatThirtyTwoBitsDoNotHoldOverflows) {
    constexpr double mostKilobytes = 2147483647.0;
    EXPECT_EQ(fileSys.FileSizeKB(mostKilobytes * 1024), 2147483647);
    EXPECT_EQ(ErrorOf([&] { fileSys.FileSizeKB(mostKilobytes * 1024 + 1); }), frame::errors::overflow);
}

TEST_F(FileSysTest, ASizeIsTakenByNameAsAnyNumber) {
    for (const Variant& size : {Variant(2048), Variant(2048.0), Variant(std::int16_t{2048}), Variant("2048")}) {
        Variant arguments[] = {size};
        EXPECT_EQ(fileSys.Call("FileSizeKB", arguments), Variant(2));
        EXPECT_EQ(fileSys.Call("FileSizeText", arguments), Variant("2 KB"));
    }
    Variant text[] = {"large"};
    EXPECT_EQ(ErrorOf([&] { fileSys.Call("FileSizeKB", text); }), frame::errors::typeMismatch);
}

TEST_F(FileSysTest, EveryDriveTypeHasItsWord) {
    namespace types = frame::driveTypes;
    EXPECT_EQ(WordOf(Record(types::removable)), "Removable Disk");
    EXPECT_EQ(WordOf(Record(types::fixed)), "Local Disk");
    EXPECT_EQ(WordOf(Record(types::network)), "Network Disk");
    EXPECT_EQ(WordOf(Record(types::network, true, "")), "Network Folder");
    EXPECT_EQ(WordOf(Record(types::network, false)), "Drive Unavailable");
    EXPECT_EQ(WordOf(Record(types::network, false, "")), "Drive Unavailable");
    EXPECT_EQ(WordOf(Record(types::compactDisk)), "Compact Disk");
    EXPECT_EQ(WordOf(Record(types::ramDisk)), "RAM Disk");
    EXPECT_EQ(WordOf(Record(types::unknown)), "Unknown Disk");
    EXPECT_EQ(WordOf(Record(7)), "Unknown Disk");
    EXPECT_EQ(WordOf(Record(types::removable, false)), "Removable Disk");
}

TEST_F(FileSysTest, ADriveIsTakenByName) {
    Variant drive[] = {frame::ObjectRef(FileSystemObject(host).GetDrive("C"))};
    EXPECT_EQ(fileSys.Call("DriveTypeWord", drive), Variant("Local Disk"));
    Variant none[] = {frame::ObjectRef()};
    EXPECT_EQ(ErrorOf([&] { fileSys.Call("DriveTypeWord", none); }), frame::errors::objectGone);
    Variant folder[] = {frame::ObjectRef(FileSystemObject(host).GetFolder("C:\\"))};
    EXPECT_EQ(ErrorOf([&] { fileSys.Call("DriveTypeWord", folder); }), frame::errors::typeMismatch);
}

TEST_F(FileSysTest, OnePathWithACommaInItsNameReachesTheShellAsTwoPaths) {
    fileSys.FileOpDelete(0, "C:\\a,b.txt", true);
    EXPECT_EQ(Operations(), "3 0 [C:\\a|b.txt] []");
}

TEST_F(FileSysTest, AnArrayOfTwoPathsReachesTheShellAsThoseWithANulBetweenAndTwoBehind) {
    const Variant paths = Array({"C:\\a", "C:\\b,c"}, 1);
    EXPECT_EQ(FileSys::PathListForOperation(paths), "C:\\a\0C:\\b,c\0\0"s);
    EXPECT_EQ(FileSys::PathListForOperation("C:\\a,C:\\b"), "C:\\a\0C:\\b\0\0"s);
    EXPECT_EQ(FileSys::PathListForOperation(""), "\0\0"s);
    fileSys.FileOpDelete(0, paths, true);
    EXPECT_EQ(Operations(), "3 0 [C:\\a|C:\\b,c] []");
}

TEST_F(FileSysTest, TheShellStopsReadingAtTheFirstEmptyPath) {
    EXPECT_EQ(FileSys::PathsIn(FileSys::PathListForOperation("C:\\a,,C:\\b")), std::vector<std::string>{"C:\\a"});
    EXPECT_EQ(FileSys::PathsIn(FileSys::PathListForOperation(",C:\\a")), std::vector<std::string>{});
    EXPECT_EQ(FileSys::PathsIn(FileSys::PathListForOperation(Array({}))), std::vector<std::string>{});
    EXPECT_EQ(FileSys::PathsIn("C:\\a"), std::vector<std::string>{"C:\\a"});
}

TEST_F(FileSysTest, EachOperationHasItsFlags) {
    host.shell.operationResults.resize(4);
    EXPECT_EQ(fileSys.FileOpMove(0, "C:\\a", "C:\\x"), "");
    EXPECT_EQ(fileSys.FileOpCopy(0, "C:\\a,C:\\b", "C:\\x,C:\\y"), "");
    EXPECT_EQ(fileSys.FileOpDelete(0, "C:\\a", true), "");
    EXPECT_EQ(fileSys.FileOpDelete(0, "C:\\a", false), "");
    EXPECT_EQ(Operations(), "1 8 [C:\\a] [C:\\x], 2 8 [C:\\a|C:\\b] [C:\\x|C:\\y], 3 0 [C:\\a] [], 3 64 [C:\\a] []");
}

TEST_F(FileSysTest, AFailureIsTheNumberOfTheSystemsErrorAndAnAbortSaysSo) {
    host.shell.operationResults = {{.code = 1, .aborted = true, .systemError = 32},
                                   {.code = 0, .aborted = true, .systemError = 5},
                                   {.code = 0, .aborted = false, .systemError = 5}};
    EXPECT_EQ(fileSys.FileOpCopy(0, "C:\\a", "C:\\x"), "32");
    EXPECT_EQ(fileSys.FileOpCopy(0, "C:\\a", "C:\\x"), "Operation cancelled");
    EXPECT_EQ(fileSys.FileOpCopy(0, "C:\\a", "C:\\x"), "");
}

TEST_F(FileSysTest, TheDiskFollowsTheOperationsCalledByName) {
    host.files.SetFile("C:\\a.txt", {.size = 7}).Check();
    host.files.SetFolder("C:\\x", {}).Check();
    Variant copy[] = {0, Array({"C:\\a.txt"}), "C:\\x"};
    EXPECT_EQ(fileSys.Call("FileOpCopy", copy), Variant(""));
    EXPECT_TRUE(host.files.FileExists("C:\\x\\a.txt"));
    Variant remove[] = {0, "C:\\a.txt", false};
    EXPECT_EQ(fileSys.Call("FileOpDelete", remove), Variant(""));
    EXPECT_FALSE(host.files.FileExists("C:\\a.txt"));
    EXPECT_EQ(host.files.Recycled(), std::vector<std::string>{"C:\\a.txt"});
    EXPECT_NE(fileSys.FileOpDelete(0, "C:\\a.txt", true), "");
}

TEST_F(FileSysTest, OpeningAnEmptyPathDoesNotCallTheShell) {
    EXPECT_EQ(fileSys.ShellOpenFile(0, ""), "No file specified.");
    EXPECT_EQ(fileSys.ShellPrintFile(0, ""), "No file specified.");
    EXPECT_TRUE(host.log.Of("execute").empty());
}

TEST_F(FileSysTest, OpeningAndPrintingAnswerByTheShellsNumber) {
    host.shell.executeResults = {33, 32, 31, 2, 3, 0};
    EXPECT_EQ(fileSys.ShellOpenFile(0, "a.txt"), "");
    EXPECT_EQ(fileSys.ShellOpenFile(0, "a.txt"), "Unable to view file");
    EXPECT_EQ(fileSys.ShellOpenFile(0, "a.txt"), "No application associated with file");
    EXPECT_EQ(fileSys.ShellPrintFile(0, "a.txt"), "Unable to find file");
    EXPECT_EQ(fileSys.ShellPrintFile(0, "a.txt"), "Unable to find file");
    EXPECT_EQ(fileSys.ShellPrintFile(0, "a.txt"), "Unable to view file");
    const auto calls = host.log.Of("execute");
    EXPECT_EQ(calls.front(), (headless::Log::Entry{"execute", "open", "a.txt"}));
    EXPECT_EQ(calls.back(), (headless::Log::Entry{"execute", "print", "a.txt"}));
}

}  // namespace
}  // namespace tessel::fileservices
