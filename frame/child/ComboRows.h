#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "frame/child/RowChains.h"
#include "frame/child/RowOrder.h"
#include "frame/child/TextStore.h"

namespace tessel::child {

/// The rows of a drop-down list: a text and a 32-bit number each, in the order in which they were added or sorted stably by their
/// texts without regard to case. Made for 100,000 rows: adding, removing and finding by number or by text cost the same however
/// many rows there are; what is found is always the first in the order. A row takes some 14 bytes beside its text, 8 more
/// where rows are sorted or have been removed, and 28 more once rows have been looked for by number and by text.
class ComboRows {
  public:
    using Position = RowOrder::Position;
    enum class Order : std::uint8_t { AsAdded, ByText };

    explicit ComboRows(Order order) : ordering_(order) {}

    Order Ordering() const { return ordering_; }
    Position Size() const { return order_.Size() + static_cast<Position>(pending_.size()); }
    RowId Add(std::string_view text, std::int32_t data);
    void Remove(Position position);
    void Clear();

    /// Good until rows are removed.
    std::string_view Text(Position position) const { return TextOf(RowAt(position)); }
    std::int32_t Data(Position position) const { return rows_[RowAt(position)].data; }
    void SetData(Position position, std::int32_t data);

    RowId RowAt(Position position) const;
    /// Only for a row that is there.
    Position PositionOf(RowId row) const;

    bool HasData(std::int32_t data) const;
    std::optional<Position> FindData(std::int32_t data) const;
    std::optional<Position> FindText(std::string_view text) const;
    /// The first row from `from` on, then from the top, whose text begins so, without regard to case.
    std::optional<Position> FindStart(std::string_view start, Position from) const;

  private:
    struct Row {
        TextStore::Place text = 0;
        std::int32_t data = 0;
    };

    std::string_view TextOf(RowId row) const { return texts_.Read(rows_[row].text); }
    bool IsSorted() const { return ordering_ == Order::ByText; }
    /// Rows that were added to a sorted list take their places.
    void Settle() const;
    void SettleFew() const;
    void SettleMany() const;
    Position PlaceFor(RowId row) const;
    void SortByPosition(std::vector<RowId>& rows) const;
    /// The indexes are made when something is looked for.
    void WantDataIndex() const;
    void WantTextIndex() const;
    RowId FirstWithData(std::int32_t data) const;
    void IndexData(RowId row) const;
    void UnindexData(RowId row);
    void IndexText(RowId row) const;
    void KeepTextsSmall();

    Order ordering_;
    RowPages<Row> rows_;
    RowId end_ = 0;            // rows that were ever in use at once
    std::vector<RowId> free_;  // those of them that are not in use
    TextStore texts_;
    std::size_t textBytes_ = 0;  // in use
    mutable RowOrder order_;
    mutable std::vector<RowId> pending_;  // added to a sorted list and not yet in their places
    mutable RowChains byData_, byText_;
    mutable bool dataIndexed_ = false, textIndexed_ = false;
};

}  // namespace tessel::child
