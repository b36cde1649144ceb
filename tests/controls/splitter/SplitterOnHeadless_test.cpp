#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "hosts/headless/HeadlessHost.h"
#include "tests/controls/splitter/SplitterTestHelp.h"

/// Forms that an application makes for the host without a screen: with a scale, a size and objects of its own.
namespace tessel::controls {
namespace {

using frame::Variant;
using headless::HeadlessHost;
using headless::HostObject;
using testing::ElementsAre;
using testing::IsEmpty;
using namespace splittertest;

class SplitterOnForms : public testing::Test {
  protected:
    HostObject& Add(const std::string& path, HostObject::Members members) {
        objects.push_back(std::make_unique<HostObject>(path, members));
        host.Form().Add(*objects.back());
        return *objects.back();
    }
    HostObject& AddText(const std::string& name, float top, float height) {
        return Add(name, {{"Name", name}, {"Left", 0.0f}, {"Top", top}, {"Width", 500.0f}, {"Height", height}});
    }
    frame::Control& NewBar(bool designTime = false) {
        return host.Create(SplitterClass(), "Splitter1", {.designTime = designTime});
    }
    std::string Place(const frame::Control& bar) {
        const auto& site = *host.SiteOf(bar);
        const auto text = [](float value) { return Variant(value).ToText(); };
        return text(site.Left()) + "," + text(site.Top()) + " " + text(site.Width()) + "x" + text(site.Height());
    }

