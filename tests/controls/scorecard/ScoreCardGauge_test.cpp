#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstdint>
#include <set>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

#include "tests/controls/scorecard/ScoreCardTestHelp.h"

/// What a gauge draws, by its operations in their order. The gauges go from 0 to 100 on 100 pixels unless a test says otherwise.
namespace tessel::controls {
namespace {

using testing::ElementsAre;
using testing::ElementsAreArray;
using testing::IsEmpty;
using namespace scoretest;

constexpr std::uint32_t silver = 0xC0C0C0, gray = 0x808080;

/// The distance of a value from the start, in pixels.
float Place(float value, double least, double most) {
    const auto ratio = static_cast<float>((double{value} - least) / (most - least));
    return longSide * ratio;
}
/// The same on a gauge from 0 to 100: not every value is exactly its own distance in these floats.
float At(float value) { return Place(value, 0, 100); }

std::string FillTo(float pixel, std::uint32_t color = buttonText, int width = 1) {
    return BoxText(0, 0, pixel, shortSide, color, width);
}
std::string FillUpTo(float pixel, std::uint32_t color = buttonText, int width = 1) {
    return BoxText(0, longSide, shortSide, longSide - pixel, color, width);
}
/// A line across the whole bar at a distance from the start.
std::string AcrossAt(float pixel, std::uint32_t color, int width = 1) { return LineText(pixel, 0, pixel, shortSide, color, width); }
std::string AcrossUpAt(float pixel, std::uint32_t color, int width = 1) {
    return LineText(0, longSide - pixel, shortSide, longSide - pixel, color, width);
}
/// A line centred on the axis, as long as the fraction of the breadth.
std::string TickAt(float pixel, float fraction, std::uint32_t color = black) {
    const float margin = (1 - fraction) / 2;
    return LineText(pixel, margin * shortSide, pixel, (1 - margin) * shortSide, color);
}
std::string TickUpAt(float pixel, float fraction) {
    const float margin = (1 - fraction) / 2;
    return LineText(margin * shortSide, longSide - pixel, (1 - margin) * shortSide, longSide - pixel, black);
}
const std::string axis = LineText(0, shortSide / 2, longSide, shortSide / 2, black);
const std::string axisUp = LineText(shortSide / 2, longSide, shortSide / 2, 0, black);

// The same by value on a gauge from 0 to 100.
std::string Fill(float to, std::uint32_t color = buttonText, int width = 1) { return FillTo(At(to), color, width); }
std::string FillUp(float to, std::uint32_t color = buttonText, int width = 1) { return FillUpTo(At(to), color, width); }
std::string Across(float value, std::uint32_t color, int width = 1) { return AcrossAt(At(value), color, width); }
std::string AcrossUp(float value, std::uint32_t color, int width = 1) { return AcrossUpAt(At(value), color, width); }
std::string Tick(float value, float fraction, std::uint32_t color = black) { return TickAt(At(value), fraction, color); }
std::string TickUp(float value, float fraction) { return TickUpAt(At(value), fraction); }
std::string Overrun(float from, float to, int width = 1) { return BoxText(At(from), 0, At(to), shortSide, red, width); }

Lines RedrawnGauge(const MemoryBag::Contents& other = {}) { return Card(GaugeBag(other)).Redrawn(); }
Lines RedrawnUpright(const MemoryBag::Contents& other = {}) { return Card(Upright(other)).Redrawn(); }

// Frame and band.

TEST(ScoreCardGauge, FillsFromTheLeftToTheValue) { EXPECT_THAT(RedrawnGauge(), ElementsAre("Cls", Fill(50))); }

TEST(ScoreCardGauge, UprightFillsFromTheBottomUpToTheValue) {
    EXPECT_THAT(RedrawnUpright({{"Value", 30}}), ElementsAre("Cls", FillUp(30)));
}

TEST(ScoreCardGauge, IsDrawnAfterALoad) {
    Card card(GaugeBag());
    EXPECT_EQ(card.picture.Point(25, 10), card.picture.Point(49, 10));
    EXPECT_NE(card.picture.Point(25, 10), card.picture.Point(75, 10));
}

TEST(ScoreCardGauge, FillIsInTheForeColorAsItWasSet) {
    EXPECT_THAT(RedrawnGauge({{"ForeColor", OLE_COLOR(0x123456)}}), ElementsAre("Cls", Fill(50, 0x123456)));
    EXPECT_THAT(RedrawnGauge({{"Style", style::gaugeOverrun}, {"ForeColor", OLE_COLOR(0x80000008)}}),
                ElementsAre("Cls", Fill(50, 0x80000008)));
}

TEST(ScoreCardGauge, ARainbowIsInTheColorOfTheValue) {
    const std::pair<int, std::uint32_t> colors[] = {{10, black}, {20, red},  {39, red},  {40, yellow},
                                                    {60, green}, {80, cyan}, {100, cyan}};
    for (const auto& [value, color] : colors)
        EXPECT_THAT(RedrawnGauge({{"Style", style::gaugeRainbow}, {"Value", value}}),
                    ElementsAre("Cls", Fill(static_cast<float>(value), color)))
            << value;
}

TEST(ScoreCardGauge, APositionIsTheShareOfTheRange) {
    for (const float value : {0.0f, 1.0f, 33.0f, 66.5f, 100.0f}) {
        Card card({{"Style", style::gauge}, {"ScoreMin", -50}, {"ScoreMax", 250}, {"Value", value}});
        const float start = Place(-50, -50, 250);
        EXPECT_EQ(start, 0);
        EXPECT_THAT(card.Redrawn(), ElementsAre("Cls", FillTo(Place(value, -50, 250)))) << value;
    }
}

TEST(ScoreCardGauge, APositionCountsFromTheBottomOfAnUprightGauge) {
    for (const float value : {-50.0f, 33.0f, 66.5f}) {
        Card card(Upright({{"ScoreMin", -50}, {"ScoreMax", 250}, {"Value", value}}));
        EXPECT_THAT(card.Redrawn(), ElementsAre("Cls", FillUpTo(Place(value, -50, 250)))) << value;
    }
}

TEST(ScoreCardGauge, TheFrameFollowsSizeBorderAndOrientation) {
    Card card(GaugeBag());
    card.host.SiteOf(card.control)->SetSize(Outer(200), Outer(40));
    EXPECT_THAT(card.Drawn(), ElementsAre("Cls", BoxText(0, 0, 100, 40, buttonText)));
    card.Put("BorderStyle", 0);
    EXPECT_THAT(card.Drawn(), ElementsAre("Cls", BoxText(0, 0, 102, 44, buttonText)));
    card.Put("GaugeOrientation", 1);
    EXPECT_THAT(card.Drawn(), ElementsAre("Cls", BoxText(0, 44, 204, 22, buttonText)));
}

TEST(ScoreCardGauge, AValueAboveTheMaximumFillsBeyondTheEnd) {
    EXPECT_THAT(RedrawnGauge({{"Value", 150}}), ElementsAre("Cls", Fill(150)));
    EXPECT_THAT(RedrawnUpright({{"Value", 150}}), ElementsAre("Cls", FillUp(150)));
}

TEST(ScoreCardGauge, AValueBelowTheMinimumFillsBackwardsFromTheStart) {
    EXPECT_THAT(RedrawnGauge({{"Value", -30}}), ElementsAre("Cls", Fill(-30)));
    EXPECT_THAT(RedrawnUpright({{"Value", -30}}), ElementsAre("Cls", FillUp(-30)));
}

TEST(ScoreCardGauge, AnEmptyBandIsDrawnToo) { EXPECT_THAT(RedrawnGauge({{"Value", 0}}), ElementsAre("Cls", Fill(0))); }

TEST(ScoreCardGauge, NothingIsLeftOfAnEarlierDrawing) {
    Card card(GaugeBag({{"Value", 90}}));
    card.Put("Value", 10);
    EXPECT_NE(card.picture.Point(5, 10), card.picture.Point(50, 10));
}

// Overrun.

TEST(ScoreCardOverrun, ABandFromTheValueBackToTheStarIsRed) {
    EXPECT_THAT(RedrawnGauge({{"Style", style::gaugeOverrun}, {"Value", 95}}), ElementsAre("Cls", Fill(95), Overrun(95, 80)));
    EXPECT_THAT(RedrawnUpright({{"Style", style::gaugeOverrun}, {"Value", 95}}),
                ElementsAre("Cls", FillUp(95), BoxText(0, longSide - At(95), shortSide, longSide - At(80), red)));
}

TEST(ScoreCardOverrun, AtOrBelowTheStarLooksLikeAGauge) {
    for (const int value : {80, 50, -10})
        EXPECT_EQ(RedrawnGauge({{"Style", style::gaugeOverrun}, {"Value", value}}), RedrawnGauge({{"Value", value}})) << value;
}

TEST(ScoreCardOverrun, IsOfNoOtherGauge) {
    EXPECT_THAT(RedrawnGauge({{"Value", 95}}), ElementsAre("Cls", Fill(95)));
    EXPECT_THAT(RedrawnGauge({{"Style", style::gaugeRainbow}, {"Value", 95}}), ElementsAre("Cls", Fill(95, cyan)));
}

// Blocks.

Lines BlockLines(int count, double least, double most, int width) {
    Lines lines;
    const auto step = static_cast<float>((most - least) / count);
    for (auto value = static_cast<float>(least + double{step}); double{value} <= most; value += step)
        lines.push_back(AcrossAt(Place(value, least, most), buttonFace, width));
    return lines;
}
/// The lines of a drawing behind its clearing and its band.
Lines Marks(Lines drawn) {
    if (drawn.size() < 2) return {"no band"};
    drawn.erase(drawn.begin(), drawn.begin() + 2);
    return drawn;
}

TEST(ScoreCardBlocks, AreCutInTheBackColorOverTheWholeBreadth) {
    EXPECT_THAT(Marks(RedrawnGauge({{"ShowBlocks", 4}, {"BackColor", OLE_COLOR(0x112233)}})),
                ElementsAre(Across(25, 0x112233, 3), Across(50, 0x112233, 3), Across(75, 0x112233, 3), Across(100, 0x112233, 3)));
}

TEST(ScoreCardBlocks, AreCutUprightFromTheBottom) {
    EXPECT_THAT(Marks(RedrawnUpright({{"ShowBlocks", 4}})), ElementsAre(AcrossUp(25, buttonFace, 3), AcrossUp(50, buttonFace, 3),
                                                                        AcrossUp(75, buttonFace, 3), AcrossUp(100, buttonFace, 3)));
}

TEST(ScoreCardBlocks, OneBlockHasOneGapAtTheEnd) {
    EXPECT_THAT(Marks(RedrawnGauge({{"ShowBlocks", 1}})), ElementsAre(Across(100, buttonFace, 3)));
}

TEST(ScoreCardBlocks, NoneHasNoGap) { EXPECT_THAT(Marks(RedrawnGauge({{"ShowBlocks", 0}})), IsEmpty()); }

TEST(ScoreCardBlocks, ANumberBelowZeroFromASavedStateHasNoGap) {
    EXPECT_THAT(Marks(RedrawnGauge({{"ShowBlocks", -5}})), IsEmpty());
}

TEST(ScoreCardBlocks, MoreBlocksHaveNarrowerGaps) {
    const std::pair<int, int> widths[] = {{1, 3}, {10, 3}, {11, 2}, {20, 2}, {21, 1}, {100, 1}};
    for (const auto& [count, width] : widths)
        EXPECT_EQ(Marks(RedrawnGauge({{"ShowBlocks", count}})), BlockLines(count, 0, 100, width)) << count;
}

TEST(ScoreCardBlocks, StepInThirtyTwoBitFloats) {
    // Ten steps of a tenth pass one by a little in these floats, so that the last gap is missing.
    Card card({{"Style", style::gauge}, {"ShowBlocks", 10}});
    const Lines marks = Marks(card.Redrawn());
    EXPECT_EQ(marks.size(), 9u);
    EXPECT_EQ(marks, BlockLines(10, 0, 1, 3));
    for (const int count : {3, 5, 6, 7, 30, 70, 100}) {
        Card other({{"Style", style::gauge}, {"ShowBlocks", count}});
        const int width = count > 20 ? 1 : 3;
        EXPECT_EQ(Marks(other.Redrawn()), BlockLines(count, 0, 1, width)) << count;
    }
}

TEST(ScoreCardBlocks, StartAtTheMinimum) {
    Card card({{"Style", style::gauge}, {"ShowBlocks", 4}, {"ScoreMin", -2}, {"ScoreMax", 2}});
    EXPECT_EQ(Marks(card.Redrawn()), BlockLines(4, -2, 2, 3));
}

// Ticks.

TEST(ScoreCardTicks, AreShortLinesOnAnAxisAndEachFifthIsLonger) {
    Lines expected = {axis};
    for (int i = 1; i <= 10; ++i) expected.push_back(Tick(static_cast<float>(i) * 10, i % 5 == 0 ? 0.5f : 0.3f));
    EXPECT_EQ(Marks(RedrawnGauge({{"ShowTickLinesEvery", 10}})), expected);
    EXPECT_EQ(expected[1], LineText(10, 7, 10, 13, black));
    EXPECT_EQ(expected[5], LineText(50, 5, 50, 15, black));
}

TEST(ScoreCardTicks, StandUprightToo) {
    Lines expected = {axisUp};
    for (int i = 1; i <= 10; ++i) expected.push_back(TickUp(static_cast<float>(i) * 10, i % 5 == 0 ? 0.5f : 0.3f));
    EXPECT_EQ(Marks(RedrawnUpright({{"ShowTickLinesEvery", 10}})), expected);
    EXPECT_EQ(expected[1], LineText(7, 90, 13, 90, black));
    EXPECT_EQ(expected[5], LineText(5, 50, 15, 50, black));
}

TEST(ScoreCardTicks, AreInTheirOwnColor) {
    for (const std::string& line : Marks(RedrawnGauge({{"ShowTickLinesEvery", 25}, {"TickLineColor", OLE_COLOR(0x80000010)}})))
        EXPECT_NE(line.find(" #80000010 w1"), std::string::npos) << line;
}

TEST(ScoreCardTicks, NoneHaveNoAxis) {
    for (const Variant& every : {Variant(0), Variant(-1), Variant(0.0)})
        EXPECT_THAT(Marks(RedrawnGauge({{"ShowTickLinesEvery", every}})), IsEmpty());
}

TEST(ScoreCardTicks, AnIntervalBeyondTheRangeLeavesTheAxis) {
    EXPECT_THAT(Marks(RedrawnGauge({{"ShowTickLinesEvery", 101}})), ElementsAre(axis));
}

TEST(ScoreCardTicks, AFractionOfTheRangeIsSteppedInThirtyTwoBitFloats) {
    for (const float every : {0.1f, 0.25f, 0.3f}) {
        Card card({{"Style", style::gauge}, {"ShowTickLinesEvery", double{every}}});
        Lines expected = {axis};
        int count = 1;
        for (float value = every; double{value} <= 1; value += every, ++count)
            expected.push_back(TickAt(Place(value, 0, 1), count % 5 == 0 ? 0.5f : 0.3f));
        EXPECT_EQ(Marks(card.Redrawn()), expected) << every;
    }
}

TEST(ScoreCardTicks, StartAtTheMinimum) {
    EXPECT_THAT(Marks(RedrawnGauge({{"ScoreMin", -100}, {"ShowTickLinesEvery", 60}})),
                ElementsAre(axis, TickAt(Place(-40, -100, 100), 0.3f), TickAt(Place(20, -100, 100), 0.3f),
                            TickAt(Place(80, -100, 100), 0.3f)));
}

TEST(ScoreCardTicks, AxisSpansTheGaugeWhereverItsMinimumIs) {
    Card card(GaugeBag({{"ScoreMin", 50}, {"ShowTickLinesEvery", 200}}));
    EXPECT_THAT(Marks(card.Redrawn()), ElementsAre(axis));
}

// Limit lines.

TEST(ScoreCardLimitLines, StandAtTheThresholdsInTheirColors) {
    EXPECT_THAT(Marks(RedrawnGauge({{"ShowLimitLines", true}})),
                ElementsAre(Across(20, red), Across(40, yellow), Across(60, green), Across(80, cyan)));
    EXPECT_THAT(Marks(RedrawnUpright({{"ShowLimitLines", true}})),
                ElementsAre(AcrossUp(20, red), AcrossUp(40, yellow), AcrossUp(60, green), AcrossUp(80, cyan)));
}

TEST(ScoreCardLimitLines, OutsideTheRangeAreNotDrawn) {
    EXPECT_THAT(Marks(RedrawnGauge({{"ShowLimitLines", true}, {"ScoreBad", -1}, {"ScoreStar", 101}})),
                ElementsAre(Across(40, yellow), Across(60, green)));
}

TEST(ScoreCardLimitLines, AtTheLimitsAreDrawn) {
    EXPECT_THAT(Marks(RedrawnGauge({{"ShowLimitLines", true}, {"ScoreBad", 0}, {"ScoreStar", 100}})),
                ElementsAre(Across(0, red), Across(40, yellow), Across(60, green), Across(100, cyan)));
}

TEST(ScoreCardLimitLines, OfTheDefaultThresholdsStandAtTheirShares) {
    Card card({{"Style", style::gauge}, {"ShowLimitLines", true}});
    EXPECT_THAT(Marks(card.Redrawn()), ElementsAre(AcrossAt(longSide * 0.2f, red), AcrossAt(longSide * 0.4f, yellow),
                                                   AcrossAt(longSide * 0.6f, green), AcrossAt(longSide * 0.8f, cyan)));
}

// Markers.

TEST(ScoreCardMarker, ALineIsBlackAtTheValue) {
    EXPECT_THAT(Marks(RedrawnGauge({{"ShowMarker", 1}})), ElementsAre(Across(50, black)));
    EXPECT_THAT(Marks(RedrawnUpright({{"ShowMarker", 1}, {"Value", 30}})), ElementsAre(AcrossUp(30, black)));
}

TEST(ScoreCardMarker, AFlatBarIsAWideBlackLineAndAWhiteOneOverIt) {
    EXPECT_THAT(Marks(RedrawnGauge({{"ShowMarker", 3}})), ElementsAre(Across(50, black, 5), Across(50, white)));
    EXPECT_THAT(Marks(RedrawnUpright({{"ShowMarker", 3}, {"Value", 30}})),
                ElementsAre(AcrossUp(30, black, 5), AcrossUp(30, white)));
}

TEST(ScoreCardMarker, ABarHasItsLightEdgeAtTheLeft) {
    EXPECT_THAT(
        Marks(RedrawnGauge({{"ShowMarker", 2}})),
        ElementsAre(AcrossAt(48, white), AcrossAt(49, silver), AcrossAt(50, silver), AcrossAt(51, gray), AcrossAt(52, black)));
}

TEST(ScoreCardMarker, ABarOfAnUprightGaugeHasItsLightEdgeAtTheTop) {
    EXPECT_THAT(Marks(RedrawnUpright({{"ShowMarker", 2}, {"Value", 25}})),
                ElementsAre(AcrossUpAt(23, black), AcrossUpAt(24, gray), AcrossUpAt(25, silver), AcrossUpAt(26, silver),
                            AcrossUpAt(27, white)));
}

TEST(ScoreCardMarker, OutsideTheRangeOnlyABarIsDrawn) {
    for (const int value : {-50, 150}) {
        EXPECT_THAT(Marks(RedrawnGauge({{"ShowMarker", 1}, {"Value", value}})), IsEmpty());
        EXPECT_THAT(Marks(RedrawnGauge({{"ShowMarker", 3}, {"Value", value}})), IsEmpty());
        const auto base = static_cast<float>(value - 2);
        EXPECT_THAT(Marks(RedrawnGauge({{"ShowMarker", 2}, {"Value", value}})),
                    ElementsAre(AcrossAt(base, white), AcrossAt(base + 1, silver), AcrossAt(base + 2, silver),
                                AcrossAt(base + 3, gray), AcrossAt(base + 4, black)));
    }
}

TEST(ScoreCardMarker, AtTheLimitsALineIsDrawn) {
    for (const int value : {0, 100})
        EXPECT_THAT(Marks(RedrawnGauge({{"ShowMarker", 1}, {"Value", value}})),
                    ElementsAre(Across(static_cast<float>(value), black)));
}

TEST(ScoreCardMarker, AnotherNumberIsNoMarker) {
    for (const int value : {0, 4, -1}) EXPECT_THAT(Marks(RedrawnGauge({{"ShowMarker", value}})), IsEmpty()) << value;
}

// The value as text.

TEST(ScoreCardValueText, StandsWhereItsPlaceSays) {
    Card card(GaugeBag({{"Value", 0.5}}));
    const float width = card.picture.TextWidth("50%"), height = card.picture.TextHeight("50%");
    ASSERT_EQ(width, 18);
    ASSERT_EQ(height, 13);
    const float middleX = (longSide - width) / 2, right = longSide - width;
    const float middleY = (shortSide - height) / 2, bottom = shortSide - height;
    const std::tuple<int, float, float> places[] = {
        {1, 0.0f, middleY}, {2, middleX, middleY}, {3, right, middleY}, {4, middleX, 0.0f}, {5, middleX, bottom}};
    for (const auto& [place, x, y] : places) {
        card.Put("ShowValue", place);
        EXPECT_THAT(Marks(card.Drawn()), ElementsAre(PrintText("50%", x, y))) << place;
    }
}

TEST(ScoreCardValueText, StandsWhereItsPlaceSaysOnAnUprightGaugeToo) {
    Card card(Upright({{"Value", 0.5}}));
    const std::tuple<int, float, float> places[] = {
        {1, 0.0f, 43.5f}, {2, 1.0f, 43.5f}, {3, 2.0f, 43.5f}, {4, 1.0f, 0.0f}, {5, 1.0f, 87.0f}};
    for (const auto& [place, x, y] : places) {
        card.Put("ShowValue", place);
        EXPECT_THAT(Marks(card.Drawn()), ElementsAre(PrintText("50%", x, y))) << place;
    }
}

/// A gauge from 0 to 1, where a value of two digits is 18 pixels wide and 13 high.
MemoryBag::Contents Adjusted(double value, int orientation) {
    return {{"Style", style::gauge}, {"Value", value}, {"ShowValue", 6}, {"GaugeOrientation", orientation}};
}

TEST(ScoreCardValueText, AdjustsToTheEmptyPartOfTheBar) {
    EXPECT_THAT(Marks(Card(Adjusted(0.25, 0)).Redrawn()), ElementsAre(PrintText("25%", 82, 3.5f)));
    EXPECT_THAT(Marks(Card(Adjusted(0.75, 0)).Redrawn()), ElementsAre(PrintText("75%", 0, 3.5f)));
    EXPECT_THAT(Marks(Card(Adjusted(0.5, 0)).Redrawn()), ElementsAre(PrintText("50%", 0, 3.5f)));
    EXPECT_THAT(Marks(Card(Adjusted(0.25, 1)).Redrawn()), ElementsAre(PrintText("25%", 41, 0)));
    EXPECT_THAT(Marks(Card(Adjusted(0.75, 1)).Redrawn()), ElementsAre(PrintText("75%", 41, 7)));
    EXPECT_THAT(Marks(Card(Adjusted(0.5, 1)).Redrawn()), ElementsAre(PrintText("50%", 41, 7)));
}

TEST(ScoreCardValueText, AdjustsByHalfTheRangeWithoutTheMinimum) {
    // From 10 to 20 the middle of the bar is 15, but the mark is 5.
    MemoryBag::Contents bag = GaugeBag({{"ScoreMin", 10}, {"ScoreMax", 20}, {"ShowValue", 6}, {"Value", 11}});
    EXPECT_THAT(Marks(Card(bag).Redrawn()), ElementsAre(PrintText("1100%", 0, 3.5f)));
    // From -10 to 10 it is 10, not 0.
    bag = GaugeBag({{"ScoreMin", -10}, {"ScoreMax", 10}, {"ShowValue", 6}, {"Value", 9}});
    EXPECT_THAT(Marks(Card(bag).Redrawn()), ElementsAre(PrintText("900%", longSide - 24, 3.5f)));
}

TEST(ScoreCardValueText, IsNotScaledToTheRange) {
    EXPECT_THAT(Marks(RedrawnGauge({{"ShowValue", 2}})), ElementsAre(PrintText("5000%", 35, 3.5f)));
}

TEST(ScoreCardValueText, NoneOrAnotherNumberPrintsNothing) {
    for (const int value : {0, 7, -1}) EXPECT_THAT(Marks(RedrawnGauge({{"ShowValue", value}})), IsEmpty()) << value;
    for (const double value : {0.75, 1.5, 2.5, 5.75, 6.25, -2.5})
        EXPECT_THAT(Marks(RedrawnGauge({{"ShowValue", value}})), IsEmpty()) << value;
}

TEST(ScoreCardValueText, APlaceOfTheSameNumberInAnotherTypePrints) {
    for (const Variant& value : {Variant(2.0), Variant(2.0f), Variant(2)})
        EXPECT_THAT(Marks(RedrawnGauge({{"ShowValue", value}})), ElementsAre(PrintText("5000%", 35, 3.5f)));
}

TEST(ScoreCardValueText, ANumberBeyondAllPlacesPrintsNothingAndFailsNoLoad) {
    for (const double value : {70'000.0, 1e10, -1e10, 1e300}) {
        Lines marks = {"not drawn"};
        EXPECT_EQ(ErrorOf([&] { marks = Marks(RedrawnGauge({{"ShowValue", value}})); }), 0) << value;
        EXPECT_THAT(marks, IsEmpty()) << value;
    }
}

TEST(ScoreCardValueText, IsPrintedInItsOwnColorAndTheForeColorComesBack) {
    Card card(GaugeBag({{"ShowValue", 2}, {"FontColor", OLE_COLOR(0x00FF00)}, {"ForeColor", OLE_COLOR(0x0000AA)}}));
    EXPECT_THAT(card.Redrawn(), ElementsAre("Cls", Fill(50, 0x0000AA), PrintText("5000%", 35, 3.5f, 0x00FF00)));
    EXPECT_EQ(card.Get("ForeColor"), Variant(OLE_COLOR(0x0000AA)));
    EXPECT_EQ(card.picture.ForeColor(), OLE_COLOR(0x0000AA));
    EXPECT_THAT(card.Redrawn(), ElementsAre("Cls", Fill(50, 0x0000AA), PrintText("5000%", 35, 3.5f, 0x00FF00)));
}

TEST(ScoreCardValueText, ASystemColorOfTheFillComesBackAsItWas) {
    Card card(GaugeBag({{"ShowValue", 2}}));
    EXPECT_EQ(card.Get("ForeColor"), Variant(OLE_COLOR(buttonText)));
}

// Layers and the pen.

TEST(ScoreCardLayers, StandInTheirOrder) {
    const Lines drawn = RedrawnGauge({{"Style", style::gaugeOverrun},
                                      {"Value", 90},
                                      {"ShowBlocks", 2},
                                      {"ShowTickLinesEvery", 50},
                                      {"ShowLimitLines", true},
                                      {"ShowMarker", 2},
                                      {"ShowValue", 1}});
    EXPECT_THAT(
        drawn, ElementsAreArray({std::string("Cls"), Fill(90), Overrun(90, 80), Across(50, buttonFace, 3),
                                 Across(100, buttonFace, 3), axis, Tick(50, 0.3f), Tick(100, 0.3f), Across(20, red),
                                 Across(40, yellow), Across(60, green), Across(80, cyan), AcrossAt(88, white), AcrossAt(89, silver),
                                 AcrossAt(90, silver), AcrossAt(91, gray), AcrossAt(92, black), PrintText("9000%", 0, 3.5f)}));
}

TEST(ScoreCardLayers, StandInTheSameOrderUpright) {
    const Lines drawn = RedrawnUpright({{"Style", style::gaugeRainbow},
                                        {"Value", 90},
                                        {"ShowBlocks", 2},
                                        {"ShowTickLinesEvery", 50},
                                        {"ShowLimitLines", true},
                                        {"ShowMarker", 3},
                                        {"ShowValue", 4}});
    EXPECT_THAT(drawn,
                ElementsAreArray({std::string("Cls"), FillUp(90, cyan), AcrossUp(50, buttonFace, 3), AcrossUp(100, buttonFace, 3),
                                  axisUp, TickUp(50, 0.3f), TickUp(100, 0.3f), AcrossUp(20, red), AcrossUp(40, yellow),
                                  AcrossUp(60, green), AcrossUp(80, cyan), AcrossUp(90, black, 5), AcrossUp(90, white),
                                  PrintText("9000%", (shortSide - 30) / 2, 0)}));
}

TEST(ScoreCardPen, KeepsTheWidthOfTheLastLineForTheNextBand) {
    Card blocks(GaugeBag({{"ShowBlocks", 2}}));
    EXPECT_EQ(blocks.picture.DrawWidth(), 3);
    EXPECT_THAT(blocks.Redrawn(),
                ElementsAre("Cls", Fill(50, buttonText, 3), Across(50, buttonFace, 3), Across(100, buttonFace, 3)));
    blocks.Put("ShowBlocks", 12);
    EXPECT_EQ(blocks.picture.DrawWidth(), 2);
    blocks.Put("ShowMarker", 1);
    EXPECT_EQ(blocks.picture.DrawWidth(), 1);
}

TEST(ScoreCardPen, KeepsTheWidthForTheBandsOfAnOverrunToo) {
    Card card(GaugeBag({{"Style", style::gaugeOverrun}, {"Value", 90}, {"ShowBlocks", 1}}));
    EXPECT_THAT(card.Redrawn(), ElementsAre("Cls", Fill(90, buttonText, 3), Overrun(90, 80, 3), Across(100, buttonFace, 3)));
}

TEST(ScoreCardPen, IsSetForTheAxisWhereNoTickFollows) {
    Card card(GaugeBag({{"ShowBlocks", 1}, {"ShowTickLinesEvery", 1000}}));
    EXPECT_EQ(card.picture.DrawWidth(), 1);
    EXPECT_THAT(card.Redrawn(), ElementsAre("Cls", Fill(50), Across(100, buttonFace, 3), axis));
}

TEST(ScoreCardPen, IsNotTouchedByALineThatIsNotDrawn) {
    Card card(GaugeBag({{"ShowBlocks", 2}, {"ShowMarker", 1}, {"Value", 120}}));
    EXPECT_EQ(card.picture.DrawWidth(), 3);
}

TEST(ScoreCardPen, IsOneAfterABarOutsideTheRange) {
    Card card(GaugeBag({{"ShowBlocks", 2}, {"ShowMarker", 2}, {"Value", 150}}));
    EXPECT_EQ(card.picture.DrawWidth(), 1);
    EXPECT_EQ(Marks(card.Redrawn()).back(), AcrossAt(152, black));
}

TEST(ScoreCardPen, OfAFlashCardIsTheOneOfTheGaugeBefore) {
    Card card(GaugeBag({{"ShowBlocks", 2}}));
    card.Put("Style", style::flashCard);
    EXPECT_THAT(card.Drawn(), ElementsAre("Cls", BoxText(0, 0, longSide, shortSide, yellow, 3)));
}

// What is seen of it.

constexpr std::uint32_t fill = 0x123456, ground = 0xF0E0D0, outside = 0xFFFFFFFF;

/// A gauge in colours that nothing else has.
MemoryBag::Contents Colored(const MemoryBag::Contents& other) {
    MemoryBag bag(GaugeBag({{"ForeColor", OLE_COLOR(fill)}, {"BackColor", OLE_COLOR(ground)}}));
    for (const auto& [key, value] : other) bag.Set(key, value);
    return bag.Kept();
}
Card Lying(const MemoryBag::Contents& other) { return Card(Colored(other)); }
Card Standing(const MemoryBag::Contents& other) { return Card(Upright(Colored(other))); }

using Colors = std::set<std::uint32_t>;
std::uint32_t PixelOf(const Card& card, int x, int y) {
    return static_cast<std::uint32_t>(card.picture.Point(static_cast<float>(x), static_cast<float>(y)));
}
/// The colours of a column of pixels from edge to edge.
Colors ColumnAt(const Card& card, int x) {
    Colors colors;
    for (int y = 0; y < static_cast<int>(card.picture.ScaleHeight()); ++y) colors.insert(PixelOf(card, x, y));
    return colors;
}
Colors RowAt(const Card& card, int y) {
    Colors colors;
    for (int x = 0; x < static_cast<int>(card.picture.ScaleWidth()); ++x) colors.insert(PixelOf(card, x, y));
    return colors;
}
constexpr std::pair<int, std::uint32_t> limits[] = {{20, red}, {40, yellow}, {60, green}, {80, cyan}};

TEST(ScoreCardPixels, LimitLinesAreNotBrokenByGaps) {
    const Card card = Lying({{"Value", 100}, {"ShowBlocks", 5}, {"ShowLimitLines", true}});
    for (const auto& [limit, color] : limits) {
        const int x = frame::PixelAt(At(static_cast<float>(limit)));
        EXPECT_EQ(ColumnAt(card, x), Colors{color}) << "from edge to edge at " << limit;
        for (const int beside : {x - 1, x + 1}) EXPECT_EQ(ColumnAt(card, beside), Colors{ground}) << "the gap at " << limit;
        for (const int beyond : {x - 2, x + 2}) EXPECT_EQ(ColumnAt(card, beyond), Colors{fill}) << "the block at " << limit;
    }
}

TEST(ScoreCardPixels, LimitLinesOfAnUprightGaugeAreNotBrokenByGaps) {
    const Card card = Standing({{"Value", 100}, {"ShowBlocks", 5}, {"ShowLimitLines", true}});
    for (const auto& [limit, color] : limits) {
        const int y = frame::PixelAt(longSide - At(static_cast<float>(limit)));
        EXPECT_EQ(RowAt(card, y), Colors{color}) << "from edge to edge at " << limit;
        for (const int beside : {y - 1, y + 1}) EXPECT_EQ(RowAt(card, beside), Colors{ground}) << "the gap at " << limit;
        for (const int beyond : {y - 2, y + 2}) EXPECT_EQ(RowAt(card, beyond), Colors{fill}) << "the block at " << limit;
    }
}

TEST(ScoreCardPixels, AFillBeyondTheEndIsCutOffByTheSurface) {
    const Card card = Lying({{"Value", 150}});
    for (int x = 0; x < 100; ++x) EXPECT_EQ(ColumnAt(card, x), Colors{fill}) << x;
    EXPECT_EQ(ColumnAt(card, 100), Colors{outside});
    const Card upright = Standing({{"Value", 150}});
    for (int y = 0; y < 100; ++y) EXPECT_EQ(RowAt(upright, y), Colors{fill}) << y;
    EXPECT_EQ(RowAt(upright, -1), Colors{outside});
}

TEST(ScoreCardPixels, AnOverrunBeyondTheEndIsCutOffByTheSurface) {
    const Card card = Lying({{"Style", style::gaugeOverrun}, {"Value", 150}});
    EXPECT_EQ(ColumnAt(card, 79), Colors{fill});
    for (int x = 80; x < 100; ++x) EXPECT_EQ(ColumnAt(card, x), Colors{red}) << x;
    EXPECT_EQ(ColumnAt(card, 100), Colors{outside});
    const Card upright = Standing({{"Style", style::gaugeOverrun}, {"Value", 150}});
    EXPECT_EQ(RowAt(upright, 21), Colors{fill});
    for (int y = 0; y <= 20; ++y) EXPECT_EQ(RowAt(upright, y), Colors{red}) << y;
}

TEST(ScoreCardPixels, ABandOffTheLeftEdgeLeavesTheColumnOfItsStart) {
    // A band is a box, and boxes include both corners: the one at the start is on the surface.
    for (const int value : {-30, -1, 0}) {
        const Card card = Lying({{"Value", value}});
        EXPECT_EQ(ColumnAt(card, 0), Colors{fill}) << value;
        for (int x = 1; x < 100; ++x) EXPECT_EQ(ColumnAt(card, x), Colors{ground}) << value << " " << x;
    }
}

TEST(ScoreCardPixels, ABandBelowAnUprightGaugeIsNotSeen) {
    // Its start is the row under the last one of the surface.
    for (const int value : {-30, -1, 0}) {
        const Card card = Standing({{"Value", value}});
        for (int y = 0; y < 100; ++y) EXPECT_EQ(RowAt(card, y), Colors{ground}) << value << " " << y;
    }
}

TEST(ScoreCardPixels, ARaisedBarOverTheLeftEdgeShowsTheLinesThatLieInside) {
    const Card card = Lying({{"Value", -1}, {"ShowMarker", 2}});
    EXPECT_EQ(ColumnAt(card, 0), Colors{gray}) << "over the column of the band";
    EXPECT_EQ(ColumnAt(card, 1), Colors{black});
    for (int x = 2; x < 100; ++x) EXPECT_EQ(ColumnAt(card, x), Colors{ground}) << x;
}

TEST(ScoreCardPixels, AMarkerOffTheLeftEdgeIsNotSeen) {
    for (const int marker : {1, 2, 3}) {
        const Card card = Lying({{"Value", -30}, {"ShowMarker", marker}});
        EXPECT_EQ(ColumnAt(card, 0), Colors{fill}) << marker;
        for (int x = 1; x < 100; ++x) EXPECT_EQ(ColumnAt(card, x), Colors{ground}) << marker << " " << x;
    }
}

TEST(ScoreCardPixels, ARaisedBarOverTheRightEdgeShowsTheLinesThatLieInside) {
    const Card card = Lying({{"Value", 100}, {"ShowMarker", 2}});
    EXPECT_EQ(ColumnAt(card, 97), Colors{fill});
    EXPECT_EQ(ColumnAt(card, 98), Colors{white});
    EXPECT_EQ(ColumnAt(card, 99), Colors{silver});
}

// Each property shows at once.

TEST(ScoreCardGauge, EveryPropertyOfTheGaugeShowsAtOnce) {
    Card card(GaugeBag());
    const auto shown = [&](const char* name, const Variant& value) {
        card.host.log.Clear();
        card.Put(name, value);
        return card.Drawn();
    };
    EXPECT_THAT(shown("Value", 60), ElementsAre("Cls", Fill(60)));
    EXPECT_THAT(shown("ForeColor", OLE_COLOR(red)), ElementsAre("Cls", Fill(60, red)));
    EXPECT_THAT(shown("ShowBlocks", 1), ElementsAre("Cls", Fill(60, red), Across(100, buttonFace, 3)));
    EXPECT_THAT(shown("BackColor", OLE_COLOR(white)), ElementsAre("Cls", Fill(60, red, 3), Across(100, white, 3)));
    card.Put("ShowBlocks", 0);
    EXPECT_THAT(shown("ShowMarker", 1), ElementsAre("Cls", Fill(60, red, 3), Across(60, black)));
    card.Put("ShowMarker", 0);
    EXPECT_THAT(shown("ShowTickLinesEvery", 75), ElementsAre("Cls", Fill(60, red), axis, Tick(75, 0.3f)));
    EXPECT_THAT(shown("TickLineColor", OLE_COLOR(0x111111)),
                ElementsAre("Cls", Fill(60, red), LineText(0, 10, 100, 10, 0x111111), Tick(75, 0.3f, 0x111111)));
    card.Put("ShowTickLinesEvery", 0);
    EXPECT_THAT(shown("ScoreMax", 120), ElementsAre("Cls", FillTo(50, red)));
    EXPECT_THAT(shown("ScoreMin", 20), ElementsAre("Cls", FillTo(40, red)));
    EXPECT_THAT(shown("GaugeOrientation", 1), ElementsAre("Cls", BoxText(0, 20, 100, 12, red)));
}

}  // namespace
}  // namespace tessel::controls
