#pragma once

#include <span>
#include <string_view>

#include "frame/Control.h"

namespace tessel::controls {

/// Every class of controls that the library has, in the order of their names. Tools, designers and sweep tests walk it.
std::span<const frame::ControlClass> ControlClasses();

/// The class of that name, in any case; null when there is none.
const frame::ControlClass* FindControlClass(std::string_view name);

}  // namespace tessel::controls
