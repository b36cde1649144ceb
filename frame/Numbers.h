#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <variant>

/// Numbers in text, read and written without any locale.
namespace tessel::frame {

/// What a text says: a decimal number, or the 32 bits of a hexadecimal or octal literal.
using TextNumber = std::variant<double, std::uint32_t>;

/// Reads a number. Blanks and tabs at the ends are passed over. "-1,234.5e+2": the sign stands before or behind, or parentheses
/// make the number negative; one "$" stands before or after a leading sign; commas group the digits of the whole part but
/// do not begin it; the exponent is marked by e, E, d or D. "&H1F" and "&O17" are literals and may end with "&".
/// Error 13 for any other text, the empty one included; error 6 for a number too large for its form. One too small is 0.
TextNumber ReadNumber(std::string_view text);

/// The same, where a literal is the signed 32-bit integer of its bits.
double ReadDouble(std::string_view text);

/// At most 15 significant digits (7 for a 32-bit float) without trailing zeros; "1E+15" and "1E-05" where the digits before the
/// point, or the zeros behind it, would be too many. Also "NaN", "Infinity" and "-Infinity", which do not read back.
std::string NumberText(double value);
std::string NumberText(float value);

/// Walks through a text from its start.
class TextCursor {
  public:
    explicit TextCursor(std::string_view text) : rest_(text) {}

    bool AtEnd() const { return rest_.empty(); }
    /// Takes the next character if it is one of `characters`; gives 0 when it is none of them.
    char TakeOneOf(std::string_view characters);
    bool Take(char character) { return TakeOneOf({&character, 1}) != 0; }
    /// Takes all decimal digits that come next.
    std::string_view TakeDigits();

  private:
    std::string_view rest_;
};

}  // namespace tessel::frame
