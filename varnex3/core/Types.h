// How the C++ types of properties, parameters and results travel through an interface that knows them as plain data.
#pragma once

#include <optional>
#include <type_traits>
#include <utility>

#include "varnex3/core/Conversions.h"
#include "varnex3/core/Error.h"
#include "varnex3/core/Interface.h"

namespace varnex3 {

// The interface type of a C++ type. A type without one cannot stand in a row.
template <class T>
struct TypeOf;

template <>
struct TypeOf<void>
{
    static constexpr Type type{Kind::None, {}, nullptr};
};
template <>
struct TypeOf<Text>
{
    static constexpr Type type{Kind::Text, {}, nullptr};
};
template <>
struct TypeOf<TextView>
{
    static constexpr Type type{Kind::Text, {}, nullptr};
};
template <>
struct TypeOf<double>
{
    static constexpr Type type{Kind::Double, {}, nullptr};
};
template <>
struct TypeOf<Date>
{
    static constexpr Type type{Kind::Date, {}, nullptr};
};
template <>
struct TypeOf<std::int16_t>
{
    static constexpr Type type{Kind::Int16, {}, nullptr};
};
template <>
struct TypeOf<std::int32_t>
{
    static constexpr Type type{Kind::Int32, {}, nullptr};
};
template <>
struct TypeOf<bool>
{
    static constexpr Type type{Kind::Boolean, {}, nullptr};
};
template <>
struct TypeOf<Variant>
{
    static constexpr Type type{Kind::Variant, {}, nullptr};
};
template <class T>
requires std::is_enum_v<T>
struct TypeOf<T>
{
    static constexpr Type type{Kind::Enumeration, EnumerationOf(T{}).name, &EnumerationOf(T{})};
};
template <class T>
struct TypeOf<Ref<T>>
{
    static constexpr Type type{Kind::Object, T::ClassName, nullptr};
};

template <class T>
concept InterfaceType = requires
{
    TypeOf<T>::type;
};

// A C++ value as a variant.
template <class T>
Variant ToVariant(const T& value)
{
    if constexpr (std::is_enum_v<T>)
        return static_cast<std::int32_t>(value);
    else if constexpr (std::is_same_v<T, Variant>)
        return value;
    else
        return Variant(std::in_place_type<T>, value);
}
template <class T>
Variant ToVariant(const Ref<T>& value)
{
    return Ref<Record>(value);
}

// A variant as a value of a C++ type, converted by the rules of Conversions.h.
template <class T>
struct FromVariant
{
    static T Get(const Variant& value)
    {
        if constexpr (std::is_same_v<T, Variant>)
            return value;
        else if constexpr (std::is_same_v<T, Text>)
            return ToText(value);
        else if constexpr (std::is_same_v<T, double>)
            return ToDouble(value);
        else if constexpr (std::is_same_v<T, Date>)
            return ToDate(value);
        else if constexpr (std::is_same_v<T, std::int16_t>)
            return ToInt16(value);
        else if constexpr (std::is_same_v<T, bool>)
            return ToBoolean(value);
        else
            return static_cast<T>(ToInt32(value));
    }
};

// A record is taken by a property of its own class only; nothing is taken by all.
template <class T>
struct FromVariant<Ref<T>>
{
    static Ref<T> Get(const Variant& value)
    {
        const Ref<Record>* const record = std::get_if<Ref<Record>>(&value);
        if (!record)
            throw Error(ErrorNumber::TypeMismatch, {}, u"an object of class " + ToText(T::ClassName) + u" is required");
        if (*record && &(*record)->Class() != &T::Info())
            throw Error(ErrorNumber::TypeMismatch, {},
                        u"an object of class " + ToText((*record)->Class().name) + u" is not a "
                            + ToText(T::ClassName));
        return Ref<T>(static_cast<T*>(record->get()));
    }
};

// A parameter that hosts pass by reference although the operation leaves the variable as it is.
template <class T>
class ByReference
{
public:
    ByReference(const T& given) : value(given) {}
    ByReference(T&& given) : value(std::move(given)) {}
    operator const T&() const { return value; }

private:
    T value;
};

// What a parameter's declared type says: the value that travels, and whether it comes back.
template <class P>
struct ParameterOf
{
    using Value = std::remove_cvref_t<P>;
    static constexpr bool isByReference = std::is_lvalue_reference_v<P> && !std::is_const_v<std::remove_reference_t<P>>;
    static constexpr bool isOutput = isByReference;
};
template <class T>
struct ParameterOf<T*> // an optional one
{
    using Value = T;
    static constexpr bool isByReference = true;
    static constexpr bool isOutput = true;
};
template <class T>
struct ParameterOf<const ByReference<T>&>
{
    using Value = T;
    static constexpr bool isByReference = true;
    static constexpr bool isOutput = false;
};

// One argument of a call: converted on its way in, written back when it comes out again.
template <class P>
class Argument
{
    using Value = typename ParameterOf<P>::Value;
    using Stored = std::conditional_t<std::is_same_v<Value, TextView>, Text, Value>;

public:
    explicit Argument(Variant& place) : given(place), value(FromVariant<Stored>::Get(place)) {}

    decltype(auto) Pass()
    {
        if constexpr (std::is_pointer_v<P>)
            return &value;
        else
            return (value);
    }
    void WriteBack()
    {
        if constexpr (ParameterOf<P>::isOutput)
            given = ToVariant(value);
    }

private:
    Variant& given;
    Stored value;
};

} // namespace varnex3
