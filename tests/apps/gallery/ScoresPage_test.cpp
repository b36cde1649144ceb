#include "apps/gallery/ScoresPage.h"

#include <gtest/gtest.h>

#include <QAccessible>
#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QDoubleSpinBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QSlider>
#include <QSpinBox>
#include <QTest>
#include <algorithm>
#include <cmath>

#include "apps/gallery/Palettes.h"

namespace tessel::gallery {
namespace {

double Luminance(const QColor& color) {
    const auto linear = [](double part) { return part <= 0.03928 ? part / 12.92 : std::pow((part + 0.055) / 1.055, 2.4); };
    return 0.2126 * linear(color.redF()) + 0.7152 * linear(color.greenF()) + 0.0722 * linear(color.blueF());
}

/// How well two colours are told apart: from 1, the same, to 21, black on white.
double Contrast(const QColor& one, const QColor& other) {
    const double first = Luminance(one), second = Luminance(other);
    return (std::max(first, second) + 0.05) / (std::min(first, second) + 0.05);
}

class ScoresPageTest : public testing::Test {
  protected:
    ScoresPageTest() {
        QApplication::setPalette(PaletteOf(Scheme::Light));
        page_ = std::make_unique<ScoresPage>();
        page_->resize(820, 600);
        page_->show();
        page_->activateWindow();
        EXPECT_TRUE(QTest::qWaitForWindowActive(page_.get()));
    }
    ~ScoresPageTest() override {
        page_.reset();
        QApplication::setPalette(before_);
    }

    template <class T>
    T* Find(const char* name) {
        return page_->findChild<T*>(name);
    }
    qt::ScoreCard* Large() { return Find<qt::ScoreCard>("large"); }
    QImage Picture(QWidget* widget) { return widget->grab().toImage(); }
    void Choose(const char* box, const QString& text) {
        auto* combo = Find<QComboBox>(box);
        ASSERT_GE(combo->findText(text), 0) << text.toStdString();
        combo->setCurrentIndex(combo->findText(text));
        QCoreApplication::processEvents();
    }
    void Press(const char* widget, Qt::Key key, int times = 1) {
        for (; times > 0; --times) QTest::keyClick(Find<QWidget>(widget), key);
    }
    void MoveTo(int percent) { Find<QSlider>("score")->setValue(percent); }

    QGroupBox* Box(const QString& title) {
        for (QGroupBox* box : page_->findChildren<QGroupBox*>())
            if (box->title() == title) return box;
        return nullptr;
    }
    QGroupBox* Styles() { return Box("One score in every style"); }
    QGroupBox* Machine() { return Box("How this machine does"); }
    /// What stands in a cell; null where nothing does.
    template <class T>
    static T* In(QGroupBox* box, int row, int column) {
        const QLayoutItem* item = static_cast<QGridLayout*>(box->layout())->itemAtPosition(row, column);
        return item ? qobject_cast<T*>(item->widget()) : nullptr;
    }
    QStringList MachineNames() {
        QStringList names;
        for (int row = 0; auto* name = In<QLabel>(Machine(), row, 1); ++row) names << name->text();
        return names;
    }

    static QAccessibleInterface* Seen(QWidget* widget) { return QAccessible::queryAccessibleInterface(widget); }
    std::string Grade() { return Seen(Large())->text(QAccessible::Description).toStdString(); }

  private:
    const QPalette before_ = QApplication::palette();

