#include "hosts/qt/Convert.h"

#include <QApplication>
#include <QScreen>
#include <QStringDecoder>
#include <algorithm>
#include <cmath>
#include <cstring>

#include "frame/Convert.h"
#include "frame/Error.h"
#include "frame/Text.h"

namespace tessel::qt {

using frame::Variant;
using frame::VarType;

namespace {

constexpr double twipsPerPoint = 20;
constexpr double pointsPerInch = 72, pixelsPerInch = pointsPerInch * twipsPerPoint / frame::twipsPerPixel;

/// The resolution by which Qt turns points into pixels.
double LogicalResolution() {
    const QScreen* screen = QGuiApplication::primaryScreen();
    const double resolution = screen ? screen->logicalDotsPerInchY() : pixelsPerInch;
    return resolution > 0 ? resolution : pixelsPerInch;
}

/// A byte order mark is a character as any other.
QString Decoded(std::string_view utf8) {
    QStringDecoder decoder(QStringDecoder::Utf8, QStringDecoder::Flag::ConvertInitialBom);
    return decoder.decode(QByteArrayView(utf8.data(), static_cast<qsizetype>(utf8.size())));
}

bool IsDialogFamily(std::string_view family) {
    const auto is = [&](std::string_view known) { return frame::EqualsNoCase(family, known); };
    return is("MS Sans Serif") || is("MS Shell Dlg") || is("MS Shell Dlg 2") || is("System") || family.empty();
}

}  // namespace

QString ToQt(std::string_view text) {
    if (frame::IsValidUtf8(text) && text.find("\xF4\x8F\xBE") == text.npos && text.find("\xF4\x8F\xBF") == text.npos)
        return Decoded(text);
    return Decoded(frame::ToStrictUtf8(text));
}

std::string FromQt(const QString& text) { return frame::FromStrictUtf8(text.toStdString()); }

QColor ToQt(frame::OLE_COLOR color, const frame::SystemColors& system) {
    const frame::OLE_COLOR rgb = frame::OleTranslateColor(color, system);
    return {frame::Red(rgb), frame::Green(rgb), frame::Blue(rgb)};
}

frame::OLE_COLOR FromQt(const QColor& color) { return frame::Rgb(color.red(), color.green(), color.blue()); }

QFont ToQt(const frame::Font& font) {
    QFont result = QApplication::font();
    if (!IsDialogFamily(font.Name())) result.setFamilies({ToQt(font.Name())});
    result.setPointSizeF(std::max(1.0, font.Size() * pixelsPerInch / LogicalResolution()));
    result.setWeight(static_cast<QFont::Weight>(std::clamp<int>(font.Weight(), 1, 1000)));
    result.setItalic(font.Italic());
    result.setUnderline(font.Underline());
    result.setStrikeOut(font.Strikethrough());
    return result;
}

frame::FontRef FromQt(const QFont& font) {
    const double points = font.pointSizeF() > 0 ? font.pointSizeF() * LogicalResolution() / pixelsPerInch
                                                : font.pixelSize() * pointsPerInch / pixelsPerInch;
    constexpr double greatest = 2048;  // that a font takes
    auto result = std::make_shared<frame::Font>(FromQt(font.family()), std::clamp(points, 1.0, greatest));
    result->SetWeight(static_cast<std::int16_t>(font.weight()));
    result->SetItalic(font.italic());
    result->SetUnderline(font.underline());
    result->SetStrikethrough(font.strikeOut());
    return result;
}

QImage ToQt(const frame::Picture& picture, double scale) {
    const frame::PixelPlane* plane = picture.Plane(scale);
    if (!plane) return {};
    QImage image(plane->width, plane->height, QImage::Format_RGBA8888);
    for (int y = 0; y < plane->height; ++y)
        for (int x = 0; x < plane->width; ++x) {
            const std::uint32_t pixel =
                plane->pixels[static_cast<std::size_t>(y) * static_cast<std::size_t>(plane->width) + static_cast<std::size_t>(x)];
            uchar* const bytes = image.scanLine(y) + std::ptrdiff_t{x} * 4;
            for (int byte = 0; byte < 4; ++byte) bytes[byte] = static_cast<uchar>(pixel >> (8 * byte));
        }
    image.setDevicePixelRatio(plane->scale);
    return image;
}

frame::PixelPlane PlaneOf(const QImage& image, double scale) {
    const QImage rgba = image.convertToFormat(QImage::Format_RGBA8888);
    frame::PixelPlane plane{.scale = scale, .width = rgba.width(), .height = rgba.height(), .pixels = {}};
    plane.pixels.reserve(static_cast<std::size_t>(rgba.width()) * static_cast<std::size_t>(rgba.height()));
    for (int y = 0; y < rgba.height(); ++y) {
        const uchar* const line = rgba.constScanLine(y);
        for (std::ptrdiff_t x = 0; x < rgba.width(); ++x) {
            const uchar* const bytes = line + x * 4;
            std::uint32_t pixel = 0;
            for (int byte = 3; byte >= 0; --byte) pixel = pixel << 8 | bytes[byte];
            plane.pixels.push_back(pixel);
        }
    }
    return plane;
}

frame::PictureRef FromQt(const QImage& image, const QString& source) {
    std::vector<frame::PixelPlane> planes;
    planes.push_back(PlaneOf(image, image.devicePixelRatio()));
    return std::make_shared<frame::Picture>(std::move(planes), FromQt(source));
}

QVariant ToQt(const Variant& value, const frame::TypeInfo& type, const frame::SystemColors& system) {
    if (type.isColor || value.IsColor()) return ToQt(value.ToColor(), system);
    switch (value.Type()) {
        case VarType::Boolean:
            return value.ToBoolean();
        case VarType::Integer:
        case VarType::Long:
            return value.ToLong();
        case VarType::Single:
            return value.ToSingle();
        case VarType::Double:
            return value.ToDouble();
        case VarType::String:
        case VarType::Date:
            return ToQt(value.ToText());
        case VarType::Object:
            break;
        case VarType::Empty:
        case VarType::Missing:
        case VarType::Array:
            return {};
    }
    const auto shared = value.ToObject().Shared();
    if (const auto* font = dynamic_cast<const frame::Font*>(shared.get())) return ToQt(*font);
    if (const auto* picture = dynamic_cast<const frame::Picture*>(shared.get())) return ToQt(*picture, 1);
    return {};
}

Variant FromQt(const QVariant& value) {
    if (value.metaType() == QMetaType::fromType<frame::ObjectRef>()) return value.value<frame::ObjectRef>();
    switch (value.typeId()) {
        case QMetaType::UnknownType:
            return Variant::Missing();
        case QMetaType::Bool:
            return value.toBool();
        case QMetaType::Short:
        case QMetaType::UShort:
        case QMetaType::Char:
        case QMetaType::SChar:
        case QMetaType::UChar:
        case QMetaType::Int:
            return static_cast<std::int32_t>(value.toInt());
        case QMetaType::Float:
            return value.toFloat();
        case QMetaType::UInt:
        case QMetaType::Long:
        case QMetaType::ULong:
        case QMetaType::LongLong:
        case QMetaType::ULongLong:
        case QMetaType::Double:
            return value.toDouble();
        case QMetaType::QColor:
            return FromQt(value.value<QColor>());
        case QMetaType::QFont:
            return {FromQt(value.value<QFont>())};
        case QMetaType::QImage:
            return {FromQt(value.value<QImage>(), {})};
        default:
            break;
    }
    if (value.metaType().flags() & QMetaType::IsEnumeration) return static_cast<std::int32_t>(value.toInt());
    if (!value.canConvert<QString>()) throw frame::ControlError(frame::errors::typeMismatch);
    return Variant(FromQt(value.toString()));
}

int Pixels(float twips) {
    constexpr float limit = 16'777'215;  // what a widget can be, as Qt has it
    const float pixels = std::round(twips / frame::twipsPerPixel);
    if (std::isnan(pixels)) return 0;
    return static_cast<int>(std::clamp(pixels, -limit, limit));
}

QRect PixelRect(float left, float top, float width, float height) {
    const int x = Pixels(left), y = Pixels(top);
    return {x, y, Pixels(left + width) - x, Pixels(top + height) - y};
}

}  // namespace tessel::qt
