#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

namespace tessel::child {

/// A row by its number in the list's storage. A number is used again once its row has gone.
using RowId = std::uint32_t;

/// Something of each row, by its number. It grows page by page: nothing in it moves, and there is no room in reserve beyond one
/// page, so that it takes what its elements take. A control captures in one what its row source makes texts of.
template <class T>
class RowPages {
  public:
    T& operator[](RowId row) { return (*pages_[row / pageSize])[row % pageSize]; }
    const T& operator[](RowId row) const { return (*pages_[row / pageSize])[row % pageSize]; }

    /// How many rows there is room for: any number below it may be used.
    std::size_t Size() const { return pages_.size() * pageSize; }
    /// Makes room for a row. New elements are as `T()` makes them.
    void MakeRoom(RowId row) {
        while (row >= Size()) pages_.push_back(std::make_unique<Page>());
    }
    void Clear() { *this = RowPages(); }

  private:
    static constexpr std::size_t pageSize = 256;
    using Page = std::array<T, pageSize>;

    std::vector<std::unique_ptr<Page>> pages_;
};

}  // namespace tessel::child
