#include "hosts/headless/Services.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstdint>
#include <limits>
#include <string>
#include <utility>
#include <vector>

#include "frame/Dates.h"
#include "hosts/headless/HeadlessHost.h"
#include "hosts/headless/HostObject.h"
#include "tests/frame/TestControl.h"

namespace tessel::headless {
namespace {

using frame::Variant;
using test::ErrorOf;
using testing::ElementsAre;

/// An entry of the log as "kind|a|b".
std::string Line(const Log::Entry& entry) {
    std::string line;
    for (const Variant& value : entry) {
        if (!line.empty()) line += '|';
        if (value.Type() != frame::VarType::Array) {
            line += value.ToText();
            continue;
        }
        line += '[';
        for (const Variant& item : value.ToArray().items) line += (line.back() == '[' ? "" : ",") + item.ToText();
        line += ']';
    }
    return line;
}

std::vector<std::string> Lines(const Log& log) {
    std::vector<std::string> lines;
    for (const Log::Entry& entry : log.Entries()) lines.push_back(Line(entry));
    return lines;
}

// Log

TEST(Log, GivesTheNamesOfEventsAndTheEntriesOfAKind) {
    Log log;
    log.Add({"event", "A", "Click", ListOf(std::vector<Variant>())});
    log.Add({"changed", "A", "Caption"});
    log.Add({"event", "B", "Show", ListOf(std::vector<Variant>())});
    log.Add({"event", "A", "DblClick", ListOf(std::vector<Variant>())});
    EXPECT_EQ(log.EventNames(), "Click Show DblClick");
    EXPECT_EQ(log.EventNames("A"), "Click DblClick");
    EXPECT_EQ(log.EventNames("C"), "");
    ASSERT_EQ(log.Of("changed").size(), 1u);
    EXPECT_EQ(Line(log.Of("changed")[0]), "changed|A|Caption");
}

TEST(Log, IsEmptyAfterItWasTakenOrCleared) {
    Log log;
    log.Add({"yield"});
    EXPECT_EQ(log.Take().size(), 1u);
    EXPECT_TRUE(log.Entries().empty());
    log.Add({"yield"});
    log.Clear();
    EXPECT_TRUE(log.Entries().empty());
}

// Boxes

TEST(ScriptedDialogs, AnswersFromTheQueueAndThenTheDefaultButton) {
    Log log;
    ScriptedDialogs dialogs(log);
    dialogs.answers = {frame::msgbox::answerNo};
    const int yesNo = frame::msgbox::yesNo + frame::msgbox::question;
    EXPECT_EQ(dialogs.MsgBox("Sure?", yesNo, "Title"), frame::msgbox::answerNo);
    EXPECT_EQ(dialogs.MsgBox("Sure?", yesNo, ""), frame::msgbox::answerYes);
    EXPECT_EQ(dialogs.MsgBox("Done", frame::msgbox::information, ""), frame::msgbox::answerOk);
    EXPECT_THAT(Lines(log), ElementsAre("msgbox|Sure?|36|Title", "msgbox|Sure?|36|", "msgbox|Done|64|"));
}

TEST(ScriptedDialogs, ChoosesFilesFromTheQueueAndElseCancels) {
    Log log;
    ScriptedDialogs dialogs(log);
    dialogs.fileNames = {"a.bmp", std::nullopt};
    std::string name = "old";
    dialogs.ShowOpen("Open", "All|*.*", name);
    EXPECT_EQ(name, "a.bmp");
    dialogs.ShowOpen("Open", "All|*.*", name);
    EXPECT_EQ(name, "a.bmp");
    dialogs.ShowOpen("Open", "All|*.*", name);
    EXPECT_EQ(name, "a.bmp");
    EXPECT_EQ(Lines(log)[0], "dialog|Open|All|*.*|old");
    EXPECT_EQ(log.Entries().size(), 3u);
}

TEST(ScriptedDialogs, LetsTheUserActInAFormOnce) {
    Log log;
    ScriptedDialogs dialogs(log);
    HostObject form("Form1", {});
    int acts = 0;
    dialogs.forms = {[&] { ++acts; }};
    dialogs.ShowModal(form);
    dialogs.ShowModal(form);
    EXPECT_EQ(acts, 1);
}

TEST(ScriptedDialogs, MayBeAskedAgainWhileAFormIsOpen) {
    Log log;
    ScriptedDialogs dialogs(log);
    HostObject form("Form1", {});
    std::string acts;
    dialogs.forms = {[&] {
                         acts += "a";
                         dialogs.ShowModal(form);
                     },
                     [&] { acts += "b"; }};
    dialogs.ShowModal(form);
    EXPECT_EQ(acts, "ab");
}

TEST(ScriptedMenus, PickFromTheQueue) {
    Log log;
    ScriptedMenus menus(log);
    HostObject menu("File1.mnuMain", {}), entry("File1.mnuMain.mnuOpen", {});
    int picked = 0;
    menus.picks = {[&] { ++picked; }};
    menus.Popup(menu, &entry);
    menus.Popup(menu, nullptr);
    EXPECT_EQ(picked, 1);
    EXPECT_THAT(Lines(log), ElementsAre("popup|File1.mnuMain|File1.mnuMain.mnuOpen", "popup|File1.mnuMain|"));
}

TEST(ScriptedLoop, WritesEachTurn) {
    Log log;
    ScriptedLoop loop(log);
    loop.Turn();
    loop.WantTurn();
    EXPECT_THAT(Lines(log), ElementsAre("yield"));
}

TEST(ScriptedFocusAndDrag, NameTheChild) {
    HeadlessHost host;
    auto& control = host.Create<test::TestControl>("Test1");
    host.log.Clear();
    host.Frame().Focus().Set(control.Child1);
    host.Frame().StartDrag(control.Child1);
    EXPECT_THAT(Lines(host.log), ElementsAre("focus|Test1.Child1", "drag|Test1.Child1"));
}

TEST(ScriptedShell, SucceedsUnlessTheQueueSaysOtherwise) {
    Log log;
    ScriptedShell shell(log);
    shell.executeResults = {31};
    EXPECT_EQ(shell.Execute("open", "a.txt"), 31);
    EXPECT_GT(shell.Execute("print", "a.txt"), 32);
    shell.operationResults = {{.code = 5, .aborted = true, .systemError = 7}};
    const frame::FileOperation operation{frame::FileOperation::Kind::Delete, 64, {"a", "b"}, {}};
    EXPECT_TRUE(shell.Run(operation).aborted);
    EXPECT_EQ(shell.Run(operation).code, 0);
    EXPECT_THAT(Lines(log),
                ElementsAre("execute|open|a.txt", "execute|print|a.txt", "operation|3|64|[a,b]|[]", "operation|3|64|[a,b]|[]"));
}

// Random numbers

TEST(ScriptedRandom, GivesTheQueueFirst) {
    ScriptedRandom random;
    random.queue = {0.25f, 0.75f};
    EXPECT_EQ(random.Next(), 0.25f);
    EXPECT_EQ(random.Next(), 0.75f);
    EXPECT_NE(random.Next(), random.Next());
}

std::vector<float> Sequence(ScriptedRandom& random) {
    std::vector<float> numbers(20);
    for (float& number : numbers) number = random.Next();
    return numbers;
}

TEST(ScriptedRandom, RepeatsForTheSameSeedAndNotForAnother) {
    ScriptedRandom one, other;
    one.Restart(12.5);
    const auto first = Sequence(one);
    one.Restart(12.5);
    EXPECT_EQ(Sequence(one), first);
    other.Next();
    other.Restart(12.5);
    EXPECT_EQ(Sequence(other), first);
    other.Restart(12.25);
    EXPECT_NE(Sequence(other), first);
    other.Restart(-12.5);
    EXPECT_NE(Sequence(other), first);
}

TEST(ScriptedRandom, RestartedFromTheClockIsTheSameOnEveryRun) {
    ScriptedRandom one, other;
    one.RestartFromClock();
    other.Restart(7);
    other.RestartFromClock();
    EXPECT_EQ(Sequence(one), Sequence(other));
}

TEST(ScriptedRandom, StaysBelowOneAndCoversItsRange) {
    ScriptedRandom random;
    float least = 1, greatest = 0;
    for (int i = 0; i < 20'000; ++i) {
        const float number = random.Next();
        ASSERT_GE(number, 0);
        ASSERT_LT(number, 1);
        least = std::min(least, number);
        greatest = std::max(greatest, number);
    }
    EXPECT_LT(least, 0.01f);
    EXPECT_GT(greatest, 0.99f);
}

// Locale

TEST(FixedLocale, WritesShortAndLongDates) {
    FixedLocale locale;
    const frame::Date moment = frame::DateFrom({2001, 2, 3, 4, 5, 6});
    EXPECT_EQ(locale.DateText(moment), "2/3/2001 4:05:06 AM");
    EXPECT_EQ(locale.LongDateText(moment), "Saturday, February 3, 2001");
}

TEST(FixedLocale, KnowsTheDayOfTheWeekAroundDayZero) {
    FixedLocale locale;
    EXPECT_EQ(locale.LongDateText({0}), "Saturday, December 30, 1899");
    EXPECT_EQ(locale.LongDateText({1}), "Sunday, December 31, 1899");
    EXPECT_EQ(locale.LongDateText({-1}), "Friday, December 29, 1899");
    EXPECT_EQ(locale.LongDateText({-1.75}), "Friday, December 29, 1899");
    EXPECT_EQ(locale.LongDateText(frame::DateFrom({2024, 2, 29, 23, 59, 59})), "Thursday, February 29, 2024");
}

TEST(FixedLocale, GroupsDigitsByThree) {
    FixedLocale locale;
    const std::pair<std::int64_t, const char*> numbers[] = {
        {0, "0"}, {999, "999"}, {1000, "1,000"}, {1'234'567, "1,234,567"}, {-1, "-1"}, {-123, "-123"}, {-123'456, "-123,456"}};
    for (const auto& [number, text] : numbers) EXPECT_EQ(locale.Grouped(number), text);
    EXPECT_EQ(locale.Grouped(std::numeric_limits<std::int64_t>::max()), "9,223,372,036,854,775,807");
    EXPECT_EQ(locale.Grouped(std::numeric_limits<std::int64_t>::min()), "-9,223,372,036,854,775,808");
}

TEST(FixedLocale, TakesUniversalTimeForLocalTime) {
    FixedLocale locale;
    EXPECT_EQ(frame::SortableDateText(locale.LocalTime(0)), "1970-01-01 00:00:00");
    EXPECT_EQ(frame::SortableDateText(locale.LocalTime(981'173'106)), "2001-02-03 04:05:06");
    EXPECT_EQ(frame::SortableDateText(locale.LocalTime(-1)), "1969-12-31 23:59:59");
    EXPECT_EQ(frame::SortableDateText(locale.LocalTime(-2'209'161'600)), "1899-12-30 00:00:00");
}

TEST(FixedLocale, KnowsTheTimeOfDayBeforeDayZero) {
    EXPECT_EQ(frame::SortableDateText(FixedLocale().LocalTime(-2'209'161'600 - 64'800)), "1899-12-29 06:00:00");
}

// Text metrics

struct Metrics : testing::Test {
    std::pair<float, float> Measure(std::string_view text, std::optional<float> wrapWidth = {}) {
        const frame::TextSize size = metrics.Measure(frame::Font(), text, wrapWidth);
        return {size.width / 90, size.height / 195};
    }

    FixedMetrics metrics;
};

using Size = std::pair<float, float>;  // in characters and lines

TEST_F(Metrics, CountCharactersAndLines) {
    EXPECT_EQ(Measure(""), Size(0, 1));
    EXPECT_EQ(Measure("abc"), Size(3, 1));
    EXPECT_EQ(Measure("abc\nlonger\n"), Size(6, 3));
    EXPECT_EQ(Measure("\u00E4\u20AC\xFF"), Size(3, 1));
}

TEST_F(Metrics, AreTheSameForEveryFont) {
    EXPECT_EQ(metrics.Measure(frame::Font("Arial", 72), "ab", {}), (frame::TextSize{180, 195}));
}

TEST_F(Metrics, WrapWordsWhereTheyNoLongerFit) {
    EXPECT_EQ(Measure("one two three", 13 * 90), Size(13, 1));
    EXPECT_EQ(Measure("one two three", 12 * 90), Size(7, 2));
    EXPECT_EQ(Measure("one two three", 7 * 90), Size(7, 2));
    EXPECT_EQ(Measure("one two three", 6 * 90), Size(5, 3));
    EXPECT_EQ(Measure("one two\nthree four", 7 * 90), Size(7, 3));
    EXPECT_EQ(Measure("", 90), Size(0, 1));
}

TEST_F(Metrics, CutAWordThatIsLongerThanALine) {
    EXPECT_EQ(Measure("abcdefgh", 3 * 90), Size(3, 3));
    EXPECT_EQ(Measure("ab abcdefgh", 3 * 90), Size(3, 4));
}

TEST_F(Metrics, HaveRoomForOneCharacterAtLeast) {
    for (const float width : {1.0f, 0.0f, -5.0f, std::numeric_limits<float>::quiet_NaN()})
        EXPECT_EQ(Measure("abc", width), Size(1, 3));
}

TEST_F(Metrics, WrapNothingInAWidthWithoutEnd) {
    for (const float width : {1e15f, 1e30f, std::numeric_limits<float>::infinity()})
        EXPECT_EQ(Measure("one two", width), Size(7, 1)) << width;
}

// What holds nothing

TEST(ScriptedPictures, LoadWhatTheMemoryDiskKnowsAsAPicture) {
    HeadlessHost host;
    host.files.SetFile("C:\\p.bmp", {.picture = std::pair(1500.0f, 900.0f)}).Check();
    host.files.SetFile("C:\\a.txt", {.contents = "words"}).Check();
    const auto picture = host.pictures.LoadPicture("C:\\p.bmp");
    EXPECT_EQ(picture->Width(), 1500);
    EXPECT_EQ(picture->Height(), 900);
    EXPECT_EQ(picture->Source(), "C:\\p.bmp");
    EXPECT_EQ(host.pictures.LoadPicture("")->Width(), 0);
    EXPECT_EQ(ErrorOf([&] { host.pictures.LoadPicture("C:\\none.bmp"); }), frame::errors::fileNotFound);
    EXPECT_EQ(ErrorOf([&] { host.pictures.LoadPicture("C:\\a.txt"); }), frame::errors::invalidPicture);
}

TEST(ScriptedPictures, HaveAnIconForEveryPathUnlessTheQueueSaysOtherwise) {
    HeadlessHost host;
    host.pictures.icons = {false, true};
    EXPECT_EQ(host.pictures.FileIcon("C:\\a.txt", 0x6605), nullptr);
    const auto large = host.pictures.FileIcon("C:\\a.txt", 0x6604);
    const auto small = host.pictures.FileIcon("C:\\a.txt", 0x6605);
    ASSERT_TRUE(large && small);
    EXPECT_EQ(large->Width(), 480);
    EXPECT_EQ(small->Width(), 240);
    EXPECT_THAT(Lines(host.log), ElementsAre("icon|C:\\a.txt|26117", "icon|C:\\a.txt|26116", "icon|C:\\a.txt|26117"));
}

TEST(MemoryClipboard, KeepsBytesByTheirFormat) {
    MemoryClipboard clipboard;
    EXPECT_EQ(clipboard.Read(1), std::nullopt);
    EXPECT_TRUE(clipboard.Put(1, "text"));
    EXPECT_TRUE(clipboard.Put(15, "files"));
    EXPECT_EQ(clipboard.Read(1), "text");
    EXPECT_TRUE(clipboard.Has(15));
    EXPECT_FALSE(clipboard.Has(2));
    clipboard.Clear();
    EXPECT_FALSE(clipboard.Has(1));
}

TEST(MemoryClipboard, ThatAnotherProgramHoldsGivesAndTakesNothing) {
    MemoryClipboard clipboard;
    clipboard.Put(1, "text");
    clipboard.held = true;
    EXPECT_FALSE(clipboard.Put(1, "other"));
    EXPECT_EQ(clipboard.Read(1), std::nullopt);
    clipboard.Clear();
    clipboard.held = false;
    EXPECT_EQ(clipboard.Read(1), "text");
}

TEST(ErrorList, KeepsEveryReport) {
    ErrorList errors;
    errors.Unhandled(frame::ControlError(13), "A.Click");
    ASSERT_EQ(errors.reports.size(), 1u);
    EXPECT_EQ(errors.reports[0].error.Number(), 13);
    EXPECT_EQ(errors.reports[0].where, "A.Click");
}

}  // namespace
}  // namespace tessel::headless
