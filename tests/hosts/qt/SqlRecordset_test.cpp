#include "hosts/qt/SqlRecordset.h"

#include <arpa/inet.h>
#include <gtest/gtest.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

#include <QDir>
#include <QFile>
#include <QProcess>
#include <QSqlDatabase>
#include <QSqlError>
#include <QSqlQuery>
#include <QTemporaryDir>
#include <memory>
#include <string>

#include "frame/Text.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/DataList.h"
#include "tests/ErrorOf.h"

namespace tessel::qt {
namespace {

using test::ErrorOf;

/// A PostgreSQL server of the test's own: on the loopback, in a temporary folder, never as root. It ends with this object.
class Server {
  public:
    Server() {
        const QDir versions("/usr/lib/postgresql");
        const QStringList names = versions.entryList(QDir::Dirs | QDir::NoDotAndDotDot, QDir::Name);
        if (names.isEmpty()) return;
        programs_ = versions.filePath(names.last() + "/bin/");
        port = FreePort();
        QFile::setPermissions(folder_.path(), QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
        if (geteuid() == 0 && !Run("chown", {account, folder_.path()})) return;
        const QString data = folder_.filePath("data");
        if (!RunAsUser(programs_ + "initdb",
                       {"--no-sync", "--auth=trust", "--username=tester", "--encoding=UTF8", "--locale=C.UTF-8", "-D", data}))
            return;
        const QString options = QString("-p %1 -c listen_addresses=127.0.0.1 -c fsync=off -k %2").arg(port).arg(folder_.path());
        runs = RunAsUser(programs_ + "pg_ctl", {"start", "-w", "-D", data, "-l", folder_.filePath("log"), "-o", options});
    }
    ~Server() {
        if (!programs_.isEmpty())
            RunAsUser(programs_ + "pg_ctl", {"stop", "-w", "-m", "immediate", "-D", folder_.filePath("data")});
    }
    Server(const Server&) = delete;
    Server& operator=(const Server&) = delete;

    bool runs = false;
    int port = 0;
    std::string said;

  private:
    static constexpr const char* account = "nobody";

    static int FreePort() {
        const int listener = socket(AF_INET, SOCK_STREAM, 0);
        sockaddr_in address{};
        address.sin_family = AF_INET;
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        socklen_t size = sizeof address;
        bind(listener, reinterpret_cast<sockaddr*>(&address), size);
        getsockname(listener, reinterpret_cast<sockaddr*>(&address), &size);
        close(listener);
        return ntohs(address.sin_port);
    }
    bool Run(const QString& program, const QStringList& arguments) {
        constexpr int longest = 60'000;
        QProcess process;
        process.setWorkingDirectory(folder_.path());
        // What the server says later does not keep this process waiting.
        process.setStandardOutputFile(QProcess::nullDevice());
        process.setStandardErrorFile(folder_.filePath("said"));
        process.start(program, arguments);
        const bool done = process.waitForFinished(longest) && process.exitCode() == 0;
        QFile file(folder_.filePath("said"));
        if (!done && file.open(QIODevice::ReadOnly)) said += program.toStdString() + ": " + file.readAll().toStdString();
        return done;
    }
    bool RunAsUser(const QString& program, const QStringList& arguments) {
        if (geteuid() != 0) return Run(program, arguments);
        return Run("runuser", QStringList{"-u", account, "--", program} + arguments);
    }

    QTemporaryDir folder_;
    QString programs_;
};

enum class Kind { SQLite, PostgreSQL };

class SqlRecordsetTest : public testing::TestWithParam<Kind> {
  protected:
    static constexpr const char* connection = "tested";

