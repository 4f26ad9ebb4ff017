#include "poly/multiple_roots.h"

#include <algorithm>
#include <cmath>
#include <numeric>

#include "frame/numeric.h"
#include "frame/status.h"
#include "linalg/element.h"
#include "linalg/finite.h"
#include "linalg/svd_solve.h"
#include "poly/root_structure.h"

namespace krnumer {

namespace {

bool Allocate(RootList* list, int32_t most) {
    return list->roots.Allocate(Count(most)) && list->multiplicities.Allocate(Count(most));
}

void Append(RootList* list, Complex root, int32_t multiplicity) {
    list->roots[Count(list->count)] = root;
    list->multiplicities[Count(list->count)] = multiplicity;
    ++list->count;
}

void SortByModulus(RootList* list, Scratch<int32_t>* order, RootList* sorted) {
    std::iota(order->data(), order->data() + list->count, 0);
    const auto& roots = list->roots;
    std::sort(order->data(), order->data() + list->count, [&](int32_t a, int32_t b) {
        const double size_a = SquaredModulus(roots[Count(a)]);
        const double size_b = SquaredModulus(roots[Count(b)]);
        return size_a != size_b ? size_a > size_b : a < b;
    });
    sorted->count = 0;
    for (int32_t i = 0; i < list->count; ++i) {
        const std::size_t from = Count((*order)[Count(i)]);
        Append(sorted, roots[from], list->multiplicities[from]);
    }
    std::swap(*list, *sorted);
}

// Coefficients from the highest down, the highest 1.
struct Product {
    Complex* c;
    int32_t degree = 0;

