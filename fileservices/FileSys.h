#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "fileservices/Drive.h"
#include "frame/Object.h"
#include "frame/Variant.h"
#include "frame/host.h"

namespace tessel::fileservices {

/// Sizes and drive types as texts, and the shell's operations. One for each host: `host.Module<FileSys>()`.
///
/// The operations answer with a text, empty for success: a failure is no error. The host knows its own windows; a window handle
/// is taken from late-bound callers and passed over.
class FileSys final : public frame::Object {
  public:
    explicit FileSys(frame::Host& host) : host_(host) {}

    /// Whole kilobytes, rounded up; error 6 for more than 32 bits hold.
    std::int32_t FileSizeKB(double bytes) const;
    /// The same as text, "1,024 KB".
    std::string FileSizeText(double bytes) const;
    /// "Local Disk", "Drive Unavailable" and so on: also the key of the drive's picture.
    std::string DriveTypeWord(const DriveRef& drive) const;

    /// `sources` is an array of paths, or one text of paths parted by commas; so is `destination`. What is in use at the
    /// destination gets another name.
    std::string FileOpCopy(std::int32_t window, const frame::Variant& sources, const frame::Variant& destination) const;
    std::string FileOpMove(std::int32_t window, const frame::Variant& sources, const frame::Variant& destination) const;
    /// What is not deleted for good can be restored by the system's own means.
    std::string FileOpDelete(std::int32_t window, const frame::Variant& sources, bool permanent) const;

    std::string ShellOpenFile(std::int32_t window, const std::string& path) const { return ShellRunVerb(window, path, "open"); }
    std::string ShellPrintFile(std::int32_t window, const std::string& path) const { return ShellRunVerb(window, path, "print"); }

    std::string Path() const override { return "FileSys"; }
    const frame::ClassTable& Table() const override;

    /// A source list as the shell takes it: each path ended by a NUL, and one more NUL behind the last.
    static std::string PathListForOperation(const frame::Variant& paths);
    /// The paths of such a list up to the first empty one, where the shell stops reading.
    static std::vector<std::string> PathsIn(std::string_view list);

  private:
    std::string RunFileOperation(frame::FileOperation::Kind kind, int flags, const frame::Variant& from,
                                 const frame::Variant& to) const;
    std::string ShellRunVerb(std::int32_t window, const std::string& path, std::string_view verb) const;

    frame::Host& host_;
};

}  // namespace tessel::fileservices
