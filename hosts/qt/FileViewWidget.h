#pragma once

#include "controls/fileview/FileView.h"
#include "hosts/qt/ControlWidget.h"

namespace tessel::qt {

/// What a user of a desktop expects of a list of files beside what the control does: it asks a layout for a useful size, the focus
/// goes to the list, and a program can show the total size without waiting for it.
class FileViewWidget : public ControlWidget {
    Q_OBJECT

  public:
    controls::FileView& fileView() const { return static_cast<controls::FileView&>(control()); }
    /// Whether `totalSize` can be read without waiting; where not, `totalSizeReady` will tell.
    bool totalSizeKnown() const { return fileView().TotalSizeKnown(); }
    QSize minimumSizeHint() const override;

  signals:
    /// What `totalSize` waits for has become known. Not raised for a size that was known at once.
    void totalSizeReady();

  protected:
    FileViewWidget(const frame::ControlClass& controlClass, QWidget* parent);

    QSize preferredSize() const override;
    void started() override;
};

}  // namespace tessel::qt
