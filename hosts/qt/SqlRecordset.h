#pragma once

#include <QSqlDatabase>
#include <QSqlQuery>
#include <QSqlRecord>

#include "frame/Recordset.h"

namespace tessel::qt {

/// The rows of a query, or of a table, as a recordset: `NULL` is an empty value, and what the database refuses is error 3146 with
/// the database's own text.
///
/// `MoveFirst` runs a query that has not yet run, or that cannot go back; one that the recordset runs by itself goes forward
/// only, so that the driver keeps no rows. A statement that gave no rows is not run again: it has no first row.
class SqlRecordset final : public frame::Recordset {
  public:
    /// `query` must outlive the recordset, and stands where that leaves it.
    explicit SqlRecordset(QSqlQuery& query) : query_(query), hasRow_(query.isValid()) {}
    /// All rows of a table.
    SqlRecordset(const QString& table, const QSqlDatabase& database);

    void MoveFirst() override;
    void MoveNext() override;
    bool AtEnd() override { return atEnd_; }
    std::int32_t FieldCount() override { return static_cast<std::int32_t>(Record().count()); }
    std::string FieldName(std::int32_t field) override;
    frame::Variant FieldValue(std::int32_t field) override;
    void FieldText(std::int32_t field, std::string& text) override;

  private:
    void Run();
    void WantRow() const;
    [[noreturn]] void Fail() const;
    const QSqlRecord& Record();

    QSqlQuery own_;  // of a table
    QSqlQuery& query_;
    QSqlRecord record_;
    bool hasRow_ = false, atEnd_ = false;
};

}  // namespace tessel::qt
