#include "hosts/qt/FolderViewWidget.h"

namespace tessel::qt {

FolderViewWidget::FolderViewWidget(const frame::ControlClass& controlClass, QWidget* parent)
    : ControlWidget(controlClass, parent) {}

QSize FolderViewWidget::preferredSize() const { return textArea(30, 20); }

QSize FolderViewWidget::minimumSizeHint() const { return textArea(12, 4); }

void FolderViewWidget::started() { giveFocusTo(folderView().TreeFolders); }

}  // namespace tessel::qt
