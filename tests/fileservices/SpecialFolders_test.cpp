#include "fileservices/SpecialFolders.h"

#include <gtest/gtest.h>

#include "frame/ClassTable.h"
#include "hosts/headless/HeadlessHost.h"

namespace tessel::fileservices {
namespace {

class SpecialFoldersTest : public testing::Test {
  protected:
    headless::HeadlessHost host;
    SpecialFolders& folders = host.Frame().Module<SpecialFolders>();
};

TEST_F(SpecialFoldersTest, ANameInAnyMixOfCapitalsGivesTheSameFolder) {
    for (const char* name : {"personal", "Personal", "PERSONAL"}) EXPECT_EQ(folders.SpecialFolderPath(name), "C:\\My Documents");
}

TEST_F(SpecialFoldersTest, MyDocumentsIsNoNameOfTheTable) {
    for (const char* name : {"My Documents", "My Computer", "My Folders", "", "Personal "})
        EXPECT_EQ(folders.SpecialFolderPath(name), "") << name;
}

TEST_F(SpecialFoldersTest, AFolderWithoutAPathIsEmpty) {
    EXPECT_EQ(folders.SpecialFolderPath("DRIVES"), "");
    constexpr int personal = 5;
    host.files.SetSpecialFolder(personal, "");
    EXPECT_EQ(folders.SpecialFolderPath("Personal"), "");
}

TEST_F(SpecialFoldersTest, EveryNameAsksForItsNumber) {
    struct Row {
        const char* name;
        int number;
    };
    constexpr Row rows[] = {{"DESKTOP", 0},    {"PROGRAMS", 2},          {"CONTROLS", 3}, {"PRINTERS", 4}, {"PERSONAL", 5},
                            {"FAVORITES", 6},  {"STARTUP", 7},           {"RECENT", 8},   {"SENDTO", 9},   {"BITBUCKET", 10},
                            {"STARTMENU", 11}, {"DESKTOPDIRECTORY", 16}, {"DRIVES", 17},  {"NETWORK", 18}, {"NETHOOD", 19},
                            {"FONTS", 20},     {"TEMPLATES", 21}};
    for (int number = 0; number <= 30; ++number) host.files.SetSpecialFolder(number, std::to_string(number));
    for (const Row& row : rows) EXPECT_EQ(folders.SpecialFolderPath(row.name), std::to_string(row.number)) << row.name;
}

TEST_F(SpecialFoldersTest, TheNameIsTakenByReference) {
    frame::Variant name[] = {"Personal"};
    EXPECT_EQ(folders.Call("SpecialFolderPath", name), frame::Variant("C:\\My Documents"));
    EXPECT_EQ(name[0], frame::Variant("Personal"));
    EXPECT_TRUE(folders.Table().Find("SpecialFolderPath")->parameters.All()[0].byReference);
}

}  // namespace
}  // namespace tessel::fileservices
