#include "controls/splitter/BarDrawing.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <map>
#include <string>
#include <vector>

#include "frame/Text.h"
#include "frame/Variant.h"

namespace tessel::controls::splitter {
namespace {

using frame::OLE_COLOR;
using frame::draw::Box;
using frame::draw::Line;

constexpr OLE_COLOR fill = 0x112233, border = 0x445566;

/// "S 0,7-0,0" is a line in the shadow's colour, "HB" a box and "FBF" a filled one.
std::string Text(const Line& line) {
    static const std::map<std::uint32_t, std::string> names = {{0x80000010u, "S"}, {0x80000014u, "H"}, {0x80000015u, "D"},
                                                               {0x80000016u, "L"}, {fill.value, "F"},  {border.value, "O"}};
    static constexpr const char* flags[] = {"", "B", "BF"};
    const auto number = [](float value) { return frame::Variant(value).ToText(); };
    return names.at(line.color.value) + flags[static_cast<int>(line.box)] + " " + number(line.x1) + "," + number(line.y1) + "-" +
           number(line.x2) + "," + number(line.y2);
}

std::vector<std::string> Drawn(tsAppearance appearance, tsOrientation orientation, float width, float height) {
    std::vector<std::string> texts;
    for (const Line& line : BarDrawing({orientation, appearance, width, height, fill, border})) texts.push_back(Text(line));
    return texts;
}

using testing::ElementsAre;
using enum tsAppearance;
using enum tsOrientation;

TEST(BarDrawing, WithoutABorderThereIsTheFillAlone) {
    EXPECT_THAT(Drawn(tsNone, tsHorizontal, 40, 8), ElementsAre("FBF 0,0-39,7"));
}

TEST(BarDrawing, AFlatBarHasABoxInItsForeColor) {
    EXPECT_THAT(Drawn(tsFlat, tsVertical, 8, 40), ElementsAre("FBF 0,0-7,39", "OB 0,0-7,39"));
}

TEST(BarDrawing, ASunkenBarIsDarkAtItsTopAndLeft) {
    EXPECT_THAT(Drawn(tsSunken, tsHorizontal, 40, 8),
                ElementsAre("FBF 0,0-39,7", "HB 0,0-39,7", "LB 1,1-38,6", "S 0,7-0,0", "S 0,0-39,0", "D 1,6-1,1", "D 1,1-38,1"));
}

TEST(BarDrawing, ARaisedBarIsDarkAtItsBottomAndRight) {
    EXPECT_THAT(Drawn(tsRaised, tsHorizontal, 40, 8), ElementsAre("FBF 0,0-39,7", "HB 0,0-39,7", "LB 1,1-38,6", "D 0,7-39,7",
                                                                  "D 39,7-39,0", "S 1,6-38,6", "S 38,6-38,1"));
}

TEST(BarDrawing, AGroovedBarHasAGrooveAlongItsMiddleOnARaisedOne) {
    auto lines = Drawn(tsGrooved, tsHorizontal, 40, 9);
    ASSERT_EQ(lines.size(), 9u);
    EXPECT_EQ(lines[3], "D 0,8-39,8");
    EXPECT_EQ(lines[7], "S 5,3-35,3");
    EXPECT_EQ(lines[8], "H 5,4-35,4");
    lines = Drawn(tsGrooved, tsVertical, 9, 40);
    EXPECT_EQ(lines[7], "S 3,5-3,35");
    EXPECT_EQ(lines[8], "H 4,5-4,35");
}

TEST(BarDrawing, ASerratedBarHasShortDoubleLinesEachFourPixels) {
    auto lines = Drawn(tsSerrated, tsHorizontal, 15, 8);
    ASSERT_EQ(lines.size(), 7u + 4u);
    EXPECT_EQ(lines[7], "H 5,3-5,5");
    EXPECT_EQ(lines[8], "S 6,3-6,5");
    EXPECT_EQ(lines[9], "H 9,3-9,5");
    EXPECT_EQ(Drawn(tsSerrated, tsHorizontal, 14, 8).size(), 7u + 2u);
    lines = Drawn(tsSerrated, tsVertical, 8, 15);
    EXPECT_EQ(lines[7], "H 3,5-5,5");
    EXPECT_EQ(lines[8], "S 3,6-5,6");
}

TEST(BarDrawing, ABarWithoutASizeAndAnUnknownLookAreDrawnWithoutHarm) {
    EXPECT_EQ(Drawn(tsSerrated, tsHorizontal, 0, 0).size(), 7u);
    EXPECT_EQ(Drawn(tsGrooved, static_cast<tsOrientation>(7), 40, 8).size(), 7u);
    EXPECT_THAT(Drawn(static_cast<tsAppearance>(9), tsVertical, 8, 40), ElementsAre("FBF 0,0-7,39"));
    EXPECT_GT(Drawn(tsSerrated, tsHorizontal, 1e30f, 8).size(), 7u);
}

}  // namespace
}  // namespace tessel::controls::splitter
