#pragma once

#include <cstdint>
#include <vector>

namespace tessel::child {

/// One step from what a peer shows to what the list holds. Positions count from 0, in the list as it is at that step.
struct RowChange {
    enum class Kind : std::uint8_t {
        Inserted,   ///< `count` rows stand new from `first` on
        Removed,    ///< `count` rows from `first` on have gone
        Changed,    ///< rows may read otherwise
        Reordered,  ///< the same rows, `count` in all, stand in another order and may read otherwise
        Reset,      ///< read the whole list anew
    };
    Kind kind = Kind::Reset;
    std::uint32_t first = 0;
    std::uint32_t count = 0;

    friend bool operator==(const RowChange&, const RowChange&) = default;
};

/// What has happened to the rows since a peer last looked, in few entries: 100,000 rows appended and filled are one. Steps that
/// do not fold into few entries become one `Reset`, or one wide range where rows were only changed.
class RowJournal {
  public:
    void Inserted(std::uint32_t first, std::uint32_t count = 1);
    void Removed(std::uint32_t first, std::uint32_t count = 1);
    void Changed(std::uint32_t first, std::uint32_t count = 1);
    /// All `count` rows of the list have been put in another order.
    void Reordered(std::uint32_t count);
    void Reset();

    /// Whether all has to be read anew: further changes add nothing.
    bool IsReset() const { return !changes_.empty() && changes_.front().kind == RowChange::Kind::Reset; }
    /// The steps in their order; the journal is empty afterwards.
    std::vector<RowChange> Take();

  private:
    static constexpr std::size_t limit = 256;

    RowChange* Last(RowChange::Kind kind);
    void Add(RowChange change);
    void Shorten();

    std::vector<RowChange> changes_;
};

}  // namespace tessel::child
