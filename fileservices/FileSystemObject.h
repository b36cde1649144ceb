#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

#include "fileservices/DiskEntry.h"
#include "fileservices/Drive.h"
#include "frame/Object.h"
#include "frame/host.h"

namespace tessel::fileservices {

/// The file that `CreateTextFile` has made. Nothing is held open, so closing it changes nothing.
class TextStream final : public frame::Object {
  public:
    void Close() {}
    const frame::ClassTable& Table() const override;
};

/// The file system by name, as applications and the controls use it. It keeps nothing: two of one host are as good as one.
class FileSystemObject final : public frame::Object {
  public:
    explicit FileSystemObject(frame::Host& host) : host_(host) {}

    bool FileExists(const std::string& path) const { return Disk().FileExists(path); }
    /// True for the root of a drive that is ready.
    bool FolderExists(const std::string& path) const { return Disk().FolderExists(path); }
    /// True for the root of a drive ("C:\") alone, ready or not: ask it before `FolderExists` where the two must be told apart.
    bool DriveExists(const std::string& path) const { return Disk().DriveExists(path); }

    /// Error 53 when there is no such file.
    FileRef GetFile(const std::string& path) const;
    /// Error 76 when there is no such folder, 71 on a drive that is not ready. Separators at the end are dropped, but for a root.
    FolderRef GetFolder(const std::string& path) const;
    /// By root, path, letter or share; error 76 when there is no such drive.
    DriveRef GetDrive(const std::string& path) const { return Drives()->Item(path); }
    DrivesRef Drives() const { return std::make_shared<DriveCollection>(Disk()); }

    // See PathHelpers.h.
    std::string BuildPath(const std::string& parent, const std::string& name) const;
    std::string GetExtensionName(const std::string& path) const;
    std::string GetFileName(const std::string& path) const;
    std::string GetParentFolderName(const std::string& path) const;

    /// The temporary folder (2); error 5 for any other number.
    FolderRef GetSpecialFolder(std::int32_t number) const;
    /// A random name, "tmp01234567.tmp". Nothing is made, and nothing is looked up.
    std::string GetTempName() const;

    void CreateFolder(const std::string& path) const { Disk().CreateFolder(path).Check(); }
    /// Makes an empty file, with `unicode` one that holds a byte order mark. Error 58 when there is one, unless it is to be
    /// overwritten.
    std::shared_ptr<TextStream> CreateTextFile(const std::string& path, std::optional<bool> overwrite,
                                               std::optional<bool> unicode) const;
    /// Error 53 when there is no such file, 70 for a read-only one without `force`.
    void DeleteFile(const std::string& path, std::optional<bool> force) const;

    std::string Path() const override { return "FileSystem"; }
    const frame::ClassTable& Table() const override;

  private:
    frame::FileSystem& Disk() const { return host_.Files(); }

    frame::Host& host_;
};

}  // namespace tessel::fileservices
