#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "frame/child/RowTexts.h"

namespace tessel::child {

/// What a row is sorted by: its text in one column, and the number that stands in for it where there is one.
struct RowKey {
    std::string text;
    std::optional<std::uint64_t> number;
};

/// Compares and sorts rows by the texts of one column without regard to case, as `frame::CompareNoCase` orders them.
class RowSort {
  public:
    RowSort(const RowTexts& texts, int column) : texts_(texts), column_(column) {}

    RowKey KeyOf(RowId row) const;
    /// Below, at or above 0 as the row orders before, with or behind a key.
    int Compare(RowId row, const RowKey& key) const;
    /// Sorts stably, in either direction. Whatever a source throws leaves the rows as they are.
    void Sort(std::vector<RowId>& rows, bool ascending) const;

  private:
    struct Word;

    bool SortByNumbers(std::vector<RowId>& rows, bool ascending) const;
    void SortByTexts(std::vector<RowId>& rows, bool ascending) const;

    const RowTexts& texts_;
    int column_;
    mutable std::string scratch_;
};

/// Appends a text so that bytes order as `frame::CompareNoCase` orders characters: its folded characters, with a byte that is no
/// part of valid UTF-8 as the three bytes that its escape would have.
void AppendOrdered(std::string& out, std::string_view text);

}  // namespace tessel::child
