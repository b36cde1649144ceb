#include "apps/gallery/ScoresPage.h"

#include <QCheckBox>
#include <QComboBox>
#include <QDoubleSpinBox>
#include <QEvent>
#include <QFormLayout>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QSignalBlocker>
#include <QSlider>
#include <QSpinBox>
#include <QTimer>
#include <QVBoxLayout>
#include <functional>
#include <span>

namespace tessel::gallery {

namespace {

using Style = qt::ScoreCard::tsScoreCardStyle;

struct Choice {
    int value;
    const char* text;
};
constexpr Choice styleChoices[] = {
    {qt::ScoreCard::ScoreCardSmall, QT_TRANSLATE_NOOP("ScoresPage", "Card")},
    {qt::ScoreCard::ScoreCardLarge, QT_TRANSLATE_NOOP("ScoresPage", "Large card")},
    {qt::ScoreCard::SmileySmall, QT_TRANSLATE_NOOP("ScoresPage", "Face")},
    {qt::ScoreCard::SmileyLarge, QT_TRANSLATE_NOOP("ScoresPage", "Large face")},
    {qt::ScoreCard::TrafficLightSmall, QT_TRANSLATE_NOOP("ScoresPage", "Light")},
    {qt::ScoreCard::TrafficLightLarge, QT_TRANSLATE_NOOP("ScoresPage", "Large light")},
    {qt::ScoreCard::WeatherSmall, QT_TRANSLATE_NOOP("ScoresPage", "Weather")},
    {qt::ScoreCard::WeatherLarge, QT_TRANSLATE_NOOP("ScoresPage", "Large weather")},
    {qt::ScoreCard::FlashCard, QT_TRANSLATE_NOOP("ScoresPage", "Flash card")},
    {qt::ScoreCard::Gauge, QT_TRANSLATE_NOOP("ScoresPage", "Gauge")},
    {qt::ScoreCard::GaugeOverrun, QT_TRANSLATE_NOOP("ScoresPage", "Gauge with overrun")},
    {qt::ScoreCard::GaugeRainbow, QT_TRANSLATE_NOOP("ScoresPage", "Gauge by value")},
};
constexpr Choice orientationChoices[] = {{qt::ScoreCard::Horizontal, QT_TRANSLATE_NOOP("ScoresPage", "Lying")},
                                         {qt::ScoreCard::Vertical, QT_TRANSLATE_NOOP("ScoresPage", "Standing")}};
constexpr Choice markerChoices[] = {{qt::ScoreCard::tsMarkerStyleNone, QT_TRANSLATE_NOOP("ScoresPage", "None")},
                                    {qt::ScoreCard::ShowLine, QT_TRANSLATE_NOOP("ScoresPage", "Line")},
                                    {qt::ScoreCard::ShowBar, QT_TRANSLATE_NOOP("ScoresPage", "Raised bar")},
                                    {qt::ScoreCard::ShowFlatBar, QT_TRANSLATE_NOOP("ScoresPage", "Flat bar")}};
constexpr Choice textChoices[] = {{qt::ScoreCard::tsShowValueNone, QT_TRANSLATE_NOOP("ScoresPage", "None")},
                                  {qt::ScoreCard::AtLeft, QT_TRANSLATE_NOOP("ScoresPage", "Left")},
                                  {qt::ScoreCard::AtMiddle, QT_TRANSLATE_NOOP("ScoresPage", "Middle")},
                                  {qt::ScoreCard::AtRight, QT_TRANSLATE_NOOP("ScoresPage", "Right")},
                                  {qt::ScoreCard::AtTop, QT_TRANSLATE_NOOP("ScoresPage", "Top")},
                                  {qt::ScoreCard::AtBottom, QT_TRANSLATE_NOOP("ScoresPage", "Bottom")},
                                  {qt::ScoreCard::Adjust, QT_TRANSLATE_NOOP("ScoresPage", "Where there is room")}};

constexpr int sliderSteps = 100;
constexpr QSize lyingGauge{320, 52}, standingGauge{52, 150};

}  // namespace

/// A threshold of the large score, by its name in every spelling.
struct ScoresPage::Threshold {
    const char* property;
    const char* text;
};

ScoresPage::ScoresPage(QWidget* parent) : Page(parent), timer_(new QTimer(this)) {
    auto* column = new QVBoxLayout(this);
    auto* top = new QHBoxLayout;
    top->addWidget(makeMachine(), 3);
    top->addWidget(makeStyles(), 2);
    column->addLayout(top, 1);
    column->addWidget(makeEditor(), 1);
    constexpr double firstScore = 0.65;
    constexpr int readEach = 2000;
    setScore(firstScore);
    timer_->setInterval(readEach);
    connect(timer_, &QTimer::timeout, this, [this] { showReadings(ReadMachine()); });
}

// This machine.

QWidget* ScoresPage::makeMachine() {
    auto* box = new QGroupBox(tr("How this machine does"));
    machine_ = new QGridLayout(box);
    machine_->setColumnStretch(2, 1);
    constexpr int lastRow = 100;
    machine_->setRowStretch(lastRow, 1);
    return box;
}

ScoresPage::Row ScoresPage::makeRow(Reading::Kind kind) {
    const Row row{kind, new QLabel, new qt::ScoreCard, new qt::ScoreCard, new QLabel};
    row.picture->setStyle(kind == Reading::Kind::Disk     ? qt::ScoreCard::SmileyLarge
                          : kind == Reading::Kind::Memory ? qt::ScoreCard::WeatherLarge
                                                          : qt::ScoreCard::TrafficLightLarge);
    row.picture->setBorderStyle(0);
    row.gauge->setStyle(qt::ScoreCard::GaugeRainbow);
    constexpr int blocks = 20, height = 26;
    row.gauge->setShowBlocks(blocks);
    row.gauge->setShowLimitLines(kind == Reading::Kind::Processor);
    row.gauge->setFixedHeight(height);
    row.gauge->setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Fixed);
    row.detail->setForegroundRole(QPalette::PlaceholderText);
    const int place = static_cast<int>(rows_.size());
    machine_->addWidget(row.picture, place, 0, Qt::AlignCenter);
    machine_->addWidget(row.name, place, 1);
    machine_->addWidget(row.gauge, place, 2);
    machine_->addWidget(row.detail, place, 3);
    return row;
}

