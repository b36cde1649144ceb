#include "hosts/qt/ListAccessible.h"

#include <QPointer>
#include <algorithm>

#include "hosts/qt/Convert.h"
#include "hosts/qt/ListWidget.h"

namespace tessel::qt {

using Position = child::ListRows::Position;

namespace {

ListAccessible* TableOf(ListWidget& list) { return static_cast<ListAccessible*>(QAccessible::queryAccessibleInterface(&list)); }

QAccessibleInterface* MakeAccessible(const QString&, QObject* object) {
    auto* list = qobject_cast<ListWidget*>(object);
    return list ? new ListAccessible(*list) : nullptr;
}

/// A cell of a row.
class Cell final : public QAccessibleInterface, public QAccessibleTableCellInterface, public QAccessibleActionInterface {
  public:
    Cell(ListWidget& list, const QModelIndex& index) : list_(&list), index_(index) {}

    void* interface_cast(QAccessible::InterfaceType type) override {
        if (type == QAccessible::TableCellInterface) return static_cast<QAccessibleTableCellInterface*>(this);
        return type == QAccessible::ActionInterface ? static_cast<QAccessibleActionInterface*>(this) : nullptr;
    }
    bool isValid() const override { return list_ && list_->List() && index_.isValid(); }
    QObject* object() const override { return nullptr; }
    QAccessible::Role role() const override {
        return Table()->role() == QAccessible::Table ? QAccessible::Cell : QAccessible::ListItem;
    }
    QAccessible::State state() const override {
        QAccessible::State state;
        if (!isValid()) {
            state.invalid = true;
            return state;
        }
        const QRect place = list_->visualRect(index_);
        state.selectable = state.focusable = true;
        state.multiSelectable = state.extSelectable = list_->List()->MultiSelect();
        state.selected = isSelected();
        state.focused = list_->hasFocus() && list_->currentIndex().row() == index_.row() && index_.column() == 0;
        state.offscreen = !list_->viewport()->rect().intersects(place);
        state.disabled = !list_->isEnabled();
        return state;
    }
    QString text(QAccessible::Text which) const override {
        if (!isValid()) return {};
        if (which == QAccessible::Name || which == QAccessible::Value) return index_.data().toString();
        return {};
    }
    void setText(QAccessible::Text, const QString&) override {}
    QRect rect() const override {
        if (!isValid()) return {};
        const QRect place = list_->visualRect(index_);
        return {list_->viewport()->mapToGlobal(place.topLeft()), place.size()};
    }
    QAccessibleInterface* parent() const override { return list_ ? Table() : nullptr; }
    QAccessibleInterface* child(int) const override { return nullptr; }
    QAccessibleInterface* childAt(int, int) const override { return nullptr; }
    int childCount() const override { return 0; }
    int indexOfChild(const QAccessibleInterface*) const override { return -1; }

    bool isSelected() const override {
        if (!isValid()) return false;
        const child::ListRows& rows = list_->List()->Rows();
        const auto row = static_cast<Position>(index_.row());
        return row < rows.Count() && rows.Selected(rows.At(row));
    }
    QList<QAccessibleInterface*> columnHeaderCells() const override {
        QList<QAccessibleInterface*> cells;
        if (isValid() && Table()->HeaderRows() > 0) cells << Table()->child(columnIndex());
        return cells;
    }
    QList<QAccessibleInterface*> rowHeaderCells() const override { return {}; }
    int columnIndex() const override { return isValid() ? Table()->PlaceOf(index_.column()) : -1; }
    int rowIndex() const override { return isValid() ? index_.row() : -1; }
    int columnExtent() const override { return 1; }
    int rowExtent() const override { return 1; }
    QAccessibleInterface* table() const override { return Table(); }

    QStringList actionNames() const override { return {toggleAction()}; }
    void doAction(const QString& name) override {
        if (name != toggleAction() || !isValid()) return;
        isSelected() ? Table()->unselectRow(index_.row()) : Table()->selectRow(index_.row());
    }
    QStringList keyBindingsForAction(const QString&) const override { return {}; }

    const QPersistentModelIndex& Index() const { return index_; }

  private:
    ListAccessible* Table() const { return TableOf(*list_); }

    QPointer<ListWidget> list_;
    QPersistentModelIndex index_;
};

/// The header of a column.
class HeaderCell final : public QAccessibleInterface {
  public:
    HeaderCell(ListWidget& list, int column) : list_(&list), column_(column) {}

