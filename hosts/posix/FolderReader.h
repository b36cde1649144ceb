#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

#include "hosts/posix/DiskPlace.h"

namespace tessel::posix {

/// Reads the names of a folder as the system hands them out.
class FolderReader {
  public:
    enum class Kind { Folder, File, Link, Unknown };
    struct Entry {
        const char* name = nullptr;  ///< ends with a NUL; valid until the next entry
        std::size_t length = 0;
        Kind kind = Kind::Unknown;
    };

    FolderReader();
    ~FolderReader();

    /// Starts with a folder that is open and at its beginning.
    void Start(int folder);
    /// False at the end, and where the folder has vanished or cannot be read on; `Error` tells which. "." and ".." do not come.
    bool Next(Entry& entry);
    int Error() const { return error_; }

  private:
    int folder_ = -1;
    int error_ = 0;
    std::size_t position_ = 0, end_ = 0;
    std::unique_ptr<char[]> buffer_;
};

}  // namespace tessel::posix
