#include "apps/gallery/IsoCodes.h"

#include <QCoreApplication>
#include <QDir>
#include <QFile>
#include <QHash>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QSqlError>
#include <QSqlQuery>
#include <QStandardPaths>
#include <algorithm>

namespace tessel::gallery {

namespace {

QString Tr(const char* text) { return QCoreApplication::translate("IsoCodes", text); }

/// The entries of one of the package's files; none when it is not there.
QJsonArray Entries(const QString& standard) {
    QFile file("/usr/share/iso-codes/json/iso_" + standard + ".json");
    if (!file.open(QIODevice::ReadOnly)) return {};
    return QJsonDocument::fromJson(file.readAll()).object().value(standard).toArray();
}

/// Writes the tables in one transaction.
class Writer {
  public:
    explicit Writer(QSqlDatabase& database) : query_(database) {}

    void Do(const QString& sql) { done_ = done_ && query_.exec(sql); }
    void Prepare(const QString& sql) { done_ = done_ && query_.prepare(sql); }
    void Add(const QVariantList& values) {
        for (int i = 0; i < values.size(); ++i) query_.bindValue(i, values[i]);
        done_ = done_ && query_.exec();
    }
    bool Done() const { return done_; }
    /// Why it is not.
    QString Problem() const { return query_.lastError().text(); }

  private:
    QSqlQuery query_;
    bool done_ = true;
};

/// Gives what went wrong, or nothing.
QString Fill(QSqlDatabase& database, const QJsonArray& countries, const QJsonArray& subdivisions, const QJsonArray& languages) {
    if (!database.transaction()) return database.lastError().text();
    Writer writer(database);
    QHash<QString, int> numbers;  // of countries, by their two letters
    writer.Do("CREATE TABLE countries (id INTEGER PRIMARY KEY, name TEXT)");
    writer.Prepare("INSERT INTO countries VALUES (?, ?)");
    for (const auto& entry : countries) {
        const QJsonObject country = entry.toObject();
        const int number = country["numeric"].toString().toInt();
        numbers[country["alpha_2"].toString()] = number;
        writer.Add({number, country["name"].toString()});
    }
    int id = 0;
    writer.Do("CREATE TABLE subdivisions (id INTEGER PRIMARY KEY, name TEXT, country INTEGER)");
    writer.Do("CREATE INDEX of_country ON subdivisions (country)");
    writer.Prepare("INSERT INTO subdivisions VALUES (?, ?, ?)");
    for (const auto& entry : subdivisions) {
        const QJsonObject subdivision = entry.toObject();
        writer.Add({++id, subdivision["name"].toString(), numbers.value(subdivision["code"].toString().section('-', 0, 0))});
    }
    id = 0;
    writer.Do("CREATE TABLE languages (id INTEGER PRIMARY KEY, name TEXT)");
    writer.Prepare("INSERT INTO languages VALUES (?, ?)");
    for (const auto& entry : languages) writer.Add({++id, entry.toObject()["name"].toString()});
    if (writer.Done() && database.commit()) return {};
    const QString problem = writer.Done() ? database.lastError().text() : writer.Problem();
    database.rollback();
    return problem;
}

}  // namespace

QString OpenIsoCodes(QSqlDatabase& database) {
    const QDir folder(QStandardPaths::writableLocation(QStandardPaths::AppDataLocation));
    folder.mkpath(".");
    // Each page has a connection of its own.
    const auto place = reinterpret_cast<quintptr>(&database);
    database = QSqlDatabase::addDatabase("QSQLITE", "iso-codes-" + QString::number(place));
    database.setDatabaseName(folder.filePath("iso-codes.sqlite"));
    if (!database.open()) return Tr("The database of names cannot be opened: %1").arg(database.lastError().text());
    const QStringList present = database.tables(), wanted = {"countries", "subdivisions", "languages"};
    const auto isPresent = [&](const QString& table) { return present.contains(table); };
    if (std::all_of(wanted.begin(), wanted.end(), isPresent)) return {};
    const QJsonArray countries = Entries("3166-1"), subdivisions = Entries("3166-2"), languages = Entries("639-3");
    if (countries.isEmpty() || subdivisions.isEmpty() || languages.isEmpty())
        return Tr("The names of countries and languages come from Debian's package iso-codes, which is not installed.");
    const QString problem = Fill(database, countries, subdivisions, languages);
    if (problem.isEmpty()) return {};
    return Tr("The database of names cannot be written: %1 (%2)").arg(problem, database.databaseName());
}

}  // namespace tessel::gallery
