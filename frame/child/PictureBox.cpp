#include "frame/child/PictureBox.h"

#include "frame/ClassTable.h"
#include "frame/Control.h"

namespace tessel::child {

using frame::twipsPerPixel;

PictureBox::PictureBox(frame::Control& owner, std::string name)
    : KeyChild(owner, std::move(name)), DrawingSurface(owner.Host()), raster_(0, 0, BackColor()) {
    AddCanvas(raster_);
    AddCanvas(owner.Host().Peers().MakeCanvas(*this, *this));
}

void PictureBox::SetPicture(const frame::PictureRef& value) {
    picture_ = value;
    FitPicture();
    Wiped();
    Changed();
}

frame::PictureRef PictureBox::Image() const {
    constexpr std::uint32_t opaque = 0xFF000000u;
    frame::PixelPlane plane{1, raster_.Width(), raster_.Height(), {}};
    plane.pixels.reserve(static_cast<std::size_t>(plane.width) * static_cast<std::size_t>(plane.height));
    for (int y = 0; y < plane.height; ++y)
        for (int x = 0; x < plane.width; ++x) plane.pixels.push_back(opaque | raster_.Pixel(x, y)->value);
    return std::make_shared<frame::Picture>(std::vector{std::move(plane)}, "");
}

void PictureBox::SetAutoSize(bool value) {
    if (Store(autoSize_, value)) FitPicture();
}

void PictureBox::SetBorderStyle(std::int16_t value) {
    if (Store(borderStyle_, value)) Moved();
}

frame::TextSize PictureBox::InnerSize() const {
    return {Width() > Border() ? Width() - Border() : 0, Height() > Border() ? Height() - Border() : 0};
}

std::optional<frame::OLE_COLOR> PictureBox::PixelOf(int x, int y) const { return raster_.Pixel(x, y); }

void PictureBox::Wiped() {
    const frame::Scale pixels;
    raster_.Draw(frame::draw::Cls{}, {}, pixels, Background(), 0);
    if (picture_) raster_.Draw(frame::draw::PaintPicture{0, 0, picture_}, {}, pixels, Background(), 0);
}

void PictureBox::Moved() {
    const frame::TextSize inner = InnerSize();
    raster_.Resize(frame::PixelAt(inner.width / twipsPerPixel), frame::PixelAt(inner.height / twipsPerPixel), Background());
}

frame::OLE_COLOR PictureBox::Background() const { return OleTranslateColor(BackColor(), SurfaceHost().Colors()); }

void PictureBox::FitPicture() {
    if (autoSize_ && picture_) Move(Left(), Top(), picture_->Width() + Border(), picture_->Height() + Border());
}

namespace {

constexpr auto members = Join(
    Join(frame::childMembers, frame::drawingMembers),
    std::array{
        frame::property<&PictureBox::Picture, &PictureBox::SetPicture>("Picture", "The picture behind what is drawn."),
        frame::property<&PictureBox::Image>("Image", "What the box shows, as a picture."),
        frame::property<&PictureBox::AutoSize, &PictureBox::SetAutoSize>("AutoSize", "Whether the box is as large as its picture."),
        frame::property<&PictureBox::BorderStyle, &PictureBox::SetBorderStyle>("BorderStyle", "Whether the box has a border."),
        frame::property<&PictureBox::MousePointer, &PictureBox::SetMousePointer>("MousePointer",
                                                                                 "The pointer's shape over the box."),
    });
constexpr frame::ClassTable table{.name = "PictureBox", .members = members, .inputs = keyInputs, .defaultMember = "Picture"};

}  // namespace

const frame::ClassTable& PictureBox::Table() const { return table; }

}  // namespace tessel::child
