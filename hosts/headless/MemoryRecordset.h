#pragma once

#include <string>
#include <vector>

#include "frame/Recordset.h"

namespace tessel::headless {

/// Rows that stand in memory. It stands on its first row when it is made.
class MemoryRecordset final : public frame::Recordset {
  public:
    using Row = std::vector<frame::Variant>;

    /// `path` is the object's place in logs. Each row has a value for each column, else error 5.
    MemoryRecordset(std::string path, std::vector<std::string> columns, std::vector<Row> rows);

    void MoveFirst() override;
    void MoveNext() override;
    bool AtEnd() override { return at_ == rows_.size(); }
    std::int32_t FieldCount() override { return static_cast<std::int32_t>(columns_.size()); }
    std::string FieldName(std::int32_t field) override { return columns_[static_cast<std::size_t>(field)]; }
    frame::Variant FieldValue(std::int32_t field) override;
    std::string Path() const override { return path_; }

  private:
    void WantRow() const;

    std::string path_;
    std::vector<std::string> columns_;
    std::vector<Row> rows_;
    std::size_t at_ = 0;
};

}  // namespace tessel::headless
