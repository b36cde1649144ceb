#include "apps/gallery/BrowserPage.h"

#include <QAction>
#include <QComboBox>
#include <QDesktopServices>
#include <QDir>
#include <QFileInfo>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPointer>
#include <QScopedValueRollback>
#include <QSettings>
#include <QSplitter>
#include <QStandardPaths>
#include <QTemporaryDir>
#include <QTimer>
#include <QToolButton>
#include <QUrl>
#include <QVBoxLayout>

#include "apps/gallery/FileStatus.h"
#include "apps/gallery/Sample.h"
#include "hosts/qt/Convert.h"

namespace tessel::gallery {

BrowserPage::BrowserPage(const QString& stateFile, QWidget* parent) : Page(parent), stateFile_(stateFile) {
    if (stateFile_.isEmpty()) stateFile_ = QStandardPaths::writableLocation(QStandardPaths::AppConfigLocation) + "/browser.ini";
    makePanes();
    auto* column = new QVBoxLayout(this);
    column->addLayout(makeTopRow());
    column->addWidget(splitter_, 1);
    column->addWidget(status_);
    restore();

    auto* goUp = new QAction(this);
    goUp->setShortcut(QKeySequence("Alt+Up"));
    goUp->setShortcutContext(Qt::WidgetWithChildrenShortcut);
    addAction(goUp);
    connect(goUp, &QAction::triggered, up_, &QToolButton::click);
}

BrowserPage::~BrowserPage() { save(); }

QLayout* BrowserPage::makeTopRow() {
    auto* row = new QHBoxLayout;
    up_ = new QToolButton;
    up_->setObjectName("browserUp");
    up_->setIcon(QIcon::fromTheme("go-up"));
    up_->setText(tr("Up"));
    up_->setToolTip(tr("To the folder above (Alt+Up)"));
    up_->setAccessibleName(up_->toolTip());
    up_->setAutoRaise(true);
    connect(up_, &QToolButton::clicked, this, [this] {
        if (tree_->goUp() == 0) go(QFileInfo(folder_).path());
    });

    link_ = new qt::Link;
    link_->setObjectName("browserLink");
    link_->setFont(font());

    filter_ = new QComboBox;
    filter_->setObjectName("browserFilter");
    filter_->setEditable(true);
    filter_->addItems({"*", "*.txt", "*.pdf", "*.jpg", "*.[ch]*"});
    filter_->setAccessibleName(tr("Filter"));
    auto* caption = new QLabel(tr("&Filter:"));
    caption->setBuddy(filter_);
    const auto filterChosen = [this] { list(folder_); };
    connect(filter_, &QComboBox::textActivated, this, filterChosen);
    connect(filter_->lineEdit(), &QLineEdit::editingFinished, this, filterChosen);

    row->addWidget(up_);
    row->addWidget(link_, 1, Qt::AlignVCenter);
    row->addWidget(caption);
    row->addWidget(filter_);
    return row;
}

void BrowserPage::makePanes() {
    splitter_ = new QSplitter;
    splitter_->setChildrenCollapsible(false);
    tree_ = new qt::FolderView;
    tree_->setObjectName("browserTree");
    files_ = new qt::FileView;
    files_->setObjectName("browserFiles");
    splitter_->addWidget(tree_);
    splitter_->addWidget(files_);
    constexpr int treeWidth = 230, listWidth = 560;
    splitter_->setSizes({treeWidth, listWidth});
    splitter_->setStretchFactor(1, 1);
    status_ = new FileStatus(files_);
}

void BrowserPage::restore() {
    const QSettings state(stateFile_, QSettings::IniFormat);
    tree_->setBag(state.value("tree").toByteArray());
    files_->setBag(state.value("files").toByteArray());
    tree_->setFont(font());
    files_->setFont(font());
    constexpr int refreshEach = 2000;
    tree_->setRefreshInterval(refreshEach);
    tree_->setAutoFillSubFolders(true);
    tree_->setBorderStyle(qt::FolderView::FixedSingle);
    files_->setRefreshInterval(refreshEach);
    files_->setMultiSelect(true);
    files_->setFullRowSelect(true);
    files_->setLimitToRoot(false);
    splitter_->restoreState(state.value("splitter").toByteArray());
    filter_->setCurrentText(state.value("filter", "*").toString());
    folder_ = state.value("folder").toString();
    if (!QFileInfo(folder_).isDir()) folder_ = QDir::homePath();
    // A tree is built anew whenever it is shown, and begins at its root.
    connect(tree_, &qt::FolderView::beforePaint, this, [this] { rebuilt_ = true; });
    connect(tree_, &qt::FolderView::changedFolder, this, [this] {
        if (std::exchange(rebuilt_, false))
            QTimer::singleShot(0, this, [this] { go(folder_); });
        else if (!revealing_)
            list(tree_->path());
    });
    connect(files_, &qt::FileView::beforeAddItem, this, [this](bool& cancel, std::string&) { cancel = cancel || due_; });
    connect(files_, &qt::FileView::dblClick, this, &BrowserPage::enter);
    connect(files_, &qt::FileView::keyDown, this, [this](short& code, short& shift) {
        constexpr short enterKey = 13, backspaceKey = 8;
        if (shift == 0 && code == enterKey) enter();
        if (shift == 0 && code == backspaceKey) up_->click();
    });
    files_->setPath({});  // nothing before the tree stands
    tree_->setPathRoot("/");
}

void BrowserPage::save() const {
    QSettings state(stateFile_, QSettings::IniFormat);
    state.setValue("tree", tree_->bag());
    state.setValue("files", files_->bag());
    state.setValue("splitter", splitter_->saveState());
    state.setValue("filter", filter_->currentText());
    state.setValue("folder", folder_);
}

// Keeping both sides in step.

void BrowserPage::go(const QString& folder) {
    reveal(folder);
    list(folder);
}

void BrowserPage::list(const QString& folder) {
    folder_ = folder;
    link_->setCaption(folder);
    link_->setLinkTo(folder);
    link_->setToolTip(tr("Open %1 with the desktop").arg(folder));
    if (!due_ && !listing_) QTimer::singleShot(0, this, &BrowserPage::listNow);
    due_ = true;
}

void BrowserPage::listNow() {
    const QPointer<BrowserPage> alive = this;
    listing_ = true;
    while (alive && due_) {
        due_ = false;
        const QString pattern = filter_->currentText().trimmed();
        files_->setFilter(pattern == "*" ? QString() : pattern);
        files_->setPath(folder_);
        files_->setShowFolders(files_->showFolders());  // lists anew
    }
    if (alive) listing_ = false;
}

void BrowserPage::reveal(const QString& folder) {
    const QScopedValueRollback<bool> guard(revealing_, true);
    child::TreeView& tree = tree_->control().TreeFolders;
    const auto nodeOf = [&](const QString& path) -> child::TreeNodeRef {
        try {
            return tree.Nodes.Item(frame::Variant(qt::FromQt(path)));
        } catch (const frame::ControlError&) {
            return nullptr;  // no node has the key
        }
    };
    QStringList above;
    for (QString path = folder; path != "/" && !path.isEmpty(); path = QFileInfo(path).path()) above.prepend(path);
    above.prepend("/");
    for (const QString& path : above)
        if (const child::TreeNodeRef node = nodeOf(path)) {
            if (path != folder) node->SetExpanded(true);
            node->EnsureVisible();
            node->SetSelected(true);
        }
    tree_->setPath(folder);
}

void BrowserPage::enter() {
    constexpr int folderColumn = 6;
    if (files_->itemIndex() == 0) return;
    const auto item = files_->control().ListFiles.ListItems.Item(files_->itemIndex());
    const QString path = QDir(qt::ToQt(item->SubItems(folderColumn))).filePath(files_->itemName());
    // The list is in the midst of an event.
    QTimer::singleShot(0, this, [this, path] {
        if (QFileInfo(path).isDir())
            go(path);
        else if (!QDesktopServices::openUrl(QUrl::fromLocalFile(path)))
            emit said(tr("Nothing opens %1.").arg(path));
    });
}

void BrowserPage::pose(const QString& /*name*/) {
    if (!sample_) sample_ = MakeSample();
    tree_->setPathRoot(sample_->path());
    go(sample_->filePath("Photographs"));
    go(sample_->path());
    listNow();
    status_->waitForSize();
}

}  // namespace tessel::gallery
