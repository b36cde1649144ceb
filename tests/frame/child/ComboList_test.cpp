#include "frame/child/ComboList.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <random>
#include <string>
#include <vector>

#include "frame/ClassTable.h"
#include "frame/Text.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/ErrorOf.h"

namespace tessel::child {
namespace {

using test::ErrorOf;

class Shelf final : public frame::Control {
  public:
    explicit Shelf(frame::Host& host) : Control(host) {
        for (ComboList* list : {&plain, &sorted}) {
            list->Click.To<&Shelf::Clicked>(*this);
            list->DblClick.To<&Shelf::Clicked>(*this);
        }
    }
    frame::TextSize DesignSize() const override { return {1500, 315}; }
    const frame::ClassTable& Table() const override {
        static constexpr frame::ClassTable table{.name = "Shelf", .members = {}};
        return table;
    }

    int clicks = 0;
    ComboList plain{*this, "plain", ComboRows::Order::AsAdded};
    ComboList sorted{*this, "sorted", ComboRows::Order::ByText};

  private:
    void Clicked() { ++clicks; }
};

std::string Rows(const ComboList& list) {
    std::string rows;
    for (std::int32_t i = 0; i < list.ListCount(); ++i)
        rows += (i ? " " : "") + list.List(i) + "=" + frame::Decimal(list.ItemData(i)) + (i == list.ListIndex() ? "*" : "");
    return rows;
}

class ComboListTest : public testing::Test {
  protected:
    headless::HeadlessHost host;
    Shelf& shelf = host.Create<Shelf>("Shelf1");
    ComboList& plain = shelf.plain;
    ComboList& sorted = shelf.sorted;
};

TEST_F(ComboListTest, APlainListKeepsTheOrderOfAdding) {
    plain.Add("b", 1);
    plain.Add("a", 2);
    plain.Add("B", 3);
    EXPECT_EQ(Rows(plain), "b=1 a=2 B=3");
    EXPECT_EQ(plain.NewIndex(), 2);
}

TEST_F(ComboListTest, ASortedListSortsStablyWithoutRegardToCase) {
    for (const char* text : {"b", "a", "B", "\xC3\x84", "\xC3\xA4", "A"}) sorted.AddItem(text);
    EXPECT_EQ(Rows(sorted), "a=0 A=0 b=0 B=0 \xC3\x84=0 \xC3\xA4=0");
    EXPECT_EQ(sorted.NewIndex(), 1);
}

TEST_F(ComboListTest, TheChosenRowStaysChosenWhereverItMoves) {
    sorted.Add("m", 5);
    sorted.SetListIndex(0);
    sorted.Add("a", 1);
    sorted.Add("z", 2);
    EXPECT_EQ(Rows(sorted), "a=1 m=5* z=2");
    sorted.RemoveItem(0);
    EXPECT_EQ(sorted.ListIndex(), 0);
    EXPECT_EQ(sorted.Text(), "m");
}

TEST_F(ComboListTest, NothingIsChosenWhenTheChosenRowGoes) {
    plain.AddItem("a");
    plain.AddItem("b");
    plain.SetListIndex(1);
    plain.RemoveItem(1);
    EXPECT_EQ(plain.ListIndex(), -1);
    EXPECT_EQ(plain.Text(), "");
    EXPECT_EQ(plain.NewIndex(), -1);
    EXPECT_EQ(shelf.clicks, 1);
}

TEST_F(ComboListTest, AnIndexSetByCodeRaisesClickEachTime) {
    plain.AddItem("a");
    plain.SetListIndex(0);
    plain.SetListIndex(0);
    plain.SetListIndex(-1);
    EXPECT_EQ(shelf.clicks, 3);
}

TEST_F(ComboListTest, AnIndexOutsideIsRefusedAndChangesNothing) {
    plain.AddItem("a");
    plain.SetListIndex(0);
    EXPECT_EQ(ErrorOf([&] { plain.SetListIndex(1); }), frame::errors::invalidValue);
    EXPECT_EQ(ErrorOf([&] { plain.SetListIndex(-2); }), frame::errors::invalidValue);
    EXPECT_EQ(ErrorOf([&] { plain.List(1); }), frame::errors::invalidArrayIndex);
    EXPECT_EQ(ErrorOf([&] { plain.ItemData(-1); }), frame::errors::invalidArrayIndex);
    EXPECT_EQ(ErrorOf([&] { plain.SetItemData(1, 0); }), frame::errors::invalidArrayIndex);
    EXPECT_EQ(ErrorOf([&] { plain.RemoveItem(1); }), frame::errors::invalidCall);
    EXPECT_EQ(Rows(plain), "a=0*");
    EXPECT_EQ(shelf.clicks, 1);
}

TEST_F(ComboListTest, TheListFixesItsHeight) {
    plain.Move(10, 20, 3000, 900);
    EXPECT_EQ(plain.Width(), 3000);
    EXPECT_EQ(plain.Height(), 315);
    EXPECT_EQ(ErrorOf([&] { plain.Put("Height", 900); }), frame::errors::notAtRunTime);
}

TEST_F(ComboListTest, AChoiceOfTheUserRaisesClick) {
    plain.AddItem("a");
    plain.AddItem("b");
    plain.ChooseInput(1);
    EXPECT_EQ(plain.Text(), "b");
    EXPECT_EQ(shelf.clicks, 1);
    plain.ListClickInput(0);
    EXPECT_EQ(plain.ListIndex(), 0);
    plain.ListClickInput({});
    EXPECT_EQ(plain.ListIndex(), 0);
    EXPECT_EQ(shelf.clicks, 3);
}

TEST_F(ComboListTest, MembersAreReachedByNameWithAnIndex) {
    frame::Variant text[] = {"x"};
    plain.Call("AddItem", text);
    frame::Variant first[] = {0};
    plain.Put("ItemData", 77, first);
    EXPECT_EQ(plain.Get("ItemData", first).ToLong(), 77);
    EXPECT_EQ(plain.Get("List", first).ToText(), "x");
    EXPECT_EQ(plain.Get("ListCount").ToLong(), 1);
    EXPECT_EQ(plain.Get("NewIndex").ToLong(), 0);
}

/// What a list must do, done in the plainest way.
struct Model {
    struct Row {
        std::string text;
        std::int32_t data;
    };
    bool sorted;
    std::vector<Row> rows;

