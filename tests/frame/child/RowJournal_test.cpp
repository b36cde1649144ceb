#include "frame/child/RowJournal.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <random>
#include <vector>

namespace tessel::child {

void PrintTo(const RowChange& change, std::ostream* out) {
    constexpr const char* kinds[] = {"Inserted", "Removed", "Changed", "Reordered", "Reset"};
    *out << kinds[static_cast<int>(change.kind)] << ' ' << change.first << '+' << change.count;
}

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

RowChange Inserted(std::uint32_t first, std::uint32_t count) { return {RowChange::Kind::Inserted, first, count}; }
RowChange Removed(std::uint32_t first, std::uint32_t count) { return {RowChange::Kind::Removed, first, count}; }
RowChange Changed(std::uint32_t first, std::uint32_t count) { return {RowChange::Kind::Changed, first, count}; }
constexpr RowChange reset{RowChange::Kind::Reset, 0, 0};

TEST(RowJournalTest, ANewJournalIsEmpty) { EXPECT_THAT(RowJournal().Take(), IsEmpty()); }

TEST(RowJournalTest, TakeLeavesAnEmptyJournal) {
    RowJournal journal;
    journal.Inserted(0);
    journal.Take();
    EXPECT_THAT(journal.Take(), IsEmpty());
}

TEST(RowJournalTest, RowsAppendedAndFilledAreOneEntry) {
    RowJournal journal;
    for (std::uint32_t row = 0; row < 100'000; ++row) {
        journal.Inserted(20 + row);
        journal.Changed(20 + row);
    }
    EXPECT_THAT(journal.Take(), ElementsAre(Inserted(20, 100'000)));
}

TEST(RowJournalTest, RowsInsertedWithinNewRowsJoinThem) {
    RowJournal journal;
    for (const std::uint32_t position : {5u, 5u, 6u, 8u}) journal.Inserted(position);
    EXPECT_THAT(journal.Take(), ElementsAre(Inserted(5, 4)));
}

TEST(RowJournalTest, RowsInsertedElsewhereAreEntriesOfTheirOwn) {
    RowJournal journal;
    for (const std::uint32_t position : {5u, 4u, 9u}) journal.Inserted(position);
    EXPECT_THAT(journal.Take(), ElementsAre(Inserted(5, 1), Inserted(4, 1), Inserted(9, 1)));
}

TEST(RowJournalTest, AnotherOrderReadsAllRowsAnew) {
    RowJournal journal;
    journal.Inserted(0);
    journal.Changed(3);
    journal.Reordered(9);
    journal.Changed(4);
    journal.Reordered(9);
    journal.Removed(2);
    journal.Reordered(8);
    constexpr auto reordered = RowChange::Kind::Reordered;
    EXPECT_THAT(journal.Take(), ElementsAre(Inserted(0, 1), RowChange{reordered, 0, 9}, Removed(2, 1), RowChange{reordered, 0, 8}));
    journal.Reset();
    journal.Reordered(8);
    EXPECT_THAT(journal.Take(), ElementsAre(reset));
}

TEST(RowJournalTest, ANewRowThatGoesAgainLeavesNoTrace) {
    RowJournal journal;
    journal.Inserted(3);
    journal.Removed(3);
    EXPECT_THAT(journal.Take(), IsEmpty());
}

TEST(RowJournalTest, RowsRemovedFromTheEndUpwardsAreOneEntry) {
    RowJournal journal;
    for (std::uint32_t row = 100; row-- > 40;) journal.Removed(row);
    EXPECT_THAT(journal.Take(), ElementsAre(Removed(40, 60)));
}

TEST(RowJournalTest, RowsRemovedAtOnePositionAreOneEntry) {
    RowJournal journal;
    for (int row = 0; row < 60; ++row) journal.Removed(40);
    EXPECT_THAT(journal.Take(), ElementsAre(Removed(40, 60)));
}

TEST(RowJournalTest, RangesFoldAsTheirRowsDo) {
    RowJournal journal;
    journal.Inserted(5, 10);
    journal.Inserted(15, 5);
    journal.Removed(7, 4);
    EXPECT_THAT(journal.Take(), ElementsAre(Inserted(5, 11)));
    journal.Removed(8, 2);
    journal.Removed(5, 6);
    EXPECT_THAT(journal.Take(), ElementsAre(Removed(5, 8)));
    journal.Inserted(5, 3);
    journal.Removed(6, 4);
    EXPECT_THAT(journal.Take(), ElementsAre(Inserted(5, 3), Removed(6, 4)));
}

TEST(RowJournalTest, ChangesOfNeighboursAreOneEntry) {
    RowJournal journal;
    for (const std::uint32_t row : {7u, 8u, 6u, 7u}) journal.Changed(row);
    journal.Changed(20);
    EXPECT_THAT(journal.Take(), ElementsAre(Changed(6, 3), Changed(20, 1)));
}

TEST(RowJournalTest, ResetMakesEarlierAndLaterStepsVoid) {
    RowJournal journal;
    journal.Inserted(0);
    journal.Reset();
    journal.Inserted(1);
    journal.Removed(0);
    journal.Changed(0);
    EXPECT_TRUE(journal.IsReset());
    EXPECT_THAT(journal.Take(), ElementsAre(reset));
}

TEST(RowJournalTest, TooManyStepsBecomeOneReset) {
    RowJournal journal;
    for (std::uint32_t row = 0; row < 257; ++row) journal.Inserted(10'000 - 2 * row);
    EXPECT_THAT(journal.Take(), ElementsAre(reset));
}

TEST(RowJournalTest, TooManyChangesBecomeOneWideRange) {
    RowJournal journal;
    for (std::uint32_t row = 0; row < 257; ++row) journal.Changed(1'000 - 2 * row);
    EXPECT_THAT(journal.Take(), ElementsAre(Changed(1'000 - 512, 513)));
}

/// A peer's rows: what it has read of each; 0 for a row that reads otherwise by now.
class Follower {
  public:
    void Apply(const std::vector<RowChange>& changes, const std::vector<int>& list) {
        for (const RowChange& change : changes) Step(change, list.size());
        for (std::size_t row = 0; row < rows.size(); ++row)
            if (rows[row] == toRead) rows[row] = list[row];
    }
    std::vector<int> rows;
    bool wasReset = false;

  private:
    static constexpr int toRead = -1;

    void Step(const RowChange& change, std::size_t size) {
        const auto first = rows.begin() + change.first;
        switch (change.kind) {
            case RowChange::Kind::Inserted:
                rows.insert(first, change.count, toRead);
                break;
            case RowChange::Kind::Removed:
                rows.erase(first, first + change.count);
                break;
            case RowChange::Kind::Changed:
                std::fill(first, first + change.count, toRead);
                break;
            case RowChange::Kind::Reordered:
                EXPECT_EQ(change.count, rows.size());
                std::fill(rows.begin(), rows.end(), toRead);
                break;
            case RowChange::Kind::Reset:
                rows.assign(size, toRead);
                wasReset = true;
                break;
        }
    }
};

TEST(RowJournalTest, AFollowerThatAppliesTheStepsHoldsTheList) {
    std::mt19937 numbers(7);
    const auto below = [&](std::size_t end) { return std::uniform_int_distribution<std::size_t>(0, end - 1)(numbers); };
    std::vector<int> list;
    RowJournal journal;
    Follower follower;
    for (int value = 1; value <= 50'000; ++value) {
        const auto kind = below(13) / 2;
        const auto near = list.empty() ? 0 : std::min(below(list.size()), below(list.size()));
        const auto at = static_cast<std::ptrdiff_t>(near);
        if (kind < 3 || list.empty()) {
            const std::size_t count = 1 + below(3);
            list.insert(list.begin() + at, count, value);
            journal.Inserted(static_cast<std::uint32_t>(at), static_cast<std::uint32_t>(count));
        } else if (kind == 3) {
            const std::size_t count = 1 + below(std::min<std::size_t>(list.size() - near, 4));
            list.erase(list.begin() + at, list.begin() + at + static_cast<std::ptrdiff_t>(count));
            journal.Removed(static_cast<std::uint32_t>(at), static_cast<std::uint32_t>(count));
        } else if (kind == 6) {
            std::shuffle(list.begin(), list.end(), numbers);
            journal.Reordered(static_cast<std::uint32_t>(list.size()));
        } else {
            list[near] = value;
            journal.Changed(static_cast<std::uint32_t>(at));
        }
        if (below(20) != 0) continue;
        follower.Apply(journal.Take(), list);
        ASSERT_EQ(follower.rows, list) << "after " << value << " steps";
        if (list.size() > 40) {
            list.clear();
            journal.Reset();
        }
    }
    EXPECT_TRUE(follower.wasReset);
}

}  // namespace
}  // namespace tessel::child
