#include "fileservices/PathHelpers.h"

#include <algorithm>

namespace tessel::fileservices {

namespace {

bool IsLetter(char c) { return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z'); }

std::string_view WithoutEnd(std::string_view text, char separator) {
    return text.substr(0, text.find_last_not_of(separator) + 1);  // npos + 1 is 0
}

std::string_view WithoutStart(std::string_view text, char separator) {
    return text.substr(std::min(text.find_first_not_of(separator), text.size()));
}

/// The length of "\\server\name", with the separator behind it; 0 for any other path.
std::size_t ShareLength(std::string_view path, char separator) {
    constexpr std::size_t start = 2;
    if (path.size() <= start || path[0] != separator || path[1] != separator || path[start] == separator) return 0;
    const std::size_t serverEnd = path.find(separator, start);
    const std::size_t name = path.find_first_not_of(separator, serverEnd);
    if (serverEnd == std::string_view::npos || name == std::string_view::npos) return 0;
    const std::size_t nameEnd = path.find(separator, name);
    return nameEnd == std::string_view::npos ? path.size() : nameEnd + 1;
}

std::size_t RootLength(std::string_view path, char separator) {
    if (separator == '\\') {
        if (path.size() >= 2 && IsLetter(path[0]) && path[1] == ':') return path.size() > 2 && path[2] == separator ? 3 : 2;
        if (const std::size_t share = ShareLength(path, separator)) return share;
    }
    return !path.empty() && path[0] == separator ? 1 : 0;
}

}  // namespace

std::string BuildPath(std::string_view parent, std::string_view name, char separator) {
    if (parent.empty()) return std::string(name);
    std::string path(WithoutEnd(parent, separator));
    path += separator;
    return path.append(WithoutStart(name, separator));
}

std::string_view GetFileName(std::string_view path, char separator) {
    const std::string_view names = WithoutEnd(path.substr(RootLength(path, separator)), separator);
    return names.substr(names.rfind(separator) + 1);  // npos + 1 is 0
}

std::string_view GetExtensionName(std::string_view path, char separator) {
    const std::string_view name = GetFileName(path, separator);
    const std::size_t point = name.rfind('.');
    return point == std::string_view::npos ? std::string_view() : name.substr(point + 1);
}

std::string_view GetParentFolderName(std::string_view path, char separator) {
    const std::string_view name = GetFileName(path, separator);
    if (name.empty()) return {};
    const std::size_t root = RootLength(path, separator);
    const auto start = static_cast<std::size_t>(name.data() - path.data());
    const std::string_view folders = WithoutEnd(path.substr(root, start - root), separator);
    return path.substr(0, root + folders.size());
}

std::string GetParentFolderName(std::string_view path, frame::FileSystem& files) {
    if (files.DriveExists(path)) return {};
    std::string parent(GetParentFolderName(path, files.Separator()));
    const std::string asDrive = parent + files.Separator();
    return !parent.empty() && files.DriveExists(asDrive) ? asDrive : parent;
}

}  // namespace tessel::fileservices
