#include "frame/child/RowOrder.h"

#include <algorithm>
#include <bit>
#include <cassert>
#include <numeric>
#include <utility>

namespace tessel::child {

void RowOrder::Append(RowId row) {
    if (plain_ && size_ == 0) first_ = row;
    if (plain_ && row == first_ + size_) {
        ++size_;
    } else {
        Spread();
        AppendToChunks(row);
    }
}

/// From here on the ids stand in chunks.
void RowOrder::Spread() {
    if (!std::exchange(plain_, false)) return;
    const RowId end = first_ + std::exchange(size_, 0);
    for (RowId row = first_; row < end; ++row) AppendToChunks(row);
}

void RowOrder::AppendToChunks(RowId row) {
    if (sequence_.empty() || ChunkAt(LastOrdinal()).rows.size() == capacity) AppendChunk();
    NoteChunk(row, sequence_.back());
    ChunkAt(LastOrdinal()).rows.push_back(row);
    Count(LastOrdinal(), 1);
    ++size_;
}

void RowOrder::Insert(Position position, RowId row) {
    assert(position <= size_);
    if (position == size_) return Append(row);
    Spread();
    Place place = Find(position);
    if (ChunkAt(place.ordinal).rows.size() == capacity) {
        Split(place.ordinal);
        place = Find(position);
    }
    NoteChunk(row, sequence_[place.ordinal]);
    auto& rows = ChunkAt(place.ordinal).rows;
    rows.insert(rows.begin() + place.offset, row);
    Count(place.ordinal, 1);
    ++size_;
}

RowId RowOrder::Remove(Position position) {
    if (plain_ && position + 1 == size_) return first_ + --size_;
    Spread();
    const Place place = Find(position);
    auto& rows = ChunkAt(place.ordinal).rows;
    const RowId row = rows[place.offset];
    rows.erase(rows.begin() + place.offset);
    Count(place.ordinal, -1);
    --size_;
    MergeOrDrop(place.ordinal);
    if (Empty()) Clear();
    return row;
}

void RowOrder::Clear() { *this = RowOrder(); }

RowId RowOrder::At(Position position) const {
    if (plain_) return first_ + position;
    const Place place = Find(position);
    return ChunkAt(place.ordinal).rows[place.offset];
}

RowOrder::Position RowOrder::PositionOf(RowId row) const {
    if (plain_) return row - first_;
    const Chunk& chunk = chunks_[chunkOf_[row]];
    if (chunk.rows.back() == row && chunk.ordinal == LastOrdinal()) return size_ - 1;
    const auto found = std::find(chunk.rows.begin(), chunk.rows.end(), row);
    assert(found != chunk.rows.end());
    return Before(chunk.ordinal) + static_cast<Position>(found - chunk.rows.begin());
}

std::vector<RowId> RowOrder::All() const {
    std::vector<RowId> all(plain_ ? size_ : 0);
    if (plain_) {
        std::iota(all.begin(), all.end(), first_);
        return all;
    }
    all.reserve(size_);
    for (const ChunkId chunk : sequence_) all.insert(all.end(), chunks_[chunk].rows.begin(), chunks_[chunk].rows.end());
    return all;
}

void RowOrder::Assign(std::span<const RowId> rows) {
    RowOrder fresh;
    for (const RowId row : rows) fresh.Append(row);
    *this = std::move(fresh);
}

RowOrder::Place RowOrder::Find(Position position) const {
    assert(position < size_);
    std::uint32_t ordinal = 0;
    for (std::size_t step = std::bit_floor(counts_.size()); step > 0; step /= 2) {
        const std::size_t next = ordinal + step;
        if (next > counts_.size() || counts_[next - 1] > position) continue;
        ordinal = static_cast<std::uint32_t>(next);
        position -= counts_[next - 1];
    }
    return {ordinal, position};
}

RowOrder::ChunkId RowOrder::NewChunk() {
    if (spare_.empty()) {
        chunks_.emplace_back();
        spare_.push_back(static_cast<ChunkId>(chunks_.size() - 1));
    }
    const ChunkId chunk = spare_.back();
    chunks_[chunk].rows.reserve(capacity);
    spare_.pop_back();
    return chunk;
}

void RowOrder::AppendChunk() {
    const ChunkId chunk = NewChunk();
    sequence_.push_back(chunk);
    chunks_[chunk].ordinal = LastOrdinal();
    // An empty node sums what its lower neighbours hold, from its own lowest bit on.
    const auto number = static_cast<std::uint32_t>(sequence_.size());
    const std::uint32_t first = number & (number - 1);
    counts_.push_back(Before(number - 1) - Before(first));
}

void RowOrder::Split(std::uint32_t ordinal) {
    const ChunkId added = NewChunk();
    sequence_.insert(sequence_.begin() + ordinal + 1, added);
    auto& rows = ChunkAt(ordinal).rows;
    Adopt(added, std::span(rows).subspan(capacity / 2));
    rows.resize(capacity / 2);
    RebuildCounts();
}

void RowOrder::MergeOrDrop(std::uint32_t ordinal) {
    const std::size_t left = ChunkAt(ordinal).rows.size();
    if (left == 0) return Drop(ordinal);
    if (left > capacity / 4) return;
    const auto joins = [&](std::uint32_t other) { return ChunkAt(other).rows.size() + left <= capacity / 2; };
    if (ordinal < LastOrdinal() && joins(ordinal + 1)) {
        Adopt(sequence_[ordinal], ChunkAt(ordinal + 1).rows);
        Drop(ordinal + 1);
    } else if (ordinal > 0 && joins(ordinal - 1)) {
        Adopt(sequence_[ordinal - 1], ChunkAt(ordinal).rows);
        Drop(ordinal);
    }
}

void RowOrder::Drop(std::uint32_t ordinal) {
    ChunkAt(ordinal).rows = {};
    spare_.push_back(sequence_[ordinal]);
    sequence_.erase(sequence_.begin() + ordinal);
    RebuildCounts();
}

void RowOrder::Adopt(ChunkId chunk, std::span<const RowId> rows) {
    for (const RowId row : rows) chunkOf_[row] = chunk;
    chunks_[chunk].rows.insert(chunks_[chunk].rows.end(), rows.begin(), rows.end());
}

void RowOrder::NoteChunk(RowId row, ChunkId chunk) {
    chunkOf_.MakeRoom(row);
    chunkOf_[row] = chunk;
}

void RowOrder::Count(std::uint32_t ordinal, int change) {
    for (std::size_t node = std::size_t{ordinal} + 1; node <= counts_.size(); node += node & (~node + 1))
        counts_[node - 1] += static_cast<Position>(change);
}

RowOrder::Position RowOrder::Before(std::uint32_t ordinal) const {
    Position sum = 0;
    for (std::uint32_t node = ordinal; node > 0; node &= node - 1) sum += counts_[node - 1];
    return sum;
}

void RowOrder::RebuildCounts() {
    counts_.assign(sequence_.size(), 0);
    for (std::uint32_t ordinal = 0; ordinal < sequence_.size(); ++ordinal) {
        ChunkAt(ordinal).ordinal = ordinal;
        counts_[ordinal] += static_cast<Position>(ChunkAt(ordinal).rows.size());
        const std::size_t node = std::size_t{ordinal} + 1;
        const std::size_t above = node + (node & (~node + 1));
        if (above <= counts_.size()) counts_[above - 1] += counts_[ordinal];
    }
}

}  // namespace tessel::child