  protected:
    std::unique_ptr<ScoresPage> page_;
};

TEST_F(ScoresPageTest, EveryStyleFollowsTheSliderBeyondBothEnds) {
    QList<qt::ScoreCard*> cards = Styles()->findChildren<qt::ScoreCard*>();
    ASSERT_EQ(cards.size(), 12);
    cards << Large();
    QList<QImage> low;
    Press("score", Qt::Key_Home);
    for (qt::ScoreCard* card : cards) {
        EXPECT_NEAR(card->value().toDouble(), -0.1, 1e-6) << card->style();
        low << Picture(card);
    }
    Press("score", Qt::Key_End);
    for (qsizetype i = 0; i < cards.size(); ++i) {
        EXPECT_NEAR(cards[i]->value().toDouble(), 1.1, 1e-6) << cards[i]->style();
        EXPECT_NE(Picture(cards[i]), low[i]) << cards[i]->style();
    }
    Press("score", Qt::Key_Left);
    EXPECT_NEAR(Large()->value().toDouble(), 1.09, 1e-6);
}

TEST_F(ScoresPageTest, EachStyleStandsBesideItsName) {
    const std::pair<const char*, qt::ScoreCard::tsScoreCardStyle> styles[] = {{"Card", qt::ScoreCard::ScoreCardSmall},
                                                                              {"Large card", qt::ScoreCard::ScoreCardLarge},
                                                                              {"Face", qt::ScoreCard::SmileySmall},
                                                                              {"Large face", qt::ScoreCard::SmileyLarge},
                                                                              {"Light", qt::ScoreCard::TrafficLightSmall},
                                                                              {"Large light", qt::ScoreCard::TrafficLightLarge},
                                                                              {"Weather", qt::ScoreCard::WeatherSmall},
                                                                              {"Large weather", qt::ScoreCard::WeatherLarge},
                                                                              {"Flash card", qt::ScoreCard::FlashCard},
                                                                              {"Gauge", qt::ScoreCard::Gauge},
                                                                              {"Gauge with overrun", qt::ScoreCard::GaugeOverrun},
                                                                              {"Gauge by value", qt::ScoreCard::GaugeRainbow}};
    int place = 0;
    for (const auto& [name, style] : styles) {
        auto* card = In<qt::ScoreCard>(Styles(), place / 2, place % 2 * 2);
        auto* label = In<QLabel>(Styles(), place / 2, place % 2 * 2 + 1);
        ASSERT_TRUE(card && label) << name;
        EXPECT_EQ(label->text(), name);
        EXPECT_EQ(card->style(), style) << name;
        Choose("style", name);
        EXPECT_EQ(Large()->style(), style) << name;
        ++place;
    }
}

TEST_F(ScoresPageTest, AssistiveProgramsReadTheScoreItsLimitsAndItsGrade) {
    ASSERT_NE(Seen(Large()), nullptr);
    EXPECT_EQ(Seen(Large())->role(), QAccessible::ProgressBar);
    const QAccessibleValueInterface* number = Seen(Large())->valueInterface();
    ASSERT_NE(number, nullptr);
    EXPECT_EQ(number->minimumValue().toDouble(), 0);
    EXPECT_EQ(number->maximumValue().toDouble(), 1);
    QStringList read;
    for (const int percent : {5, 25, 45, 65, 85}) {
        MoveTo(percent);
        EXPECT_NEAR(number->currentValue().toDouble(), percent / 100.0, 1e-6);
        read << Seen(Large())->text(QAccessible::Value) + ' ' + Seen(Large())->text(QAccessible::Description);
    }
    EXPECT_EQ(read.join(" | ").toStdString(), "5% very poor | 25% poor | 45% fair | 65% good | 85% excellent");
    EXPECT_EQ(Seen(Find<QWidget>("score"))->text(QAccessible::Name), "Score");
    EXPECT_EQ(Seen(Large())->text(QAccessible::Name), "Large score");
    Choose("style", "Large face");
    EXPECT_EQ(Seen(Large())->role(), QAccessible::Indicator);
}

TEST_F(ScoresPageTest, APictureIsAsLargeAsItIsAndAGaugeLiesOrStands) {
    EXPECT_EQ(Large()->size(), QSize(320, 52));
    Choose("style", "Large face");
    EXPECT_EQ(Large()->size(), QSize(36, 36));
    Choose("style", "Weather");
    EXPECT_EQ(Large()->size(), QSize(20, 20));
    Choose("style", "Gauge");
    EXPECT_EQ(Large()->size(), QSize(320, 52));
    Choose("gaugeOrientation", "Standing");
    EXPECT_EQ(Large()->size(), QSize(52, 150));
    Choose("style", "Flash card");
    EXPECT_EQ(Large()->size(), QSize(320, 52));
}

TEST_F(ScoresPageTest, EveryMarkerAndEveryPlaceOfTheTextLooksDifferent) {
    MoveTo(25);
    const auto looks = [&](const char* box, const QStringList& choices) {
        QList<QImage> seen;
        for (const QString& choice : choices) {
            Choose(box, choice);
            const QImage picture = Picture(Large());
            EXPECT_FALSE(seen.contains(picture)) << choice.toStdString();
            seen << picture;
        }
        return seen;
    };
    looks("showMarker", {"None", "Line", "Raised bar", "Flat bar"});
    const QList<QImage> texts = looks("showValue", {"None", "Left", "Middle", "Right", "Top", "Bottom"});
    Choose("showValue", "Where there is room");
    EXPECT_EQ(Picture(Large()), texts[3]) << "right of a low score";
}

TEST_F(ScoresPageTest, BlocksTicksAndLimitLinesAreDrawnAsTheyAreTyped) {
    QImage before = Picture(Large());
    const auto looksDifferent = [&] { return std::exchange(before, Picture(Large())) != before; };
    const QImage plain = before;
    const auto type = [&](const char* box, const QString& text) {
        auto* spin = Find<QAbstractSpinBox>(box);
        spin->setFocus();
        spin->selectAll();
        QTest::keyClicks(spin, text);
        QTest::keyClick(spin, Qt::Key_Return);
    };
    type("showBlocks", "10");
    EXPECT_EQ(Large()->showBlocks(), 10);
    EXPECT_TRUE(looksDifferent());
    type("showTickLinesEvery", "0.25");
    EXPECT_EQ(Large()->showTickLinesEvery().toDouble(), 0.25);
    EXPECT_TRUE(looksDifferent());
    Find<QCheckBox>("showLimitLines")->click();
    EXPECT_TRUE(looksDifferent());
    type("showBlocks", "0");
    type("showTickLinesEvery", "0");
    Find<QCheckBox>("showLimitLines")->click();
    EXPECT_EQ(Picture(Large()), plain);
}

TEST_F(ScoresPageTest, AThresholdStopsAtItsNeighbours) {
    Press("ScoreGood", Qt::Key_Up);
    EXPECT_EQ(Find<QDoubleSpinBox>("ScoreGood")->text(), "0.65");
    Press("ScoreGood", Qt::Key_Up, 9);
    EXPECT_EQ(Find<QDoubleSpinBox>("ScoreGood")->text(), "0.80");
    Press("ScoreGood", Qt::Key_PageDown);
    EXPECT_EQ(Find<QDoubleSpinBox>("ScoreGood")->text(), "0.40");
    EXPECT_NEAR(Large()->scoreGood(), 0.4, 1e-6);
    EXPECT_EQ(Find<QDoubleSpinBox>("ScoreStar")->text(), "0.80");
    EXPECT_EQ(Find<QDoubleSpinBox>("ScoreMaybe")->text(), "0.40");
}

TEST_F(ScoresPageTest, AThresholdThatIsTypedCountsWhenItIsThere) {
    auto* box = Find<QDoubleSpinBox>("ScoreStar");
    box->selectAll();
    QTest::keyClicks(box, QString(box->locale().decimalPoint()).prepend('0') + "7");
    EXPECT_NEAR(Large()->scoreStar(), 0.8, 1e-6);
    QTest::keyClick(box, Qt::Key_Return);
    EXPECT_NEAR(Large()->scoreStar(), 0.7, 1e-6);
    EXPECT_EQ(Find<QDoubleSpinBox>("ScoreGood")->text(), "0.60");
}

TEST_F(ScoresPageTest, TheGradeFollowsTheThresholdsAtOnce) {
    MoveTo(62);
    EXPECT_EQ(Grade(), "good");
    QImage before = Picture(Large());
    Press("ScoreGood", Qt::Key_Up);
    EXPECT_EQ(Grade(), "fair");
    EXPECT_NE(Picture(Large()), before);
    MoveTo(17);
    EXPECT_EQ(Grade(), "very poor");
    before = Picture(Large());
    Press("ScoreBad", Qt::Key_Down);
    EXPECT_EQ(Grade(), "poor");
    EXPECT_NE(Picture(Large()), before);
}

TEST_F(ScoresPageTest, ThisMachineIsReadWhenThePageIsShown) {
    QStringList names;
    for (const Reading& reading : ReadMachine()) names << reading.name;
    EXPECT_EQ(MachineNames(), names);
    EXPECT_TRUE(names.contains("Memory"));
    for (int row = 0; row < names.size(); ++row) {
        auto* picture = In<qt::ScoreCard>(Machine(), row, 0);
        auto* gauge = In<qt::ScoreCard>(Machine(), row, 2);
        ASSERT_TRUE(picture && gauge) << row;
        EXPECT_EQ(picture->value(), gauge->value());
        EXPECT_GE(gauge->value().toDouble(), 0);
        EXPECT_LE(gauge->value().toDouble(), 1);
        EXPECT_NE(In<QLabel>(Machine(), row, 3)->text(), "");
    }
}

TEST_F(ScoresPageTest, TheReadingsOfAnotherMachineTakeTheRows) {
    page_->pose("gauge");
    QStringList rows;
    QList<qt::ScoreCard::tsScoreCardStyle> pictures;
    for (int row = 0; row < MachineNames().size(); ++row) {
        QStringList seen;
        for (const int column : {0, 2}) {
            QAccessibleInterface* card = Seen(In<qt::ScoreCard>(Machine(), row, column));
            EXPECT_EQ(card->text(QAccessible::Name), MachineNames()[row]);
            seen << card->text(QAccessible::Value) + ' ' + card->text(QAccessible::Description);
        }
        EXPECT_EQ(seen[0], seen[1]);
        pictures << In<qt::ScoreCard>(Machine(), row, 0)->style();
        rows << MachineNames()[row] + ' ' + seen[0];
    }
    EXPECT_EQ(rows.join(" | ").toStdString(),
              "/ 14% very poor | /home 82% excellent | /media/photos 44% fair | Memory 66% good | Processors 67% good");
    constexpr auto disk = qt::ScoreCard::SmileyLarge;
    EXPECT_EQ(pictures, (QList{disk, disk, disk, qt::ScoreCard::WeatherLarge, qt::ScoreCard::TrafficLightLarge}));
    EXPECT_EQ(Machine()->findChildren<qt::ScoreCard*>().size(), 10) << "nothing is left of the rows before";
}

TEST_F(ScoresPageTest, TheLabelsAreLegibleInLightAndDark) {
    constexpr double faintButLegible = 3;
    for (const Scheme scheme : {Scheme::Dark, Scheme::Light}) {
        QApplication::setPalette(PaletteOf(scheme));
        QCoreApplication::processEvents();
        for (QLabel* label : page_->findChildren<QLabel*>()) {
            const QImage picture = Picture(label);
            double best = 1;
            for (int y = 0; y < picture.height(); ++y)
                for (int x = 0; x < picture.width(); ++x)
                    best = std::max(best, Contrast(picture.pixelColor(x, y), picture.pixelColor(0, 0)));
            EXPECT_GE(best, faintButLegible) << label->text().toStdString();
        }
    }
}

TEST_F(ScoresPageTest, TheTextOfTheGaugeIsLegibleInLightAndDark) {
    constexpr double legible = 4.5;
    const auto expectLegible = [&](const char* place) {
        Choose("showValue", "None");
        const QImage bare = Picture(Large());
        Choose("showValue", place);
        const QImage printed = Picture(Large());
        double worst = 100;
        for (int y = 0; y < bare.height(); ++y) {
            for (int x = 0; x < bare.width(); ++x) {
                if (printed.pixel(x, y) == bare.pixel(x, y)) continue;
                worst = std::min(worst, Contrast(Large()->fontColor(), bare.pixelColor(x, y)));
            }
        }
        EXPECT_NE(printed, bare) << Large()->value().toDouble();
        EXPECT_GE(worst, legible) << place << ' ' << Large()->value().toDouble();
    };
    for (const char* style : {"Gauge", "Gauge by value"}) {
        Choose("style", style);
        for (const Scheme scheme : {Scheme::Dark, Scheme::Light}) {
            MoveTo(20);
            QApplication::setPalette(PaletteOf(scheme));
            QCoreApplication::processEvents();
            expectLegible("Where there is room");
            for (int percent = 5; percent < 100; percent += 10) {
                MoveTo(percent);
                expectLegible("Where there is room");
                if (std::string(style) == "Gauge")
                    for (const char* place : {"Left", "Middle", "Right"}) expectLegible(place);
            }
        }
    }
}

TEST_F(ScoresPageTest, TheKeysOfTheLabelsLeadToTheirBoxes) {
    const std::pair<Qt::Key, const char*> keys[] = {
        {Qt::Key_S, "style"},           {Qt::Key_M, "showMarker"},         {Qt::Key_T, "showValue"},
        {Qt::Key_B, "showBlocks"},      {Qt::Key_E, "showTickLinesEvery"}, {Qt::Key_A, "ScoreStar"},
        {Qt::Key_G, "ScoreGood"},       {Qt::Key_Y, "ScoreMaybe"},         {Qt::Key_R, "ScoreBad"},
        {Qt::Key_D, "gaugeOrientation"}};
    for (const auto& [key, box] : keys) {
        QTest::keyClick(page_.get(), key, Qt::AltModifier);
        EXPECT_EQ(QApplication::focusWidget(), Find<QWidget>(box)) << box;
    }
    QTest::keyClick(page_.get(), Qt::Key_L, Qt::AltModifier);
    EXPECT_TRUE(QTest::qWaitFor([&] { return Large()->showLimitLines(); })) << "pressed for a moment";
}

}  // namespace
}  // namespace tessel::gallery
