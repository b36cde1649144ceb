#pragma once

#include <QColor>
#include <QFont>
#include <QImage>
#include <QRect>
#include <QString>
#include <QVariant>
#include <string>
#include <string_view>

#include "frame/Color.h"
#include "frame/Font.h"
#include "frame/Member.h"
#include "frame/Picture.h"
#include "frame/Surface.h"
#include "frame/Variant.h"

/// Between the library's values and those of Qt.
namespace tessel::qt {

/// Bytes that are no valid UTF-8 become private characters, from which `FromQt` brings them back.
QString ToQt(std::string_view text);
std::string FromQt(const QString& text);

/// A system colour becomes what stands behind it now.
QColor ToQt(frame::OLE_COLOR color, const frame::SystemColors& system);
frame::OLE_COLOR FromQt(const QColor& color);
/// Whether a background is that of faces: it is not painted, so that what a control stands on shows, which has that colour or a
/// shade of it.
inline bool IsSurroundings(frame::OLE_COLOR background) { return background == frame::colors::buttonFace; }

/// One point is 20 twips, whatever resolution the screen claims, so that text fits what was laid out in twips. The families of
/// the classic dialogs stand for the application's own.
QFont ToQt(const frame::Font& font);
frame::FontRef FromQt(const QFont& font);

/// The pixels of the plane that suits a screen of this scale; null for a picture without pixels.
QImage ToQt(const frame::Picture& picture, double scale);
frame::PictureRef FromQt(const QImage& image, const QString& source);
/// The pixels of an image as the plane of a scale.
frame::PixelPlane PlaneOf(const QImage& image, double scale);

/// A value as a Qt program expects it for a member of this type: a colour as `QColor`, a font as `QFont`, an enumeration as
/// `int`. Invalid for an empty or missing value and for an object without such a form.
QVariant ToQt(const frame::Variant& value, const frame::TypeInfo& type, const frame::SystemColors& system);
/// An invalid variant is a missing value; a `frame::ObjectRef` is the object. Error 13 for a type that has no form here.
frame::Variant FromQt(const QVariant& value);

/// Whole pixels of a length or a place in twips.
int Pixels(float twips);
inline double PixelsExactly(float twips) { return static_cast<double>(twips) / frame::twipsPerPixel; }
inline float Twips(double pixels) { return static_cast<float>(pixels * frame::twipsPerPixel); }
/// The rectangle between rounded edges: neighbours in twips stay neighbours in pixels.
QRect PixelRect(float left, float top, float width, float height);

}  // namespace tessel::qt
