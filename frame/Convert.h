#pragma once

#include <concepts>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>

#include "frame/Error.h"
#include "frame/Variant.h"

/// Conversion between a C++ type and a Variant, written once for each type. Tables, events and bags all use it.
namespace tessel::frame {

/// A type T converts by `Conversion<T>::type` (its place in a bag or signature), `From` and `To`.
template <class T>
struct Conversion;

template <>
struct Conversion<bool> {
    static constexpr VarType type = VarType::Boolean;
    static bool From(const Variant& value) { return value.ToBoolean(); }
    static Variant To(bool value) { return value; }
};
template <>
struct Conversion<std::int16_t> {
    static constexpr VarType type = VarType::Integer;
    static std::int16_t From(const Variant& value) { return value.ToInteger(); }
    static Variant To(std::int16_t value) { return value; }
};
template <>
struct Conversion<std::int32_t> {
    static constexpr VarType type = VarType::Long;
    static std::int32_t From(const Variant& value) { return value.ToLong(); }
    static Variant To(std::int32_t value) { return value; }
};
template <>
struct Conversion<float> {
    static constexpr VarType type = VarType::Single;
    static float From(const Variant& value) { return value.ToSingle(); }
    static Variant To(float value) { return value; }
};
template <>
struct Conversion<double> {
    static constexpr VarType type = VarType::Double;
    static double From(const Variant& value) { return value.ToDouble(); }
    static Variant To(double value) { return value; }
};
template <>
struct Conversion<std::string> {
    static constexpr VarType type = VarType::String;
    static std::string From(const Variant& value) { return value.ToText(); }
    static Variant To(std::string value) { return value; }
};
template <>
struct Conversion<std::string_view> {
    static constexpr VarType type = VarType::String;
    static Variant To(std::string_view value) { return value; }
};
template <>
struct Conversion<OLE_COLOR> {
    static constexpr VarType type = VarType::Long;
    static OLE_COLOR From(const Variant& value) { return value.ToColor(); }
    static Variant To(OLE_COLOR value) { return value; }
};
template <>
struct Conversion<Date> {
    static constexpr VarType type = VarType::Date;
    static Date From(const Variant& value) { return value.ToDate(); }
    static Variant To(Date value) { return value; }
};
/// A `Variant` takes what it is given, a missing argument too.
template <>
struct Conversion<Variant> {
    static constexpr VarType type = VarType::Empty;
    static Variant From(const Variant& value) { return value; }
    static Variant To(Variant value) { return value; }
};
template <>
struct Conversion<ObjectRef> {
    static constexpr VarType type = VarType::Object;
    static ObjectRef From(const Variant& value) { return value.ToObject(); }
    static Variant To(ObjectRef value) { return value; }
};
/// An enumeration is its number; a number that names no constant passes through.
template <class T>
requires std::is_enum_v<T>
struct Conversion<T> {
    using Number = std::underlying_type_t<T>;
    static constexpr VarType type = Conversion<Number>::type;
    static T From(const Variant& value) { return static_cast<T>(Conversion<Number>::From(value)); }
    static Variant To(T value) { return static_cast<Number>(value); }
};
/// A shared value: a font, a picture. Nothing converts to null; an object of another class is error 13.
template <class T>
requires std::derived_from<T, Object>
struct Conversion<std::shared_ptr<T>> {
    static constexpr VarType type = VarType::Object;
    static std::shared_ptr<T> From(const Variant& value) {
        const ObjectRef object = value.ToObject();
        if (object.IsNothing()) return nullptr;
        auto shared = std::dynamic_pointer_cast<T>(object.Shared());
        if (!shared) throw ControlError(errors::typeMismatch);
        return shared;
    }
    static Variant To(std::shared_ptr<T> value) { return value ? Variant(ObjectRef(std::move(value))) : Variant(ObjectRef()); }
};
/// An object by reference: weak, as children and collections are.
template <class T>
requires std::derived_from<T, Object>
struct Conversion<T&> {
    static constexpr VarType type = VarType::Object;
    static Variant To(T& value) { return ObjectRef(value); }
};
/// An optional argument: an `std::optional<Variant>` is nothing when it is missing, any other type also for null.
template <class T>
struct Conversion<std::optional<T>> {
    static constexpr VarType type = Conversion<T>::type;
    static std::optional<T> From(const Variant& value) {
        const bool none = value.IsMissing() || (value.IsEmpty() && !std::is_same_v<T, Variant>);
        return none ? std::nullopt : std::optional<T>(Conversion<T>::From(value));
    }
};

template <class T>
Variant ToVariant(T&& value) {
    if constexpr (std::is_lvalue_reference_v<T> && std::derived_from<std::remove_cvref_t<T>, Object>)
        return Conversion<std::remove_cvref_t<T>&>::To(value);
    else
        return Conversion<std::remove_cvref_t<T>>::To(std::forward<T>(value));
}

template <class T>
T FromVariant(const Variant& value) {
    return Conversion<T>::From(value);
}

}  // namespace tessel::frame
