#pragma once

#include <QPointer>
#include <QWidget>

#include "frame/ChildControl.h"
#include "frame/host.h"

namespace tessel::qt {

/// The part of a peer that shows its child as a widget: that stands on the surface of the child's site, and goes later, unseen and
/// deaf, since an event of its own may be on the stack when the peer ends.
class WidgetPeer {
  public:
    QWidget* widget() const { return widget_; }

  protected:
    /// Shows the widget as a part of the child's control, under the child's name.
    WidgetPeer(frame::ChildControl& child, QWidget* widget);
    WidgetPeer(const WidgetPeer&) = delete;
    WidgetPeer& operator=(const WidgetPeer&) = delete;
    virtual ~WidgetPeer();
    /// Follows what every child has: place, size, visibility, whether it is enabled, tool tip.
    void FollowChild();

  private:
    frame::ChildControl& child_;
    QPointer<QWidget> widget_;
};

/// The peer of a child, by its kind; null for a kind that is not shown.
std::unique_ptr<frame::Peer> MakePeer(frame::ChildControl& child);

}  // namespace tessel::qt
