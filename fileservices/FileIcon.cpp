#include "fileservices/FileIcon.h"

#include <array>

#include "fileservices/FileSys.h"
#include "frame/ClassTable.h"
#include "frame/Error.h"

namespace tessel::fileservices {

namespace {

// What is asked of the shell.
constexpr int systemIconIndex = 0x4000, programType = 0x2000, typeName = 0x0400, displayName = 0x0200, shellIconSize = 0x0004,
              openIcon = 0x0002, smallIcon = 0x0001;
constexpr int allIcons = systemIconIndex | programType | typeName | displayName | shellIconSize;

constexpr float smallSide = 240, largeSide = 480;  // twips

template <class T>
T& As(const frame::ObjectRef& object) {
    auto* target = dynamic_cast<T*>(&*object);
    if (!target) throw frame::ControlError(frame::errors::typeMismatch);
    return *target;
}

/// A quotient by 256 as the nearest whole number, of two the even one.
std::uint32_t RoundedByte(std::uint32_t value) {
    constexpr std::uint32_t half = 128;
    const std::uint32_t whole = value >> 8, rest = value & 0xFF;
    return whole + (rest > half || (rest == half && (whole & 1) != 0) ? 1 : 0);
}

/// Half way to white, to the nearest whole number, of two the even one.
int Paled(std::uint32_t part) {
    const int twice = 255 + static_cast<int>(part & 0xFF);
    const int whole = twice / 2;
    return whole + (twice & whole & 1);
}

/// The parts come from rounded quotients, so that a red above 128 counts as one more of green: kept so that washed pictures look
/// the same everywhere.
frame::OLE_COLOR Washed(frame::OLE_COLOR color) {
    const std::uint32_t greenAndUp = RoundedByte(color.value);
    const std::uint32_t blueAndUp = RoundedByte(greenAndUp);
    return frame::Rgb(Paled(color.value), Paled(greenAndUp), Paled(blueAndUp));
}

/// An icon of the box's size as it is, with all its scales and soft edges; any other as the box shows it in its corner.
frame::PictureRef Fitted(const frame::PictureRef& icon, child::PictureBox& box) {
    if (box.BorderStyle() == 0 && icon->Width() == box.Width() && icon->Height() == box.Height()) return icon;
    box.SetPicture(nullptr);
    box.PaintPicture(icon, box.ScaleLeft(), box.ScaleTop());
    return box.Image();
}

}  // namespace

std::optional<std::string> FileIcon::IconKey(const std::string& path) const {
    if (files_.FileExists(path)) return files_.GetExtensionName(path);
    if (files_.DriveExists(path)) return host_.Module<FileSys>().DriveTypeWord(files_.GetDrive(path));
    if (files_.FolderExists(path)) return files_.GetFolder(path)->Type();
    return std::nullopt;
}

bool FileIcon::GetFileIcon(const std::string& path, IconSize size, child::PictureBox& picture, std::string& key,
                           IconForm form) const {
    const std::optional<std::string> found = IconKey(path);
    key = found.value_or("");
    if (!found) return false;
    const bool large = size == IconSize::Large;
    const float side = large ? largeSide : smallSide;
    const int flags = allIcons | (form == IconForm::Open ? openIcon : 0) | (large ? 0 : smallIcon);
    picture.Move(picture.Left(), picture.Top(), side, side);
    const frame::PictureRef icon = host_.Pictures().FileIcon(path, flags);
    if (!icon) return false;
    picture.SetPicture(Fitted(icon, picture));
    return true;
}

void FileIcon::WashOutPicture(frame::DrawingSurface& picture, frame::OLE_COLOR maskColor) {
    const frame::ScaleModeConstants mode = picture.ScaleMode();
    picture.SetScaleMode(frame::ScaleModeConstants::Pixels);
    const float left = picture.ScaleLeft(), top = picture.ScaleTop();
    const float right = picture.ScaleWidth() - 1, bottom = picture.ScaleHeight() - 1;
    // Where the surface keeps no pixels there is nothing to pale.
    for (float x = left; x <= right && picture.Point(x, top) >= 0; ++x)
        for (float y = top; y <= bottom; ++y) {
            const std::int32_t point = picture.Point(x, y);
            if (point < 0) break;
            const frame::OLE_COLOR color = static_cast<std::uint32_t>(point);
            if (color != maskColor) picture.PSet(x, y, Washed(color));
        }
    picture.SetScaleMode(mode);
}

frame::PictureRef FileIcon::WashedOut(const frame::PictureRef& picture, frame::OLE_COLOR maskColor) {
    constexpr std::uint32_t alphaBits = 0xFF000000u, rgbBits = 0xFFFFFFu;
    return MapPixels(picture, [&](std::uint32_t pixel) {
        return (pixel & rgbBits) == maskColor.value ? pixel : (pixel & alphaBits) | Washed(pixel & rgbBits).value;
    });
}

bool FileIcon::GetByReference(std::string& path, bool& large, const frame::ObjectRef& picture, std::string& key, bool& open) const {
    return GetFileIcon(path, large ? IconSize::Large : IconSize::Small, As<child::PictureBox>(picture), key,
                       open ? IconForm::Open : IconForm::Closed);
}

void FileIcon::WashOutObject(const frame::ObjectRef& picture, frame::OLE_COLOR maskColor) const {  // NOLINT: a row calls it
    WashOutPicture(As<frame::DrawingSurface>(picture), maskColor);
}

const frame::ClassTable& FileIcon::Table() const {
    static constexpr std::array members = {
        frame::method<&FileIcon::GetByReference>("GetFileIcon", "Draws the icon of a path onto a picture box.",
                                                 {"Path", "Large", "Picture", "Key", "Open"}),
        frame::method<&FileIcon::WashOutObject>("WashOutPicture", "Pales what a surface shows.", {"Picture", "MaskColor"}),
    };
    static constexpr frame::ClassTable table{.name = "FileIcon", .members = members};
    return table;
}

}  // namespace tessel::fileservices
