#include "frame/child/PictureBox.h"

#include <gtest/gtest.h>

#include "frame/ClassTable.h"
#include "hosts/headless/HeadlessHost.h"

namespace tessel::child {
namespace {

using frame::DrawOp;
using frame::OLE_COLOR;
namespace draw = frame::draw;

constexpr OLE_COLOR red = 0x0000FF, blue = 0xFF0000, white = 0xFFFFFF;

class Board final : public frame::Control {
  public:
    using Control::Control;
    frame::TextSize DesignSize() const override { return {1500, 1500}; }
    const frame::ClassTable& Table() const override {
        static constexpr frame::ClassTable table{.name = "Board", .members = {}};
        return table;
    }

    PictureBox Picture1{*this, "Picture1"};
};

/// A box of 10 by 6 pixels without a border, in pixels, white.
class PictureBoxTest : public ::testing::Test {
  protected:
    PictureBoxTest() {
        box.SetBorderStyle(0);
        box.Move(0, 0, 150, 90);
        box.SetScaleMode(frame::ScaleModeConstants::Pixels);
        box.SetBackColor(white);
        box.AddCanvas(recorded);
    }
    ~PictureBoxTest() override { box.RemoveCanvas(recorded); }

    /// The pixels as rows of text: '.' white, '#' any other.
    std::string Pixels() const {
        std::string text;
        for (float y = 0; y < box.ScaleHeight(); ++y) {
            for (float x = 0; x < box.ScaleWidth(); ++x) text += box.Point(x, y) == static_cast<int>(white.value) ? '.' : '#';
            text += '\n';
        }
        return text;
    }

