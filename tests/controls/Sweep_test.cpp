#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <set>
#include <span>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "controls/Classes.h"
#include "frame/ClassTable.h"
#include "frame/Control.h"
#include "frame/Text.h"
#include "tests/HostUnderTest.h"
#include "tests/frame/TestControl.h"

/// What holds for every class of controls and every row of its table, and for the parts that are reached through it.
namespace tessel::controls {
namespace {

using frame::Access;
using frame::ClassTable;
using frame::ControlClass;
using frame::Member;
using frame::Object;
using frame::Variant;
using frame::VarType;
using headless::Placing;
using test::ErrorOf;
using test::HostUnderTest;

/// An object of the library and where it stands: "Link", "Link.Label1".
struct Place {
    std::string path;
    Object* object;
};

void AddPlaces(const std::string& path, Object& object, std::vector<Place>& places) {
    if (std::any_of(places.begin(), places.end(), [&](const Place& place) { return place.object == &object; })) return;
    places.push_back({path, &object});
    for (const frame::Part& part : object.Table().parts) AddPlaces(path + "." + std::string(part.name), part.of(object), places);
}

/// One control of a class, the objects inside it, and their rows.
class Sweep : public testing::TestWithParam<ControlClass> {
  protected:
    const ClassTable& Table() const { return *GetParam().table; }
    frame::Control& Make(const Placing& placing = {}) { return host.Create(GetParam(), "Swept1", placing); }

    std::vector<Place> Places(frame::Control& control) const {
        std::vector<Place> places;
        AddPlaces(std::string(Table().name), control, places);
        for (frame::ChildControl* child : control.Children())
            AddPlaces(std::string(Table().name) + "." + child->Name(), *child, places);
        return places;
    }
    /// Calls `visit` for each row of members of the control and of all inside it.
    void EachMember(frame::Control& control,
                    const std::function<void(const std::string& path, Object&, const Member&)>& visit) const {
        for (const Place& place : Places(control))
            for (const Member& member : place.object->Table().members)
                visit(place.path + "." + std::string(member.name), *place.object, member);
    }

