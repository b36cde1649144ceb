#include "hosts/qt/FileViewWidget.h"

#include "hosts/qt/WidgetPeer.h"

namespace tessel::qt {

FileViewWidget::FileViewWidget(const frame::ControlClass& controlClass, QWidget* parent) : ControlWidget(controlClass, parent) {}

QSize FileViewWidget::preferredSize() const {
    constexpr int lettersWide = 72, lines = 20;
    const QFontMetrics metrics = fontMetrics();
    return {lettersWide * metrics.averageCharWidth(), lines * metrics.lineSpacing()};
}

QSize FileViewWidget::minimumSizeHint() const {
    constexpr int lettersWide = 12, lines = 4;
    const QFontMetrics metrics = fontMetrics();
    return {lettersWide * metrics.averageCharWidth(), lines * metrics.lineSpacing()};
}

void FileViewWidget::started() {
    if (const auto* peer = dynamic_cast<WidgetPeer*>(fileView().ListFiles.Peer())) setFocusProxy(peer->widget());
    fileView().TotalSizeReady.To<&FileViewWidget::totalSizeReady>(*this);
}

}  // namespace tessel::qt
