#pragma once

#include <QWidget>

namespace tessel::gallery {

/// A page of the gallery: one group of controls at work.
class Page : public QWidget {
    Q_OBJECT

  public:
    using QWidget::QWidget;

    /// One word, as the list of pages and the names of pictures have it.
    virtual QString title() const = 0;
    /// Brings the page into a state worth a picture, without a user.
    virtual void pose() {}

  signals:
    /// Something happened that the user may want to read.
    void said(const QString& line);
};

}  // namespace tessel::gallery
