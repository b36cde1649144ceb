#pragma once

#include <QWidget>

#include "hosts/qt/FileView.h"

class QLabel;

namespace tessel::gallery {

/// Tells of a list of files how many there are and what they come to.
class FileStatus final : public QWidget {
    Q_OBJECT

  public:
    explicit FileStatus(qt::FileView* files, QWidget* parent = nullptr);

    /// What the list shows from now on: the results of a search below a folder, or with an empty text a folder.
    void setSearched(const QString& folder);
    /// Waits until the size is known, for a picture.
    void waitForSize();

  private:
    void followCount();
    void followSize();

    qt::FileView* files_;
    QLabel *count_, *size_;
    QString searched_;
};

}  // namespace tessel::gallery
