#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "frame/ClassTable.h"
#include "tests/controls/scorecard/ScoreCardTestHelp.h"

/// What a score card tells of itself, and what it keeps in a property bag.
namespace tessel::controls {
namespace {

using frame::ClassTable;
using frame::Font;
using frame::Member;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;
using namespace scoretest;

const ClassTable& Table() { return *ScoreCardClass().table; }
const Member& MemberNamed(std::string_view name) {
    const Member* member = Table().Find(name);
    if (!member) throw std::runtime_error("no member " + std::string(name));
    return *member;
}
std::string HelpOf(std::string_view name) { return std::string(MemberNamed(name).help); }

/// "tsGaugeOrientation Horizontal=0 Vertical=1"
std::string EnumerationOf(std::string_view name) {
    const frame::Enumeration* enumeration = MemberNamed(name).type.enumeration;
    if (!enumeration) return "none";
    std::string line(enumeration->name);
    for (const auto& constant : enumeration->constants)
        line += " " + std::string(constant.name) + "=" + std::to_string(constant.value);
    return line;
}

// Members.

TEST(ScoreCardTables, TheClassIsNamedScoreCard) { EXPECT_EQ(Table().name, "ScoreCard"); }

TEST(ScoreCardTables, MembersStandInTheOrderOfTheInterfaceWithTheirNumbers) {
    Lines lines;
    for (const Member& member : Table().members)
        lines.push_back(std::string(member.name) + " " + std::to_string(Table().NumberOf(member)));
    EXPECT_THAT(lines, ElementsAre("BackColor -501", "ForeColor -513", "Enabled -514", "Font -512", "BorderStyle -504",
                                   "Refresh -550", "Value 7", "Style 8", "ScoreStar 9", "ScoreGood 10", "ScoreMaybe 11",
                                   "ScoreBad 12", "ScoreMin 13", "ScoreMax 14", "ShowLimitLines 15", "ShowTickLinesEvery 16",
                                   "TickLineColor 17", "FontColor 18", "ShowValue 19", "ToolTipStyle 20", "ToolTip 21",
                                   "ShowMarker 22", "ShowBlocks 23", "GaugeOrientation 24"));
}

TEST(ScoreCardTables, RefreshIsTheOnlyMethodAndTakesNothing) {
    for (const Member& member : Table().members) EXPECT_EQ(member.isMethod, member.name == "Refresh") << member.name;
    EXPECT_THAT(MemberNamed("Refresh").parameters.All(), IsEmpty());
}

TEST(ScoreCardTables, EveryPropertyMayBeReadAndSetAtAnyTime) {
    for (const Member& member : Table().members) {
        if (member.isMethod) continue;
        EXPECT_EQ(member.access, frame::Access::Plain) << member.name;
        EXPECT_TRUE(member.get && member.set) << member.name;
    }
}

TEST(ScoreCardTables, PropertiesHaveTheirTypes) {
    const std::map<std::string, VarType> types = {{"BackColor", VarType::Long},         {"ForeColor", VarType::Long},
                                                  {"Enabled", VarType::Boolean},        {"Font", VarType::Object},
                                                  {"BorderStyle", VarType::Integer},    {"Style", VarType::Integer},
                                                  {"ScoreStar", VarType::Single},       {"ScoreGood", VarType::Single},
                                                  {"ScoreMaybe", VarType::Single},      {"ScoreBad", VarType::Single},
                                                  {"ScoreMin", VarType::Single},        {"ScoreMax", VarType::Single},
                                                  {"ShowLimitLines", VarType::Boolean}, {"TickLineColor", VarType::Long},
                                                  {"FontColor", VarType::Long},         {"ToolTipStyle", VarType::Long},
                                                  {"ToolTip", VarType::String},         {"ShowBlocks", VarType::Integer}};
    for (const auto& [name, type] : types) EXPECT_EQ(MemberNamed(name).type.type, type) << name;
    for (const auto* name : {"BackColor", "ForeColor", "TickLineColor", "FontColor"})
        EXPECT_TRUE(MemberNamed(name).type.isColor) << name;
}

TEST(ScoreCardTables, ValueIsAVariant) { EXPECT_EQ(MemberNamed("Value").type.type, VarType::Empty); }

TEST(ScoreCardTables, EnumerationsNameTheirConstants) {
    EXPECT_EQ(EnumerationOf("Style"),
              "tsScoreCardStyle ScoreCardSmall=0 ScoreCardLarge=1 SmileySmall=2 SmileyLarge=3 TrafficLightSmall=4 "
              "TrafficLightLarge=5 FlashCard=6 Gauge=7 GaugeOverrun=8 GaugeRainbow=9 WeatherSmall=10 WeatherLarge=11");
    EXPECT_EQ(EnumerationOf("ToolTipStyle"), "tsToolTipStyle None=0 ShowTextAsTip=1 ShowValueAsTip=2 ShowBothAsTip=3");
    EXPECT_EQ(EnumerationOf("GaugeOrientation"), "tsGaugeOrientation Horizontal=0 Vertical=1");
    EXPECT_EQ(EnumerationOf("ShowMarker"), "tsMarkerStyle None=0 ShowLine=1 ShowBar=2 ShowFlatBar=3");
    EXPECT_EQ(EnumerationOf("ShowValue"), "tsShowValue None=0 AtLeft=1 AtMiddle=2 AtRight=3 AtTop=4 AtBottom=5 Adjust=6");
}

TEST(ScoreCardTables, HelpTextsOfTheThresholdsAndLimits) {
    EXPECT_EQ(HelpOf("ScoreStar"), "Score above which the control shows star marks");
    EXPECT_EQ(HelpOf("ScoreGood"), "Score above which the control shows a good mark");
    EXPECT_EQ(HelpOf("ScoreMaybe"), "Score above which the control shows a maybe mark");
    EXPECT_EQ(HelpOf("ScoreBad"), "Score above which the control shows a bad mark");
    EXPECT_EQ(HelpOf("ScoreMin"), "Minimum score allowed");
    EXPECT_EQ(HelpOf("ScoreMax"), "Maximum score allowed");
}

TEST(ScoreCardTables, HelpTextsOfStyleAndToolTip) {
    EXPECT_EQ(HelpOf("Style"), "Style for the control, either an image or a gauge style type.");
    EXPECT_EQ(HelpOf("ToolTip"),
              "Returns/sets the text displayed when the mouse is paused over the control.  Overwrites ToolTipText, see "
              "ToolTipStyle.");
}

TEST(ScoreCardTables, HelpTextsOfTheGauge) {
    EXPECT_EQ(HelpOf("ShowLimitLines"), "Shows the limit (bad,maybe,good,star) lines on the control");
    EXPECT_EQ(HelpOf("ShowTickLinesEvery"), "Shows tick lines every interval on the control.  0 means no tick lines.");
    EXPECT_EQ(HelpOf("ShowBlocks"), "Sets the number of blocks the gauge is split into.  Looks like an LED display.");
    EXPECT_EQ(HelpOf("ShowMarker"), "Shows the marker for the value of the gauge.");
    EXPECT_EQ(HelpOf("ShowValue"), "Show the value on the control as text (eg 93%).");
    EXPECT_EQ(HelpOf("GaugeOrientation"), "Changes the gauge orientation from horizontal to vertical.");
    EXPECT_EQ(HelpOf("TickLineColor"), "Sets the line color for the tick marks");
    EXPECT_EQ(HelpOf("FontColor"), "The color used for the value displayed on the control");
}

TEST(ScoreCardTables, AMemberAnswersByNameInAnyCaseAndByNumber) {
    Card card;
    card.control.Put(7, 0.25);
    card.control.Put("BACKCOLOR", OLE_COLOR(0x123456));
    card.control.Put(-513, OLE_COLOR(0x654321));
    EXPECT_EQ(card.Get("value"), Variant(0.25f));
    EXPECT_EQ(card.control.Get(-501), Variant(OLE_COLOR(0x123456)));
    EXPECT_EQ(card.Get("ForeColor"), Variant(OLE_COLOR(0x654321)));
}

TEST(ScoreCardTables, TheChildrenAreReachedByTheirNames) {
    Card card;
    for (const auto* name : {"Picture1", "ImageList32", "ImageList16"}) EXPECT_FALSE(card.control.Inner(name).IsNothing()) << name;
    EXPECT_EQ(card.picture.Path(), "ScoreCard1.Picture1");
}

TEST(ScoreCardTables, ThePictureBoxCountsInPixelsAndTheControlInTwips) {
    Card card({{"Style", style::flashCard}});
    EXPECT_EQ(card.picture.ScaleMode(), frame::ScaleModeConstants::Pixels);
    EXPECT_EQ(card.control.Surface().ScaleMode(), frame::ScaleModeConstants::Twips);
    EXPECT_EQ(card.picture.ScaleWidth(), longSide);
    EXPECT_EQ(card.picture.ScaleHeight(), shortSide);
    EXPECT_EQ(card.control.Surface().ScaleWidth(), Outer(longSide));
    EXPECT_EQ(card.control.Surface().ScaleHeight(), Outer(shortSide));
}

// Events.

std::string Described(const frame::EventInfo& event) {
    std::string line = std::string(event.name) + " " + std::to_string(event.number);
    for (const auto& parameter : event.parameters.All())
        line += " " + std::string(parameter.byReference ? "&" : "") + std::string(parameter.name) + ":" +
                std::string(VarTypeName(parameter.type.type));
    return line;
}

TEST(ScoreCardTables, EventsAreTheStockOnes) {
    Lines lines;
    for (const auto* event : Table().events) lines.push_back(Described(*event));
    EXPECT_THAT(lines, UnorderedElementsAre("Click -600", "DblClick -601", "KeyDown -602 &KeyCode:Integer &Shift:Integer",
                                            "KeyPress -603 &KeyAscii:Integer", "KeyUp -604 &KeyCode:Integer &Shift:Integer",
                                            "MouseDown -605 &Button:Integer &Shift:Integer &X:Single &Y:Single",
                                            "MouseMove -606 &Button:Integer &Shift:Integer &X:Single &Y:Single",
                                            "MouseUp -607 &Button:Integer &Shift:Integer &X:Single &Y:Single"));
}

// The bag.

const Lines loadOrder = {"BackColor",     "ForeColor",  "Enabled",         "Font",           "BorderStyle",
                         "Value",         "Style",      "ScoreStar",       "ScoreGood",      "ScoreMaybe",
                         "ScoreBad",      "ScoreMin",   "ScoreMax",        "ShowLimitLines", "ShowTickLinesEvery",
                         "TickLineColor", "FontColor",  "ShowValue",       "ToolTipStyle",   "ToolTip",
                         "ShowMarker",    "ShowBlocks", "GaugeOrientation"};
const Lines saveOrder = {"BackColor",      "ForeColor",          "Enabled",       "Font",       "BorderStyle",     "Value",
                         "Style",          "ScoreStar",          "ScoreGood",     "ScoreMaybe", "ScoreMin",        "ScoreMax",
                         "ShowLimitLines", "ShowTickLinesEvery", "TickLineColor", "FontColor",  "ShowValue",       "ToolTipStyle",
                         "ToolTip",        "ScoreBad",           "ShowMarker",    "ShowBlocks", "GaugeOrientation"};

/// A bag that keeps nothing and remembers what it was asked for.
struct AskedBag final : frame::PropertyBag {
    Variant ReadProperty(std::string_view key, const Variant& otherwise) const override {
        asked.emplace_back(std::string(key), otherwise);
        return otherwise;
    }
    void WriteProperty(std::string_view, const Variant&, const Variant&) override {}

