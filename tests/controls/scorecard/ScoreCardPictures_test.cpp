#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <ostream>
#include <string>
#include <utility>
#include <vector>

#include "frame/Picture.h"
#include "tests/controls/scorecard/ScoreCardTestHelp.h"

/// The picture styles, the flash card, the size of the card and its tool tip.
namespace tessel::controls {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using namespace scoretest;

/// A picture style, the family and the list from which it takes its picture, and its inner size in pixels.
struct PictureStyle {
    int number;
    const char* family;
    const char* list;
    int pixels;
};
void PrintTo(const PictureStyle& row, std::ostream* out) { *out << row.family << row.pixels; }

constexpr PictureStyle pictureStyles[] = {
    {style::scoreCardSmall, "ScoreCard", "ImageList16", 16}, {style::scoreCardLarge, "ScoreCard", "ImageList32", 32},
    {style::smileySmall, "Smiley", "ImageList16", 16},       {style::smileyLarge, "Smiley", "ImageList32", 32},
    {style::trafficSmall, "Traffic", "ImageList16", 16},     {style::trafficLarge, "Traffic", "ImageList32", 32},
    {style::weatherSmall, "Weather", "ImageList16", 16},     {style::weatherLarge, "Weather", "ImageList32", 32}};

constexpr const char* families[] = {"ScoreCard", "Smiley", "Traffic", "Weather"};
constexpr std::pair<const char*, int> lists[] = {{"ImageList16", 16}, {"ImageList32", 32}};

// The image lists.

TEST(ScoreCardImages, EachListHoldsFiveGradesOfFourFamiliesInTheirOrder) {
    Lines expected;
    for (const auto* family : families)
        for (int grade = 1; grade <= 5; ++grade) expected.push_back(family + std::to_string(grade));
    Card card;
    for (const auto& [name, pixels] : lists) {
        const child::ListImages& images = card.ImageList(name).ListImages;
        Lines keys;
        for (int index = 1; index <= images.Count(); ++index) keys.push_back(images.Item(index).Key());
        EXPECT_EQ(keys, expected) << name;
    }
}

TEST(ScoreCardImages, EachPictureHasTheSizeOfItsListAndPixels) {
    Card card;
    for (const auto& [name, pixels] : lists) {
        EXPECT_EQ(card.ImageList(name).ImageWidth(), pixels);
        EXPECT_EQ(card.ImageList(name).ImageHeight(), pixels);
        const child::ListImages& images = card.ImageList(name).ListImages;
        for (int index = 1; index <= images.Count(); ++index) {
            const frame::Picture& picture = *images.Item(index).Picture();
            EXPECT_EQ(picture.Width(), static_cast<float>(pixels * 15)) << name << " " << index;
            EXPECT_EQ(picture.Height(), static_cast<float>(pixels * 15)) << name << " " << index;
            const frame::PixelPlane* plane = picture.Plane(1);
            ASSERT_NE(plane, nullptr) << name << " " << index;
            EXPECT_EQ(plane->width, pixels) << name << " " << index;
            EXPECT_EQ(plane->height, pixels) << name << " " << index;
        }
    }
}

TEST(ScoreCardImages, NoTwoPicturesLookTheSame) {
    Card card;
    for (const auto& [name, pixels] : lists) {
        const child::ListImages& images = card.ImageList(name).ListImages;
        ASSERT_EQ(images.Count(), 20);
        for (int one = 1; one <= 20; ++one) {
            for (int other = one + 1; other <= 20; ++other) {
                const auto *first = images.Item(one).Picture()->Plane(1), *second = images.Item(other).Picture()->Plane(1);
                ASSERT_TRUE(first && second);
                EXPECT_NE(first->pixels, second->pixels) << name << " " << one << " " << other;
            }
        }
    }
}

// Grades.

class ScoreCardPictureStyles : public testing::TestWithParam<PictureStyle> {
  protected:
    std::string Image(int grade) const { return std::string(GetParam().list) + " " + GetParam().family + std::to_string(grade); }
};

INSTANTIATE_TEST_SUITE_P(Styles, ScoreCardPictureStyles, testing::ValuesIn(pictureStyles), [](const auto& row) {
    return row.param.family + std::string(row.param.pixels == 16 ? "Small" : "Large");
});

TEST_P(ScoreCardPictureStyles, ShowThePictureOfTheGrade) {
    Card card({{"Style", GetParam().number}});
    const std::pair<float, int> grades[] = {{-10, 1},   {0, 1},    {0.19f, 1}, {0.2f, 2}, {0.39f, 2}, {0.4f, 3},
                                            {0.59f, 3}, {0.6f, 4}, {0.79f, 4}, {0.8f, 5}, {1, 5},     {1000, 5}};
    for (const auto& [value, grade] : grades) {
        card.Put("Value", value);
        EXPECT_EQ(card.ShownImage(), Image(grade)) << value;
    }
}

TEST_P(ScoreCardPictureStyles, ShowTheirPictureAfterALoad) {
    Card card({{"Style", GetParam().number}, {"Value", 0.7}});
    EXPECT_EQ(card.ShownImage(), Image(4));
}

TEST_P(ScoreCardPictureStyles, ShowTheirPictureWhenTheyAreChosen) {
    for (const int before : {style::scoreCardSmall, style::flashCard, style::gauge, 12}) {
        Card card({{"Style", before}});
        card.Put("Style", GetParam().number);
        EXPECT_EQ(card.ShownImage(), Image(3)) << before;
    }
}

TEST_P(ScoreCardPictureStyles, ClearAndDrawNothing) {
    Card card({{"Style", GetParam().number}});
    EXPECT_THAT(card.Redrawn(), ElementsAre("Cls"));
}

TEST_P(ScoreCardPictureStyles, ShowTheWholePictureInTheBox) {
    Card card({{"Style", GetParam().number}});
    const frame::PixelPlane& plane = *card.picture.Picture()->Plane(1);
    ASSERT_EQ(plane.width, GetParam().pixels);
    const auto last = static_cast<float>(GetParam().pixels - 1);
    EXPECT_NE(card.picture.Point(last, last), -1);
    EXPECT_EQ(card.picture.Point(last + 1, 0), -1);
    EXPECT_EQ(card.picture.Point(0, last + 1), -1);
    int opaque = 0;
    for (int y = 0; y < plane.height; ++y) {
        for (int x = 0; x < plane.width; ++x) {
            const std::uint32_t pixel = plane.pixels[static_cast<std::size_t>(y * plane.width + x)];
            if (pixel >> 24 != 0xFF) continue;
            ++opaque;
            EXPECT_EQ(card.picture.Point(static_cast<float>(x), static_cast<float>(y)),
                      static_cast<std::int32_t>(pixel & 0xFFFFFF));
        }
    }
    EXPECT_GT(opaque, 0);
}

// Their size.

TEST_P(ScoreCardPictureStyles, SettleAtTheirInnerSizeWhateverTheHostAsksFor) {
    const auto pixels = static_cast<float>(GetParam().pixels);
    const std::string settled = Shortest(Outer(pixels)) + " " + Shortest(Outer(pixels));
    const std::pair<float, float> sizes[] = {{15'000, 15'000}, {4500, 300}, {300, 6000}, {300, 300}, {540, 540},
                                             {15, 15},         {0, 0},      {61, 61},    {301, 299}};
    for (const auto& [width, height] : sizes) {
        Card card(Options{.saved = {{"Style", GetParam().number}}, .width = width, .height = height});
        EXPECT_EQ(card.Size(), settled) << width << " " << height;
        EXPECT_NEAR(card.picture.ScaleWidth(), pixels, 0.001) << width << " " << height;
        EXPECT_NEAR(card.picture.ScaleHeight(), pixels, 0.001) << width << " " << height;
        EXPECT_NE(card.picture.Point(pixels - 1, pixels - 1), -1) << width << " " << height;
        EXPECT_EQ(card.picture.Left(), 0);
        EXPECT_EQ(card.picture.Top(), 0);
    }
}

TEST_P(ScoreCardPictureStyles, SettleAgainAfterTheHostHasResizedThem) {
    const auto pixels = static_cast<float>(GetParam().pixels);
    Card card({{"Style", GetParam().number}});
    for (const auto& [width, height] : {std::pair{3000.0f, 900.0f}, {30.0f, 30.0f}, {540.0f, 300.0f}}) {
        card.host.SiteOf(card.control)->SetSize(width, height);
        EXPECT_EQ(card.Size(), Shortest(Outer(pixels)) + " " + Shortest(Outer(pixels)));
        EXPECT_THAT(card.Drawn(), IsEmpty());
    }
}

TEST_P(ScoreCardPictureStyles, SettleWithoutABorderToo) {
    const auto twips = static_cast<float>(GetParam().pixels * 15);
    Card card({{"Style", GetParam().number}});
    card.Put("BorderStyle", 0);
    EXPECT_EQ(card.Size(), Shortest(twips) + " " + Shortest(twips));
    EXPECT_THAT(card.Drawn(), IsEmpty());
    card.Put("BorderStyle", 1);
    EXPECT_EQ(card.Size(), Shortest(twips + 60) + " " + Shortest(twips + 60));
    EXPECT_THAT(card.Drawn(), IsEmpty());
}

TEST_P(ScoreCardPictureStyles, SettleAtDesignTimeAndWhenTheyArePlacedNew) {
    const auto outer = Shortest(Outer(static_cast<float>(GetParam().pixels)));
    Card card(Options{.placedNew = true, .designTime = true, .width = 3000, .height = 2000});
    card.Put("Style", GetParam().number);
    EXPECT_EQ(card.Size(), outer + " " + outer);
    EXPECT_EQ(card.picture.Width(), card.picture.Height());
}

TEST_P(ScoreCardPictureStyles, BringABigGaugeToTheirSize) {
    const auto outer = Shortest(Outer(static_cast<float>(GetParam().pixels)));
    Card card(GaugeBag());
    card.Put("Style", GetParam().number);
    EXPECT_EQ(card.Size(), outer + " " + outer);
    card.Put("Style", style::flashCard);
    EXPECT_EQ(card.Size(), outer + " " + outer);
    EXPECT_NEAR(card.picture.ScaleWidth(), GetParam().pixels, 0.001);
}

TEST(ScoreCardSize, ChangesBetweenSmallAndLargeMoveTheSize) {
    Card card;
    EXPECT_EQ(card.Size(), "300 300");
    card.Put("Style", style::weatherLarge);
    EXPECT_EQ(card.Size(), "540 540");
    card.Put("Style", style::trafficSmall);
    EXPECT_EQ(card.Size(), "300 300");
}

TEST(ScoreCardSize, EveryOtherStyleFillsTheControlAndIsDrawnAnew) {
    for (const int value : {style::flashCard, style::gauge, style::gaugeOverrun, style::gaugeRainbow}) {
        Card card({{"Style", value}});
        card.host.SiteOf(card.control)->SetSize(Outer(60), Outer(50));
        EXPECT_EQ(CountOf(card.Drawn(), "Cls"), 1u) << value;
        EXPECT_EQ(card.picture.Left(), 0);
        EXPECT_EQ(card.picture.Top(), 0);
        EXPECT_EQ(card.picture.Width(), Outer(60));
        EXPECT_EQ(card.picture.Height(), Outer(50));
        EXPECT_EQ(card.Size(), "960 810");
    }
}

TEST(ScoreCardSize, AnUnknownStyleFillsTheControlAndDrawsNothing) {
    Card card({{"Style", 12}});
    card.host.SiteOf(card.control)->SetSize(Outer(60), Outer(50));
    EXPECT_THAT(card.Drawn(), IsEmpty());
    EXPECT_EQ(card.picture.Width(), Outer(60));
    EXPECT_EQ(card.picture.Height(), Outer(50));
}

TEST(ScoreCardSize, ThePictureBoxGoesBackToItsPlace) {
    for (const int value : {style::scoreCardSmall, style::gauge}) {
        Card card({{"Style", value}});
        card.picture.SetLeft(150);
        card.picture.SetTop(75);
        card.control.Resize();
        EXPECT_EQ(card.picture.Left(), 0) << value;
        EXPECT_EQ(card.picture.Top(), 0) << value;
    }
}

TEST(ScoreCardSize, AnEmptySurfaceIsDrawnWithoutFailure) {
    for (const int value : {style::flashCard, style::gauge, style::gaugeRainbow}) {
        Card card(Options{.saved = GaugeBag({{"Style", value}, {"ShowBlocks", 5}, {"ShowTickLinesEvery", 10}, {"ShowValue", 2}}),
                          .width = 0,
                          .height = 0});
        EXPECT_EQ(card.picture.ScaleWidth(), 0);
        EXPECT_EQ(CountOf(card.Redrawn(), "Cls"), 1u);
    }
}

// When a picture is drawn.

TEST(ScoreCardPictures, ANewCardShowsItsGradeAtOnce) {
    for (const bool designTime : {true, false}) {
        Card card(Options{.placedNew = true, .designTime = designTime});
        EXPECT_EQ(card.ShownImage(), "ImageList16 ScoreCard3");
        EXPECT_EQ(card.Size(), "300 300");
    }
}

TEST(ScoreCardPictures, ScoreBadShowsAtTheNextRedraw) {
    Card card({{"Value", 0.3}});
    EXPECT_EQ(card.ShownImage(), "ImageList16 ScoreCard2");
    card.Put("ScoreBad", 0.9);
    EXPECT_EQ(card.Number("ScoreBad"), 0.4f);
    EXPECT_EQ(card.ShownImage(), "ImageList16 ScoreCard2");
    card.Put("FontColor", OLE_COLOR(0));
    EXPECT_EQ(card.ShownImage(), "ImageList16 ScoreCard1");
}

TEST(ScoreCardPictures, ThresholdsChooseThePicture) {
    Card card({{"Value", 0.5}});
    card.Put("ScoreMaybe", 0.55);
    EXPECT_EQ(card.ShownImage(), "ImageList16 ScoreCard2");
    card.Put("ScoreMaybe", 0.4);
    card.Put("ScoreGood", 0.45);
    EXPECT_EQ(card.ShownImage(), "ImageList16 ScoreCard4");
    card.Put("ScoreStar", 0.5);
    EXPECT_EQ(card.ShownImage(), "ImageList16 ScoreCard5");
}

TEST(ScoreCardPictures, AValueAtAThresholdTakesTheHigherGrade) {
    const std::pair<double, int> thresholds[] = {{0.2, 2}, {0.4, 3}, {0.6, 4}, {0.8, 5}};
    for (const auto& [value, grade] : thresholds) {
        const std::string image = "ImageList32 Smiley" + std::to_string(grade);
        Card set({{"Style", style::smileyLarge}});
        set.Put("Value", value);
        EXPECT_EQ(set.ShownImage(), image) << value << " by a set";
        Card loaded({{"Style", style::smileyLarge}, {"Value", value}});
        EXPECT_EQ(loaded.ShownImage(), image) << value << " by a load";
        Card saved({{"Style", style::smileyLarge}, {"Value", static_cast<float>(value)}});
        EXPECT_EQ(saved.ShownImage(), image) << value << " by a load of what was set";
    }
}

TEST(ScoreCardPictures, AThresholdSetToTheValueTakesTheHigherGrade) {
    Card card({{"Value", 0.7}});
    EXPECT_EQ(card.ShownImage(), "ImageList16 ScoreCard4");
    card.Put("ScoreStar", 0.7);
    EXPECT_EQ(card.ShownImage(), "ImageList16 ScoreCard5");
}

TEST(ScoreCardPictures, EachThresholdIsTestedOnItsOwnAndALaterOneWins) {
    // A saved state may have its thresholds in any order.
    Card star({{"Value", 0.1}, {"ScoreStar", 0.0}});
    EXPECT_EQ(star.ShownImage(), "ImageList16 ScoreCard5");
    Card good({{"Value", 0.1}, {"ScoreGood", -1}});
    EXPECT_EQ(good.ShownImage(), "ImageList16 ScoreCard4");
    Card maybe({{"Value", 0.5}, {"ScoreBad", 0.9}});
    EXPECT_EQ(maybe.ShownImage(), "ImageList16 ScoreCard3");
}

TEST(ScoreCardPictures, AnotherStyleTakesThePictureAway) {
    for (const int value : {style::flashCard, style::gauge, style::gaugeOverrun, style::gaugeRainbow}) {
        Card card;
        card.Put("Style", value);
        EXPECT_EQ(card.ShownImage(), "nothing") << value;
    }
}

TEST(ScoreCardPictures, AnUnknownStyleLeavesThePictureAsItIs) {
    Card card;
    card.Put("Style", 12);
    EXPECT_EQ(card.ShownImage(), "ImageList16 ScoreCard3");
}

TEST(ScoreCardPictures, AMissingImagePassesItsErrorOut) {
    Card card;
    card.ImageList("ImageList16").ListImages.Remove("ScoreCard5");
    EXPECT_EQ(ErrorOf([&] { card.Put("Value", 1); }), frame::errors::elementNotFound);
    EXPECT_EQ(card.Get("Value"), Variant(1));
    EXPECT_THAT(card.Changed(), ElementsAre("Value"));
}

// The flash card.

TEST(ScoreCardFlashCard, IsABoxInTheColorOfTheValue) {
    Card card({{"Style", style::flashCard}});
    const std::pair<float, std::uint32_t> colors[] = {{-10, black},    {0.19f, black}, {0.2f, red},    {0.39f, red}, {0.4f, yellow},
                                                      {0.59f, yellow}, {0.6f, green},  {0.79f, green}, {0.8f, cyan}, {5, cyan}};
    for (const auto& [value, color] : colors) {
        card.Put("Value", value);
        EXPECT_THAT(card.Drawn(), ElementsAre("Cls", BoxText(0, 0, longSide, shortSide, color))) << value;
    }
}

TEST(ScoreCardFlashCard, AValueAtAThresholdTakesTheHigherGrade) {
    const std::pair<double, std::uint32_t> thresholds[] = {{0.2, red}, {0.4, yellow}, {0.6, green}, {0.8, cyan}};
    for (const auto& [value, color] : thresholds) {
        Card set({{"Style", style::flashCard}});
        set.Put("Value", value);
        EXPECT_EQ(set.picture.Point(50, 10), static_cast<std::int32_t>(color)) << value << " by a set";
        Card loaded({{"Style", style::flashCard}, {"Value", value}});
        EXPECT_EQ(loaded.picture.Point(50, 10), static_cast<std::int32_t>(color)) << value << " by a load";
        Card saved({{"Style", style::flashCard}, {"Value", static_cast<float>(value)}});
        EXPECT_EQ(saved.picture.Point(50, 10), static_cast<std::int32_t>(color)) << value << " by a load of what was set";
    }
}

TEST(ScoreCardFlashCard, CoversTheWholeSurface) {
    Card card({{"Style", style::flashCard}, {"Value", 0.9}});
    for (const auto& [x, y] : {std::pair{0.0f, 0.0f}, {longSide - 1, 0.0f}, {0.0f, shortSide - 1}, {longSide - 1, shortSide - 1}})
        EXPECT_EQ(card.picture.Point(x, y), static_cast<std::int32_t>(cyan)) << x << " " << y;
}

TEST(ScoreCardFlashCard, FollowsTheSizeAndTheBorder) {
    Card card({{"Style", style::flashCard}});
    card.host.SiteOf(card.control)->SetSize(Outer(40), Outer(30));
    EXPECT_THAT(card.Drawn(), ElementsAre("Cls", BoxText(0, 0, 40, 30, yellow)));
    card.Put("BorderStyle", 0);
    EXPECT_THAT(card.Drawn(), ElementsAre("Cls", BoxText(0, 0, 44, 34, yellow)));
}

TEST(ScoreCardFlashCard, ShowsNothingOfAGauge) {
    Card card(GaugeBag({{"Style", style::flashCard},
                        {"ShowBlocks", 5},
                        {"ShowTickLinesEvery", 10},
                        {"ShowLimitLines", true},
                        {"ShowMarker", 2},
                        {"ShowValue", 2}}));
    EXPECT_THAT(card.Redrawn(), ElementsAre("Cls", BoxText(0, 0, longSide, shortSide, yellow)));
}

TEST(ScoreCardFlashCard, IsDrawnWhereTheLimitsAreEqualToo) {
    Card card({{"Style", style::flashCard}, {"ScoreMin", 3}, {"ScoreMax", 3}});
    EXPECT_THAT(card.Redrawn(), ElementsAre("Cls", BoxText(0, 0, longSide, shortSide, yellow)));
}

// The tool tip.

/// The tip of a card with this value and style of tip.
std::string TipOf(const Variant& value, int tipStyle, const std::string& text) {
    return Card({{"Value", value}, {"ToolTipStyle", tipStyle}, {"ToolTip", text}}).ToolTip();
}

TEST(ScoreCardToolTip, IsABlankAndThePercentageAtFirst) { EXPECT_EQ(Card().ToolTip(), " 50%"); }

TEST(ScoreCardToolTip, ShowsWhatItsStyleSays) {
    EXPECT_EQ(TipOf(0.5, 0, "Score"), "");
    EXPECT_EQ(TipOf(0.5, 1, "Score"), "Score");
    EXPECT_EQ(TipOf(0.5, 2, "Score"), "50%");
    EXPECT_EQ(TipOf(0.5, 3, "Score"), "Score 50%");
    EXPECT_EQ(TipOf(0.5, 4, "Score"), "");
    EXPECT_EQ(TipOf(0.5, -1, "Score"), "");
}

TEST(ScoreCardToolTip, GivesTheValueAsAPercentageInWholeNumbers) {
    const std::pair<Variant, const char*> tips[] = {{0, "0%"},       {1, "100%"},         {0.93, "93%"}, {0.123, "12%"},
                                                    {0.126, "13%"},  {0.29f, "29%"},      {1.5, "150%"}, {50, "5000%"},
                                                    {-0.25, "-25%"}, {1e6, "100000000%"}, {0.001, "0%"}, {0.999, "100%"}};
    for (const auto& [value, tip] : tips) EXPECT_EQ(TipOf(value, 2, ""), tip);
}

TEST(ScoreCardToolTip, IsSetAtEachRedrawOfEveryStyle) {
    for (const int value : {style::scoreCardSmall, style::flashCard, style::gauge, 12}) {
        Card card({{"Style", value}, {"ToolTip", "Score"}});
        EXPECT_EQ(card.ToolTip(), "Score 50%") << value;
        card.Put("Value", 0.75);
        EXPECT_EQ(card.ToolTip(), "Score 75%") << value;
    }
}

TEST(ScoreCardToolTip, ANewTextOrStyleShowsAtTheNextRedraw) {
    Card card;
    card.Put("ToolTip", "Score");
    EXPECT_EQ(card.ToolTip(), " 50%");
    card.Put("ToolTipStyle", 1);
    EXPECT_EQ(card.ToolTip(), " 50%");
    card.Put("Value", 0.75);
    EXPECT_EQ(card.ToolTip(), "Score");
}

TEST(ScoreCardToolTip, StaysAsItIsAtDesignTime) {
    Card card(Options{.placedNew = true, .designTime = true});
    EXPECT_EQ(card.ToolTip(), "");
    card.Put("ToolTip", "Score");
    card.Put("Value", 0.75);
    EXPECT_EQ(card.ToolTip(), "");
}

TEST(ScoreCardToolTip, AsksForTheModeAtEachRedraw) {
    Card card(Options{.placedNew = true, .designTime = true});
    card.host.SiteOf(card.control)->SetUserMode(true);
    card.Put("Value", 0.75);
    EXPECT_EQ(card.ToolTip(), " 75%");
    card.host.SiteOf(card.control)->SetUserMode(false);
    card.Put("Value", 0.25);
    EXPECT_EQ(card.ToolTip(), " 75%");
}

TEST(ScoreCardToolTip, DoesNotReadTheOneOfTheHost) {
    HostUnderTest host;
    frame::Control& control =
        host.Create(ScoreCardClass(), "ScoreCard1", {.extender = {{"ToolTipText", Variant("The host's own")}}});
    control.Put("Value", 0.75);
    EXPECT_EQ(PictureOf(control).ToolTipText(), " 75%");
}

}  // namespace
}  // namespace tessel::controls
