#pragma once

#include <array>
#include <cstdint>
#include <initializer_list>
#include <optional>
#include <span>
#include <string_view>
#include <tuple>
#include <type_traits>
#include <utility>

#include "frame/Convert.h"
#include "frame/Error.h"

/// The rows of a class table: a member of a class, declared once, with what late-bound callers, designers and the reference
/// pages need of it.
namespace tessel::frame {

/// The names of an enumeration's constants, in the order of their declaration.
struct Enumeration {
    struct Constant {
        std::string_view name;
        int value;
    };
    std::string_view name;
    std::span<const Constant> constants;
};

/// The names of an enumeration type; null for any other type. Specialised beside the enumeration.
template <class T>
inline constexpr const Enumeration* enumerationOf = nullptr;

/// What a designer or a manual has to know of the type of a value.
struct TypeInfo {
    VarType type = VarType::Empty;
    bool isColor = false;
    const Enumeration* enumeration = nullptr;

    template <class T>
    static constexpr TypeInfo Of() {
        using Plain = std::remove_cvref_t<T>;
        if constexpr (std::is_void_v<Plain> || std::is_same_v<Plain, Status>)
            return {};
        else if constexpr (std::is_base_of_v<Object, Plain>)
            return {VarType::Object};
        else
            return {Conversion<Plain>::type, std::is_same_v<Plain, OLE_COLOR>, enumerationOf<Plain>};
    }
};

struct Parameter {
    std::string_view name;
    TypeInfo type;
    bool optional = false;
    bool byReference = false;
};

inline constexpr std::size_t maximumParameters = 7;

struct Parameters {
    std::array<Parameter, maximumParameters> list{};
    std::size_t count = 0;

    constexpr std::span<const Parameter> All() const { return {list.data(), count}; }
};

/// When a property may be set. `RunTime` refuses at design time with error 387; `ReadOnly` refuses always, with 387 at
/// design time and 382 at run time; `GetOnly` has no setter to call (error 382).
enum class Access : std::uint8_t { Plain, RunTime, ReadOnly, GetOnly };

struct Member {
    std::string_view name;
    std::string_view help;
    int number = 0;  ///< dispatch number; 0 stands for the row's place in its table, from 1
    Access access = Access::Plain;
    bool isMethod = false;
    TypeInfo type;
    Parameters parameters;

