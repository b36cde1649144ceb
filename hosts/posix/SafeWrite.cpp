#include "hosts/posix/SafeWrite.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <sys/xattr.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdint>
#include <cstdio>
#include <optional>
#include <random>

#include "hosts/posix/DiskPlace.h"

namespace tessel::posix {
namespace {

namespace errors = frame::errors;
constexpr mode_t permissions = 07777;

int WriteAll(int file, std::string_view bytes, off_t position) {
    while (!bytes.empty()) {
        const ssize_t written = pwrite(file, bytes.data(), bytes.size(), position);
        if (written < 0 && errno == EINTR) continue;
        if (written < 0) return errno;
        bytes.remove_prefix(static_cast<std::size_t>(written));
        position += written;
    }
    return 0;
}

/// Copies from `position` to the end.
int CopyRest(int from, int to, off_t position) {
    std::array<char, 1 << 16> block{};
    while (true) {
        const ssize_t got = pread(from, block.data(), block.size(), position);
        if (got < 0 && errno == EINTR) continue;
        if (got < 0) return errno;
        if (got == 0) return 0;
        if (const int error = WriteAll(to, {block.data(), static_cast<std::size_t>(got)}, position)) return error;
        position += got;
    }
}

int Sync(int file) { return fsync(file) == 0 ? 0 : errno; }

/// Whether a file has attributes that a new one would not have by itself; the label of a security policy it gets like any other.
bool HasOwnAttributes(int file) {
    std::array<char, 1 << 12> names{};
    const ssize_t length = flistxattr(file, names.data(), names.size());
    if (length < 0) return errno == ERANGE;
    std::string_view rest(names.data(), static_cast<std::size_t>(length));
    while (!rest.empty()) {
        const std::size_t end = std::min(rest.find('\0'), rest.size() - 1);
        if (rest.substr(0, end) != "security.selinux") return true;
        rest.remove_prefix(end + 1);
    }
    return false;
}

/// A new file with a name that nothing else has. It goes when nobody keeps it.
class NewFile {
  public:
    NewFile(int folder, const std::string& start, const char* ending, mode_t mode) : folder_(folder) {
        constexpr std::size_t longestStart = 200;
        constexpr int tries = 100;
        std::random_device random;
        for (int i = 0; i < tries && error_ == EEXIST; ++i) {
            std::array<char, 16> number{};
            std::snprintf(number.data(), number.size(), ".%08x", static_cast<unsigned>(random()));
            name_ = start.substr(0, longestStart) + number.data() + ending;
            file_ = Descriptor(openat(folder_, name_.c_str(), O_RDWR | O_CREAT | O_EXCL | O_NOFOLLOW | O_CLOEXEC, mode));
            error_ = file_.IsOpen() ? 0 : errno;
        }
        made_ = error_ == 0;
    }
    NewFile(const NewFile&) = delete;
    NewFile& operator=(const NewFile&) = delete;
    ~NewFile() {
        if (made_) unlinkat(folder_, name_.c_str(), 0);
    }

    int Error() const { return error_; }
    int Number() const { return file_.Number(); }
    /// Gives it the name of a file in its folder, which it replaces.
    int TakeName(const std::string& name) {
        if (renameat(folder_, name_.c_str(), folder_, name.c_str()) != 0) return errno;
        made_ = false;
        return 0;
    }
    void Keep() { made_ = false; }

