#pragma once

#include "frame/child/ListView.h"
#include "hosts/qt/ListWidget.h"
#include "hosts/qt/WidgetPeer.h"

namespace tessel::qt {

/// Shows a list.
class ListViewPeer final : public child::ListViewPeer, public WidgetPeer, private child::ListScreen {
  public:
    explicit ListViewPeer(child::ListView& list);
    ~ListViewPeer() override;

    void Update() override;
    child::ListScreen* Screen() override;
    void EditBegan(child::RowId row) override;

  private:
    ListViewPeer(child::ListView& list, ListWidget* widget);

    std::optional<Position> RowAt(float x, float y) override;
    Position FirstVisible() override;
    RowPlace PlaceOf(Position row) override;
    void ScrollTo(Position row) override;
    void MakeVisible(Position row) override;

    QPointer<ListWidget> shown_;
    bool follows_ = false;
};

}  // namespace tessel::qt
