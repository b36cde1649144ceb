#include "apps/gallery/LinksPage.h"

#include <QDir>
#include <QFile>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QStandardPaths>
#include <QVBoxLayout>

namespace tessel::gallery {

namespace {

/// A note to open and print; made when it is not there. An empty name when it cannot be.
QString WelcomeNote() {
    const QString folder = QStandardPaths::writableLocation(QStandardPaths::AppDataLocation);
    const QString name = folder + "/Welcome.txt";
    if (QFile::exists(name)) return name;
    QFile file(name);
    if (!QDir().mkpath(folder) || !file.open(QIODevice::WriteOnly)) return {};
    file.write("Welcome to the gallery of Tesselcontrols4.\n\nThis note was opened by a link.\n");
    return name;
}

QLabel* Caption(const QString& text) {
    auto* label = new QLabel(text);
    label->setAlignment(Qt::AlignRight | Qt::AlignVCenter);
    label->setForegroundRole(QPalette::PlaceholderText);
    return label;
}

void AddRow(QGridLayout* grid, const QString& what, QWidget* widget) {
    const int row = grid->rowCount();
    grid->addWidget(Caption(what), row, 0);
    grid->addWidget(widget, row, 1);
}

}  // namespace

LinksPage::LinksPage(QWidget* parent) : Page(parent) {
    auto* columns = new QGridLayout(this);
    columns->addWidget(makeTargets(), 0, 0);
    columns->addWidget(makeLooks(), 0, 1);
    columns->addWidget(makeLog(), 1, 0, 1, 2);
    columns->setColumnStretch(0, 1);
    columns->setColumnStretch(1, 1);
    columns->setRowStretch(1, 1);
}

qt::Link* LinksPage::makeLink(const QString& name, const QString& caption, const QString& target) {
    auto* link = new qt::Link(this);
    link->setObjectName(name);
    link->setFont(font());
    link->setCaption(caption);
    link->setLinkTo(target);
    link->setToolTip(target.isEmpty() ? caption : target);
    listen(link);
    links_ << link;
    return link;
}

QWidget* LinksPage::makeTargets() {
    auto* box = new QGroupBox(tr("What a link can lead to"));
    auto* grid = new QGridLayout(box);
    const QString note = WelcomeNote();
    AddRow(grid, tr("A file"), makeLink("fileLink", tr("Read the welcome note"), note));
    AddRow(grid, tr("A folder"), makeLink("folderLink", tr("Open your home folder"), QDir::homePath()));
    AddRow(grid, tr("A web address"), makeLink("webLink", tr("Visit Debian"), "https://www.debian.org/"));
    AddRow(grid, tr("Its own text"), makeLink("captionLink", "https://www.freedesktop.org/", {}));
    AddRow(grid, tr("An e-mail address"), makeLink("mailLink", tr("Write a letter"), "somebody@example.org"));
    auto* print = makeLink("printLink", tr("Print the welcome note"), note);
    print->setClickAction(qt::Link::Print_Link);
    AddRow(grid, tr("A printer"), print);
    AddRow(grid, tr("Nothing that exists"),
           makeLink("missingLink", tr("Open a file that is not there"), QDir::homePath() + "/no such file.txt"));
    grid->setRowStretch(grid->rowCount(), 1);
    grid->setColumnStretch(1, 1);
    return box;
}

QWidget* LinksPage::makeLooks() {
    auto* box = new QGroupBox(tr("How it can look"));
    auto* grid = new QGridLayout(box);

    auto* idle = makeLink("idleLink", tr("Changes colour, opens nothing"), {});
    idle->setClickAction(qt::Link::Do_nothing);
    AddRow(grid, tr("No action"), idle);

    auto* disabled = makeLink("disabledLink", tr("Cannot be used now"), "https://www.debian.org/");
    disabled->setEnabled(false);
    AddRow(grid, tr("Disabled"), disabled);

    auto* colours = makeLink("colouredLink", tr("Colours of its own"), "https://www.debian.org/");
    colours->setBackColor(QColor(0xFF, 0xF4, 0xCE));
    colours->setForeColor(QColor(0x8A, 0x4B, 0x00));
    colours->setHighlightColor(QColor(0xC4, 0x3E, 0x00));
    AddRow(grid, tr("Coloured"), colours);

    auto* framed = makeLink("framedLink", tr("Framed, and in the middle"), "https://www.debian.org/");
    framed->setBorderStyle(qt::Link::FixedSingle);
    framed->setAlignment(qt::Link::Center);
    AddRow(grid, tr("Framed"), framed);

    auto* large = makeLink("largeLink", tr("A bolder text"), "https://www.debian.org/");
    QFont bold = font();
    bold.setPointSizeF(bold.pointSizeF() * 1.6);
    bold.setBold(true);
    large->setFont(bold);
    AddRow(grid, tr("A font"), large);

    auto* hebrew = makeLink("hebrewLink", QString::fromUtf8("\xD7\xA9\xD7\x9C\xD7\x95\xD7\x9D, \xD7\xA2\xD7\x95\xD7\x9C\xD7\x9D!"),
                            "https://www.debian.org/");
    hebrew->setLayoutDirection(Qt::RightToLeft);
    AddRow(grid, tr("Right to left"), hebrew);

    auto* wrapped =
        makeLink("wrappedLink", tr("A long text that goes on in the next line where the place is too narrow for all of its words"),
                 "https://www.debian.org/");
    wrapped->setWordWrap(true);
    AddRow(grid, tr("Wrapped"), wrapped);

    grid->setRowStretch(grid->rowCount(), 1);
    grid->setColumnStretch(1, 1);
    return box;
}

QWidget* LinksPage::makeLog() {
    auto* box = new QGroupBox(tr("Events"));
    auto* column = new QVBoxLayout(box);
    log_ = new QPlainTextEdit;
    log_->setReadOnly(true);
    log_->setMaximumBlockCount(1000);
    log_->setPlaceholderText(tr("What the links tell their program: move over them, press them, use the keyboard."));
    column->addWidget(log_);
    return box;
}

void LinksPage::listen(qt::Link* link) {
    const auto say = [this, link](const QString& what) { log(link->objectName() + ": " + what); };
    connect(link, &qt::Link::mouseDown, this, [say](short& button, short& shift, float& x, float& y) {
        say(QString("MouseDown %1 %2 %3 %4").arg(button).arg(shift).arg(x).arg(y));
    });
    connect(link, &qt::Link::mouseUp, this, [say](short& button, short& shift, float& x, float& y) {
        say(QString("MouseUp %1 %2 %3 %4").arg(button).arg(shift).arg(x).arg(y));
    });
    connect(link, &qt::Link::click, this, [say] { say("Click"); });
    connect(link, &qt::Link::dblClick, this, [say] { say("DblClick"); });
}

void LinksPage::log(const QString& line) {
    if (log_) log_->appendPlainText(line);
}

void LinksPage::pose(const QString& /*name*/) {
    const auto find = [this](const char* name) { return findChild<qt::Link*>(name); };
    const auto visit = [](controls::Link& link, float x) { link.Label1.MouseMoveInput(0, 0, x, link.Label1.Height() / 2); };
    // One that was used, one under the pointer, one with the focus.
    auto& used = find("webLink")->control();
    find("webLink")->setClickAction(qt::Link::Do_nothing);
    used.Label1.MouseDownInput(1, 0, used.Label1.Width() / 2, used.Label1.Height() / 2);
    visit(used, 0);
    auto& hovered = find("folderLink")->control();
    visit(hovered, hovered.Label1.Width() / 2);
    find("captionLink")->setFocus(Qt::TabFocusReason);
}

}  // namespace tessel::gallery
