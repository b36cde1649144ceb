#include "fileservices/SpecialFolders.h"

#include <array>

#include "frame/ClassTable.h"

namespace tessel::fileservices {

std::string SpecialFolders::SpecialFolderPath(std::string_view name) const {
    const int number = frame::SpecialFolderNumber(name);
    return number < 0 ? std::string() : host_.Files().SpecialFolder(number);
}

const frame::ClassTable& SpecialFolders::Table() const {
    static constexpr std::array members = {
        frame::method<&SpecialFolders::PathByReference>("SpecialFolderPath", "The path of a special folder by its name.", {"Name"}),
    };
    static constexpr frame::ClassTable table{.name = "SpecialFolders", .members = members};
    return table;
}

}  // namespace tessel::fileservices
