#include "tools/tessel-host/Json.h"

#include <limits>

#include <gtest/gtest.h>

#include "frame/Dates.h"
#include "frame/Error.h"
#include "frame/Font.h"
#include "frame/Picture.h"

namespace tessel::tools {
namespace {

using frame::Variant;
using frame::VarType;

std::string Written(const Variant& value) { return ToJson(value).dump(); }

/// A finder that knows one object, under "it", and no picture.
class Finding : public testing::Test {
  protected:
    Variant Read(const std::string& text) { return FromJson(Json::parse(text), finder_); }
    std::string RoundTrip(const std::string& text) { return Written(Read(text)); }
    int ErrorOf(const std::string& text) {
        try {
            Read(text);
            return 0;
        } catch (const frame::ControlError& error) {
            return error.Number();
        }
    }

    std::shared_ptr<frame::Font> it_ = std::make_shared<frame::Font>();
    std::string picture_;
    ObjectFinder finder_{[this](const std::string& path) -> frame::ObjectRef {
                             if (path != "it") throw frame::ControlError(frame::errors::objectRequired);
                             return it_;
                         },
                         [this](const std::string& file) {
                             picture_ = file;
                             return frame::ObjectRef();
                         }};
};

using JsonValues = Finding;

TEST(JsonText, PlainValuesAreThemselves) {
    EXPECT_EQ(Written(Variant()), "null");
    EXPECT_EQ(Written(true), "true");
    EXPECT_EQ(Written(std::int16_t{-5}), "-5");
    EXPECT_EQ(Written(std::int32_t{70'000}), "70000");
    EXPECT_EQ(Written("a\"b"), R"("a\"b")");
    EXPECT_EQ(Written(Variant::Missing()), R"({"missing":true})");
    EXPECT_EQ(Written(frame::ObjectRef()), "null");
}

TEST(JsonText, FloatsAreTheShortestTextThatReadsBack) {
    EXPECT_EQ(Written(0.1f), "0.1");
    EXPECT_EQ(Written(300.0f), "300.0");
    EXPECT_EQ(Written(16777216.0f), "16777216.0");
    EXPECT_EQ(Written(0.1), "0.1");
    EXPECT_EQ(Written(1.0 / 3), "0.3333333333333333");
    EXPECT_EQ(Written(1.0f / 3), "0.33333334");
}

TEST(JsonText, WhatIsNoNumberIsNull) {
    EXPECT_EQ(Written(std::numeric_limits<double>::quiet_NaN()), "null");
    EXPECT_EQ(Written(std::numeric_limits<float>::infinity()), "null");
}

TEST(JsonText, ColoursArePositive) {
    EXPECT_EQ(Written(frame::OLE_COLOR(0x8000000F)), "2147483663");
    EXPECT_EQ(Written(frame::OLE_COLOR(0xFFFFFFFF)), "4294967295");
    EXPECT_EQ(Written(std::int32_t{-2147483633}), "-2147483633") << "a plain number keeps its sign";
}

TEST(JsonText, BytesThatAreNoUtf8GoThroughAndComeBack) {
    const std::string bytes = "a\xE9z";
    const Json json = ToJson(bytes);
    EXPECT_EQ(json.dump(), "\"a\xF4\x8F\xBF\xA9z\"");
    EXPECT_EQ(FromJson(json, {}).Text(), bytes);
}

TEST(JsonText, DatesAreTheirDefaultText) { EXPECT_EQ(Written(frame::DateFrom({2001, 2, 3, 4, 5, 6})), "\"2/3/2001 4:05:06 AM\""); }

TEST(JsonText, ArraysBeginWithTheirFirstElementWhateverItsNumber) {
    EXPECT_EQ(Written(frame::VariantArray(1, {Variant(std::int16_t{7}), Variant("x")})), R"([7,"x"])");
    EXPECT_EQ(Written(frame::VariantArray()), "[]");
}

TEST(JsonText, AFontIsAnObjectOfItsMembers) {
    const auto font = std::make_shared<frame::Font>();
    font->SetName("Courier New");
    font->SetSize(9.75);
    font->SetBold(true);
    EXPECT_EQ(Written(font), R"({"Name":"Courier New","Size":9.75,"Bold":true,"Italic":false,"Underline":false,)"
                             R"("Strikethrough":false,"Weight":700,"Charset":0})");
}

TEST_F(JsonValues, TakeTheLeastTypeThatHoldsThem) {
    EXPECT_EQ(Read("32767").Type(), VarType::Integer);
    EXPECT_EQ(Read("-32768").Type(), VarType::Integer);
    EXPECT_EQ(Read("32768").Type(), VarType::Long);
    EXPECT_EQ(Read("-2147483648").Type(), VarType::Long);
    EXPECT_EQ(Read("2147483648").Type(), VarType::Double);
    EXPECT_EQ(Read("-2147483649").Type(), VarType::Double);
    EXPECT_EQ(Read("18446744073709551615").Type(), VarType::Double);
    EXPECT_EQ(Read("1.0").Type(), VarType::Double);
    EXPECT_EQ(Read("true").Type(), VarType::Boolean);
    EXPECT_EQ(Read("\"1\"").Type(), VarType::String);
    EXPECT_TRUE(Read("null").IsEmpty());
}

TEST_F(JsonValues, KeepWhatTheySay) {
    for (const char* text : {"0", "-1", "32768", "2147483648.0", "0.1", "\"x\"", "false", "null", R"([1,[2.5,"x"],null])", "[]",
                             R"({"missing":true})"})
        EXPECT_EQ(RoundTrip(text), text);
    EXPECT_EQ(Read("2147483663").ToColor(), frame::OLE_COLOR(0x8000000F));
    EXPECT_EQ(Read("-2147483633").ToColor(), frame::OLE_COLOR(0x8000000F));
}

TEST_F(JsonValues, AFontIsReadFromAnyOfItsMembersInAnyCase) {
    const auto font = std::dynamic_pointer_cast<frame::Font>(Read(R"({"name":"Arial","Size":12,"BOLD":true})").ToObject().Shared());
    ASSERT_TRUE(font);
    EXPECT_EQ(font->Name(), "Arial");
    EXPECT_EQ(font->Size(), 12);
    EXPECT_TRUE(font->Bold());
    EXPECT_FALSE(font->Italic());
}

TEST_F(JsonValues, AnObjectIsFoundByItsPath) {
    EXPECT_EQ(Read(R"({"object":"it"})").ToObject().Get(), it_.get());
    EXPECT_EQ(ErrorOf(R"({"object":"other"})"), frame::errors::objectRequired);
}

TEST_F(JsonValues, APictureIsAskedForByItsFile) {
    Read(R"({"picture":"C:\\p.bmp"})");
    EXPECT_EQ(picture_, "C:\\p.bmp");
}

TEST_F(JsonValues, AnObjectOfUnknownFormIsATypeMismatch) {
    for (const char* text : {"{}", R"({"Nam":"Arial"})", R"({"Name":"Arial","x":1})", R"({"object":1})", R"({"picture":null})",
                             R"({"object":"it","picture":"x"})"})
        EXPECT_EQ(ErrorOf(text), frame::errors::typeMismatch) << text;
}

TEST_F(JsonValues, AFontWithABadMemberIsRefused) {
    EXPECT_EQ(ErrorOf(R"({"Size":0})"), frame::errors::invalidValue);
    EXPECT_EQ(ErrorOf(R"({"Size":"large"})"), frame::errors::typeMismatch);
    EXPECT_EQ(ErrorOf(R"({"Weight":70000})"), frame::errors::overflow);
}

TEST_F(JsonValues, NestedTooDeepAreRefused) {
    const auto nested = [](std::size_t depth) { return std::string(depth, '[') + std::string(depth, ']'); };
    EXPECT_EQ(RoundTrip(nested(33)), nested(33));
    EXPECT_EQ(ErrorOf(nested(34)), frame::errors::invalidCall);
}

}  // namespace
}  // namespace tessel::tools
