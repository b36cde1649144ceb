#pragma once

#include <cstdint>
#include <vector>

#include "frame/Color.h"
#include "frame/Drawing.h"
#include "frame/Member.h"

namespace tessel::controls {

/// The lie of a bar: across the form, moving up and down, or upright, moving left and right.
enum class tsOrientation : std::int32_t { tsHorizontal = 0, tsVertical = 1 };

/// How a bar is drawn.
enum class tsAppearance : std::int32_t { tsNone = 0, tsFlat = 1, tsRaised = 2, tsSunken = 3, tsGrooved = 4, tsSerrated = 5 };

namespace splitter {

/// What the drawing of a bar depends on. The size is in pixels.
struct BarLook {
    tsOrientation orientation = tsOrientation::tsHorizontal;
    tsAppearance appearance = tsAppearance::tsGrooved;
    float width = 0, height = 0;
    frame::OLE_COLOR fill, border;
};

/// The lines and boxes of a bar, in their order, in pixels.
std::vector<frame::draw::Line> BarDrawing(const BarLook& look);

}  // namespace splitter
}  // namespace tessel::controls

namespace tessel::controls::names {
inline constexpr frame::Enumeration::Constant orientation[] = {{"tsHorizontal", 0}, {"tsVertical", 1}};
inline constexpr frame::Enumeration tsOrientation{"tsOrientation", orientation};
inline constexpr frame::Enumeration::Constant appearance[] = {{"tsNone", 0},   {"tsFlat", 1},    {"tsRaised", 2},
                                                              {"tsSunken", 3}, {"tsGrooved", 4}, {"tsSerrated", 5}};
inline constexpr frame::Enumeration tsAppearance{"tsAppearance", appearance};
}  // namespace tessel::controls::names

template <>
inline constexpr const tessel::frame::Enumeration* tessel::frame::enumerationOf<tessel::controls::tsOrientation> =
    &tessel::controls::names::tsOrientation;
template <>
inline constexpr const tessel::frame::Enumeration* tessel::frame::enumerationOf<tessel::controls::tsAppearance> =
    &tessel::controls::names::tsAppearance;
