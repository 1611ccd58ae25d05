// The vtable of a class, synthesised from its rows.
//
// A row's type says what a slot calls, so each slot's function is written once, here, for all of them: take the
// arguments in, call, hand the result out; an exception becomes an HRESULT and the thread's error object.
//
// Layout that this relies on: a vtable is a structure of function pointers, made of bases that follow each other in the
// order of the rows without gaps; lines without a row are empty bases and take no room. CheckedVtable guards it.
#pragma once

#include <array>

#include "varnex3/server/Dispatch.h"
#include "varnex3/server/Errors.h"
#include "varnex3/server/Wire.h"

namespace varnex3::server {

// The function of one slot: F, an accessor or method of the class C, which the row of a line is about.
template <class C, int kLine, auto F, class Signature = decltype(F)>
struct Slot;

template <class C, int kLine, auto F, class R, class... P>
struct Slot<C, kLine, F, R (C::*)(P...)>
{
    using Result = Wire<std::remove_cvref_t<R>>;

    static HRESULT STDMETHODCALLTYPE Enter(Port* self, typename Incoming<P>::Type... given,
                                           typename Result::Type* result) noexcept
    {
        if (!result)
            return E_POINTER;
        *result = {};
        try {
            [&](Incoming<P>... arguments) {
                decltype(auto) value = (self->As<C>().*F)(arguments.Pass()...); // a reference stays one: no copy
                (arguments.WriteBack(), ...);
                *result = Result::Give(value);
            }(given...);
            return S_OK;
        } catch (...) {
            return Raised(C::ClassName, rows::RowAt<C, kLine>().name);
        }
    }
};

template <class C, int kLine, auto F, class... P>
struct Slot<C, kLine, F, void (C::*)(P...)>
{
    static HRESULT STDMETHODCALLTYPE Enter(Port* self, typename Incoming<P>::Type... given) noexcept
    {
        try {
            [&](Incoming<P>... arguments) {
                (self->As<C>().*F)(arguments.Pass()...);
                (arguments.WriteBack(), ...);
            }(given...);
            return S_OK;
        } catch (...) {
            return Raised(C::ClassName, rows::RowAt<C, kLine>().name);
        }
    }
};

template <class C, int kLine, auto F, class R, class... P>
struct Slot<C, kLine, F, R (C::*)(P...) const> : Slot<C, kLine, F, R (C::*)(P...)>
{};

// One pointer of a vtable; none for what a property does not have.
template <class C, int kLine, auto F>
struct Entry
{
    decltype(&Slot<C, kLine, F>::Enter) function = &Slot<C, kLine, F>::Enter;
};
template <class C, int kLine>
struct Entry<C, kLine, nullptr>
{};

// The entries of the row on a line: one, or a getter's and a setter's; none without a row.
template <class C, int kLine, bool hasRow = rows::kHasRow<C, kLine>>
struct Entries
{};
template <class C, int kLine>
struct Entries<C, kLine, true> : Entry<C, kLine, decltype(rows::RowAt<C, kLine>())::kGet>,
                                 Entry<C, kLine, decltype(rows::RowAt<C, kLine>())::kPut>
{};

template <class C, class Lines = std::make_integer_sequence<int, C::kLastRow - C::kFirstRow>>
struct Vtable;
template <class C, int... I>
struct Vtable<C, std::integer_sequence<int, I...>> : DispatchFunctions, Entries<C, C::kFirstRow + I>...
{};

template <class C>
inline constexpr Vtable<C> kVtable{};

template <class C>
constexpr std::size_t SlotCount()
{
    std::size_t count = kFirstSlot;
    for (const Member& member : rows::kMembers<C>)
        count += member.IsWritable() ? 2U : 1U;
    return count;
}

template <class C>
constexpr const void* CheckedVtable()
{
    static_assert(sizeof kVtable<C> == SlotCount<C>() * sizeof(void*), "the slots follow each other without gaps");
    return &kVtable<C>;
}

template <class... C>
std::span<const ClassVtable> VtablesOf(ClassList<C...>)
{
    static constexpr std::array<ClassVtable, sizeof...(C)> vtables{{{&C::Info, CheckedVtable<C>()}...}};
    return vtables;
}

} // namespace varnex3::server
