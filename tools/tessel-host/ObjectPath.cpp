#include "tools/tessel-host/ObjectPath.h"

#include <charconv>

#include "frame/Error.h"

namespace tessel::tools {

namespace {

[[noreturn]] void Malformed(std::string_view path) {
    throw frame::ControlError(frame::errors::invalidCall, "No object path: " + std::string(path));
}

/// The end of the key that begins behind the opening parenthesis at `open`: the place of its closing parenthesis.
std::size_t ClosingOf(std::string_view path, std::size_t open) {
    const bool quoted = open + 1 < path.size() && path[open + 1] == '"';
    for (std::size_t at = path.find(')', open + 1); at != std::string_view::npos; at = path.find(')', at + 1)) {
        const bool ends = at + 1 == path.size() || path[at + 1] == '.';
        if (ends && (!quoted || (at > open + 2 && path[at - 1] == '"'))) return at;
    }
    Malformed(path);
}

frame::Variant KeyFrom(std::string_view path, std::string_view text) {
    if (text.size() >= 2 && text.front() == '"') return text.substr(1, text.size() - 2);
    std::int32_t number = 0;
    const auto read = std::from_chars(text.data(), text.data() + text.size(), number);
    if (read.ec != std::errc() || read.ptr != text.data() + text.size()) Malformed(path);
    return number;
}

}  // namespace

std::vector<PathStep> ParseObjectPath(std::string_view path) {
    std::vector<PathStep> steps;
    for (std::size_t start = 0;;) {
        const std::size_t nameEnd = std::min(path.find_first_of(".(", start), path.size());
        PathStep step{path.substr(start, nameEnd - start), std::nullopt, {}};
        if (step.name.empty()) Malformed(path);
        std::size_t end = nameEnd;
        if (end < path.size() && path[end] == '(') {
            const std::size_t close = ClosingOf(path, end);
            step.key = KeyFrom(path, path.substr(end + 1, close - end - 1));
            end = close + 1;
        }
        step.whole = path.substr(start, end - start);
        steps.push_back(std::move(step));
        if (end == path.size()) return steps;
        start = end + 1;  // behind the point
    }
}

}  // namespace tessel::tools
