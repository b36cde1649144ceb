#pragma once

#include "frame/child/Label.h"
#include "hosts/qt/WidgetPeer.h"

namespace tessel::qt {

class LabelWidget;

/// Shows a label. Text in a fixed colour over a background that follows the palette is lightened on a dark palette until it can
/// be read; the label's own colours stay as they are.
class LabelPeer final : public frame::Peer, public WidgetPeer {
  public:
    explicit LabelPeer(child::Label& label);
    ~LabelPeer() override;
    void Update() override;

  private:
    LabelPeer(child::Label& label, LabelWidget* widget);

    child::Label& label_;
    QPointer<LabelWidget> shown_;
};

/// `color` itself where it can be read on `background` (contrast 4.5 to 1), else mixed with as much white as it takes.
QColor Readable(const QColor& color, const QColor& background);

}  // namespace tessel::qt
