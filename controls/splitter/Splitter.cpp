#include "controls/splitter/Splitter.h"

#include <algorithm>
#include <array>

#include "frame/ResumeNext.h"
#include "frame/Text.h"

namespace tessel::controls {

using frame::Object;
using frame::OLE_COLOR;
using frame::OwnSurface;
using frame::ResumeNext;
using frame::Variant;
using frame::VarType;

namespace {

constexpr float thickness = 120;      // of a new bar, in twips
constexpr float edgeStripTwips = 30;  // senses the mouse leaving the bar
constexpr frame::TextSize designSize{4800, thickness};

/// Calls `visit` for each part of a list between its commas; an empty list has none. The list is a copy: what is visited runs the
/// host's code, which may set another.
template <class F>
void EachEntry(const std::string list, F&& visit) {
    for (std::size_t start = 0; !list.empty() && start <= list.size();) {
        const std::size_t end = std::min(list.find(',', start), list.size());
        visit(std::string_view(list).substr(start, end - start));
        start = end + 1;
    }
}

void AddTo(Object& object, const char* member, float difference) { object.Put(member, object.Get(member).ToSingle() + difference); }

/// What would be 0 or less becomes 0.
void AddToExtent(Object& object, const char* member, float difference) {
    const float extent = object.Get(member).ToSingle() + difference;
    object.Put(member, extent > 0 ? extent : 0.0f);
}

}  // namespace

Splitter::Splitter(frame::Host& host) : Control(host) {
    OwnSurface& surface = Surface();
    surface.Click.To<&Splitter::SurfaceClick>(*this);
    surface.DblClick.To<&Splitter::SurfaceDblClick>(*this);
    surface.KeyDown.To<&Splitter::SurfaceKeyDown>(*this);
    surface.KeyPress.To<&Splitter::SurfaceKeyPress>(*this);
    surface.KeyUp.To<&Splitter::SurfaceKeyUp>(*this);
    surface.MouseDown.To<&Splitter::SurfaceMouseDown>(*this);
    surface.MouseMove.To<&Splitter::SurfaceMouseMove>(*this);
    surface.MouseUp.To<&Splitter::SurfaceMouseUp>(*this);
}

void Splitter::SetMinTopLeft(float value) {
    own.MinTopLeft = value;
    PropertyChanged("MinTopLeft");
}

void Splitter::SetMinBottomRight(float value) {
    own.MinBottomRight = value;
    PropertyChanged("MinBottomRight");
}

void Splitter::SetBackColor(OLE_COLOR value) {
    Surface().SetBackColor(value);
    PropertyChanged("BackColor");
    Draw();
}

void Splitter::SetForeColor(OLE_COLOR value) {
    Surface().SetForeColor(value);
    PropertyChanged("ForeColor");
}

void Splitter::SetEnabled(bool value) {
    Surface().SetEnabled(value);
    PropertyChanged("Enabled");
}

void Splitter::Refresh() { Surface().Refresh(); }

void Splitter::SetOrientation(tsOrientation value) {
    own.Orientation = value;
    PropertyChanged("Orientation");
    PutInTheMiddle();
}

void Splitter::SetControlsTopLeft(const std::string& value) {
    own.ControlsTopLeft = value;
    PropertyChanged("ControlsTopLeft");
}

void Splitter::SetControlsBottomRight(const std::string& value) {
    own.ControlsBottomRight = value;
    PropertyChanged("ControlsBottomRight");
}

void Splitter::SetMousePointer(std::int16_t value) {
    Surface().SetMousePointer(value);
    PropertyChanged("MousePointer");
}

void Splitter::SetMouseIcon(const frame::PictureRef& value) {
    Surface().SetMouseIcon(value);
    PropertyChanged("MouseIcon");
}

void Splitter::SetAppearance(tsAppearance value) {
    own.Appearance = value;
    PropertyChanged("Appearance");
    Draw();
}

void Splitter::SetHighlightColor(OLE_COLOR value) {
    own.HighlightColor = value;
    PropertyChanged("HighlightColor");
}

void Splitter::SetIdent(const Variant& value) {
    RefuseAtDesignTime();
    own.Ident = value;
    PropertyChanged("Ident");
}

void Splitter::MoveBy(float distance) {
    const Way* way = TheWay();
    if (!way) return;
    ResumeNext next;
    const auto present = [&] { return Extender().Get(way->place).ToSingle(); };
    float delta = distance, place = 0, formExtent = 0;
    next([&] { place = delta + present(); });
    if (place < own.MinTopLeft) place = own.MinTopLeft;
    next([&] { formExtent = FormExtent(*way); });
    if (formExtent > 0) {
        const float ownExtent = OwnThickness();
        if (formExtent - place - ownExtent < own.MinBottomRight) place = formExtent - own.MinBottomRight - ownExtent;
    }
    next([&] { delta = place - present(); });
    if (!next.If([&] { return place != present(); })) return;
    next([&] { Extender().Put(way->place, place); });
    const bool across = own.Orientation == tsOrientation::tsHorizontal;
    const float dx = across ? 0 : delta, dy = across ? delta : 0;
    MoveControls(dx, dy);
    next([&] { ForwardEvent(splitter::AfterMove, dx, dy); });
}

float Splitter::Place() const {
    ResumeNext next;
    const Way* way = TheWay();
    return way ? next.Value([&] { return Extender().Get(way->place).ToSingle(); }, 0) : 0;
}

std::optional<float> Splitter::FarEnd() const {
    ResumeNext next;
    const Way* way = TheWay();
    const float formExtent = way ? next.Value([&] { return FormExtent(*way); }, 0) : 0;
    if (!(formExtent > 0)) return std::nullopt;
    return formExtent - own.MinBottomRight - OwnThickness();
}

void Splitter::InitProperties() {
    Control::InitProperties();
    own.unplaced = true;
}

void Splitter::Show() {
    if (UserMode() || !own.unplaced) return;
    PutInTheMiddle();
    own.unplaced = false;
}

void Splitter::Paint() { Draw(); }

frame::TextSize Splitter::DesignSize() const { return designSize; }

void Splitter::SurfaceClick() { ForwardEvent(frame::stock::Click); }

void Splitter::SurfaceDblClick() { ForwardEvent(frame::stock::DblClick); }

void Splitter::SurfaceKeyDown(std::int16_t keyCode, std::int16_t shift) { ForwardEvent(frame::stock::KeyDown, keyCode, shift); }

void Splitter::SurfaceKeyPress(std::int16_t keyAscii) { ForwardEvent(frame::stock::KeyPress, keyAscii); }

void Splitter::SurfaceKeyUp(std::int16_t keyCode, std::int16_t shift) { ForwardEvent(frame::stock::KeyUp, keyCode, shift); }

void Splitter::SurfaceMouseDown(std::int16_t button, std::int16_t shift, float x, float y) {
    ForwardEvent(frame::stock::MouseDown, button, shift, x, y);
    own.dragging = true;
    own.pressX = x;
    own.pressY = y;
}

void Splitter::SurfaceMouseMove(std::int16_t button, std::int16_t shift, float x, float y) {
    ForwardEvent(frame::stock::MouseMove, button, shift, x, y);
    Hover(x, y);
    DragStep(x, y);
}

// Draws nothing: the bar keeps its highlight until it is painted or the mouse moves.
void Splitter::SurfaceMouseUp(std::int16_t button, std::int16_t shift, float x, float y) {
    ForwardEvent(frame::stock::MouseUp, button, shift, x, y);
    own.dragging = false;
    own.highlighted = false;
}

/// The object that holds the bar. A form that does not tell its name leaves it to the first of the controls.
Object* Splitter::FormObject() const {
    if (!Site()) return nullptr;
    Object* parent = Site()->Parent();
    ResumeNext next;
    if (parent && !next.Value([&] { return parent->Get("Name").ToText(); }, {}).empty()) return parent;
    frame::Siblings& siblings = Site()->ParentControls();
    return siblings.Count() > 0 ? &siblings.Item(0) : nullptr;
}

void Splitter::PutInTheMiddle() {
    constexpr std::int16_t sizeNorthSouth = 7, sizeWestEast = 9;
    ResumeNext next;
    frame::ObjectRef form;
    next([&] {
        if (Object* found = FormObject()) form = frame::ObjectRef(*found);
    });
    const auto formSize = [&](const char* member) { return form->Get(member).ToSingle(); };
    if (own.Orientation == tsOrientation::tsHorizontal) {
        next([&] { Extender().Put("Left", 0.0f); });
        next([&] { Extender().Put("Top", formSize("ScaleHeight") / 2); });
        next([&] { Surface().SetWidth(formSize("ScaleWidth")); });
        next([&] { Surface().SetHeight(thickness); });
        next([&] { Surface().SetMousePointer(sizeNorthSouth); });
    } else if (own.Orientation == tsOrientation::tsVertical) {
        next([&] { Extender().Put("Left", formSize("ScaleWidth") / 2); });
        next([&] { Extender().Put("Top", 0.0f); });
        next([&] { Surface().SetWidth(thickness); });
        next([&] { Surface().SetHeight(formSize("ScaleHeight")); });
        next([&] { Surface().SetMousePointer(sizeWestEast); });
    }
}

Object* Splitter::FindControl(std::string_view entry) {
    constexpr std::int16_t searching = 42, idle = 0;
    ResumeNext next;
    std::string_view name = frame::TrimBlanks(entry);
    std::int16_t index = -1;
    if (const std::size_t open = name.find('('); open != std::string_view::npos) {
        index = 0;  // stays so for what is no number
        next([&] { index = Variant(name.substr(open + 1, std::max(name.size() - open, std::size_t{2}) - 2)).ToInteger(); });
        name = name.substr(0, open);
    }
    own.Ident = searching;
    Object* found = nullptr;
    next([&] {
        if (Site()) found = Site()->ParentControls().Find(name, index);
    });
    own.Ident = idle;
    return found;
}

bool Splitter::InActiveArea(float x, float y) const {
    return x >= edgeStripTwips && x <= Surface().ScaleWidth() - edgeStripTwips && y >= edgeStripTwips &&
           y <= Surface().ScaleHeight() - edgeStripTwips;
}

void Splitter::Hover(float x, float y) {
    if (own.dragging) {
        own.highlighted = true;
        return;
    }
    const bool active = InActiveArea(x, y);
    if (active == own.highlighted) return;
    own.highlighted = active;
    Draw();
}

// The bar moves under the pointer, so that the pointer stays where it was pressed on the bar.
void Splitter::DragStep(float x, float y) {
    if (!own.dragging) return;
    MoveBy(own.Orientation == tsOrientation::tsHorizontal ? y - own.pressY : x - own.pressX);
}

void Splitter::MoveControls(float dx, float dy) {
    const bool across = own.Orientation == tsOrientation::tsHorizontal;
    const char* const extent = across ? "Height" : "Width";
    const char* const place = across ? "Top" : "Left";
    const float distance = across ? dy : dx;
    const auto find = [this](std::string_view entry) {
        Object* found = FindControl(entry);
        return found ? frame::ObjectRef(*found) : frame::ObjectRef();
    };
    ResumeNext next;
    EachEntry(own.ControlsTopLeft, [&](std::string_view entry) {
        next.Clear();
        const frame::ObjectRef control = find(entry);
        if (!control.IsNothing()) next([&] { AddToExtent(*control, extent, distance); });
    });
    EachEntry(own.ControlsBottomRight, [&](std::string_view entry) {
        next.Clear();
        const frame::ObjectRef control = find(entry);
        if (control.IsNothing()) return;
        next([&] { AddToExtent(*control, extent, -distance); });
        next([&] { AddTo(*control, place, distance); });  // a control squeezed to nothing moves on
    });
}

void Splitter::Draw() {
    struct InPixels {
        explicit InPixels(OwnSurface& given) : surface(given) { surface.SetScaleMode(frame::ScaleModeConstants::Pixels); }
        ~InPixels() { surface.SetScaleMode(frame::ScaleModeConstants::Twips); }
        OwnSurface& surface;
    } const pixels(Surface());
    const auto lines = splitter::BarDrawing({.orientation = own.Orientation,
                                             .appearance = own.Appearance,
                                             .width = Surface().ScaleWidth(),
                                             .height = Surface().ScaleHeight(),
                                             .fill = own.highlighted ? own.HighlightColor : BackColor(),
                                             .border = ForeColor()});
    for (const auto& line : lines) Surface().Line(line.x1, line.y1, line.x2, line.y2, line.color, line.box);
}

const Splitter::Way* Splitter::TheWay() const {
    static constexpr Way down{"Top", "Height", "ScaleHeight"}, right{"Left", "Width", "ScaleWidth"};
    switch (own.Orientation) {
        case tsOrientation::tsHorizontal:
            return &down;
        case tsOrientation::tsVertical:
            return &right;
    }
    return nullptr;
}

float Splitter::OwnThickness() const {
    return own.Orientation == tsOrientation::tsHorizontal ? Surface().Height() : Surface().Width();
}

float Splitter::FormExtent(const Way& way) const {
    Object* parent = Site() ? Site()->Parent() : nullptr;
    if (!parent) frame::ThrowObjectGone();
    return parent->Get(way.formExtent).ToSingle();
}

struct Splitter::Tables {
    static constexpr std::array members = {
        frame::property<&Splitter::MinTopLeft, &Splitter::SetMinTopLeft>(
            "MinTopLeft", "Sets the minimum for the splitter for the bottom or right size depending on its orientation."),
        frame::property<&Splitter::MinBottomRight, &Splitter::SetMinBottomRight>(
            "MinBottomRight", "Sets the minimum for the splitter for the top or left size depending on its orientation."),
        frame::property<&Splitter::BackColor, &Splitter::SetBackColor>(
            "BackColor", "Returns/sets the background color used to display text and graphics in an object.",
            frame::dispatch::backColor),
        frame::property<&Splitter::ForeColor, &Splitter::SetForeColor>(
            "ForeColor", "Returns/sets the foreground color used to draw the border when appearance is flat.",
            frame::dispatch::foreColor),
        frame::property<&Splitter::Enabled, &Splitter::SetEnabled>(
            "Enabled", "Returns/sets a value that determines whether an object can respond to user-generated events.",
            frame::dispatch::enabled),
        frame::method<&Splitter::Refresh>("Refresh", "Forces a complete repaint of a object.", {}, frame::dispatch::refresh),
        frame::property<&Splitter::Orientation, &Splitter::SetOrientation>("Orientation",
                                                                           "Orientation of the control (Horizontal or vertical)."),
        frame::property<&Splitter::ControlsTopLeft, &Splitter::SetControlsTopLeft>(
            "ControlsTopLeft", "Comma separated list of controls to size that are above or to the left of the splitter."),
        frame::property<&Splitter::ControlsBottomRight, &Splitter::SetControlsBottomRight>(
            "ControlsBottomRight", "Comma separated list of controls to size that are below or to the right of the splitter."),
        frame::property<&Splitter::MousePointer, &Splitter::SetMousePointer>(
            "MousePointer", "Returns/sets the type of mouse pointer displayed when over part of an object."),
        frame::property<&Splitter::MouseIcon, &Splitter::SetMouseIcon>("MouseIcon", "Sets a custom mouse icon."),
        frame::property<&Splitter::Appearance, &Splitter::SetAppearance>(
            "Appearance", "Appearance of the control.  It can appear flat, sunken, raised and grooved.",
            frame::dispatch::appearance),
        frame::property<&Splitter::HighlightColor, &Splitter::SetHighlightColor>(
            "HighlightColor", "Returns/sets the highlight color used to highlight the control when the mouse pointer is over it."),
        frame::runTimeProperty<&Splitter::Ident, &Splitter::SetIdent>("Ident", "Internal splitter identification"),
    };
    static constexpr std::array<const frame::EventInfo*, 9> events = {
        &frame::stock::Click,     &frame::stock::DblClick,  &frame::stock::KeyDown, &frame::stock::KeyPress, &frame::stock::KeyUp,
        &frame::stock::MouseDown, &frame::stock::MouseMove, &frame::stock::MouseUp, &splitter::AfterMove,
    };
    static constexpr std::array kept = {
        frame::key<&Splitter::own, &Own::MinTopLeft>("MinTopLeft", VarType::Integer, 0),
        frame::key<&Splitter::own, &Own::MinBottomRight>("MinBottomRight", VarType::Integer, 0),
        frame::surfaceKey<&OwnSurface::BackColor, &OwnSurface::SetBackColor>("BackColor", VarType::Long, 0x8000000F),
        frame::surfaceKey<&OwnSurface::ForeColor, &OwnSurface::SetForeColor>("ForeColor", VarType::Long, 0x80000012),
        frame::surfaceKey<&OwnSurface::Enabled, &OwnSurface::SetEnabled>("Enabled", VarType::Boolean, true),
        frame::key<&Splitter::own, &Own::Orientation>("Orientation", VarType::Integer, 0),
        frame::key<&Splitter::own, &Own::ControlsTopLeft>("ControlsTopLeft", ""),
        frame::key<&Splitter::own, &Own::ControlsBottomRight>("ControlsBottomRight", ""),
        frame::surfaceKey<&OwnSurface::MousePointer, &OwnSurface::SetMousePointer>("MousePointer", VarType::Integer, 0),
        frame::setterKey<&Splitter::MouseIcon, &Splitter::SetMouseIcon>("MouseIcon", frame::noObject),
        frame::key<&Splitter::own, &Own::Appearance>("Appearance", VarType::Integer, 4),
        frame::key<&Splitter::own, &Own::HighlightColor>("HighlightColor", VarType::Long, 0xC0C000),
        frame::key<&Splitter::own, &Own::Ident>("Ident", VarType::Integer, 0),
    };
};

constexpr frame::ClassTable Splitter::table{
    .name = "Splitter", .members = Tables::members, .events = Tables::events, .bag = Tables::kept, .inputs = frame::keyInputs};

}  // namespace tessel::controls
