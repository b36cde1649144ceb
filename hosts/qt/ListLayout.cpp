#include "hosts/qt/ListLayout.h"

#include <algorithm>

namespace tessel::qt {

namespace {

int Between(int value, int least, int most) { return std::clamp(value, least, std::max(least, most)); }

}  // namespace

int ListLayout::InLine() const {
    if (flow == Flow::Across) return std::max(1, window.width() / cell.width());
    return flow == Flow::Down ? std::max(1, window.height() / cell.height()) : 1;
}

int ListLayout::Lines() const { return static_cast<int>((static_cast<std::int64_t>(count) + InLine() - 1) / InLine()); }

QSize ListLayout::Contents() const {
    if (count == 0) return flow == Flow::Rows ? QSize(contentWidth, 0) : QSize(0, 0);
    const int lines = Lines(), places = std::min(InLine(), static_cast<int>(count));
    if (flow == Flow::Across) return {places * cell.width(), lines * cell.height()};
    if (flow == Flow::Down) return {lines * cell.width(), places * cell.height()};
    return {contentWidth, lines * cell.height()};
}

QRect ListLayout::CellOf(Position row) const {
    const int number = static_cast<int>(row), line = number / InLine(), place = number % InLine();
    if (flow == Flow::Across) return {QPoint(place * cell.width(), line * cell.height()), cell};
    if (flow == Flow::Down) return {QPoint(line * cell.width(), place * cell.height()), cell};
    return {0, line * cell.height(), std::max(contentWidth, window.width()), cell.height()};
}

ListLayout::Position ListLayout::AtCell(int line, int place) const {
    const std::int64_t number = static_cast<std::int64_t>(line) * InLine() + place;
    return static_cast<Position>(std::clamp<std::int64_t>(number, 0, static_cast<std::int64_t>(count)));
}

std::optional<ListLayout::Position> ListLayout::At(QPoint point) const {
    if (point.x() < 0 || point.y() < 0) return std::nullopt;
    const int across = flow == Flow::Rows ? 0 : point.x() / cell.width(), down = point.y() / cell.height();
    const int place = flow == Flow::Down ? down : across, line = flow == Flow::Down ? across : down;
    if (place >= InLine()) return std::nullopt;
    const Position row = AtCell(line, place);
    return row < count ? std::optional(row) : std::nullopt;
}

std::vector<child::RowRange> ListLayout::Touched(QRect rectangle) const {
    std::vector<child::RowRange> result;
    if (count == 0 || rectangle.isEmpty()) return result;
    const bool isDown = flow == Flow::Down;
    const auto cells = [](int first, int last, int size) {
        return std::pair(std::max(0, first) / size, last < 0 ? -1 : last / size);
    };
    const auto [left, right] = cells(rectangle.left(), rectangle.right(), cell.width());
    const auto [top, bottom] = cells(rectangle.top(), rectangle.bottom(), cell.height());
    const int firstLine = isDown ? left : top, lastLine = std::min(isDown ? right : bottom, Lines() - 1);
    int firstPlace = isDown ? top : left, lastPlace = std::min(isDown ? bottom : right, InLine() - 1);
    if (flow == Flow::Rows) {
        if (rectangle.right() < 0 || rectangle.left() >= std::max(contentWidth, window.width())) return result;
        firstPlace = lastPlace = 0;
    }
    if (firstPlace > lastPlace) return result;
    const auto add = [&](Position first, Position end) {
        if (first >= end) return;
        if (!result.empty() && result.back().first + result.back().count == first)
            result.back().count += end - first;
        else
            result.push_back({first, end - first});
    };
    if (flow == Flow::Rows) {
        if (firstLine <= lastLine) add(AtCell(firstLine, 0), AtCell(lastLine + 1, 0));
        return result;
    }
    for (int line = firstLine; line <= lastLine; ++line) add(AtCell(line, firstPlace), AtCell(line, lastPlace + 1));
    return result;
}

ListLayout::Position ListLayout::Next(Position from, Step step) const {
    const int inLine = InLine(), last = static_cast<int>(count) - 1, number = static_cast<int>(from);
    const int line = number / inLine, place = number % inLine;
    const auto inside = [&](int target) { return static_cast<Position>(target >= 0 && target <= last ? target : number); };
    const auto lineward = [&](int lines) {
        const int target = Between(line + lines, 0, Lines() - 1) * inLine + place;
        return static_cast<Position>(std::min(target, last));
    };
    const int pageLines =
        std::max(1, (flow == Flow::Down ? window.width() / cell.width() : window.height() / cell.height()) - (flow == Flow::Rows));
    switch (step) {
        case Step::First:
            return 0;
        case Step::Last:
            return static_cast<Position>(last);
        case Step::Up:
            return flow == Flow::Down ? inside(number - 1) : inside(number - inLine);
        case Step::Down:
            if (flow == Flow::Down) return inside(number + 1);
            return line + 1 < Lines() ? lineward(1) : from;
        case Step::Left:
            if (flow == Flow::Rows) return from;
            return flow == Flow::Across ? inside(number - 1) : inside(number - inLine);
        case Step::Right:
            if (flow == Flow::Rows) return from;
            if (flow == Flow::Across) return inside(number + 1);
            return line + 1 < Lines() ? lineward(1) : from;
        case Step::PageUp:
            return lineward(-pageLines);
        case Step::PageDown:
            return lineward(pageLines);
    }
    return from;
}

QPoint ListLayout::Limit() const {
    const QSize contents = Contents();
    return {std::max(0, contents.width() - window.width()), std::max(0, contents.height() - window.height())};
}

ListLayout::Position ListLayout::FirstVisible(QPoint scrolled) const {
    if (count == 0) return 0;
    const int offset = flow == Flow::Down ? scrolled.x() : scrolled.y(), size = flow == Flow::Down ? cell.width() : cell.height();
    const int seen = flow == Flow::Down ? window.width() : window.height();
    int line = (std::max(0, offset) + size - 1) / size;
    if (line > 0 && line * size >= offset + seen) --line;  // the window is lower than a row
    return std::min(AtCell(line, 0), count - 1);
}

QPoint ListLayout::ToTop(Position row) const {
    const QPoint at = CellOf(row).topLeft();
    return flow == Flow::Down ? QPoint(std::min(at.x(), Limit().x()), 0) : QPoint(0, std::min(at.y(), Limit().y()));
}

QPoint ListLayout::IntoView(Position row, QPoint scrolled) const {
    const QRect place = CellOf(row);
    const auto fit = [](int offset, int first, int size, int seen) {
        if (first < offset || size > seen) return first;
        return std::max(offset, first + size - seen);
    };
    const QPoint limit = Limit();
    QPoint result = scrolled;
    if (flow == Flow::Down)
        result.setX(fit(scrolled.x(), place.x(), place.width(), window.width()));
    else
        result.setY(fit(scrolled.y(), place.y(), place.height(), window.height()));
    return {Between(result.x(), 0, limit.x()), Between(result.y(), 0, limit.y())};
}

}  // namespace tessel::qt
