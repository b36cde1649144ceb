#include "frame/Extender.h"

#include "frame/Control.h"

namespace tessel::frame {
namespace {

/// The row of one of the host's own members; they have names alone.
const Member* Find(MemberKey key) {
    static constexpr std::array rows = {
        property<&Extender::Name>("Name"),
        property<&Extender::Left, &Extender::SetLeft>("Left"),
        property<&Extender::Top, &Extender::SetTop>("Top"),
        property<&Extender::Width, &Extender::SetWidth>("Width"),
        property<&Extender::Height, &Extender::SetHeight>("Height"),
        property<&Extender::Visible, &Extender::SetVisible>("Visible"),
    };
    static constexpr ClassTable table{.name = "Extender", .members = rows};
    return key.ByNumber() ? nullptr : table.Find(key);
}

}  // namespace

const Object& Extender::Behind(MemberKey key) const {
    if (!key.ByNumber() && More().Has(key)) return More();
    return site_.Control();
}

Variant Extender::Get(MemberKey key, Arguments arguments) {
    if (const Member* own = Find(key)) return own->get(*this, arguments);
    return Behind(key).Get(key, arguments);
}

void Extender::Put(MemberKey key, const Variant& value, Arguments arguments) {
    const Member* own = Find(key);
    if (!own) return Behind(key).Put(key, value, arguments);
    if (!own->set) throw ControlError(errors::notAtRunTime);
    own->set(*this, arguments, value);
}

Variant Extender::Call(MemberKey key, Arguments arguments) {
    return Find(key) ? Get(key, arguments) : Behind(key).Call(key, arguments);
}

bool Extender::Has(MemberKey key) const { return Find(key) || Behind(key).Has(key); }

ObjectRef Extender::Inner(std::string_view name) { return site_.Control().Inner(name); }

const ClassTable& Extender::Table() const { return site_.Control().Table(); }

}  // namespace tessel::frame
