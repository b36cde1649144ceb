#include "frame/Object.h"

#include <gtest/gtest.h>

#include <array>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "frame/ClassTable.h"
#include "frame/Font.h"
#include "tests/frame/TestControl.h"

namespace tessel::frame {

// Not in the unnamed namespace: the rows of a table name it in templates that have linkage.
namespace object_test {

/// One member of each kind.
class Thing final : public Object {
  public:
    const std::string& Name() const { return name; }
    void SetName(const std::string& value) { name = value; }
    std::int16_t Small() const { return small; }
    void SetSmall(std::int16_t value) { small = value; }
    std::string Cell(std::int16_t row, std::int32_t column) const {
        const auto found = cells.find({row, column});
        return found != cells.end() ? found->second : "";
    }
    void SetCell(std::int16_t row, std::int32_t column, const std::string& value) { cells[{row, column}] = value; }
    Status SetEven(std::int32_t value) {
        if (value % 2 != 0) return errors::invalidValue;
        even = value;
        return {};
    }
    std::int32_t Even() const { return even; }
    std::int32_t Fixed() const { return 5; }
    const FontRef& Face() const { return face; }
    void SetFace(const FontRef& value) { face = value; }
    Thing& Self() { return *this; }

    std::int32_t Add(std::int16_t a, std::optional<std::int32_t> b) const { return a + b.value_or(100); }
    std::string Kind(const std::optional<Variant>& value) const {
        return value ? std::string(VarTypeName(value->Type())) : "Missing";
    }
    std::string Needed(const Variant& value) const { return std::string(VarTypeName(value.Type())); }
    void Exchange(std::int16_t& number, std::string& text, std::int32_t factor) {
        number = static_cast<std::int16_t>(number * factor);
        text += "!";
    }
    void Spoil(std::int16_t& number) {
        number = 99;
        throw ControlError(errors::invalidCall);
    }
    Status Try(bool works) const { return works ? Status() : Status(errors::diskFull); }
    void Clear() { name.clear(); }

    const ClassTable& Table() const override;

    std::string name = "thing";
    std::int16_t small = 0;
    std::int32_t even = 0;
    FontRef face;
    std::map<std::pair<int, int>, std::string> cells;
};

inline constexpr std::array members = {
    property<&Thing::Name, &Thing::SetName>("Name"),
    property<&Thing::Small, &Thing::SetSmall>("Small", "", -500),
    property<&Thing::Cell, &Thing::SetCell>("Cell"),
    property<&Thing::Even, &Thing::SetEven>("Even"),
    readOnlyProperty<&Thing::Fixed>("Fixed"),
    property<&Thing::Fixed>("Given"),
    property<&Thing::Face, &Thing::SetFace>("Face"),
    method<&Thing::Add>("Add", "", {"A", "B"}),
    method<&Thing::Kind>("Kind", "", {"Value"}),
    method<&Thing::Needed>("Needed", "", {"Value"}),
    method<&Thing::Exchange>("Exchange", "", {"Number", "Text", "Factor"}),
    method<&Thing::Spoil>("Spoil", "", {"Number"}),
    method<&Thing::Try>("Try", "", {"Works"}),
    method<&Thing::Clear>("Clear"),
    property<&Thing::Self>("Self"),
};
inline constexpr std::array parts = {Part{"Inside", [](Object& object) -> Object& { return object; }}};
inline constexpr ClassTable table{.name = "Thing", .members = members, .parts = parts, .defaultMember = "Name"};

inline const ClassTable& Thing::Table() const { return table; }

}  // namespace object_test

namespace {

using object_test::table;
using object_test::Thing;
using test::ErrorOf;

/// Arguments of a call by name.
class With {
  public:
    template <class... Values>
    explicit With(Values... values) : values_{Variant(values)...} {}
    operator Arguments() { return values_; }
    const Variant& operator[](std::size_t index) const { return values_[index]; }

