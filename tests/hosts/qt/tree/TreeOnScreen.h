#pragma once

#include <QApplication>
#include <QScrollBar>
#include <optional>
#include <string>

#include "frame/Text.h"
#include "hosts/qt/TreeViewPeer.h"
#include "hosts/qt/TreeWidget.h"
#include "tests/frame/child/TreeOwner.h"
#include "tests/hosts/qt/OnScreen.h"

namespace tessel::qt::test {

/// A tree that fills its window.
class TreeOnScreen : public OnScreen<tessel::test::TreeOwner> {
  public:
    explicit TreeOnScreen(int width = 300, int height = 240) : OnScreen(width, height) {
        tree.Move(0, 0, Twips(width), Twips(height));
        Settle();
        view().setFocus();
    }

    child::NodeId Add(const std::string& text, child::NodeId parent = child::noNode) {
        child::NodeId node = child::noNode;
        nodes().Add(node, text, {}, parent, child::TreeRelationshipConstants::Child).Check();
        return node;
    }
    child::TreeNodes& nodes() { return tree.Tree(); }
    /// The first node with a text.
    child::NodeId Node(const std::string& text) {
        for (child::TreeNodes::Position place = 0; place < nodes().Count(); ++place)
            if (nodes().Text(nodes().At(place)) == text) return nodes().At(place);
        ADD_FAILURE() << "no node " << text;
        return child::noNode;
    }
    child::TreeNodes::Row Row(const std::string& text) { return nodes().RowOf(Node(text)).value(); }

    TreeWidget& view() { return *window.findChild<TreeWidget*>(); }
    QWidget* port() { return view().viewport(); }
    QRect CellOf(const std::string& text) { return view().visualRect(view().model()->index(static_cast<int>(Row(text)), 0)); }
    QPoint LabelPoint(const std::string& text) { return view().LabelPlace(Row(text)).center(); }
    QPoint SignPoint(const std::string& text) { return view().SignPlace(Row(text)).center(); }
    void Click(const std::string& text) { ClickAt(LabelPoint(text)); }
    void ClickSign(const std::string& text) { ClickAt(SignPoint(text)); }
    void ClickAt(QPoint at) { QTest::mouseClick(port(), Qt::LeftButton, {}, at); }
    void Key(int key, Qt::KeyboardModifiers modifiers = {}) { QTest::keyClick(&view(), static_cast<Qt::Key>(key), modifiers); }
    void Move(QPoint to) {
        QMouseEvent moved(QEvent::MouseMove, to, port()->mapToGlobal(to), Qt::NoButton, Qt::NoButton, {});
        QCoreApplication::sendEvent(port(), &moved);
    }
    QColor Pixel(QPoint at) { return PixelOf(*port(), at.x(), at.y()); }
    /// A point of the inside in twips of the tree.
    child::TreeNodeRef HitAt(QPoint at) {
        const QPoint inside = at + port()->geometry().topLeft() - view().contentsRect().topLeft();
        return tree.HitTest(Twips(inside.x()), Twips(inside.y()));
    }

    /// What the model shows: "docs- .letters+ .bills*", the selected row with "*", levels as points.
    std::string Rows() {
        std::string rows;
        for (int row = 0; row < view().model()->rowCount(); ++row) {
            const child::NodeId node = nodes().AtRow(static_cast<child::TreeNodes::Row>(row));
            rows += (row > 0 ? " " : "") + std::string(static_cast<std::size_t>(nodes().Level(node)), '.') +
                    view().model()->index(row, 0).data().toString().toStdString();
            if (nodes().HasChildren(node)) rows += nodes().Expanded(node) ? "-" : "+";
            if (nodes().Selected() == node) rows += "*";
        }
        return rows;
    }
    std::string Selected() { return tree.SelectedItem() ? tree.SelectedItem()->Text() : ""; }
    /// What was heard but for the mouse and the keys.
    std::string Events() {
        std::string events;
        std::string heard = owner.Heard();
        while (!heard.empty()) {
            const std::size_t end = heard.find(" | ");
            const std::string event = heard.substr(0, end);
            heard = end == std::string::npos ? "" : heard.substr(end + 3);
            if (event.starts_with("MouseDown") || event.starts_with("KeyUp")) continue;
            events += (events.empty() ? "" : " | ") + event;
        }
        return events;
    }

    tessel::test::TreeOwner& owner = widget->owner();
    child::TreeView& tree = owner.tree;
};

/// The tree "docs (letters (anna, bert), bills), music (rock), zoo", collapsed.
struct Sample : TreeOnScreen {
    explicit Sample(int width = 300, int height = 240) : TreeOnScreen(width, height) {
        const auto docs = Add("docs"), letters = Add("letters", docs);
        for (const char* text : {"anna", "bert"}) Add(text, letters);
        Add("bills", docs);
        Add("rock", Add("music"));
        Add("zoo");
        Settle();
    }
};

/// A hundred nodes "node 0", "node 1" and so on.
struct Nodes100 : TreeOnScreen {
    Nodes100() {
        for (int number = 0; number < 100; ++number) Add("node " + frame::Decimal(number));
        Settle();
    }
    std::string TopText() {
        return view().model()->index(static_cast<int>(view().FirstVisible()), 0).data().toString().toStdString();
    }
    void ScrollTo(int row) { view().verticalScrollBar()->setValue(row * CellOf("node 0").height()); }
};

}  // namespace tessel::qt::test
