#include "hosts/headless/MemoryDisk.h"

#include <algorithm>

#include "frame/Text.h"
#include "hosts/headless/MemoryDiskParts.h"

namespace tessel::headless {

namespace attributes = frame::attributes;
namespace errors = frame::errors;
using frame::Status;
using namespace memorydisk;

// Reading.

frame::FileRecord MemoryDisk::RecordOf(const Entry& entry) {
    frame::FileRecord record;
    record.size = entry.isFolder ? 0 : entry.size;
    record.created = entry.created;
    record.modified = entry.modified;
    record.accessed = entry.accessed;
    record.attributes = entry.attributes | (entry.isFolder ? attributes::directory : 0);
    record.typeId = TypeIdOf(entry);
    return record;
}

std::int32_t MemoryDisk::TypeIdOf(const Entry& entry) {
    std::string text = entry.type;
    if (text.empty() && entry.isFolder) text = frame::folderTypeText;
    if (text.empty()) {
        text = "File";
        if (const std::size_t point = entry.name.rfind('.'); point != std::string::npos && point + 1 < entry.name.size()) {
            std::string extension = entry.name.substr(point + 1);
            std::transform(extension.begin(), extension.end(), extension.begin(), Upper);
            text = extension + " File";
        }
    }
    const auto [known, isNew] = typeIds_.try_emplace(text, static_cast<std::int32_t>(types_.size()));
    if (isNew) types_.push_back(text);
    return known->second;
}

std::string MemoryDisk::TypeText(std::int32_t typeId) {
    const auto index = static_cast<std::size_t>(typeId);
    return typeId >= 0 && index < types_.size() ? types_[index] : std::string();
}

bool MemoryDisk::FileExists(std::string_view path) {
    const Place place = Find(path);
    return place.entry && !place.entry->isFolder;
}

bool MemoryDisk::FolderExists(std::string_view path) {
    const Place place = Find(path);
    return place.entry && place.entry->isFolder;
}

bool MemoryDisk::DriveExists(std::string_view path) {
    return std::any_of(drives_.begin(), drives_.end(),
                       [&](const auto& known) { return frame::EqualsNoCase(known.second->root, path); });
}

Status MemoryDisk::Stat(std::string_view path, frame::FileRecord& record) {
    const Place place = Find(path);
    if (!place.entry) return place.status;
    record = RecordOf(*place.entry);
    return {};
}

/// Knows its folder by path, so that a folder that goes meanwhile does no harm.
class MemoryDisk::Listing final : public frame::FolderListing {
  public:
    Listing(MemoryDisk& disk, std::string path, const MemoryDisk::Entry& folder) : disk_(disk), path_(std::move(path)) {
        for (const bool folders : {true, false}) {
            for (const auto& [name, child] : folder.children)
                if (child->isFolder == folders) Add(name);
            if (folders) folders_ = entries_.size();
        }
    }
    Status Stat(std::size_t index, frame::FileRecord& record) override {
        const Status status = disk_.Stat(Joined(path_, Name(index)), record);
        return status.Number() == errors::pathNotFound ? Status(errors::fileNotFound) : status;
    }

  private:
    MemoryDisk& disk_;
    std::string path_;
};

Status MemoryDisk::List(std::string_view folder, std::unique_ptr<frame::FolderListing>& listing) {
    const Place place = Find(folder);
    if (!place.entry && place.status.Number() == errors::diskNotReady) return place.status;
    if (!place.entry || !place.entry->isFolder) return errors::pathNotFound;
    if (place.entry->unreadable) return errors::permissionDenied;
    listing = std::make_unique<Listing>(*this, place.Path(), *place.entry);
    return {};
}

Status MemoryDisk::Count(std::string_view folder, frame::FolderCounts& counts) {
    const Place place = Find(folder);
    if (!place.entry && place.status.Number() == errors::diskNotReady) return place.status;
    if (!place.entry || !place.entry->isFolder) return errors::pathNotFound;
    if (place.entry->unreadable) return errors::permissionDenied;
    counts = {};
    for (const auto& child : place.entry->children) ++(child.second->isFolder ? counts.folders : counts.files);
    return {};
}

class MemoryDisk::Measure final : public frame::TreeSize {
  public:
    Measure(MemoryDisk& disk, std::string_view folder) : disk_(disk), folders_{std::string(folder)} {}
    bool Step(std::size_t entries) override {
        for (std::size_t seen = 0; !folders_.empty() && seen < entries; ++seen) {
            const std::string path = std::move(folders_.back());
            folders_.pop_back();
            const Place place = disk_.Find(path);
            if (!place.entry || !place.entry->isFolder || place.entry->unreadable) continue;
            for (const auto& [name, child] : place.entry->children) {
                ++seen;
                if (child->isFolder)
                    folders_.push_back(Joined(path, name));
                else
                    bytes_ += child->size;
            }
        }
        return !folders_.empty();
    }

