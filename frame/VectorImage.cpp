#include "frame/VectorImage.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <memory>
#include <numbers>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace tessel::frame {

namespace {

struct Point {
    double x = 0, y = 0;
};
using Polygon = std::vector<Point>;

struct Line {
    Polygon points;
    bool closed = false;
};

/// The lines of an outline, in pixels, with curves as many short pieces.
class OutlineReader {
  public:
    OutlineReader(std::string_view text, double scale) : rest_(text), scale_(scale) {}

    std::vector<Line> Read() {
        while (const char command = TakeLetter())
            if (!Run(command)) break;
        return std::move(lines_);
    }

  private:
    bool Run(char command) {
        switch (command) {
            case 'M':
                return With<2>([&](const auto& n) { lines_.push_back({{At(n[0], n[1])}, false}); });
            case 'L':
                return With<2>([&](const auto& n) { Go(At(n[0], n[1])); });
            case 'C':
                return With<6>([&](const auto& n) { Curve(At(n[0], n[1]), At(n[2], n[3]), At(n[4], n[5])); });
            case 'E':
                return With<4>([&](const auto& n) { Ellipse(n[0], n[1], n[2], n[3]); });
            case 'R':
                return With<5>([&](const auto& n) { Box(n[0], n[1], n[2], n[3], n[4]); });
            case 'Z':
                if (!lines_.empty()) lines_.back().closed = true;
                return true;
            default:
                return false;
        }
    }

    template <std::size_t N, class F>
    bool With(F&& run) {
        std::array<double, N> numbers{};
        for (double& number : numbers) {
            const auto taken = TakeNumber();
            if (!taken) return false;
            number = *taken;
        }
        run(numbers);
        return true;
    }

    Point At(double x, double y) const { return {x * scale_, y * scale_}; }

    void Go(Point to) {
        if (lines_.empty()) lines_.push_back({{{0, 0}}, false});
        lines_.back().points.push_back(to);
    }

    void Curve(Point a, Point b, Point end) {
        if (lines_.empty()) lines_.push_back({{{0, 0}}, false});
        const Point start = lines_.back().points.back();
        constexpr int pieces = 16;
        for (int i = 1; i <= pieces; ++i) {
            const double t = static_cast<double>(i) / pieces, u = 1 - t;
            const double w0 = u * u * u, w1 = 3 * u * u * t, w2 = 3 * u * t * t, w3 = t * t * t;
            Go({w0 * start.x + w1 * a.x + w2 * b.x + w3 * end.x, w0 * start.y + w1 * a.y + w2 * b.y + w3 * end.y});
        }
    }

    void Arc(Polygon& points, Point centre, double rx, double ry, double from, double to) const {
        const int pieces = std::clamp(static_cast<int>(std::max(rx, ry) * scale_ * 4), 8, 64);
        for (int i = 0; i <= pieces; ++i) {
            const double angle = from + (to - from) * i / pieces;
            points.push_back(At(centre.x + rx * std::cos(angle), centre.y + ry * std::sin(angle)));
        }
    }

    void Ellipse(double x, double y, double rx, double ry) {
        Line line{{}, true};
        Arc(line.points, {x, y}, rx, ry, 0, 2 * std::numbers::pi);
        lines_.push_back(std::move(line));
    }

    void Box(double x, double y, double width, double height, double r) {
        constexpr double quarter = std::numbers::pi / 2;
        const Point corners[] = {{x + width - r, y + height - r}, {x + r, y + height - r}, {x + r, y + r}, {x + width - r, y + r}};
        Line line{{}, true};
        for (int i = 0; i < 4; ++i) Arc(line.points, corners[i], r, r, i * quarter, (i + 1) * quarter);
        lines_.push_back(std::move(line));
    }

    void SkipBlanks() {
        while (!rest_.empty() && rest_.front() == ' ') rest_.remove_prefix(1);
    }
    char TakeLetter() {
        SkipBlanks();
        if (rest_.empty()) return 0;
        const char letter = rest_.front();
        rest_.remove_prefix(1);
        return letter;
    }
    std::optional<double> TakeNumber() {
        SkipBlanks();
        double number = 0;
        const auto [end, error] = std::from_chars(rest_.data(), rest_.data() + rest_.size(), number);
        if (error != std::errc() || !std::isfinite(number)) return std::nullopt;
        rest_.remove_prefix(static_cast<std::size_t>(end - rest_.data()));
        return number;
    }

