#pragma once

#include <string>

#include "fileservices/DiskEntry.h"
#include "fileservices/Drive.h"
#include "fileservices/FileSystemObject.h"
#include "frame/Object.h"
#include "frame/Variant.h"
#include "frame/host.h"

namespace tessel::fileservices {

/// Names as users see them, and the boxes that the two file controls share. One for each host: `host.Module<CommonFile>()`.
class CommonFile final : public frame::Object {
  public:
    explicit CommonFile(frame::Host& host) : host_(host), files_(host) {}

    /// The folder's name; at the root of a drive the drive's display name, "Unknown drive or folder" when the drive has gone.
    std::string FolderDisplayName(const FolderRef& folder) const;
    /// "Local Disk (C:)", "Work (D:)", "docs on 'server' (N:)", "(A:)" for a drive that is not ready; empty for such a one without
    /// letter. Without a letter a name ends in a blank.
    std::string DriveDisplayName(const DriveRef& drive) const;
    /// "name on 'server' ", with the blank, of "\\server\name"; error 9 for a text of another form.
    std::string ShareDisplayName(const std::string& share) const;
    /// The path of a folder that does not exist yet: "New Folder", "New Folder (1)" without a name, "a", "Copy (1) of a" with one.
    std::string UniqueFolderPath(const frame::Variant& parent, const std::string& name) const;
    /// The paths of a drag object, whatever its class, parted by commas.
    void DataObjectFileList(const frame::ObjectRef& data, std::string& list) const;

    // Each gives the number of the button pressed.
    int ConfirmExtensionChange() const;
    int ShowFolderNotAccessible(const std::string& path) const;
    int ShowBadNameCharacters() const;

    std::string Path() const override { return "CommonFile"; }
    const frame::ClassTable& Table() const override;

  private:
    frame::Host& host_;
    FileSystemObject files_;
};

}  // namespace tessel::fileservices
