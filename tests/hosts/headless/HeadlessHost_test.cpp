#include "hosts/headless/HeadlessHost.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

#include "controls/link/Link.h"
#include "tests/frame/TestControl.h"
#include "tests/frame/child/ListOwner.h"

namespace tessel::headless {
namespace {

using controls::Link;
using frame::Handle;
using frame::ObjectRef;
using frame::Variant;
using test::BagOf;
using test::ErrorOf;
using test::TestControl;
using testing::ElementsAre;

/// A control whose load fails otherwise than with a numbered error.
class BrokenControl final : public frame::Control {
  public:
    using Control::Control;
    void InitProperties() override { throw std::runtime_error("broken"); }
    frame::TextSize DesignSize() const override { return {}; }
    const frame::ClassTable& Table() const override {
        static constexpr frame::ClassTable table{.name = "BrokenControl", .members = {}};
        return table;
    }
};

struct HeadlessHosts : testing::Test {
    TestControl& Make(const std::string& name = "Test1", const Placing& placing = {}) {
        return host.Create<TestControl>(name, placing);
    }
    frame::Object& ExtenderOf(const frame::Control& control) { return host.SiteOf(control)->Extender(); }
    std::vector<std::string> Siblings(HeadlessForm& form) {
        std::vector<std::string> names;
        for (int i = 0; i < form.Count(); ++i) names.push_back(form.Item(i).Path());
        return names;
    }

