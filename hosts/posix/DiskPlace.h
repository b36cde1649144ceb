#pragma once

#include <sys/types.h>

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

#include "frame/Error.h"

/// The calls of the system that the real disk is made of. Failures are the system's error numbers, 0 for success.
namespace tessel::posix {

/// Owns an open file of the system.
class Descriptor {
  public:
    explicit Descriptor(int number = -1) : number_(number) {}
    Descriptor(Descriptor&& other) noexcept : number_(std::exchange(other.number_, -1)) {}
    Descriptor& operator=(Descriptor&& other) noexcept {
        std::swap(number_, other.number_);
        return *this;
    }
    ~Descriptor() { Close(); }

    int Number() const { return number_; }
    bool IsOpen() const { return number_ >= 0; }
    void Close();

  private:
    int number_;
};

/// What a call of the ...at family needs to reach a path of any length: a folder, and a name below it that the system takes.
class DiskPlace {
  public:
    /// `Error` tells when the way there fails: a NUL in the path, a folder missing on a way too long for one call.
    explicit DiskPlace(std::string_view path);

    int Error() const { return error_; }
    int Folder() const;
    const char* Name() const { return name_.c_str(); }

  private:
    int error_ = 0;
    Descriptor folder_;
    std::string name_;
};

/// The folder of a path and the last name in it.
struct SplitPath {
    std::string folder;  ///< "." when the path is one name
    std::string name;    ///< empty for the root
};
SplitPath Split(std::string_view path);

/// What the system tells about an entry. Times are whole seconds.
struct EntryFacts {
    mode_t mode = 0;
    uid_t owner = 0;
    gid_t group = 0;
    std::uint64_t links = 0, device = 0, inode = 0;
    std::int64_t size = 0, modified = 0, accessed = 0;
    std::optional<std::int64_t> created;

    bool IsFolder() const;
    bool IsFile() const;  ///< a regular one
    bool IsLink() const;
};

/// Reads the facts of entries, by statx where the system has it.
class FactReader {
  public:
    explicit FactReader(bool useStatx = true) : statx_(useStatx) {}

    /// Of a link: what it leads to.
    int Follow(int folder, const char* name, EntryFacts& facts) { return Read(folder, name, 0, facts); }
    /// Of a link: itself.
    int Itself(int folder, const char* name, EntryFacts& facts);
    /// Of a link what it leads to, and itself when it leads nowhere.
    int FollowOrItself(int folder, const char* name, EntryFacts& facts);
    /// Of an open file.
    int Open(int file, EntryFacts& facts);

  private:
    int Read(int folder, const char* name, int flags, EntryFacts& facts);

    bool statx_;
};

/// Opens for reading, never as a terminal and never waiting for another program.
int OpenFolder(std::string_view path, Descriptor& folder);

/// The library's number for a failure; `missing` for an entry that is not there.
frame::Status StatusOf(int systemError, int missing = frame::errors::fileNotFound);

}  // namespace tessel::posix
