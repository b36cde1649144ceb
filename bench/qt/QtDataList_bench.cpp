#include <benchmark/benchmark.h>

#include <QAbstractItemView>
#include <QApplication>
#include <QComboBox>
#include <QSqlDatabase>
#include <QSqlQuery>
#include <memory>
#include <string>

#include "bench/Contest.h"
#include "bench/LiveBytes.h"
#include "bench/qt/Run.h"
#include "frame/Text.h"
#include "hosts/qt/DataList.h"

/// What it costs to fill a list of pairs from a query, beside the bare walk over the same query and a combo box of the toolkit that
/// is filled in a loop; to look values up; to refuse repeated values; and to show many items and open them.

namespace tessel::qt {
namespace {

/// A program with a database of 100,000 rows.
struct Program {
    Program() {
        database = QSqlDatabase::addDatabase("QSQLITE");
        database.setDatabaseName(":memory:");
        database.open();
        QSqlQuery query(database);
        query.exec(
            "CREATE TABLE items AS WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 100000) "
            "SELECT i AS id, 'Holiday picture ' || (i * 7919 % 1000003) AS name FROM n");
    }
    QSqlDatabase database;
};

Program& TheProgram() {
    static auto* const program = new Program;
    return *program;
}

QSqlQuery Rows(std::int64_t count) {
    QSqlQuery query(TheProgram().database);
    query.setForwardOnly(true);
    query.prepare("SELECT name, id FROM items LIMIT ?");
    query.addBindValue(static_cast<qlonglong>(count));
    return query;
}

void Populate(benchmark::State& state) {
    TheProgram();
    const std::int64_t count = state.range(0);
    bench::Contest contest(state);
    for (auto _ : state) {
        contest.Peer("bare", [&] {
            QSqlQuery query = Rows(count);
            query.exec();
            std::int64_t sum = 0;
            while (query.next()) sum += query.value(0).toString().size() + query.value(1).toInt();
            benchmark::DoNotOptimize(sum);
        });
        auto list = std::make_unique<DataList>();
        list->control();
        QCoreApplication::processEvents();  // what comes of its making
        const std::size_t before = bench::liveBytes;
        contest.Own([&] {
            QSqlQuery query = Rows(count);
            list->populate(query, "name", "id");
        });
        const auto& rows = list->control().listItems[0];
        bench::Expect(state, rows.ListCount(), count);
        std::size_t text = 0;
        for (std::int32_t i = 0; i < rows.ListCount(); ++i) text += rows.List(i).size();
        contest.Figure("bytes_a_row", static_cast<double>(bench::liveBytes - before - text) / static_cast<double>(count));
        rows.FindData(1);
        rows.FindText("x");
        contest.Figure("bytes_a_row_indexed", static_cast<double>(bench::liveBytes - before - text) / static_cast<double>(count));
        auto combo = std::make_unique<QComboBox>();
        contest.Peer("addItem", [&] {
            QSqlQuery query = Rows(count);
            query.exec();
            while (query.next()) combo->addItem(query.value(0).toString(), query.value(1).toInt());
        });
        bench::Expect(state, combo->count(), count);
        combo.reset();
        auto unique = std::make_unique<DataList>();
        unique->setOnlyUniqueValues(true);
        contest.Figure("own_unique_ms", bench::Contest::Time([&] {
                           QSqlQuery query = Rows(count);
                           unique->populate(query, "name", "id");
                       }));
        bench::Expect(state, unique->control().listItems[0].ListCount(), count);
    }
}
BENCHMARK(Populate)->Arg(10'000)->Arg(100'000)->UseManualTime()->Iterations(9)->Unit(benchmark::kMillisecond);

void FindAThousandValues(benchmark::State& state) {
    TheProgram();
    constexpr int lookups = 1000;
    const auto count = static_cast<std::int32_t>(state.range(0));
    auto list = std::make_unique<DataList>();
    auto combo = std::make_unique<QComboBox>();
    child::ComboList& rows = list->control().listItems[0];
    for (std::int32_t row = 0; row < count; ++row) {
        rows.Add("row " + frame::Decimal(row), row);
        combo->addItem(QString::number(row), row);
    }
    rows.FindData(0);
    bench::Contest contest(state);
    const auto wanted = [&](int i) { return static_cast<std::int32_t>(std::int64_t{i} * 7919 % count); };
    for (auto _ : state) {
        std::int64_t found = 0;
        contest.Own([&] {
            for (int i = 0; i < lookups; ++i) found += rows.FindData(wanted(i)) == wanted(i) ? 1 : 0;
        });
        bench::Expect(state, found, lookups);
        contest.Peer("findData", [&] {
            for (int i = 0; i < lookups / 20; ++i) benchmark::DoNotOptimize(combo->findData(wanted(i * 20)));
        });
    }
    state.SetLabel("findData looks up 50");
}
BENCHMARK(FindAThousandValues)->Arg(100'000)->UseManualTime()->Iterations(5)->Unit(benchmark::kMillisecond);

void InsertUniqueValues(benchmark::State& state) {
    TheProgram();
    const auto count = static_cast<std::int32_t>(state.range(0));
    bench::Contest contest(state);
    for (auto _ : state) {
        auto list = std::make_unique<DataList>();
        child::ComboList& rows = list->control().listItems[0];
        const std::string text = "a text of some length";
        contest.Own([&] {
            for (std::int32_t row = 0; row < count; ++row)
                if (!rows.HasData(row)) rows.Add(text, row);
        });
        bench::Expect(state, rows.ListCount(), count);
        // As many as this are looked for among as many, so that the time of all rows is the square of the share.
        constexpr int share = 50;
        auto combo = std::make_unique<QComboBox>();
        contest.Peer("findData", [&] {
            for (int row = 0; row < count / share; ++row)
                if (combo->findData(row) < 0) combo->addItem(QString::fromStdString(text), row);
        });
    }
    state.SetLabel("findData inserts a fiftieth of them");
}
BENCHMARK(InsertUniqueValues)->Arg(100'000)->UseManualTime()->Iterations(7)->Unit(benchmark::kMillisecond);

template <class Box>
double TimeOfPopup(Box& combo) {
    const double time = bench::Contest::Time([&] {
        combo.showPopup();
        QCoreApplication::processEvents();
    });
    combo.hidePopup();
    return time;
}

void ShowAndOpen(benchmark::State& state) {
    TheProgram();
    const auto count = static_cast<std::int32_t>(state.range(0));
    bench::Contest contest(state);
    for (auto _ : state) {
        auto list = std::make_unique<DataList>();
        child::ComboList& rows = list->control().listItems[0];
        auto other = std::make_unique<QComboBox>();
        for (std::int32_t row = 0; row < count; ++row) {
            rows.Add("row " + frame::Decimal(row), row);
            other->addItem("row " + QString::number(row), row);
        }
        contest.Own([&] {
            list->show();
            QCoreApplication::processEvents();
        });
        contest.Peer("combo", [&] {
            other->show();
            QCoreApplication::processEvents();
        });
        auto* const combo = list->findChild<QComboBox*>("listItems(0)");
        bench::Expect(state, combo->count(), count);
        contest.Figure("open_own_ms", TimeOfPopup(*combo));
        contest.Figure("open_combo_ms", TimeOfPopup(*other));
    }
}
BENCHMARK(ShowAndOpen)->Arg(100'000)->UseManualTime()->Iterations(5)->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace tessel::qt

int main(int count, char** arguments) { return tessel::bench::Run(count, arguments); }
