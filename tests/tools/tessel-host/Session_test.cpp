#include "tools/tessel-host/Session.h"

#include <gtest/gtest.h>

namespace tessel::tools {
namespace {

constexpr const char* defaultFont =
    R"({"Name":"MS Sans Serif","Size":8.25,"Bold":false,"Italic":false,"Underline":false,"Strikethrough":false,"Weight":400,"Charset":0})";

class SessionTest : public testing::Test {
  protected:
    void MakeLink(const std::string& fields = R"("bag":{"Caption":"Docs","LinkTo":"a.txt"})") {
        ASSERT_EQ(Answer(R"({"do":"create","class":"Link","name":"Link1",)" + fields + "}"), R"({"value":"Link1","log":[]})");
    }
    std::string Answer(const std::string& line) { return session_.Answer(line); }
    Json Reply(const std::string& line) { return Json::parse(Answer(line)); }
    /// The value of a reply as text; the error's number, as "error 13", when there is one.
    std::string Value(const std::string& line) {
        const Json reply = Reply(line);
        return reply.contains("error") ? "error " + reply["error"]["number"].dump() : reply["value"].dump();
    }
    std::string Description(const std::string& line) { return Reply(line)["error"]["description"].get<std::string>(); }
    /// The log of a reply as text.
    std::string LogOf(const std::string& line) { return Reply(line)["log"].dump(); }
    std::string Get(const std::string& of, const std::string& name) {
        return Value(Json{{"do", "get"}, {"of", of}, {"name", name}}.dump());
    }
    std::string Put(const std::string& of, const std::string& name, const Json& value) {
        return Value(Json{{"do", "put"}, {"of", of}, {"name", name}, {"value", value}}.dump());
    }
    std::string Press() { return Answer(R"({"do":"fire","of":"Link1.Label1","event":"MouseDown","args":[1,0,300,100]})"); }

