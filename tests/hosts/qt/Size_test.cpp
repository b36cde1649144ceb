#include <QBoxLayout>
#include <QEvent>
#include <QFormLayout>
#include <QGridLayout>

#include "hosts/qt/Convert.h"
#include "tests/hosts/qt/QtTest.h"

namespace tessel::qt {
namespace {

class SizeTest : public test::QtTest {
  protected:
    static float Read(Link* link, const char* member) { return link->extender().Get(member).ToSingle(); }

    /// Counts the events of a type that a widget gets.
    struct Counter final : QObject {
        Counter(QObject* watched, QEvent::Type what) : type(what) { watched->installEventFilter(this); }
        bool eventFilter(QObject*, QEvent* event) override {
            if (event->type() == type) ++count;
            return false;
        }
        QEvent::Type type;
        int count = 0;
    };
};

TEST_F(SizeTest, ASizeInTwipsStaysAsItWasSet) {
    Link* link = Shown();
    link->extender().Put("Width", frame::Variant(1664.53f));
    test::Settle();
    EXPECT_EQ(Read(link, "Width"), 1664.53f);
    EXPECT_EQ(link->width(), 111);
    link->setCaption("another");
    link->setBorderSize(7);
    test::Settle();
    EXPECT_EQ(Read(link, "Width"), 1664.53f);
    EXPECT_EQ(Read(link, "Height"), 600);
}

TEST_F(SizeTest, APlaceInTwipsStaysAsItWasSet) {
    Link* link = Shown();
    link->extender().Put("Left", frame::Variant(307.25f));
    link->extender().Put("Top", frame::Variant(-22.5f));
    test::Settle();
    EXPECT_EQ(Read(link, "Left"), 307.25f);
    EXPECT_EQ(Read(link, "Top"), -22.5f);
    EXPECT_EQ(link->x(), 20);
    link->move(30, 40);
    EXPECT_EQ(Read(link, "Left"), 450);
    EXPECT_EQ(Read(link, "Top"), 600);
}

TEST_F(SizeTest, ASizeInTwipsOfAHiddenLinkIsThatOfItsWidget) {
    Link* link = Add();
    link->extender().Put("Width", frame::Variant(1664.53f));
    EXPECT_EQ(link->width(), 111);
    Show();
    EXPECT_EQ(Read(link, "Width"), 1664.53f);
}

TEST_F(SizeTest, AResizeByTheProgramReachesTheControl) {
    Link* link = Shown();
    link->resize(100, 30);
    EXPECT_EQ(link->control().Label1.Width(), 1500);
    EXPECT_EQ(link->control().Label1.Height(), 450);
    EXPECT_EQ(Read(link, "Width"), 1500);
}

TEST_F(SizeTest, AHiddenLinkHasTheSizeThatItWasGiven) {
    Link* link = Add();
    link->caption();
    link->resize(70, 20);
    EXPECT_EQ(Read(link, "Width"), 1050);
    EXPECT_EQ(link->control().Label1.Width(), 1050);
    link->resize(60, 20);
    link->press();
    EXPECT_EQ(link->control().Label1.Width(), 900);
}

TEST_F(SizeTest, AHiddenLinkHasThePlaceThatItWasGiven) {
    Link* link = Add();
    link->caption();
    link->move(50, 60);
    EXPECT_EQ(Read(link, "Left"), 750);
    EXPECT_EQ(Read(link, "Top"), 900);
}

TEST_F(SizeTest, SettingTheTopOfAHiddenLinkDoesNotBringItsOldLeftBack) {
    Link* link = Add();
    link->caption();
    link->move(50, 60);
    link->extender().Put("Top", frame::Variant(300));
    EXPECT_EQ(link->pos(), QPoint(50, 20));
}

TEST_F(SizeTest, ALinkThatWasHiddenAndResizedIsRightWhenItIsShownAgain) {
    Link* link = Shown();
    link->hide();
    link->setGeometry(5, 6, 77, 22);
    link->show();
    test::Settle();
    EXPECT_EQ(link->geometry(), QRect(5, 6, 77, 22));
    EXPECT_EQ(link->control().Label1.Width(), 77 * 15);
    EXPECT_EQ(Read(link, "Left"), 75);
}

TEST_F(SizeTest, ALinkThatWasNeverSizedHasTheSizeOfItsDesign) {
    auto* link = new Link(window);
    const frame::TextSize design = link->control().DesignSize();
    test::Settle();
    EXPECT_EQ(Read(link, "Width"), design.width);
    EXPECT_EQ(link->size(), PixelRect(0, 0, design.width, design.height).size());
    Show();
    EXPECT_EQ(link->size(), PixelRect(0, 0, design.width, design.height).size());
}

TEST_F(SizeTest, ALinkSizedByItsBagAloneHasTheSizeOfItsDesignToo) {
    auto* link = new Link(window);
    link->setBag("{}");
    EXPECT_EQ(Read(link, "Width"), link->control().DesignSize().width);
    EXPECT_EQ(link->width(), Pixels(link->control().DesignSize().width));
}

TEST_F(SizeTest, ALinkAsAWindowIsSizedToo) {
    Link link;
    Host::attach(&link, host);
    link.setCaption("alone");
    link.resize(150, 50);
    link.show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&link));
    EXPECT_EQ(link.control().Label1.Width(), link.width() * 15);
}

