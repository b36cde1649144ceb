#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstdint>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "tests/controls/folderview/FolderViewTestHelp.h"

/// The images of the nodes and how they come into the list.
namespace tessel::controls {
namespace {

using namespace foldertest;
using frame::Variant;
using testing::ElementsAre;
using testing::IsEmpty;
namespace attributes = frame::attributes;

class FolderViewImages : public testing::Test {
  protected:
    std::string ImageOf(const std::string& key) { return stage.Node(key)->Image().ToText(); }
    std::string SelectedImageOf(const std::string& key) { return stage.Node(key)->SelectedImage().ToText(); }
    /// A pixel of an image of the list, as 0xAABBGGRR.
    std::uint32_t PixelOf(const std::string& key, std::size_t pixel) {
        return view.Image16.ListImages.FindKey(key)->Picture()->Plane(1)->pixels.at(pixel);
    }
    /// Puts an image of two pixels into the list before the system is asked for one.
    void AddImage(const std::string& key, std::uint32_t first, std::uint32_t second) {
        std::vector<frame::PixelPlane> planes{{1, 2, 1, {first, second}}};
        view.ImageAddNew(Variant(std::make_shared<frame::Picture>(std::move(planes), key)), key);
    }
    static constexpr std::uint32_t black = 0xFF000000, blue = 0xFFFF0000;
    Stage stage;
    FolderView& view = stage.View();
};

TEST_F(FolderViewImages, TheListStartsWithFourImagesOfTheDesign) {
    EXPECT_EQ(ImageKeys(view), designImages);
    EXPECT_EQ(view.ImageCount(), 4);
    EXPECT_EQ(view.Image16.ImageWidth(), 16);
    EXPECT_EQ(view.Image16.ImageHeight(), 16);
    EXPECT_EQ(view.Image16.MaskColor(), frame::OLE_COLOR(0xC0C0C0));
    EXPECT_TRUE(view.Image16.UseMaskColor());
}

TEST_F(FolderViewImages, TheDesignImagesHavePixels) {
    for (std::int32_t index = 1; index <= 4; ++index) {
        const frame::PixelPlane* plane = view.Image16.ListImages.Item(index).Picture()->Plane(1);
        ASSERT_NE(plane, nullptr) << index;
        EXPECT_EQ(plane->width, 16);
        EXPECT_EQ(plane->height, 16);
    }
}

TEST_F(FolderViewImages, AFolderShowsItsTypeAndSelectedItsOpenForm) {
    stage.Folder("C:\\x");
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(ImageOf("C:\\x"), "File Folder");
    EXPECT_EQ(SelectedImageOf("C:\\x"), "OPEN_File Folder");
}

TEST_F(FolderViewImages, ATypeIsAskedForOnceInEachForm) {
    for (const char* path : {"C:\\x\\a", "C:\\x\\b"}) stage.Folder(path);
    view.SetPathRoot("C:\\x");
    EXPECT_THAT(stage.Asked(), ElementsAre("closed C:\\x", "open C:\\x"));
    EXPECT_EQ(ImageKeys(view), std::string(designImages) + " | File Folder | OPEN_File Folder");
    stage.ShowRoot("C:\\Temp");
    EXPECT_THAT(stage.Asked(), IsEmpty());
}

TEST_F(FolderViewImages, EachTypeHasItsImages) {
    stage.Folder("C:\\x");
    stage.Disk().SetFolder("C:\\x\\a", {.type = "Album"}).Check();
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(ImageOf("C:\\x\\a"), "Album");
    EXPECT_EQ(SelectedImageOf("C:\\x\\a"), "OPEN_Album");
    EXPECT_EQ(ImageOf("C:\\x"), "File Folder");
    EXPECT_EQ(ImageKeys(view), std::string(designImages) + " | File Folder | OPEN_File Folder | Album | OPEN_Album");
}

TEST_F(FolderViewImages, TheImagesAreTheIconsThatTheSystemGave) {
    stage.Folder("C:\\x");
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(PixelOf("File Folder", 0), blue);
    EXPECT_EQ(view.Image16.ListImages.FindKey("File Folder")->Picture()->Width(), 240);
}

TEST_F(FolderViewImages, AnIconThatTheSystemLacksLeavesTheNodeWithoutImageAndIsAskedForAgain) {
    stage.Folder("C:\\x\\a");
    stage.hasIcon = [](const std::string&) { return false; };
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(Labels(view), "x {a}");
    EXPECT_EQ(ImageOf("C:\\x"), "");
    EXPECT_EQ(SelectedImageOf("C:\\x"), "");
    EXPECT_THAT(stage.Asked(), ElementsAre("closed C:\\x", "open C:\\x", "closed C:\\x\\a", "open C:\\x\\a"));
    EXPECT_EQ(ImageKeys(view), designImages);
}

TEST_F(FolderViewImages, AMissingOpenFormLeavesTheClosedOne) {
    stage.Folder("C:\\x");
    stage.hasIcon = [](const std::string& icon) { return !icon.starts_with("open"); };
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(ImageOf("C:\\x"), "File Folder");
    EXPECT_EQ(SelectedImageOf("C:\\x"), "");
    EXPECT_EQ(ImageKeys(view), std::string(designImages) + " | File Folder");
}

TEST_F(FolderViewImages, ADriveShowsTheWordOfItsType) {
    stage.Drive("D", {.type = frame::driveTypes::compactDisk});
    stage.Drive("E", {.type = frame::driveTypes::removable});
    stage.ShowRoot("My Computer");
    EXPECT_EQ(ImageOf("C:\\"), "Local Disk");
    EXPECT_EQ(SelectedImageOf("C:\\"), "OPEN_Local Disk");
    EXPECT_EQ(ImageOf("D:\\"), "Compact Disk");
    EXPECT_EQ(SelectedImageOf("D:\\"), "OPEN_Compact Disk");
    EXPECT_EQ(ImageOf("E:\\"), "Removable Disk");
}

TEST_F(FolderViewImages, TheIconOfADriveIsAskedForByItsRoot) {
    view.SetPathRoot("My Computer");
    const std::vector<std::string> asked = stage.Asked();
    ASSERT_GE(asked.size(), 2u);
    EXPECT_EQ(asked[0], "closed C:\\");
    EXPECT_EQ(asked[1], "open C:\\");
}

TEST_F(FolderViewImages, AnUnreadyNetworkDriveShowsTheImageOfTheDesign) {
    stage.Drive("N", {.type = frame::driveTypes::network, .share = "\\\\server\\name", .ready = false});
    view.SetPathRoot("My Computer");
    EXPECT_EQ(ImageOf("N:\\"), "Drive Unavailable");
    for (const std::string& icon : stage.Asked()) EXPECT_EQ(icon.find("closed N:\\"), std::string::npos);
}

TEST_F(FolderViewImages, SpecialRootsShowTheImagesOfTheDesign) {
    for (const char* root : {"My Computer", "My Folders"}) {
        stage.ShowRoot(root);
        EXPECT_EQ(ImageOf(root), root);
    }
}

TEST_F(FolderViewImages, MyDocumentsShowsTheIconsOfItsFolder) {
    stage.Folder("C:\\My Documents");
    stage.ShowRoot("My Documents");
    EXPECT_EQ(ImageOf("C:\\My Documents"), "File Folder");
    EXPECT_EQ(SelectedImageOf("C:\\My Documents"), "OPEN_File Folder");
}

TEST_F(FolderViewImages, AHiddenFolderShowsPaleCopies) {
    stage.Folder("C:\\x\\h", attributes::hidden);
    view.SetAllowHiddenFolders(true);
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(ImageOf("C:\\x\\h"), "HIDDEN_File Folder");
    EXPECT_EQ(SelectedImageOf("C:\\x\\h"), "HIDDEN_OPEN_File Folder");
    EXPECT_EQ(ImageOf("C:\\x"), "File Folder");
    EXPECT_EQ(ImageKeys(view),
              std::string(designImages) + " | File Folder | OPEN_File Folder | HIDDEN_File Folder | HIDDEN_OPEN_File Folder");
}

TEST_F(FolderViewImages, PaleCopiesAreMadeOnceForAType) {
    for (const char* path : {"C:\\x\\g", "C:\\x\\h"}) stage.Folder(path, attributes::hidden);
    view.SetAllowHiddenFolders(true);
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(view.ImageCount(), 8);
    EXPECT_EQ(ImageOf("C:\\x\\g"), ImageOf("C:\\x\\h"));
}

TEST_F(FolderViewImages, APaleCopyIsHalfWayToWhite) {
    stage.Folder("C:\\x\\h", attributes::hidden);
    AddImage("File Folder", black, blue);
    AddImage("OPEN_File Folder", blue, black);
    view.SetAllowHiddenFolders(true);
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(PixelOf("HIDDEN_File Folder", 0), 0xFF808080u);
    EXPECT_EQ(PixelOf("HIDDEN_OPEN_File Folder", 0), 0xFFFF8080u);
    EXPECT_EQ(PixelOf("File Folder", 0), black);
}

TEST_F(FolderViewImages, APaleCopyKeepsTheMaskColour) {
    stage.Folder("C:\\x\\h", attributes::hidden);
    constexpr std::uint32_t gray = 0xFFC0C0C0;
    AddImage("File Folder", gray, black);
    view.SetAllowHiddenFolders(true);
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(PixelOf("HIDDEN_File Folder", 0), gray);
    EXPECT_EQ(PixelOf("HIDDEN_File Folder", 1), 0xFF808080u);
}

TEST_F(FolderViewImages, ASystemFolderIsNotPale) {
    stage.Folder("C:\\x\\s", attributes::system);
    view.SetAllowSystemFolders(true);
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(ImageOf("C:\\x\\s"), "File Folder");
}

TEST_F(FolderViewImages, AHiddenFolderOfATypeWithoutIconHasNoImage) {
    stage.Folder("C:\\x");
    stage.Disk().SetFolder("C:\\x\\h", {.attributes = attributes::hidden, .type = "Strange"}).Check();
    stage.hasIcon = [](const std::string& icon) { return icon.find("\\h") == std::string::npos; };
    view.SetAllowHiddenFolders(true);
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(Labels(view), "x {h}");
    EXPECT_EQ(ImageOf("C:\\x\\h"), "");
    EXPECT_EQ(view.Image16.ListImages.FindKey("HIDDEN_Strange"), nullptr);
}

TEST_F(FolderViewImages, AnImageThatTheHostHasAddedUnderATypeIsUsed) {
    stage.Folder("C:\\x");
    const auto own = std::make_shared<frame::Picture>(240.0f, 240.0f, "own");
    view.ImageAddNew(Variant(own), "File Folder");
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(ImageOf("C:\\x"), "File Folder");
    EXPECT_EQ(view.Image16.ListImages.FindKey("File Folder")->Picture(), own);
    EXPECT_THAT(stage.Asked(), IsEmpty());
}

TEST_F(FolderViewImages, AnImageThatTheHostHasRemovedIsAskedForAgain) {
    stage.Folder("C:\\x");
    stage.ShowRoot("C:\\x");
    view.ImageRemove("File Folder");
    stage.Asked();
    view.Show();
    EXPECT_EQ(ImageOf("C:\\x"), "File Folder");
    EXPECT_EQ(stage.Asked().front(), "closed C:\\x");
}

TEST_F(FolderViewImages, ImagesLastAsLongAsTheControl) {
    stage.Folder("C:\\x");
    stage.ShowRoot("C:\\x");
    stage.ShowRoot("");
    EXPECT_EQ(ImageKeys(view), std::string(designImages) + " | File Folder | OPEN_File Folder");
}

}  // namespace
}  // namespace tessel::controls