    Session session_;
};

// Replies.

TEST_F(SessionTest, AReplyIsTheValueThenTheLog) {
    EXPECT_EQ(Answer(R"({"do":"create","class":"Link","name":"Link1","mode":"run","bag":{"Caption":"Docs","LinkTo":"a.txt"}})"),
              R"({"value":"Link1","log":[]})");
    EXPECT_EQ(Press(), R"({"value":null,"log":[["event","Link1","MouseDown",[1,0,300.0,100.0]],["execute","open","a.txt"]]})");
}

TEST_F(SessionTest, AFailedRequestRepliesTheErrorThenTheLog) {
    MakeLink();
    EXPECT_EQ(Answer(R"({"do":"put","of":"Link1","name":"BorderSize","value":"x"})"),
              R"({"error":{"number":13,"description":"Type mismatch"},"log":[]})");
}

TEST_F(SessionTest, TheLogIsWhatHappenedSinceTheLastReply) {
    MakeLink();
    EXPECT_EQ(LogOf(R"({"do":"put","of":"Link1","name":"Caption","value":"x"})"), R"([["changed","Link1","Caption"]])");
    EXPECT_EQ(LogOf(R"({"do":"get","of":"Link1","name":"Caption"})"), "[]");
}

TEST_F(SessionTest, WhatIsNoRequestIsRefused) {
    for (const char* line : {"nope", "[]", "7", "null", "\"get\"", "{}", R"({"do":7})", R"({"do":"dance"})", R"({"do":"Get"})", "{",
                             R"({"do":"now")", "{} {}", "\xEF\xBB\xBF", R"({"do":"now","value":1e999})", R"(["\ud800"])"})
        EXPECT_EQ(Value(line), "error 5") << line;
    EXPECT_EQ(Description("{"), "The request is no valid JSON");
    EXPECT_EQ(Description("[]"), "A request is an object");
    EXPECT_EQ(Description("{}"), "The request lacks its field \"do\"");
    EXPECT_EQ(Description(R"({"do":"dance"})"), "Unknown request \"dance\"");
}

TEST_F(SessionTest, BytesThatAreNoUtf8AreRefused) {
    EXPECT_EQ(Description("{\"do\":\"\xFF\"}"), "The request is no valid UTF-8");
    EXPECT_EQ(Value("{\"do\":\"\xC0\x80\"}"), "error 5");
}

TEST_F(SessionTest, NulBytesAreNoJsonButAnEscapedOneIsText) {
    MakeLink();
    EXPECT_EQ(Value(std::string(1, '\0')), "error 5");
    EXPECT_EQ(Value(R"({"do":"put","of":"Link1","name":"Caption","value":"a\u0000b"})"), "null");
    EXPECT_EQ(Get("Link1", "Caption"), R"("a\u0000b")");
}

TEST_F(SessionTest, ALineThatWasTooLongHasAReplyOfItsOwn) {
    EXPECT_EQ(session_.AnswerTooLong(), R"({"error":{"number":5,"description":"The request is too long"},"log":[]})");
}

TEST_F(SessionTest, BracketsBeyondALimitAreRefused) {
    const auto nested = [](std::size_t depth) { return std::string(depth, '[') + std::string(depth, ']'); };
    EXPECT_EQ(Description(nested(1000)), "A request is an object");
    EXPECT_EQ(Description(nested(1002)), "The request is nested too deep");
    EXPECT_EQ(Description(std::string(1'000'000, '[')), "The request is nested too deep");
}

TEST_F(SessionTest, FieldsBeyondALimitAreRefused) {
    const auto withFields = [](int count) {
        std::string fields;
        for (int i = 0; i < count; ++i) fields += ",\"f" + std::to_string(i) + "\":1";
        return R"({"do":"dance")" + fields + "}";
    };
    EXPECT_EQ(Description(withFields(999)), "Unknown request \"dance\"");
    EXPECT_EQ(Description(withFields(1000)), "An object has too many fields");
    EXPECT_EQ(Description(withFields(100'000)), "An object has too many fields");
}

// Controls.

TEST_F(SessionTest, AControlIsLoadedFromItsBagOrPlacedNew) {
    MakeLink(R"("bag":{"BorderSize":"45"})");
    EXPECT_EQ(Get("Link1", "BorderSize"), "45.0");
    EXPECT_EQ(Value(R"({"do":"create","class":"Link","name":"Link2"})"), "\"Link2\"");
    EXPECT_EQ(Get("Link2", "BorderSize"), "30.0");
}

TEST_F(SessionTest, ClassesAreFoundWithoutRegardToCase) {
    EXPECT_EQ(Value(R"({"do":"create","class":"LINK","name":"x"})"), "\"x\"");
    EXPECT_EQ(Value(R"({"do":"create","class":"Chain","name":"y"})"), "error 5");
}

TEST_F(SessionTest, ANameInUseIsRefusedWhateverHasIt) {
    MakeLink();
    Answer(R"({"do":"sibling","name":"Text1","index":2})");
    for (const char* name : {"Link1", "LINK1", "Text1(2)", "Form1", "App", "Screen"}) {
        EXPECT_EQ(Value(Json{{"do", "create"}, {"class", "Link"}, {"name", name}}.dump()), "error 457") << name;
        EXPECT_EQ(Value(Json{{"do", "sibling"}, {"name", name}}.dump()), "error 457") << name;
    }
    EXPECT_EQ(Value(R"({"do":"sibling","name":"text1","index":2})"), "error 457");
    EXPECT_EQ(Value(R"({"do":"form","name":"Link1"})"), "error 457");
}

TEST_F(SessionTest, OnlyAFormMayBeWithoutAName) {
    EXPECT_EQ(Value(R"({"do":"create","class":"Link","name":""})"), "error 5");
    EXPECT_EQ(Value(R"({"do":"sibling","name":""})"), "error 5");
    EXPECT_EQ(Value(R"({"do":"form","name":""})"), R"("")");
}

TEST_F(SessionTest, AControlThatFailsToLoadIsNotThere) {
    EXPECT_EQ(Value(R"({"do":"create","class":"Link","name":"Link1","bag":{"BorderSize":"wide"}})"), "error 13");
    EXPECT_EQ(Get("Link1", "Caption"), "error 424");
    MakeLink();
}

TEST_F(SessionTest, CreateTakesItsSizeAndTheHostsMembers) {
    MakeLink(R"("width":2000.5,"height":600,"extender":{"ToolTipText":"Tip","Tag":"t"},"ambient":{"DisplayName":"d"})");
    EXPECT_EQ(Get("Link1", "Width"), "2000.5");
    EXPECT_EQ(Get("Link1", "Height"), "600.0");
    EXPECT_EQ(Get("Link1", "Tag"), "\"t\"");
    EXPECT_EQ(Get("Link1.Label1", "ToolTipText"), "\"Tip\"");
}

TEST_F(SessionTest, CreateShowsUnlessToldOtherwise) {
    MakeLink(R"("show":false,"extender":{"ToolTipText":"Tip"})");
    EXPECT_EQ(Get("Link1", "Visible"), "false");
    EXPECT_EQ(Get("Link1.Label1", "ToolTipText"), "\"\"");
    EXPECT_EQ(Value(R"({"do":"show","of":"Link1"})"), "null");
    EXPECT_EQ(Get("Link1", "Visible"), "true");
    EXPECT_EQ(Get("Link1.Label1", "ToolTipText"), "\"Tip\"");
    EXPECT_EQ(Value(R"({"do":"hide","of":"Link1"})"), "null");
    EXPECT_EQ(Get("Link1", "Visible"), "false");
}

TEST_F(SessionTest, FieldsOfAWrongTypeAreRefused) {
    const std::string begin = R"({"do":"create","class":"Link","name":"Link1",)";
    for (const char* field : {R"("mode":"walk")", R"("mode":1)", R"("bag":[])", R"("show":1)", R"("extender":"x")",
                              R"("ambient":{"Colour":1})", R"("ambient":7)"})
        EXPECT_EQ(Value(begin + field + "}"), "error 5") << field;
    for (const char* field : {R"("width":"wide")", R"("height":[])", R"("ambient":{"Font":7})"})
        EXPECT_TRUE(Value(begin + field + "}") == "error 13" || Value(begin + field + "}") == "error 424") << field;
    EXPECT_EQ(Get("Link1", "Caption"), "error 424") << "none of them made the control";
}

TEST_F(SessionTest, SaveGivesWhatIsWrittenAndWhatDiffersFromItsDefault) {
    MakeLink();
    const Json saved = Reply(R"({"do":"save","of":"Link1"})")["value"];
    EXPECT_EQ(saved["bag"].dump(), R"({"Caption":"Docs","LinkTo":"a.txt"})");
    EXPECT_EQ(saved["written"].size(), 16u);
    EXPECT_EQ(saved["written"][0].dump(), R"(["BackColor",2147483663,2147483663])");
    EXPECT_EQ(saved["written"][2].dump(), std::string("[\"Font\",") + defaultFont + "," + defaultFont + "]");
    EXPECT_EQ(saved["written"][7].dump(), R"(["Caption","Docs","Label1"])");
    EXPECT_EQ(saved["written"][12].dump(), R"(["Forecolor",12582912,12582912])");
}

TEST_F(SessionTest, ResizeSetsTheSizeAsTheHostDoes) {
    MakeLink();
    EXPECT_EQ(Value(R"({"do":"resize","of":"Link1","width":100.5,"height":-1})"), "null");
    EXPECT_EQ(Get("Link1.Label1", "Width"), "100.5");
    EXPECT_EQ(Get("Link1", "Height"), "0.0");
    EXPECT_EQ(Value(R"({"do":"resize","of":"Link1","width":100})"), "null");
    EXPECT_EQ(Get("Link1", "Width"), "100.0");
    EXPECT_EQ(Get("Link1", "Height"), "0.0");
    EXPECT_EQ(Value(R"({"do":"resize","of":"Link1","width":1e39,"height":1})"), "error 6");
}

TEST_F(SessionTest, ADestroyedControlIsGoneAndItsNameFree) {
    MakeLink();
    EXPECT_EQ(Value(R"({"do":"destroy","of":"Link1"})"), "null");
    EXPECT_EQ(Get("Link1", "Caption"), "error 424");
    EXPECT_EQ(Value(R"({"do":"destroy","of":"Link1"})"), "error 424");
    MakeLink();
}

TEST_F(SessionTest, RequestsForControlsRefuseOtherObjects) {
    for (const char* request : {"show", "hide", "paint", "save"})
        EXPECT_EQ(Value(Json{{"do", request}, {"of", "Form1"}}.dump()), "error 424") << request;
    EXPECT_EQ(Value(R"({"do":"destroy","of":"Form1"})"), "error 424");
}

TEST_F(SessionTest, AmbientPropertiesChange) {
    MakeLink(R"("ambient":{"Font":{"Name":"Arial","Size":10}})");
    EXPECT_EQ(Reply(R"({"do":"save","of":"Link1"})")["value"]["written"][2][2]["Name"], "Arial");
    EXPECT_EQ(Value(R"({"do":"ambient","of":"Link1","name":"Font","value":{"Name":"Courier New"}})"), "null");
    EXPECT_EQ(Reply(R"({"do":"save","of":"Link1"})")["value"]["written"][2][2]["Name"], "Courier New");
    EXPECT_EQ(Value(R"({"do":"ambient","of":"Link1","name":"usermode","value":false})"), "null");
    EXPECT_EQ(Value(R"({"do":"ambient","of":"Link1","name":"DisplayName","value":"d"})"), "null");
    EXPECT_EQ(Value(R"({"do":"ambient","of":"Link1","name":"Weather","value":1})"), "error 438");
    EXPECT_EQ(Value(R"({"do":"ambient","of":"Link1","name":"Font","value":7})"), "error 424");
}

TEST_F(SessionTest, AnAmbientFontThatIsNothingIsTheDefaultOne) {
    MakeLink(R"("ambient":{"Font":{"Name":"Arial"}})");
    EXPECT_EQ(Value(R"({"do":"ambient","of":"Link1","name":"Font","value":null})"), "null");
    EXPECT_EQ(Reply(R"({"do":"save","of":"Link1"})")["value"]["written"][2][2].dump(), defaultFont);
}

TEST_F(SessionTest, UserModeDecidesWhetherTheToolTipIsCopiedWhenTheControlIsShown) {
    MakeLink(R"("mode":"design","extender":{"ToolTipText":"Tip"})");
    EXPECT_EQ(Get("Link1.Label1", "ToolTipText"), "\"\"");
    Answer(R"({"do":"ambient","of":"Link1","name":"UserMode","value":true})");
    Answer(R"({"do":"show","of":"Link1"})");
    EXPECT_EQ(Get("Link1.Label1", "ToolTipText"), "\"Tip\"");
}

// Members.

TEST_F(SessionTest, MembersAreFoundWithoutRegardToCaseOrByNumber) {
    MakeLink();
    EXPECT_EQ(Get("LINK1", "caption"), "\"Docs\"");
    EXPECT_EQ(Value(R"({"do":"get","of":"Link1","name":-518})"), "\"Docs\"");
    EXPECT_EQ(Value(R"({"do":"put","of":"Link1","name":-518,"value":"x"})"), "null");
    EXPECT_EQ(Get("Link1", "Caption"), "\"x\"");
    EXPECT_EQ(Value(R"({"do":"get","of":"Link1","name":1})"), "2147483663") << "a member without a number has its place";
    EXPECT_EQ(Value(R"({"do":"call","of":"Link1","name":-550})"), "null");
}

TEST_F(SessionTest, ANumberThatNoMemberHasIsNoMember) {
    MakeLink();
    for (const char* number : {"0", "3", "20", "-1", "4294967297", "18446744073709551615"})
        EXPECT_EQ(Value(std::string(R"({"do":"get","of":"Link1","name":)") + number + "}"), "error 438") << number;
    for (const char* name : {"1.5", "true", "null", "[]"})
        EXPECT_EQ(Value(std::string(R"({"do":"get","of":"Link1","name":)") + name + "}"), "error 5") << name;
}

TEST_F(SessionTest, UnknownMembersAndMethodsAsPropertiesAreRefused) {
    MakeLink();
    EXPECT_EQ(Get("Link1", "Colour"), "error 438");
    EXPECT_EQ(Put("Link1", "Colour", 1), "error 438");
    EXPECT_EQ(Value(R"({"do":"call","of":"Link1","name":"Fly"})"), "error 438");
    EXPECT_EQ(Get("Link1", "OpenLink"), "error 438");
    EXPECT_EQ(Put("Link1", "OpenLink", 1), "error 438");
}

TEST_F(SessionTest, FieldsThatAreMissingAreNamed) {
    MakeLink();
    EXPECT_EQ(Description(R"({"do":"get","name":"Caption"})"), "The request lacks its field \"of\"");
    EXPECT_EQ(Description(R"({"do":"get","of":"Link1"})"), "The request lacks its field \"name\"");
    EXPECT_EQ(Description(R"({"do":"put","of":"Link1","name":"Caption"})"), "The request lacks its field \"value\"");
    EXPECT_EQ(Description(R"({"do":"fire","of":"Link1.Label1"})"), "The request lacks its field \"event\"");
    EXPECT_EQ(Description(R"({"do":"create","name":"x"})"), "The request lacks its field \"class\"");
    EXPECT_EQ(Description(R"({"do":"get","of":7,"name":"x"})"), "\"of\" must be a string");
    EXPECT_EQ(Description(R"({"do":"call","of":"Link1","name":"OpenLink","args":7})"), "\"args\" must be a list");
}

TEST_F(SessionTest, AMissingArgumentIsLeftOffOrSaidToBeMissing) {
    MakeLink();
    for (const char* arguments : {"", R"(,"args":[])", R"(,"args":[{"missing":true}])"})
        EXPECT_EQ(LogOf(std::string(R"({"do":"call","of":"Link1","name":"OpenLink")") + arguments + "}"),
                  R"([["execute","open","a.txt"]])")
            << arguments;
    EXPECT_EQ(LogOf(R"({"do":"call","of":"Link1","name":"OpenLink","args":["b.txt"]})"), R"([["execute","open","b.txt"]])");
    EXPECT_EQ(Value(R"({"do":"call","of":"Link1","name":"OpenLink","args":["b","c"]})"), "error 450");
}

TEST_F(SessionTest, AControlHasTheHostsMembersToo) {
    MakeLink();
    EXPECT_EQ(Get("Link1", "Name"), "\"Link1\"");
    EXPECT_EQ(Get("Link1", "ToolTipText"), "error 438") << "not every host has one";
    EXPECT_EQ(Put("Link1", "tooltiptext", "Tip"), "null");
    EXPECT_EQ(Get("Link1", "ToolTipText"), "\"Tip\"");
    EXPECT_EQ(Put("Link1", "Left", 120), "null");
    EXPECT_EQ(Get("Link1", "LEFT"), "120.0");
    EXPECT_EQ(Put("Link1", "Width", 700), "null");
    EXPECT_EQ(Get("Link1.Label1", "Width"), "700.0");
    EXPECT_EQ(Put("Link1", "Visible", false), "null");
    EXPECT_EQ(Get("Link1", "Visible"), "false");
}

TEST_F(SessionTest, TheNameOfAControlCannotBeSet) {
    MakeLink();
    EXPECT_EQ(Put("Link1", "Name", "Link9"), "error 382");
    EXPECT_EQ(Get("Link1", "Name"), "\"Link1\"");
}

TEST_F(SessionTest, AChildReadAsAValueIsItsPath) {
    MakeLink();
    EXPECT_EQ(Get("Link1", "Label1"), R"({"object":"Link1.Label1"})");
    EXPECT_EQ(Get("link1.label1", "Caption"), "\"Docs\"");
}

TEST_F(SessionTest, ColoursArePositiveAndMayBeGivenEitherWay) {
    MakeLink();
    EXPECT_EQ(Get("Link1", "BackColor"), "2147483663");
    EXPECT_EQ(Put("Link1", "HighlightColor", -2147483633), "null");
    EXPECT_EQ(Get("Link1", "HighlightColor"), "2147483663");
    EXPECT_EQ(Put("Link1", "HighlightColor", 4294967295), "null");
    EXPECT_EQ(Get("Link1", "HighlightColor"), "4294967295");
    EXPECT_EQ(Put("Link1", "HighlightColor", 4294967296), "error 6");
}

TEST_F(SessionTest, FloatsAreShort) {
    MakeLink();
    EXPECT_EQ(Put("Link1", "BorderSize", 0.1), "null");
    EXPECT_EQ(Get("Link1", "BorderSize"), "0.1");
    EXPECT_EQ(Put("Link1", "BorderSize", 1e39), "error 6");
}

TEST_F(SessionTest, FontsAreObjectsBothWays) {
    MakeLink();
    EXPECT_EQ(Get("Link1", "Font"), defaultFont);
    EXPECT_EQ(Put("Link1", "Font", {{"Name", "Courier New"}, {"Size", 12}, {"Bold", true}}), "null");
    EXPECT_EQ(Get("Link1.Label1", "Font"), R"({"Name":"Courier New","Size":12.0,"Bold":true,"Italic":false,"Underline":false,)"
                                           R"("Strikethrough":false,"Weight":700,"Charset":0})");
    EXPECT_EQ(Put("Link1.Font", "Size", 9.75), "null");
    EXPECT_EQ(Get("Link1.Label1.Font", "Size"), "9.75");
    EXPECT_EQ(Put("Link1", "Font", {{"Nam", "Arial"}}), "error 13");
}

TEST_F(SessionTest, TextThatIsNoUtf8IsEscaped) {
    MakeLink();
    EXPECT_EQ(Put("Link1", "Caption", "a\xF4\x8F\xBF\xA9"), "null");
    EXPECT_EQ(Get("Link1", "Caption"), "\"a\xF4\x8F\xBF\xA9\"");
    EXPECT_EQ(Get("Link1.Label1", "Caption"), "\"a\xF4\x8F\xBF\xA9\"");
}

TEST_F(SessionTest, AValueMayNameAnObject) {
    MakeLink();
    Answer(R"({"do":"sibling","name":"Text1","props":{"Owner":{"object":"link1"}}})");
    EXPECT_EQ(Get("Text1", "Owner"), R"({"object":"Link1"})");
    EXPECT_EQ(Get("Text1.Owner", "Caption"), "\"Docs\"");
    EXPECT_EQ(Put("Text1", "Owner", {{"object", "Link9"}}), "error 424");
    Answer(R"({"do":"destroy","of":"Link1"})");
    EXPECT_EQ(Get("Text1", "Owner"), "null") << "the reference does not keep the control alive";
}

TEST_F(SessionTest, PathsThatLeadNowhereAreRefused) {
    MakeLink();
    for (const char* path : {"Link9", "Link1.Label9", "Link1.Label1.Label1", "Link1.Caption"})
        EXPECT_EQ(Get(path, "Caption"), "error 424") << path;
    for (const char* path : {"", ".", "Link1.", "Link1..Label1", "Link1(", "Link1(x)"})
        EXPECT_EQ(Get(path, "Caption"), "error 5") << path;
    EXPECT_EQ(Get("Link1(1)", "Caption"), "error 438");
}

// Forms and the host's own objects.

TEST_F(SessionTest, ASiblingHasExactlyItsProperties) {
    EXPECT_EQ(Value(R"({"do":"sibling","name":"Text1","index":2,"props":{"Text":"a","List":[1,"x"]}})"), "\"Text1(2)\"");
    EXPECT_EQ(Get("text1(2)", "TEXT"), "\"a\"");
    EXPECT_EQ(Get("Text1(2)", "List"), R"([1,"x"])");
    EXPECT_EQ(Get("Text1(2)", "Name"), "\"Text1\"");
    EXPECT_EQ(Get("Text1(2)", "Index"), "2");
    EXPECT_EQ(Get("Text1(2)", "Left"), "error 438");
    EXPECT_EQ(Put("Text1(2)", "Left", 1), "error 438");
    EXPECT_EQ(Get("Text1", "Text"), "error 424");
}

TEST_F(SessionTest, AnIndexIsAWholeNumber) {
    EXPECT_EQ(Value(R"({"do":"sibling","name":"A","index":"2"})"), "\"A(2)\"");
    EXPECT_EQ(Value(R"({"do":"sibling","name":"A","index":-1})"), "\"A(-1)\"");
    EXPECT_EQ(Value(R"({"do":"sibling","name":"A","index":"x"})"), "error 13");
    EXPECT_EQ(Value(R"({"do":"sibling","name":"A","index":[]})"), "error 13");
    EXPECT_EQ(Value(R"({"do":"sibling","name":"A","index":3000000000})"), "error 6");
}

TEST_F(SessionTest, ASiblingWithASurfaceIsDrawnOn) {
    Answer(R"({"do":"sibling","name":"P","surface":true,"props":{"ScaleMode":3,"Caption":"x"}})");
    EXPECT_EQ(Get("P", "ScaleMode"), "3");
    EXPECT_EQ(Get("P", "Caption"), "\"x\"");
    EXPECT_EQ(LogOf(R"({"do":"call","of":"P","name":"Line","args":[1,2,3,4,255,"bf"]})"),
              R"([["draw","P","Line",1.0,2.0,3.0,4.0,255,"BF"]])");
    EXPECT_EQ(LogOf(R"({"do":"call","of":"P","name":"Circle","args":[1,2,3,{"missing":true},0.5]})"),
              R"([["draw","P","Circle",1.0,2.0,3.0,2147483666,0.5,null,null]])");
    EXPECT_EQ(LogOf(R"({"do":"put","of":"P","name":"DrawWidth","value":3})"), R"([["draw","P","DrawWidth",3]])");
    EXPECT_EQ(LogOf(R"({"do":"put","of":"P","name":"DrawWidth","value":3})"), "[]");
    EXPECT_EQ(Put("P", "DrawWidth", 0), "error 380");
    EXPECT_EQ(Get("P", "CurrentX"), "1.0");
    Answer(R"({"do":"sibling","name":"Q"})");
    EXPECT_EQ(Value(R"({"do":"call","of":"Q","name":"Cls"})"), "error 438");
}

TEST_F(SessionTest, APictureFromAnImageListIsNamedByItsImage) {
    for (const char* name : {"ScoreCard1", "ScoreCard2"}) {
        Answer(Json{{"do", "create"}, {"class", "ScoreCard"}, {"name", name}, {"mode", "run"}, {"bag", {{"Style", 2}}}}.dump());
        EXPECT_EQ(Get(std::string(name) + ".Picture1", "Picture"),
                  "{\"object\":\"" + std::string(name) + ".ImageList16.ListImages(\\\"Smiley3\\\")\"}");
    }
    Put("ScoreCard1", "Style", 7);
    EXPECT_EQ(Get("ScoreCard1.Picture1", "Picture"), "null");
}

TEST_F(SessionTest, AFormHoldsWhatComesNextUntilAnotherIsNamed) {
    EXPECT_EQ(Get("Form1", "Name"), "\"Form1\"");
    EXPECT_EQ(Value(R"({"do":"form","name":"Form2","ScaleMode":3,"ScaleWidth":1500,"BackColor":255,"Caption":"x"})"), "\"Form2\"");
    EXPECT_EQ(Get("Form2", "ScaleWidth"), "100.0");
    EXPECT_EQ(Get("Form2", "BackColor"), "255");
    EXPECT_EQ(Get("Form2", "Caption"), "\"x\"");
    EXPECT_EQ(Get("Form2", "Picture"), "null");
    EXPECT_EQ(Get("Form1", "Name"), "\"Form1\"");
    EXPECT_EQ(Value(R"({"do":"form","name":"Form1","Caption":"y"})"), "\"Form1\"");
    EXPECT_EQ(Value(R"({"do":"form","name":"form2"})"), "\"form2\"");
    EXPECT_EQ(Get("Form1", "Caption"), "\"y\"");
    EXPECT_EQ(Get("Form2", "Caption"), "\"x\"");
}

TEST_F(SessionTest, PlaceSizeAndVisibilityMayComeWithTheExtender) {
    Answer(R"({"do":"create","class":"Link","name":"L","extender":{"Left":300,"top":200,"Width":900,"Visible":false}})");
    EXPECT_EQ(Get("L", "Left"), "300.0");
    EXPECT_EQ(Get("L", "Top"), "200.0");
    EXPECT_EQ(Get("L.Label1", "Width"), "900.0");
    EXPECT_EQ(Get("L", "Visible"), "false");
}

TEST_F(SessionTest, ASurfaceKeepsItsPixels) {
    Answer(R"({"do":"sibling","name":"P","surface":true,"props":{"Width":150,"Height":90}})");
    EXPECT_EQ(Get("P", "ScaleWidth"), "150.0");
    Answer(R"({"do":"call","of":"P","name":"PSet","args":[20,20,255]})");
    EXPECT_EQ(Value(R"({"do":"call","of":"P","name":"Point","args":[29,29]})"), "255");
    EXPECT_EQ(Value(R"({"do":"call","of":"P","name":"Point","args":[150,29]})"), "-1");
}

TEST_F(SessionTest, AColourOfASiblingIsWrittenAsAPositiveNumber) {
    Answer(R"({"do":"sibling","name":"T","props":{"BackColor":-2147483643}})");
    EXPECT_EQ(Get("T", "BackColor"), "2147483653");
    Answer(R"({"do":"put","of":"T","name":"BackColor","value":2147483656})");
    EXPECT_EQ(Get("T", "BackColor"), "2147483656");
}

TEST_F(SessionTest, TheInnerSizeOfAFormFollowsItsScale) {
    Answer(R"({"do":"form","name":"F","ScaleWidth":1500,"ScaleHeight":300})");
    EXPECT_EQ(Put("F", "ScaleMode", 3), "null");
    EXPECT_EQ(Get("F", "ScaleWidth"), "100.0");
    EXPECT_EQ(Get("F", "ScaleHeight"), "20.0");
    EXPECT_EQ(Put("F", "ScaleMode", 9), "error 380");
}

TEST_F(SessionTest, TheProgramAndTheScreenAreObjects) {
    EXPECT_EQ(Get("App", "Path"), R"("C:\\App")");
    EXPECT_EQ(Put("app", "path", "C:\\x"), "null");
    EXPECT_EQ(Get("App", "Path"), R"("C:\\x")");
    EXPECT_EQ(Put("Screen", "MousePointer", 11), "null");
    EXPECT_EQ(Get("Screen", "MousePointer"), "11");
    EXPECT_EQ(Put("Screen", "MousePointer", 70000), "error 6");
}

// Events.

TEST_F(SessionTest, FireChecksTheEventAndItsArguments) {
    MakeLink();
    EXPECT_EQ(Value(R"({"do":"fire","of":"Link1.Label1","event":"Sneeze"})"), "error 438");
    EXPECT_EQ(Value(R"({"do":"fire","of":"Link1","event":"Click"})"), "error 438");
    EXPECT_EQ(Value(R"({"do":"fire","of":"Link1.Label1","event":"MouseDown","args":[1,0,5]})"), "error 449");
    EXPECT_EQ(Value(R"({"do":"fire","of":"Link1.Label1","event":"MouseDown","args":[1,0,5,5,5]})"), "error 450");
    EXPECT_EQ(Value(R"({"do":"fire","of":"Link1.Label1","event":"MouseDown","args":[1,0,"x",5]})"), "error 13");
    EXPECT_EQ(Value(R"({"do":"fire","of":"Link1.Label1","event":"MouseDown","args":[70000,0,5,5]})"), "error 6");
    EXPECT_EQ(LogOf(R"({"do":"fire","of":"Link1.Label1","event":"click"})"), R"([["event","Link1","Click",[]]])");
}

TEST_F(SessionTest, AHandlerRunsItsRequestsInsideTheEvent) {
    MakeLink();
    Answer(R"({"do":"handler","of":"Link1","event":"MouseDown","run":[)"
           R"({"do":"put","of":"Link1","name":"LinkTo","value":"b.txt"},{"do":"dance"}]})");
    EXPECT_EQ(Press(), R"({"value":null,"log":[["event","Link1","MouseDown",[1,0,300.0,100.0]],)"
                       R"(["changed","Link1","LinkTo"],["reply",{"value":null}],)"
                       R"(["reply",{"error":{"number":5,"description":"Unknown request \"dance\""}}],)"
                       R"(["execute","open","b.txt"]]})");
}

TEST_F(SessionTest, AHandlerRunsOnlyWhenTheArgumentsMatch) {
    MakeLink(R"("bag":{"ClickAction":0})");
    Answer(R"({"do":"handler","of":"link1","event":"mousedown","when":{"button":2},"run":[{"do":"advance","ms":1}]})");
    EXPECT_EQ(Press(), R"({"value":null,"log":[["event","Link1","MouseDown",[1,0,300.0,100.0]]]})");
    EXPECT_EQ(LogOf(R"({"do":"fire","of":"Link1.Label1","event":"MouseDown","args":[2,0,300,100]})"),
              R"([["event","Link1","MouseDown",[2,0,300.0,100.0]],["reply",{"value":null}]])");
}

TEST_F(SessionTest, AHandlerRunsNoMoreTimesThanItIsTold) {
    MakeLink();
    const std::string click = R"({"do":"fire","of":"Link1.Label1","event":"Click"})";
    Answer(R"({"do":"handler","of":"Link1","event":"Click","times":2,"run":[{"do":"advance","ms":1}]})");
    EXPECT_EQ(Reply(click)["log"].size(), 2u);
    EXPECT_EQ(Reply(click)["log"].size(), 2u);
    EXPECT_EQ(Reply(click)["log"].size(), 1u);
    Answer(R"({"do":"handler","of":"Link1","event":"Click","times":-2147483648,"run":[{"do":"advance","ms":1}]})");
    EXPECT_EQ(Reply(click)["log"].size(), 1u);
}

TEST_F(SessionTest, AHandlerSetsTheArgumentsOfTheEventWhichAForwarderDoesNotReadBack) {
    MakeLink(R"("bag":{"LinkTo":"a.txt"},"width":2000,"height":600)");
    Answer(R"({"do":"handler","of":"Link1","event":"MouseDown","set":{"x":5,"BUTTON":"2"}})");
    EXPECT_EQ(Press(), R"({"value":null,"log":[["event","Link1","MouseDown",[1,0,300.0,100.0]],["execute","open","a.txt"]]})");
    // Had the press been taken to the border strip, the link would not count as used.
    Answer(R"({"do":"fire","of":"Link1.Label1","event":"MouseMove","args":[0,0,5,5]})");
    EXPECT_EQ(Get("Link1.Label1", "ForeColor"), Get("Link1", "UsedColor"));
}

TEST_F(SessionTest, ALaterHandlerReplacesTheFormerAlsoFromInside) {
    MakeLink();
    const std::string click = R"({"do":"fire","of":"Link1.Label1","event":"Click"})";
    Answer(
        R"({"do":"handler","of":"Link1","event":"Click","run":[{"do":"handler","of":"Link1","event":"Click"},{"do":"advance","ms":1}]})");
    EXPECT_EQ(Reply(click)["log"].size(), 3u);
    EXPECT_EQ(Reply(click)["log"].size(), 1u);
}

TEST_F(SessionTest, AHandlerMayDestroyItsControl) {
    MakeLink();
    Answer(R"({"do":"handler","of":"Link1","event":"MouseDown","run":[{"do":"destroy","of":"Link1"}]})");
    Press();
    EXPECT_EQ(Get("Link1", "Caption"), "error 424");
    MakeLink();
}

TEST_F(SessionTest, AHandlerIsCheckedWhenItIsSet) {
    MakeLink();
    EXPECT_EQ(Value(R"({"do":"handler","of":"Link1","event":"Sneeze"})"), "error 438");
    EXPECT_EQ(Value(R"({"do":"handler","of":"Later","event":"Sneeze"})"), "null") << "its control may come later";
    for (const char* field : {R"("set":[])", R"("when":7)", R"("run":{})"})
        EXPECT_EQ(Value(std::string(R"({"do":"handler","of":"Link1","event":"Click",)") + field + "}"), "error 5") << field;
    EXPECT_EQ(Value(R"({"do":"handler","of":"Link1","event":"Click","times":"often"})"), "error 13");
}

TEST_F(SessionTest, AnErrorThatLeavesAControlInsideAnEventReachesTheReply) {
    MakeLink();
    Answer(R"({"do":"handler","of":"Link1","event":"MouseDown","set":{"Buton":1}})");
    EXPECT_EQ(Press(), R"({"error":{"number":438,"description":"The event has no argument \"Buton\""},)"
                       R"("log":[["event","Link1","MouseDown",[1,0,300.0,100.0]]]})");
    Answer(R"({"do":"handler","of":"Link1","event":"MouseDown","when":{"Buton":1}})");
    EXPECT_EQ(Json::parse(Press())["error"]["number"], 438);
    Answer(R"({"do":"handler","of":"Link1","event":"MouseDown","set":{"Button":"x"}})");
    EXPECT_EQ(Json::parse(Press())["error"]["number"], 13);
    EXPECT_EQ(Get("Link1", "Caption"), "\"Docs\"") << "the next request succeeds";
}

