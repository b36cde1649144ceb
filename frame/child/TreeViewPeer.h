#pragma once

#include <optional>

#include "frame/child/TreeNodes.h"
#include "frame/host.h"

namespace tessel::child {

/// What only a screen can answer of a tree, and how it is scrolled. Rows count from 0 and coordinates are twips of the tree's
/// inside, as it is scrolled. The tree has told its peer of every change before it asks.
class TreeScreen {
  public:
    using Row = TreeNodes::Row;
    struct RowsInView {
        Row first = 0, count = 0;
    };

    /// The row at a point; nothing beside the rows.
    virtual std::optional<Row> RowAt(float x, float y) = 0;
    /// The rows that are within the window, in whole or in part.
    virtual RowsInView InView() = 0;
    /// Scrolls just so far that the row is in view.
    virtual void MakeVisible(Row row) = 0;

  protected:
    ~TreeScreen() = default;
};

/// The peer of a tree. What it must do stands at `TreeView`.
class TreeViewPeer : public frame::Peer {
  public:
    /// Who answers for the screen; null where the fixed rule of the headless host stands in.
    virtual TreeScreen* Screen() = 0;
    /// The edit of a node's label has opened; the node has a row. It is over when `TreeView::EditedNode` is no more, which `Update`
    /// sees.
    virtual void EditBegan(NodeId node) = 0;
};

}  // namespace tessel::child
