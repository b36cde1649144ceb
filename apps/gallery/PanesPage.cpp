#include "apps/gallery/PanesPage.h"

#include <QCalendarWidget>
#include <QComboBox>
#include <QEvent>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLocale>
#include <QPainter>
#include <QPlainTextEdit>
#include <QTableWidget>
#include <QVBoxLayout>
#include <algorithm>

#include "frame/Surface.h"
#include "hosts/qt/Host.h"

namespace tessel::gallery {

namespace {

constexpr int barPixels = 8, leastPane = 90;

struct Cost {
    const char* what;
    int amount;
};
constexpr Cost costs[] = {
    {QT_TRANSLATE_NOOP("PanesPage", "Hall"), 320},   {QT_TRANSLATE_NOOP("PanesPage", "Music"), 250},
    {QT_TRANSLATE_NOOP("PanesPage", "Food"), 410},   {QT_TRANSLATE_NOOP("PanesPage", "Flowers"), 75},
    {QT_TRANSLATE_NOOP("PanesPage", "Letters"), 48},
};

struct Look {
    const char* pose;
    qt::Splitter::tsAppearance appearance;
};
constexpr Look looks[] = {
    {"grooved", qt::Splitter::tsGrooved}, {"serrated", qt::Splitter::tsSerrated}, {"raised", qt::Splitter::tsRaised},
    {"sunken", qt::Splitter::tsSunken},   {"flat", qt::Splitter::tsFlat},         {"none", qt::Splitter::tsNone},
};

}  // namespace

/// The amounts of a table's second column as bars with the names of its first.
class PanesPage::Chart final : public QWidget {
  public:
    Chart(const QTableWidget* table, QWidget* parent) : QWidget(parent), table_(table) {
        connect(table, &QTableWidget::itemChanged, this, qOverload<>(&QWidget::update));
    }

  protected:
    void paintEvent(QPaintEvent*) override {
        QPainter painter(this);
        painter.fillRect(rect(), palette().color(QPalette::Base));
        const int rows = table_->rowCount();
        double most = 1;
        for (int row = 0; row < rows; ++row) most = std::max(most, amount(row));
        constexpr int gap = 6;
        const int text = fontMetrics().height(), floor = height() - text - gap, room = std::max(floor - text - 2 * gap, 1);
        for (int row = 0; row < rows; ++row) {
            const int from = width() * row / rows + gap, to = width() * (row + 1) / rows - gap;
            const int high = static_cast<int>(room * amount(row) / most);
            const QRect bar(from, floor - high, std::max(to - from, 1), high);
            painter.fillRect(bar, palette().color(QPalette::Highlight));
            painter.setPen(palette().color(QPalette::Text));
            painter.drawText(QRect(from, bar.top() - text, bar.width(), text), Qt::AlignCenter, cell(row, 1));
            const QString name = fontMetrics().elidedText(cell(row, 0), Qt::ElideRight, bar.width());
            painter.drawText(QRect(from, floor, bar.width(), text), Qt::AlignCenter, name);
        }
    }

  private:
    QString cell(int row, int column) const {
        const QTableWidgetItem* item = table_->item(row, column);
        return item ? item->text() : QString();
    }
    double amount(int row) const { return std::max(cell(row, 1).toDouble(), 0.0); }

