#include "tools/tessel-host/Lines.h"

#include <sstream>

#include <gtest/gtest.h>

namespace tessel::tools {
namespace {

/// All lines of a text, each in brackets; "<long>" for one that is too long.
std::string LinesOf(const std::string& text, std::size_t longest = longestLine) {
    std::istringstream input(text);
    std::string line, all;
    while (true) {
        const LineRead read = ReadLine(input, line, longest);
        if (read == LineRead::End) return all;
        all += read == LineRead::TooLong ? "<long>" : "[" + line + "]";
    }
}

TEST(Lines, EndAtALineFeedWithOrWithoutACarriageReturn) { EXPECT_EQ(LinesOf("a\nb\r\nc\n"), "[a][b][c]"); }

TEST(Lines, TheLastOneNeedsNoEnd) {
    EXPECT_EQ(LinesOf("a\nb"), "[a][b]");
    EXPECT_EQ(LinesOf("a\r"), "[a]");
}

TEST(Lines, EmptyOnesAreLinesAndAnEmptyInputHasNone) {
    EXPECT_EQ(LinesOf("\n\r\n\n"), "[][][]");
    EXPECT_EQ(LinesOf(""), "");
}

TEST(Lines, OneCarriageReturnBelongsToTheEndAndOthersToTheText) {
    EXPECT_EQ(LinesOf("a\r\r\n"), "[a\r]");
    EXPECT_EQ(LinesOf("a\rb\n"), "[a\rb]");
}

TEST(Lines, NulBytesAndBytesAboveAsciiAreKept) {
    const std::string text("a\0\xFF", 3);
    EXPECT_EQ(LinesOf(text + "\n"), "[" + text + "]");
}

TEST(Lines, TheLongestOneIsReadAndALongerOnePassedOver) {
    EXPECT_EQ(LinesOf("abcd\nabcde\nab\n", 4), "[abcd]<long>[ab]");
    EXPECT_EQ(LinesOf("abcde", 4), "<long>");
}

TEST(Lines, ALineThatIsTooLongIsNotKept) {
    std::istringstream input(std::string(1000, 'x') + "\n");
    std::string line;
    EXPECT_EQ(ReadLine(input, line, 10), LineRead::TooLong);
    EXPECT_LE(line.size(), 10u);
}

TEST(Lines, AfterTheEndThereIsOnlyTheEnd) {
    std::istringstream input("a");
    std::string line;
    EXPECT_EQ(ReadLine(input, line), LineRead::Line);
    EXPECT_EQ(ReadLine(input, line), LineRead::End);
    EXPECT_EQ(ReadLine(input, line), LineRead::End);
    EXPECT_EQ(line, "");
}

}  // namespace
}  // namespace tessel::tools
