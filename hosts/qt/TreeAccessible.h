#pragma once

#include "hosts/qt/RowAccessible.h"

namespace tessel::qt {

class TreeWidget;

/// A tree as assistive programs see it: its rows one below the other, each of which says at which level it stands, whether it is
/// expanded, and can be expanded, collapsed and selected.
class TreeAccessible final : public RowAccessible {
  public:
    /// From now on every tree widget is seen like this.
    static void Install();

    explicit TreeAccessible(TreeWidget& tree);

    int selectedRowCount() const override { return static_cast<int>(selectedRows().size()); }
    QList<int> selectedRows() const override;
    bool selectRow(int row) override;
    bool unselectRow(int row) override;

    QAccessible::Role CellRole() const override { return QAccessible::TreeItem; }
    void AddState(int row, QAccessible::State& state) const override;
    /// The level, from 1.
    QString DescriptionOf(int row) const override;
    /// To toggle is to expand or collapse, to press is to select.
    QStringList ActionsOf(int row) const override;
    void Act(int row, const QString& action) override;

  private:
    TreeWidget& tree_;
};

}  // namespace tessel::qt