  private:
    MemoryDisk& disk_;
    std::vector<std::string> folders_;  // still to be looked into
};

std::unique_ptr<frame::TreeSize> MemoryDisk::MeasureTree(std::string_view folder) {
    return std::make_unique<Measure>(*this, folder);
}

std::vector<frame::DriveRecord> MemoryDisk::Drives() {
    std::vector<frame::DriveRecord> records;
    for (const auto& [key, drive] : drives_)
        records.push_back({drive->path, drive->root, drive->letter, drive->type, drive->share,
                           drive->ready ? drive->volume : std::string(), drive->ready});
    return records;
}

// Changing.

Status MemoryDisk::CreateFolder(std::string_view path) {
    Place place;
    if (const Status status = FindNew(path, place); status.Failed()) return status;
    place.folder->Take(NewEntry(place.leaf, true));
    return {};
}

Status MemoryDisk::CreateFile(std::string_view path, bool overwrite) {
    Place place;
    const Status status = FindNew(path, place);
    if (!place.entry) {
        if (status.Failed()) return status;
        place.folder->Take(NewEntry(place.leaf, false));
        return {};
    }
    if (place.entry->isFolder) return errors::permissionDenied;
    if (!overwrite) return errors::fileExists;
    if (place.drive->readOnly || (place.entry->attributes & attributes::readOnly)) return errors::permissionDenied;
    place.entry->contents.clear();
    place.entry->size = 0;
    place.entry->modified = now_ ? now_() : 0;
    return {};
}

Status MemoryDisk::DeleteFile(std::string_view path, bool force) {
    const Place place = Find(path);
    if (!place.entry) return place.status;
    if (place.entry->isFolder) return errors::fileNotFound;
    if (place.drive->readOnly || (!force && (place.entry->attributes & attributes::readOnly))) return errors::permissionDenied;
    place.folder->Release(place.leaf);
    return {};
}

Status MemoryDisk::Rename(std::string_view path, std::string_view newName) {
    const Place place = Find(path);
    if (!place.entry) return place.status;
    if (!IsGoodName(newName)) return errors::badFileName;
    if (place.IsRoot() || place.drive->readOnly) return errors::permissionDenied;
    const std::string name(Trimmed(newName));
    if (Entry* other = place.folder->Child(name); other && other != place.entry) return errors::fileExists;
    auto entry = place.folder->Release(place.leaf);
    entry->name = name;
    place.folder->Take(std::move(entry));
    return {};
}

Status MemoryDisk::SetAttributes(std::string_view path, std::int32_t value) {
    const Place place = Find(path);
    if (!place.entry) return place.status;
    value &= ~attributes::directory;
    if (value == place.entry->attributes) return {};
    if ((value & ~keptAttributes) != 0) return errors::invalidCall;
    if (place.drive->readOnly) return errors::permissionDenied;
    place.entry->attributes = value;
    return {};
}

std::string MemoryDisk::TemporaryFolder() {
    for (const auto& [letter, drive] : drives_)
        if (std::string folder = Joined(drive->root, "Temp"); FolderExists(folder)) return folder;
    return drives_.empty() ? std::string() : Joined(drives_.begin()->second->root, "Temp");
}

std::string MemoryDisk::SpecialFolder(int number) {
    const auto found = special_.find(number);
    return found != special_.end() ? found->second : std::string();
}

/// Keeps what the file held when it was opened.
class MemoryDisk::Reader final : public frame::BinaryFile {
  public:
    Reader(std::string contents, std::int64_t size) : contents_(std::move(contents)), size_(size) {}
    Status Read(std::int64_t position, char* bytes, std::size_t size, std::size_t& read) override {
        read = 0;
        if (position < 0) return errors::invalidCall;
        if (position >= size_) return {};
        read = static_cast<std::size_t>(std::min<std::int64_t>(size_ - position, static_cast<std::int64_t>(size)));
        std::fill_n(bytes, read, '\0');
        if (const auto start = static_cast<std::size_t>(position); start < contents_.size()) contents_.copy(bytes, read, start);
        return {};
    }
    std::int64_t Size() const override { return size_; }

  private:
    std::string contents_;
    std::int64_t size_;
};

Status MemoryDisk::OpenForReading(std::string_view path, std::unique_ptr<frame::BinaryFile>& file) {
    const Place place = Find(path);
    if (!place.entry) return place.status;
    if (place.entry->isFolder) return errors::pathAccess;
    if (place.entry->unreadable) return errors::permissionDenied;
    file = std::make_unique<Reader>(place.entry->contents, place.entry->size);
    return {};
}

Status MemoryDisk::WriteOver(std::string_view path, std::string_view bytes) {
    Place place;
    const Status status = FindNew(path, place);
    if (!place.entry && status.Failed()) return status;
    if (place.entry) {
        if (place.entry->isFolder) return errors::pathAccess;
        const bool isProtected = place.entry->unreadable || (place.entry->attributes & attributes::readOnly) != 0;
        if (isProtected || place.drive->readOnly) return errors::permissionDenied;
    }
    if (const Status charged = Charge(bytes.size()); charged.Failed()) return charged;
    if (!place.entry) place.entry = &place.folder->Take(NewEntry(place.leaf, false));
    std::string& contents = place.entry->contents;
    contents.replace(0, std::min(bytes.size(), contents.size()), bytes);
    place.entry->size = std::max(place.entry->size, static_cast<std::int64_t>(contents.size()));
    place.entry->modified = now_ ? now_() : 0;
    return {};
}

}  // namespace tessel::headless
