#pragma once

#include <cstdint>
#include <string>

#include "frame/Drawing.h"
#include "frame/Member.h"
#include "frame/Variant.h"

/// Where the parts of a gauge lie, computed without drawing. All lengths are pixels of the picture box.
namespace tessel::controls {

enum class tsGaugeOrientation : std::int32_t { Horizontal = 0, Vertical = 1 };
enum class tsMarkerStyle : std::int32_t { None = 0, ShowLine = 1, ShowBar = 2, ShowFlatBar = 3 };
enum class tsShowValue : std::int32_t { None = 0, AtLeft = 1, AtMiddle = 2, AtRight = 3, AtTop = 4, AtBottom = 5, Adjust = 6 };

/// A number that keeps the type, and the form, in which a saved design gave it.
struct AnyNumber : frame::Variant {
    using Variant::Variant;
    explicit AnyNumber(const Variant& value) : Variant(value) {}
};

/// Whether `a` is below `b`. A 32-bit float meets any other number as such a float, so that a score of 0.7 reaches a threshold of
/// 0.7 whichever of them a saved design brought as 64-bit float. Error 13 for what is no number.
bool IsBelow(const frame::Variant& a, const frame::Variant& b);
/// Not the opposite of `IsBelow` where one is no number to compare: then neither holds.
bool Reaches(const frame::Variant& a, const frame::Variant& b);
bool IsEqual(const frame::Variant& a, const frame::Variant& b);

/// The score as a percentage without decimals, halves away from zero: "50%" for 0.5. What counts is the number as it is written, so
/// that 0.145 is "15%". "NaN%", "Infinity%" and "-Infinity%" for what is no number to round.
std::string PercentText(const frame::Variant& score);

namespace gauge {

/// The bar: the pixel at which the range starts, the one at which it ends, and the extent across.
struct Frame {
    float GaugeStart = 0, GaugeEnd = 0, GaugeBreadth = 0;
    frame::OLE_COLOR GaugeColor;
    bool vertical = false;  ///< grows from the bottom upwards
};
/// `color` is kept as it is.
void Lay(Frame& bar, bool vertical, float scaleWidth, float scaleHeight);

/// The distance of a value from `GaugeStart`, not held within the bar; `maximum` itself for an empty range. Error 6 for one that is
/// too far away for a float.
float PositionOf(const Frame& bar, double value, double minimum, double maximum);

/// The ends, across the bar, of a line of a part of its breadth that is centred on its axis.
struct Across {
    float from = 0, to = 0;
};
Across AcrossOf(const Frame& bar, float fraction);

frame::draw::Line CrossLine(const Frame& bar, float position, Across across, frame::OLE_COLOR color);
/// The box that fills the bar between two positions.
frame::draw::Line Band(const Frame& bar, float from, float to, frame::OLE_COLOR color);
/// The line along the middle of the bar, from its start to its end.
frame::draw::Line Axis(const Frame& bar, frame::OLE_COLOR color);

/// The width of the gaps between so many blocks.
std::int16_t GapWidth(int blocks);

/// The colour of one of the five lines of a raised bar, the first at the least position.
frame::OLE_COLOR RaisedColor(const Frame& bar, int line);

/// Where a text of this size begins. `lowValue` is whether the bar leaves more room behind the value, which is where `Adjust` puts
/// it.
struct Place {
    float x = 0, y = 0;
};
struct Extent {
    float width = 0, height = 0;
};
Place TextPlace(tsShowValue where, bool lowValue, bool vertical, Extent box, Extent text);

}  // namespace gauge

}  // namespace tessel::controls

namespace tessel::controls::names {
inline constexpr frame::Enumeration::Constant gaugeOrientation[] = {{"Horizontal", 0}, {"Vertical", 1}};
inline constexpr frame::Enumeration tsGaugeOrientationNames{"tsGaugeOrientation", gaugeOrientation};
inline constexpr frame::Enumeration::Constant markerStyle[] = {{"None", 0}, {"ShowLine", 1}, {"ShowBar", 2}, {"ShowFlatBar", 3}};
inline constexpr frame::Enumeration tsMarkerStyleNames{"tsMarkerStyle", markerStyle};
inline constexpr frame::Enumeration::Constant showValue[] = {{"None", 0},  {"AtLeft", 1},   {"AtMiddle", 2}, {"AtRight", 3},
                                                             {"AtTop", 4}, {"AtBottom", 5}, {"Adjust", 6}};
inline constexpr frame::Enumeration tsShowValueNames{"tsShowValue", showValue};
}  // namespace tessel::controls::names

/// Error 13 for what is no number, 6 for a text of one that is too large.
template <>
struct tessel::frame::Conversion<tessel::controls::AnyNumber> {
    static constexpr VarType type = VarType::Empty;
    static controls::AnyNumber From(const Variant& value) {
        value.ToDouble();
        return controls::AnyNumber(value);
    }
    static Variant To(const controls::AnyNumber& value) { return value; }
};

template <>
inline constexpr const tessel::frame::Enumeration* tessel::frame::enumerationOf<tessel::controls::tsGaugeOrientation> =
    &tessel::controls::names::tsGaugeOrientationNames;
template <>
inline constexpr const tessel::frame::Enumeration* tessel::frame::enumerationOf<tessel::controls::tsMarkerStyle> =
    &tessel::controls::names::tsMarkerStyleNames;
template <>
inline constexpr const tessel::frame::Enumeration* tessel::frame::enumerationOf<tessel::controls::tsShowValue> =
    &tessel::controls::names::tsShowValueNames;
