#include "linalg/reflector_chain.h"

namespace krnumer {

namespace {

enum class Side { kLeft, kRight };

// The sum of products that a reflector takes, and what it subtracts, on the first, second and third element.
template <Side side>
double Sum(const BulgeReflector& f, double a, double b, double c) {
    if constexpr (side == Side::kLeft) {
        return a + f.q * b + f.r * c;
    } else {
        return f.x * a + f.y * b + f.z * c;
    }
}
template <Side side>
double Sum(const BulgeReflector& f, double a, double b) {
    if constexpr (side == Side::kLeft) {
        return a + f.q * b;
    } else {
        return f.x * a + f.y * b;
    }
}
template <Side side>
double First(const BulgeReflector& f, double p) {
    return side == Side::kLeft ? p * f.x : p;
}
template <Side side>
double Second(const BulgeReflector& f, double p) {
    return p * (side == Side::kLeft ? f.y : f.q);
}
template <Side side>
double Third(const BulgeReflector& f, double p) {
    return p * (side == Side::kLeft ? f.z : f.r);
}

// A bundle of `size` lines through the whole chain. Lines are `line_step` apart, the elements that a reflector takes
// together `step`. The two elements that the next reflector shares stay in registers.
template <Side side, int size>
void ReflectBundle(const ReflectorChain& chain, double* first, std::ptrdiff_t step, std::ptrdiff_t line_step) {
    double a[size], b[size];
    for (int i = 0; i < size; ++i) a[i] = first[i * line_step];
    for (int i = 0; i < size; ++i) b[i] = first[i * line_step + step];
    const BulgeReflector* const last = chain.reflectors + chain.count - (chain.ends_short ? 1 : 0);
    for (const BulgeReflector* f = chain.reflectors; f != last; ++f, first += step) {
        double c[size], p[size];
        for (int i = 0; i < size; ++i) c[i] = first[i * line_step + 2 * step];
        for (int i = 0; i < size; ++i) p[i] = Sum<side>(*f, a[i], b[i], c[i]);
        for (int i = 0; i < size; ++i) first[i * line_step] = a[i] - First<side>(*f, p[i]);
        for (int i = 0; i < size; ++i) a[i] = b[i] - Second<side>(*f, p[i]);
        for (int i = 0; i < size; ++i) b[i] = c[i] - Third<side>(*f, p[i]);
    }
    if (chain.ends_short) {
        for (int i = 0; i < size; ++i) {
            const double p = Sum<side>(*last, a[i], b[i]);
            a[i] -= First<side>(*last, p);
            b[i] -= Second<side>(*last, p);
        }
    }
    for (int i = 0; i < size; ++i) first[i * line_step] = a[i];
    for (int i = 0; i < size; ++i) first[i * line_step + step] = b[i];
}

template <Side side>
void ReflectStrips(const ReflectorChain& chain, double* rows, std::ptrdiff_t stride, std::ptrdiff_t width) {
    constexpr int kWide = 8;
    constexpr int kNarrow = 2;
    std::ptrdiff_t j = 0;
    for (; j + kWide <= width; j += kWide) ReflectBundle<side, kWide>(chain, rows + j, stride, 1);
    for (; j + kNarrow <= width; j += kNarrow) ReflectBundle<side, kNarrow>(chain, rows + j, stride, 1);
    for (; j < width; ++j) ReflectBundle<side, 1>(chain, rows + j, stride, 1);
}

}  // namespace

void ReflectRowsByChain(const ReflectorChain& chain, double* rows, std::ptrdiff_t stride, std::ptrdiff_t width) {
    ReflectStrips<Side::kLeft>(chain, rows, stride, width);
}

void ReflectTransposedByChain(const ReflectorChain& chain, double* rows, std::ptrdiff_t stride, std::ptrdiff_t width) {
    ReflectStrips<Side::kRight>(chain, rows, stride, width);
}

void ReflectColumnsByChain(const ReflectorChain& chain, double* rows, std::ptrdiff_t stride, std::ptrdiff_t height) {
    constexpr int kTogether = 4;
    std::ptrdiff_t i = 0;
    for (; i + kTogether <= height; i += kTogether)
        ReflectBundle<Side::kRight, kTogether>(chain, rows + i * stride, 1, stride);
    for (; i < height; ++i) ReflectBundle<Side::kRight, 1>(chain, rows + i * stride, 1, stride);
}

}  // namespace krnumer
