// Work memory of cores and entry points.
#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <type_traits>
#include <utility>

#include "frame/memory.h"

namespace krnumer {

// An array from AllocateMemory that goes back on every path. A failed allocation is tested at once and becomes -20001:
//
//     Scratch<double> sorted(Count(n));
//     if (!sorted) return kOutOfMemory;
//
// An array of no elements is never a failure. The elements are uninitialised unless kZeroed asks otherwise.
template <class T>
class Scratch {
    static_assert(std::is_trivially_copyable_v<T> && std::is_trivially_destructible_v<T>);

  public:
    using Fill = MemoryFill;
    static constexpr Fill kUninitialised = Fill::kUninitialised;
    static constexpr Fill kZeroed = Fill::kZeroed;

    Scratch() = default;
    explicit Scratch(std::size_t count, Fill fill = kUninitialised) { static_cast<void>(Allocate(count, fill)); }
    Scratch(const Scratch&) = delete;
    Scratch& operator=(const Scratch&) = delete;
    Scratch(Scratch&& other) noexcept : data_(std::exchange(other.data_, nullptr)) {}
    Scratch& operator=(Scratch&& other) noexcept {
        std::swap(data_, other.data_);
        return *this;
    }
    ~Scratch() { std::free(data_); }

    // Drops what was held and allocates anew; false when the memory cannot be had.
    [[nodiscard]] bool Allocate(std::size_t count, Fill fill = kUninitialised) {
        std::free(data_);
        data_ = nullptr;
        if (count > kMost) return false;
        data_ = static_cast<T*>(AllocateMemory(count * sizeof(T), fill));
        return data_ != nullptr;
    }

    // Keeps the contents up to the lesser size; on failure (false) the old array stays.
    [[nodiscard]] bool Grow(std::size_t count) {
        if (count > kMost) return false;
        void* grown = std::realloc(data_, count > 0 ? count * sizeof(T) : 1);
        if (grown == nullptr) return false;
        data_ = static_cast<T*>(grown);
        return true;
    }

    explicit operator bool() const { return data_ != nullptr; }
    T* data() { return data_; }
    const T* data() const { return data_; }
    T& operator[](std::size_t i) { return data_[i]; }
    const T& operator[](std::size_t i) const { return data_[i]; }

  private:
    static constexpr std::size_t kMost = PTRDIFF_MAX / sizeof(T);

    T* data_ = nullptr;
};

}  // namespace krnumer
