#include "frame/FileSystem.h"

#include <limits>

#include "frame/Text.h"

namespace tessel::frame {

bool FolderListing::Add(std::string_view name) {
    constexpr std::size_t mostBytes = std::numeric_limits<std::uint32_t>::max();
    constexpr std::size_t longestName = std::numeric_limits<std::uint16_t>::max();
    if (name.size() > longestName || names_.size() + name.size() + 1 > mostBytes) return false;
    entries_.push_back({static_cast<std::uint32_t>(names_.size()), static_cast<std::uint16_t>(name.size()), false});
    names_.append(name);
    names_ += '\0';
    return true;
}

Status FolderListing::StatHiding(std::size_t index, std::int32_t& attributes) {
    FileRecord record;
    const Status status = Stat(index, record);
    attributes = record.attributes & (frame::attributes::hidden | frame::attributes::system);
    return status;
}

std::int64_t TreeSize::Finish() {
    constexpr std::size_t manyEntries = 100'000;
    while (Step(manyEntries)) {
    }
    return bytes_;
}

int SpecialFolderNumber(std::string_view name) {
    for (const SpecialFolderName& known : specialFolderNames)
        if (EqualsNoCase(known.name, name)) return known.number;
    return -1;
}

}  // namespace tessel::frame
