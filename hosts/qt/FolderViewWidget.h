#pragma once

#include "controls/folderview/FolderView.h"
#include "hosts/qt/ControlWidget.h"

namespace tessel::qt {

/// What a user of a desktop expects of a tree of folders beside what the control does: it asks a layout for a useful size, and the
/// focus goes to the tree.
class FolderViewWidget : public ControlWidget {
    Q_OBJECT

  public:
    controls::FolderView& folderView() const { return static_cast<controls::FolderView&>(control()); }
    QSize minimumSizeHint() const override;

  protected:
    FolderViewWidget(const frame::ControlClass& controlClass, QWidget* parent);

    QSize preferredSize() const override;
    void started() override;
};

}  // namespace tessel::qt
