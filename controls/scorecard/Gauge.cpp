#include "controls/scorecard/Gauge.h"

#include <array>
#include <cmath>

#include "frame/Numbers.h"

namespace tessel::controls {

using frame::OLE_COLOR;
using frame::Variant;
using frame::VarType;

namespace {

bool AreFloats(const Variant& a, const Variant& b) { return a.Type() == VarType::Single || b.Type() == VarType::Single; }

/// One more in decimal digits: "099" becomes "100".
void CountUp(std::string& digits) {
    for (auto digit = digits.rbegin(); digit != digits.rend(); ++digit) {
        if (*digit != '9') {
            ++*digit;
            return;
        }
        *digit = '0';
    }
    digits.insert(digits.begin(), '1');
}

}  // namespace

bool IsBelow(const Variant& a, const Variant& b) {
    const double x = a.ToDouble(), y = b.ToDouble();
    return AreFloats(a, b) ? static_cast<float>(x) < static_cast<float>(y) : x < y;
}

bool Reaches(const Variant& a, const Variant& b) {
    const double x = a.ToDouble(), y = b.ToDouble();
    return AreFloats(a, b) ? static_cast<float>(x) >= static_cast<float>(y) : x >= y;
}

bool IsEqual(const Variant& a, const Variant& b) {
    const double x = a.ToDouble(), y = b.ToDouble();
    return AreFloats(a, b) ? static_cast<float>(x) == static_cast<float>(y) : x == y;
}

std::string PercentText(const Variant& score) {
    const double number = score.ToDouble();
    std::string text = score.Type() == VarType::Single ? frame::NumberText(score.ToSingle()) : frame::NumberText(number);
    if (!std::isfinite(number)) return text + '%';

    // The digits before the point that stands two places further to the right, and whether the rest is a half or more.
    std::string digits;
    int pointPlace = 2;
    bool behindPoint = false;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] == '.') {
            behindPoint = true;
        } else if (text[i] == 'E') {
            pointPlace += static_cast<int>(frame::ReadDouble(std::string_view(text).substr(i + 1)));
            break;
        } else if (text[i] != '-') {
            digits += text[i];
            if (!behindPoint) ++pointPlace;
        }
    }
    if (pointPlace < 0) return "0%";
    const auto whole = static_cast<std::size_t>(pointPlace);
    const bool roundsUp = whole < digits.size() && digits[whole] >= '5';
    digits.resize(whole, '0');
    if (roundsUp) CountUp(digits);
    digits.erase(0, digits.find_first_not_of('0'));
    if (digits.empty()) return "0%";
    return (number < 0 ? "-" : "") + digits + '%';
}

namespace gauge {

void Lay(Frame& bar, bool vertical, float scaleWidth, float scaleHeight) {
    bar.vertical = vertical;
    bar.GaugeStart = vertical ? scaleHeight : 0;
    bar.GaugeEnd = vertical ? 0 : scaleWidth;
    bar.GaugeBreadth = vertical ? scaleWidth : scaleHeight;
}

float PositionOf(const Frame& bar, double value, double minimum, double maximum) {
    if (minimum == maximum) return Variant(maximum).ToSingle();
    const float ratio = Variant((value - minimum) / (maximum - minimum)).ToSingle();
    return Variant(static_cast<double>(std::abs(bar.GaugeEnd - bar.GaugeStart)) * ratio).ToSingle();
}

Across AcrossOf(const Frame& bar, float fraction) {
    const float margin = (1 - fraction) / 2;
    return {margin * bar.GaugeBreadth, (1 - margin) * bar.GaugeBreadth};
}

frame::draw::Line CrossLine(const Frame& bar, float position, Across across, OLE_COLOR color) {
    if (!bar.vertical) return {position, across.from, position, across.to, color};
    const float y = bar.GaugeStart - position;
    return {across.from, y, across.to, y, color};
}

frame::draw::Line Band(const Frame& bar, float from, float to, OLE_COLOR color) {
    constexpr auto filled = frame::draw::Box::Filled;
    if (!bar.vertical) return {from, 0, to, bar.GaugeBreadth, color, filled};
    return {0, bar.GaugeStart - from, bar.GaugeBreadth, bar.GaugeStart - to, color, filled};
}

frame::draw::Line Axis(const Frame& bar, OLE_COLOR color) {
    const float middle = bar.GaugeBreadth * 0.5f;
    if (!bar.vertical) return {bar.GaugeStart, middle, bar.GaugeEnd, middle, color};
    return {middle, bar.GaugeStart, middle, bar.GaugeEnd, color};
}

std::int16_t GapWidth(int blocks) {
    constexpr int mostWide = 10, mostMedium = 20;
    if (blocks <= mostWide) return 3;
    return blocks <= mostMedium ? 2 : 1;
}

// The light edge is at the top or left, and a vertical bar's first line lies lowest.
OLE_COLOR RaisedColor(const Frame& bar, int line) {
    static constexpr std::array<std::uint32_t, 5> across = {0xFFFFFF, 0xC0C0C0, 0xC0C0C0, 0x808080, 0};
    static constexpr std::array<std::uint32_t, 5> upwards = {0, 0x808080, 0xC0C0C0, 0xC0C0C0, 0xFFFFFF};
    return (bar.vertical ? upwards : across).at(static_cast<std::size_t>(line));
}

Place TextPlace(tsShowValue where, bool lowValue, bool vertical, Extent box, Extent text) {
    const float right = box.width - text.width, bottom = box.height - text.height;
    const float middleX = right / 2, middleY = bottom / 2;
    switch (where) {
        case tsShowValue::AtLeft:
            return {0, middleY};
        case tsShowValue::AtRight:
            return {right, middleY};
        case tsShowValue::AtTop:
            return {middleX, 0};
        case tsShowValue::AtBottom:
            return {middleX, bottom};
        case tsShowValue::Adjust:
            return TextPlace(vertical ? (lowValue ? tsShowValue::AtTop : tsShowValue::AtBottom)
                                      : (lowValue ? tsShowValue::AtRight : tsShowValue::AtLeft),
                             lowValue, vertical, box, text);
        case tsShowValue::AtMiddle:
        case tsShowValue::None:
            break;
    }
    return {middleX, middleY};
}

}  // namespace gauge

}  // namespace tessel::controls
