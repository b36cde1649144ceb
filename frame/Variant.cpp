#include "frame/Variant.h"

#include <array>
#include <cmath>
#include <limits>
#include <optional>
#include <type_traits>
#include <utility>

#include "frame/ClassTable.h"
#include "frame/Dates.h"
#include "frame/Error.h"
#include "frame/Numbers.h"
#include "frame/Text.h"

namespace tessel::frame {

static_assert(sizeof(Variant) <= 40);
static_assert(std::is_nothrow_move_constructible_v<Variant> && std::is_nothrow_move_assignable_v<Variant>);

namespace {

[[noreturn]] void ThrowMismatch() { throw ControlError(errors::typeMismatch); }

/// The value as a number. What is not listed has none; an object gives its default member before it comes here.
struct NumberOf {
    double operator()(std::monostate) const { return 0; }
    double operator()(bool value) const { return value ? -1 : 0; }
    double operator()(std::int16_t value) const { return value; }
    double operator()(std::int32_t value) const { return value; }
    double operator()(float value) const { return value; }
    double operator()(double value) const { return value; }
    double operator()(const std::string& value) const { return ReadDouble(value); }
    double operator()(Date value) const { return value.days; }
    double operator()(OLE_COLOR value) const { return static_cast<std::int32_t>(value.value); }
    template <class T>
    double operator()(const T&) const {
        ThrowMismatch();
    }
};

struct TextOf {
    std::string operator()(std::monostate) const { return {}; }
    std::string operator()(bool value) const { return value ? "True" : "False"; }
    std::string operator()(std::int16_t value) const { return Decimal(value); }
    std::string operator()(std::int32_t value) const { return Decimal(value); }
    std::string operator()(float value) const { return NumberText(value); }
    std::string operator()(double value) const { return NumberText(value); }
    std::string operator()(const std::string& value) const { return value; }
    std::string operator()(Date value) const { return DateText(value); }
    std::string operator()(OLE_COLOR value) const { return Decimal(static_cast<std::int32_t>(value.value)); }
    template <class T>
    std::string operator()(const T&) const {
        ThrowMismatch();
    }
};

/// The nearest integer, ties to the even one; error 6 outside the bounds.
template <class Integer>
Integer Rounded(double value, Integer least, Integer most) {
    const double rounded = std::nearbyint(value);
    if (!(rounded >= static_cast<double>(least) && rounded <= static_cast<double>(most))) throw ControlError(errors::overflow);
    return static_cast<Integer>(rounded);
}
template <class Integer>
Integer Rounded(double value) {
    return Rounded(value, std::numeric_limits<Integer>::min(), std::numeric_limits<Integer>::max());
}

std::optional<bool> ReadBoolean(std::string_view text) {
    if (EqualsNoCase(text, "True") || EqualsNoCase(text, "#TRUE#")) return true;
    if (EqualsNoCase(text, "False") || EqualsNoCase(text, "#FALSE#")) return false;
    return std::nullopt;
}

/// A literal fills the 16 bits of an integer, so that "&HFFFF" is -1.
std::int16_t ReadInteger(std::string_view text) {
    const TextNumber number = ReadNumber(text);
    const auto* bits = std::get_if<std::uint32_t>(&number);
    if (!bits) return Rounded<std::int16_t>(std::get<double>(number));
    if (*bits > 0xFFFF) throw ControlError(errors::overflow);
    return static_cast<std::int16_t>(*bits);
}

/// A bag must see an unchanged NaN as equal.
bool SameNumber(double a, double b) { return a == b || (std::isnan(a) && std::isnan(b)); }

}  // namespace

std::string_view VarTypeName(VarType type) {
    switch (type) {
        case VarType::Empty:
            return "Empty";
        case VarType::Missing:
            return "Missing";
        case VarType::Boolean:
            return "Boolean";
        case VarType::Integer:
            return "Integer";
        case VarType::Long:
            return "Long";
        case VarType::Single:
            return "Single";
        case VarType::Double:
            return "Double";
        case VarType::String:
            return "String";
        case VarType::Date:
            return "Date";
        case VarType::Object:
            return "Object";
        case VarType::Array:
            return "Array";
    }
    return {};
}

Variant::Variant(VariantArray value) : value_(std::make_shared<const VariantArray>(std::move(value))) {}

Variant Variant::FromCount(std::int64_t count) {
    if (std::in_range<std::int32_t>(count)) return static_cast<std::int32_t>(count);
    return static_cast<double>(count);
}

VarType Variant::Type() const {
    using enum VarType;
    static constexpr std::array typesByAlternative = {Empty,  Missing, Boolean, Integer, Long,   Single,
                                                      Double, String,  Date,    Long,    Object, Array};
    static_assert(typesByAlternative.size() == std::variant_size_v<Storage>);
    return typesByAlternative[value_.index()];
}

bool Variant::IsNumber() const {
    const VarType type = Type();
    return type >= VarType::Boolean && type <= VarType::Double;
}

bool Variant::ToBoolean() const {
    if (Type() == VarType::Object) return DefaultMember().ToBoolean();
    if (IsString()) {
        if (const auto value = ReadBoolean(Text())) return *value;
    }
    return ToDouble() != 0;
}

std::int16_t Variant::ToInteger() const {
    if (Type() == VarType::Object) return DefaultMember().ToInteger();
    return IsString() ? ReadInteger(Text()) : Rounded<std::int16_t>(ToDouble());
}

std::int32_t Variant::ToLong() const {
    if (const auto* number = std::get_if<std::int32_t>(&value_)) return *number;
    return Rounded<std::int32_t>(ToDouble());
}

float Variant::ToSingle() const {
    const double value = ToDouble();
    const auto narrow = static_cast<float>(value);
    if (std::isinf(narrow) && !std::isinf(value)) throw ControlError(errors::overflow);
    return narrow;
}

double Variant::ToDouble() const {
    if (Type() == VarType::Object) return DefaultMember().ToDouble();
    return std::visit(NumberOf(), value_);
}

std::string Variant::ToText() const {
    if (Type() == VarType::Object) return DefaultMember().ToText();
    return std::visit(TextOf(), value_);
}

Date Variant::ToDate() const {
    if (Type() == VarType::Object) return DefaultMember().ToDate();
    if (const auto* date = std::get_if<Date>(&value_)) return *date;
    if (IsString()) {
        if (const auto date = ParseDate(Text())) return *date;
    }
    const Date date{ToDouble()};
    PartsOf(date);  // a number that is no moment is error 6
    return date;
}

OLE_COLOR Variant::ToColor() const {
    constexpr std::int64_t least = std::numeric_limits<std::int32_t>::min();
    constexpr std::int64_t most = std::numeric_limits<std::uint32_t>::max();
    return static_cast<std::uint32_t>(Rounded(ToDouble(), least, most));
}

ObjectRef Variant::ToObject() const {
    switch (Type()) {
        case VarType::Empty:
            return {};
        case VarType::Object:
            return std::get<ObjectRef>(value_);
        case VarType::Missing:
        case VarType::Array:
            ThrowMismatch();
        default:
            throw ControlError(errors::objectRequired);
    }
}

const VariantArray& Variant::ToArray() const {
    static const VariantArray neverFilled;  // what is left of an array that was moved from
    const auto* array = std::get_if<std::shared_ptr<const VariantArray>>(&value_);
    if (!array) ThrowMismatch();
    return *array ? **array : neverFilled;
}

Variant Variant::ConvertedTo(VarType type) const {
    if (type == Type()) return *this;
    if (IsMissing()) ThrowMismatch();
    switch (type) {
        case VarType::Empty:
            return *this;
        case VarType::Boolean:
            return ToBoolean();
        case VarType::Integer:
            return ToInteger();
        case VarType::Long:
            return ToLong();
        case VarType::Single:
            return ToSingle();
        case VarType::Double:
            return ToDouble();
        case VarType::String:
            return ToText();
        case VarType::Date:
            return ToDate();
        case VarType::Object:
            return ToObject();
        case VarType::Missing:
        case VarType::Array:
            break;
    }
    ThrowMismatch();
}

bool operator==(const Variant& a, const Variant& b) {
    if (a.IsNumber() && b.IsNumber()) return SameNumber(a.ToDouble(), b.ToDouble());
    if (a.value_.index() != b.value_.index()) return false;
    return std::visit(
        [&b]<class T>(const T& left) {
            const T& right = std::get<T>(b.value_);
            if constexpr (std::is_empty_v<T>)
                return true;
            else if constexpr (std::is_same_v<T, Date>)
                return SameNumber(left.days, right.days);
            else if constexpr (std::is_same_v<T, std::shared_ptr<const VariantArray>>)
                return left == right || (left && right && *left == *right);
            else
                return left == right;
        },
        a.value_);
}

/// What the object's default member holds, which is no object: a chain of them is followed for a few steps, so that one that
/// never ends is error 13.
Variant Variant::DefaultMember() const {
    constexpr int mostSteps = 8;
    Variant value = *this;
    for (int step = 0; step < mostSteps; ++step) {
        Object& object = *std::get<ObjectRef>(value.value_);
        const std::string_view member = object.Table().defaultMember;
        if (member.empty()) ThrowMismatch();
        value = object.Get(member);
        if (value.Type() != VarType::Object) return value;
    }
    ThrowMismatch();
}

int VariantArray::LowerBound() const {
    if (!filled) throw ControlError(errors::subscript);
    return lower;
}

int VariantArray::UpperBound() const {
    const auto upper = LowerBound() + static_cast<std::int64_t>(items.size()) - 1;
    if (!std::in_range<int>(upper)) throw ControlError(errors::overflow);
    return static_cast<int>(upper);
}

const Variant& VariantArray::At(int index) const {
    const auto place = static_cast<std::int64_t>(index) - LowerBound();
    if (place < 0 || place >= static_cast<std::int64_t>(items.size())) throw ControlError(errors::subscript);
    return items[static_cast<std::size_t>(place)];
}

}  // namespace tessel::frame
