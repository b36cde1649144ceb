#pragma once

#include <optional>

#include "frame/child/ListRows.h"
#include "frame/host.h"

namespace tessel::child {

/// What only a screen can answer of a list, and how it is scrolled. Positions count from 0 and coordinates are twips of the list's
/// inside, as it is scrolled. The list has told its peer of every change before it asks.
class ListScreen {
  public:
    using Position = ListRows::Position;
    struct RowPlace {
        float top = 0, height = 0;
    };

    /// The row at a point; nothing beside the rows.
    virtual std::optional<Position> RowAt(float x, float y) = 0;
    /// The first row in view. The list has rows.
    virtual Position FirstVisible() = 0;
    virtual RowPlace PlaceOf(Position row) = 0;
    /// Scrolls so that the row is the first in view, as far as the list can be scrolled.
    virtual void ScrollTo(Position row) = 0;
    /// Scrolls just so far that the row is in view.
    virtual void MakeVisible(Position row) = 0;

  protected:
    ~ListScreen() = default;
};

/// The peer of a list. What it must do stands at `ListView`.
class ListViewPeer : public frame::Peer {
  public:
    /// Who answers for the screen; null where the fixed rule of the headless host stands in.
    virtual ListScreen* Screen() = 0;
    /// The edit of a row's label has opened. It is over when `ListView::EditedRow` is no more, which `Update` sees.
    virtual void EditBegan(RowId row) = 0;
};

}  // namespace tessel::child
