#include "frame/child/KeyIndex.h"

#include <gtest/gtest.h>

#include <map>
#include <random>

namespace tessel::child {
namespace {

TEST(KeyIndexTest, AfterAnyChangesItFindsWhatIsThereAndNothingElse) {
    std::mt19937 numbers(41);
    constexpr std::uint32_t fewHashes = 64;  // so that many stand beside their home
    KeyIndex index;
    std::map<RowId, std::uint32_t> rows;
    for (int step = 0; step < 20'000; ++step) {
        const RowId row = numbers() % 300;
        const bool isThere = rows.contains(row);
        if (isThere) {
            index.Remove(row, rows[row]);
            rows.erase(row);
        } else {
            rows[row] = numbers() % fewHashes * 0x01000193u;
            index.Add(row, rows[row]);
        }
        const RowId asked = numbers() % 300;
        const std::uint32_t hash = rows.contains(asked) ? rows[asked] : 0;
        const RowId found = index.Find(hash, [&](RowId candidate) { return candidate == asked; });
        ASSERT_EQ(found, rows.contains(asked) ? asked : KeyIndex::none) << step;
    }
    index.Clear();
    EXPECT_EQ(index.Find(0, [](RowId) { return true; }), KeyIndex::none);
}

}  // namespace
}  // namespace tessel::child