  private:
    std::vector<Variant> values_;
};

// Members by name and number

TEST(Object, KnowsItsMembersByNameInAnyCase) {
    Thing thing;
    EXPECT_EQ(thing.Get("Name").ToText(), "thing");
    EXPECT_EQ(thing.Get("NAME").ToText(), "thing");
    thing.Put("nAmE", "other");
    EXPECT_EQ(thing.name, "other");
    EXPECT_TRUE(thing.Has("name"));
    EXPECT_FALSE(thing.Has("Nam"));
    EXPECT_FALSE(thing.Has(""));
}

TEST(Object, KnowsAMemberByItsPlaceFromOneOrByTheNumberThatItHas) {
    Thing thing;
    EXPECT_EQ(thing.Get(1).ToText(), "thing");
    thing.Put(-500, 8);
    EXPECT_EQ(thing.Get("Small").ToLong(), 8);
    EXPECT_TRUE(thing.Has(3));
    EXPECT_FALSE(thing.Has(2));  // the second has a number of its own
    EXPECT_FALSE(thing.Has(0));
    EXPECT_FALSE(thing.Has(static_cast<int>(table.members.size()) + 1));
    EXPECT_EQ(thing.Call(8, With(1, 2)).ToLong(), 3);
}

TEST(Object, RefusesAMemberThatItLacks) {
    Thing thing;
    With none;
    EXPECT_EQ(ErrorOf([&] { thing.Get("Nothing"); }), errors::noSuchMember);
    EXPECT_EQ(ErrorOf([&] { thing.Put("Nothing", 1); }), errors::noSuchMember);
    EXPECT_EQ(ErrorOf([&] { thing.Call("Nothing", none); }), errors::noSuchMember);
    EXPECT_EQ(ErrorOf([&] { thing.Get(77); }), errors::noSuchMember);
}

TEST(Object, RefusesToReadOrSetAMethod) {
    Thing thing;
    EXPECT_EQ(ErrorOf([&] { thing.Get("Clear"); }), errors::noSuchMember);
    EXPECT_EQ(ErrorOf([&] { thing.Put("Clear", 1); }), errors::noSuchMember);
    EXPECT_EQ(thing.name, "thing");
}

TEST(Object, ReadsAPropertyThatIsCalled) {
    Thing thing;
    thing.cells[{1, 2}] = "x";
    EXPECT_EQ(thing.Call("Name").ToText(), "thing");
    EXPECT_EQ(thing.Call("Cell", With(1, 2)).ToText(), "x");
}

// Properties

TEST(Object, ConvertsAValueThatIsSetAndLeavesTheOldOneWhereThatFails) {
    Thing thing;
    thing.Put("Small", "2.5");
    EXPECT_EQ(thing.small, 2);
    EXPECT_EQ(ErrorOf([&] { thing.Put("Small", "two"); }), errors::typeMismatch);
    EXPECT_EQ(ErrorOf([&] { thing.Put("Small", 40'000); }), errors::overflow);
    EXPECT_EQ(thing.small, 2);
}

TEST(Object, ReadsAndSetsAnIndexedProperty) {
    Thing thing;
    thing.Put("Cell", "here", With(1, "2"));
    EXPECT_EQ(thing.Get("Cell", With(1, 2)).ToText(), "here");
    EXPECT_EQ(thing.Get("Cell", With(2, 1)).ToText(), "");
}

TEST(Object, RefusesMissingAndSurplusIndexes) {
    Thing thing;
    EXPECT_EQ(ErrorOf([&] { thing.Get("Cell"); }), errors::argumentMissing);
    EXPECT_EQ(ErrorOf([&] { thing.Get("Cell", With(1)); }), errors::argumentMissing);
    EXPECT_EQ(ErrorOf([&] { thing.Get("Cell", With(1, 2, 3)); }), errors::wrongArguments);
    EXPECT_EQ(ErrorOf([&] { thing.Put("Cell", "x", With(1)); }), errors::argumentMissing);
    EXPECT_EQ(ErrorOf([&] { thing.Put("Cell", "x", With(1, 2, 3)); }), errors::wrongArguments);
    EXPECT_EQ(ErrorOf([&] { thing.Put("Name", "x", With(1)); }), errors::wrongArguments);
    EXPECT_EQ(ErrorOf([&] { thing.Get("Name", With(1)); }), errors::wrongArguments);
    EXPECT_TRUE(thing.cells.empty());
    EXPECT_EQ(thing.name, "thing");
}

TEST(Object, RefusesAnIndexThatDoesNotConvert) {
    Thing thing;
    EXPECT_EQ(ErrorOf([&] { thing.Get("Cell", With("one", 2)); }), errors::typeMismatch);
    EXPECT_EQ(ErrorOf([&] { thing.Get("Cell", With(70'000, 2)); }), errors::overflow);
}

TEST(Object, TurnsAFailedStatusOfASetterIntoItsError) {
    Thing thing;
    thing.Put("Even", 4);
    EXPECT_EQ(ErrorOf([&] { thing.Put("Even", 5); }), errors::invalidValue);
    EXPECT_EQ(thing.even, 4);
}

TEST(Object, RefusesToSetWhatHasNoSetter) {
    Thing thing;
    EXPECT_EQ(ErrorOf([&] { thing.Put("Fixed", 1); }), errors::notAtRunTime);
    EXPECT_EQ(ErrorOf([&] { thing.Put("Given", 1); }), errors::notAtRunTime);
    EXPECT_EQ(thing.Get("Fixed").ToLong(), 5);
    EXPECT_EQ(thing.Get("Given").ToLong(), 5);
}

TEST(Object, SharesAFontThatIsSetAndTakesNothingForNone) {
    Thing thing;
    const auto font = std::make_shared<Font>("Arial", 10);
    thing.Put("Face", font);
    EXPECT_EQ(thing.face, font);
    EXPECT_EQ(thing.Get("Face").ToObject().Get(), font.get());
    EXPECT_EQ(ErrorOf([&] { thing.Put("Face", std::make_shared<Thing>()); }), errors::typeMismatch);
    EXPECT_EQ(ErrorOf([&] { thing.Put("Face", 5); }), errors::objectRequired);
    EXPECT_EQ(thing.face, font);
    thing.Put("Face", ObjectRef());
    EXPECT_EQ(thing.face, nullptr);
    EXPECT_TRUE(thing.Get("Face").ToObject().IsNothing());
}

// Methods

TEST(Object, TakesAnOptionalArgumentThatIsLeftOffOrMarkedMissing) {
    Thing thing;
    EXPECT_EQ(thing.Call("Add", With(1)).ToLong(), 101);
    EXPECT_EQ(thing.Call("Add", With(1, Variant::Missing())).ToLong(), 101);
    EXPECT_EQ(thing.Call("add", With("1", 2.0)).ToLong(), 3);
    EXPECT_EQ(thing.Call("Kind", With()).ToText(), "Missing");
    EXPECT_EQ(thing.Call("Kind", With(true)).ToText(), "Boolean");
    EXPECT_EQ(thing.Call("Kind", With(Variant())).ToText(), "Empty");
    EXPECT_EQ(thing.Call("Add", With(1, Variant())).ToLong(), 101) << "null is none, but for a variant";
}

TEST(Object, RefusesMissingAndSurplusArguments) {
    Thing thing;
    EXPECT_EQ(ErrorOf([&] { thing.Call("Add"); }), errors::argumentMissing);
    EXPECT_EQ(ErrorOf([&] { thing.Call("Needed"); }), errors::argumentMissing);
    EXPECT_EQ(ErrorOf([&] { thing.Call("Add", With(Variant::Missing(), 2)); }), errors::argumentMissing);
    EXPECT_EQ(ErrorOf([&] { thing.Call("Add", With(1, 2, 3)); }), errors::wrongArguments);
    EXPECT_EQ(ErrorOf([&] { thing.Call("Clear", With(1)); }), errors::wrongArguments);
    EXPECT_EQ(thing.name, "thing");
}

TEST(Object, RefusesArgumentsThatDoNotConvert) {
    Thing thing;
    EXPECT_EQ(ErrorOf([&] { thing.Call("Add", With("x")); }), errors::typeMismatch);
    EXPECT_EQ(ErrorOf([&] { thing.Call("Add", With(40'000)); }), errors::overflow);
}

TEST(Object, WritesByReferenceArgumentsBackInTheirOwnTypes) {
    Thing thing;
    With arguments("21", "hello", 2);
    EXPECT_TRUE(thing.Call("Exchange", arguments).IsEmpty());
    EXPECT_EQ(arguments[0].Type(), VarType::Integer);
    EXPECT_EQ(arguments[0].ToLong(), 42);
    EXPECT_EQ(arguments[1].ToText(), "hello!");
    EXPECT_EQ(arguments[2].ToLong(), 2);
}

TEST(Object, LeavesByReferenceArgumentsOfAFailedCallAsTheyWere) {
    Thing thing;
    With arguments(1);
    EXPECT_EQ(ErrorOf([&] { thing.Call("Spoil", arguments); }), errors::invalidCall);
    EXPECT_EQ(arguments[0].ToLong(), 1);
}

TEST(Object, TurnsAFailedStatusOfAMethodIntoItsError) {
    Thing thing;
    EXPECT_TRUE(thing.Call("Try", With(true)).IsEmpty());
    EXPECT_EQ(ErrorOf([&] { thing.Call("Try", With(false)); }), errors::diskFull);
}

// Inner objects and the default member

TEST(Object, FindsAPartAndAPropertyThatHoldsAnObjectByName) {
    Thing thing;
    EXPECT_EQ(thing.Inner("inside").Get(), &thing);
    EXPECT_EQ(thing.Inner("SELF").Get(), &thing);
    EXPECT_TRUE(thing.Inner("Face").IsNothing());
    thing.face = std::make_shared<Font>();
    EXPECT_EQ(thing.Inner("Face").Get(), thing.face.get());
}

TEST(Object, FindsNoInnerObjectUnderAnyOtherName) {
    Thing thing;
    EXPECT_TRUE(thing.Inner("Name").IsNothing());
    EXPECT_TRUE(thing.Inner("Clear").IsNothing());
    EXPECT_TRUE(thing.Inner("Cell").IsNothing());
    EXPECT_TRUE(thing.Inner("Nobody").IsNothing());
}

TEST(Object, StandsForItsDefaultMemberWhereAValueIsAsked) {
    Thing thing;
    thing.name = "12";
    const Variant reference{ObjectRef(thing)};
    EXPECT_EQ(reference.ToText(), "12");
    EXPECT_EQ(reference.ToLong(), 12);
}

TEST(ClassTable, FindsARowAndItsNumber) {
    const Member* row = table.Find("small");
    ASSERT_NE(row, nullptr);
    EXPECT_EQ(table.NumberOf(*row), -500);
    EXPECT_EQ(table.NumberOf(*table.Find("Cell")), 3);
    EXPECT_EQ(table.Find(4)->name, "Even");
    EXPECT_EQ(table.Find("x"), nullptr);
    EXPECT_EQ(table.FindInput("Name"), nullptr);
    EXPECT_EQ(table.FindEvent("Name"), nullptr);
}

TEST(ClassTable, TellsWhatARowTakesAndGives) {
    const Member& add = *table.Find("Add");
    EXPECT_TRUE(add.isMethod);
    EXPECT_EQ(add.type.type, VarType::Long);
    ASSERT_EQ(add.parameters.count, 2u);
    EXPECT_EQ(add.parameters.list[0].name, "A");
    EXPECT_EQ(add.parameters.list[0].type.type, VarType::Integer);
    EXPECT_FALSE(add.parameters.list[0].optional);
    EXPECT_TRUE(add.parameters.list[1].optional);
    EXPECT_FALSE(add.parameters.list[1].byReference);
    const Member& exchange = *table.Find("Exchange");
    EXPECT_TRUE(exchange.parameters.list[0].byReference);
    EXPECT_FALSE(exchange.parameters.list[2].byReference);
    EXPECT_EQ(exchange.type.type, VarType::Empty);
    EXPECT_TRUE(table.Find("Kind")->parameters.list[0].optional);
}

// References

TEST(WeakObject, KnowsItsObjectUntilThatHasGone) {
    auto thing = std::make_unique<Thing>();
    const WeakObject weak(*thing);
    EXPECT_EQ(weak.Get(), thing.get());
    thing.reset();
    EXPECT_EQ(weak.Get(), nullptr);
    EXPECT_TRUE(weak.EverSet());
    EXPECT_FALSE(WeakObject().EverSet());
}

TEST(WeakObject, OfOneObjectIsEqualToAllOthersOfIt) {
    Thing one, other;
    EXPECT_EQ(WeakObject(one), WeakObject(one));
    EXPECT_FALSE(WeakObject(one) == WeakObject(other));
}

TEST(Handle, ReachesItsTargetAndFailsWithError91WhenItHasGone) {
    auto thing = std::make_unique<Thing>();
    const Handle<Thing> handle(*thing);
    const Handle<Thing> copy = handle;
    EXPECT_TRUE(handle);
    EXPECT_EQ(handle->name, "thing");
    EXPECT_EQ(&*copy, thing.get());
    thing.reset();
    EXPECT_FALSE(handle);
    EXPECT_EQ(copy.Get(), nullptr);
    EXPECT_EQ(ErrorOf([&] { handle->name.clear(); }), errors::objectGone);
    EXPECT_EQ(ErrorOf([&] { (*copy).name.clear(); }), errors::objectGone);
}

TEST(Handle, ThatWasNeverSetFailsWithError91) {
    const Handle<Thing> handle;
    EXPECT_FALSE(handle);
    EXPECT_EQ(ErrorOf([&] { handle->name.clear(); }), errors::objectGone);
}

TEST(Handle, DoesNotComeBackForANewObjectInTheSamePlace) {
    std::optional<Thing> place;
    place.emplace();
    const Handle<Thing> handle(*place);
    place.emplace();
    EXPECT_FALSE(handle);
}

TEST(ObjectRef, KeepsASharedValueAlive) {
    auto font = std::make_shared<Font>("Arial", 10);
    const std::weak_ptr<Font> watched = font;
    {
        const ObjectRef reference(std::move(font));
        EXPECT_FALSE(watched.expired());
        EXPECT_EQ(reference.Shared(), watched.lock());
        EXPECT_EQ(reference->Get("Name").ToText(), "Arial");
    }
    EXPECT_TRUE(watched.expired());
}

TEST(ObjectRef, ToAnythingElseIsWeak) {
    auto thing = std::make_unique<Thing>();
    const ObjectRef reference(*thing);
    EXPECT_EQ(reference.Get(), thing.get());
    EXPECT_EQ(reference.Shared(), nullptr);
    thing.reset();
    EXPECT_EQ(reference.Get(), nullptr);
    EXPECT_FALSE(reference.IsNothing());
    EXPECT_EQ(ErrorOf([&] { reference->Get("Name"); }), errors::objectGone);
}

TEST(ObjectRef, ToNothingFailsWithError91) {
    const ObjectRef nothing;
    EXPECT_TRUE(nothing.IsNothing());
    EXPECT_TRUE(ObjectRef(std::shared_ptr<Font>()).IsNothing());
    EXPECT_EQ(ErrorOf([&] { nothing->Get("Name"); }), errors::objectGone);
}

TEST(ObjectRef, ComparesValuesByContentAndAllElseByIdentity) {
    Thing one, other;
    EXPECT_EQ(ObjectRef(one), ObjectRef(one));
    EXPECT_FALSE(ObjectRef(one) == ObjectRef(other));
    EXPECT_EQ(ObjectRef(std::make_shared<Font>("Arial", 10)), ObjectRef(std::make_shared<Font>("Arial", 10)));
    EXPECT_EQ(ObjectRef(), ObjectRef());
    EXPECT_FALSE(ObjectRef() == ObjectRef(one));
}

TEST(ObjectRef, ToAnObjectThatHasGoneIsNotNothing) {
    auto thing = std::make_unique<Thing>();
    const ObjectRef reference(*thing);
    thing.reset();
    EXPECT_FALSE(reference == ObjectRef());
}

}  // namespace
}  // namespace tessel::frame