TEST_F(SizeTest, ANegativeSizeIsNone) {
    Link* link = Shown();
    link->extender().Put("Width", frame::Variant(-100));
    test::Settle();
    EXPECT_EQ(Read(link, "Width"), 0);
    EXPECT_EQ(link->width(), 0);
    link->extender().Put("Width", frame::Variant(1500));
    EXPECT_EQ(link->width(), 100);
}

TEST_F(SizeTest, AMaximumSizeOfTheWidgetIsASizeThatTheControlKnows) {
    Link* link = Shown();
    link->setMaximumWidth(90);
    test::Settle();
    EXPECT_EQ(link->width(), 90);
    EXPECT_EQ(Read(link, "Width"), 1350);
}

// AutoSize.

TEST_F(SizeTest, AnAutoSizedLinkFollowsItsText) {
    Link* link = Shown();
    link->setAutoSize(true);
    test::Settle();
    const QSize before = link->size();
    EXPECT_LT(before.width(), 200);
    link->setCaption("a good deal longer than the caption before");
    test::Settle();
    EXPECT_GT(link->width(), before.width());
    EXPECT_EQ(link->height(), before.height());
    EXPECT_EQ(link->size(), link->sizeHint());
    EXPECT_EQ(link->width(), Pixels(Read(link, "Width")));
    EXPECT_EQ(link->control().Label1.Width(), Read(link, "Width"));
}

TEST_F(SizeTest, AnAutoSizedLinkFollowsItsFont) {
    Link* link = Shown();
    link->setAutoSize(true);
    const QSize before = link->size();
    QFont font("DejaVu Sans");
    font.setPixelSize(40);
    link->setFont(font);
    test::Settle();
    EXPECT_GT(link->height(), before.height());
    EXPECT_EQ(link->size(), link->sizeHint());
}

TEST_F(SizeTest, ASizeGivenToAnAutoSizedLinkDoesNotStay) {
    Link* link = Shown();
    link->setAutoSize(true);
    const QSize own = link->size();
    link->resize(300, 100);
    test::Settle();
    EXPECT_EQ(link->size(), own);
    EXPECT_EQ(link->control().Label1.Width(), Read(link, "Width"));
}

TEST_F(SizeTest, AnAutoSizedLinkShowsAllOfItsText) {
    Link* link = Shown();
    link->setBackColor(Qt::white);
    link->setCaption("Wide MMMMW jgqy");
    link->setAutoSize(true);
    test::Settle();
    const QImage tight = link->grab().toImage().convertToFormat(QImage::Format_RGB32);
    link->setAutoSize(false);
    link->resize(300, 100);
    test::Settle();
    const QImage loose = link->grab().toImage().convertToFormat(QImage::Format_RGB32);
    EXPECT_EQ(test::InkOf(tight).size(), test::InkOf(loose).size());
}

template <class Layout>
Layout* LayOut(QWidget* window, QWidget* one, QWidget* two) {
    auto* layout = new Layout(window);
    layout->addWidget(one);
    layout->addWidget(two);
    return layout;
}

TEST_F(SizeTest, ALayoutGivesTheLinkItsSize) {
    Link* link = Add();
    LayOut<QVBoxLayout>(window, link, new QWidget);
    Show();
    test::Settle();
    EXPECT_GT(link->width(), 350);
    EXPECT_EQ(link->control().Label1.Width(), link->width() * 15);
    window->resize(250, 200);
    test::Settle();
    EXPECT_LT(link->width(), 250);
    EXPECT_EQ(link->control().Label1.Width(), link->width() * 15);
}

