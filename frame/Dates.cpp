#include "frame/Dates.h"

#include <array>
#include <chrono>
#include <cmath>

#include "frame/Error.h"
#include "frame/Numbers.h"
#include "frame/Text.h"

namespace tessel::frame {

namespace {

namespace calendar = std::chrono;

constexpr int secondsPerDay = 86'400;
constexpr int firstYear = 100, lastYear = 9999;
constexpr calendar::sys_days dayZero{calendar::year(1899) / 12 / 30};

constexpr int DayNumber(calendar::year_month_day day) { return static_cast<int>((calendar::sys_days{day} - dayZero).count()); }
constexpr int firstDay = DayNumber(calendar::year(firstYear) / 1 / 1);
constexpr int lastDay = DayNumber(calendar::year(lastYear) / 12 / 31);

constexpr bool Within(int value, int least, int most) { return least <= value && value <= most; }

calendar::year_month_day DayOf(const DateParts& parts) {
    return calendar::year(parts.year) / calendar::month(static_cast<unsigned>(parts.month)) /
           calendar::day(static_cast<unsigned>(parts.day));
}

bool IsMoment(const DateParts& parts) {
    return Within(parts.year, firstYear, lastYear) && Within(parts.month, 1, 12) && Within(parts.day, 1, 31) && DayOf(parts).ok() &&
           Within(parts.hour, 0, 23) && Within(parts.minute, 0, 59) && Within(parts.second, 0, 59);
}

/// `digits` of them at most, so that no text overflows the number.
std::optional<int> ReadPart(TextCursor& cursor, std::size_t leastDigits, std::size_t mostDigits) {
    const std::string_view digits = cursor.TakeDigits();
    if (digits.size() < leastDigits || digits.size() > mostDigits) return std::nullopt;
    int value = 0;
    for (const char digit : digits) value = value * 10 + (digit - '0');
    return value;
}

/// One or two digits: a month, a day, a part of a time.
std::optional<int> ReadShort(TextCursor& cursor) { return ReadPart(cursor, 1, 2); }
std::optional<int> ReadYear(TextCursor& cursor) { return ReadPart(cursor, 3, 4); }

void SkipBlanks(TextCursor& cursor) {
    while (cursor.Take(' ')) {
    }
}

/// "2/3/2001".
bool ReadSlashedDay(TextCursor& cursor, DateParts& parts) {
    const auto month = ReadShort(cursor);
    if (!month || !cursor.Take('/')) return false;
    const auto day = ReadShort(cursor);
    if (!day || !cursor.Take('/')) return false;
    const auto year = ReadYear(cursor);
    if (!year) return false;
    parts.year = *year;
    parts.month = *month;
    parts.day = *day;
    return true;
}

/// "2001-02-03".
bool ReadDashedDay(TextCursor& cursor, DateParts& parts) {
    const auto year = ReadYear(cursor);
    if (!year || !cursor.Take('-')) return false;
    const auto month = ReadShort(cursor);
    if (!month || !cursor.Take('-')) return false;
    const auto day = ReadShort(cursor);
    if (!day) return false;
    parts.year = *year;
    parts.month = *month;
    parts.day = *day;
    return true;
}

/// "AM" and "PM" in any case move the hour, which is 1 to 12 then; without them it stays.
bool ReadHalfOfDay(TextCursor& cursor, int& hour) {
    SkipBlanks(cursor);
    const char half = cursor.TakeOneOf("aApP");
    if (!half) return true;
    if (!cursor.TakeOneOf("mM") || !Within(hour, 1, 12)) return false;
    const bool afternoon = half == 'p' || half == 'P';
    hour = hour % 12 + (afternoon ? 12 : 0);
    return true;
}

/// "16:05", "4:05:06 AM".
bool ReadTime(TextCursor& cursor, DateParts& parts) {
    const auto hour = ReadShort(cursor);
    if (!hour || !cursor.Take(':')) return false;
    const auto minute = ReadShort(cursor);
    if (!minute) return false;
    const auto second = cursor.Take(':') ? ReadShort(cursor) : 0;
    if (!second) return false;
    parts.hour = *hour;
    parts.minute = *minute;
    parts.second = *second;
    return ReadHalfOfDay(cursor, parts.hour);
}

bool ReadMoment(TextCursor& cursor, bool slashed, DateParts& parts) {
    if (!(slashed ? ReadSlashedDay(cursor, parts) : ReadDashedDay(cursor, parts))) return false;
    if (cursor.AtEnd()) return true;
    if (cursor.Take(' '))
        SkipBlanks(cursor);
    else if (slashed || !cursor.Take('T'))
        return false;
    return ReadTime(cursor, parts);
}

std::string Padded(int value, std::size_t digits) {
    const std::string text = Decimal(value);
    return text.size() < digits ? std::string(digits - text.size(), '0') + text : text;
}

std::string DayText(const DateParts& parts) { return Decimal(parts.month) + '/' + Decimal(parts.day) + '/' + Decimal(parts.year); }

std::string TimeText(const DateParts& parts) {
    const int hour = parts.hour % 12 == 0 ? 12 : parts.hour % 12;
    return Decimal(hour) + ':' + Padded(parts.minute, 2) + ':' + Padded(parts.second, 2) + (parts.hour < 12 ? " AM" : " PM");
}

}  // namespace

Date DateFrom(const DateParts& parts) {
    if (!IsMoment(parts)) throw ControlError(errors::invalidCall);
    const int day = DayNumber(DayOf(parts));
    const double time = (parts.hour * 3600 + parts.minute * 60 + parts.second) / static_cast<double>(secondsPerDay);
    return {day < 0 ? day - time : day + time};
}

DateParts PartsOf(Date date) {
    if (!(date.days > firstDay - 1 && date.days < lastDay + 1)) throw ControlError(errors::overflow);
    int day = static_cast<int>(date.days);
    int second = static_cast<int>(std::lround(std::abs(date.days - day) * secondsPerDay));
    if (second == secondsPerDay) {
        second = 0;
        ++day;
    }
    if (day > lastDay) throw ControlError(errors::overflow);
    const calendar::year_month_day found{dayZero + calendar::days(day)};
    return {static_cast<int>(found.year()),
            static_cast<int>(static_cast<unsigned>(found.month())),
            static_cast<int>(static_cast<unsigned>(found.day())),
            second / 3600,
            second / 60 % 60,
            second % 60};
}

std::optional<Date> ParseDate(std::string_view text) {
    const std::string_view trimmed = TrimBlanks(text);
    const std::size_t firstMark = trimmed.find_first_of("/-:");
    if (firstMark == std::string_view::npos) return std::nullopt;
    TextCursor cursor(trimmed);
    DateParts parts;
    const bool read = trimmed[firstMark] == ':' ? ReadTime(cursor, parts) : ReadMoment(cursor, trimmed[firstMark] == '/', parts);
    if (!read || !cursor.AtEnd() || !IsMoment(parts)) return std::nullopt;
    return DateFrom(parts);
}

std::string DateText(Date date) {
    const DateParts parts = PartsOf(date);
    const bool onDayZero = DayNumber(DayOf(parts)) == 0;
    const bool atMidnight = parts.hour == 0 && parts.minute == 0 && parts.second == 0;
    if (onDayZero) return TimeText(parts);
    return atMidnight ? DayText(parts) : DayText(parts) + ' ' + TimeText(parts);
}

std::string SortableDateText(Date date) {
    const DateParts parts = PartsOf(date);
    return Padded(parts.year, 4) + '-' + Padded(parts.month, 2) + '-' + Padded(parts.day, 2) + ' ' + Padded(parts.hour, 2) + ':' +
           Padded(parts.minute, 2) + ':' + Padded(parts.second, 2);
}

}  // namespace tessel::frame
