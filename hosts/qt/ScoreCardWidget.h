#pragma once

#include "controls/scorecard/ScoreCard.h"
#include "hosts/qt/ControlWidget.h"

namespace tessel::qt {

/// What a user of a desktop expects of a score beside what the control does: it asks a layout for a useful size, and assistive
/// programs read its value, its limits and its grade, and hear of changes.
class ScoreCardWidget : public ControlWidget {
    Q_OBJECT

  public:
    controls::ScoreCard& scoreCard() const { return static_cast<controls::ScoreCard&>(control()); }
    /// What the score is worth in a word: "very poor", "poor", "fair", "good" or "excellent".
    QString gradeWord() const;
    /// The score as the control writes it: "50%".
    QString percent() const;
    QSize minimumSizeHint() const override;

  protected:
    ScoreCardWidget(const frame::ControlClass& controlClass, QWidget* parent);

    QSize preferredSize() const override;
    /// As large as its picture.
    bool sizesItself() const override;
    void started() override;
    void propertyChanged(std::string_view key) override;

  private:
    friend class AccessibleScoreCard;

    /// Reads something of the control that a saved state may have spoilt.
    template <class F>
    void read(F&& from) const;
    QSize along(QSize horizontal) const;
    void takeWholePlace();
    void tellAssistants(bool value);
    QString told_;  // the grade that assistive programs know
};

}  // namespace tessel::qt
