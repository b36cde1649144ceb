#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QApplication>
#include <QCursor>
#include <QPaintEvent>
#include <QPalette>
#include <QTest>
#include <algorithm>
#include <cmath>

#include "frame/ClassTable.h"
#include "frame/child/PictureBox.h"
#include "hosts/qt/SurfaceCanvas.h"
#include "tests/hosts/qt/OnScreen.h"

namespace tessel::qt::test {
namespace {

using frame::ScaleModeConstants;
namespace draw = frame::draw;

constexpr frame::OLE_COLOR red = 0x0000FF, blue = 0xFF0000, white = 0xFFFFFF;
constexpr int boxLeft = 10, boxTop = 20, boxWidth = 60, boxHeight = 40, border = 2;

class Easel final : public frame::Control {
  public:
    explicit Easel(frame::Host& host) : Control(host) {
        Picture1.MouseDown.To<&Easel::Down>(*this);
        Picture1.MouseMove.To<&Easel::Move>(*this);
        Picture1.MouseUp.To<&Easel::Up>(*this);
        Picture1.Click.To<&Easel::Click>(*this);
        Picture1.KeyDown.To<&Easel::KeyDown>(*this);
        Picture1.KeyPress.To<&Easel::KeyPress>(*this);
    }
    frame::TextSize DesignSize() const override { return {Twips(100), Twips(100)}; }
    const frame::ClassTable& Table() const override {
        static constexpr frame::ClassTable easel{.name = "Easel", .members = {}};
        return easel;
    }

    child::PictureBox Picture1{*this, "Picture1"};
    std::vector<std::string> heard;

  private:
    static std::string Number(float value) { return std::to_string(static_cast<int>(std::lround(value))); }
    void Down(std::int16_t button, std::int16_t, float x, float y) {
        heard.push_back("down " + std::to_string(button) + " at " + Number(x) + "," + Number(y));
    }
    void Move(std::int16_t, std::int16_t, float, float) {}
    void Up(std::int16_t, std::int16_t, float x, float y) { heard.push_back("up at " + Number(x) + "," + Number(y)); }
    void Click() { heard.emplace_back("click"); }
    void KeyDown(std::int16_t code, std::int16_t) { heard.push_back("key " + std::to_string(code)); }
    void KeyPress(std::int16_t ascii) { heard.push_back("types " + std::to_string(ascii)); }
};

/// A white box of 56 by 36 pixels inside a border, in pixels.
class PictureBoxPeerTest : public testing::Test {
  protected:
    PictureBoxPeerTest() {
        box.Move(Twips(boxLeft), Twips(boxTop), Twips(boxWidth), Twips(boxHeight));
        box.SetScaleMode(ScaleModeConstants::Pixels);
        box.SetBackColor(white);
        screen.Settle();
        shown = screen.window.findChild<QWidget*>("Picture1");
    }

    double Scale() const { return shown->devicePixelRatioF(); }
    /// What the box shows, in the pixels of the screen.
    QImage Seen() {
        screen.Settle();
        QImage image = shown->grab().toImage();
        image.setDevicePixelRatio(1);
        return image;
    }
    /// The colour in the middle of a pixel of the inside.
    QColor SeenAt(int x, int y) {
        const QImage seen = Seen();
        const auto place = [&](int at) { return static_cast<int>((at + border + 0.5) * Scale()); };
        return seen.pixelColor(place(x), place(y));
    }

