#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

#include "tests/controls/fileview/FileViewTestHelp.h"

/// The icons of the items.
namespace tessel::controls {
namespace {

using namespace fileviewtest;
using testing::ElementsAre;
using testing::IsEmpty;

class FileViewIcons : public testing::Test {
  protected:
    std::string SmallIcons() {
        std::string line;
        for (std::int32_t index = 1; index <= view.ItemCount(); ++index)
            line += (index == 1 ? "" : " | ") + view.ListFiles.ListItems.Item(index)->SmallIcon().ToText();
        return line;
    }
    void List(const std::string& path) {
        stage.Asked();
        view.SetPathRoot(path);
    }
    Stage stage;
    FileView& view = stage.View();
};

TEST_F(FileViewIcons, AnExtensionIsAskedForOnceInEachSize) {
    stage.File("C:\\x\\a.txt");
    stage.File("C:\\x\\b.TXT");
    List("C:\\x");
    EXPECT_THAT(stage.Asked(), ElementsAre("S C:\\x\\a.txt", "L C:\\x\\a.txt"));
    EXPECT_EQ(frame::FoldCase(SmallIcons()), "txt | txt");
    List("C:\\x");
    EXPECT_THAT(stage.Asked(), IsEmpty());
    EXPECT_EQ(Keys(view.Image32), "Drive Unavailable | FolderUnavailable | File Folder | txt");
}

TEST_F(FileViewIcons, EachProgramHasItsOwnUntilTheNextPaint) {
    stage.File("C:\\x\\one.exe");
    stage.File("C:\\x\\two.EXE");
    List("C:\\x");
    EXPECT_EQ(SmallIcons(), "one.exe | two.EXE");
    EXPECT_EQ(Keys(view.Image32), "Drive Unavailable | FolderUnavailable | File Folder | one.exe | two.EXE");
    EXPECT_EQ(view.Image16.ListImages.FindKey("one.exe")->Tag().ToText(), "exe");
    EXPECT_EQ(stage.Asked().size(), 4u);
    stage.Remove("C:\\x\\one.exe");
    List("C:\\x");
    EXPECT_EQ(Keys(view.Image32), "Drive Unavailable | FolderUnavailable | File Folder | two.EXE");
    EXPECT_EQ(stage.Asked().size(), 2u);
}

TEST_F(FileViewIcons, AProgramThatIsAddedAgainFindsItsImage) {
    stage.File("C:\\x\\one.exe");
    List("C:\\x");
    view.ItemAddNew("C:\\x\\one.exe");
    EXPECT_EQ(SmallIcons(), "one.exe | one.exe");
    EXPECT_EQ(view.Image16.ListImages.Count(), 6);
}

TEST_F(FileViewIcons, ClearingTakesTheProgramsImagesAway) {
    stage.File("C:\\x\\one.exe");
    stage.File("C:\\x\\a.txt");
    List("C:\\x");
    view.ItemClear();
    EXPECT_EQ(Keys(view.Image16), "SortDown | SortUp | Drive Unavailable | FolderUnavailable | File Folder | txt");
    EXPECT_EQ(view.ListFiles.SmallIcons(), &view.Image16);
    EXPECT_EQ(view.ListFiles.Icons(), &view.Image32);
    EXPECT_EQ(view.ListFiles.ColumnHeaderIcons(), &view.Image16);
}

TEST_F(FileViewIcons, AFileWithoutExtensionEndsWithoutAnImage) {
    stage.File("C:\\x\\README");
    List("C:\\x");
    EXPECT_EQ(SmallIcons(), "");
    EXPECT_EQ(view.Image16.ListImages.Count(), 6);
    EXPECT_EQ(view.Image16.ListImages.Item(6).Key(), "");
}

TEST_F(FileViewIcons, EveryFileWithoutExtensionAddsAnImageWithoutKey) {
    stage.File("C:\\x\\LICENSE");
    stage.File("C:\\x\\README");
    List("C:\\x");
    EXPECT_EQ(SmallIcons(), " | ");
    EXPECT_THAT(stage.Asked(), ElementsAre("S C:\\x\\LICENSE", "L C:\\x\\LICENSE", "S C:\\x\\README", "L C:\\x\\README"));
    EXPECT_EQ(view.Image16.ListImages.Count(), 7);
    EXPECT_EQ(view.Image32.ListImages.Count(), 5);
}

TEST_F(FileViewIcons, AnIconThatTheSystemLacksIsAskedForAgain) {
    stage.host.pictures.icons = {false, false, false, false};
    stage.File("C:\\x\\a.txt");
    stage.File("C:\\x\\b.txt");
    List("C:\\x");
    EXPECT_EQ(SmallIcons(), " | ");
    EXPECT_EQ(stage.Asked().size(), 4u);
    EXPECT_EQ(Rows(view), "a.txt | b.txt");
}

TEST_F(FileViewIcons, FoldersHaveTheImageOfTheirType) {
    stage.Folder("C:\\x\\plain");
    stage.Disk().SetFolder("C:\\x\\special", {.type = "Briefcase"}).Check();
    List("C:\\x");
    EXPECT_EQ(SmallIcons(), "File Folder | Briefcase");
    EXPECT_THAT(stage.Asked(), ElementsAre("S C:\\x\\special", "L C:\\x\\special"));
}

TEST_F(FileViewIcons, DrivesHaveTheImageOfTheirKind) {
    stage.Disk().SetDrive("D", {}).Check();
    stage.Disk().SetDrive("N", {.type = frame::driveTypes::network, .share = "\\\\s\\n", .ready = false}).Check();
    List("My Computer");
    EXPECT_EQ(SmallIcons(), "Local Disk | Local Disk | Drive Unavailable");
    EXPECT_THAT(stage.Asked(), ElementsAre("S C:\\", "L C:\\"));
}

TEST_F(FileViewIcons, AnItemCanBeGivenItsIcon) {
    stage.File("C:\\x\\a.txt");
    stage.Folder("C:\\x\\sub");
    List("C:\\x");
    view.SetItemIndex(2);
    view.SetItemIcon("File Folder");
    EXPECT_EQ(view.ItemSetupIcon(2), "txt");
    EXPECT_EQ(view.ItemIcon(), "txt");
    EXPECT_EQ(view.ItemSetupIcon(1), "File Folder");
    EXPECT_EQ(view.ItemSetupIcon(0), "");
    EXPECT_EQ(view.ItemSetupIcon(3), "");
}

TEST_F(FileViewIcons, TheIconOfATypeComesByWayOfATemporaryFile) {
    std::string during;
    stage.host.pictures.onIcon = [&](const std::string& path) {
        EXPECT_TRUE(stage.Disk().FileExists(path));
        during = path;
    };
    EXPECT_TRUE(view.ImageLoadFileType("txt"));
    EXPECT_EQ(during.substr(0, 8), "C:\\Temp\\");
    EXPECT_EQ(during.substr(during.size() - 4), ".txt");
    EXPECT_FALSE(stage.Disk().FileExists(during));
    EXPECT_NE(view.Image32.ListImages.FindKey("txt"), nullptr);
    stage.Asked();
    EXPECT_TRUE(view.ImageLoadFileType("TXT"));
    EXPECT_THAT(stage.Asked(), IsEmpty());
    EXPECT_FALSE(view.ImageLoadFileType(""));
    stage.host.pictures.icons = {false, false};
    EXPECT_FALSE(view.ImageLoadFileType("doc"));
}

TEST_F(FileViewIcons, ATemporaryFileDoesNotCountForWhatAListingFound) {
    for (int number = 1000; number < 3000; ++number) stage.File("C:\\Temp\\" + std::to_string(number) + "\\one", 1);
    List("C:\\Temp");
    EXPECT_FALSE(view.TotalSizeKnown());
    view.ImageLoadFileType("txt");
    EXPECT_TRUE(view.TotalSizeKnown());
    EXPECT_EQ(view.TotalSize(), frame::Variant(2000));
}

}  // namespace
}  // namespace tessel::controls
