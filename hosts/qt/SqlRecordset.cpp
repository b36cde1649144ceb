#include "hosts/qt/SqlRecordset.h"

#include <QSqlDriver>
#include <QSqlError>

#include "frame/Error.h"
#include "hosts/qt/Convert.h"

namespace tessel::qt {

using frame::ControlError;
using frame::Variant;

namespace {

Variant FromSql(const QVariant& value) {
    if (value.isNull()) return {};
    switch (value.typeId()) {
        case QMetaType::QString:
            return FromQt(value.toString());
        case QMetaType::LongLong:
            return Variant::FromCount(*static_cast<const qlonglong*>(value.constData()));
        default:
            return FromQt(value);
    }
}

}  // namespace

SqlRecordset::SqlRecordset(const QString& table, const QSqlDatabase& database) : own_(database), query_(own_) {
    const QString name = database.driver()->escapeIdentifier(table, QSqlDriver::TableName);
    own_.setForwardOnly(true);
    own_.prepare("SELECT * FROM " + name);
}

void SqlRecordset::MoveFirst() {
    record_ = {};
    hasRow_ = false;
    if (query_.isActive() && !query_.isSelect()) {  // it has no rows, and is not done again
        atEnd_ = true;
        WantRow();
    }
    const bool fresh = query_.isActive() && query_.isSelect() && query_.at() == QSql::BeforeFirstRow;
    if (!fresh && (!query_.isActive() || query_.isForwardOnly())) Run();
    hasRow_ = query_.isForwardOnly() ? query_.next() : query_.first();
    if (!hasRow_ && query_.lastError().isValid()) Fail();
    atEnd_ = !hasRow_;
    WantRow();
}

void SqlRecordset::Run() {
    query_.setForwardOnly(true);
    const bool done = query_.boundValues().isEmpty() ? query_.exec(query_.lastQuery()) : query_.exec();
    if (!done) Fail();
}

void SqlRecordset::MoveNext() {
    if (atEnd_) WantRow();
    hasRow_ = query_.next();
    if (hasRow_) return;
    // After a failure it does not stand at the end: the next attempt fails too.
    if (query_.lastError().isValid()) Fail();
    atEnd_ = true;
}

std::string SqlRecordset::FieldName(std::int32_t field) { return FromQt(Record().fieldName(field)); }

Variant SqlRecordset::FieldValue(std::int32_t field) {
    WantRow();
    return FromSql(query_.value(field));
}

void SqlRecordset::FieldText(std::int32_t field, std::string& text) {
    constexpr ushort firstBeyondAscii = 0x80;
    WantRow();
    const QVariant value = query_.value(field);
    if (value.typeId() != QMetaType::QString) {
        text = FromSql(value).ToText();
        return;
    }
    // `NULL` has no characters.
    const auto& wide = *static_cast<const QString*>(value.constData());
    text.resize(static_cast<std::size_t>(wide.size()));
    const ushort* const from = wide.utf16();
    char* const to = text.data();
    const qsizetype size = wide.size();
    ushort all = 0;
    for (qsizetype i = 0; i < size; ++i) all |= from[i];
    for (qsizetype i = 0; i < size; ++i) to[i] = static_cast<char>(from[i]);
    if (all >= firstBeyondAscii) text = FromQt(wide);
}

void SqlRecordset::WantRow() const {
    if (!hasRow_) throw ControlError(frame::errors::noCurrentRow);
}

void SqlRecordset::Fail() const {
    const QString text = query_.lastError().text().trimmed();
    if (text.isEmpty()) throw ControlError(frame::errors::dataSourceError);
    throw ControlError(frame::errors::dataSourceError, FromQt(text));
}

const QSqlRecord& SqlRecordset::Record() {
    if (record_.isEmpty()) record_ = query_.record();
    return record_;
}

}  // namespace tessel::qt
