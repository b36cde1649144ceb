#include "hosts/qt/TreeAccessible.h"

#include <QCoreApplication>

#include "hosts/qt/TreeWidget.h"

namespace tessel::qt {

using child::NodeId;
using child::noNode;
using Position = TreeWidget::Position;

namespace {

QAccessibleInterface* MakeAccessible(const QString&, QObject* object) {
    auto* tree = qobject_cast<TreeWidget*>(object);
    return tree ? new TreeAccessible(*tree) : nullptr;
}

}  // namespace

void TreeAccessible::Install() {
    static const bool installed = (QAccessible::installFactory(MakeAccessible), true);
    Q_UNUSED(installed);
}

TreeAccessible::TreeAccessible(TreeWidget& tree) : RowAccessible(tree, QAccessible::Tree), tree_(tree) {}

QList<int> TreeAccessible::selectedRows() const {
    const NodeId selected = tree_.Tree() ? tree_.Tree()->Tree().Selected() : noNode;
    const auto row = selected == noNode ? std::nullopt : tree_.Tree()->Tree().RowOf(selected);
    return row ? QList<int>{static_cast<int>(*row)} : QList<int>();
}

bool TreeAccessible::selectRow(int row) {
    if (!tree_.Tree() || row < 0 || static_cast<Position>(row) >= tree_.Model().HeldRows()) return false;
    tree_.ReportSelection(static_cast<Position>(row), Qt::NoModifier);
    return true;
}

// The user takes no selection away either.
bool TreeAccessible::unselectRow(int) { return false; }

void TreeAccessible::AddState(int row, QAccessible::State& state) const {
    const child::TreeNodes& nodes = tree_.Tree()->Tree();
    if (static_cast<Position>(row) >= nodes.RowCount()) return;
    const NodeId node = nodes.AtRow(static_cast<Position>(row));
    state.expandable = nodes.HasChildren(node);
    state.expanded = state.expandable && nodes.Expanded(node);
    state.collapsed = state.expandable && !nodes.Expanded(node);
    state.checkable = tree_.Tree()->Checkboxes();
    state.checked = state.checkable && nodes.Checked(node);
}

QString TreeAccessible::DescriptionOf(int row) const {
    const child::TreeNodes& nodes = tree_.Tree()->Tree();
    if (static_cast<Position>(row) >= nodes.RowCount()) return {};
    return QCoreApplication::translate("TreeView", "Level %1").arg(nodes.Level(nodes.AtRow(static_cast<Position>(row))) + 1);
}

QStringList TreeAccessible::ActionsOf(int row) const {
    QStringList actions;
    const child::TreeNodes& nodes = tree_.Tree()->Tree();
    const bool turns = static_cast<Position>(row) < nodes.RowCount() && nodes.HasChildren(nodes.AtRow(static_cast<Position>(row)));
    if (turns) actions << QAccessibleActionInterface::toggleAction();
    actions << QAccessibleActionInterface::pressAction();
    return actions;
}

void TreeAccessible::Act(int row, const QString& action) {
    if (action == QAccessibleActionInterface::toggleAction())
        tree_.TurnSign(static_cast<Position>(row));
    else
        selectRow(row);
}

}  // namespace tessel::qt
