#include "fit/scaled_system.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

#include "frame/numeric.h"
#include "frame/status.h"
#include "linalg/finite.h"
#include "linalg/householder.h"

namespace krnumer {

namespace {

double RootOfWeight(const double* w, std::ptrdiff_t i) {
    return w != nullptr ? std::sqrt(std::fabs(w[i])) : 1.0;
}

// The QR decomposition of long and narrow (h, y), one block of rows after the other, each below the triangle that its
// forerunners have left (J. Demmel, L. Grigori, M. Hoemmen and J. Langou, SIAM J. Sci. Comput. 34, A206, 2012). The
// rows are read once, and everything else happens in a block that the caches hold.
class Triangle {
  public:
    Triangle(std::ptrdiff_t k, std::ptrdiff_t block)
        : k_(k), stride_(k + block), columns_(static_cast<std::size_t>((k + 2) * stride_), columns_.kZeroed) {}

    explicit operator bool() const { return static_cast<bool>(columns_); }

    // Where element i of column j of the next block is put; column k is y.
    double& Next(std::ptrdiff_t i, std::ptrdiff_t j) { return Column(j)[k_ + i]; }

    // Reduces the block of `count` rows; false where it has an element that cannot be used, or a column overflows.
    bool Reduce(std::ptrdiff_t count) {
        for (std::ptrdiff_t j = 0; j <= k_; ++j)
            if (HasUnusable(&Next(0, j), static_cast<std::size_t>(count))) return false;
        double* const scaled = Column(k_ + 1);
        for (std::ptrdiff_t j = 0; j < k_; ++j) {
            double* const column = Column(j) + j;
            const std::ptrdiff_t length = k_ - j + count;
            const Reflector<double> reflector = MakeReflector(column, length, 1);
            if (!std::isfinite(reflector.image)) return false;
            if (reflector.h == 0.0) continue;
            std::transform(column, column + length, scaled, [&](double x) { return x / reflector.h; });
            ReflectRows(column, scaled, Block<double>{column + stride_, k_ - j, length, stride_});
            column[0] = reflector.image;
        }
        return true;
    }

    double R(std::ptrdiff_t i, std::ptrdiff_t j) { return i <= j ? Column(j)[i] : 0.0; }
    double QtY(std::ptrdiff_t i) { return Column(k_)[i]; }

  private:
    double* Column(std::ptrdiff_t j) { return columns_.data() + j * stride_; }

    std::ptrdiff_t k_;
    std::ptrdiff_t stride_;
    Scratch<double> columns_;  // of h and of y, each with the triangle on top and the block below; and work space
};

}  // namespace

int32_t ScaledSystem::Load(const double* h_in, int32_t m, int32_t k, const double* y_in, const double* w) {
    // Beyond this width the blocked factorisations of the solvers are faster, and so they are on few rows.
    constexpr int32_t kWidest = 32;
    constexpr int32_t kBlockElements = 4096;
    if (k <= kWidest) {
        const int32_t block = std::max(kBlockElements / (k + 1), 3 * (k + 1));
        const int32_t status = m / 2 > block ? Reduce(h_in, m, k, y_in, w, block) : kNotFinite;
        if (status != kNotFinite) return status;
    }
    return Copy(h_in, m, k, y_in, w);
}

int32_t ScaledSystem::Copy(const double* h_in, int32_t m, int32_t k, const double* y_in, const double* w) {
    if (!h.Allocate(Count(m) * Count(k)) || !y.Allocate(Count(m))) return kOutOfMemory;
    double* row = h.data();
    for (int32_t i = 0; i < m; ++i, row += k, h_in += k) {
        const double scale = RootOfWeight(w, i);
        std::transform(h_in, h_in + k, row, [=](double element) { return scale * element; });
        y[Count(i)] = scale * y_in[i];
    }
    rows = m;
    return kOk;
}

int32_t ScaledSystem::Reduce(const double* h_in, int32_t m, int32_t k, const double* y_in, const double* w,
                             int32_t block) {
    Triangle triangle(k, block);
    if (!triangle || !h.Allocate(Count(k) * Count(k)) || !y.Allocate(Count(k))) return kOutOfMemory;
    for (int32_t start = 0, count; start < m; start += count) {
        count = std::min(block, m - start);
        for (int32_t i = 0; i < count; ++i, h_in += k) {
            const double scale = RootOfWeight(w, start + i);
            for (int32_t j = 0; j < k; ++j) triangle.Next(i, j) = scale * h_in[j];
            triangle.Next(i, k) = scale * y_in[start + i];
        }
        if (!triangle.Reduce(count)) return kNotFinite;
    }
    for (int32_t i = 0; i < k; ++i) {
        for (int32_t j = 0; j < k; ++j) h[Count(i) * Count(k) + Count(j)] = triangle.R(i, j);
        y[Count(i)] = triangle.QtY(i);
    }
    rows = k;
    return kOk;
}

}  // namespace krnumer
