#include "frame/Recordset.h"

#include <array>

#include "frame/ClassTable.h"
#include "frame/Error.h"
#include "frame/Text.h"

namespace tessel::frame {

std::int32_t Recordset::NumberOf(const Variant& field) {
    const std::int32_t count = FieldCount();
    if (!field.IsString()) {
        const std::int32_t number = field.ToLong();
        if (number >= 0 && number < count) return number;
        throw ControlError(errors::noSuchField);
    }
    for (std::int32_t number = 0; number < count; ++number)
        if (EqualsNoCase(FieldName(number), field.Text())) return number;
    throw ControlError(errors::noSuchField);
}

std::shared_ptr<Field> Recordset::Fields(const Variant& Index) { return std::make_shared<Field>(*this, NumberOf(Index)); }

namespace {

class OwnReader final : public RecordReader {
  public:
    explicit OwnReader(Recordset& records) : records_(records) {}
    void MoveFirst() override { records_->MoveFirst(); }
    void MoveNext() override { records_->MoveNext(); }
    bool AtEnd() override { return records_->AtEnd(); }
    std::size_t Column(const Variant& field) override {
        const std::int32_t number = records_->NumberOf(field);
        records_->FieldName(number);
        return static_cast<std::size_t>(number);
    }
    Variant Value(std::size_t column) override { return records_->FieldValue(static_cast<std::int32_t>(column)); }
    void Text(std::size_t column, std::string& text) override { records_->FieldText(static_cast<std::int32_t>(column), text); }

  private:
    Handle<Recordset> records_;
};

/// An object of the application that has the members of a recordset.
class ForeignReader final : public RecordReader {
  public:
    explicit ForeignReader(ObjectRef records) : records_(std::move(records)) {}
    void MoveFirst() override { records_->Call("MoveFirst"); }
    void MoveNext() override { records_->Call("MoveNext"); }
    bool AtEnd() override { return records_->Get("EOF").ToBoolean(); }
    std::size_t Column(const Variant& field) override {
        FieldOf(field)->Get("Name");
        columns_.push_back(field);
        return columns_.size() - 1;
    }
    Variant Value(std::size_t column) override { return FieldOf(columns_[column])->Get("Value"); }
    void Text(std::size_t column, std::string& text) override { text = Value(column).ToText(); }

  private:
    ObjectRef FieldOf(const Variant& field) {
        Variant index[] = {field};
        return records_->Call("Fields", index).ToObject();
    }

    ObjectRef records_;
    std::vector<Variant> columns_;
};

constexpr std::array members = {
    method<&Recordset::MoveFirst>("MoveFirst", "Goes to the first row."),
    method<&Recordset::MoveNext>("MoveNext", "Goes on to the next row."),
    property<&Recordset::AtEnd>("EOF", "Whether the recordset stands behind its last row."),
    property<&Recordset::Fields>("Fields", "A field by its name or its number, from 0."),
};
constexpr ClassTable recordsetTable{.name = "Recordset", .members = members, .defaultMember = "Fields"};

constexpr std::array fieldMembers = {
    property<&Field::Name>("Name", "The name of the field."),
    property<&Field::Value>("Value", "The value of the field in the present row."),
};
constexpr ClassTable fieldTable{.name = "Field", .members = fieldMembers, .defaultMember = "Value"};

}  // namespace

const ClassTable& Recordset::Table() const { return recordsetTable; }
const ClassTable& Field::Table() const { return fieldTable; }

std::unique_ptr<RecordReader> RecordReader::For(const ObjectRef& records) {
    if (auto* own = dynamic_cast<Recordset*>(&*records)) return std::make_unique<OwnReader>(*own);
    return std::make_unique<ForeignReader>(records);
}

}  // namespace tessel::frame
