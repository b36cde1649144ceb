#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "frame/Error.h"
#include "frame/Variant.h"

namespace tessel::frame {

/// Attribute bits of a file or folder.
namespace attributes {
inline constexpr int readOnly = 1, hidden = 2, system = 4, directory = 16, archive = 32;
}

/// What a listing captures of one entry; texts are made from it when they are read.
struct FileRecord {
    std::string name;  ///< empty for a drive root
    bool isFolder = false;
    std::int32_t attributes = 0;
    std::int64_t size = 0;                                 ///< bytes; of a folder 0
    std::int64_t created = 0, modified = 0, accessed = 0;  ///< seconds since 1970-01-01 in Coordinated Universal Time
    std::int32_t typeId = 0;                               ///< names the type text, `FileSystem::TypeText`
};

struct DriveRecord {
    std::string path;    ///< as `Drive.Path` gives it
    std::string root;    ///< the spelling that `DriveExists` knows
    std::string letter;  ///< empty where drives have none
    int type = 0;        ///< 1 removable, 2 fixed, 3 network, 4 compact disk, 5 RAM disk
    std::string shareName, volumeName;
    bool isReady = true;
};

/// A file opened for binary reading. Positions and sizes are in bytes; a failed read is a `Status`.
class BinaryFile {
  public:
    virtual ~BinaryFile() = default;
    /// Reads up to `size` bytes at `position`; `read` tells how many there were.
    virtual Status Read(std::int64_t position, char* bytes, std::size_t size, std::size_t& read) = 0;
    virtual std::int64_t Size() const = 0;
};

/// The file system as the library sees it. Paths are UTF-8 in the system's own separator; every call works on the disk as it is
/// now and keeps nothing.
class FileSystem {
  public:
    virtual ~FileSystem() = default;

    virtual char Separator() const = 0;
    /// Whether names compare without regard to case.
    virtual bool IgnoresCase() const = 0;

    virtual bool FileExists(std::string_view path) = 0;
    virtual bool FolderExists(std::string_view path) = 0;
    virtual bool DriveExists(std::string_view path) = 0;
    /// 53, 76 or 70 when the entry is absent or cannot be read.
    virtual Status Stat(std::string_view path, FileRecord& record) = 0;
    /// Calls `each` for the entries of a folder in name order, folders first, until it gives false.
    virtual Status List(std::string_view folder, const std::function<bool(const FileRecord&)>& each) = 0;
    virtual std::vector<DriveRecord> Drives() = 0;
    virtual std::string TypeText(std::int32_t typeId) = 0;

    virtual Status CreateFolder(std::string_view path) = 0;
    virtual Status Rename(std::string_view path, std::string_view newName) = 0;
    virtual Status Delete(std::string_view path) = 0;
    virtual Status SetAttributes(std::string_view path, std::int32_t value) = 0;
    virtual std::string TemporaryFolder() = 0;
    /// The path of a special folder by its number; empty when there is none.
    virtual std::string SpecialFolder(int number) = 0;

    virtual Status OpenForReading(std::string_view path, std::unique_ptr<BinaryFile>& file) = 0;
    /// Puts `bytes` at the start of the file, which keeps what stood behind them. The file is afterwards the old one or the
    /// new one, never something between.
    virtual Status WriteOver(std::string_view path, std::string_view bytes) = 0;
};

}  // namespace tessel::frame