void ScoresPage::showReadings(const QList<Reading>& readings) {
    const auto fits = [&](qsizetype i) { return i < readings.size() && rows_[i].kind == readings[i].kind; };
    while (!rows_.isEmpty() && !fits(rows_.size() - 1)) {
        const Row row = rows_.takeLast();
        for (QWidget* widget : {static_cast<QWidget*>(row.name), static_cast<QWidget*>(row.picture),
                                static_cast<QWidget*>(row.gauge), static_cast<QWidget*>(row.detail)})
            delete widget;
    }
    for (qsizetype i = 0; i < readings.size(); ++i) {
        const Reading& reading = readings[i];
        if (i == rows_.size()) rows_ << makeRow(reading.kind);
        const Row& row = rows_[i];
        row.name->setText(reading.name);
        row.detail->setText(reading.detail);
        for (qt::ScoreCard* card : {row.picture, row.gauge}) {
            card->setToolTip(reading.name);
            card->setValue(reading.score);
        }
    }
}

void ScoresPage::showEvent(QShowEvent* event) {
    Page::showEvent(event);
    if (rows_.isEmpty()) showReadings(ReadMachine());
    timer_->start();
}

void ScoresPage::hideEvent(QHideEvent* event) {
    Page::hideEvent(event);
    timer_->stop();
}

void ScoresPage::changeEvent(QEvent* event) {
    Page::changeEvent(event);
    if (event->type() == QEvent::PaletteChange) followPalette();
}

// Every style.

QWidget* ScoresPage::makeStyles() {
    auto* box = new QGroupBox(tr("One score in every style"));
    auto* grid = new QGridLayout(box);
    constexpr int columns = 2;
    int place = 0;
    for (const Choice& choice : styleChoices) {
        auto* card = new qt::ScoreCard;
        card->setStyle(static_cast<Style>(choice.value));
        card->setAccessibleName(tr(choice.text));
        constexpr int cardSide = 24;
        if (choice.value >= qt::ScoreCard::FlashCard && choice.value <= qt::ScoreCard::GaugeRainbow)
            card->setFixedSize(choice.value == qt::ScoreCard::FlashCard ? QSize(cardSide, cardSide)
                                                                        : QSize(2 * cardSide, cardSide));
        styles_ << card;
        auto* label = new QLabel(tr(choice.text));
        const int row = place / columns, column = place % columns * 2;
        grid->addWidget(card, row, column, Qt::AlignCenter);
        grid->addWidget(label, row, column + 1);
        ++place;
    }
    for (int column = 1; column < 2 * columns; column += 2) grid->setColumnStretch(column, 1);
    grid->setRowStretch(place / columns, 1);
    return box;
}

