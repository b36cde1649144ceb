#include "frame/Text.h"

#include <algorithm>
#include <array>
#include <cassert>
#include <charconv>

namespace tessel::frame {

namespace {

constexpr char32_t asciiEnd = 0x80;
constexpr char32_t lastCharacter = 0x10FFFF;
constexpr char32_t replacementCharacter = 0xFFFD;

/// Every `stride`-th character from `first` to `last` folds to itself plus `delta`.
struct FoldRange {
    char32_t first;
    char32_t last;
    std::uint32_t stride;
    std::int32_t delta;
};

#include "frame/CaseFolding.inc"

constexpr bool IsOutOfOrder(const FoldRange& range, const FoldRange& next) { return range.last >= next.first; }
static_assert(std::adjacent_find(foldRanges.begin(), foldRanges.end(), IsOutOfOrder) == foldRanges.end());

constexpr unsigned char Byte(char unit) { return static_cast<unsigned char>(unit); }
constexpr bool IsAscii(char unit) { return Byte(unit) < asciiEnd; }
constexpr bool IsContinuation(char unit) { return (Byte(unit) & 0xC0) == 0x80; }
constexpr bool IsSurrogate(char32_t character) { return character >= 0xD800 && character <= 0xDFFF; }
constexpr bool IsEscapedByte(char32_t character) {
    return character >= escapedByteBase + 0x80 && character <= escapedByteBase + 0xFF;
}

constexpr char32_t FoldAscii(char32_t character) {
    return character >= U'A' && character <= U'Z' ? character + (U'a' - U'A') : character;
}

/// The number of bytes of the sequence that `lead` begins; 0 for a byte that begins none.
constexpr std::size_t SequenceLength(unsigned char lead) {
    if (lead < 0xC0) return 0;
    if (lead < 0xE0) return 2;
    if (lead < 0xF0) return 3;
    return lead < 0xF8 ? 4 : 0;
}

constexpr bool IsSequenceValid(char32_t character, std::size_t length) {
    constexpr std::array<char32_t, 5> smallestOfLength = {0, 0, 0x80, 0x800, 0x10000};
    return character >= smallestOfLength[length] && character <= lastCharacter && !IsSurrogate(character);
}

char32_t NextFolded(std::string_view text, std::size_t& position) {
    if (IsAscii(text[position])) return FoldAscii(Byte(text[position++]));
    return FoldCase(NextCharacter(text, position));
}

/// Orders before every character.
constexpr std::int32_t ended = -1;

std::int32_t NextFoldedOrEnded(std::string_view text, std::size_t& position) {
    return position < text.size() ? static_cast<std::int32_t>(NextFolded(text, position)) : ended;
}

/// The folded characters of two texts at the first place where they differ; both `ended` where they do not.
struct Difference {
    std::int32_t a;
    std::int32_t b;
};

Difference FirstDifference(std::string_view a, std::string_view b) {
    std::size_t positionA = 0;
    std::size_t positionB = 0;
    for (;;) {
        const std::int32_t characterA = NextFoldedOrEnded(a, positionA);
        const std::int32_t characterB = NextFoldedOrEnded(b, positionB);
        if (characterA != characterB || characterA == ended) return {characterA, characterB};
    }
}

}  // namespace

char32_t NextCharacter(std::string_view text, std::size_t& position) {
    assert(position < text.size());
    const std::size_t start = position++;
    const unsigned char lead = Byte(text[start]);
    if (lead < asciiEnd) return lead;

    const std::size_t length = SequenceLength(lead);
    if (length == 0 || length > text.size() - start) return escapedByteBase + lead;
    char32_t character = lead & (0x7Fu >> length);
    for (std::size_t i = 1; i < length; ++i) {
        if (!IsContinuation(text[start + i])) return escapedByteBase + lead;
        character = character << 6 | (Byte(text[start + i]) & 0x3Fu);
    }
    if (!IsSequenceValid(character, length)) return escapedByteBase + lead;
    position = start + length;
    return character;
}

void AppendCharacter(std::string& text, char32_t character) {
    const auto append = [&text](char32_t unit) { text.push_back(static_cast<char>(unit)); };
    const auto appendContinuation = [&](int shift) { append(0x80 | (character >> shift & 0x3F)); };

    if (character < asciiEnd) return append(character);
    if (IsEscapedByte(character)) return append(character - escapedByteBase);
    if (IsSurrogate(character) || character > lastCharacter) character = replacementCharacter;
    if (character < 0x800) {
        append(0xC0 | character >> 6);
    } else if (character < 0x10000) {
        append(0xE0 | character >> 12);
        appendContinuation(6);
    } else {
        append(0xF0 | character >> 18);
        appendContinuation(12);
        appendContinuation(6);
    }
    appendContinuation(0);
}

bool IsValidUtf8(std::string_view text) {
    for (std::size_t position = 0; position < text.size();) {
        if (IsAscii(text[position])) {
            ++position;
        } else if (IsEscapedByte(NextCharacter(text, position))) {
            return false;
        }
    }
    return true;
}

std::size_t CharacterCount(std::string_view text) {
    std::size_t count = 0;
    for (std::size_t position = 0; position < text.size(); ++count) {
        if (IsAscii(text[position])) {
            ++position;
        } else {
            NextCharacter(text, position);
        }
    }
    return count;
}

char32_t FoldCase(char32_t character) {
    if (character < asciiEnd) return FoldAscii(character);
    const auto range = std::lower_bound(foldRanges.begin(), foldRanges.end(), character,
                                        [](const FoldRange& candidate, char32_t wanted) { return candidate.last < wanted; });
    if (range == foldRanges.end() || character < range->first) return character;
    if ((character - range->first) % range->stride != 0) return character;
    return static_cast<char32_t>(static_cast<std::int32_t>(character) + range->delta);
}

std::string FoldCase(std::string_view text) {
    std::string folded;
    folded.reserve(text.size());
    for (std::size_t position = 0; position < text.size();) AppendCharacter(folded, NextFolded(text, position));
    return folded;
}

bool EqualsNoCase(std::string_view a, std::string_view b) {
    const Difference difference = FirstDifference(a, b);
    return difference.a == difference.b;
}

int CompareNoCase(std::string_view a, std::string_view b) {
    const Difference difference = FirstDifference(a, b);
    return difference.a - difference.b;
}

bool StartsWithNoCase(std::string_view text, std::string_view start) { return FirstDifference(text, start).b == ended; }

std::size_t HashNoCase::operator()(std::string_view text) const {
    // FNV-1a, by folded characters instead of bytes.
    constexpr std::uint64_t offsetBasis = 0xCBF29CE484222325u;
    constexpr std::uint64_t prime = 0x100000001B3u;
    std::uint64_t hash = offsetBasis;
    for (std::size_t position = 0; position < text.size();) hash = (hash ^ NextFolded(text, position)) * prime;
    return static_cast<std::size_t>(hash);
}

std::string_view TrimBlanks(std::string_view text) {
    const std::size_t first = text.find_first_not_of(' ');
    if (first == std::string_view::npos) return text.substr(text.size());
    return text.substr(first, text.find_last_not_of(' ') - first + 1);
}

namespace {

constexpr char32_t strictEscapeBase = 0x10FF00;

constexpr bool IsStrictEscape(char32_t character) {
    return character >= strictEscapeBase + 0x80 && character <= strictEscapeBase + 0xFF;
}

}  // namespace

std::string ToStrictUtf8(std::string_view text) {
    std::string strict;
    for (std::size_t position = 0; position < text.size();) {
        const std::size_t start = position;
        const char32_t character = NextCharacter(text, position);
        const bool invalid = character >= escapedByteBase + 0x80 && character <= escapedByteBase + 0xFF;
        if (!invalid && !IsStrictEscape(character)) {
            strict.append(text.substr(start, position - start));
            continue;
        }
        for (std::size_t i = start; i < position; ++i)
            AppendCharacter(strict, strictEscapeBase + static_cast<unsigned char>(text[i]));
    }
    return strict;
}

std::string FromStrictUtf8(std::string_view strict) {
    std::string text;
    for (std::size_t position = 0; position < strict.size();) {
        const std::size_t start = position;
        const char32_t character = NextCharacter(strict, position);
        if (IsStrictEscape(character))
            text += static_cast<char>(character - strictEscapeBase);
        else
            text.append(strict.substr(start, position - start));
    }
    return text;
}

std::string Decimal(std::int64_t value) {
    std::array<char, 20> digits{};  // the sign and 19 digits of the smallest value
    const auto written = std::to_chars(digits.data(), digits.data() + digits.size(), value);
    return std::string(digits.data(), written.ptr);
}

}  // namespace tessel::frame
