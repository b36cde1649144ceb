#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <string_view>
#include <tuple>
#include <utility>
#include <vector>

#include "tests/HostUnderTest.h"
#include "tests/controls/splitter/SplitterTestHelp.h"

/// How the splitter draws itself: in pixels, 15 twips each.
namespace tessel::controls {
namespace {

using frame::OLE_COLOR;
using frame::ScaleModeConstants;
using test::HostUnderTest;
using testing::ElementsAre;
using testing::IsEmpty;
using namespace splittertest;

constexpr int twips = 15;  // a pixel

/// A bar of so many pixels with its own recorder.
class Painted {
  public:
    Painted(int orientation, int appearance, int width, int height) {
        bar.Put("Orientation", orientation);
        bar.Put("Appearance", appearance);
        host.SiteOf(bar)->SetSize(static_cast<float>(width * twips), static_cast<float>(height * twips));
        bar.Surface().AddCanvas(canvas);
    }
    std::vector<std::string> Paint() {
        canvas.operations.clear();
        bar.Paint();
        return Drawn(canvas);
    }

    frame::RecordingCanvas canvas;
    HostUnderTest host;
    frame::Control& bar = host.Create(SplitterClass(), "Splitter1");
};

// Each appearance in full.

TEST(SplitterDrawing, NoneIsTheFillAlone) {
    EXPECT_THAT(Painted(horizontal, none, 20, 8).Paint(), ElementsAre("fill 0,0-19,7 8000000F"));
    EXPECT_THAT(Painted(vertical, none, 8, 20).Paint(), ElementsAre("fill 0,0-7,19 8000000F"));
}

TEST(SplitterDrawing, FlatHasABoxInTheForeColour) {
    EXPECT_THAT(Painted(horizontal, flat, 20, 8).Paint(), ElementsAre("fill 0,0-19,7 8000000F", "box 0,0-19,7 80000012"));
    EXPECT_THAT(Painted(vertical, flat, 8, 20).Paint(), ElementsAre("fill 0,0-7,19 8000000F", "box 0,0-7,19 80000012"));
}

TEST(SplitterDrawing, SunkenIsDarkAboveAndAtTheLeft) {
    EXPECT_THAT(Painted(horizontal, sunken, 20, 8).Paint(),
                ElementsAre("fill 0,0-19,7 8000000F", "box 0,0-19,7 H", "box 1,1-18,6 L", "line 0,7-0,0 S", "line 0,0-19,0 S",
                            "line 1,6-1,1 D", "line 1,1-18,1 D"));
    EXPECT_THAT(Painted(vertical, sunken, 8, 20).Paint(),
                ElementsAre("fill 0,0-7,19 8000000F", "box 0,0-7,19 H", "box 1,1-6,18 L", "line 0,19-0,0 S", "line 0,0-7,0 S",
                            "line 1,18-1,1 D", "line 1,1-6,1 D"));
}

TEST(SplitterDrawing, RaisedIsDarkBelowAndAtTheRight) {
    EXPECT_THAT(Painted(horizontal, raised, 20, 8).Paint(),
                ElementsAre("fill 0,0-19,7 8000000F", "box 0,0-19,7 H", "box 1,1-18,6 L", "line 0,7-19,7 D", "line 19,7-19,0 D",
                            "line 1,6-18,6 S", "line 18,6-18,1 S"));
    EXPECT_THAT(Painted(vertical, raised, 8, 20).Paint(),
                ElementsAre("fill 0,0-7,19 8000000F", "box 0,0-7,19 H", "box 1,1-6,18 L", "line 0,19-7,19 D", "line 7,19-7,0 D",
                            "line 1,18-6,18 S", "line 6,18-6,1 S"));
}

TEST(SplitterDrawing, GroovedHasAGrooveAlongItsMiddle) {
    EXPECT_THAT(Painted(horizontal, grooved, 20, 8).Paint(),
                ElementsAre("fill 0,0-19,7 8000000F", "box 0,0-19,7 H", "box 1,1-18,6 L", "line 0,7-19,7 D", "line 19,7-19,0 D",
                            "line 1,6-18,6 S", "line 18,6-18,1 S", "line 5,3-15,3 S", "line 5,4-15,4 H"));
    EXPECT_THAT(Painted(vertical, grooved, 8, 20).Paint(),
                ElementsAre("fill 0,0-7,19 8000000F", "box 0,0-7,19 H", "box 1,1-6,18 L", "line 0,19-7,19 D", "line 7,19-7,0 D",
                            "line 1,18-6,18 S", "line 6,18-6,1 S", "line 3,5-3,15 S", "line 4,5-4,15 H"));
}

TEST(SplitterDrawing, TheGrooveOfAnOddThicknessStandsAtTheWholePartOfItsHalf) {
    const auto lying = Painted(horizontal, grooved, 20, 9).Paint();
    ASSERT_EQ(lying.size(), 9u);
    EXPECT_EQ(lying[7], "line 5,3-15,3 S");
    EXPECT_EQ(lying[8], "line 5,4-15,4 H");
    const auto standing = Painted(vertical, grooved, 9, 20).Paint();
    ASSERT_EQ(standing.size(), 9u);
    EXPECT_EQ(standing[7], "line 3,5-3,15 S");
    EXPECT_EQ(standing[8], "line 4,5-4,15 H");
}

TEST(SplitterDrawing, SerratedHasDoubleLinesFourPixelsApart) {
    EXPECT_THAT(Painted(horizontal, serrated, 20, 8).Paint(),
                ElementsAre("fill 0,0-19,7 8000000F", "box 0,0-19,7 H", "box 1,1-18,6 L", "line 0,7-19,7 D", "line 19,7-19,0 D",
                            "line 1,6-18,6 S", "line 18,6-18,1 S", "line 5,3-5,5 H", "line 6,3-6,5 S", "line 9,3-9,5 H",
                            "line 10,3-10,5 S", "line 13,3-13,5 H", "line 14,3-14,5 S"));
    EXPECT_THAT(Painted(vertical, serrated, 8, 20).Paint(),
                ElementsAre("fill 0,0-7,19 8000000F", "box 0,0-7,19 H", "box 1,1-6,18 L", "line 0,19-7,19 D", "line 7,19-7,0 D",
                            "line 1,18-6,18 S", "line 6,18-6,1 S", "line 3,5-5,5 H", "line 3,6-5,6 S", "line 3,9-5,9 H",
                            "line 3,10-5,10 S", "line 3,13-5,13 H", "line 3,14-5,14 S"));
}

TEST(SplitterDrawing, TheLastDoubleLineMayStandJustAtTheEnd) {
    // R is 18: 13 is just R - 5. With R = 17 it is past the end.
    EXPECT_EQ(Painted(horizontal, serrated, 19, 8).Paint().size(), 7u + 6u);
    EXPECT_EQ(Painted(horizontal, serrated, 18, 8).Paint().size(), 7u + 4u);
    EXPECT_EQ(Painted(vertical, serrated, 8, 19).Paint().size(), 7u + 6u);
    EXPECT_EQ(Painted(vertical, serrated, 8, 18).Paint().size(), 7u + 4u);
}

TEST(SplitterDrawing, AnAppearanceWithoutANameHasNoBorder) {
    EXPECT_THAT(Painted(horizontal, 9, 20, 8).Paint(), ElementsAre("fill 0,0-19,7 8000000F"));
}

// Every appearance at several sizes.

/// The operations worked out from the rules, for whole pixels.
std::vector<std::string> Expected(int orientation, int appearance, int width, int height, const std::string& fill) {
    const int r = width - 1, b = height - 1;
    std::vector<std::string> ops;
    const auto add = [&](std::string_view kind, int x1, int y1, int x2, int y2, const std::string& color) {
        ops.push_back(LineText(kind, x1, y1, x2, y2, color));
    };
    add("fill", 0, 0, r, b, fill);
    if (appearance == flat) add("box", 0, 0, r, b, "80000012");
    if (appearance >= raised) {
        add("box", 0, 0, r, b, "H");
        add("box", 1, 1, r - 1, b - 1, "L");
    }
    if (appearance == sunken) {
        add("line", 0, b, 0, 0, "S");
        add("line", 0, 0, r, 0, "S");
        add("line", 1, b - 1, 1, 1, "D");
        add("line", 1, 1, r - 1, 1, "D");
    } else if (appearance >= raised) {
        add("line", 0, b, r, b, "D");
        add("line", r, b, r, 0, "D");
        add("line", 1, b - 1, r - 1, b - 1, "S");
        add("line", r - 1, b - 1, r - 1, 1, "S");
    }
    if (appearance == grooved && orientation == horizontal) {
        const int m = height / 2, e = width - 5;
        add("line", 5, m - 1, e, m - 1, "S");
        add("line", 5, m, e, m, "H");
    } else if (appearance == grooved) {
        const int m = width / 2, e = height - 5;
        add("line", m - 1, 5, m - 1, e, "S");
        add("line", m, 5, m, e, "H");
    }
    const int end = (orientation == horizontal ? r : b) - 5;
    for (int at = 5; appearance == serrated && at <= end; at += 4) {
        if (orientation == horizontal) {
            add("line", at, 3, at, b - 2, "H");
            add("line", at + 1, 3, at + 1, b - 2, "S");
        } else {
            add("line", 3, at, r - 2, at, "H");
            add("line", 3, at + 1, r - 2, at + 1, "S");
        }
    }
    return ops;
}

class SplitterLook : public testing::TestWithParam<std::tuple<int, int>> {
  protected:
    int Orientation() const { return std::get<0>(GetParam()); }
    int Appearance() const { return std::get<1>(GetParam()); }
};

INSTANTIATE_TEST_SUITE_P(Looks, SplitterLook, testing::Combine(testing::Values(0, 1), testing::Range(0, 6)));

constexpr std::pair<int, int> sizes[] = {{0, 0}, {1, 1},  {2, 2},   {5, 3},   {8, 8},    {11, 11},  {12, 7},
                                         {0, 8}, {20, 0}, {400, 8}, {8, 266}, {101, 57}, {37, 203}, {800, 600}};

TEST_P(SplitterLook, AllOperationsComeInOrderAtEverySize) {
    for (const auto& [width, height] : sizes) {
        Painted painted(Orientation(), Appearance(), width, height);
        EXPECT_EQ(painted.Paint(), Expected(Orientation(), Appearance(), width, height, "8000000F")) << width << " x " << height;
    }
}

TEST_P(SplitterLook, TheHighlightChangesTheFillAlone) {
    Painted painted(Orientation(), Appearance(), 40, 40);
    MoveTo(painted.bar, 300, 300);
    EXPECT_EQ(painted.Paint(), Expected(Orientation(), Appearance(), 40, 40, "C0C000"));
    MoveTo(painted.bar, 0, 0);
    EXPECT_EQ(painted.Paint(), Expected(Orientation(), Appearance(), 40, 40, "8000000F"));
}

TEST_P(SplitterLook, TheScaleIsInPixelsWhileItDrawsAndInTwipsAfterwards) {
    struct Watching final : frame::Canvas {
        void Draw(const frame::DrawOp&, const frame::Pen& pen, const frame::Scale& scale, OLE_COLOR, OLE_COLOR) override {
            ++operations;
            wrong += scale == frame::Scale{} && pen == frame::Pen{} ? 0 : 1;
        }
        int operations = 0, wrong = 0;
    };
    for (const auto& [width, height] : sizes) {
        Watching watching;
        Painted painted(Orientation(), Appearance(), width, height);
        painted.bar.Surface().AddCanvas(watching);
        painted.bar.Paint();
        painted.bar.Surface().RemoveCanvas(watching);
        EXPECT_GT(watching.operations, 0);
        EXPECT_EQ(watching.wrong, 0);
        EXPECT_EQ(painted.bar.Surface().ScaleMode(), ScaleModeConstants::Twips) << width << " x " << height;
        EXPECT_EQ(painted.bar.Surface().ScaleWidth(), static_cast<float>(width * twips));
    }
}

TEST_P(SplitterLook, EveryPathOfDrawingLeavesTheScaleInTwips) {
    Painted painted(Orientation(), Appearance(), 40, 40);
    const auto mode = [&] { return painted.bar.Surface().ScaleMode(); };
    painted.bar.Put("BackColor", OLE_COLOR(0x123456));
    EXPECT_EQ(mode(), ScaleModeConstants::Twips);
    painted.bar.Put("Appearance", Appearance());
    EXPECT_EQ(mode(), ScaleModeConstants::Twips);
    MoveTo(painted.bar, 300, 300);
    EXPECT_EQ(mode(), ScaleModeConstants::Twips);
    MoveTo(painted.bar, 0, 0);
    EXPECT_EQ(mode(), ScaleModeConstants::Twips);
}

TEST(SplitterDrawing, TheEdgesHaveTheColoursOfTheSystemWhateverTheBarsOwnColours) {
    Painted painted(horizontal, sunken, 20, 8);
    painted.bar.Put("BackColor", OLE_COLOR(0x112233));
    painted.bar.Put("ForeColor", OLE_COLOR(0x445566));
    EXPECT_THAT(painted.Paint(), ElementsAre("fill 0,0-19,7 112233", "box 0,0-19,7 H", "box 1,1-18,6 L", "line 0,7-0,0 S",
                                             "line 0,0-19,0 S", "line 1,6-1,1 D", "line 1,1-18,1 D"));
}

// When it draws.

class SplitterRedraw : public testing::Test {
  protected:
    SplitterRedraw() {
        stage.Lay(horizontal, 0, 1000, 3000, 1050);
        stage.Bar().Put("Appearance", none);
        stage.Forget();
    }
    std::vector<std::string> DrawnBy(const std::function<void()>& act) {
        stage.canvas.operations.clear();
        act();
        return Drawn(stage.canvas);
    }

