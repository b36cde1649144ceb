#include <algorithm>
#include <cstdlib>

#include "frame/child/RasterRuns.h"

namespace tessel::child::raster {

namespace {

/// `numerator / denominator` rounded to the nearest whole number, halves downwards. The denominator is above 0.
std::int64_t RoundedQuotient(std::int64_t numerator, std::int64_t denominator) {
    const std::int64_t dividend = 2 * numerator + denominator - 1;
    const std::int64_t divisor = 2 * denominator;
    return dividend / divisor - (dividend % divisor < 0 ? 1 : 0);
}

/// The steps, `first` up to but without `end`, after which a walk from `start` is within `low` up to but without `high`.
struct Steps {
    std::int64_t first = 0, end = 0;
};
Steps StepsWithin(int start, int direction, int low, int high) {
    return direction > 0 ? Steps{low - start, high - start} : Steps{start - high + 1, start - low + 1};
}

struct Corners {
    int left, top, right, bottom;
};
Corners Ordered(Point corner, Point opposite) {
    return {std::min(corner.x, opposite.x), std::min(corner.y, opposite.y), std::max(corner.x, opposite.x),
            std::max(corner.y, opposite.y)};
}

}  // namespace

Runs LineRuns(Point from, Point to, LastPoint lastPoint, const Dashes& dashes, const Area& clip) {
    const int across = to.x - from.x;
    const int down = to.y - from.y;
    const bool flat = std::abs(across) >= std::abs(down);
    const std::int64_t length = std::max(std::abs(across), std::abs(down));
    const int direction = (flat ? across : down) < 0 ? -1 : 1;
    const Steps inside =
        flat ? StepsWithin(from.x, direction, clip.left, clip.right) : StepsWithin(from.y, direction, clip.top, clip.bottom);
    const std::int64_t end = std::min(inside.end, length + (lastPoint == LastPoint::Included ? 1 : 0));

    Runs runs;
    for (std::int64_t step = std::max<std::int64_t>(inside.first, 0); step < end; ++step) {
        if (!dashes.DrawsAt(step)) continue;
        const int along = static_cast<int>(direction * step);
        const int aside = length == 0 ? 0 : static_cast<int>(RoundedQuotient(step * (flat ? down : across), length));
        const Point pixel = flat ? Point{from.x + along, from.y + aside} : Point{from.x + aside, from.y + along};
        const bool visible = flat ? pixel.y >= clip.top && pixel.y < clip.bottom : pixel.x >= clip.left && pixel.x < clip.right;
        if (visible) AddPixel(runs, pixel);
    }
    return runs;
}

Runs BoxOutlineRuns(Point corner, Point opposite, const Dashes& dashes, const Area& clip) {
    const auto [left, top, right, bottom] = Ordered(corner, opposite);
    const std::int64_t across = right - left;
    const std::int64_t down = bottom - top;
    const int firstColumn = std::max(left, clip.left);
    const int lastColumn = std::min(right, clip.right - 1);
    const int firstRow = std::max(top + 1, clip.top);
    const int lastRow = std::min(bottom - 1, clip.bottom - 1);

    Runs runs;
    const auto addAt = [&](int x, int y, std::int64_t step) {
        if (dashes.DrawsAt(step)) AddPixel(runs, {x, y});
    };
    if (top >= clip.top && top < clip.bottom)
        for (int x = firstColumn; x <= lastColumn; ++x) addAt(x, top, x - left);
    if (right >= clip.left && right < clip.right)
        for (int y = firstRow; y <= lastRow; ++y) addAt(right, y, across + y - top);
    if (bottom > top && bottom >= clip.top && bottom < clip.bottom)
        for (int x = firstColumn; x <= lastColumn; ++x) addAt(x, bottom, across + down + right - x);
    if (left < right && left >= clip.left && left < clip.right)
        for (int y = firstRow; y <= lastRow; ++y) addAt(left, y, 2 * across + down + bottom - y);
    return runs;
}

Runs BoxInsideRuns(Point corner, Point opposite, const Area& clip) {
    const auto [left, top, right, bottom] = Ordered(corner, opposite);
    const int first = std::max(left + 1, clip.left);
    const int last = std::min(right - 1, clip.right - 1);
    Runs runs;
    if (first > last) return runs;
    for (int y = std::max(top + 1, clip.top); y <= std::min(bottom - 1, clip.bottom - 1); ++y) runs.push_back({y, first, last});
    return runs;
}

}  // namespace tessel::child::raster
