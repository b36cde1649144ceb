#include "hosts/qt/BagText.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <string>

#include "frame/Font.h"
#include "frame/Picture.h"
#include "tests/ErrorOf.h"

namespace tessel::qt {
namespace {

using frame::MemoryBag;
using frame::Variant;
using test::ErrorOf;

Variant There(const Variant& value, const char* key = "Key") {
    MemoryBag bag;
    bag.Set(key, value);
    const MemoryBag back = BagOf(BagText(bag));
    EXPECT_EQ(back.Kept().size(), 1u);
    return back.ReadProperty(key, Variant("nothing there"));
}

bool IsAscii(const QByteArray& text) {
    return std::all_of(text.begin(), text.end(), [](char c) { return static_cast<unsigned char>(c) < 0x80; });
}

TEST(BagTextTest, AnEmptyBagIsAnEmptyObject) {
    EXPECT_EQ(BagText({}).simplified().replace(" ", ""), "{}");
    EXPECT_TRUE(BagOf("{}").Kept().empty());
}

TEST(BagTextTest, BooleansComeBackAsBooleans) {
    EXPECT_EQ(There(true).Type(), frame::VarType::Boolean);
    EXPECT_TRUE(There(true).ToBoolean());
    EXPECT_FALSE(There(false).ToBoolean());
}

TEST(BagTextTest, WholeNumbersComeBack) {
    for (const int number : {0, 1, -1, 30, 32767, -32768, std::numeric_limits<int>::max(), std::numeric_limits<int>::min()}) {
        EXPECT_EQ(There(Variant(number)), Variant(number)) << number;
    }
    EXPECT_EQ(There(Variant(std::int16_t{-7})), Variant(-7));
}

TEST(BagTextTest, ColoursComeBackWithTheirHighBit) {
    EXPECT_EQ(There(Variant(frame::colors::buttonFace)).ToColor(), frame::colors::buttonFace);
    EXPECT_EQ(There(Variant(frame::OLE_COLOR(0xC00000))).ToColor(), frame::OLE_COLOR(0xC00000));
}

TEST(BagTextTest, FloatsComeBackToTheBit) {
    for (const float number :
         {0.1f, 1664.53f, 30.5f, -0.0f, std::numeric_limits<float>::denorm_min(), std::numeric_limits<float>::max()}) {
        EXPECT_EQ(There(Variant(number)).ToSingle(), number) << number;
    }
    for (const double number : {0.1, 1e300, -1e-300, 123456789.123456789, 9007199254740993.0, std::numeric_limits<double>::min()}) {
        EXPECT_EQ(There(Variant(number)).ToDouble(), number) << number;
    }
}

TEST(BagTextTest, NumbersThatJsonLacksComeBack) {
    const double infinity = std::numeric_limits<double>::infinity();
    EXPECT_EQ(There(Variant(infinity)).ToDouble(), infinity);
    EXPECT_EQ(There(Variant(-infinity)).ToDouble(), -infinity);
    EXPECT_TRUE(std::isnan(There(Variant(std::numeric_limits<double>::quiet_NaN())).ToDouble()));
    EXPECT_TRUE(std::isinf(There(Variant(std::numeric_limits<float>::infinity())).ToSingle()));
}

TEST(BagTextTest, DatesComeBackAsDates) {
    const Variant back = There(Variant(frame::Date{36925.170205}));
    EXPECT_EQ(back.Type(), frame::VarType::Date);
    EXPECT_EQ(back, Variant(frame::Date{36925.170205}));
    EXPECT_EQ(There(Variant(frame::Date{-1.25})), Variant(frame::Date{-1.25}));
}

TEST(BagTextTest, TextsComeBackByteByByte) {
    for (const std::string& text :
         std::vector<std::string>{"", "a", "quote \" back \\ slash /", "two\r\nlines\ttab", "\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80",
                                  std::string("nul\0in", 6), "\x7F\x01\x1F", "\xFF", "\xC3", "half \xE2\x82", "\xED\xA0\x80",
                                  "\xC0\x80", "\xF4\x90\x80\x80", "\xF4\x8F\xBE\x80", "\xF4\x8F\xBF\xBF", "{\"date\":1}",
                                  "\xEF\xBB\xBF"
                                  "bom",
                                  "\xEF\xBF\xBE"}) {
        const Variant back = There(Variant(text));
        ASSERT_TRUE(back.IsString());
        EXPECT_EQ(back.Text(), text);
    }
}

TEST(BagTextTest, EveryByteComesBackByItself) {
    for (int byte = 0; byte < 256; ++byte) {
        const std::string text = "a" + std::string(1, static_cast<char>(byte)) + "b";
        EXPECT_EQ(There(Variant(text)).ToText(), text) << byte;
    }
}

TEST(BagTextTest, TheTextIsAsciiWhateverItHolds) {
    MemoryBag bag;
    bag.Set("Caption", Variant("\xC3\xA9 \xF0\x9F\x98\x80 \xFF \x7F"));
    bag.Set("k\xC3\xA9y", Variant(1));
    bag.Set("Font", Variant(std::make_shared<frame::Font>("F\xC3\xB6nt", 9)));
    EXPECT_TRUE(IsAscii(BagText(bag)));
    EXPECT_EQ(BagText(bag).indexOf('\0'), -1);
}

TEST(BagTextTest, KeysComeBackWhateverTheirCharacters) {
    for (const char* key : {"Forecolor", "", "a \"b\" \\", "k\xC3\xA9y", "with space", "date", "font"}) {
        EXPECT_EQ(There(Variant(7), key), Variant(7)) << key;
    }
}

TEST(BagTextTest, KeysThatDifferInCaseAreTwo) {
    MemoryBag bag;
    bag.Set("Key", Variant(1));
    bag.Set("key", Variant(2));
    const MemoryBag back = BagOf(BagText(bag));
    EXPECT_EQ(back.ReadProperty("Key", {}), Variant(1));
    EXPECT_EQ(back.ReadProperty("key", {}), Variant(2));
}

TEST(BagTextTest, AFontComesBackWithAllItsMembers) {
    const auto font = std::make_shared<frame::Font>("D\xC3\xA9j\xC3\xA0 \"Vu\" \xFF", 8.25);
    font->SetWeight(600);
    font->SetItalic(true);
    font->SetUnderline(true);
    font->SetStrikethrough(true);
    font->SetCharset(204);
    EXPECT_EQ(There(Variant(font)), Variant(font));
    const auto plain = std::make_shared<frame::Font>("Sans", 0.0001);
    EXPECT_EQ(There(Variant(plain)), Variant(plain));
    const auto nameless = std::make_shared<frame::Font>("", 2048);
    EXPECT_EQ(There(Variant(nameless)), Variant(nameless));
    const auto light = std::make_shared<frame::Font>("Sans", 10);
    light->SetWeight(300);
    EXPECT_EQ(There(Variant(light)), Variant(light));
}

frame::PictureRef SmallPicture(const std::string& source, double scale = 1) {
    frame::PixelPlane plane;
    plane.scale = scale;
    plane.width = 3;
    plane.height = 2;
    plane.pixels = {0xFF0000FF, 0xFF00FF00, 0xFFFF0000, 0xFFFFFFFF, 0xFF123456, 0xFF000000};
    return std::make_shared<frame::Picture>(std::vector{plane}, source);
}

TEST(BagTextTest, AnOpaquePictureComesBackWithItsSource) {
    const frame::PictureRef picture = SmallPicture(
        "c:\\p\xC3\xAC"
        "c \xFF.bmp");
    const Variant back = There(Variant(picture));
    EXPECT_EQ(back, Variant(picture));
}

TEST(BagTextTest, HalfTransparentPixelsComeBackExactly) {
    frame::PixelPlane plane;
    plane.width = 4;
    plane.height = 1;
    plane.pixels = {0x80112233, 0x01FF8040, 0xFE010203, 0x7F000000};
    const auto picture = std::make_shared<frame::Picture>(std::vector{plane}, "");
    EXPECT_EQ(There(Variant(picture)), Variant(frame::PictureRef(picture)));
}

TEST(BagTextTest, APictureOfTwoScalesKeepsItsSizeAndItsSharpPixels) {
    const frame::PictureRef picture = SmallPicture("two.png", 2);
    const Variant back = There(Variant(picture));
    const auto came = std::dynamic_pointer_cast<frame::Picture>(back.ToObject().Shared());
    ASSERT_TRUE(came);
    EXPECT_EQ(came->Width(), picture->Width());
    EXPECT_EQ(came->Height(), picture->Height());
}

TEST(BagTextTest, APictureWithoutPixelsDoesNotSpoilTheBag) {
    for (const frame::PictureRef& picture :
         {std::make_shared<frame::Picture>(), std::make_shared<frame::Picture>(150.0f, 75.0f, "x")}) {
        MemoryBag bag;
        bag.Set("Picture", Variant(picture));
        bag.Set("Caption", Variant("kept"));
        EXPECT_EQ(ErrorOf([&] { EXPECT_EQ(BagOf(BagText(bag)).ReadProperty("Caption", {}), Variant("kept")); }), 0);
    }
}

TEST(BagTextTest, NoObjectComesBackAsNone) {
    EXPECT_EQ(There(Variant(frame::ObjectRef())).ToObject().Get(), nullptr);
    EXPECT_TRUE(There(Variant()).IsEmpty());
}

TEST(BagTextTest, AValueOfAnotherKindIsError13) {
    MemoryBag missing;
    missing.Set("Key", Variant::Missing());
    EXPECT_EQ(ErrorOf([&] { BagText(missing); }), frame::errors::typeMismatch);
    MemoryBag array;
    array.Set("Key", Variant(frame::VariantArray(0, {Variant(1)})));
    EXPECT_EQ(ErrorOf([&] { BagText(array); }), frame::errors::typeMismatch);
}

TEST(BagTextTest, WhatIsNoBagIsError380) {
    for (const char* text : {"",
                             " ",
                             "[",
                             "[]",
                             "null",
                             "3",
                             "\"text\"",
                             "true",
                             "{",
                             "}",
                             "{\"a\"}",
                             "{\"a\":}",
                             "{\"a\":1",
                             "{\"a\":1}}",
                             "{\"a\":1} x",
                             "{a:1}",
                             "{'a':1}",
                             "{\"a\":1,}",
                             "{\"a\":[1]}",
                             "{\"a\":{}}",
                             "not json",
                             "{\"a\":\"\\ud83d",
                             "{\"a\":1e}",
                             "\xFF\xFE{}"}) {
        EXPECT_EQ(ErrorOf([&] { BagOf(text); }), frame::errors::invalidValue) << text;
    }
}

TEST(BagTextTest, MalformedValuesAreError380) {
    for (const char* text :
         {"{\"a\":{\"date\":\"x\"}}", "{\"a\":{\"date\":null}}", "{\"a\":{\"number\":\"x\"}}", "{\"a\":{\"number\":1}}",
          "{\"a\":{\"font\":3,\"size\":8}}", "{\"a\":{\"font\":\"A\",\"size\":-1}}", "{\"a\":{\"font\":\"A\",\"size\":0}}",
          "{\"a\":{\"font\":\"A\",\"size\":99999}}", "{\"a\":{\"font\":\"A\",\"size\":\"8\"}}",
          "{\"a\":{\"font\":\"A\",\"size\":8,\"weight\":1e9}}", "{\"a\":{\"font\":\"A\",\"size\":8,\"weight\":\"bold\"}}",
          "{\"a\":{\"picture\":3}}", "{\"a\":{\"picture\":\"%%%\"}}", "{\"a\":{\"picture\":\"aGVsbG8=\"}}", "{\"a\":{\"other\":1}}",
          "{\"a\":{\"date\":1,\"font\":\"A\"}}"}) {
        EXPECT_EQ(ErrorOf([&] { BagOf(text); }), frame::errors::invalidValue) << text;
    }
}

TEST(BagTextTest, DeepNestingEndsInError380) {
    QByteArray deep = "{\"a\":";
    for (int level = 0; level < 200000; ++level) deep += "{\"a\":";
    EXPECT_EQ(ErrorOf([&] { BagOf(deep); }), frame::errors::invalidValue);
    EXPECT_EQ(ErrorOf([&] { BagOf(QByteArray(200000, '[')); }), frame::errors::invalidValue);
}

/// A PNG that claims a gigantic size in its head.
TEST(BagTextTest, APictureThatClaimsAGiganticSizeIsRefusedWithoutTheMemory) {
    MemoryBag bag;
    bag.Set("Picture", Variant(SmallPicture("")));
    const QByteArray text = BagText(bag);
    const int from = text.indexOf("iVBOR");
    ASSERT_GE(from, 0);
    const int to = text.indexOf('"', from);
    QByteArray file = QByteArray::fromBase64(text.mid(from, to - from));
    for (const int place : {16, 17, 18, 19, 20, 21, 22, 23}) file[place] = place % 4 == 0 ? '\0' : '\xF0';
    EXPECT_EQ(ErrorOf([&] { BagOf(text.left(from) + file.toBase64() + text.mid(to)); }), frame::errors::invalidValue);
}

TEST(BagTextTest, EveryCutOfATextIsRefusedOrRead) {
    MemoryBag bag;
    bag.Set("Caption", Variant("\xC3\xA9 \xF0\x9F\x98\x80 \xFF"));
    bag.Set("Font", Variant(std::make_shared<frame::Font>("Sans", 9)));
    bag.Set("Picture", Variant(SmallPicture("x")));
    bag.Set("When", Variant(frame::Date{1.5}));
    const QByteArray text = BagText(bag);
    for (int length = 0; length < text.size(); ++length) {
        EXPECT_EQ(ErrorOf([&] { BagOf(text.left(length)); }), frame::errors::invalidValue) << length;
    }
    for (int place = 0; place < text.size(); ++place) {
        for (const char other : {'\0', '"', '{', '9', '\xFF'}) {
            QByteArray spoiled = text;
            spoiled[place] = other;
            const int error = ErrorOf([&] { BagOf(spoiled); });
            EXPECT_TRUE(error == 0 || error == frame::errors::invalidValue) << place << " gave " << error;
        }
    }
}

}  // namespace
}  // namespace tessel::qt
