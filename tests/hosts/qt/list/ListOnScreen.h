#pragma once

#include <QApplication>
#include <QHeaderView>
#include <QPainter>
#include <QScrollBar>
#include <string>

#include "frame/Text.h"
#include "hosts/qt/ListViewPeer.h"
#include "hosts/qt/ListWidget.h"
#include "tests/frame/child/ListOwner.h"
#include "tests/hosts/qt/OnScreen.h"

namespace tessel::qt::test {

/// A list that fills its window.
class ListOnScreen : public OnScreen<tessel::test::ListOwner> {
  public:
    explicit ListOnScreen(int width = 400, int height = 200) : OnScreen(width, height) {
        list.Move(0, 0, Twips(width), Twips(height));
        Settle();
        view().setFocus();
    }

    /// Adds rows "row 0", "row 1" and so on, whose sub-item is their number.
    void AddRows(int count) {
        const int first = static_cast<int>(rows().Count());
        for (int row = first; row < first + count; ++row) {
            const auto id = rows().Add("row " + frame::Decimal(row));
            rows().SetText(id, 1, frame::Decimal(row));
        }
        Settle();
    }
    child::ListRows& rows() { return list.Rows(); }
    ListWidget& view() { return *window.findChild<ListWidget*>(); }
    QWidget* port() { return view().viewport(); }
    QPoint LabelPoint(int row) { return CellOf(row).topLeft() + QPoint(12, CellOf(row).height() / 2); }
    QRect CellOf(int row) { return view().visualRect(view().model()->index(row, 0)); }
    void Click(int row, Qt::KeyboardModifiers modifiers = {}) {
        QTest::mouseClick(port(), Qt::LeftButton, modifiers, LabelPoint(row));
    }
    void Key(int key, Qt::KeyboardModifiers modifiers = {}) { QTest::keyClick(&view(), static_cast<Qt::Key>(key), modifiers); }

    QColor Pixel(int x, int y) { return PixelOf(*port(), x, y); }
    QColor Pixel(QPoint at) { return Pixel(at.x(), at.y()); }

    /// The texts of the selected rows, with "*" behind that of the focus row, and of a focus row that is not selected in brackets.
    std::string Selection() {
        std::string result;
        for (child::ListRows::Position row = 0; row < rows().Count(); ++row) {
            const auto id = rows().At(row);
            const bool isFocus = list.FocusRow() == id;
            if (!rows().Selected(id) && !isFocus) continue;
            if (!result.empty()) result += ", ";
            const std::string text = rows().Text(id, 0);
            result += rows().Selected(id) ? text + (isFocus ? "*" : "") : "(" + text + ")";
        }
        return result;
    }

    tessel::test::ListOwner& owner = widget->owner();
    child::ListView& list = owner.list;
};

}  // namespace tessel::qt::test