TEST_F(SessionTest, AnErrorInsideAnEventBelongsToTheRequestThatFiredIt) {
    MakeLink();
    Answer(R"({"do":"handler","of":"Link1","event":"MouseUp","set":{"Buton":1}})");
    Answer(R"({"do":"handler","of":"Link1","event":"Click","run":[)"
           R"({"do":"fire","of":"Link1.Label1","event":"MouseUp","args":[1,0,1,1]}]})");
    EXPECT_EQ(Answer(R"({"do":"fire","of":"Link1.Label1","event":"Click"})"),
              R"({"value":null,"log":[["event","Link1","Click",[]],["event","Link1","MouseUp",[1,0,1.0,1.0]],)"
              R"(["reply",{"error":{"number":438,"description":"The event has no argument \"Buton\""}}]]})");
}

TEST_F(SessionTest, EndlessRecursionOfHandlersEnds) {
    MakeLink();
    Answer(R"({"do":"handler","of":"Link1","event":"Click","run":[{"do":"fire","of":"Link1.Label1","event":"Click"}]})");
    const Json reply = Reply(R"({"do":"fire","of":"Link1.Label1","event":"Click"})");
    EXPECT_TRUE(reply.contains("value"));
    EXPECT_EQ(reply["log"].size(), 200u);
    EXPECT_EQ(reply["log"][100][1]["error"]["description"], "Requests are nested too deep");
}

