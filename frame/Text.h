#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

/// Text is UTF-8 throughout. Bytes that are no valid UTF-8 (a name from a disk) are carried along unchanged:
/// each such byte counts as one character of its own that equals only itself.
namespace tessel::frame {

/// The character that stands for one byte that is no part of valid UTF-8: 0xDC80 to 0xDCFF for the bytes 0x80 to 0xFF.
/// These code points cannot appear in valid UTF-8, so that the mapping is reversible.
constexpr char32_t escapedByteBase = 0xDC00;

/// Reads the character that begins at `position` of `text` and moves `position` behind it.
/// Overlong forms, surrogates and values above 0x10FFFF are not valid: their first byte is given as an escaped byte.
/// `position` must be below `text.size()`.
char32_t NextCharacter(std::string_view text, std::size_t& position);

/// Appends a character as UTF-8; an escaped byte becomes that byte again. Any other surrogate and a value above 0x10FFFF
/// have no form in UTF-8: U+FFFD is appended in their place.
void AppendCharacter(std::string& text, char32_t character);

bool IsValidUtf8(std::string_view text);

/// The number of characters (code points, and invalid bytes) of a text.
std::size_t CharacterCount(std::string_view text);

/// The simple case folding of the Unicode character database (status C and S), without any locale: one character always
/// folds to one character, so that U+00DF does not equal "ss" and U+0130 folds to itself. An escaped byte folds to itself.
/// Folding again changes nothing. The folded text may have other lengths in bytes than the given one.
char32_t FoldCase(char32_t character);
std::string FoldCase(std::string_view text);

/// Whether two texts are equal without regard to case, by `FoldCase` of each character. Allocates nothing.
bool EqualsNoCase(std::string_view a, std::string_view b);

/// Below, at or above 0 as `a` orders before, with or behind `b` without regard to case: by the folded code points;
/// an invalid byte as its escaped byte, thus before U+E000. Allocates nothing.
int CompareNoCase(std::string_view a, std::string_view b);

/// Whether `text` begins with the characters of `start`, without regard to case. Every text begins with the empty one.
/// The first byte of a longer valid sequence is not its beginning. Allocates nothing.
bool StartsWithNoCase(std::string_view text, std::string_view start);

/// A hash that is equal for texts that `EqualsNoCase` calls equal, the same on every run. Not hardened against
/// names that were chosen to collide. For use with the comparison below in hashed containers.
struct HashNoCase {
    using is_transparent = void;
    std::size_t operator()(std::string_view text) const;
};
struct EqualNoCase {
    using is_transparent = void;
    bool operator()(std::string_view a, std::string_view b) const { return EqualsNoCase(a, b); }
};

/// The text without blanks (0x20, no tabs and no other white space) at its two ends: a part of `text`, nothing is copied.
std::string_view TrimBlanks(std::string_view text);

/// A text as valid UTF-8, for worlds that know no other (JSON, a toolkit's strings): each byte that is no part of valid UTF-8
/// becomes one of the characters U+10FF80 to U+10FFFF. `FromStrictUtf8` brings back exactly the text that went in, those
/// characters themselves included.
std::string ToStrictUtf8(std::string_view text);
std::string FromStrictUtf8(std::string_view strict);

/// An integer in decimal digits, with "-" before a negative one and without any grouping.
std::string Decimal(std::int64_t value);

}  // namespace tessel::frame
