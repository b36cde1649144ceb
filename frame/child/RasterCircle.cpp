#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <numbers>

#include "frame/child/RasterRuns.h"

namespace tessel::child::raster {

namespace {

constexpr double turn = 2 * std::numbers::pi;
/// Radians by which an angle read from a 32-bit number may miss the angle that was meant.
constexpr double angleTolerance = 1e-6;

double Wrapped(double angle) {
    const double rest = std::fmod(angle, turn);
    return rest < 0 ? rest + turn : rest;
}

/// The outline of an ellipse row by row: in row `row` (0 or more, from the centre), the pixels whose distance from the centre's
/// column is `Inner` to `Outer`. Where the outline is steep it has the pixel nearest to it in each row; where it is flat, in
/// each column.
class Outline {
  public:
    explicit Outline(const Ellipse& ellipse) : halfWidth(ellipse.halfWidth), halfHeight(ellipse.halfHeight) {}

    int Outer(int row) const {
        if (row > halfHeight) return -1;
        const double reach = Reach(row);
        const bool steep = halfHeight * halfHeight * reach >= halfWidth * halfWidth * row;
        return static_cast<int>(steep ? std::round(reach) : std::floor(Reach(row - 0.5)));
    }
    int Inner(int row) const { return std::min(Outer(row + 1) + 1, Outer(row)); }

    /// The pixel of the outline, from the centre, that is seen at this angle.
    Point At(double angle) const {
        const double right = std::cos(angle);
        const double up = std::sin(angle);
        const double divisor = std::hypot(halfHeight * right, halfWidth * up);
        const double distance = divisor > 0 ? halfWidth * halfHeight / divisor : 0;
        const int y = static_cast<int>(std::clamp(std::round(-distance * up), -halfHeight, halfHeight));
        const int nearest = static_cast<int>(std::round(std::abs(distance * right)));
        const int x = std::clamp(nearest, Inner(std::abs(y)), Outer(std::abs(y)));
        return {right < 0 ? -x : x, y};
    }

    double MeanRadius() const { return (halfWidth + halfHeight) / 2; }

  private:
    double Reach(double row) const {
        return halfHeight > 0 ? halfWidth / halfHeight * std::sqrt(halfHeight * halfHeight - row * row) : halfWidth;
    }

    double halfWidth, halfHeight;
};

/// Which pixels of an outline are drawn, given an arc and a broken style.
class Selection {
  public:
    Selection(const Outline& outline, const Arc& which, const Dashes& style)
        : arc(which), dashes(style), radius(outline.MeanRadius()), middle(outline.At(which.start + which.sweep / 2)) {}

    bool IsAll() const { return arc.whole && dashes.IsSolid(); }

    bool Has(Point fromCenter) const {
        double behindStart = Wrapped(std::atan2(-fromCenter.y, fromCenter.x) - arc.start + angleTolerance);
        if (!arc.whole && behindStart > arc.sweep + 2 * angleTolerance) {
            if (fromCenter != middle) return false;
            behindStart = 0;
        }
        return dashes.DrawsAt(static_cast<std::int64_t>(behindStart * radius));
    }

  private:
    const Arc& arc;
    const Dashes& dashes;
    double radius;
    Point middle;
};

}  // namespace

Arc ArcBetween(std::optional<float> start, std::optional<float> end) {
    const bool hasStart = start && std::isfinite(*start);
    const bool hasEnd = end && std::isfinite(*end);
    if (!hasStart && !hasEnd) return {};
    const double from = hasStart ? *start : 0;
    const double to = hasEnd ? *end : turn;
    const double sweep = Wrapped(to - from);
    const bool isTurn = std::abs(to - from) > 1 && std::min(sweep, turn - sweep) < angleTolerance;
    return isTurn ? Arc{Wrapped(from), turn, true} : Arc{Wrapped(from), sweep, false};
}

Runs EllipseRuns(const Ellipse& ellipse, const Arc& arc, const Dashes& dashes, const Area& clip) {
    const Outline outline(ellipse);
    const Selection selection(outline, arc, dashes);
    const Point center = ellipse.center;

    Runs runs;
    const auto add = [&](int row, int first, int last) {
        first = std::max(first, clip.left);
        last = std::min(last, clip.right - 1);
        if (selection.IsAll() && first <= last) return runs.push_back({row, first, last});
        for (int x = first; x <= last; ++x)
            if (selection.Has({x - center.x, row - center.y})) AddPixel(runs, {x, row});
    };
    const int lastRow = std::min(center.y + ellipse.halfHeight, clip.bottom - 1);
    for (int row = std::max(center.y - ellipse.halfHeight, clip.top); row <= lastRow; ++row) {
        const int inner = outline.Inner(std::abs(row - center.y));
        const int outer = outline.Outer(std::abs(row - center.y));
        if (inner == 0) {
            add(row, center.x - outer, center.x + outer);
        } else {
            add(row, center.x - outer, center.x - inner);
            add(row, center.x + inner, center.x + outer);
        }
    }
    return runs;
}

}  // namespace tessel::child::raster
