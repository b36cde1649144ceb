#pragma once

#include <QHash>

#include "hosts/qt/RowAccessible.h"

namespace tessel::qt {

class ListWidget;

/// A list as assistive programs see it: in report view a table of the columns that are seen, with their headers as its first row;
/// in the others a list.
class ListAccessible final : public RowAccessible {
  public:
    /// From now on every list widget is seen like this.
    static void Install();

    explicit ListAccessible(ListWidget& list);
    ~ListAccessible() override;

    // As an object.
    QAccessible::Role role() const override;
    QAccessible::State state() const override;
    int childCount() const override;
    QAccessibleInterface* child(int index) const override;
    QAccessibleInterface* childAt(int x, int y) const override;
    int indexOfChild(const QAccessibleInterface* child) const override;

    // As a table.
    QString columnDescription(int column) const override;
    int selectedRowCount() const override;
    int columnCount() const override;
    QList<int> selectedRows() const override;
    bool selectRow(int row) override;
    bool unselectRow(int row) override;

    QAccessible::Role CellRole() const override;
    void AddState(int row, QAccessible::State& state) const override;
    QList<QAccessibleInterface*> HeadersOf(int column) const override;
    int HeaderRows() const override;
    int PlaceOf(int column) const override;
    int ColumnAt(int place) const override;

  protected:
    void Forget() const override;

  private:
    void ForgetHeaders() const;
    QAccessibleInterface* HeaderOf(int column) const;

    ListWidget& list_;
    mutable QHash<int, QAccessible::Id> headers_;
};

}  // namespace tessel::qt