    const QTableWidget* table_;
};

PanesPage::PanesPage(QWidget* parent) : Page(parent), area_(new QWidget) {
    auto* column = new QVBoxLayout(this);
    column->addWidget(makeChoices());
    column->addWidget(area_, 1);
    area_->setObjectName("panesArea");
    qt::Host::setForm(area_);
    area_->installEventFilter(this);
    makePanes();
    layOut();
}

QWidget* PanesPage::makeChoices() {
    auto* choices = new QWidget;
    auto* row = new QHBoxLayout(choices);
    row->setContentsMargins({});
    appearances_ = new QComboBox;
    appearances_->setObjectName("appearances");
    const QStringList names = {tr("Grooved"), tr("Serrated"), tr("Raised"), tr("Sunken"), tr("Flat"), tr("None")};
    for (int i = 0; i < names.size(); ++i) appearances_->addItem(names[i], QString(looks[i].pose));
    auto* caption = new QLabel(tr("&Bars:"));
    caption->setBuddy(appearances_);
    row->addWidget(caption);
    row->addWidget(appearances_);
    row->addStretch(1);
    connect(appearances_, &QComboBox::currentIndexChanged, this,
            [this] { chooseAppearance(appearances_->currentData().toString()); });
    return choices;
}

void PanesPage::makePanes() {
    calendar_ = new QCalendarWidget(area_);
    calendar_->setObjectName("calendar");
    calendar_->setMinimumSize(1, 1);
    notes_ = new QPlainTextEdit(area_);
    notes_->setObjectName("notes");
    costs_ = new QTableWidget(static_cast<int>(std::size(costs)), 2, area_);
    costs_->setObjectName("costs");
    costs_->setHorizontalHeaderLabels({tr("What"), tr("Amount")});
    costs_->horizontalHeader()->setSectionResizeMode(QHeaderView::Stretch);
    costs_->verticalHeader()->hide();
    for (int row = 0; row < costs_->rowCount(); ++row) {
        costs_->setItem(row, 0, new QTableWidgetItem(tr(costs[row].what)));
        auto* amount = new QTableWidgetItem;
        amount->setData(Qt::EditRole, costs[row].amount);
        costs_->setItem(row, 1, amount);
    }
    chart_ = new Chart(costs_, area_);
    chart_->setObjectName("chart");
    chart_->setAccessibleName(tr("Costs"));

    middle_ = makeBar("middleBar", qt::Splitter::tsVertical, "calendar, leftBar, chart", "notes, rightBar, costs");
    left_ = makeBar("leftBar", qt::Splitter::tsHorizontal, "calendar", "chart");
    right_ = makeBar("rightBar", qt::Splitter::tsHorizontal, "notes", "costs");
    middle_->setAccessibleName(tr("Between left and right"));
    left_->setAccessibleName(tr("Between calendar and chart"));
    right_->setAccessibleName(tr("Between notes and costs"));
    connect(calendar_, &QCalendarWidget::selectionChanged, this, &PanesPage::chooseDay);
    chooseDay();
}

qt::Splitter* PanesPage::makeBar(const char* name, qt::Splitter::tsOrientation orientation, const QString& before,
                                 const QString& behind) {
    constexpr double least = leastPane * static_cast<double>(frame::twipsPerPixel);
    auto* bar = new qt::Splitter(area_);
    bar->setObjectName(name);
    bar->setOrientation(orientation);
    bar->setControlsTopLeft(before);
    bar->setControlsBottomRight(behind);
    bar->setMinTopLeft(least);
    bar->setMinBottomRight(least);
    connect(bar, &qt::Splitter::afterMove, this, [this] { keepParts(); });
    return bar;
}

bool PanesPage::eventFilter(QObject* watched, QEvent* event) {
    if (watched == area_ && event->type() == QEvent::Resize) layOut();
    return Page::eventFilter(watched, event);
}

void PanesPage::layOut() {
    if (!right_) return;
    const auto part = [](int whole, double share) {
        const int last = std::max(whole - leastPane - barPixels, leastPane);
        return std::clamp(static_cast<int>(whole * share + 0.5), leastPane, last);
    };
    const int width = area_->width(), height = area_->height();
    const int middle = part(width, middlePart_), behind = middle + barPixels, rest = std::max(width - behind, 0);
    middle_->setGeometry(middle, 0, barPixels, height);
    const auto column = [&](int x, int wide, double share, QWidget* above, QWidget* bar, QWidget* below) {
        const int top = part(height, share), next = top + barPixels;
        above->setGeometry(x, 0, wide, top);
        bar->setGeometry(x, top, wide, barPixels);
        below->setGeometry(x, next, wide, std::max(height - next, 0));
    };
    column(0, middle, leftPart_, calendar_, left_, chart_);
    column(behind, rest, rightPart_, notes_, right_, costs_);
}

void PanesPage::keepParts() {
    if (area_->width() == 0 || area_->height() == 0) return;
    middlePart_ = static_cast<double>(middle_->x()) / area_->width();
    leftPart_ = static_cast<double>(left_->y()) / area_->height();
    rightPart_ = static_cast<double>(right_->y()) / area_->height();
}

void PanesPage::chooseDay() {
    if (day_.isValid()) notesOfDays_[day_] = notes_->toPlainText();
    day_ = calendar_->selectedDate();
    notes_->setPlainText(notesOfDays_.value(day_));
    notes_->setPlaceholderText(tr("Notes for %1").arg(QLocale().toString(day_, QLocale::LongFormat)));
}

void PanesPage::chooseAppearance(const QString& name) {
    for (const Look& look : looks)
        if (name == look.pose)
            for (qt::Splitter* bar : {middle_, left_, right_}) bar->setAppearance(look.appearance);
}

// For pictures.

void PanesPage::pose(const QString& name) {
    calendar_->setSelectedDate(QDate(2001, 2, 3));
    notes_->setPlainText(tr("Summer party\n\n- ask for the hall\n- the band wants an answer by Friday\n- letters to all members"));
    appearances_->setCurrentIndex(appearances_->findData(name));
    middlePart_ = name == "serrated" ? 0.6 : 0.42;
    leftPart_ = 0.55;
    rightPart_ = name == "raised" ? 0.65 : 0.45;
    layOut();
    if (name == "raised") middle_->setFocus(Qt::TabFocusReason);
    auto& surface = right_->control().Surface();
    if (name == "serrated")
        surface.MouseMoveInput(0, 0, surface.Width() / 2, surface.Height() / 2);
    else
        surface.MouseMoveInput(0, 0, 0, 0);
}

}  // namespace tessel::gallery
