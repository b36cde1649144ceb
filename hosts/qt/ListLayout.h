#pragma once

#include <QPoint>
#include <QRect>
#include <QSize>
#include <optional>
#include <vector>

#include "frame/child/ListRows.h"

namespace tessel::qt {

/// Where the rows of a list stand: all in cells of one size, so that nothing is kept of any row and each answer takes the same time
/// for any number of rows. In pixels of the contents, from their left; a view from right to left mirrors them.
struct ListLayout {
    using Position = child::ListRows::Position;
    enum class Flow {
        Rows,    ///< one below the other, as wide as the contents
        Across,  ///< from left to right in lines, which go on downwards
        Down,    ///< from top to bottom in columns, which go on to the right
    };
    enum class Step { Up, Down, Left, Right, PageUp, PageDown, First, Last };

    Flow flow = Flow::Rows;
    Position count = 0;
    QSize cell{1, 1};      ///< in `Rows` only its height counts
    QSize window{1, 1};    ///< what is seen of the contents
    int contentWidth = 0;  ///< in `Rows`: that of all columns

    /// Cells in a line of `Across`, in a column of `Down`; 1 in `Rows`.
    int InLine() const;
    QSize Contents() const;
    QRect CellOf(Position row) const;
    /// The row whose cell has a point.
    std::optional<Position> At(QPoint point) const;
    /// The rows whose cells a rectangle touches, in their order.
    std::vector<child::RowRange> Touched(QRect rectangle) const;
    /// The row that stands a step away; the row itself where there is none.
    Position Next(Position from, Step step) const;
    /// The first row in view, when the contents are scrolled so far: the first that begins in view.
    Position FirstVisible(QPoint scrolled) const;
    /// How far the contents must be scrolled for a row to come first, or just to come into view.
    QPoint ToTop(Position row) const;
    QPoint IntoView(Position row, QPoint scrolled) const;
    /// The greatest offset.
    QPoint Limit() const;
    /// Whether rows that are in both stand in the same place, and as much of them is seen.
    bool StandsAs(const ListLayout& other) const {
        return flow == other.flow && cell == other.cell && window == other.window && contentWidth == other.contentWidth;
    }

  private:
    int Lines() const;
    Position AtCell(int line, int place) const;
};

}  // namespace tessel::qt