    headless::HeadlessHost host;
    PictureBox& box = host.Create<Board>("Board1").Picture1;
    frame::RecordingCanvas recorded;
};

TEST_F(PictureBoxTest, ALineOfWidthOneTouchesItsPixelsButNotItsEnd) {
    box.Line(0, 0, 5, 0, red);
    EXPECT_EQ(Pixels(), "#####.....\n..........\n..........\n..........\n..........\n..........\n");
    EXPECT_EQ(recorded.operations, (std::vector<DrawOp>{draw::Line{0, 0, 5, 0, red, draw::Box::None}}));
}

TEST_F(PictureBoxTest, ABoxIncludesBothCorners) {
    box.Line(1, 1, 4, 3, red, draw::Box::Outline);
    box.Line(6, 1, 8, 4, blue, draw::Box::Filled);
    EXPECT_EQ(Pixels(), "..........\n.####.###.\n.#..#.###.\n.####.###.\n......###.\n..........\n");
    EXPECT_EQ(box.Point(1, 1), static_cast<int>(red.value));
    EXPECT_EQ(box.Point(7, 2), static_cast<int>(blue.value));
}

TEST_F(PictureBoxTest, XorTwiceLeavesEveryPixelAndTheRecordTellsBothPasses) {
    box.Line(0, 0, 9, 5, red, draw::Box::Filled);
    box.Circle(5, 3, 2, blue);
    const auto pixelsBefore = box.Image();
    recorded.operations.clear();

    box.SetDrawMode(draw::xorPen);
    const auto drawAll = [&] {
        box.Line(0, 5, 9, 0, 0xC0C0C0);
        box.Line(2, 1, 7, 4, 0x808080, draw::Box::Outline);
        box.Circle(4, 3, 3, 0x00FF00);
        box.PSet(9, 5, white);
    };
    drawAll();
    EXPECT_FALSE(box.Image()->EqualsObject(*pixelsBefore));
    drawAll();
    EXPECT_TRUE(box.Image()->EqualsObject(*pixelsBefore));

    ASSERT_EQ(recorded.operations.size(), 9u);
    EXPECT_EQ(recorded.operations[0], DrawOp(draw::DrawMode{draw::xorPen}));
    EXPECT_EQ(recorded.operations[1], recorded.operations[5]);
    EXPECT_EQ(recorded.operations[4], recorded.operations[8]);
}

TEST_F(PictureBoxTest, PointReadsBackWhatPSetWroteAndMinusOneOutside) {
    box.PSet(3, 2, 0x123456);
    EXPECT_EQ(box.Point(3, 2), 0x123456);
    EXPECT_EQ(box.Point(2, 3), static_cast<int>(white.value));
    EXPECT_EQ(box.Point(10, 0), -1);
    EXPECT_EQ(box.Point(0, -1), -1);
}

TEST_F(PictureBoxTest, CoordinatesAreInTheScaleOfTheBox) {
    box.SetScaleMode(frame::ScaleModeConstants::Twips);
    box.PSet(45, 30, red);
    EXPECT_EQ(box.Point(59, 44), static_cast<int>(red.value)) << "the same pixel";
    EXPECT_EQ(box.Point(60, 30), static_cast<int>(white.value));
    EXPECT_EQ(box.ScaleWidth(), 150);
}

TEST_F(PictureBoxTest, ABorderTakesTwoPixelsOnEachSide) {
    box.SetBorderStyle(1);
    EXPECT_EQ(box.ScaleWidth(), 6);
    EXPECT_EQ(box.ScaleHeight(), 2);
    EXPECT_EQ(box.Point(6, 0), -1);
}

TEST_F(PictureBoxTest, ClsAndANewBackgroundWipeTheDrawing) {
    box.Line(0, 0, 9, 5, red, draw::Box::Filled);
    box.Cls();
    EXPECT_EQ(box.Point(4, 4), static_cast<int>(white.value));
    box.PSet(4, 4, red);
    box.SetBackColor(blue);
    EXPECT_EQ(box.Point(4, 4), static_cast<int>(blue.value));
}

TEST_F(PictureBoxTest, APictureStandsBehindTheDrawingAndItsImageIsASnapshot) {
    box.PSet(0, 0, red);
    const auto image = box.Image();
    EXPECT_EQ(image->Width(), 150);
    EXPECT_EQ(image->Height(), 90);
    box.SetPicture(image);
    box.PSet(1, 0, blue);
    EXPECT_EQ(box.Point(0, 0), static_cast<int>(red.value));
    EXPECT_EQ(box.Point(1, 0), static_cast<int>(blue.value));
    box.SetPicture(nullptr);
    EXPECT_EQ(box.Point(0, 0), static_cast<int>(white.value));
    EXPECT_EQ(image->Plane(1)->pixels[0], 0xFF0000FFu);
}

TEST_F(PictureBoxTest, AutoSizeTakesTheSizeOfThePictureAndItsBorder) {
    box.SetBorderStyle(1);
    box.SetAutoSize(true);
    box.SetPicture(std::make_shared<frame::Picture>(300.0f, 600.0f, "p.bmp"));
    EXPECT_EQ(box.Width(), 360);
    EXPECT_EQ(box.Height(), 660);
}

TEST_F(PictureBoxTest, DrawsByNameAsOnASurfaceOfUnknownClass) {
    frame::Object& object = box;
    frame::Variant line[] = {0, 0, 3, 2, OLE_COLOR(red), "bf"};
    object.Call("LINE", line);
    EXPECT_EQ(Pixels(), "####......\n####......\n####......\n..........\n..........\n..........\n");
    frame::Variant point[] = {1, 1};
    EXPECT_EQ(object.Call("Point", point), frame::Variant(static_cast<int>(red.value)));
}

TEST_F(PictureBoxTest, TheLogHasEachOperationInTheUnitsOfTheSurface) {
    host.log.Clear();
    box.SetDrawWidth(3);
    box.SetDrawWidth(3);
    box.Line(1, 2, 3.5f, 4, red, draw::Box::Outline);
    const auto drawn = host.log.Of("draw");
    ASSERT_EQ(drawn.size(), 2u) << "a pen that stays the same is not told again";
    EXPECT_EQ(drawn[0], (headless::Log::Entry{"draw", "Board1.Picture1", "DrawWidth", 3}));
    EXPECT_EQ(drawn[1], (headless::Log::Entry{"draw", "Board1.Picture1", "Line", 1, 2, 3.5f, 4, red, "B"}));
}

}  // namespace
}  // namespace tessel::child
