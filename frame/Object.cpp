#include "frame/Object.h"

#include <algorithm>

#include "frame/ClassTable.h"
#include "frame/Error.h"
#include "frame/Text.h"

namespace tessel::frame {

Object::~Object() {
    if (anchor_) *anchor_ = nullptr;
}

namespace {

const Member& Require(const ClassTable& table, MemberKey key) {
    const Member* member = table.Find(key);
    if (!member) throw ControlError(errors::noSuchMember);
    return *member;
}

}  // namespace

Variant Object::Get(MemberKey key, Arguments arguments) {
    const Member& member = Require(Table(), key);
    if (member.isMethod) throw ControlError(errors::noSuchMember);
    return member.get(*this, arguments);
}

void Object::Put(MemberKey key, const Variant& value, Arguments arguments) {
    const Member& member = Require(Table(), key);
    if (member.isMethod) throw ControlError(errors::noSuchMember);
    if (member.access == Access::ReadOnly) RefuseReadOnly();
    if (!member.set) throw ControlError(errors::notAtRunTime);
    member.set(*this, arguments, value);
}

Variant Object::Call(MemberKey key, Arguments arguments) {
    const Member& member = Require(Table(), key);
    return member.isMethod ? member.call(*this, arguments) : member.get(*this, arguments);
}

bool Object::Has(MemberKey key) const { return Table().Find(key) != nullptr; }

void Object::RefuseReadOnly() const { throw ControlError(errors::notAtRunTime); }

ObjectRef Object::Inner(std::string_view name) {
    for (const Part& part : Table().parts)
        if (EqualsNoCase(part.name, name)) return ObjectRef(part.of(*this));
    const Member* member = Table().Find(name);
    if (!member || member->isMethod || member->type.type != VarType::Object || member->parameters.count != 0) return {};
    return member->get(*this, {}).ToObject();
}

WeakObject::WeakObject(Object& object) {
    if (!object.anchor_) object.anchor_ = std::make_shared<Object*>(&object);
    anchor_ = object.anchor_;
}

Object* ObjectRef::Get() const {
    if (const auto* shared = std::get_if<std::shared_ptr<Object>>(&ref_)) return shared->get();
    return std::get<WeakObject>(ref_).Get();
}

bool ObjectRef::IsNothing() const {
    const auto* shared = std::get_if<std::shared_ptr<Object>>(&ref_);
    return shared && !*shared;
}

Object& ObjectRef::operator*() const {
    Object* object = Get();
    if (!object) ThrowObjectGone();
    return *object;
}

std::shared_ptr<Object> ObjectRef::Shared() const {
    const auto* shared = std::get_if<std::shared_ptr<Object>>(&ref_);
    return shared ? *shared : nullptr;
}

bool operator==(const ObjectRef& a, const ObjectRef& b) {
    const Object* first = a.Get();
    const Object* second = b.Get();
    if (!first || !second) return first == second && a.IsNothing() == b.IsNothing();
    return first == second || first->EqualsObject(*second);
}

void ThrowObjectGone() { throw ControlError(errors::objectGone); }

const Member* ClassTable::Find(MemberKey key) const {
    for (const Member& member : members)
        if (key.ByNumber() ? NumberOf(member) == key.Number() : EqualsNoCase(member.name, key.Name())) return &member;
    return nullptr;
}

const Member* ClassTable::FindInput(std::string_view inputName) const {
    const auto found =
        std::find_if(inputs.begin(), inputs.end(), [&](const Member& row) { return EqualsNoCase(row.name, inputName); });
    return found != inputs.end() ? &*found : nullptr;
}

const EventInfo* ClassTable::FindEvent(MemberKey key) const {
    for (const EventInfo* event : events)
        if (key.ByNumber() ? event->number == key.Number() : EqualsNoCase(event->name, key.Name())) return event;
    return nullptr;
}

int ClassTable::NumberOf(const Member& member) const {
    return member.number != 0 ? member.number : static_cast<int>(&member - members.data()) + 1;
}

}  // namespace tessel::frame
