#include "hosts/posix/DiskListing.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <sys/vfs.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstring>

namespace tessel::posix {

namespace attributes = frame::attributes;
namespace errors = frame::errors;

bool DiskUser::MayWrite(mode_t mode, uid_t owner, gid_t group) const {
    if (user == 0) return (mode & (S_IWUSR | S_IWGRP | S_IWOTH)) != 0;
    if (owner == user) return (mode & S_IWUSR) != 0;
    const bool member = std::find(groups.begin(), groups.end(), group) != groups.end();
    return (mode & (member ? S_IWGRP : S_IWOTH)) != 0;
}

DiskUser DiskUser::OfThisProcess() {
    DiskUser user{.user = geteuid(), .groups = {getegid()}};
    const int count = getgroups(0, nullptr);
    std::vector<gid_t> others(static_cast<std::size_t>(std::max(count, 0)));
    const int got = getgroups(static_cast<int>(others.size()), others.data());
    others.resize(static_cast<std::size_t>(std::max(got, 0)));
    user.groups.insert(user.groups.end(), others.begin(), others.end());
    return user;
}

frame::FileRecord RecordMaker::RecordOf(std::string_view name, const EntryFacts& entry) {
    frame::FileRecord record;
    record.attributes = HidingOf(name);
    if (!user.MayWrite(entry.mode, entry.owner, entry.group)) record.attributes |= attributes::readOnly;
    if (entry.IsFolder()) {
        record.attributes |= attributes::directory;
        record.typeId = TypeTexts::folderId;
    } else {
        record.size = entry.size;
        record.typeId = types.IdOf(name);
    }
    record.modified = entry.modified;
    record.accessed = entry.accessed;
    record.created = entry.created.value_or(entry.modified);
    return record;
}

// Listing.

frame::Status DiskListing::Open(std::string_view path) {
    path_ = path;
    if (const int error = OpenFolder(path, folder_)) return StatusOf(error, errors::pathNotFound);
    FolderReader reader;
    reader.Start(folder_.Number());
    std::vector<Entry> files;
    for (FolderReader::Entry entry; reader.Next(entry);) {
        if (!Add({entry.name, entry.length})) return errors::outOfMemory;
        const FolderReader::Kind kind = KindOf(entry);
        entries_.back().isLink = kind == FolderReader::Kind::Link;
        if (!LeadsToFolder(entry.name, kind)) {
            files.push_back(entries_.back());
            entries_.pop_back();
        }
    }
    if (reader.Error() != 0) return StatusOf(reader.Error());
    folders_ = entries_.size();
    entries_.insert(entries_.end(), files.begin(), files.end());
    Order(0, folders_);
    Order(folders_, entries_.size());
    return {};
}

/// Not every file system tells the kind with the name.
FolderReader::Kind DiskListing::KindOf(const FolderReader::Entry& entry) {
    using Kind = FolderReader::Kind;
    EntryFacts facts;
    if (entry.kind != Kind::Unknown) return entry.kind;
    if (maker_.facts.Itself(folder_.Number(), entry.name, facts) != 0) return Kind::File;
    if (facts.IsLink()) return Kind::Link;
    return facts.IsFolder() ? Kind::Folder : Kind::File;
}

bool DiskListing::LeadsToFolder(const char* name, FolderReader::Kind kind) {
    if (kind != FolderReader::Kind::Link) return kind == FolderReader::Kind::Folder;
    EntryFacts facts;
    return maker_.facts.Follow(folder_.Number(), name, facts) == 0 && facts.IsFolder();
}

/// Orders by the eight bytes behind what all names have in common, which mostly tell any two apart, and by the rest where they
/// do not.
void DiskListing::Order(std::size_t first, std::size_t end) {
    if (end - first < 2) return;
    constexpr std::size_t keySize = 8;
    const char* names = names_.data();
    std::size_t common = entries_[first].length;
    for (std::size_t i = first + 1; i < end; ++i) {
        common = std::min<std::size_t>(common, entries_[i].length);
        const char *a = names + entries_[first].start, *b = names + entries_[i].start;
        common = static_cast<std::size_t>(std::mismatch(a, a + common, b).first - a);
    }
    struct Keyed {
        std::uint64_t key;
        Entry entry;
    };
    std::vector<Keyed> keyed;
    keyed.reserve(end - first);
    for (std::size_t i = first; i < end; ++i) {
        const char* name = names + entries_[i].start;
        std::uint64_t key = 0;
        for (std::size_t place = common; place < common + keySize; ++place)
            key = key << 8 | (place < entries_[i].length ? static_cast<unsigned char>(name[place]) : 0U);
        keyed.push_back({key, entries_[i]});
    }
    const auto nameOf = [&](const Keyed& item) { return std::string_view(names + item.entry.start, item.entry.length); };
    std::sort(keyed.begin(), keyed.end(), [&](const Keyed& a, const Keyed& b) {
        return a.key != b.key ? a.key < b.key : nameOf(a).substr(common) < nameOf(b).substr(common);
    });
    for (std::size_t i = first; i < end; ++i) entries_[i] = keyed[i - first].entry;
}

frame::Status DiskListing::Stat(std::size_t index, frame::FileRecord& record) {
    if (!folder_.IsOpen())
        if (const int error = OpenFolder(path_, folder_)) return StatusOf(error);
    const Entry& entry = entries_[index];
    EntryFacts facts;
    const int error = maker_.facts.FollowOrItself(folder_.Number(), names_.data() + entry.start, facts);
    if (error == 0) record = maker_.RecordOf(Name(index), facts);
    return StatusOf(error);
}

frame::Status DiskListing::StatHiding(std::size_t index, std::int32_t& attributes) {
    attributes = RecordMaker::HidingOf(Name(index));
    return {};
}

frame::Status CountEntries(FactReader& facts, std::string_view path, frame::FolderCounts& counts) {
    Descriptor folder;
    if (const int error = OpenFolder(path, folder)) return StatusOf(error, errors::pathNotFound);
    FolderReader reader;
    reader.Start(folder.Number());
    counts = {};
    for (FolderReader::Entry entry; reader.Next(entry);) {
        bool isFolder = entry.kind == FolderReader::Kind::Folder;
        EntryFacts found;
        if (entry.kind == FolderReader::Kind::Link || entry.kind == FolderReader::Kind::Unknown)
            isFolder = facts.Follow(folder.Number(), entry.name, found) == 0 && found.IsFolder();
        ++(isFolder ? counts.folders : counts.files);
    }
    return StatusOf(reader.Error());
}

// Tree sizes.

namespace {

constexpr int walkFlags = O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC | O_NONBLOCK;

/// File systems whose files are no bytes on any disk: by the magic numbers of proc, sysfs, debugfs, tracefs, cgroup, cgroup2,
/// devpts, securityfs, selinuxfs, bpf, pstore, configfs, mqueue, binfmt_misc, efivarfs, nsfs and autofs.
bool IsPseudo(int folder) {
    static constexpr std::array<std::uint32_t, 17> numbers = {
        0x9fa0,     0x62656572, 0x64626720, 0x74726163, 0x27e0eb,   0x63677270, 0x1cd1,     0x73636673, 0xf97cff8c,
        0xcafe4a11, 0x6165676c, 0x62656570, 0x19800202, 0x42494e4d, 0xde5e81e4, 0x6e736673, 0x0187};
    struct statfs told {};
    return fstatfs(folder, &told) == 0 &&
           std::find(numbers.begin(), numbers.end(), static_cast<std::uint32_t>(told.f_type)) != numbers.end();
}

}  // namespace

DiskTreeSize::DiskTreeSize(FactReader facts, std::string_view path) : facts_(facts) {
    Descriptor top;
    EntryFacts entry;
    if (OpenFolder(path, top) != 0 || IsPseudo(top.Number()) || facts_.Open(top.Number(), entry) != 0) return;
    device_ = entry.device;
    Enter(std::move(top));
}

bool DiskTreeSize::Step(std::size_t entries) {
    for (std::size_t seen = 0; seen < entries && !levels_.empty(); ++seen) {
        FolderReader::Entry entry;
        if (reading_ && reader_.Next(entry)) {
            LookAt(entry);
        } else {
            reading_ = false;
            if (!GoOn()) return false;
        }
    }
    return !levels_.empty();
}

void DiskTreeSize::Enter(Descriptor folder) {
    constexpr std::size_t mostOpen = 32;
    EntryFacts entry;
    if (facts_.Open(folder.Number(), entry) != 0 || entry.device != device_) return;
    reader_.Start(folder.Number());
    reading_ = true;
    levels_.push_back({.folder = std::move(folder), .device = entry.device, .inode = entry.inode, .below = {}, .next = 0});
    if (levels_.size() > mostOpen) levels_[levels_.size() - mostOpen - 1].folder.Close();
}

void DiskTreeSize::LookAt(const FolderReader::Entry& entry) {
    Level& level = levels_.back();
    FolderReader::Kind kind = entry.kind;
    EntryFacts facts;
    if (kind == FolderReader::Kind::Link) return;
    if (kind != FolderReader::Kind::Folder) {
        if (facts_.Itself(level.folder.Number(), entry.name, facts) != 0) return;
        if (facts.IsFile()) bytes_ += facts.size;
        if (facts.IsFolder()) kind = FolderReader::Kind::Folder;
    }
    if (kind == FolderReader::Kind::Folder) level.below.append(entry.name, entry.length + 1);
}

/// Goes into the next sub-folder of the last level, or up where there is none. False at the end of the walk.
bool DiskTreeSize::GoOn() {
    Level& level = levels_.back();
    if (level.next >= level.below.size()) return GoUp();
    const char* name = level.below.data() + level.next;
    level.next += std::strlen(name) + 1;
    if (Descriptor folder(openat(level.folder.Number(), name, walkFlags)); folder.IsOpen()) Enter(std::move(folder));
    return true;
}

/// A folder that was closed is reached again from below; where it has been moved away meanwhile, it and what is above it end.
bool DiskTreeSize::GoUp() {
    const Level left = std::move(levels_.back());
    levels_.pop_back();
    if (levels_.empty()) return false;
    Level& level = levels_.back();
    if (level.folder.IsOpen()) return true;
    EntryFacts facts;
    level.folder = Descriptor(openat(left.folder.Number(), "..", walkFlags));
    const bool same = level.folder.IsOpen() && facts_.Open(level.folder.Number(), facts) == 0 && facts.device == level.device &&
                      facts.inode == level.inode;
    if (!same) levels_.clear();
    return same;
}

}  // namespace tessel::posix
