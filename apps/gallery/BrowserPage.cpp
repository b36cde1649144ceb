#include "apps/gallery/BrowserPage.h"

#include <QAction>
#include <QDesktopServices>
#include <QDir>
#include <QEvent>
#include <QFileInfo>
#include <QHBoxLayout>
#include <QLabel>
#include <QPointer>
#include <QScopedValueRollback>
#include <QSettings>
#include <QStandardPaths>
#include <QTemporaryDir>
#include <QTimer>
#include <QToolButton>
#include <QUrl>
#include <QVBoxLayout>
#include <algorithm>

#include "apps/gallery/FileStatus.h"
#include "apps/gallery/Sample.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/Host.h"

namespace tessel::gallery {

namespace {

constexpr int barWidth = 8, leastPane = 120;

struct Filter {
    const char* text;
    const char* pattern;
};
/// In the order of their values in the list.
constexpr Filter filters[] = {
    {QT_TRANSLATE_NOOP("BrowserPage", "Everything"), ""},
    {QT_TRANSLATE_NOOP("BrowserPage", "Texts (*.txt)"), "*.txt"},
    {QT_TRANSLATE_NOOP("BrowserPage", "Documents (*.pdf)"), "*.pdf"},
    {QT_TRANSLATE_NOOP("BrowserPage", "Photographs (*.jpg)"), "*.jpg"},
    {QT_TRANSLATE_NOOP("BrowserPage", "Sources (*.[ch]*)"), "*.[ch]*"},
};

QString PatternOf(int value) {
    return value >= 0 && value < static_cast<int>(std::size(filters)) ? filters[value].pattern : QString();
}

}  // namespace

BrowserPage::BrowserPage(const QString& stateFile, QWidget* parent) : Page(parent), stateFile_(stateFile) {
    if (stateFile_.isEmpty()) stateFile_ = QStandardPaths::writableLocation(QStandardPaths::AppConfigLocation) + "/browser.ini";
    makePanes();
    auto* column = new QVBoxLayout(this);
    column->addLayout(makeTopRow());
    column->addWidget(area_, 1);
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

    filter_ = new qt::DataList;
    filter_->setObjectName("browserFilter");
    filter_->setFont(font());
    filter_->setAccessibleName(tr("Filter"));
    for (int value = 0; value < static_cast<int>(std::size(filters)); ++value) filter_->addItem(tr(filters[value].text), value);
    auto* caption = new QLabel(tr("&Filter:"));
    caption->setBuddy(filter_);

    row->addWidget(up_);
    row->addWidget(link_, 1, Qt::AlignVCenter);
    row->addWidget(caption);
    row->addWidget(filter_);
    return row;
}

void BrowserPage::makePanes() {
    area_ = new QWidget;
    area_->setObjectName("browserArea");
    qt::Host::setForm(area_);
    area_->installEventFilter(this);
    tree_ = new qt::FolderView(area_);
    tree_->setObjectName("browserTree");
    bar_ = new qt::Splitter(area_);
    bar_->setObjectName("browserBar");
    bar_->setAccessibleName(tr("Between folders and files"));
    bar_->setOrientation(qt::Splitter::tsVertical);
    constexpr double least = leastPane * static_cast<double>(frame::twipsPerPixel);
    bar_->setMinTopLeft(least);
    bar_->setMinBottomRight(least);
    files_ = new qt::FileView(area_);
    files_->setObjectName("browserFiles");
    connect(bar_, &qt::Splitter::afterMove, this, [this] { treeWidth_ = tree_->width(); });
    status_ = new FileStatus(files_);
}

bool BrowserPage::eventFilter(QObject* watched, QEvent* event) {
    if (watched == area_ && (event->type() == QEvent::Resize || event->type() == QEvent::LayoutDirectionChange)) layOut();
    return Page::eventFilter(watched, event);
}

void BrowserPage::layOut() {
    const bool mirrored = area_->layoutDirection() == Qt::RightToLeft;
    QWidget* const first = mirrored ? static_cast<QWidget*>(files_) : tree_;
    QWidget* const second = mirrored ? static_cast<QWidget*>(tree_) : files_;
    const int width = area_->width(), height = area_->height();
    const int tree = std::clamp(treeWidth_, leastPane, std::max(width - leastPane - barWidth, leastPane));
    const int at = mirrored ? std::max(width - tree - barWidth, 0) : tree;
    bar_->setControlsTopLeft(first->objectName());
    bar_->setControlsBottomRight(second->objectName());
    first->setGeometry(0, 0, at, height);
    bar_->setGeometry(at, 0, barWidth, height);
    second->setGeometry(at + barWidth, 0, std::max(width - at - barWidth, 0), height);
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
    treeWidth_ = state.value("treeWidth", treeWidth_).toInt();
    filter_->setValue(state.value("filter").toInt());
    connect(filter_, &qt::DataList::click, this, [this] { list(folder_); });
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
    state.setValue("treeWidth", treeWidth_);
    state.setValue("filter", filter_->value());
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
        files_->setFilter(PatternOf(filter_->value()));
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
