// Host arrays as a C++ program likes them: created and freed with their scope, read and written as spans.
#pragma once

#include <krnumer/krnumer.h>
#include <krrt/krrt.h>

#include <algorithm>
#include <cstdint>
#include <new>
#include <span>
#include <stdexcept>
#include <string>
#include <type_traits>

// A call that failed says which and why; warnings pass.
inline void Check(int32_t status, const char* function) {
    if (status < 0) throw std::runtime_error(std::string(function) + " failed with status " + std::to_string(status));
}

template <class T>
class Array {
  public:
    explicit Array(std::size_t size = 0) : handle_(KrrtNewArray(TypeCode(), static_cast<int32_t>(size))) {
        if (handle_ == nullptr) throw std::bad_alloc();
    }
    explicit Array(std::span<const T> values) : Array(values.size()) {
        std::ranges::copy(values, this->values().begin());
    }
    Array(std::size_t size, T value) : Array(size) { std::ranges::fill(values(), value); }
    Array(const Array& other) : Array(other.values()) {}
    Array& operator=(const Array&) = delete;
    ~Array() { KrrtFree(handle_); }

    KrHandle handle() const { return handle_; }
    std::size_t size() const { return static_cast<std::size_t>(KrrtSize(handle_, 0)); }
    int32_t count() const { return KrrtSize(handle_, 0); }

    // Valid until a call resizes the array.
    std::span<T> values() { return {static_cast<T*>(KrrtElements(handle_)), size()}; }
    std::span<const T> values() const { return {static_cast<const T*>(KrrtElements(handle_)), size()}; }
    T& operator[](std::size_t i) { return values()[i]; }
    const T& operator[](std::size_t i) const { return values()[i]; }

  private:
    static constexpr int32_t TypeCode() {
        if constexpr (std::is_same_v<T, int32_t>) {
            return KRRT_INT32;
        } else if constexpr (std::is_same_v<T, KrComplex>) {
            return KRRT_COMPLEX;
        } else {
            static_assert(std::is_same_v<T, double>);
            return KRRT_DOUBLE;
        }
    }

    KrHandle handle_;
};

// An array of packed records. The library reads such arrays and never resizes them.
template <class T>
class Records {
  public:
    explicit Records(std::size_t count)
        : handle_(KrrtNewRecords(static_cast<int32_t>(sizeof(T)), static_cast<int32_t>(count))), count_(count) {
        if (handle_ == nullptr) throw std::bad_alloc();
    }
    Records(const Records&) = delete;
    Records& operator=(const Records&) = delete;
    ~Records() { KrrtFree(handle_); }

    KrHandle handle() const { return handle_; }
    std::span<T> values() { return {static_cast<T*>(KrrtElements(handle_)), count_}; }

  private:
    KrHandle handle_;
    std::size_t count_;
};

// A matrix of doubles, row after row.
class Matrix {
  public:
    explicit Matrix(std::size_t rows = 0, std::size_t columns = 0)
        : handle_(KrrtNewMatrix(KRRT_DOUBLE, static_cast<int32_t>(rows), static_cast<int32_t>(columns))) {
        if (handle_ == nullptr) throw std::bad_alloc();
    }
    Matrix(const Matrix&) = delete;
    Matrix& operator=(const Matrix&) = delete;
    ~Matrix() { KrrtFree(handle_); }

    KrHandle handle() const { return handle_; }
    std::size_t rows() const { return static_cast<std::size_t>(KrrtSize(handle_, 0)); }
    std::size_t columns() const { return static_cast<std::size_t>(KrrtSize(handle_, 1)); }

    // Valid until a call resizes the matrix.
    std::span<double> Row(std::size_t i) {
        return {static_cast<double*>(KrrtElements(handle_)) + i * columns(), columns()};
    }
    std::span<const double> Row(std::size_t i) const { return const_cast<Matrix*>(this)->Row(i); }

  private:
    KrHandle handle_;
};
