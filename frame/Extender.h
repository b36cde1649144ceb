#pragma once

#include <string>
#include <utility>

#include "frame/Object.h"
#include "frame/Site.h"
#include "frame/Variant.h"

namespace tessel::frame {

/// What stands on a form for one control, for all who reach it by name: the host's own members first, behind them the
/// control's. The geometry is the site's; a host adds the members that it has beside it.
class Extender : public Object {
  public:
    explicit Extender(Site& site) : site_(site) {}

    virtual std::string Name() const = 0;
    virtual bool Visible() const = 0;
    virtual void SetVisible(bool value) = 0;
    float Left() const { return site_.Left(); }
    void SetLeft(float value) { site_.SetPlace(value, site_.Top()); }
    float Top() const { return site_.Top(); }
    void SetTop(float value) { site_.SetPlace(site_.Left(), value); }
    float Width() const { return site_.Width(); }
    void SetWidth(float value) { site_.SetSize(value, site_.Height()); }
    float Height() const { return site_.Height(); }
    void SetHeight(float value) { site_.SetSize(site_.Width(), value); }

    Variant Get(MemberKey key, Arguments arguments = {}) override;
    void Put(MemberKey key, const Variant& value, Arguments arguments = {}) override;
    Variant Call(MemberKey key, Arguments arguments = {}) override;
    bool Has(MemberKey key) const override;
    ObjectRef Inner(std::string_view name) override;
    std::string Path() const override { return site_.Path(); }
    /// That of the control.
    const ClassTable& Table() const override;

  protected:
    /// What the host adds beside the members above; they have names alone.
    virtual const Object& More() const = 0;
    Object& More() { return const_cast<Object&>(std::as_const(*this).More()); }

  private:
    /// Who answers to what is no member of the geometry. A number is always one of the control's.
    const Object& Behind(MemberKey key) const;
    Object& Behind(MemberKey key) { return const_cast<Object&>(std::as_const(*this).Behind(key)); }

    Site& site_;
};

}  // namespace tessel::frame
