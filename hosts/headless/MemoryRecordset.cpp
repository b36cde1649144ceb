#include "hosts/headless/MemoryRecordset.h"

#include <utility>

#include "frame/Error.h"

namespace tessel::headless {

MemoryRecordset::MemoryRecordset(std::string path, std::vector<std::string> columns, std::vector<Row> rows)
    : path_(std::move(path)), columns_(std::move(columns)), rows_(std::move(rows)) {
    for (const Row& row : rows_)
        if (row.size() != columns_.size())
            throw frame::ControlError(frame::errors::invalidCall, "A row of the recordset has not a value for each column");
}

void MemoryRecordset::WantRow() const {
    if (at_ == rows_.size()) throw frame::ControlError(frame::errors::noCurrentRow);
}

void MemoryRecordset::MoveFirst() {
    at_ = 0;
    WantRow();
}

void MemoryRecordset::MoveNext() {
    WantRow();
    ++at_;
}

frame::Variant MemoryRecordset::FieldValue(std::int32_t field) {
    WantRow();
    return rows_[at_][static_cast<std::size_t>(field)];
}

}  // namespace tessel::headless
