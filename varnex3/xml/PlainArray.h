// A growable array of plain data that reallocates in place where it can, so that growing does not double the peak.
#pragma once

#include <cstddef>
#include <cstdlib>
#include <limits>
#include <memory>
#include <new>
#include <type_traits>
#include <utility>

namespace varnex3::xml {

template <class T>
class PlainArray
{
    static_assert(std::is_trivially_copyable_v<T>);

public:
    PlainArray() = default;
    PlainArray(PlainArray&& other) noexcept
        : items(std::move(other.items)),
          count(std::exchange(other.count, 0)),
          capacity(std::exchange(other.capacity, 0))
    {}
    PlainArray& operator=(PlainArray&& other) noexcept
    {
        items = std::move(other.items);
        count = std::exchange(other.count, 0);
        capacity = std::exchange(other.capacity, 0);
        return *this;
    }

    std::size_t Size() const { return count; }
    bool IsEmpty() const { return count == 0; }
    T& operator[](std::size_t index) { return items.get()[index]; }
    const T& operator[](std::size_t index) const { return items.get()[index]; }
    T& Back() { return items.get()[count - 1]; }
    const T* begin() const { return items.get(); }
    const T* end() const { return items.get() + count; }

    void Reserve(std::size_t wanted)
    {
        if (wanted > capacity)
            Reallocate(wanted);
    }

    T& Append(const T& item)
    {
        if (count == capacity) [[unlikely]]
            Reallocate(capacity + capacity / 2 + 16);
        T* place = new (items.get() + count) T(item);
        ++count;
        return *place;
    }

    void Resize(std::size_t size) { count = size; } // to a smaller size
    void Clear() { count = 0; }

    // Sets the size and every item.
    void Fill(std::size_t size, const T& item)
    {
        Reserve(size);
        for (count = 0; count < size; ++count)
            new (items.get() + count) T(item);
    }

    // Gives slack back where it is much.
    void Shrink()
    {
        constexpr std::size_t littleSlack = 512; // bytes
        if ((capacity - count) * sizeof(T) > littleSlack && capacity > count + count / 4)
            Reallocate(count);
    }

private:
    struct Free
    {
        void operator()(T* memory) const { std::free(memory); }
    };

    [[gnu::noinline]] void Reallocate(std::size_t wanted)
    {
        if (wanted == 0) {
            items.reset();
        } else {
            if (wanted > std::numeric_limits<std::size_t>::max() / sizeof(T))
                throw std::bad_alloc();
            void* moved = std::realloc(static_cast<void*>(items.get()), wanted * sizeof(T));
            if (moved == nullptr)
                throw std::bad_alloc();
            static_cast<void>(items.release());
            items.reset(static_cast<T*>(moved));
        }
        capacity = wanted;
    }

    std::unique_ptr<T, Free> items;
    std::size_t count = 0;
    std::size_t capacity = 0;
};

} // namespace varnex3::xml
