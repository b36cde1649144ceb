#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <type_traits>
#include <variant>

namespace tessel::frame {

class Object;
class ObjectRef;
class Variant;
struct ClassTable;

using Arguments = std::span<Variant>;

/// A member named by its name (in any case) or its dispatch number.
class MemberKey {
  public:
    MemberKey(const char* name) : key_(std::string_view(name)) {}
    MemberKey(std::string_view name) : key_(name) {}
    MemberKey(const std::string& name) : key_(std::string_view(name)) {}
    MemberKey(int number) : key_(number) {}

    bool ByNumber() const { return std::holds_alternative<int>(key_); }
    int Number() const { return std::get<int>(key_); }
    std::string_view Name() const { return std::get<std::string_view>(key_); }

  private:
    std::variant<std::string_view, int> key_;
};

/// Everything that can be read, written and called by name. A class describes itself by its table; an object whose
/// members are known only at run time (a sibling on a form, an extender) answers the three virtual calls itself.
class Object {
  public:
    Object() = default;
    Object(const Object&) = delete;
    Object& operator=(const Object&) = delete;
    virtual ~Object();

    virtual const ClassTable& Table() const = 0;

    /// The value of a property, indexed by `arguments` where it takes an index. Error 438 when there is no such member,
    /// 449 and 450 for missing and surplus arguments, 13 and 6 for arguments that do not convert.
    virtual Variant Get(MemberKey key, Arguments arguments = {});
    virtual void Put(MemberKey key, const Variant& value, Arguments arguments = {});
    /// Calls a method. What it sets in its by-reference arguments stands in `arguments` afterwards.
    virtual Variant Call(MemberKey key, Arguments arguments = {});
    virtual bool Has(MemberKey key) const;

    /// The object by its name under this one: a child control, a member of a control array, a property that holds an object.
    /// Nothing when there is none.
    virtual ObjectRef Inner(std::string_view name);

    /// Where the object stands, as names joined by points ("Link1.Label1"); empty for an object that is a value.
    virtual std::string Path() const { return {}; }

    /// Whether two objects stand for the same value. Objects with identity are equal only to themselves.
    virtual bool EqualsObject(const Object& other) const { return this == &other; }

  protected:
    /// Refuses the setting of a read-only property: always throws.
    virtual void RefuseReadOnly() const;

  private:
    friend class WeakObject;
    std::shared_ptr<Object*> anchor_;  // made when the first weak reference is taken; tells them when this object goes
};

/// A reference that does not keep its object alive and knows when it has gone.
class WeakObject {
  public:
    WeakObject() = default;
    explicit WeakObject(Object& object);

    /// Null when the object has gone or none was ever set.
    Object* Get() const { return anchor_ ? *anchor_ : nullptr; }
    bool EverSet() const { return anchor_ != nullptr; }
    friend bool operator==(const WeakObject&, const WeakObject&) = default;

  private:
    std::shared_ptr<Object*> anchor_;
};

/// A weak reference to a known class: controls, children, siblings. `->` fails with error 91 when the target has gone.
template <class T>
class Handle {
  public:
    Handle() = default;
    Handle(T& target) : weak_(target) {}

    T* Get() const { return static_cast<T*>(weak_.Get()); }
    explicit operator bool() const { return Get() != nullptr; }
    T& operator*() const;
    T* operator->() const { return &**this; }

  private:
    WeakObject weak_;
};

/// A reference to any object, as a variant holds it: shared and strong for value-like objects, weak for all others.
class ObjectRef {
  public:
    ObjectRef() = default;
    template <class T>
    requires std::is_base_of_v<Object, T> ObjectRef(std::shared_ptr<T> value) : ref_(std::shared_ptr<Object>(std::move(value))) {}
    explicit ObjectRef(Object& object) : ref_(WeakObject(object)) {}

    /// Null for no object and for one that has gone.
    Object* Get() const;
    bool IsNothing() const;
    /// Error 91 for no object and for one that has gone.
    Object& operator*() const;
    Object* operator->() const { return &**this; }
    /// The shared value; empty for a weak reference or none.
    std::shared_ptr<Object> Shared() const;

    friend bool operator==(const ObjectRef& a, const ObjectRef& b);

  private:
    std::variant<std::shared_ptr<Object>, WeakObject> ref_;
};

[[noreturn]] void ThrowObjectGone();

template <class T>
T& Handle<T>::operator*() const {
    T* target = Get();
    if (!target) ThrowObjectGone();
    return *target;
}

}  // namespace tessel::frame
