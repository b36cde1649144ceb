#pragma once

#include <cstdint>
#include <memory>
#include <string>

#include "frame/FileSystem.h"
#include "frame/Object.h"
#include "frame/Variant.h"
#include "frame/host.h"

namespace tessel::fileservices {

class File;
class Folder;
template <class T>
class EntryCollection;
using FileRef = std::shared_ptr<File>;
using FolderRef = std::shared_ptr<Folder>;
using FilesRef = std::shared_ptr<EntryCollection<File>>;
using FoldersRef = std::shared_ptr<EntryCollection<Folder>>;

/// What files and folders have in common. An object stands for a path: what it tells it reads from the disk at each call, and that
/// fails with the disk's error (53, 76, 71) once the entry has gone. No object may outlive its host.
class DiskEntry : public frame::Object {
  public:
    /// The last name of the path; empty at the root of a drive. Setting it renames, and the object goes with its entry; error 58
    /// when the name is taken.
    std::string Name() const;
    void SetName(const std::string& value);
    const std::string& FullPath() const { return path_; }
    /// The system's description of the type.
    std::string Type() const;
    /// Bits of `frame::attributes`. Setting changes those that differ; error 5 for one that the disk cannot keep.
    std::int32_t Attributes() const { return Record().attributes; }
    void SetAttributes(std::int32_t value);
    // Local time.
    frame::Date DateCreated() const { return LocalTime(Record().created); }
    frame::Date DateLastModified() const { return LocalTime(Record().modified); }
    frame::Date DateLastAccessed() const { return LocalTime(Record().accessed); }
    /// Null at the root of a drive.
    FolderRef ParentFolder() const;
    /// The size in bytes, as a number of whatever type holds it.
    frame::Variant Size() const { return frame::Variant::FromCount(Bytes()); }
    virtual std::int64_t Bytes() const = 0;
    /// All that the disk tells of the entry, at one go.
    virtual frame::FileRecord Record() const = 0;

    bool EqualsObject(const Object& other) const override;

  protected:
    DiskEntry(frame::Host& host, std::string path) : host_(host), path_(std::move(path)) {}

    frame::Host& Host() const { return host_; }
    frame::FileSystem& Disk() const { return host_.Files(); }

  private:
    frame::Date LocalTime(std::int64_t seconds) const { return host_.Locale().LocalTime(seconds); }

    frame::Host& host_;
    std::string path_;
};

class File final : public DiskEntry {
  public:
    File(frame::Host& host, std::string path) : DiskEntry(host, std::move(path)) {}

    std::int64_t Bytes() const override { return Record().size; }
    /// Error 53 when no file stands there.
    frame::FileRecord Record() const override;
    const frame::ClassTable& Table() const override;
};

class Folder final : public DiskEntry {
  public:
    Folder(frame::Host& host, std::string path) : DiskEntry(host, std::move(path)) {}

    /// The sum over the whole tree: takes its time.
    std::int64_t Bytes() const override;
    /// Error 76 when no folder stands there.
    frame::FileRecord Record() const override;
    FilesRef Files() const;
    FoldersRef SubFolders() const;
    const frame::ClassTable& Table() const override;
};

/// The files or the folders in a folder, in name order. They are listed when the first is asked for, and stay so: a file that goes
/// meanwhile keeps its number. Error 76 when the folder is missing, 70 when it may not be read.
template <class T>
class EntryCollection final : public frame::Object {
  public:
    EntryCollection(frame::Host& host, std::string folder) : host_(host), folder_(std::move(folder)) {}

    std::int32_t Count() const;
    /// By number, from 1 (error 9 outside), or by name (error 53 or 76 when there is none).
    std::shared_ptr<T> Item(const frame::Variant& key) const;
    std::shared_ptr<T> At(std::int32_t number) const;

    const frame::ClassTable& Table() const override;

  private:
    const frame::FolderListing& Listing() const;

    frame::Host& host_;
    std::string folder_;
    mutable std::unique_ptr<frame::FolderListing> listing_;
};

extern template class EntryCollection<File>;
extern template class EntryCollection<Folder>;

}  // namespace tessel::fileservices
