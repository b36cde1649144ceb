#include <QMetaEnum>
#include <QSignalSpy>
#include <cmath>
#include <limits>

#include "tests/hosts/qt/QtTest.h"

namespace tessel::qt {
namespace {

class PropertiesTest : public test::QtTest {};

struct Sample {
    const char* ours;
    const char* theirs;
    QVariant value;
    const char* notify;
};

QFont Serif() {
    QFont font("DejaVu Serif");
    font.setPixelSize(16);
    font.setBold(true);
    return font;
}

std::vector<Sample> Samples() {
    return {{"BackColor", "backColor", QColor(1, 2, 3), "backColorChanged()"},
            {"BorderStyle", "borderStyle", 1, "borderStyleChanged()"},
            {"Alignment", "alignment", 2, "alignmentChanged()"},
            {"Appearance", "appearance", 0, "appearanceChanged()"},
            {"AutoSize", "autoSize", true, "autoSizeChanged()"},
            {"Caption", "caption", QString::fromUtf8("Caf\xC3\xA9"), "captionChanged()"},
            {"WordWrap", "wordWrap", true, "wordWrapChanged()"},
            {"HighlightColor", "highlightColor", QColor(4, 5, 6), "highlightColorChanged()"},
            {"UsedColor", "usedColor", QColor(7, 8, 9), "usedColorChanged()"},
            {"LinkTo", "linkTo", QString("b.txt"), "linkToChanged()"},
            {"ForeColor", "foreColor", QColor(10, 11, 12), "foreColorChanged()"},
            {"BorderSize", "borderSize", 12.5, "borderSizeChanged()"},
            {"SuppressMessages", "suppressMessages", true, "suppressMessagesChanged()"},
            {"ClickAction", "clickAction", 2, "clickActionChanged()"},
            {"Font", "font", QVariant::fromValue(Serif()), "fontChanged()"}};
}

QVariant Plain(const QVariant& value) {
    return value.metaType().flags() & QMetaType::IsEnumeration ? QVariant(value.toInt()) : value;
}

TEST_F(PropertiesTest, EachPropertyIsSetAndReadByBothSpellings) {
    for (const Sample& sample : Samples()) {
        Link one(window), two(window);
        EXPECT_TRUE(one.setProperty(sample.ours, sample.value)) << sample.ours;
        EXPECT_TRUE(two.setProperty(sample.theirs, sample.value)) << sample.theirs;
        EXPECT_EQ(Plain(one.property(sample.theirs)), Plain(two.property(sample.ours))) << sample.ours;
        if (sample.value.typeId() != QMetaType::QFont) {
            EXPECT_EQ(Plain(one.property(sample.ours)), sample.value) << sample.ours;
        }
        EXPECT_EQ(one.bag(), two.bag()) << sample.ours;
    }
    EXPECT_EQ(Errors(), "");
}

TEST_F(PropertiesTest, NoSpellingMakesADynamicProperty) {
    Link link(window);
    for (const Sample& sample : Samples()) {
        link.setProperty(sample.ours, sample.value);
        link.setProperty(sample.theirs, sample.value);
    }
    link.setProperty("Enabled", false);
    EXPECT_TRUE(link.dynamicPropertyNames().isEmpty());
}

TEST_F(PropertiesTest, EachNewValueIsNotifiedOnceInEitherSpelling) {
    for (const Sample& sample : Samples()) {
        for (const char* name : {sample.ours, sample.theirs}) {
            Link link(window);
            link.caption();
            QSignalSpy spy(&link, (QByteArray("2") + sample.notify).constData());
            ASSERT_TRUE(spy.isValid()) << sample.notify;
            link.setProperty(name, sample.value);
            EXPECT_EQ(spy.count(), 1) << name;
        }
    }
}

TEST_F(PropertiesTest, AChangeThroughTheControlItselfIsNotified) {
    Link link(window);
    QSignalSpy caption(&link, &Link::captionChanged), color(&link, &Link::foreColorChanged);
    link.control().SetCaption("x");
    link.control().SetForeColor(0xFF);
    EXPECT_EQ(caption.count(), 1);
    EXPECT_EQ(color.count(), 1);
    EXPECT_EQ(link.foreColor(), QColor(Qt::red));
}

TEST_F(PropertiesTest, TypedAccessorsReadWhatWasSet) {
    Link link(window);
    link.setCaption("Open");
    link.setBorderSize(12.5);
    link.setClickAction(Link::Print_Link);
    link.setAlignment(Link::Center);
    link.setBorderStyle(Link::FixedSingle);
    link.setAppearance(Link::Flat);
    link.setFont(Serif());
    EXPECT_EQ(link.caption(), "Open");
    EXPECT_EQ(link.borderSize(), 12.5);
    EXPECT_EQ(link.clickAction(), Link::Print_Link);
    EXPECT_EQ(link.alignment(), Link::Center);
    EXPECT_EQ(link.borderStyle(), Link::FixedSingle);
    EXPECT_EQ(link.appearance(), Link::Flat);
    EXPECT_EQ(link.font().family(), "DejaVu Serif");
    EXPECT_TRUE(link.font().bold());
    EXPECT_EQ(link.control().Font()->Name(), "DejaVu Serif");
    EXPECT_EQ(link.control().Font()->Size(), 12);
}

TEST_F(PropertiesTest, DefaultsAreThoseOfTheControl) {
    Link link(window);
    EXPECT_EQ(link.caption(), "Label1");
    EXPECT_EQ(link.foreColor(), QColor(0, 0, 0xC0));
    EXPECT_EQ(link.highlightColor(), QColor(0xC0, 0, 0));
    EXPECT_EQ(link.usedColor(), QColor(0x80, 0, 0x80));
    EXPECT_EQ(link.borderSize(), 30);
    EXPECT_EQ(link.clickAction(), Link::Open_Link);
    EXPECT_EQ(link.linkTo(), "");
    EXPECT_TRUE(link.isEnabled());
}

TEST_F(PropertiesTest, ANumberThatNamesNoConstantIsKeptAndDoesNothing) {
    Link* link = Shown();
    EXPECT_TRUE(link->setProperty("clickAction", 7));
    EXPECT_EQ(link->property("ClickAction").toInt(), 7);
    link->setAlignment(static_cast<Link::AlignmentConstants>(9));
    EXPECT_EQ(static_cast<int>(link->alignment()), 9);
    Click(link, {100, 20});
    EXPECT_EQ(Executed(), "");
    const QByteArray bag = link->bag();
    Link other(window);
    other.setBag(bag);
    EXPECT_EQ(static_cast<int>(other.clickAction()), 7);
    EXPECT_FALSE(link->grab().isNull());
}

TEST_F(PropertiesTest, ANumberTooLargeForAnEnumerationIsAnErrorAndChangesNothing) {
    Link link(window);
    link.setClickAction(static_cast<Link::ClickActionConstants>(70000));
    EXPECT_EQ(static_cast<int>(link.clickAction()), 1);
    EXPECT_THAT(Errors(), testing::StartsWith("6 "));
}

TEST_F(PropertiesTest, EnumerationsTakeTheNamesOfTheirConstants) {
    Link link(window);
    EXPECT_TRUE(link.setProperty("clickAction", "Print_Link"));
    EXPECT_EQ(link.clickAction(), Link::Print_Link);
    EXPECT_EQ(QMetaEnum::fromType<Link::AlignmentConstants>().valueToKey(2), QByteArray("Center"));
    EXPECT_EQ(QMetaEnum::fromType<Link::ClickActionConstants>().keyToValue("Do_nothing"), 0);
}

TEST_F(PropertiesTest, ColoursAndNumbersTakeTextsAsTheToolkitReadsThem) {
    Link link(window);
    EXPECT_TRUE(link.setProperty("BackColor", "#ff8000"));
    EXPECT_EQ(link.backColor(), QColor(255, 128, 0));
    EXPECT_TRUE(link.setProperty("borderSize", "12.5"));
    EXPECT_EQ(link.borderSize(), 12.5);
}

TEST_F(PropertiesTest, BothSpellingsStandInTheMetaObject) {
    const QMetaObject& meta = Link::staticMetaObject;
    EXPECT_STREQ(meta.className(), "tessel::qt::Link");
    for (const Sample& sample : Samples()) {
        const QMetaProperty ours = meta.property(meta.indexOfProperty(sample.ours));
        const QMetaProperty theirs = meta.property(meta.indexOfProperty(sample.theirs));
        ASSERT_TRUE(ours.isValid() && theirs.isValid()) << sample.ours;
        EXPECT_FALSE(ours.isDesignable()) << sample.ours;
        EXPECT_TRUE(theirs.isDesignable()) << sample.theirs;
        EXPECT_EQ(QByteArray("2") + theirs.notifySignal().methodSignature(), QByteArray("2") + sample.notify);
        EXPECT_EQ(ours.metaType(), theirs.metaType());
    }
    EXPECT_GE(meta.indexOfProperty("bag"), 0);
    for (const char* signal : {"click()", "dblClick()", "mouseDown(short&,short&,float&,float&)", "keyPress(short&)"}) {
        EXPECT_GE(meta.indexOfSignal(signal), 0) << signal;
    }
    for (const char* slot : {"refresh()", "openLink(QVariant)", "openLink()", "printLink(QVariant)", "printLink()"}) {
        EXPECT_GE(meta.indexOfSlot(slot), 0) << slot;
    }
}

TEST_F(PropertiesTest, EnabledIsOneThingForTheToolkitAndTheControl) {
    Link link(window);
    link.setEnabled(false);
    EXPECT_FALSE(link.control().Enabled());
    EXPECT_FALSE(link.property("Enabled").toBool());
    link.control().SetEnabled(true);
    test::Settle();
    EXPECT_TRUE(link.isEnabled());
    link.setProperty("Enabled", false);
    EXPECT_FALSE(link.control().Enabled());
    EXPECT_FALSE(link.isEnabled());
}

TEST_F(PropertiesTest, DisablingTheFormDoesNotDisableWhatTheLinkSaves) {
    Link* link = Shown();
    const QByteArray before = link->bag();
    window->setEnabled(false);
    EXPECT_FALSE(link->isEnabled());
    EXPECT_TRUE(link->control().Enabled());
    EXPECT_EQ(link->bag(), before);
    window->setEnabled(true);
    EXPECT_TRUE(link->isEnabled());
    EXPECT_TRUE(link->control().Enabled());
}

TEST_F(PropertiesTest, ALinkDisabledUnderADisabledFormStaysDisabledWithTheForm) {
    Link* link = Shown();
    window->setEnabled(false);
    link->control().SetEnabled(false);
    test::Settle();
    window->setEnabled(true);
    EXPECT_FALSE(link->isEnabled());
    EXPECT_FALSE(link->control().Enabled());
}

TEST_F(PropertiesTest, AFontThatWasReadAndSetAgainIsTheSameFont) {
    Link link(window);
    for (const double points : {8.25, 9.0, 10.0, 11.0, 12.0}) {
        link.control().SetFont(std::make_shared<frame::Font>("DejaVu Sans", points));
        link.setFont(link.font());
        EXPECT_NEAR(link.control().Font()->Size(), points, 0.001);
    }
}

TEST_F(PropertiesTest, AFontSetOnTheWidgetAsSuchIsTheControlsFont) {
    Link link(window);
    link.caption();
    static_cast<QWidget&>(link).setFont(Serif());
    EXPECT_EQ(link.control().Font()->Name(), "DejaVu Serif");
    EXPECT_EQ(link.control().Font()->Size(), 12);
}

TEST_F(PropertiesTest, AFontSetOnTheWidgetAsSuchBeforeAllElseIsTheControlsFont) {
    Link link(window);
    static_cast<QWidget&>(link).setFont(Serif());
    EXPECT_EQ(link.control().Font()->Name(), "DejaVu Serif");
}

TEST_F(PropertiesTest, AFontOfTheFormIsNotTakenByALinkWithItsOwn) {
    Link* link = Shown();
    const QByteArray before = link->bag();
    window->setFont(Serif());
    test::Settle();
    EXPECT_NE(link->control().Font()->Name(), "DejaVu Serif");
    EXPECT_NE(before, "");
}

TEST_F(PropertiesTest, ANumberThatDoesNotFitIsReportedAndChangesNothing) {
    Link link(window);
    link.setBorderSize(1e300);
    EXPECT_EQ(link.borderSize(), 30);
    EXPECT_THAT(Errors(), testing::StartsWith("6 "));
}

TEST_F(PropertiesTest, WildBorderSizesDoNoHarmAndAreSaved) {
    Link* link = Shown();
    for (const double size : {-1e9, 1e9, std::numeric_limits<double>::infinity(), std::numeric_limits<double>::quiet_NaN()}) {
        link->setBorderSize(size);
        Click(link, {100, 20});
        MoveAway();
        Link other(window);
        other.setBag(link->bag());
        EXPECT_EQ(std::isnan(other.borderSize()), std::isnan(size));
        if (!std::isnan(size)) {
            EXPECT_EQ(other.borderSize(), size);
        }
    }
    EXPECT_EQ(Errors(), "");
}

TEST_F(PropertiesTest, InvalidUtf8InTheControlComesBackThroughTheToolkit) {
    Link link(window);
    link.control().SetLinkTo("caf\xE9.txt");
    link.setLinkTo(link.linkTo());
    EXPECT_EQ(link.control().LinkTo(), "caf\xE9.txt");
    link.openLink();
    EXPECT_EQ(Executed(), "open caf\xE9.txt");
}

TEST_F(PropertiesTest, SlotsAnswerWithTheMessageOfTheFailure) {
    Link link(window);
    link.setLinkTo("a.txt");
    EXPECT_EQ(link.openLink(), "");
    EXPECT_EQ(link.printLink("b.txt"), "");
    EXPECT_EQ(Executed(), "open a.txt print b.txt");
    link.setSuppressMessages(true);
    shell.executeResults = {2, 3, 31, 5, 0};
    EXPECT_EQ(link.openLink(), "Unable to find file");
    EXPECT_EQ(link.printLink(), "Unable to find file");
    EXPECT_EQ(link.openLink(), "No application associated with file");
    EXPECT_EQ(link.openLink(), "Unable to view file");
    EXPECT_EQ(link.printLink(), "Unable to print file");
    EXPECT_TRUE(log.Of("msgbox").empty());
}

TEST_F(PropertiesTest, AFailureIsShownInABoxUnlessSuppressed) {
    Link link(window);
    shell.executeResults = {2};
    EXPECT_EQ(link.openLink("no such"), "Unable to find file");
    ASSERT_EQ(log.Of("msgbox").size(), 1u);
    EXPECT_EQ(log.Of("msgbox")[0][1].ToText(), "Error 2: Unable to find file 'no such'");
}

TEST_F(PropertiesTest, SlotsAreCalledByName) {
    Link link(window);
    QString result = "unset";
    EXPECT_TRUE(QMetaObject::invokeMethod(&link, "openLink", Q_RETURN_ARG(QString, result), Q_ARG(QVariant, "c.txt")));
    EXPECT_EQ(result, "");
    EXPECT_EQ(Executed(), "open c.txt");
    EXPECT_TRUE(QMetaObject::invokeMethod(&link, "refresh"));
    EXPECT_EQ(Errors(), "");
}

TEST_F(PropertiesTest, AnArgumentOfTheWrongTypeIsReportedAndOpensNothing) {
    Link link(window);
    link.setLinkTo("a.txt");
    EXPECT_EQ(link.openLink(QVariant(QPoint(1, 2))), "");
    EXPECT_EQ(Executed(), "");
    EXPECT_THAT(Errors(), testing::StartsWith("13 "));
}

TEST_F(PropertiesTest, OpeningByNameDoesNotFallBackOnTheCaption) {
    Link link(window);
    EXPECT_EQ(link.openLink(), "");
    EXPECT_EQ(link.openLink(QString()), "");
    EXPECT_EQ(Executed(), "");
}

TEST_F(PropertiesTest, RefreshCopiesTheToolTip) {
    Link* link = Shown();
    link->setToolTip("Hint");
    link->refresh();
    EXPECT_EQ(link->control().Label1.ToolTipText(), "Hint");
}

TEST_F(PropertiesTest, TheToolTipIsCopiedWhenTheLinkIsShown) {
    Link* link = Add();
    link->setToolTip("Hint");
    Show();
    EXPECT_EQ(link->control().Label1.ToolTipText(), "Hint");
}

}  // namespace
}  // namespace tessel::qt
