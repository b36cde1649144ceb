#include "frame/Dates.h"

#include <gtest/gtest.h>

#include <chrono>
#include <cmath>
#include <limits>
#include <random>
#include <string>
#include <vector>

#include "frame/Error.h"

#include "tests/ErrorOf.h"

namespace tessel::frame {
namespace {

using test::ErrorOf;

constexpr double firstDay = -657'434, lastDay = 2'958'465;
constexpr double secondsPerDay = 86'400;

std::string Parsed(std::string_view text) {
    const auto date = ParseDate(text);
    return date ? SortableDateText(*date) : "none";
}

std::string Sortable(double days) { return SortableDateText(Date{days}); }
std::string Shown(double days) { return DateText(Date{days}); }

DateParts RandomParts(std::mt19937& random) {
    const auto from = [&](int least, int most) { return std::uniform_int_distribution(least, most)(random); };
    return {from(100, 9999), from(1, 12), from(1, 28), from(0, 23), from(0, 59), from(0, 59)};
}

TEST(Dates, DayZeroIsTheDayBeforeTheLastOfTheYear1899) {
    EXPECT_EQ(DateFrom({1899, 12, 30}).days, 0);
    EXPECT_EQ(DateFrom({}).days, 0);
    EXPECT_EQ(PartsOf(Date{0}), (DateParts{1899, 12, 30, 0, 0, 0}));
}

TEST(Dates, DaysCountFromDayZeroByTheGregorianCalendar) {
    struct Case {
        DateParts parts;
        double days;
    };
    const Case cases[] = {
        {{1899, 12, 31}, 1},       {{1900, 1, 1}, 2},          {{1899, 12, 29}, -1},    {{1900, 2, 28}, 60},
        {{1900, 3, 1}, 61},        {{1970, 1, 1}, 25'569},     {{2000, 2, 29}, 36'585}, {{2001, 2, 3}, 36'925},
        {{1582, 10, 4}, -115'869}, {{1582, 10, 15}, -115'858}, {{100, 1, 1}, firstDay}, {{9999, 12, 31}, lastDay},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(DateFrom(c.parts).days, c.days);
        EXPECT_EQ(PartsOf(Date{c.days}), c.parts) << c.days;
    }
}

TEST(Dates, DaysFollowOneAnotherThroughTheWholeCalendar) {
    auto day = std::chrono::sys_days{std::chrono::year(100) / 1 / 1};
    for (double days = firstDay; days <= lastDay; days += 97, day += std::chrono::days(97)) {
        const std::chrono::year_month_day expected{day};
        const DateParts parts = PartsOf(Date{days});
        ASSERT_EQ(std::chrono::year(parts.year) / static_cast<unsigned>(parts.month) / static_cast<unsigned>(parts.day), expected)
            << days;
        ASSERT_EQ(DateFrom(parts).days, days);
    }
}

TEST(Dates, TheFractionIsTheTimeOfDay) {
    EXPECT_EQ(Sortable(0.25), "1899-12-30 06:00:00");
    EXPECT_EQ(Sortable(36'925.5), "2001-02-03 12:00:00");
    EXPECT_EQ(DateFrom({2001, 2, 3, 18, 0, 0}).days, 36'925.75);
    EXPECT_EQ(DateFrom({1899, 12, 30, 6, 0, 0}).days, 0.25);
}

TEST(Dates, BeforeDayZeroTheFractionStillCountsForwardFromMidnight) {
    EXPECT_EQ(Sortable(-1.25), "1899-12-29 06:00:00");
    EXPECT_EQ(Sortable(-1.75), "1899-12-29 18:00:00");
    EXPECT_EQ(DateFrom({1899, 12, 29, 6, 0, 0}).days, -1.25);
    EXPECT_EQ(Sortable(-0.25), "1899-12-30 06:00:00");
    EXPECT_EQ(Sortable(-657'434.75), "0100-01-01 18:00:00");
}

TEST(Dates, MomentsRoundToTheNearestSecond) {
    EXPECT_EQ(Sortable(1 + 0.4 / secondsPerDay), "1899-12-31 00:00:00");
    EXPECT_EQ(Sortable(1 + 0.6 / secondsPerDay), "1899-12-31 00:00:01");
    EXPECT_EQ(Sortable(2 - 0.6 / secondsPerDay), "1899-12-31 23:59:59");
}

TEST(Dates, TheLastHalfSecondOfADayRoundsToTheNextMidnight) {
    EXPECT_EQ(Sortable(2 - 0.4 / secondsPerDay), "1900-01-01 00:00:00");
    EXPECT_EQ(Sortable(-2 + 0.4 / secondsPerDay), "1899-12-30 00:00:00");
    EXPECT_EQ(Sortable(-1 + 0.4 / secondsPerDay), "1899-12-31 00:00:00");
}

TEST(Dates, EverySecondOfADayComesBackAsItself) {
    for (const double day : {0.0, 36'925.0, lastDay, -1.0, firstDay}) {
        DateParts parts = PartsOf(Date{day});
        for (int second = 0; second < 86'400; second += 7) {
            parts.hour = second / 3600;
            parts.minute = second / 60 % 60;
            parts.second = second % 60;
            ASSERT_EQ(PartsOf(DateFrom(parts)), parts) << day << " " << second;
        }
    }
}

TEST(Dates, PartsThatNameNoMomentAreError5) {
    const DateParts bad[] = {
        {2001, 13, 1},
        {2001, 0, 1},
        {2001, -1, 1},
        {2001, 1, 0},
        {2001, 1, 32},
        {2001, 2, 29},
        {1900, 2, 29},
        {2001, 4, 31},
        {99, 12, 31},
        {10'000, 1, 1},
        {2001, 1, 1, 24, 0, 0},
        {2001, 1, 1, -1, 0, 0},
        {2001, 1, 1, 0, 60, 0},
        {2001, 1, 1, 0, -1, 0},
        {2001, 1, 1, 0, 0, 60},
        {2001, 1, 1, 0, 0, -1},
        {2001, 257, 1},
        {2001, 1, 257},
        {67'537, 1, 1},
        {2001, 1 - 256, 1},
        {std::numeric_limits<int>::max(), 1, 1},
        {std::numeric_limits<int>::min(), 1, 1},
    };
    for (const DateParts& parts : bad)
        EXPECT_EQ(ErrorOf([&] { DateFrom(parts); }), errors::invalidCall) << parts.year << " " << parts.month << " " << parts.day;
}

TEST(Dates, LeapDaysAreThoseOfTheGregorianCalendar) {
    EXPECT_EQ(ErrorOf([] { DateFrom({2000, 2, 29}); }), 0);
    EXPECT_EQ(ErrorOf([] { DateFrom({2004, 2, 29}); }), 0);
    EXPECT_EQ(ErrorOf([] { DateFrom({2100, 2, 29}); }), errors::invalidCall);
}

TEST(Dates, MomentsOutsideTheYears100To9999AreError6) {
    constexpr double infinity = std::numeric_limits<double>::infinity();
    for (const double days : {firstDay - 1, -657'435.5, lastDay + 1, 3e6, -1e6, 2147483648.0, -2147483649.0, 1e18, -1e18, 1e308,
                              -1e308, infinity, -infinity, std::numeric_limits<double>::quiet_NaN()}) {
        EXPECT_EQ(ErrorOf([&] { PartsOf(Date{days}); }), errors::overflow) << days;
        EXPECT_EQ(ErrorOf([&] { DateText(Date{days}); }), errors::overflow) << days;
        EXPECT_EQ(ErrorOf([&] { SortableDateText(Date{days}); }), errors::overflow) << days;
    }
    EXPECT_EQ(Sortable(firstDay), "0100-01-01 00:00:00");
    EXPECT_EQ(Sortable(lastDay + 86'399 / secondsPerDay), "9999-12-31 23:59:59");
}

TEST(Dates, TheLastMomentDoesNotRoundIntoTheYear10000) {
    EXPECT_EQ(ErrorOf([] { PartsOf(Date{std::nextafter(lastDay + 1, 0.0)}); }), errors::overflow);
}

TEST(Dates, TextShowsTheTwelveHourClock) {
    EXPECT_EQ(Shown(36'925 + (4 * 3600 + 5 * 60 + 6) / secondsPerDay), "2/3/2001 4:05:06 AM");
    EXPECT_EQ(Shown(36'925.5), "2/3/2001 12:00:00 PM");
    EXPECT_EQ(Shown(36'925 + 1 / secondsPerDay), "2/3/2001 12:00:01 AM");
    EXPECT_EQ(Shown(36'925.75), "2/3/2001 6:00:00 PM");
    EXPECT_EQ(Shown(lastDay + 86'399 / secondsPerDay), "12/31/9999 11:59:59 PM");
}

TEST(Dates, TextOfAMidnightHasNoTime) {
    EXPECT_EQ(Shown(36'925), "2/3/2001");
    EXPECT_EQ(Shown(-1), "12/29/1899");
    EXPECT_EQ(Shown(firstDay), "1/1/100");
}

TEST(Dates, TextOfDayZeroHasNoDate) {
    EXPECT_EQ(Shown(0.25), "6:00:00 AM");
    EXPECT_EQ(Shown(-0.25), "6:00:00 AM");
    EXPECT_EQ(Shown(0), "12:00:00 AM");
}

TEST(Dates, SortableTextOrdersAsTheMomentsDo) {
    std::mt19937 random(20010203);
    for (int round = 0; round < 2000; ++round) {
        const DateParts a = RandomParts(random), b = RandomParts(random);
        const auto order = [](const DateParts& p) { return std::vector{p.year, p.month, p.day, p.hour, p.minute, p.second}; };
        ASSERT_EQ(SortableDateText(DateFrom(a)) < SortableDateText(DateFrom(b)), order(a) < order(b));
    }
}

TEST(Dates, AllDocumentedFormsAreRead) {
    struct Case {
        const char *text, *expected;
    };
    const Case cases[] = {
        {"2/3/2001", "2001-02-03 00:00:00"},
        {"02/03/2001", "2001-02-03 00:00:00"},
        {"2/3/2001 4:05:06 AM", "2001-02-03 04:05:06"},
        {"2/3/2001 4:05:06 pm", "2001-02-03 16:05:06"},
        {"2/3/2001 16:05", "2001-02-03 16:05:00"},
        {"2/3/2001   16:05", "2001-02-03 16:05:00"},
        {"4:05 PM", "1899-12-30 16:05:00"},
        {"4:05PM", "1899-12-30 16:05:00"},
        {"16:05:06", "1899-12-30 16:05:06"},
        {"0:00", "1899-12-30 00:00:00"},
        {"12:00 AM", "1899-12-30 00:00:00"},
        {"12:30 am", "1899-12-30 00:30:00"},
        {"12:30 PM", "1899-12-30 12:30:00"},
        {"2001-02-03", "2001-02-03 00:00:00"},
        {"2001-02-03 04:05:06", "2001-02-03 04:05:06"},
        {"2001-02-03T04:05:06", "2001-02-03 04:05:06"},
        {"  2001-02-03  ", "2001-02-03 00:00:00"},
        {" 2/3/2001 4:05 AM ", "2001-02-03 04:05:00"},
        {"1/1/100", "0100-01-01 00:00:00"},
        {"0100-01-01", "0100-01-01 00:00:00"},
        {"12/31/9999 23:59:59", "9999-12-31 23:59:59"},
        {"2/29/2000", "2000-02-29 00:00:00"},
    };
    for (const Case& c : cases) EXPECT_EQ(Parsed(c.text), c.expected) << c.text;
}

TEST(Dates, AnyOtherTextIsNoDate) {
    for (const std::string text : {
             "",
             " ",
             "5",
             "2.5",
             "-1",
             "today",
             "/",
             "-",
             ":",
             "//",
             "--",
             "::",
             "2/3",
             "2/3/",
             "/2/3/2001",
             "2/3/01",
             "2/3/20011",
             "2/3/2001 4",
             "2/3/2001 4:",
             "2/3/2001 4:05:",
             "2/3/2001 4:05:06:07",
             "2/3/2001 4:05 XM",
             "2/3/2001 4:05 A",
             "2/3/2001 4:05 AMM",
             "2/3/2001T04:05:06",
             "2/3/2001  AM",
             "2001-02-03t04:05:06",
             "2001-02-03T",
             "2001-02-03T 04:05",
             "2001-02-0304:05",
             "2001-02",
             "2001-02-03Z",
             "13/1/2001",
             "0/1/2001",
             "2/29/2001",
             "2/30/2000",
             "4/31/2001",
             "1/1/99",
             "1/1/0099",
             "10000-01-01",
             "24:00",
             "23:60",
             "23:59:60",
             "13:00 PM",
             "0:30 AM",
             "12:00 AM PM",
             "4 PM",
             "2/3/-2001",
             "+2/3/2001",
             "2 /3/2001",
             "2/ 3/2001",
             "002/3/2001",
             "2-3-2001",
             "2001/02/03",
             "99999999999999999999/1/2001",
             "1/99999999999999999999/2001",
             "1:99999999999999999999",
             "2/3/2001\t4:05",
             "\xC2\xA0"
             "2/3/2001",
             "2/3/2001\xFF",
         })
        EXPECT_EQ(Parsed(text), "none") << '"' << text << '"';
    EXPECT_EQ(Parsed(std::string_view("2/3/2001\0", 9)), "none");
    EXPECT_EQ(Parsed(std::string(1'000'000, '1') + "/1/2001"), "none");
}

TEST(Dates, EveryTextOfADateReadsBackAsThatDate) {
    std::mt19937 random(18991230);
    for (int round = 0; round < 5000; ++round) {
        DateParts parts = RandomParts(random);
        if (round % 5 == 0) parts.hour = parts.minute = parts.second = 0;
        if (round % 7 == 0) parts.year = 1899, parts.month = 12, parts.day = 30;
        const Date date = DateFrom(parts);
        ASSERT_EQ(ParseDate(DateText(date)), date) << DateText(date);
        ASSERT_EQ(ParseDate(SortableDateText(date)), date) << SortableDateText(date);
    }
}

TEST(Dates, TextMadeOfThePiecesOfDatesIsReadOrRefusedButNeverBreaks) {
    const std::string_view pieces[] = {"1", "12", "31", "100", "2001", "10000", "/",        "-",   ":",
                                       " ", "T",  "AM", "PM",  "+",    "2/3/",  "2001-02-", "4:05"};
    std::mt19937 random(4711);
    int dates = 0;
    for (int round = 0; round < 100'000; ++round) {
        std::string text;
        for (auto left = std::uniform_int_distribution(1, 9)(random); left > 0; --left)
            text += pieces[std::uniform_int_distribution<std::size_t>(0, std::size(pieces) - 1)(random)];
        const auto date = ParseDate(text);
        if (!date) continue;
        ++dates;
        ASSERT_EQ(ParseDate(DateText(*date)), date) << text;
    }
    EXPECT_GT(dates, 400);
}

}  // namespace
}  // namespace tessel::frame
