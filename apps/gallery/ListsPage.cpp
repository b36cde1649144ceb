#include "apps/gallery/ListsPage.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFormLayout>
#include <QHBoxLayout>
#include <QLabel>
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
    auto* form = new QFormLayout;
    form->setFieldGrowthPolicy(QFormLayout::ExpandingFieldsGrow);
    countries_ = makeRow(form, tr("&Country:"), "countries");
    subdivisions_ = makeRow(form, tr("&Subdivision:"), "subdivisions");
    languages_ = makeRow(form, tr("&Language:"), "languages");
    column->addWidget(problem_);
    column->addLayout(form);
    column->addLayout(makeChoices());
    column->addStretch(1);
    connect(countries_.list, &qt::DataList::click, this, &ListsPage::fillSubdivisions);
    say(OpenIsoCodes(database_));
    fill();
}

ListsPage::~ListsPage() {
    const QString name = database_.connectionName();
    database_ = {};
    QSqlDatabase::removeDatabase(name);
}

ListsPage::Row ListsPage::makeRow(QFormLayout* form, const QString& caption, const char* name) {
    const Row row{new qt::DataList, new QLabel};
    row.list->setObjectName(name);
    row.list->setFont(font());
    row.list->setAccessibleName(QString(caption).remove('&').remove(':'));
    row.says->setTextInteractionFlags(Qt::TextSelectableByMouse);
    auto* line = new QVBoxLayout;
    line->addWidget(row.list);
    line->addWidget(row.says);
    auto* label = new QLabel(caption);
    label->setBuddy(row.list);
    form->addRow(label, line);
    connect(row.list, &qt::DataList::click, this, [this, row] { tell(row); });
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

void ListsPage::fill() {
    if (!database_.isOpen() || !problem_->text().isEmpty()) return;
    const int country = countries_.list->value(), subdivision = subdivisions_.list->value(), language = languages_.list->value();
    for (const Row& row : {countries_, subdivisions_, languages_}) {
        row.list->setStyle(static_cast<qt::DataList::DataListStyleConstants>(style_->currentIndex()));
        row.list->setLocked(locked_->isChecked());
        // Set even where it stays as it was: that shows what is locked. The items come anew.
        row.list->setSorted(sorted_->isChecked());
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
    if (!subdivisions_.list->populate(query, "name", "id", defaultText(), 0).isEmpty()) subdivisions_.list->clear();
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
    for (const Row& row : {countries_, subdivisions_, languages_}) tell(row);
}

}  // namespace tessel::gallery
