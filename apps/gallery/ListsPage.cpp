#include "apps/gallery/ListsPage.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QPlainTextEdit>
#include <QSqlError>
#include <QSqlQuery>
#include <QVBoxLayout>

#include "apps/gallery/IsoCodes.h"

namespace tessel::gallery {

ListsPage::ListsPage(QWidget* parent) : Page(parent) {
    auto* column = new QVBoxLayout(this);
    problem_ = new QLabel;
    problem_->setObjectName("problem");
    problem_->setWordWrap(true);
    problem_->hide();
    column->addWidget(problem_);
    column->addWidget(makeLists());
    column->addWidget(makeLog(), 1);
    connect(countries_.list, &qt::DataList::click, this, &ListsPage::fillSubdivisions);
    say(OpenIsoCodes(database_));
    fill();
}

ListsPage::~ListsPage() {
    const QString name = database_.connectionName();
    database_ = {};
    QSqlDatabase::removeDatabase(name);
}

QWidget* ListsPage::makeLists() {
    auto* box = new QGroupBox(tr("Pairs from a database"));
    auto* column = new QVBoxLayout(box);
    auto* grid = new QGridLayout;
    constexpr int listColumn = 1, saysColumn = 2;
    grid->setColumnStretch(listColumn, 1);
    grid->setColumnStretch(saysColumn, 1);
    countries_ = makeRow(grid, tr("&Country:"), "countries");
    subdivisions_ = makeRow(grid, tr("&Subdivision:"), "subdivisions");
    languages_ = makeRow(grid, tr("&Language:"), "languages");
    column->addLayout(grid);
    column->addLayout(makeChoices());
    return box;
}

ListsPage::Row ListsPage::makeRow(QGridLayout* grid, const QString& caption, const char* name) {
    const Row row{new QLabel(caption), new qt::DataList, new QLabel};
    row.list->setObjectName(name);
    row.list->setFont(font());
    row.list->setAccessibleName(QString(caption).remove('&').remove(':'));
    row.says->setTextInteractionFlags(Qt::TextSelectableByMouse);
    row.says->setForegroundRole(QPalette::PlaceholderText);
    row.list->setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Fixed);
    row.caption->setBuddy(row.list);
    const int place = grid->rowCount();
    grid->addWidget(row.caption, place, 0);
    grid->addWidget(row.list, place, 1);
    grid->addWidget(row.says, place, 2);
    connect(row.list, &qt::DataList::click, this, [this, row] { tell(row); });
    listen(row.list);
    return row;
}

QLayout* ListsPage::makeChoices() {
    auto* line = new QHBoxLayout;
    sorted_ = new QCheckBox(tr("S&orted"));
    sorted_->setObjectName("sorted");
    sorted_->setChecked(true);
    locked_ = new QCheckBox(tr("Loc&ked"));
    locked_->setObjectName("locked");
    defaults_ = new QCheckBox(tr("&Default pair"));
    defaults_->setObjectName("defaults");
    defaults_->setChecked(true);
    style_ = new QComboBox;
    style_->setObjectName("style");
    style_->addItems({tr("Text only"), tr("Number and text"), tr("Count and text")});
    style_->setAccessibleName(tr("Style"));
    for (QWidget* choice : {static_cast<QWidget*>(sorted_), static_cast<QWidget*>(locked_), static_cast<QWidget*>(defaults_),
                            static_cast<QWidget*>(style_)})
        line->addWidget(choice);
    line->addStretch(1);
    connect(sorted_, &QCheckBox::toggled, this, &ListsPage::fill);
    connect(locked_, &QCheckBox::toggled, this, &ListsPage::fill);
    connect(defaults_, &QCheckBox::toggled, this, &ListsPage::fill);
    connect(style_, &QComboBox::activated, this, &ListsPage::fill);
    return line;
}