    void Add(const std::string& text, std::int32_t data) {
        auto place = rows.end();
        if (sorted)
            place =
                std::find_if(rows.begin(), rows.end(), [&](const Row& row) { return frame::CompareNoCase(row.text, text) > 0; });
        rows.insert(place, {text, data});
    }
    template <class F>
    std::optional<ComboRows::Position> First(F&& is) const {
        const auto found = std::find_if(rows.begin(), rows.end(), is);
        if (found == rows.end()) return std::nullopt;
        return static_cast<ComboRows::Position>(found - rows.begin());
    }
};

/// Adds, removes and sets at random and compares every answer with the plain model's.
void CompareAtRandom(ComboRows::Order order, unsigned seed, int steps, int texts, int numbers) {
    std::mt19937 random(seed);
    const auto below = [&](int end) { return static_cast<int>(random() % static_cast<unsigned>(end)); };
    const auto text = [&] {
        static constexpr const char* letters[] = {"a", "A", "b", "\xC3\x96", "\xC3\xB6", "Z", "_", "\xFF"};
        std::string made = letters[below(8)];
        made += frame::Decimal(below(texts));
        return made;
    };
    ComboRows rows(order);
    Model model{order == ComboRows::Order::ByText, {}};
    for (int step = 0; step < steps; ++step) {
        const int what = below(100);
        const auto size = static_cast<int>(model.rows.size());
        if (what < 50) {
            const std::string added = text();
            const int data = below(numbers);
            rows.Add(added, data);
            model.Add(added, data);
        } else if (what < 65 && size > 0) {
            const int at = below(size);
            rows.Remove(static_cast<ComboRows::Position>(at));
            model.rows.erase(model.rows.begin() + at);
        } else if (what < 75 && size > 0) {
            const int at = below(size), data = below(numbers);
            rows.SetData(static_cast<ComboRows::Position>(at), data);
            model.rows[static_cast<std::size_t>(at)].data = data;
        } else if (what < 85) {
            const int data = below(numbers);
            const auto expected = model.First([&](const Model::Row& row) { return row.data == data; });
            ASSERT_EQ(rows.HasData(data), expected.has_value()) << step;
            ASSERT_EQ(rows.FindData(data), expected) << step;
        } else if (what < 95) {
            const std::string wanted = text();
            ASSERT_EQ(rows.FindText(wanted), model.First([&](const Model::Row& row) {
                return frame::EqualsNoCase(row.text, wanted);
            })) << step;
        } else if (size > 0) {
            const int at = below(size);
            ASSERT_EQ(rows.Text(static_cast<ComboRows::Position>(at)), model.rows[static_cast<std::size_t>(at)].text) << step;
        }
        ASSERT_EQ(rows.Size(), model.rows.size());
    }
    for (std::size_t i = 0; i < model.rows.size(); ++i) {
        const auto at = static_cast<ComboRows::Position>(i);
        ASSERT_EQ(rows.Text(at), model.rows[i].text) << i;
        ASSERT_EQ(rows.Data(at), model.rows[i].data) << i;
        ASSERT_EQ(rows.PositionOf(rows.RowAt(at)), at);
    }
}

TEST(ComboRows, AnswersAsALinearSearchWould) {
    for (const auto order : {ComboRows::Order::AsAdded, ComboRows::Order::ByText})
        for (unsigned seed = 1; seed <= 6; ++seed) CompareAtRandom(order, seed, 4000, 40, 30);
}

TEST(ComboRows, AnswersAsALinearSearchWouldWithManyEqualRows) {
    for (const auto order : {ComboRows::Order::AsAdded, ComboRows::Order::ByText})
        for (unsigned seed = 11; seed <= 14; ++seed) CompareAtRandom(order, seed, 3000, 3, 3);
}

TEST(ComboRows, AnswersAsALinearSearchWouldWithFewEqualRows) {
    for (const auto order : {ComboRows::Order::AsAdded, ComboRows::Order::ByText})
        for (unsigned seed = 21; seed <= 22; ++seed) CompareAtRandom(order, seed, 4000, 100'000, 1'000'000);
}

TEST(ComboRows, ManyRowsAddedAtOnceToASortedListStandAsIfAddedOneByOne) {
    std::mt19937 random(5);
    ComboRows rows(ComboRows::Order::ByText);
    std::vector<Model::Row> expected;
    for (int i = 0; i < 5000; ++i) {
        const std::string text = frame::Decimal(static_cast<std::int64_t>(random() % 900));
        rows.Add(text, i);
        expected.push_back({text, i});
    }
    std::stable_sort(expected.begin(), expected.end(),
                     [](const auto& a, const auto& b) { return frame::CompareNoCase(a.text, b.text) < 0; });
    for (std::size_t i = 0; i < expected.size(); ++i)
        ASSERT_EQ(rows.Data(static_cast<ComboRows::Position>(i)), expected[i].data) << i;
}

TEST(ComboRows, TheSameTextMayComeFromTheListItselfAfterManyHaveGone) {
    ComboRows rows(ComboRows::Order::AsAdded);
    for (int i = 0; i < 4000; ++i) rows.Add("a text of some length " + frame::Decimal(i), i);
    for (int i = 0; i < 3990; ++i) rows.Remove(0);
    rows.Add(rows.Text(0), 1);
    EXPECT_EQ(rows.Text(10), "a text of some length 3990");
    EXPECT_EQ(rows.Text(9), "a text of some length 3999");
    EXPECT_EQ(rows.FindText("A TEXT OF SOME LENGTH 3995"), 5u);
}

TEST(ComboRows, TypeAheadGoesOnFromAPlaceAndFromTheTop) {
    ComboRows rows(ComboRows::Order::AsAdded);
    for (const char* text : {"Apple", "apricot", "Pear", "APE"}) rows.Add(text, 0);
    EXPECT_EQ(rows.FindStart("ap", 0), 0u);
    EXPECT_EQ(rows.FindStart("ap", 2), 3u);
    EXPECT_EQ(rows.FindStart("pe", 3), 2u);
    EXPECT_EQ(rows.FindStart("x", 1), std::nullopt);
    EXPECT_EQ(rows.FindStart("apr", 100), 1u);
}

}  // namespace
}  // namespace tessel::child
