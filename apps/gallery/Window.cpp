#include "apps/gallery/Window.h"

#include <QActionGroup>
#include <QApplication>
#include <QHBoxLayout>
#include <QListWidget>
#include <QMenuBar>
#include <QStackedWidget>
#include <QStatusBar>

#include "apps/gallery/BrowserPage.h"
#include "apps/gallery/FilesPage.h"
#include "apps/gallery/LinksPage.h"
#include "apps/gallery/ListsPage.h"
#include "apps/gallery/PanesPage.h"
#include "apps/gallery/ScoresPage.h"
#include "hosts/qt/Host.h"

namespace tessel::gallery {

Window::Window(QWidget* parent) : QMainWindow(parent), list_(new QListWidget), stack_(new QStackedWidget) {
    setWindowTitle(tr("Tesselcontrols4 Gallery"));
    resize(960, 640);
    auto* middle = new QWidget;
    auto* row = new QHBoxLayout(middle);
    list_->setFixedWidth(130);
    row->addWidget(list_);
    row->addWidget(stack_, 1);
    setCentralWidget(middle);
    connect(list_, &QListWidget::currentRowChanged, this, [this](int page) {
        stack_->setCurrentIndex(page);
        statusBar()->showMessage(pages_[page]->hint());
    });

    connect(qt::Host::of(this).get(), &qt::Host::unhandledError, this,
            [this](int number, const QString& description, const QString& where) {
                statusBar()->showMessage(tr("%1: error %2, %3").arg(where).arg(number).arg(description));
            });
    makeMenus();
    addPage(new LinksPage);
    addPage(new FilesPage);
    addPage(new BrowserPage);
    addPage(new ScoresPage);
    addPage(new PanesPage);
    addPage(new ListsPage);
    choose(0);
}

void Window::addPage(Page* page) {
    pages_ << page;
    list_->addItem(page->title());
    stack_->addWidget(page);
    connect(page, &Page::said, this, [this](const QString& line) { statusBar()->showMessage(line); });
}

void Window::choose(int page) { list_->setCurrentRow(page); }

void Window::makeMenus() {
    QMenu* file = menuBar()->addMenu(tr("&File"));
    file->addAction(tr("&Quit"), QKeySequence::Quit, qApp, &QApplication::closeAllWindows);

    QMenu* view = menuBar()->addMenu(tr("&View"));
    auto* schemes = new QActionGroup(this);
    const QPalette desktop = QApplication::palette();
    const auto add = [&](const QString& text, const QPalette& palette) {
        QAction* action = view->addAction(text, this, [palette] { Follow(palette); });
        action->setCheckable(true);
        schemes->addAction(action);
        return action;
    };
    add(tr("The &desktop's colours"), desktop)->setChecked(true);
    add(tr("&Light"), PaletteOf(Scheme::Light));
    add(tr("D&ark"), PaletteOf(Scheme::Dark));
    view->addSeparator();
    QAction* mirrored = view->addAction(tr("&Right to left"));
    mirrored->setCheckable(true);
    connect(mirrored, &QAction::toggled, this,
            [](bool on) { QApplication::setLayoutDirection(on ? Qt::RightToLeft : Qt::LeftToRight); });
}

}  // namespace tessel::gallery
