#include "hosts/qt/Convert.h"

#include <gtest/gtest.h>

#include <QFontInfo>
#include <QPoint>
#include <cmath>
#include <cstdlib>
#include <limits>
#include <random>

#include "tests/ErrorOf.h"

namespace tessel::qt {
namespace {

using frame::Variant;
using test::ErrorOf;

TEST(ConvertTest, ValidTextsAreTheSameOnBothSides) {
    EXPECT_EQ(ToQt("\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80"), QString::fromUtf8("\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80"));
    EXPECT_EQ(FromQt(QString::fromUtf8("\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80")), "\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80");
    EXPECT_EQ(ToQt(std::string("a\0b", 3)).size(), 3);
    EXPECT_EQ(FromQt(QString()), "");
}

TEST(ConvertTest, BytesThatAreNoUtf8ComeBackAsTheyWere) {
    std::vector<std::string> texts = {"\xED\xA0\x80",
                                      "\xC0\x80",
                                      "\xF4\x90\x80\x80",
                                      "half \xE2\x82",
                                      "\xF4\x8F\xBE\x80",
                                      "\xF4\x8F\xBF\xBF",
                                      "\xF8\x88\x80\x80\x80",
                                      "\xEF\xBB\xBF"
                                      "bom",
                                      "\xFF\xFE"};
    for (int byte = 0; byte < 256; ++byte) texts.push_back("a" + std::string(1, static_cast<char>(byte)) + "b");
    std::mt19937 random(1);
    for (int i = 0; i < 2000; ++i) {
        std::string text;
        for (unsigned length = random() % 12; length; --length) text += static_cast<char>(random());
        texts.push_back(text);
    }
    for (const std::string& text : texts) {
        EXPECT_EQ(FromQt(ToQt(text)), text);
        EXPECT_TRUE(ToQt(text).isValidUtf16());
    }
}

TEST(ConvertTest, TextsOfTheToolkitComeBackAsTheyWere) {
    for (const char32_t character : {U'\x10FF7F', U'\x10FFFD', U'\xE000', U'\xFFFD', U'\xFEFF', U'\x1F600'}) {
        const QString text = "a" + QString::fromUcs4(&character, 1) + "b";
        EXPECT_EQ(ToQt(FromQt(text)), text) << static_cast<unsigned>(character);
    }
}

TEST(ConvertTest, ALoneSurrogateBecomesValidUtf8OrComesBack) {
    const QString lone = QString("a") + QChar(0xD800) + "b";
    const std::string text = FromQt(lone);
    EXPECT_EQ(FromQt(ToQt(text)), text);
    EXPECT_EQ(text.front(), 'a');
    EXPECT_EQ(text.back(), 'b');
}

TEST(ConvertTest, ColoursHaveRedInTheLowByte) {
    EXPECT_EQ(ToQt(frame::OLE_COLOR(0x0000C0), frame::ClassicColors()), QColor(0xC0, 0, 0));
    EXPECT_EQ(ToQt(frame::OLE_COLOR(0x112233), frame::ClassicColors()), QColor(0x33, 0x22, 0x11));
    EXPECT_EQ(FromQt(QColor(0x33, 0x22, 0x11)), frame::OLE_COLOR(0x112233));
    EXPECT_EQ(FromQt(QColor::fromHslF(0, 1, 0.5)), frame::OLE_COLOR(0x0000FF));
}

TEST(ConvertTest, ASystemColourIsWhatStandsBehindItNow) {
    EXPECT_EQ(FromQt(ToQt(frame::colors::buttonFace, frame::ClassicColors())),
              frame::OleTranslateColor(frame::colors::buttonFace, frame::ClassicColors()));
    EXPECT_EQ(ToQt(frame::OLE_COLOR(0x80000005u), frame::ClassicColors()), QColor(Qt::white));
    EXPECT_EQ(ToQt(frame::OLE_COLOR(0x800000FFu), frame::ClassicColors()), QColor(Qt::black));
}

TEST(ConvertTest, OnlyTheFaceColourIsTheSurroundings) {
    EXPECT_TRUE(IsSurroundings(frame::colors::buttonFace));
    EXPECT_FALSE(IsSurroundings(frame::OleTranslateColor(frame::colors::buttonFace, frame::ClassicColors())));
    EXPECT_FALSE(IsSurroundings(frame::colors::windowBackground));
}

TEST(ConvertTest, APointIsTwentyTwips) {
    EXPECT_EQ(QFontInfo(ToQt(frame::Font("DejaVu Sans", 12))).pixelSize(), 16);
    EXPECT_EQ(QFontInfo(ToQt(frame::Font("DejaVu Sans", 8.25))).pixelSize(), 11);
    EXPECT_EQ(QFontInfo(ToQt(frame::Font("DejaVu Sans", 36))).pixelSize(), 48);
}

TEST(ConvertTest, AFontComesBackWithItsSizeAndStyles) {
    for (const double size : {6.0, 8.25, 9.0, 9.75, 10.0, 11.0, 12.0, 13.5, 24.0, 72.0}) {
        frame::Font font("DejaVu Sans", size);
        font.SetItalic(true);
        font.SetUnderline(true);
        font.SetStrikethrough(true);
        font.SetBold(true);
        const frame::FontRef back = FromQt(ToQt(font));
        EXPECT_EQ(back->Name(), "DejaVu Sans");
        EXPECT_NEAR(back->Size(), size, 0.001) << size;
        EXPECT_TRUE(back->Bold() && back->Italic() && back->Underline() && back->Strikethrough());
    }
}

TEST(ConvertTest, WeightsComeBack) {
    for (const std::int16_t weight : {100, 300, 400, 500, 600, 700, 900}) {
        frame::Font font("DejaVu Sans", 9);
        font.SetWeight(weight);
        EXPECT_EQ(FromQt(ToQt(font))->Weight(), weight);
    }
}

TEST(ConvertTest, WeightsOutsideTheToolkitsRangeDoNoHarm) {
    for (const std::int16_t weight : {0, -5, 32767, -32768, 1}) {
        frame::Font font("DejaVu Sans", 9);
        font.SetWeight(weight);
        EXPECT_EQ(ToQt(font).bold(), font.Bold()) << weight;
    }
}

TEST(ConvertTest, HugeAndTinyFontSizesDoNoHarm) {
    for (const double size : {0.0001, 0.3, 2048.0}) {
        const QFont font = ToQt(frame::Font("DejaVu Sans", size));
        EXPECT_TRUE(font.pixelSize() > 0 || font.pointSizeF() > 0) << size;
        EXPECT_GT(FromQt(font)->Size(), 0);
    }
}

TEST(ConvertTest, AFontInPointsIsThatManyPoints) {
    for (const double points : {8.0, 9.0, 10.0, 10.5, 12.0}) {
        QFont font("DejaVu Sans");
        font.setPointSizeF(points);
        EXPECT_NEAR(FromQt(font)->Size(), points, 0.001) << points;
    }
    QFont pixels("DejaVu Sans");
    pixels.setPixelSize(16);
    EXPECT_NEAR(FromQt(pixels)->Size(), 12, 0.001);
}

TEST(ConvertTest, FontsWithoutAFamilyOrWithWildSizesBecomeFonts) {
    QFont huge("DejaVu Sans");
    huge.setPixelSize(100000);
    EXPECT_EQ(ErrorOf([&] { FromQt(huge); }), 0);
    QFont tiny("DejaVu Sans");
    tiny.setPointSizeF(0.00001);
    EXPECT_EQ(ErrorOf([&] { FromQt(tiny); }), 0);
    EXPECT_NE(FromQt(QFont()), nullptr);
}

TEST(ConvertTest, TheFamiliesOfTheClassicDialogsAreTheApplicationsOwn) {
    EXPECT_EQ(ToQt(frame::Font("MS Sans Serif", 8.25)).family(), QFont().family());
    EXPECT_EQ(ToQt(frame::Font("DejaVu Serif", 8.25)).family(), "DejaVu Serif");
}

TEST(ConvertTest, APictureComesBackPixelByPixel) {
    QImage image(3, 2, QImage::Format_ARGB32);
    image.setPixel(0, 0, qRgba(1, 2, 3, 255));
    image.setPixel(1, 0, qRgba(255, 0, 128, 128));
    image.setPixel(2, 0, qRgba(9, 8, 7, 1));
    image.setPixel(0, 1, qRgba(0, 255, 0, 255));
    image.setPixel(1, 1, qRgba(255, 255, 255, 254));
    image.setPixel(2, 1, qRgba(0, 0, 255, 255));
    const frame::PictureRef picture = FromQt(image, "a\xC3\xA9.png");
    EXPECT_EQ(picture->Source(), FromQt(QString("a\xC3\xA9.png")));
    EXPECT_EQ(picture->Width(), 45);
    EXPECT_EQ(picture->Height(), 30);
    const QImage back = ToQt(*picture, 1);
    ASSERT_EQ(back.size(), image.size());
    for (int y = 0; y < 2; ++y) {
        for (int x = 0; x < 3; ++x) EXPECT_EQ(back.pixel(x, y), image.pixel(x, y)) << x << "," << y;
    }
}

TEST(ConvertTest, ASharpPictureKeepsItsNaturalSize) {
    QImage image(6, 4, QImage::Format_RGB32);
    image.fill(Qt::red);
    image.setDevicePixelRatio(2);
    const frame::PictureRef picture = FromQt(image, {});
    EXPECT_EQ(picture->Width(), 45);
    EXPECT_EQ(picture->Height(), 30);
    EXPECT_EQ(ToQt(*picture, 2).deviceIndependentSize(), QSizeF(3, 2));
}

TEST(ConvertTest, APictureWithoutPixelsIsANullImage) {
    EXPECT_TRUE(ToQt(frame::Picture(), 1).isNull());
    EXPECT_TRUE(ToQt(frame::Picture(150, 150, "x"), 2).isNull());
    EXPECT_EQ(ErrorOf([] { FromQt(QImage(), {}); }), 0);
}

QVariant There(const Variant& value, const frame::TypeInfo& type) { return ToQt(value, type, frame::ClassicColors()); }

TEST(ConvertTest, ValuesHaveTheTypeThatAToolkitProgramExpects) {
    EXPECT_EQ(There(Variant(frame::OLE_COLOR(0xFF)), frame::TypeInfo::Of<frame::OLE_COLOR>()), QVariant(QColor(Qt::red)));
    EXPECT_EQ(There(Variant(true), frame::TypeInfo::Of<bool>()).typeId(), QMetaType::Bool);
    EXPECT_EQ(There(Variant("t"), frame::TypeInfo::Of<std::string>()), QVariant(QString("t")));
    EXPECT_EQ(There(Variant(2.5f), frame::TypeInfo::Of<float>()).toDouble(), 2.5);
    EXPECT_EQ(There(Variant(std::make_shared<frame::Font>("DejaVu Sans", 12)), {frame::VarType::Object}).typeId(),
              QMetaType::QFont);
    const frame::Enumeration colours{"Colours", {}};
    EXPECT_EQ(There(Variant(std::int16_t{2}), {frame::VarType::Integer, false, &colours}).typeId(), QMetaType::Int);
}

TEST(ConvertTest, EmptyAndMissingValuesAreInvalid) {
    EXPECT_FALSE(There({}, {}).isValid());
    EXPECT_FALSE(There(Variant::Missing(), {}).isValid());
    EXPECT_FALSE(There(Variant(frame::ObjectRef()), {frame::VarType::Object}).isValid());
}

TEST(ConvertTest, QtValuesBecomeVariants) {
    EXPECT_EQ(FromQt(QVariant(true)), Variant(true));
    EXPECT_EQ(FromQt(QVariant(7)), Variant(7));
    EXPECT_EQ(FromQt(QVariant(-2.5)), Variant(-2.5));
    EXPECT_EQ(FromQt(QVariant(2.5f)), Variant(2.5));
    EXPECT_EQ(FromQt(QVariant(QString("t"))), Variant("t"));
    EXPECT_EQ(FromQt(QVariant(QColor(Qt::red))).ToColor(), frame::OLE_COLOR(0xFF));
    EXPECT_EQ(FromQt(QVariant(7u)), Variant(7));
    EXPECT_EQ(FromQt(QVariant(7000000000ll)).ToDouble(), 7e9);
    EXPECT_EQ(FromQt(QVariant::fromValue(QFont("DejaVu Sans"))).Type(), frame::VarType::Object);
    EXPECT_TRUE(FromQt(QVariant()).IsMissing());
}

TEST(ConvertTest, AValueWithoutAFormIsError13) {
    EXPECT_EQ(ErrorOf([] { FromQt(QVariant(QPoint(1, 2))); }), frame::errors::typeMismatch);
}

TEST(ConvertTest, PixelsAreFifteenTwips) {
    for (int pixels = -3000; pixels <= 3000; ++pixels) EXPECT_EQ(Pixels(Twips(pixels)), pixels);
    EXPECT_EQ(Pixels(1664.53f), 111);
}

TEST(ConvertTest, NeighboursInTwipsStayNeighboursInPixels) {
    std::mt19937 random(7);
    std::uniform_real_distribution<float> place(-9000, 9000), extent(0, 3000);
    for (int i = 0; i < 20000; ++i) {
        const float left = place(random), width = extent(random), top = place(random), height = extent(random);
        const QRect one = PixelRect(left, top, width, height);
        const QRect right = PixelRect(left + width, top, 100, height);
        const QRect below = PixelRect(left, top + height, width, 100);
        ASSERT_EQ(one.left() + one.width(), right.left());
        ASSERT_EQ(one.top() + one.height(), below.top());
        ASSERT_GE(one.width(), 0);
    }
}

TEST(ConvertTest, LengthsThatNoScreenHasDoNoHarm) {
    const float infinity = std::numeric_limits<float>::infinity(), none = std::numeric_limits<float>::quiet_NaN();
    for (const float wild : {1e30f, -1e30f, infinity, -infinity, none}) {
        EXPECT_LT(std::abs(Pixels(wild)), 20'000'000);
        EXPECT_GE(PixelRect(wild, wild, 100, 100).width(), 0);
        EXPECT_GE(PixelRect(0, 0, std::fabs(wild), std::fabs(wild)).height(), 0);
    }
}

}  // namespace
}  // namespace tessel::qt
