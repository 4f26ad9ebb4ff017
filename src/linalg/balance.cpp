#include "linalg/balance.h"

#include <cmath>
#include <utility>

#include "frame/numeric.h"
#include "linalg/element.h"

namespace krnumer {

namespace {

template <class T>
class Balancer {
  public:
    Balancer(T* a, std::ptrdiff_t n, double* scale) : a_(a), n_(n), high_(n - 1), scale_(scale) {}

    Balance Run() {
        while (high_ >= 0 && IsolateRow()) {
        }
        while (IsolateColumn()) {
        }
        for (std::ptrdiff_t i = low_; i <= high_; ++i) scale_[i] = 1.0;
        for (int passes = 0; passes < kMostPasses && ScaleOnce(); ++passes) {
        }
        return {low_, high_, scale_};
    }

  private:
    // A handful suffices, unless elements underflow when they are scaled: then passes may undo each other for ever.
    static constexpr int kMostPasses = 200;

    T& At(std::ptrdiff_t i, std::ptrdiff_t j) { return a_[i * n_ + j]; }

    // Pushes a row that is zero beside the diagonal to the bottom of the block.
    bool IsolateRow() {
        for (std::ptrdiff_t j = high_; j >= 0; --j) {
            if (!IsIsolated(j, 1, n_)) continue;
            Exchange(j, high_);
            --high_;
            return true;
        }
        return false;
    }

    // Pushes a column that is zero beside the diagonal to the left of the block.
    bool IsolateColumn() {
        for (std::ptrdiff_t j = low_; j <= high_; ++j) {
            if (!IsIsolated(j, n_, 1)) continue;
            Exchange(j, low_);
            ++low_;
            return true;
        }
        return false;
    }

    // Whether row j (steps 1, n) or column j (steps n, 1) of the block has nothing but its diagonal element.
    bool IsIsolated(std::ptrdiff_t j, std::ptrdiff_t step, std::ptrdiff_t step_of_lines) const {
        const T* line = a_ + j * step_of_lines;
        for (std::ptrdiff_t i = low_; i <= high_; ++i)
            if (i != j && SumOfParts(line[i * step]) != 0.0) return false;
        return true;
    }

    void Exchange(std::ptrdiff_t j, std::ptrdiff_t m) {
        scale_[m] = static_cast<double>(j + 1);
        if (j == m) return;
        for (std::ptrdiff_t i = 0; i <= high_; ++i) std::swap(At(i, j), At(i, m));
        for (std::ptrdiff_t i = low_; i < n_; ++i) std::swap(At(j, i), At(m, i));
    }

    // One pass over the block; whether it changed anything.
    bool ScaleOnce() {
        bool changed = false;
        for (std::ptrdiff_t i = low_; i <= high_; ++i) {
            double c = 0.0, r = 0.0;
            for (std::ptrdiff_t j = low_; j <= high_; ++j) {
                if (j == i) continue;
                c += SumOfParts(At(j, i));
                r += SumOfParts(At(i, j));
            }
            if (c == 0.0 || r == 0.0 || !std::isfinite(c) || !std::isfinite(r)) continue;
            const double sum = c + r;
            double f = 1.0;
            for (const double g = r / 2.0; c < g; c *= 4.0) f *= 2.0;
            for (const double g = r * 2.0; c >= g && c < kInfinity; c *= 0.25) f *= 0.5;
            const double inverse = 1.0 / f;
            if (!((c + r) / f < 0.95 * sum) || !std::isnormal(f) || !std::isfinite(inverse)) continue;
            changed = true;
            scale_[i] *= f;
            for (std::ptrdiff_t j = low_; j < n_; ++j) At(i, j) *= inverse;
            for (std::ptrdiff_t j = 0; j <= high_; ++j) At(j, i) *= f;
        }
        return changed;
    }

    T* a_;
    std::ptrdiff_t n_;
    std::ptrdiff_t low_ = 0;
    std::ptrdiff_t high_;
    double* scale_;
};

}  // namespace

template <class T>
Balance BalanceMatrix(T* a, std::ptrdiff_t n, double* scale) {
    return Balancer<T>(a, n, scale).Run();
}

template <class T>
void Unbalance(const Balance& balance, std::ptrdiff_t n, T* vector) {
    for (std::ptrdiff_t i = balance.low; i <= balance.high; ++i) vector[i] *= balance.scale[i];
    const auto exchange = [&](std::ptrdiff_t i) {
        std::swap(vector[i], vector[static_cast<std::ptrdiff_t>(balance.scale[i]) - 1]);
    };
    for (std::ptrdiff_t i = balance.low - 1; i >= 0; --i) exchange(i);
    for (std::ptrdiff_t i = balance.high + 1; i < n; ++i) exchange(i);
}

template Balance BalanceMatrix(double*, std::ptrdiff_t, double*);
template Balance BalanceMatrix(Complex*, std::ptrdiff_t, double*);
template void Unbalance(const Balance&, std::ptrdiff_t, double*);
template void Unbalance(const Balance&, std::ptrdiff_t, Complex*);

}  // namespace krnumer
