#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <stdexcept>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "tests/ErrorOf.h"
#include "tests/HostUnderTest.h"
#include "tests/controls/splitter/SplitterTestHelp.h"

namespace tessel::controls {
namespace {

using frame::MemoryBag;
using frame::OLE_COLOR;
using frame::Picture;
using frame::Variant;
using frame::VarType;
using test::ErrorOf;
using test::HostUnderTest;
using testing::ElementsAre;
using testing::IsEmpty;
using namespace splittertest;

const frame::ClassTable& Table() { return *SplitterClass().table; }
const frame::Member& MemberNamed(std::string_view name) {
    const frame::Member* found = Table().Find(name);
    if (!found) throw std::logic_error("There is no member " + std::string(name));
    return *found;
}
std::string HelpOf(std::string_view name) { return std::string(MemberNamed(name).help); }

frame::Control& NewBar(HostUnderTest& host, const std::string& name = "Splitter1") {
    return host.Create(SplitterClass(), name, {.width = 3000, .height = thick});
}
frame::Control& LoadedBar(HostUnderTest& host, const frame::PropertyBag& saved, const std::string& name = "Splitter1") {
    return host.Create(SplitterClass(), name, {.saved = &saved, .width = 3000, .height = thick});
}
std::vector<std::string> Changes(const HostUnderTest& host) {
    std::vector<std::string> names;
    for (const auto& entry : host.log.Of("changed")) names.push_back(entry.at(2).ToText());
    return names;
}

// Members.

TEST(SplitterTables, TheClassIsNamedSplitter) { EXPECT_EQ(Table().name, "Splitter"); }

TEST(SplitterTables, ASplitterHasNoChildControls) {
    HostUnderTest host;
    EXPECT_TRUE(NewBar(host).Children().empty());
}

TEST(SplitterTables, MembersStandInTheOrderOfTheInterfaceWithTheirNumbers) {
    std::vector<std::string> lines;
    for (const auto& member : Table().members)
        lines.push_back(std::string(member.name) + " " + std::to_string(Table().NumberOf(member)));
    EXPECT_THAT(lines, ElementsAre("MinTopLeft 1", "MinBottomRight 2", "BackColor -501", "ForeColor -513", "Enabled -514",
                                   "Refresh -550", "Orientation 7", "ControlsTopLeft 8", "ControlsBottomRight 9", "MousePointer 10",
                                   "MouseIcon 11", "Appearance -520", "HighlightColor 13", "Ident 14"));
}

TEST(SplitterTables, OnlyRefreshIsAMethodAndItTakesNothing) {
    for (const auto& member : Table().members) EXPECT_EQ(member.isMethod, member.name == "Refresh") << member.name;
    EXPECT_TRUE(MemberNamed("Refresh").parameters.All().empty());
}

TEST(SplitterTables, OnlyIdentIsARunTimeProperty) {
    for (const auto& member : Table().members)
        EXPECT_EQ(member.access, member.name == "Ident" ? frame::Access::RunTime : frame::Access::Plain) << member.name;
}

TEST(SplitterTables, PropertiesHaveTheTypesOfTheirFields) {
    EXPECT_EQ(MemberNamed("MinTopLeft").type.type, VarType::Single);
    EXPECT_EQ(MemberNamed("MinBottomRight").type.type, VarType::Single);
    EXPECT_EQ(MemberNamed("Enabled").type.type, VarType::Boolean);
    EXPECT_EQ(MemberNamed("MousePointer").type.type, VarType::Integer);
    EXPECT_EQ(MemberNamed("MouseIcon").type.type, VarType::Object);
    for (const auto* name : {"BackColor", "ForeColor", "HighlightColor"}) {
        EXPECT_EQ(MemberNamed(name).type.type, VarType::Long) << name;
        EXPECT_TRUE(MemberNamed(name).type.isColor) << name;
    }
}

std::vector<std::string> ConstantsOf(std::string_view name) {
    const frame::Enumeration* enumeration = MemberNamed(name).type.enumeration;
    if (!enumeration) return {};
    std::vector<std::string> lines = {std::string(enumeration->name)};
    for (const auto& constant : enumeration->constants)
        lines.push_back(std::string(constant.name) + "=" + std::to_string(constant.value));
    return lines;
}

TEST(SplitterTables, OrientationsAreTwoNamedNumbers) {
    EXPECT_THAT(ConstantsOf("Orientation"), ElementsAre("tsOrientation", "tsHorizontal=0", "tsVertical=1"));
}

TEST(SplitterTables, AppearancesAreSixNamedNumbers) {
    EXPECT_THAT(ConstantsOf("Appearance"),
                ElementsAre("tsAppearance", "tsNone=0", "tsFlat=1", "tsRaised=2", "tsSunken=3", "tsGrooved=4", "tsSerrated=5"));
}

// The help texts of the two limits describe the reverse of what the properties do.
TEST(SplitterTables, HelpTextsAreTheSplittersOwnWords) {
    EXPECT_EQ(HelpOf("MinTopLeft"), "Sets the minimum for the splitter for the bottom or right size depending on its orientation.");
    EXPECT_EQ(HelpOf("MinBottomRight"), "Sets the minimum for the splitter for the top or left size depending on its orientation.");
    EXPECT_EQ(HelpOf("Orientation"), "Orientation of the control (Horizontal or vertical).");
    EXPECT_EQ(HelpOf("ControlsTopLeft"), "Comma separated list of controls to size that are above or to the left of the splitter.");
    EXPECT_EQ(HelpOf("ControlsBottomRight"),
              "Comma separated list of controls to size that are below or to the right of the splitter.");
    EXPECT_EQ(HelpOf("Appearance"), "Appearance of the control.  It can appear flat, sunken, raised and grooved.");
    EXPECT_EQ(HelpOf("HighlightColor"),
              "Returns/sets the highlight color used to highlight the control when the mouse pointer is over it.");
    EXPECT_EQ(HelpOf("ForeColor"), "Returns/sets the foreground color used to draw the border when appearance is flat.");
    EXPECT_EQ(HelpOf("Ident"), "Internal splitter identification");
}

TEST(SplitterTables, AMemberAnswersByNameInAnyCaseAndByNumber) {
    HostUnderTest host;
    auto& bar = NewBar(host);
    bar.Put(1, 250);
    bar.Put("BACKCOLOR", OLE_COLOR(0x123456));
    bar.Put(8, "Text1");
    EXPECT_EQ(bar.Get("mintopleft"), Variant(250.0f));
    EXPECT_EQ(bar.Get(-501), Variant(OLE_COLOR(0x123456)));
    EXPECT_EQ(bar.Get("controlstopleft"), Variant("Text1"));
}

TEST(SplitterTables, ANumberThatNoMemberHasIsRefused) {
    HostUnderTest host;
    auto& bar = NewBar(host);
    for (const int number : {0, 3, 4, 5, 6, 12, 15, -504, -512})
        EXPECT_EQ(ErrorOf([&] { bar.Get(number); }), frame::errors::noSuchMember) << number;
}

// Events.

/// "MouseDown -605 &Button:Integer &Shift:Integer &X:Single &Y:Single", a variant being "Empty".
std::string Described(const frame::EventInfo& event) {
    std::string line = std::string(event.name) + " " + std::to_string(event.number);
    for (const auto& parameter : event.parameters.All()) {
        line += " " + std::string(parameter.byReference ? "&" : "") + std::string(parameter.name);
        if (parameter.type.type != VarType::Empty) line += ":" + std::string(VarTypeName(parameter.type.type));
    }
    return line;
}

TEST(SplitterTables, EventsAreTheStockOnesAndAfterMoveWithTwoVariantsByReference) {
    std::vector<std::string> lines;
    for (const auto* event : Table().events) lines.push_back(Described(*event));
    EXPECT_THAT(lines, ElementsAre("Click -600", "DblClick -601", "KeyDown -602 &KeyCode:Integer &Shift:Integer",
                                   "KeyPress -603 &KeyAscii:Integer", "KeyUp -604 &KeyCode:Integer &Shift:Integer",
                                   "MouseDown -605 &Button:Integer &Shift:Integer &X:Single &Y:Single",
                                   "MouseMove -606 &Button:Integer &Shift:Integer &X:Single &Y:Single",
                                   "MouseUp -607 &Button:Integer &Shift:Integer &X:Single &Y:Single", "AfterMove 9 &dx &dy"));
}

TEST(SplitterTables, AfterMoveTellsThatTheSplitterHasBeenMoved) {
    const frame::EventInfo* event = Table().FindEvent("AfterMove");
    ASSERT_NE(event, nullptr);
    EXPECT_EQ(event->help, "Occurs after the splitter has been moved.");
}

TEST(SplitterTables, InputsAreTheEightOfTheSurface) {
    for (const auto* name : {"Click", "DblClick", "KeyDown", "KeyPress", "KeyUp", "MouseDown", "MouseMove", "MouseUp"})
        EXPECT_NE(Table().FindInput(name), nullptr) << name;
    EXPECT_EQ(Table().FindInput("AfterMove"), nullptr);
}

// The bag.

/// A bag that keeps nothing and remembers what it was asked for.
struct AskedBag final : frame::PropertyBag {
    Variant ReadProperty(std::string_view key, const Variant& otherwise) const override {
        asked.emplace_back(std::string(key), otherwise);
        return otherwise;
    }
    void WriteProperty(std::string_view, const Variant&, const Variant&) override {}

