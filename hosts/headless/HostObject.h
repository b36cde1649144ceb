#pragma once

#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "frame/Object.h"
#include "frame/Surface.h"
#include "frame/Variant.h"

namespace tessel::headless {

/// An object of the host whose members are just those that it was given; any other name fails with error 438. With a surface
/// it can be drawn on too.
class HostObject : public frame::Object {
  public:
    using Members = std::vector<std::pair<std::string, frame::Variant>>;

    /// `path` is the object's place in logs: "Text1", "Text1(2)".
    HostObject(std::string path, Members members) : path_(std::move(path)), members_(std::move(members)) {}

    frame::Variant Get(frame::MemberKey key, frame::Arguments arguments = {}) override;
    void Put(frame::MemberKey key, const frame::Variant& value, frame::Arguments arguments = {}) override;
    frame::Variant Call(frame::MemberKey key, frame::Arguments arguments = {}) override;
    bool Has(frame::MemberKey key) const override { return Find(key) != nullptr; }
    frame::ObjectRef Inner(std::string_view name) override;
    std::string Path() const override { return path_; }
    const frame::ClassTable& Table() const override;

    /// Adds a member, or sets the one of that name.
    void SetMember(std::string_view name, frame::Variant value);

  protected:
    const frame::Variant* Find(frame::MemberKey key) const;

  private:
    std::string path_;
    Members members_;
};

/// A host's object with a surface: a form, a picture box of the application. It has the drawing members beside its own.
class SurfaceObject : public HostObject, public frame::DrawingSurface {
  public:
    SurfaceObject(frame::Host& host, std::string path, Members members);

    frame::Variant Get(frame::MemberKey key, frame::Arguments arguments = {}) override;
    void Put(frame::MemberKey key, const frame::Variant& value, frame::Arguments arguments = {}) override;
    frame::Variant Call(frame::MemberKey key, frame::Arguments arguments = {}) override;
    bool Has(frame::MemberKey key) const override;

    // The inner size is set in the units of the present scale and keeps that scale.
    void SetScaleWidth(float value) override;
    void SetScaleHeight(float value) override;

  protected:
    frame::TextSize InnerSize() const override { return inner_; }
    /// Sets what is given, the scale mode last: sizes are given in twips, whatever the mode.
    void Take(Members members);

  private:
    frame::TextSize inner_{12'000, 9'000};
};

}  // namespace tessel::headless
