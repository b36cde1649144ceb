#pragma once

#include <optional>
#include <vector>

#include "frame/child/TreeView.h"
#include "hosts/qt/RowModel.h"

namespace tessel::qt {

/// The rows of a tree: its nodes whose ancestors are all expanded, one below the other. A persistent index ends when its node loses
/// its row.
class TreeModel final : public RowModel {
    Q_OBJECT

  public:
    explicit TreeModel(child::TreeView& tree, QObject* parent = nullptr) : RowModel(parent), tree_(tree) {}

    /// Goes the steps from what was shown to what the tree holds.
    void Follow(const std::vector<child::RowChange>& changes);

    int columnCount(const QModelIndex& parent = {}) const override { return parent.isValid() ? 0 : 1; }

    Position HeldRows() const override { return tree_.Tree().RowCount(); }
    RowKey KeyAt(Position position) const override { return KeyOf(tree_.Tree().AtRow(position)); }
    std::optional<Position> PositionOf(RowKey key) const override;
    RowKey KeyOf(child::NodeId node) const;

  protected:
    QString HeldText(Position position, int column) const override;
    QPixmap HeldIcon(Position position, int column) const override;

  private:
    child::TreeView& tree_;  // read while connected
};

}  // namespace tessel::qt