    static void TearDownTestSuite() { server.reset(); }
    void SetUp() override {
        if (GetParam() == Kind::PostgreSQL) {
            if (!server) server = std::make_unique<Server>();
            ASSERT_TRUE(server->runs) << server->said;
            database = QSqlDatabase::addDatabase("QPSQL", connection);
            database.setHostName("127.0.0.1");
            database.setPort(server->port);
            database.setDatabaseName("postgres");
            database.setUserName("tester");
        } else {
            database = QSqlDatabase::addDatabase("QSQLITE", connection);
            database.setDatabaseName(":memory:");
        }
        ASSERT_TRUE(database.open()) << database.lastError().text().toStdString();
        Do("DROP TABLE IF EXISTS colours");
        Do("CREATE TABLE colours (id INTEGER, name VARCHAR(40), share DOUBLE PRECISION)");
        Do("INSERT INTO colours VALUES (3, 'Red', 0.5), (1, 'Gr\xC3\xBCn', NULL), (2, NULL, 2), (4, 'Blue', 3)");
    }
    void TearDown() override {
        database.close();
        database = {};
        QSqlDatabase::removeDatabase(connection);
    }
    void Do(const char* sql) const {
        QSqlQuery query(database);
        ASSERT_TRUE(query.exec(sql)) << query.lastError().text().toStdString();
    }
    static std::string Walk(frame::Recordset& records, const frame::Variant& field = "name") {
        std::string all;
        const std::int32_t number = records.NumberOf(field);
        for (records.MoveFirst(); !records.AtEnd(); records.MoveNext()) all += records.FieldValue(number).ToText() + ",";
        return all;
    }

