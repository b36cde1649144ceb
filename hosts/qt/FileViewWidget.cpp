#include "hosts/qt/FileViewWidget.h"

namespace tessel::qt {

FileViewWidget::FileViewWidget(const frame::ControlClass& controlClass, QWidget* parent) : ControlWidget(controlClass, parent) {}

QSize FileViewWidget::preferredSize() const { return textArea(72, 20); }

QSize FileViewWidget::minimumSizeHint() const { return textArea(12, 4); }

void FileViewWidget::started() {
    giveFocusTo(fileView().ListFiles);
    fileView().TotalSizeReady.To<&FileViewWidget::totalSizeReady>(*this);
}

}  // namespace tessel::qt
