#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "frame/Object.h"
#include "frame/Variant.h"

namespace tessel::frame {

class Field;

/// The rows of a data source, one after the other, with their fields by name or by number. A host or an application derives from
/// this; any other object with `MoveFirst`, `MoveNext`, `EOF` and `Fields(x)`, whose fields have `Name` and `Value`, is read as
/// well (see `RecordReader`).
///
/// What the data source refuses passes out as a `ControlError` with the data source's own text.
class Recordset : public Object {
  public:
    /// Goes to the first row. Error 3021 when there is none.
    virtual void MoveFirst() = 0;
    /// Goes on to the next row, or behind the last one. Error 3021 at the end.
    virtual void MoveNext() = 0;
    /// Whether it stands behind the last row. The member's name is `EOF`.
    virtual bool AtEnd() = 0;

    // Fields count from 0.
    virtual std::int32_t FieldCount() = 0;
    virtual std::string FieldName(std::int32_t field) = 0;
    /// The field's value in the present row; error 3021 at the end.
    virtual Variant FieldValue(std::int32_t field) = 0;
    /// The value as text, into a string that is used again for each row.
    virtual void FieldText(std::int32_t field, std::string& text) { text = FieldValue(field).ToText(); }

    /// The number of a field that is named by its name, in any case, or by its number. Error 3265 when there is none.
    std::int32_t NumberOf(const Variant& field);
    /// A field by name or number. It reads the row on which the recordset stands by then.
    std::shared_ptr<Field> Fields(const Variant& Index);

    const ClassTable& Table() const override;
};

/// A field of a recordset, which it does not keep alive.
class Field final : public Object {
  public:
    Field(Recordset& recordset, std::int32_t number) : recordset_(recordset), number_(number) {}

    std::string Name() const { return recordset_->FieldName(number_); }
    Variant Value() const { return recordset_->FieldValue(number_); }

    const ClassTable& Table() const override;

  private:
    Handle<Recordset> recordset_;
    std::int32_t number_;
};

/// Reads a recordset, or an object that has its members. What fails throws a `ControlError`.
class RecordReader {
  public:
    virtual ~RecordReader() = default;
    /// `records` must outlive the reader. Error 91 for no object and for one that has gone.
    static std::unique_ptr<RecordReader> For(const ObjectRef& records);

    virtual void MoveFirst() = 0;
    virtual void MoveNext() = 0;
    virtual bool AtEnd() = 0;
    /// Reads the name of a field that is given by name or by number, and gives a handle to its column.
    virtual std::size_t Column(const Variant& field) = 0;
    /// The value of a column in the present row.
    virtual Variant Value(std::size_t column) = 0;
    virtual void Text(std::size_t column, std::string& text) = 0;
};

}  // namespace tessel::frame
