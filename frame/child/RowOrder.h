#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

#include "frame/child/RowPages.h"

namespace tessel::child {

/// The order of the rows of a list: a sequence of row ids, each at most once, with positions from 0. Inserting, removing and
/// both ways of looking up stay cheap with hundreds of thousands of rows; appending is the cheapest.
///
/// As long as each id is the next after the one before it, as in a list that was filled and left so, nothing is kept but the
/// first one and how many there are. After that they stand in chunks whose counts are summed in a binary indexed tree, so that a
/// position is found through the tree and the position of an id through its chunk: about 8 bytes an id.
class RowOrder {
  public:
    using Position = std::uint32_t;

    Position Size() const { return size_; }
    bool Empty() const { return size_ == 0; }

    void Append(RowId row);
    /// `position` from 0 to `Size()`.
    void Insert(Position position, RowId row);
    /// Gives the id that stood there.
    RowId Remove(Position position);
    void Clear();

    RowId At(Position position) const;
    /// Only for an id that is in the order.
    Position PositionOf(RowId row) const;

    /// All ids in their order, and a new order as a whole.
    std::vector<RowId> All() const;
    void Assign(std::span<const RowId> rows);

  private:
    static constexpr std::size_t capacity = 512;
    using ChunkId = std::uint32_t;

    struct Chunk {
        std::vector<RowId> rows;
        std::uint32_t ordinal = 0;  // its place among the chunks
    };
    struct Place {
        std::uint32_t ordinal;
        std::uint32_t offset;
    };

    void Spread();
    void AppendToChunks(RowId row);
    Chunk& ChunkAt(std::uint32_t ordinal) { return chunks_[sequence_[ordinal]]; }
    const Chunk& ChunkAt(std::uint32_t ordinal) const { return chunks_[sequence_[ordinal]]; }
    std::uint32_t LastOrdinal() const { return static_cast<std::uint32_t>(sequence_.size()) - 1; }
    Place Find(Position position) const;
    ChunkId NewChunk();
    void AppendChunk();
    void Split(std::uint32_t ordinal);
    void MergeOrDrop(std::uint32_t ordinal);
    void Drop(std::uint32_t ordinal);
    void Adopt(ChunkId chunk, std::span<const RowId> rows);
    void NoteChunk(RowId row, ChunkId chunk);

    // The binary indexed tree of the counts, one node a chunk.
    void Count(std::uint32_t ordinal, int change);
    Position Before(std::uint32_t ordinal) const;
    void RebuildCounts();

    bool plain_ = true;  // the ids follow one another from `first_` on, and there are no chunks
    RowId first_ = 0;
    std::vector<Chunk> chunks_;
    std::vector<ChunkId> spare_;
    std::vector<ChunkId> sequence_;  // the chunks in their order
    std::vector<Position> counts_;
    RowPages<ChunkId> chunkOf_;
    Position size_ = 0;
};

}  // namespace tessel::child
