#pragma once

#include <concepts>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "frame/Color.h"
#include "frame/Object.h"

namespace tessel::frame {

enum class VarType : std::uint8_t { Empty, Missing, Boolean, Integer, Long, Single, Double, String, Date, Object, Array };

/// The name of a type as the reference pages write it: "Boolean", "Integer" (16 bits), "Long" (32 bits) and so on.
std::string_view VarTypeName(VarType type);

/// A moment in local time: days since 1899-12-30, the time of day in the fraction (for days before that, the fraction
/// still counts forward from midnight).
struct Date {
    double days = 0;
    friend bool operator==(Date, Date) = default;
};

struct VariantArray;

/// The value of property bags, of optional arguments and of late-bound calls.
///
/// Conversions follow the rules of automation variants: fractions round to the nearest integer, ties to the even one; a number
/// that does not fit is error 6, a value that has no such form is error 13; true is -1. They know no locale: the point
/// parts decimals, the comma groups digits, so that a saved design reads the same everywhere.
class Variant {
  public:
    Variant() = default;
    Variant(bool value) : value_(value) {}
    Variant(std::int16_t value) : value_(value) {}
    Variant(std::int32_t value) : value_(value) {}
    Variant(float value) : value_(value) {}
    Variant(double value) : value_(value) {}
    Variant(const char* value) : value_(std::string(value)) {}
    Variant(std::string_view value) : value_(std::string(value)) {}
    Variant(std::string value) : value_(std::move(value)) {}
    Variant(Date value) : value_(value) {}
    Variant(OLE_COLOR value) : value_(value) {}
    Variant(ObjectRef value) : value_(std::move(value)) {}
    Variant(VariantArray value);
    template <class T>
    requires std::derived_from<T, Object> Variant(std::shared_ptr<T> value) : value_(ObjectRef(std::move(value))) {}

    /// An optional argument that was left off; it can be told from any value.
    static Variant Missing() {
        Variant variant;
        variant.value_ = MissingValue{};
        return variant;
    }
    /// A count or a size: 32-bit where it fits, else a 64-bit float.
    static Variant FromCount(std::int64_t count);

    /// A colour has the type `Long`.
    VarType Type() const;
    bool IsEmpty() const { return std::holds_alternative<std::monostate>(value_); }
    bool IsMissing() const { return std::holds_alternative<MissingValue>(value_); }
    /// Whether this holds a colour, which is a `Long` that is shown without a sign.
    bool IsColor() const { return std::holds_alternative<OLE_COLOR>(value_); }
    bool IsString() const { return std::holds_alternative<std::string>(value_); }
    /// A boolean, an integer or a float; a string is not, whatever it says.
    bool IsNumber() const;

    // Conversions. Empty counts as false, 0, the empty string and no object. An object converts by its default member.
    bool ToBoolean() const;
    std::int16_t ToInteger() const;
    std::int32_t ToLong() const;
    float ToSingle() const;
    double ToDouble() const;
    /// Numbers as the shortest text with at most 15 digits (7 for a 32-bit float), booleans as "True" and "False",
    /// dates as "2/3/2001 4:05:06 AM".
    std::string ToText() const;
    Date ToDate() const;
    /// The 32 bits of a colour, given as a positive or as a negative number.
    OLE_COLOR ToColor() const;
    /// Empty is no object. Error 424 for a value that is no object, 13 for an array and a missing argument.
    ObjectRef ToObject() const;
    /// Error 13 for anything but an array.
    const VariantArray& ToArray() const;
    /// `Empty` stands for no particular type and leaves the value as it is; a colour stays one as a `Long`.
    Variant ConvertedTo(VarType type) const;

    /// The string inside, without conversion. Only for a variant that holds one.
    const std::string& Text() const { return std::get<std::string>(value_); }

    /// Equal in value: numbers, booleans (true is -1) and colours by their number, whatever their types; strings and
    /// dates exactly; objects as they see it themselves; arrays element by element. A string never equals a number.
    friend bool operator==(const Variant& a, const Variant& b);

  private:
    struct MissingValue {};
    using Storage = std::variant<std::monostate, MissingValue, bool, std::int16_t, std::int32_t, float, double, std::string, Date,
                                 OLE_COLOR, ObjectRef, std::shared_ptr<const VariantArray>>;
    Variant DefaultMember() const;

    Storage value_;
};

/// An array of values with a lower bound. One that was never filled has no bounds: asking for them is error 9.
struct VariantArray {
    int lower = 0;
    bool filled = false;
    std::vector<Variant> items;

    VariantArray() = default;
    VariantArray(int lowerBound, std::vector<Variant> values) : lower(lowerBound), filled(true), items(std::move(values)) {}

    int LowerBound() const;
    int UpperBound() const;
    /// Error 9 for an index outside the bounds.
    const Variant& At(int index) const;
    friend bool operator==(const VariantArray&, const VariantArray&) = default;
};

}  // namespace tessel::frame