TEST(Session, HandlersThatMultiplyEnd) {
    Session session(1000);
    const std::string click = R"({"do":"fire","of":"Link1.Label1","event":"Click"})";
    session.Answer(R"({"do":"create","class":"Link","name":"Link1"})");
    session.Answer(R"({"do":"handler","of":"Link1","event":"Click","run":[)" + click + "," + click + "]}");
    EXPECT_EQ(Json::parse(session.Answer(click))["error"]["description"], "One line sets off too many requests");
    EXPECT_EQ(session.Answer(R"({"do":"get","of":"Link1","name":"Caption"})"), R"({"value":"Label1","log":[]})");
}

TEST(Session, TheLimitOfRequestsHoldsForEachLineByItself) {
    Session session(10);
    session.Answer(R"({"do":"create","class":"Link","name":"Link1"})");
    session.Answer(R"({"do":"handler","of":"Link1","event":"Click","run":[{"do":"advance","ms":1},{"do":"advance","ms":1}]})");
    for (int line = 0; line < 20; ++line)
        EXPECT_TRUE(Json::parse(session.Answer(R"({"do":"fire","of":"Link1.Label1","event":"Click"})")).contains("value"));
}

// The host.

TEST_F(SessionTest, TimeIsMovedByANumberOfMilliseconds) {
    for (const char* milliseconds : {"0", "1000", "0.5", "1e12", "\"20\""})
        EXPECT_EQ(Value(std::string(R"({"do":"advance","ms":)") + milliseconds + "}"), "null") << milliseconds;
    for (const char* milliseconds : {"-1", "-0.001", "1.1e12", "1e300"})
        EXPECT_EQ(Value(std::string(R"({"do":"advance","ms":)") + milliseconds + "}"), "error 5") << milliseconds;
    for (const char* milliseconds : {"\"soon\"", "[]", "{}"})
        EXPECT_EQ(Value(std::string(R"({"do":"advance","ms":)") + milliseconds + "}"), "error 13") << milliseconds;
    EXPECT_EQ(Value(R"({"do":"advance"})"), "error 5");
}

