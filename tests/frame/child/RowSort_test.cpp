#include "frame/child/RowSort.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdio>
#include <map>
#include <random>
#include <string>
#include <utility>
#include <vector>

#include "frame/Text.h"
#include "frame/child/ListRows.h"

namespace tessel::child {
namespace {

/// Random texts that share beginnings, end in each other, and hold letters of all lengths, zeros and bytes that are no UTF-8.
class TextMaker {
  public:
    explicit TextMaker(unsigned seed) : numbers_(seed) {}

    int Below(int end) { return std::uniform_int_distribution(0, end - 1)(numbers_); }
    std::string Text() {
        static const std::vector<std::string> parts = {"a",
                                                       "A",
                                                       "b",
                                                       "Z",
                                                       "Holiday picture ",
                                                       std::string(1, '\0'),
                                                       "\xC3\xA9",
                                                       "\xC3\x89",
                                                       "\x80",
                                                       "\xE9",
                                                       "\xF0\x9F\x98\x80",
                                                       "\xEE\x80\x80",
                                                       "\xE2\x84\xAA",
                                                       "k",
                                                       "\xFF",
                                                       " "};
        std::string text;
        for (int count = Below(6); count > 0; --count)
            text += parts[static_cast<std::size_t>(Below(static_cast<int>(parts.size())))];
        return text;
    }

  private:
    std::mt19937 numbers_;
};

int Sign(int number) { return (number > 0) - (number < 0); }

TEST(RowSortTest, OrderedBytesOrderAsTextsDoWithoutRegardToCase) {
    TextMaker make(1);
    for (int round = 0; round < 20'000; ++round) {
        const std::string a = make.Text(), b = make.Text();
        std::string orderedA, orderedB;
        AppendOrdered(orderedA, a);
        AppendOrdered(orderedB, b);
        ASSERT_EQ(Sign(orderedA.compare(orderedB)), Sign(frame::CompareNoCase(a, b)))
            << testing::PrintToString(a) << " " << testing::PrintToString(b);
    }
}

/// Rows in an order, with a text each, and a number where the map has one.
class Texts final : public RowSource {
  public:
    std::string Text(RowId row, int) const override { return texts.at(row); }
    std::optional<std::uint64_t> SortNumber(RowId row, int) const override {
        const auto found = numbers.find(row);
        return found != numbers.end() ? std::optional(found->second) : std::nullopt;
    }
    std::vector<std::string> texts;
    std::map<RowId, std::uint64_t> numbers;
};

class RowSortOfSource : public testing::Test {
  protected:
    RowSortOfSource() { rows.SetSource(&source); }

    void Add(const std::string& text) {
        const auto row = static_cast<RowId>(source.texts.size());
        source.texts.push_back(text);
        rows.Begin(row, RowTexts::ColumnZero::FromSource);
    }
    std::vector<RowId> Sorted(std::vector<RowId> order, bool ascending) {
        RowSort(rows, 0).Sort(order, ascending);
        return order;
    }

    Texts source;
    RowTexts rows;
};

TEST_F(RowSortOfSource, SortsAsAStableSortOfTheTextsDoes) {
    TextMaker make(2);
    for (int round = 0; round < 60; ++round) {
        source.texts.clear();
        std::vector<RowId> order;
        for (int row = make.Below(300); row >= 0; --row) {
            order.push_back(static_cast<RowId>(source.texts.size()));
            Add((round % 3 == 0 ? "all begin like this: " : "") + make.Text());
        }
        for (std::size_t i = order.size() - 1; i > 0; --i)
            std::swap(order[i], order[static_cast<std::size_t>(make.Below(static_cast<int>(i + 1)))]);
        for (const bool ascending : {true, false}) {
            std::vector<RowId> expected = order;
            std::stable_sort(expected.begin(), expected.end(), [&](RowId a, RowId b) {
                const int compared = frame::CompareNoCase(source.texts[a], source.texts[b]);
                return ascending ? compared < 0 : compared > 0;
            });
            ASSERT_EQ(Sorted(order, ascending), expected) << round;
        }
    }
}

TEST_F(RowSortOfSource, NoRowsAndEqualRowsAreSorted) {
    EXPECT_TRUE(Sorted({}, true).empty());
    for (int row = 0; row < 4; ++row) Add(row % 2 == 0 ? "The same long text" : "THE SAME LONG TEXT");
    EXPECT_EQ(Sorted({3, 1, 0, 2}, true), (std::vector<RowId>{3, 1, 0, 2}));
    EXPECT_EQ(Sorted({3, 1, 0, 2}, false), (std::vector<RowId>{3, 1, 0, 2}));
}

TEST_F(RowSortOfSource, NumbersStandInForTextsWhereEveryRowHasOne) {
    for (const char* text : {"c", "b", "a", ""}) Add(text);
    source.numbers = {{0, 1}, {1, 2}, {2, 3}, {3, 0}};
    EXPECT_EQ(Sorted({0, 1, 2, 3}, true), (std::vector<RowId>{3, 0, 1, 2}));
    EXPECT_EQ(Sorted({0, 1, 2, 3}, false), (std::vector<RowId>{2, 1, 0, 3}));
    source.numbers.erase(1);
    EXPECT_EQ(Sorted({0, 1, 2, 3}, true), (std::vector<RowId>{3, 2, 1, 0}));
}

TEST_F(RowSortOfSource, ATextOfTheRowsOwnHasNoNumberAndTheEmptyOneHas) {
    for (const char* text : {"c", "b"}) Add(text);
    source.numbers = {{0, 1}, {1, 2}};
    rows.SetText(1, 0, "a");
    EXPECT_EQ(Sorted({0, 1}, true), (std::vector<RowId>{1, 0}));
    rows.SetText(1, 0, "");
    EXPECT_EQ(rows.SortNumber(1, 0), 0u);
    EXPECT_EQ(Sorted({0, 1}, true), (std::vector<RowId>{1, 0}));
}

/// Sizes as texts of twelve digits, which order as their numbers; larger ones have no number.
class Sizes final : public RowSource {
  public:
    static constexpr std::uint64_t firstWithout = 1'000'000'000'000;

