#pragma once

#include <string>
#include <string_view>

#include "frame/Object.h"
#include "frame/host.h"

namespace tessel::fileservices {

/// The paths of the system's own folders. One for each host: `host.Module<SpecialFolders>()`.
class SpecialFolders final : public frame::Object {
  public:
    explicit SpecialFolders(frame::Host& host) : host_(host) {}

    /// The path of a folder by its name, in any case: one of `frame::specialFolderNames`. Empty for another name, which nobody is
    /// asked about, and where the system has no such folder.
    std::string SpecialFolderPath(std::string_view name) const;

    std::string Path() const override { return "SpecialFolders"; }
    const frame::ClassTable& Table() const override;

  private:
    /// What late-bound callers reach: they pass the name by reference.
    std::string PathByReference(std::string& name) const { return SpecialFolderPath(name); }

    frame::Host& host_;
};

}  // namespace tessel::fileservices
