#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "frame/Variant.h"

namespace tessel::frame {

/// A moment taken apart, by the Gregorian calendar. Years 100 to 9999.
struct DateParts {
    int year = 1899, month = 12, day = 30;
    int hour = 0, minute = 0, second = 0;
    friend bool operator==(const DateParts&, const DateParts&) = default;
};

/// Error 5 for parts that name no moment (month 13, second 60).
Date DateFrom(const DateParts& parts);
/// Rounded to the nearest second. Error 6 for a moment outside the years 100 to 9999, NaN included.
DateParts PartsOf(Date date);

/// Reads "2/3/2001", "2/3/2001 4:05:06 AM", "2/3/2001 16:05", "4:05 PM", "2001-02-03 04:05:06" and "2001-02-03T04:05:06" (month
/// before day where slashes part them, blanks at the ends allowed). Nothing when the text is no date.
std::optional<Date> ParseDate(std::string_view text);

/// "2/3/2001 4:05:06 AM"; a date at midnight without its time, a time on day 0 without its date.
std::string DateText(Date date);
/// "2001-02-03 04:05:06", which orders as the moments do.
std::string SortableDateText(Date date);

}  // namespace tessel::frame
