#pragma once

#include <QAbstractTableModel>
#include <QPixmap>
#include <optional>
#include <span>
#include <vector>

#include "frame/child/ImageList.h"
#include "frame/child/RowJournal.h"

namespace tessel::qt {

/// The rows of a child as a model: it holds no row and no text, only how many there are. Rows come and go by `FollowRows`, which
/// makes one signal of whatever has happened; where rows have gone and come in several places it is a new layout, after the number
/// of rows was made right at the end.
///
/// A persistent index stays with its row wherever that moves, and becomes invalid when the row goes or all rows are read anew.
/// Which rows are selected is the child's to say: no selection model knows.
class RowModel : public QAbstractTableModel {
    Q_OBJECT

  public:
    using Position = std::uint32_t;
    /// Names a row wherever it moves, and no other once it has gone. 0 names none.
    using RowKey = quintptr;

    using QAbstractTableModel::QAbstractTableModel;
    /// The child goes: the model is empty from now on.
    void Disconnect();

    int rowCount(const QModelIndex& parent = {}) const override { return parent.isValid() ? 0 : rows_; }
    QModelIndex index(int row, int column, const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
    Qt::ItemFlags flags(const QModelIndex& index) const override;

    /// The text of a cell.
    QString Text(int row, int column) const;

    // What the child holds by now, which is ahead of the model until that has followed.
    virtual Position HeldRows() const = 0;
    virtual RowKey KeyAt(Position position) const = 0;
    /// Nothing for one that has gone, or is not among the rows at present.
    virtual std::optional<Position> PositionOf(RowKey key) const = 0;

  protected:
    virtual QString HeldText(Position position, int column) const = 0;
    virtual QPixmap HeldIcon(Position position, int column) const = 0;

    bool IsConnected() const { return connected_; }
    /// Goes the steps from what was shown to what the child holds.
    void FollowRows(std::span<const child::RowChange> changes);
    /// A key for a thing's number in its storage and the serial that no other thing of that number has.
    static RowKey KeyFor(std::uint32_t number, std::uint32_t serial);
    static std::uint32_t NumberOf(RowKey key) { return static_cast<std::uint32_t>(key); }
    static std::uint32_t SerialOf(RowKey key);

  private:
    void Rearrange();
    /// Where a row now stands that is shown at a place; nothing for one that has gone.
    std::optional<Position> HeldAt(int row) const;

    bool connected_ = true;
    int rows_ = 0;
    child::RowChange coming_{child::RowChange::Kind::Changed, 0, 0};  // told, and not yet taken over
};

/// The picture of an icon at the size of its list, in pixels of a screen of this scale; null for none.
QPixmap IconOf(child::ImageList* images, const frame::Variant& icon, double scale);

/// Whether a step moves rows.
bool Moves(const child::RowChange& change);

}  // namespace tessel::qt