    std::string Text(RowId row, int column) const override {
        if (column == 0) return frame::Decimal(row);
        char text[32];
        std::snprintf(text, sizeof text, "%012llu", static_cast<unsigned long long>(sizes.at(row)));
        return text;
    }
    std::optional<std::uint64_t> SortNumber(RowId row, int column) const override {
        if (column == 0 || sizes.at(row) >= firstWithout) return std::nullopt;
        return sizes.at(row) + 1;
    }
    std::map<RowId, std::uint64_t> sizes;
};

/// Two lists go through the same, one with a source that knows numbers and one with texts that were set.
TEST(RowSortOfListTest, ListsWithNumbersAndListsWithTextsSettleAlike) {
    TextMaker make(3);
    Sizes sizes;
    ListRows numbered([] {}), plain([] {});
    numbered.SetSource(&sizes);
    for (ListRows* rows : {&numbered, &plain}) {
        rows->SetSortKey(1);
        rows->SetSorted(true);
    }
    const auto anySize = [&] {
        return make.Below(20) == 0 ? Sizes::firstWithout + static_cast<std::uint64_t>(make.Below(3))
                                   : static_cast<std::uint64_t>(make.Below(30));
    };
    for (int step = 0; step < 4'000; ++step) {
        const int kind = make.Below(20);
        const auto count = static_cast<int>(numbered.Count());
        if (kind < 10 || count == 0) {
            ASSERT_EQ(numbered.NextId(), plain.NextId());
            sizes.sizes[numbered.NextId()] = anySize();
            const RowId row = numbered.AddFromSource();
            ASSERT_EQ(plain.Add(frame::Decimal(row)), row);
            numbered.Fill(row);
            plain.SetText(row, 1, sizes.Text(row, 1));
        } else if (kind < 13) {
            const RowId row = numbered.At(static_cast<std::uint32_t>(make.Below(count)));
            numbered.Remove(row);
            plain.Remove(row);
        } else if (kind < 16) {
            const RowId row = numbered.At(static_cast<std::uint32_t>(make.Below(count)));
            const std::string text = make.Below(3) == 0 ? std::string() : "0000000000" + frame::Decimal(10 + make.Below(30));
            numbered.SetText(row, 1, text);
            plain.SetText(row, 1, text);
        } else if (kind < 17) {
            const auto order = make.Below(2) == 0 ? ListSortOrderConstants::Ascending : ListSortOrderConstants::Descending;
            numbered.SetSortOrder(order);
            plain.SetSortOrder(order);
        } else if (kind < 18) {
            const bool sorted = make.Below(4) != 0;
            numbered.SetSorted(sorted);
            plain.SetSorted(sorted);
        } else if (count > 200) {
            numbered.Clear();
            plain.Clear();
        }
        for (std::uint32_t position = 0; position < numbered.Count(); ++position)
            ASSERT_EQ(numbered.At(position), plain.At(position)) << "step " << step;
    }
}

TEST(TextIndexTest, NamesTheRowsThatMayHaveAText) {
    TextMaker make(4);
    TextIndex index;
    std::map<RowId, std::string> texts;
    for (int step = 0; step < 5'000; ++step) {
        const auto row = static_cast<RowId>(make.Below(600));
        if (texts.contains(row)) {
            index.Remove(row);
            texts.erase(row);
        } else {
            texts[row] = make.Text();
            index.Add(row, texts[row]);
        }
        const std::string wanted = make.Text();
        std::vector<RowId> found, expected;
        index.Candidates(wanted, [&](RowId candidate) {
            if (frame::EqualsNoCase(texts.at(candidate), wanted)) found.push_back(candidate);
        });
        for (const auto& [candidate, text] : texts)
            if (frame::EqualsNoCase(text, wanted)) expected.push_back(candidate);
        std::sort(found.begin(), found.end());
        ASSERT_EQ(found, expected) << "step " << step;
    }
}

}  // namespace
}  // namespace tessel::child
