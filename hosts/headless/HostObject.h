#pragma once

#include <memory>
#include <optional>
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
    HostObject(std::string path, const Members& members);

    frame::Variant Get(frame::MemberKey key, frame::Arguments arguments = {}) override;
    void Put(frame::MemberKey key, const frame::Variant& value, frame::Arguments arguments = {}) override;
    frame::Variant Call(frame::MemberKey key, frame::Arguments arguments = {}) override;
    bool Has(frame::MemberKey key) const override { return Find(key) != nullptr; }
    frame::ObjectRef Inner(std::string_view name) override;
    std::string Path() const override { return path_; }
    const frame::ClassTable& Table() const override;

    /// Adds a member, or sets the one of that name. A number under a name that ends in "Color" is a colour.
    void SetMember(std::string_view name, frame::Variant value);
    /// From now on this is set when the object's `Name` or `Index` is.
    void TellWhenRenamed(std::shared_ptr<bool> renamed) { renamed_ = std::move(renamed); }

  protected:
    const frame::Variant* Find(frame::MemberKey key) const;

  private:
    std::string path_;
    Members members_;
    std::shared_ptr<bool> renamed_;
};

/// A host's object with a surface: a form, a picture box of the application. It has the drawing members beside its own, and
/// keeps its pixels. It is as large as its members `Width` and `Height` say when it is made, else 12,000 by 9,000 twips.
class SurfaceObject : public HostObject, public frame::DrawingSurface {
  public:
    SurfaceObject(frame::Host& host, std::string path, Members members);

    frame::Variant Get(frame::MemberKey key, frame::Arguments arguments = {}) override;
    void Put(frame::MemberKey key, const frame::Variant& value, frame::Arguments arguments = {}) override;
    frame::Variant Call(frame::MemberKey key, frame::Arguments arguments = {}) override;
    bool Has(frame::MemberKey key) const override;

    // The inner size is set in the units of the present scale and keeps that scale, but for a user's own, which is then another.
    void SetScaleWidth(float value) override;
    void SetScaleHeight(float value) override;

    /// Sets what is given, the scale mode last: sizes are given in twips, whatever the mode.
    void Take(Members members);

  protected:
    frame::TextSize InnerSize() const override { return inner_; }

  private:
    void SetInner(frame::TextSize size);

    frame::TextSize inner_;
};

}  // namespace tessel::headless
