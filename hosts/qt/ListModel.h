#pragma once

#include <QAbstractTableModel>
#include <QIcon>
#include <QPixmap>
#include <optional>
#include <span>
#include <vector>

#include "frame/child/ListView.h"

namespace tessel::qt {

/// The rows of a list as a model: it holds no row and no text, only how many there are. Rows and columns come and go by `Follow`,
/// which makes one signal of whatever has happened; where rows have gone and come in several places it is a new layout, after the
/// number of rows was made right at the end.
///
/// A persistent index stays with its row wherever that moves, and becomes invalid when the row goes or all rows are read anew.
/// Which rows are selected is the list's to say: no selection model knows.
class ListModel final : public QAbstractTableModel {
    Q_OBJECT

  public:
    explicit ListModel(child::ListView& list, QObject* parent = nullptr) : QAbstractTableModel(parent), list_(&list) {}
    /// The list goes: the model is empty from now on.
    void Disconnect();

    /// Goes the steps from what was shown to what the list holds, and takes over its headers.
    void Follow(const std::vector<child::RowChange>& changes);

    int rowCount(const QModelIndex& parent = {}) const override { return parent.isValid() ? 0 : rows_; }
    int columnCount(const QModelIndex& parent = {}) const override { return parent.isValid() ? 0 : columns_; }
    QModelIndex index(int row, int column, const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;
    Qt::ItemFlags flags(const QModelIndex& index) const override;

    /// The text of a cell.
    QString Text(int row, int column) const;

  private:
    void FollowRows(std::span<const child::RowChange> changes);
    void FollowHeaders();
    void Rearrange();
    /// Where a row now stands that is shown at a place; nothing for one that has gone.
    std::optional<child::ListRows::Position> PositionOf(int row) const;
    QIcon HeaderIcon(const frame::Variant& icon) const;

    child::ListView* list_;
    int rows_ = 0;
    int columns_ = 1;  // at least one, which shows the text
    std::uint32_t headers_ = 0;
    child::RowChange coming_{child::RowChange::Kind::Changed, 0, 0};  // told, and not yet taken over
};

/// The picture of an icon at the size of its list, in pixels of a screen of this scale; null for none.
QPixmap IconOf(child::ImageList* images, const frame::Variant& icon, double scale);

Qt::Alignment ToQt(child::AlignmentConstants alignment);

}  // namespace tessel::qt
