#include "frame/Surface.h"

#include <gtest/gtest.h>

#include <functional>
#include <limits>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "hosts/headless/HeadlessHost.h"
#include "hosts/headless/HostObject.h"
#include "tests/frame/TestControl.h"

namespace tessel::frame {
namespace {

using enum ScaleModeConstants;
using test::ErrorOf;

constexpr float nan = std::numeric_limits<float>::quiet_NaN();
constexpr float infinity = std::numeric_limits<float>::infinity();

/// Keeps some pixels, and nothing of what is drawn.
class FewPixels final : public Canvas {
  public:
    void Draw(const DrawOp&, const Pen&, const Scale&, OLE_COLOR, OLE_COLOR) override {}
    bool KeepsPixels() const override { return true; }
    std::optional<OLE_COLOR> Pixel(int x, int y) const override {
        const auto found = pixels.find({x, y});
        return found != pixels.end() ? std::optional(found->second) : std::nullopt;
    }
    std::vector<PixelPlane> Planes() const override { return {PixelPlane{1, 1, 1, {0xFF123456}}}; }

    std::map<std::pair<int, int>, OLE_COLOR> pixels;
};

/// 200 by 100 pixels.
class SmallSurface final : public DrawingSurface {
  public:
    using DrawingSurface::DrawingSurface;

    TextSize inner{3000, 1500};
    int looks = 0;

  protected:
    TextSize InnerSize() const override { return inner; }
    void LookChanged() override { ++looks; }
};

/// Keeps with what each operation was drawn.
class WatchingCanvas final : public Canvas {
  public:
    void Draw(const DrawOp&, const Pen& withPen, const Scale& withScale, OLE_COLOR behind, OLE_COLOR before) override {
        pen = withPen;
        scale = withScale;
        background = behind;
        foreground = before;
    }

    Pen pen;
    Scale scale;
    OLE_COLOR background, foreground;
};

struct Surfaces : testing::Test {
    Surfaces() {
        surface.AddCanvas(canvas);
        surface.AddCanvas(kept);
    }
    std::vector<DrawOp> Drawn() { return std::exchange(canvas.operations, {}); }
    std::pair<float, float> Position() const { return {surface.CurrentX(), surface.CurrentY()}; }
    void GoTo(float x, float y) {
        surface.SetCurrentX(x);
        surface.SetCurrentY(y);
    }

