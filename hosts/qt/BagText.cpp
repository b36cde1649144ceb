#include "hosts/qt/BagText.h"

#include <QBuffer>
#include <QImage>
#include <QJsonDocument>
#include <QJsonObject>
#include <cmath>
#include <limits>

#include "frame/Error.h"
#include "hosts/qt/Convert.h"

namespace tessel::qt {

using frame::Variant;
using frame::VarType;

namespace {

QJsonValue FontValue(const frame::Font& font) {
    return QJsonObject{{"font", ToQt(font.Name())}, {"size", font.Size()},           {"weight", font.Weight()},
                       {"italic", font.Italic()},   {"underline", font.Underline()}, {"strikethrough", font.Strikethrough()},
                       {"charset", font.Charset()}};
}

[[noreturn]] void Refuse() { throw frame::ControlError(frame::errors::invalidValue); }

// A part of an object, of the kind that it must have.
QString TextIn(const QJsonObject& object, const char* key) {
    if (!object[key].isString()) Refuse();
    return object[key].toString();
}
double NumberIn(const QJsonObject& object, const char* key) {
    if (!object[key].isDouble()) Refuse();
    return object[key].toDouble();
}
bool FlagIn(const QJsonObject& object, const char* key) {
    if (object.contains(key) && !object[key].isBool()) Refuse();
    return object[key].toBool();
}

Variant FontOf(const QJsonObject& value) {
    auto font = std::make_shared<frame::Font>(FromQt(TextIn(value, "font")), NumberIn(value, "size"));
    const auto number = [&](const char* key, std::int16_t otherwise) {
        return value.contains(key) ? Variant(NumberIn(value, key)).ToInteger() : otherwise;
    };
    font->SetWeight(number("weight", font->Weight()));
    font->SetItalic(FlagIn(value, "italic"));
    font->SetUnderline(FlagIn(value, "underline"));
    font->SetStrikethrough(FlagIn(value, "strikethrough"));
    font->SetCharset(number("charset", font->Charset()));
    return {std::move(font)};
}

QJsonValue PictureValue(const frame::Picture& picture) {
    QByteArray png;
    const QImage image = ToQt(picture, std::numeric_limits<double>::max());
    if (!image.isNull()) {
        QBuffer buffer(&png);
        image.save(&buffer, "PNG");
    }
    return QJsonObject{{"picture", QString::fromLatin1(png.toBase64())},
                       {"width", picture.Width()},
                       {"height", picture.Height()},
                       {"source", ToQt(picture.Source())}};
}

Variant PictureOf(const QJsonObject& value) {
    const QByteArray png = QByteArray::fromBase64(TextIn(value, "picture").toLatin1());
    const double width = NumberIn(value, "width"), height = NumberIn(value, "height");
    const QString source = TextIn(value, "source");
    if (png.isEmpty())
        return {std::make_shared<frame::Picture>(static_cast<float>(width), static_cast<float>(height), FromQt(source))};
    QImage image;
    if (!image.loadFromData(png, "PNG")) Refuse();
    const double pixels = width / frame::twipsPerPixel;
    if (pixels > 0) image.setDevicePixelRatio(std::max(1.0, std::round(image.width() / pixels)));
    return {FromQt(image, source)};
}

QJsonValue ObjectValue(const Variant& value) {
    const auto shared = value.ToObject().Shared();
    if (const auto* font = dynamic_cast<const frame::Font*>(shared.get())) return FontValue(*font);
    if (const auto* picture = dynamic_cast<const frame::Picture*>(shared.get())) return PictureValue(*picture);
    if (!value.ToObject().Get()) return QJsonValue::Null;
    throw frame::ControlError(frame::errors::typeMismatch);
}

QJsonValue JsonOf(const Variant& value) {
    switch (value.Type()) {
        case VarType::Boolean:
            return value.ToBoolean();
        case VarType::String:
            return ToQt(value.Text());
        case VarType::Date:
            return QJsonObject{{"date", value.ToDate().days}};
        case VarType::Object:
            return ObjectValue(value);
        case VarType::Empty:
            return QJsonValue::Null;
        case VarType::Missing:
        case VarType::Array:
            throw frame::ControlError(frame::errors::typeMismatch);
        default:
            break;
    }
    const double number = value.ToDouble();
    if (std::isfinite(number)) return number;
    return QJsonObject{{"number", std::isnan(number) ? "nan" : number < 0 ? "-inf" : "inf"}};
}

Variant NumberOf(const QString& name) {
    constexpr double infinity = std::numeric_limits<double>::infinity();
    if (name == "inf") return infinity;
    if (name == "-inf") return -infinity;
    if (name == "nan") return std::numeric_limits<double>::quiet_NaN();
    Refuse();
}

Variant ValueOf(const QJsonValue& value) {
    switch (value.type()) {
        case QJsonValue::Null:
            return {};
        case QJsonValue::Bool:
            return value.toBool();
        case QJsonValue::Double:
            return value.toDouble();
        case QJsonValue::String:
            return FromQt(value.toString());
        case QJsonValue::Object:
            break;
        default:
            throw frame::ControlError(frame::errors::invalidValue);
    }
    const QJsonObject object = value.toObject();
    if (object.contains("font")) return FontOf(object);
    if (object.contains("picture")) return PictureOf(object);
    if (object.contains("date")) return frame::Date{NumberIn(object, "date")};
    return NumberOf(TextIn(object, "number"));
}

/// Escapes what is outside ASCII: generated code and forms keep only that as it stands.
QByteArray Ascii(const QByteArray& utf8) {
    QByteArray result;
    for (const QChar unit : QString::fromUtf8(utf8)) {
        if (unit.unicode() < 0x80)
            result += unit.toLatin1();
        else
            result += "\\u" + QByteArray::number(unit.unicode(), 16).rightJustified(4, '0');
    }
    return result;
}

}  // namespace

QByteArray BagText(const frame::MemoryBag& bag) {
    QJsonObject object;
    for (const auto& [key, value] : bag.Kept()) object[ToQt(key)] = JsonOf(value);
    return Ascii(QJsonDocument(object).toJson(QJsonDocument::Compact));
}

frame::MemoryBag BagOf(const QByteArray& text) {
    QJsonParseError problem;
    const QJsonDocument document = QJsonDocument::fromJson(text, &problem);
    if (!document.isObject())
        throw frame::ControlError(frame::errors::invalidValue, "The saved state cannot be read: " + FromQt(problem.errorString()));
    frame::MemoryBag bag;
    const QJsonObject object = document.object();
    for (auto at = object.begin(); at != object.end(); ++at) {
        try {
            bag.Set(FromQt(at.key()), ValueOf(at.value()));
        } catch (const frame::ControlError&) {
            throw frame::ControlError(frame::errors::invalidValue, "The saved state cannot be read at " + FromQt(at.key()));
        }
    }
    return bag;
}

}  // namespace tessel::qt
