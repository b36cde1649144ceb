#pragma once

#include <functional>

#include "frame/Variant.h"
#include "hosts/headless/MemoryDisk.h"
#include "tools/tessel-host/Json.h"

namespace tessel::tools {

/// Carries out a `disk` request: sets up the memory disk, takes away, limits the free space, or lists. `read` turns JSON into a
/// value.
Json CarryOutDisk(headless::MemoryDisk& disk, const Json& request, const std::function<frame::Variant(const Json&)>& read);

}  // namespace tessel::tools