    mutable std::vector<std::pair<std::string, Variant>> asked;
};

/// A key with the type and value of its default: "BackColor Long 2147483663".
std::string DefaultLine(const std::string& key, const Variant& value) {
    std::string line = key + " " + std::string(VarTypeName(value.Type()));
    if (value.Type() == VarType::Object) return line + (value.ToObject().IsNothing() ? " none" : " some");
    return line + " " + (value.Type() == VarType::Long ? std::to_string(value.ToColor().value) : value.ToText());
}

const std::vector<std::string> defaultLines = {
    "MinTopLeft Integer 0",   "MinBottomRight Integer 0", "BackColor Long 2147483663", "ForeColor Long 2147483666",
    "Enabled Boolean True",   "Orientation Integer 0",    "ControlsTopLeft String ",   "ControlsBottomRight String ",
    "MousePointer Integer 0", "MouseIcon Object none",    "Appearance Integer 4",      "HighlightColor Long 12632064",
    "Ident Integer 0"};

TEST(SplitterTables, LoadAsksForEveryKeyInItsOrderWithItsDefault) {
    HostUnderTest host;
    const AskedBag bag;
    LoadedBar(host, bag);
    std::vector<std::string> lines;
    for (const auto& [key, otherwise] : bag.asked) lines.push_back(DefaultLine(key, otherwise));
    EXPECT_EQ(lines, defaultLines);
}

TEST(SplitterTables, SaveHandsOverEveryKeyInTheSameOrderWithTheSameDefault) {
    HostUnderTest host;
    const MemoryBag bag = host.Save(NewBar(host));
    std::vector<std::string> lines;
    for (const auto& write : bag.Written()) lines.push_back(DefaultLine(write.key, write.otherwise));
    EXPECT_EQ(lines, defaultLines);
}

TEST(SplitterTables, ABarPlacedNewAndSavedAtOnceHandsOverItsDefaults) {
    HostUnderTest host;
    const MemoryBag bag = host.Save(NewBar(host));
    for (const auto& write : bag.Written()) EXPECT_EQ(write.value, write.otherwise) << write.key;
    EXPECT_THAT(bag.Kept(), IsEmpty());
}

TEST(SplitterTables, ABarLoadedFromAnEmptyBagEqualsANewOne) {
    HostUnderTest host;
    const MemoryBag nothing;
    auto& placed = NewBar(host);
    auto& loaded = LoadedBar(host, nothing, "Splitter2");
    for (const auto& member : Table().members) {
        if (member.isMethod) continue;
        EXPECT_EQ(placed.Get(member.name), loaded.Get(member.name)) << member.name;
    }
}

TEST(SplitterTables, ANewBarHasTheDefaultsOfTheBag) {
    HostUnderTest host;
    auto& bar = NewBar(host);
    EXPECT_EQ(bar.Get("MinTopLeft"), Variant(0));
    EXPECT_EQ(bar.Get("MinBottomRight"), Variant(0));
    EXPECT_EQ(bar.Get("BackColor"), Variant(OLE_COLOR(0x8000000Fu)));
    EXPECT_EQ(bar.Get("ForeColor"), Variant(OLE_COLOR(0x80000012u)));
    EXPECT_EQ(bar.Get("Enabled"), Variant(true));
    EXPECT_EQ(bar.Get("Orientation"), Variant(horizontal));
    EXPECT_EQ(bar.Get("ControlsTopLeft"), Variant(""));
    EXPECT_EQ(bar.Get("ControlsBottomRight"), Variant(""));
    EXPECT_EQ(bar.Get("MousePointer"), Variant(0));
    EXPECT_TRUE(bar.Get("MouseIcon").ToObject().IsNothing());
    EXPECT_EQ(bar.Get("Appearance"), Variant(grooved));
    EXPECT_EQ(bar.Get("HighlightColor"), Variant(OLE_COLOR(0xC0C000)));
    EXPECT_EQ(bar.Get("Ident"), Variant(0));
}

/// For each key a value that is not its default.
MemoryBag::Contents OtherValues() {
    static const auto icon = std::make_shared<Picture>(480.0f, 480.0f, "hand.ico");
    return {{"MinTopLeft", 250.0f},
            {"MinBottomRight", 375.0f},
            {"BackColor", OLE_COLOR(0xABCDEF)},
            {"ForeColor", OLE_COLOR(0x010203)},
            {"Enabled", false},
            {"Orientation", std::int16_t{1}},
            {"ControlsTopLeft", "Text1, Text2(1)"},
            {"ControlsBottomRight", "List1"},
            {"MousePointer", std::int16_t{2}},
            {"MouseIcon", icon},
            {"Appearance", std::int16_t{5}},
            {"HighlightColor", OLE_COLOR(0x80000005u)},
            {"Ident", std::int16_t{7}}};
}

TEST(SplitterTables, EachKeyByItselfComesThroughLoadAndSave) {
    HostUnderTest host;
    for (const auto& [key, value] : OtherValues()) {
        const MemoryBag saved({{key, value}});
        auto& bar = LoadedBar(host, saved);
        EXPECT_EQ(bar.Get(key), value) << key;
        const MemoryBag again = host.Save(bar);
        ASSERT_EQ(again.Kept().size(), 1u) << key;
        EXPECT_EQ(again.Kept().front().first, key);
        EXPECT_EQ(again.Kept().front().second, value) << key;
        host.Destroy(bar);
    }
}

TEST(SplitterTables, AllKeysTogetherComeThroughLoadAndSave) {
    HostUnderTest host;
    const MemoryBag saved(OtherValues());
    auto& bar = LoadedBar(host, saved);
    EXPECT_EQ(host.Save(bar).Kept(), OtherValues());
}

TEST(SplitterTables, LimitsSetAsPropertiesComeBackFromTheBag) {
    HostUnderTest host;
    auto& bar = NewBar(host);
    bar.Put("MinTopLeft", 300);
    bar.Put("MinBottomRight", 400);
    const MemoryBag saved = host.Save(bar);
    auto& second = LoadedBar(host, saved, "Splitter2");
    EXPECT_EQ(second.Get("MinTopLeft"), Variant(300));
    EXPECT_EQ(second.Get("MinBottomRight"), Variant(400));
}

TEST(SplitterTables, ALoadReportsTheMousePointersIconAloneSinceThatGoesThroughItsSetter) {
    HostUnderTest host;
    const MemoryBag saved(OtherValues());
    LoadedBar(host, saved);
    EXPECT_THAT(Changes(host), ElementsAre("MouseIcon"));
}

TEST(SplitterTables, ALoadOfAnEmptyBagReportsTheIconToo) {
    HostUnderTest host;
    const MemoryBag nothing;
    LoadedBar(host, nothing);
    EXPECT_THAT(Changes(host), ElementsAre("MouseIcon"));
}

TEST(SplitterTables, ABarPlacedNewReportsNothing) {
    HostUnderTest host;
    NewBar(host);
    EXPECT_THAT(Changes(host), IsEmpty());
}

TEST(SplitterTables, NoEventIsRaisedByALoadOrAPlacing) {
    HostUnderTest host;
    const MemoryBag saved(OtherValues());
    LoadedBar(host, saved);
    NewBar(host, "Splitter2");
    EXPECT_EQ(host.log.EventNames(), "");
}

TEST(SplitterTables, KeysAreCaseSensitive) {
    HostUnderTest host;
    const MemoryBag saved({{"backcolor", OLE_COLOR(1)}, {"MINTOPLEFT", 5}, {"Controlstopleft", "no"}});
    auto& bar = LoadedBar(host, saved);
    EXPECT_EQ(bar.Get("BackColor"), Variant(OLE_COLOR(0x8000000Fu)));
    EXPECT_EQ(bar.Get("MinTopLeft"), Variant(0));
    EXPECT_EQ(bar.Get("ControlsTopLeft"), Variant(""));
}

TEST(SplitterTables, KeysOfOtherTypesAreConvertedOnLoad) {
    HostUnderTest host;
    const MemoryBag saved({{"MinTopLeft", "250"},
                           {"MinBottomRight", true},
                           {"BackColor", "255"},
                           {"ForeColor", -2147483643},
                           {"Enabled", "False"},
                           {"Orientation", "1"},
                           {"MousePointer", 2.0},
                           {"HighlightColor", 1.0}});
    auto& bar = LoadedBar(host, saved);
    EXPECT_EQ(bar.Get("MinTopLeft"), Variant(250));
    EXPECT_EQ(bar.Get("MinBottomRight"), Variant(-1));
    EXPECT_EQ(bar.Get("BackColor"), Variant(OLE_COLOR(255)));
    EXPECT_EQ(bar.Get("ForeColor"), Variant(OLE_COLOR(0x80000005u)));
    EXPECT_EQ(bar.Get("Enabled"), Variant(false));
    EXPECT_EQ(bar.Get("Orientation"), Variant(vertical));
    EXPECT_EQ(bar.Get("MousePointer"), Variant(2));
    EXPECT_EQ(bar.Get("HighlightColor"), Variant(OLE_COLOR(1)));
}

/// The number of the error with which a load fails; 0 when it succeeds.
int LoadError(HostUnderTest& host, const std::string& key, const Variant& value) {
    const MemoryBag saved({{key, value}});
    return ErrorOf([&] { LoadedBar(host, saved); });
}

TEST(SplitterTables, AValueThatDoesNotConvertFailsTheLoadAndLeavesNoControlBehind) {
    HostUnderTest host;
    for (const auto* key :
         {"MinTopLeft", "MinBottomRight", "BackColor", "ForeColor", "Enabled", "Orientation", "MousePointer", "HighlightColor"}) {
        EXPECT_EQ(LoadError(host, key, "wide"), frame::errors::typeMismatch) << key;
        EXPECT_EQ(host.FindSite("Splitter1"), nullptr) << key;
        EXPECT_EQ(host.OnForm().Count(), 0) << key;
    }
}

TEST(SplitterTables, ANumberThatDoesNotFitFailsTheLoadWithOverflow) {
    HostUnderTest host;
    EXPECT_EQ(LoadError(host, "MousePointer", 70'000), frame::errors::overflow);
    EXPECT_EQ(LoadError(host, "BackColor", 1e12), frame::errors::overflow);
    EXPECT_EQ(host.FindSite("Splitter1"), nullptr);
}

TEST(SplitterTables, AnIconThatIsNoPictureFailsTheLoad) {
    HostUnderTest host;
    EXPECT_NE(LoadError(host, "MouseIcon", "hand.ico"), 0);
    EXPECT_EQ(LoadError(host, "MouseIcon", std::make_shared<frame::Font>()), frame::errors::typeMismatch);
    EXPECT_EQ(host.OnForm().Count(), 0);
}

// When the icon is reported the keys before it have been loaded and those behind it have not.
TEST(SplitterTables, TheIconsSetterRunsAtItsPlaceInTheLoad) {
    const MemoryBag saved(OtherValues());
    Stage stage({.show = false});
    std::vector<Variant> seen;
    stage.onPropertyChanged = [&](std::string_view) {
        for (const auto* name : {"ControlsBottomRight", "MousePointer", "Appearance", "HighlightColor"})
            seen.push_back(stage.Bar().Get(name));
    };
    stage.Bar().ReadProperties(saved);
    ASSERT_EQ(seen.size(), 4u);
    EXPECT_EQ(seen[0], Variant("List1"));
    EXPECT_EQ(seen[1], Variant(2));
    EXPECT_EQ(seen[2], Variant(grooved));
    EXPECT_EQ(seen[3], Variant(OLE_COLOR(0xC0C000)));
    EXPECT_EQ(stage.Bar().Get("Appearance"), Variant(serrated));
}

TEST(SplitterTables, ALoadDrawsNothing) {
    const MemoryBag saved(OtherValues());
    Stage stage({.saved = &saved});
    EXPECT_THAT(Drawn(stage.canvas), IsEmpty());
}

TEST(SplitterTables, SavingWhileHoveredAndDraggedKeepsNothingOfThem) {
    HostUnderTest host;
    auto& bar = NewBar(host);
    Press(bar, 50, 50);
    MoveTo(bar, 50, 50);
    EXPECT_THAT(host.Save(bar).Kept(), IsEmpty());
}

// Setters.

TEST(SplitterTables, EachSetterStoresAndReportsItsKeyFirst) {
    HostUnderTest host;
    auto& bar = NewBar(host);
    for (const auto& [key, value] : OtherValues()) {
        host.log.Clear();
        bar.Put(key, value);
        const auto changes = Changes(host);
        ASSERT_FALSE(changes.empty()) << key;
        EXPECT_EQ(changes.front(), key);
        EXPECT_TRUE(key == "Orientation" || changes.size() == 1) << key;
        EXPECT_EQ(bar.Get(key), value) << key;
    }
}

TEST(SplitterTables, EachSetterWorksAtDesignTimeButIdents) {
    HostUnderTest host;
    auto& bar = host.Create(SplitterClass(), "Splitter1", {.designTime = true});
    for (const auto& [key, value] : OtherValues()) {
        if (key == "Ident") continue;
        host.log.Clear();
        bar.Put(key, value);
        EXPECT_EQ(bar.Get(key), value) << key;
        ASSERT_FALSE(Changes(host).empty()) << key;
        EXPECT_EQ(Changes(host).front(), key);
    }
}

TEST(SplitterTables, ASetterReportsAValueThatIsTheSameToo) {
    HostUnderTest host;
    auto& bar = NewBar(host);
    for (const auto* name : {"MinTopLeft", "MinBottomRight", "BackColor", "ForeColor", "Enabled", "ControlsTopLeft",
                             "ControlsBottomRight", "MousePointer", "MouseIcon", "Appearance", "HighlightColor", "Ident"}) {
        host.log.Clear();
        bar.Put(name, bar.Get(name));
        EXPECT_THAT(Changes(host), ElementsAre(name));
    }
}

TEST(SplitterTables, LimitsAndListsAreStoredWithoutAnyTest) {
    HostUnderTest host;
    auto& bar = NewBar(host);
    for (const float value : {-500.0f, 0.25f, 1e9f}) {
        bar.Put("MinTopLeft", value);
        bar.Put("MinBottomRight", value);
        EXPECT_EQ(bar.Get("MinTopLeft"), Variant(value));
        EXPECT_EQ(bar.Get("MinBottomRight"), Variant(value));
    }
    for (const std::string list : {",,,", "no such control", " a ( b , ) ", "Text1(999999)"}) {
        bar.Put("ControlsTopLeft", list);
        bar.Put("ControlsBottomRight", list);
        EXPECT_EQ(bar.Get("ControlsTopLeft"), Variant(list));
        EXPECT_EQ(bar.Get("ControlsBottomRight"), Variant(list));
    }
}

TEST(SplitterTables, LimitsAre32BitFloats) {
    HostUnderTest host;
    auto& bar = NewBar(host);
    bar.Put("MinTopLeft", 0.1);
    EXPECT_EQ(bar.Get("MinTopLeft"), Variant(0.1f));
    EXPECT_FALSE(bar.Get("MinTopLeft") == Variant(0.1));
}

TEST(SplitterTables, ALimitThatIsNoNumberIsRefusedAndTheOldOneStays) {
    HostUnderTest host;
    auto& bar = NewBar(host);
    bar.Put("MinTopLeft", 100);
    host.log.Clear();
    EXPECT_EQ(ErrorOf([&] { bar.Put("MinTopLeft", "wide"); }), frame::errors::typeMismatch);
    EXPECT_EQ(bar.Get("MinTopLeft"), Variant(100));
    EXPECT_THAT(Changes(host), IsEmpty());
}

TEST(SplitterTables, AValueThatDoesNotConvertIsRefusedWithoutAReport) {
    HostUnderTest host;
    auto& bar = NewBar(host);
    host.SiteOf(bar)->SetPlace(10, 20);
    for (const auto* name :
         {"MinTopLeft", "MinBottomRight", "BackColor", "ForeColor", "Enabled", "Orientation", "MousePointer", "HighlightColor"}) {
        const Variant before = bar.Get(name);
        EXPECT_EQ(ErrorOf([&] { bar.Put(name, "wide"); }), frame::errors::typeMismatch) << name;
        EXPECT_EQ(bar.Get(name), before) << name;
    }
    EXPECT_EQ(ErrorOf([&] { bar.Put("MousePointer", 70'000); }), frame::errors::overflow);
    EXPECT_NE(ErrorOf([&] { bar.Put("MouseIcon", 5); }), 0);
    EXPECT_THAT(Changes(host), IsEmpty());
    EXPECT_EQ(host.SiteOf(bar)->Left(), 10);
    EXPECT_EQ(host.SiteOf(bar)->Top(), 20);
}

TEST(SplitterTables, ColoursPointerAndEnabledAreThoseOfTheSurface) {
    HostUnderTest host;
    auto& bar = NewBar(host);
    const auto icon = std::make_shared<Picture>(480.0f, 480.0f, "hand.ico");
    bar.Put("BackColor", OLE_COLOR(0x111111));
    bar.Put("ForeColor", OLE_COLOR(0x222222));
    bar.Put("Enabled", false);
    bar.Put("MousePointer", 11);
    bar.Put("MouseIcon", icon);
    EXPECT_EQ(bar.Surface().BackColor(), OLE_COLOR(0x111111));
    EXPECT_EQ(bar.Surface().ForeColor(), OLE_COLOR(0x222222));
    EXPECT_FALSE(bar.Surface().Enabled());
    EXPECT_EQ(bar.Surface().MousePointer(), 11);
    EXPECT_EQ(bar.Surface().MouseIcon(), icon);
}

TEST(SplitterTables, TheIconIsTheSameObjectAndCanBeTakenAway) {
    HostUnderTest host;
    auto& bar = NewBar(host);
    const auto icon = std::make_shared<Picture>(480.0f, 480.0f, "hand.ico");
    bar.Put("MouseIcon", icon);
    EXPECT_EQ(bar.Get("MouseIcon").ToObject().Get(), icon.get());
    bar.Put("MouseIcon", frame::ObjectRef());
    EXPECT_TRUE(bar.Get("MouseIcon").ToObject().IsNothing());
}

TEST(SplitterTables, IdentIsRefusedAtDesignTimeAndLeavesValueAndBagAsTheyWere) {
    HostUnderTest host;
    auto& bar = host.Create(SplitterClass(), "Splitter1", {.designTime = true});
    const auto kept = host.Save(bar).Kept();
    host.log.Clear();
    EXPECT_EQ(ErrorOf([&] { bar.Put("Ident", 5); }), 387);
    EXPECT_EQ(bar.Get("Ident"), Variant(0));
    EXPECT_EQ(host.Save(bar).Kept(), kept);
    EXPECT_THAT(Changes(host), IsEmpty());
}

TEST(SplitterTables, IdentIsSetAndReportedAtRunTime) {
    HostUnderTest host;
    auto& bar = NewBar(host);
    bar.Put("Ident", 5);
    EXPECT_EQ(bar.Get("Ident"), Variant(5));
    EXPECT_THAT(Changes(host), ElementsAre("Ident"));
}

TEST(SplitterTables, IdentIsLoadedAtDesignTimeWithoutARefusal) {
    HostUnderTest host;
    const MemoryBag saved({{"Ident", std::int16_t{7}}});
    auto& bar = host.Create(SplitterClass(), "Splitter1", {.designTime = true, .saved = &saved});
    EXPECT_EQ(bar.Get("Ident"), Variant(7));
}

TEST(SplitterTables, IdentIsAVariantThatHoldsATextToo) {
    HostUnderTest host;
    auto& bar = NewBar(host);
    bar.Put("Ident", "left bar");
    EXPECT_EQ(bar.Get("Ident"), Variant("left bar"));
}

TEST(SplitterTables, SettersRaiseNoEvent) {
    HostUnderTest host;
    auto& bar = NewBar(host);
    for (const auto& [key, value] : OtherValues()) bar.Put(key, value);
    EXPECT_EQ(host.log.EventNames(), "");
}

}  // namespace
}  // namespace tessel::controls
