#pragma once

#include "apps/gallery/Page.h"
#include "hosts/qt/Link.h"

class QPlainTextEdit;

namespace tessel::gallery {

/// Links that open and print real things, in all their looks, with a log of their events.
class LinksPage final : public Page {
    Q_OBJECT

  public:
    explicit LinksPage(QWidget* parent = nullptr);

    QString title() const override { return "Links"; }
    QString hint() const override { return tr("Move, press, or go from link to link with the Tab key."); }
    void pose(const QString& name) override;

  private:
    QWidget* makeTargets();
    QWidget* makeLooks();
    QWidget* makeLog();
    qt::Link* makeLink(const QString& name, const QString& caption, const QString& target);
    void listen(qt::Link* link);
    void log(const QString& line);

    QPlainTextEdit* log_ = nullptr;
    QList<qt::Link*> links_;
};

}  // namespace tessel::gallery
