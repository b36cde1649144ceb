#include "controls/splitter/BarDrawing.h"

#include <cmath>

namespace tessel::controls::splitter {

namespace {

using frame::OLE_COLOR;
using frame::draw::Box;
using frame::draw::Line;

constexpr OLE_COLOR shadow = frame::colors::buttonShadow, highlight = frame::colors::buttonHighlight,
                    dark = frame::colors::darkShadow, light = frame::colors::lightEdge;
constexpr float endGap = 5, sideGap = 3;  // of a groove or a row of lines from the edges

using Lines = std::vector<Line>;

void AddSunken(Lines& lines, float right, float bottom) {
    lines.insert(lines.end(), {
                                  {0, 0, right, bottom, highlight, Box::Outline},
                                  {1, 1, right - 1, bottom - 1, light, Box::Outline},
                                  {0, bottom, 0, 0, shadow},
                                  {0, 0, right, 0, shadow},
                                  {1, bottom - 1, 1, 1, dark},
                                  {1, 1, right - 1, 1, dark},
                              });
}

void AddRaised(Lines& lines, float right, float bottom) {
    lines.insert(lines.end(), {
                                  {0, 0, right, bottom, highlight, Box::Outline},
                                  {1, 1, right - 1, bottom - 1, light, Box::Outline},
                                  {0, bottom, right, bottom, dark},
                                  {right, bottom, right, 0, dark},
                                  {1, bottom - 1, right - 1, bottom - 1, shadow},
                                  {right - 1, bottom - 1, right - 1, 1, shadow},
                              });
}

void AddBorder(Lines& lines, const BarLook& look, float right, float bottom) {
    switch (look.appearance) {
        case tsAppearance::tsNone:
            break;
        case tsAppearance::tsFlat:
            lines.push_back({0, 0, right, bottom, look.border, Box::Outline});
            break;
        case tsAppearance::tsSunken:
            AddSunken(lines, right, bottom);
            break;
        case tsAppearance::tsRaised:
        case tsAppearance::tsGrooved:
        case tsAppearance::tsSerrated:
            AddRaised(lines, right, bottom);
            break;
    }
}

void AddGroove(Lines& lines, const BarLook& look) {
    if (look.orientation == tsOrientation::tsHorizontal) {
        const float middle = std::trunc(look.height / 2), end = look.width - endGap;
        lines.push_back({endGap, middle - 1, end, middle - 1, shadow});
        lines.push_back({endGap, middle, end, middle, highlight});
    } else if (look.orientation == tsOrientation::tsVertical) {
        const float middle = std::trunc(look.width / 2), end = look.height - endGap;
        lines.push_back({middle - 1, endGap, middle - 1, end, shadow});
        lines.push_back({middle, endGap, middle, end, highlight});
    }
}

void AddSerration(Lines& lines, const BarLook& look, float right, float bottom) {
    // Counted as whole numbers, so that a length beyond what a float can count ends too.
    constexpr int step = 4, most = 100'000;
    const bool across = look.orientation == tsOrientation::tsHorizontal;
    if (!across && look.orientation != tsOrientation::tsVertical) return;
    const float last = (across ? right : bottom) - endGap;
    for (int i = 0; i < most; ++i) {
        const float at = endGap + static_cast<float>(i * step);
        if (!(at <= last)) break;
        if (across) {
            lines.push_back({at, sideGap, at, bottom - 2, highlight});
            lines.push_back({at + 1, sideGap, at + 1, bottom - 2, shadow});
        } else {
            lines.push_back({sideGap, at, right - 2, at, highlight});
            lines.push_back({sideGap, at + 1, right - 2, at + 1, shadow});
        }
    }
}

}  // namespace

std::vector<Line> BarDrawing(const BarLook& look) {
    const float right = look.width - 1, bottom = look.height - 1;
    Lines lines = {{0, 0, right, bottom, look.fill, Box::Filled}};
    AddBorder(lines, look, right, bottom);
    if (look.appearance == tsAppearance::tsGrooved) AddGroove(lines, look);
    if (look.appearance == tsAppearance::tsSerrated) AddSerration(lines, look, right, bottom);
    return lines;
}

}  // namespace tessel::controls::splitter
