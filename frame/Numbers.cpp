#include "frame/Numbers.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <system_error>

#include "frame/Error.h"
#include "frame/Text.h"

namespace tessel::frame {

namespace {

constexpr std::string_view decimalDigits = "0123456789";

/// A decimal number without its sign, as 0.d1d2d3... times ten to the `place`, where d1 is not 0.
class DecimalNumber {
  public:
    void AddWhole(std::string_view digits) {
        for (const char digit : digits) {
            if (!Begun() && digit == '0') continue;
            text_ += digit;
            ++place_;
        }
    }
    void AddFraction(std::string_view digits) {
        for (const char digit : digits) {
            if (!Begun() && digit == '0')
                --place_;
            else
                text_ += digit;
        }
    }
    void AddExponent(std::int64_t exponent) { place_ += exponent; }

    /// Only places that a double can nearly have reach `from_chars`: it cuts off exponents of many digits.
    double Value() const {
        constexpr std::int64_t placesOfDouble = 400;
        if (!Begun() || place_ < -placesOfDouble) return 0;
        if (place_ > placesOfDouble) throw ControlError(errors::overflow);
        const std::string text = text_ + 'e' + Decimal(place_);
        double value = 0;
        const auto read = std::from_chars(text.data(), text.data() + text.size(), value);
        if (read.ec != std::errc::result_out_of_range && std::isfinite(value)) return value;
        if (place_ > 0) throw ControlError(errors::overflow);
        return 0;
    }

  private:
    static constexpr std::string_view start = "0.";
    bool Begun() const { return text_.size() > start.size(); }

    std::string text_{start};
    std::int64_t place_ = 0;
};

/// Held below a bound that no length of a text reaches, so that adding the places of the digits cannot overflow.
std::int64_t ReadExponent(TextCursor& cursor) {
    constexpr std::int64_t bound = 1'000'000'000'000'000;
    const bool negative = cursor.TakeOneOf("+-") == '-';
    const std::string_view digits = cursor.TakeDigits();
    if (digits.empty()) throw ControlError(errors::typeMismatch);
    std::int64_t exponent = 0;
    for (const char digit : digits) exponent = std::min(exponent * 10 + (digit - '0'), bound);
    return negative ? -exponent : exponent;
}

double ReadDecimal(std::string_view text) {
    TextCursor cursor(text);
    const bool currency = cursor.Take('$');
    char sign = cursor.TakeOneOf("+-(");
    if (!currency) cursor.Take('$');

    DecimalNumber number;
    const std::string_view whole = cursor.TakeDigits();
    number.AddWhole(whole);
    while (!whole.empty() && cursor.Take(',')) number.AddWhole(cursor.TakeDigits());
    const std::string_view fraction = cursor.Take('.') ? cursor.TakeDigits() : std::string_view();
    number.AddFraction(fraction);
    if (whole.empty() && fraction.empty()) throw ControlError(errors::typeMismatch);
    if (cursor.TakeOneOf("eEdD")) number.AddExponent(ReadExponent(cursor));

    if (!sign)
        sign = cursor.TakeOneOf("+-");
    else if (sign == '(' && !cursor.Take(')'))
        throw ControlError(errors::typeMismatch);
    if (!cursor.AtEnd()) throw ControlError(errors::typeMismatch);
    const double value = number.Value();
    return sign == '-' || sign == '(' ? -value : value;
}

/// Reads what follows the "&".
std::uint32_t ReadLiteral(std::string_view text) {
    TextCursor cursor(text);
    const char mark = cursor.TakeOneOf("hHoO");
    if (!mark) throw ControlError(errors::typeMismatch);
    const int base = mark == 'h' || mark == 'H' ? 16 : 8;
    const char* const end = text.data() + text.size();
    std::uint32_t bits = 0;
    const auto read = std::from_chars(text.data() + 1, end, bits, base);
    const std::string_view rest(read.ptr, static_cast<std::size_t>(end - read.ptr));
    if (read.ec == std::errc::invalid_argument || !(rest.empty() || rest == "&")) throw ControlError(errors::typeMismatch);
    if (read.ec == std::errc::result_out_of_range) throw ControlError(errors::overflow);
    return bits;
}

template <class Float>
std::string TextOf(Float value, int digits) {
    if (std::isnan(value)) return "NaN";
    if (std::isinf(value)) return value < 0 ? "-Infinity" : "Infinity";
    if (value == 0) return "0";
    std::array<char, 32> buffer{};
    char* const end = std::to_chars(buffer.data(), buffer.data() + buffer.size(), value, std::chars_format::general, digits).ptr;
    std::replace(buffer.data(), end, 'e', 'E');
    return std::string(buffer.data(), end);
}

}  // namespace

TextNumber ReadNumber(std::string_view text) {
    constexpr std::string_view blanks = " \t";
    const std::size_t first = text.find_first_not_of(blanks);
    if (first == std::string_view::npos) throw ControlError(errors::typeMismatch);
    text = text.substr(first, text.find_last_not_of(blanks) - first + 1);
    if (text.front() == '&') return ReadLiteral(text.substr(1));
    return ReadDecimal(text);
}

double ReadDouble(std::string_view text) {
    const TextNumber number = ReadNumber(text);
    if (const auto* bits = std::get_if<std::uint32_t>(&number)) return static_cast<std::int32_t>(*bits);
    return std::get<double>(number);
}

std::string NumberText(double value) { return TextOf(value, 15); }
std::string NumberText(float value) { return TextOf(value, 7); }

char TextCursor::TakeOneOf(std::string_view characters) {
    if (rest_.empty() || characters.find(rest_.front()) == std::string_view::npos) return 0;
    const char taken = rest_.front();
    rest_.remove_prefix(1);
    return taken;
}

std::string_view TextCursor::TakeDigits() {
    const std::string_view digits = rest_.substr(0, rest_.find_first_not_of(decimalDigits));
    rest_.remove_prefix(digits.size());
    return digits;
}

}  // namespace tessel::frame
