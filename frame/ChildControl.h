#pragma once

#include <memory>
#include <string>

#include "frame/Event.h"
#include "frame/Member.h"
#include "frame/host.h"

namespace tessel::frame {

class Control;

/// The base of child controls: neutral objects that hold their state and their rules. A host shows one by attaching a peer;
/// without a peer it works just the same.
///
/// Changes by the program raise their events here; a peer only follows (`Peer::Update`) and reports what the user does
/// through the functions whose names end in `Input`.
class ChildControl : public Object {
  public:
    /// A child of `owner` under a fixed name; a member of a control array has its index in the name: "picHandle(0)".
    ChildControl(Control& owner, std::string name);
    ~ChildControl() override;

    const std::string& Name() const { return name_; }
    Control& Owner() const { return owner_; }
    frame::Host& Host() const { return host_; }
    std::string Path() const override;

    // Place and size in the owner's twips.
    float Left() const { return left_; }
    float Top() const { return top_; }
    float Width() const { return width_; }
    float Height() const { return height_; }
    void SetLeft(float value) { Move(value, top_, width_, height_); }
    void SetTop(float value) { Move(left_, value, width_, height_); }
    void SetWidth(float value) { Move(left_, top_, value, height_); }
    void SetHeight(float value) { Move(left_, top_, width_, value); }
    /// A negative width or height becomes 0.
    void Move(float left, float top, float width, float height);

    /// The child's own state, not whether a screen shows it.
    bool Visible() const { return visible_; }
    void SetVisible(bool value) { Store(visible_, value); }
    bool Enabled() const { return enabled_; }
    void SetEnabled(bool value) { Store(enabled_, value); }
    const std::string& ToolTipText() const { return toolTipText_; }
    void SetToolTipText(const std::string& value) { Store(toolTipText_, value); }
    /// Asks for a repaint.
    void Refresh() { Changed(); }

    void AttachPeer(std::unique_ptr<frame::Peer> peer);
    frame::Peer* Peer() const { return peer_.get(); }

  protected:
    /// A peer has come that will follow from now on.
    virtual void PeerAttached() {}
    /// The place or size has changed. A child that sizes itself answers here.
    virtual void Moved() {}
    /// Remembers that the peer has something to follow.
    void Changed();
    template <class T>
    bool Store(T& field, const T& value) {
        if (field == value) return false;
        field = value;
        Changed();
        return true;
    }
    /// Sets the geometry without asking `Moved`.
    void Place(float left, float top, float width, float height);

    /// Runs what a peer reports, through the one way in.
    template <class F>
    void Enter(std::string_view event, F&& call) {
        if (!IsAttached()) return;
        Entry::Run(
            host_, [&] { return Path() + "." + std::string(event); }, call);
    }

    /// Whether the host has not let go of the child's control.
    bool IsAttached() const;

  private:
    friend class frame::Host;
    friend class Control;

    Control& owner_;
    frame::Host& host_;
    std::string name_;
    float left_ = 0, top_ = 0, width_ = 0, height_ = 0;
    bool visible_ = true, enabled_ = true;
    bool askedForPeer_ = false;
    bool touched_ = false;  // stands in the host's list of changed children
    std::string toolTipText_;
    std::unique_ptr<frame::Peer> peer_;
};

/// The rows of the members that every child has.
inline constexpr std::array childMembers = {
    property<&ChildControl::Name>("Name", "The name of the child."),
    property<&ChildControl::Left, &ChildControl::SetLeft>("Left", "Left edge in twips."),
    property<&ChildControl::Top, &ChildControl::SetTop>("Top", "Top edge in twips."),
    property<&ChildControl::Width, &ChildControl::SetWidth>("Width", "Width in twips."),
    property<&ChildControl::Height, &ChildControl::SetHeight>("Height", "Height in twips."),
    property<&ChildControl::Visible, &ChildControl::SetVisible>("Visible", "Whether the child is to be seen."),
    property<&ChildControl::Enabled, &ChildControl::SetEnabled>("Enabled", "Whether the child takes input."),
    property<&ChildControl::ToolTipText, &ChildControl::SetToolTipText>("ToolTipText", "The tool tip."),
    method<&ChildControl::Refresh>("Refresh", "Repaints the child."),
};

}  // namespace tessel::frame
