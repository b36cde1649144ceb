#pragma once

#include <memory>
#include <string>
#include <string_view>
#include <type_traits>
#include <vector>

#include "frame/ChildControl.h"
#include "frame/ClassTable.h"
#include "frame/Event.h"
#include "frame/OwnSurface.h"
#include "frame/Site.h"
#include "frame/host.h"

namespace tessel::frame {

/// The base of the visual controls: their life, their saved state, their refusals and their events.
///
/// A host calls the handlers in this order: `Initialize`, then `InitProperties` (placed new) or `ReadProperties` (loaded), then
/// `Resize`, then `Show`, then what comes; `WriteProperties` at any moment.
class Control : public Object {
  public:
    explicit Control(frame::Host& host) : host_(host) {}

    frame::Host& Host() const { return host_; }
    /// The name by which the host's extender knows the control.
    std::string Path() const override;
    ObjectRef Inner(std::string_view name) override;
    std::span<ChildControl* const> Children() const { return children_; }

    /// Once, before anything else. No ambient property may be asked.
    virtual void Initialize() {}
    /// Placed new on a form. Gives every own field its default; the children keep the state of their design.
    virtual void InitProperties();
    /// Loaded from saved state, straight into fields and children: no setter runs and nothing is reported. An entry that does
    /// not convert fails with error 13 or 6 and leaves the load where it stands.
    virtual void ReadProperties(const PropertyBag& bag);
    /// The size has changed.
    virtual void Resize() {}
    virtual void Show() {}
    virtual void Paint() {}
    virtual void AmbientChanged(const std::string& /*name*/) {}
    virtual void Hide() {}
    /// Writes every key in the fixed order.
    virtual void WriteProperties(PropertyBag& bag) const;

    /// The size that a new control has before its host gives it one, in twips.
    virtual TextSize DesignSize() const = 0;

    /// The control's own surface: its size, colours, pointer and drawing operations.
    OwnSurface& Surface() { return surface_; }
    const OwnSurface& Surface() const { return surface_; }

    /// Null once the host has let go of the control.
    frame::Site* Site() const { return site_; }
    /// Whether the control runs in an application; false in a form designer, and once the host has let go.
    bool UserMode() const { return site_ && site_->Ambient().UserMode(); }
    /// A copy of the host's font at each call.
    FontRef AmbientFont() const;

  protected:
    /// Tells the host that a property has changed, by its bag key.
    void PropertyChanged(std::string_view key) const;
    /// Raises an event and returns when the host's handlers have. Afterwards anything may have changed, this control's own
    /// state and life in its host included.
    template <class... Args>
    void RaiseEvent(const Event<Args...>& event, std::type_identity_t<Args>... arguments) const {
        if (!site_) return;
        EventSink& sink = site_->Events();
        if (!sink.Wants(event)) return;
        const Callout callout(host_);
        if constexpr (sizeof...(Args) == 0) {
            sink.Raise(event, {});
        } else {
            const EventArgument references[] = {EventArgument(arguments)...};
            sink.Raise(event, references);
        }
    }
    /// Forwards an event of a child. What a handler does to the arguments is not read back.
    template <class... Args>
    void ForwardEvent(const Event<Args...>& event, std::remove_reference_t<Args>... copies) const {
        RaiseEvent(event, copies...);
    }
    /// First step of the setter of a run-time property: error 387 at design time.
    void RefuseAtDesignTime() const;
    void RefuseReadOnly() const override;
    /// The host's own members for this control; error 91 once the host has let go.
    Object& Extender() const;

  private:
    friend class ChildControl;
    friend class frame::Site;

    void AddChild(ChildControl& child) { children_.push_back(&child); }
    void RemoveChild(ChildControl& child) { std::erase(children_, &child); }
    /// Asks the host for the peers of the children that have not yet been asked for.
    void TakePeers();
    /// Before the children go: a peer may still look at its child.
    void DropPeers();

    frame::Host& host_;
    frame::Site* site_ = nullptr;
    std::vector<ChildControl*> children_;
    OwnSurface surface_{*this};
};

namespace detail {
template <class C>
const C& Of(const Control& control) {
    return static_cast<const C&>(control);
}
template <class C>
C& Of(Control& control) {
    return static_cast<C&>(control);
}
}  // namespace detail

/// A class of controls, as factories and tools know it.
struct ControlClass {
    const ClassTable* table = nullptr;
    std::unique_ptr<Control> (*make)(Host&) = nullptr;
};

}  // namespace tessel::frame
