#include "hosts/qt/RowAccessible.h"

#include <QPointer>

#include "hosts/qt/RowView.h"

namespace tessel::qt {

using Position = RowView::Position;

namespace {

RowAccessible* TableOf(RowView& view) { return static_cast<RowAccessible*>(QAccessible::queryAccessibleInterface(&view)); }

/// A cell of a row.
class Cell final : public QAccessibleInterface, public QAccessibleTableCellInterface, public QAccessibleActionInterface {
  public:
    Cell(RowView& view, const QModelIndex& index) : view_(&view), index_(index) {}

    void* interface_cast(QAccessible::InterfaceType type) override {
        if (type == QAccessible::TableCellInterface) return static_cast<QAccessibleTableCellInterface*>(this);
        return type == QAccessible::ActionInterface ? static_cast<QAccessibleActionInterface*>(this) : nullptr;
    }
    bool isValid() const override { return view_ && view_->Child() && index_.isValid(); }
    QObject* object() const override { return nullptr; }
    QAccessible::Role role() const override { return Table()->CellRole(); }
    QAccessible::State state() const override {
        QAccessible::State state;
        if (!isValid()) {
            state.invalid = true;
            return state;
        }
        const QRect place = view_->visualRect(index_);
        state.selectable = state.focusable = true;
        state.selected = isSelected();
        state.focused = view_->hasFocus() && view_->currentIndex().row() == index_.row() && index_.column() == 0;
        state.offscreen = !view_->viewport()->rect().intersects(place);
        state.disabled = !view_->isEnabled();
        Table()->AddState(index_.row(), state);
        return state;
    }
    QString text(QAccessible::Text which) const override {
        if (!isValid()) return {};
        if (which == QAccessible::Name || which == QAccessible::Value) return index_.data().toString();
        return which == QAccessible::Description ? Table()->DescriptionOf(index_.row()) : QString();
    }
    void setText(QAccessible::Text, const QString&) override {}
    QRect rect() const override {
        if (!isValid()) return {};
        const QRect place = view_->visualRect(index_);
        return {view_->viewport()->mapToGlobal(place.topLeft()), place.size()};
    }
    QAccessibleInterface* parent() const override { return view_ ? Table() : nullptr; }
    QAccessibleInterface* child(int) const override { return nullptr; }
    QAccessibleInterface* childAt(int, int) const override { return nullptr; }
    int childCount() const override { return 0; }
    int indexOfChild(const QAccessibleInterface*) const override { return -1; }

    bool isSelected() const override { return isValid() && Table()->isRowSelected(index_.row()); }
    QList<QAccessibleInterface*> columnHeaderCells() const override {
        return isValid() ? Table()->HeadersOf(columnIndex()) : QList<QAccessibleInterface*>();
    }
    QList<QAccessibleInterface*> rowHeaderCells() const override { return {}; }
    int columnIndex() const override { return isValid() ? Table()->PlaceOf(index_.column()) : -1; }
    int rowIndex() const override { return isValid() ? index_.row() : -1; }
    int columnExtent() const override { return 1; }
    int rowExtent() const override { return 1; }
    QAccessibleInterface* table() const override { return Table(); }

    QStringList actionNames() const override { return isValid() ? Table()->ActionsOf(index_.row()) : QStringList(); }
    void doAction(const QString& name) override {
        if (actionNames().contains(name)) Table()->Act(index_.row(), name);
    }
    QStringList keyBindingsForAction(const QString&) const override { return {}; }

  private:
    RowAccessible* Table() const { return TableOf(*view_); }

