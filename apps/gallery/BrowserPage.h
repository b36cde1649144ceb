#pragma once

#include <memory>

#include "apps/gallery/Page.h"
#include "hosts/qt/FileView.h"
#include "hosts/qt/FolderView.h"
#include "hosts/qt/Link.h"

class QComboBox;
class QLayout;
class QSettings;
class QSplitter;
class QTemporaryDir;
class QToolButton;

namespace tessel::gallery {

class FileStatus;

/// A file manager: a tree of folders and a list of files side by side, each following the other. It begins where it was left.
class BrowserPage final : public Page {
    Q_OBJECT

  public:
    /// The state is kept in this file; empty for the user's own.
    explicit BrowserPage(const QString& stateFile = {}, QWidget* parent = nullptr);
    ~BrowserPage() override;

    QString title() const override { return "Browser"; }
    QString hint() const override { return tr("A folder chosen on either side is shown on the other. Alt+Up goes up."); }
    void pose(const QString& name) override;

  private:
    QLayout* makeTopRow();
    void makePanes();
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
    QComboBox* filter_ = nullptr;
    QSplitter* splitter_ = nullptr;
    qt::FolderView* tree_ = nullptr;
    qt::FileView* files_ = nullptr;
    FileStatus* status_ = nullptr;
    std::unique_ptr<QTemporaryDir> sample_;

    QString folder_;  // that is shown or about to be
    bool due_ = false, listing_ = false, revealing_ = false, rebuilt_ = false;
};

}  // namespace tessel::gallery
