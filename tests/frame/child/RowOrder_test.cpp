#include "frame/child/RowOrder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <numeric>
#include <random>
#include <utility>
#include <vector>

namespace tessel::child {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

using Rows = std::vector<RowId>;

RowOrder OrderOf(const Rows& rows) {
    RowOrder order;
    for (const RowId row : rows) order.Append(row);
    return order;
}

Rows Upto(RowId count) {
    Rows rows(count);
    std::iota(rows.begin(), rows.end(), RowId{0});
    return rows;
}

/// Both directions of every row.
void ExpectIs(const RowOrder& order, const Rows& rows) {
    ASSERT_EQ(order.Size(), rows.size());
    ASSERT_EQ(order.All(), rows);
    for (RowOrder::Position position = 0; position < rows.size(); ++position) {
        ASSERT_EQ(order.At(position), rows[position]) << "at " << position;
        ASSERT_EQ(order.PositionOf(rows[position]), position) << "of " << rows[position];
    }
}

/// Inserts and removes at random as a vector does, with rows numbered as a list with a free list numbers them.
class Model {
  public:
    explicit Model(unsigned seed) : numbers_(seed) {}

    void Insert() {
        const RowId row = free_.empty() ? static_cast<RowId>(rows.size()) : free_.back();
        if (!free_.empty()) free_.pop_back();
        const auto position = Upto(rows.size());
        rows.insert(rows.begin() + position, row);
        order.Insert(position, row);
    }
    void Remove() {
        const auto position = Upto(rows.size() - 1);
        ASSERT_EQ(order.Remove(position), rows[position]);
        free_.push_back(rows[position]);
        rows.erase(rows.begin() + position);
    }
    bool Chance(double share) { return std::bernoulli_distribution(share)(numbers_); }
    void Check() const { ExpectIs(order, rows); }

    RowOrder order;
    Rows rows;

  private:
    /// 0 to `last`, its two ends more often than the rest.
    RowOrder::Position Upto(std::size_t last) {
        const int kind = std::uniform_int_distribution(0, 9)(numbers_);
        if (kind == 0) return 0;
        if (kind == 1) return static_cast<RowOrder::Position>(last);
        return static_cast<RowOrder::Position>(std::uniform_int_distribution<std::size_t>(0, last)(numbers_));
    }

    std::mt19937 numbers_;
    Rows free_;
};

TEST(RowOrderTest, ANewOrderIsEmpty) {
    const RowOrder order;
    EXPECT_TRUE(order.Empty());
    EXPECT_THAT(order.All(), IsEmpty());
}

TEST(RowOrderTest, AppendedRowsStandInTheirOrder) { ExpectIs(OrderOf({7, 3, 9}), {7, 3, 9}); }

TEST(RowOrderTest, InsertPutsARowBeforeTheOneAtThePosition) {
    RowOrder order = OrderOf({7, 3});
    order.Insert(1, 5);
    order.Insert(0, 8);
    order.Insert(4, 1);
    ExpectIs(order, {8, 7, 5, 3, 1});
}

TEST(RowOrderTest, RemoveGivesTheRowAndClosesTheGap) {
    RowOrder order = OrderOf({7, 3, 9});
    EXPECT_EQ(order.Remove(1), 3u);
    ExpectIs(order, {7, 9});
}

TEST(RowOrderTest, ManyAppendedRowsAreFoundBothWays) { ExpectIs(OrderOf(Upto(20'000)), Upto(20'000)); }

TEST(RowOrderTest, RowsInsertedAtTheFrontStandReversed) {
    RowOrder order;
    Rows reversed = Upto(5'000);
    for (const RowId row : reversed) order.Insert(0, row);
    std::reverse(reversed.begin(), reversed.end());
    ExpectIs(order, reversed);
}

TEST(RowOrderTest, AnOrderEmptiedFromEitherEndTakesRowsAgain) {
    for (const bool fromTheEnd : {false, true}) {
        RowOrder order = OrderOf(Upto(3'000));
        while (!order.Empty()) order.Remove(fromTheEnd ? order.Size() - 1 : 0);
        order.Append(2);
        order.Insert(0, 1);
        EXPECT_THAT(order.All(), ElementsAre(1, 2));
    }
}

TEST(RowOrderTest, AssignReplacesTheOrder) {
    RowOrder order = OrderOf(Upto(3'000));
    Rows shuffled = Upto(3'000);
    std::shuffle(shuffled.begin(), shuffled.end(), std::mt19937(1));
    order.Assign(shuffled);
    ExpectIs(order, shuffled);
}

TEST(RowOrderTest, ClearLeavesNothing) {
    RowOrder order = OrderOf(Upto(3'000));
    order.Clear();
    EXPECT_TRUE(order.Empty());
    order.Append(4);
    ExpectIs(order, {4});
}

TEST(RowOrderTest, AnOrderThatWasFilledTakesAnyChangeAfterwards) {
    constexpr RowId many = 1'300;  // of several chunks
    for (const RowOrder::Position position : {0u, 1u, many / 2, many - 1}) {
        RowOrder order = OrderOf(Upto(many));
        Rows rows = Upto(many);
        EXPECT_EQ(order.Remove(position), position);
        rows.erase(rows.begin() + position);
        ExpectIs(order, rows);
        order.Insert(position / 2, position);
        rows.insert(rows.begin() + position / 2, position);
        ExpectIs(order, rows);
        order.Append(many);
        rows.push_back(many);
        ExpectIs(order, rows);
    }
}

TEST(RowOrderTest, RowsThatFollowOneAnotherMayBeginAtAnyNumber) {
    Rows rows(700);
    std::iota(rows.begin(), rows.end(), RowId{17});
    RowOrder order = OrderOf(rows);
    ExpectIs(order, rows);
    EXPECT_EQ(order.Remove(699), 716u);
    rows.pop_back();
    ExpectIs(order, rows);
    EXPECT_EQ(order.Remove(0), 17u);
    rows.erase(rows.begin());
    ExpectIs(order, rows);
    while (!order.Empty()) order.Remove(order.Size() - 1);
    order.Append(5);
    order.Append(6);
    ExpectIs(order, {5, 6});
}

TEST(RowOrderTest, TheLastRowMayGoAndAnotherComeInItsPlace) {
    RowOrder order = OrderOf(Upto(600));
    EXPECT_EQ(order.Remove(599), 599u);
    EXPECT_EQ(order.Remove(598), 598u);
    ExpectIs(order, Upto(598));
    order.Append(599);
    order.Append(598);
    Rows rows = Upto(600);
    std::swap(rows[598], rows[599]);
    ExpectIs(order, rows);
}

TEST(RowOrderTest, BehavesAsAVectorThatGrowsShrinksAndHovers) {
    for (const unsigned seed : {1u, 2u, 3u}) {
        Model model(seed);
        for (const double growth : {0.9, 0.1, 0.5, 0.8, 0.2}) {
            for (int step = 0; step < 6'000; ++step) {
                if (model.rows.empty() || model.Chance(growth))
                    model.Insert();
                else
                    model.Remove();
                if (step % 1'500 == 0) model.Check();
                if (testing::Test::HasFatalFailure()) return;
            }
            model.Check();
        }
    }
}

}  // namespace
}  // namespace tessel::child