    OnScreen<Easel> screen{100, 100};
    Easel& easel = screen.widget->owner();
    child::PictureBox& box = easel.Picture1;
    QWidget* shown = nullptr;
};

TEST_F(PictureBoxPeerTest, ABoxStandsAtItsPlaceWithTheLookOfItsState) {
    ASSERT_TRUE(shown);
    EXPECT_EQ(shown->geometry(), QRect(boxLeft, boxTop, boxWidth, boxHeight));
    EXPECT_TRUE(shown->isVisible());
    box.SetToolTipText("93%");
    box.SetEnabled(false);
    constexpr std::int16_t crossPointer = 2;
    box.SetMousePointer(crossPointer);
    screen.Settle();
    EXPECT_EQ(shown->toolTip(), "93%");
    EXPECT_FALSE(shown->isEnabled());
    EXPECT_EQ(shown->cursor().shape(), Qt::CrossCursor);
    box.SetMousePointer(0);
    box.SetVisible(false);
    screen.Settle();
    EXPECT_FALSE(shown->testAttribute(Qt::WA_SetCursor));
    EXPECT_TRUE(shown->isHidden());
}

TEST_F(PictureBoxPeerTest, TheBackgroundThePictureAndTheDrawingShow) {
    box.SetPicture(Square(4, 0xFF00FF00u, {1, 2}));
    EXPECT_EQ(SeenAt(1, 1), QColor(Qt::green)) << "at its natural size from the top left";
    EXPECT_EQ(SeenAt(5, 1), QColor(Qt::white));
    box.Line(2, 2, 10, 10, red, draw::Box::Filled);
    EXPECT_EQ(SeenAt(1, 1), QColor(Qt::green));
    EXPECT_EQ(SeenAt(3, 3), QColor(Qt::red));
    EXPECT_EQ(SeenAt(10, 10), QColor(Qt::red));
    EXPECT_EQ(SeenAt(20, 10), QColor(Qt::white));
}

TEST_F(PictureBoxPeerTest, ALineOfWidthOneIsSharpAtTheScaleOfTheScreen) {
    box.Line(0, 10, 30, 10, red);
    const QImage seen = Seen();
    const int column = static_cast<int>((border + 5) * Scale());
    std::vector<int> rows;
    for (int y = 0; y < seen.height(); ++y) {
        const QColor color = seen.pixelColor(column, y);
        if (color == QColor(Qt::red)) rows.push_back(y);
        const bool isInside = y >= std::ceil(border * Scale()) && y < seen.height() - std::ceil(border * Scale());
        EXPECT_TRUE(!isInside || color == QColor(Qt::red) || color == QColor(Qt::white)) << "no mixed colour in row " << y;
    }
    ASSERT_EQ(rows.size(), static_cast<std::size_t>(std::lround(Scale())));
    EXPECT_EQ(rows.back() - rows.front() + 1, static_cast<int>(rows.size()));
}

TEST_F(PictureBoxPeerTest, EachPixelIsTheSquareOfTheScreensPixelsThatStandsForIt) {
    box.Line(4, 4, 8, 4, red);
    box.Line(12, 4, 16, 8, red, draw::Box::Outline);
    box.PSet(20, 4, red);
    box.Line(24, 8, 24, 4, red);
    EXPECT_EQ(SeenAt(3, 4), QColor(Qt::white));
    EXPECT_EQ(SeenAt(4, 4), QColor(Qt::red));
    EXPECT_EQ(SeenAt(7, 4), QColor(Qt::red));
    EXPECT_EQ(SeenAt(8, 4), QColor(Qt::white)) << "a line ends before its last pixel";
    EXPECT_EQ(SeenAt(4, 3), QColor(Qt::white));
    EXPECT_EQ(SeenAt(4, 5), QColor(Qt::white));
    EXPECT_EQ(SeenAt(12, 4), QColor(Qt::red));
    EXPECT_EQ(SeenAt(16, 8), QColor(Qt::red));
    EXPECT_EQ(SeenAt(11, 4), QColor(Qt::white));
    EXPECT_EQ(SeenAt(14, 6), QColor(Qt::white));
    EXPECT_EQ(SeenAt(20, 4), QColor(Qt::red));
    EXPECT_EQ(SeenAt(19, 4), QColor(Qt::white));
    EXPECT_EQ(SeenAt(21, 4), QColor(Qt::white));
    EXPECT_EQ(SeenAt(24, 8), QColor(Qt::red));
    EXPECT_EQ(SeenAt(24, 5), QColor(Qt::red));
    EXPECT_EQ(SeenAt(24, 4), QColor(Qt::white));
}

TEST_F(PictureBoxPeerTest, XorTwiceLeavesTheScreenAsItWas) {
    box.Line(10, 10, 20, 20, blue, draw::Box::Filled);
    const QImage before = Seen();
    box.SetDrawMode(draw::xorPen);
    for (int pass = 0; pass < 2; ++pass) {
        box.Line(0, 0, 30, 17, white);
        box.Line(3, 3, 30, 30, white, draw::Box::Outline);
        box.Line(5, 5, 15, 15, white, draw::Box::Filled);
        box.Circle(20, 20, 9, white);
        box.PSet(40, 4, white);
        EXPECT_EQ(Seen() == before, pass == 1);
    }
}

TEST_F(PictureBoxPeerTest, XorTwiceWithAWidePenLeavesTheScreenAsItWas) {
    frame::OwnSurface& own = easel.Surface();
    own.SetScaleMode(ScaleModeConstants::Pixels);
    own.SetBackColor(white);
    const auto look = [&] {
        screen.Settle();
        return screen.widget->grab().toImage();
    };
    using Shape = void (*)(frame::DrawingSurface&);
    constexpr Shape shapes[] = {
        [](frame::DrawingSurface& surface) { surface.Line(0, 0, 30, 17, white); },
        [](frame::DrawingSurface& surface) { surface.Line(30, 9, 2, 9, white); },
        [](frame::DrawingSurface& surface) { surface.Line(3, 3, 30, 30, white, draw::Box::Outline); },
        [](frame::DrawingSurface& surface) { surface.Line(5, 5, 15, 15, white, draw::Box::Filled); },
        [](frame::DrawingSurface& surface) { surface.Circle(20, 20, 9, white); },
        [](frame::DrawingSurface& surface) { surface.Circle(20, 20, 11, white, 0.5f, 4.0f, 0.5f); },
        [](frame::DrawingSurface& surface) { surface.PSet(40, 4, white); },
    };
    for (frame::DrawingSurface* surface : {static_cast<frame::DrawingSurface*>(&box), static_cast<frame::DrawingSurface*>(&own)}) {
        surface->SetDrawMode(draw::copyPen);
        surface->SetDrawWidth(1);
        surface->Line(10, 10, 20, 20, blue, draw::Box::Filled);
        const QImage before = look();
        const frame::PictureRef image = surface->Image();
        surface->SetDrawMode(draw::xorPen);
        for (const std::int16_t width : {2, 5}) {
            surface->SetDrawWidth(width);
            for (std::size_t i = 0; i < std::size(shapes); ++i) {
                shapes[i](*surface);
                EXPECT_FALSE(look() == before) << i << " shows, with a pen of " << width;
                shapes[i](*surface);
                EXPECT_TRUE(look() == before) << i << ", with a pen of " << width;
                EXPECT_TRUE(surface->Image()->EqualsObject(*image)) << i << ", with a pen of " << width;
            }
        }
    }
}

TEST_F(PictureBoxPeerTest, AFilledBoxWithoutAnOutlineIsTheSquaresOfThePixelsInsideOnly) {
    // On a screen of one and a half, too, these squares begin and end between two of its pixels.
    constexpr int left = 3, top = 5, right = 10, bottom = 12;
    const auto edge = [&](int pixel) { return static_cast<int>(std::lround((border + pixel) * Scale())); };
    const QRect inside(QPoint(edge(left + 1), edge(top + 1)), QPoint(edge(right) - 1, edge(bottom) - 1));
    box.SetDrawStyle(draw::transparent);
    for (const std::int16_t width : {1, 2, 5}) {
        for (const bool backwards : {false, true}) {
            box.Cls();
            box.SetDrawWidth(width);
            if (backwards)
                box.Line(right, bottom, left, top, red, draw::Box::Filled);
            else
                box.Line(left, top, right, bottom, red, draw::Box::Filled);
            const QImage seen = Seen();
            QRect filled;
            int count = 0, mixed = 0;
            for (int y = edge(0); y < edge(boxHeight - 2 * border); ++y) {
                for (int x = edge(0); x < edge(boxWidth - 2 * border); ++x) {
                    const QColor color = seen.pixelColor(x, y);
                    mixed += color != QColor(Qt::red) && color != QColor(Qt::white) ? 1 : 0;
                    if (color != QColor(Qt::red)) continue;
                    ++count;
                    filled |= QRect(x, y, 1, 1);
                }
            }
            EXPECT_EQ(filled, inside) << "with a pen of " << width;
            EXPECT_EQ(count, inside.width() * inside.height()) << "with a pen of " << width;
            EXPECT_EQ(mixed, 0);
            EXPECT_EQ(box.Point(left + 1, top + 1), static_cast<int>(red.value));
            EXPECT_EQ(box.Point(right - 1, bottom - 1), static_cast<int>(red.value));
            EXPECT_EQ(box.Point(left, top + 1), static_cast<int>(white.value));
            EXPECT_EQ(box.Point(right, bottom - 1), static_cast<int>(white.value));
            EXPECT_EQ(box.Point(left + 1, bottom), static_cast<int>(white.value));
        }
    }
}

TEST_F(PictureBoxPeerTest, ABoxWithoutAnOutlineAndWithoutAnInsideShowsNothing) {
    const QImage before = Seen();
    box.SetDrawStyle(draw::transparent);
    box.Line(20, 5, 21, 12, red, draw::Box::Filled);
    box.Line(30, 5, 30, 12, red, draw::Box::Filled);
    box.Line(5, 20, 12, 20, red, draw::Box::Filled);
    box.Line(5, 25, 12, 24, red, draw::Box::Filled);
    EXPECT_TRUE(Seen() == before);
    box.Line(20, 5, 22, 12, red, draw::Box::Filled);
    EXPECT_FALSE(Seen() == before) << "one pixel inside is one column";
}

TEST_F(PictureBoxPeerTest, PointAndImageHaveThePrintedText) {
    box.SetForeColor(blue);
    box.SetCurrentX(2);
    box.Print("MMM");
    int inked = 0;
    for (float y = 0; y < box.ScaleHeight(); ++y)
        for (float x = 0; x < box.ScaleWidth(); ++x) inked += box.Point(x, y) != static_cast<int>(white.value) ? 1 : 0;
    EXPECT_GT(inked, 20);
    const frame::PictureRef image = box.Image();
    const frame::PixelPlane* plane = image->Plane(1);
    ASSERT_TRUE(plane);
    EXPECT_EQ(plane->width, boxWidth - 2 * border);
    EXPECT_EQ(std::count_if(plane->pixels.begin(), plane->pixels.end(), [](auto pixel) { return pixel != 0xFFFFFFFFu; }), inked);
    const frame::PixelPlane* sharp = image->Plane(Scale());
    ASSERT_TRUE(sharp);
    EXPECT_EQ(sharp->scale, Scale());
    EXPECT_EQ(sharp->width, static_cast<int>(std::ceil((boxWidth - 2 * border) * Scale())));
}

TEST_F(PictureBoxPeerTest, ADrawingOutlivesHidingAndAnotherSize) {
    box.Line(2, 2, 10, 10, red, draw::Box::Filled);
    screen.Settle();
    box.SetVisible(false);
    screen.Settle();
    box.SetVisible(true);
    box.Move(Twips(boxLeft), Twips(boxTop), Twips(boxWidth + 20), Twips(boxHeight + 20));
    EXPECT_EQ(SeenAt(5, 5), QColor(Qt::red));
    EXPECT_EQ(SeenAt(60, 40), QColor(Qt::white));
}

TEST_F(PictureBoxPeerTest, ColorsOfTheSystemFollowThePaletteAndTheDrawingStays) {
    box.SetBackColor(frame::colors::windowBackground);
    box.Line(2, 2, 10, 10, red, draw::Box::Filled);
    box.Line(20, 2, 30, 10, frame::colors::windowText, draw::Box::Filled);
    const QPalette before = QApplication::palette();
    QPalette dark = before;
    dark.setColor(QPalette::Base, QColor(20, 30, 40));
    dark.setColor(QPalette::WindowText, QColor(200, 210, 220));
    dark.setColor(QPalette::Text, QColor(200, 210, 220));
    EXPECT_EQ(SeenAt(15, 5), before.color(QPalette::Base));
    QApplication::setPalette(dark);
    EXPECT_EQ(SeenAt(15, 5), QColor(20, 30, 40));
    EXPECT_EQ(SeenAt(25, 5), QColor(200, 210, 220));
    EXPECT_EQ(SeenAt(5, 5), QColor(Qt::red));
    EXPECT_EQ(box.Point(15, 5), static_cast<int>(frame::Rgb(20, 30, 40).value));
    QApplication::setPalette(before);
}

TEST_F(PictureBoxPeerTest, ANewBackgroundOrPictureWipesWhatTheScreenShows) {
    box.Line(0, 0, 60, 40, red, draw::Box::Filled);
    EXPECT_EQ(SeenAt(5, 5), QColor(Qt::red));
    box.SetBackColor(blue);
    EXPECT_EQ(SeenAt(5, 5), QColor(Qt::blue));
    box.Line(0, 0, 60, 40, red, draw::Box::Filled);
    box.SetPicture(Square(3, 0xFF00FF00u));
    EXPECT_EQ(SeenAt(1, 1), QColor(Qt::green));
    EXPECT_EQ(SeenAt(5, 5), QColor(Qt::blue));
}

TEST_F(PictureBoxPeerTest, AControlsOwnSurfaceIsWipedToo) {
    frame::OwnSurface& surface = easel.Surface();
    surface.Line(0, 0, Twips(100), Twips(100), red, draw::Box::Filled);
    EXPECT_EQ(PixelOf(*screen.widget, 90, 90), QColor(Qt::red));
    surface.SetBackColor(blue);
    EXPECT_EQ(PixelOf(*screen.widget, 90, 90), QColor(Qt::blue));
    surface.Line(0, 0, Twips(100), Twips(100), red, draw::Box::Filled);
    surface.SetPicture(Square(3, 0xFF00FF00u));
    EXPECT_EQ(PixelOf(*screen.widget, 90, 90), QColor(Qt::blue));
    EXPECT_EQ(PixelOf(*screen.widget, 1, 1), QColor(Qt::green));
}

TEST_F(PictureBoxPeerTest, AControlsOwnSurfaceIsReadBackAtScaleOneAndAtTheScreens) {
    frame::OwnSurface& surface = easel.Surface();
    surface.SetScaleMode(ScaleModeConstants::Pixels);
    surface.SetBackColor(white);
    EXPECT_EQ(surface.Point(0, 0), static_cast<int>(white.value)) << "before anything is drawn";
    EXPECT_EQ(surface.Point(99, 99), static_cast<int>(white.value));
    surface.Line(80, 80, 89, 89, red, draw::Box::Filled);
    EXPECT_EQ(surface.Point(89, 89), static_cast<int>(red.value));
    EXPECT_EQ(surface.Point(90, 90), static_cast<int>(white.value));
    EXPECT_EQ(surface.Point(100, 0), -1);
    const frame::PictureRef image = surface.Image();
    const frame::PixelPlane* plain = image->Plane(1);
    ASSERT_TRUE(plain);
    EXPECT_EQ(plain->scale, 1);
    ASSERT_EQ(plain->width, 100);
    ASSERT_EQ(plain->height, 100);
    EXPECT_EQ(std::count(plain->pixels.begin(), plain->pixels.end(), 0xFF0000FFu), 100);
    const frame::PixelPlane* sharp = image->Plane(Scale());
    ASSERT_TRUE(sharp);
    EXPECT_EQ(sharp->scale, Scale());
    ASSERT_EQ(sharp->width, static_cast<int>(std::ceil(100 * Scale())));
    const auto side = std::lround(10 * Scale());  // of the box, which begins and ends between two pixels of the screen
    EXPECT_EQ(std::count(sharp->pixels.begin(), sharp->pixels.end(), 0xFF0000FFu), side * side);
    EXPECT_EQ(PixelOf(*screen.widget, 89, 89), QColor(Qt::red)) << "which is what shows";
    EXPECT_EQ(PixelOf(*screen.widget, 90, 90), QColor(Qt::white));
}

TEST_F(PictureBoxPeerTest, TheBorderIsDarkerAboveAndLighterBelowOnAnyGround) {
    const QPalette before = QApplication::palette();
    for (const int grey : {239, 60}) {
        QPalette palette = before;
        palette.setColor(QPalette::Window, QColor(grey, grey, grey));
        QApplication::setPalette(palette);
        QApplication::processEvents();
        const QImage seen = Seen();
        const int middle = seen.width() / 2;
        EXPECT_LT(seen.pixelColor(middle, 0).lightness(), grey);
        EXPECT_GT(seen.pixelColor(middle, seen.height() - 1).lightness(), grey);
    }
    QApplication::setPalette(before);
    box.SetBorderStyle(0);
    box.Line(0, 0, 60, 40, red, draw::Box::Filled);
    EXPECT_EQ(Seen().pixelColor(0, 0), QColor(Qt::red));
}

TEST_F(PictureBoxPeerTest, TheMouseIsReportedInTwipsFromTheInsideOfTheBorderInAnyScale) {
    for (const auto scale : {ScaleModeConstants::Pixels, ScaleModeConstants::Twips, ScaleModeConstants::Inches}) {
        box.SetScaleMode(scale);
        easel.heard.clear();
        QTest::mousePress(shown, Qt::LeftButton, {}, {12, 7});
        QTest::mouseRelease(shown, Qt::LeftButton, {}, {13, 7});
        EXPECT_THAT(easel.heard, testing::ElementsAre("down 1 at 150,75", "up at 165,75", "click"));
    }
    easel.heard.clear();
    box.SetBorderStyle(0);
    QTest::mousePress(shown, Qt::RightButton, {}, {12, 7});
    QTest::mouseRelease(shown, Qt::RightButton, {}, {12, 7});
    EXPECT_THAT(easel.heard, testing::ElementsAre("down 2 at 180,105", "up at 180,105"));
}

TEST_F(PictureBoxPeerTest, AClickGivesTheFocusAndKeysAreReported) {
    QTest::mouseClick(shown, Qt::LeftButton, {}, {12, 7});
    EXPECT_TRUE(shown->hasFocus());
    easel.heard.clear();
    QTest::keyClick(shown, Qt::Key_A);
    EXPECT_THAT(easel.heard, testing::ElementsAre("key 65", "types 97"));
}

/// Notes what a widget paints.
class PaintWatch final : public QObject {
  public:
    QRect painted;

