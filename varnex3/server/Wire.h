// How the types of the rows travel through a vtable: what a slot's function takes and gives in their place.
//
// | C++ type                      | in a slot                                           |
// |-------------------------------|-----------------------------------------------------|
// | numbers, enumerations         | as they are                                         |
// | bool, Date                    | VARIANT_BOOL, DATE                                  |
// | Text, TextView                | BSTR; a null one is the empty text                  |
// | Variant                       | VARIANT by value                                    |
// | Ref<C>                        | a pointer to the interface of C                     |
// | T&, T*, const ByReference<T>& | a pointer to what T is; null is an omitted argument |
#pragma once

#include "varnex3/core/Types.h"
#include "varnex3/server/Face.h"
#include "varnex3/server/Values.h"

namespace varnex3::server {

// Take reads a host's value, which stays the host's; Give makes one that the host frees, with Free.
template <class T>
struct Wire
{
    using Type = T;
    static T Take(T value) { return value; }
    static T Give(T value) { return value; }
    static void Free(T) {}
};
template <>
struct Wire<bool>
{
    using Type = VARIANT_BOOL;
    static bool Take(VARIANT_BOOL value) { return value != VARIANT_FALSE; }
    static VARIANT_BOOL Give(bool value) { return value ? VARIANT_TRUE : VARIANT_FALSE; }
    static void Free(VARIANT_BOOL) {}
};
template <>
struct Wire<Date>
{
    using Type = DATE;
    static Date Take(DATE value) { return {value}; }
    static DATE Give(Date value) { return value.serial; }
    static void Free(DATE) {}
};
template <>
struct Wire<TextView>
{
    using Type = BSTR;
    static TextView Take(BSTR value) { return ViewOf(value); }
    static BSTR Give(TextView value) { return ToBstr(value); }
    static void Free(BSTR value) { SysFreeString(value); }
};
template <>
struct Wire<Text> : Wire<TextView>
{
    static Text Take(BSTR value) { return Text(ViewOf(value)); }
};
template <>
struct Wire<Variant>
{
    using Type = VARIANT;
    static Variant Take(const VARIANT& value)
    {
        if (std::optional<Variant> taken = ValueOf(value))
            return *std::move(taken);
        throw Error(ErrorNumber::TypeMismatch, {}, u"Null, an array or a foreign object is no value");
    }
    static VARIANT Give(const Variant& value) { return ToHost(value); }
    static void Free(VARIANT& value) { VariantClear(&value); }
};
template <class C>
struct Wire<Ref<C>>
{
    using Type = Port*;
    static Ref<C> Take(Port* port)
    {
        const Ref<Record> record(port ? RecordBehind(port) : nullptr);
        if (port && !record)
            throw Error(ErrorNumber::TypeMismatch, {}, u"a foreign object is not a " + ToText(C::ClassName));
        return FromVariant<Ref<C>>::Get(record);
    }
    static Port* Give(const Ref<C>& record) { return Face::PortFor(record); }
};

// One argument on its way to a parameter that is declared as P.
template <class P>
class Incoming
{
    using Value = typename ParameterOf<P>::Value;

public:
    using Type = typename Wire<Value>::Type;

    Incoming(const Type& given) : value(Wire<Value>::Take(given)) {}

    P Pass() { return static_cast<P&&>(value); }
    void WriteBack() {}

private:
    Value value;
};

// The same by reference: the host's variable is read before the call and, for a result, stored after it.
template <class P>
requires ParameterOf<P>::isByReference class Incoming<P>
{
    using Value = typename ParameterOf<P>::Value;

public:
    using Type = typename Wire<Value>::Type*;

    Incoming(Type place_) : place(place_), value(place ? Wire<Value>::Take(*place) : Value()) {}

    decltype(auto) Pass()
    {
        if constexpr (std::is_pointer_v<P>)
            return &value;
        else if constexpr (ParameterOf<P>::isOutput)
            return (value);
        else
            return ByReference<Value>(std::move(value));
    }
    void WriteBack()
    {
        if (!place || !ParameterOf<P>::isOutput)
            return;
        const auto result = Wire<Value>::Give(value);
        Wire<Value>::Free(*place);
        *place = result;
    }

private:
    Type place;
    Value value;
};

} // namespace varnex3::server