    using Getter = Variant (*)(Object&, Arguments);
    using Setter = void (*)(Object&, Arguments, const Variant&);
    Getter get = nullptr;  ///< of a property
    Setter set = nullptr;
    Getter call = nullptr;  ///< of a method or an input
};

namespace detail {

template <class F>
struct MemberFunction;
template <class R, class C, class... A>
struct MemberFunction<R (C::*)(A...)> {
    using Class = C;
    using Result = R;
    using Tuple = std::tuple<A...>;
    static constexpr std::size_t count = sizeof...(A);
};
template <class R, class C, class... A>
struct MemberFunction<R (C::*)(A...) const> : MemberFunction<R (C::*)(A...)> {};
template <class R, class C, class... A>
struct MemberFunction<R (C::*)(A...) noexcept> : MemberFunction<R (C::*)(A...)> {};
template <class R, class C, class... A>
struct MemberFunction<R (C::*)(A...) const noexcept> : MemberFunction<R (C::*)(A...)> {};

template <class T>
inline constexpr bool isOptional = false;
template <class T>
inline constexpr bool isOptional<std::optional<T>> = true;

template <class A>
inline constexpr bool isByReference = std::is_lvalue_reference_v<A> && !std::is_const_v<std::remove_reference_t<A>>;

/// The object as the class that a member function belongs to; a class beside `Object` is reached by its run-time type.
template <class C>
C& As(Object& self) {
    if constexpr (std::is_base_of_v<Object, C>)
        return static_cast<C&>(self);
    else
        return dynamic_cast<C&>(self);
}

template <class A>
std::remove_cvref_t<A> ArgumentAt(Arguments arguments, std::size_t index) {
    using T = std::remove_cvref_t<A>;
    if (index < arguments.size() && (!arguments[index].IsMissing() || isOptional<T>)) return FromVariant<T>(arguments[index]);
    if constexpr (isOptional<T>)
        return FromVariant<T>(Variant::Missing());
    else
        throw ControlError(errors::argumentMissing);
}

/// Passes a stored value on as the parameter type asks: by reference, or moved out.
template <class A, class T>
decltype(auto) Pass(T& stored) {
    if constexpr (std::is_lvalue_reference_v<A>)
        return static_cast<A>(stored);
    else
        return static_cast<A&&>(stored);
}

template <class R, class F>
Variant ResultOf(F&& call) {
    if constexpr (std::is_void_v<R>) {
        call();
        return {};
    } else if constexpr (std::is_same_v<R, Status>) {
        call().Check();
        return {};
    } else {
        return ToVariant(call());
    }
}

template <auto F>
Variant Invoke(Object& self, Arguments arguments) {
    using M = MemberFunction<decltype(F)>;
    if (arguments.size() > M::count) throw ControlError(errors::wrongArguments);
    auto& object = As<typename M::Class>(self);
    return [&]<std::size_t... I>(std::index_sequence<I...>) {
        std::tuple<std::remove_cvref_t<std::tuple_element_t<I, typename M::Tuple>>...> values{
            ArgumentAt<std::tuple_element_t<I, typename M::Tuple>>(arguments, I)...};
        Variant result = ResultOf<typename M::Result>([&]() -> decltype(auto) {
            return (object.*F)(Pass<std::tuple_element_t<I, typename M::Tuple>>(std::get<I>(values))...);
        });
        [[maybe_unused]] const auto giveBack = [&]<std::size_t N>(std::integral_constant<std::size_t, N>) {
            if constexpr (isByReference<std::tuple_element_t<N, typename M::Tuple>>)
                if (N < arguments.size()) arguments[N] = ToVariant(std::get<N>(values));
        };
        (giveBack(std::integral_constant<std::size_t, I>{}), ...);
        return result;
    }
    (std::make_index_sequence<M::count>{});
}

/// Calls a setter whose last parameter is the value and whose others are the index.
template <auto F>
void Assign(Object& self, Arguments index, const Variant& value) {
    using M = MemberFunction<decltype(F)>;
    constexpr std::size_t last = M::count - 1;
    if (index.size() > last) throw ControlError(errors::wrongArguments);
    auto& object = As<typename M::Class>(self);
    [&]<std::size_t... I>(std::index_sequence<I...>) {
        const auto assign = [&]() -> decltype(auto) {
            return (object.*F)(ArgumentAt<std::tuple_element_t<I, typename M::Tuple>>(index, I)...,
                               FromVariant<std::remove_cvref_t<std::tuple_element_t<last, typename M::Tuple>>>(value));
        };
        ResultOf<typename M::Result>(assign);
    }
    (std::make_index_sequence<last>{});
}

template <class Tuple>
constexpr Parameters ParametersOf(std::initializer_list<std::string_view> names) {
    static_assert(std::tuple_size_v<Tuple> <= maximumParameters);
    Parameters result;
    [&]<std::size_t... I>(std::index_sequence<I...>) {
        ((result.list[I] =
              Parameter{I < names.size() ? names.begin()[I] : std::string_view(), TypeInfo::Of<std::tuple_element_t<I, Tuple>>(),
                        isOptional<std::remove_cvref_t<std::tuple_element_t<I, Tuple>>>,
                        isByReference<std::tuple_element_t<I, Tuple>>}),
         ...);
    }
    (std::make_index_sequence<std::tuple_size_v<Tuple>>{});
    result.count = std::tuple_size_v<Tuple>;
    return result;
}

}  // namespace detail

/// A property that can only be read, of an object that refuses nothing: a count, a collection, a computed size.
/// An indexed one has the index as the getter's parameters.
template <auto Get>
constexpr Member property(std::string_view name, std::string_view help = {}, int number = 0) {
    using M = detail::MemberFunction<decltype(Get)>;
    return {.name = name,
            .help = help,
            .number = number,
            .access = Access::GetOnly,
            .isMethod = false,
            .type = TypeInfo::Of<typename M::Result>(),
            .parameters = detail::ParametersOf<typename M::Tuple>({"Index"}),
            .get = &detail::Invoke<Get>,
            .set = nullptr,
            .call = nullptr};
}

/// A property with a getter and a setter; the setter of an indexed one takes the index before the value.
template <auto Get, auto Set>
constexpr Member property(std::string_view name, std::string_view help = {}, int number = 0) {
    Member row = property<Get>(name, help, number);
    row.access = Access::Plain;
    row.set = &detail::Assign<Set>;
    return row;
}

/// A property that cannot be set at design time; its setter begins with `RefuseAtDesignTime`.
template <auto Get, auto Set>
constexpr Member runTimeProperty(std::string_view name, std::string_view help = {}, int number = 0) {
    Member row = property<Get, Set>(name, help, number);
    row.access = Access::RunTime;
    return row;
}

/// A property that is never set: the attempt is refused by `Object::Put` on the control's behalf.
template <auto Get>
constexpr Member readOnlyProperty(std::string_view name, std::string_view help = {}, int number = 0) {
    Member row = property<Get>(name, help, number);
    row.access = Access::ReadOnly;
    return row;
}

template <auto F>
constexpr Member method(std::string_view name, std::string_view help = {}, std::initializer_list<std::string_view> parameters = {},
                        int number = 0) {
    using M = detail::MemberFunction<decltype(F)>;
    return {.name = name,
            .help = help,
            .number = number,
            .access = Access::Plain,
            .isMethod = true,
            .type = TypeInfo::Of<typename M::Result>(),
            .parameters = detail::ParametersOf<typename M::Tuple>(parameters),
            .get = nullptr,
            .set = nullptr,
            .call = &detail::Invoke<F>};
}

/// What a toolkit reports to a child or a surface: the event by its name, with the effects that the model has by itself.
template <auto F>
constexpr Member input(std::string_view name, std::initializer_list<std::string_view> parameters = {}) {
    return method<F>(name, {}, parameters);
}

/// Rows of a base class and of its own class as one table.
template <std::size_t A, std::size_t B>
constexpr std::array<Member, A + B> Join(const std::array<Member, A>& base, const std::array<Member, B>& own) {
    std::array<Member, A + B> all{};
    for (std::size_t i = 0; i < A; ++i) all[i] = base[i];
    for (std::size_t i = 0; i < B; ++i) all[A + i] = own[i];
    return all;
}

}  // namespace tessel::frame