  protected:
    bool eventFilter(QObject*, QEvent* event) override {
        if (event->type() == QEvent::Paint) painted |= static_cast<QPaintEvent*>(event)->rect();
        return false;
    }
};

TEST_F(PictureBoxPeerTest, AnOperationPaintsNoMoreThanItTouches) {
    box.Line(0, 0, 60, 40, blue, draw::Box::Filled);
    screen.Settle();
    for (int turn = 0; turn < 3; ++turn) QApplication::processEvents();
    PaintWatch watch;
    shown->installEventFilter(&watch);
    box.Line(10, 10, 14, 12, red, draw::Box::Filled);
    screen.Settle();
    for (int turn = 0; turn < 3; ++turn) QApplication::processEvents();
    EXPECT_TRUE(watch.painted.contains(QRect(12, 12, 5, 3))) << "the box, from the corner of the inside";
    EXPECT_LE(watch.painted.width(), 12);
    EXPECT_LE(watch.painted.height(), 10);
}

/// A widget that can be taken to a screen of another scale.
class Movable final : public QWidget {
  public:
    double scale = 1;

  protected:
    int metric(PaintDeviceMetric metric) const override {
        if (metric == PdmDevicePixelRatioScaled) return static_cast<int>(scale * devicePixelRatioFScale());
        return metric == PdmDevicePixelRatio ? static_cast<int>(scale) : QWidget::metric(metric);
    }
};

class Paper final : public frame::DrawingSurface {
  public:
    explicit Paper(frame::Host& host) : DrawingSurface(host) {
        SetScaleMode(ScaleModeConstants::Pixels);
        SetBackColor(white);
    }

