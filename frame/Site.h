#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "frame/Event.h"
#include "frame/PropertyBag.h"
#include "frame/host.h"

namespace tessel::frame {

class Control;

/// What a host offers to all its controls. Asked afresh each time; nothing of it is kept.
class AmbientProperties {
  public:
    virtual ~AmbientProperties() = default;
    /// False at design time, true at run time.
    virtual bool UserMode() const = 0;
    /// A copy of the ambient font; never null.
    virtual FontRef Font() const = 0;
    /// The name by which the host knows the control.
    virtual std::string DisplayName() const = 0;
};

/// The objects that stand on the same form, each reached by name.
class Siblings {
  public:
    virtual ~Siblings() = default;
    virtual int Count() const = 0;
    /// From 0. Error 9 for an index outside.
    virtual Object& Item(int index) = 0;
    /// The first in order whose `Name` is this one, without regard to case; with an index of 0 or more only one whose `Index`
    /// equals it. One that has no readable `Name`, or no `Index` where one is asked, is passed over. Null when there is none. This
    /// is a search from the first to the last; a host may find the same sooner.
    virtual Object* Find(std::string_view name, std::int32_t index = -1);
};

/// The place of one control in its host: what the host offers it, and its life. A host derives from this and gives one to
/// each control; the site owns the control and its size.
class Site {
  public:
    explicit Site(frame::Host& host);
    Site(const Site&) = delete;
    Site& operator=(const Site&) = delete;
    virtual ~Site();

    frame::Host& Host() const { return host_; }
    frame::Control& Control() const { return *control_; }

    // What the control asks.
    virtual const AmbientProperties& Ambient() const = 0;
    /// The object by which the host adds its own members to the control: `Name`, `Left`, `Top`, `ToolTipText` and others.
    virtual Object& Extender() = 0;
    /// The form; null when there is none.
    virtual Object* Parent() = 0;
    virtual Siblings& ParentControls() = 0;
    virtual void PropertyChanged(std::string_view key) = 0;
    virtual EventSink& Events() = 0;
    /// The name under which logs and error reports know the control.
    virtual std::string Path() const { return Ambient().DisplayName(); }
    /// The control's surface needs to be seen anew.
    virtual void Repaint() {}
    /// The control's surface needs to be drawn anew: its `Paint` runs, at once or when the surface is next shown.
    virtual void Redraw() { Paint(); }

    // Size and place, in twips. A set that changes nothing is none.
    float Left() const { return left_; }
    float Top() const { return top_; }
    float Width() const { return width_; }
    float Height() const { return height_; }
    void SetPlace(float left, float top);
    /// Calls `Resize` of the control when the size has changed. A negative extent becomes 0.
    void SetSize(float width, float height);

    // What the host does with the control, in this order.
    /// Takes a control: its children get their peers, then `Initialize` runs.
    void Adopt(std::unique_ptr<frame::Control> control);
    /// `ReadProperties` from saved state or `InitProperties` without, then the size that the host gives, and `Resize`.
    void Start(const PropertyBag* saved, std::optional<float> width = {}, std::optional<float> height = {});
    void Show();
    void Hide();
    void Paint();
    void AmbientChanged(const std::string& name);
    void Save(PropertyBag& bag);
    /// Cuts the control off: it asks, tells and raises nothing more. `Host::Retire` does it.
    void Detach();

  protected:
    /// The place has been set.
    virtual void Placed() {}
    /// The size has been set; `Start` says so once in any case. The design's size, which a control has from `Adopt` to `Start`,
    /// is not announced.
    virtual void Sized() {}

  private:
    frame::Host& host_;
    std::unique_ptr<frame::Control> control_;
    float left_ = 0, top_ = 0, width_ = 0, height_ = 0;
};

}  // namespace tessel::frame