TEST_F(SizeTest, ALinkInALayoutHasRoomForItsText) {
    Link* link = Add();
    link->setCaption("A caption of some length, all of which should be there");
    auto* layout = LayOut<QHBoxLayout>(window, link, new QWidget);
    layout->setStretch(1, 1);
    Show();
    const frame::TextSize text = host->frameHost().Metrics().Measure(*link->control().Font(), link->control().Caption());
    EXPECT_GE(link->width() * 15 + 15, text.width);
    EXPECT_GE(link->height() * 15 + 15, text.height);
}

TEST_F(SizeTest, ALongerCaptionInALayoutGetsMoreRoom) {
    Link* link = Add();
    link->setCaption("short");
    auto* layout = LayOut<QHBoxLayout>(window, link, new QWidget);
    layout->setStretch(1, 1);
    Show();
    const int before = link->width();
    link->setCaption("a good deal longer than short");
    test::Settle();
    EXPECT_GT(link->width(), before);
}

TEST_F(SizeTest, AnAutoSizedLinkInALayoutSettles) {
    Link* link = Add();
    link->setAutoSize(true);
    auto* layout = LayOut<QVBoxLayout>(window, link, new QWidget);
    layout->setStretch(1, 1);
    Counter resizes(link, QEvent::Resize), layouts(window, QEvent::LayoutRequest);
    Show();
    link->setCaption("a caption of another length");
    for (int i = 0; i < 20; ++i) test::Settle();
    EXPECT_LT(resizes.count, 10);
    EXPECT_LT(layouts.count, 10);
    const int asked = layouts.count;
    for (int i = 0; i < 20; ++i) test::Settle();
    EXPECT_EQ(layouts.count, asked);
    const frame::TextSize text = host->frameHost().Metrics().Measure(*link->control().Font(), link->control().Caption());
    EXPECT_EQ(link->sizeHint(), PixelRect(0, 0, text.width, text.height).size());
    EXPECT_EQ(link->control().Label1.Width(), text.width);
}

TEST_F(SizeTest, AnAutoSizedLinkInARowTakesNoMoreThanItsText) {
    Link* link = Add();
    link->setAutoSize(true);
    auto* layout = LayOut<QHBoxLayout>(window, link, new QWidget);
    layout->setStretch(1, 1);
    Show();
    test::Settle();
    EXPECT_EQ(link->width(), link->sizeHint().width());
    link->setCaption("longer than before");
    test::Settle();
    EXPECT_EQ(link->width(), link->sizeHint().width());
}

TEST_F(SizeTest, AnAutoSizedLinkFreedFromItsLayoutHasTheSizeOfItsText) {
    Link* link = Add();
    link->setAutoSize(true);
    auto* layout = LayOut<QVBoxLayout>(window, link, new QWidget);
    Show();
    test::Settle();
    layout->removeWidget(link);
    link->setCaption("freed");
    test::Settle();
    EXPECT_EQ(link->size(), link->sizeHint());
}

TEST_F(SizeTest, InnerLayoutsCountAsLayouts) {
    Link* link = Add();
    link->setAutoSize(true);
    auto* outer = new QGridLayout(window);
    auto* inner = new QVBoxLayout;
    outer->addLayout(inner, 0, 0);
    inner->addWidget(link);
    Counter layouts(window, QEvent::LayoutRequest);
    Show();
    for (int i = 0; i < 20; ++i) test::Settle();
    EXPECT_LT(layouts.count, 10);
    EXPECT_EQ(link->control().Label1.Width(), Read(link, "Width"));
}

TEST_F(SizeTest, TheHintOfALinkWithABorderHoldsItsTextToo) {
    Link* link = Shown();
    link->setBorderStyle(Link::FixedSingle);
    const QSize hint = link->sizeHint();
    link->setAutoSize(true);
    test::Settle();
    EXPECT_EQ(link->size(), hint);
    EXPECT_EQ(link->sizeHint(), hint);
    link->setBorderStyle(Link::None);
    test::Settle();
    EXPECT_LT(link->width(), hint.width());
    EXPECT_EQ(link->size(), link->sizeHint());
}

