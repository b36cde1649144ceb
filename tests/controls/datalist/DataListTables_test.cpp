#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstdint>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "frame/Font.h"
#include "frame/StockNumbers.h"
#include "tests/controls/datalist/DataListTestHelp.h"

namespace tessel::controls {
namespace {

using frame::Font;
using frame::Member;
using frame::MemoryBag;
using frame::OLE_COLOR;
using frame::VarType;
using test::ErrorOf;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;
using namespace datalisttest;

const Member& MemberNamed(const std::string& name) {
    const Member* found = DataListTable().Find(name);
    if (!found) throw frame::ControlError(frame::errors::noSuchMember, name);
    return *found;
}
std::string HelpOf(const std::string& name) { return std::string(MemberNamed(name).help); }

// Members.

TEST(DataListTables, TheClassIsNamedDataList) { EXPECT_EQ(DataListTable().name, "DataList"); }

TEST(DataListTables, MembersStandInTheOrderOfTheInterfaceAndOnlyFontKeepsAStockNumber) {
    std::vector<std::string> lines;
    for (const Member& member : DataListTable().members)
        lines.push_back(std::string(member.name) + " " + std::to_string(DataListTable().NumberOf(member)) +
                        (member.isMethod ? " method" : ""));
    EXPECT_THAT(lines, ElementsAre("Populate 1 method", "Locked 2", "Value 3", "LockedAlways 4", "AddItem 5 method",
                                   "DefaultValue 6", "DefaultText 7", "Style 8", "BackColor 9", "ForeColor 10", "Enabled 11",
                                   "Font -512", "Appearance 13", "Refresh 14 method", "Text 15", "Clear 16 method",
                                   "RemoveItem 17 method", "Sorted 18", "ListCount 19", "OnlyUniqueValues 20"));
}

TEST(DataListTables, PropertiesHaveTheirTypes) {
    std::vector<std::string> lines;
    for (const Member& member : DataListTable().members) {
        if (member.isMethod) continue;
        lines.push_back(std::string(member.name) + " " + std::string(VarTypeName(member.type.type)) +
                        (member.type.isColor ? " colour" : ""));
    }
    EXPECT_THAT(
        lines, ElementsAre("Locked Boolean", "Value Long", "LockedAlways Boolean", "DefaultValue Long", "DefaultText String",
                           "Style Integer", "BackColor Long colour", "ForeColor Long colour", "Enabled Boolean", "Font Object",
                           "Appearance Integer", "Text String", "Sorted Boolean", "ListCount Integer", "OnlyUniqueValues Boolean"));
}

TEST(DataListTables, ReadingAPropertyGivesItsType) {
    Stage stage;
    for (const Member& member : DataListTable().members) {
        if (member.isMethod) continue;
        EXPECT_EQ(stage.Get(std::string(member.name)).Type(), member.type.type) << member.name;
    }
}

TEST(DataListTables, OnlyValueAndListCountAreForRunTime) {
    for (const Member& member : DataListTable().members) {
        if (member.isMethod) continue;
        const bool runTime = member.name == "Value" || member.name == "ListCount";
        EXPECT_EQ(member.access, runTime ? frame::Access::RunTime : frame::Access::Plain) << member.name;
        EXPECT_TRUE(member.get && member.set) << member.name;
    }
}

TEST(DataListTables, ValueIsTheDefaultMember) {
    EXPECT_EQ(DataListTable().defaultMember, "Value");
    Stage stage;
    stage.Put("DefaultValue", 17);
    EXPECT_EQ(Variant(frame::ObjectRef(stage.Control())).ToLong(), 17);
    EXPECT_EQ(Variant(frame::ObjectRef(stage.Control())).ToText(), "17");
}

TEST(DataListTables, HelpTextsAreTheControlsOwnWords) {
    EXPECT_EQ(HelpOf("Locked"), "Locks the control from user setting but still responds to program setting.");
    EXPECT_EQ(HelpOf("Value"), "Sets or returns the value corresponding to the recordset text and data items.");
    EXPECT_EQ(HelpOf("LockedAlways"), "Overrides the Locked property if set to true");
    EXPECT_EQ(HelpOf("Style"), "Sets the style for the control");
    EXPECT_EQ(HelpOf("Refresh"), "Forces a complete repaint of a object.");
    EXPECT_EQ(HelpOf("Text"), "Reads the current text setting in the list.");
    EXPECT_EQ(HelpOf("Clear"), "Clears all items from the list.");
    EXPECT_EQ(HelpOf("RemoveItem"), "Removes the requested item from the list.");
    EXPECT_EQ(HelpOf("Sorted"), "Sorts the list alphabetically");
    EXPECT_EQ(HelpOf("ListCount"), "Returns the number of items in the list portion of a control.");
    EXPECT_EQ(HelpOf("OnlyUniqueValues"), "When set, you can only add items with unique values");
}

TEST(DataListTables, PopulateTakesARecordsetTwoColumnsAndAnOptionalDefaultPairAndGivesAText) {
    const Member& populate = MemberNamed("Populate");
    std::vector<std::string> lines;
    for (const auto& parameter : populate.parameters.All())
        lines.push_back(std::string(parameter.name) + (parameter.optional ? " optional" : ""));
    EXPECT_THAT(lines, ElementsAre("ListRecordset", "TextColumn", "ValueColumn", "DefaultText optional", "DefaultValue optional"));
    EXPECT_EQ(populate.type.type, VarType::String);
}

TEST(DataListTables, AddItemTakesTextAndValueAsVariantsAndGivesAText) {
    const Member& addItem = MemberNamed("AddItem");
    const auto parameters = addItem.parameters.All();
    ASSERT_EQ(parameters.size(), 2u);
    EXPECT_EQ(parameters[0].name, "Text");
    EXPECT_EQ(parameters[1].name, "Value");
    for (const auto& parameter : parameters) {
        EXPECT_EQ(parameter.type.type, VarType::Empty) << parameter.name;
        EXPECT_FALSE(parameter.optional) << parameter.name;
    }
    EXPECT_EQ(addItem.type.type, VarType::String);
}

TEST(DataListTables, RemoveItemTakesA32BitValueAndClearAndRefreshTakeNothing) {
    const auto parameters = MemberNamed("RemoveItem").parameters.All();
    ASSERT_EQ(parameters.size(), 1u);
    EXPECT_EQ(parameters[0].name, "Value");
    EXPECT_EQ(parameters[0].type.type, VarType::Long);
    EXPECT_FALSE(parameters[0].optional);
    EXPECT_TRUE(MemberNamed("Clear").parameters.All().empty());
    EXPECT_TRUE(MemberNamed("Refresh").parameters.All().empty());
}

TEST(DataListTables, StylesAreThreeNamedNumbers) {
    const frame::Enumeration* styles = MemberNamed("Style").type.enumeration;
    ASSERT_NE(styles, nullptr);
    EXPECT_EQ(styles->name, "DataListStyleConstants");
    std::vector<std::string> constants;
    for (const auto& constant : styles->constants)
        constants.push_back(std::string(constant.name) + "=" + std::to_string(constant.value));
    EXPECT_THAT(constants, ElementsAre("Text_Only=0", "ID_and_Text=1", "Count_and_Text=2"));
}

TEST(DataListTables, AMemberAnswersByNameInAnyCaseAndByNumber) {
    Stage stage;
    stage.Control().Put(6, 12);
    stage.Put("defaulttext", "None");
    EXPECT_EQ(stage.Get("DEFAULTVALUE"), Variant(12));
    EXPECT_EQ(stage.Control().Get(3), Variant(12));
    EXPECT_EQ(stage.Control().Get(15), Variant("None"));
    std::vector<Variant> item = {"Red", 5};
    EXPECT_EQ(stage.Control().Call(5, item), Variant(""));
    EXPECT_EQ(stage.Control().Get(19), Variant(1));
}

TEST(DataListTables, StockNumbersOfItsOtherMembersAreNotAnswered) {
    Stage stage;
    for (const int number : {frame::dispatch::backColor, frame::dispatch::foreColor, frame::dispatch::enabled,
                             frame::dispatch::text, frame::dispatch::appearance, frame::dispatch::refresh, 12, 21})
        EXPECT_EQ(ErrorOf([&] { stage.Control().Call(number, {}); }), frame::errors::noSuchMember) << number;
}

TEST(DataListTables, ChildrenAreReachedByTheirNames) {
    Stage stage;
    for (const auto* name : {"listItems(0)", "listItems(1)", "labItem"}) {
        const frame::ObjectRef child = stage.Control().Inner(name);
        ASSERT_NE(child.Get(), nullptr) << name;
        EXPECT_EQ(child->Path(), std::string("List1.") + name);
    }
}

// Events.

std::string Described(const frame::EventInfo& event) {
    std::string line = std::string(event.name) + " " + std::to_string(event.number);
    for (const auto& parameter : event.parameters.All())
        line += " " + std::string(parameter.byReference ? "&" : "") + std::string(parameter.name) + ":" +
                std::string(VarTypeName(parameter.type.type));
    return line;
}

TEST(DataListTables, EventsAreNumberedInTheirOrderButForTheThreeOfTheMouse) {
    std::vector<std::string> lines;
    for (const auto* event : DataListTable().events) lines.push_back(Described(*event));
    EXPECT_THAT(lines, UnorderedElementsAre("Click 1", "DblClick 2", "KeyDown 3 &KeyCode:Integer &Shift:Integer",
                                            "KeyPress 4 &KeyAscii:Integer", "KeyUp 5 &KeyCode:Integer &Shift:Integer",
                                            "MouseDown -605 &Button:Integer &Shift:Integer &X:Single &Y:Single",
                                            "MouseMove -606 &Button:Integer &Shift:Integer &X:Single &Y:Single",
                                            "MouseUp -607 &Button:Integer &Shift:Integer &X:Single &Y:Single"));
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

/// A key with the type and value of its default: "BackColor Long 2147483653".
std::string DefaultLine(const std::string& key, const Variant& value) {
    std::string line = key + " " + std::string(VarTypeName(value.Type()));
    if (value.Type() == VarType::Object) return line;
    return line + " " + (value.Type() == VarType::Long ? std::to_string(value.ToColor().value) : value.ToText());
}

const std::vector<std::string> defaultLines = {
    "Locked Boolean False", "Value Integer 0",     "LockedAlways Boolean False",    "DefaultValue Integer 0",
    "DefaultText String ",  "Style Integer 0",     "BackColor Long 2147483653",     "ForeColor Long 0",
    "Enabled Boolean True", "Font Object",         "Appearance Integer 0",          "Text String ",
    "Sorted Boolean False", "ListCount Integer 0", "OnlyUniqueValues Boolean False"};
constexpr std::size_t fontKey = 9;

TEST(DataListTables, LoadAsksForEveryKeyInItsOrderWithItsDefaultAndForNoToolTip) {
    const AskedBag bag;
    Stage stage(Stage::Options{.saved = &bag});
    std::vector<std::string> lines;
    for (const auto& [key, otherwise] : bag.asked) lines.push_back(DefaultLine(key, otherwise));
    EXPECT_EQ(lines, defaultLines);
}

TEST(DataListTables, SaveHandsOverTheSameKeysWithTheSameDefaultsInTheSameOrder) {
    Stage stage;
    std::vector<std::string> lines;
    const MemoryBag bag = stage.Save();
    for (const auto& write : bag.Written()) lines.push_back(DefaultLine(write.key, write.otherwise));
    ASSERT_GE(lines.size(), defaultLines.size());
    lines.resize(defaultLines.size());
    EXPECT_EQ(lines, defaultLines);
}

TEST(DataListTables, SaveWritesTheToolTipOfTheFirstListTwiceAtItsEnd) {
    Stage stage;
    stage.List(0).Put("ToolTipText", "First");
    stage.List(1).Put("ToolTipText", "Second");
    stage.Label().Put("ToolTipText", "Third");
    const MemoryBag bag = stage.Save();
    ASSERT_EQ(bag.Written().size(), defaultLines.size() + 2);
    for (std::size_t i = defaultLines.size(); i < bag.Written().size(); ++i) {
        EXPECT_EQ(bag.Written()[i].key, "ToolTipText");
        EXPECT_EQ(bag.Written()[i].value, Variant("First"));
    }
    EXPECT_EQ(DefaultLine("ToolTipText", bag.Written().back().otherwise), "ToolTipText String ");
    EXPECT_EQ(bag.ReadProperty("ToolTipText", ""), Variant("First"));
}

TEST(DataListTables, LoadLeavesASavedToolTipAlone) {
    Loaded loaded{{"ToolTipText", "Saved"}};
    EXPECT_EQ(loaded.stage.List(0).Get("ToolTipText"), Variant(""));
    EXPECT_EQ(loaded.stage.List(1).Get("ToolTipText"), Variant(""));
    EXPECT_EQ(loaded.stage.Label().Get("ToolTipText"), Variant(""));
}

TEST(DataListTables, SavedValuesHaveTheTypesOfTheirFields) {
    Stage stage;
    const MemoryBag bag = stage.Save();
    std::vector<std::string> lines;
    for (const auto& write : bag.Written()) lines.push_back(write.key + " " + std::string(VarTypeName(write.value.Type())));
    EXPECT_THAT(lines, ElementsAre("Locked Boolean", "Value Long", "LockedAlways Boolean", "DefaultValue Long",
                                   "DefaultText String", "Style Integer", "BackColor Long", "ForeColor Long", "Enabled Boolean",
                                   "Font Object", "Appearance Integer", "Text String", "Sorted Boolean", "ListCount Integer",
                                   "OnlyUniqueValues Boolean", "ToolTipText String", "ToolTipText String"));
}

TEST(DataListTables, TheDefaultOfTheFontIsTheAmbientFont) {
    const auto ambient = std::make_shared<Font>("Courier", 20);
    const AskedBag asked;
    Stage stage(Stage::Options{.saved = &asked, .ambientFont = ambient});
    ASSERT_EQ(asked.asked.size(), defaultLines.size());
    EXPECT_EQ(asked.asked[fontKey].second, Variant(ambient));
    EXPECT_EQ(stage.Get("Font"), Variant(ambient));
    const MemoryBag saved = stage.Save();
    EXPECT_EQ(saved.Written()[fontKey].otherwise, Variant(ambient));
}

TEST(DataListTables, OnePlacedNewTakesTheAmbientFont) {
    const auto ambient = std::make_shared<Font>("Courier", 20);
    Stage stage(Stage::Options{.ambientFont = ambient});
    EXPECT_EQ(stage.Get("Font"), Variant(ambient));
}

TEST(DataListTables, OnePlacedNewHasTheDefaultsOfTheBag) {
    Stage stage;
    for (const auto* name : {"Locked", "LockedAlways", "Sorted", "OnlyUniqueValues"})
        EXPECT_EQ(stage.Get(name), Variant(false)) << name;
    for (const auto* name : {"Value", "DefaultValue", "Style", "Appearance", "ListCount"})
        EXPECT_EQ(stage.Get(name), Variant(0)) << name;
    for (const auto* name : {"DefaultText", "Text"}) EXPECT_EQ(stage.Get(name), Variant("")) << name;
    EXPECT_EQ(stage.Get("Enabled"), Variant(true));
    EXPECT_EQ(stage.Get("BackColor"), Variant(OLE_COLOR(0x80000005u)));
    EXPECT_EQ(stage.Get("ForeColor"), Variant(OLE_COLOR(0)));
}

TEST(DataListTables, OnePlacedNewAndSavedAtOnceHandsOverItsDefaults) {
    for (const bool designTime : {true, false}) {
        Stage stage(Stage::Options{.designTime = designTime});
        const MemoryBag bag = stage.Save();
        ASSERT_EQ(bag.Written().size(), defaultLines.size() + 2);
        for (std::size_t i = 0; i < defaultLines.size(); ++i)
            EXPECT_EQ(bag.Written()[i].value, bag.Written()[i].otherwise) << bag.Written()[i].key;
        EXPECT_EQ(bag.Written().back().value, Variant(""));
        EXPECT_THAT(bag.Kept(), IsEmpty());
    }
}

TEST(DataListTables, OneLoadedFromAnEmptyBagEqualsANewOne) {
    Stage placed;
    Loaded loaded{};
    for (const Member& member : DataListTable().members) {
        if (member.isMethod) continue;
        const std::string name(member.name);
        EXPECT_EQ(placed.Get(name), loaded.stage.Get(name)) << name;
    }
    EXPECT_EQ(placed.Visible(), loaded.stage.Visible());
}

/// For each key that a design sets, a value that is not its default.
MemoryBag::Contents OtherValues() {
    return {{"Locked", true},
            {"LockedAlways", true},
            {"DefaultValue", std::int32_t{0}},
            {"DefaultText", "None"},
            {"Style", countAndText},
            {"BackColor", OLE_COLOR(0xABCDEF)},
            {"ForeColor", OLE_COLOR(0x80000012u)},
            {"Enabled", false},
            {"Font", std::make_shared<Font>("Courier", 20)},
            {"Appearance", std::int16_t{1}},
            {"Text", "Red"},
            {"Sorted", true},
            {"OnlyUniqueValues", true}};
}

TEST(DataListTables, EachKeyByItselfComesThroughLoadAndSave) {
    for (const auto& [key, value] : OtherValues()) {
        if (key == "DefaultValue") continue;
        Loaded loaded{{key, value}};
        const MemoryBag saved = loaded.stage.Save();
        ASSERT_EQ(saved.Kept().size(), 1u) << key;
        EXPECT_EQ(saved.Kept().front().first, key);
        EXPECT_EQ(saved.Kept().front().second, value) << key;
        if (key == "Text") continue;  // what is read is the text of the choice
        EXPECT_EQ(loaded.stage.Get(key), value) << key;
    }
}

TEST(DataListTables, AllKeysTogetherComeThroughSetSaveAndLoad) {
    Stage stage(Stage::Options{.show = false});
    MemoryBag::Contents values = OtherValues();
    for (auto& [key, value] : values) {
        if (key == "DefaultValue") value = std::int32_t{40'000};  // beyond 16 bits
        stage.Put(key, value);
    }
    const MemoryBag saved = stage.Save();
    for (const auto& [key, value] : values) EXPECT_EQ(saved.ReadProperty(key, Variant::Missing()), value) << key;
    Stage second(Stage::Options{.saved = &saved, .show = false});
    EXPECT_EQ(second.Save().Kept(), saved.Kept());
    EXPECT_EQ(second.Get("DefaultValue"), Variant(40'000));
}

TEST(DataListTables, ASavedListCountIsTheStoredNumberAndComesThrough) {
    Loaded loaded{{"ListCount", std::int16_t{7}}};
    EXPECT_EQ(loaded.stage.Get("ListCount"), Variant(0));
    EXPECT_EQ(loaded.stage.Saved("ListCount"), Variant(7));
    loaded.stage.Add("Red", 5);
    EXPECT_EQ(loaded.stage.Get("ListCount"), Variant(1));
    EXPECT_EQ(loaded.stage.Saved("ListCount"), Variant(7));
}

TEST(DataListTables, ASavedValueIsThePublicOneAndALoadedOneIsNotUsed) {
    Loaded loaded{{"Value", std::int16_t{9}}, {"DefaultValue", std::int16_t{4}}};
    EXPECT_EQ(loaded.stage.Value(), 4);
    EXPECT_EQ(loaded.stage.Saved("Value"), Variant(4));
    loaded.stage.Add("Red", 70'000);
    loaded.stage.Choose(0);
    EXPECT_EQ(loaded.stage.Saved("Value"), Variant(70'000));
}

TEST(DataListTables, ALoadedValueMayBeAnything) {
    EXPECT_EQ(ErrorOf([] { Loaded loaded{{"Value", "no number"}}; }), 0);
    EXPECT_EQ(ErrorOf([] { Loaded loaded{{"Value", 3e9}}; }), 0);
}

TEST(DataListTables, ItemsAreNotSaved) {
    Stage stage;
    stage.Add("Red", 5);
    const MemoryBag saved = stage.Save();
    EXPECT_EQ(saved.Written().size(), defaultLines.size() + 2);
    Stage second(Stage::Options{.saved = &saved});
    EXPECT_EQ(second.ItemsOf(0), "");
    EXPECT_EQ(second.ItemsOf(1), "");
}

TEST(DataListTables, EachSetterReportsItsKeyOnce) {
    for (const bool designTime : {true, false}) {
        Stage stage(Stage::Options{.designTime = designTime, .show = false});
        for (const auto& [key, value] : OtherValues()) {
            stage.Reset();
            stage.Put(key, value);
            EXPECT_EQ(stage.Happened(), "changed " + key);
        }
    }
}

TEST(DataListTables, ASetterReportsAValueThatIsTheSameToo) {
    Stage stage;
    for (const auto& [key, value] : OtherValues()) {
        stage.Reset();
        stage.Put(key, stage.Get(key));
        EXPECT_EQ(stage.Happened(), "changed " + key);
    }
}

TEST(DataListTables, ALoadReportsNothing) {
    const MemoryBag saved(OtherValues());
    test::HostUnderTest host;
    host.Create(DataListClass(), "List2", {.saved = &saved});
    EXPECT_THAT(host.log.Of("changed"), IsEmpty());
    EXPECT_EQ(host.log.EventNames(), "");
    EXPECT_THAT(host.log.Of("yield"), IsEmpty());
}

TEST(DataListTables, KeysAreCaseSensitive) {
    Loaded loaded{{"locked", true}, {"DEFAULTTEXT", "None"}, {"style", countAndText}};
    EXPECT_EQ(loaded.stage.Get("Locked"), Variant(false));
    EXPECT_EQ(loaded.stage.Get("DefaultText"), Variant(""));
    EXPECT_EQ(loaded.stage.Get("Style"), Variant(textOnly));
}

TEST(DataListTables, KeysOfOtherTypesAreConvertedOnLoad) {
    Loaded loaded{
        {"Locked", "True"},   {"LockedAlways", 5},        {"DefaultValue", "40000"},    {"DefaultText", 42}, {"Style", 1.0},
        {"BackColor", "255"}, {"ForeColor", -2147483643}, {"Enabled", std::int16_t{0}}, {"Appearance", "1"}, {"Text", true},
        {"Sorted", -1},       {"ListCount", "12"},        {"OnlyUniqueValues", 1.5}};
    Stage& stage = loaded.stage;
    for (const auto* name : {"Locked", "LockedAlways", "Sorted", "OnlyUniqueValues"})
        EXPECT_EQ(stage.Get(name), Variant(true)) << name;
    EXPECT_EQ(stage.Get("DefaultValue"), Variant(40'000));
    EXPECT_EQ(stage.Get("DefaultText"), Variant("42"));
    EXPECT_EQ(stage.Get("Style"), Variant(idAndText));
    EXPECT_EQ(stage.Get("BackColor"), Variant(OLE_COLOR(255)));
    EXPECT_EQ(stage.Get("ForeColor"), Variant(OLE_COLOR(0x80000005u)));
    EXPECT_EQ(stage.Get("Enabled"), Variant(false));
    EXPECT_EQ(stage.Get("Appearance"), Variant(1));
    EXPECT_EQ(stage.Saved("Text"), Variant("True"));
    EXPECT_EQ(stage.Saved("ListCount"), Variant(12));
}

/// The number of the error with which a load fails; 0 when it succeeds.
int LoadError(test::HostUnderTest& host, const std::string& key, const Variant& value) {
    const MemoryBag saved({{key, value}});
    return ErrorOf([&] { host.Create(DataListClass(), "List2", {.saved = &saved}); });
}

TEST(DataListTables, AValueThatDoesNotConvertFailsTheLoadAndLeavesNoControlBehind) {
    test::HostUnderTest host;
    for (const auto* key : {"Locked", "LockedAlways", "DefaultValue", "Style", "BackColor", "ForeColor", "Enabled", "Appearance",
                            "Sorted", "ListCount", "OnlyUniqueValues"}) {
        EXPECT_EQ(LoadError(host, key, "wide"), frame::errors::typeMismatch) << key;
        EXPECT_EQ(host.FindSite("List2"), nullptr) << key;
        EXPECT_EQ(host.OnForm().Count(), 0) << key;
    }
}

TEST(DataListTables, ATextThatIsAnArrayFailsTheLoad) {
    test::HostUnderTest host;
    for (const auto* key : {"DefaultText", "Text"})
        EXPECT_EQ(LoadError(host, key, headless::ListOf(std::vector<std::string>{"a"})), frame::errors::typeMismatch) << key;
}

TEST(DataListTables, ANumberThatDoesNotFitFailsTheLoadWithOverflow) {
    test::HostUnderTest host;
    for (const auto* key : {"Style", "Appearance", "ListCount"})
        EXPECT_EQ(LoadError(host, key, 70'000), frame::errors::overflow) << key;
    EXPECT_EQ(LoadError(host, "DefaultValue", 3e9), frame::errors::overflow);
}

TEST(DataListTables, AFontThatIsNoFontFailsTheLoad) {
    test::HostUnderTest host;
    EXPECT_NE(LoadError(host, "Font", "Courier"), 0);
    EXPECT_EQ(LoadError(host, "Font", frame::ObjectRef(host.Form())), frame::errors::typeMismatch);
}

// Refusals.

TEST(DataListRefusals, ValueAndListCountCannotBeSetAtDesignTime) {
    Stage stage(Stage::Options{.designTime = true});
    const std::string before = stage.State();
    const auto kept = stage.Save().Kept();
    for (const auto* name : {"Value", "ListCount"}) {
        const Variant value = stage.Get(name);
        stage.Reset();
        EXPECT_EQ(ErrorOf([&] { stage.Put(name, 1); }), frame::errors::notPermitted) << name;
        EXPECT_EQ(stage.Get(name), value) << name;
        EXPECT_EQ(stage.Happened(), "") << name;
    }
    EXPECT_EQ(stage.State(), before);
    EXPECT_EQ(stage.Save().Kept(), kept);
}

TEST(DataListRefusals, ARefusalCarriesItsNumberAndTheStandardWords) {
    Stage stage(Stage::Options{.designTime = true});
    try {
        stage.Put("Value", 1);
        ADD_FAILURE() << "not refused";
    } catch (const frame::ControlError& error) {
        EXPECT_EQ(error.Number(), 387);
        EXPECT_EQ(error.Description(), frame::ErrorText(387));
    }
}

TEST(DataListRefusals, UserModeIsAskedAtEachSet) {
    Stage stage(Stage::Options{.designTime = true});
    stage.host.SiteOf(stage.Control())->SetUserMode(true);
    EXPECT_EQ(ErrorOf([&] { stage.Put("ListCount", 3); }), 0);
    stage.host.SiteOf(stage.Control())->SetUserMode(false);
    EXPECT_EQ(ErrorOf([&] { stage.Put("ListCount", 4); }), frame::errors::notPermitted);
    EXPECT_EQ(stage.Saved("ListCount"), Variant(3));
}

TEST(DataListRefusals, AtRunTimeBothAreSetAndReported) {
    Stage stage;
    stage.Put("ListCount", 3);
    EXPECT_EQ(stage.Happened(), "changed ListCount");
    stage.Put("Value", 3);
    EXPECT_EQ(stage.Happened(), "changed Value");
}

TEST(DataListRefusals, AValueThatDoesNotConvertLeavesEverythingAsItWas) {
    Stage stage;
    stage.Add("Red", 5);
    stage.Choose(0);
    const std::string before = stage.State();
    const auto kept = stage.Save().Kept();
    stage.Reset();
    for (const auto* name : {"Locked", "Value", "LockedAlways", "DefaultValue", "Style", "BackColor", "ForeColor", "Enabled",
                             "Appearance", "Sorted", "ListCount", "OnlyUniqueValues"})
        EXPECT_EQ(ErrorOf([&] { stage.Put(name, "wide"); }), frame::errors::typeMismatch) << name;
    EXPECT_NE(ErrorOf([&] { stage.Put("Font", "Courier"); }), 0);
    for (const auto* name : {"Style", "Appearance", "ListCount"})
        EXPECT_EQ(ErrorOf([&] { stage.Put(name, 70'000); }), frame::errors::overflow) << name;
    for (const auto* name : {"Value", "DefaultValue"})
        EXPECT_EQ(ErrorOf([&] { stage.Put(name, 3e9); }), frame::errors::overflow) << name;
    EXPECT_EQ(stage.Happened(), "");
    EXPECT_EQ(stage.State(), before);
    EXPECT_EQ(stage.Save().Kept(), kept);
}

TEST(DataListRefusals, MethodsRefuseArgumentsThatDoNotFit) {
    Stage stage;
    EXPECT_EQ(ErrorOf([&] { Call(stage.Control(), "AddItem", {"Red"}); }), frame::errors::argumentMissing);
    EXPECT_EQ(ErrorOf([&] { Call(stage.Control(), "AddItem", {"Red", 5, 6}); }), frame::errors::wrongArguments);
    EXPECT_EQ(ErrorOf([&] { Call(stage.Control(), "RemoveItem"); }), frame::errors::argumentMissing);
    EXPECT_EQ(ErrorOf([&] { stage.Remove("Red"); }), frame::errors::typeMismatch);
    EXPECT_EQ(ErrorOf([&] { stage.Remove(3e9); }), frame::errors::overflow);
    EXPECT_EQ(ErrorOf([&] { Call(stage.Control(), "Clear", {1}); }), frame::errors::wrongArguments);
    EXPECT_EQ(stage.ItemsOf(0), "");
}

}  // namespace
}  // namespace tessel::controls
