#pragma once

#include <algorithm>
#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "frame/FileSystem.h"
#include "hosts/headless/MemoryDisk.h"

/// What the sources of the memory disk share.
namespace tessel::headless {

namespace memorydisk {

inline constexpr char separator = '\\';
inline constexpr std::int32_t keptAttributes =
    frame::attributes::readOnly | frame::attributes::hidden | frame::attributes::system | frame::attributes::archive;

inline bool IsLetter(char c) { return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z'); }
inline char Upper(char c) { return c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c; }

/// A name without what counts nothing at its end.
inline std::string_view Trimmed(std::string_view name) {
    while (!name.empty() && (name.back() == ' ' || name.back() == '.')) name.remove_suffix(1);
    return name;
}

inline bool IsGoodName(std::string_view name) {
    constexpr std::size_t longest = 255;
    if (name.empty() || name.size() > longest || Trimmed(name).empty()) return false;
    return std::none_of(name.begin(), name.end(), [](char c) {
        return static_cast<unsigned char>(c) < ' ' || std::string_view("\\/:*?\"<>|").find(c) != std::string_view::npos;
    });
}

/// The names of a path, with "." and ".." followed.
inline std::vector<std::string_view> NamesOf(std::string_view path) {
    std::vector<std::string_view> names;
    for (std::size_t start = 0; start < path.size();) {
        const std::size_t end = std::min(path.find(separator, start), path.size());
        const std::string_view name = path.substr(start, end - start);
        if (name == "..") {
            if (!names.empty()) names.pop_back();
        } else if (!name.empty() && name != ".") {
            const std::string_view trimmed = Trimmed(name);
            names.push_back(trimmed.empty() ? name : trimmed);
        }
        start = end + 1;
    }
    return names;
}

inline std::string Joined(std::string_view folder, std::string_view name) {
    std::string path(folder);
    if (path.empty() || path.back() != separator) path += separator;
    return path.append(name);
}

}  // namespace memorydisk

struct MemoryDisk::Entry {
    std::string name;
    bool isFolder = false;
    std::int32_t attributes = 0;
    std::int64_t size = 0;
    std::string contents;  // at most `size` bytes; what lacks is NUL
    std::int64_t created = 0, modified = 0, accessed = 0;
    std::string type;  // empty for the usual one
    bool unreadable = false;
    std::optional<std::pair<float, float>> picture;
    Children children;

    void Set(const Facts& facts) {
        if (facts.attributes) attributes = *facts.attributes & memorydisk::keptAttributes;
        if (facts.contents && !isFolder) {
            contents = *facts.contents;
            size = static_cast<std::int64_t>(contents.size());
        }
        if (facts.size && !isFolder) {
            size = std::max<std::int64_t>(*facts.size, 0);
            if (static_cast<std::int64_t>(contents.size()) > size) contents.resize(static_cast<std::size_t>(size));
        }
        if (facts.created) created = *facts.created;
        if (facts.modified) modified = *facts.modified;
        if (facts.accessed) accessed = *facts.accessed;
        if (facts.type) type = *facts.type;
        if (facts.unreadable) unreadable = *facts.unreadable;
        if (facts.picture) picture = facts.picture;
    }
    Entry* Child(std::string_view childName) {
        const auto found = children.find(childName);
        return found != children.end() ? found->second.get() : nullptr;
    }
    Entry& Take(std::unique_ptr<Entry> child) {
        Entry& taken = *child;
        children[taken.name] = std::move(child);
        return taken;
    }
    std::unique_ptr<Entry> Release(std::string_view childName) {
        const auto found = children.find(childName);
        std::unique_ptr<Entry> child = std::move(found->second);
        children.erase(found);
        return child;
    }
};

struct MemoryDisk::Drive {
    std::string path, root, letter;
    int type = frame::driveTypes::fixed;
    std::string volume, share;
    bool ready = true, readOnly = false;
    Entry top;
};

/// Where a path leads.
struct MemoryDisk::Place {
    frame::Status status;     // 71, 76 when the way there fails, 53 when the entry alone is missing
    Drive* drive = nullptr;   // null where no drive is meant
    Entry* folder = nullptr;  // that holds the entry; null for the root of a drive and where it is missing
    Entry* entry = nullptr;   // null where it is missing
    std::string_view leaf;    // the last name, a part of the path
    std::string folderPath;   // of `folder`

    bool IsRoot() const { return entry && entry == &drive->top; }
    std::string Path() const { return IsRoot() ? drive->root : memorydisk::Joined(folderPath, entry->name); }
};

}  // namespace tessel::headless