    void Begin() {
        c[0] = {1.0, 0.0};
        degree = 0;
    }
    void Multiply(Complex root) {
        c[degree + 1] = {0.0, 0.0};
        for (int32_t i = ++degree; i >= 1; --i) c[i] -= root * c[i - 1];
    }
};

// Gauss-Newton iteration for the roots z of p, with their multiplicities held fixed, which keeps multiple roots well
// conditioned. kNoConvergence within 20 steps.
template <class T>
int32_t PejorativeRefine(const T* p, int32_t degree, const int32_t* multiplicities, int32_t count, Complex* z) {
    constexpr int32_t kMostSteps = 20;
    constexpr double kConverged = 1e-6;
    const std::size_t rows = Count(degree);
    const std::size_t columns = Count(count);
    Scratch<Complex> jacobian(rows * columns);
    Scratch<Complex> residual(rows);
    Scratch<Complex> step(columns);
    Scratch<Complex> base_terms(rows + 1);
    Scratch<Complex> terms(rows + 1);
    if (!jacobian || !residual || !step || !base_terms || !terms) return kOutOfMemory;
    bool converged = false;
    double former = 0.0;
    for (int32_t pass = 0; pass < kMostSteps; ++pass) {
        Product base{base_terms.data()};
        base.Begin();
        for (int32_t j = 0; j < count; ++j)
            for (int32_t i = 1; i < multiplicities[j]; ++i) base.Multiply(z[j]);
        Product product{terms.data()};
        const auto multiply_all_but = [&](int32_t left_out) {
            std::copy_n(base.c, base.degree + 1, product.c);
            product.degree = base.degree;
            for (int32_t i = 0; i < count; ++i)
                if (i != left_out) product.Multiply(z[i]);
        };
        for (int32_t j = 0; j < count; ++j) {
            multiply_all_but(j);
            for (std::size_t i = 0; i < rows; ++i)
                jacobian[i * columns + Count(j)] = (-multiplicities[j] * RowWeight(p[i + 1])) * terms[i];
        }
        multiply_all_but(-1);
        for (std::size_t i = 0; i < rows; ++i) {
            Complex right{};
            if constexpr (kIsComplex<T>) {
                right = p[i + 1];
            } else {
                right = {p[i + 1], 0.0};
            }
            residual[i] = RowWeight(p[i + 1]) * (terms[i + 1] - right);
        }
        const int32_t status = SvdSolve(jacobian.data(), degree, count, residual.data(), 1, step.data(), -1.0);
        if (status == kNotFinite) return kNoConvergence;  // the roots ran away
        if (status < 0) return status;

        double square = 0.0;
        for (std::size_t j = 0; j < columns; ++j) square += SquaredModulus(step[j]);
        const double length = std::sqrt(square);
        if (length < kConverged) converged = true;
        if (pass > 0) {
            if (length >= former) {
                if (converged) return kOk;
            } else if (square / (former - length) < kConverged) {
                converged = true;
            }
        }
        if (pass == kMostSteps - 1 && !converged) return kNoConvergence;
        for (std::size_t j = 0; j < columns; ++j) z[j] -= step[j];
        former = length;
    }
    return kOk;
}

// The polynomial with the highest coefficient first and 1.
template <class T>
void Reverse(const T* c, int32_t size, T* f) {
    std::reverse_copy(c, c + size, f);
    MakeMonic(f, size - 1);
}

// Stretches the variable so that the constant has modulus 1. Returns the factor of the roots; 1 where it cannot be.
template <class T>
double ScaleVariable(const T* c, int32_t size, T* f) {
    const int32_t degree = size - 1;
    const double s = std::pow(Modulus(f[degree]), 1.0 / degree);
    if (s == 1.0 || s == 0.0 || !std::isfinite(s)) return 1.0;
    for (int32_t k = 1; k <= degree; ++k) f[k] = f[k] / FromReal<T>(std::pow(s, k));
    if (!HasUnusable(f, Count(size))) return s;
    Reverse(c, size, f);
    return 1.0;
}

// The eigenvalues of the companion matrix; only those that agree to the last bit are one root.
template <class T>
int32_t EigenvalueList(const T* f, int32_t degree, RootList* list) {
    Scratch<Complex> eigenvalues(Count(degree));
    if (!eigenvalues) return kOutOfMemory;
    if (const int32_t status = CompanionRoots(f, degree, eigenvalues.data())) return status;
    list->count = 0;
    for (int32_t i = 0; i < degree; ++i) {
        const Complex value = eigenvalues[Count(i)];
        const Complex* const end = list->roots.data() + list->count;
        const Complex* const same = std::find(static_cast<const Complex*>(list->roots.data()), end, value);
        if (same == end) {
            Append(list, value, 1);
        } else {
            ++list->multiplicities[static_cast<std::size_t>(same - list->roots.data())];
        }
    }
    return kOk;
}

// The list with its roots improved; the factor s of the roots is applied to the result.
template <class T>
int32_t RefineList(const T* f, int32_t degree, double s, const RootList& list, RootList* refined) {
    Scratch<Complex> z(Count(list.count));
    if (!z) return kOutOfMemory;
    std::copy_n(list.roots.data(), list.count, z.data());
    const int32_t status = PejorativeRefine(f, degree, list.multiplicities.data(), list.count, z.data());
    if (status != kOk) return status;
    for (int32_t i = 0; i < list.count; ++i) {
        const std::size_t at = Count(i);
        Complex root = z[at] * s;
        if (list.roots[at].im == 0.0 && std::fabs(root.im) <= s * kEpsilon) root.im = 0.0;
        Append(refined, root, list.multiplicities[at]);
    }
    return kOk;
}

}  // namespace

template <class T>
int32_t MultipleRoots(const T* c, int32_t n, bool refine, double tol, RootList* roots, RootList* refined) {
    constexpr double kDefaultTolerance = 1e-10;
    if (n < 1) return kEmptyInput;
    if (HasUnusable(c, Count(n))) return kBadCoefficient;
    if (tol <= 0.0) tol = kDefaultTolerance;
    while (n > 0 && c[n - 1] == T{}) --n;
    if (n == 0) return kZeroPolynomial;
    if (n == 1) return kBadOrder;
    if (!Allocate(roots, n) || !Allocate(refined, n)) return kOutOfMemory;
    RootList* const delivered = refine ? refined : roots;
    int32_t zeros = 0;
    while (c[zeros] == T{}) ++zeros;
    c += zeros;
    n -= zeros;
    const auto append_zeros = [&](RootList* list) {
        if (zeros > 0) Append(list, {0.0, 0.0}, zeros);
    };
    if (n == 1) {
        append_zeros(roots);
        if (refine) append_zeros(refined);
        return kOk;
    }

    const int32_t degree = n - 1;
    Scratch<T> f(Count(n));
    Scratch<int32_t> order(Count(n));
    RootList sorted;
    if (!f || !order || !Allocate(&sorted, n)) return kOutOfMemory;
    Reverse(c, n, f.data());
    if (HasUnusable(f.data(), Count(n))) return kBadCoefficient;
    const double s = ScaleVariable(c, n, f.data());
    int32_t status =
        RootStructure(f.data(), degree, tol, roots->roots.data(), roots->multiplicities.data(), &roots->count);
    if (status != kOk) return status;
    if (refine) SortByModulus(roots, &order, &sorted);
    const int32_t* const multiplicities = roots->multiplicities.data();
    bool structured = std::accumulate(multiplicities, multiplicities + roots->count, 0) == degree;
    if (refine && structured) {
        status = RefineList(f.data(), degree, s, *roots, refined);
        if (status != kOk && status != kNoConvergence) return status;
        structured = status == kOk;
    }
    for (int32_t i = 0; i < roots->count; ++i) roots->roots[Count(i)] *= s;
    if (refine) append_zeros(roots);
    if (!structured) {
        Reverse(c, n, f.data());
        status = EigenvalueList(f.data(), degree, delivered);
        if (status != kOk) return status;
    }
    append_zeros(delivered);
    return kOk;
}

template int32_t MultipleRoots(const double*, int32_t, bool, double, RootList*, RootList*);
template int32_t MultipleRoots(const Complex*, int32_t, bool, double, RootList*, RootList*);

}  // namespace krnumer
