#include "frame/Variant.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <bit>
#include <clocale>
#include <cmath>
#include <cstdio>
#include <functional>
#include <limits>
#include <locale>
#include <random>
#include <string>
#include <utility>
#include <vector>

#include "frame/ClassTable.h"
#include "frame/Convert.h"
#include "frame/Dates.h"
#include "frame/Error.h"
#include "frame/Numbers.h"

#include "tests/ErrorOf.h"

namespace tessel::frame {
namespace {

using test::ErrorOf;

constexpr double infinity = std::numeric_limits<double>::infinity();
constexpr double nan = std::numeric_limits<double>::quiet_NaN();
constexpr auto floatNan = std::numeric_limits<float>::quiet_NaN();
constexpr auto floatInfinity = std::numeric_limits<float>::infinity();
constexpr VarType allTypes[] = {VarType::Empty, VarType::Missing, VarType::Boolean, VarType::Integer,
                                VarType::Long,  VarType::Single,  VarType::Double,  VarType::String,
                                VarType::Date,  VarType::Object,  VarType::Array};

/// An object whose default member holds a value. Equal to another one with the same rank, whatever they hold.
class Holder final : public Object {
  public:
    explicit Holder(Variant content, int ofRank = 0) : held(std::move(content)), rank(ofRank) { table_.defaultMember = "Value"; }

    const ClassTable& Table() const override { return table_; }
    Variant Get(MemberKey key, Arguments) override {
        if (key.ByNumber() || key.Name() != "Value") throw ControlError(errors::noSuchMember);
        ++reads;
        return held;
    }
    bool EqualsObject(const Object& other) const override {
        const auto* holder = dynamic_cast<const Holder*>(&other);
        return holder && holder->rank == rank;
    }

    Variant held;
    int rank = 0;
    int reads = 0;

  private:
    ClassTable table_{};
};

/// An object without a default member.
class Plain final : public Object {
  public:
    const ClassTable& Table() const override { return table_; }

