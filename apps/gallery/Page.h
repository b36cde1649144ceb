#pragma once

#include <QStringList>
#include <QWidget>

namespace tessel::gallery {

/// A page of the gallery: one group of controls at work.
class Page : public QWidget {
    Q_OBJECT

  public:
    using QWidget::QWidget;

    /// One word, as the list of pages and the names of pictures have it.
    virtual QString title() const = 0;
    /// What the user can do there.
    virtual QString hint() const = 0;
    /// The states that are worth a picture; an empty name for a page of one state.
    virtual QStringList poses() const { return {""}; }
    /// Brings the page into one of them, without a user.
    virtual void pose(const QString& /*name*/) {}

  signals:
    /// Something happened that the user may want to read.
    void said(const QString& line);
};

}  // namespace tessel::gallery
