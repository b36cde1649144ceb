#include "frame/Surface.h"

#include <algorithm>
#include <array>

#include "frame/Text.h"

namespace tessel::frame {

namespace {

void CheckRange(int value, int least, int greatest) {
    if (value < least || value > greatest) throw ControlError(errors::invalidValue);
}

}  // namespace

DrawingSurface::DrawingSurface(Host& host) : host_(host) { font_.Set(std::make_shared<frame::Font>()); }

void DrawingSurface::Cls() {
    Emit(draw::Cls{});
    currentX_ = scaleLeft_;
    currentY_ = scaleTop_;
}

void DrawingSurface::Line(float x1, float y1, float x2, float y2, std::optional<OLE_COLOR> color, draw::Box box) {
    Emit(draw::Line{x1, y1, x2, y2, color.value_or(foreColor_), box});
    currentX_ = x2;
    currentY_ = y2;
}

void DrawingSurface::LineWithFlags(float x1, float y1, float x2, float y2, std::optional<OLE_COLOR> color,
                                   std::optional<std::string> flags) {
    const std::string_view given = flags ? std::string_view(*flags) : std::string_view();
    if (EqualsNoCase(given, "BF"))
        Line(x1, y1, x2, y2, color, draw::Box::Filled);
    else if (EqualsNoCase(given, "B"))
        Line(x1, y1, x2, y2, color, draw::Box::Outline);
    else if (given.empty())
        Line(x1, y1, x2, y2, color);
    else
        throw ControlError(errors::invalidCall);
}

void DrawingSurface::Circle(float x, float y, float radius, std::optional<OLE_COLOR> color, std::optional<float> start,
                            std::optional<float> end, std::optional<float> aspect) {
    Emit(draw::Circle{x, y, radius, color.value_or(foreColor_), start, end, aspect});
    currentX_ = x;
    currentY_ = y;
}

void DrawingSurface::PSet(float x, float y, std::optional<OLE_COLOR> color) {
    Emit(draw::PSet{x, y, color.value_or(foreColor_)});
    currentX_ = x;
    currentY_ = y;
}

std::int32_t DrawingSurface::Point(float x, float y) const {
    const Scale scale = PixelScale();
    const Canvas* const kept = Kept();
    const auto color = kept ? kept->Pixel(PixelAt(scale.X(x)), PixelAt(scale.Y(y))) : std::nullopt;
    return color ? static_cast<std::int32_t>(color->value) : -1;
}

void DrawingSurface::Print(const std::string& text) {
    Emit(draw::Print{text, currentX_, currentY_});
    currentX_ = scaleLeft_;
    currentY_ += TextHeight(text);
}

void DrawingSurface::PaintPicture(const PictureRef& picture, float x, float y) {
    if (!picture) throw ControlError(errors::invalidPicture);
    Emit(draw::PaintPicture{x, y, picture});
}

TextSize DrawingSurface::UnitsAt(float xTwips, float yTwips) const {
    const TextSize unit = TwipsPerUnit();
    return {scaleLeft_ + xTwips / unit.width, scaleTop_ + yTwips / unit.height};
}

float DrawingSurface::TextWidth(const std::string& text) const {
    return host_.Metrics().Measure(*Font(), text).width / TwipsPerUnit().width;
}

float DrawingSurface::TextHeight(const std::string& text) const {
    return host_.Metrics().Measure(*Font(), text).height / TwipsPerUnit().height;
}

void DrawingSurface::SetDrawWidth(std::int16_t value) {
    constexpr int widest = 32'767;
    CheckRange(value, 1, widest);
    if (pen_.width == value) return;
    pen_.width = value;
    Emit(draw::DrawWidth{value});
}

void DrawingSurface::SetDrawStyle(std::int16_t value) {
    CheckRange(value, draw::solid, draw::insideSolid);
    if (pen_.style == value) return;
    pen_.style = value;
    Emit(draw::DrawStyle{value});
}

void DrawingSurface::SetDrawMode(std::int16_t value) {
    constexpr int whiteness = 16;
    CheckRange(value, draw::blackness, whiteness);
    if (pen_.mode == value) return;
    pen_.mode = value;
    Emit(draw::DrawMode{value});
}

void DrawingSurface::SetScaleMode(ScaleModeConstants value) {
    CheckRange(static_cast<int>(value), static_cast<int>(ScaleModeConstants::User),
               static_cast<int>(ScaleModeConstants::Centimetres));
    if (value == scaleMode_) return;
    if (value == ScaleModeConstants::User) {
        userWidth_ = ScaleWidth();
        userHeight_ = ScaleHeight();
        scaleMode_ = value;
        return;
    }
    const TextSize before = TwipsPerUnit();
    const float x = (currentX_ - scaleLeft_) * before.width;
    const float y = (currentY_ - scaleTop_) * before.height;
    scaleMode_ = value;
    scaleLeft_ = scaleTop_ = 0;
    const TextSize after = TwipsPerUnit();
    currentX_ = x / after.width;
    currentY_ = y / after.height;
}

void DrawingSurface::SetScaleLeft(float value) {
    SetScaleMode(ScaleModeConstants::User);
    scaleLeft_ = value;
}

void DrawingSurface::SetScaleTop(float value) {
    SetScaleMode(ScaleModeConstants::User);
    scaleTop_ = value;
}

float DrawingSurface::ScaleWidth() const {
    return scaleMode_ == ScaleModeConstants::User ? userWidth_ : InnerSize().width / TwipsPerUnit().width;
}

void DrawingSurface::SetScaleWidth(float value) {
    if (value == 0) throw ControlError(errors::invalidValue);
    SetScaleMode(ScaleModeConstants::User);
    userWidth_ = value;
}

float DrawingSurface::ScaleHeight() const {
    return scaleMode_ == ScaleModeConstants::User ? userHeight_ : InnerSize().height / TwipsPerUnit().height;
}

void DrawingSurface::SetScaleHeight(float value) {
    if (value == 0) throw ControlError(errors::invalidValue);
    SetScaleMode(ScaleModeConstants::User);
    userHeight_ = value;
}

void DrawingSurface::SetBackColor(OLE_COLOR value) {
    if (value == backColor_) return;
    backColor_ = value;
    Wipe(behind_);
    LookChanged();
}

void DrawingSurface::SetForeColor(OLE_COLOR value) {
    if (value == foreColor_) return;
    foreColor_ = value;
    LookChanged();
}

void DrawingSurface::SetFont(const FontRef& value) {
    font_.Set(value ? value : std::make_shared<frame::Font>());
    LookChanged();
}

void DrawingSurface::AddCanvas(Canvas& canvas) {
    canvases_.push_back(&canvas);
    TellSize(canvas);
    canvas.Wipe(Background(), behind_);
}

void DrawingSurface::AddCanvas(std::unique_ptr<Canvas> canvas) {
    if (!canvas) return;
    AddCanvas(*canvas);
    ownCanvases_.push_back(std::move(canvas));
}

const Canvas* DrawingSurface::Kept() const {
    const auto found = std::find_if(canvases_.begin(), canvases_.end(), [](const Canvas* canvas) { return canvas->KeepsPixels(); });
    return found != canvases_.end() ? *found : nullptr;
}

PictureRef DrawingSurface::Image() const {
    const Canvas* const kept = Kept();
    return kept ? std::make_shared<Picture>(kept->Planes(), "") : std::make_shared<Picture>();
}

void DrawingSurface::Wipe(const PictureRef& picture) {
    behind_ = picture;
    for (Canvas* canvas : canvases_) canvas->Wipe(Background(), behind_);
}

void DrawingSurface::Resized() {
    for (Canvas* canvas : canvases_) TellSize(*canvas);
}

void DrawingSurface::TellSize(Canvas& canvas) const {
    const TextSize inner = InnerSize();
    canvas.Resize(PixelAt(inner.width / twipsPerPixel), PixelAt(inner.height / twipsPerPixel), Background());
}

Scale DrawingSurface::PixelScale() const {
    const TextSize unit = TwipsPerUnit();
    return {scaleLeft_, scaleTop_, unit.width / twipsPerPixel, unit.height / twipsPerPixel};
}

void DrawingSurface::Emit(const DrawOp& op) {
    if (canvases_.empty()) return;
    const Scale scale = PixelScale();
    const OLE_COLOR background = Background();
    const OLE_COLOR foreground = OleTranslateColor(foreColor_, host_.Colors());
    for (Canvas* canvas : canvases_) canvas->Draw(op, pen_, scale, background, foreground);
}

TextSize DrawingSurface::TwipsPerUnit() const {
    constexpr float perInch = 1440;
    static constexpr std::array<TextSize, 8> table = {{{1, 1},
                                                       {1, 1},
                                                       {20, 20},
                                                       {twipsPerPixel, twipsPerPixel},
                                                       {120, 240},
                                                       {perInch, perInch},
                                                       {perInch / 25.4f, perInch / 25.4f},
                                                       {perInch / 2.54f, perInch / 2.54f}}};
    if (scaleMode_ != ScaleModeConstants::User) return table[static_cast<std::size_t>(scaleMode_)];
    const TextSize inner = InnerSize();
    return {userWidth_ != 0 && inner.width != 0 ? inner.width / userWidth_ : 1,
            userHeight_ != 0 && inner.height != 0 ? inner.height / userHeight_ : 1};
}

}  // namespace tessel::frame
