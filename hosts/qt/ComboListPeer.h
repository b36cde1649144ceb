#pragma once

#include "frame/child/ComboList.h"
#include "hosts/qt/WidgetPeer.h"

namespace tessel::qt {

class ComboListWidget;

/// Shows a drop-down list as the desktop's combo box, which reads the list's own rows: nothing is copied, and the popup opens as
/// fast with 100,000 rows as with ten. The wheel over the closed list changes nothing.
class ComboListPeer final : public child::ComboListPeer, public WidgetPeer {
  public:
    explicit ComboListPeer(child::ComboList& list);
    ~ComboListPeer() override;
    void Update() override;
    float NaturalHeight() override;

  private:
    ComboListPeer(child::ComboList& list, ComboListWidget* widget);

    QPointer<ComboListWidget> shown_;
};

}  // namespace tessel::qt
