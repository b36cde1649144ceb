#pragma once

#include <optional>
#include <string>

#include "fileservices/FileSystemObject.h"
#include "frame/Color.h"
#include "frame/Object.h"
#include "frame/Surface.h"
#include "frame/child/PictureBox.h"
#include "frame/host.h"

namespace tessel::fileservices {

enum class IconSize { Small, Large };  ///< 16 or 32 pixels a side
enum class IconForm { Closed, Open };  ///< of a folder

/// The icons that the system shows for files, folders and drives, and the keys under which they are kept. One for each host:
/// `host.Module<FileIcon>()`.
class FileIcon final : public frame::Object {
  public:
    explicit FileIcon(frame::Host& host) : host_(host), files_(host) {}

    /// The key of an icon, one for each kind of thing: a file's extension, which may be empty, a drive's type word, a folder's
    /// type. Nothing for a path that does not exist.
    std::optional<std::string> IconKey(const std::string& path) const;

    /// Draws the icon of a path onto a picture box, which takes the icon's size, and keeps it there as the box's picture. `key`
    /// becomes the icon's key. False when the path does not exist, and then `key` is empty, or when the system has no icon for it.
    bool GetFileIcon(const std::string& path, IconSize size, child::PictureBox& picture, std::string& key, IconForm form) const;

    /// Pales what a surface shows: the colour of each pixel halves its distance to white; pixels of the mask colour stay.
    static void WashOutPicture(frame::DrawingSurface& picture, frame::OLE_COLOR maskColor);
    /// The same for a picture, at all its scales; what is clear stays so.
    static frame::PictureRef WashedOut(const frame::PictureRef& picture, frame::OLE_COLOR maskColor);

    std::string Path() const override { return "FileIcon"; }
    const frame::ClassTable& Table() const override;

  private:
    // What late-bound callers reach. Error 13 for an object that is no picture box, or cannot be drawn on.
    bool GetByReference(std::string& path, bool& large, const frame::ObjectRef& picture, std::string& key, bool& open) const;
    void WashOutObject(const frame::ObjectRef& picture, frame::OLE_COLOR maskColor) const;

    frame::Host& host_;
    FileSystemObject files_;
};

}  // namespace tessel::fileservices
