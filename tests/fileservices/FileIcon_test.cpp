#include "fileservices/FileIcon.h"

#include <gtest/gtest.h>

#include "frame/ClassTable.h"
#include "frame/Error.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/frame/TestControl.h"

namespace tessel::fileservices {
namespace {

using frame::OLE_COLOR;
using frame::ScaleModeConstants;
using frame::Variant;
using test::ErrorOf;

constexpr OLE_COLOR red = 0x0000FF, white = 0xFFFFFF;

/// A shell whose icons are red squares with a transparent left column.
class RedIcons final : public frame::PictureLoader {
  public:
    frame::PictureRef LoadPicture(const std::string&) override { return nullptr; }
    frame::PictureRef FileIcon(const std::string& path, int flags) override {
        asked.push_back(path + " " + std::to_string(flags));
        if (!hasIcons) return nullptr;
        if (icon) return icon;
        const int side = (flags & 1) != 0 ? 16 : 32;
        frame::PixelPlane plane{1, side, side, {}};
        for (int i = 0; i < side * side; ++i) plane.pixels.push_back(i % side == 0 ? 0 : 0xFF000000u | red.value);
        return std::make_shared<frame::Picture>(std::vector{plane}, "");
    }

    std::vector<std::string> asked;
    bool hasIcons = true;
    frame::PictureRef icon;  // instead of the red squares
};

class Board final : public frame::Control {
  public:
    using Control::Control;
    frame::TextSize DesignSize() const override { return {1500, 1500}; }
    const frame::ClassTable& Table() const override {
        static constexpr frame::ClassTable table{.name = "Board", .members = {}};
        return table;
    }

    child::PictureBox TempPic{*this, "TempPic"};
};

class FileIconTest : public testing::Test {
  protected:
    FileIconTest() {
        box.SetBorderStyle(0);
        box.SetBackColor(white);
        for (const char* file : {"a.txt", "b.txt", "a.exe", "b.EXE", "none"}) disk().SetFile(At(file), {}).Check();
    }

    static std::string At(const std::string& name) { return "C:\\x\\" + name; }
    headless::MemoryDisk& disk() { return headless.files; }
    frame::Services Services() {
        frame::Services services = headless.LentServices();
        services.pictures = &pictures;
        return services;
    }
    bool Get(const std::string& path, IconSize size = IconSize::Small, IconForm form = IconForm::Closed) {
        return icons.GetFileIcon(path, size, box, key, form);
    }
    /// The colour of a pixel after the colour has been set there and the box washed out, with white as the mask.
    int Washed(OLE_COLOR color) {
        box.SetScaleMode(ScaleModeConstants::Pixels);
        box.PSet(1, 1, color);
        icons.WashOutPicture(box, white);
        return box.Point(1, 1);
    }