// The editor.

QWidget* ScoresPage::makeEditor() {
    auto* box = new QGroupBox(tr("Try it"));
    auto* row = new QHBoxLayout(box);
    large_ = new qt::ScoreCard;
    large_->setObjectName("large");
    large_->setAccessibleName(tr("Large score"));
    large_->setStyle(qt::ScoreCard::GaugeRainbow);
    fitLarge();
    slider_ = new QSlider(Qt::Horizontal);
    slider_->setObjectName("score");
    slider_->setAccessibleName(tr("Score"));
    slider_->setRange(-sliderSteps / 10, sliderSteps + sliderSteps / 10);
    slider_->setTickInterval(sliderSteps / 10);
    slider_->setTickPosition(QSlider::TicksBelow);
    connect(slider_, &QSlider::valueChanged, this, [this](int value) { setScore(static_cast<double>(value) / sliderSteps); });

    auto* left = new QVBoxLayout;
    auto* stage = new QWidget;
    auto* stageLayout = new QVBoxLayout(stage);
    stageLayout->addWidget(large_, 0, Qt::AlignCenter);
    left->addWidget(stage, 1);
    left->addWidget(slider_);
    auto* middle = new QFormLayout;
    addChoices(middle);
    auto* right = new QFormLayout;
    addNumbers(right);
    addThresholds(right);
    row->addLayout(left, 1);
    row->addLayout(middle);
    row->addLayout(right);
    return box;
}

void ScoresPage::addChoices(QFormLayout* form) {
    const auto add = [&](const char* name, const QString& text, std::span<const Choice> choices,
                         const std::function<void(int)>& choose) {
        auto* box = new QComboBox;
        box->setObjectName(name);
        for (const Choice& choice : choices) box->addItem(tr(choice.text), choice.value);
        box->setCurrentIndex(box->findData(large_->property(name).toInt()));
        connect(box, &QComboBox::currentIndexChanged, this, [box, choose] { choose(box->currentData().toInt()); });
        form->addRow(text, box);
    };
    add("style", tr("&Style:"), styleChoices, [this](int value) {
        large_->setStyle(static_cast<Style>(value));
        fitLarge();
        followPalette();
    });
    add("gaugeOrientation", tr("&Direction:"), orientationChoices, [this](int value) {
        large_->setGaugeOrientation(static_cast<qt::ScoreCard::tsGaugeOrientation>(value));
        fitLarge();
        followPalette();
    });
    add("showMarker", tr("&Marker:"), markerChoices,
        [this](int value) { large_->setShowMarker(static_cast<qt::ScoreCard::tsMarkerStyle>(value)); });
    add("showValue", tr("&Text:"), textChoices, [this](int value) {
        large_->setShowValue(static_cast<qt::ScoreCard::tsShowValue>(value));
        followPalette();
    });
}

/// A picture is as large as it is; all else gets a place of its own.
void ScoresPage::fitLarge() {
    const int style = large_->style();
    const bool isPicture = style < qt::ScoreCard::FlashCard || style > qt::ScoreCard::GaugeRainbow;
    const bool stands = style != qt::ScoreCard::FlashCard && large_->gaugeOrientation() == qt::ScoreCard::Vertical;
    const QSize place = stands ? standingGauge : lyingGauge;
    large_->setMinimumSize(isPicture ? QSize(0, 0) : place);
    large_->setMaximumSize(isPicture ? QSize(QWIDGETSIZE_MAX, QWIDGETSIZE_MAX) : place);
}

void ScoresPage::addNumbers(QFormLayout* form) {
    auto* blocks = new QSpinBox;
    blocks->setObjectName("showBlocks");
    blocks->setRange(0, 100);
    connect(blocks, &QSpinBox::valueChanged, large_, &qt::ScoreCard::setShowBlocks);
    form->addRow(tr("&Blocks:"), blocks);
    auto* ticks = new QDoubleSpinBox;
    ticks->setObjectName("showTickLinesEvery");
    constexpr double tickStep = 0.05;
    ticks->setRange(0, 1);
    ticks->setSingleStep(tickStep);
    connect(ticks, &QDoubleSpinBox::valueChanged, large_, [this](double value) { large_->setShowTickLinesEvery(value); });
    form->addRow(tr("Tick &every:"), ticks);
    auto* limits = new QCheckBox(tr("&Limit lines"));
    limits->setObjectName("showLimitLines");
    connect(limits, &QCheckBox::toggled, large_, &qt::ScoreCard::setShowLimitLines);
    form->addRow(QString(), limits);
}

