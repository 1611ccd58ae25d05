// What every public class is: a reference-counted object on the heap that can describe its own interface.
#pragma once

#include <atomic>
#include <concepts>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <type_traits>
#include <utility>

#include "varnex3/core/RecordRoom.h"

namespace varnex3 {

struct ClassInfo;

// A face's own part of a record, such as the interface pointers that automation hosts hold.
class Attachment
{
public:
    Attachment() = default;
    Attachment(const Attachment&) = delete;
    Attachment& operator=(const Attachment&) = delete;
    virtual ~Attachment() = default;
};

// The base of every class. Records are made by New<T>(), live as long as somebody holds a Ref to them, and are used
// by one thread at a time; the count alone is safe to change from several.
class Record
{
public:
    Record(const Record&) = delete;
    Record& operator=(const Record&) = delete;

    // The record's class: its name and its members in interface order.
    virtual const ClassInfo& Class() const = 0;

    // The level at which a record writes its group when nothing else is said: directly under a message's root.
    static constexpr int kLevel = 1;

    // Both give the new count.
    std::int32_t AddRef() const noexcept { return references.fetch_add(1, std::memory_order_relaxed) + 1; }
    std::int32_t Release() const noexcept
    {
        // Who holds the only reference is alone with the record: no other thread can be counting.
        const bool isOnly = references.load(std::memory_order_acquire) == 1;
        const std::int32_t left = isOnly ? 0 : references.fetch_sub(1, std::memory_order_acq_rel) - 1;
        if (left == 0)
            delete this;
        return left;
    }

    // The first reference to a new record, which nobody else knows.
    void AddFirstRef() const noexcept { references.store(1, std::memory_order_relaxed); }

    // Null until a face needs it; ends with the record.
    std::unique_ptr<Attachment>& Attached() noexcept { return attachment; }

    // NOLINTNEXTLINE(misc-new-delete-overloads,cert-dcl54-cpp): the one below matches it, with the size of the class
    static void* operator new(std::size_t size) { return RecordRoom::Allocate(size); }
    static void operator delete(void* memory, std::size_t size) noexcept { RecordRoom::Free(memory, size); }

protected:
    Record() = default;
    virtual ~Record() = default; // protected here and in every class: records live on the heap only

private:
    mutable std::atomic<std::int32_t> references{0};
    std::unique_ptr<Attachment> attachment;
};

// A counted reference to a record; may be null.
template <class T>
class Ref
{
public:
    Ref() = default;
    Ref(std::nullptr_t) {}
    explicit Ref(T* held) : record(held)
    {
        if (record)
            record->AddRef();
    }
    Ref(const Ref& other) : Ref(other.record) {}
    Ref(Ref&& other) noexcept : record(std::exchange(other.record, nullptr)) {}
    template <class U>
    requires std::convertible_to<U*, T*> Ref(const Ref<U>& other) : Ref(static_cast<T*>(other.get())) {}
    ~Ref()
    {
        if (record)
            record->Release();
    }
    Ref& operator=(Ref other) noexcept
    {
        std::swap(record, other.record);
        return *this;
    }

    T* get() const { return record; }
    T* operator->() const { return record; }
    T& operator*() const { return *record; }
    explicit operator bool() const { return record != nullptr; }

    friend bool operator==(const Ref& a, const Ref& b) { return a.record == b.record; }

private:
    template <class U>
    friend Ref<U> New();

    T* record = nullptr;
};

// A new record, such as New<VersionDef>().
template <class T>
Ref<T> New()
{
    static_assert(alignof(T) <= RecordRoom::kAlignment);
    Ref<T> made;
    made.record = new T;
    made.record->AddFirstRef();
    return made;
}

// Whether two functions are one. As types: a sanitizer build does not compare addresses while it compiles.
template <auto A, auto B>
inline constexpr bool kIsSameFunction =
    std::is_same_v<std::integral_constant<decltype(A), A>, std::integral_constant<decltype(A), B>>;

// A child of a record: made on first use, by a function of its own where it is to start with other values than its
// class's. One that is set to nothing is a new one of its class.
template <class T, Ref<T> (*Make)() = &New<T>>
class Child
{
public:
    Child() = default;
    Child(Ref<T> given) : record(std::move(given))
    {
        if (!kIsSameFunction<Make, &New<T>> && !record)
            record = New<T>();
    }

    T* operator->() const { return Held().get(); }
    T& operator*() const { return *Held(); }

    const Ref<T>& Held() const
    {
        if (!record)
            record = Make();
        return record;
    }

    // Whether it was made already. One that was not is what its first use makes.
    bool IsMade() const { return static_cast<bool>(record); }

private:
    mutable Ref<T> record;
};

} // namespace varnex3
