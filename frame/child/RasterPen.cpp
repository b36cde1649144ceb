#include <algorithm>
#include <cmath>

#include "frame/child/RasterRuns.h"

namespace tessel::child::raster {

namespace {

std::vector<int> LengthsOf(int style) {
    switch (style) {
        case frame::draw::dash:
            return {18, 6};
        case frame::draw::dot:
            return {3, 3};
        case frame::draw::dashDot:
            return {9, 6, 3, 6};
        case frame::draw::dashDotDot:
            return {9, 3, 3, 3, 3, 3};
        default:
            return {};
    }
}

/// A round brush: for each of its rows the columns that it covers, from the pixel that it stands on.
class Brush {
  public:
    explicit Brush(int width) : firstRow(-(width / 2)) {
        const int half = width % 2 == 0 ? 1 : 0;
        rows.reserve(static_cast<std::size_t>(width));
        for (int row = firstRow; row < firstRow + width; ++row) {
            // In half pixels, so that the middle of an even brush is a whole number too.
            const double away = 2.0 * row + half;
            const double reach = std::sqrt(static_cast<double>(width) * width - away * away);
            const int right = static_cast<int>((reach - half) / 2);
            rows.push_back({row, -right - half, right});
        }
    }
    int FirstRow() const { return firstRow; }
    int LastRow() const { return firstRow + static_cast<int>(rows.size()) - 1; }
    const Run& Row(int row) const { return rows[static_cast<std::size_t>(row - firstRow)]; }

  private:
    int firstRow;
    Runs rows;
};

/// One row of pixels that collects overlapping runs and gives back what they cover together.
class Coverage {
  public:
    Coverage(int left, int right) : begin(left), end(right), edges(static_cast<std::size_t>(right - left) + 1) { Reset(); }

    void Add(int first, int last) {
        first = std::max(first, begin);
        last = std::min(last, end - 1);
        if (first > last) return;
        ++EdgeAt(first);
        --EdgeAt(last + 1);
        touchedFirst = std::min(touchedFirst, first);
        touchedEnd = std::max(touchedEnd, last + 1);
        full = full || (first == begin && last == end - 1);
    }
    bool IsFull() const { return full; }

    /// Adds the runs that are covered, and is empty again.
    void MoveTo(Runs& runs, int row) {
        int depth = 0;
        int first = begin;
        for (int x = touchedFirst; x <= touchedEnd; ++x) {
            const int before = depth;
            depth += EdgeAt(x);
            EdgeAt(x) = 0;
            if (before == 0 && depth > 0) first = x;
            if (before > 0 && depth == 0) runs.push_back({row, first, x - 1});
        }
        Reset();
    }

  private:
    void Reset() {
        touchedFirst = end;
        touchedEnd = begin - 1;
        full = false;
    }
    int& EdgeAt(int x) { return edges[static_cast<std::size_t>(x - begin)]; }

    int begin, end;
    int touchedFirst = 0, touchedEnd = 0;
    bool full = false;
    /// Where runs begin (above 0) and end (below 0).
    std::vector<int> edges;
};

}  // namespace

void AddPixel(Runs& runs, Point pixel) {
    const bool sameRow = !runs.empty() && runs.back().row == pixel.y;
    if (sameRow && runs.back().last + 1 == pixel.x) {
        runs.back().last = pixel.x;
    } else if (sameRow && runs.back().first - 1 == pixel.x) {
        runs.back().first = pixel.x;
    } else {
        runs.push_back({pixel.y, pixel.x, pixel.x});
    }
}

Dashes::Dashes(int style) : lengths(LengthsOf(style)) {
    if (lengths.empty()) return;
    period = 0;
    for (const int length : lengths) period += length;
}

bool Dashes::DrawsAt(std::int64_t step) const {
    if (lengths.empty()) return true;
    int rest = static_cast<int>(step % period);
    bool draws = true;
    for (const int length : lengths) {
        if (rest < length) break;
        rest -= length;
        draws = !draws;
    }
    return draws;
}

Runs BrushedBoxRuns(Point corner, Point opposite, int width, const Area& clip) {
    const auto [left, right] = std::minmax({corner.x, opposite.x});
    const auto [top, bottom] = std::minmax({corner.y, opposite.y});
    const Brush brush(width);
    const int firstRow = std::max(top + brush.FirstRow(), clip.top);
    const int lastRow = std::min(bottom + brush.LastRow(), clip.bottom - 1);
    Runs runs;
    if (firstRow <= lastRow) runs.reserve(static_cast<std::size_t>(lastRow - firstRow + 1));
    for (int row = firstRow; row <= lastRow; ++row) {
        // Of the brush's rows that come here the one nearest to its middle is the widest.
        const Run& span = brush.Row(std::clamp(0, row - bottom, row - top));
        const int first = std::max(left + span.first, clip.left), last = std::min(right + span.last, clip.right - 1);
        if (first <= last) runs.push_back({row, first, last});
    }
    return runs;
}

Runs Widened(Runs runs, int width, const Area& clip) {
    if (runs.empty() || clip.left >= clip.right || clip.top >= clip.bottom) return {};
    const Brush brush(width);
    std::sort(runs.begin(), runs.end(), [](const Run& a, const Run& b) { return a.row < b.row; });

    Runs wide;
    Coverage coverage(clip.left, clip.right);
    const int lastRow = std::min(runs.back().row + brush.LastRow(), clip.bottom - 1);
    auto nearest = runs.cbegin();
    for (int row = std::max(runs.front().row + brush.FirstRow(), clip.top); row <= lastRow; ++row) {
        while (nearest != runs.cend() && nearest->row < row - brush.LastRow()) ++nearest;
        for (auto run = nearest; run != runs.cend() && run->row <= row - brush.FirstRow() && !coverage.IsFull(); ++run) {
            const Run& span = brush.Row(row - run->row);
            coverage.Add(run->first + span.first, run->last + span.last);
        }
        coverage.MoveTo(wide, row);
    }
    return wide;
}

}  // namespace tessel::child::raster