void ScoresPage::addThresholds(QFormLayout* form) {
    static constexpr Threshold thresholds[] = {{"ScoreStar", QT_TR_NOOP("St&ar from:")},
                                               {"ScoreGood", QT_TR_NOOP("&Good from:")},
                                               {"ScoreMaybe", QT_TR_NOOP("Ma&ybe from:")},
                                               {"ScoreBad", QT_TR_NOOP("Bad f&rom:")}};
    constexpr double step = 0.05;
    for (const Threshold& threshold : thresholds) {
        auto* box = new QDoubleSpinBox;
        box->setObjectName(threshold.property);
        box->setRange(0, 1);
        box->setSingleStep(step);
        box->setKeyboardTracking(false);  // a number that is being typed is none yet
        box->setValue(large_->property(threshold.property).toDouble());
        connect(box, &QDoubleSpinBox::valueChanged, this, [this, box](double value) {
            large_->setProperty(box->objectName().toLatin1(), value);
            followThresholds();
        });
        thresholds_ << box;
        form->addRow(tr(threshold.text), box);
    }
}

/// The score keeps each threshold between its neighbours; the lowest shows when the score is set.
void ScoresPage::followThresholds() {
    for (QDoubleSpinBox* box : thresholds_) {
        const QSignalBlocker quiet(box);
        box->setValue(large_->property(box->objectName().toLatin1()).toDouble());
    }
    large_->setValue(large_->value());
    followPalette();
}

void ScoresPage::setScore(double score) {
    const QSignalBlocker quiet(slider_);
    slider_->setValue(qRound(score * sliderSteps));
    large_->setValue(score);
    followPalette();
    for (qt::ScoreCard* card : styles_) card->setValue(score);
}

/// The ticks cross the filled part and the empty one, and so may the text: one colour reads well on both where the gauge is filled
/// with a tint. In the colours of the grades it goes by where its middle stands.
void ScoresPage::followPalette() {
    if (!large_) return;
    const QColor base = palette().color(QPalette::Base), strong = palette().color(QPalette::Highlight);
    large_->setForeColor(
        QColor((base.red() + strong.red()) / 2, (base.green() + strong.green()) / 2, (base.blue() + strong.blue()) / 2));
    large_->setTickLineColor(palette().color(QPalette::PlaceholderText));
    const double score = large_->value().toDouble();
    const bool filled = large_->style() == qt::ScoreCard::GaugeRainbow && middleOfText() < score;
    const QColor inside = score < large_->scoreBad() ? Qt::white : Qt::black;
    large_->setFontColor(filled ? inside : palette().color(QPalette::WindowText));
}

/// Where the text's middle stands along the gauge: 0 where it begins to fill, 1 at its other end.
double ScoresPage::middleOfText() const {
    using Card = qt::ScoreCard;
    constexpr double middle = 0.5;
    const bool stands = large_->gaugeOrientation() == Card::Vertical;
    const auto begin = stands ? Card::AtBottom : Card::AtLeft, end = stands ? Card::AtTop : Card::AtRight;
    auto where = large_->showValue();
    if (where == Card::Adjust) where = large_->value().toDouble() < middle ? end : begin;
    const QFontMetrics metrics(large_->font());
    const double half =
        stands ? metrics.height() / 2.0 / large_->height() : metrics.horizontalAdvance("50%") / 2.0 / large_->width();
    return where == begin ? half : where == end ? 1 - half : middle;
}

// For pictures.

void ScoresPage::pose(const QString& name) {
    timer_->stop();
    showReadings(SampleReadings());
    const bool picture = name == "picture";
    constexpr double low = 0.31, high = 0.87;
    setScore(picture ? low : high);
    const auto choose = [this](const char* box, int value) {
        auto* combo = findChild<QComboBox*>(box);
        combo->setCurrentIndex(combo->findData(value));
    };
    choose("style", picture ? static_cast<int>(qt::ScoreCard::WeatherLarge) : static_cast<int>(qt::ScoreCard::GaugeRainbow));
    choose("showMarker", qt::ScoreCard::ShowFlatBar);
    choose("showValue", qt::ScoreCard::Adjust);
    constexpr int blocks = 10;
    constexpr double ticks = 0.05;
    findChild<QSpinBox*>("showBlocks")->setValue(blocks);
    findChild<QDoubleSpinBox*>("showTickLinesEvery")->setValue(ticks);
    findChild<QCheckBox*>("showLimitLines")->setChecked(true);
}

}  // namespace tessel::gallery
