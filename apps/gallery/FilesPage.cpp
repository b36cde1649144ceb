#include "apps/gallery/FilesPage.h"

#include <QAction>
#include <QButtonGroup>
#include <QCheckBox>
#include <QComboBox>
#include <QDesktopServices>
#include <QDir>
#include <QFileInfo>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPointer>
#include <QTemporaryDir>
#include <QTimer>
#include <QToolButton>
#include <QUrl>
#include <QVBoxLayout>

#include "apps/gallery/FileStatus.h"
#include "apps/gallery/Sample.h"
#include "hosts/qt/Convert.h"

namespace tessel::gallery {

namespace {

using View = qt::FileView::ListViewConstants;

struct ViewChoice {
    View view;
    const char *icon, *text, *tip, *keys;
};
constexpr ViewChoice viewChoices[] = {
    {View::Report, "view-list-details", QT_TRANSLATE_NOOP("FilesPage", "Details"), QT_TRANSLATE_NOOP("FilesPage", "Details"),
     "Ctrl+1"},
    {View::List, "view-list-text", QT_TRANSLATE_NOOP("FilesPage", "List"), QT_TRANSLATE_NOOP("FilesPage", "List"), "Ctrl+2"},
    {View::SmallIcon, "view-list-icons", QT_TRANSLATE_NOOP("FilesPage", "Small"), QT_TRANSLATE_NOOP("FilesPage", "Small icons"),
     "Ctrl+3"},
    {View::Icon, "view-grid", QT_TRANSLATE_NOOP("FilesPage", "Large"), QT_TRANSLATE_NOOP("FilesPage", "Large icons"), "Ctrl+4"},
};

/// A button with a theme's icon, or a word where the theme has none.
QToolButton* Button(const char* name, const char* icon, const QString& text, const QString& tip) {
    auto* button = new QToolButton;
    button->setObjectName(name);
    button->setIcon(QIcon::fromTheme(icon));
    button->setText(text);
    button->setToolTip(tip);
    button->setAccessibleName(tip);
    button->setAutoRaise(true);
    return button;
}

}  // namespace

FilesPage::FilesPage(QWidget* parent) : Page(parent) {
    makeList();
    auto* column = new QVBoxLayout(this);
    column->addLayout(makePathRow());
    column->addLayout(makeFilterRow());
    column->addWidget(files_, 1);
    column->addWidget(status_);
    makeKeys();
    files_->setPathRoot("/");
    files_->setPath(QDir::homePath());  // listed when it is shown
    followPath();
}

FilesPage::~FilesPage() = default;

QLayout* FilesPage::makePathRow() {
    auto* row = new QHBoxLayout;
    up_ = Button("up", "go-up", tr("Up"), tr("To the folder above (Alt+Up)"));
    path_ = new QLineEdit;
    path_->setObjectName("path");
    path_->setAccessibleName(tr("Folder"));
    auto* home = Button("home", "go-home", tr("Home"), tr("To your home folder (Alt+Home)"));
    row->addWidget(up_);
    row->addWidget(home);
    row->addWidget(path_, 1);
    idleOnly_ << up_ << home << path_;
    connect(up_, &QToolButton::clicked, this, &FilesPage::goUp);
    connect(home, &QToolButton::clicked, this, [this] { go(QDir::homePath()); });
    connect(path_, &QLineEdit::returnPressed, this, [this] { go(path_->text()); });
    return row;
}

QLayout* FilesPage::makeFilterRow() {
    auto* row = new QHBoxLayout;
    filter_ = new QComboBox;
    filter_->setObjectName("filter");
    filter_->setEditable(true);
    filter_->addItems({"*", "*.txt", "*.pdf", "*.jpg", "*.[ch]*"});
    filter_->setAccessibleName(tr("Filter"));
    filter_->setToolTip(tr("Names to show: * is any text, ? one letter, # one digit, [a-z] one of these"));
    auto* caption = new QLabel(tr("&Filter:"));
    caption->setBuddy(filter_);
    hidden_ = new QCheckBox(tr("&Hidden"));
    hidden_->setObjectName("hidden");
    hidden_->setToolTip(tr("Show hidden files and folders too"));
    row->addWidget(caption);
    row->addWidget(filter_);
    row->addWidget(hidden_);
    row->addStretch(1);

    views_ = new QButtonGroup(this);
    for (const ViewChoice& choice : viewChoices) {
        QToolButton* button = Button(choice.icon, choice.icon, tr(choice.text), tr("%1 (%2)").arg(tr(choice.tip), choice.keys));
        button->setShortcut(QKeySequence(choice.keys));
        button->setCheckable(true);
        button->setChecked(choice.view == files_->view());
        views_->addButton(button, choice.view);
        row->addWidget(button);
    }
    row->addStretch(1);

    search_ = new QLineEdit;
    search_->setObjectName("search");
    search_->setPlaceholderText(tr("Search here and below"));
    search_->setClearButtonEnabled(true);
    constexpr int lettersWide = 28;
    search_->setMinimumWidth(lettersWide * fontMetrics().averageCharWidth());
    search_->setAccessibleName(tr("Search"));
    find_ = Button("find", "edit-find", tr("Search"), tr("Search"));
    row->addWidget(search_);
    row->addWidget(find_);

    idleOnly_ << filter_ << hidden_ << search_;
    connect(filter_, &QComboBox::textActivated, this, &FilesPage::list);
    connect(filter_->lineEdit(), &QLineEdit::returnPressed, this, &FilesPage::list);
    connect(hidden_, &QCheckBox::toggled, this, &FilesPage::list);
    connect(views_, &QButtonGroup::idClicked, this, &FilesPage::chooseView);
    connect(search_, &QLineEdit::returnPressed, this, &FilesPage::find);
    connect(search_, &QLineEdit::textChanged, this, [this](const QString& text) {
        if (text.isEmpty() && shows_ == Shows::Results) list();
    });
    connect(find_, &QToolButton::clicked, this, [this] {
        if (filling_)
            stopped_ = true;
        else
            find();
    });
    return row;
}

void FilesPage::makeList() {
    files_ = new qt::FileView;
    files_->setObjectName("files");
    files_->setFont(font());
    files_->setMultiSelect(true);
    files_->setFullRowSelect(true);
    files_->setAllowColumnReorder(true);
    files_->setLimitToRoot(false);
    constexpr int refreshEach = 2000;
    files_->setRefreshInterval(refreshEach);
    connect(files_, &qt::FileView::beforeAddItem, this, [this](bool& cancel, std::string&) { cancel = cancel || stopped_; });
    connect(files_, &qt::FileView::afterPaint, this, &FilesPage::followPath);
    connect(files_, &qt::FileView::dblClick, this, &FilesPage::enter);
    status_ = new FileStatus(files_);
}

void FilesPage::makeKeys() {
    const auto key = [this](const char* keys, const std::function<void()>& run) {
        auto* action = new QAction(this);
        action->setShortcut(QKeySequence(keys));
        action->setShortcutContext(Qt::WidgetWithChildrenShortcut);
        addAction(action);
        connect(action, &QAction::triggered, this, run);
    };
    // The list's own keys come as its events. What they start runs when the event is over.
    connect(files_, &qt::FileView::keyDown, this, [this](short& code, short& shift) {
        constexpr short enterKey = 13, backspaceKey = 8;
        if (shift == 0 && code == enterKey) QTimer::singleShot(0, this, &FilesPage::enter);
        if (shift == 0 && code == backspaceKey) QTimer::singleShot(0, this, &FilesPage::goUp);
    });
    key("Alt+Up", [this] { goUp(); });
    key("Alt+Home", [this] { go(QDir::homePath()); });
    key("F5", [this] { list(); });
    key("Ctrl+L", [this] {
        path_->setFocus(Qt::ShortcutFocusReason);
        path_->selectAll();
    });
    key("Ctrl+F", [this] { search_->setFocus(Qt::ShortcutFocusReason); });
    key("Escape", [this] { stopped_ = filling_; });
}

// Showing folders.

void FilesPage::go(const QString& folder) {
    if (filling_) return;
    files_->setPath(folder);
    list();
}

void FilesPage::goUp() {
    if (filling_) return;
    if (shows_ == Shows::Results) return list();
    fill(Shows::Folder, [this] { files_->goUp(); });
}

void FilesPage::list() {
    if (filling_) return;
    if (files_->path().isEmpty()) files_->setPath(folder_);
    const QString pattern = filter_->currentText().trimmed();
    files_->setFilter(pattern == "*" ? QString() : pattern);
    files_->setAllowHiddenFiles(hidden_->isChecked());
    fill(Shows::Folder, [this] { files_->setShowFolders(files_->showFolders()); });
}

void FilesPage::enter() {
    if (filling_ || files_->itemIndex() == 0) return;
    const QString path = fullPathOfItem();
    if (QFileInfo(path).isDir())
        go(path);
    else if (!QDesktopServices::openUrl(QUrl::fromLocalFile(path)))
        emit said(tr("Nothing opens %1.").arg(path));
}

void FilesPage::find() {
    QString pattern = search_->text().trimmed();
    if (filling_ || pattern.isEmpty()) return;
    if (!pattern.contains('*') && !pattern.contains('?') && !pattern.contains('[')) pattern = '*' + pattern + '*';
    fill(Shows::Results, [this, pattern] { files_->search(pattern, folder_, true); });
    if (stopped_) emit said(tr("The search was stopped."));
}

void FilesPage::fill(Shows what, const std::function<void()>& run) {
    const QPointer<FilesPage> alive = this;
    shows_ = what;
    filling_ = true;
    stopped_ = false;
    for (QWidget* widget : idleOnly_) widget->setEnabled(false);
    find_->setIcon(QIcon::fromTheme("process-stop"));
    find_->setText(tr("Stop"));
    find_->setToolTip(tr("Stop (Esc)"));
    status_->setSearched(what == Shows::Results ? folder_ : QString());
    run();
    if (!alive) return;
    filling_ = false;
    for (QWidget* widget : idleOnly_) widget->setEnabled(true);
    find_->setIcon(QIcon::fromTheme("edit-find"));
    find_->setText(tr("Search"));
    find_->setToolTip(tr("Search"));
    followPath();
    files_->setFocus();
}

void FilesPage::chooseView(int view) {
    files_->setView(static_cast<View>(view));
    if (QAbstractButton* button = views_->button(view)) button->setChecked(true);
    files_->setFocus();
}

QString FilesPage::fullPathOfItem() const {
    constexpr int folderColumn = 6;
    const controls::FileView& view = files_->control();
    const auto item = view.ListFiles.ListItems.Item(view.ItemIndex());
    const QString folder = qt::ToQt(item->SubItems(folderColumn)), name = files_->itemName();
    return folder.isEmpty() ? name : QDir(folder).filePath(name);
}

// What stands around the list.

void FilesPage::followPath() {
    if (!files_->path().isEmpty()) folder_ = files_->path();
    path_->setText(folder_);
    up_->setEnabled(!filling_ && (shows_ == Shows::Results || folder_ != files_->pathRoot()));
}

// For pictures.

void FilesPage::pose(const QString& name) {
    if (!sample_) sample_ = MakeSample();
    search_->clear();
    chooseView(name == "icons" ? View::Icon : View::Report);
    go(sample_->path());
    if (name == "search") {
        search_->setText("*.jpg");
        find();
    }
    files_->setItemIndex(1);
    files_->setItemSelected(true);
    status_->waitForSize();
}

}  // namespace tessel::gallery