TEST_F(SizeTest, OnlyTheTextOfAnAutoSizedLinkInALayoutHasTheHand) {
    Link* link = Add();
    link->setCaption("short");
    link->setAutoSize(true);
    LayOut<QVBoxLayout>(window, link, new QWidget);
    Show();
    test::Settle();
    ASSERT_GT(link->width(), 200);
    EXPECT_EQ(window->childAt(At(link, {5, 5}))->cursor().shape(), Qt::PointingHandCursor);
    EXPECT_NE(window->childAt(At(link, {link->width() - 5, 5}))->cursor().shape(), Qt::PointingHandCursor);
}

TEST_F(SizeTest, AnAutoSizedLinkInALayoutIsPressedOnItsText) {
    Link* link = Add();
    link->setCaption("short");
    link->setLinkTo("a.txt");
    link->setAutoSize(true);
    LayOut<QVBoxLayout>(window, link, new QWidget);
    for (const auto direction : {Qt::LeftToRight, Qt::RightToLeft}) {
        window->setLayoutDirection(direction);
        Show();
        test::Settle();
        const QRect ink = test::InkOf(link->grab().toImage().convertToFormat(QImage::Format_RGB32));
        EXPECT_EQ(ink.left() > link->width() / 2, direction == Qt::RightToLeft);
        Click(link, ink.center());
        EXPECT_EQ(Executed(), "open a.txt");
    }
}

// WordWrap.

TEST_F(SizeTest, AWrappedLinkIsHigherWhereItIsNarrower) {
    Link* link = Add();
    EXPECT_FALSE(link->hasHeightForWidth());
    link->setWordWrap(true);
    link->setCaption("several words that do not fit into one line of a narrow link");
    EXPECT_TRUE(link->hasHeightForWidth());
    EXPECT_GT(link->heightForWidth(80), link->heightForWidth(160));
    EXPECT_GT(link->heightForWidth(160), link->heightForWidth(2000));
    EXPECT_EQ(link->heightForWidth(2000), link->heightForWidth(3000));
    EXPECT_GT(link->heightForWidth(0), 0);
    EXPECT_GT(link->heightForWidth(-5), 0);
}

TEST_F(SizeTest, ALayoutGivesAWrappedLinkTheHeightOfItsLines) {
    Link* link = Add();
    link->setWordWrap(true);
    link->setCaption("several words that do not fit into one line of a narrow link, and some more of them");
    auto* layout = LayOut<QVBoxLayout>(window, link, new QWidget);
    layout->setStretch(1, 1);
    window->resize(150, 300);
    Show();
    test::Settle();
    EXPECT_GE(link->height(), link->heightForWidth(link->width()));
    EXPECT_GT(link->height(), 30);
}

TEST_F(SizeTest, AnAutoSizedWrappedLinkKeepsItsWidthAndTakesTheHeight) {
    Link* link = Shown();
    link->resize(100, 10);
    link->setCaption("several words that do not fit into one line of a narrow link");
    link->setWordWrap(true);
    link->setAutoSize(true);
    test::Settle();
    EXPECT_EQ(link->width(), 100);
    EXPECT_EQ(link->height(), link->heightForWidth(100));
    link->resize(200, 10);
    test::Settle();
    EXPECT_EQ(link->width(), 200);
    EXPECT_EQ(link->height(), link->heightForWidth(200));
}

TEST_F(SizeTest, AnAutoSizedWrappedLinkInALayoutSettles) {
    Link* link = Add();
    link->setCaption("several words that do not fit into one line of a narrow link, and some more of them");
    link->setWordWrap(true);
    link->setAutoSize(true);
    auto* layout = LayOut<QVBoxLayout>(window, link, new QWidget);
    layout->setStretch(1, 1);
    Counter layouts(window, QEvent::LayoutRequest);
    Show();
    for (const int width : {150, 300, 120}) {
        window->resize(width, 300);
        for (int i = 0; i < 10; ++i) test::Settle();
    }
    EXPECT_LT(layouts.count, 40);
    EXPECT_GE(link->height(), link->heightForWidth(link->width()));
    const int asked = layouts.count;
    for (int i = 0; i < 10; ++i) test::Settle();
    EXPECT_EQ(layouts.count, asked);
}

TEST_F(SizeTest, AHugeCaptionHasASize) {
    Link* link = Shown();
    link->setAutoSize(true);
    link->setCaption(QString(20000, 'M'));
    test::Settle();
    EXPECT_GT(link->width(), 20000);
    link->setCaption("");
    test::Settle();
    EXPECT_GE(link->width(), 0);
    EXPECT_LT(link->width(), 20);
}

}  // namespace
}  // namespace tessel::qt
