#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "frame/FileSystem.h"
#include "frame/Object.h"
#include "frame/Variant.h"

namespace tessel::fileservices {

/// A drive as it stood when the object was made.
class Drive final : public frame::Object {
  public:
    explicit Drive(frame::DriveRecord record) : record_(std::move(record)) {}

    /// "C:", "/media/usb/"; of a network drive without a letter its share.
    const std::string& DrivePath() const { return record_.path; }
    /// Its top folder, as `DriveExists` knows it: "C:\".
    const std::string& RootPath() const { return record_.root; }
    /// Empty where it has none.
    const std::string& DriveLetter() const { return record_.letter; }
    /// One of `frame::driveTypes`.
    std::int32_t DriveType() const { return record_.type; }
    /// "\\server\name" of a network drive, else empty.
    const std::string& ShareName() const { return record_.shareName; }
    const std::string& VolumeName() const { return record_.volumeName; }
    bool IsReady() const { return record_.isReady; }

    const frame::ClassTable& Table() const override;
    bool EqualsObject(const Object& other) const override;

  private:
    frame::DriveRecord record_;
};
using DriveRef = std::shared_ptr<Drive>;

/// The drives as they stood when the object was made.
class DriveCollection final : public frame::Object {
  public:
    explicit DriveCollection(frame::FileSystem& files);

    std::int32_t Count() const { return static_cast<std::int32_t>(drives_.size()); }
    /// A drive by its number, from 1 (error 9 outside), or by its letter, path, root or share (error 76 when there is none).
    DriveRef Item(const frame::Variant& key) const;

    const frame::ClassTable& Table() const override;

  private:
    bool Means(std::string_view text, const Drive& drive) const;

    std::vector<DriveRef> drives_;
    bool ignoresCase_;
};
using DrivesRef = std::shared_ptr<DriveCollection>;

}  // namespace tessel::fileservices
