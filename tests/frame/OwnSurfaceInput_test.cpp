#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "frame/OwnSurface.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/frame/TestControl.h"

namespace tessel::frame {
namespace {

/// Takes the mouse and the keys on its own surface, and writes down what came.
class Touched final : public Control {
  public:
    explicit Touched(frame::Host& host) : Control(host) {
        Surface().MouseMove.To<&Touched::Moved>(*this);
        Surface().KeyDown.To<&Touched::KeyDown>(*this);
        Surface().Click.To<&Touched::Clicked>(*this);
    }
    TextSize DesignSize() const override { return {1500, 1500}; }
    const ClassTable& Table() const override {
        static constexpr ClassTable table{.name = "Touched", .members = {}, .inputs = keyInputs};
        return table;
    }

    std::vector<std::string> heard;

  private:
    void Moved(std::int16_t button, std::int16_t shift, float x, float y) {
        heard.push_back("MouseMove " + Variant(button).ToText() + " " + Variant(shift).ToText() + " " + Variant(x).ToText() + " " +
                        Variant(y).ToText());
    }
    void KeyDown(std::int16_t code, std::int16_t) { heard.push_back("KeyDown " + Variant(code).ToText()); }
    void Clicked() { throw ControlError(errors::subscript); }
};

class Untouched final : public Control {
  public:
    using Control::Control;
    TextSize DesignSize() const override { return {1500, 1500}; }
    const ClassTable& Table() const override {
        static constexpr ClassTable table{.name = "Untouched", .members = {}};
        return table;
    }
};

TEST(OwnSurfaceInput, WhatIsReportedComesToTheControl) {
    headless::HeadlessHost host;
    auto& control = host.Create<Touched>("Touched1");
    control.Surface().MouseMoveInput(1, 2, 30, 45);
    control.Surface().KeyDownInput(65, 0);
    EXPECT_EQ(control.heard, (std::vector<std::string>{"MouseMove 1 2 30 45", "KeyDown 65"}));
}

TEST(OwnSurfaceInput, TheRowsOfTheControlsTableReportToItsSurface) {
    headless::HeadlessHost host;
    auto& control = host.Create<Touched>("Touched1");
    std::vector<Variant> move{1, 0, 7.5f, 8};
    control.Table().FindInput("mousemove")->call(control, move);
    std::vector<Variant> key{13, 0};
    control.Table().FindInput("KeyDown")->call(control, key);
    EXPECT_EQ(control.heard, (std::vector<std::string>{"MouseMove 1 0 7.5 8", "KeyDown 13"}));
    std::vector<Variant> tooFew{1, 0};
    EXPECT_EQ(test::ErrorOf([&] { control.Table().FindInput("MouseMove")->call(control, tooFew); }), errors::argumentMissing);
}

TEST(OwnSurfaceInput, AnErrorGoesToTheHostWithTheControlsName) {
    headless::HeadlessHost host;
    host.Create<Touched>("Touched1").Surface().ClickInput();
    ASSERT_EQ(host.errors.reports.size(), 1u);
    EXPECT_EQ(host.errors.reports[0].where, "Touched1.Click");
    EXPECT_EQ(host.errors.reports[0].error.Number(), errors::subscript);
}

TEST(OwnSurfaceInput, ASurfaceListensWhereItsControlDoes) {
    headless::HeadlessHost host;
    EXPECT_TRUE(host.Create<Touched>("Touched1").Surface().Listens());
    EXPECT_FALSE(host.Create<Untouched>("Untouched1").Surface().Listens());
}

TEST(OwnSurfaceInput, PointsAreInTheSurfacesScale) {
    headless::HeadlessHost host;
    auto& surface = host.Create<Touched>("Touched1").Surface();
    EXPECT_EQ(surface.InputPoint(150, 300), (std::pair<float, float>{150, 300}));
    surface.SetScaleMode(ScaleModeConstants::Pixels);
    EXPECT_EQ(surface.InputPoint(150, 300), (std::pair<float, float>{10, 20}));
    surface.SetScaleLeft(100);
    EXPECT_EQ(surface.InputPoint(150, 300), (std::pair<float, float>{110, 20}));
}

TEST(OwnSurfaceInput, ABorderMovesThePointsAndNotTheExtent) {
    headless::HeadlessHost host;
    auto& surface = host.Create<Touched>("Touched1", {.width = 900, .height = 600}).Surface();
    surface.SetBorderStyle(1);
    EXPECT_EQ(surface.InputPoint(30, 30), (std::pair<float, float>{0, 0}));
    EXPECT_EQ(surface.InputExtent().width, 900);
    EXPECT_EQ(surface.InputExtent().height, 600);
    EXPECT_EQ(surface.InputPoint(900, 600), (std::pair<float, float>{surface.ScaleWidth() + 30, surface.ScaleHeight() + 30}));
}

}  // namespace
}  // namespace tessel::frame
