#include "hosts/posix/DiskPlace.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <sys/sysmacros.h>
#include <unistd.h>

#include <cerrno>
#include <climits>

namespace tessel::posix {

namespace errors = frame::errors;

void Descriptor::Close() {
    if (IsOpen()) close(std::exchange(number_, -1));
}

DiskPlace::DiskPlace(std::string_view path) {
    constexpr std::size_t mostBytes = PATH_MAX - 1;
    if (path.find('\0') != std::string_view::npos) {
        error_ = EINVAL;
        return;
    }
    while (path.size() > mostBytes) {
        const std::size_t slash = path.rfind('/', mostBytes - 1);
        if (slash == std::string_view::npos) {
            error_ = ENAMETOOLONG;
            return;
        }
        const std::string start(path.substr(0, slash + 1));
        Descriptor next(openat(Folder(), start.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC));
        if (!next.IsOpen()) {
            error_ = errno;
            return;
        }
        folder_ = std::move(next);
        path.remove_prefix(slash + 1);
        while (path.starts_with('/')) path.remove_prefix(1);  // the rest is not to begin at the root again
        if (path.empty()) path = ".";
    }
    name_ = path;
}

int DiskPlace::Folder() const { return folder_.IsOpen() ? folder_.Number() : AT_FDCWD; }

SplitPath Split(std::string_view path) {
    while (path.size() > 1 && path.ends_with('/')) path.remove_suffix(1);
    const std::size_t slash = path.rfind('/');
    if (slash == std::string_view::npos) return {".", std::string(path)};
    std::string_view folder = path.substr(0, slash);
    while (folder.ends_with('/')) folder.remove_suffix(1);
    return {folder.empty() ? "/" : std::string(folder), std::string(path.substr(slash + 1))};
}

bool EntryFacts::IsFolder() const { return S_ISDIR(mode); }
bool EntryFacts::IsFile() const { return S_ISREG(mode); }
bool EntryFacts::IsLink() const { return S_ISLNK(mode); }

int FactReader::Read(int folder, const char* name, int flags, EntryFacts& facts) {
    if (statx_) {
        struct statx told {};
        if (statx(folder, name, flags, STATX_BASIC_STATS | STATX_BTIME, &told) == 0) {
            facts.mode = told.stx_mode;
            facts.owner = told.stx_uid;
            facts.group = told.stx_gid;
            facts.links = told.stx_nlink;
            facts.device = makedev(told.stx_dev_major, told.stx_dev_minor);
            facts.inode = told.stx_ino;
            facts.size = static_cast<std::int64_t>(told.stx_size);
            facts.modified = told.stx_mtime.tv_sec;
            facts.accessed = told.stx_atime.tv_sec;
            facts.created.reset();
            if ((told.stx_mask & STATX_BTIME) != 0) facts.created = told.stx_btime.tv_sec;
            return 0;
        }
        if (errno != ENOSYS) return errno;
        statx_ = false;
    }
    struct stat told {};
    if (fstatat(folder, name, &told, flags) != 0) return errno;
    facts = {.mode = told.st_mode,
             .owner = told.st_uid,
             .group = told.st_gid,
             .links = told.st_nlink,
             .device = told.st_dev,
             .inode = told.st_ino,
             .size = told.st_size,
             .modified = told.st_mtim.tv_sec,
             .accessed = told.st_atim.tv_sec,
             .created = {}};
    return 0;
}

int FactReader::Itself(int folder, const char* name, EntryFacts& facts) { return Read(folder, name, AT_SYMLINK_NOFOLLOW, facts); }

int FactReader::FollowOrItself(int folder, const char* name, EntryFacts& facts) {
    const int error = Follow(folder, name, facts);
    return error == 0 ? 0 : Itself(folder, name, facts);
}

int FactReader::Open(int file, EntryFacts& facts) { return Read(file, "", AT_EMPTY_PATH, facts); }

int OpenFolder(std::string_view path, Descriptor& folder) {
    const DiskPlace place(path);
    if (place.Error() != 0) return place.Error();
    folder = Descriptor(openat(place.Folder(), place.Name(), O_RDONLY | O_DIRECTORY | O_CLOEXEC | O_NONBLOCK));
    return folder.IsOpen() ? 0 : errno;
}

frame::Status StatusOf(int systemError, int missing) {
    switch (systemError) {
        case 0:
            return {};
        case ENOENT:
            return missing;
        case ENOTDIR:
        case ELOOP:
            return errors::pathNotFound;
        case EEXIST:
        case ENOTEMPTY:
            return errors::fileExists;
        case EACCES:
        case EPERM:
        case EROFS:
        case EBUSY:
        case ETXTBSY:
            return errors::permissionDenied;
        case EINVAL:
        case EILSEQ:
        case ENAMETOOLONG:
            return errors::badFileName;
        case ENOSPC:
        case EDQUOT:
        case EFBIG:
            return errors::diskFull;
        case EIO:
        case ESTALE:
            return errors::deviceError;
        case ENODEV:
        case ENXIO:
        case ENOTCONN:
        case ETIMEDOUT:
        case EHOSTDOWN:
            return errors::diskNotReady;
        case ENOMEM:
            return errors::outOfMemory;
        default:
            return errors::pathAccess;
    }
}

}  // namespace tessel::posix