    bool isValid() const override { return list_ && list_->List() && column_ < list_->Header().count(); }
    QObject* object() const override { return nullptr; }
    QAccessible::Role role() const override { return QAccessible::ColumnHeader; }
    QAccessible::State state() const override {
        QAccessible::State state;
        state.invalid = !isValid();
        return state;
    }
    QString text(QAccessible::Text which) const override {
        if (!isValid() || which != QAccessible::Name) return {};
        return list_->Model().headerData(column_, Qt::Horizontal).toString();
    }
    void setText(QAccessible::Text, const QString&) override {}
    QRect rect() const override {
        if (!isValid()) return {};
        const ListHeader& header = list_->Header();
        const QRect place(header.sectionViewportPosition(column_), 0, header.sectionSize(column_), header.height());
        return {header.mapToGlobal(place.topLeft()), place.size()};
    }
    QAccessibleInterface* parent() const override { return list_ ? TableOf(*list_) : nullptr; }
    QAccessibleInterface* child(int) const override { return nullptr; }
    QAccessibleInterface* childAt(int, int) const override { return nullptr; }
    int childCount() const override { return 0; }
    int indexOfChild(const QAccessibleInterface*) const override { return -1; }
    int Column() const { return column_; }

  private:
    QPointer<ListWidget> list_;
    int column_;
};

}  // namespace

void ListAccessible::Install() {
    static const bool installed = (QAccessible::installFactory(MakeAccessible), true);
    Q_UNUSED(installed);
}

void ListAccessible::TellFocus(ListWidget& list, const QModelIndex& row) {
    ListAccessible* const table = TableOf(list);
    if (!table || !list.hasFocus()) return;
    if (QAccessibleInterface* cell = table->CellOf(row)) {
        QAccessibleEvent event(cell, QAccessible::Focus);
        QAccessible::updateAccessibility(&event);
    }
}

void ListAccessible::TellRows(ListWidget& list) {
    QAccessibleTableModelChangeEvent event(&list, QAccessibleTableModelChangeEvent::ModelReset);
    QAccessible::updateAccessibility(&event);
}

ListAccessible::ListAccessible(ListWidget& list) : QAccessibleWidget(&list, QAccessible::List), list_(list) {}

ListAccessible::~ListAccessible() { Forget(); }

void ListAccessible::Forget() const {
    for (const QAccessible::Id id : std::as_const(cells_)) QAccessible::deleteAccessibleInterface(id);
    for (const QAccessible::Id id : std::as_const(headers_)) QAccessible::deleteAccessibleInterface(id);
    cells_.clear();
    headers_.clear();
}

void* ListAccessible::interface_cast(QAccessible::InterfaceType type) {
    if (type == QAccessible::TableInterface) return static_cast<QAccessibleTableInterface*>(this);
    return QAccessibleWidget::interface_cast(type);
}

QAccessible::Role ListAccessible::role() const {
    const bool isReport = list_.List() && list_.List()->View() == child::ListViewConstants::Report;
    return isReport ? QAccessible::Table : QAccessible::List;
}

QAccessible::State ListAccessible::state() const {
    QAccessible::State state = QAccessibleWidget::state();
    state.multiSelectable = state.extSelectable = list_.List() && list_.List()->MultiSelect();
    return state;
}

QString ListAccessible::text(QAccessible::Text which) const { return QAccessibleWidget::text(which); }

int ListAccessible::HeaderRows() const { return role() == QAccessible::Table && list_.Header().isVisibleTo(&list_) ? 1 : 0; }

int ListAccessible::ColumnAt(int place) const {
    if (role() != QAccessible::Table) return place == 0 ? 0 : -1;
    for (int visual = 0; visual < list_.Header().count(); ++visual) {
        const int column = list_.Header().logicalIndex(visual);
        if (!list_.Header().isSectionHidden(column) && place-- == 0) return column;
    }
    return -1;
}

int ListAccessible::PlaceOf(int column) const {
    if (role() != QAccessible::Table) return 0;
    int place = 0;
    for (int visual = 0; visual < list_.Header().visualIndex(column); ++visual)
        if (!list_.Header().isSectionHidden(list_.Header().logicalIndex(visual))) ++place;
    return place;
}

int ListAccessible::columnCount() const {
    return role() == QAccessible::Table ? list_.Header().count() - list_.Header().hiddenSectionCount() : 1;
}

int ListAccessible::rowCount() const { return list_.Model().rowCount(); }

int ListAccessible::childCount() const { return (rowCount() + HeaderRows()) * columnCount(); }

QAccessibleInterface* ListAccessible::child(int index) const {
    if (index < 0 || index >= childCount()) return nullptr;
    const int column = ColumnAt(index % columnCount()), row = index / columnCount() - HeaderRows();
    return row < 0 ? HeaderOf(column) : CellOf(list_.Model().index(row, column));
}

QAccessibleInterface* ListAccessible::HeaderOf(int column) const {
    const auto found = headers_.find(column);
    if (found != headers_.end()) return QAccessible::accessibleInterface(*found);
    auto* cell = new HeaderCell(list_, column);
    headers_[column] = QAccessible::registerAccessibleInterface(cell);
    return cell;
}

QAccessibleInterface* ListAccessible::CellOf(const QModelIndex& index) const {
    if (!index.isValid()) return nullptr;
    const QPersistentModelIndex key(index);
    const auto found = cells_.find(key);
    if (found != cells_.end()) return QAccessible::accessibleInterface(*found);
    constexpr qsizetype most = 4096;  // an assistive program may walk through all rows
    if (cells_.size() >= most) Forget();
    auto* cell = new Cell(list_, index);
    cells_[key] = QAccessible::registerAccessibleInterface(cell);
    return cell;
}

QAccessibleInterface* ListAccessible::childAt(int x, int y) const {
    if (HeaderRows() > 0) {
        const QPoint at = list_.Header().mapFromGlobal(QPoint(x, y));
        if (list_.Header().rect().contains(at)) {
            const int column = list_.Header().logicalIndexAt(at);
            return column >= 0 ? HeaderOf(column) : nullptr;
        }
    }
    const QPoint at = list_.viewport()->mapFromGlobal(QPoint(x, y));
    return list_.viewport()->rect().contains(at) ? CellOf(list_.indexAt(at)) : nullptr;
}

int ListAccessible::indexOfChild(const QAccessibleInterface* child) const {
    if (const auto* header = dynamic_cast<const HeaderCell*>(child)) return PlaceOf(header->Column());
    const auto* cell = dynamic_cast<const Cell*>(child);
    if (!cell || !cell->isValid()) return -1;
    return (cell->rowIndex() + HeaderRows()) * columnCount() + cell->columnIndex();
}

QAccessibleInterface* ListAccessible::focusChild() const { return CellOf(list_.currentIndex()); }

QAccessibleInterface* ListAccessible::cellAt(int row, int column) const {
    return CellOf(list_.Model().index(row, ColumnAt(column)));
}

int ListAccessible::selectedRowCount() const { return list_.List() ? static_cast<int>(list_.List()->Rows().SelectedCount()) : 0; }

bool ListAccessible::isRowSelected(int row) const {
    if (!list_.List() || row < 0 || static_cast<Position>(row) >= list_.List()->Rows().Count()) return false;
    const child::ListRows& rows = list_.List()->Rows();
    return rows.Selected(rows.At(static_cast<Position>(row)));
}

QList<int> ListAccessible::selectedRows() const {
    QList<int> rows;
    for (int row = 0; rows.size() < selectedRowCount() && row < rowCount(); ++row)
        if (isRowSelected(row)) rows << row;
    return rows;
}

QList<QAccessibleInterface*> ListAccessible::selectedCells() const {
    QList<QAccessibleInterface*> cells;
    for (const int row : selectedRows())
        for (int column = 0; column < columnCount(); ++column) cells << cellAt(row, column);
    return cells;
}

QString ListAccessible::columnDescription(int column) const {
    return list_.Model().headerData(ColumnAt(column), Qt::Horizontal).toString();
}

bool ListAccessible::selectRow(int row) {
    if (!list_.List() || row < 0 || row >= rowCount()) return false;
    if (list_.List()->MultiSelect()) {
        const child::RowRange rows{static_cast<Position>(row), 1};
        list_.List()->SelectionInput({&rows, 1}, {});
    } else {
        list_.List()->SelectInput(row + 1, child::ListSelectConstants::Only);
    }
    return true;
}

bool ListAccessible::unselectRow(int row) {
    if (!isRowSelected(row)) return false;
    const child::RowRange rows{static_cast<Position>(row), 1};
    list_.List()->SelectionInput({}, {&rows, 1});
    return true;
}

void ListAccessible::modelChange(QAccessibleTableModelChangeEvent*) {
    cells_.removeIf([](QHash<QPersistentModelIndex, QAccessible::Id>::iterator cell) {
        const bool hasGone = !cell.key().isValid();
        if (hasGone) QAccessible::deleteAccessibleInterface(cell.value());
        return hasGone;
    });
}

}  // namespace tessel::qt
