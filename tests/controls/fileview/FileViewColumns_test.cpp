#include <gtest/gtest.h>

#include <string>

#include "frame/Text.h"
#include "tests/controls/fileview/FileViewTestHelp.h"

/// Columns, sorting and views.
namespace tessel::controls {
namespace {

using namespace fileviewtest;
using Order = child::ListSortOrderConstants;

class FileViewColumns : public testing::Test {
  protected:
    void Click(std::int32_t column) { view.ListFiles.ColumnClickInput(column); }
    /// The headers that have an image: "Size:SortDown".
    std::string Arrows() const {
        std::string line;
        const child::ColumnHeaders& headers = view.ListFiles.ColumnHeaders;
        for (std::int32_t index = 1; index <= headers.Count(); ++index) {
            const std::string icon = headers.Item(index).Icon().ToText();
            if (!icon.empty() && icon != "0") line += (line.empty() ? "" : " ") + headers.Item(index).Text() + ":" + icon;
        }
        return line;
    }
    std::string Sorting() const {
        const bool ascending = view.ListFiles.SortOrder() == Order::Ascending;
        return frame::Decimal(view.ListFiles.SortKey()) + (ascending ? " up" : " down") +
               (view.ListFiles.Sorted() ? " sorted" : "");
    }
    std::string SortedRows() {
        view.ListFiles.Rows().TakeChanges();
        return Rows(view);
    }
    Stage stage;
    FileView& view = stage.View();
};

TEST_F(FileViewColumns, StandAsTheyWereDesigned) {
    std::string line;
    child::ColumnHeaders& headers = view.ListFiles.ColumnHeaders;
    for (std::int32_t index = 1; index <= headers.Count(); ++index) {
        const child::ColumnHeader& header = headers.Item(index);
        line += header.Text() + "," + frame::Decimal(static_cast<int>(header.Width())) + "," +
                (header.Alignment() == child::AlignmentConstants::RightJustify ? "right" : "left") + "," + header.Key() + "," +
                header.Tag().ToText() + " ";
    }
    EXPECT_EQ(line,
              "Name,2540,left,,13 Size,1305,right,,8 Type,2540,left,, Modified,2540,left,,9 Created,2540,left,,10 "
              "Changed,582,left,, Folder,6068,left,Folder, SortedSize,0,left,, SortedModified,0,left,, SortedCreated,0,left,, "
              "RealName,0,left,RealName, Refresh,0,left,Refresh, SortName,0,left,, ");
    EXPECT_EQ(Sorting(), "12 up");
    EXPECT_EQ(view.ListFiles.ColumnHeaderIcons(), &view.Image16);
    EXPECT_EQ(view.View(), child::ListViewConstants::Report);
}

TEST_F(FileViewColumns, TheFirstClickOnNameTurnsTheOrderRound) {
    stage.File("C:\\x\\a");
    stage.File("C:\\x\\b");
    stage.Folder("C:\\x\\z");
    stage.ShowPath("C:\\x");
    Click(1);
    EXPECT_EQ(Sorting(), "12 down sorted");
    EXPECT_EQ(Arrows(), "Name:SortUp");
    EXPECT_EQ(SortedRows(), "b | a | z");
    Click(1);
    EXPECT_EQ(Sorting(), "12 up sorted");
    EXPECT_EQ(Arrows(), "Name:SortDown");
    EXPECT_EQ(SortedRows(), "z | a | b");
}

TEST_F(FileViewColumns, SizesSortByTheirNumbersAndFoldersByTheirCount) {
    stage.File("C:\\x\\a", 10);
    stage.File("C:\\x\\b", 9);
    stage.File("C:\\x\\c", 1000);
    for (const char* name : {"1", "2", "3", "4", "5", "6", "7", "8", "9", "10"}) stage.File(std::string("C:\\x\\z\\") + name, 1);
    stage.Folder("C:\\x\\none");
    stage.ShowPath("C:\\x");
    Click(2);
    EXPECT_EQ(Sorting(), "7 up sorted");
    EXPECT_EQ(Arrows(), "Size:SortDown");
    EXPECT_EQ(SortedRows(), "none | b | z | a | c");
    Click(2);
    EXPECT_EQ(Sorting(), "7 down sorted");
    EXPECT_EQ(Arrows(), "Size:SortUp");
    EXPECT_EQ(SortedRows(), "c | z | a | b | none");
}

TEST_F(FileViewColumns, ASizeOfMoreThanTwelveDigitsSortsByItsText) {
    stage.File("C:\\x\\a", 999'999'999'999);
    stage.File("C:\\x\\b", 1'000'000'000'000);
    stage.File("C:\\x\\c", 5);
    stage.ShowPath("C:\\x");
    Click(2);
    EXPECT_EQ(SortedRows(), "c | b | a");
}

TEST_F(FileViewColumns, DatesSortByTheirMoments) {
    stage.File("C:\\x\\a", 0, 300, 1'000'000'000);
    stage.File("C:\\x\\b", 0, 100, 999'999'999);
    stage.File("C:\\x\\c", 0, 200, 2'000'000'000);
    stage.ShowPath("C:\\x");
    Click(4);
    EXPECT_EQ(Sorting(), "8 up sorted");
    EXPECT_EQ(SortedRows(), "b | a | c");
    Click(5);
    EXPECT_EQ(Sorting(), "9 up sorted");
    EXPECT_EQ(SortedRows(), "b | c | a");
}

TEST_F(FileViewColumns, ColumnsWithoutATagSortByThemselves) {
    stage.File("C:\\x\\a.txt", 0, 0, 1);
    stage.File("C:\\x\\b.doc");
    stage.ShowPath("C:\\x");
    Click(3);
    EXPECT_EQ(Sorting(), "2 up sorted");
    EXPECT_EQ(Arrows(), "Type:SortDown");
    EXPECT_EQ(SortedRows(), "b.doc | a.txt");
    Click(6);
    EXPECT_EQ(Sorting(), "5 up sorted");
    EXPECT_EQ(Arrows(), "Changed:SortDown");
    EXPECT_EQ(SortedRows(), "b.doc | a.txt");
}

TEST_F(FileViewColumns, TheCursorKeepsItsNumberWhenTheRowsMove) {
    stage.File("C:\\x\\a");
    stage.File("C:\\x\\b");
    stage.ShowPath("C:\\x");
    view.SetItemIndex(2);
    Click(1);
    view.ListFiles.Rows().TakeChanges();
    EXPECT_EQ(view.ItemIndex(), 2);
    EXPECT_EQ(view.ItemName(), "a");
    EXPECT_EQ(stage.Events(), "");
}

TEST_F(FileViewColumns, ATagThatIsNoNumberSortsByTheClickedColumn) {
    view.ListFiles.ColumnHeaders.Item(2).SetTag("none");
    Click(2);
    EXPECT_EQ(Sorting(), "1 up sorted");
    EXPECT_EQ(Arrows(), "Size:SortDown");
}

TEST_F(FileViewColumns, ASortedListIsListedSorted) {
    stage.File("C:\\x\\a", 3);
    stage.File("C:\\x\\b", 2);
    stage.File("C:\\x\\c", 1);
    stage.ShowPath("C:\\x");
    Click(2);
    view.Show();
    EXPECT_EQ(SortedRows(), "c | b | a");
    EXPECT_EQ(Sorting(), "7 up sorted");
}

TEST_F(FileViewColumns, ARowIsAddedBeforeItsTextsAreThere) {
    stage.File("C:\\x\\a", 3);
    stage.File("C:\\x\\b", 2);
    Click(2);
    stage.ShowPath("C:\\x");
    view.Show();
    // A new row has an empty size when it is put in, so that it stands first.
    EXPECT_NE(stage.Events().find("AfterAddItem(1) BeforeAddItem(False, C:\\x\\b) AfterAddItem(1)"), std::string::npos);
}

TEST_F(FileViewColumns, ThePicturesAreThereFromTheStart) {
    EXPECT_EQ(Keys(view.Image16), "SortDown | SortUp | Drive Unavailable | FolderUnavailable | File Folder");
    EXPECT_EQ(Keys(view.Image32), "Drive Unavailable | FolderUnavailable | File Folder");
    EXPECT_EQ(view.Image16.ImageWidth(), 16);
    EXPECT_EQ(view.Image32.ImageHeight(), 32);
    EXPECT_EQ(view.Image16.MaskColor(), frame::OLE_COLOR(0xC0C0C0));
    for (child::ImageList* images : {&view.Image16, &view.Image32})
        for (std::int32_t index = 1; index <= images->ListImages.Count(); ++index) {
            const frame::PixelPlane* plane = images->ListImages.Item(index).Picture()->Plane(1);
            ASSERT_NE(plane, nullptr);
            EXPECT_EQ(plane->width, images->ImageWidth());
            int drawn = 0, clear = 0;
            for (const std::uint32_t pixel : plane->pixels) ++(pixel == 0 ? clear : drawn);
            EXPECT_GE(drawn, plane->width) << images->ListImages.Item(index).Key();
            EXPECT_GT(clear, plane->width) << images->ListImages.Item(index).Key();
            for (std::int32_t other = 1; other < index; ++other)
                EXPECT_NE(images->ListImages.Item(other).Picture()->Plane(1)->pixels, plane->pixels);
        }
}

}  // namespace
}  // namespace tessel::controls
