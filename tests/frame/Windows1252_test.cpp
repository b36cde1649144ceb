#include "frame/Windows1252.h"

#include <gtest/gtest.h>

#include <optional>
#include <string>
#include <utility>

namespace tessel::frame {
namespace {

TEST(Windows1252, MapsItsCharactersBothWays) {
    Windows1252 page;
    const std::pair<const char*, const char*> texts[] = {
        {"", ""},
        {"plain\t\r\n~\x7F", "plain\t\r\n~\x7F"},
        {"\u00A0\u00E4\u00FF", "\xA0\xE4\xFF"},
        {"\u20AC\u201A\u0192\u201E\u2026\u2020\u2021\u02C6\u2030\u0160\u2039\u0152\u017D",
         "\x80\x82\x83\x84\x85\x86\x87\x88\x89\x8A\x8B\x8C\x8E"},
        {"\u2018\u2019\u201C\u201D\u2022\u2013\u2014\u02DC\u2122\u0161\u203A\u0153\u017E\u0178",
         "\x91\x92\x93\x94\x95\x96\x97\x98\x99\x9A\x9B\x9C\x9E\x9F"},
    };
    for (const auto& [text, bytes] : texts) {
        EXPECT_EQ(page.ToNarrow(text), bytes);
        EXPECT_EQ(page.FromNarrow(bytes), text);
    }
}

TEST(Windows1252, TakesAZeroByteAsACharacter) {
    using namespace std::string_literals;
    Windows1252 page;
    EXPECT_EQ(page.ToNarrow("a\0b"s), "a\0b"s);
    EXPECT_EQ(page.FromNarrow("a\0b"s), "a\0b"s);
}

TEST(Windows1252, RefusesATextWithACharacterThatItLacks) {
    Windows1252 page;
    EXPECT_EQ(page.ToNarrow("price \u0100"), std::nullopt);
    EXPECT_EQ(page.ToNarrow("\u4E2D"), std::nullopt);
    EXPECT_EQ(page.ToNarrow("\U0001F600"), std::nullopt);
    EXPECT_EQ(page.ToNarrow("\u0085"), std::nullopt);  // a control character whose byte means another
}

TEST(Windows1252, RefusesATextThatIsNoValidUtf8) {
    Windows1252 page;
    EXPECT_EQ(page.ToNarrow("a\xFF"), std::nullopt);
    EXPECT_EQ(page.ToNarrow("a\x80"), std::nullopt);
}

TEST(Windows1252, BringsEveryByteBack) {
    Windows1252 page;
    for (int byte = 0; byte < 256; ++byte) {
        const std::string bytes(1, static_cast<char>(byte));
        EXPECT_EQ(page.ToNarrow(page.FromNarrow(bytes)), bytes) << byte;
    }
}

}  // namespace
}  // namespace tessel::frame