    HostUnderTest host;
};

template <class Rows, class NameOf>
void ExpectUniqueNames(const std::string& where, const Rows& rows, NameOf nameOf) {
    std::set<std::string> names;
    for (const auto& row : rows) {
        EXPECT_FALSE(nameOf(row).empty()) << where;
        EXPECT_TRUE(names.insert(frame::FoldCase(nameOf(row))).second) << where << ": " << nameOf(row) << " comes twice";
    }
}

void ExpectNamedParameters(const std::string& where, const frame::Parameters& parameters) {
    ExpectUniqueNames(where, parameters.All(), [](const frame::Parameter& parameter) { return parameter.name; });
}

// Rows

TEST_P(Sweep, NamesAreUniqueWithoutRegardToCase) {
    for (const Place& place : Places(Make())) {
        const ClassTable& table = place.object->Table();
        EXPECT_FALSE(table.name.empty()) << place.path;
        ExpectUniqueNames(place.path, table.members, [](const Member& row) { return row.name; });
        ExpectUniqueNames(place.path, table.inputs, [](const Member& row) { return row.name; });
        ExpectUniqueNames(place.path, table.events, [](const frame::EventInfo* row) { return row->name; });
        ExpectUniqueNames(place.path, table.parts, [](const frame::Part& row) { return row.name; });
    }
}

TEST_P(Sweep, DispatchNumbersAreUnique) {
    for (const Place& place : Places(Make())) {
        const ClassTable& table = place.object->Table();
        std::map<int, std::string_view> numbers;
        for (const Member& member : table.members) {
            const auto [taken, added] = numbers.emplace(table.NumberOf(member), member.name);
            EXPECT_TRUE(added) << place.path << ": " << member.name << " and " << taken->second;
            EXPECT_NE(table.NumberOf(member), 0);
        }
    }
}

TEST_P(Sweep, EventNumbersAreUnique) {
    for (const Place& place : Places(Make())) {
        std::map<int, std::string_view> numbers;
        for (const frame::EventInfo* event : place.object->Table().events) {
            const auto [taken, added] = numbers.emplace(event->number, event->name);
            EXPECT_TRUE(added) << place.path << ": " << event->name << " and " << taken->second;
            EXPECT_NE(event->number, 0);
        }
    }
}

constexpr std::pair<std::string_view, int> stockMembers[] = {
    {"AutoSize", -500}, {"BackColor", -501}, {"BorderStyle", -504}, {"Font", -512},       {"ForeColor", -513},
    {"Enabled", -514},  {"Text", -517},      {"Caption", -518},     {"Appearance", -520}, {"Refresh", -550}};
constexpr std::pair<std::string_view, int> stockEvents[] = {{"Click", -600},     {"DblClick", -601}, {"KeyDown", -602},
                                                            {"KeyPress", -603},  {"KeyUp", -604},    {"MouseDown", -605},
                                                            {"MouseMove", -606}, {"MouseUp", -607}};

/// The stock number of a name; 0 for a name that has none.
int StockNumber(std::span<const std::pair<std::string_view, int>> stock, std::string_view name) {
    const auto found = std::find_if(stock.begin(), stock.end(), [&](const auto& entry) { return entry.first == name; });
    return found != stock.end() ? found->second : 0;
}

TEST_P(Sweep, AMemberHasItsStockNumberOrItsPlace) {
    int place = 0;
    for (const Member& member : Table().members) {
        const int number = Table().NumberOf(member), stock = StockNumber(stockMembers, member.name);
        // A member that is not there yet keeps its place free.
        place = member.number > 0 ? std::max(member.number, place + 1) : place + 1;
        EXPECT_EQ(number, number > 0 ? place : stock) << member.name;
    }
}

TEST_P(Sweep, AnEventHasItsStockNumberOrAnOrdinaryOne) {
    const auto events = Table().events;
    for (const frame::EventInfo* event : events) {
        if (event->number < 0) {
            EXPECT_EQ(event->number, StockNumber(stockEvents, event->name)) << event->name;
        } else {
            EXPECT_LE(event->number, static_cast<int>(events.size())) << event->name;
        }
    }
}

TEST_P(Sweep, EveryMemberTellsWhatItIsFor) {
    for (const Member& member : Table().members) EXPECT_FALSE(member.help.empty()) << Table().name << "." << member.name;
    for (const frame::EventInfo* event : Table().events) EXPECT_FALSE(event->help.empty()) << Table().name << "." << event->name;
}

TEST_P(Sweep, EveryParameterHasAName) {
    for (const Place& place : Places(Make())) {
        const ClassTable& table = place.object->Table();
        for (const Member& member : table.members)
            if (member.isMethod) ExpectNamedParameters(place.path + "." + std::string(member.name), member.parameters);
        for (const Member& member : table.inputs)
            ExpectNamedParameters(place.path + "." + std::string(member.name), member.parameters);
        for (const frame::EventInfo* event : table.events)
            ExpectNamedParameters(place.path + "." + std::string(event->name), event->parameters);
    }
}

TEST_P(Sweep, EveryArgumentOfAnEventGoesByReference) {
    for (const frame::EventInfo* event : Table().events)
        for (const frame::Parameter& parameter : event->parameters.All()) EXPECT_TRUE(parameter.byReference) << event->name;
}

TEST_P(Sweep, EveryRowHasTheFunctionsOfItsKind) {
    EachMember(Make(), [](const std::string& path, Object&, const Member& member) {
        const bool settable = !member.isMethod && (member.access == Access::Plain || member.access == Access::RunTime);
        EXPECT_EQ(member.call != nullptr, member.isMethod) << path;
        EXPECT_EQ(member.get != nullptr, !member.isMethod) << path;
        EXPECT_EQ(member.set != nullptr, settable) << path;
    });
}

TEST_P(Sweep, EveryRowIsFoundByItsNameInAnyCaseAndByItsNumber) {
    EachMember(Make(), [](const std::string& path, Object& object, const Member& member) {
        const ClassTable& table = object.Table();
        EXPECT_EQ(table.Find(frame::FoldCase(member.name)), &member) << path;
        EXPECT_EQ(table.Find(table.NumberOf(member)), &member) << path;
    });
}

TEST_P(Sweep, TheDefaultMemberIsAProperty) {
    for (const Place& place : Places(Make())) {
        const ClassTable& table = place.object->Table();
        if (table.defaultMember.empty()) continue;
        const Member* member = table.Find(table.defaultMember);
        ASSERT_NE(member, nullptr) << place.path;
        EXPECT_FALSE(member->isMethod) << place.path;
    }
}

TEST_P(Sweep, AnEnumerationNamesEachConstantAndEachNumberOnce) {
    EachMember(Make(), [](const std::string& path, Object&, const Member& member) {
        if (!member.type.enumeration) return;
        std::set<int> values;
        for (const auto& constant : member.type.enumeration->constants) EXPECT_TRUE(values.insert(constant.value).second) << path;
        EXPECT_FALSE(values.empty()) << path;
        ExpectUniqueNames(path, member.type.enumeration->constants, [](const auto& constant) { return constant.name; });
    });
}

TEST_P(Sweep, EveryChildIsAPartUnderItsName) {
    frame::Control& control = Make();
    for (frame::ChildControl* child : control.Children()) EXPECT_EQ(control.Inner(child->Name()).Get(), child) << child->Name();
    for (const frame::Part& part : Table().parts) EXPECT_EQ(control.Inner(part.name).Get(), &part.of(control)) << part.name;
}

// Properties

/// Values to try for a property, by its type.
std::vector<Variant> ValuesFor(const frame::TypeInfo& type) {
    if (type.enumeration) {
        std::vector<Variant> values;
        for (const auto& constant : type.enumeration->constants) values.emplace_back(constant.value);
        return values;
    }
    if (type.isColor) return {frame::OLE_COLOR(0x123456), frame::OLE_COLOR(0x8000000Fu), frame::OLE_COLOR(0)};
    switch (type.type) {
        case VarType::Boolean:
            return {true, false};
        case VarType::Integer:
        case VarType::Long:
            return {1, 0, 3, 500};
        case VarType::Single:
        case VarType::Double:
            return {1, 0, 0.5, 90.25};
        case VarType::String:
            return {"text", "", "\u00E4 \u20AC"};
        case VarType::Date:
            return {frame::Date{36'000.25}};
        case VarType::Object:
            return {std::make_shared<frame::Font>("Arial", 14), std::make_shared<frame::Picture>(150.0f, 300.0f, "a.bmp")};
        default:
            return {1, "text"};
    }
}

bool IsIndexed(const Member& member) { return member.parameters.count != 0; }

/// The keys with another default on load than on save: what the save leaves out comes back as something else.
bool LoadsWhatASaveLeavesOut(const frame::BagKey& key) {
    return !(key.onLoad.type == key.onSave.type && key.onLoad.number == key.onSave.number);
}

/// The properties that take a value only where there is something to choose it from.
bool ChoosesFromWhatIsThere(const std::string& path) {
    static const std::set<std::string, std::less<>> names = {"Icons",        "SmallIcons",    "ColumnHeaderIcons", "ImageList",
                                                             "SelectedItem", "DropHighlight", "TopIndex",          "ImageWidth",
                                                             "ImageHeight",  "ListIndex"};
    return names.contains(std::string_view(path).substr(path.rfind('.') + 1));
}

TEST_P(Sweep, APropertyThatIsSetToWhatItReadsReadsTheSame) {
    EachMember(Make(), [](const std::string& path, Object& object, const Member& member) {
        if (member.isMethod || member.access != Access::Plain || IsIndexed(member)) return;
        bool took = false;
        for (const Variant& value : ValuesFor(member.type)) {
            if (ErrorOf([&] { object.Put(member.name, value); }) != 0) continue;
            const Variant read = object.Get(member.name);
            took = took || read == value;
            EXPECT_EQ(ErrorOf([&] { object.Put(member.name, read); }), 0) << path;
            EXPECT_TRUE(object.Get(member.name) == read) << path;
        }
        EXPECT_TRUE(took || ChoosesFromWhatIsThere(path)) << path << " took no value";
    });
}

TEST_P(Sweep, AValueThatDoesNotConvertLeavesAPropertyAsItWas) {
    EachMember(Make(), [](const std::string& path, Object& object, const Member& member) {
        if (member.isMethod || member.access != Access::Plain || IsIndexed(member)) return;
        if (member.type.type == VarType::String || member.type.type == VarType::Empty) return;
        const Variant before = object.Get(member.name);
        EXPECT_NE(ErrorOf([&] { object.Put(member.name, "no such value"); }), 0) << path;
        EXPECT_TRUE(object.Get(member.name) == before) << path;
    });
}

TEST_P(Sweep, APropertyReadsAsTheTypeThatItsRowTells) {
    EachMember(Make(), [](const std::string& path, Object& object, const Member& member) {
        if (member.isMethod || IsIndexed(member) || member.type.type == VarType::Empty) return;
        EXPECT_EQ(object.Get(member.name).Type(), member.type.type) << path;
    });
}

TEST_P(Sweep, ARunTimePropertyRefusesAtDesignTimeAndKeepsItsValueAndTheBag) {
    frame::Control& control = Make({.designTime = true});
    const auto kept = host.Save(control).Kept();
    for (const Member& member : Table().members) {
        if (member.access != Access::RunTime || IsIndexed(member)) continue;
        const Variant before = control.Get(member.name);
        for (const Variant& value : ValuesFor(member.type))
            EXPECT_EQ(ErrorOf([&] { control.Put(member.name, value); }), frame::errors::notPermitted) << member.name;
        EXPECT_TRUE(control.Get(member.name) == before) << member.name;
    }
    EXPECT_TRUE(host.Save(control).Kept() == kept);
}

TEST_P(Sweep, ARunTimePropertyIsPermittedAtRunTime) {
    frame::Control& control = Make();
    for (const Member& member : Table().members) {
        if (member.access != Access::RunTime || IsIndexed(member)) continue;
        for (const Variant& value : ValuesFor(member.type))
            EXPECT_NE(ErrorOf([&] { control.Put(member.name, value); }), frame::errors::notPermitted) << member.name;
    }
}

TEST_P(Sweep, AReadOnlyPropertyRefusesAlwaysAndKeepsItsValueAndTheBag) {
    for (const bool designTime : {true, false}) {
        frame::Control& control = Make({.designTime = designTime});
        const auto kept = host.Save(control).Kept();
        for (const Member& member : Table().members) {
            const bool readOnly = member.access == Access::ReadOnly, getOnly = member.access == Access::GetOnly;
            if (member.isMethod || IsIndexed(member) || (!readOnly && !getOnly)) continue;
            const int expected = readOnly && designTime ? frame::errors::notPermitted : frame::errors::notAtRunTime;
            const Variant before = control.Get(member.name);
            for (const Variant& value : ValuesFor(member.type))
                EXPECT_EQ(ErrorOf([&] { control.Put(member.name, value); }), expected) << member.name;
            EXPECT_TRUE(control.Get(member.name) == before) << member.name;
        }
        EXPECT_TRUE(host.Save(control).Kept() == kept);
    }
}

// The bag

/// A bag that remembers what was asked and answers with the defaults.
class AskedBag final : public frame::PropertyBag {
  public:
    Variant ReadProperty(std::string_view key, const Variant& otherwise) const override {
        reads.emplace_back(key);
        return otherwise;
    }
    void WriteProperty(std::string_view key, const Variant&, const Variant&) override { writes.emplace_back(key); }

    mutable std::vector<std::string> reads;
    std::vector<std::string> writes;
};

std::vector<std::string> KeysOf(const ClassTable& table) {
    std::vector<std::string> keys;
    for (const frame::BagKey& key : table.bag) keys.emplace_back(key.name);
    return keys;
}

TEST_P(Sweep, EveryKeyIsReadOnceInTheOrderOfTheTable) {
    const AskedBag bag;
    Make({.saved = &bag});
    EXPECT_EQ(bag.reads, KeysOf(Table()));
}

TEST_P(Sweep, EveryKeyIsWrittenOnceInTheOrderOfSaving) {
    AskedBag bag;
    Make().WriteProperties(bag);
    const auto order = Table().savedOrder;
    for (auto behind = Table().savedBehind; !behind.empty(); behind = behind.first(behind.size() - 1)) {
        ASSERT_FALSE(bag.writes.empty());
        EXPECT_EQ(bag.writes.back(), behind.back().name);
        bag.writes.pop_back();
    }
    EXPECT_EQ(bag.writes, order.empty() ? KeysOf(Table()) : std::vector<std::string>(order.begin(), order.end()));
    EXPECT_THAT(bag.writes, testing::UnorderedElementsAreArray(KeysOf(Table())));
    EXPECT_EQ(std::set<std::string>(bag.writes.begin(), bag.writes.end()).size(), bag.writes.size());
}

std::string Keys(const frame::MemoryBag& bag) {
    std::string keys;
    for (const auto& [key, value] : bag.Kept()) keys += (keys.empty() ? "" : " ") + key;
    return keys;
}

TEST_P(Sweep, PlacedNewAndSavedAtOnceGivesAnEmptyBag) {
    EXPECT_EQ(Keys(host.Save(Make())), "");
    // Before it is shown: a bar puts itself at its place then.
    EXPECT_EQ(Keys(host.Save(Make({.designTime = true, .show = false}))), "");
}

/// The keys that a load from an empty bag brings into the next save.
std::string KeysThatALoadBrings(const ClassTable& table) {
    std::string keys;
    for (const frame::BagKey& key : table.bag)
        if (LoadsWhatASaveLeavesOut(key)) keys += (keys.empty() ? "" : " ") + std::string(key.name);
    return keys;
}

TEST_P(Sweep, LoadedFromAnEmptyBagAndSavedGivesAnEmptyBag) {
    const frame::MemoryBag empty;
    EXPECT_EQ(Keys(host.Save(Make({.saved = &empty}))), KeysThatALoadBrings(Table()));
    const auto font = std::make_shared<frame::Font>("Arial", 14);
    EXPECT_EQ(Keys(host.Save(Make({.saved = &empty, .ambientFont = font}))), KeysThatALoadBrings(Table()));
}

TEST_P(Sweep, EveryKeyThatNamesAPropertyKeepsWhatIsSet) {
    for (const frame::BagKey& key : Table().bag) {
        const Member* member = Table().Find(key.name);
        if (!member || member->access != Access::Plain || IsIndexed(*member)) continue;
        frame::Control& control = Make();
        // A value that the save leaves out comes back as the load's default.
        for (const Variant& value : ValuesFor(member->type)) {
            if (ErrorOf([&] { control.Put(member->name, value); }) != 0) continue;
            const Variant read = control.Get(member->name);
            if (LoadsWhatASaveLeavesOut(key) && read == key.onSave.For(control)) continue;
            const frame::MemoryBag bag = host.Save(control);
            EXPECT_TRUE(Make({.saved = &bag}).Get(member->name) == read) << key.name;
        }
    }
}

TEST_P(Sweep, WhatWasSavedLoadsToTheSameSave) {
    frame::Control& control = Make();
    for (const Member& member : Table().members) {
        if (member.isMethod || member.access != Access::Plain || IsIndexed(member)) continue;
        for (const Variant& value : ValuesFor(member.type)) ErrorOf([&] { control.Put(member.name, value); });
    }
    const frame::MemoryBag bag = host.Save(control);
    EXPECT_FALSE(bag.Kept().empty());
    EXPECT_TRUE(host.Save(Make({.saved = &bag})).Kept() == bag.Kept());
}

TEST_P(Sweep, AKeyThatDoesNotConvertFailsTheLoad) {
    // They keep whatever they are given.
    const std::set<std::pair<std::string_view, std::string_view>> keptAsTheyCame = {{"DataList", "Value"}, {"Splitter", "Ident"}};
    for (const frame::BagKey& key : Table().bag) {
        if (keptAsTheyCame.contains({Table().name, key.name})) continue;
        if (key.onLoad.type == VarType::String || key.onLoad.type == VarType::Empty) continue;
        const auto bag = test::BagOf({{std::string(key.name), "no such value"}});
        EXPECT_NE(ErrorOf([&] { Make({.saved = &bag}); }), 0) << key.name;
    }
}

TEST_P(Sweep, APlainPropertyReportsItselfByItsKey) {
    frame::Control& control = Make();
    for (const frame::BagKey& key : Table().bag) {
        const Member* member = Table().Find(key.name);
        if (!member || member->access != Access::Plain || IsIndexed(*member)) continue;
        host.log.Clear();
        bool set = false;
        for (const Variant& value : ValuesFor(member->type)) set = ErrorOf([&] { control.Put(member->name, value); }) == 0 || set;
        const auto changes = host.log.Of("changed");
        const bool told =
            std::any_of(changes.begin(), changes.end(), [&](const auto& entry) { return entry[2] == Variant(key.name); });
        EXPECT_EQ(told, set) << key.name;
    }
}

INSTANTIATE_TEST_SUITE_P(EveryClass, Sweep, testing::ValuesIn(ControlClasses().begin(), ControlClasses().end()),
                         [](const auto& tested) { return std::string(tested.param.table->name); });

// The list of classes

TEST(ControlClasses, StandInTheOrderOfTheirNames) {
    const auto classes = ControlClasses();
    ASSERT_FALSE(classes.empty());
    for (std::size_t i = 1; i < classes.size(); ++i) EXPECT_LT(classes[i - 1].table->name, classes[i].table->name);
}

TEST(ControlClasses, AreFoundByNameInAnyCase) {
    for (const ControlClass& controlClass : ControlClasses()) {
        EXPECT_EQ(FindControlClass(controlClass.table->name), &controlClass);
        EXPECT_EQ(FindControlClass(frame::FoldCase(controlClass.table->name)), &controlClass);
    }
    EXPECT_EQ(FindControlClass("NoSuchControl"), nullptr);
    EXPECT_EQ(FindControlClass(""), nullptr);
}

TEST(ControlClasses, MakeControlsOfTheirTable) {
    HostUnderTest host;
    for (const ControlClass& controlClass : ControlClasses())
        EXPECT_EQ(&host.Create(controlClass, "Made1").Table(), controlClass.table);
}

}  // namespace
}  // namespace tessel::controls
