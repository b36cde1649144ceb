#include "controls/scorecard/Gauge.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "tests/ErrorOf.h"

namespace tessel::controls {
namespace {

using frame::Variant;
using frame::draw::Box;
using frame::draw::Line;

constexpr float infinite = std::numeric_limits<float>::infinity();
constexpr auto nan = std::numeric_limits<double>::quiet_NaN();

gauge::Frame Bar(bool vertical = false, float width = 200, float height = 40) {
    gauge::Frame bar;
    gauge::Lay(bar, vertical, width, height);
    return bar;
}

TEST(ScorePercentTest, RoundsToWholePercentWithHalvesAwayFromZero) {
    EXPECT_EQ(PercentText(0.5), "50%");
    EXPECT_EQ(PercentText(0.5f), "50%");
    EXPECT_EQ(PercentText(0.125), "13%");
    EXPECT_EQ(PercentText(0.124), "12%");
    EXPECT_EQ(PercentText(-0.125), "-13%");
    EXPECT_EQ(PercentText(-0.05), "-5%");
    EXPECT_EQ(PercentText(0.995), "100%");
    EXPECT_EQ(PercentText(9.995), "1000%");
    EXPECT_EQ(PercentText(50.0), "5000%");
    EXPECT_EQ(PercentText(std::int16_t{1}), "100%");
    EXPECT_EQ(PercentText(true), "-100%");
}

TEST(ScorePercentTest, CountsTheNumberAsItIsWritten) {
    EXPECT_EQ(PercentText(0.145), "15%");
    EXPECT_EQ(PercentText(0.145f), "15%");
    EXPECT_EQ(PercentText(0.285f), "29%");
    EXPECT_EQ(PercentText(1.005), "101%");
}

TEST(ScorePercentTest, NothingIsZeroWithoutASign) {
    EXPECT_EQ(PercentText(0.0), "0%");
    EXPECT_EQ(PercentText(-0.0), "0%");
    EXPECT_EQ(PercentText(0.004), "0%");
    EXPECT_EQ(PercentText(-0.004), "0%");
    EXPECT_EQ(PercentText(0.005), "1%");
    EXPECT_EQ(PercentText(-0.005), "-1%");
    EXPECT_EQ(PercentText(1e-7), "0%");
    EXPECT_EQ(PercentText(5e-324), "0%");
    EXPECT_EQ(PercentText(Variant()), "0%");
}

TEST(ScorePercentTest, LargeNumbersHaveAllTheirDigits) {
    EXPECT_EQ(PercentText(1e15), "100000000000000000%");
    EXPECT_EQ(PercentText(-1.5e20), "-15000000000000000000000%");
    EXPECT_EQ(PercentText(std::numeric_limits<double>::max()).size(), 309u + 2 + 1);
    EXPECT_EQ(PercentText(std::numeric_limits<float>::max()).size(), 39u + 2 + 1);
}

TEST(ScorePercentTest, WhatIsNoNumberToRoundHasAFixedText) {
    EXPECT_EQ(PercentText(nan), "NaN%");
    EXPECT_EQ(PercentText(infinite), "Infinity%");
    EXPECT_EQ(PercentText(-infinite), "-Infinity%");
    EXPECT_EQ(test::ErrorOf([] { PercentText("x"); }), 13);
}

TEST(ScoreOrderTest, AFloatMeetsOtherNumbersAsAFloat) {
    EXPECT_FALSE(IsBelow(0.7f, 0.7));
    EXPECT_FALSE(IsBelow(0.7, 0.7f));
    EXPECT_TRUE(IsEqual(0.7, 0.7f));
    EXPECT_TRUE(IsBelow(0.7, 0.7000000001)) << "two 64-bit floats keep their precision";
    EXPECT_TRUE(IsBelow(std::int16_t{0}, 0.1f));
    EXPECT_TRUE(IsBelow("0.5", 0.6));
    EXPECT_FALSE(IsBelow(nan, 0.5));
    EXPECT_FALSE(IsBelow(0.5, nan));
    EXPECT_TRUE(Reaches(0.7f, 0.7));
    EXPECT_TRUE(Reaches(0.7, 0.7f));
    EXPECT_FALSE(Reaches(nan, 0.5));
    EXPECT_FALSE(Reaches(0.5, nan));
    EXPECT_EQ(test::ErrorOf([] { IsBelow("x", 1.0); }), 13);
}

TEST(GaugeTest, ABarRunsFromTheLeftOrFromTheBottom) {
    const gauge::Frame lying = Bar(), standing = Bar(true);
    EXPECT_EQ(lying.GaugeStart, 0);
    EXPECT_EQ(lying.GaugeEnd, 200);
    EXPECT_EQ(lying.GaugeBreadth, 40);
    EXPECT_EQ(standing.GaugeStart, 40);
    EXPECT_EQ(standing.GaugeEnd, 0);
    EXPECT_EQ(standing.GaugeBreadth, 200);
}

TEST(GaugeTest, APositionIsADistanceFromTheStartAndNotHeldWithinTheBar) {
    EXPECT_EQ(gauge::PositionOf(Bar(), 0.5, 0, 1), 100);
    EXPECT_EQ(gauge::PositionOf(Bar(), 2, 0, 1), 400);
    EXPECT_EQ(gauge::PositionOf(Bar(), -1, 0, 1), -200);
    EXPECT_EQ(gauge::PositionOf(Bar(), 15, 10, 20), 100);
    EXPECT_EQ(gauge::PositionOf(Bar(true), 0.25, 0, 1), 10);
    EXPECT_EQ(gauge::PositionOf(Bar(), 0.1, 0, 1), 200 * 0.1f) << "the ratio is a float";
    EXPECT_EQ(gauge::PositionOf(Bar(), 0.5, 7, 7), 7) << "of an empty range";
}

TEST(GaugeTest, APositionTooFarAwayForAFloatIsAnOverflow) {
    EXPECT_EQ(test::ErrorOf([] { gauge::PositionOf(Bar(), 1e300, 0, 1); }), 6);
    EXPECT_EQ(test::ErrorOf([] { gauge::PositionOf(Bar(), 3e38, 0, 1); }), 6);
    EXPECT_TRUE(std::isnan(gauge::PositionOf(Bar(), nan, 0, 1)));
}

TEST(GaugeTest, LinesOfAPartOfTheBreadthAreCentred) {
    EXPECT_EQ(gauge::AcrossOf(Bar(), 1).from, 0);
    EXPECT_EQ(gauge::AcrossOf(Bar(), 1).to, 40);
    EXPECT_EQ(gauge::AcrossOf(Bar(), 0.5f).from, 10);
    EXPECT_EQ(gauge::AcrossOf(Bar(), 0.5f).to, 30);
}

TEST(GaugeTest, CrossLinesBandsAndTheAxisTurnWithTheBar) {
    EXPECT_EQ(gauge::CrossLine(Bar(), 60, {5, 35}, 0xFFu), (Line{60, 5, 60, 35, 0xFFu, Box::None}));
    EXPECT_EQ(gauge::CrossLine(Bar(true), 10, {5, 35}, 0xFFu), (Line{5, 30, 35, 30, 0xFFu, Box::None}));
    EXPECT_EQ(gauge::Band(Bar(), 0, 60, 0xFFu), (Line{0, 0, 60, 40, 0xFFu, Box::Filled}));
    EXPECT_EQ(gauge::Band(Bar(true), 0, 10, 0xFFu), (Line{0, 40, 200, 30, 0xFFu, Box::Filled}));
    EXPECT_EQ(gauge::Axis(Bar(), 0xFFu), (Line{0, 20, 200, 20, 0xFFu, Box::None}));
    EXPECT_EQ(gauge::Axis(Bar(true), 0xFFu), (Line{100, 40, 100, 0, 0xFFu, Box::None}));
}

TEST(GaugeTest, GapsAreNarrowerBetweenMoreBlocks) {
    EXPECT_EQ(gauge::GapWidth(1), 3);
    EXPECT_EQ(gauge::GapWidth(10), 3);
    EXPECT_EQ(gauge::GapWidth(11), 2);
    EXPECT_EQ(gauge::GapWidth(20), 2);
    EXPECT_EQ(gauge::GapWidth(21), 1);
    EXPECT_EQ(gauge::GapWidth(100), 1);
}

TEST(GaugeTest, ARaisedBarIsLightAtTheTopOrLeft) {
    EXPECT_EQ(gauge::RaisedColor(Bar(), 0), 0xFFFFFFu);
    EXPECT_EQ(gauge::RaisedColor(Bar(), 1), 0xC0C0C0u);
    EXPECT_EQ(gauge::RaisedColor(Bar(), 3), 0x808080u);
    EXPECT_EQ(gauge::RaisedColor(Bar(), 4), 0u);
    EXPECT_EQ(gauge::RaisedColor(Bar(true), 0), 0u);
    EXPECT_EQ(gauge::RaisedColor(Bar(true), 1), 0x808080u);
    EXPECT_EQ(gauge::RaisedColor(Bar(true), 4), 0xFFFFFFu);
}

TEST(GaugeTest, TheTextStandsWhereItIsWantedOrWhereTheBarIsEmpty) {
    const auto place = [](tsShowValue where, bool low = false, bool vertical = false) {
        const gauge::Place at = gauge::TextPlace(where, low, vertical, {100, 50}, {20, 10});
        return std::pair(at.x, at.y);
    };
    const std::pair left(0.0f, 20.0f), middle(40.0f, 20.0f), right(80.0f, 20.0f), top(40.0f, 0.0f), bottom(40.0f, 40.0f);
    EXPECT_EQ(place(tsShowValue::AtLeft), left);
    EXPECT_EQ(place(tsShowValue::AtMiddle), middle);
    EXPECT_EQ(place(tsShowValue::AtRight), right);
    EXPECT_EQ(place(tsShowValue::AtTop), top);
    EXPECT_EQ(place(tsShowValue::AtBottom), bottom);
    EXPECT_EQ(place(tsShowValue::Adjust, true), right);
    EXPECT_EQ(place(tsShowValue::Adjust, false), left);
    EXPECT_EQ(place(tsShowValue::Adjust, true, true), top);
    EXPECT_EQ(place(tsShowValue::Adjust, false, true), bottom);
}

}  // namespace
}  // namespace tessel::controls
