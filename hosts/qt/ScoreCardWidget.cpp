#include "hosts/qt/ScoreCardWidget.h"

#include <QAccessibleWidget>

#include "hosts/qt/Convert.h"

namespace tessel::qt {

using Style = controls::tsScoreCardStyle;

namespace {

bool IsGauge(Style style) { return style >= Style::Gauge && style <= Style::GaugeRainbow; }

}  // namespace

// What assistive programs see. Nothing that a saved state brought may throw at them: all is read by name, with errors reported.

class AccessibleScoreCard final : public QAccessibleWidget, public QAccessibleValueInterface {
  public:
    explicit AccessibleScoreCard(ScoreCardWidget& card) : QAccessibleWidget(&card), card_(card) {}

    QAccessible::Role role() const override {
        return IsGauge(card_.scoreCard().Style()) ? QAccessible::ProgressBar : QAccessible::Indicator;
    }
    QAccessible::State state() const override {
        QAccessible::State state = QAccessibleWidget::state();
        state.readOnly = true;
        return state;
    }
    QString text(QAccessible::Text kind) const override {
        if (kind == QAccessible::Name && card_.accessibleName().isEmpty()) return card_.get("ToolTip").toString();
        if (kind == QAccessible::Description && card_.accessibleDescription().isEmpty()) return card_.gradeWord();
        if (kind == QAccessible::Value) return card_.percent();
        return QAccessibleWidget::text(kind);
    }
    void* interface_cast(QAccessible::InterfaceType type) override {
        if (type == QAccessible::ValueInterface) return static_cast<QAccessibleValueInterface*>(this);
        return QAccessibleWidget::interface_cast(type);
    }

    QVariant currentValue() const override { return card_.get("Value").toDouble(); }
    void setCurrentValue(const QVariant&) override {}
    QVariant minimumValue() const override { return card_.get("ScoreMin").toDouble(); }
    QVariant maximumValue() const override { return card_.get("ScoreMax").toDouble(); }
    QVariant minimumStepSize() const override { return 0.0; }

    // The box that is drawn on is no part that is read again.
    int childCount() const override { return 0; }
    QAccessibleInterface* child(int) const override { return nullptr; }
    QAccessibleInterface* childAt(int, int) const override { return nullptr; }
    int indexOfChild(const QAccessibleInterface*) const override { return -1; }

  private:
    ScoreCardWidget& card_;
};

namespace {

QAccessibleInterface* MakeAccessibleScoreCard(const QString&, QObject* object) {
    auto* card = qobject_cast<ScoreCardWidget*>(object);
    return card ? new AccessibleScoreCard(*card) : nullptr;
}

}  // namespace

ScoreCardWidget::ScoreCardWidget(const frame::ControlClass& controlClass, QWidget* parent) : ControlWidget(controlClass, parent) {
    QAccessible::installFactory(MakeAccessibleScoreCard);
}

template <class F>
void ScoreCardWidget::read(F&& from) const {
    const controls::ScoreCard& card = scoreCard();
    frame::Entry::Run(
        host()->frameHost(), [&] { return card.Path() + ".Value"; }, [&] { from(card); });
}

QString ScoreCardWidget::gradeWord() const {
    static constexpr const char* words[] = {QT_TR_NOOP("very poor"), QT_TR_NOOP("poor"), QT_TR_NOOP("fair"), QT_TR_NOOP("good"),
                                            QT_TR_NOOP("excellent")};
    QString word;
    read([&](const controls::ScoreCard& card) { word = tr(words[card.Grade() - 1]); });
    return word;
}

QString ScoreCardWidget::percent() const {
    QString text;
    read([&](const controls::ScoreCard& card) { text = ToQt(controls::PercentText(card.Value())); });
    return text;
}

QSize ScoreCardWidget::along(QSize horizontal) const {
    const bool vertical = get("GaugeOrientation").toInt() == static_cast<int>(controls::tsGaugeOrientation::Vertical);
    return vertical ? horizontal.transposed() : horizontal;
}

QSize ScoreCardWidget::preferredSize() const {
    constexpr int letters = 24, lines = 1, margin = 8, cardSide = 48;
    if (IsGauge(scoreCard().Style())) return along(textArea(letters, lines) + QSize(0, margin));
    return {cardSide, cardSide};
}

QSize ScoreCardWidget::minimumSizeHint() const {
    constexpr int shortest = 32, thinnest = 8;
    if (!isSettled() || sizesItself()) return sizeHint();
    return IsGauge(scoreCard().Style()) ? along({shortest, thinnest}) : QSize(thinnest, thinnest);
}

bool ScoreCardWidget::sizesItself() const {
    const Style style = scoreCard().Style();
    return (style >= Style::ScoreCardSmall && style < Style::FlashCard) || style == Style::WeatherSmall || style == Style::WeatherLarge;
}

// A score is nothing to stop at on the way by the Tab key, unless a program wants its keys.
void ScoreCardWidget::started() {
    const Qt::FocusPolicy policy = focusPolicy();
    giveFocusTo(scoreCard().Picture1);
    setFocusPolicy(policy);
    told_ = gradeWord();
    updateGeometry();
}

void ScoreCardWidget::propertyChanged(std::string_view key) {
    if (isSettled()) tellAssistants(key == "Value");
    if (key == "Style" && isSettled() && !sizesItself()) takeWholePlace();
    if (key == "Style" || key == "GaugeOrientation" || key == "BorderStyle") updateGeometry();
    ControlWidget::propertyChanged(key);
}

// In a layout a picture may be smaller than the widget; another style takes all of it again.
void ScoreCardWidget::takeWholePlace() {
    frame::OwnSurface& surface = scoreCard().Surface();
    if (PixelRect(0, 0, surface.Width(), surface.Height()).size() == size()) return;
    surface.SetWidth(Twips(width()));
    surface.SetHeight(Twips(height()));
}

void ScoreCardWidget::tellAssistants(bool value) {
    if (value && QAccessible::isActive()) {
        QAccessibleValueChangeEvent changed(this, get("Value"));
        QAccessible::updateAccessibility(&changed);
    }
    const QString word = gradeWord();
    if (word == told_) return;
    told_ = word;
    QAccessibleEvent described(this, QAccessible::DescriptionChanged);
    QAccessible::updateAccessibility(&described);
}

}  // namespace tessel::qt