  protected:
    frame::TextSize InnerSize() const override { return {Twips(20), Twips(10)}; }
};

int InkedRows(const QImage& image, int column) {
    int rows = 0;
    for (int y = 0; y < image.height(); ++y) rows += image.pixelColor(column, y) == QColor(Qt::red) ? 1 : 0;
    return rows;
}

class SurfaceCanvasTest : public testing::Test {
  protected:
    SurfaceCanvasTest() {
        canvas.ShowOn(&widget, {});
        paper.AddCanvas(canvas);
    }
    ~SurfaceCanvasTest() override { paper.RemoveCanvas(canvas); }

    const std::shared_ptr<Host> host = Host::make();
    Paper paper{host->frameHost()};
    Movable widget;
    SurfaceCanvas canvas{paper};
};

TEST_F(SurfaceCanvasTest, IsDrawnAnewForAScreenOfAnotherScale) {
    EXPECT_TRUE(canvas.Image().isNull()) << "nothing was drawn";
    paper.Line(0, 3, 20, 3, red);
    EXPECT_EQ(canvas.Image().size(), QSize(20, 10));
    EXPECT_EQ(InkedRows(canvas.Image(), 5), 1);
    widget.scale = 2;
    EXPECT_EQ(canvas.Image().size(), QSize(40, 20));
    EXPECT_EQ(InkedRows(canvas.Image(), 10), 2);
    EXPECT_EQ(canvas.Image().devicePixelRatio(), 2);
    paper.Cls();
    EXPECT_TRUE(canvas.Image().isNull());
}

TEST_F(SurfaceCanvasTest, ABoxWithoutAnOutlineFillsItsInsideAtEveryScale) {
    paper.SetDrawStyle(draw::transparent);
    for (const int scale : {1, 2, 3, 4}) {
        widget.scale = scale;
        paper.Cls();
        paper.Line(2, 1, 6, 4, red, draw::Box::Filled);
        int inked = 0;
        for (int x = 0; x < 20 * scale; ++x) inked += InkedRows(canvas.Image(), x);
        EXPECT_EQ(inked, 3 * 2 * scale * scale) << scale;
        EXPECT_EQ(canvas.Image().pixelColor(3 * scale, 2 * scale), QColor(Qt::red)) << scale;
        EXPECT_EQ(canvas.Image().pixelColor(6 * scale - 1, 4 * scale - 1), QColor(Qt::red)) << scale;
        paper.Cls();
        paper.Line(8, 1, 8, 4, red, draw::Box::Filled);
        paper.Line(2, 6, 6, 6, red, draw::Box::Filled);
        paper.Line(12, 1, 13, 4, red, draw::Box::Filled);
        inked = 0;
        for (int x = 0; x < 20 * scale; ++x) inked += InkedRows(canvas.Image(), x);
        EXPECT_EQ(inked, 0) << "where there is no inside nothing shows, at " << scale;
    }
}

TEST_F(SurfaceCanvasTest, ThatWasDrawnOnWithoutEndIsScaled) {
    paper.Line(0, 2, 20, 6, red, draw::Box::Filled);
    constexpr int passes = 60'000;
    for (int pass = 0; pass < passes; ++pass) paper.PSet(15, 4, red);
    widget.scale = 2;
    EXPECT_EQ(canvas.Image().size(), QSize(40, 20));
    EXPECT_EQ(canvas.Image().pixelColor(10, 8), QColor(Qt::red));
    EXPECT_EQ(canvas.Image().pixelColor(10, 18), QColor(Qt::white));
    paper.PSet(0, 9, blue);
    EXPECT_EQ(canvas.Image().pixelColor(1, 19), QColor(Qt::blue)) << "what comes is sharp";
    paper.Cls();
    paper.Line(0, 3, 20, 3, red);
    EXPECT_EQ(InkedRows(canvas.Image(), 10), 2) << "and so is all after clearing";
}

}  // namespace
}  // namespace tessel::qt::test
