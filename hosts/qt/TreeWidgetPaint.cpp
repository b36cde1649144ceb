#include <QPainter>
#include <QStyle>
#include <QStyleOption>

#include "hosts/qt/Convert.h"
#include "hosts/qt/TreeWidget.h"

/// How a tree looks.
namespace tessel::qt {

using child::NodeId;
using child::noNode;

void TreeWidget::PaintRow(QPainter& painter, Position row, const Colors& colors) {
    const child::TreeNodes& nodes = Nodes();
    const NodeId node = NodeAt(row);
    const QString text = LabelText(row);
    const Parts parts = PartsOf(row);
    const Label label = LabelOf(row, text);
    const bool isTarget = nodes.Lives(view_.dropHighlight) && view_.dropHighlight.node == node;
    const bool isMarked = isTarget || (IsSelected(row) && ShowsMark()), isHot = hot_ == row && look_.hot;
    const child::TreeNodes::Colors own = nodes.ColorsOf(node);
    const frame::SystemColors& system = tree_->Host().Colors();
    Colors used = colors;
    if (isTarget) {
        used.mark = palette().color(QPalette::Active, QPalette::Highlight);
        used.markedText = palette().color(QPalette::Active, QPalette::HighlightedText);
    }
    if (own.back && !isMarked) painter.fillRect(ToViewport(label.mark), ToQt(*own.back, system));
    PaintMark(painter, label.mark, isMarked, isHot, used);
    Colors around = used;
    if (isMarked && look_.fullRow) around.text = used.markedText;
    PaintBranches(painter, row, around);
    if (!parts.box.isEmpty()) PaintBox(painter, row, parts.box, colors);
    PaintIcon(painter, label.icon, nodes.ShownImage(node), {.tinted = isMarked && !look_.fullRow}, used);

    QColor ink = isMarked ? used.markedText : used.text;
    if (own.fore && !isMarked && isEnabled()) ink = ToQt(*own.fore, system);
    painter.setPen(ink);
    painter.setFont(FontOf(node));
    PaintLine(painter, ToViewport(label.text), text, Qt::AlignLeft);
    if (currentIndex().row() == static_cast<int>(row) && hasFocus())
        PaintFocus(painter, ToViewport(label.mark), isMarked ? used.mark : used.back);
}

void TreeWidget::PaintBranches(QPainter& painter, Position row, const Colors& colors) const {
    const child::TreeNodes& nodes = Nodes();
    const NodeId own = NodeAt(row);
    const QRect cell = layout_.CellOf(row);
    QStyleOptionViewItem option;
    option.initFrom(this);
    option.state &= ~QStyle::State_MouseOver;
    for (const auto role : {QPalette::Text, QPalette::WindowText, QPalette::ButtonText}) option.palette.setColor(role, colors.text);
    option.palette.setColor(QPalette::Base, colors.back);
    option.palette.setColor(QPalette::Window, colors.back);
    const QStyle::State plain = option.state;
    const int width = ColumnWidth();
    int column = ColumnsBefore(nodes.Level(own)) - 1;
    for (NodeId node = own; node != noNode && column >= 0; node = nodes.Parent(node), --column) {
        option.rect = ToViewport(QRect(column * width, cell.top(), width, cell.height()));
        option.state = plain;
        if (view_.lines && node == own) option.state |= QStyle::State_Item;
        if (view_.lines && nodes.Next(node) != noNode) option.state |= QStyle::State_Sibling;
        if (view_.signs && node == own && nodes.HasChildren(node))
            option.state |= QStyle::State_Children | (nodes.Expanded(node) ? QStyle::State_Open : QStyle::State_None);
        style()->drawPrimitive(QStyle::PE_IndicatorBranch, &option, &painter, this);
    }
}

void TreeWidget::PaintBox(QPainter& painter, Position row, const QRect& box, const Colors& colors) const {
    QStyleOptionViewItem option;
    option.initFrom(this);
    // Styles shade a box's frame from the window, which would not be seen on a dark background.
    constexpr float halfway = 0.5f;
    if (IsDark(colors.back)) option.palette.setColor(QPalette::Window, Mixed(colors.text, colors.back, halfway));
    option.rect = ToViewport(box);
    option.features |= QStyleOptionViewItem::HasCheckIndicator;
    option.checkState = Nodes().Checked(NodeAt(row)) ? Qt::Checked : Qt::Unchecked;
    option.state &= ~(QStyle::State_HasFocus | QStyle::State_MouseOver);
    option.state |= option.checkState == Qt::Checked ? QStyle::State_On : QStyle::State_Off;
    style()->drawPrimitive(QStyle::PE_IndicatorItemViewItemCheck, &option, &painter, this);
}

QString TreeWidget::FullTextAt(QPoint at) const {
    const auto row = layout_.At(ToContents(at));
    if (!row || *row >= Nodes().RowCount()) return {};
    const QString text = LabelText(*row);
    return viewport()->rect().contains(ToViewport(LabelOf(*row, text).text)) ? QString() : text;
}

}  // namespace tessel::qt
