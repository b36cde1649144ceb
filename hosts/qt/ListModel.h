#pragma once

#include <QIcon>
#include <optional>
#include <vector>

#include "frame/child/ListView.h"
#include "hosts/qt/RowModel.h"

namespace tessel::qt {

/// The rows of a list, with its columns.
class ListModel final : public RowModel {
    Q_OBJECT

  public:
    explicit ListModel(child::ListView& list, QObject* parent = nullptr) : RowModel(parent), list_(list) {}

    /// Goes the steps from what was shown to what the list holds, and takes over its headers.
    void Follow(const std::vector<child::RowChange>& changes);

    int columnCount(const QModelIndex& parent = {}) const override { return parent.isValid() ? 0 : columns_; }
    QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;

    Position HeldRows() const override { return list_.Rows().Count(); }
    RowKey KeyAt(Position position) const override { return KeyOf(list_.Rows().At(position)); }
    std::optional<Position> PositionOf(RowKey key) const override;

    RowKey KeyOf(child::RowId row) const { return KeyFor(row, list_.Rows().Ref(row).serial); }

  protected:
    QString HeldText(Position position, int column) const override;
    QPixmap HeldIcon(Position position, int column) const override;

  private:
    void FollowHeaders();
    QIcon HeaderIcon(const frame::Variant& icon) const;

    child::ListView& list_;  // read while connected
    int columns_ = 1;        // at least one, which shows the text
    std::uint32_t headers_ = 0;
};

Qt::Alignment ToQt(child::AlignmentConstants alignment);

}  // namespace tessel::qt