TEST_F(SessionTest, RandomNumbersLieBelowOne) {
    EXPECT_EQ(Value(R"({"do":"random","values":[0,0.5,0.9999]})"), "null");
    EXPECT_EQ(Value(R"({"do":"random"})"), "null");
    for (const char* values : {"[1.1]", "[-0.1]", "[0.5,2]", "7"})
        EXPECT_EQ(Value(std::string(R"({"do":"random","values":)") + values + "}"), "error 5") << values;
    EXPECT_EQ(Value(R"({"do":"random","values":["x"]})"), "error 13");
}

TEST_F(SessionTest, TheDateIsSetFromText) {
    EXPECT_EQ(Value(R"({"do":"now","value":"2001-02-03 04:05:06"})"), "null");
    EXPECT_EQ(Value(R"({"do":"now","value":"yesterday"})"), "error 13");
    EXPECT_EQ(Value(R"({"do":"now","value":"2001-02-30 04:05:06"})"), "error 13");
    EXPECT_EQ(Value(R"({"do":"now","value":7})"), "error 5");
}

TEST_F(SessionTest, ShellResultsAreTakenFromTheirQueueInOrder) {
    MakeLink();
    const std::string open = R"({"do":"call","of":"Link1","name":"OpenLink","args":["t.txt"]})";
    EXPECT_EQ(Value(R"({"do":"shell","execute":[2,31]})"), "null");
    EXPECT_EQ(Answer(open), R"({"value":"Unable to find file","log":[["execute","open","t.txt"],)"
                            R"(["msgbox","Error 2: Unable to find file 't.txt'",0,""]]})");
    EXPECT_EQ(Value(open), "\"No application associated with file\"");
    EXPECT_EQ(Value(open), "\"\"") << "an empty queue succeeds";
}