    std::string_view rest_;
    double scale_;
    std::vector<Line> lines_;
};

/// The area that a round pen covers: a box along each piece and a disc at each of its ends, all turning the same way.
std::vector<Polygon> Stroked(const std::vector<Line>& lines, double width) {
    const double half = width / 2;
    const int pieces = std::clamp(static_cast<int>(half * 6), 8, 48);
    std::vector<Polygon> areas;
    const auto disc = [&](Point centre) {
        Polygon round;
        for (int i = 0; i < pieces; ++i) {
            const double angle = 2 * std::numbers::pi * i / pieces;
            round.push_back({centre.x + half * std::cos(angle), centre.y + half * std::sin(angle)});
        }
        areas.push_back(std::move(round));
    };
    const auto bar = [&](Point a, Point b) {
        const double dx = b.x - a.x, dy = b.y - a.y, length = std::hypot(dx, dy);
        if (!(length > 0)) return;
        const double nx = dy / length * half, ny = -dx / length * half;
        areas.push_back({{a.x + nx, a.y + ny}, {b.x + nx, b.y + ny}, {b.x - nx, b.y - ny}, {a.x - nx, a.y - ny}});
    };
    for (const Line& line : lines) {
        for (const Point& point : line.points) disc(point);
        for (std::size_t i = 1; i < line.points.size(); ++i) bar(line.points[i - 1], line.points[i]);
        if (line.closed && !line.points.empty()) bar(line.points.back(), line.points.front());
    }
    return areas;
}

/// Where an edge passes the middle of one of the rows that a pixel is divided into.
struct Crossing {
    int row;
    double x;
    int turn;
    friend bool operator<(const Crossing& a, const Crossing& b) { return std::pair(a.row, a.x) < std::pair(b.row, b.x); }
};

constexpr int rowsOfPixel = 8;

void AddEdge(std::vector<Crossing>& crossings, Point a, Point b, int side) {
    const int turn = a.y < b.y ? 1 : -1;
    if (turn < 0) std::swap(a, b);
    const auto rowBelow = [&](double y) {
        return static_cast<int>(std::clamp(std::ceil(y * rowsOfPixel - 0.5), 0.0, static_cast<double>(side) * rowsOfPixel));
    };
    const double slope = a.y < b.y ? (b.x - a.x) / (b.y - a.y) : 0;
    for (int row = rowBelow(a.y); row < rowBelow(b.y); ++row)
        crossings.push_back({row, a.x + ((row + 0.5) / rowsOfPixel - a.y) * slope, turn});
}

/// How much of each pixel an area covers, from 0 to 1: exact along a row, sampled by rows down a pixel.
class Coverage {
  public:
    explicit Coverage(int side) : side_(side), parts_(static_cast<std::size_t>(side) * static_cast<std::size_t>(side)) {}

    void Add(const std::vector<Polygon>& areas) {
        std::vector<Crossing> crossings;
        for (const Polygon& area : areas)
            for (std::size_t i = 0; i < area.size(); ++i) AddEdge(crossings, area[i], area[(i + 1) % area.size()], side_);
        std::sort(crossings.begin(), crossings.end());
        int turns = 0;
        for (std::size_t i = 0; i + 1 < crossings.size(); ++i) {
            turns += crossings[i].turn;
            if (crossings[i].row != crossings[i + 1].row)
                turns = 0;
            else if (turns != 0)
                AddRun(crossings[i].row / rowsOfPixel, crossings[i].x, crossings[i + 1].x);
        }
    }
    double At(std::size_t place) const { return std::min(1.0, parts_[place]); }

  private:
    void AddRun(int y, double from, double to) {
        from = std::clamp(from, 0.0, static_cast<double>(side_));
        to = std::clamp(to, 0.0, static_cast<double>(side_));
        for (int x = static_cast<int>(from); x < side_ && x < to; ++x) {
            const double covered = std::min(to, x + 1.0) - std::max(from, static_cast<double>(x));
            parts_[static_cast<std::size_t>(y) * static_cast<std::size_t>(side_) + static_cast<std::size_t>(x)] +=
                covered / rowsOfPixel;
        }
    }

    int side_;
    std::vector<double> parts_;
};

constexpr std::uint32_t Byte(std::uint32_t color, int index) { return color >> (8 * index) & 0xFF; }

/// A colour, of which `coverage` is seen, over another. Straight alpha.
std::uint32_t Over(std::uint32_t top, double coverage, std::uint32_t below) {
    const double above = Byte(top, 3) / 255.0 * coverage, under = Byte(below, 3) / 255.0 * (1 - above), alpha = above + under;
    if (!(alpha > 0)) return 0;
    auto result = static_cast<std::uint32_t>(alpha * 255 + 0.5) << 24;
    for (int i = 0; i < 3; ++i)
        result |= static_cast<std::uint32_t>((Byte(top, i) * above + Byte(below, i) * under) / alpha + 0.5) << (8 * i);
    return result;
}

}  // namespace

PixelPlane Rasterise(std::span<const VectorShape> shapes, int side, double scale) {
    constexpr double mostPixels = 4096;
    const double exact = std::ceil(side * scale);
    if (!(exact >= 1 && exact <= mostPixels)) return {scale, 0, 0, {}};
    const int pixels = static_cast<int>(exact);
    PixelPlane plane{scale, pixels, pixels, {}};
    plane.pixels.resize(static_cast<std::size_t>(pixels) * static_cast<std::size_t>(pixels));
    for (const VectorShape& shape : shapes) {
        std::vector<Line> lines = OutlineReader(shape.outline, scale).Read();
        std::vector<Polygon> areas;
        if (shape.stroke > 0)
            areas = Stroked(lines, shape.stroke * scale);
        else
            for (Line& line : lines) areas.push_back(std::move(line.points));
        Coverage coverage(pixels);
        coverage.Add(areas);
        for (std::size_t i = 0; i < plane.pixels.size(); ++i)
            if (coverage.At(i) > 0) plane.pixels[i] = Over(shape.color, coverage.At(i), plane.pixels[i]);
    }
    return plane;
}

PictureRef DrawnPicture(std::vector<VectorShape> shapes, int side) {
    constexpr float twipsPerPixel = 15;
    const float extent = static_cast<float>(side) * twipsPerPixel;
    return std::make_shared<Picture>(extent, extent,
                                     [shapes = std::move(shapes), side](double scale) { return Rasterise(shapes, side, scale); });
}

}  // namespace tessel::frame
