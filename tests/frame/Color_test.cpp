#include "frame/Color.h"

#include <gtest/gtest.h>

namespace tessel::frame {
namespace {

TEST(Color, HasRedInTheLowByte) {
    constexpr OLE_COLOR color = Rgb(0x12, 0x34, 0x56);
    EXPECT_EQ(color.value, 0x563412u);
    EXPECT_EQ(Red(color), 0x12);
    EXPECT_EQ(Green(color), 0x34);
    EXPECT_EQ(Blue(color), 0x56);
}

TEST(Color, TakesTheLowByteOfEachPart) { EXPECT_EQ(Rgb(0x112, -1, 256), Rgb(0x12, 0xFF, 0)); }

TEST(Color, IsASystemColorByItsHighestBit) {
    EXPECT_TRUE(colors::buttonFace.IsSystem());
    EXPECT_TRUE(OLE_COLOR(0x80000000u).IsSystem());
    EXPECT_FALSE(OLE_COLOR(0x7FFFFFFFu).IsSystem());
}

class Numbered final : public SystemColors {
  public:
    OLE_COLOR Color(int index) const override { return static_cast<std::uint32_t>(index); }
};

TEST(OleTranslateColor, LooksASystemColorUpByItsLowByte) {
    EXPECT_EQ(OleTranslateColor(0x80000012u, Numbered()).value, 0x12u);
    EXPECT_EQ(OleTranslateColor(0x80FFFF12u, Numbered()).value, 0x12u);
    EXPECT_EQ(OleTranslateColor(0xFFFFFFFFu, Numbered()).value, 0xFFu);
}

TEST(OleTranslateColor, LeavesAnyOtherColorWithoutItsHighByte) {
    EXPECT_EQ(OleTranslateColor(0x00563412u, Numbered()).value, 0x563412u);
    EXPECT_EQ(OleTranslateColor(0x7F563412u, Numbered()).value, 0x563412u);
    EXPECT_EQ(OleTranslateColor(0, Numbered()).value, 0u);
}

TEST(ClassicColors, AreGreyFacesWhiteWindowsAndBlackText) {
    const auto rgb = [](OLE_COLOR color) { return OleTranslateColor(color, ClassicColors()).value; };
    EXPECT_EQ(rgb(colors::buttonFace), 0xC0C0C0u);
    EXPECT_EQ(rgb(colors::windowBackground), 0xFFFFFFu);
    EXPECT_EQ(rgb(colors::windowText), 0u);
    EXPECT_EQ(rgb(colors::buttonText), 0u);
    EXPECT_EQ(rgb(colors::buttonHighlight), 0xFFFFFFu);
    EXPECT_EQ(rgb(colors::buttonShadow), 0x808080u);
    EXPECT_EQ(rgb(colors::darkShadow), 0u);
}

TEST(ClassicColors, AreBlackForAnIndexThatHasNone) {
    EXPECT_EQ(ClassicColors().Color(0x18).value, 0xE1FFFFu);
    EXPECT_EQ(ClassicColors().Color(0x19).value, 0u);
    EXPECT_EQ(ClassicColors().Color(255).value, 0u);
    EXPECT_EQ(ClassicColors().Color(-1).value, 0u);
}

}  // namespace
}  // namespace tessel::frame
