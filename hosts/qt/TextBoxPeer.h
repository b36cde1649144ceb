#pragma once

#include "frame/child/TextBox.h"
#include "hosts/qt/WidgetPeer.h"

namespace tessel::qt {

class TextBoxWidget;

/// Shows a text box: a line edit, or with several lines a plain text edit.
class TextBoxPeer final : public frame::Peer, public WidgetPeer {
  public:
    explicit TextBoxPeer(child::TextBox& box);
    ~TextBoxPeer() override;
    void Update() override;

  private:
    TextBoxPeer(child::TextBox& box, TextBoxWidget* widget);

    QPointer<TextBoxWidget> shown_;
};

}  // namespace tessel::qt
