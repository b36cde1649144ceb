#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QApplication>
#include <QDateTime>
#include <QElapsedTimer>
#include <QFile>
#include <QGuiApplication>
#include <QImage>
#include <QLocale>
#include <QPalette>
#include <QTemporaryDir>
#include <QTest>
#include <QTimer>
#include <QWidget>
#include <functional>

#include "frame/Dates.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/FileIcons.h"
#include "hosts/qt/Services.h"
#include "tests/ErrorOf.h"

/// The services of the host for Qt by themselves.
namespace tessel::qt {
namespace {

using test::ErrorOf;

// Timers

struct Ticker final : frame::TimerClient {
    void Tick() override {
        ++ticks;
        if (onTick) onTick();
    }
    int ticks = 0;
    std::function<void()> onTick;
};

/// Lets so much time go by that a timer of a millisecond would have ticked again.
void LetTimersTick() {
    SystemClock clock;
    Ticker other;
    clock.Start(other, 2);
    EXPECT_TRUE(QTest::qWaitFor([&] { return other.ticks >= 5; }));
    clock.Stop(other);
}

TEST(SystemClockTest, TicksAgainAndAgainUntilItIsStopped) {
    SystemClock clock;
    Ticker ticker;
    clock.Start(ticker, 1);
    EXPECT_TRUE(QTest::qWaitFor([&] { return ticker.ticks >= 3; }));
    clock.Stop(ticker);
    const int ticks = ticker.ticks;
    LetTimersTick();
    EXPECT_EQ(ticker.ticks, ticks);
}

TEST(SystemClockTest, CanBeStoppedByItsOwnTick) {
    SystemClock clock;
    Ticker ticker;
    ticker.onTick = [&] { clock.Stop(ticker); };
    clock.Start(ticker, 1);
    EXPECT_TRUE(QTest::qWaitFor([&] { return ticker.ticks == 1; }));
    LetTimersTick();
    EXPECT_EQ(ticker.ticks, 1);
}

TEST(SystemClockTest, CanBeStartedAnewByItsOwnTick) {
    SystemClock clock;
    Ticker ticker;
    ticker.onTick = [&] { clock.Start(ticker, 2); };
    clock.Start(ticker, 1);
    EXPECT_TRUE(QTest::qWaitFor([&] { return ticker.ticks >= 3; }));
    clock.Stop(ticker);
}

TEST(SystemClockTest, StoppingWhatDoesNotRunIsNothing) {
    SystemClock clock;
    Ticker ticker;
    clock.Stop(ticker);
    EXPECT_EQ(ticker.ticks, 0);
}

TEST(SystemClockTest, NowIsTheLocalTime) {
    SystemClock clock;
    const QString before = QDateTime::currentDateTime().toString("yyyy-MM-dd hh:mm:ss");
    const QString now = ToQt(frame::SortableDateText(clock.Now()));
    const QString after = QDateTime::currentDateTime().toString("yyyy-MM-dd hh:mm:ss");
    EXPECT_LE(before, now);
    EXPECT_LE(now, after);
}

// The message loop

TEST(EventLoopTest, ATurnDeliversWhatIsDueAndManyWishesAreOneTurn) {
    int settled = 0;
    EventLoop loop([&] { ++settled; });
    bool delivered = false;
    QTimer::singleShot(0, [&] { delivered = true; });
    for (int wish = 0; wish < 1000; ++wish) loop.WantTurn();
    EXPECT_EQ(settled, 0);
    loop.Turn();
    EXPECT_TRUE(delivered);
    EXPECT_EQ(settled, 1);
    loop.Turn();
    EXPECT_EQ(settled, 1);
}

TEST(EventLoopTest, InARunOfTurnsAWindowIsPaintedOnceAFrameAndInTheEndAsItStands) {
    struct Window final : QWidget {
        void paintEvent(QPaintEvent*) override {
            ++paints;
            shown = state;
        }
        int paints = 0, state = 0, shown = -1;
    };
    EventLoop loop([] {});
    Window window;
    window.show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&window));
    const int before = window.paints;
    QElapsedTimer time;
    time.start();
    constexpr int turns = 2000;
    for (int turn = 1; turn <= turns; ++turn) {
        window.state = turn;
        window.update();
        loop.Turn();
    }
    const auto frames = static_cast<int>(time.elapsed() / EventLoop::frame) + 1;
    EXPECT_GE(window.paints, before + 1);
    EXPECT_LE(window.paints - before, frames + 1);
    EXPECT_TRUE(QTest::qWaitFor([&] { return window.shown == turns; }));
}

TEST(EventLoopTest, OutsideOfTurnsWindowsArePaintedAsEver) {
    EventLoop loop([] {});
    struct Window final : QWidget {
        void paintEvent(QPaintEvent*) override { ++paints; }
        int paints = 0;
    };
    Window window;
    window.show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&window));
    for (int i = 0; i < 5; ++i) {
        const int before = window.paints;
        window.update();
        QApplication::sendPostedEvents(&window, QEvent::UpdateRequest);
        QApplication::processEvents();
        EXPECT_EQ(window.paints, before + 1);
    }
}

// Chance

TEST(GeneratorTest, GivesNumbersFromZeroToBelowOneAndRepeatsThemForASeed) {
    Generator random;
    random.Restart(42);
    std::vector<float> first, second;
    for (int i = 0; i < 1000; ++i) first.push_back(random.Next());
    random.Restart(42);
    for (int i = 0; i < 1000; ++i) second.push_back(random.Next());
    EXPECT_EQ(first, second);
    EXPECT_THAT(first, testing::Each(testing::AllOf(testing::Ge(0.0f), testing::Lt(1.0f))));
    random.Restart(43);
    EXPECT_NE(random.Next(), first.front());
    for (const double odd : {0.0, -1.0, 1e300, -1e300}) {
        random.Restart(odd);
        EXPECT_LT(random.Next(), 1.0f) << odd;
    }
}

