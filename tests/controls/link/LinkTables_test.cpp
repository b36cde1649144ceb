#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "controls/link/Link.h"
#include "frame/ClassTable.h"
#include "tests/HostUnderTest.h"
#include "tests/controls/link/LinkTestHelp.h"

namespace tessel::controls {
namespace {

using frame::ControlError;
using frame::Font;
using frame::MemoryBag;
using frame::OLE_COLOR;
using frame::Variant;
using frame::VarType;
using test::HostUnderTest;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;
using namespace linktest;

// Members.

/// "BackColor 1 Long colour", "Refresh -550 method", "OpenLink 17 method String".
std::string Described(const frame::Member& member) {
    std::string line = std::string(member.name) + " " + std::to_string(Link::table.NumberOf(member));
    if (member.isMethod) line += " method";
    if (member.type.type != VarType::Empty) line += " " + std::string(VarTypeName(member.type.type));
    if (member.type.isColor) line += " colour";
    if (member.type.enumeration) line += " " + std::string(member.type.enumeration->name);
    return line;
}

const frame::Member& MemberNamed(std::string_view name) { return *Link::table.Find(name); }
std::string HelpOf(std::string_view name) { return std::string(MemberNamed(name).help); }

TEST(LinkTables, MembersStandInTheOrderOfTheInterfaceWithTheirNumbersAndTypes) {
    std::vector<std::string> lines;
    for (const auto& member : Link::table.members) lines.push_back(Described(member));
    EXPECT_THAT(lines,
                ElementsAre("BackColor 1 Long colour", "Enabled -514 Boolean", "Font -512 Object",
                            "BorderStyle -504 Integer LabelBorderConstants", "Refresh -550 method",
                            "Alignment 6 Integer AlignmentConstants", "Appearance -520 Integer AppearanceConstants",
                            "AutoSize -500 Boolean", "Caption -518 String", "WordWrap 10 Boolean", "HighlightColor 11 Long colour",
                            "UsedColor 12 Long colour", "LinkTo 13 String", "ForeColor 14 Long colour", "BorderSize 15 Single",
                            "SuppressMessages 16 Boolean", "OpenLink 17 method String", "PrintLink 18 method String",
                            "ClickAction 19 Integer ClickActionConstants"));
}

TEST(LinkTables, TheClassIsNamedLink) { EXPECT_EQ(Link::table.name, "Link"); }

TEST(LinkTables, EveryPropertyMayBeReadAndSetAtAnyTime) {
    for (const auto& member : Link::table.members) {
        if (member.isMethod) continue;
        EXPECT_EQ(member.access, frame::Access::Plain) << member.name;
        EXPECT_TRUE(member.get && member.set) << member.name;
    }
}

TEST(LinkTables, HelpTextsAreTheLinksOwnWords) {
    EXPECT_EQ(HelpOf("HighlightColor"), "Color set when hovered over");
    EXPECT_EQ(HelpOf("UsedColor"), "Color used when link has been used");
    EXPECT_EQ(HelpOf("LinkTo"), "String to link to - could be a filename, URL or email address");
    EXPECT_EQ(HelpOf("ForeColor"), "The color of the font text that has not yet been used (clicked).");
    EXPECT_EQ(HelpOf("BorderSize"),
              "Defines the size of the border around the control.  This senses the mouse moving off the control and hence "
              "defines the active area of the control.");
    EXPECT_EQ(HelpOf("SuppressMessages"), "Suppress error messages from open and print  actions");
    EXPECT_EQ(HelpOf("OpenLink"), "Open the item in LinkTo");
    EXPECT_EQ(HelpOf("PrintLink"), "Open the item in LinkTo");
    EXPECT_EQ(HelpOf("ClickAction"), "The action to take when the control is clicked");
}

TEST(LinkTables, OpenLinkAndPrintLinkTakeAnOptionalVariant) {
    for (const auto* name : {"OpenLink", "PrintLink"}) {
        const auto parameters = MemberNamed(name).parameters.All();
        ASSERT_EQ(parameters.size(), 1u) << name;
        EXPECT_EQ(parameters[0].name, "MyLinkTo");
        EXPECT_TRUE(parameters[0].optional);
        EXPECT_FALSE(parameters[0].byReference);
        EXPECT_EQ(parameters[0].type.type, VarType::Empty);
    }
    EXPECT_TRUE(MemberNamed("Refresh").parameters.All().empty());
}

TEST(LinkTables, ClickActionsAreThreeNamedNumbers) {
    std::vector<std::string> constants;
    for (const auto& constant : MemberNamed("ClickAction").type.enumeration->constants)
        constants.push_back(std::string(constant.name) + "=" + std::to_string(constant.value));
    EXPECT_THAT(constants, ElementsAre("Do_nothing=0", "Open_Link=1", "Print_Link=2"));
}

TEST(LinkTables, AMemberAnswersByNameInAnyCaseAndByNumber) {
    HostUnderTest host;
    auto& link = NewLink(host);
    link.Put(-518, "Home");
    link.Put("forecolor", OLE_COLOR(0x123456));
    link.Put(1, OLE_COLOR(0x654321));
    link.Put("BORDERSIZE", 12.5);
    EXPECT_EQ(link.Get("caption"), Variant("Home"));
    EXPECT_EQ(link.Get(14), Variant(OLE_COLOR(0x123456)));
    EXPECT_EQ(link.Get("BackColor"), Variant(OLE_COLOR(0x654321)));
    EXPECT_EQ(link.Get(15), Variant(12.5f));
    EXPECT_EQ(link.BorderSize(), 12.5f);
}

TEST(LinkTables, TheStockNumbersOfTheColoursAndOfTextAreNotTheLinks) {
    HostUnderTest host;
    auto& link = NewLink(host);
    for (const int number : {frame::dispatch::backColor, frame::dispatch::foreColor, frame::dispatch::text, 0, 2, 20}) {
        try {
            link.Get(number);
            ADD_FAILURE() << number << " answers";
        } catch (const ControlError& error) {
            EXPECT_EQ(error.Number(), frame::errors::noSuchMember) << number;
        }
    }
}

TEST(LinkTables, OpenLinkByNumberTakesItsTargetAndGivesTheMessage) {
    HostUnderTest host;
    auto& link = NewLink(host);
    host.shell.executeResults = {33, 2};
    std::vector<Variant> target = {"a.txt"};
    EXPECT_EQ(link.Call(17, target), Variant(""));
    EXPECT_EQ(link.Call("PrintLink", target), Variant("Unable to find file"));
    EXPECT_EQ(link.Call("OpenLink"), Variant(""));
    EXPECT_THAT(Requests(host), ElementsAre("open a.txt", "print a.txt"));
}

TEST(LinkTables, TheLabelIsReachedByItsName) {
    HostUnderTest host;
    auto& link = NewLink(host);
    EXPECT_EQ(link.Inner("Label1").Get(), &link.Label1);
    EXPECT_EQ(link.Label1.Path(), "Link1.Label1");
}

// Events.

/// "MouseDown -605(Button Integer, Shift Integer, X Single, Y Single)", each argument by reference.
std::string Described(const frame::EventInfo& event) {
    std::string line = std::string(event.name) + " " + std::to_string(event.number);
    for (const auto& parameter : event.parameters.All())
        line += " " + std::string(parameter.byReference ? "&" : "") + std::string(parameter.name) + ":" +
                std::string(VarTypeName(parameter.type.type));
    return line;
}

TEST(LinkTables, EventsAreTheStockOnesAndTheKeyEventsAreDeclaredToo) {
    std::vector<std::string> lines;
    for (const auto* event : Link::table.events) lines.push_back(Described(*event));
    EXPECT_THAT(lines, UnorderedElementsAre("Click -600", "DblClick -601", "KeyDown -602 &KeyCode:Integer &Shift:Integer",
                                            "KeyPress -603 &KeyAscii:Integer", "KeyUp -604 &KeyCode:Integer &Shift:Integer",
                                            "MouseDown -605 &Button:Integer &Shift:Integer &X:Single &Y:Single",
                                            "MouseMove -606 &Button:Integer &Shift:Integer &X:Single &Y:Single",
                                            "MouseUp -607 &Button:Integer &Shift:Integer &X:Single &Y:Single"));
}

// The bag.

const std::vector<std::string> keys = {
    "BackColor", "Enabled",        "Font",      "BorderStyle", "Alignment", "Appearance", "AutoSize",         "Caption",
    "WordWrap",  "HighlightColor", "UsedColor", "LinkTo",      "Forecolor", "BorderSize", "SuppressMessages", "ClickAction"};

/// A bag that keeps nothing and remembers what it was asked for.
struct AskedBag final : frame::PropertyBag {
    Variant ReadProperty(std::string_view key, const Variant& otherwise) const override {
        asked.emplace_back(std::string(key), otherwise);
        return otherwise;
    }
    void WriteProperty(std::string_view, const Variant&, const Variant&) override {}

