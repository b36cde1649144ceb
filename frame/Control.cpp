#include "frame/Control.h"

#include <algorithm>
#include <cassert>
#include <utility>

#include "frame/Text.h"

namespace tessel::frame {

std::string Control::Path() const { return site_ ? site_->Path() : std::string(Table().name); }

ObjectRef Control::Inner(std::string_view name) {
    for (ChildControl* child : children_)
        if (EqualsNoCase(child->Name(), name)) return ObjectRef(*child);
    return Object::Inner(name);
}

void Control::InitProperties() {
    for (const BagKey& key : Table().bag)
        if (key.ownField) key.load(*this, key.onLoad.For(*this));
}

void Control::ReadProperties(const PropertyBag& bag) {
    for (const BagKey& key : Table().bag) key.load(*this, bag.ReadProperty(key.name, key.onLoad.For(*this)));
}

void Control::WriteProperties(PropertyBag& bag) const {
    const auto write = [&](const BagKey& key) { bag.WriteProperty(key.name, key.save(*this), key.onSave.For(*this)); };
    const ClassTable& table = Table();
    if (table.savedOrder.empty())
        for (const BagKey& key : table.bag) write(key);
    for (const std::string_view name : table.savedOrder) {
        const auto found = std::find_if(table.bag.begin(), table.bag.end(), [&](const BagKey& key) { return key.name == name; });
        assert(found != table.bag.end());
        write(*found);
    }
    for (const SavedKey& key : table.savedBehind) bag.WriteProperty(key.name, key.save(*this), key.onSave.For(*this));
}

FontRef Control::AmbientFont() const { return site_ ? site_->Ambient().Font() : std::make_shared<Font>(); }

void Control::PropertyChanged(std::string_view key) const {
    if (!site_) return;
    const Callout callout(host_);
    site_->PropertyChanged(key);
}

void Control::RefuseAtDesignTime() const {
    if (!UserMode()) throw ControlError(errors::notPermitted);
}

void Control::RefuseReadOnly() const {
    RefuseAtDesignTime();
    throw ControlError(errors::notAtRunTime);
}

Object& Control::Extender() const {
    if (!site_) ThrowObjectGone();
    return site_->Extender();
}

void Control::TakePeers() {
    for (ChildControl* child : children_)
        if (!std::exchange(child->askedForPeer_, true)) child->AttachPeer(host_.Peers().MakePeer(*child));
}

void Control::DropPeers() {
    for (ChildControl* child : children_) child->AttachPeer(nullptr);
}

Variant BagDefault::For(const Control& control) const {
    switch (source) {
        case Source::AmbientFont:
            return ObjectRef(control.AmbientFont());
        case Source::NoObject:
            return ObjectRef();
        case Source::None:
            return {};
        case Source::Value:
            break;
    }
    if (type == VarType::String) return text;
    if (isColor && type == VarType::Long) return OLE_COLOR(static_cast<std::uint32_t>(static_cast<std::int64_t>(number)));
    return Variant(number).ConvertedTo(type);
}

namespace detail {
const OwnSurface& SurfaceOf(const Control& control) { return control.Surface(); }
OwnSurface& SurfaceOf(Control& control) { return control.Surface(); }
}  // namespace detail

}  // namespace tessel::frame