    Stage stage;
};

TEST_F(SplitterRedraw, BackColorDrawsAtOnce) {
    EXPECT_THAT(DrawnBy([&] { stage.Bar().Put("BackColor", OLE_COLOR(0x123456)); }), ElementsAre("fill 0,0-199,69 123456"));
}

TEST_F(SplitterRedraw, AppearanceDrawsAtOnce) {
    EXPECT_THAT(DrawnBy([&] { stage.Bar().Put("Appearance", flat); }),
                ElementsAre("fill 0,0-199,69 8000000F", "box 0,0-199,69 80000012"));
}

TEST_F(SplitterRedraw, ASetToTheSameValueDrawsToo) {
    EXPECT_THAT(DrawnBy([&] { stage.Bar().Put("BackColor", OLE_COLOR(0x8000000Fu)); }), ElementsAre("fill 0,0-199,69 8000000F"));
    EXPECT_THAT(DrawnBy([&] { stage.Bar().Put("Appearance", none); }), ElementsAre("fill 0,0-199,69 8000000F"));
}

TEST_F(SplitterRedraw, ThePropertyIsReportedBeforeTheDrawing) {
    std::size_t drawnBefore = 0;
    stage.onPropertyChanged = [&](std::string_view) { drawnBefore += stage.canvas.operations.size(); };
    stage.Bar().Put("BackColor", OLE_COLOR(0x123456));
    EXPECT_EQ(drawnBefore, 0u);
    EXPECT_EQ(stage.canvas.operations.size(), 1u);
    stage.canvas.operations.clear();
    stage.Bar().Put("Appearance", none);
    EXPECT_EQ(drawnBefore, 0u);
    EXPECT_EQ(stage.canvas.operations.size(), 1u);
}

TEST_F(SplitterRedraw, NoOtherSetterDraws) {
    const std::vector<std::pair<std::string, frame::Variant>> values = {{"ForeColor", OLE_COLOR(1)},
                                                                        {"HighlightColor", OLE_COLOR(2)},
                                                                        {"Enabled", false},
                                                                        {"MousePointer", 2},
                                                                        {"MinTopLeft", 100},
                                                                        {"MinBottomRight", 100},
                                                                        {"ControlsTopLeft", "a"},
                                                                        {"ControlsBottomRight", "b"},
                                                                        {"Orientation", vertical},
                                                                        {"Ident", 4},
                                                                        {"MouseIcon", frame::ObjectRef()}};
    for (const auto& [name, value] : values)
        EXPECT_THAT(DrawnBy([&, key = name, kept = value] { stage.Bar().Put(key, kept); }), IsEmpty()) << name;
}

TEST_F(SplitterRedraw, ANewHighlightColourShowsAtTheNextDrawing) {
    MoveTo(stage.Bar(), 500, 500);
    EXPECT_THAT(DrawnBy([&] { stage.Bar().Put("HighlightColor", OLE_COLOR(0x777777)); }), IsEmpty());
    EXPECT_THAT(DrawnBy([&] { stage.Bar().Paint(); }), ElementsAre("fill 0,0-199,69 777777"));
}

TEST_F(SplitterRedraw, BackColorOfAHighlightedBarIsStoredAndTheHighlightDrawn) {
    MoveTo(stage.Bar(), 500, 500);
    EXPECT_THAT(DrawnBy([&] { stage.Bar().Put("BackColor", OLE_COLOR(0x123456)); }), ElementsAre("fill 0,0-199,69 C0C000"));
}

TEST_F(SplitterRedraw, RefreshDrawsTheSurfaceAnew) {
    EXPECT_THAT(DrawnBy([&] { stage.Bar().Call("Refresh"); }), ElementsAre("fill 0,0-199,69 8000000F"));
    constexpr int refresh = -550;
    EXPECT_THAT(DrawnBy([&] { stage.Bar().Call(refresh); }), ElementsAre("fill 0,0-199,69 8000000F"));
}

TEST_F(SplitterRedraw, AChangeOfSizeDrawsNothingByItself) {
    EXPECT_THAT(DrawnBy([&] { stage.Site().SetSize(4000, 500); }), IsEmpty());
}

TEST_F(SplitterRedraw, ShowHideAndAChangedAmbientPropertyDrawNothing) {
    EXPECT_THAT(DrawnBy([&] {
                    stage.Site().Hide();
                    stage.Site().Show();
                    for (const auto* name : {"UserMode", "Font", "DisplayName", ""}) stage.Site().AmbientChanged(name);
                }),
                IsEmpty());
    EXPECT_THAT(stage.deeds, IsEmpty());
}

TEST_F(SplitterRedraw, PaintDrawsEachTimeAnew) {
    EXPECT_EQ(DrawnBy([&] {
                  stage.Bar().Paint();
                  stage.Bar().Paint();
              }).size(),
              2u);
}

}  // namespace
}  // namespace tessel::controls
