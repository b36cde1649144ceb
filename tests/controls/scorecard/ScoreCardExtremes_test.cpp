#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>
#include <string>
#include <utility>
#include <vector>

#include "tests/controls/scorecard/ScoreCardTestHelp.h"

/// Numbers that no designer would set: a card draws something or fails with a number, but it always comes to an end.
namespace tessel::controls {
namespace {

using testing::AnyOf;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;
using namespace scoretest;

constexpr float infinity = std::numeric_limits<float>::infinity(), notANumber = std::numeric_limits<float>::quiet_NaN();
constexpr float greatest = std::numeric_limits<float>::max(), least = std::numeric_limits<float>::denorm_min();
constexpr float extremes[] = {infinity, -infinity, notANumber, greatest, -greatest, least, 1e-30f, 1e8f};
constexpr int gauges[] = {style::gauge, style::gaugeOverrun, style::gaugeRainbow};
constexpr const char* numbers[] = {"Value",      "ScoreMin",  "ScoreMax",  "ScoreBad",
                                   "ScoreMaybe", "ScoreGood", "ScoreStar", "ShowTickLinesEvery"};

/// A gauge with all layers.
MemoryBag::Contents Full(const MemoryBag::Contents& other = {}) {
    MemoryBag bag(
        GaugeBag({{"ShowBlocks", 5}, {"ShowTickLinesEvery", 10}, {"ShowLimitLines", true}, {"ShowMarker", 2}, {"ShowValue", 6}}));
    for (const auto& [key, value] : other) bag.Set(key, value);
    return bag.Kept();
}
/// Either it works or a computation fails.
auto IsArithmetic() { return AnyOf(0, frame::errors::overflow, frame::errors::divisionByZero); }

// Equal limits, which only a saved state can bring.

TEST(ScoreCardEqualLimits, DrawNothingAndReportAsEver) {
    for (const int value : gauges) {
        Card card(Full({{"Style", value}, {"ScoreMin", 3}, {"ScoreMax", 3.0}}));
        EXPECT_THAT(card.Redrawn(), IsEmpty()) << value;
        card.Put("Value", 3);
        EXPECT_THAT(card.Happened(), ElementsAre("changed Value")) << value;
    }
}

TEST(ScoreCardEqualLimits, LeaveTheSurfaceAsItIs) {
    Card card({{"Style", style::flashCard}, {"ScoreMin", 3}, {"ScoreMax", 3}});
    card.Put("Style", style::gauge);
    EXPECT_THAT(card.Happened(), ElementsAre("changed Style"));
    EXPECT_EQ(card.picture.Point(10, 10), static_cast<std::int32_t>(yellow));
}

TEST(ScoreCardEqualLimits, LeaveThePictureToo) {
    Card card({{"Style", style::smileyLarge}, {"ScoreMin", 3}, {"ScoreMax", 3}});
    card.Put("Style", style::gaugeRainbow);
    EXPECT_EQ(card.ShownImage(), "ImageList32 Smiley3");
}

TEST(ScoreCardEqualLimits, StillSetTheToolTip) {
    Card card(GaugeBag({{"ScoreMin", 3}, {"ScoreMax", 3}, {"ToolTip", "Score"}, {"Value", 0.5}}));
    EXPECT_EQ(card.ToolTip(), "Score 50%");
    card.Put("Value", 0.75);
    EXPECT_EQ(card.ToolTip(), "Score 75%");
}

TEST(ScoreCardEqualLimits, AreDrawnAgainOnceTheyDiffer) {
    Card card({{"Style", style::gauge}, {"ScoreMin", 3}, {"ScoreMax", 3}, {"Value", 3.5}});
    card.Put("ScoreMax", 3);
    EXPECT_THAT(card.Drawn(), ElementsAre("Cls", BoxText(0, 0, 50, shortSide, buttonText)));
}

TEST(ScoreCardEqualLimits, FillTheControlAllTheSame) {
    Card card({{"Style", style::gauge}, {"ScoreMin", 3}, {"ScoreMax", 3}});
    card.host.SiteOf(card.control)->SetSize(Outer(60), Outer(50));
    EXPECT_EQ(card.picture.Width(), Outer(60));
    EXPECT_EQ(card.picture.Height(), Outer(50));
    EXPECT_THAT(card.Drawn(), IsEmpty());
}

// Limits in the wrong order.

TEST(ScoreCardReversedLimits, HaveABandAndNoLines) {
    Card card(GaugeBag({{"ScoreMin", 100},
                        {"ScoreMax", 0},
                        {"Value", 25},
                        {"ShowBlocks", 5},
                        {"ShowTickLinesEvery", 10},
                        {"ShowLimitLines", true},
                        {"ShowMarker", 1}}));
    EXPECT_THAT(card.Redrawn(), ElementsAre("Cls", BoxText(0, 0, 75, shortSide, buttonText), LineText(0, 10, longSide, 10, black)));
}

// The counter of the ticks has 16 bits.

Card GaugeTo(int most) { return Card(GaugeBag({{"ScoreMax", most}})); }

TEST(ScoreCardTickCounter, OverflowsWithTooManyTicks) {
    Card card(GaugeBag({{"ScoreMax", 1}, {"ShowMarker", 1}, {"Value", 0.5}}));
    EXPECT_EQ(ErrorOf([&] { card.Put("ShowTickLinesEvery", 1e-5); }), frame::errors::overflow);
    const Lines happened = card.Happened();
    ASSERT_GT(happened.size(), 3u);
    EXPECT_EQ(happened[0], "changed ShowTickLinesEvery");
    EXPECT_EQ(happened[1], "Cls");
    EXPECT_EQ(happened[3], LineText(0, 10, longSide, 10, black));
    EXPECT_THAT(happened, SizeIs(4 + 32'767));  // neither the marker nor what follows
}

TEST(ScoreCardTickCounter, AnOverflowRollsNothingBack) {
    Card card(GaugeBag({{"ScoreMax", 1}}));
    EXPECT_EQ(ErrorOf([&] { card.Put("ShowTickLinesEvery", 1e-5f); }), frame::errors::overflow);
    EXPECT_EQ(card.Get("ShowTickLinesEvery"), Variant(1e-5f));
    EXPECT_EQ(ErrorOf([&] { card.Put("Value", 0.75); }), frame::errors::overflow);
    EXPECT_EQ(card.Get("Value"), Variant(0.75));
    EXPECT_EQ(ErrorOf([&] { card.Put("ShowTickLinesEvery", 0); }), 0);
    EXPECT_THAT(card.Redrawn(), ElementsAre("Cls", BoxText(0, 0, 75, shortSide, buttonText)));
}

TEST(ScoreCardTickCounter, HoldsAsManyTicksAsFit) {
    Card card = GaugeTo(32'766);
    EXPECT_EQ(ErrorOf([&] { card.Put("ShowTickLinesEvery", 1); }), 0);
    EXPECT_THAT(card.Drawn(), SizeIs(3 + 32'766));
}

TEST(ScoreCardTickCounter, OverflowsWithOneTooMany) {
    Card card = GaugeTo(32'768);
    EXPECT_EQ(ErrorOf([&] { card.Put("ShowTickLinesEvery", 1); }), frame::errors::overflow);
}

TEST(ScoreCardTickCounter, OverflowsWhereAStepIsTooSmallToMove) {
    Card card({{"Style", style::gauge}, {"ScoreMin", 100'000'000}, {"ScoreMax", 200'000'000}});
    EXPECT_EQ(ErrorOf([&] { card.Put("ShowTickLinesEvery", 1); }), frame::errors::overflow);
}

TEST(ScoreCardTickCounter, AnOverflowFailsALoad) {
    HostUnderTest host;
    const MemoryBag saved(GaugeBag({{"ScoreMax", 1}, {"ShowTickLinesEvery", 1e-5}}));
    EXPECT_EQ(ErrorOf([&] { host.Create(ScoreCardClass(), "ScoreCard1", {.saved = &saved}); }), frame::errors::overflow);
    EXPECT_EQ(host.FindSite("ScoreCard1"), nullptr);
}

TEST(ScoreCardTickCounter, CountsForNoOtherStyle) {
    for (const int value : {style::scoreCardSmall, style::flashCard, 12}) {
        Card card({{"Style", value}});
        EXPECT_EQ(ErrorOf([&] { card.Put("ShowTickLinesEvery", 1e-5); }), 0) << value;
    }
}

// Arithmetic.

TEST(ScoreCardArithmetic, APositionThatIsTooLargeFailsWithOverflow) {
    Card card({{"Style", style::gauge}});
    EXPECT_EQ(ErrorOf([&] { card.Put("Value", greatest); }), frame::errors::overflow);
    EXPECT_EQ(card.Get("Value"), Variant(greatest));
    EXPECT_THAT(card.Changed(), ElementsAre("Value"));
}

TEST(ScoreCardArithmetic, AnErrorOfTheDrawingLeavesTheCardUsable) {
    Card card({{"Style", style::gauge}});
    EXPECT_NE(ErrorOf([&] { card.Put("Value", greatest); }), 0);
    card.Put("Value", 0.5);
    EXPECT_THAT(card.Redrawn(), ElementsAre("Cls", BoxText(0, 0, 50, shortSide, buttonText)));
}

TEST(ScoreCardArithmetic, AStepOfBlocksThatIsTooSmallToMoveComesToAnEnd) {
    Card card({{"Style", style::gauge}, {"ScoreMin", 100'000'000}, {"ScoreMax", 100'000'008}});
    EXPECT_THAT(ErrorOf([&] { card.Put("ShowBlocks", 100); }), IsArithmetic());
    EXPECT_EQ(card.Get("ShowBlocks"), Variant(100));
}

TEST(ScoreCardArithmetic, ANumberOfBlocksFromASavedStateHasNoGreatestButEnds) {
    Card card(GaugeBag({{"ShowBlocks", 32'767}}));
    const Lines drawn = card.Redrawn();
    EXPECT_GT(drawn.size(), 1000u);
    EXPECT_NE(drawn.back().find(" w1"), std::string::npos);
}

TEST(ScoreCardArithmetic, AnInfiniteIntervalLeavesTheAxis) {
    Card card(GaugeBag());
    EXPECT_THAT(ErrorOf([&] { card.Put("ShowTickLinesEvery", infinity); }), IsArithmetic());
    EXPECT_THAT(card.Drawn(), ElementsAre("Cls", BoxText(0, 0, 50, shortSide, buttonText), LineText(0, 10, longSide, 10, black)));
}

// Whatever is set, and whatever a saved state brings, the drawing ends.

TEST(ScoreCardExtremes, EverySetEnds) {
    for (const int gauge : gauges) {
        for (const auto* name : numbers) {
            for (const float value : extremes) {
                Card card(Full({{"Style", gauge}}));
                EXPECT_THAT(ErrorOf([&] { card.Put(name, value); }), IsArithmetic()) << name << " " << value;
            }
        }
    }
}

TEST(ScoreCardExtremes, EverySavedStateEnds) {
    for (const auto* name : numbers) {
        for (const float value : extremes) {
            for (const int orientation : {0, 1})
                EXPECT_THAT(ErrorOf([&] {
                                Card(Full({{name, value}, {"GaugeOrientation", orientation}}));
                            }),
                            IsArithmetic())
                    << name << " " << value;
        }
    }
}

TEST(ScoreCardExtremes, PairsOfLimitsEnd) {
    for (const float low : extremes) {
        for (const float high : extremes) {
            EXPECT_THAT(ErrorOf([&] {
                            Card(Full({{"ScoreMin", low}, {"ScoreMax", high}}));
                        }),
                        IsArithmetic())
                << low << " " << high;
            Card card(Full({{"ShowTickLinesEvery", 0}}));
            EXPECT_THAT(ErrorOf([&] { card.Put("ScoreMax", high); }), IsArithmetic()) << low << " " << high;
            EXPECT_THAT(ErrorOf([&] { card.Put("ScoreMin", low); }), IsArithmetic()) << low << " " << high;
            EXPECT_THAT(ErrorOf([&] { card.Put("ShowBlocks", 100); }), IsArithmetic()) << low << " " << high;
        }
    }
}

TEST(ScoreCardExtremes, MarkersAndTextsOfEveryValueEnd) {
    for (int marker = 0; marker <= 3; ++marker) {
        for (const float value : extremes) {
            Card card(GaugeBag({{"ShowMarker", marker}, {"ShowValue", 2}}));
            EXPECT_THAT(ErrorOf([&] { card.Put("Value", value); }), IsArithmetic()) << marker << " " << value;
        }
    }
}

TEST(ScoreCardExtremes, PicturesAndFlashCardsTakeEveryNumber) {
    for (const int value : {style::scoreCardLarge, style::flashCard}) {
        for (const auto* name : numbers) {
            for (const float number : extremes) {
                Card card({{"Style", value}});
                EXPECT_THAT(ErrorOf([&] { card.Put(name, number); }), IsArithmetic()) << name << " " << number;
            }
        }
    }
}

TEST(ScoreCardExtremes, InfiniteScoresHaveTheirGrades) {
    EXPECT_EQ(Card({{"Value", infinity}, {"ToolTipStyle", 1}}).ShownImage(), "ImageList16 ScoreCard5");
    EXPECT_EQ(Card({{"Value", -infinity}, {"ToolTipStyle", 1}}).ShownImage(), "ImageList16 ScoreCard1");
    EXPECT_EQ(Card({{"Value", notANumber}, {"ToolTipStyle", 1}}).ShownImage(), "ImageList16 ScoreCard1");
}

}  // namespace
}  // namespace tessel::controls