    headless::HeadlessHost headless;
    RedIcons pictures;
    frame::Host host{Services()};
    test::WatchedSite site{host, "Board1"};
    child::PictureBox& box = site.Make<Board>().TempPic;
    FileIcon& icons = host.Module<FileIcon>();
    std::string key = "before";
};

TEST_F(FileIconTest, APathThatDoesNotExistGivesFalseAndAnEmptyKey) {
    box.SetWidth(100);
    EXPECT_FALSE(Get(At("missing.txt")));
    EXPECT_EQ(key, "");
    EXPECT_FALSE(Get(""));
    EXPECT_TRUE(pictures.asked.empty());
    EXPECT_EQ(box.Width(), 100);
}

TEST_F(FileIconTest, TwoTextFilesHaveOneKey) {
    EXPECT_TRUE(Get(At("a.txt")));
    EXPECT_EQ(key, "txt");
    EXPECT_TRUE(Get(At("b.txt")));
    EXPECT_EQ(key, "txt");
}

TEST_F(FileIconTest, AProgramHasTheKeyOfItsExtensionAndItsOwnIconIsAskedFor) {
    EXPECT_TRUE(Get(At("a.exe")));
    EXPECT_EQ(key, "exe");
    EXPECT_TRUE(Get(At("b.EXE")));
    EXPECT_EQ(key, "EXE");
    EXPECT_EQ(pictures.asked, (std::vector<std::string>{"C:\\x\\a.exe 26117", "C:\\x\\b.EXE 26117"}));
}

TEST_F(FileIconTest, AFileWithoutExtensionHasAnEmptyKeyAndAnIcon) {
    EXPECT_TRUE(Get(At("none")));
    EXPECT_EQ(key, "");
}

TEST_F(FileIconTest, FoldersAndDrivesAreKeyedByTheirTypes) {
    EXPECT_TRUE(Get("C:\\x"));
    EXPECT_EQ(key, "File Folder");
    EXPECT_TRUE(Get("C:\\"));
    EXPECT_EQ(key, "Local Disk");
    disk().SetDrive("N", {.type = frame::driveTypes::network, .share = "\\\\server\\name", .ready = false}).Check();
    EXPECT_TRUE(Get("N:\\"));
    EXPECT_EQ(key, "Drive Unavailable");
}

TEST_F(FileIconTest, EachSizeAndFormHasItsFlags) {
    for (const IconForm form : {IconForm::Closed, IconForm::Open})
        for (const IconSize size : {IconSize::Small, IconSize::Large}) Get("C:\\x", size, form);
    EXPECT_EQ(pictures.asked, (std::vector<std::string>{"C:\\x 26117", "C:\\x 26116", "C:\\x 26119", "C:\\x 26118"}));
}

TEST_F(FileIconTest, TheIconStaysOnTheBoxWhichTakesItsSize) {
    EXPECT_TRUE(Get(At("a.txt"), IconSize::Large));
    EXPECT_EQ(box.Width(), 480);
    EXPECT_EQ(box.Height(), 480);
    EXPECT_TRUE(Get(At("a.txt")));
    EXPECT_EQ(box.Width(), 240);
    EXPECT_EQ(box.Height(), 240);
    ASSERT_TRUE(box.Picture());
    const frame::PictureRef image = box.Image();
    const frame::PixelPlane* plane = image->Plane(1);
    ASSERT_TRUE(plane);
    EXPECT_EQ(plane->width, 16);
    EXPECT_EQ(plane->pixels[0], 0xFFFFFFFFu);
    EXPECT_EQ(plane->pixels[1], 0xFF0000FFu);
    EXPECT_EQ(plane->pixels.back(), 0xFF0000FFu);
    box.SetPicture(box.Picture());
    EXPECT_TRUE(box.Image()->EqualsObject(*image));
}

TEST_F(FileIconTest, AnIconKeepsItsScalesAndItsSoftEdges) {
    constexpr std::uint32_t faint = 0x400000FFu;
    pictures.icon =
        std::make_shared<frame::Picture>(std::vector<frame::PixelPlane>{{1, 16, 16, std::vector<std::uint32_t>(256, faint)},
                                                                        {2, 32, 32, std::vector<std::uint32_t>(1024, faint)}},
                                         "");
    EXPECT_TRUE(Get(At("a.txt")));
    ASSERT_TRUE(box.Picture());
    EXPECT_EQ(box.Picture()->Plane(1)->pixels[0], faint);
    EXPECT_EQ(box.Picture()->Plane(2)->width, 32);
    EXPECT_EQ(box.Point(0, 0), static_cast<int>(white.value)) << "less than half opaque";
}

TEST_F(FileIconTest, AnIconOfAnotherSizeStandsInTheCorner) {
    pictures.icon = std::make_shared<frame::Picture>(
        std::vector<frame::PixelPlane>{{1, 8, 8, std::vector<std::uint32_t>(64, 0xFF0000FFu)}}, "");
    EXPECT_TRUE(Get(At("a.txt")));
    EXPECT_EQ(box.Picture()->Plane(1)->width, 16);
    EXPECT_EQ(box.Point(7 * 15, 7 * 15), 0x0000FF);
    EXPECT_EQ(box.Point(8 * 15, 8 * 15), static_cast<int>(white.value));
}

TEST_F(FileIconTest, WashingOutAPicturePalesAllItsScales) {
    const auto picture =
        std::make_shared<frame::Picture>(std::vector<frame::PixelPlane>{{1, 2, 1, {0xFF000000u, 0xFF404040u}},
                                                                        {2, 2, 2, {0x80000000u, 0, 0xFF0300FFu, 0xFFC0C0C0u}}},
                                         "");
    const frame::PictureRef pale = FileIcon::WashedOut(picture, 0xC0C0C0);
    EXPECT_EQ(pale->Plane(1)->pixels, (std::vector<std::uint32_t>{0xFF808080u, 0xFFA0A0A0u}));
    EXPECT_EQ(pale->Plane(2)->pixels, (std::vector<std::uint32_t>{0x80808080u, 0x00808080u, 0xFF8180FFu, 0xFFC0C0C0u}));
}

TEST_F(FileIconTest, NothingOfTheIconBeforeShinesThrough) {
    EXPECT_TRUE(Get(At("a.txt")));
    box.PSet(0, 0, 0);
    EXPECT_TRUE(Get(At("b.txt")));
    EXPECT_EQ(box.Point(0, 0), static_cast<int>(white.value));
}

TEST_F(FileIconTest, TheIconStandsInTheCornerWhateverTheScale) {
    box.Move(0, 0, 240, 240);
    box.SetScaleLeft(100);
    box.SetScaleTop(-50);
    EXPECT_TRUE(Get(At("a.txt")));
    EXPECT_EQ(box.Image()->Plane(1)->pixels[1], 0xFF0000FFu);
    EXPECT_EQ(box.Image()->Plane(1)->pixels.back(), 0xFF0000FFu);
}

TEST_F(FileIconTest, WhereTheSystemHasNoIconTheBoxKeepsItsPicture) {
    EXPECT_TRUE(Get(At("a.txt")));
    const frame::PictureRef before = box.Picture();
    pictures.hasIcons = false;
    EXPECT_FALSE(Get(At("b.txt")));
    EXPECT_EQ(key, "txt");
    EXPECT_EQ(box.Picture(), before);
}

TEST_F(FileIconTest, AThrowAwayFileGivesTheIconOfItsTypeAndLeavesNothing) {
    const FileSystemObject files(host);
    const std::string path = files.BuildPath(files.GetSpecialFolder(2)->FullPath(), files.GetTempName() + ".abc");
    files.CreateTextFile(path, true, false)->Close();
    EXPECT_TRUE(Get(path));
    EXPECT_EQ(key, "abc");
    files.DeleteFile(path, true);
    EXPECT_EQ(files.GetFolder("C:\\Temp")->Files()->Count(), 0);
}

TEST_F(FileIconTest, IsCalledByNameWithItsArgumentsByReference) {
    Variant arguments[] = {At("a.txt"), true, frame::ObjectRef(box), "", false};
    EXPECT_EQ(icons.Call("GetFileIcon", arguments), Variant(true));
    EXPECT_EQ(arguments[3], Variant("txt"));
    EXPECT_EQ(box.Width(), 480);
    Variant noBox[] = {At("a.txt"), true, frame::ObjectRef(icons), "", false};
    EXPECT_EQ(ErrorOf([&] { icons.Call("GetFileIcon", noBox); }), frame::errors::typeMismatch);
    Variant nothing[] = {At("a.txt"), true, frame::ObjectRef(), "", false};
    EXPECT_EQ(ErrorOf([&] { icons.Call("GetFileIcon", nothing); }), frame::errors::objectGone);
}

TEST_F(FileIconTest, WashingOutHalvesTheDistanceToWhite) {
    box.Move(0, 0, 150, 150);
    EXPECT_EQ(Washed(0), 0x808080);
    EXPECT_EQ(frame::Red(static_cast<std::uint32_t>(Washed(0x0000FF))), 255);
    // The red 2 and 4 are ties: 128.5 and 129.5 go to the even number.
    EXPECT_EQ(Washed(0x000001), 0x808080);
    EXPECT_EQ(Washed(0x000002), 0x808080);
    EXPECT_EQ(Washed(0x000003), 0x808081);
    EXPECT_EQ(Washed(0x000004), 0x808082);
}

TEST_F(FileIconTest, WashingOutRoundsTheQuotientsThatGreenAndBlueComeFrom) {
    box.Move(0, 0, 150, 150);
    EXPECT_EQ(Washed(0x0000FF), 0x8080FF);  // its green is 1
    EXPECT_EQ(Washed(0x0300FF), 0x8180FF);  // its green is 1, its blue 3
    EXPECT_EQ(Washed(0x03FFFF), 0x8280FF);  // its green is 0, its blue 4
    EXPECT_EQ(Washed(0x000280), 0x8080C0);  // a tie goes to the even 2
    EXPECT_EQ(Washed(0x000380), 0x8082C0);  // and to 4 from 3.5
}

TEST_F(FileIconTest, WashingOutLeavesTheMaskColourAndTheScaleMode) {
    box.Move(0, 0, 30, 30);
    box.PSet(0, 0, red);
    icons.WashOutPicture(box, white);
    EXPECT_EQ(box.ScaleMode(), ScaleModeConstants::Twips);
    EXPECT_EQ(box.Point(0, 0), 0x8080FF);
    for (const auto& [x, y] : {std::pair{15.0f, 0.0f}, {0.0f, 15.0f}, {15.0f, 15.0f}})
        EXPECT_EQ(box.Point(x, y), static_cast<int>(white.value));
}

TEST_F(FileIconTest, WashingOutTouchesEveryPixel) {
    box.Move(0, 0, 150, 75);
    box.SetBackColor(0);
    Variant arguments[] = {frame::ObjectRef(box), white};
    icons.Call("WashOutPicture", arguments);
    const frame::PictureRef image = box.Image();
    for (const std::uint32_t pixel : image->Plane(1)->pixels) EXPECT_EQ(pixel, 0xFF808080u);
    Variant noSurface[] = {frame::ObjectRef(icons), white};
    EXPECT_EQ(ErrorOf([&] { icons.Call("WashOutPicture", noSurface); }), frame::errors::typeMismatch);
}

TEST_F(FileIconTest, WashingOutASurfaceOfNoSizeOrAnyDoesNothingForEver) {
    box.Move(0, 0, 0, 0);
    icons.WashOutPicture(box, white);
    box.Move(0, 0, 1e30f, 15);
    icons.WashOutPicture(box, white);
    EXPECT_EQ(box.ScaleMode(), ScaleModeConstants::Twips);
}

}  // namespace
}  // namespace tessel::fileservices