// The user's locale

class UserLocaleTest : public testing::Test {
  protected:
    UserLocaleTest() { QLocale::setDefault(QLocale(QLocale::German, QLocale::Germany)); }
    ~UserLocaleTest() override { QLocale::setDefault(QLocale::c()); }

    UserLocale locale;
};

TEST_F(UserLocaleTest, WritesAsTheUserDoes) {
    const frame::Date moment = frame::DateFrom({2001, 2, 3, 4, 5, 6});
    EXPECT_EQ(locale.Grouped(1'234'567), "1.234.567");
    EXPECT_EQ(locale.DateText(moment), "03.02.01 04:05");
    EXPECT_EQ(locale.LongDateText(moment), "Samstag, 3. Februar 2001");
}

TEST_F(UserLocaleTest, KnowsTheTimeZone) {
    const QDateTime local = QDateTime::fromSecsSinceEpoch(1'000'000'000);
    EXPECT_EQ(ToQt(frame::SortableDateText(locale.LocalTime(1'000'000'000))), local.toString("yyyy-MM-dd hh:mm:ss"));
}

// Pictures

class PicturesTest : public testing::Test {
  protected:
    std::string Name(const char* file) const { return FromQt(folder.filePath(file)); }

    QTemporaryDir folder;
    ImageLoader loader;
};

TEST_F(PicturesTest, AnImageFileIsAPictureOfItsSize) {
    QImage image(30, 20, QImage::Format_RGB32);
    image.fill(Qt::red);
    ASSERT_TRUE(image.save(folder.filePath("a.png")));
    const frame::PictureRef picture = loader.LoadPicture(Name("a.png"));
    EXPECT_EQ(picture->Width(), 450);
    EXPECT_EQ(picture->Height(), 300);
    EXPECT_EQ(picture->Source(), Name("a.png"));
    ASSERT_TRUE(picture->Plane(1));
    EXPECT_EQ(picture->Plane(1)->pixels.front(), 0xFF0000FFu);
}

TEST_F(PicturesTest, AMissingFileAndOneThatIsNoPictureAreToldApart) {
    QFile words(folder.filePath("words.png"));
    ASSERT_TRUE(words.open(QIODevice::WriteOnly));
    words.write("no picture");
    words.close();
    EXPECT_EQ(ErrorOf([&] { loader.LoadPicture(Name("none.png")); }), frame::errors::fileNotFound);
    EXPECT_EQ(ErrorOf([&] { loader.LoadPicture(Name("words.png")); }), frame::errors::invalidPicture);
    EXPECT_EQ(ErrorOf([&] { loader.LoadPicture(FromQt(folder.path())); }), frame::errors::fileNotFound);
    EXPECT_EQ(loader.LoadPicture("")->Width(), 0);
}

TEST_F(PicturesTest, FilesAndFoldersHaveIconsInTwoSizesAndTwoScales) {
    QFile words(folder.filePath("words.txt"));
    ASSERT_TRUE(words.open(QIODevice::WriteOnly));
    words.close();
    FileIcons icons;
    for (const QString& path : {folder.path(), folder.filePath("words.txt"), QString("/")}) {
        const frame::PictureRef small = icons.Of(path, 0x6605), large = icons.Of(path, 0x6604);
        ASSERT_TRUE(small && large) << path.toStdString();
        EXPECT_EQ(small->Width(), 240);
        EXPECT_EQ(large->Width(), 480);
        EXPECT_EQ(small->Plane(2)->width, 32);
        EXPECT_EQ(large->Plane(2)->height, 64);
        EXPECT_THAT(large->Plane(1)->pixels, testing::Contains(testing::Ge(0x01000000u))) << "an icon that shows nothing";
    }
    EXPECT_EQ(icons.Of(folder.filePath("none.txt"), 0x6605), nullptr);
}

TEST_F(PicturesTest, WhatLooksTheSameIsTheSamePicture) {
    for (const char* name : {"a.txt", "b.txt", "README", "LICENSE"})
        EXPECT_TRUE(QFile(folder.filePath(name)).open(QIODevice::WriteOnly));
    FileIcons icons;
    const auto icon = [&](const char* name, int flags) { return icons.Of(folder.filePath(name), flags); };
    EXPECT_EQ(icon("a.txt", 0x6605), icon("b.txt", 0x6605));
    EXPECT_NE(icon("a.txt", 0x6605), icon("a.txt", 0x6604));
    EXPECT_NE(icon(".", 0x6605), icon("a.txt", 0x6605));
}

// Colours

TEST(PaletteColorsTest, FollowTheApplicationsPalette) {
    const QPalette before = QGuiApplication::palette();
    QPalette palette = before;
    palette.setColor(QPalette::Window, QColor(1, 2, 3));
    palette.setColor(QPalette::Base, QColor(4, 5, 6));
    QGuiApplication::setPalette(palette);
    const PaletteColors colors;
    EXPECT_EQ(frame::OleTranslateColor(frame::colors::buttonFace, colors), frame::Rgb(1, 2, 3));
    EXPECT_EQ(frame::OleTranslateColor(frame::colors::windowBackground, colors), frame::Rgb(4, 5, 6));
    EXPECT_EQ(colors.Color(-1), frame::Rgb(0, 0, 0));
    EXPECT_EQ(colors.Color(1000), frame::Rgb(0, 0, 0));
    QGuiApplication::setPalette(before);
}

}  // namespace
}  // namespace tessel::qt
