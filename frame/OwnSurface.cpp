#include "frame/OwnSurface.h"

#include "frame/Control.h"

namespace tessel::frame {

OwnSurface::OwnSurface(Control& control) : DrawingSurface(control.Host()), control_(control) {}

float OwnSurface::Width() const { return control_.Site() ? control_.Site()->Width() : 0; }
float OwnSurface::Height() const { return control_.Site() ? control_.Site()->Height() : 0; }

void OwnSurface::SetWidth(float value) {
    if (Site* site = control_.Site()) site->SetSize(value, site->Height());
}

void OwnSurface::SetHeight(float value) {
    if (Site* site = control_.Site()) site->SetSize(site->Width(), value);
}

void OwnSurface::SetEnabled(bool value) {
    enabled_ = value;
    LookChanged();
}

void OwnSurface::SetMousePointer(std::int16_t value) {
    mousePointer_ = value;
    LookChanged();
}

void OwnSurface::SetMouseIcon(const PictureRef& value) {
    mouseIcon_ = value;
    LookChanged();
}

void OwnSurface::SetAppearance(std::int16_t value) {
    appearance_ = value;
    LookChanged();
}

void OwnSurface::SetBorderStyle(std::int16_t value) {
    borderStyle_ = value;
    Resized();
    LookChanged();
}

void OwnSurface::SetPicture(const PictureRef& value) {
    picture_ = value;
    Wipe(value);
    LookChanged();
}

void OwnSurface::Refresh() {
    LookChanged();
    if (Site* site = control_.Site()) site->Redraw();
}

std::pair<float, float> OwnSurface::InputPoint(float x, float y) const {
    const TextSize place = UnitsAt(x - Border() / 2, y - Border() / 2);
    return {place.width, place.height};
}

TextSize OwnSurface::InnerSize() const {
    return {Width() > Border() ? Width() - Border() : 0, Height() > Border() ? Height() - Border() : 0};
}

void OwnSurface::LookChanged() {
    if (Site* site = control_.Site()) site->Repaint();
}

bool OwnSurface::TakesInput() const { return control_.Site() != nullptr; }

std::string OwnSurface::InputPath() const { return control_.Path(); }

}  // namespace tessel::frame