    mutable std::vector<std::pair<std::string, Variant>> asked;
};

/// The keys with the types and values of their defaults: "BackColor Long 0x8000000F".
std::string DefaultLine(const std::string& key, const Variant& value) {
    std::string line = key + " " + std::string(VarTypeName(value.Type()));
    if (value.Type() != VarType::Object)
        line += " " + (value.Type() == VarType::Long ? std::to_string(value.ToColor().value) : value.ToText());
    return line;
}

const std::vector<std::string> defaultLines = {
    "BackColor Long 2147483663", "Enabled Boolean True",   "Font Object",
    "BorderStyle Integer 0",     "Alignment Integer 0",    "Appearance Integer 1",
    "AutoSize Boolean False",    "Caption String Label1",  "WordWrap Boolean False",
    "HighlightColor Long 192",   "UsedColor Long 8388736", "LinkTo String ",
    "Forecolor Long 12582912",   "BorderSize Integer 30",  "SuppressMessages Boolean False",
    "ClickAction Integer 1"};

TEST(LinkTables, LoadAsksForEveryKeyInItsOrderWithItsDefault) {
    HostUnderTest host;
    const AskedBag bag;
    LoadedLink(host, bag);
    std::vector<std::string> lines;
    for (const auto& [key, otherwise] : bag.asked) lines.push_back(DefaultLine(key, otherwise));
    EXPECT_EQ(lines, defaultLines);
}

TEST(LinkTables, SaveHandsOverEveryKeyInTheSameOrderWithTheSameDefault) {
    HostUnderTest host;
    auto& link = NewLink(host);
    std::vector<std::string> lines;
    const MemoryBag bag = host.Save(link);
    for (const auto& write : bag.Written()) lines.push_back(DefaultLine(write.key, write.otherwise));
    EXPECT_EQ(lines, defaultLines);
}

TEST(LinkTables, TheDefaultOfTheFontIsTheAmbientFont) {
    HostUnderTest host;
    const auto ambient = std::make_shared<Font>("Courier", 20);
    const AskedBag asked;
    auto& link = host.Create<Link>("Link1", {.saved = &asked, .ambientFont = ambient});
    EXPECT_EQ(asked.asked.at(2).second, Variant(ambient));
    const MemoryBag saved = host.Save(link);
    EXPECT_EQ(saved.Written().at(2).otherwise, Variant(ambient));
}

TEST(LinkTables, SavedValuesHaveTheTypesOfTheirPlaces) {
    HostUnderTest host;
    auto& link = NewLink(host);
    std::vector<std::string> lines;
    const MemoryBag bag = host.Save(link);
    for (const auto& write : bag.Written()) lines.push_back(write.key + " " + std::string(VarTypeName(write.value.Type())));
    EXPECT_THAT(lines, ElementsAre("BackColor Long", "Enabled Boolean", "Font Object", "BorderStyle Integer", "Alignment Integer",
                                   "Appearance Integer", "AutoSize Boolean", "Caption String", "WordWrap Boolean",
                                   "HighlightColor Long", "UsedColor Long", "LinkTo String", "Forecolor Long",
                                   "BorderSize Single",  // the float it is, beside a default that is an integer
                                   "SuppressMessages Boolean", "ClickAction Integer"));
}

TEST(LinkTables, ALinkPlacedNewAndSavedAtOnceHandsOverItsDefaults) {
    HostUnderTest host;
    auto& link = NewLink(host);
    const MemoryBag bag = host.Save(link);
    for (const auto& write : bag.Written()) EXPECT_EQ(write.value, write.otherwise) << write.key;
    EXPECT_THAT(bag.Kept(), IsEmpty());
}

TEST(LinkTables, ALinkLoadedFromAnEmptyBagEqualsANewOne) {
    HostUnderTest host;
    const MemoryBag nothing;
    auto& placed = NewLink(host);
    auto& loaded = host.Create<Link>("Link2", {.saved = &nothing, .width = width, .height = height});
    for (const auto& member : Link::table.members) {
        if (member.isMethod) continue;
        EXPECT_EQ(placed.Get(member.name), loaded.Get(member.name)) << member.name;
    }
    EXPECT_EQ(placed.Label1.ForeColor(), loaded.Label1.ForeColor());
}

/// For each key a value that is not its default.
MemoryBag::Contents OtherValues() {
    return {{"BackColor", OLE_COLOR(0xABCDEF)},
            {"Enabled", false},
            {"Font", std::make_shared<Font>("Courier", 20)},
            {"BorderStyle", std::int16_t{1}},
            {"Alignment", std::int16_t{2}},
            {"Appearance", std::int16_t{0}},
            {"AutoSize", true},
            {"Caption", "Home"},
            {"WordWrap", true},
            {"HighlightColor", OLE_COLOR(0x010203)},
            {"UsedColor", OLE_COLOR(0x80000012)},
            {"LinkTo", "C:\\Notes.txt"},
            {"Forecolor", OLE_COLOR(0x040506)},
            {"BorderSize", 12.5f},
            {"SuppressMessages", true},
            {"ClickAction", std::int16_t{2}}};
}

/// The public property of a key.
std::string PropertyOf(const std::string& key) { return key == "Forecolor" ? "ForeColor" : key; }

TEST(LinkTables, EachKeyByItselfComesThroughLoadAndSave) {
    HostUnderTest host;
    for (const auto& [key, value] : OtherValues()) {
        const MemoryBag saved({{key, value}});
        auto& link = LoadedLink(host, saved);
        EXPECT_EQ(link.Get(PropertyOf(key)), value) << key;
        const MemoryBag again = host.Save(link);
        ASSERT_EQ(again.Kept().size(), 1u) << key;
        EXPECT_EQ(again.Kept().front().first, key);
        EXPECT_EQ(again.Kept().front().second, value) << key;
        host.Destroy(link);
    }
}

TEST(LinkTables, AllKeysTogetherComeThroughSetSaveAndLoad) {
    HostUnderTest host;
    auto& link = NewLink(host);
    for (const auto& [key, value] : OtherValues()) link.Put(PropertyOf(key), value);
    const MemoryBag saved = host.Save(link);
    EXPECT_EQ(saved.Kept(), OtherValues());
    auto& second = host.Create<Link>("Link2", {.saved = &saved, .width = width, .height = height});
    EXPECT_EQ(host.Save(second).Kept(), OtherValues());
    EXPECT_EQ(second.Label1.ForeColor(), OLE_COLOR(0x040506));
}

TEST(LinkTables, EachSetterReportsItsKeyOnce) {
    for (const bool designTime : {true, false}) {
        HostUnderTest host;
        auto& link = host.Create<Link>("Link1", {.designTime = designTime});
        std::vector<std::string> reported;
        for (const auto& [key, value] : OtherValues()) {
            link.Put(PropertyOf(key), value);
            EXPECT_EQ(link.Get(PropertyOf(key)), value);
            for (const auto& name : Changes(host)) reported.push_back(name);
            host.log.Clear();
        }
        EXPECT_EQ(reported, keys);
    }
}

TEST(LinkTables, ASetterReportsAValueThatIsTheSameToo) {
    HostUnderTest host;
    auto& link = NewLink(host);
    host.log.Clear();
    for (const auto& key : keys) link.Put(PropertyOf(key), link.Get(PropertyOf(key)));
    EXPECT_EQ(Changes(host), keys);
}

TEST(LinkTables, ALoadReportsNothing) {
    HostUnderTest host;
    const MemoryBag saved(OtherValues());
    LoadedLink(host, saved);
    EXPECT_THAT(Changes(host), IsEmpty());
    EXPECT_EQ(host.log.EventNames(), "");
}

TEST(LinkTables, KeysAreCaseSensitive) {
    HostUnderTest host;
    const MemoryBag saved({{"ForeColor", OLE_COLOR(1)}, {"forecolor", OLE_COLOR(2)}, {"caption", "no"}, {"LINKTO", "no"}});
    auto& link = LoadedLink(host, saved);
    EXPECT_EQ(link.ForeColor(), blue);
    EXPECT_EQ(link.Caption(), "Label1");
    EXPECT_EQ(link.LinkTo(), "");
}

TEST(LinkTables, KeysOfOtherTypesAreConvertedOnLoad) {
    HostUnderTest host;
    const MemoryBag saved({{"BackColor", "255"},
                           {"Enabled", "False"},
                           {"Alignment", 2.0},
                           {"AutoSize", std::int16_t{0}},
                           {"Caption", 42},
                           {"WordWrap", 5},
                           {"HighlightColor", -2147483643},
                           {"LinkTo", true},
                           {"BorderSize", "12.5"},
                           {"SuppressMessages", -1},
                           {"ClickAction", "2"}});
    auto& link = LoadedLink(host, saved);
    EXPECT_EQ(link.BackColor(), OLE_COLOR(255));
    EXPECT_FALSE(link.Enabled());
    EXPECT_EQ(link.Alignment(), child::AlignmentConstants::Center);
    EXPECT_FALSE(link.AutoSize());
    EXPECT_EQ(link.Caption(), "42");
    EXPECT_TRUE(link.WordWrap());
    EXPECT_EQ(link.HighlightColor(), OLE_COLOR(0x80000005));
    EXPECT_EQ(link.LinkTo(), "True");
    EXPECT_EQ(link.BorderSize(), 12.5f);
    EXPECT_TRUE(link.SuppressMessages());
    EXPECT_EQ(link.ClickAction(), ClickActionConstants::Print_Link);
}

/// The number of the error with which a load fails; 0 when it succeeds.
int LoadError(HostUnderTest& host, const std::string& key, const Variant& value) {
    const MemoryBag saved({{key, value}});
    try {
        LoadedLink(host, saved);
    } catch (const ControlError& error) {
        return error.Number();
    }
    return 0;
}

TEST(LinkTables, AValueThatDoesNotConvertFailsTheLoadAndLeavesNoControlBehind) {
    HostUnderTest host;
    for (const auto* key : {"BackColor", "Enabled", "BorderStyle", "Alignment", "Appearance", "AutoSize", "WordWrap",
                            "HighlightColor", "UsedColor", "Forecolor", "BorderSize", "SuppressMessages", "ClickAction"}) {
        EXPECT_EQ(LoadError(host, key, "wide"), frame::errors::typeMismatch) << key;
        EXPECT_EQ(host.FindSite("Link1"), nullptr) << key;
        EXPECT_EQ(host.OnForm().Count(), 0) << key;
    }
    EXPECT_THAT(Changes(host), IsEmpty());
}

TEST(LinkTables, ATextThatIsAnArrayFailsTheLoad) {
    HostUnderTest host;
    for (const auto* key : {"Caption", "LinkTo"}) {
        EXPECT_EQ(LoadError(host, key, headless::ListOf(std::vector<std::string>{"a"})), frame::errors::typeMismatch) << key;
        EXPECT_EQ(host.FindSite("Link1"), nullptr) << key;
    }
}

TEST(LinkTables, ANumberThatDoesNotFitFailsTheLoadWithOverflow) {
    HostUnderTest host;
    for (const auto* key : {"BorderStyle", "Alignment", "Appearance", "ClickAction"}) {
        EXPECT_EQ(LoadError(host, key, 70'000), frame::errors::overflow) << key;
        EXPECT_EQ(host.FindSite("Link1"), nullptr) << key;
    }
}

TEST(LinkTables, AFontThatIsNoFontFailsTheLoad) {
    HostUnderTest host;
    EXPECT_NE(LoadError(host, "Font", "Courier"), 0);
    EXPECT_EQ(LoadError(host, "Font", frame::ObjectRef(host.Form())), frame::errors::typeMismatch);
    EXPECT_EQ(host.OnForm().Count(), 0);
}

TEST(LinkTables, AFailedLoadDoesNotHinderTheNextOfTheSameName) {
    HostUnderTest host;
    EXPECT_EQ(LoadError(host, "BorderSize", "wide"), frame::errors::typeMismatch);
    EXPECT_EQ(LoadError(host, "BorderSize", 5), 0);
    ASSERT_NE(host.FindSite("Link1"), nullptr);
    EXPECT_EQ(static_cast<Link&>(host.FindSite("Link1")->Control()).BorderSize(), 5);
}

TEST(LinkTables, AnUnnamedClickActionIsKeptByTheBag) {
    HostUnderTest host;
    for (const std::int16_t action : {std::int16_t{3}, std::int16_t{-1}, std::int16_t{32767}}) {
        const MemoryBag saved({{"ClickAction", action}});
        auto& link = LoadedLink(host, saved);
        EXPECT_EQ(link.Get("ClickAction"), Variant(action));
        EXPECT_EQ(host.Save(link).Kept(), saved.Kept());
        host.Destroy(link);
    }
}

}  // namespace
}  // namespace tessel::controls
