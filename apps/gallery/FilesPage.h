#pragma once

#include <functional>
#include <memory>

#include "apps/gallery/Page.h"
#include "hosts/qt/FileView.h"

class QButtonGroup;
class QCheckBox;
class QComboBox;
class QLayout;
class QLineEdit;
class QTemporaryDir;
class QToolButton;

namespace tessel::gallery {

class FileStatus;

/// The files of this machine: a list with a path line, a filter, four views, a search, and what it all comes to.
class FilesPage final : public Page {
    Q_OBJECT

  public:
    explicit FilesPage(QWidget* parent = nullptr);
    ~FilesPage() override;

    QString title() const override { return "Files"; }
    QString hint() const override {
        return tr("Enter and Backspace go in and up, F5 reads anew, Ctrl+L and Ctrl+F lead to the boxes.");
    }
    QStringList poses() const override { return {"report", "icons", "search"}; }
    void pose(const QString& name) override;

  private:
    enum class Shows { Folder, Results };

    QLayout* makePathRow();
    QLayout* makeFilterRow();
    void makeList();
    void makeKeys();

    void go(const QString& folder);
    void goUp();
    void list();
    void enter();
    void find();
    /// Runs what fills the list. Meanwhile nothing else may begin to.
    void fill(Shows what, const std::function<void()>& run);
    void chooseView(int view);
    void followPath();
    QString fullPathOfItem() const;

    QToolButton* up_ = nullptr;
    QLineEdit* path_ = nullptr;
    QComboBox* filter_ = nullptr;
    QCheckBox* hidden_ = nullptr;
    QButtonGroup* views_ = nullptr;
    QLineEdit* search_ = nullptr;
    QToolButton* find_ = nullptr;
    qt::FileView* files_ = nullptr;
    FileStatus* status_ = nullptr;
    QList<QWidget*> idleOnly_;  // what begins a listing
    std::unique_ptr<QTemporaryDir> sample_;

    Shows shows_ = Shows::Folder;
    QString folder_;  // that is shown, or was before a search
    bool filling_ = false, stopped_ = false;
};

}  // namespace tessel::gallery
