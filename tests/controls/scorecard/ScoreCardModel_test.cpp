#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>
#include <memory>
#include <ostream>
#include <string>
#include <tuple>
#include <vector>

#include "tests/controls/scorecard/ScoreCardTestHelp.h"

/// The score, its limits and its thresholds, and what each setter does beside storing.
namespace tessel::controls {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;
using namespace scoretest;

constexpr const char* thresholds[] = {"ScoreBad", "ScoreMaybe", "ScoreGood", "ScoreStar"};

/// "0.2 0.4 0.6 0.8", and the limits: "0 to 1".
std::string Thresholds(Card& card) {
    std::string line;
    for (const auto* name : thresholds) line += (line.empty() ? "" : " ") + Shortest(card.Number(name));
    return line;
}
std::string Limits(Card& card) { return Shortest(card.Number("ScoreMin")) + " to " + Shortest(card.Number("ScoreMax")); }

MemoryBag::Contents Flash() { return {{"Style", style::flashCard}}; }

// Value.

TEST(ScoreCardModel, ValueIsConvertedToAThirtyTwoBitFloatOnEverySet) {
    Card card;
    for (const Variant& value : {Variant(0.1), Variant(3), Variant("0.75"), Variant(true), Variant()}) {
        card.Put("Value", value);
        EXPECT_EQ(card.Get("Value").Type(), VarType::Single);
        EXPECT_EQ(card.Get("Value"), Variant(value.ToSingle()));
    }
}

TEST(ScoreCardModel, ValueHasNoLimits) {
    Card card;
    for (const float value : {-5.0f, 17.5f, 1e6f}) {
        card.Put("Value", value);
        EXPECT_EQ(card.Get("Value"), Variant(value));
    }
    EXPECT_EQ(Limits(card), "0 to 1");
    EXPECT_EQ(Thresholds(card), "0.2 0.4 0.6 0.8");
}

TEST(ScoreCardModel, AValueThatIsNoNumberFailsAndChangesNothing) {
    Card card(Flash());
    for (const Variant& value : {Variant("x"), Variant(""), Variant::Missing(), headless::ListOf(Lines{"1"})})
        EXPECT_EQ(ErrorOf([&] { card.Put("Value", value); }), frame::errors::typeMismatch);
    EXPECT_EQ(card.Get("Value"), Variant(0.5));
    EXPECT_THAT(card.Happened(), IsEmpty());
}

TEST(ScoreCardModel, AValueTooLargeForAFloatFailsWithOverflowAndChangesNothing) {
    Card card(Flash());
    EXPECT_EQ(ErrorOf([&] { card.Put("Value", 1e300); }), frame::errors::overflow);
    EXPECT_EQ(card.Get("Value"), Variant(0.5));
    EXPECT_THAT(card.Happened(), IsEmpty());
}

TEST(ScoreCardModel, NumbersThatDoNotConvertLeaveEveryPropertyAsItWas) {
    Card card(Flash());
    for (const auto* name :
         {"BackColor",  "ForeColor", "Enabled",      "BorderStyle", "Style",          "ScoreStar",          "ScoreGood",
          "ScoreMaybe", "ScoreBad",  "ScoreMin",     "ScoreMax",    "ShowLimitLines", "ShowTickLinesEvery", "TickLineColor",
          "FontColor",  "ShowValue", "ToolTipStyle", "ShowMarker",  "ShowBlocks",     "GaugeOrientation"}) {
        const Variant before = card.Get(name);
        EXPECT_EQ(ErrorOf([&] { card.Put(name, "wide"); }), frame::errors::typeMismatch) << name;
        EXPECT_EQ(card.Get(name), before) << name;
    }
    EXPECT_THAT(card.Happened(), IsEmpty());
}

TEST(ScoreCardModel, IntegersThatDoNotFitFailWithOverflow) {
    Card card;
    for (const auto* name : {"BorderStyle", "Style", "ShowBlocks"})
        EXPECT_EQ(ErrorOf([&] { card.Put(name, 70'000); }), frame::errors::overflow) << name;
    EXPECT_EQ(ErrorOf([&] { card.Put("ScoreStar", 1e300); }), frame::errors::overflow);
}

// Thresholds: clamped to their neighbours, which they never push.

struct Clamped {
    const char* name;
    float set, kept;
};
void PrintTo(const Clamped& row, std::ostream* out) { *out << row.name << " = " << row.set; }

class ScoreCardThresholds : public testing::TestWithParam<Clamped> {};

INSTANTIATE_TEST_SUITE_P(
    Neighbours, ScoreCardThresholds,
    testing::Values(Clamped{"ScoreStar", 0.1f, 0.6f}, Clamped{"ScoreStar", 0.6f, 0.6f}, Clamped{"ScoreStar", 0.7f, 0.7f},
                    Clamped{"ScoreStar", 1.0f, 1.0f}, Clamped{"ScoreStar", 1.5f, 1.0f}, Clamped{"ScoreGood", 0.1f, 0.4f},
                    Clamped{"ScoreGood", 0.5f, 0.5f}, Clamped{"ScoreGood", 0.9f, 0.8f}, Clamped{"ScoreMaybe", 0.1f, 0.2f},
                    Clamped{"ScoreMaybe", 0.5f, 0.5f}, Clamped{"ScoreMaybe", 0.7f, 0.6f}, Clamped{"ScoreBad", -0.5f, 0.0f},
                    Clamped{"ScoreBad", 0.0f, 0.0f}, Clamped{"ScoreBad", 0.3f, 0.3f}, Clamped{"ScoreBad", 0.9f, 0.4f}));

TEST_P(ScoreCardThresholds, LandOnTheNeighbourAndNeverPushIt) {
    Card card;
    card.Put(GetParam().name, GetParam().set);
    for (const auto* name : thresholds) {
        if (name == std::string(GetParam().name)) continue;
        EXPECT_EQ(card.Get(name), Card().Get(name)) << name;
    }
    EXPECT_EQ(card.Number(GetParam().name), GetParam().kept);
    EXPECT_EQ(Limits(card), "0 to 1");
    EXPECT_THAT(card.Changed(), ElementsAre(GetParam().name));
}

TEST(ScoreCardModel, AThresholdIsRaisedFirstAndLoweredThen) {
    // A saved state may have its thresholds in any order.
    Card star({{"ScoreGood", 5}});
    star.Put("ScoreStar", 0.1);
    EXPECT_EQ(star.Number("ScoreStar"), 1);
    Card good({{"ScoreMaybe", 0.9}});
    good.Put("ScoreGood", 0.1);
    EXPECT_EQ(good.Number("ScoreGood"), 0.8f);
    Card maybe({{"ScoreBad", 0.7}});
    maybe.Put("ScoreMaybe", 0.1);
    EXPECT_EQ(maybe.Number("ScoreMaybe"), 0.6f);
    Card bad({{"ScoreMin", 0.5}});
    bad.Put("ScoreBad", 0.1);
    EXPECT_EQ(bad.Number("ScoreBad"), 0.4f);
}

// Limits.

TEST(ScoreCardModel, AMinimumAtOrAboveTheMaximumBecomesTheMaximumLessOne) {
    for (const float value : {5.0f, 1.0f}) {
        Card card;
        card.Put("ScoreMin", value);
        EXPECT_EQ(Limits(card), "0 to 1");
        EXPECT_EQ(Thresholds(card), "0.2 0.4 0.6 0.8");
        EXPECT_THAT(card.Changed(), ElementsAre("ScoreMin"));
    }
    Card card({{"ScoreMax", 10}});
    card.Put("ScoreMin", 20);
    EXPECT_EQ(Limits(card), "9 to 10");
    EXPECT_EQ(Thresholds(card), "9 9 9 9");
}

TEST(ScoreCardModel, AMaximumAtOrBelowTheMinimumBecomesTheMinimumAndOne) {
    for (const float value : {-1.0f, 0.0f}) {
        Card card;
        card.Put("ScoreMax", value);
        EXPECT_EQ(Limits(card), "0 to 1");
        EXPECT_EQ(Thresholds(card), "0.2 0.4 0.6 0.8");
        EXPECT_THAT(card.Changed(), ElementsAre("ScoreMax"));
    }
    Card card;
    card.Put("ScoreMin", -5);
    card.Put("ScoreMax", -10);
    EXPECT_EQ(Limits(card), "-5 to -4");
    EXPECT_EQ(Thresholds(card), "-4 -4 -4 -4");
}

TEST(ScoreCardModel, AMinimumRaisesTheThresholdsBelowIt) {
    Card card;
    card.Put("ScoreMin", 0.5);
    EXPECT_EQ(Limits(card), "0.5 to 1");
    EXPECT_EQ(Thresholds(card), "0.5 0.5 0.6 0.8");
    EXPECT_THAT(card.Changed(), ElementsAre("ScoreMin"));
    card.Put("ScoreMin", 0.9);
    EXPECT_EQ(Thresholds(card), "0.9 0.9 0.9 0.9");
    card.Put("ScoreMin", -3);
    EXPECT_EQ(Limits(card), "-3 to 1");
    EXPECT_EQ(Thresholds(card), "0.9 0.9 0.9 0.9");
}

TEST(ScoreCardModel, AMaximumLowersTheThresholdsAboveIt) {
    Card card;
    card.Put("ScoreMax", 0.5);
    EXPECT_EQ(Limits(card), "0 to 0.5");
    EXPECT_EQ(Thresholds(card), "0.2 0.4 0.5 0.5");
    EXPECT_THAT(card.Changed(), ElementsAre("ScoreMax"));
    card.Put("ScoreMax", 0.1);
    EXPECT_EQ(Thresholds(card), "0.1 0.1 0.1 0.1");
    card.Put("ScoreMax", 100);
    EXPECT_EQ(Limits(card), "0 to 100");
    EXPECT_EQ(Thresholds(card), "0.1 0.1 0.1 0.1");
}

TEST(ScoreCardModel, LimitsLeaveTheValueAlone) {
    Card card;
    card.Put("ScoreMin", 0.75);
    card.Put("ScoreMax", 0.875);
    EXPECT_EQ(card.Get("Value"), Variant(0.5));
}

TEST(ScoreCardModel, ASavedStateWithEqualLimitsIsPutInOrderByTheNextSet) {
    Card card({{"ScoreMin", 3}, {"ScoreMax", 3}});
    card.Put("ScoreMax", 3);
    EXPECT_EQ(Limits(card), "3 to 4");
    Card other({{"ScoreMin", 3}, {"ScoreMax", 3}});
    other.Put("ScoreMin", 3);
    EXPECT_EQ(Limits(other), "2 to 3");
}

TEST(ScoreCardModel, AnyOrderOfSetsKeepsTheOrderOfTheLimits) {
    Card card;
    const float values[] = {0.3f, -2, 7, 0.5f, 100, -0.25f, 3, 1};
    for (std::size_t i = 0; i < 200; ++i) {
        const auto* name =
            std::vector{"ScoreMin", "ScoreBad", "ScoreMaybe", "ScoreGood", "ScoreStar", "ScoreMax"}[(i * 7 + i / 6) % 6];
        card.Put(name, values[(i * 5 + i / 8) % 8]);
        float before = card.Number("ScoreMin");
        for (const auto* next : thresholds) {
            EXPECT_LE(before, card.Number(next)) << name << " in step " << i;
            before = card.Number(next);
        }
        EXPECT_LE(before, card.Number("ScoreMax")) << name << " in step " << i;
        EXPECT_LT(card.Number("ScoreMin"), card.Number("ScoreMax")) << name << " in step " << i;
    }
}

// The other setters.

TEST(ScoreCardModel, AnyStyleIsAcceptedAndAnUnknownOneShowsNothing) {
    Card card(Flash());
    for (const int value : {12, -1, 1000}) {
        card.Put("Style", value);
        EXPECT_EQ(card.Get("Style"), Variant(value));
        EXPECT_THAT(card.Happened(), ElementsAre("changed Style"));
    }
}

TEST(ScoreCardModel, AStyleThatIsTheSameDoesNothingAtAll) {
    for (const int value : {style::scoreCardSmall, style::flashCard, style::gauge, 12}) {
        Card card({{"Style", value}, {"ToolTip", "A"}});
        card.Put("ToolTip", "B");
        card.host.log.Clear();
        card.Put("Style", value);
        EXPECT_THAT(card.Happened(), IsEmpty()) << value;
        EXPECT_EQ(card.ToolTip(), "A 50%") << value;
    }
}

TEST(ScoreCardModel, AStyleThatIsTheSameLeavesTheBagAlone) {
    Card card(Options{.placedNew = true, .designTime = true});
    card.Put("Style", 0);
    EXPECT_THAT(card.Changed(), IsEmpty());
    EXPECT_THAT(card.host.Save(card.control).Kept(), IsEmpty());
}

TEST(ScoreCardModel, ShowBlocksTakesZeroToAHundredAndIgnoresTheRest) {
    Card card(Flash());
    for (const int value : {100, 1, 0, 50}) {
        card.Put("ShowBlocks", value);
        EXPECT_EQ(card.Get("ShowBlocks"), Variant(value));
        EXPECT_THAT(card.Changed(), ElementsAre("ShowBlocks"));
    }
    for (const int value : {101, -1, 32'767, -32'768}) {
        card.Put("ShowBlocks", value);
        EXPECT_EQ(card.Get("ShowBlocks"), Variant(50)) << value;
        EXPECT_THAT(card.Happened(), IsEmpty()) << value;
    }
}

TEST(ScoreCardModel, ToolTipStyleTakesZeroToThreeAndIgnoresTheRest) {
    Card card(Flash());
    for (const int value : {0, 1, 3, 2}) {
        card.Put("ToolTipStyle", value);
        EXPECT_EQ(card.Get("ToolTipStyle"), Variant(value));
        EXPECT_THAT(card.Happened(), ElementsAre("changed ToolTipStyle"));
    }
    for (const int value : {4, -1, 100'000}) {
        card.Put("ToolTipStyle", value);
        EXPECT_EQ(card.Get("ToolTipStyle"), Variant(2)) << value;
        EXPECT_THAT(card.Happened(), IsEmpty()) << value;
    }
}

TEST(ScoreCardModel, ShowValueKeepsZeroToSixAndDrawsOnAnyDifference) {
    Card card(Flash());
    for (int value = 6; value > 0; --value) {
        card.Put("ShowValue", value);
        EXPECT_EQ(card.Get("ShowValue"), Variant(value));
        const Lines happened = card.Happened();
        EXPECT_EQ(CountOf(happened, "Cls"), 1u) << value;
        EXPECT_EQ(CountOf(happened, "changed ShowValue"), 1u) << value;
    }
    for (const int value : {7, -1}) {
        card.Put("ShowValue", value);
        EXPECT_EQ(card.Get("ShowValue"), Variant(1)) << value;
        const Lines happened = card.Happened();
        EXPECT_EQ(CountOf(happened, "Cls"), 1u) << value;
        EXPECT_EQ(CountOf(happened, "changed ShowValue"), 1u) << value;
    }
}

TEST(ScoreCardModel, AShowValueThatIsTheSameIsReportedAndNotDrawn) {
    Card card(Flash());
    card.Put("ShowValue", 0);
    EXPECT_THAT(card.Happened(), ElementsAre("changed ShowValue"));
}

TEST(ScoreCardModel, ATickIntervalBelowZeroBecomesTheIntegerZero) {
    Card card;
    for (const Variant& value : {Variant(-1), Variant(-0.25), Variant(-1e30f)}) {
        card.Put("ShowTickLinesEvery", 2);
        card.Put("ShowTickLinesEvery", value);
        EXPECT_EQ(card.Get("ShowTickLinesEvery"), Variant(0));
        const MemoryBag bag = card.host.Save(card.control);
        EXPECT_EQ(bag.Written().at(13).key, "ShowTickLinesEvery");
        EXPECT_EQ(bag.Written().at(13).value.Type(), VarType::Integer);
    }
    card.Put("ShowTickLinesEvery", 0.25);
    EXPECT_EQ(card.Get("ShowTickLinesEvery"), Variant(0.25));
}

TEST(ScoreCardModel, MarkersAndOrientationsTakeAnyNumber) {
    Card card;
    for (const auto* name : {"ShowMarker", "GaugeOrientation"}) {
        card.Put(name, 9);
        EXPECT_EQ(card.Get(name), Variant(9)) << name;
    }
}

TEST(ScoreCardModel, ColorsAreKeptAsTheyAreSet) {
    Card card;
    for (const auto* name : {"BackColor", "ForeColor", "TickLineColor", "FontColor"}) {
        for (const OLE_COLOR color : {OLE_COLOR(0x80000005), OLE_COLOR(0xFFFFFF), OLE_COLOR(0)}) {
            card.Put(name, color);
            EXPECT_EQ(card.Get(name), Variant(color)) << name;
        }
    }
}

TEST(ScoreCardModel, ColorsFontAndBorderLiveInThePictureBox) {
    Card card;
    const auto font = std::make_shared<frame::Font>("Courier", 20);
    card.Put("BackColor", OLE_COLOR(0x010203));
    card.Put("ForeColor", OLE_COLOR(0x040506));
    card.Put("Font", font);
    card.Put("BorderStyle", 0);
    EXPECT_EQ(card.picture.BackColor(), OLE_COLOR(0x010203));
    EXPECT_EQ(card.picture.ForeColor(), OLE_COLOR(0x040506));
    EXPECT_EQ(card.picture.Font(), font);
    EXPECT_EQ(card.picture.BorderStyle(), 0);
    card.picture.SetBackColor(0x0A0B0C);
    EXPECT_EQ(card.Get("BackColor"), Variant(OLE_COLOR(0x0A0B0C)));
    EXPECT_EQ(card.Get("Font").ToObject().Get(), font.get());
}

TEST(ScoreCardModel, EnabledIsTheControlsOwn) {
    Card card;
    card.Put("Enabled", false);
    EXPECT_FALSE(card.control.Surface().Enabled());
    EXPECT_TRUE(card.picture.Enabled());
    card.control.Surface().SetEnabled(true);
    EXPECT_EQ(card.Get("Enabled"), Variant(true));
}

TEST(ScoreCardModel, FontOfALoadedCardIsSharedWithItsBag) {
    const auto font = std::make_shared<frame::Font>("Courier", 20);
    Card card({{"Font", font}, {"Style", style::flashCard}});
    EXPECT_EQ(card.picture.Font(), font);
}

// Who draws anew.

/// A new value for a property, and how often the card is drawn anew for it.
struct Redraw {
    const char* name;
    Variant value;
    int times;
};
void PrintTo(const Redraw& row, std::ostream* out) { *out << row.name; }

class ScoreCardRedraw : public testing::TestWithParam<Redraw> {};

INSTANTIATE_TEST_SUITE_P(Properties, ScoreCardRedraw,
                         testing::Values(Redraw{"BackColor", OLE_COLOR(1), 1}, Redraw{"ForeColor", OLE_COLOR(1), 1},
                                         Redraw{"Enabled", false, 0},
                                         Redraw{"Font", std::make_shared<frame::Font>("Courier", 20), 0},
                                         Redraw{"BorderStyle", 0, 1}, Redraw{"Value", 0.9, 1}, Redraw{"ScoreStar", 0.9, 1},
                                         Redraw{"ScoreGood", 0.7, 1}, Redraw{"ScoreMaybe", 0.3, 1}, Redraw{"ScoreBad", 0.1, 0},
                                         Redraw{"ScoreMin", -1, 1}, Redraw{"ScoreMax", 2, 1}, Redraw{"ShowLimitLines", true, 1},
                                         Redraw{"ShowTickLinesEvery", 0.25, 1}, Redraw{"TickLineColor", OLE_COLOR(1), 1},
                                         Redraw{"FontColor", OLE_COLOR(1), 1}, Redraw{"ShowValue", 1, 1},
                                         Redraw{"ToolTipStyle", 1, 0}, Redraw{"ToolTip", "A", 0}, Redraw{"ShowMarker", 1, 1},
                                         Redraw{"ShowBlocks", 5, 1}, Redraw{"GaugeOrientation", 1, 1}),
                         [](const auto& row) { return std::string(row.param.name); });

TEST_P(ScoreCardRedraw, OfAFlashCardComesAsOftenAsItShould) {
    Card card(Flash());
    card.Put(GetParam().name, GetParam().value);
    EXPECT_EQ(CountOf(card.Drawn(), "Cls"), static_cast<std::size_t>(GetParam().times));
}

TEST_P(ScoreCardRedraw, OfAGaugeComesAsOftenAsItShould) {
    Card card({{"Style", style::gauge}});
    card.Put(GetParam().name, GetParam().value);
    EXPECT_EQ(CountOf(card.Drawn(), "Cls"), static_cast<std::size_t>(GetParam().times));
}

TEST_P(ScoreCardRedraw, OfAPictureComesAsOftenAsItShould) {
    Card card({{"Style", style::smileySmall}});
    card.Put(GetParam().name, GetParam().value);
    // A border changes the size of the card, for which a picture is not drawn anew.
    const int times = GetParam().name == std::string("BorderStyle") ? 0 : GetParam().times;
    EXPECT_EQ(CountOf(card.Drawn(), "Cls"), static_cast<std::size_t>(times));
}

TEST_P(ScoreCardRedraw, ComesAfterTheReport) {
    if (GetParam().times == 0 || GetParam().name == std::string("ShowValue")) return;
    Card card(Flash());
    card.Put(GetParam().name, GetParam().value);
    const Lines happened = card.Happened();
    ASSERT_THAT(happened, SizeIs(3));
    EXPECT_EQ(happened[0], std::string("changed ") + GetParam().name);
    EXPECT_EQ(happened[1], "Cls");
    EXPECT_EQ(CountOf({happened[2]}, "Box"), 1u);
}

TEST_P(ScoreCardRedraw, ComesAtDesignTimeToo) {
    Card card(Options{.saved = Flash(), .designTime = true});
    card.Put(GetParam().name, GetParam().value);
    EXPECT_EQ(CountOf(card.Drawn(), "Cls"), static_cast<std::size_t>(GetParam().times));
}

TEST_P(ScoreCardRedraw, ComesForAValueThatIsTheSameToo) {
    Card card(Flash());
    card.Put(GetParam().name, GetParam().value);
    card.host.log.Clear();
    card.Put(GetParam().name, card.Get(GetParam().name));
    const int times = GetParam().name == std::string("ShowValue") ? 0 : GetParam().times;
    EXPECT_EQ(CountOf(card.Drawn(), "Cls"), static_cast<std::size_t>(times));
}

TEST(ScoreCardModel, AChangeOfStyleDrawsFirstAndReportsThen) {
    Card card({{"Style", style::gauge}});
    card.Put("Style", style::flashCard);
    EXPECT_THAT(card.Happened(), ElementsAre("Cls", BoxText(0, 0, longSide, shortSide, yellow), "changed Style"));
}

TEST(ScoreCardModel, AChangeToAPictureDrawsFirstAndReportsThen) {
    Card card(Flash());
    card.Put("Style", style::smileyLarge);
    EXPECT_THAT(card.Happened(), ElementsAre("Cls", "changed Style"));
    EXPECT_EQ(card.ShownImage(), "ImageList32 Smiley3");
}

TEST(ScoreCardModel, AMinimumDrawsOnceWithTheRaisedThresholds) {
    Card card(Flash());
    card.Put("ScoreMin", 0.75);
    EXPECT_THAT(card.Happened(), ElementsAre("changed ScoreMin", "Cls", BoxText(0, 0, longSide, shortSide, black)));
}

TEST(ScoreCardModel, ShowAndHideDoNothing) {
    Card card(Flash());
    for (const bool visible : {false, true}) card.host.SiteOf(card.control)->SetVisible(visible);
    EXPECT_THAT(card.Happened(), IsEmpty());
}

TEST(ScoreCardModel, RefreshDrawsAndReportsNothing) {
    for (const int value : {style::scoreCardSmall, style::flashCard, style::gauge}) {
        Card card({{"Style", value}, {"ToolTip", "A"}});
        card.Put("ToolTip", "B");
        card.host.log.Clear();
        card.control.Call("Refresh");
        EXPECT_THAT(card.Happened(), IsEmpty());
        EXPECT_EQ(card.ToolTip(), "A 50%");
    }
}

/// Counts how often the picture box asks for a repaint.
struct Repaints final : frame::Peer {
    explicit Repaints(int& counter) : count(counter) {}
    void Update() override { ++count; }
    int& count;
};

TEST(ScoreCardModel, RefreshRepaintsThePictureBox) {
    int repaints = 0;
    headless::HeadlessHost host;
    host.makePeer = [&](frame::ChildControl& child) -> std::unique_ptr<frame::Peer> {
        if (child.Name() != "Picture1") return nullptr;
        return std::make_unique<Repaints>(repaints);
    };
    frame::Control& control = host.Create(ScoreCardClass(), "ScoreCard1");
    host.Frame().Flush();
    repaints = 0;
    control.Call("Refresh");
    host.Frame().Flush();
    EXPECT_EQ(repaints, 1);
    host.Frame().Flush();
    EXPECT_EQ(repaints, 1);
}

TEST(ScoreCardModel, TheControlIsNotDrawnByPaint) {
    Card card(Flash());
    card.control.Paint();
    EXPECT_THAT(card.Happened(), IsEmpty());
}

}  // namespace
}  // namespace tessel::controls
