#include "hosts/qt/ListModel.h"

#include <gtest/gtest.h>

#include <QAbstractItemModelTester>
#include <QPersistentModelIndex>
#include <QSignalSpy>
#include <algorithm>
#include <random>
#include <string>
#include <vector>

#include "frame/Text.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/frame/child/ListOwner.h"

namespace tessel::qt {
namespace {

/// A list that a model follows, without a screen.
struct Followed {
    Followed() {
        struct Watching final : frame::Peer {
            void Update() override {}
        };
        list.AttachPeer(std::make_unique<Watching>());
        Follow();
    }
    void Follow() { model.Follow(list.Rows().TakeChanges()); }
    child::RowId Add(const std::string& text) { return list.Rows().Add(text); }
    std::string Shown() const {
        std::string texts;
        for (int row = 0; row < model.rowCount(); ++row)
            texts += (row > 0 ? " " : "") + model.data(model.index(row, 0)).toString().toStdString();
        return texts;
    }

    headless::HeadlessHost host;
    test::ListOwner owner{host};
    child::ListView& list = owner.list;
    ListModel model{list};
};

/// Counts the told by which a model tells of its rows.
class Told {
  public:
    explicit Told(ListModel& model)
        : inserted_(&model, &QAbstractItemModel::rowsInserted),
          removed_(&model, &QAbstractItemModel::rowsRemoved),
          changed_(&model, &QAbstractItemModel::dataChanged),
          layout_(&model, &QAbstractItemModel::layoutChanged),
          reset_(&model, &QAbstractItemModel::modelReset) {}
    /// What came since the last call: "inserted 0-2, layout".
    std::string Heard() {
        std::string heard;
        const auto add = [&](const std::string& what) { heard += (heard.empty() ? "" : ", ") + what; };
        for (auto& [name, spy] : {std::pair("inserted ", &inserted_), std::pair("removed ", &removed_)}) {
            for (const auto& signal : *spy) add(name + std::to_string(signal[1].toInt()) + "-" + std::to_string(signal[2].toInt()));
            spy->clear();
        }
        for (const auto& signal : changed_)
            add("changed " + std::to_string(signal[0].toModelIndex().row()) + "-" + std::to_string(signal[1].toModelIndex().row()));
        if (!layout_.empty()) add("layout");
        if (!reset_.empty()) add("reset");
        changed_.clear();
        layout_.clear();
        reset_.clear();
        return heard;
    }

