#include "controls/fileview/FilterMatch.h"

#include "frame/Text.h"

namespace tessel::controls {

namespace {

bool IsAscii(char unit) { return static_cast<unsigned char>(unit) < 0x80; }
char LowerAscii(char unit) { return unit >= 'A' && unit <= 'Z' ? static_cast<char>(unit - 'A' + 'a') : unit; }

/// The pattern ends in plain characters that the name does not end in: most names of a folder are passed over by that alone.
/// False says nothing.
bool EndsOtherwise(std::string_view name, std::string_view pattern) {
    constexpr std::string_view special = "*?#[]";
    for (std::size_t inName = name.size(), inPattern = pattern.size(); inPattern > 0; --inName, --inPattern) {
        const char element = pattern[inPattern - 1];
        if (!IsAscii(element) || special.find(element) != std::string_view::npos) return false;
        if (inName == 0) return true;
        const char character = name[inName - 1];
        if (!IsAscii(character)) return false;  // it may fold to an ASCII character
        if (LowerAscii(character) != LowerAscii(element)) return true;
    }
    return false;
}

/// As `frame::NextCharacter`, which need not be called for most.
char32_t NextCharacter(std::string_view text, std::size_t& place) {
    return IsAscii(text[place]) ? static_cast<unsigned char>(text[place++]) : frame::NextCharacter(text, place);
}

bool SameCharacter(char32_t a, char32_t b) { return a == b || frame::FoldCase(a) == frame::FoldCase(b); }

bool Has(std::string_view list, char32_t character) {
    for (std::size_t place = 0; place < list.size();)
        if (SameCharacter(NextCharacter(list, place), character)) return true;
    return false;
}

/// Whether the element of the pattern at `place`, which is no `*`, takes the character; `place` moves behind the element.
bool Takes(std::string_view pattern, std::size_t& place, char32_t character) {
    const char32_t element = NextCharacter(pattern, place);
    if (element == U'?') return true;
    if (element == U'#') return character >= U'0' && character <= U'9';
    const std::size_t end = element == U'[' ? pattern.find(']', place) : std::string_view::npos;
    if (end == std::string_view::npos) return SameCharacter(element, character);
    std::string_view list = pattern.substr(place, end - place);
    place = end + 1;
    const bool outside = list.starts_with('!');
    if (outside) list.remove_prefix(1);
    return Has(list, character) != outside;
}

}  // namespace

// Whatever a run took before the last `*` can stay as it is: only that last one is ever made longer.
bool FilterMatch(std::string_view name, std::optional<std::string_view> given) {
    const std::string_view pattern = given.value_or(std::string_view());
    if (pattern.empty()) return true;
    if (EndsOtherwise(name, pattern)) return false;
    std::size_t inName = 0, inPattern = 0;
    std::optional<std::size_t> behindRun;
    std::size_t runEnd = 0;
    while (inName < name.size()) {
        if (inPattern < pattern.size() && pattern[inPattern] == '*') {
            behindRun = ++inPattern;
            runEnd = inName;
            continue;
        }
        std::size_t next = inName;
        const char32_t character = NextCharacter(name, next);
        if (inPattern < pattern.size() && Takes(pattern, inPattern, character)) {
            inName = next;
        } else if (behindRun) {
            (void)NextCharacter(name, runEnd);
            inName = runEnd;
            inPattern = *behindRun;
        } else {
            return false;
        }
    }
    return pattern.find_first_not_of('*', inPattern) == std::string_view::npos;
}

}  // namespace tessel::controls