  private:
    ClassTable table_{};
};

Variant Held(Variant content) { return std::make_shared<Holder>(std::move(content)); }

/// A chain of objects, each the default member of the next, around a value.
Variant Chain(Variant content, int length) {
    for (; length > 0; --length) content = Held(std::move(content));
    return content;
}

Variant GoneObject() {
    Plain object;
    return ObjectRef(object);
}

Variant List(std::vector<Variant> values) { return VariantArray(0, std::move(values)); }

std::string Hex(std::uint32_t bits) {
    char text[16];
    std::snprintf(text, sizeof text, "%08X", bits);
    return text;
}

/// What a conversion gives, or "!" and the number of its error.
std::string Shown(const std::function<std::string()>& convert) {
    try {
        return convert();
    } catch (const ControlError& error) {
        return "!" + std::to_string(error.Number());
    }
}

/// All conversions of a value: boolean, 16-bit, 32-bit, float, double, text, days of a date, bits of a colour, object, array.
std::string Conversions(const Variant& value) {
    const std::function<std::string()> all[] = {
        [&] { return value.ToBoolean() ? "T" : "F"; },
        [&] { return std::to_string(value.ToInteger()); },
        [&] { return std::to_string(value.ToLong()); },
        [&] { return NumberText(value.ToSingle()); },
        [&] { return NumberText(value.ToDouble()); },
        [&] { return '"' + value.ToText() + '"'; },
        [&] { return NumberText(value.ToDate().days); },
        [&] { return Hex(value.ToColor().value); },
        [&] { return value.ToObject().Get() ? "object" : "nothing"; },
        [&] { return "array of " + std::to_string(value.ToArray().items.size()); },
    };
    std::string text;
    for (const auto& convert : all) text += (text.empty() ? "" : " | ") + Shown(convert);
    return text;
}

TEST(Variant, EverySourceConvertsToEveryTargetOrRefuses) {
    struct Case {
        const char* name;
        Variant value;
        const char* expected;
    };
    const Case cases[] = {
        // clang-format off
        //                  value                         Boolean Integer  Long    Single  Double       Text       Date  Colour    Object      Array
        {"empty",           Variant(),                    R"(F   | 0      | 0     | 0     | 0          | ""       | 0   | 00000000 | nothing | !13)"},
        {"missing",         Variant::Missing(),           R"(!13 | !13    | !13   | !13   | !13        | !13      | !13 | !13      | !13     | !13)"},
        {"false",           false,                        R"(F   | 0      | 0     | 0     | 0          | "False"  | 0   | 00000000 | !424    | !13)"},
        {"true",            true,                         R"(T   | -1     | -1    | -1    | -1         | "True"   | -1  | FFFFFFFF | !424    | !13)"},
        {"16-bit",          std::int16_t{-7},             R"(T   | -7     | -7    | -7    | -7         | "-7"     | -7  | FFFFFFF9 | !424    | !13)"},
        {"16-bit zero",     std::int16_t{0},              R"(F   | 0      | 0     | 0     | 0          | "0"      | 0   | 00000000 | !424    | !13)"},
        {"32-bit",          70000,                        R"(T   | !6     | 70000 | 70000 | 70000      | "70000"  | 70000 | 00011170 | !424  | !13)"},
        {"32-bit least",    -2147483647 - 1,              R"(T   | !6     | -2147483648 | -2.147484E+09 | -2147483648 | "-2147483648" | !6 | 80000000 | !424 | !13)"},
        {"float",           2.5f,                         R"(T   | 2      | 2     | 2.5   | 2.5        | "2.5"    | 2.5 | 00000002 | !424    | !13)"},
        {"float of tenth",  0.1f,                         R"(T   | 0      | 0     | 0.1   | 0.100000001490116 | "0.1" | 0.100000001490116 | 00000000 | !424 | !13)"},
        {"float infinity",  floatInfinity,                R"(T   | !6     | !6    | Infinity | Infinity | "Infinity" | !6 | !6     | !424    | !13)"},
        {"float nan",       floatNan,                     R"(T   | !6     | !6    | NaN   | NaN        | "NaN"    | !6  | !6       | !424    | !13)"},
        {"double",          -1.25,                        R"(T   | -1     | -1    | -1.25 | -1.25      | "-1.25"  | -1.25 | FFFFFFFF | !424  | !13)"},
        {"double too large", 1e300,                       R"(T   | !6     | !6    | !6    | 1E+300     | "1E+300" | !6  | !6       | !424    | !13)"},
        {"negative zero",   -0.0,                         R"(F   | 0      | 0     | 0     | 0          | "0"      | 0   | 00000000 | !424    | !13)"},
        {"infinity",        infinity,                     R"(T   | !6     | !6    | Infinity | Infinity | "Infinity" | !6 | !6     | !424    | !13)"},
        {"-infinity",       -infinity,                    R"(T   | !6     | !6    | -Infinity | -Infinity | "-Infinity" | !6 | !6  | !424    | !13)"},
        {"nan",             nan,                          R"(T   | !6     | !6    | NaN   | NaN        | "NaN"    | !6  | !6       | !424    | !13)"},
        {"empty text",      "",                           R"(!13 | !13    | !13   | !13   | !13        | ""       | !13 | !13      | !424    | !13)"},
        {"words",           "apple",                      R"(!13 | !13    | !13   | !13   | !13        | "apple"  | !13 | !13      | !424    | !13)"},
        {"text of number",  " 12.5 ",                     R"(T   | 12     | 12    | 12.5  | 12.5       | " 12.5 " | 12.5 | 0000000C | !424   | !13)"},
        {"text of zero",    "0",                          R"(F   | 0      | 0     | 0     | 0          | "0"      | 0   | 00000000 | !424    | !13)"},
        {"text of boolean", "true",                       R"(T   | !13    | !13   | !13   | !13        | "true"   | !13 | !13      | !424    | !13)"},
        {"text of date",    "2/3/2001 12:00 PM",          R"(!13 | !13    | !13   | !13   | !13        | "2/3/2001 12:00 PM" | 36925.5 | !13 | !424 | !13)"},
        {"text of literal", "&HFFFF",                     R"(T   | -1     | 65535 | 65535 | 65535      | "&HFFFF" | 65535 | 0000FFFF | !424  | !13)"},
        {"text of colour",  "&H80000005&",                R"(T   | !6     | -2147483643 | -2.147484E+09 | -2147483643 | "&H80000005&" | !6 | 80000005 | !424 | !13)"},
        {"date",            Date{1.25},                   R"(T   | 1      | 1     | 1.25  | 1.25       | "12/31/1899 6:00:00 AM" | 1.25 | 00000001 | !424 | !13)"},
        {"date of day 0",   Date{0},                      R"(F   | 0      | 0     | 0     | 0          | "12:00:00 AM" | 0 | 00000000 | !424  | !13)"},
        {"date of no year", Date{1e9},                    R"(T   | !6     | 1000000000 | 1E+09 | 1000000000 | !6   | 1000000000 | 3B9ACA00 | !424 | !13)"},
        {"date of nan",     Date{nan},                    R"(T   | !6     | !6    | NaN   | NaN        | !6       | NaN | !6       | !424    | !13)"},
        {"colour",          Rgb(1, 2, 3),                 R"(T   | !6     | 197121 | 197121 | 197121   | "197121" | 197121 | 00030201 | !424 | !13)"},
        {"system colour",   colors::buttonFace,           R"(T   | !6     | -2147483633 | -2.147484E+09 | -2147483633 | "-2147483633" | !6 | 8000000F | !424 | !13)"},
        {"black",           OLE_COLOR(0),                 R"(F   | 0      | 0     | 0     | 0          | "0"      | 0   | 00000000 | !424    | !13)"},
        {"nothing",         ObjectRef(),                  R"(!91 | !91    | !91   | !91   | !91        | !91      | !91 | !91      | nothing | !13)"},
        {"gone object",     GoneObject(),                 R"(!91 | !91    | !91   | !91   | !91        | !91      | !91 | !91      | nothing | !13)"},
        {"plain object",    std::make_shared<Plain>(),    R"(!13 | !13    | !13   | !13   | !13        | !13      | !13 | !13      | object  | !13)"},
        {"holder",          Held("3"),                    R"(T   | 3      | 3     | 3     | 3          | "3"      | 3   | 00000003 | object  | !13)"},
        {"holder of array", Held(List({1})),              R"(!13 | !13    | !13   | !13   | !13        | !13      | !13 | !13      | object  | !13)"},
        {"array",           List({1, 2}),                 R"(!13 | !13    | !13   | !13   | !13        | !13      | !13 | !13      | !13     | array of 2)"},
        {"empty array",     VariantArray(),               R"(!13 | !13    | !13   | !13   | !13        | !13      | !13 | !13      | !13     | array of 0)"},
        // clang-format on
    };
    const auto inOneLine = [](std::string text) {
        const auto isDouble = [](char a, char b) { return a == ' ' && b == ' '; };
        text.erase(std::unique(text.begin(), text.end(), isDouble), text.end());
        return text;
    };
    for (const Case& c : cases) EXPECT_EQ(inOneLine(Conversions(c.value)), inOneLine(c.expected)) << c.name;
}

TEST(Variant, TakesNoMoreThanAStringAndAByteAndMovesWithoutFailing) {
    EXPECT_LE(sizeof(Variant), 40u);
    EXPECT_TRUE(std::is_nothrow_move_constructible_v<Variant>);
    EXPECT_TRUE(std::is_nothrow_move_assignable_v<Variant>);
}

TEST(Variant, HasTheTypeOfWhatItIsGiven) {
    EXPECT_EQ(Variant().Type(), VarType::Empty);
    EXPECT_EQ(Variant::Missing().Type(), VarType::Missing);
    EXPECT_EQ(Variant(true).Type(), VarType::Boolean);
    EXPECT_EQ(Variant(std::int16_t{1}).Type(), VarType::Integer);
    EXPECT_EQ(Variant(1).Type(), VarType::Long);
    EXPECT_EQ(Variant(1.0f).Type(), VarType::Single);
    EXPECT_EQ(Variant(1.0).Type(), VarType::Double);
    EXPECT_EQ(Variant("1").Type(), VarType::String);
    EXPECT_EQ(Variant(std::string_view("1")).Type(), VarType::String);
    EXPECT_EQ(Variant(std::string("1")).Type(), VarType::String);
    EXPECT_EQ(Variant(Date{1}).Type(), VarType::Date);
    EXPECT_EQ(Variant(colors::buttonFace).Type(), VarType::Long);
    EXPECT_EQ(Variant(ObjectRef()).Type(), VarType::Object);
    EXPECT_EQ(Held(1).Type(), VarType::Object);
    EXPECT_EQ(List({}).Type(), VarType::Array);
}

TEST(Variant, OnlyBooleansIntegersAndFloatsAreNumbers) {
    for (const Variant& number :
         {Variant(false), Variant(std::int16_t{0}), Variant(0), Variant(0.0f), Variant(0.0), Variant(OLE_COLOR(0))})
        EXPECT_TRUE(number.IsNumber()) << VarTypeName(number.Type());
    for (const Variant& other : {Variant(), Variant::Missing(), Variant("1"), Variant(Date{1}), Variant(ObjectRef()), List({1})})
        EXPECT_FALSE(other.IsNumber()) << VarTypeName(other.Type());
}

TEST(Variant, EveryTypeHasAName) {
    std::string names;
    for (const VarType type : allTypes) names += std::string(VarTypeName(type)) + ' ';
    EXPECT_EQ(names, "Empty Missing Boolean Integer Long Single Double String Date Object Array ");
}

TEST(Variant, CountsAre32BitWhereTheyFitAndElseFloats) {
    EXPECT_EQ(Variant::FromCount(2147483647).Type(), VarType::Long);
    EXPECT_EQ(Variant::FromCount(2147483647).ToLong(), 2147483647);
    EXPECT_EQ(Variant::FromCount(-2147483648LL).Type(), VarType::Long);
    EXPECT_EQ(Variant::FromCount(2147483648LL).Type(), VarType::Double);
    EXPECT_EQ(Variant::FromCount(5'000'000'000LL).ToDouble(), 5e9);
    EXPECT_EQ(Variant::FromCount(-2147483649LL).ToDouble(), -2147483649.0);
}

TEST(Variant, AVariantThatWasMovedFromCanStillBeUsed) {
    Variant list = List({1});
    const Variant taken = std::move(list);
    EXPECT_EQ(taken.ToArray().items.size(), 1u);
    EXPECT_TRUE(list == list);    // NOLINT(bugprone-use-after-move)
    EXPECT_FALSE(list == taken);  // NOLINT(bugprone-use-after-move)
    EXPECT_FALSE(taken == list);  // NOLINT(bugprone-use-after-move)
    list.ToArray();
    list = 5;
    EXPECT_EQ(list.ToLong(), 5);
}

TEST(VariantRounding, FractionsRoundToTheNearestIntegerTiesToTheEvenOne) {
    struct Case {
        double value;
        int expected;
    };
    for (const auto [value, expected] : {Case{0.5, 0},
                                         {1.5, 2},
                                         {2.5, 2},
                                         {3.5, 4},
                                         {-0.5, 0},
                                         {-1.5, -2},
                                         {-2.5, -2},
                                         {0.49999999999999994, 0},
                                         {0.51, 1},
                                         {-0.51, -1},
                                         {32766.5, 32766},
                                         {32767.49, 32767},
                                         {-32768.5, -32768},
                                         {-32767.5, -32768}}) {
        EXPECT_EQ(Variant(value).ToInteger(), expected) << value;
        EXPECT_EQ(Variant(value).ToLong(), expected) << value;
        EXPECT_EQ(Variant(static_cast<float>(value)).ToLong(), std::nearbyint(static_cast<float>(value))) << value;
        EXPECT_EQ(Variant(Date{value}).ToLong(), expected) << value;
    }
    EXPECT_EQ(Variant("2.5").ToInteger(), 2);
    EXPECT_EQ(Variant("3.5").ToLong(), 4);
}

TEST(VariantRounding, A16BitIntegerHolds32767AndNoMore) {
    for (const double value : {32767.5, 32768.0, -32768.500001, -32769.0, 65535.0, 1e10, -1e300, infinity, -infinity, nan})
        EXPECT_EQ(ErrorOf([&] { Variant(value).ToInteger(); }), errors::overflow) << value;
    for (const int value : {32768, -32769, 65536, 2147483647}) {
        EXPECT_EQ(ErrorOf([&] { Variant(value).ToInteger(); }), errors::overflow) << value;
        EXPECT_EQ(ErrorOf([&] { Variant(std::to_string(value)).ToInteger(); }), errors::overflow) << value;
    }
    EXPECT_EQ(Variant(32767).ToInteger(), 32767);
    EXPECT_EQ(Variant("-32768").ToInteger(), -32768);
}

TEST(VariantRounding, A32BitIntegerHolds2147483647AndNoMore) {
    EXPECT_EQ(Variant(2147483647.0).ToLong(), 2147483647);
    EXPECT_EQ(Variant(2147483646.5).ToLong(), 2147483646);
    EXPECT_EQ(Variant(2147483647.49).ToLong(), 2147483647);
    EXPECT_EQ(Variant(-2147483648.5).ToLong(), -2147483647 - 1);
    EXPECT_EQ(Variant("-2147483648").ToLong(), -2147483647 - 1);
    for (const double value : {2147483647.5, 2147483648.0, -2147483648.51, -2147483649.0, 1e18, 1e300, infinity, -infinity, nan})
        EXPECT_EQ(ErrorOf([&] { Variant(value).ToLong(); }), errors::overflow) << value;
    EXPECT_EQ(ErrorOf([] { Variant(2147483648.0f).ToLong(); }), errors::overflow);
    EXPECT_EQ(ErrorOf([] { Variant("2147483648").ToLong(); }), errors::overflow);
}

TEST(VariantRounding, A32BitFloatTakesTheNearestValueAndRefusesOneBeyondItsRange) {
    constexpr double most = std::numeric_limits<float>::max();
    EXPECT_EQ(Variant(0.1).ToSingle(), 0.1f);
    EXPECT_EQ(Variant(16'777'217).ToSingle(), 16'777'216.0f);
    EXPECT_EQ(Variant(most).ToSingle(), std::numeric_limits<float>::max());
    EXPECT_EQ(Variant(-most).ToSingle(), std::numeric_limits<float>::lowest());
    EXPECT_EQ(Variant("3.4028235E+38").ToSingle(), std::numeric_limits<float>::max());
    EXPECT_EQ(Variant(1e-300).ToSingle(), 0.0f);
    EXPECT_EQ(ErrorOf([] { Variant(3.5e38).ToSingle(); }), errors::overflow);
    EXPECT_EQ(ErrorOf([] { Variant(-1e39).ToSingle(); }), errors::overflow);
    EXPECT_EQ(ErrorOf([] { Variant("1e39").ToSingle(); }), errors::overflow);
    EXPECT_EQ(Variant(infinity).ToSingle(), floatInfinity);
    EXPECT_TRUE(std::isnan(Variant(nan).ToSingle()));
}

TEST(VariantFromText, AllFormsOfANumberAreRead) {
    struct Case {
        const char* text;
        double expected;
    };
    const Case cases[] = {
        {"0", 0},
        {"7", 7},
        {"007", 7},
        {"1.5", 1.5},
        {".5", 0.5},
        {"5.", 5},
        {"00.50", 0.5},
        {" 7", 7},
        {"7 ", 7},
        {"\t 7 \t", 7},
        {"+7", 7},
        {"-7", -7},
        {"7+", 7},
        {"7-", -7},
        {"-.5", -0.5},
        {".5-", -0.5},
        {"5.-", -5},
        {"(7)", -7},
        {" (7.5) ", -7.5},
        {"$7", 7},
        {"$-7", -7},
        {"-$7", -7},
        {"+$7", 7},
        {"$+7", 7},
        {"$7-", -7},
        {"($7)", -7},
        {"$(7)", -7},
        {"$.5", 0.5},
        {"1,234", 1234},
        {"1,234,567.5", 1234567.5},
        {"12,34", 1234},
        {"1,,2", 12},
        {"1,", 1},
        {"1,.5", 1.5},
        {"0,001", 1},
        {"$1,000", 1000},
        {"1e3", 1000},
        {"1E3", 1000},
        {"1d3", 1000},
        {"1D3", 1000},
        {"1e+3", 1000},
        {"25e-2", 0.25},
        {".5e1", 5},
        {"5.e1", 50},
        {"1,000e-3", 1},
        {"1e3-", -1000},
        {"1e-3-", -0.001},
        {"(1e3)", -1000},
        {"1e0000000000000000000000002", 100},
        {"&H1F", 31},
        {"&h1f", 31},
        {"&O17", 15},
        {"&o17", 15},
        {"&H1F&", 31},
        {"&O17&", 15},
        {" &H0 ", 0},
        {"&H00000000001", 1},
        {"&HFFFF", 65535},
        {"&HFFFFFFFF", -1},
        {"&H80000000", -2147483648.0},
        {"&H7FFFFFFF", 2147483647},
        {"&O37777777777", -1},
    };
    for (const auto& [text, expected] : cases) EXPECT_EQ(Variant(text).ToDouble(), expected) << '"' << text << '"';
}

TEST(VariantFromText, AnyOtherTextIsError13) {
    const std::string_view cases[] = {
        "",
        " ",
        "\t",
        "apple",
        "1 2",
        "1a",
        "a1",
        "1.2.3",
        "1..2",
        ".",
        "-",
        "+",
        "$",
        "()",
        "(",
        ")",
        "-.",
        "$.",
        ",",
        ".e5",
        "--7",
        "++7",
        "-7-",
        "+7-",
        "-7+",
        "7--",
        "- 7",
        "7 -",
        "-(7)",
        "(-7)",
        "(7-)",
        "(+7)",
        "(7",
        "7)",
        "((7))",
        "( 7)",
        "(7 )",
        "(7)-",
        "$$7",
        "$-$7",
        "7$",
        "$ 7",
        "$",
        "-$",
        "$7$",
        "($)7",
        ",7",
        ",7.5",
        ",.5",
        "$,1.5",
        "-,7",
        "$,7",
        "(,7)",
        "1.2,3",
        "1.,2",
        ",",
        "1e3,0",
        "e",
        "e5",
        "1e",
        "1e+",
        "1e-",
        "1e+-5",
        "1ee5",
        "1e5e5",
        "1e5.0",
        "1 e5",
        "1e 5",
        "1-e5",
        "1f5",
        "1ed5",
        "1e5d5",
        "inf",
        "Infinity",
        "-Infinity",
        "nan",
        "NaN",
        "nan(1)",
        "1.#INF",
        "0x10",
        "0X10",
        "1p3",
        "0b1",
        "1_000",
        "1'000",
        "&",
        "&H",
        "&O",
        "&HG",
        "&O8",
        "&H&",
        "&O&",
        "&10",
        "&H1F&&",
        "&H1F%",
        "&H 1F",
        "& H1F",
        "-&H1F",
        "&H-1F",
        "&H+1F",
        "&H1F-",
        "(&H1F)",
        "$&H1F",
        "&H1.5",
        "&H1,0",
        "&H0x1F",
        "&O1F",
        "&HFFFFFFFFFFG",
        "&B1",
        "H1F",
        "#5",
        "5%",
        "\n7",
        "7\n",
        "7\r\n",
        "\v7",
        "\xC2\xA0"
        "7",
        "\xD9\xA1",
        "\xEF\xBC\x91",
        "\xE2\x82\xAC"
        "7",
        "\xFF",
        "7\xFF",
        "true1",
        "2/3/2001",
    };
    for (const std::string_view text : cases) {
        EXPECT_EQ(ErrorOf([&] { Variant(text).ToDouble(); }), errors::typeMismatch) << '"' << text << '"';
        EXPECT_EQ(ErrorOf([&] { Variant(text).ToInteger(); }), errors::typeMismatch) << '"' << text << '"';
        EXPECT_EQ(ErrorOf([&] { Variant(text).ToColor(); }), errors::typeMismatch) << '"' << text << '"';
    }
    for (const std::string_view text : {std::string_view("7\0", 2),
                                        std::string_view("\0"
                                                         "7",
                                                         2),
                                        std::string_view("\0", 1)})
        EXPECT_EQ(ErrorOf([&] { Variant(text).ToDouble(); }), errors::typeMismatch);
}

TEST(VariantFromText, ANumberTooLargeIsError6AndOneTooSmallIs0) {
    for (const char* text : {"1e309", "-1e309", "1.7976931348623159e308", "1e99999999999999999999", "(1e400)", "123e307",
                             "&H100000000", "&O40000000000"})
        EXPECT_EQ(ErrorOf([&] { Variant(text).ToDouble(); }), errors::overflow) << text;
    for (const char* text :
         {"1e-400", "-1e-330", "2e-324", "2.4703282292062327e-324", "1e-99999999999999999999", "0e99999999999999999999", "0e309"})
        EXPECT_EQ(Variant(text).ToDouble(), 0) << text;
}

TEST(VariantFromText, NumbersAtTheBoundsOfADoubleAreTheNearestDouble) {
    constexpr double most = std::numeric_limits<double>::max(), least = std::numeric_limits<double>::denorm_min();
    EXPECT_EQ(Variant("1.7976931348623157e308").ToDouble(), most);
    EXPECT_EQ(Variant("1.7976931348623158e308").ToDouble(), most);
    EXPECT_EQ(Variant("4.9406564584124654e-324").ToDouble(), least);
    EXPECT_EQ(Variant("2.4703282292062328e-324").ToDouble(), least);
    EXPECT_EQ(Variant("2.2250738585072011e-308").ToDouble(), std::nextafter(std::numeric_limits<double>::min(), 0.0));
    EXPECT_EQ(Variant("9007199254740993").ToDouble(), 9007199254740992.0);
    EXPECT_EQ(Variant("9007199254740993.00000000000000000000000000000000000001").ToDouble(), 9007199254740994.0);
}

TEST(VariantFromText, LiteralsFillTheBitsOfAnInteger) {
    EXPECT_EQ(Variant("&HFFFF").ToInteger(), -1);
    EXPECT_EQ(Variant("&H8000").ToInteger(), -32768);
    EXPECT_EQ(Variant("&H7FFF").ToInteger(), 32767);
    EXPECT_EQ(Variant("&O177777").ToInteger(), -1);
    EXPECT_EQ(Variant("&HFFFF").ToLong(), 65535);
    EXPECT_EQ(Variant("&HFFFFFFFF").ToLong(), -1);
    EXPECT_EQ(Variant("&H80000000").ToLong(), -2147483647 - 1);
    EXPECT_EQ(ErrorOf([] { Variant("&H10000").ToInteger(); }), errors::overflow);
    EXPECT_EQ(ErrorOf([] { Variant("&HFFFFFFFF").ToInteger(); }), errors::overflow);
    EXPECT_EQ(ErrorOf([] { Variant("&H100000000").ToLong(); }), errors::overflow);
    EXPECT_EQ(ErrorOf([] { Variant("&H100000000").ToInteger(); }), errors::overflow);
    EXPECT_EQ(Variant("65535").ToLong(), 65535);
    EXPECT_EQ(ErrorOf([] { Variant("65535").ToInteger(); }), errors::overflow);
}

TEST(VariantFromText, BooleansAreWordsInAnyCaseOrNumbers) {
    for (const char* text : {"True", "true", "TRUE", "tRuE", "#TRUE#", "#true#", "1", "-1", "0.001", "&H1", "(2)", " 1 "})
        EXPECT_TRUE(Variant(text).ToBoolean()) << text;
    for (const char* text : {"False", "false", "FALSE", "#FALSE#", "#False#", "0", "-0", "0.000", "&H0", "1e-400"})
        EXPECT_FALSE(Variant(text).ToBoolean()) << text;
    for (const char* text : {"", " True", "True ", "#TRUE", "TRUE#", "##TRUE##", "yes", "T", "Falsee", "nan"})
        EXPECT_EQ(ErrorOf([&] { Variant(text).ToBoolean(); }), errors::typeMismatch) << '"' << text << '"';
    EXPECT_EQ(ErrorOf([] { Variant("1e309").ToBoolean(); }), errors::overflow);
}

TEST(VariantFromText, DatesAreDatesOrNumbersOfDays) {
    EXPECT_EQ(Variant("2/3/2001 6:00 AM").ToDate(), Date{36'925.25});
    EXPECT_EQ(Variant("2001-02-03").ToDate(), Date{36'925});
    EXPECT_EQ(Variant("36,925.25").ToDate(), Date{36'925.25});
    EXPECT_EQ(Variant("&H10").ToDate(), Date{16});
    EXPECT_EQ(ErrorOf([] { Variant("2/30/2001").ToDate(); }), errors::typeMismatch);
    EXPECT_EQ(ErrorOf([] { Variant("").ToDate(); }), errors::typeMismatch);
    EXPECT_EQ(ErrorOf([] { Variant("3000000").ToDate(); }), errors::overflow);
}

TEST(VariantFromText, HugeTextsAreReadWithoutHarm) {
    constexpr std::size_t many = 1'000'000;
    const std::string nines(many, '9'), zeros(many, '0');
    EXPECT_EQ(ErrorOf([&] { Variant(nines).ToDouble(); }), errors::overflow);
    EXPECT_EQ(Variant(zeros + "5").ToDouble(), 5);
    EXPECT_EQ(Variant("1" + zeros + "e-1000000").ToDouble(), 1);
    EXPECT_EQ(Variant("." + zeros + "1e1000001").ToDouble(), 1);
    EXPECT_EQ(Variant("." + nines).ToDouble(), 1);
    EXPECT_EQ(Variant("." + zeros + "1").ToDouble(), 0);
    EXPECT_EQ(Variant("1" + std::string(many, ',')).ToDouble(), 1);
    EXPECT_EQ(Variant(std::string(many, ' ') + "1" + std::string(many, '\t')).ToDouble(), 1);
    EXPECT_EQ(Variant("1e" + zeros + "2").ToDouble(), 100);
    EXPECT_EQ(ErrorOf([&] { Variant("1e" + nines).ToDouble(); }), errors::overflow);
    EXPECT_EQ(Variant("1e-" + nines).ToDouble(), 0);
    EXPECT_EQ(ErrorOf([&] { Variant("&H" + nines).ToDouble(); }), errors::overflow);
    EXPECT_EQ(Variant("&H" + zeros + "F").ToDouble(), 15);
    EXPECT_EQ(ErrorOf([&] { Variant(std::string(many, '(')).ToDouble(); }), errors::typeMismatch);
    EXPECT_EQ(ErrorOf([&] { Variant(std::string(many, '-') + "1").ToDouble(); }), errors::typeMismatch);
    EXPECT_EQ(ErrorOf([&] { Variant(std::string(many, '\0')).ToDouble(); }), errors::typeMismatch);
}

TEST(VariantFromText, TextMadeOfThePiecesOfNumbersIsReadOrRefusedButNeverBreaks) {
    const std::string_view pieces[] = {"0", "1",  "9",  "123", "00", ",", ".",   "e",   "E",    "d", "+", "-", "(",  ")",   "$",
                                       " ", "\t", "&H", "&O",  "&",  "F", "308", "400", "True", "#", "/", ":", "AM", "\xFF"};
    std::mt19937 random(160914);
    int numbers = 0;
    for (int round = 0; round < 40'000; ++round) {
        std::string text;
        for (auto left = std::uniform_int_distribution(1, 7)(random); left > 0; --left)
            text += pieces[std::uniform_int_distribution<std::size_t>(0, std::size(pieces) - 1)(random)];
        const Variant value = text;
        const auto allowed = [](int error) { return error == 0 || error == errors::overflow || error == errors::typeMismatch; };
        ASSERT_TRUE(allowed(ErrorOf([&] { value.ToInteger(); }))) << text;
        ASSERT_TRUE(allowed(ErrorOf([&] { value.ToSingle(); }))) << text;
        ASSERT_TRUE(allowed(ErrorOf([&] { value.ToDate(); }))) << text;
        ASSERT_TRUE(allowed(ErrorOf([&] { value.ToBoolean(); }))) << text;
        if (ErrorOf([&] { value.ToDouble(); }) != 0) continue;
        ++numbers;
        const double number = value.ToDouble();
        ASSERT_TRUE(std::isfinite(number)) << text;
        ASSERT_EQ(value.ToBoolean(), number != 0) << text;
        ASSERT_EQ(Variant(' ' + text + '\t').ToDouble(), number) << text;
    }
    EXPECT_GT(numbers, 400);
}

TEST(VariantFromText, BytesAtRandomAreReadOrRefusedButNeverBreak) {
    std::mt19937 random(777);
    for (int round = 0; round < 50'000; ++round) {
        std::string text(std::uniform_int_distribution<std::size_t>(0, 12)(random), ' ');
        for (char& byte : text) byte = static_cast<char>(random());
        const int error = ErrorOf([&] { Variant(text).ToDouble(); });
        ASSERT_TRUE(error == 0 || error == errors::overflow || error == errors::typeMismatch);
        ErrorOf([&] { Variant(text).ToDate(); });
    }
}

TEST(VariantToText, NumbersHaveAtMost15DigitsAndNoTrailingZeros) {
    struct Case {
        double value;
        const char* expected;
    };
    const Case cases[] = {
        {0, "0"},
        {-0.0, "0"},
        {1, "1"},
        {-1.5, "-1.5"},
        {100, "100"},
        {0.1, "0.1"},
        {0.1 + 0.2, "0.3"},
        {1.0 / 3, "0.333333333333333"},
        {2.0 / 3, "0.666666666666667"},
        {123456789012345, "123456789012345"},
        {999999999999999, "999999999999999"},
        {1e15, "1E+15"},
        {1234567890123456, "1.23456789012346E+15"},
        {999999999999999.9, "1E+15"},
        {0.0001, "0.0001"},
        {0.00001, "1E-05"},
        {0.000123456, "0.000123456"},
        {-1.5e-7, "-1.5E-07"},
        {1e100, "1E+100"},
        {1e-100, "1E-100"},
        {std::numeric_limits<double>::max(), "1.79769313486232E+308"},
        {-std::numeric_limits<double>::min(), "-2.2250738585072E-308"},
        {std::numeric_limits<double>::denorm_min(), "4.94065645841247E-324"},
        {infinity, "Infinity"},
        {-infinity, "-Infinity"},
        {nan, "NaN"},
        {-nan, "NaN"},
    };
    for (const auto& [value, expected] : cases) EXPECT_EQ(Variant(value).ToText(), expected);
}

TEST(VariantToText, FloatsHaveAtMost7Digits) {
    struct Case {
        float value;
        const char* expected;
    };
    const Case cases[] = {
        {0.0f, "0"},
        {-0.0f, "0"},
        {0.1f, "0.1"},
        {1.0f / 3, "0.3333333"},
        {9999999.0f, "9999999"},
        {1e7f, "1E+07"},
        {16777216.0f, "1.677722E+07"},
        {0.0001f, "0.0001"},
        {0.00001f, "1E-05"},
        {-2.5f, "-2.5"},
        {std::numeric_limits<float>::max(), "3.402823E+38"},
        {std::numeric_limits<float>::denorm_min(), "1.401298E-45"},
        {floatInfinity, "Infinity"},
        {-floatInfinity, "-Infinity"},
        {floatNan, "NaN"},
    };
    for (const auto& [value, expected] : cases) EXPECT_EQ(Variant(value).ToText(), expected);
}

TEST(VariantToText, IntegersAreAllTheirDigits) {
    EXPECT_EQ(Variant(std::int16_t{-32768}).ToText(), "-32768");
    EXPECT_EQ(Variant(2147483647).ToText(), "2147483647");
    EXPECT_EQ(Variant(-2147483647 - 1).ToText(), "-2147483648");
}

TEST(VariantToText, TextStaysAsItIs) {
    const std::string text("  \xFF\0 \xC3\xA4\n", 8);
    EXPECT_EQ(Variant(text).ToText(), text);
    EXPECT_EQ(Variant(text).Text(), text);
}

/// A comma for decimals and points between thousands, as in many languages.
class OtherSigns final : public std::numpunct<char> {
  protected:
    char do_decimal_point() const override { return ','; }
    char do_thousands_sep() const override { return '.'; }
    std::string do_grouping() const override { return "\3"; }
    std::string do_truename() const override { return "wahr"; }
};

TEST(VariantToText, NumbersAreTheSameUnderEveryLocale) {
    const std::string before = std::setlocale(LC_ALL, nullptr);
    const std::locale locale = std::locale::global(std::locale(std::locale::classic(), new OtherSigns));
    for (const char* name : {"de_DE.UTF-8", "fr_FR.UTF-8", "tr_TR.UTF-8"}) {
        if (std::setlocale(LC_ALL, name)) break;  // one of them where the machine has any
    }
    EXPECT_EQ(Variant(1234567.5).ToText(), "1234567.5");
    EXPECT_EQ(Variant(1234567).ToText(), "1234567");
    EXPECT_EQ(Variant(true).ToText(), "True");
    EXPECT_EQ(Variant("1,234.5").ToDouble(), 1234.5);
    EXPECT_EQ(Variant("TRUE").ToBoolean(), true);
    EXPECT_EQ(Variant(Date{36'925.25}).ToText(), "2/3/2001 6:00:00 AM");
    std::locale::global(locale);
    std::setlocale(LC_ALL, before.c_str());
}

TEST(VariantRoundTrip, IntegersComeBackFromTheirText) {
    for (int value = -32768; value <= 32767; ++value) {
        const auto number = static_cast<std::int16_t>(value);
        ASSERT_EQ(Variant(Variant(number).ToText()).ToInteger(), number);
    }
    std::mt19937 random(1);
    for (int round = 0; round < 20'000; ++round) {
        const auto number = static_cast<std::int32_t>(random());
        ASSERT_EQ(Variant(Variant(number).ToText()).ToLong(), number);
    }
}

TEST(VariantRoundTrip, ColoursComeBackFromTheirTextTheirLongAndTheirLiteral) {
    std::mt19937 random(2);
    for (int round = 0; round < 20'000; ++round) {
        const OLE_COLOR color(static_cast<std::uint32_t>(random()));
        ASSERT_EQ(Variant(Variant(color).ToText()).ToColor(), color);
        ASSERT_EQ(Variant(Variant(color).ToLong()).ToColor(), color);
        ASSERT_EQ(Variant(Variant(color).ToDouble()).ToColor(), color);
        ASSERT_EQ(Variant(static_cast<double>(color.value)).ToColor(), color);
        ASSERT_EQ(Variant("&H" + Hex(color.value) + "&").ToColor(), color);
    }
}

TEST(VariantRoundTrip, AnyDoubleIsReadFrom17DigitsExactly) {
    std::mt19937_64 random(3);
    for (int round = 0; round < 20'000; ++round) {
        const auto number = std::bit_cast<double>(random());
        if (!std::isfinite(number)) continue;
        char text[40];
        std::snprintf(text, sizeof text, "%.17g", number);
        ASSERT_EQ(Variant(text).ToDouble(), number) << text;
    }
}

TEST(VariantRoundTrip, TextOf15DigitsComesBackFromItsNumber) {
    std::mt19937_64 random(4);
    for (int round = 0; round < 20'000; ++round) {
        const auto number = std::bit_cast<double>(random());
        if (!std::isnormal(number)) continue;
        const std::string text = Variant(number).ToText();
        if (std::abs(number) > 1.7976931348623e308) continue;  // 15 digits of the very largest round up beyond the range
        const double read = Variant(text).ToDouble();
        ASSERT_NEAR(read / number, 1, 1e-14) << text;
        ASSERT_EQ(Variant(read).ToText(), text);
    }
}

TEST(VariantRoundTrip, TextIsWhatPrintingWith15DigitsGives) {
    std::mt19937_64 random(5);
    for (int round = 0; round < 20'000; ++round) {
        const auto number = round % 2 ? std::bit_cast<double>(random()) : static_cast<double>(random() % 1'000'000) / 1000;
        if (!std::isfinite(number)) continue;
        char text[40];
        std::snprintf(text, sizeof text, "%.15G", number);
        ASSERT_EQ(Variant(number).ToText(), text);
        std::snprintf(text, sizeof text, "%.7G", static_cast<double>(static_cast<float>(number / 1e300)));
        ASSERT_EQ(Variant(static_cast<float>(number / 1e300)).ToText(), text == std::string("-0") ? "0" : text);
    }
}

TEST(VariantRoundTrip, FloatsComeBackNearlyFromTheirText) {
    std::mt19937 random(6);
    for (int round = 0; round < 20'000; ++round) {
        const auto number = std::bit_cast<float>(static_cast<std::uint32_t>(random()));
        if (!std::isnormal(number)) continue;
        const float read = Variant(Variant(number).ToText()).ToSingle();
        ASSERT_NEAR(read / number, 1, 1e-6);
    }
}

TEST(VariantRoundTrip, DatesComeBackFromTheirTextToTheSecond) {
    std::mt19937 random(7);
    for (int round = 0; round < 20'000; ++round) {
        const Date date{std::uniform_real_distribution(-657'434.0, 2'958'465.0)(random)};
        ASSERT_EQ(PartsOf(Variant(Variant(date).ToText()).ToDate()), PartsOf(date));
    }
}

TEST(VariantDate, ANumberOutsideTheYears100To9999IsError6) {
    for (const double days : {-657'435.0, 2'958'466.0, 1e300, -1e300, infinity, nan})
        EXPECT_EQ(ErrorOf([&] { Variant(days).ToDate(); }), errors::overflow) << days;
    EXPECT_EQ(Variant(-657'434).ToDate(), Date{-657'434});
    EXPECT_EQ(Variant(2'958'465.5).ToDate(), Date{2'958'465.5});
}

TEST(VariantColor, AnyNumberFromMinus2To31Up2To32Is32Bits) {
    EXPECT_EQ(Variant(-1).ToColor().value, 0xFFFFFFFFu);
    EXPECT_EQ(Variant(4294967295.0).ToColor().value, 0xFFFFFFFFu);
    EXPECT_EQ(Variant(4294967295.25).ToColor().value, 0xFFFFFFFFu);
    EXPECT_EQ(Variant(2147483648.0).ToColor().value, 0x80000000u);
    EXPECT_EQ(Variant(-2147483648.0).ToColor().value, 0x80000000u);
    EXPECT_EQ(Variant("2147483653").ToColor(), colors::windowBackground);
    EXPECT_EQ(Variant("-2147483643").ToColor(), colors::windowBackground);
    EXPECT_EQ(Variant(2.5).ToColor().value, 2u);
    EXPECT_EQ(Variant(std::int16_t{-1}).ToColor().value, 0xFFFFFFFFu);
    for (const double value : {4294967295.5, 4294967296.0, -2147483649.0, 1e300, infinity, -infinity, nan})
        EXPECT_EQ(ErrorOf([&] { Variant(value).ToColor(); }), errors::overflow) << value;
}

TEST(VariantColor, IsALongThatStaysAColourWhenConvertedToLong) {
    const Variant color = colors::windowBackground;
    EXPECT_TRUE(color.IsColor());
    EXPECT_EQ(color.ToLong(), -2147483643);
    EXPECT_TRUE(color.ConvertedTo(VarType::Long).IsColor());
    EXPECT_EQ(color.ConvertedTo(VarType::Long).ToColor(), colors::windowBackground);
    EXPECT_FALSE(Variant(5).ConvertedTo(VarType::Long).IsColor());
    EXPECT_FALSE(color.ConvertedTo(VarType::Double).IsColor());
}

TEST(VariantObject, ConvertsByItsDefaultMember) {
    const auto holder = std::make_shared<Holder>(Variant("12.5"));
    const Variant value = holder;
    EXPECT_EQ(value.ToDouble(), 12.5);
    EXPECT_EQ(value.ToText(), "12.5");
    EXPECT_EQ(value.ToInteger(), 12);
    holder->held = true;
    EXPECT_EQ(value.ToText(), "True");
    EXPECT_EQ(value.ToLong(), -1);
    holder->held = Date{36'925};
    EXPECT_EQ(value.ToText(), "2/3/2001");
    holder->held = "&HFFFF";
    EXPECT_EQ(value.ToInteger(), -1);
    holder->held = Variant();
    EXPECT_EQ(value.ToText(), "");
    holder->held = Variant::Missing();
    EXPECT_EQ(ErrorOf([&] { value.ToText(); }), errors::typeMismatch);
}

TEST(VariantObject, TheDefaultMemberIsReadOncePerConversion) {
    const auto holder = std::make_shared<Holder>(Variant("1"));
    const Variant value = holder;
    const std::function<void()> conversions[] = {[&] { value.ToBoolean(); }, [&] { value.ToInteger(); }, [&] { value.ToLong(); },
                                                 [&] { value.ToSingle(); },  [&] { value.ToDouble(); },  [&] { value.ToText(); },
                                                 [&] { value.ToDate(); },    [&] { value.ToColor(); }};
    for (const auto& convert : conversions) {
        holder->reads = 0;
        convert();
        EXPECT_EQ(holder->reads, 1);
    }
}

TEST(VariantObject, ConvertingToAnObjectKeepsTheObjectItself) {
    const auto holder = std::make_shared<Holder>(Variant(1));
    EXPECT_EQ(Variant(holder).ToObject().Get(), holder.get());
    EXPECT_EQ(holder->reads, 0);
}

TEST(VariantObject, AChainOfDefaultMembersEndsAfter8Steps) {
    EXPECT_EQ(Chain(5, 1).ToLong(), 5);
    EXPECT_EQ(Chain(5, 8).ToLong(), 5);
    EXPECT_EQ(ErrorOf([] { Chain(5, 9).ToLong(); }), errors::typeMismatch);
    EXPECT_EQ(ErrorOf([] { Chain(ObjectRef(), 1).ToLong(); }), errors::objectGone);
    EXPECT_EQ(ErrorOf([] { Chain(std::make_shared<Plain>(), 2).ToLong(); }), errors::typeMismatch);
}

TEST(VariantObject, AnObjectThatIsItsOwnDefaultMemberIsError13) {
    Holder self{Variant()};
    self.held = ObjectRef(self);
    const Variant value = ObjectRef(self);
    EXPECT_EQ(ErrorOf([&] { value.ToBoolean(); }), errors::typeMismatch);
    EXPECT_EQ(ErrorOf([&] { value.ToText(); }), errors::typeMismatch);
    EXPECT_EQ(self.reads, 16);
}

TEST(VariantObject, AnErrorOfTheDefaultMemberPassesThrough) {
    class Failing final : public Object {
      public:
        Failing() { table_.defaultMember = "Value"; }
        const ClassTable& Table() const override { return table_; }
        Variant Get(MemberKey, Arguments) override { throw ControlError(errors::notPermitted); }

      private:
        ClassTable table_{};
    };
    EXPECT_EQ(ErrorOf([] { Variant(std::make_shared<Failing>()).ToLong(); }), errors::notPermitted);
}

TEST(VariantArrays, HaveBoundsFromTheLowerOneUp) {
    const VariantArray list(-1, {10, "x", 30});
    EXPECT_EQ(list.LowerBound(), -1);
    EXPECT_EQ(list.UpperBound(), 1);
    EXPECT_EQ(list.At(-1).ToLong(), 10);
    EXPECT_EQ(list.At(1).ToLong(), 30);
    for (const int index : {-2, 2, std::numeric_limits<int>::min(), std::numeric_limits<int>::max()})
        EXPECT_EQ(ErrorOf([&] { list.At(index); }), errors::subscript) << index;
}

TEST(VariantArrays, OneFilledWithNothingEndsBeforeItBegins) {
    const VariantArray list(3, {});
    EXPECT_EQ(list.LowerBound(), 3);
    EXPECT_EQ(list.UpperBound(), 2);
    EXPECT_EQ(ErrorOf([&] { list.At(3); }), errors::subscript);
}

TEST(VariantArrays, OneNeverFilledConvertsToItselfButHasNoBounds) {
    const Variant value = VariantArray();
    const VariantArray& list = value.ToArray();
    EXPECT_FALSE(list.filled);
    EXPECT_EQ(ErrorOf([&] { list.LowerBound(); }), errors::subscript);
    EXPECT_EQ(ErrorOf([&] { list.UpperBound(); }), errors::subscript);
    EXPECT_EQ(ErrorOf([&] { list.At(0); }), errors::subscript);
}

TEST(VariantArrays, BoundsBeyondAnIntegerAreErrorsNotAccidents) {
    constexpr int most = std::numeric_limits<int>::max(), least = std::numeric_limits<int>::min();
    const VariantArray high(most, {1, 2});
    EXPECT_EQ(ErrorOf([&] { high.UpperBound(); }), errors::overflow);
    EXPECT_EQ(high.At(most).ToLong(), 1);
    EXPECT_EQ(ErrorOf([&] { high.At(least); }), errors::subscript);
    const VariantArray low(least, {});
    EXPECT_EQ(ErrorOf([&] { low.UpperBound(); }), errors::overflow);
    EXPECT_EQ(ErrorOf([&] { low.At(most); }), errors::subscript);
}

TEST(VariantConvertedTo, GivesTheTypeThatIsAskedForAndTheSameValueAsTheDirectConversion) {
    const Variant values[] = {
        Variant(), true,       std::int16_t{5}, 70'000,       2.5f,        -1e5,         "12",
        "x",       "2/3/2001", Date{36'925.25}, Rgb(1, 2, 3), ObjectRef(), GoneObject(), std::make_shared<Plain>(),
        Held("7"), List({1}),  VariantArray(),  nan};
    const std::function<Variant(const Variant&)> conversions[] = {
        [](const Variant& v) { return Variant(v.ToBoolean()); }, [](const Variant& v) { return Variant(v.ToInteger()); },
        [](const Variant& v) { return Variant(v.ToLong()); },    [](const Variant& v) { return Variant(v.ToSingle()); },
        [](const Variant& v) { return Variant(v.ToDouble()); },  [](const Variant& v) { return Variant(v.ToText()); },
        [](const Variant& v) { return Variant(v.ToDate()); },    [](const Variant& v) { return Variant(v.ToObject()); },
        [](const Variant& v) { return Variant(v.ToArray()); }};
    for (const Variant& value : values) {
        for (std::size_t place = 0; place < std::size(conversions); ++place) {
            const VarType type = allTypes[place + 2];
            const int error = ErrorOf([&] { conversions[place](value); });
            ASSERT_EQ(ErrorOf([&] { value.ConvertedTo(type); }), error) << VarTypeName(value.Type()) << " to " << VarTypeName(type);
            if (error) continue;
            EXPECT_EQ(value.ConvertedTo(type).Type(), type);
            EXPECT_EQ(value.ConvertedTo(type), conversions[place](value))
                << VarTypeName(value.Type()) << " to " << VarTypeName(type);
        }
    }
}

TEST(VariantConvertedTo, EmptyAsksForNoParticularType) {
    EXPECT_EQ(Variant("x").ConvertedTo(VarType::Empty), Variant("x"));
    EXPECT_EQ(Variant(5).ConvertedTo(VarType::Empty).Type(), VarType::Long);
    EXPECT_TRUE(Variant().ConvertedTo(VarType::Empty).IsEmpty());
}

TEST(VariantConvertedTo, OnlyAMissingArgumentIsMissing) {
    EXPECT_TRUE(Variant::Missing().ConvertedTo(VarType::Missing).IsMissing());
    for (const VarType type : allTypes) {
        if (type == VarType::Missing) continue;
        EXPECT_EQ(ErrorOf([&] { Variant::Missing().ConvertedTo(type); }), errors::typeMismatch) << VarTypeName(type);
    }
    for (const Variant& value : {Variant(), Variant(0), Variant("x"), Variant(ObjectRef()), List({})})
        EXPECT_EQ(ErrorOf([&] { value.ConvertedTo(VarType::Missing); }), errors::typeMismatch) << VarTypeName(value.Type());
}

TEST(VariantEquality, NumbersAreEqualByValueWhateverTheirTypes) {
    const Variant minusOne[] = {true, std::int16_t{-1}, -1, -1.0f, -1.0, OLE_COLOR(0xFFFFFFFFu)};
    for (const Variant& a : minusOne) {
        for (const Variant& b : minusOne) EXPECT_EQ(a, b) << VarTypeName(a.Type()) << " " << VarTypeName(b.Type());
        EXPECT_NE(a, Variant(1));
        EXPECT_NE(a, Variant(false));
    }
    EXPECT_EQ(Variant(false), Variant(-0.0));
    EXPECT_NE(Variant(16'777'217), Variant(16'777'216.0f));
    EXPECT_NE(Variant(0.1f), Variant(0.1));
    EXPECT_NE(Variant(2147483647), Variant(2147483647.5));
    EXPECT_EQ(Variant(colors::buttonFace), Variant(-2147483633));
}

TEST(VariantEquality, ANotANumberEqualsItself) {
    EXPECT_EQ(Variant(nan), Variant(nan));
    EXPECT_EQ(Variant(nan), Variant(floatNan));
    EXPECT_EQ(Variant(Date{nan}), Variant(Date{nan}));
    EXPECT_EQ(List({nan}), List({nan}));
    EXPECT_NE(Variant(nan), Variant(0.0));
    EXPECT_NE(Variant(nan), Variant(infinity));
}

TEST(VariantEquality, KindsOfValuesThatAreNoNumbersNeverEqualOneAnother) {
    const Variant kinds[] = {Variant(), Variant::Missing(), 0, "", "0", Date{0}, ObjectRef(), List({}), List({0}), VariantArray()};
    for (std::size_t a = 0; a < std::size(kinds); ++a) {
        for (std::size_t b = 0; b < std::size(kinds); ++b) EXPECT_EQ(kinds[a] == kinds[b], a == b) << a << " " << b;
    }
}

TEST(VariantEquality, TextsAndDatesAreComparedExactly) {
    EXPECT_EQ(Variant("abc"), Variant(std::string("abc")));
    EXPECT_NE(Variant("abc"), Variant("ABC"));
    EXPECT_NE(Variant("1"), Variant("1.0"));
    EXPECT_EQ(Variant(Date{1.5}), Variant(Date{1.5}));
    EXPECT_NE(Variant(Date{1.5}), Variant(Date{std::nextafter(1.5, 2)}));
}

TEST(VariantEquality, ObjectsAreEqualAsTheySeeItThemselves) {
    const auto one = std::make_shared<Holder>(Variant(1), 1), alsoOne = std::make_shared<Holder>(Variant(9), 1),
               two = std::make_shared<Holder>(Variant(1), 2);
    EXPECT_EQ(Variant(one), Variant(one));
    EXPECT_EQ(Variant(one), Variant(alsoOne));
    EXPECT_NE(Variant(one), Variant(two));
    EXPECT_NE(Variant(one), Variant(std::make_shared<Plain>()));
    EXPECT_NE(Variant(one), Variant(1));
    EXPECT_EQ(one->reads, 0);
}

TEST(VariantEquality, ArraysAreEqualElementByElementWithTheSameBounds) {
    EXPECT_EQ(List({1, "x", List({2})}), List({1.0, "x", List({2.0f})}));
    EXPECT_NE(List({1, 2}), List({1}));
    EXPECT_NE(List({1, 2}), List({2, 1}));
    EXPECT_NE(Variant(VariantArray(0, {1})), Variant(VariantArray(1, {1})));
    EXPECT_NE(Variant(VariantArray()), Variant(VariantArray(0, {})));
    EXPECT_EQ(Variant(VariantArray()), Variant(VariantArray()));
}

TEST(VariantEquality, IsTheSameInBothDirections) {
    const Variant values[] = {
        Variant(), Variant::Missing(), true, std::int16_t{-1}, -1,           0.5f,    0.5,       nan,           "-1",
        Date{-1},  OLE_COLOR(5),       5,    ObjectRef(),      GoneObject(), Held(1), List({1}), VariantArray()};
    for (const Variant& a : values) {
        EXPECT_TRUE(a == a) << VarTypeName(a.Type());
        for (const Variant& b : values) EXPECT_EQ(a == b, b == a) << VarTypeName(a.Type()) << " " << VarTypeName(b.Type());
    }
}

TEST(VariantConversion, CppTypesPassThroughAVariantUnchanged) {
    EXPECT_EQ(FromVariant<bool>(ToVariant(true)), true);
    EXPECT_EQ(FromVariant<std::int16_t>(ToVariant(std::int16_t{-5})), -5);
    EXPECT_EQ(FromVariant<std::int32_t>(ToVariant(70'000)), 70'000);
    EXPECT_EQ(FromVariant<float>(ToVariant(0.1f)), 0.1f);
    EXPECT_EQ(FromVariant<double>(ToVariant(0.1)), 0.1);
    EXPECT_EQ(FromVariant<std::string>(ToVariant(std::string("x"))), "x");
    EXPECT_EQ(FromVariant<OLE_COLOR>(ToVariant(colors::buttonFace)), colors::buttonFace);
    EXPECT_EQ(FromVariant<Date>(ToVariant(Date{1.5})), Date{1.5});
}

TEST(VariantConversion, AnOptionalArgumentIsNothingWhenItIsMissing) {
    EXPECT_EQ(FromVariant<std::optional<float>>(Variant::Missing()), std::nullopt);
    EXPECT_EQ(FromVariant<std::optional<float>>(Variant("2.5")), 2.5f);
    EXPECT_EQ(ErrorOf([] { FromVariant<std::optional<float>>(Variant("x")); }), errors::typeMismatch);
}

TEST(VariantConversion, ASharedObjectOfAnotherClassIsError13) {
    const auto holder = std::make_shared<Holder>(Variant(1));
    EXPECT_EQ(FromVariant<std::shared_ptr<Holder>>(Variant(holder)), holder);
    EXPECT_EQ(FromVariant<std::shared_ptr<Holder>>(Variant()), nullptr);
    EXPECT_EQ(ErrorOf([&] { FromVariant<std::shared_ptr<Plain>>(Variant(holder)); }), errors::typeMismatch);
    EXPECT_EQ(ErrorOf([] { FromVariant<std::shared_ptr<Plain>>(Variant(1)); }), errors::objectRequired);
}

}  // namespace
}  // namespace tessel::frame