    mutable std::vector<std::pair<std::string, Variant>> asked;
};

/// The type and value of a default: "Integer 1".
std::string DefaultText(const Variant& value) {
    std::string line(VarTypeName(value.Type()));
    if (value.Type() == VarType::Object) return line;
    return line + " " + (value.Type() == VarType::Long ? std::to_string(value.ToColor().value) : value.ToText());
}

using Defaults = std::map<std::string, std::string>;
const Defaults defaults = {{"BackColor", "Long 2147483663"},
                           {"ForeColor", "Long 2147483666"},
                           {"Enabled", "Boolean True"},
                           {"Font", "Object"},
                           {"BorderStyle", "Integer 1"},
                           {"Value", "Double 0.5"},
                           {"Style", "Integer 0"},
                           {"ScoreStar", "Double 0.8"},
                           {"ScoreGood", "Double 0.6"},
                           {"ScoreMaybe", "Double 0.4"},
                           {"ScoreBad", "Double 0.2"},
                           {"ScoreMin", "Integer 0"},
                           {"ScoreMax", "Integer 1"},
                           {"ShowLimitLines", "Boolean False"},
                           {"ShowTickLinesEvery", "Integer 0"},
                           {"ShowValue", "Integer 0"},
                           {"ToolTipStyle", "Integer 3"},
                           {"ToolTip", "String "},
                           {"ShowMarker", "Integer 0"},
                           {"ShowBlocks", "Integer 0"},
                           {"GaugeOrientation", "Integer 0"}};
/// Two colours whose defaults are plain numbers.
bool IsColorWithAPlainDefault(const std::string& key) { return key == "TickLineColor" || key == "FontColor"; }

std::vector<std::pair<std::string, Variant>> AskedFor(HostUnderTest& host, const frame::FontRef& ambientFont = {}) {
    const AskedBag bag;
    host.Create(ScoreCardClass(), "ScoreCard1", {.saved = &bag, .ambientFont = ambientFont});
    return bag.asked;
}

TEST(ScoreCardTables, LoadAsksForEveryKeyInItsOrder) {
    HostUnderTest host;
    Lines keys;
    for (const auto& [key, otherwise] : AskedFor(host)) keys.push_back(key);
    EXPECT_EQ(keys, loadOrder);
}

TEST(ScoreCardTables, LoadGivesTheDefaultsInTheirTypes) {
    HostUnderTest host;
    Defaults given;
    for (const auto& [key, otherwise] : AskedFor(host))
        if (!IsColorWithAPlainDefault(key)) given[key] = DefaultText(otherwise);
    EXPECT_EQ(given, defaults);
}

TEST(ScoreCardTables, SaveHandsOverEveryKeyWithScoreBadBehindToolTip) {
    Card card;
    Lines keys;
    const MemoryBag bag = card.host.Save(card.control);
    for (const auto& write : bag.Written()) keys.push_back(write.key);
    EXPECT_EQ(keys, saveOrder);
}

TEST(ScoreCardTables, SaveGivesTheSameDefaultsAsLoad) {
    Card card;
    Defaults given;
    const MemoryBag bag = card.host.Save(card.control);
    for (const auto& write : bag.Written())
        if (!IsColorWithAPlainDefault(write.key)) given[write.key] = DefaultText(write.otherwise);
    EXPECT_EQ(given, defaults);
}

TEST(ScoreCardTables, TheDefaultColorsOfTicksAndTextAreZero) {
    HostUnderTest host;
    for (const auto& [key, otherwise] : AskedFor(host))
        if (IsColorWithAPlainDefault(key)) {
            EXPECT_EQ(otherwise.ToColor(), OLE_COLOR(0)) << key;
        }
}

TEST(ScoreCardTables, TheDefaultColorsOfTicksAndTextAreSixteenBitIntegers) {
    Card card;
    HostUnderTest host;
    for (const auto& [key, otherwise] : AskedFor(host))
        if (IsColorWithAPlainDefault(key)) {
            EXPECT_EQ(otherwise.Type(), VarType::Integer) << key;
        }
    const MemoryBag bag = card.host.Save(card.control);
    for (const auto& write : bag.Written())
        if (IsColorWithAPlainDefault(write.key)) {
            EXPECT_EQ(write.otherwise.Type(), VarType::Integer) << write.key;
        }
}

TEST(ScoreCardTables, TheDefaultOfTheFontIsTheAmbientFont) {
    HostUnderTest host;
    const auto ambient = std::make_shared<Font>("Courier", 20);
    const auto asked = AskedFor(host, ambient);
    ASSERT_EQ(asked.size(), loadOrder.size());
    EXPECT_EQ(asked.at(3).second, Variant(ambient));
    const MemoryBag saved = host.Save(host.FindSite("ScoreCard1")->Control());
    EXPECT_EQ(saved.Written().at(3).otherwise, Variant(ambient));
}

TEST(ScoreCardTables, AnEmptyBagGivesThePictureBoxTheAmbientFont) {
    const auto ambient = std::make_shared<Font>("Courier", 20);
    Card card(Options{.ambientFont = ambient});
    EXPECT_EQ(card.Get("Font"), Variant(ambient));
    EXPECT_EQ(Variant(card.picture.Font()), Variant(ambient));
}

TEST(ScoreCardTables, ACardPlacedNewAndSavedAtOnceHandsOverItsDefaults) {
    Card card;
    const MemoryBag bag = card.host.Save(card.control);
    for (const auto& write : bag.Written()) EXPECT_EQ(write.value, write.otherwise) << write.key;
    EXPECT_THAT(bag.Kept(), IsEmpty());
}

TEST(ScoreCardTables, ACardLoadedFromAnEmptyBagEqualsANewOne) {
    Card placed, loaded{MemoryBag::Contents()};
    for (const Member& member : Table().members) {
        if (member.isMethod) continue;
        const std::string name(member.name);
        EXPECT_EQ(placed.Get(name), loaded.Get(name)) << name;
    }
    EXPECT_EQ(placed.ShownImage(), loaded.ShownImage());
    EXPECT_EQ(placed.ToolTip(), loaded.ToolTip());
    EXPECT_EQ(placed.Size(), loaded.Size());
}

TEST(ScoreCardTables, DefaultsAreReadByTheProperties) {
    Card card;
    EXPECT_EQ(card.Get("BackColor"), Variant(OLE_COLOR(buttonFace)));
    EXPECT_EQ(card.Get("ForeColor"), Variant(OLE_COLOR(buttonText)));
    EXPECT_EQ(card.Get("Enabled"), Variant(true));
    EXPECT_EQ(card.Get("BorderStyle"), Variant(1));
    EXPECT_EQ(card.Get("Value"), Variant(0.5));
    EXPECT_EQ(card.Get("Style"), Variant(0));
    EXPECT_EQ(card.Get("ScoreStar"), Variant(0.8f));
    EXPECT_EQ(card.Get("ScoreGood"), Variant(0.6f));
    EXPECT_EQ(card.Get("ScoreMaybe"), Variant(0.4f));
    EXPECT_EQ(card.Get("ScoreBad"), Variant(0.2f));
    EXPECT_EQ(card.Get("ScoreMin"), Variant(0));
    EXPECT_EQ(card.Get("ScoreMax"), Variant(1));
    EXPECT_EQ(card.Get("ShowLimitLines"), Variant(false));
    EXPECT_EQ(card.Get("ShowTickLinesEvery"), Variant(0));
    EXPECT_EQ(card.Get("TickLineColor"), Variant(OLE_COLOR(0)));
    EXPECT_EQ(card.Get("FontColor"), Variant(OLE_COLOR(0)));
    EXPECT_EQ(card.Get("ShowValue"), Variant(0));
    EXPECT_EQ(card.Get("ToolTipStyle"), Variant(3));
    EXPECT_EQ(card.Get("ToolTip"), Variant(""));
    EXPECT_EQ(card.Get("ShowMarker"), Variant(0));
    EXPECT_EQ(card.Get("ShowBlocks"), Variant(0));
    EXPECT_EQ(card.Get("GaugeOrientation"), Variant(0));
}

TEST(ScoreCardTables, ThresholdsAndLimitsReadAsThirtyTwoBitFloats) {
    Card card({{"ScoreStar", 0.8}, {"ScoreMin", 0}});
    for (const auto* name : {"ScoreStar", "ScoreGood", "ScoreMaybe", "ScoreBad", "ScoreMin", "ScoreMax"})
        EXPECT_EQ(card.Get(name).Type(), VarType::Single) << name;
}

/// For each key a value that is not its default; set by their properties in this order, none is clamped.
MemoryBag::Contents OtherValues() {
    return {{"BackColor", OLE_COLOR(0xABCDEF)},
            {"ForeColor", OLE_COLOR(0x80000005)},
            {"Enabled", false},
            {"Font", std::make_shared<Font>("Courier", 20)},
            {"BorderStyle", std::int16_t{0}},
            {"Value", 0.25f},
            {"Style", std::int16_t{style::gaugeRainbow}},
            {"ScoreMin", -1.0f},
            {"ScoreMax", 2.0f},
            {"ScoreStar", 1.5f},
            {"ScoreGood", 0.5f},
            {"ScoreMaybe", 0.25f},
            {"ScoreBad", -0.5f},
            {"ShowLimitLines", true},
            {"ShowTickLinesEvery", 0.25f},
            {"TickLineColor", OLE_COLOR(0x010203)},
            {"FontColor", OLE_COLOR(0x80000012)},
            {"ShowValue", std::int16_t{6}},
            {"ToolTipStyle", std::int32_t{1}},
            {"ToolTip", "A score"},
            {"ShowMarker", std::int16_t{2}},
            {"ShowBlocks", std::int16_t{10}},
            {"GaugeOrientation", std::int16_t{1}}};
}

/// Entries of a bag in the order in which a save writes them.
MemoryBag::Contents AsSaved(const MemoryBag::Contents& contents) {
    MemoryBag::Contents sorted;
    for (const std::string& key : saveOrder)
        for (const auto& entry : contents)
            if (entry.first == key) sorted.push_back(entry);
    return sorted;
}

TEST(ScoreCardTables, EachKeyByItselfComesThroughLoadAndSave) {
    for (const auto& [key, value] : OtherValues()) {
        Card card({{key, value}});
        EXPECT_EQ(card.Get(key), value) << key;
        const MemoryBag again = card.host.Save(card.control);
        ASSERT_EQ(again.Kept().size(), 1u) << key;
        EXPECT_EQ(again.Kept().front().first, key);
        EXPECT_EQ(again.Kept().front().second, value) << key;
    }
}

TEST(ScoreCardTables, AllKeysTogetherComeThroughSetSaveAndLoad) {
    Card card;
    for (const auto& [key, value] : OtherValues()) card.Put(key, value);
    const MemoryBag saved = card.host.Save(card.control);
    EXPECT_EQ(saved.Kept(), AsSaved(OtherValues()));
    Card second(saved.Kept());
    EXPECT_EQ(card.host.Save(second.control).Kept(), AsSaved(OtherValues()));
}

TEST(ScoreCardTables, ALoadKeepsTheTypesThatTheBagGives) {
    Card card({{"Value", 1}, {"ScoreStar", std::int16_t{1}}, {"ScoreMax", 2.5}, {"ShowTickLinesEvery", 0.25}});
    EXPECT_EQ(card.Get("Value").Type(), VarType::Long);
    std::map<std::string, VarType> types;
    const MemoryBag bag = card.host.Save(card.control);
    for (const auto& write : bag.Written()) types[write.key] = write.value.Type();
    EXPECT_EQ(types["Value"], VarType::Long);
    EXPECT_EQ(types["ScoreStar"], VarType::Integer);
    EXPECT_EQ(types["ScoreMax"], VarType::Double);
    EXPECT_EQ(types["ShowTickLinesEvery"], VarType::Double);
    EXPECT_EQ(types["ScoreGood"], VarType::Double);
    EXPECT_EQ(types["ScoreMin"], VarType::Integer);
}

TEST(ScoreCardTables, WhatWasSetIsSavedAsAThirtyTwoBitFloat) {
    Card card;
    for (const auto* name : {"Value", "ScoreStar", "ScoreMin", "ScoreMax"}) card.Put(name, card.Get(name));
    const MemoryBag bag = card.host.Save(card.control);
    for (const auto& write : bag.Written())
        if (write.key == "Value" || write.key == "ScoreStar") {
            EXPECT_EQ(write.value.Type(), VarType::Single) << write.key;
        }
    EXPECT_EQ(bag.ReadProperty("ScoreStar", 0.8), Variant(0.8f));  // no longer the default, a 64-bit float
}

TEST(ScoreCardTables, ALoadDoesNotBringTheLimitsIntoOrder) {
    Card card({{"ScoreMin", 5},
               {"ScoreMax", 1},
               {"ScoreStar", -3.0},
               {"ScoreBad", 9.0},
               {"ShowBlocks", 500},
               {"ToolTipStyle", 9},
               {"ShowValue", 77},
               {"ShowTickLinesEvery", -2},
               {"Style", 99}});
    EXPECT_EQ(card.Number("ScoreMin"), 5);
    EXPECT_EQ(card.Number("ScoreMax"), 1);
    EXPECT_EQ(card.Number("ScoreStar"), -3);
    EXPECT_EQ(card.Number("ScoreBad"), 9);
    EXPECT_EQ(card.Get("ShowBlocks"), Variant(500));
    EXPECT_EQ(card.Get("ToolTipStyle"), Variant(9));
    EXPECT_EQ(card.Get("ShowValue"), Variant(77));
    EXPECT_EQ(card.Get("ShowTickLinesEvery"), Variant(-2));
    EXPECT_EQ(card.Get("Style"), Variant(99));
}

TEST(ScoreCardTables, ALoadReportsNothing) {
    HostUnderTest host;
    const MemoryBag saved(OtherValues());
    host.Create(ScoreCardClass(), "ScoreCard1", {.saved = &saved});
    EXPECT_THAT(host.log.Of("changed"), IsEmpty());
    EXPECT_EQ(host.log.EventNames(), "");
}

TEST(ScoreCardTables, ANewCardReportsNothing) {
    HostUnderTest host;
    host.Create(ScoreCardClass(), "ScoreCard1");
    EXPECT_THAT(host.log.Of("changed"), IsEmpty());
}

TEST(ScoreCardTables, EachSetterReportsItsKeyOnce) {
    for (const bool designTime : {true, false}) {
        Card card(Options{.placedNew = true, .designTime = designTime});
        for (const auto& [key, value] : OtherValues()) {
            card.Put(key, value);
            EXPECT_EQ(card.Get(key), value) << key;
            EXPECT_THAT(card.Changed(), ElementsAre(key));
        }
    }
}

TEST(ScoreCardTables, EverySetterButStyleReportsAValueThatIsTheSameToo) {
    Card card;
    for (const std::string& key : loadOrder) {
        card.Put(key, card.Get(key));
        EXPECT_EQ(card.Changed(), key == "Style" ? Lines() : Lines{key});
    }
}

TEST(ScoreCardTables, KeysAreCaseSensitive) {
    Card card({{"value", 0.9}, {"STYLE", 3}, {"Tooltip", "no"}});
    EXPECT_EQ(card.Get("Value"), Variant(0.5));
    EXPECT_EQ(card.Get("Style"), Variant(0));
    EXPECT_EQ(card.Get("ToolTip"), Variant(""));
}

TEST(ScoreCardTables, KeysOfOtherTypesAreConvertedOnLoad) {
    Card card({{"BackColor", "255"},
               {"ForeColor", -2147483643},
               {"Enabled", "False"},
               {"BorderStyle", "0"},
               {"Style", 6.0},
               {"ShowLimitLines", 5},
               {"TickLineColor", "&HFF"},
               {"FontColor", 255.0},
               {"ToolTipStyle", "2"},
               {"ToolTip", 42},
               {"ShowBlocks", "12"}});
    EXPECT_EQ(card.Get("BackColor"), Variant(OLE_COLOR(255)));
    EXPECT_EQ(card.Get("ForeColor"), Variant(OLE_COLOR(0x80000005)));
    EXPECT_EQ(card.Get("Enabled"), Variant(false));
    EXPECT_EQ(card.Get("BorderStyle"), Variant(0));
    EXPECT_EQ(card.Get("Style"), Variant(6));
    EXPECT_EQ(card.Get("ShowLimitLines"), Variant(true));
    EXPECT_EQ(card.Get("TickLineColor"), Variant(OLE_COLOR(255)));
    EXPECT_EQ(card.Get("FontColor"), Variant(OLE_COLOR(255)));
    EXPECT_EQ(card.Get("ToolTipStyle"), Variant(2));
    EXPECT_EQ(card.Get("ToolTip"), Variant("42"));
    EXPECT_EQ(card.Get("ShowBlocks"), Variant(12));
}

/// The number of the error with which a load fails; 0 when it succeeds.
int LoadError(HostUnderTest& host, const MemoryBag::Contents& contents) {
    const MemoryBag saved(contents);
    const int number = ErrorOf([&] { host.Create(ScoreCardClass(), "ScoreCard1", {.saved = &saved}); });
    if (number == 0) host.Destroy(host.FindSite("ScoreCard1")->Control());
    return number;
}

TEST(ScoreCardTables, AValueThatDoesNotConvertFailsTheLoadAndLeavesNoControlBehind) {
    HostUnderTest host;
    for (const auto* key :
         {"BackColor", "ForeColor", "Enabled", "BorderStyle", "Value", "Style", "ScoreStar", "ScoreGood", "ScoreMaybe", "ScoreBad",
          "ShowLimitLines", "TickLineColor", "FontColor", "ToolTipStyle", "ShowBlocks"}) {
        EXPECT_EQ(LoadError(host, {{key, "wide"}}), frame::errors::typeMismatch) << key;
        EXPECT_EQ(host.FindSite("ScoreCard1"), nullptr) << key;
        EXPECT_EQ(host.OnForm().Count(), 0) << key;
    }
}

TEST(ScoreCardTables, AGaugeWhoseNumbersDoNotConvertFailsToLoad) {
    HostUnderTest host;
    for (const auto* key : {"Value", "ScoreMin", "ScoreMax", "ShowTickLinesEvery"}) {
        EXPECT_EQ(LoadError(host, {{"Style", style::gauge}, {key, "wide"}}), frame::errors::typeMismatch) << key;
        EXPECT_EQ(host.FindSite("ScoreCard1"), nullptr) << key;
    }
}

TEST(ScoreCardTables, ANumberThatDoesNotFitFailsTheLoadWithOverflow) {
    HostUnderTest host;
    for (const auto* key : {"BorderStyle", "Style", "ShowBlocks"})
        EXPECT_EQ(LoadError(host, {{key, 70'000}}), frame::errors::overflow) << key;
}

TEST(ScoreCardTables, AFontThatIsNoFontFailsTheLoad) {
    HostUnderTest host;
    EXPECT_NE(LoadError(host, {{"Font", "Courier"}}), 0);
    EXPECT_EQ(LoadError(host, {{"Font", frame::ObjectRef(host.Form())}}), frame::errors::typeMismatch);
}

}  // namespace
}  // namespace tessel::controls