  private:
    int folder_;
    std::string name_;
    Descriptor file_;
    int error_ = EEXIST;
    bool made_ = false;
};

struct Target {
    Descriptor folder;
    std::string name;
    bool exists = false;
    EntryFacts facts;
};

/// Follows the links at the end of a path to the file that is meant.
int FindTarget(std::string path, Target& target) {
    constexpr int mostLinks = 40;
    FactReader reader;
    for (int i = 0; i < mostLinks; ++i) {
        const SplitPath split = Split(path);
        if (split.name.empty()) return EISDIR;
        if (const int error = OpenFolder(split.folder, target.folder)) return error == ENOENT ? ENOTDIR : error;
        target.name = split.name;
        const int error = reader.Itself(target.folder.Number(), target.name.c_str(), target.facts);
        target.exists = error == 0;
        if (error == ENOENT) return 0;
        if (error != 0) return error;
        if (!target.facts.IsLink()) return 0;
        std::array<char, 4096> led{};
        const ssize_t length = readlinkat(target.folder.Number(), target.name.c_str(), led.data(), led.size());
        if (length <= 0) return length == 0 ? ENOENT : errno;
        const std::string_view next(led.data(), static_cast<std::size_t>(length));
        path = next.starts_with('/') ? std::string(next) : split.folder + "/" + std::string(next);
    }
    return ELOOP;
}

int MakeNew(const Target& target, std::string_view bytes) {
    constexpr mode_t everyone = 0666;  // less what the user's mask takes away
    NewFile fresh(target.folder.Number(), "." + target.name, ".new", everyone);
    if (fresh.Error() != 0) return fresh.Error();
    if (const int error = WriteAll(fresh.Number(), bytes, 0)) return error;
    if (const int error = Sync(fresh.Number())) return error;
    if (const int error = fresh.TakeName(target.name)) return error;
    Sync(target.folder.Number());
    return 0;
}

/// Nothing where the file would not be the same one afterwards.
std::optional<int> Replace(const Target& target, int old, std::string_view bytes) {
    if (target.facts.links > 1 || HasOwnAttributes(old)) return {};
    NewFile fresh(target.folder.Number(), "." + target.name, ".new", S_IRUSR | S_IWUSR);
    if (fresh.Error() == ENOSPC || fresh.Error() == EDQUOT) return fresh.Error();
    if (fresh.Error() != 0) return {};
    if (fchown(fresh.Number(), target.facts.owner, target.facts.group) != 0) return {};
    if (fchmod(fresh.Number(), target.facts.mode & permissions) != 0) return {};
    EntryFacts made;
    FactReader reader;
    const mode_t wanted = target.facts.mode & permissions;
    if (reader.Open(fresh.Number(), made) != 0 || (made.mode & permissions) != wanted) return {};
    if (made.owner != target.facts.owner || made.group != target.facts.group) return {};
    if (const int error = WriteAll(fresh.Number(), bytes, 0)) return error;
    if (const int error = CopyRest(old, fresh.Number(), static_cast<off_t>(bytes.size()))) return error;
    // Writing may have taken the set-user bits away again.
    if (fchmod(fresh.Number(), wanted) != 0) return errno;
    if (const int error = Sync(fresh.Number())) return error;
    if (const int error = fresh.TakeName(target.name)) return error;
    Sync(target.folder.Number());
    return 0;
}

/// Writes where the file stands; `copy` holds what it was.
int WriteBehind(int file, NewFile& copy, std::int64_t size, std::string_view bytes) {
    if (const int error = CopyRest(file, copy.Number(), 0)) return error;
    if (const int error = Sync(copy.Number())) return error;
    const auto wanted = static_cast<std::int64_t>(bytes.size());
    int error = 0;
    if (wanted > size) {
        error = posix_fallocate(file, size, wanted - size);
        if (error == EOPNOTSUPP || error == EINVAL) error = 0;
    }
    if (error == 0) error = WriteAll(file, bytes, 0);
    if (error == 0) error = Sync(file);
    if (error == 0) return 0;
    const bool restored = ftruncate(file, size) == 0 && CopyRest(copy.Number(), file, 0) == 0 && Sync(file) == 0;
    if (!restored) copy.Keep();
    return error;
}

int WriteInPlace(const Target& target, int file, std::string_view bytes, const std::string& otherFolder) {
    NewFile beside(target.folder.Number(), target.name, ".saved", S_IRUSR | S_IWUSR);
    if (beside.Error() == 0) return WriteBehind(file, beside, target.facts.size, bytes);
    Descriptor folder;
    if (const int error = OpenFolder(otherFolder, folder)) return error;
    NewFile away(folder.Number(), target.name, ".saved", S_IRUSR | S_IWUSR);
    return away.Error() != 0 ? away.Error() : WriteBehind(file, away, target.facts.size, bytes);
}

}  // namespace

frame::Status WriteOverFile(std::string_view path, std::string_view bytes, const std::string& otherFolder) {
    if (path.empty() || path.find('\0') != std::string_view::npos) return errors::badFileName;
    Target target;
    if (const int error = FindTarget(std::string(path), target)) return StatusOf(error, errors::pathNotFound);
    if (!target.exists) return StatusOf(MakeNew(target, bytes));
    if (!target.facts.IsFile()) return errors::pathAccess;
    const Descriptor file(openat(target.folder.Number(), target.name.c_str(), O_RDWR | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC));
    if (!file.IsOpen()) return StatusOf(errno);
    FactReader reader;
    if (const int error = reader.Open(file.Number(), target.facts)) return StatusOf(error);
    if (const auto replaced = Replace(target, file.Number(), bytes)) return StatusOf(*replaced);
    return StatusOf(WriteInPlace(target, file.Number(), bytes, otherFolder));
}

}  // namespace tessel::posix
