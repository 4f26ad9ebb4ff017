#include "fft/long_dft.h"

#include <bit>
#include <cstdint>
#include <map>
#include <numbers>

namespace krnumer {
namespace {

// exp(-2 pi i k / n)
LongComplex Root(uint64_t k, uint64_t n) {
    const long double angle =
        -2 * std::numbers::pi_v<long double> * static_cast<long double>(k % n) / static_cast<long double>(n);
    return {std::cos(angle), std::sin(angle)};
}

const std::vector<LongComplex>& RootsOf(size_t n) {
    static std::map<size_t, std::vector<LongComplex>> all;
    std::vector<LongComplex>& roots = all[n];
    if (roots.empty())
        for (size_t k = 0; k < n / 2; ++k) roots.push_back(Root(k, n));
    return roots;
}

LongComplex Product(LongComplex a, LongComplex b) {
    return {a.real() * b.real() - a.imag() * b.imag(), a.real() * b.imag() + a.imag() * b.real()};
}

// In place, for a power of two.
void RadixTwo(std::vector<LongComplex>& x) {
    const size_t n = x.size();
    for (size_t i = 1, j = 0; i < n; ++i) {
        size_t bit = n / 2;
        for (; j & bit; bit /= 2) j ^= bit;
        j ^= bit;
        if (i < j) std::swap(x[i], x[j]);
    }
    const std::vector<LongComplex>& roots = RootsOf(n);
    for (size_t half = 1; half < n; half *= 2) {
        for (size_t start = 0; start < n; start += 2 * half) {
            for (size_t k = 0; k < half; ++k) {
                const LongComplex a = x[start + k];
                const LongComplex b = Product(x[start + k + half], roots[k * (n / (2 * half))]);
                x[start + k] = a + b;
                x[start + k + half] = a - b;
            }
        }
    }
}

}  // namespace

std::vector<LongComplex> LongDft(const std::vector<LongComplex>& x) {
    const uint64_t n = x.size();
    if (std::has_single_bit(n)) {
        std::vector<LongComplex> y = x;
        RadixTwo(y);
        return y;
    }
    size_t size = 1;
    while (size < 2 * n - 1) size *= 2;
    std::vector<LongComplex> a(size), b(size), chirp(n);
    for (uint64_t k = 0; k < n; ++k) {
        chirp[k] = Root(k * k, 2 * n);
        a[k] = Product(x[k], chirp[k]);
        b[k] = b[(size - k) % size] = std::conj(chirp[k]);
    }
    RadixTwo(a);
    RadixTwo(b);
    for (size_t k = 0; k < size; ++k) a[k] = std::conj(Product(a[k], b[k]));
    RadixTwo(a);
    std::vector<LongComplex> y(n);
    for (uint64_t k = 0; k < n; ++k) y[k] = Product(std::conj(a[k]), chirp[k]) / static_cast<long double>(size);
    return y;
}

std::vector<LongComplex> LongDftByDefinition(const std::vector<LongComplex>& x) {
    const uint64_t n = x.size();
    std::vector<LongComplex> y(n);
    for (uint64_t k = 0; k < n; ++k)
        for (uint64_t j = 0; j < n; ++j) y[k] += Product(x[j], Root(j * k, n));
    return y;
}

}  // namespace krnumer