    HeadlessHost host;
};

// Creating and destroying

TEST_F(HeadlessHosts, CreateMakesLoadsAndShowsAControl) {
    const auto bag = BagOf({{"Number", 4}});
    const TestControl& control = Make("Test1", {.saved = &bag, .width = 300.0f, .height = 400.0f});
    EXPECT_EQ(control.trace, "Initialize ReadProperties Resize Show");
    EXPECT_EQ(control.Number(), 4);
    EXPECT_EQ(control.Surface().Width(), 300);
    EXPECT_TRUE(control.UserMode());
    EXPECT_EQ(&host.SiteOf(control)->Control(), &control);
}

TEST_F(HeadlessHosts, CreateDoesNotShowWhatIsNotToBeSeen) {
    const TestControl& control = Make("Test1", {.show = false});
    EXPECT_EQ(control.trace, "Initialize InitProperties Resize");
    EXPECT_FALSE(host.SiteOf(control)->Visible());
}

TEST_F(HeadlessHosts, CreateTakesAClassOfAList) {
    const frame::ControlClass controlClass{
        nullptr, [](frame::Host& of) -> std::unique_ptr<frame::Control> { return std::make_unique<TestControl>(of); }};
    EXPECT_EQ(host.Create(controlClass, "Test1").Path(), "Test1");
}

TEST_F(HeadlessHosts, AControlAtDesignTimeKnowsIt) { EXPECT_FALSE(Make("Test1", {.designTime = true}).UserMode()); }

TEST_F(HeadlessHosts, AnErrorOfALoadPassesToTheCallerAndTheControlIsGone) {
    const auto bag = BagOf({{"Number", "none"}});
    EXPECT_EQ(ErrorOf([&] { Make("Test1", {.saved = &bag}); }), frame::errors::typeMismatch);
    EXPECT_EQ(host.FindSite("Test1"), nullptr);
    EXPECT_EQ(host.Form().Count(), 0);
}

TEST_F(HeadlessHosts, AnyOtherErrorOfALoadLeavesNoControlEither) {
    EXPECT_THROW(host.Create<BrokenControl>("Broken1"), std::runtime_error);
    EXPECT_EQ(host.FindSite("Broken1"), nullptr);
    EXPECT_EQ(host.Form().Count(), 0);
}

TEST_F(HeadlessHosts, SitesAreFoundByNameInAnyCase) {
    const TestControl& control = Make();
    EXPECT_EQ(host.FindSite("TEST1"), host.SiteOf(control));
    EXPECT_EQ(host.FindSite("Test2"), nullptr);
}

TEST_F(HeadlessHosts, DestroyFreesAControlAndItsPlace) {
    TestControl& control = Make();
    const Handle<TestControl> handle(control);
    host.Destroy(control);
    EXPECT_FALSE(handle);
    EXPECT_EQ(host.FindSite("Test1"), nullptr);
    EXPECT_EQ(host.Form().Count(), 0);
}

TEST_F(HeadlessHosts, AControlThatIsBeingDestroyedIsNoLongerFound) {
    TestControl& control = Make();
    host.SiteOf(control)->ApplicationHandlers().On(frame::stock::Click, [&] {
        host.Destroy(control);
        EXPECT_EQ(host.SiteOf(control), nullptr);
        host.Destroy(control);
    });
    control.Child1.ClickInput();
    EXPECT_EQ(host.FindSite("Test1"), nullptr);
}

TEST_F(HeadlessHosts, TheHostTakesItsControlsAlong) {
    int gone = 0;
    {
        HeadlessHost other;
        for (const char* name : {"A", "B", "C"}) other.Create<TestControl>(name).onEnd = [&] { ++gone; };
    }
    EXPECT_EQ(gone, 3);
}

TEST_F(HeadlessHosts, SaveGivesWhatTheControlWrites) {
    TestControl& control = Make();
    EXPECT_TRUE(host.Save(control).Kept().empty());
    control.SetNumber(4);
    const frame::MemoryBag bag = host.Save(control);
    ASSERT_EQ(bag.Kept().size(), 1u);
    EXPECT_EQ(bag.Kept()[0].first, "Number");
}

// The ambient properties

TEST_F(HeadlessHosts, TheAmbientFontIsTheGivenOneOrTheOrdinaryOne) {
    EXPECT_TRUE(Make("Test1").AmbientFont()->EqualsObject(frame::Font()));
    EXPECT_EQ(Make("Test2", {.ambientFont = std::make_shared<frame::Font>("Arial", 14)}).AmbientFont()->Name(), "Arial");
}

TEST_F(HeadlessHosts, TheDisplayNameIsTheNameUnlessAnotherIsGiven) {
    EXPECT_EQ(host.SiteOf(Make("Test1"))->Ambient().DisplayName(), "Test1");
    HeadlessSite& site = *host.SiteOf(Make("Test2", {.displayName = "Shown"}));
    EXPECT_EQ(site.Ambient().DisplayName(), "Shown");
    EXPECT_EQ(site.Path(), "Test2");
    site.SetDisplayName("Other");
    EXPECT_EQ(site.Ambient().DisplayName(), "Other");
}

// The extender

TEST_F(HeadlessHosts, TheExtenderHoldsNameAndPlace) {
    const TestControl& control = Make("Test1", {.width = 300.0f});
    frame::Object& extender = ExtenderOf(control);
    EXPECT_EQ(extender.Get("name").ToText(), "Test1");
    EXPECT_EQ(extender.Get("WIDTH").ToSingle(), 300);
    extender.Put("Left", 15);
    extender.Put("Top", "30");
    extender.Put("Height", 45);
    EXPECT_EQ(host.SiteOf(control)->Left(), 15);
    EXPECT_EQ(extender.Get("Top").ToSingle(), 30);
    EXPECT_EQ(control.Surface().Height(), 45);
    EXPECT_EQ(control.trace, "Initialize InitProperties Resize Show Resize");
}

TEST_F(HeadlessHosts, TheExtenderRefusesAnotherName) {
    frame::Object& extender = ExtenderOf(Make());
    EXPECT_EQ(ErrorOf([&] { extender.Put("Name", "Other"); }), frame::errors::notAtRunTime);
    EXPECT_EQ(extender.Get("Name").ToText(), "Test1");
}

TEST_F(HeadlessHosts, TheExtenderHasTheMembersThatItWasGivenAndNoOthers) {
    frame::Object& extender = ExtenderOf(Make("Test1", {.extender = {{"Tag", "mine"}}}));
    EXPECT_EQ(extender.Get("tag").ToText(), "mine");
    extender.Put("TAG", 5);
    EXPECT_EQ(extender.Get("Tag").ToLong(), 5);
    EXPECT_TRUE(extender.Has("Tag"));
    EXPECT_FALSE(extender.Has("Index"));
    EXPECT_EQ(ErrorOf([&] { extender.Get("Index"); }), frame::errors::noSuchMember);
    EXPECT_EQ(ErrorOf([&] { extender.Put("Index", 1); }), frame::errors::noSuchMember);
}

TEST_F(HeadlessHosts, AToolTipIsThereOnceItHasBeenGivenOrSet) {
    TestControl& without = Make("Test1");
    EXPECT_EQ(ErrorOf([&] { without.ToolTip(); }), frame::errors::noSuchMember);
    ExtenderOf(without).Put("tooltiptext", "set");
    EXPECT_EQ(without.ToolTip(), "set");
    EXPECT_EQ(Make("Test2", {.extender = {{"ToolTipText", "given"}}}).ToolTip(), "given");
}

TEST_F(HeadlessHosts, VisibleShowsAndHidesOnceForEachChange) {
    TestControl& control = Make();
    control.trace.clear();
    frame::Object& extender = ExtenderOf(control);
    EXPECT_TRUE(extender.Get("Visible").ToBoolean());
    extender.Put("Visible", true);
    extender.Put("Visible", false);
    extender.Put("Visible", 0);
    EXPECT_FALSE(extender.Get("Visible").ToBoolean());
    extender.Put("Visible", -1);
    EXPECT_EQ(control.trace, "Hide Show");
}

// Forms

TEST_F(HeadlessHosts, AFormListsItsControlsAndObjectsInTheirOrder) {
    Make("B");
    HostObject object("Text1", {{"Name", "Text1"}});
    host.Form().Add(object);
    TestControl& last = Make("A");
    EXPECT_THAT(Siblings(host.Form()), ElementsAre("B", "Text1", "A"));
    EXPECT_EQ(ErrorOf([&] { host.Form().Item(3); }), frame::errors::subscript);
    EXPECT_EQ(ErrorOf([&] { host.Form().Item(-1); }), frame::errors::subscript);
    host.Form().Remove(object);
    EXPECT_THAT(Siblings(host.Form()), ElementsAre("B", "A"));
    host.Destroy(last);
    EXPECT_THAT(Siblings(host.Form()), ElementsAre("B"));
}

TEST_F(HeadlessHosts, AControlFindsItsFormAndItsSiblings) {
    const TestControl& control = Make();
    EXPECT_EQ(host.SiteOf(control)->Parent(), &host.Form());
    EXPECT_EQ(control.Site()->ParentControls().Count(), 1);
    EXPECT_EQ(&control.Site()->ParentControls().Item(0), &ExtenderOf(control));
}

TEST_F(HeadlessHosts, WhatStandsOnTheFormHasTheHostsMembersAndTheControlsOwn) {
    Link& link = host.Create<Link>("Link1", {.extender = {{"Left", 90}, {"Tag", "mine"}}});
    frame::Object& item = host.Form().Item(0);
    EXPECT_EQ(item.Get("Name").ToText(), "Link1");
    EXPECT_EQ(item.Get("left").ToSingle(), 90);
    EXPECT_EQ(item.Get("Tag").ToText(), "mine");
    EXPECT_EQ(item.Get("Caption").ToText(), "Label1");
    item.Put("Width", 450);
    EXPECT_EQ(link.Label1.Width(), 450);
    item.Put("BackColor", 255);
    EXPECT_EQ(link.BackColor(), frame::OLE_COLOR(255));
    Variant target[] = {"a.txt"};
    EXPECT_EQ(item.Call("OpenLink", target).ToText(), "");
    EXPECT_FALSE(item.Has("Nothing"));
    EXPECT_EQ(ErrorOf([&] { item.Get("Nothing"); }), frame::errors::noSuchMember);
    EXPECT_EQ(ErrorOf([&] { item.Put("Name", "other"); }), frame::errors::notAtRunTime);
}

TEST_F(HeadlessHosts, AControlStaysOnItsFormWhenAnotherFormIsMade) {
    const TestControl& control = Make("Test1");
    HeadlessForm& first = host.Form();
    HeadlessForm& second = host.NewForm("Form2");
    Make("Test2");
    EXPECT_EQ(host.SiteOf(control)->Parent(), &first);
    EXPECT_EQ(host.FindSite("Test2")->Parent(), &second);
    EXPECT_EQ(control.Site()->ParentControls().Count(), 1);
    EXPECT_THAT(Siblings(second), ElementsAre("Test2"));
}

TEST_F(HeadlessHosts, AFormHasItsMembersAndTakesMore) {
    HeadlessForm& form = host.NewForm("Main", {{"ScaleMode", 3}, {"Tag", "mine"}, {"BackColor", 255}});
    EXPECT_EQ(form.Get("Name").ToText(), "Main");
    EXPECT_EQ(form.Path(), "Main");
    EXPECT_EQ(form.Get("Tag").ToText(), "mine");
    EXPECT_EQ(form.BackColor(), frame::OLE_COLOR(255));
    EXPECT_EQ(form.ScaleMode(), frame::ScaleModeConstants::Pixels);
    EXPECT_TRUE(form.Get("Picture").ToObject().IsNothing());
    EXPECT_EQ(form.Get("MousePointer").ToLong(), 0);
}

TEST_F(HeadlessHosts, AFormIsInTwipsAndHasASizeAtFirst) {
    HeadlessForm& form = host.Form();
    EXPECT_EQ(form.Path(), "Form1");
    EXPECT_EQ(form.ScaleMode(), frame::ScaleModeConstants::Twips);
    EXPECT_EQ(form.ScaleWidth(), 12'000);
    EXPECT_EQ(form.ScaleHeight(), 9'000);
    form.SetScaleMode(frame::ScaleModeConstants::Pixels);
    EXPECT_EQ(form.ScaleWidth(), 800);
}

// The log

TEST_F(HeadlessHosts, EveryEventIsLoggedWithItsArgumentsAsTheyWereRaised) {
    TestControl& control = Make();
    host.SiteOf(control)->ApplicationHandlers().On(test::Happened, [](bool&, std::int32_t& count, std::string&) { count = 9; });
    host.log.Clear();
    control.Ask(true, 1, "text");
    ASSERT_EQ(host.log.Entries().size(), 1u);
    const Log::Entry& entry = host.log.Entries()[0];
    ASSERT_EQ(entry.size(), 4u);
    EXPECT_EQ(entry[1].ToText() + "." + entry[2].ToText(), "Test1.Happened");
    EXPECT_TRUE(entry[3] == ListOf(std::vector<Variant>{true, 1, "text"}));
}

TEST_F(HeadlessHosts, AnEventGoesToTheLogThenToTheScriptThenToTheApplication) {
    std::string order;
    const auto script = [&](const std::string& name, const frame::EventInfo& event, frame::EventArguments) {
        order += name + "." + std::string(event.name) + " script " + host.log.EventNames("Test1");
    };
    TestControl& control = Make("Test1", {.onEvent = script});
    host.SiteOf(control)->ApplicationHandlers().On(test::Quiet, [&] { order += " application"; });
    control.Tell();
    EXPECT_EQ(order, "Test1.Quiet script Quiet application");
}

TEST_F(HeadlessHosts, AScriptSetsArguments) {
    const auto script = [](const std::string&, const frame::EventInfo&, frame::EventArguments arguments) { arguments[1].Set("7"); };
    EXPECT_EQ(Make("Test1", {.onEvent = script}).Ask(false, 1, "x"), "False 7 x");
}

TEST_F(HeadlessHosts, AnErrorOfAScriptPassesToTheOneWhoRaised) {
    const auto script = [](const std::string&, const frame::EventInfo&, frame::EventArguments) {
        throw frame::ControlError(frame::errors::diskFull);
    };
    TestControl& control = Make("Test1", {.onEvent = script});
    EXPECT_EQ(ErrorOf([&] { control.Tell(); }), frame::errors::diskFull);
}

TEST_F(HeadlessHosts, AChangedPropertyIsLoggedByItsKey) {
    TestControl& control = Make();
    host.log.Clear();
    control.SetTitle("x");
    ASSERT_EQ(host.log.Entries().size(), 1u);
    EXPECT_EQ(host.log.Entries()[0][0].ToText(), "changed");
    EXPECT_EQ(host.log.Entries()[0][1].ToText(), "Test1");
    EXPECT_EQ(host.log.Entries()[0][2].ToText(), "Title");
}

/// An entry of the log as "draw Test1 Line 1 2".
std::vector<std::string> Drawn(const Log& log) {
    std::vector<std::string> lines;
    for (const Log::Entry& entry : log.Of("draw")) {
        std::string line;
        for (const Variant& value : entry)
            line += (line.empty() ? "" : " ") + (value.Type() == frame::VarType::Object ? "object" : value.ToText());
        lines.push_back(line);
    }
    return lines;
}

TEST_F(HeadlessHosts, EveryOperationOnAControlOrAFormIsLoggedInTheUnitsThatItWasGivenIn) {
    frame::OwnSurface& own = Make().Surface();
    own.SetForeColor(1);
    own.Line(1, 2, 3.5f, 4, frame::OLE_COLOR(255), frame::draw::Box::Filled);
    own.SetScaleMode(frame::ScaleModeConstants::Pixels);
    own.Line(5, 6, 7, 8);
    own.Circle(1, 2, 3, frame::OLE_COLOR(4), 0.5f);
    own.PSet(1, 2);
    own.Print("text");
    own.SetDrawWidth(2);
    own.SetDrawStyle(1);
    own.SetDrawMode(7);
    own.Cls();
    own.PaintPicture(std::make_shared<frame::Picture>(), 1, 2);
    host.Form().Line(1, 2, 3, 4, frame::OLE_COLOR(5), frame::draw::Box::Outline);
    EXPECT_THAT(Drawn(host.log),
                ElementsAre("draw Test1 Line 1 2 3.5 4 255 BF", "draw Test1 Line 5 6 7 8 1 ", "draw Test1 Circle 1 2 3 4 0.5  ",
                            "draw Test1 PSet 1 2 1", "draw Test1 Print text 1 2", "draw Test1 DrawWidth 2",
                            "draw Test1 DrawStyle 1", "draw Test1 DrawMode 7", "draw Test1 Cls",
                            "draw Test1 PaintPicture 1 2 object", "draw Form1 Line 1 2 3 4 5 B"));
}

TEST_F(HeadlessHosts, ErrorsThatNoCallerCanTakeGather) {
    TestControl& control = Make();
    host.SiteOf(control)->ApplicationHandlers().On(frame::stock::Click, [] { throw frame::ControlError(frame::errors::diskFull); });
    control.Child1.ClickInput();
    ASSERT_EQ(host.errors.reports.size(), 1u);
    EXPECT_EQ(host.errors.reports[0].where, "Test1.Child1.Click");
}

TEST_F(HeadlessHosts, AChildHasNoPeer) { EXPECT_EQ(Make().Child1.Peer(), nullptr); }

// Host objects

TEST(HostObject, HasJustTheMembersThatItWasGiven) {
    HostObject object("Text1(2)", {{"Text", "x"}, {"Index", 2}});
    EXPECT_EQ(object.Path(), "Text1(2)");
    EXPECT_EQ(object.Get("TEXT").ToText(), "x");
    EXPECT_EQ(object.Call("Index").ToLong(), 2);
    object.Put("text", 5);
    EXPECT_EQ(object.Get("Text").ToLong(), 5);
    EXPECT_FALSE(object.Has("Caption"));
    EXPECT_FALSE(object.Has(1));
    for (const char* name : {"Caption", ""}) {
        EXPECT_EQ(ErrorOf([&] { object.Get(name); }), frame::errors::noSuchMember);
        EXPECT_EQ(ErrorOf([&] { object.Put(name, 1); }), frame::errors::noSuchMember);
        EXPECT_EQ(ErrorOf([&] { object.Call(name); }), frame::errors::noSuchMember);
    }
    EXPECT_EQ(ErrorOf([&] { object.Get(1); }), frame::errors::noSuchMember);
}

TEST(HostObject, TakesNoIndex) {
    HostObject object("Text1", {{"Text", "x"}});
    std::vector<Variant> index = {1};
    EXPECT_EQ(ErrorOf([&] { object.Get("Text", index); }), frame::errors::wrongArguments);
    EXPECT_EQ(ErrorOf([&] { object.Put("Text", 1, index); }), frame::errors::wrongArguments);
}

TEST(HostObject, ReachesTheObjectThatAMemberHolds) {
    const auto font = std::make_shared<frame::Font>();
    HostObject object("Text1", {{"Font", font}, {"Text", "x"}});
    EXPECT_EQ(object.Inner("FONT").Get(), font.get());
    EXPECT_TRUE(object.Inner("Text").IsNothing());
    EXPECT_TRUE(object.Inner("Picture").IsNothing());
}

TEST(HeadlessHostLists, LabelEditThatOpensIsLogged) {
    HeadlessHost host;
    auto& owner = host.Create<test::ListOwner>("Owner1");
    owner.list.Items().Add("a");
    owner.list.SetSelectedItem(owner.list.ListItems.Item(1));
    owner.list.StartLabelEdit();
    ASSERT_EQ(host.log.Of("edit").size(), 1u);
    EXPECT_EQ(host.log.Of("edit")[0][1].ToText(), owner.list.Path());
    EXPECT_TRUE(owner.list.Editing());
}

}  // namespace
}  // namespace tessel::headless
