#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>

#include "fileservices/PathHelpers.h"

/// Whatever bytes a path has, its parts lie inside it, walking up ends, and what was taken apart goes together again.
/// An input is a separator, a path, a NUL and a name.
namespace {

namespace fileservices = tessel::fileservices;

void Check(bool holds) {
    if (!holds) std::abort();
}

void CheckName(std::string_view path, char separator) {
    const std::string_view name = fileservices::GetFileName(path, separator);
    Check(name.find(separator) == std::string_view::npos);
    Check(name.empty() || (name.data() >= path.data() && name.data() + name.size() <= path.data() + path.size()));

    const std::string_view extension = fileservices::GetExtensionName(path, separator);
    Check(extension.find('.') == std::string_view::npos && name.ends_with(extension));
    Check(extension.empty() || name[name.size() - extension.size() - 1] == '.');
    Check(separator == '.' || extension.empty() == (name.find('.') == std::string_view::npos || name.ends_with('.')));
}

/// Checks a path and all above it.
void CheckWayUp(std::string_view path, char separator) {
    while (true) {
        CheckName(path, separator);
        const std::string_view name = fileservices::GetFileName(path, separator);
        const std::string_view parent = fileservices::GetParentFolderName(path, separator);
        Check(path.starts_with(parent) && (parent.size() < path.size() || path.empty()));
        if (parent.empty()) break;

        const std::string joined = fileservices::BuildPath(parent, name, separator);
        Check(fileservices::GetFileName(joined, separator) == name);
        const std::string_view again = fileservices::GetParentFolderName(joined, separator);
        const bool isBareDrive = parent.ends_with(':');  // "C:a" goes together as "C:\a"
        Check(again == parent || (isBareDrive && again == std::string(parent) + separator));
        path = parent;
    }
}

void CheckJoined(std::string_view parent, std::string_view name, char separator) {
    const std::string joined = fileservices::BuildPath(parent, name, separator);
    if (parent.empty()) {
        Check(joined == name);
        return;
    }
    std::string_view first = parent, second = name;
    while (first.ends_with(separator)) first.remove_suffix(1);
    while (second.starts_with(separator)) second.remove_prefix(1);
    Check(joined == std::string(first) + separator + std::string(second));
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view input(reinterpret_cast<const char*>(data), size);
    if (input.empty()) return 0;
    const char separator = input.front();
    const std::string_view rest = input.substr(1);
    const std::string_view path = rest.substr(0, rest.find('\0'));
    const std::string_view name = path.size() < rest.size() ? rest.substr(path.size() + 1) : std::string_view();
    for (const std::string_view part : {path, name, rest}) CheckWayUp(part, separator);
    CheckJoined(path, name, separator);
    return 0;
}
