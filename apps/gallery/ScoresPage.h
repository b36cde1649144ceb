#pragma once

#include "apps/gallery/Page.h"
#include "apps/gallery/Readings.h"
#include "hosts/qt/ScoreCard.h"

class QDoubleSpinBox;
class QFormLayout;
class QGridLayout;
class QLabel;
class QSlider;
class QTimer;

namespace tessel::gallery {

/// How this machine does, one score in every style, and a gauge to play with.
class ScoresPage final : public Page {
    Q_OBJECT

  public:
    explicit ScoresPage(QWidget* parent = nullptr);

    QString title() const override { return "Scores"; }
    QString hint() const override { return tr("Move the slider: every style follows it."); }
    QStringList poses() const override { return {"gauge", "picture"}; }
    void pose(const QString& name) override;

  protected:
    void showEvent(QShowEvent* event) override;
    void hideEvent(QHideEvent* event) override;
    void changeEvent(QEvent* event) override;

  private:
    /// The parts that show one reading.
    struct Row {
        Reading::Kind kind;
        QLabel* name;
        qt::ScoreCard *picture, *gauge;
        QLabel* detail;
    };
    struct Threshold;

    QWidget* makeMachine();
    QWidget* makeStyles();
    QWidget* makeEditor();
    void addChoices(QFormLayout* form);
    void addNumbers(QFormLayout* form);
    void addThresholds(QFormLayout* form);
    Row makeRow(Reading::Kind kind);
    void showReadings(const QList<Reading>& readings);
    void setScore(double score);
    void followThresholds();
    void fitLarge();
    void followPalette();
    double middleOfText() const;

    QTimer* timer_ = nullptr;
    QGridLayout* machine_ = nullptr;
    QList<Row> rows_;
    QList<qt::ScoreCard*> styles_;
    qt::ScoreCard* large_ = nullptr;
    QSlider* slider_ = nullptr;
    QList<QDoubleSpinBox*> thresholds_;
};

}  // namespace tessel::gallery