TEST_F(SessionTest, QueuesTakeTheirKindsOfValues) {
    EXPECT_EQ(Value(R"({"do":"shell","operation":[0,1026,{"return":0,"aborted":true,"error":5},{}]})"), "null");
    EXPECT_EQ(Value(R"({"do":"answers","msgbox":[6,7],"dialog":["C:\\a.txt",null],"popup":["Link1",null],"form":[[]]})"), "null");
    for (const char* fields : {R"("msgbox":6)", R"("dialog":[6])", R"("popup":[6])", R"("form":[6])", R"("form":{})"})
        EXPECT_EQ(Value(std::string(R"({"do":"answers",)") + fields + "}"), "error 5") << fields;
    for (const char* fields : {R"("execute":2)", R"("operation":[{"aborted":1}])"})
        EXPECT_EQ(Value(std::string(R"({"do":"shell",)") + fields + "}"), "error 5") << fields;
    EXPECT_EQ(Value(R"({"do":"answers","msgbox":["yes"]})"), "error 13");
    EXPECT_EQ(Value(R"({"do":"shell","execute":["ok"]})"), "error 13");
}

TEST_F(SessionTest, AWidthBeyondAllScreensWrapsNothing) {
    MakeLink(R"("bag":{"Caption":"abc def","WordWrap":true})");
    EXPECT_EQ(Value(R"({"do":"resize","of":"Link1","width":1e38,"height":10})"), "null");
    EXPECT_EQ(Put("Link1", "AutoSize", true), "null");
    EXPECT_EQ(Get("Link1.Label1", "Height"), "195.0");
}

