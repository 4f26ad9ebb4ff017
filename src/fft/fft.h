// Discrete Fourier transforms of any length.
//
// Forward: X[k] = sum of x[j] exp(-2 pi i j k / n), unscaled. Inverse: the other sign and the factor 1/n. Complex data
// are two arrays, real and imaginary parts; interleaved data are two pointers one double apart, with stride 2.
//
// Half-complex form of a real sequence of length n: position p holds Re X[p] for p <= n/2 and Im X[n-p] for p > n/2.
//
//     HeldTable table(n);
//     if (!table) return kOutOfMemory;
//     if (const int32_t status = RealFFT(table.get(), x, spectrum, 1, 1, n)) return status;
#pragma once

#include <cstdint>
#include <utility>

struct qmfft_table;

namespace krnumer {

using ::qmfft_table;

// The table of a length, shared by all who hold it; null for a length below 1 or when there is no memory.
// What is created must be destroyed; destroying null does nothing. Any thread may call either.
qmfft_table* CreateTable(int32_t length);
void DestroyTable(qmfft_table* table);

// Holds a table for as long as it lives.
class HeldTable {
  public:
    explicit HeldTable(int32_t length) : table_(CreateTable(length)) {}
    HeldTable(HeldTable&& other) noexcept : table_(std::exchange(other.table_, nullptr)) {}
    HeldTable& operator=(HeldTable&& other) noexcept {
        std::swap(table_, other.table_);
        return *this;
    }
    ~HeldTable() {
        if (table_ != nullptr) DestroyTable(table_);
    }

    explicit operator bool() const { return table_ != nullptr; }
    const qmfft_table* get() const { return table_; }

  private:
    qmfft_table* table_;
};

// Least length >= n whose prime factors all have butterflies; 1 for n < 2, and 0 where no int32 is long enough.
int32_t NextGoodLength(int32_t length);

// Status of a transform whose n is not the length of its table. Nothing is touched then.
inline constexpr int32_t kLengthMismatch = -1;

// The transforms; strides count doubles. They return 0, kLengthMismatch, or kOutOfMemory, which only lengths with prime
// factors 23, 47 or above can give. Output must not overlap input. Any number of threads may use one table at once; long
// transforms take up to 300 KiB of the stack.
int32_t ComplexFFT(const qmfft_table* table, const double* in_re, const double* in_im, double* out_re, double* out_im,
                   int32_t in_stride, int32_t out_stride, int32_t n);
int32_t InverseComplexFFT(const qmfft_table* table, const double* in_re, const double* in_im, double* out_re,
                          double* out_im, int32_t in_stride, int32_t out_stride, int32_t n);
int32_t RealFFT(const qmfft_table* table, const double* in, double* out, int32_t in_stride, int32_t out_stride,
                int32_t n);
// Takes its input for scratch: it comes back scaled by 1/n and folded into Hartley form.
int32_t InverseRealFFT(const qmfft_table* table, double* in, double* out, int32_t in_stride, int32_t out_stride,
                       int32_t n);

}  // namespace krnumer
