#include "controls/fileview/FilterMatch.h"

#include <gtest/gtest.h>

#include <random>
#include <string>
#include <string_view>

namespace tessel::controls {
namespace {

TEST(FilterMatch, AMissingOrEmptyPatternMatchesEveryName) {
    EXPECT_TRUE(FilterMatch("a.txt"));
    EXPECT_TRUE(FilterMatch("a.txt", ""));
    EXPECT_TRUE(FilterMatch("", ""));
    EXPECT_TRUE(FilterMatch(""));
}

TEST(FilterMatch, TheWholeNameIsMatched) {
    EXPECT_TRUE(FilterMatch("a.txt", "a.txt"));
    EXPECT_FALSE(FilterMatch("a.txt", "a"));
    EXPECT_FALSE(FilterMatch("a", "a.txt"));
    EXPECT_FALSE(FilterMatch("a.txt ", "a.txt"));
    EXPECT_FALSE(FilterMatch("", "a"));
}

TEST(FilterMatch, CaseIsIgnoredInEveryScript) {
    EXPECT_TRUE(FilterMatch("README.TXT", "readme.*"));
    EXPECT_TRUE(FilterMatch("\u00C4pfel", "\u00E4PFEL"));
    EXPECT_TRUE(FilterMatch("\u0414\u043E\u043C", "\u0434*"));
    EXPECT_TRUE(FilterMatch("300 \u212A", "*k"));  // the sign of Kelvin
    EXPECT_TRUE(FilterMatch("k", "*\u212A"));
    EXPECT_TRUE(FilterMatch("B", "[abc]"));
    EXPECT_FALSE(FilterMatch("B", "[!abc]"));
}

TEST(FilterMatch, AStarStandsForAnyRunTheEmptyOneToo) {
    EXPECT_TRUE(FilterMatch("a.txt", "*"));
    EXPECT_TRUE(FilterMatch("", "*"));
    EXPECT_TRUE(FilterMatch("a.txt", "*.txt"));
    EXPECT_TRUE(FilterMatch(".txt", "*.txt"));
    EXPECT_TRUE(FilterMatch("a.txt", "a*.*t"));
    EXPECT_TRUE(FilterMatch("abcabc", "*abc"));
    EXPECT_TRUE(FilterMatch("aab", "*a*b"));
    EXPECT_TRUE(FilterMatch("a", "**a**"));
    EXPECT_FALSE(FilterMatch("a.txt2", "*.txt"));
    EXPECT_FALSE(FilterMatch("abcab", "*abc"));
}

TEST(FilterMatch, AQuestionMarkStandsForOneCharacter) {
    EXPECT_TRUE(FilterMatch("a", "?"));
    EXPECT_TRUE(FilterMatch("\u20AC", "?"));
    EXPECT_TRUE(FilterMatch("\xFF", "?"));
    EXPECT_FALSE(FilterMatch("", "?"));
    EXPECT_FALSE(FilterMatch("ab", "?"));
    EXPECT_TRUE(FilterMatch("ab", "?*?"));
    EXPECT_FALSE(FilterMatch("a", "?*?"));
}

TEST(FilterMatch, ANumberSignStandsForOneDigit) {
    EXPECT_TRUE(FilterMatch("img7", "img#"));
    EXPECT_FALSE(FilterMatch("imgx", "img#"));
    EXPECT_FALSE(FilterMatch("img", "img#"));
    EXPECT_FALSE(FilterMatch("img#", "img#"));
    EXPECT_TRUE(FilterMatch("img#", "img[#]"));
    EXPECT_FALSE(FilterMatch("img\u0667", "img#"));
}

TEST(FilterMatch, AListStandsForOneOfItsCharacters) {
    EXPECT_TRUE(FilterMatch("bat", "[bc]at"));
    EXPECT_TRUE(FilterMatch("cat", "[bc]at"));
    EXPECT_FALSE(FilterMatch("rat", "[bc]at"));
    EXPECT_FALSE(FilterMatch("bcat", "[bc]at"));
    EXPECT_TRUE(FilterMatch("a*b", "a[*]b"));
    EXPECT_FALSE(FilterMatch("axb", "a[*]b"));
    EXPECT_TRUE(FilterMatch("a?", "a[?]"));
    EXPECT_TRUE(FilterMatch("[a", "[[]a"));
    EXPECT_TRUE(FilterMatch("!", "[a!]"));
}

TEST(FilterMatch, AListWithAnExclamationMarkStandsForAnyOtherCharacter) {
    EXPECT_TRUE(FilterMatch("rat", "[!bc]at"));
    EXPECT_FALSE(FilterMatch("bat", "[!bc]at"));
    EXPECT_FALSE(FilterMatch("at", "[!bc]at"));
}

TEST(FilterMatch, AListHasNoRanges) {
    EXPECT_TRUE(FilterMatch("-", "[a-c]"));
    EXPECT_FALSE(FilterMatch("b", "[a-c]"));
}

TEST(FilterMatch, NoCharacterIsInAnEmptyList) {
    EXPECT_FALSE(FilterMatch("a", "[]"));
    EXPECT_FALSE(FilterMatch("", "[]"));
    EXPECT_FALSE(FilterMatch("]", "[]]"));
    EXPECT_TRUE(FilterMatch("a", "[!]"));
}

TEST(FilterMatch, ABracketThatIsNotClosedStandsForItself) {
    EXPECT_TRUE(FilterMatch("a[b", "a[b"));
    EXPECT_TRUE(FilterMatch("[", "["));
    EXPECT_FALSE(FilterMatch("b", "[b"));
    EXPECT_TRUE(FilterMatch("a]", "a]"));
}

TEST(FilterMatch, NamesThatAreNoUtf8AreMatchedByteByByte) {
    EXPECT_TRUE(FilterMatch("a\xFF.txt", "a?.txt"));
    EXPECT_TRUE(FilterMatch("a\xFF.txt", "a\xFF.txt"));
    EXPECT_FALSE(FilterMatch("a\xFF.txt", "a\xFE.txt"));
    EXPECT_TRUE(FilterMatch("line\nfeed", "line*feed"));
}

TEST(FilterMatch, ManyStarsCostNoEndlessTime) {
    const std::string name(4000, 'a');
    std::string pattern;
    for (int i = 0; i < 200; ++i) pattern += "a*";
    EXPECT_FALSE(FilterMatch(name, pattern + "b"));
    EXPECT_TRUE(FilterMatch(name, pattern));
}

/// What the wildcards mean, told without any thought of speed.
bool Means(std::string_view name, std::string_view pattern) {
    if (pattern.empty()) return name.empty();
    if (pattern[0] == '*') return Means(name, pattern.substr(1)) || (!name.empty() && Means(name.substr(1), pattern));
    if (name.empty()) return false;
    std::size_t length = 1;
    bool takes = pattern[0] == name[0];
    if (pattern[0] == '?') takes = true;
    if (pattern[0] == '#') takes = name[0] >= '0' && name[0] <= '9';
    if (const std::size_t end = pattern.find(']'); pattern[0] == '[' && end != std::string_view::npos) {
        length = end + 1;
        const bool outside = pattern[1] == '!';
        const std::string_view list = pattern.substr(outside ? 2 : 1, end - (outside ? 2 : 1));
        takes = (list.find(name[0]) != std::string_view::npos) != outside;
    }
    return takes && Means(name.substr(1), pattern.substr(length));
}

TEST(FilterMatch, RandomPatternsMatchWhatTheWildcardsMean) {
    std::mt19937 random(7);
    const auto text = [&](std::string_view from, int most) {
        std::string made;
        for (int left = static_cast<int>(random() % static_cast<unsigned>(most + 1)); left > 0; --left)
            made += from[random() % from.size()];
        return made;
    };
    int matches = 0;
    for (int round = 0; round < 20'000; ++round) {
        const std::string name = text("ab1", 6), pattern = "*" + text("ab1*?#[]!", 7);
        ASSERT_EQ(FilterMatch(name, pattern), Means(name, pattern)) << name << " " << pattern;
        matches += FilterMatch(name, pattern) ? 1 : 0;
    }
    EXPECT_GT(matches, 1'000);
}

}  // namespace
}  // namespace tessel::controls
