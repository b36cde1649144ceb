#include "tools/tessel-host/ObjectPath.h"

#include <gtest/gtest.h>

#include "frame/Error.h"

namespace tessel::tools {
namespace {

/// The steps of a path, parted by bars: the name, and the key with its kind: `Nodes<text C:\x>`, `Item<number 3>`.
std::string StepsOf(std::string_view path) {
    std::string all;
    for (const PathStep& step : ParseObjectPath(path)) {
        if (!all.empty()) all += " | ";
        all += step.name;
        if (step.key) all += (step.key->IsString() ? "<text " : "<number ") + step.key->ToText() + ">";
    }
    return all;
}

/// The number of the error that a path ends in; 0 for none.
int ErrorOf(std::string_view path) {
    try {
        ParseObjectPath(path);
        return 0;
    } catch (const frame::ControlError& error) {
        return error.Number();
    }
}

TEST(ObjectPath, IsNamesJoinedByPoints) {
    EXPECT_EQ(StepsOf("Link1"), "Link1");
    EXPECT_EQ(StepsOf("Link1.Label1.Font"), "Link1 | Label1 | Font");
}

TEST(ObjectPath, AMemberOfACollectionStandsInParentheses) {
    EXPECT_EQ(StepsOf("A.Items(3).Text"), "A | Items<number 3> | Text");
    EXPECT_EQ(StepsOf("Text1(2)"), "Text1<number 2>");
    EXPECT_EQ(StepsOf("A(-1)"), "A<number -1>");
    EXPECT_EQ(StepsOf("A.B(\"key\")"), "A | B<text key>");
}

TEST(ObjectPath, AStepIsKeptAsItStandsToo) {
    const auto steps = ParseObjectPath("A.Items(\"x.y\").B");
    ASSERT_EQ(steps.size(), 3u);
    EXPECT_EQ(steps[0].whole, "A");
    EXPECT_EQ(steps[1].whole, "Items(\"x.y\")");
    EXPECT_EQ(steps[2].whole, "B");
}

TEST(ObjectPath, NothingIsEscapedInAQuotedKey) {
    EXPECT_EQ(StepsOf(R"(A.B("C:\x\y.txt").C)"), R"(A | B<text C:\x\y.txt> | C)");
    EXPECT_EQ(StepsOf(R"(A.B("say "hello""))"), R"(A | B<text say "hello">)");
    EXPECT_EQ(StepsOf(R"(A.B("a(1).b"))"), R"(A | B<text a(1).b>)");
    EXPECT_EQ(StepsOf(R"(A.B(""))"), "A | B<text >");
    EXPECT_EQ(StepsOf(R"(A.B("3"))"), "A | B<text 3>");
}

TEST(ObjectPath, AQuotedKeyEndsAtTheFirstQuoteBehindWhichTheStepEnds) {
    EXPECT_EQ(StepsOf(R"(A.B("x").C("y"))"), "A | B<text x> | C<text y>");
    EXPECT_EQ(StepsOf(R"(A.B("x")y"))"), R"(A | B<text x")y>)");
}

TEST(ObjectPath, NamesKeepTheirBlanksAndTheirLetters) { EXPECT_EQ(StepsOf("My Form.\xC3\x84rger"), "My Form | \xC3\x84rger"); }

TEST(ObjectPath, WhatIsNoPathIsRefused) {
    for (const char* path : {"",
                             ".",
                             "A.",
                             ".A",
                             "A..B",
                             "(1)",
                             "A.(1)",
                             "A()",
                             "A(",
                             "A(1",
                             "A(\"x\"",
                             "A(\"x",
                             "A(\")",
                             "A(x)",
                             "A(1.5)",
                             "A( 1)",
                             "A(1 )",
                             "A(+1)",
                             "A(1)B",
                             "A(1)(2)",
                             "A(2147483648)",
                             "A(99999999999999999999)"})
        EXPECT_EQ(ErrorOf(path), frame::errors::invalidCall) << path;
}

TEST(ObjectPath, KeysReachToTheEndsOf32Bits) {
    EXPECT_EQ(StepsOf("A(2147483647)"), "A<number 2147483647>");
    EXPECT_EQ(StepsOf("A(-2147483648)"), "A<number -2147483648>");
}

TEST(ObjectPath, ALongOneIsReadInOnePass) {
    std::string path = "A";
    for (int i = 0; i < 100'000; ++i) path += ".B(1)";
    EXPECT_EQ(ParseObjectPath(path).size(), 100'001u);
}

}  // namespace
}  // namespace tessel::tools
