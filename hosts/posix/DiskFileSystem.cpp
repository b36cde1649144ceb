#include "hosts/posix/DiskFileSystem.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <sys/statvfs.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstdio>

#include "hosts/posix/SafeWrite.h"

namespace tessel::posix {

namespace attributes = frame::attributes;
namespace errors = frame::errors;
using frame::Status;

namespace {

constexpr mode_t everyonesWrite = S_IWUSR | S_IWGRP | S_IWOTH;

bool AsksWell(const std::string& point) {
    struct statvfs told {};
    struct stat facts {};
    return statvfs(point.c_str(), &told) == 0 && stat(point.c_str(), &facts) == 0 && S_ISDIR(facts.st_mode);
}

bool IsGoodName(std::string_view name) {
    constexpr std::size_t longest = 255;
    return !name.empty() && name.size() <= longest && name != "." && name != ".." &&
           name.find_first_of(std::string_view("/\0", 2)) == std::string_view::npos;
}

/// The folder and the name of something that is to change.
struct ChangePlace {
    Descriptor folder;
    std::string name;

    Status Open(std::string_view path) {
        if (path.empty() || path.find('\0') != std::string_view::npos) return errors::badFileName;
        SplitPath split = Split(path);
        if (split.name.empty()) return errors::permissionDenied;  // the root
        name = std::move(split.name);
        const DiskPlace place(split.folder);
        if (place.Error() != 0) return StatusOf(place.Error(), errors::pathNotFound);
        folder = Descriptor(openat(place.Folder(), place.Name(), O_PATH | O_DIRECTORY | O_CLOEXEC));
        return folder.IsOpen() ? Status() : StatusOf(errno, errors::pathNotFound);
    }
};

class DiskFile final : public frame::BinaryFile {
  public:
    DiskFile(Descriptor file, std::int64_t size) : file_(std::move(file)), size_(size) {}
    Status Read(std::int64_t position, char* bytes, std::size_t size, std::size_t& read) override {
        read = 0;
        if (position < 0) return errors::invalidCall;
        while (read < size) {
            const ssize_t got = pread(file_.Number(), bytes + read, size - read, position + static_cast<std::int64_t>(read));
            if (got < 0 && errno == EINTR) continue;
            if (got < 0) return StatusOf(errno);
            if (got == 0) break;
            read += static_cast<std::size_t>(got);
        }
        return {};
    }
    std::int64_t Size() const override { return size_; }

