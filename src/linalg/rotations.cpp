#include "linalg/rotations.h"

namespace krnumer {

namespace {

// One strip of `width` columns through the whole chain: the row that the next rotation shares stays in registers.
template <int width>
void RotateStrip(double* row, std::ptrdiff_t step, std::ptrdiff_t count, const double* c, const double* s) {
    double x[width];
    for (int q = 0; q < width; ++q) x[q] = row[q];
    for (std::ptrdiff_t r = 0; r < count; ++r) {
        double* next = row + step;
        double y[width], rotated[width];
        for (int q = 0; q < width; ++q) y[q] = next[q];
        for (int q = 0; q < width; ++q) rotated[q] = x[q] * c[r] + y[q] * s[r];
        for (int q = 0; q < width; ++q) x[q] = y[q] * c[r] - x[q] * s[r];
        for (int q = 0; q < width; ++q) row[q] = rotated[q];
        row = next;
    }
    for (int q = 0; q < width; ++q) row[q] = x[q];
}

}  // namespace

void RotateRows(double* x, double* y, std::ptrdiff_t length, double c, double s) {
    for (std::ptrdiff_t q = 0; q < length; ++q) {
        const double rotated = x[q] * c + y[q] * s;
        y[q] = y[q] * c - x[q] * s;
        x[q] = rotated;
    }
}

void RotateChain(VectorRows vectors, std::ptrdiff_t first, std::ptrdiff_t step, std::ptrdiff_t count, const double* c,
                 const double* s) {
    constexpr int kWide = 16;
    constexpr int kNarrow = 4;

    double* row = vectors[first];
    const std::ptrdiff_t stride = step * vectors.length;
    std::ptrdiff_t q = 0;
    for (; q + kWide <= vectors.length; q += kWide) RotateStrip<kWide>(row + q, stride, count, c, s);
    for (; q + kNarrow <= vectors.length; q += kNarrow) RotateStrip<kNarrow>(row + q, stride, count, c, s);
    for (; q < vectors.length; ++q) RotateStrip<1>(row + q, stride, count, c, s);
}

}  // namespace krnumer
