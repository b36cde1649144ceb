#include "hosts/headless/HostObject.h"

#include <algorithm>
#include <functional>

#include "frame/ClassTable.h"
#include "frame/Error.h"
#include "frame/Text.h"

namespace tessel::headless {

using frame::ControlError;
using frame::Variant;

namespace {

constexpr frame::ClassTable plainTable{.name = "HostObject", .members = {}};
constexpr frame::ClassTable drawingTable{.name = "Surface", .members = frame::drawingMembers};

}  // namespace

HostObject::HostObject(std::string path, const Members& members) : path_(std::move(path)) {
    for (const auto& [name, value] : members) SetMember(name, value);
}

const frame::ClassTable& HostObject::Table() const { return plainTable; }

const Variant* HostObject::Find(frame::MemberKey key) const {
    if (key.ByNumber()) return nullptr;
    const auto found = std::find_if(members_.begin(), members_.end(),
                                    [&](const auto& member) { return frame::EqualsNoCase(member.first, key.Name()); });
    return found != members_.end() ? &found->second : nullptr;
}

Variant HostObject::Get(frame::MemberKey key, frame::Arguments arguments) {
    const Variant* value = Find(key);
    if (!value) throw ControlError(frame::errors::noSuchMember);
    if (!arguments.empty()) throw ControlError(frame::errors::wrongArguments);
    return *value;
}

void HostObject::Put(frame::MemberKey key, const Variant& value, frame::Arguments arguments) {
    if (!Find(key)) throw ControlError(frame::errors::noSuchMember);
    if (!arguments.empty()) throw ControlError(frame::errors::wrongArguments);
    SetMember(key.Name(), value);
}

Variant HostObject::Call(frame::MemberKey key, frame::Arguments arguments) { return Get(key, arguments); }

frame::ObjectRef HostObject::Inner(std::string_view name) {
    const Variant* value = Find(name);
    return value && value->Type() == frame::VarType::Object ? value->ToObject() : frame::ObjectRef();
}

void HostObject::SetMember(std::string_view name, Variant value) {
    constexpr std::string_view color = "Color";
    if (renamed_ && (frame::EqualsNoCase(name, "Name") || frame::EqualsNoCase(name, "Index"))) *renamed_ = true;
    if (value.IsNumber() && name.size() >= color.size() && frame::EqualsNoCase(name.substr(name.size() - color.size()), color))
        value = value.ToColor();
    const auto found =
        std::find_if(members_.begin(), members_.end(), [&](const auto& member) { return frame::EqualsNoCase(member.first, name); });
    if (found != members_.end())
        found->second = std::move(value);
    else
        members_.emplace_back(name, std::move(value));
}

SurfaceObject::SurfaceObject(frame::Host& host, std::string path, Members members)
    : HostObject(std::move(path), {}), DrawingSurface(host) {
    AddCanvas(host.Peers().MakeCanvas(*this, *this));
    frame::TextSize size{12'000, 9'000};
    for (const auto& [name, value] : members) {
        if (frame::EqualsNoCase(name, "Width")) size.width = value.ToSingle();
        if (frame::EqualsNoCase(name, "Height")) size.height = value.ToSingle();
    }
    SetInner(size);
    Take(std::move(members));
}

void SurfaceObject::Take(Members members) {
    const auto isScaleMode = [](const auto& member) { return frame::EqualsNoCase(member.first, "ScaleMode"); };
    std::stable_partition(members.begin(), members.end(), std::not_fn(isScaleMode));
    for (auto& [name, value] : members) {
        if (Has(std::string_view(name)))
            Put(name, value);
        else
            SetMember(name, std::move(value));
    }
}

Variant SurfaceObject::Get(frame::MemberKey key, frame::Arguments arguments) {
    const frame::Member* drawing = drawingTable.Find(key);
    return drawing && drawing->get ? drawing->get(*this, arguments) : HostObject::Get(key, arguments);
}

void SurfaceObject::Put(frame::MemberKey key, const Variant& value, frame::Arguments arguments) {
    const frame::Member* drawing = drawingTable.Find(key);
    if (drawing && drawing->set)
        drawing->set(*this, arguments, value);
    else
        HostObject::Put(key, value, arguments);
}

Variant SurfaceObject::Call(frame::MemberKey key, frame::Arguments arguments) {
    const frame::Member* drawing = drawingTable.Find(key);
    return drawing && drawing->call ? drawing->call(*this, arguments) : Get(key, arguments);
}

bool SurfaceObject::Has(frame::MemberKey key) const { return drawingTable.Find(key) || HostObject::Has(key); }

void SurfaceObject::SetScaleWidth(float value) {
    if (ScaleMode() == frame::ScaleModeConstants::User)
        DrawingSurface::SetScaleWidth(value);
    else
        SetInner({value * TwipsPerUnit().width, inner_.height});
}

void SurfaceObject::SetScaleHeight(float value) {
    if (ScaleMode() == frame::ScaleModeConstants::User)
        DrawingSurface::SetScaleHeight(value);
    else
        SetInner({inner_.width, value * TwipsPerUnit().height});
}

void SurfaceObject::SetInner(frame::TextSize size) {
    inner_ = size;
    Resized();
}

}  // namespace tessel::headless
