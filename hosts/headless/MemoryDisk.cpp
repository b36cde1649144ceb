#include "hosts/headless/MemoryDisk.h"

#include <algorithm>
#include <cmath>

#include "frame/Text.h"
#include "hosts/headless/MemoryDiskParts.h"

namespace tessel::headless {

namespace errors = frame::errors;
using frame::Status;
using namespace memorydisk;

std::int64_t SecondsOf(frame::Date date) {
    constexpr double epoch = 25'569, secondsPerDay = 86'400;
    const double midnight = std::trunc(date.days);
    const double fraction = std::fabs(date.days - midnight);  // counts forward from midnight on days before day 0 too
    return static_cast<std::int64_t>(std::llround((midnight - epoch) * secondsPerDay + fraction * secondsPerDay));
}

bool MemoryDisk::NameOrder::operator()(std::string_view a, std::string_view b) const { return frame::CompareNoCase(a, b) < 0; }

MemoryDisk::MemoryDisk(std::function<std::int64_t()> now) : now_(std::move(now)) {
    constexpr int personal = 5;
    (void)SetFolder("C:\\Temp", {});  // nothing stands in its way
    special_[personal] = "C:\\My Documents";
}

MemoryDisk::~MemoryDisk() = default;

// Paths.

MemoryDisk::Drive* MemoryDisk::DriveOf(std::string_view path, std::vector<std::string_view>& names) {
    if (path.size() >= 2 && IsLetter(path[0]) && path[1] == ':' && (path.size() == 2 || path[2] == separator)) {
        names = NamesOf(path.substr(2));
        const auto found = drives_.find(std::string{'1', Upper(path[0])});
        return found != drives_.end() ? found->second.get() : nullptr;
    }
    if (!path.starts_with("\\\\")) return nullptr;
    for (const auto& [key, drive] : drives_) {
        if (!drive->letter.empty() || !frame::StartsWithNoCase(Joined(path, ""), drive->root)) continue;
        const std::size_t length = std::min(path.size(), drive->root.size());
        names = NamesOf(path.substr(length));
        return drive.get();
    }
    return nullptr;
}

MemoryDisk::Place MemoryDisk::Find(std::string_view path) {
    Place place;
    std::vector<std::string_view> names;
    place.drive = DriveOf(path, names);
    if (!place.drive) {
        place.status = errors::pathNotFound;
    } else if (!place.drive->ready) {
        place.status = errors::diskNotReady;
    } else {
        place.entry = &place.drive->top;
        place.folderPath = place.drive->root;
        if (!names.empty()) place.leaf = names.back();
        for (std::size_t i = 0; i < names.size(); ++i) {
            if (i > 0) place.folderPath = Joined(place.folderPath, place.entry->name);
            place.folder = place.entry;
            if (!place.folder->isFolder) {
                place.status = errors::pathNotFound;
                place.folder = place.entry = nullptr;
                break;
            }
            place.entry = place.folder->Child(names[i]);
            if (place.entry) continue;
            const bool last = i + 1 == names.size();
            place.status = last ? errors::fileNotFound : errors::pathNotFound;
            if (!last) place.folder = nullptr;
            break;
        }
    }
    return place;
}

Status MemoryDisk::FindNew(std::string_view path, Place& place) {
    place = Find(path);
    if (place.entry) return errors::fileExists;
    if (!place.folder) return place.status;
    if (!IsGoodName(place.leaf)) return errors::badFileName;
    if (place.drive->readOnly) return errors::permissionDenied;
    return {};
}

std::unique_ptr<MemoryDisk::Entry> MemoryDisk::NewEntry(std::string_view name, bool isFolder) const {
    auto entry = std::make_unique<Entry>();
    entry->name = name;
    entry->isFolder = isFolder;
    entry->created = entry->modified = entry->accessed = now_ ? now_() : 0;
    return entry;
}

Status MemoryDisk::Charge(std::size_t bytes) {
    if (!free_) return {};
    if (static_cast<std::int64_t>(bytes) > *free_) return errors::diskFull;
    *free_ -= static_cast<std::int64_t>(bytes);
    return {};
}

// Setting up.

Status MemoryDisk::SetDrive(std::string_view letter, const DriveFacts& facts) {
    const bool lettered = !letter.empty();
    std::string root, key, path;
    if (lettered) {
        const std::string_view rest = letter.substr(1);
        if (!IsLetter(letter[0]) || (!rest.empty() && rest != ":" && rest != ":\\")) return errors::badFileName;
        path = std::string{Upper(letter[0]), ':'};
        root = path + separator;
        key = std::string{'1', Upper(letter[0])};
    } else {
        if (!facts.share || !facts.share->starts_with("\\\\") || NamesOf(*facts.share).size() < 2) return errors::badFileName;
        path = *facts.share;
        root = Joined(path, "");
        key = "2" + frame::FoldCase(root);
    }
    auto& drive = drives_[key];
    if (!drive) {
        drive = std::make_unique<Drive>();
        drive->path = path;
        drive->root = root;
        if (lettered) drive->letter = path.substr(0, 1);
        if (!lettered) drive->type = frame::driveTypes::network;
        drive->top = std::move(*NewEntry({}, true));
    }
    if (facts.type) drive->type = *facts.type;
    if (facts.volume) drive->volume = *facts.volume;
    if (facts.share) drive->share = *facts.share;
    if (facts.ready) drive->ready = *facts.ready;
    if (facts.readOnly) drive->readOnly = *facts.readOnly;
    return {};
}

Status MemoryDisk::SetFile(std::string_view path, const Facts& facts) { return Set(path, false, facts); }
Status MemoryDisk::SetFolder(std::string_view path, const Facts& facts) { return Set(path, true, facts); }

Status MemoryDisk::Set(std::string_view path, bool isFolder, const Facts& facts) {
    std::vector<std::string_view> names;
    Drive* drive = DriveOf(path, names);
    if (!std::all_of(names.begin(), names.end(), IsGoodName)) return errors::badFileName;
    if (!drive && !names.empty()) {  // a letter that has no drive yet
        if (const Status made = SetDrive(path.substr(0, 1), {}); made.Failed()) return made;
        drive = DriveOf(path, names);
    }
    if (!drive || (names.empty() && !isFolder)) return errors::badFileName;
    Entry* entry = &drive->top;
    for (std::size_t i = 0; i < names.size(); ++i) {
        const bool folder = isFolder || i + 1 < names.size();
        Entry* child = entry->Child(names[i]);
        if (!child) child = &entry->Take(NewEntry(names[i], folder));
        if (child->isFolder != folder) return errors::fileExists;
        entry = child;
    }
    entry->Set(facts);
    return {};
}

Status MemoryDisk::Remove(std::string_view path) {
    std::vector<std::string_view> names;
    Drive* drive = DriveOf(path, names);
    if (!drive) return errors::pathNotFound;
    if (names.empty()) {
        std::erase_if(drives_, [&](const auto& known) { return known.second.get() == drive; });
        return {};
    }
    Entry* folder = &drive->top;
    for (std::size_t i = 0; i + 1 < names.size(); ++i)
        if (!(folder = folder->Child(names[i]))) return errors::pathNotFound;
    if (!folder->Child(names.back())) return errors::fileNotFound;
    folder->Release(names.back());
    return {};
}

// Looking on.

Status MemoryDisk::ListTree(std::string_view folder, std::vector<Listed>& all) {
    std::vector<std::string_view> names;
    Drive* drive = DriveOf(folder, names);
    Entry* entry = drive ? &drive->top : nullptr;
    std::string path = drive ? drive->root : std::string();
    for (const std::string_view name : names) {
        if (entry) entry = entry->Child(name);
        if (entry) path = Joined(path, entry->name);
    }
    if (!entry || !entry->isFolder) return errors::pathNotFound;
    const auto walk = [&](const auto& self, Entry& below, const std::string& at) -> void {
        for (const bool folders : {true, false})
            for (const auto& [name, child] : below.children) {
                if (child->isFolder != folders) continue;
                const frame::FileRecord record = RecordOf(*child);
                all.push_back({Joined(at, name), record.size, record.attributes});
                if (folders) self(self, *child, Joined(at, name));
            }
    };
    walk(walk, *entry, path);
    return {};
}

std::optional<std::pair<float, float>> MemoryDisk::PictureSize(std::string_view path) {
    const Place place = Find(path);
    return place.entry ? place.entry->picture : std::nullopt;
}

std::vector<std::string> MemoryDisk::Recycled() const {
    std::vector<std::string> paths;
    for (const auto& deleted : recycled_) paths.push_back(deleted.first);
    return paths;
}

Status MemoryDisk::Restore(std::string_view path) {
    const auto found = std::find_if(recycled_.rbegin(), recycled_.rend(),
                                    [&](const auto& deleted) { return frame::EqualsNoCase(deleted.first, path); });
    if (found == recycled_.rend()) return errors::fileNotFound;
    Place place;
    if (const Status status = FindNew(path, place); status.Failed()) return status;
    place.folder->Take(std::move(found->second));
    recycled_.erase(std::next(found).base());
    return {};
}

}  // namespace tessel::headless
