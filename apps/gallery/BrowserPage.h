#pragma once

#include <memory>

#include "apps/gallery/Page.h"
#include "hosts/qt/DataList.h"
#include "hosts/qt/FileView.h"
#include "hosts/qt/FolderView.h"
#include "hosts/qt/Link.h"
#include "hosts/qt/Splitter.h"

class QLayout;
class QTemporaryDir;
class QToolButton;

namespace tessel::gallery {

class FileStatus;

/// A file manager: a tree of folders and a list of files side by side with a bar between, each following the other, a list of
/// filters, and a link to the folder. It begins where it was left.
class BrowserPage final : public Page {
    Q_OBJECT

  public:
    /// The state is kept in this file; empty for the user's own.
    explicit BrowserPage(const QString& stateFile = {}, QWidget* parent = nullptr);
    ~BrowserPage() override;

    QString title() const override { return "Browser"; }
    QString hint() const override { return tr("A folder chosen on either side is shown on the other. Alt+Up goes up."); }
    void pose(const QString& name) override;

  protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

  private:
    QLayout* makeTopRow();
    void makePanes();
    /// Gives the panes the whole area; the tree keeps its width as far as there is room.
    void layOut();
    void restore();
    void save() const;

    /// Shows a folder on both sides.
    void go(const QString& folder);
    /// Lists a folder as soon as the running event and listing are over; a later wish takes the place of one not yet begun.
    void list(const QString& folder);
    void listNow();
    /// Opens the tree down to the folder and selects it.
    void reveal(const QString& folder);
    void enter();

    QString stateFile_;
    QToolButton* up_ = nullptr;
    qt::Link* link_ = nullptr;
    qt::DataList* filter_ = nullptr;
    QWidget* area_ = nullptr;  // the form of the bar, without a layout
    qt::Splitter* bar_ = nullptr;
    qt::FolderView* tree_ = nullptr;
    qt::FileView* files_ = nullptr;
    FileStatus* status_ = nullptr;
    std::unique_ptr<QTemporaryDir> sample_;

    QString folder_;  // that is shown or about to be
    int treeWidth_ = 230;
    bool due_ = false, listing_ = false, revealing_ = false, rebuilt_ = false;
};

}  // namespace tessel::gallery