    std::vector<std::unique_ptr<HostObject>> objects;
    HeadlessHost host;
};

TEST_F(SplitterOnForms, PlacementIsInTheUnitsOfTheFormAndTheThicknessInTheBars) {
    host.NewForm("Pixels", {{"ScaleWidth", 12'000}, {"ScaleHeight", 9'000}, {"ScaleMode", 3}});
    auto& bar = NewBar(true);
    EXPECT_EQ(Place(bar), "0,300 800x120");
    bar.Put("Orientation", vertical);
    EXPECT_EQ(Place(bar), "400,0 120x600");
}

TEST_F(SplitterOnForms, LimitsAreTakenInTheUnitsOfTheForm) {
    host.NewForm("Pixels", {{"ScaleWidth", 12'000}, {"ScaleHeight", 9'000}, {"ScaleMode", 3}});
    auto& bar = NewBar(true);
    bar.Put("MinTopLeft", 50);
    bar.Put("MinBottomRight", 100);
    DragBy(bar, 0, -5000);
    EXPECT_EQ(Place(bar), "0,50 800x120");
    DragBy(bar, 0, 5000);
    EXPECT_EQ(Place(bar), "0,380 800x120");  // 600 - 100 - 120
}

TEST_F(SplitterOnForms, TheStripIsInTheTwipsOfTheBar) {
    host.NewForm("Pixels", {{"ScaleMode", 3}});
    auto& bar = NewBar(true);
    bar.Put("Appearance", none);
    host.log.Clear();
    MoveTo(bar, 100, 29);
    EXPECT_THAT(host.log.Of("draw"), IsEmpty());
    MoveTo(bar, 100, 30);
    EXPECT_EQ(host.log.Of("draw").size(), 1u);
}

TEST_F(SplitterOnForms, AFormOfSizeZeroPutsTheBarAtItsEdgeAndGivesNoLowerLimit) {
    host.NewForm("Flat", {{"ScaleHeight", 0}});
    auto& bar = NewBar(true);
    EXPECT_EQ(Place(bar), "0,0 12000x120");
    DragBy(bar, 0, 50'000);
    EXPECT_EQ(Place(bar), "0,50000 12000x120");
}

TEST_F(SplitterOnForms, AFormThatShrinksTakesTheBarBackAtTheNextStep) {
    auto& bar = NewBar(true);
    host.NewForm("Form1", {{"ScaleHeight", 3000}});
    Press(bar, 50, 50);
    MoveTo(bar, 50, 50);
    EXPECT_EQ(Place(bar), "0,2880 12000x120");
}

TEST_F(SplitterOnForms, EntriesWithAnIndexFindTheMembersOfAControlArray) {
    for (int i = 0; i < 3; ++i)
        Add("Text1(" + std::to_string(i) + ")", {{"Name", "Text1"}, {"Index", i}, {"Top", 100}, {"Height", 400}});
    auto& bar = NewBar(true);
    bar.Put("ControlsTopLeft", "text1 , Text1(2)");
    bar.Put("ControlsBottomRight", " TEXT1(1) ");
    DragBy(bar, 0, 50);
    EXPECT_EQ(objects[0]->Get("Height"), Variant(450));
    EXPECT_EQ(objects[1]->Get("Height"), Variant(350));
    EXPECT_EQ(objects[1]->Get("Top"), Variant(150));
    EXPECT_EQ(objects[2]->Get("Height"), Variant(450));
    EXPECT_EQ(objects[2]->Get("Top"), Variant(100));
}

TEST_F(SplitterOnForms, ObjectsWithoutAnyMembersAreNoHindrance) {
    Add("Nothing", {});
    auto& text = AddText("Text1", 0, 400);
    Add("Timer1", {{"Name", "Timer1"}});
    auto& bar = NewBar(true);
    bar.Put("ControlsTopLeft", "Timer1,Text1");
    DragBy(bar, 0, 50);
    EXPECT_EQ(text.Get("Height"), Variant(450));
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST_F(SplitterOnForms, ASurfaceOfTheApplicationMovesToo) {
    headless::SurfaceObject picture(host.Frame(), "Picture1",
                                    {{"Name", "Picture1"}, {"Top", 500}, {"Width", 900}, {"Height", 700}});
    host.Form().Add(picture);
    auto& bar = NewBar(true);
    bar.Put("ControlsBottomRight", "Picture1");
    DragBy(bar, 0, 50);
    EXPECT_EQ(picture.Get("Height"), Variant(650));
    EXPECT_EQ(picture.Get("Top"), Variant(550));
}

TEST_F(SplitterOnForms, AControlOfAnotherFormIsNotFound) {
    auto& text = AddText("Text1", 0, 400);
    host.NewForm("Form2");
    auto& bar = NewBar(true);
    bar.Put("ControlsTopLeft", "Text1");
    DragBy(bar, 0, 50);
    EXPECT_EQ(text.Get("Height"), Variant(400));
}

TEST_F(SplitterOnForms, TheFormIsNotAmongItsControls) {
    auto& bar = NewBar(true);
    bar.Put("ControlsTopLeft", "Form1");
    const Variant before = host.Form().Get("Height");
    DragBy(bar, 0, 50);
    EXPECT_EQ(host.Form().Get("Height"), before);
}

// What the log tells, in its order.

std::string Line(const headless::Log::Entry& entry) {
    std::string line;
    for (const Variant& value : entry) {
        std::string text;
        if (value.Type() == frame::VarType::Array)
            for (const Variant& item : value.ToArray().items) text += (text.empty() ? "" : ",") + item.ToText();
        else
            text = value.IsColor() ? ColorText(value.ToColor()) : value.ToText();
        line += (line.empty() ? "" : " ") + text;
    }
    return line;
}

TEST_F(SplitterOnForms, TheLogTellsEventsBeforeTheDrawingAndAfterMoveBehindTheMouse) {
    auto& bar = NewBar();
    bar.Put("Appearance", none);
    host.SiteOf(bar)->SetPlace(0, 1000);
    host.SiteOf(bar)->SetSize(3000, thick);
    host.log.Clear();
    MoveTo(bar, 100, 60);
    Press(bar, 100, 60);
    MoveTo(bar, 100, 160);
    Release(bar);
    bar.Put("BackColor", frame::OLE_COLOR(0x123456));
    std::vector<std::string> lines;
    for (const auto& entry : host.log.Entries()) lines.push_back(Line(entry));
    EXPECT_THAT(lines, ElementsAre("event Splitter1 MouseMove 1,0,100,60", "draw Splitter1 Line 0 0 199 7 C0C000 BF",
                                   "event Splitter1 MouseDown 1,0,100,60", "event Splitter1 MouseMove 1,0,100,160",
                                   "event Splitter1 AfterMove 0,100", "event Splitter1 MouseUp 1,0,0,0",
                                   "changed Splitter1 BackColor", "draw Splitter1 Line 0 0 199 7 123456 BF"));
}

TEST_F(SplitterOnForms, MakingAndShowingABarDrawsNothing) {
    const frame::MemoryBag saved({{"BackColor", frame::OLE_COLOR(1)}, {"Appearance", std::int16_t{1}}});
    host.Create(SplitterClass(), "Splitter1", {.saved = &saved});
    host.Create(SplitterClass(), "Splitter2");
    host.Create(SplitterClass(), "Splitter3", {.designTime = true});
    EXPECT_THAT(host.log.Of("draw"), IsEmpty());
}

}  // namespace
}  // namespace tessel::controls
