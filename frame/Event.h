#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <span>
#include <string_view>
#include <utility>

#include "frame/Convert.h"
#include "frame/Member.h"
#include "frame/StockNumbers.h"

namespace tessel::frame {

/// An event of a control's event interface: its name, its dispatch number and its arguments.
struct EventInfo {
    std::string_view name;
    int number = 0;
    std::string_view help;
    Parameters parameters;
};

/// A declared event with the types of its arguments, all by reference: `Event<std::int16_t&, float&>`.
template <class... Args>
struct Event : EventInfo {
    static_assert((std::is_lvalue_reference_v<Args> && ...), "every argument of an event goes by reference");

    constexpr Event(std::string_view eventName, int eventNumber, std::initializer_list<std::string_view> parameterNames = {},
                    std::string_view helpText = {})
        : EventInfo{eventName, eventNumber, helpText, detail::ParametersOf<std::tuple<Args...>>(parameterNames)} {}

    /// The same event under an ordinary number of its control.
    constexpr Event Numbered(int ordinary) const {
        Event copy = *this;
        copy.number = ordinary;
        return copy;
    }
};

/// One argument of a raised event: a reference to the storage of the one who raised it. What a handler sets is there at once.
class EventArgument {
  public:
    template <class T>
    explicit EventArgument(T& storage) : storage_(&storage), access_(&accessTo<T>) {}

    Variant Get() const { return access_->get(storage_); }
    /// Converts to the storage's type; error 13 or 6 where that fails, with the storage unchanged.
    void Set(const Variant& value) const { access_->set(storage_, value); }
    /// The storage itself. Only with the type that the event declares.
    template <class T>
    T& As() const {
        if (access_ != &accessTo<T>) throw ControlError(errors::typeMismatch);
        return *static_cast<T*>(storage_);
    }

  private:
    struct AccessTable {
        Variant (*get)(const void*);
        void (*set)(void*, const Variant&);
    };
    template <class T>
    static constexpr AccessTable accessTo{
        [](const void* storage) { return Conversion<T>::To(*static_cast<const T*>(storage)); },
        [](void* storage, const Variant& value) { *static_cast<T*>(storage) = Conversion<T>::From(value); }};

    void* storage_;
    const AccessTable* access_;
};

using EventArguments = std::span<const EventArgument>;

/// The stock events that several controls forward from their main child.
namespace stock {
inline constexpr Event<> Click{
    "Click", dispatch::click, {}, "Occurs when the user presses and then releases a mouse button over an object."};
inline constexpr Event<> DblClick{
    "DblClick",
    dispatch::dblClick,
    {},
    "Occurs when the user presses and releases a mouse button and then presses and releases it again over an object."};
inline constexpr Event<std::int16_t&, std::int16_t&> KeyDown{
    "KeyDown", dispatch::keyDown, {"KeyCode", "Shift"}, "Occurs when the user presses a key while an object has the focus."};
inline constexpr Event<std::int16_t&> KeyPress{
    "KeyPress", dispatch::keyPress, {"KeyAscii"}, "Occurs when the user presses and releases an ANSI key."};
inline constexpr Event<std::int16_t&, std::int16_t&> KeyUp{
    "KeyUp", dispatch::keyUp, {"KeyCode", "Shift"}, "Occurs when the user releases a key while an object has the focus."};
inline constexpr Event<std::int16_t&, std::int16_t&, float&, float&> MouseDown{
    "MouseDown",
    dispatch::mouseDown,
    {"Button", "Shift", "X", "Y"},
    "Occurs when the user presses the mouse button while an object has the focus."};
inline constexpr Event<std::int16_t&, std::int16_t&, float&, float&> MouseMove{
    "MouseMove", dispatch::mouseMove, {"Button", "Shift", "X", "Y"}, "Occurs when the user moves the mouse."};
inline constexpr Event<std::int16_t&, std::int16_t&, float&, float&> MouseUp{
    "MouseUp",
    dispatch::mouseUp,
    {"Button", "Shift", "X", "Y"},
    "Occurs when the user releases the mouse button while an object has the focus."};
}  // namespace stock

/// Who hears the events of a control: the application, through its host.
class EventSink {
  public:
    virtual ~EventSink() = default;
    /// Whether anybody listens. Asked before each raise; an event that nobody wants costs this test and nothing more.
    virtual bool Wants(const EventInfo& event) const = 0;
    /// Runs the application's handlers and returns when they have. Errors of a handler pass to the one who raised the event.
    virtual void Raise(const EventInfo& event, EventArguments arguments) = 0;
};

/// A sink for programs: typed handlers by event.
///
///     Handlers handlers;
///     handlers.On(stock::MouseDown, [&](std::int16_t& button, std::int16_t&, float&, float&) { ... });
class Handlers final : public EventSink {
  public:
    /// Adds or replaces the handler of an event.
    template <class... Args, class F>
    void On(const Event<Args...>& event, F handler) {
        auto call = [handler = std::move(handler)](EventArguments arguments) mutable {
            [&]<std::size_t... I>(std::index_sequence<I...>) {
                handler(arguments[I].template As<std::remove_reference_t<Args>>()...);
            }
            (std::index_sequence_for<Args...>{});
        };
        handlers_[event.number] = std::make_shared<Handler>(std::move(call));
    }
    void Remove(const EventInfo& event) { handlers_.erase(event.number); }

    bool Wants(const EventInfo& event) const override { return handlers_.contains(event.number); }
    void Raise(const EventInfo& event, EventArguments arguments) override {
        const auto found = handlers_.find(event.number);
        if (found == handlers_.end()) return;
        const auto handler = found->second;  // a handler may replace or remove itself
        (*handler)(arguments);
    }

  private:
    using Handler = std::function<void(EventArguments)>;
    std::map<int, std::shared_ptr<Handler>> handlers_;
};

/// Where a child's event goes: one function of its control. Empty until it is connected.
template <class... Args>
class Slot {
  public:
    /// `label.MouseDown.To<&Link::LabelMouseDown>(*this)`
    template <auto F, class T>
    void To(T& target) {
        target_ = &target;
        call_ = [](void* object, Args... arguments) { (static_cast<T*>(object)->*F)(static_cast<Args&&>(arguments)...); };
    }
    explicit operator bool() const { return call_ != nullptr; }
    void operator()(Args... arguments) const {
        if (call_) call_(target_, static_cast<Args&&>(arguments)...);
    }

  private:
    void* target_ = nullptr;
    void (*call_)(void*, Args...) = nullptr;
};

}  // namespace tessel::frame