TEST_F(SessionTest, ARecordsetFillsAList) {
    EXPECT_EQ(Answer(R"({"do":"recordset","name":"RS1","columns":["Name","Id"],"rows":[["Red",1],["",2],["Blue",40000]]})"),
              R"({"value":{"object":"RS1"},"log":[]})");
    EXPECT_EQ(Value(R"({"do":"create","class":"DataList","name":"DataList1","mode":"run"})"), "\"DataList1\"");
    EXPECT_EQ(Answer(R"({"do":"call","of":"DataList1","name":"Populate","args":[{"object":"RS1"},"name",1]})"),
              R"({"value":"","log":[["yield"]]})");
    EXPECT_EQ(Get("DataList1", "ListCount"), "2");
    EXPECT_EQ(Value(R"~({"do":"get","of":"DataList1.listItems(0)","name":"List","args":[1]})~"), "\"Blue\"");
    EXPECT_EQ(Value(R"~({"do":"get","of":"DataList1.listItems(0)","name":"ItemData","args":[1]})~"), "40000");
    EXPECT_EQ(Answer(R"~({"do":"put","of":"DataList1.listItems(0)","name":"ListIndex","value":1})~"),
              R"({"value":null,"log":[["event","DataList1","Click",[]]]})");
    EXPECT_EQ(Get("DataList1", "Value"), "40000");
    EXPECT_EQ(Get("DataList1.labItem", "Caption"), "\"Blue\"");
    EXPECT_EQ(Get("RS1", "EOF"), "true");
    EXPECT_EQ(Get("RS1.Fields(\"id\")", "Name"), "\"Id\"");
}