    headless::HeadlessHost host;
    RecordingCanvas canvas;
    FewPixels kept;
    SmallSurface surface{host.Frame()};
};

using Operations = std::vector<DrawOp>;
using Place = std::pair<float, float>;

// Operations

TEST_F(Surfaces, ALineEndsAtItsEnd) {
    surface.Line(1, 2, 30, 40, OLE_COLOR(255));
    EXPECT_EQ(Drawn(), (Operations{draw::Line{1, 2, 30, 40, 255, draw::Box::None}}));
    EXPECT_EQ(Position(), Place(30, 40));
}

TEST_F(Surfaces, ABoxEndsAtItsSecondCorner) {
    surface.Line(1, 2, 30, 40, OLE_COLOR(255), draw::Box::Outline);
    surface.Line(50, 60, 3, 4, OLE_COLOR(1), draw::Box::Filled);
    EXPECT_EQ(Drawn(),
              (Operations{draw::Line{1, 2, 30, 40, 255, draw::Box::Outline}, draw::Line{50, 60, 3, 4, 1, draw::Box::Filled}}));
    EXPECT_EQ(Position(), Place(3, 4));
}

TEST_F(Surfaces, WithoutAColorTheForeColorDraws) {
    surface.SetForeColor(0x123456);
    surface.Line(0, 0, 1, 1);
    surface.Circle(0, 0, 1);
    surface.PSet(0, 0);
    EXPECT_EQ(Drawn(), (Operations{draw::Line{0, 0, 1, 1, 0x123456, draw::Box::None}, draw::Circle{0, 0, 1, 0x123456, {}, {}, {}},
                                   draw::PSet{0, 0, 0x123456}}));
}

TEST_F(Surfaces, ACircleEndsAtItsCentre) {
    surface.Circle(10, 20, 5, OLE_COLOR(255));
    surface.Circle(30, 40, 5, OLE_COLOR(255), 0.5f, 1.5f, 2.0f);
    EXPECT_EQ(Drawn(), (Operations{draw::Circle{10, 20, 5, 255, {}, {}, {}}, draw::Circle{30, 40, 5, 255, 0.5f, 1.5f, 2.0f}}));
    EXPECT_EQ(Position(), Place(30, 40));
}

TEST_F(Surfaces, APointEndsWhereItIs) {
    surface.PSet(7, 8, OLE_COLOR(9));
    EXPECT_EQ(Drawn(), (Operations{draw::PSet{7, 8, 9}}));
    EXPECT_EQ(Position(), Place(7, 8));
}

TEST_F(Surfaces, PrintingGoesToTheStartOfTheNextLine) {
    GoTo(100, 200);
    surface.Print("one");
    surface.Print("two\nlines");
    surface.Print("");
    EXPECT_EQ(Drawn(), (Operations{draw::Print{"one", 100, 200}, draw::Print{"two\nlines", 0, 395}, draw::Print{"", 0, 785}}));
    EXPECT_EQ(Position(), Place(0, 980));
}

TEST_F(Surfaces, PaintingAPictureLeavesThePositionAlone) {
    const auto picture = std::make_shared<Picture>(150.0f, 150.0f, "a.bmp");
    GoTo(1, 2);
    surface.PaintPicture(picture, 10, 20);
    EXPECT_EQ(Drawn(), (Operations{draw::PaintPicture{10, 20, picture}}));
    EXPECT_EQ(Position(), Place(1, 2));
    EXPECT_EQ(ErrorOf([&] { surface.PaintPicture(nullptr, 0, 0); }), errors::invalidPicture);
    EXPECT_TRUE(Drawn().empty());
}

TEST_F(Surfaces, ClearingGoesToTheOrigin) {
    GoTo(100, 200);
    surface.Cls();
    EXPECT_EQ(Drawn(), (Operations{draw::Cls{}}));
    EXPECT_EQ(Position(), Place(0, 0));
    surface.SetScaleLeft(-5);
    surface.SetScaleTop(10);
    surface.Cls();
    EXPECT_EQ(Position(), Place(-5, 10));
}

TEST_F(Surfaces, EveryCanvasGetsEveryOperationUntilItIsRemoved) {
    RecordingCanvas other;
    surface.AddCanvas(other);
    surface.Cls();
    surface.RemoveCanvas(canvas);
    surface.PSet(1, 1, OLE_COLOR(0));
    EXPECT_EQ(Drawn(), (Operations{draw::Cls{}}));
    EXPECT_EQ(other.operations.size(), 2u);
}

TEST_F(Surfaces, WithoutAnyCanvasThePositionStillMoves) {
    surface.RemoveCanvas(canvas);
    surface.Line(0, 0, 5, 6);
    surface.Print("x");
    EXPECT_EQ(Position(), Place(0, 201));
}

// The pen

TEST_F(Surfaces, ThePenIsThinSolidAndCopiesAtFirst) {
    EXPECT_EQ(surface.DrawWidth(), 1);
    EXPECT_EQ(surface.DrawStyle(), draw::solid);
    EXPECT_EQ(surface.DrawMode(), draw::copyPen);
}

TEST_F(Surfaces, APenThatIsSetToWhatItIsIsNotReported) {
    surface.SetDrawWidth(1);
    surface.SetDrawStyle(0);
    surface.SetDrawMode(13);
    EXPECT_TRUE(Drawn().empty());
}

TEST_F(Surfaces, AChangeOfThePenIsReportedOnceBeforeWhatItDraws) {
    surface.SetDrawWidth(3);
    surface.SetDrawWidth(3);
    surface.SetDrawStyle(draw::dot);
    surface.SetDrawStyle(draw::dot);
    surface.SetDrawMode(draw::xorPen);
    surface.SetDrawMode(draw::xorPen);
    surface.PSet(0, 0, OLE_COLOR(0));
    EXPECT_EQ(Drawn(),
              (Operations{draw::DrawWidth{3}, draw::DrawStyle{draw::dot}, draw::DrawMode{draw::xorPen}, draw::PSet{0, 0, 0}}));
}

TEST_F(Surfaces, AWidthBelowOneIsRefused) {
    EXPECT_EQ(ErrorOf([&] { surface.SetDrawWidth(0); }), errors::invalidValue);
    EXPECT_EQ(ErrorOf([&] { surface.SetDrawWidth(-1); }), errors::invalidValue);
    EXPECT_EQ(surface.DrawWidth(), 1);
    surface.SetDrawWidth(32'767);
    EXPECT_EQ(surface.DrawWidth(), 32'767);
}

TEST_F(Surfaces, AStyleOutsideZeroToSixIsRefused) {
    for (const int style : {-1, 7})
        EXPECT_EQ(ErrorOf([&] { surface.SetDrawStyle(static_cast<std::int16_t>(style)); }), errors::invalidValue);
    for (const int style : {0, 6}) EXPECT_EQ(ErrorOf([&] { surface.SetDrawStyle(static_cast<std::int16_t>(style)); }), 0);
    EXPECT_EQ(surface.DrawStyle(), 6);
}

TEST_F(Surfaces, AModeOutsideOneToSixteenIsRefused) {
    for (const int mode : {-1, 0, 17})
        EXPECT_EQ(ErrorOf([&] { surface.SetDrawMode(static_cast<std::int16_t>(mode)); }), errors::invalidValue);
    for (const int mode : {1, 16}) EXPECT_EQ(ErrorOf([&] { surface.SetDrawMode(static_cast<std::int16_t>(mode)); }), 0);
    EXPECT_EQ(surface.DrawMode(), 16);
}

TEST_F(Surfaces, ARefusedPenIsNotReported) {
    ErrorOf([&] { surface.SetDrawWidth(0); });
    ErrorOf([&] { surface.SetDrawStyle(9); });
    ErrorOf([&] { surface.SetDrawMode(0); });
    EXPECT_TRUE(Drawn().empty());
}

TEST_F(Surfaces, AnOperationComesWithPenScaleAndColors) {
    WatchingCanvas watching;
    surface.AddCanvas(watching);
    surface.SetDrawWidth(2);
    surface.SetDrawStyle(draw::dash);
    surface.SetDrawMode(draw::invert);
    surface.SetBackColor(colors::windowBackground);
    surface.SetForeColor(0x7F123456);
    surface.Cls();
    EXPECT_EQ(watching.pen, (Pen{2, draw::dash, draw::invert}));
    EXPECT_EQ(watching.scale, (Scale{0, 0, 1 / 15.0f, 1 / 15.0f}));
    EXPECT_EQ(watching.background, OLE_COLOR(0xFFFFFF));
    EXPECT_EQ(watching.foreground, OLE_COLOR(0x123456));
    surface.SetScaleMode(Pixels);
    surface.Cls();
    EXPECT_EQ(watching.scale, (Scale{0, 0, 1, 1}));
}

// Scales

TEST_F(Surfaces, IsInTwipsAtFirst) {
    EXPECT_EQ(surface.ScaleMode(), Twips);
    EXPECT_EQ(surface.ScaleLeft(), 0);
    EXPECT_EQ(surface.ScaleTop(), 0);
    EXPECT_EQ(surface.ScaleWidth(), 3000);
    EXPECT_EQ(surface.ScaleHeight(), 1500);
}

TEST_F(Surfaces, TellsItsSizeInEachUnit) {
    const std::pair<ScaleModeConstants, TextSize> sizes[] = {{Twips, {3000, 1500}},
                                                             {Points, {150, 75}},
                                                             {Pixels, {200, 100}},
                                                             {Characters, {25, 6.25f}},
                                                             {Inches, {2.083333f, 1.041667f}},
                                                             {Millimetres, {52.91667f, 26.45833f}},
                                                             {Centimetres, {5.291667f, 2.645833f}}};
    for (const auto& [mode, size] : sizes) {
        surface.SetScaleMode(mode);
        EXPECT_EQ(surface.ScaleMode(), mode);
        EXPECT_FLOAT_EQ(surface.ScaleWidth(), size.width);
        EXPECT_FLOAT_EQ(surface.ScaleHeight(), size.height);
    }
}

TEST_F(Surfaces, ANewScaleTakesTheCurrentPositionAlong) {
    const std::pair<ScaleModeConstants, Place> places[] = {{Pixels, {100, 20}},
                                                           {Points, {75, 15}},
                                                           {Characters, {12.5f, 1.25f}},
                                                           {Inches, {1500 / 1440.0f, 300 / 1440.0f}},
                                                           {Centimetres, {2.645833f, 0.5291667f}},
                                                           {Millimetres, {26.45833f, 5.291667f}},
                                                           {Twips, {1500, 300}}};
    GoTo(1500, 300);
    for (const auto& [mode, place] : places) {
        surface.SetScaleMode(mode);
        EXPECT_FLOAT_EQ(surface.CurrentX(), place.first) << static_cast<int>(mode);
        EXPECT_FLOAT_EQ(surface.CurrentY(), place.second) << static_cast<int>(mode);
    }
}

TEST_F(Surfaces, AScaleOutsideZeroToSevenIsRefused) {
    for (const int mode : {-1, 8, 32'767})
        EXPECT_EQ(ErrorOf([&] { surface.SetScaleMode(static_cast<ScaleModeConstants>(mode)); }), errors::invalidValue);
    EXPECT_EQ(surface.ScaleMode(), Twips);
}

TEST_F(Surfaces, AUsersScaleBeginsAsTheOneThatWas) {
    surface.SetScaleMode(Pixels);
    GoTo(5, 6);
    surface.SetScaleMode(User);
    EXPECT_EQ(surface.ScaleMode(), User);
    EXPECT_EQ(surface.ScaleWidth(), 200);
    EXPECT_EQ(surface.ScaleHeight(), 100);
    EXPECT_EQ(Position(), Place(5, 6));
}

TEST_F(Surfaces, SettingOneBoundMakesTheScaleAUsersOwn) {
    const std::pair<const char*, std::function<void(float)>> bounds[] = {
        {"ScaleLeft", [&](float value) { surface.SetScaleLeft(value); }},
        {"ScaleTop", [&](float value) { surface.SetScaleTop(value); }},
        {"ScaleWidth", [&](float value) { surface.SetScaleWidth(value); }},
        {"ScaleHeight", [&](float value) { surface.SetScaleHeight(value); }},
    };
    for (const auto& [name, set] : bounds) {
        surface.SetScaleMode(Twips);
        set(10);
        EXPECT_EQ(surface.ScaleMode(), User) << name;
    }
    EXPECT_EQ(surface.ScaleWidth(), 3000);
    EXPECT_EQ(surface.ScaleHeight(), 10);
}

TEST_F(Surfaces, AUsersScaleHasItsOwnOriginSizeAndUnits) {
    WatchingCanvas watching;
    surface.AddCanvas(watching);
    surface.SetScaleLeft(-5);
    surface.SetScaleTop(2);
    surface.SetScaleWidth(10);
    surface.SetScaleHeight(-20);  // upwards
    surface.Cls();
    EXPECT_EQ(watching.scale, (Scale{-5, 2, 20, -5}));
    EXPECT_EQ(watching.scale.X(0), 100);
    EXPECT_EQ(watching.scale.Y(-18), 100);
}

TEST_F(Surfaces, AUsersScaleKeepsItsSizeWhenTheSurfaceGrows) {
    surface.SetScaleWidth(10);
    surface.inner = {6000, 1500};
    EXPECT_EQ(surface.ScaleWidth(), 10);
    surface.SetScaleMode(Pixels);
    EXPECT_EQ(surface.ScaleWidth(), 400);
}

TEST_F(Surfaces, LeavingAUsersScaleTakesThePositionAlongAndTheOriginAway) {
    surface.SetScaleLeft(2);
    surface.SetScaleTop(-1);
    surface.SetScaleWidth(10);
    surface.SetScaleHeight(10);
    GoTo(5, 4);
    surface.SetScaleMode(Pixels);
    EXPECT_EQ(Position(), Place(60, 50));
    EXPECT_EQ(surface.ScaleLeft(), 0);
    EXPECT_EQ(surface.ScaleTop(), 0);
}

TEST_F(Surfaces, ASizeOfNothingIsRefused) {
    EXPECT_EQ(ErrorOf([&] { surface.SetScaleWidth(0); }), errors::invalidValue);
    EXPECT_EQ(ErrorOf([&] { surface.SetScaleHeight(0); }), errors::invalidValue);
    EXPECT_EQ(surface.ScaleMode(), Twips);
    EXPECT_EQ(surface.ScaleWidth(), 3000);
}

TEST_F(Surfaces, ASurfaceWithoutAnySizeStillDraws) {
    surface.inner = {0, 0};
    surface.SetScaleMode(User);
    surface.Line(0, 0, 10, 10);
    surface.Print("x");
    surface.SetScaleMode(Pixels);
    EXPECT_EQ(surface.ScaleWidth(), 0);
    EXPECT_EQ(Drawn().size(), 2u);
}

TEST_F(Surfaces, MeasuresTextInItsUnits) {
    EXPECT_EQ(surface.TextWidth("abc"), 270);
    EXPECT_EQ(surface.TextHeight("abc"), 195);
    EXPECT_EQ(surface.TextHeight("a\nb"), 390);
    EXPECT_EQ(surface.TextWidth(""), 0);
    surface.SetScaleMode(Pixels);
    EXPECT_EQ(surface.TextWidth("abc"), 18);
    EXPECT_EQ(surface.TextHeight("abc"), 13);
    surface.SetScaleWidth(400);
    EXPECT_EQ(surface.TextWidth("abc"), 36);
}

TEST_F(Surfaces, PrintingAdvancesInItsUnitsFromItsOrigin) {
    surface.SetScaleMode(Pixels);
    surface.SetScaleLeft(-7);
    GoTo(1, 2);
    surface.Print("x");
    EXPECT_EQ(Position(), Place(-7, 15));
}

// Pixels

TEST_F(Surfaces, APointIsTheColorOfThePixelThatItFallsOn) {
    kept.pixels[{2, 1}] = 0x123456;
    EXPECT_EQ(surface.Point(30, 15), 0x123456);
    EXPECT_EQ(surface.Point(44.9f, 29.9f), 0x123456);
    EXPECT_EQ(surface.Point(29.9f, 15), -1);
    EXPECT_EQ(surface.Point(45, 15), -1);
    surface.SetScaleMode(Pixels);
    EXPECT_EQ(surface.Point(2, 1), 0x123456);
    EXPECT_EQ(surface.Point(2.9f, 1.9f), 0x123456);
    surface.SetScaleLeft(100);
    EXPECT_EQ(surface.Point(102, 1), 0x123456);
    EXPECT_EQ(surface.Point(2, 1), -1);
}

TEST_F(Surfaces, APointFallsOnThePixelTowardsMinusInfinity) {
    surface.SetScaleMode(Pixels);
    kept.pixels[{-1, 0}] = 1;
    EXPECT_EQ(surface.Point(-0.5f, 0), 1);
}

TEST_F(Surfaces, APointThatIsNowhereIsNoColor) {
    for (const float place : {infinity, -infinity, 1e30f, -1e30f}) EXPECT_EQ(surface.Point(place, place), -1);
    EXPECT_EQ(surface.Point(nan, nan), -1);
}

TEST_F(Surfaces, TheImageIsWhatTheFirstCanvasWithPixelsKeeps) {
    FewPixels second;
    surface.AddCanvas(second);
    second.pixels[{0, 0}] = 1;
    EXPECT_EQ(surface.Point(0, 0), -1);
    const PictureRef image = surface.Image();
    ASSERT_NE(image->Plane(1), nullptr);
    EXPECT_EQ(image->Plane(1)->pixels, std::vector<std::uint32_t>{0xFF123456});
    surface.RemoveCanvas(second);
}

TEST_F(Surfaces, WithoutACanvasThatKeepsPixelsThereIsNone) {
    surface.RemoveCanvas(kept);
    EXPECT_EQ(surface.Point(0, 0), -1);
    EXPECT_EQ(surface.Image()->Plane(1), nullptr);
}

TEST(PixelAt, StaysInBoundsForAnyValue) {
    EXPECT_EQ(PixelAt(1.9f), 1);
    EXPECT_EQ(PixelAt(-0.1f), -1);
    EXPECT_EQ(PixelAt(1e30f), 16'777'216);
    EXPECT_EQ(PixelAt(infinity), 16'777'216);
    EXPECT_EQ(PixelAt(-1e30f), -16'777'216);
    EXPECT_EQ(PixelAt(-infinity), -16'777'216);
    EXPECT_EQ(PixelAt(nan), 0);
}

// Look

TEST_F(Surfaces, TellsOfANewLookOnly) {
    surface.SetBackColor(colors::buttonFace);
    surface.SetForeColor(colors::buttonText);
    EXPECT_EQ(surface.looks, 0);
    surface.SetBackColor(1);
    surface.SetForeColor(2);
    const auto font = std::make_shared<Font>();
    surface.SetFont(font);
    EXPECT_EQ(surface.looks, 3);
    font->SetBold(true);
    EXPECT_EQ(surface.looks, 4);
    EXPECT_EQ(surface.Font(), font);
}

// A control's own surface

TEST_F(Surfaces, AControlsOwnSurfaceHasTheSizeOfItsSite) {
    test::WatchedSite site(host, "Test1");
    OwnSurface& own = site.Make<test::TestControl>().Surface();
    EXPECT_EQ(own.ScaleWidth(), 1200);
    own.SetWidth(3000);
    own.SetHeight(-5);
    EXPECT_EQ(site.Width(), 3000);
    EXPECT_EQ(own.Height(), 0);
    own.SetScaleMode(Pixels);
    EXPECT_EQ(own.ScaleWidth(), 200);
    EXPECT_EQ(own.Width(), 3000);
}

TEST_F(Surfaces, ABorderTakesTwoPixelsOnEachSideOfTheInside) {
    test::WatchedSite site(host, "Test1");
    OwnSurface& own = site.Make<test::TestControl>().Surface();
    own.SetBorderStyle(1);
    EXPECT_EQ(own.ScaleWidth(), 1140);
    EXPECT_EQ(own.ScaleHeight(), 540);
    own.SetHeight(50);
    EXPECT_EQ(own.ScaleHeight(), 0);
}

TEST_F(Surfaces, AControlsOwnSurfaceAsksItsSiteToRepaint) {
    test::WatchedSite site(host, "Test1");
    OwnSurface& own = site.Make<test::TestControl>().Surface();
    own.SetBackColor(1);
    own.SetEnabled(false);
    own.SetMousePointer(11);
    own.SetMouseIcon(std::make_shared<Picture>());
    own.SetAppearance(0);
    own.SetBorderStyle(1);
    own.SetPicture(std::make_shared<Picture>());
    own.Refresh();
    EXPECT_EQ(site.repaints, 8);
    EXPECT_FALSE(own.Enabled());
    EXPECT_EQ(own.MousePointer(), 11);
    EXPECT_EQ(own.Appearance(), 0);
    EXPECT_NE(own.MouseIcon(), nullptr);
    EXPECT_NE(own.Picture(), nullptr);
}

// By name

struct LateBound : Surfaces {
    LateBound() { form.AddCanvas(canvas); }
    Variant Call(const char* name, std::vector<Variant> arguments = {}) { return form.Call(name, arguments); }
    int Failure(const char* name, std::vector<Variant> arguments) {
        return ErrorOf([&] { form.Call(name, arguments); });
    }

    headless::SurfaceObject form{host.Frame(), "Form9", {}};
    Object& object = form;
};

TEST_F(LateBound, ALineIsDrawnByName) {
    Call("Line", {1, "2", 30.0, 40.5f});
    Call("LINE", {1, 2, 3, 4, 255});
    Call("line", {1, 2, 3, 4, 255, "B"});
    Call("Line", {1, 2, 3, 4, Variant::Missing(), "bf"});
    Call("Line", {1, 2, 3, 4, 0, ""});
    EXPECT_EQ(Drawn(), (Operations{draw::Line{1, 2, 30, 40.5f, colors::buttonText, draw::Box::None},
                                   draw::Line{1, 2, 3, 4, 255, draw::Box::None}, draw::Line{1, 2, 3, 4, 255, draw::Box::Outline},
                                   draw::Line{1, 2, 3, 4, colors::buttonText, draw::Box::Filled},
                                   draw::Line{1, 2, 3, 4, 0, draw::Box::None}}));
    EXPECT_EQ(object.Get("CurrentX").ToSingle(), 3);
}

TEST_F(LateBound, ALineWithUnknownFlagsIsRefused) {
    EXPECT_EQ(Failure("Line", {1, 2, 3, 4, 255, "F"}), errors::invalidCall);
    EXPECT_EQ(Failure("Line", {1, 2, 3, 4, 255, "B "}), errors::invalidCall);
    EXPECT_TRUE(Drawn().empty());
}

TEST_F(LateBound, ACircleIsDrawnByName) {
    Call("Circle", {1, 2, 3});
    Call("Circle", {1, 2, 3, 255, Variant::Missing(), Variant::Missing(), 0.5});
    EXPECT_EQ(Drawn(),
              (Operations{draw::Circle{1, 2, 3, colors::buttonText, {}, {}, {}}, draw::Circle{1, 2, 3, 255, {}, {}, 0.5f}}));
}

TEST_F(LateBound, MissingSurplusAndUnfitArgumentsAreRefused) {
    EXPECT_EQ(Failure("Line", {1, 2, 3}), errors::argumentMissing);
    EXPECT_EQ(Failure("Circle", {1, 2}), errors::argumentMissing);
    EXPECT_EQ(Failure("Line", {1, 2, 3, 4, 5, "", 7}), errors::wrongArguments);
    EXPECT_EQ(Failure("Cls", {1}), errors::wrongArguments);
    EXPECT_EQ(Failure("PSet", {"x", 1}), errors::typeMismatch);
    EXPECT_TRUE(Drawn().empty());
}

TEST_F(LateBound, TheOtherOperationsAreThereByName) {
    const auto picture = std::make_shared<Picture>(150.0f, 150.0f, "a.bmp");
    Call("Cls");
    Call("PSet", {1, 2, 3});
    Call("Print", {12.5});
    Call("PaintPicture", {picture, 5, 6});
    EXPECT_EQ(Drawn(),
              (Operations{draw::Cls{}, draw::PSet{1, 2, 3}, draw::Print{"12.5", 1, 2}, draw::PaintPicture{5, 6, picture}}));
    EXPECT_EQ(Call("Point", {1, 2}).ToLong(), 3);
    EXPECT_EQ(Call("Point", {-1, 1}).ToLong(), -1);
    EXPECT_EQ(Call("TextWidth", {"ab"}).ToSingle(), 180);
    EXPECT_EQ(Call("TextHeight", {"ab"}).ToSingle(), 195);
}

TEST_F(LateBound, TheStateIsReadAndSetByName) {
    const std::pair<const char*, Variant> values[] = {
        {"CurrentX", 5},    {"CurrentY", 6},       {"DrawWidth", 2}, {"DrawStyle", 1},   {"DrawMode", 7},
        {"BackColor", 255}, {"ForeColor", 0x8000}, {"ScaleMode", 3}, {"ScaleWidth", 80}, {"ScaleHeight", 60}};
    for (const auto& [name, value] : values) {
        object.Put(name, value);
        EXPECT_TRUE(object.Get(name) == value) << name;
        EXPECT_TRUE(object.Has(name)) << name;
    }
    EXPECT_EQ(ErrorOf([&] { object.Put("DrawMode", 0); }), errors::invalidValue);
    EXPECT_EQ(ErrorOf([&] { object.Put("Cls", 0); }), errors::noSuchMember);
    EXPECT_EQ(ErrorOf([&] { object.Get("Cls"); }), errors::noSuchMember);
    EXPECT_EQ(ErrorOf([&] { object.Get("Nothing"); }), errors::noSuchMember);
    EXPECT_FALSE(object.Has("Nothing"));
}

TEST_F(LateBound, AFormsSizeIsSetInThePresentUnitsAndKeepsTheScale) {
    object.Put("ScaleMode", 3);
    object.Put("ScaleWidth", 100);
    object.Put("ScaleHeight", 50);
    EXPECT_EQ(object.Get("ScaleMode").ToLong(), 3);
    object.Put("ScaleMode", 1);
    EXPECT_EQ(object.Get("ScaleWidth").ToSingle(), 1500);
    EXPECT_EQ(object.Get("ScaleHeight").ToSingle(), 750);
}

TEST_F(LateBound, AFormThatWasShrunkToNothingGrowsAgainInThePresentUnits) {
    object.Put("ScaleMode", 3);
    object.Put("ScaleWidth", 0);
    object.Put("ScaleWidth", 100);
    EXPECT_EQ(object.Get("ScaleWidth").ToSingle(), 100);
    EXPECT_EQ(object.Get("ScaleMode").ToLong(), 3);
}

}  // namespace
}  // namespace tessel::frame