  private:
    QSignalSpy inserted_, removed_, changed_, layout_, reset_;
};

TEST(ListModel, HundredThousandRowsAreOneSignal) {
    Followed followed;
    Told told(followed.model);
    for (int row = 0; row < 100'000; ++row) followed.Add("x");
    EXPECT_EQ(followed.model.rowCount(), 0);
    followed.Follow();
    EXPECT_EQ(told.Heard(), "inserted 0-99999");
    EXPECT_EQ(followed.model.rowCount(), 100'000);
}

TEST(ListModel, OneStepIsItsOwnSignal) {
    Followed followed;
    for (const char* text : {"a", "b", "c", "d"}) followed.Add(text);
    followed.Follow();
    Told told(followed.model);
    followed.list.Rows().Remove(followed.list.Rows().At(1));
    followed.Follow();
    EXPECT_EQ(told.Heard(), "removed 1-1");
    followed.list.Rows().SetText(followed.list.Rows().At(2), 0, "e");
    followed.Follow();
    EXPECT_EQ(told.Heard(), "changed 2-2");
    followed.list.Rows().SetSortOrder(child::ListSortOrderConstants::Descending);
    followed.list.SetSorted(true);
    followed.Follow();
    EXPECT_EQ(told.Heard(), "layout");
    EXPECT_EQ(followed.Shown(), "e c a");
    followed.list.Rows().Clear();
    followed.Follow();
    EXPECT_EQ(told.Heard(), "reset");
    followed.Follow();
    EXPECT_EQ(told.Heard(), "");
}

TEST(ListModel, ChangesOfSeveralRowsAreOneRange) {
    Followed followed;
    for (int row = 0; row < 10; ++row) followed.Add("x");
    followed.Follow();
    Told told(followed.model);
    followed.list.Rows().SetText(followed.list.Rows().At(7), 0, "y");
    followed.list.Rows().SetText(followed.list.Rows().At(2), 0, "y");
    followed.Follow();
    EXPECT_EQ(told.Heard(), "changed 2-7");
}

TEST(ListModel, RowsThatGoAndComeInSeveralPlacesAreANewLayout) {
    Followed followed;
    for (const char* text : {"a", "b", "c", "d", "e", "f"}) followed.Add(text);
    followed.Follow();
    Told told(followed.model);
    followed.list.Rows().Remove(followed.list.Rows().At(4));
    followed.list.Rows().Remove(followed.list.Rows().At(0));
    followed.list.Rows().Add("n", 1);
    followed.Follow();
    EXPECT_EQ(told.Heard(), "removed 5-5, layout");
    EXPECT_EQ(followed.Shown(), "b n c d f");
}

TEST(ListModel, APersistentIndexStaysWithItsRow) {
    Followed followed;
    for (const char* text : {"a", "b", "c", "d", "e", "f"}) followed.Add(text);
    followed.Follow();
    std::vector<QPersistentModelIndex> kept;
    for (int row = 0; row < 6; ++row) kept.emplace_back(followed.model.index(row, 0));
    const auto texts = [&] {
        std::string result;
        for (const auto& index : kept) result += index.isValid() ? index.data().toString().toStdString() : "-";
        return result;
    };
    followed.list.Rows().SetSortOrder(child::ListSortOrderConstants::Descending);
    followed.list.SetSorted(true);
    followed.Follow();
    EXPECT_EQ(followed.Shown(), "f e d c b a");
    EXPECT_EQ(texts(), "abcdef");
    followed.list.Rows().Remove(followed.list.Rows().At(0));
    followed.list.Rows().Remove(followed.list.Rows().At(2));
    followed.Add("bb");
    followed.list.Rows().SetSortOrder(child::ListSortOrderConstants::Ascending);
    followed.Follow();
    EXPECT_EQ(followed.Shown(), "a b bb d e");
    EXPECT_EQ(texts(), "ab-de-");
}

TEST(ListModel, ANumberThatIsUsedAgainIsAnotherRow) {
    Followed followed;
    const child::RowId gone = followed.Add("a");
    followed.Add("b");
    followed.Follow();
    const QPersistentModelIndex index = followed.model.index(0, 0);
    followed.list.Rows().Remove(gone);
    ASSERT_EQ(followed.Add("c"), gone);
    followed.Follow();
    EXPECT_EQ(followed.Shown(), "b c");
    EXPECT_FALSE(index.isValid());
}

TEST(ListModel, ColumnsAreTheHeadersOfTheList) {
    Followed followed;
    const auto row = followed.Add("name");
    followed.list.Rows().SetText(row, 1, "12 KB");
    EXPECT_EQ(followed.model.columnCount(), 1);
    followed.list.Headers().Add({}, {}, "Name");
    followed.list.Headers().Add({}, {}, "Size", {}, child::AlignmentConstants::RightJustify);
    followed.Follow();
    EXPECT_EQ(followed.model.columnCount(), 2);
    EXPECT_EQ(followed.model.headerData(1, Qt::Horizontal).toString(), "Size");
    EXPECT_EQ(followed.model.data(followed.model.index(0, 1)).toString(), "12 KB");
    EXPECT_EQ(followed.model.data(followed.model.index(0, 1), Qt::TextAlignmentRole).toInt(),
              static_cast<int>(Qt::AlignRight | Qt::AlignVCenter));
    followed.list.Headers().Clear();
    followed.Follow();
    EXPECT_EQ(followed.model.columnCount(), 1);
}

TEST(ListModel, AnsweringAheadOfTheFollowingIsHarmless) {
    Followed followed;
    for (const char* text : {"a", "b", "c"}) followed.Add(text);
    followed.Follow();
    followed.list.Rows().Clear();
    EXPECT_FALSE(followed.model.data(followed.model.index(2, 0)).isValid());
    followed.model.Disconnect();
    EXPECT_EQ(followed.model.rowCount(), 0);
}

TEST(ListModel, RandomStepsKeepTheModelTesterAndEveryPersistentIndexContent) {
    Followed followed;
    QAbstractItemModelTester tester(&followed.model, QAbstractItemModelTester::FailureReportingMode::Fatal);
    std::mt19937 random(7);
    const auto below = [&](std::uint32_t end) { return static_cast<std::uint32_t>(random() % end); };
    child::ListRows& rows = followed.list.Rows();
    struct Kept {
        QPersistentModelIndex index;
        child::RowRef row;
    };
    for (int round = 0; round < 400; ++round) {
        std::vector<Kept> kept;
        for (std::uint32_t place = 0; place < rows.Count(); place += 1 + below(4))
            kept.push_back({followed.model.index(static_cast<int>(place), 0), rows.Ref(rows.At(place))});
        bool isReset = false;
        for (std::uint32_t step = 1 + below(6); step > 0; --step) {
            const std::uint32_t what = below(12), count = rows.Count();
            if (what < 5 || count == 0)
                rows.Add(frame::Decimal(below(1000)), rows.Sorted() ? std::nullopt : std::optional(below(count + 1)));
            else if (what < 8)
                rows.Remove(rows.At(below(count)));
            else if (what < 9)
                rows.SetText(rows.At(below(count)), 0, frame::Decimal(below(1000)));
            else if (what < 10)
                rows.SetSelected(rows.At(below(count)), true);
            else if (what < 11)
                rows.SetSortOrder(static_cast<child::ListSortOrderConstants>(below(2)));
            else if (below(4) == 0)
                rows.SetSorted(!rows.Sorted());
            else if (below(20) == 0) {
                rows.Clear();
                isReset = true;
            }
        }
        followed.Follow();
        ASSERT_EQ(followed.model.rowCount(), static_cast<int>(rows.Count()));
        for (const Kept& row : kept) {
            ASSERT_EQ(row.index.isValid(), !isReset && rows.Lives(row.row)) << "round " << round;
            if (row.index.isValid()) {
                ASSERT_EQ(static_cast<std::uint32_t>(row.index.row()), rows.PositionOf(row.row.row));
            }
        }
    }
}

}  // namespace
}  // namespace tessel::qt
