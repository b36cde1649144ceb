#pragma once

#include <optional>
#include <string_view>

namespace tessel::controls {

/// Whether a name matches a whole pattern, without regard to case. `*` stands for any run of characters, `?` for one character,
/// `#` for one digit, `[list]` for one character of the list, `[!list]` for one outside it. Every name matches a pattern that is
/// missing or empty.
///
/// A list ends at the first `]` and has no ranges: a hyphen is a character like any other. No character is in an empty list. A `[`
/// that no `]` closes stands for itself.
bool FilterMatch(std::string_view name, std::optional<std::string_view> pattern = {});

}  // namespace tessel::controls
