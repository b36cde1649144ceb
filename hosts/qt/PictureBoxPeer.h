#pragma once

#include "frame/child/PictureBox.h"
#include "hosts/qt/WidgetPeer.h"

namespace tessel::qt {

class PictureBoxWidget;

/// Shows a picture box: its background, its picture, what was drawn, and a sunken border that is darker and lighter than what the
/// box stands on, whatever the palette. It takes the focus, which it shows when it came by the keyboard.
class PictureBoxPeer final : public frame::Peer, public WidgetPeer {
  public:
    explicit PictureBoxPeer(child::PictureBox& box);
    ~PictureBoxPeer() override;
    void Update() override;

  private:
    PictureBoxPeer(child::PictureBox& box, PictureBoxWidget* widget);

    QPointer<PictureBoxWidget> shown_;
};

}  // namespace tessel::qt
