#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>

#include "controls/fileview/FilterMatch.h"
#include "frame/Text.h"

/// Any name against any pattern: the two stand in the input one behind the other, parted by a line feed. What must hold whatever
/// they are: a star in front finds what stood behind anything, and case changes nothing.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using tessel::controls::FilterMatch;
    const std::string_view input(reinterpret_cast<const char*>(data), size);
    const std::size_t end = input.find('\n');
    const std::string_view name = input.substr(0, end);
    const std::string_view pattern = end == std::string_view::npos ? std::string_view() : input.substr(end + 1);

    const bool matches = FilterMatch(name, pattern);
    if (FilterMatch(tessel::frame::FoldCase(name), tessel::frame::FoldCase(pattern)) != matches) std::abort();
    if (!FilterMatch(name, "*")) std::abort();
    if (matches && !FilterMatch(name, "*" + std::string(pattern))) std::abort();
    if (pattern.find_first_of("*?#[") == std::string_view::npos && !pattern.empty() &&
        matches != tessel::frame::EqualsNoCase(name, pattern))
        std::abort();
    return 0;
}