QWidget* ListsPage::makeLog() {
    auto* box = new QGroupBox(tr("Events"));
    auto* column = new QVBoxLayout(box);
    constexpr int mostLines = 1000;
    log_ = new QPlainTextEdit;
    log_->setReadOnly(true);
    log_->setMaximumBlockCount(mostLines);
    log_->setPlaceholderText(tr("What the lists tell their program: open one, type, choose."));
    column->addWidget(log_);
    return box;
}

void ListsPage::listen(qt::DataList* list) {
    connect(list, &qt::DataList::click, this, [this, list] { log(list->objectName() + ": Click"); });
    connect(list, &qt::DataList::dblClick, this, [this, list] { log(list->objectName() + ": DblClick"); });
    connect(list, &qt::DataList::keyDown, this, [this, list](short& code, short& shift) {
        log(QString("%1: KeyDown %2 %3").arg(list->objectName()).arg(code).arg(shift));
    });
}

void ListsPage::log(const QString& line) {
    if (log_) log_->appendPlainText(line);
}

void ListsPage::fill() {
    if (!database_.isOpen() || !problem_->text().isEmpty()) return;
    const int country = countries_.list->value(), subdivision = subdivisions_.list->value(), language = languages_.list->value();
    for (const Row& row : {countries_, subdivisions_, languages_}) {
        row.list->setStyle(static_cast<qt::DataList::DataListStyleConstants>(style_->currentIndex()));
        row.list->setLocked(locked_->isChecked());
        // Set even where it stays as it was: that shows what is locked. The items come anew.
        row.list->setSorted(sorted_->isChecked());
        // The label of a locked list has its text at the top.
        for (QLabel* label : {row.caption, row.says})
            label->setAlignment(Qt::AlignLeading | (locked_->isChecked() ? Qt::AlignTop : Qt::AlignVCenter));
    }
    say(countries_.list->populate("countries", database_, "name", "id", defaultText(), 0));
    say(languages_.list->populate("languages", database_, "name", "id", defaultText(), 0));
    countries_.list->setValue(country);
    languages_.list->setValue(language);
    fillSubdivisions();
    subdivisions_.list->setValue(subdivision);
    for (const Row& row : {countries_, subdivisions_, languages_}) tell(row);
}

QVariant ListsPage::defaultText() const { return defaults_->isChecked() ? QVariant(tr("(all)")) : QVariant(); }

void ListsPage::fillSubdivisions() {
    const int country = countries_.list->value();
    QSqlQuery query(database_);
    query.prepare(country == 0 ? "SELECT id, name FROM subdivisions" : "SELECT id, name FROM subdivisions WHERE country = ?");
    if (country != 0) query.addBindValue(country);
    if (!subdivisions_.list->populate(query, "name", "id", defaultText(), 0).isEmpty()) {
        // A country without any, or the database's own words.
        if (query.lastError().isValid()) say(query.lastError().text());
        subdivisions_.list->clear();
        if (defaults_->isChecked()) subdivisions_.list->addItem(defaultText(), 0);
        subdivisions_.list->setValue(0);
    }
    tell(subdivisions_);
}

void ListsPage::tell(const Row& row) {
    const auto items = row.list->control().listItems[row.list->sorted() ? 1 : 0].ListCount();
    row.says->setText(tr("Value %1, text \"%2\", of %L3 items").arg(row.list->value()).arg(row.list->text()).arg(items));
}

void ListsPage::say(const QString& problem) {
    if (problem.isEmpty()) return;
    problem_->setText(problem);
    problem_->show();
}

void ListsPage::pose(const QString& name) {
    constexpr int portugal = 620, firstLanguage = 1;
    locked_->setChecked(false);
    countries_.list->setValue(portugal);
    fillSubdivisions();
    languages_.list->setValue(firstLanguage);
    locked_->setChecked(name == "locked");
    log_->clear();
    for (const Row& row : {countries_, subdivisions_, languages_}) tell(row);
}

}  // namespace tessel::gallery
