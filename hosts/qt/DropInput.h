#pragma once

#include <QDropEvent>
#include <QPointF>

#include "frame/child/DragChild.h"

namespace tessel::qt {

/// Reports what is dragged over a widget and dropped on it to the child that it shows: the local files, and whether there is text.
/// What the child makes of the effect is what the source is told.
///
/// An input may end the child and its peer: the peer disconnects this object, which lives as long as the widget.
class DropInput {
  public:
    explicit DropInput(child::DragChild& child) : child_(&child) {}
    /// From now on nothing is reported.
    void Disconnect() { child_ = nullptr; }
    /// Whether the child takes drops at all.
    bool Wanted() const { return child_ && child_->OLEDropMode() != child::OLEDropConstants::None; }

    // `at` is in pixels of the child.
    void Enter(QDropEvent& event, QPointF at);
    void Over(QDropEvent& event, QPointF at);
    void Leave();
    void Drop(QDropEvent& event, QPointF at);

  private:
    void Report(QDropEvent& event, QPointF at, child::DragOverConstants state);
    static void Answer(QDropEvent& event, std::int32_t effect);

    child::DragChild* child_;  // null once it has gone
    child::DragDataRef data_;  // of the drag that is over the child
    QPointF last_;
};

}  // namespace tessel::qt
