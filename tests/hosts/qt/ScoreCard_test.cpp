#include "hosts/qt/ScoreCard.h"

#include <QAccessible>
#include <QHBoxLayout>
#include <QMetaEnum>

#include "tests/hosts/qt/QtTest.h"

namespace tessel::qt {
namespace {

using Strings = std::vector<std::string>;

class ScoreCardWidgetTest : public test::QtTest {
  protected:
    ScoreCardWidgetTest() : card(new ScoreCard(window)) { card->setObjectName("ScoreCard1"); }
    QAccessibleInterface* Seen() { return QAccessible::queryAccessibleInterface(card); }
    QAccessibleValueInterface* Number() { return Seen()->valueInterface(); }

    QPointer<ScoreCard> card;
};

TEST_F(ScoreCardWidgetTest, AssistiveProgramsReadTheScoreItsLimitsAndItsGrade) {
    card->setStyle(ScoreCard::Gauge);
    card->setScoreMax(10);
    card->setScoreMin(-2);
    card->setValue(0.7);
    card->setToolTip("Health");
    ASSERT_NE(Seen(), nullptr);
    EXPECT_EQ(Seen()->role(), QAccessible::ProgressBar);
    EXPECT_TRUE(Seen()->state().readOnly);
    EXPECT_EQ(Seen()->childCount(), 0);
    ASSERT_NE(Number(), nullptr);
    EXPECT_NEAR(Number()->currentValue().toDouble(), 0.7, 1e-6);
    EXPECT_EQ(Number()->minimumValue().toDouble(), -2);
    EXPECT_EQ(Number()->maximumValue().toDouble(), 10);
    EXPECT_EQ(Seen()->text(QAccessible::Name), "Health");
    EXPECT_EQ(Seen()->text(QAccessible::Value), "70%");
    EXPECT_EQ(Seen()->text(QAccessible::Description), "good");
    Number()->setCurrentValue(3);
    EXPECT_NEAR(card->value().toDouble(), 0.7, 1e-6) << "nobody sets a score from there";
}

TEST_F(ScoreCardWidgetTest, APictureIsAnIndicator) {
    ASSERT_NE(Seen(), nullptr);
    EXPECT_EQ(Seen()->role(), QAccessible::Indicator);
    card->setStyle(ScoreCard::GaugeRainbow);
    EXPECT_EQ(Seen()->role(), QAccessible::ProgressBar);
}

TEST_F(ScoreCardWidgetTest, EachGradeHasItsWord) {
    Strings words;
    for (const double score : {0.1, 0.2, 0.4, 0.6, 0.8}) {
        card->setValue(score);
        words.push_back(card->gradeWord().toStdString());
    }
    EXPECT_EQ(words, (Strings{"very poor", "poor", "fair", "good", "excellent"}));
}

TEST_F(ScoreCardWidgetTest, WhatAProgramSaysOfTheWidgetItselfGoesFirst) {
    card->setAccessibleName("Disk");
    card->setAccessibleDescription("How much is free");
    ASSERT_NE(Seen(), nullptr);
    EXPECT_EQ(Seen()->text(QAccessible::Name), "Disk");
    EXPECT_EQ(Seen()->text(QAccessible::Description), "How much is free");
}

TEST_F(ScoreCardWidgetTest, EnumerationsAreKnownByTheirNames) {
    const QMetaObject& meta = ScoreCard::staticMetaObject;
    const auto keyOf = [&](const char* property, int value) {
        return std::string(meta.property(meta.indexOfProperty(property)).enumerator().valueToKey(value));
    };
    EXPECT_EQ(keyOf("style", 8), "GaugeOverrun");
    EXPECT_EQ(keyOf("gaugeOrientation", 1), "Vertical");
    EXPECT_EQ(keyOf("showMarker", 2), "ShowBar");
    EXPECT_EQ(keyOf("showMarker", 0), "tsMarkerStyleNone");
    EXPECT_EQ(keyOf("showValue", 6), "Adjust");
    EXPECT_EQ(keyOf("toolTipStyle", 3), "ShowBothAsTip");
}

TEST_F(ScoreCardWidgetTest, APictureKeepsItsSizeInALayoutAndAGaugeTakesItsPlace) {
    auto* row = new QHBoxLayout(window);
    row->addWidget(card, 0, Qt::AlignCenter);
    card->setStyle(ScoreCard::SmileyLarge);
    Show();
    EXPECT_EQ(card->sizeHint(), QSize(36, 36)) << "32 pixels and the border";
    EXPECT_EQ(card->size(), QSize(36, 36));
    card->setStyle(ScoreCard::Gauge);
    test::Settle();
    EXPECT_GT(card->sizeHint().width(), 2 * card->sizeHint().height());
    EXPECT_EQ(card->size(), card->sizeHint());
    card->setGaugeOrientation(ScoreCard::Vertical);
    test::Settle();
    EXPECT_GT(card->sizeHint().height(), 2 * card->sizeHint().width());
}

TEST_F(ScoreCardWidgetTest, AGaugeAfterAPictureTakesAllOfAWidgetThatKeptItsSize) {
    auto* row = new QHBoxLayout(window);
    row->addWidget(card, 0, Qt::AlignCenter);
    card->setFixedSize(180, 40);
    Show();
    EXPECT_EQ(card->size(), QSize(180, 40));
    EXPECT_EQ(card->control().Picture1.Width(), 20 * 15);
    card->setStyle(ScoreCard::Gauge);
    test::Settle();
    EXPECT_EQ(card->control().Picture1.Width(), 180 * 15);
    EXPECT_EQ(card->control().Picture1.Height(), 40 * 15);
}

TEST_F(ScoreCardWidgetTest, APictureThatIsPlacedByHandShrinksTheWidget) {
    card->setGeometry(10, 10, 200, 100);
    Show();
    EXPECT_EQ(card->size(), QSize(20, 20));
    card->resize(150, 150);
    test::Settle();
    EXPECT_EQ(card->size(), QSize(20, 20));
    card->setStyle(ScoreCard::Gauge);
    card->resize(150, 30);
    EXPECT_EQ(card->size(), QSize(150, 30));
}

TEST_F(ScoreCardWidgetTest, TakesTheFocusOnlyWhereAProgramWantsItsKeys) {
    card->setStyle(ScoreCard::Gauge);
    card->setGeometry(10, 10, 200, 30);
    Show();
    Click(card, {20, 10});
    EXPECT_FALSE(card->hasFocus());
    card->setFocusPolicy(Qt::StrongFocus);
    Strings keys;
    QObject::connect(card, &ScoreCard::keyDown, card, [&](short& code, short&) { keys.push_back(std::to_string(code)); });
    Click(card, {20, 10});
    EXPECT_TRUE(card->hasFocus());
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_A);
    EXPECT_EQ(keys, Strings{"65"});
}

TEST_F(ScoreCardWidgetTest, ABadScoreInASavedStateIsReportedAndHarmsNobody) {
    card->setBag("");
    frame::MemoryBag saved;
    saved.Set("Value", "no number");
    card->load(saved);
    EXPECT_THAT(Errors(), testing::HasSubstr("13 "));
    ASSERT_NE(Seen(), nullptr);
    EXPECT_EQ(Number()->currentValue().toDouble(), 0.5);
    EXPECT_EQ(Seen()->text(QAccessible::Value), "50%");
}

}  // namespace
}  // namespace tessel::qt
