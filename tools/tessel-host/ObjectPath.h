#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "frame/Variant.h"

namespace tessel::tools {

/// One step of an object path: `ListItems(3)`, `Nodes("C:\x")`, `Label1`.
struct PathStep {
    std::string_view name;
    std::optional<frame::Variant> key;  ///< what stands in parentheses: a number or a quoted key
    std::string_view whole;             ///< the step as it stands, "picHandle(0)"
};

/// Takes a path apart at its points. A quoted key ends at the first quote that a closing parenthesis and then a point or the
/// end follow; inside it nothing is escaped. Error 5 for a path that is none.
std::vector<PathStep> ParseObjectPath(std::string_view path);

}  // namespace tessel::tools
