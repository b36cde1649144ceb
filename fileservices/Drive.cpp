#include "fileservices/Drive.h"

#include <algorithm>
#include <array>

#include "frame/ClassTable.h"
#include "frame/Error.h"
#include "frame/Text.h"

namespace tessel::fileservices {

bool Drive::EqualsObject(const Object& other) const {
    const auto* drive = dynamic_cast<const Drive*>(&other);
    return drive && drive->record_ == record_;
}

DriveCollection::DriveCollection(frame::FileSystem& files) : ignoresCase_(files.IgnoresCase()) {
    for (frame::DriveRecord& record : files.Drives()) drives_.push_back(std::make_shared<Drive>(std::move(record)));
}

DriveRef DriveCollection::Item(const frame::Variant& key) const {
    if (key.IsNumber()) {
        const std::int32_t number = key.ToLong();
        if (number < 1 || number > Count()) throw frame::ControlError(frame::errors::subscript);
        return drives_[static_cast<std::size_t>(number - 1)];
    }
    const std::string text = key.ToText();
    const auto found = std::find_if(drives_.begin(), drives_.end(), [&](const DriveRef& drive) { return Means(text, *drive); });
    if (found == drives_.end()) throw frame::ControlError(frame::errors::pathNotFound);
    return *found;
}

bool DriveCollection::Means(std::string_view text, const Drive& drive) const {
    const auto is = [&](std::string_view name) {
        return !name.empty() && (ignoresCase_ ? frame::EqualsNoCase(name, text) : name == text);
    };
    return is(drive.RootPath()) || is(drive.DrivePath()) || is(drive.DriveLetter()) || is(drive.ShareName());
}

namespace {

constexpr std::array driveMembers = {
    frame::property<&Drive::DrivePath>("Path", "The drive's path, as C:"),
    frame::property<&Drive::DriveLetter>("DriveLetter", "The drive's letter; empty where it has none."),
    frame::property<&Drive::DriveType>("DriveType", "1 removable, 2 fixed, 3 network, 4 compact disk, 5 RAM disk."),
    frame::property<&Drive::ShareName>("ShareName", "The network share that the drive stands for."),
    frame::property<&Drive::VolumeName>("VolumeName", "The label of what is in the drive."),
    frame::property<&Drive::IsReady>("IsReady", "Whether the drive can be read."),
};
constexpr frame::ClassTable driveTable{.name = "Drive", .members = driveMembers, .defaultMember = "Path"};

constexpr std::array collectionMembers = {
    frame::property<&DriveCollection::Count>("Count", "How many drives there are."),
    frame::property<&DriveCollection::Item>("Item", "A drive by its number, from 1, or by its letter."),
};
constexpr frame::ClassTable collectionTable{.name = "Drives", .members = collectionMembers, .defaultMember = "Item"};

}  // namespace

const frame::ClassTable& Drive::Table() const { return driveTable; }
const frame::ClassTable& DriveCollection::Table() const { return collectionTable; }

}  // namespace tessel::fileservices