    QPointer<RowView> view_;
    QPersistentModelIndex index_;
};

}  // namespace

void RowAccessible::TellFocus(RowView& view, const QModelIndex& row) {
    RowAccessible* const table = TableOf(view);
    if (!table || !view.hasFocus()) return;
    if (QAccessibleInterface* cell = table->CellOf(row)) {
        QAccessibleEvent event(cell, QAccessible::Focus);
        QAccessible::updateAccessibility(&event);
    }
}

void RowAccessible::TellRows(RowView& view) {
    QAccessibleTableModelChangeEvent event(&view, QAccessibleTableModelChangeEvent::ModelReset);
    QAccessible::updateAccessibility(&event);
}

void RowAccessible::TellState(RowView& view, const QModelIndex& row, QAccessible::State changed) {
    RowAccessible* const table = TableOf(view);
    QAccessibleInterface* const cell = table ? table->CellOf(row) : nullptr;
    if (!cell) return;
    QAccessibleStateChangeEvent event(cell, changed);
    QAccessible::updateAccessibility(&event);
}

RowAccessible::RowAccessible(RowView& view, QAccessible::Role role) : QAccessibleWidget(&view, role), view_(view) {}

RowAccessible::~RowAccessible() { RowAccessible::Forget(); }

void RowAccessible::Forget() const {
    for (const QAccessible::Id id : std::as_const(cells_)) QAccessible::deleteAccessibleInterface(id);
    cells_.clear();
}

void* RowAccessible::interface_cast(QAccessible::InterfaceType type) {
    if (type == QAccessible::TableInterface) return static_cast<QAccessibleTableInterface*>(this);
    return QAccessibleWidget::interface_cast(type);
}

QString RowAccessible::text(QAccessible::Text which) const { return QAccessibleWidget::text(which); }

int RowAccessible::rowCount() const { return view_.Model().rowCount(); }

QAccessibleInterface* RowAccessible::child(int index) const {
    if (index < 0 || index >= rowCount() * columnCount()) return nullptr;
    return cellAt(index / columnCount(), index % columnCount());
}

QAccessibleInterface* RowAccessible::CellOf(const QModelIndex& index) const {
    if (!index.isValid()) return nullptr;
    const QPersistentModelIndex key(index);
    const auto found = cells_.find(key);
    if (found != cells_.end()) return QAccessible::accessibleInterface(*found);
    constexpr qsizetype most = 4096;  // an assistive program may walk through all rows
    if (cells_.size() >= most) Forget();
    auto* cell = new Cell(view_, index);
    cells_[key] = QAccessible::registerAccessibleInterface(cell);
    return cell;
}

QAccessibleInterface* RowAccessible::childAt(int x, int y) const {
    const QPoint at = view_.viewport()->mapFromGlobal(QPoint(x, y));
    return view_.viewport()->rect().contains(at) ? CellOf(view_.indexAt(at)) : nullptr;
}

int RowAccessible::indexOfChild(const QAccessibleInterface* child) const {
    const auto* cell = dynamic_cast<const Cell*>(child);
    if (!cell || !cell->isValid()) return -1;
    return (cell->rowIndex() + HeaderRows()) * columnCount() + cell->columnIndex();
}

QAccessibleInterface* RowAccessible::focusChild() const { return CellOf(view_.currentIndex()); }

QAccessibleInterface* RowAccessible::cellAt(int row, int column) const {
    return CellOf(view_.Model().index(row, ColumnAt(column)));
}

bool RowAccessible::isRowSelected(int row) const {
    if (!view_.Child() || row < 0 || static_cast<Position>(row) >= view_.Model().HeldRows()) return false;
    return view_.IsSelected(static_cast<Position>(row));
}

QList<QAccessibleInterface*> RowAccessible::selectedCells() const {
    QList<QAccessibleInterface*> cells;
    for (const int row : selectedRows())
        for (int column = 0; column < columnCount(); ++column) cells << cellAt(row, column);
    return cells;
}

QStringList RowAccessible::ActionsOf(int) const { return {QAccessibleActionInterface::toggleAction()}; }

void RowAccessible::Act(int row, const QString&) { isRowSelected(row) ? unselectRow(row) : selectRow(row); }

void RowAccessible::modelChange(QAccessibleTableModelChangeEvent*) {
    cells_.removeIf([](QHash<QPersistentModelIndex, QAccessible::Id>::iterator cell) {
        const bool hasGone = !cell.key().isValid();
        if (hasGone) QAccessible::deleteAccessibleInterface(cell.value());
        return hasGone;
    });
}

}  // namespace tessel::qt
