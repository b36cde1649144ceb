#include "frame/Windows1252.h"

#include <algorithm>
#include <array>

#include "frame/Text.h"

namespace tessel::frame {

namespace {

/// The characters of the bytes 0x80 to 0x9F. The five that have none stand for the control characters of their number, so that
/// every file comes back as it was.
constexpr std::array<char32_t, 32> windows1252Upper = {
    0x20AC, 0x81,   0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160, 0x2039, 0x0152, 0x8D, 0x017D, 0x8F,
    0x90,   0x2018, 0x2019, 0x201C, 0x201D, 0x2022, 0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x9D, 0x017E, 0x0178};
constexpr char32_t upperStart = 0x80, upperEnd = 0xA0, codePageEnd = 0x100;

std::optional<char> NarrowOf(char32_t character) {
    if (character < upperStart || (character >= upperEnd && character < codePageEnd)) return static_cast<char>(character);
    const auto found = std::find(windows1252Upper.begin(), windows1252Upper.end(), character);
    if (found == windows1252Upper.end()) return std::nullopt;
    return static_cast<char>(upperStart + static_cast<char32_t>(found - windows1252Upper.begin()));
}

}  // namespace

std::optional<std::string> Windows1252::ToNarrow(std::string_view text) {
    std::string bytes;
    for (std::size_t position = 0; position < text.size();) {
        const auto byte = NarrowOf(NextCharacter(text, position));
        if (!byte) return std::nullopt;
        bytes += *byte;
    }
    return bytes;
}

std::string Windows1252::FromNarrow(std::string_view bytes) {
    std::string text;
    for (const char byte : bytes) {
        const auto code = static_cast<char32_t>(static_cast<unsigned char>(byte));
        const bool upper = code >= upperStart && code < upperEnd;
        AppendCharacter(text, upper ? windows1252Upper[code - upperStart] : code);
    }
    return text;
}

}  // namespace tessel::frame
