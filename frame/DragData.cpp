#include "frame/DragData.h"

#include <array>

#include "frame/ClassTable.h"
#include "frame/Error.h"

namespace tessel::frame {

const std::string& DragFiles::Item(std::int32_t index) const {
    if (index < 1 || index > Count()) throw ControlError(errors::subscript);
    return paths_[static_cast<std::size_t>(index - 1)];
}

void DragData::Clear() {
    formats_.clear();
    Files.Clear();
}

void DragData::SetData(const std::optional<Variant>&, std::int16_t format) { formats_.insert(format); }

bool DragData::GetFormat(std::int16_t format) const {
    return formats_.contains(format) || (format == filesFormat && Files.Count() > 0);
}

namespace {

constexpr std::array fileMembers = {
    property<&DragFiles::Count>("Count", "How many files there are."),
    property<&DragFiles::Item>("Item", "The path of a file, from 1."),
    method<&DragFiles::Add>("Add", "Adds a path.", {"Path"}),
    method<&DragFiles::Clear>("Clear", "Takes all paths away."),
};
constexpr ClassTable filesTable{.name = "DragFiles", .members = fileMembers, .defaultMember = "Item"};

constexpr std::array dataMembers = {
    method<&DragData::Clear>("Clear", "Takes every format and file away."),
    method<&DragData::SetData>("SetData", "Promises a format.", {"Data", "Format"}),
    method<&DragData::GetFormat>("GetFormat", "Whether a format is there.", {"Format"}),
};
constexpr std::array dataParts = {part<&DragData::Files>("Files")};
constexpr ClassTable dataTable{.name = "DragData", .members = dataMembers, .parts = dataParts};

}  // namespace

const ClassTable& DragFiles::Table() const { return filesTable; }
const ClassTable& DragData::Table() const { return dataTable; }

}  // namespace tessel::frame
