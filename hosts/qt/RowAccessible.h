#pragma once

#include <QAccessibleWidget>
#include <QHash>
#include <QPersistentModelIndex>

namespace tessel::qt {

class RowView;

/// Rows as assistive programs see them: a table whose cells are made when asked for. What it says of a cell is read from the child
/// when asked.
class RowAccessible : public QAccessibleWidget, public QAccessibleTableInterface {
  public:
    static void TellFocus(RowView& view, const QModelIndex& row);
    static void TellRows(RowView& view);
    /// A row's states have changed.
    static void TellState(RowView& view, const QModelIndex& row, QAccessible::State changed);

    ~RowAccessible() override;

    // As an object.
    void* interface_cast(QAccessible::InterfaceType type) override;
    QString text(QAccessible::Text which) const override;
    int childCount() const override { return rowCount() * columnCount(); }
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
    QString columnDescription(int) const override { return {}; }
    QString rowDescription(int) const override { return {}; }
    int selectedColumnCount() const override { return 0; }
    int columnCount() const override { return 1; }
    int rowCount() const override;
    QList<int> selectedColumns() const override { return {}; }
    bool isColumnSelected(int) const override { return false; }
    bool isRowSelected(int row) const override;
    bool selectColumn(int) override { return false; }
    bool unselectColumn(int) override { return false; }
    void modelChange(QAccessibleTableModelChangeEvent* event) override;

    // What cells say and do besides.
    virtual QAccessible::Role CellRole() const = 0;
    virtual void AddState(int /*row*/, QAccessible::State&) const {}
    virtual QString DescriptionOf(int /*row*/) const { return {}; }
    virtual QStringList ActionsOf(int row) const;
    virtual void Act(int row, const QString& action);
    virtual QList<QAccessibleInterface*> HeadersOf(int /*column*/) const { return {}; }
    /// 1 where headers are the first children.
    virtual int HeaderRows() const { return 0; }
    /// The place of a column among those that are seen.
    virtual int PlaceOf(int) const { return 0; }
    /// The column that stands at a place among those that are seen.
    virtual int ColumnAt(int place) const { return place == 0 ? 0 : -1; }
    QAccessibleInterface* CellOf(const QModelIndex& index) const;

  protected:
    RowAccessible(RowView& view, QAccessible::Role role);
    virtual void Forget() const;

  private:
    RowView& view_;
    mutable QHash<QPersistentModelIndex, QAccessible::Id> cells_;
};

}  // namespace tessel::qt