    inline static std::unique_ptr<Server> server;
    QSqlDatabase database;
};

constexpr const char* all = "SELECT id, name, share FROM colours ORDER BY id";
constexpr const char* named = "Gr\xC3\xBCn,,Red,Blue,";

TEST_P(SqlRecordsetTest, WalksAQueryThatHasRun) {
    QSqlQuery query(all, database);
    SqlRecordset records(query);
    EXPECT_EQ(Walk(records), named);
    EXPECT_EQ(Walk(records), named);
}

TEST_P(SqlRecordsetTest, WalksAQueryThatGoesForwardOnlyAsOftenAsOneLikes) {
    QSqlQuery query(database);
    query.setForwardOnly(true);
    ASSERT_TRUE(query.exec(all));
    SqlRecordset records(query);
    EXPECT_EQ(Walk(records), named);
    EXPECT_EQ(Walk(records), named);
    EXPECT_EQ(ErrorOf([&] { records.MoveNext(); }), frame::errors::noCurrentRow);
}

TEST_P(SqlRecordsetTest, RunsAPreparedQueryWithItsValuesAgain) {
    QSqlQuery query(database);
    query.prepare("SELECT id, name FROM colours WHERE id > ? ORDER BY id");
    query.addBindValue(2);
    SqlRecordset records(query);
    records.MoveFirst();
    EXPECT_EQ(Walk(records), "Red,Blue,");
    EXPECT_EQ(Walk(records, "id"), "3,4,");
}

TEST_P(SqlRecordsetTest, AQueryExecutedAgainShowsItsNewColumnsFromTheNextMoveFirst) {
    for (const bool forwardOnly : {false, true}) {
        QSqlQuery query(database);
        query.setForwardOnly(forwardOnly);
        ASSERT_TRUE(query.exec(all));
        SqlRecordset records(query);
        records.MoveFirst();
        EXPECT_EQ(records.FieldCount(), 3);
        EXPECT_EQ(records.FieldName(0), "id");
        ASSERT_TRUE(query.exec("SELECT share AS part, name FROM colours WHERE share IS NOT NULL ORDER BY id DESC"));
        records.MoveFirst();
        EXPECT_EQ(records.FieldCount(), 2) << forwardOnly;
        EXPECT_EQ(records.FieldName(0), "part");
        EXPECT_EQ(ErrorOf([&] { records.NumberOf("id"); }), frame::errors::noSuchField);
        EXPECT_EQ(records.Fields("name")->Value().ToText(), "Blue");
        EXPECT_EQ(Walk(records), "Blue,Red,,");
        EXPECT_EQ(Walk(records, "part"), "3,0.5,2,");
    }
}

TEST_P(SqlRecordsetTest, AQueryThatGivesNoRowsIsNotExecutedASecondTime) {
    const auto pinks = [&] {
        QSqlQuery query("SELECT COUNT(*) FROM colours WHERE name = 'Pink'", database);
        return query.next() ? query.value(0).toInt() : -1;
    };
    int inserted = 0;
    for (const bool forwardOnly : {false, true}) {
        for (const bool prepared : {false, true}) {
            QSqlQuery query(database);
            query.setForwardOnly(forwardOnly);
            if (prepared) {
                query.prepare("INSERT INTO colours VALUES (?, 'Pink', 1)");
                query.addBindValue(5);
                ASSERT_TRUE(query.exec());
            } else {
                ASSERT_TRUE(query.exec("INSERT INTO colours VALUES (5, 'Pink', 1)"));
            }
            ASSERT_EQ(pinks(), ++inserted);
            SqlRecordset records(query);
            for (int i = 0; i < 2; ++i) EXPECT_EQ(ErrorOf([&] { records.MoveFirst(); }), frame::errors::noCurrentRow);
            DataList list;
            EXPECT_EQ(list.populate(query, 1, 0), ToQt(frame::ErrorText(frame::errors::noCurrentRow)));
            EXPECT_EQ(list.listCount(), 0);
            ASSERT_EQ(pinks(), inserted) << (forwardOnly ? "forward only" : "both ways") << (prepared ? ", prepared" : "");
        }
    }
}

TEST_P(SqlRecordsetTest, AfterAMoveToTheFirstOfNoRowsItStandsAtItsEndWhateverTheQueryIs) {
    for (const char* sql : {"SELECT name FROM colours WHERE id > 100", "INSERT INTO colours VALUES (5, 'Pink', 1)"}) {
        QSqlQuery query(all, database);
        SqlRecordset records(query);
        records.MoveFirst();
        EXPECT_FALSE(records.AtEnd());
        ASSERT_TRUE(query.exec(sql));
        EXPECT_EQ(ErrorOf([&] { records.MoveFirst(); }), frame::errors::noCurrentRow);
        EXPECT_TRUE(records.AtEnd()) << sql;
        EXPECT_EQ(ErrorOf([&] { records.FieldValue(0); }), frame::errors::noCurrentRow);
        EXPECT_EQ(ErrorOf([&] { records.MoveNext(); }), frame::errors::noCurrentRow) << sql;
    }
}

TEST_P(SqlRecordsetTest, TakesATableByItsName) {
    Do("DROP TABLE IF EXISTS \"two words\"");
    Do("CREATE TABLE \"two words\" (a INTEGER)");
    Do("INSERT INTO \"two words\" VALUES (5)");
    SqlRecordset records("two words", database);
    records.MoveFirst();
    EXPECT_EQ(Walk(records, 0), "5,");
}

TEST_P(SqlRecordsetTest, ValuesComeInTheirKindAndNullIsEmpty) {
    QSqlQuery query(all, database);
    SqlRecordset records(query);
    records.MoveFirst();
    EXPECT_TRUE(records.Fields("SHARE")->Value().IsEmpty());
    EXPECT_EQ(records.Fields(0)->Value().ToLong(), 1);
    EXPECT_EQ(records.Fields(0)->Name(), "id");
    EXPECT_TRUE(records.Fields("name")->Value().IsString());
    records.MoveNext();
    EXPECT_EQ(records.Fields("name")->Value().ToText(), "");
    EXPECT_EQ(records.Fields("share")->Value().ToDouble(), 2);
}

TEST_P(SqlRecordsetTest, AQueryThatStandsOnARowIsReadFromThere) {
    QSqlQuery query(all, database);
    SqlRecordset before(query);
    EXPECT_EQ(ErrorOf([&] { before.FieldValue(0); }), frame::errors::noCurrentRow);
    ASSERT_TRUE(query.next());
    ASSERT_TRUE(query.next());
    SqlRecordset records(query);
    EXPECT_EQ(records.FieldValue(0).ToLong(), 2);
    records.MoveNext();
    EXPECT_EQ(records.FieldValue(0).ToLong(), 3);
    std::string text;
    records.FieldText(0, text);
    EXPECT_EQ(text, "3");
}

TEST_P(SqlRecordsetTest, WithoutRowsMoveFirstFails) {
    QSqlQuery query("SELECT name FROM colours WHERE id > 100", database);
    SqlRecordset records(query);
    EXPECT_EQ(ErrorOf([&] { records.MoveFirst(); }), frame::errors::noCurrentRow);
    EXPECT_TRUE(records.AtEnd());
    EXPECT_EQ(ErrorOf([&] { records.FieldValue(0); }), frame::errors::noCurrentRow);
}

TEST_P(SqlRecordsetTest, TheWordsOfTheDatabaseComeBack) {
    DataList list;
    const QString result = list.populate("no_such_table", database, "name", "id");
    EXPECT_TRUE(result.contains("no_such_table")) << result.toStdString();
    QSqlQuery query(database);
    query.exec("SELECT nonsense FROM colours");
    EXPECT_TRUE(list.populate(query, "name", "id").contains("nonsense"));
}

TEST_P(SqlRecordsetTest, WhatFailsOnTheWayEndsTheFillWithTheWordsOfTheDatabase) {
    if (GetParam() != Kind::SQLite) GTEST_SKIP() << "the server works out all rows before the first one comes";
    QSqlQuery query(database);
    query.setForwardOnly(true);
    ASSERT_TRUE(
        query.exec("WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 9) "
                   "SELECT i, CASE i WHEN 3 THEN abs(i - 4 - 9223372036854775807) ELSE 'row ' || i END AS t FROM n"));
    DataList list;
    EXPECT_TRUE(list.populate(query, "t", "i").contains("overflow"));
    EXPECT_EQ(list.listCount(), 2);
}

TEST_P(SqlRecordsetTest, AListIsFilledInOneLine) {
    DataList list;
    QSqlQuery query(all, database);
    EXPECT_EQ(list.populate(query, "name", "id"), "");
    EXPECT_EQ(list.listCount(), 3);
    list.setValue(3);
    EXPECT_EQ(list.text(), "Red");
    EXPECT_EQ(list.populate(QSqlQuery(all, database), 1, 0, "none", 9), "");
    EXPECT_EQ(list.listCount(), 4);
    EXPECT_EQ(list.value(), 9);
    EXPECT_EQ(list.text(), "none");
    EXPECT_EQ(list.populate("colours", database, "name", "id"), "");
    EXPECT_EQ(list.listCount(), 3);
    EXPECT_TRUE(list.populate(query, "nome", "id").startsWith("TextColumn=nome - "));
    EXPECT_EQ(list.listCount(), 3);
}

TEST_P(SqlRecordsetTest, RowsInHundredsOfPagesComeWhole) {
    QSqlQuery query(database);
    query.setForwardOnly(true);
    ASSERT_TRUE(
        query.exec("WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 40000) "
                   "SELECT i, 'row ' || i AS t FROM n"));
    DataList list;
    EXPECT_EQ(list.populate(query, "t", "i"), "");
    const child::ComboList& rows = list.control().listItems[0];
    ASSERT_EQ(rows.ListCount(), 40'000);
    EXPECT_EQ(rows.List(39'999), "row 40000");
    list.setValue(40'000);
    EXPECT_EQ(list.value(), 40'000);
}

INSTANTIATE_TEST_SUITE_P(EachDatabase, SqlRecordsetTest, testing::Values(Kind::SQLite, Kind::PostgreSQL),
                         [](const auto& tested) { return tested.param == Kind::SQLite ? "SQLite" : "PostgreSQL"; });

}  // namespace
}  // namespace tessel::qt
