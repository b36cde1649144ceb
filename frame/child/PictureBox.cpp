#include "frame/child/PictureBox.h"

#include "frame/ClassTable.h"
#include "frame/Control.h"
#include "frame/child/Raster.h"

namespace tessel::child {

PictureBox::PictureBox(frame::Control& owner, std::string name) : KeyChild(owner, std::move(name)), DrawingSurface(owner.Host()) {
    AddCanvas(owner.Host().Peers().MakeCanvas(*this, *this));
    if (!Kept()) AddCanvas(std::make_unique<Raster>(0, 0, BackColor()));
}

void PictureBox::SetPicture(const frame::PictureRef& value) {
    Wipe(value);
    FitPicture();
    Changed();
}

void PictureBox::SetAutoSize(bool value) {
    if (Store(autoSize_, value)) FitPicture();
}

void PictureBox::SetBorderStyle(std::int16_t value) {
    if (Store(borderStyle_, value)) Resized();
}

std::pair<float, float> PictureBox::InputPoint(float x, float y) const { return {x - Border() / 2, y - Border() / 2}; }

frame::TextSize PictureBox::InnerSize() const {
    return {Width() > Border() ? Width() - Border() : 0, Height() > Border() ? Height() - Border() : 0};
}

void PictureBox::FitPicture() {
    if (autoSize_ && Behind()) Move(Left(), Top(), Behind()->Width() + Border(), Behind()->Height() + Border());
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
