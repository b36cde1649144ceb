#include "tests/hosts/qt/QtTest.h"

namespace tessel::qt {
namespace {

/// A loaded link has the font of its form, a new one that of its design.
class LoadingTest : public test::QtTest {
  protected:
    LoadingTest() {
        QFont font("DejaVu Serif");
        font.setPixelSize(16);
        window->setFont(font);
    }
    static bool IsLoaded(Link& link) {
        return link.control().Font()->Name() == "DejaVu Serif" && link.control().Font()->Size() == 12;
    }
};

/// The pointer that the user sees over the middle of a link.
Qt::CursorShape PointerOver(const Link& link) {
    const QWidget* under = link.childAt(link.rect().center());
    return (under ? under->cursor() : link.cursor()).shape();
}

TEST_F(LoadingTest, ABagMakesALoadedLink) {
    Link link(window);
    link.setBag("{}");
    EXPECT_TRUE(IsLoaded(link));
}

TEST_F(LoadingTest, ThePropertyAskedFirstMakesANewLink) {
    Link link(window);
    EXPECT_EQ(link.caption(), "Label1");
    EXPECT_FALSE(IsLoaded(link));
}

TEST_F(LoadingTest, AnEmptyTextMakesANewLink) {
    Link link(window);
    link.setBag("");
    EXPECT_FALSE(IsLoaded(link));
}

TEST_F(LoadingTest, AnEmptyTextAfterALoadMakesANewLink) {
    Link link(window);
    link.setBag("{\"Caption\":\"c\"}");
    link.setBag("");
    EXPECT_EQ(link.caption(), "Label1");
    EXPECT_FALSE(IsLoaded(link));
}

TEST_F(LoadingTest, ShowingMakesANewLink) {
    Link* link = Add();
    Show();
    EXPECT_FALSE(IsLoaded(*link));
    EXPECT_EQ(link->control().Label1.Width(), 3000);
}

TEST_F(LoadingTest, GrabbingMakesALinkThatIsSeen) {
    Link* link = Add();
    EXPECT_FALSE(test::InkOf(link->grab().toImage().convertToFormat(QImage::Format_RGB32)).isEmpty());
}

TEST_F(LoadingTest, TheOrderOfBagAndGeometryDoesNotMatter) {
    Link one(window), two(window);
    one.setGeometry(10, 20, 111, 33);
    one.setBag("{\"Caption\":\"c\"}");
    two.setBag("{\"Caption\":\"c\"}");
    two.setGeometry(10, 20, 111, 33);
    EXPECT_EQ(one.geometry(), QRect(10, 20, 111, 33));
    EXPECT_EQ(two.geometry(), QRect(10, 20, 111, 33));
    for (Link* link : {&one, &two}) {
        EXPECT_EQ(link->control().Label1.Width(), 1665);
        EXPECT_EQ(link->control().Label1.Height(), 495);
        EXPECT_EQ(link->extender().Get("Left"), frame::Variant(150));
        EXPECT_EQ(link->extender().Get("Top"), frame::Variant(300));
    }
    EXPECT_EQ(one.bag(), two.bag());
}

TEST_F(LoadingTest, WhatWasSavedIsLoadedAgain) {
    Link one(window);
    one.setCaption(QString::fromUtf8("Caf\xC3\xA9 \xE2\x82\xAC"));
    one.setLinkTo("mailto:a@example.org");
    one.setForeColor(QColor(1, 2, 3));
    one.setBorderSize(12.5);
    one.setClickAction(Link::Print_Link);
    one.setEnabled(false);
    QFont font("DejaVu Sans Mono");
    font.setPixelSize(20);
    one.setFont(font);
    Link two(window);
    two.setBag(one.bag());
    EXPECT_EQ(two.caption(), one.caption());
    EXPECT_EQ(two.linkTo(), one.linkTo());
    EXPECT_EQ(two.foreColor(), QColor(1, 2, 3));
    EXPECT_EQ(two.borderSize(), 12.5);
    EXPECT_EQ(two.clickAction(), Link::Print_Link);
    EXPECT_FALSE(two.isEnabled());
    EXPECT_EQ(two.font().family(), "DejaVu Sans Mono");
    EXPECT_EQ(two.bag(), one.bag());
}

TEST_F(LoadingTest, ALoadedLinkThatWasNotTouchedSavesNothing) {
    Link link(window);
    link.setBag("{}");
    EXPECT_EQ(link.bag(), "{}");
}

TEST_F(LoadingTest, ABagByPropertyIsTheSame) {
    Link link(window);
    EXPECT_TRUE(link.setProperty("bag", QByteArray("{\"LinkTo\":\"z\"}")));
    EXPECT_EQ(link.linkTo(), "z");
    EXPECT_EQ(link.property("bag").toByteArray(), link.bag());
}

TEST_F(LoadingTest, ALoadReportsNoChange) {
    Link link(window);
    int changes = 0;
    QObject::connect(&link, &Link::captionChanged, [&] { ++changes; });
    QObject::connect(&link, &Link::foreColorChanged, [&] { ++changes; });
    link.setBag("{\"Caption\":\"c\",\"Forecolor\":255}");
    EXPECT_EQ(changes, 0);
    EXPECT_EQ(link.foreColor(), QColor(Qt::red));
}

TEST_F(LoadingTest, TheSizeAndPlaceOfALinkStayWithASecondBag) {
    Link* link = Shown();
    link->setBag("{\"Caption\":\"second\"}");
    EXPECT_EQ(link->geometry(), QRect(20, 20, 200, 40));
    EXPECT_EQ(link->control().Label1.Width(), 3000);
    EXPECT_EQ(link->extender().Get("Left"), frame::Variant(300));
}

TEST_F(LoadingTest, ASecondBagForgetsThatTheLinkWasUsed) {
    Link* link = Shown();
    Click(link, {100, 20});
    link->setBag(link->bag());
    MoveTo(link, {100, 20});
    MoveAway();
    EXPECT_EQ(link->control().Label1.ForeColor(), link->control().ForeColor());
}

TEST_F(LoadingTest, ASecondBagKeepsSignalsAndInput) {
    Link* link = Shown();
    Listen(link);
    link->setBag("{\"LinkTo\":\"second.txt\"}");
    test::Settle();
    Click(link, {100, 20});
    EXPECT_EQ(Events(), "MouseDown MouseUp Click");
    EXPECT_EQ(Executed(), "open second.txt");
    EXPECT_EQ(PointerOver(*link), Qt::PointingHandCursor);
}

TEST_F(LoadingTest, ASecondBagShowsItsText) {
    Link* link = Shown();
    const QImage before = link->grab().toImage();
    link->setBag("{\"Caption\":\"quite another text\"}");
    test::Settle();
    EXPECT_NE(link->grab().toImage(), before);
}

TEST_F(LoadingTest, AnUnreadableBagIsReportedAndChangesNothing) {
    Link* link = Shown();
    for (const char* text : {"{", "[1]", "nonsense", "{\"Caption\":[1]}"}) {
        link->setBag(text);
        EXPECT_THAT(Errors(), testing::StartsWith("380 ")) << text;
        EXPECT_EQ(link->linkTo(), "a.txt");
    }
}

TEST_F(LoadingTest, AnUnreadableBagBeforeAllElseLeavesTheChoiceOpen) {
    Link link(window);
    link.setBag("{");
    EXPECT_THAT(Errors(), testing::StartsWith("380 "));
    link.setBag("{}");
    EXPECT_TRUE(IsLoaded(link));
}

TEST_F(LoadingTest, AnEntryOfTheWrongTypeIsReportedAndTheLinkGoesOn) {
    Link* link = Shown();
    link->setBag("{\"BackColor\":\"blue\",\"Caption\":\"c\"}");
    EXPECT_THAT(Errors(), testing::StartsWith("13 "));
    link->setCaption("works");
    link->setLinkTo("works.txt");
    link->press();
    EXPECT_EQ(Executed(), "open works.txt");
    EXPECT_EQ(link->geometry(), QRect(20, 20, 200, 40));
}

TEST_F(LoadingTest, EntriesConvertAsVariantsDo) {
    Link link(window);
    link.setBag("{\"BorderSize\":\"45\",\"ClickAction\":\"2\",\"AutoSize\":-1,\"Caption\":12}");
    EXPECT_EQ(Errors(), "");
    EXPECT_EQ(link.borderSize(), 45);
    EXPECT_EQ(link.clickAction(), Link::Print_Link);
    EXPECT_TRUE(link.autoSize());
    EXPECT_EQ(link.caption(), "12");
}

TEST_F(LoadingTest, ForeignEntriesArePassedOver) {
    Link link(window);
    link.setBag("{\"Unknown\":1,\"caption\":\"not this spelling\",\"Caption\":\"c\"}");
    EXPECT_EQ(Errors(), "");
    EXPECT_EQ(link.caption(), "c");
}

TEST_F(LoadingTest, AnAutoSizedLinkIsLoadedInTheSizeOfItsText) {
    Link link(window);
    link.setGeometry(10, 10, 300, 200);
    link.setBag("{\"AutoSize\":true,\"Caption\":\"short\"}");
    test::Settle();
    EXPECT_LT(link.width(), 100);
    EXPECT_LT(link.height(), 60);
    EXPECT_EQ(link.size(), link.sizeHint());
}

// The host and its ambient properties.

TEST_F(LoadingTest, TheAmbientFontIsThatOfTheNamedForm) {
    auto* form = new QWidget(window);
    Host::setForm(form);
    QFont mono("DejaVu Sans Mono");
    mono.setPixelSize(20);
    form->setFont(mono);
    Link link(form);
    link.setBag("{}");
    EXPECT_EQ(link.control().Font()->Name(), "DejaVu Sans Mono");
    EXPECT_EQ(Host::formOf(&link), form);
    EXPECT_EQ(Host::formOf(form), form);
    EXPECT_EQ(Host::formOf(window), window);
}

TEST_F(LoadingTest, AHostIsFoundByTheNearestAncestor) {
    auto* inner = new QWidget(window);
    auto second = Host::make();
    Host::attach(inner, second);
    auto* deep = new QWidget(inner);
    EXPECT_EQ(Host::of(deep), second);
    EXPECT_EQ(Host::of(window), host);
    EXPECT_EQ(Host::of(nullptr), Host::of(nullptr));
    EXPECT_NE(Host::of(nullptr), host);
    QWidget elsewhere;
    EXPECT_EQ(Host::of(&elsewhere), Host::of(nullptr));
    Link link(deep);
    EXPECT_EQ(link.host(), second);
}

TEST_F(LoadingTest, ALinkKeepsTheHostThatItWasMadeWith) {
    Link link(window);
    auto second = Host::make();
    Host::attach(window, second);
    EXPECT_EQ(link.host(), host);
    Link later(window);
    EXPECT_EQ(later.host(), second);
    Host::attach(window, host);
}

TEST_F(LoadingTest, UserModeIsAPropertyOfTheHost) {
    EXPECT_TRUE(host->userMode());
    int told = 0;
    QObject::connect(host.get(), &Host::userModeChanged, [&](bool mode) { told += mode ? 10 : 1; });
    Link link(window);
    EXPECT_TRUE(link.control().UserMode());
    host->setProperty("userMode", false);
    EXPECT_FALSE(link.control().UserMode());
    host->setUserMode(false);
    host->setUserMode(true);
    EXPECT_EQ(told, 11);
}

TEST_F(LoadingTest, TwoHostsHaveTheirOwnMode) {
    QWidget other;
    auto second = Host::make();
    Host::attach(&other, second);
    second->setUserMode(false);
    Link live(window), design(&other);
    EXPECT_TRUE(live.control().UserMode());
    EXPECT_FALSE(design.control().UserMode());
}

TEST_F(LoadingTest, TheHandComesWithUserMode) {
    host->setUserMode(false);
    Link* link = Shown();
    EXPECT_NE(PointerOver(*link), Qt::PointingHandCursor);
    host->setUserMode(true);
    EXPECT_EQ(PointerOver(*link), Qt::PointingHandCursor);
    host->setUserMode(false);
    EXPECT_NE(PointerOver(*link), Qt::PointingHandCursor);
}

TEST_F(LoadingTest, ALinkSavedAsDisabledIsDisabledAsSoonAsTheHostIsLive) {
    host->setUserMode(false);
    Link* link = Add();
    link->setBag("{\"Enabled\":false}");
    EXPECT_TRUE(link->isEnabled());  // a designer must be able to select it
    host->setUserMode(true);
    EXPECT_FALSE(link->isEnabled());
    EXPECT_FALSE(link->control().Enabled());
}

TEST_F(LoadingTest, AWidgetWhoseHostWasTakenAwayHasTheNextHostUp) {
    auto* inner = new QWidget(window);
    Host::attach(inner, Host::make());
    Host::attach(inner, nullptr);
    EXPECT_EQ(Host::of(inner), host);
}

TEST_F(LoadingTest, EnabledIsSetAndSavedAtDesignTime) {
    host->setUserMode(false);
    Link* link = Add();
    link->setBag("{}");
    link->setProperty("Enabled", false);
    EXPECT_FALSE(link->property("Enabled").toBool());
    EXPECT_EQ(link->bag(), "{\"Enabled\":false}");
}

TEST_F(LoadingTest, AtDesignTimeTheSavedEnabledIsKept) {
    host->setUserMode(false);
    Link* link = Add();
    link->setBag("{\"Enabled\":false}");
    EXPECT_FALSE(link->property("Enabled").toBool());
    EXPECT_THAT(link->bag().toStdString(), testing::HasSubstr("\"Enabled\":false"));
}

TEST_F(LoadingTest, TheObjectNameIsTheDisplayName) {
    Link link(window);
    link.setObjectName("lnkFirst");
    EXPECT_EQ(link.control().Site()->Ambient().DisplayName(), "lnkFirst");
    link.setObjectName("lnkSecond");
    EXPECT_EQ(link.control().Site()->Ambient().DisplayName(), "lnkSecond");
    EXPECT_EQ(link.extender().Get("Name"), frame::Variant("lnkSecond"));
    link.setBag("{");
    EXPECT_THAT(Errors(), testing::HasSubstr("lnkSecond"));
}

}  // namespace
}  // namespace tessel::qt