  private:
    Descriptor file_;
    std::int64_t size_;
};

}  // namespace

namespace {

DiskSettings Completed(DiskSettings settings) {
    if (!settings.mountTable) settings.mountTable = [] { return SmallFile("/proc/self/mountinfo"); };
    if (!settings.askMount) settings.askMount = AsksWell;
    return settings;
}

std::vector<std::string> MimeFolders(const DiskSettings& settings) {
    std::vector<std::string> folders;
    if (!settings.dataHome.empty()) folders.push_back(settings.dataHome);
    folders.insert(folders.end(), settings.dataFolders.begin(), settings.dataFolders.end());
    return folders;
}

}  // namespace

DiskFileSystem::DiskFileSystem(DiskSettings settings)
    : settings_(Completed(std::move(settings))),
      maker_{FactReader(settings_.useStatx), settings_.user, TypeTexts(MimeFolders(settings_), settings_.languages)},
      probe_(settings_.askMount, settings_.mountWait) {}

// Looking.

int DiskFileSystem::FactsOf(std::string_view path, EntryFacts& facts) {
    const DiskPlace place(path);
    if (place.Error() != 0) return place.Error();
    return maker_.facts.FollowOrItself(place.Folder(), place.Name(), facts);
}

bool DiskFileSystem::FileExists(std::string_view path) {
    EntryFacts facts;
    return FactsOf(path, facts) == 0 && !facts.IsFolder();
}

bool DiskFileSystem::FolderExists(std::string_view path) {
    EntryFacts facts;
    return FactsOf(path, facts) == 0 && facts.IsFolder();
}

bool DiskFileSystem::DriveExists(std::string_view path) {
    if (!path.ends_with('/')) return false;  // without a look at the table, which is asked for every folder of a listing
    const auto mounts = Mounts();
    return std::any_of(mounts.begin(), mounts.end(), [&](const Mount& mount) { return mount.DriveRoot() == path; });
}

Status DiskFileSystem::Stat(std::string_view path, frame::FileRecord& record) {
    EntryFacts facts;
    if (const int error = FactsOf(path, facts)) {
        if (error != ENOENT) return error == EINVAL ? Status(errors::fileNotFound) : StatusOf(error);
        return FolderExists(Split(path).folder) ? errors::fileNotFound : errors::pathNotFound;
    }
    record = maker_.RecordOf(Split(path).name, facts);
    return {};
}

Status DiskFileSystem::List(std::string_view folder, std::unique_ptr<frame::FolderListing>& listing) {
    auto opened = std::make_unique<DiskListing>(maker_);
    const Status status = opened->Open(folder);
    if (!status.Failed()) listing = std::move(opened);
    return status;
}

Status DiskFileSystem::Count(std::string_view folder, frame::FolderCounts& counts) {
    return CountEntries(maker_.facts, folder, counts);
}

std::unique_ptr<frame::TreeSize> DiskFileSystem::MeasureTree(std::string_view folder) {
    return std::make_unique<DiskTreeSize>(maker_.facts, folder);
}

std::vector<Mount> DiskFileSystem::Mounts() { return UserMounts(ParseMountInfo(settings_.mountTable())); }

std::vector<frame::DriveRecord> DiskFileSystem::Drives() {
    const auto label = [this](const Mount& mount) { return LabelOf(mount, settings_.labelFolder); };
    return DrivesOf(Mounts(), probe_, label, settings_.deviceFolder);
}

// Changing.

Status DiskFileSystem::CreateFolder(std::string_view path) {
    constexpr mode_t everyone = 0777;  // less what the user's mask takes away
    ChangePlace place;
    if (const Status status = place.Open(path); status.Failed()) return path == "/" ? Status(errors::fileExists) : status;
    return mkdirat(place.folder.Number(), place.name.c_str(), everyone) == 0 ? Status() : StatusOf(errno);
}

Status DiskFileSystem::CreateFile(std::string_view path, bool overwrite) {
    constexpr mode_t everyone = 0666;
    ChangePlace place;
    if (const Status status = place.Open(path); status.Failed()) return status;
    const int flags = O_WRONLY | O_CREAT | O_CLOEXEC | O_NONBLOCK | O_NOCTTY | (overwrite ? O_TRUNC : O_EXCL);
    const Descriptor file(openat(place.folder.Number(), place.name.c_str(), flags, everyone));
    if (file.IsOpen()) return {};
    const int error = errno;
    EntryFacts facts;
    const bool stands = maker_.facts.Follow(place.folder.Number(), place.name.c_str(), facts) == 0;
    return stands && facts.IsFolder() ? Status(errors::permissionDenied) : StatusOf(error);
}

Status DiskFileSystem::DeleteFile(std::string_view path, bool force) {
    ChangePlace place;
    if (const Status status = place.Open(path); status.Failed()) return status;
    EntryFacts facts;
    if (const int error = maker_.facts.Itself(place.folder.Number(), place.name.c_str(), facts)) return StatusOf(error);
    if (facts.IsFolder() || path.ends_with('/')) return errors::fileNotFound;
    if (!force && !facts.IsLink() && !settings_.user.MayWrite(facts.mode, facts.owner, facts.group))
        return errors::permissionDenied;
    return unlinkat(place.folder.Number(), place.name.c_str(), 0) == 0 ? Status() : StatusOf(errno);
}

namespace {

/// Renames without replacing anything.
int RenameInFolder(int folder, const char* from, const char* to) {
    if (renameat2(folder, from, folder, to, RENAME_NOREPLACE) == 0) return 0;
    if (errno != EINVAL && errno != ENOSYS) return errno;
    // A file system that cannot promise it: looking first comes as near as it goes.
    struct stat facts {};
    if (fstatat(folder, to, &facts, AT_SYMLINK_NOFOLLOW) == 0) return EEXIST;
    return renameat(folder, from, folder, to) == 0 ? 0 : errno;
}

}  // namespace

Status DiskFileSystem::Rename(std::string_view path, std::string_view newName) {
    ChangePlace place;
    if (const Status status = place.Open(path); status.Failed()) return status;
    EntryFacts facts;
    if (const int error = maker_.facts.Itself(place.folder.Number(), place.name.c_str(), facts)) return StatusOf(error);
    if (!IsGoodName(newName)) return errors::badFileName;
    if (newName == place.name) return {};
    return StatusOf(RenameInFolder(place.folder.Number(), place.name.c_str(), std::string(newName).c_str()));
}

Status DiskFileSystem::SetAttributes(std::string_view path, std::int32_t value) {
    EntryFacts facts;
    const DiskPlace place(path);
    if (place.Error() != 0) return StatusOf(place.Error());
    if (const int error = maker_.facts.Follow(place.Folder(), place.Name(), facts)) return StatusOf(error);
    const std::int32_t present = maker_.RecordOf(Split(path).name, facts).attributes;
    const std::int32_t differing = (present ^ value) & ~attributes::directory;
    if ((differing & ~attributes::readOnly) != 0) return errors::invalidCall;
    if (differing == 0) return {};
    const mode_t mode = (value & attributes::readOnly) != 0 ? facts.mode & ~everyonesWrite : facts.mode | S_IWUSR;
    constexpr mode_t permissions = 07777;
    if (fchmodat(place.Folder(), place.Name(), mode & permissions, 0) != 0) return StatusOf(errno);
    return {};
}

// Special folders.

std::string DiskFileSystem::SpecialFolder(int number) {
    enum : int {
        desktop = 0,
        programs = 2,
        personal = 5,
        startup = 7,
        bitBucket = 10,
        desktopDirectory = 16,
        fonts = 20,
        templates = 21
    };
    if (const auto given = special_.find(number); given != special_.end()) return given->second;
    const auto userFolder = [&](const char* name, const char* usual) {
        const auto folders = ParseUserFolders(SmallFile(settings_.configHome + "/user-dirs.dirs"), settings_.home);
        if (const auto found = folders.find(name); found != folders.end()) return found->second;
        const std::string path = settings_.home + "/" + usual;
        return FolderExists(path) ? path : settings_.home;
    };
    switch (number) {
        case desktop:
        case desktopDirectory:
            return userFolder("DESKTOP", "Desktop");
        case personal:
            return userFolder("DOCUMENTS", "Documents");
        case templates:
            return userFolder("TEMPLATES", "Templates");
        case programs:
            return settings_.dataHome + "/applications";
        case fonts:
            return settings_.dataHome + "/fonts";
        case bitBucket:
            return settings_.dataHome + "/Trash/files";
        case startup:
            return settings_.configHome + "/autostart";
        default:
            return {};
    }
}

// Contents.

Status DiskFileSystem::OpenForReading(std::string_view path, std::unique_ptr<frame::BinaryFile>& file) {
    const DiskPlace place(path);
    if (place.Error() != 0) return StatusOf(place.Error());
    EntryFacts facts;
    if (const int error = maker_.facts.Follow(place.Folder(), place.Name(), facts)) {
        if (error != ENOENT) return StatusOf(error);
        return FolderExists(Split(path).folder) ? errors::fileNotFound : errors::pathNotFound;
    }
    if (!facts.IsFile()) return errors::pathAccess;  // before it is opened: opening a device or a pipe can have effects
    Descriptor opened(openat(place.Folder(), place.Name(), O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY));
    if (!opened.IsOpen()) return StatusOf(errno);
    if (const int error = maker_.facts.Open(opened.Number(), facts)) return StatusOf(error);
    file = std::make_unique<DiskFile>(std::move(opened), facts.size);
    return {};
}

Status DiskFileSystem::WriteOver(std::string_view path, std::string_view bytes) {
    return WriteOverFile(path, bytes, settings_.temporaryFolder);
}

}  // namespace tessel::posix
