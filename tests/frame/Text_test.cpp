#include "frame/Text.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>
#include <cstdint>
#include <limits>
#include <random>
#include <string>
#include <string_view>
#include <unordered_set>
#include <vector>

namespace tessel::frame {
namespace {

using namespace std::string_literals;
using namespace std::string_view_literals;
using testing::ElementsAre;

constexpr char32_t lastCharacter = 0x10FFFF;

bool IsSurrogate(char32_t character) { return character >= 0xD800 && character <= 0xDFFF; }

std::vector<std::uint32_t> Characters(std::string_view text) {
    std::vector<std::uint32_t> characters;
    for (std::size_t position = 0; position < text.size();) characters.push_back(NextCharacter(text, position));
    return characters;
}

std::string Utf8(char32_t character) {
    std::string text;
    AppendCharacter(text, character);
    return text;
}

std::uint32_t Fold(char32_t character) { return FoldCase(character); }

/// Bytes that are near to valid UTF-8: leads, continuations and the bounds of both come often.
std::string RandomBytes(std::mt19937& numbers) {
    constexpr std::string_view likely =
        "aZ\x7F\x80\x8F\x90\x9F\xA0\xBF\xC0\xC1\xC2\xC3\xCE\xDF\xE0\xE1\xED\xEF\xF0\xF1\xF4\xF5\xF8\xFC\xFF"sv;
    std::string bytes(numbers() % 40, '\0');
    for (char& byte : bytes) byte = numbers() % 2 ? likely[numbers() % likely.size()] : static_cast<char>(numbers() % 256);
    return bytes;
}

std::string JoinCharacters(std::string_view text) {
    std::string joined;
    for (const char32_t character : Characters(text)) AppendCharacter(joined, character);
    return joined;
}

// Reading characters

TEST(NextCharacter, ReadsOneToFourBytesAndMovesBehindThem) {
    const std::string_view text = "a\u00E4\u20AC\U0001F600";
    std::size_t position = 0;
    EXPECT_EQ(NextCharacter(text, position), U'a');
    EXPECT_EQ(position, 1u);
    EXPECT_EQ(NextCharacter(text, position), U'\u00E4');
    EXPECT_EQ(position, 3u);
    EXPECT_EQ(NextCharacter(text, position), U'\u20AC');
    EXPECT_EQ(position, 6u);
    EXPECT_EQ(NextCharacter(text, position), U'\U0001F600');
    EXPECT_EQ(position, 10u);
}

TEST(NextCharacter, TakesAZeroByteAsACharacter) { EXPECT_THAT(Characters("a\0b"sv), ElementsAre('a', 0, 'b')); }

TEST(NextCharacter, ReadsTheBoundsOfEachLength) {
    EXPECT_THAT(Characters("\x7F"), ElementsAre(0x7F));
    EXPECT_THAT(Characters("\xC2\x80"), ElementsAre(0x80));
    EXPECT_THAT(Characters("\xDF\xBF"), ElementsAre(0x7FF));
    EXPECT_THAT(Characters("\xE0\xA0\x80"), ElementsAre(0x800));
    EXPECT_THAT(Characters("\xED\x9F\xBF"), ElementsAre(0xD7FF));
    EXPECT_THAT(Characters("\xEE\x80\x80"), ElementsAre(0xE000));
    EXPECT_THAT(Characters("\xEF\xBF\xBF"), ElementsAre(0xFFFF));
    EXPECT_THAT(Characters("\xF0\x90\x80\x80"), ElementsAre(0x10000));
    EXPECT_THAT(Characters("\xF4\x8F\xBF\xBF"), ElementsAre(0x10FFFF));
}

TEST(NextCharacter, GivesOverlongFormsAsEscapedBytes) {
    EXPECT_THAT(Characters("\xC0\x80"), ElementsAre(0xDCC0, 0xDC80));
    EXPECT_THAT(Characters("\xC1\xBF"), ElementsAre(0xDCC1, 0xDCBF));
    EXPECT_THAT(Characters("\xE0\x9F\xBF"), ElementsAre(0xDCE0, 0xDC9F, 0xDCBF));
    EXPECT_THAT(Characters("\xF0\x8F\xBF\xBF"), ElementsAre(0xDCF0, 0xDC8F, 0xDCBF, 0xDCBF));
}

TEST(NextCharacter, GivesEncodedSurrogatesAsEscapedBytes) {
    EXPECT_THAT(Characters("\xED\xA0\x80"), ElementsAre(0xDCED, 0xDCA0, 0xDC80));
    EXPECT_THAT(Characters("\xED\xB2\x80"), ElementsAre(0xDCED, 0xDCB2, 0xDC80));
    EXPECT_THAT(Characters("\xED\xBF\xBF"), ElementsAre(0xDCED, 0xDCBF, 0xDCBF));
}

TEST(NextCharacter, GivesValuesAboveTheLastCharacterAsEscapedBytes) {
    EXPECT_THAT(Characters("\xF4\x90\x80\x80"), ElementsAre(0xDCF4, 0xDC90, 0xDC80, 0xDC80));
    EXPECT_THAT(Characters("\xF7\xBF\xBF\xBF"), ElementsAre(0xDCF7, 0xDCBF, 0xDCBF, 0xDCBF));
}

TEST(NextCharacter, GivesFormsOfFiveAndSixBytesAsEscapedBytes) {
    EXPECT_THAT(Characters("\xF8\x88\x80\x80\x80"), ElementsAre(0xDCF8, 0xDC88, 0xDC80, 0xDC80, 0xDC80));
    EXPECT_THAT(Characters("\xFC\x84\x80\x80\x80\x80"), ElementsAre(0xDCFC, 0xDC84, 0xDC80, 0xDC80, 0xDC80, 0xDC80));
    EXPECT_THAT(Characters("\xFE\xFF"), ElementsAre(0xDCFE, 0xDCFF));
}

TEST(NextCharacter, GivesATruncatedSequenceAsEscapedBytes) {
    EXPECT_THAT(Characters("\xC3"), ElementsAre(0xDCC3));
    EXPECT_THAT(Characters("\xE2\x82"), ElementsAre(0xDCE2, 0xDC82));
    EXPECT_THAT(Characters("\xF0\x9F\x98"), ElementsAre(0xDCF0, 0xDC9F, 0xDC98));
}

TEST(NextCharacter, DoesNotReadBehindTheEndOfTheView) {
    const std::string_view euro = "\u20AC";
    EXPECT_THAT(Characters(euro.substr(0, 2)), ElementsAre(0xDCE2, 0xDC82));
}

TEST(NextCharacter, GoesOnBehindTheFirstByteOfABrokenSequence) {
    EXPECT_THAT(Characters("\xE2\x82x"), ElementsAre(0xDCE2, 0xDC82, 'x'));
    EXPECT_THAT(Characters("\xE2\xC3\xA4"), ElementsAre(0xDCE2, 0xE4));
    EXPECT_THAT(Characters("\x80\xC3\xA4"), ElementsAre(0xDC80, 0xE4));
}

TEST(AppendCharacter, WritesTheShortestForm) {
    EXPECT_EQ(Utf8(0), "\0"sv);
    EXPECT_EQ(Utf8(0x7F), "\x7F");
    EXPECT_EQ(Utf8(0x80), "\xC2\x80");
    EXPECT_EQ(Utf8(0x7FF), "\xDF\xBF");
    EXPECT_EQ(Utf8(0x800), "\xE0\xA0\x80");
    EXPECT_EQ(Utf8(0xFFFF), "\xEF\xBF\xBF");
    EXPECT_EQ(Utf8(0x10000), "\xF0\x90\x80\x80");
    EXPECT_EQ(Utf8(0x10FFFF), "\xF4\x8F\xBF\xBF");
}

TEST(AppendCharacter, KeepsWhatTheTextHeld) {
    std::string text = "caf";
    AppendCharacter(text, U'\u00E9');
    EXPECT_EQ(text, "caf\u00E9");
}

TEST(AppendCharacter, WritesAnEscapedByteAsThatByte) {
    EXPECT_EQ(Utf8(0xDC80), "\x80");
    EXPECT_EQ(Utf8(0xDCFF), "\xFF");
}

TEST(AppendCharacter, WritesTheReplacementCharacterForWhatHasNoForm) {
    for (const char32_t character : {0xD800u, 0xDBFFu, 0xDC00u, 0xDC7Fu, 0xDD00u, 0xDFFFu, 0x110000u, 0xFFFFFFFFu})
        EXPECT_EQ(Utf8(character), "\uFFFD") << std::hex << std::uint32_t{character};
}

TEST(Utf8, EveryCodePointIsReadBackAsWritten) {
    for (char32_t character = 0; character <= lastCharacter; ++character) {
        if (IsSurrogate(character)) continue;
        const std::string text = Utf8(character);
        std::size_t position = 0;
        ASSERT_EQ(NextCharacter(text, position), character);
        ASSERT_EQ(position, text.size());
        ASSERT_TRUE(IsValidUtf8(text));
    }
}

TEST(Utf8, ArbitraryBytesSurviveReadingAndWriting) {
    std::mt19937 numbers(20240229);
    for (int round = 0; round < 50000; ++round) {
        const std::string bytes = RandomBytes(numbers);
        ASSERT_EQ(JoinCharacters(bytes), bytes) << testing::PrintToString(bytes);
    }
}

TEST(Utf8, ATextIsValidExactlyWhenNoByteOfItIsEscaped) {
    std::mt19937 numbers(7);
    int validTexts = 0;
    for (int round = 0; round < 50000; ++round) {
        const std::string bytes = RandomBytes(numbers);
        bool hasEscapedByte = false;
        for (const std::uint32_t character : Characters(bytes)) hasEscapedByte |= IsSurrogate(character);
        ASSERT_EQ(IsValidUtf8(bytes), !hasEscapedByte) << testing::PrintToString(bytes);
        validTexts += !hasEscapedByte;
    }
    EXPECT_GT(validTexts, 0);
}

// Validity and length

TEST(IsValidUtf8, AcceptsTheEmptyTextAndEveryLengthOfSequence) {
    EXPECT_TRUE(IsValidUtf8(""));
    EXPECT_TRUE(IsValidUtf8("a\0b"sv));
    EXPECT_TRUE(IsValidUtf8("a\u00E4\u20AC\U0001F600z"));
    EXPECT_TRUE(IsValidUtf8("\uFEFF\uFFFD\uFFFF"));
}

TEST(IsValidUtf8, RefusesInvalidBytesAnywhere) {
    for (const std::string_view invalid :
         {"\x80", "\xBF", "\xC0\x80", "\xC3", "\xE0\x9F\xBF", "\xE2\x82", "\xED\xA0\x80", "\xF0\x8F\xBF\xBF", "\xF0\x9F\x98",
          "\xF4\x90\x80\x80", "\xF8\x88\x80\x80\x80", "\xFF"}) {
        const std::string text(invalid);
        EXPECT_FALSE(IsValidUtf8(text)) << testing::PrintToString(text);
        EXPECT_FALSE(IsValidUtf8("name" + text)) << testing::PrintToString(text);
        EXPECT_FALSE(IsValidUtf8(text + "name")) << testing::PrintToString(text);
    }
}

TEST(IsValidUtf8, AcceptsAsManyTwoByteTextsAsThereAre) {
    constexpr int asciiCharacters = 128;
    constexpr int twoByteCharacters = 0x800 - 0x80;
    int valid = 0;
    for (int bytes = 0; bytes < 0x10000; ++bytes) {
        const std::array text = {static_cast<char>(bytes >> 8), static_cast<char>(bytes)};
        valid += IsValidUtf8({text.data(), text.size()});
    }
    EXPECT_EQ(valid, asciiCharacters * asciiCharacters + twoByteCharacters);
}

TEST(IsValidUtf8, AcceptsAsManySequencesOfThreeBytesAsThereAreCharacters) {
    constexpr int threeByteCharacters = 0x10000 - 0x800 - 0x800;  // without the surrogates
    int valid = 0;
    for (int bytes = 0xC00000; bytes < 0x1000000; ++bytes) {
        const std::array text = {static_cast<char>(bytes >> 16), static_cast<char>(bytes >> 8), static_cast<char>(bytes)};
        const bool endsWithAscii = (bytes & 0x80) == 0;
        valid += !endsWithAscii && IsValidUtf8({text.data(), text.size()});
    }
    EXPECT_EQ(valid, threeByteCharacters);
}

TEST(IsValidUtf8, AcceptsOnlyPlanesOneToSixteenInFourBytes) {
    constexpr int planes = 16;
    constexpr int secondBytesOfAPlane = 16;
    constexpr int validEnds = 2 * 2;  // of the four tried for each of the last two bytes
    int valid = 0;
    for (int start = 0xF000; start <= 0xFFFF; ++start) {
        for (const char third : {'\x7F', '\x80', '\xBF', '\xC0'}) {
            for (const char fourth : {'\x7F', '\x80', '\xBF', '\xC0'}) {
                const std::array text = {static_cast<char>(start >> 8), static_cast<char>(start), third, fourth};
                valid += IsValidUtf8({text.data(), text.size()});
            }
        }
    }
    EXPECT_EQ(valid, planes * secondBytesOfAPlane * validEnds);
}

TEST(CharacterCount, CountsCodePointsAndEachInvalidByte) {
    EXPECT_EQ(CharacterCount(""), 0u);
    EXPECT_EQ(CharacterCount("name.txt"), 8u);
    EXPECT_EQ(CharacterCount("a\u00E4\u20AC\U0001F600"), 4u);
    EXPECT_EQ(CharacterCount("a\u0308"), 2u);
    EXPECT_EQ(CharacterCount("a\xE2\x82z\xFF"), 5u);
}

TEST(CharacterCount, IsTheNumberOfCharactersThatAreRead) {
    std::mt19937 numbers(11);
    for (int round = 0; round < 20000; ++round) {
        const std::string bytes = RandomBytes(numbers);
        ASSERT_EQ(CharacterCount(bytes), Characters(bytes).size()) << testing::PrintToString(bytes);
    }
}

// Folding

TEST(FoldCase, AsciiFoldsOnlyItsCapitalLetters) {
    for (char32_t character = 0; character < 0x80; ++character) {
        const bool isCapital = character >= U'A' && character <= U'Z';
        EXPECT_EQ(Fold(character), isCapital ? character + 32 : character);
    }
}

TEST(FoldCase, LatinLettersFoldToTheirSmallForms) {
    EXPECT_EQ(Fold(U'\u00C4'), 0xE4u);
    EXPECT_EQ(Fold(U'\u00DE'), 0xFEu);
    EXPECT_EQ(Fold(U'\u0139'), 0x13Au);
    EXPECT_EQ(Fold(U'\u013A'), 0x13Au);
    EXPECT_EQ(Fold(U'\u0178'), 0xFFu);
    EXPECT_EQ(Fold(U'\u017F'), std::uint32_t{'s'});
    EXPECT_EQ(Fold(U'\u212A'), std::uint32_t{'k'});
    EXPECT_EQ(Fold(U'\u212B'), 0xE5u);
    EXPECT_EQ(Fold(U'\uFF21'), 0xFF41u);
}

TEST(FoldCase, SignsBetweenTheLatinLettersStay) {
    EXPECT_EQ(Fold(U'\u00D7'), 0xD7u);
    EXPECT_EQ(Fold(U'\u00F7'), 0xF7u);
    EXPECT_EQ(Fold(U'\u20AC'), 0x20ACu);
}

TEST(FoldCase, TheThreeGreekSigmasFoldToOne) {
    EXPECT_EQ(Fold(U'\u03A3'), 0x3C3u);
    EXPECT_EQ(Fold(U'\u03C2'), 0x3C3u);
    EXPECT_EQ(Fold(U'\u03C3'), 0x3C3u);
}

TEST(FoldCase, TheMicroSignFoldsToTheGreekLetter) { EXPECT_EQ(Fold(U'\u00B5'), 0x3BCu); }

TEST(FoldCase, CyrillicLettersFoldToTheirSmallForms) {
    EXPECT_EQ(Fold(U'\u0410'), 0x430u);
    EXPECT_EQ(Fold(U'\u042F'), 0x44Fu);
    EXPECT_EQ(Fold(U'\u0401'), 0x451u);
    EXPECT_EQ(Fold(U'\u044F'), 0x44Fu);
}

TEST(FoldCase, CherokeeFoldsToItsCapitals) {
    EXPECT_EQ(Fold(U'\uAB70'), 0x13A0u);
    EXPECT_EQ(Fold(U'\u13F8'), 0x13F0u);
    EXPECT_EQ(Fold(U'\u13A0'), 0x13A0u);
}

TEST(FoldCase, TheCapitalSharpSFoldsToTheSmallOne) {
    EXPECT_EQ(Fold(U'\u1E9E'), 0xDFu);
    EXPECT_EQ(Fold(U'\u00DF'), 0xDFu);
}

TEST(FoldCase, TheDottedAndTheDotlessIStayThemselves) {
    EXPECT_EQ(Fold(U'\u0130'), 0x130u);
    EXPECT_EQ(Fold(U'\u0131'), 0x131u);
    EXPECT_EQ(Fold(U'I'), std::uint32_t{'i'});
}

TEST(FoldCase, LettersBeyondTheFirstPlaneFold) {
    EXPECT_EQ(Fold(U'\U00010400'), 0x10428u);
    EXPECT_EQ(Fold(U'\U00010427'), 0x1044Fu);
    EXPECT_EQ(Fold(U'\U00010428'), 0x10428u);
    EXPECT_EQ(Fold(U'\U0001E921'), 0x1E943u);
    EXPECT_EQ(Fold(U'\U0001E922'), 0x1E922u);
}

TEST(FoldCase, EscapedBytesAndValuesThatAreNoCharactersStay) {
    for (char32_t byte = 0x80; byte <= 0xFF; ++byte) EXPECT_EQ(Fold(escapedByteBase + byte), escapedByteBase + byte);
    EXPECT_EQ(Fold(0x110000), 0x110000u);
    EXPECT_EQ(Fold(0xFFFFFFFF), 0xFFFFFFFFu);
}

TEST(FoldCase, IsIdempotentForEveryCodePoint) {
    for (char32_t character = 0; character <= lastCharacter; ++character)
        ASSERT_EQ(FoldCase(FoldCase(character)), FoldCase(character)) << std::hex << std::uint32_t{character};
}

TEST(FoldCase, ChangesExactlyTheCharactersThatUnicode15Names) {
    // The number of the lines with status C or S in CaseFolding.txt 15.0.0, and the sums of their two columns.
    std::uint64_t changed = 0;
    std::uint64_t sum = 0;
    std::uint64_t sumFolded = 0;
    for (char32_t character = 0; character <= lastCharacter; ++character) {
        const char32_t folded = FoldCase(character);
        if (folded == character) continue;
        ++changed;
        sum += character;
        sumFolded += folded;
    }
    EXPECT_EQ(changed, 1454u);
    EXPECT_EQ(sum, 35422145u);
    EXPECT_EQ(sumFolded, 31874600u);
}

TEST(FoldCase, FoldsEachCharacterOfAText) {
    EXPECT_EQ(FoldCase(""), "");
    EXPECT_EQ(FoldCase("ReadMe-1.TXT"), "readme-1.txt");
    EXPECT_EQ(FoldCase("\u00C4\u03A3\u042F\U00010400"), "\u00E4\u03C3\u044F\U00010428");
    EXPECT_EQ(FoldCase("A\0B"sv), "a\0b"sv);
}

TEST(FoldCase, TheFoldedTextMayBeShorterOrLonger) {
    EXPECT_EQ(FoldCase("\u212A"), "k");
    EXPECT_EQ(FoldCase("\u023A"), "\u2C65");
}

TEST(FoldCase, InvalidBytesOfATextStay) {
    EXPECT_EQ(FoldCase("A\xFF"
                       "B\xC3"),
              "a\xFF"
              "b\xC3");
    EXPECT_EQ(FoldCase("\xC1\x81"), "\xC1\x81");
}

TEST(FoldCase, IsIdempotentForArbitraryBytes) {
    std::mt19937 numbers(3);
    for (int round = 0; round < 20000; ++round) {
        const std::string bytes = RandomBytes(numbers);
        const std::string folded = FoldCase(bytes);
        ASSERT_EQ(FoldCase(folded), folded) << testing::PrintToString(bytes);
        ASSERT_EQ(CharacterCount(folded), CharacterCount(bytes)) << testing::PrintToString(bytes);
    }
}

// Comparing

TEST(EqualsNoCase, AsciiTextsDifferingOnlyInCaseAreEqual) {
    EXPECT_TRUE(EqualsNoCase("", ""));
    EXPECT_TRUE(EqualsNoCase("ReadMe.TXT", "README.txt"));
    EXPECT_FALSE(EqualsNoCase("readme", "readme2"));
    EXPECT_FALSE(EqualsNoCase("readme2", "readme"));
    EXPECT_FALSE(EqualsNoCase("", "a"));
    EXPECT_FALSE(EqualsNoCase("a", "b"));
}

TEST(EqualsNoCase, AsciiSignsThatLieThirtyTwoApartDiffer) {
    EXPECT_FALSE(EqualsNoCase("@", "`"));
    EXPECT_FALSE(EqualsNoCase("[", "{"));
    EXPECT_FALSE(EqualsNoCase("\x10", "0"));
}

TEST(EqualsNoCase, GoesOnBehindAZeroByte) { EXPECT_FALSE(EqualsNoCase("a\0b"sv, "a\0c"sv)); }

TEST(EqualsNoCase, FoldsBeyondAscii) {
    EXPECT_TRUE(EqualsNoCase("STRA\u1E9EE", "stra\u00DFe"));
    EXPECT_TRUE(EqualsNoCase("\u039F\u0394\u039F\u03A3", "\u03BF\u03B4\u03BF\u03C2"));
    EXPECT_TRUE(EqualsNoCase("\u0416\u0423\u041A", "\u0436\u0443\u043A"));
    EXPECT_TRUE(EqualsNoCase("\U00010400", "\U00010428"));
}

TEST(EqualsNoCase, AsciiMayEqualACharacterBeyondIt) {
    EXPECT_TRUE(EqualsNoCase("kilo", "\u212Ailo"));
    EXPECT_TRUE(EqualsNoCase("\u017FET", "set"));
}

TEST(EqualsNoCase, ExpandsNothingAndNormalizesNothing) {
    EXPECT_FALSE(EqualsNoCase("\u00DF", "ss"));
    EXPECT_FALSE(EqualsNoCase("\u0130", "i"));
    EXPECT_FALSE(EqualsNoCase("\u0130", "i\u0307"));
    EXPECT_FALSE(EqualsNoCase("\u00E4", "a\u0308"));
}

TEST(EqualsNoCase, AnInvalidByteEqualsOnlyItself) {
    for (int byte = 0x80; byte <= 0xFF; ++byte) {
        for (int other = 0x80; other <= 0xFF; ++other) {
            const std::array bytes = {static_cast<char>(byte), static_cast<char>(other)};
            ASSERT_EQ(EqualsNoCase({&bytes[0], 1}, {&bytes[1], 1}), byte == other);
        }
        ASSERT_FALSE(EqualsNoCase(std::string(1, static_cast<char>(byte)), Utf8(static_cast<char32_t>(byte))));
        ASSERT_FALSE(EqualsNoCase(std::string(1, static_cast<char>(byte)), "\uFFFD"));
    }
}

TEST(EqualsNoCase, AnOverlongLetterIsNoLetter) { EXPECT_FALSE(EqualsNoCase("\xC1\x81", "A")); }

TEST(EqualsNoCase, IsTheEqualityOfTheFoldedTexts) {
    std::mt19937 numbers(5);
    const std::array<std::string, 10> parts = {"k", "K", "\u212A", "\u03C2", "\u03A3", "\u00DF", "\u1E9E", "\xE2", "\x84", "\xAA"};
    int equals = 0;
    for (int round = 0; round < 50000; ++round) {
        std::string a;
        std::string b;
        for (auto left = numbers() % 4; left > 0; --left) a += parts[numbers() % parts.size()];
        for (auto left = numbers() % 4; left > 0; --left) b += parts[numbers() % parts.size()];
        const bool equal = FoldCase(a) == FoldCase(b);
        ASSERT_EQ(EqualsNoCase(a, b), equal) << testing::PrintToString(a) << " " << testing::PrintToString(b);
        ASSERT_EQ(CompareNoCase(a, b) == 0, equal) << testing::PrintToString(a) << " " << testing::PrintToString(b);
        equals += equal;
    }
    EXPECT_GT(equals, 1000);
    EXPECT_LT(equals, 49000);
}

TEST(EqualNoCase, EqualsAsTheFunctionDoes) {
    EXPECT_TRUE(EqualNoCase()("\u00C4", "\u00E4"));
    EXPECT_FALSE(EqualNoCase()("\u00C4", "a"));
}

TEST(CompareNoCase, OrdersByFoldedCodePoints) {
    EXPECT_EQ(CompareNoCase("", ""), 0);
    EXPECT_EQ(CompareNoCase("ABC", "abc"), 0);
    EXPECT_LT(CompareNoCase("a", "B"), 0);
    EXPECT_GT(CompareNoCase("B", "a"), 0);
    EXPECT_LT(CompareNoCase("_", "A"), 0);
    EXPECT_LT(CompareNoCase("z", "\u00C4"), 0);
    EXPECT_LT(CompareNoCase("\uFFFD", "\U00010400"), 0);
    EXPECT_EQ(CompareNoCase("\u03C2", "\u03A3"), 0);
}

TEST(CompareNoCase, AStartOrdersBeforeTheLongerText) {
    EXPECT_LT(CompareNoCase("name", "NAME2"), 0);
    EXPECT_GT(CompareNoCase("NAME2", "name"), 0);
    EXPECT_LT(CompareNoCase("", "\0"sv), 0);
    EXPECT_LT(CompareNoCase("a", "a\xFF"), 0);
}

TEST(CompareNoCase, AnInvalidByteOrdersAsItsEscapedByte) {
    EXPECT_LT(CompareNoCase("\x80", "\xFF"), 0);
    EXPECT_GT(CompareNoCase("\x80", "\uD7FB"), 0);
    EXPECT_LT(CompareNoCase("\xFF", "\uE000"), 0);
}

TEST(CompareNoCase, IsAnOrderOfArbitraryBytes) {
    const auto sign = [](int order) { return (order > 0) - (order < 0); };
    std::mt19937 numbers(13);
    for (int round = 0; round < 20000; ++round) {
        std::array<std::string, 3> texts;
        for (std::string& text : texts) text = RandomBytes(numbers).substr(0, 3);
        const auto& [a, b, c] = texts;
        ASSERT_EQ(CompareNoCase(a, a), 0);
        ASSERT_EQ(sign(CompareNoCase(a, b)), -sign(CompareNoCase(b, a)));
        if (CompareNoCase(a, b) <= 0 && CompareNoCase(b, c) <= 0) {
            ASSERT_LE(CompareNoCase(a, c), 0);
        }
    }
}

TEST(StartsWithNoCase, FindsAStartInAnyCase) {
    EXPECT_TRUE(StartsWithNoCase("HTTP://host", "http:"));
    EXPECT_TRUE(StartsWithNoCase("name", "NAME"));
    EXPECT_TRUE(StartsWithNoCase("\u03A3\u03BF\u03C6", "\u03C2\u039F"));
    EXPECT_FALSE(StartsWithNoCase("name", "ame"));
}

TEST(StartsWithNoCase, EveryTextBeginsWithTheEmptyOne) {
    EXPECT_TRUE(StartsWithNoCase("name", ""));
    EXPECT_TRUE(StartsWithNoCase("", ""));
}

TEST(StartsWithNoCase, ALongerStartIsNotFound) {
    EXPECT_FALSE(StartsWithNoCase("name", "name2"));
    EXPECT_FALSE(StartsWithNoCase("", "a"));
}

TEST(StartsWithNoCase, TheStartMayBeLongerInBytesThanTheText) { EXPECT_TRUE(StartsWithNoCase("k", "\u212A")); }

TEST(StartsWithNoCase, TheFirstByteOfACharacterIsNotItsStart) {
    EXPECT_FALSE(StartsWithNoCase("\xC3\xA4", "\xC3"));
    EXPECT_TRUE(StartsWithNoCase("\xC3x", "\xC3"));
}

// Hashing

TEST(HashNoCase, EveryCodePointHashesAsItsFoldedForm) {
    const HashNoCase hash;
    for (char32_t character = 0; character <= lastCharacter; ++character) {
        if (IsSurrogate(character)) continue;
        const std::string text = Utf8(character);
        ASSERT_EQ(hash(text), hash(Utf8(FoldCase(character)))) << std::hex << std::uint32_t{character};
    }
}

TEST(HashNoCase, EqualTextsHaveEqualHashes) {
    const HashNoCase hash;
    EXPECT_EQ(hash("ReadMe.TXT"), hash("README.txt"));
    EXPECT_EQ(hash("\u039F\u0394\u039F\u03A3"), hash("\u03BF\u03B4\u03BF\u03C2"));
    EXPECT_EQ(hash("kilo"), hash("\u212Ailo"));
    EXPECT_EQ(hash("A\xFF"), hash("a\xFF"));
}

TEST(HashNoCase, DifferentNamesSeldomShareAHash) {
    std::unordered_set<std::size_t> hashes;
    for (int number = 0; number < 10000; ++number) hashes.insert(HashNoCase()("name" + Decimal(number)));
    EXPECT_GT(hashes.size(), 9990u);
}

TEST(HashNoCase, DependsOnTheOrderAndNumberOfCharacters) {
    const HashNoCase hash;
    EXPECT_NE(hash("ab"), hash("ba"));
    EXPECT_NE(hash("a"), hash("aa"));
    EXPECT_NE(hash(""), hash("\0"sv));
    EXPECT_NE(hash("\x80"), hash("\x81"));
}

TEST(HashNoCase, ASetOfNamesFindsThemInAnyCase) {
    const std::unordered_set<std::string, HashNoCase, EqualNoCase> names = {"\u00C4pfel.TXT", "readme", "README"};
    EXPECT_EQ(names.size(), 2u);
    EXPECT_TRUE(names.contains("\u00E4PFEL.txt"sv));
    EXPECT_FALSE(names.contains("apfel.txt"sv));
}

// Blanks and numbers

TEST(TrimBlanks, TakesBlanksFromBothEndsOnly) {
    EXPECT_EQ(TrimBlanks("name"), "name");
    EXPECT_EQ(TrimBlanks("  a  b   "), "a  b");
    EXPECT_EQ(TrimBlanks(" a"), "a");
    EXPECT_EQ(TrimBlanks("a "), "a");
}

TEST(TrimBlanks, LeavesNothingOfBlanks) {
    EXPECT_EQ(TrimBlanks(""), "");
    EXPECT_EQ(TrimBlanks(" "), "");
    EXPECT_EQ(TrimBlanks("    "), "");
}

TEST(TrimBlanks, KeepsOtherWhiteSpaceAndZeroBytes) {
    EXPECT_EQ(TrimBlanks(" \t a\n "), "\t a\n");
    EXPECT_EQ(TrimBlanks(" \u00A0 "), "\u00A0");
    EXPECT_EQ(TrimBlanks(" \0 "sv), "\0"sv);
}

TEST(Decimal, WritesTheDigitsAndTheSign) {
    EXPECT_EQ(Decimal(0), "0");
    EXPECT_EQ(Decimal(7), "7");
    EXPECT_EQ(Decimal(-7), "-7");
    EXPECT_EQ(Decimal(1234567), "1234567");
}

TEST(Decimal, WritesTheSmallestAndTheLargestNumber) {
    EXPECT_EQ(Decimal(std::numeric_limits<std::int64_t>::min()), "-9223372036854775808");
    EXPECT_EQ(Decimal(std::numeric_limits<std::int64_t>::max()), "9223372036854775807");
}

// Strict UTF-8

TEST(ToStrictUtf8, LeavesValidTextUnchanged) {
    const std::string texts[] = {"",
                                 "plain\t\n\x7F",
                                 "a\0b"s,
                                 "\u00E4\u20AC\uD7FF\uE000\uFFFD\uFFFF",
                                 "\U00010000\U0001F600",
                                 "\U0010FF00\U0010FF7F",
                                 "\U000FFFFF\U00100000"};
    for (const std::string& text : texts) {
        EXPECT_EQ(ToStrictUtf8(text), text);
        EXPECT_EQ(FromStrictUtf8(text), text);
    }
}

TEST(ToStrictUtf8, WritesEachInvalidByteAsACharacterOfItsOwn) {
    EXPECT_EQ(ToStrictUtf8("\x80"), "\U0010FF80");
    EXPECT_EQ(ToStrictUtf8("a\xFF\xE2\x82z"), "a\U0010FFFF\U0010FFE2\U0010FF82z");
    EXPECT_EQ(ToStrictUtf8("\xED\xA0\x80"), "\U0010FFED\U0010FFA0\U0010FF80");
}

TEST(ToStrictUtf8, WritesTheCharactersThatStandForBytesByteByByte) {
    EXPECT_EQ(ToStrictUtf8("\U0010FF80"), "\U0010FFF4\U0010FF8F\U0010FFBE\U0010FF80");
}

TEST(ToStrictUtf8, TellsAnInvalidByteFromTheCharacterThatStandsForIt) {
    EXPECT_NE(ToStrictUtf8("\x80"), ToStrictUtf8("\U0010FF80"));
}

TEST(FromStrictUtf8, BringsBackEveryInvalidByte) {
    for (int byte = 0x80; byte < 0x100; ++byte) {
        const std::string text = "a" + std::string(1, static_cast<char>(byte)) + "z";
        EXPECT_TRUE(IsValidUtf8(ToStrictUtf8(text)));
        EXPECT_EQ(FromStrictUtf8(ToStrictUtf8(text)), text);
    }
}

TEST(FromStrictUtf8, BringsBackTheCharactersThatStandForBytes) {
    std::string all;
    for (char32_t character = 0x10FF80; character <= 0x10FFFF; ++character) {
        EXPECT_EQ(FromStrictUtf8(ToStrictUtf8(Utf8(character))), Utf8(character));
        all += Utf8(character) + "\x80";
    }
    EXPECT_TRUE(IsValidUtf8(ToStrictUtf8(all)));
    EXPECT_EQ(FromStrictUtf8(ToStrictUtf8(all)), all);
}

TEST(FromStrictUtf8, BringsBackAnyBytes) {
    std::mt19937 numbers(6);
    for (int round = 0; round < 20'000; ++round) {
        std::string bytes = RandomBytes(numbers);
        if (round % 3 == 0) bytes += Utf8(0x10FF80 + numbers() % 0x80) + RandomBytes(numbers);
        const std::string strict = ToStrictUtf8(bytes);
        ASSERT_TRUE(IsValidUtf8(strict)) << testing::PrintToString(bytes);
        ASSERT_EQ(FromStrictUtf8(strict), bytes);
    }
}

}  // namespace
}  // namespace tessel::frame
