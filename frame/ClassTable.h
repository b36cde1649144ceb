#pragma once

#include <optional>
#include <span>
#include <string_view>

#include "frame/Event.h"
#include "frame/Member.h"

namespace tessel::frame {

class Control;
class OwnSurface;

/// The default of a bag key: a value of the type that the bag holds, the ambient font, no object, or none at all.
struct BagDefault {
    enum class Source : std::uint8_t { Value, AmbientFont, NoObject, None };

    Source source = Source::Value;
    VarType type = VarType::Empty;
    double number = 0;
    std::string_view text = {};
    bool isColor = false;

    Variant For(const Control& control) const;
};

/// One key of a property bag: how it is loaded straight into its place, and how it is read at the moment of a save.
struct BagKey {
    std::string_view name;
    BagDefault onLoad;
    BagDefault onSave;
    bool ownField = false;  ///< lives in an own field: a new control takes the default too
    void (*load)(Control&, const Variant&) = nullptr;
    Variant (*save)(const Control&) = nullptr;
};

/// A key that a save writes behind those of the bag and a load never asks for.
struct SavedKey {
    std::string_view name;
    BagDefault onSave;
    Variant (*save)(const Control&) = nullptr;
};

/// A part that is reached by its name under the object: a child control, a collection, a property that holds an object.
struct Part {
    std::string_view name;
    Object& (*of)(Object&) = nullptr;
};

/// Everything that a class tells of itself.
struct ClassTable {
    std::string_view name;
    std::span<const Member> members;
    std::span<const EventInfo* const> events = {};
    std::span<const BagKey> bag = {};                   ///< in load order
    std::span<const std::string_view> savedOrder = {};  ///< keys in save order, where it is not the load order
    std::span<const SavedKey> savedBehind = {};         ///< written at the end of a save, a name even twice
    std::span<const Part> parts = {};
    std::span<const Member> inputs = {};  ///< what a toolkit reports
    std::string_view defaultMember = {};

