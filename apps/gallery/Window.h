#pragma once

#include <QList>
#include <QMainWindow>

#include "apps/gallery/Palettes.h"

class QListWidget;
class QStackedWidget;

namespace tessel::gallery {

class Page;

/// The gallery: a list of pages, and the page chosen.
class Window final : public QMainWindow {
    Q_OBJECT

  public:
    explicit Window(QWidget* parent = nullptr);

    const QList<Page*>& pages() const { return pages_; }
    void choose(int page);

  private:
    void addPage(Page* page);
    void makeMenus();

    QListWidget* list_;
    QStackedWidget* stack_;
    QList<Page*> pages_;
};

}  // namespace tessel::gallery
