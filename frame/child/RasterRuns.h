#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "frame/Drawing.h"

/// The geometry of the raster: which pixels a shape covers, as runs of pixels. Pure functions of numbers; whatever a shape's
/// size, they walk no more than the rows and columns of the area asked for.
namespace tessel::child::raster {

/// A rectangle of pixels. `right` and `bottom` are the first column and row behind it.
struct Area {
    int left = 0, top = 0, right = 0, bottom = 0;
    friend bool operator==(const Area&, const Area&) = default;
};

/// The area with this many pixels more on every side.
constexpr Area Grown(const Area& area, int pixels) {
    return {area.left - pixels, area.top - pixels, area.right + pixels, area.bottom + pixels};
}

struct Point {
    int x = 0, y = 0;
    friend bool operator==(Point, Point) = default;
};

/// The pixels `first` to `last`, both included, of one row.
struct Run {
    int row = 0, first = 0, last = 0;
    friend bool operator==(const Run&, const Run&) = default;
};

/// The pixels of a shape. But for what `Widened` takes, no pixel is in two runs: a mode such as XOR needs each just once.
using Runs = std::vector<Run>;

/// Adds a pixel; one that continues the last run makes that run longer.
void AddPixel(Runs& runs, Point pixel);

/// The steps of an outline at which a `DrawStyle` draws: dash 18 drawn and 6 left out, dot 3/3, dash-dot 9/6/3/6,
/// dash-dot-dot 9/3/3/3/3/3. Any other style draws at every step.
class Dashes {
  public:
    explicit Dashes(int style);
    bool IsSolid() const { return lengths.empty(); }
    /// `step` counts the pixels from the outline's begin, from 0.
    bool DrawsAt(std::int64_t step) const;

  private:
    std::vector<int> lengths;
    int period = 1;
};

enum class LastPoint : std::uint8_t { Excluded, Included };

/// A line one pixel wide. It has the same pixels in either direction: halfway between two pixels it takes the upper one, or
/// the left one. Clipped to `clip` it keeps the pixels, and the dashes, that it has unclipped.
Runs LineRuns(Point from, Point to, LastPoint lastPoint, const Dashes& dashes, const Area& clip);

/// The outline, one pixel wide, of the box between two corners, which are part of it. Its steps are counted clockwise from
/// the top left.
Runs BoxOutlineRuns(Point corner, Point opposite, const Dashes& dashes, const Area& clip);

/// What the outline of the box encloses.
Runs BoxInsideRuns(Point corner, Point opposite, const Area& clip);

struct Ellipse {
    Point center;
    int halfWidth = 0, halfHeight = 0;
};

/// A part of an ellipse, in angles as they are seen from the centre, in radians counter-clockwise from the right.
struct Arc {
    double start = 0;
    double sweep = 0;
    bool whole = true;
};

/// The arc from `start` to `end`. Angles are taken modulo two pi; one that is not given, or is no finite number, is the begin
/// or the end of a turn. Two angles that are a whole number of turns apart, other than none, are the whole ellipse.
Arc ArcBetween(std::optional<float> start, std::optional<float> end);

/// The outline, one pixel wide, of an ellipse, or the part of it that is seen within an arc: at least the pixel in the middle of
/// the arc. Half axes of 0 give a straight line, or a dot. The steps of a broken style are exact on circles.
Runs EllipseRuns(const Ellipse& ellipse, const Arc& arc, const Dashes& dashes, const Area& clip);

/// What a round brush covers that is moved over all pixels of the box between two corners, which are part of it.
Runs BrushedBoxRuns(Point corner, Point opposite, int width, const Area& clip);

/// What a round brush covers that is moved along these runs, which may overlap: all pixels within half the width of one of
/// theirs. The middle of a brush of even width is the top left corner of the pixel.
Runs Widened(Runs runs, int width, const Area& clip);

}  // namespace tessel::child::raster