    /// The row of a member by name (in any case) or dispatch number; null when there is none.
    const Member* Find(MemberKey key) const;
    const Member* FindInput(std::string_view inputName) const;
    const EventInfo* FindEvent(MemberKey key) const;
    /// The dispatch number of one of `members`: its own, or its place from 1.
    int NumberOf(const Member& member) const;
};

namespace detail {

template <class P>
struct DataMember;
template <class T, class C>
struct DataMember<T C::*> {
    using Class = C;
    using Type = T;
};

template <class C>
const C& Of(const Control& control);
template <class C>
C& Of(Control& control);

const OwnSurface& SurfaceOf(const Control& control);
OwnSurface& SurfaceOf(Control& control);

}  // namespace detail

constexpr BagDefault ValueDefault(VarType type, double number, bool isColor = false) {
    return {BagDefault::Source::Value, type, number, {}, isColor};
}
constexpr BagDefault TextDefault(std::string_view text) { return {BagDefault::Source::Value, VarType::String, 0, text}; }
inline constexpr BagDefault ambientFont{.source = BagDefault::Source::AmbientFont, .type = VarType::Object};
inline constexpr BagDefault noDefault{.source = BagDefault::Source::None};
inline constexpr BagDefault noObject{.source = BagDefault::Source::NoObject, .type = VarType::Object};

/// A key that lives in an own field: `key<&Link::own, &Link::Own::BorderSize>("BorderSize", VarType::Integer, 30)`.
/// The type is that of the default; a load converts to the field's type, a save writes the field's type.
template <auto Own, auto Field>
constexpr BagKey key(std::string_view name, BagDefault onLoad, std::optional<BagDefault> onSave = {}) {
    using C = typename detail::DataMember<decltype(Own)>::Class;
    using T = typename detail::DataMember<decltype(Field)>::Type;
    BagDefault saved = onSave.value_or(onLoad);
    onLoad.isColor = saved.isColor = std::is_same_v<T, OLE_COLOR>;
    return {name,
            onLoad,
            saved,
            true,
            [](Control& control, const Variant& value) { (detail::Of<C>(control).*Own).*Field = FromVariant<T>(value); },
            [](const Control& control) -> Variant { return ToVariant((detail::Of<C>(control).*Own).*Field); }};
}
template <auto Own, auto Field>
constexpr BagKey key(std::string_view name, VarType type, double number) {
    return key<Own, Field>(name, ValueDefault(type, number));
}
template <auto Own, auto Field>
constexpr BagKey key(std::string_view name, std::string_view text) {
    return key<Own, Field>(name, TextDefault(text));
}

/// A key that lives in a child: `childKey<&Link::Label1, &Label::Caption, &Label::SetCaption>("Caption", "Label1")`.
template <auto Child, auto Get, auto Set>
constexpr BagKey childKey(std::string_view name, BagDefault onLoad, std::optional<BagDefault> onSave = {}) {
    using C = typename detail::DataMember<decltype(Child)>::Class;
    using T = std::remove_cvref_t<typename detail::MemberFunction<decltype(Get)>::Result>;
    BagDefault saved = onSave.value_or(onLoad);
    onLoad.isColor = saved.isColor = std::is_same_v<T, OLE_COLOR>;
    return {name,
            onLoad,
            saved,
            false,
            [](Control& control, const Variant& value) { ((detail::Of<C>(control).*Child).*Set)(FromVariant<T>(value)); },
            [](const Control& control) -> Variant { return ToVariant(((detail::Of<C>(control).*Child).*Get)()); }};
}
template <auto Child, auto Get, auto Set>
constexpr BagKey childKey(std::string_view name, VarType type, double number) {
    return childKey<Child, Get, Set>(name, ValueDefault(type, number));
}
template <auto Child, auto Get, auto Set>
constexpr BagKey childKey(std::string_view name, std::string_view text) {
    return childKey<Child, Get, Set>(name, TextDefault(text));
}

/// A key that lives in the control's own surface:
/// `surfaceKey<&OwnSurface::Enabled, &OwnSurface::SetEnabled>("Enabled", VarType::Boolean, true)`.
template <auto Get, auto Set>
constexpr BagKey surfaceKey(std::string_view name, BagDefault onLoad, std::optional<BagDefault> onSave = {}) {
    using T = std::remove_cvref_t<typename detail::MemberFunction<decltype(Get)>::Result>;
    BagDefault saved = onSave.value_or(onLoad);
    onLoad.isColor = saved.isColor = std::is_same_v<T, OLE_COLOR>;
    return {name,
            onLoad,
            saved,
            false,
            [](Control& control, const Variant& value) { (detail::SurfaceOf(control).*Set)(FromVariant<T>(value)); },
            [](const Control& control) -> Variant { return ToVariant((detail::SurfaceOf(control).*Get)()); }};
}
template <auto Get, auto Set>
constexpr BagKey surfaceKey(std::string_view name, VarType type, double number) {
    return surfaceKey<Get, Set>(name, ValueDefault(type, number));
}

/// A key that a load sets as a program does, by the control's public setter:
/// `setterKey<&Splitter::MouseIcon, &Splitter::SetMouseIcon>("MouseIcon", noObject)`.
template <auto Get, auto Set>
constexpr BagKey setterKey(std::string_view name, BagDefault byDefault) {
    using C = typename detail::MemberFunction<decltype(Get)>::Class;
    using T = std::remove_cvref_t<typename detail::MemberFunction<decltype(Get)>::Result>;
    return {name,
            byDefault,
            byDefault,
            false,
            [](Control& control, const Variant& value) { (detail::Of<C>(control).*Set)(FromVariant<T>(value)); },
            [](const Control& control) -> Variant { return ToVariant((detail::Of<C>(control).*Get)()); }};
}

/// A child control or other part: `part<&Link::Label1>("Label1")`.
template <auto Member>
constexpr Part part(std::string_view name) {
    using C = typename detail::DataMember<decltype(Member)>::Class;
    return {name, [](Object& object) -> Object& { return static_cast<C&>(object).*Member; }};
}

}  // namespace tessel::frame