TEST_F(SessionTest, ARecordsetOfTheSameNameReplacesTheOldOne) {
    EXPECT_EQ(Value(R"({"do":"recordset","name":"RS1","columns":["a"],"rows":[[1]]})"), R"({"object":"RS1"})");
    EXPECT_EQ(Value(R"({"do":"recordset","name":"rs1","columns":["a"],"rows":[]})"), R"({"object":"rs1"})");
    EXPECT_EQ(Value(R"({"do":"call","of":"RS1","name":"MoveFirst"})"), "error 3021");
    MakeLink();
    EXPECT_EQ(Value(R"({"do":"recordset","name":"Link1","columns":["a"],"rows":[]})"), "error 457");
    EXPECT_EQ(Value(R"({"do":"recordset","name":"RS2","columns":["a"],"rows":[[1,2]]})"), "error 5");
    EXPECT_EQ(Value(R"({"do":"recordset","name":"RS2","columns":["a"],"rows":[1]})"), "error 5");
    EXPECT_EQ(Value(R"({"do":"recordset","columns":[],"rows":[]})"), "error 5");
}

TEST_F(SessionTest, ToolTipTextIsWrittenTwiceBehindTheBagOfAList) {
    EXPECT_EQ(Value(R"({"do":"create","class":"DataList","name":"DataList1","mode":"run"})"), "\"DataList1\"");
    const Json reply = Reply(R"({"do":"save","of":"DataList1"})");
    const Json& written = reply["value"]["written"];
    ASSERT_EQ(written.size(), 17u);
    EXPECT_EQ(written[15].dump(), R"(["ToolTipText","",null])");
    EXPECT_EQ(written[16].dump(), R"(["ToolTipText","",""])");
    EXPECT_EQ(reply["value"]["bag"].dump(), "{}");
}

}  // namespace
}  // namespace tessel::tools
