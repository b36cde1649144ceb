#pragma once

#include <QAccessibleWidget>
#include <QHash>
#include <QPersistentModelIndex>

namespace tessel::qt {

class ListWidget;

/// A list as assistive programs see it: in report view a table of the columns that are seen, with their headers as its first row;
/// in the others a list. What it says of a cell is read from the list when asked.
class ListAccessible final : public QAccessibleWidget, public QAccessibleTableInterface {
  public:
    /// From now on every list widget is seen like this.
    static void Install();
    static void TellFocus(ListWidget& list, const QModelIndex& row);
    static void TellRows(ListWidget& list);

    explicit ListAccessible(ListWidget& list);
    ~ListAccessible() override;

    // As an object.
    void* interface_cast(QAccessible::InterfaceType type) override;
    QAccessible::Role role() const override;
    QAccessible::State state() const override;
    QString text(QAccessible::Text which) const override;
    int childCount() const override;
    QAccessibleInterface* child(int index) const override;
    QAccessibleInterface* childAt(int x, int y) const override;
    int indexOfChild(const QAccessibleInterface* child) const override;
    QAccessibleInterface* focusChild() const override;

    // As a table.
    QAccessibleInterface* caption() const override { return nullptr; }
    QAccessibleInterface* summary() const override { return nullptr; }
    QAccessibleInterface* cellAt(int row, int column) const override;
    int selectedCellCount() const override { return selectedRowCount() * columnCount(); }
    QList<QAccessibleInterface*> selectedCells() const override;
    QString columnDescription(int column) const override;
    QString rowDescription(int) const override { return {}; }
    int selectedColumnCount() const override { return 0; }
    int selectedRowCount() const override;
    int columnCount() const override;
    int rowCount() const override;
    QList<int> selectedColumns() const override { return {}; }
    QList<int> selectedRows() const override;
    bool isColumnSelected(int) const override { return false; }
    bool isRowSelected(int row) const override;
    bool selectRow(int row) override;
    bool selectColumn(int) override { return false; }
    bool unselectRow(int row) override;
    bool unselectColumn(int) override { return false; }
    void modelChange(QAccessibleTableModelChangeEvent* event) override;

    /// 1 where headers are the first children.
    int HeaderRows() const;
    /// The column that stands at a place among those that are seen, and the other way round.
    int ColumnAt(int place) const;
    int PlaceOf(int column) const;
    QAccessibleInterface* CellOf(const QModelIndex& index) const;

  private:
    void Forget() const;
    QAccessibleInterface* HeaderOf(int column) const;

    ListWidget& list_;
    mutable QHash<QPersistentModelIndex, QAccessible::Id> cells_;
    mutable QHash<int, QAccessible::Id> headers_;
};

}  // namespace tessel::qt
