#include "poly/madsen_roots.h"

#include <algorithm>
#include <cmath>
#include <complex>
#include <cstdint>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"

namespace krnumer {

namespace {

// Without the overflow and underflow of the squares.
double Magnitude(Complex z) {
    return std::hypot(z.re, z.im);
}

bool IsFinite(Complex z) {
    return std::isfinite(z.re) && std::isfinite(z.im);
}

// Of the larger part.
int Exponent(Complex z) {
    return std::ilogb(std::max(std::fabs(z.re), std::fabs(z.im)));
}

// z times a power of 2, exactly unless it overflows or underflows.
Complex Shifted(Complex z, int exponent) {
    return {std::ldexp(z.re, exponent), std::ldexp(z.im, exponent)};
}

Complex SquareRoot(Complex z) {
    const std::complex<double> root = std::sqrt(std::complex<double>(z.re, z.im));
    return {root.real(), root.imag()};
}

// A polynomial, coefficients from the constant up, with all sizes that matter near 1.
struct Descent {
    const Complex* c;
    int32_t degree;

    struct Point {
        Complex z;
        Complex value;  // p(z)
        double height;  // |p(z)|
    };

    Complex Value(Complex z) const {
        Complex value = c[degree];
        for (int32_t k = degree - 1; k >= 0; --k) value = value * z + c[k];
        return value;
    }
    Complex Slope(Complex z) const {
        Complex slope = c[degree] * degree;
        for (int32_t k = degree - 1; k >= 1; --k) slope = slope * z + c[k] * k;
        return slope;
    }
    Point At(Complex z) const {
        const Complex value = Value(z);
        return {z, value, Modulus(value)};
    }

    Complex FirstStep() const;
    Point Search(const Point& from, Complex step, bool* whole_step) const;
    int32_t Find(int32_t limit, Complex* root) const;
};

// Half the way to a circle in which no root lies, in the direction of Newton's step from 0.
Complex Descent::FirstStep() const {
    const auto size = [this](int32_t k) { return std::log2(c[k].re * c[k].re + c[k].im * c[k].im); };
    const double constant = size(0);
    double log_radius = kInfinity;
    for (int32_t k = 1; k <= degree; ++k) log_radius = std::min(log_radius, (constant - size(k)) / (2.0 * k));
    Complex direction = -c[0] / c[1];
    if (!IsFinite(direction) || Magnitude(direction) == 0.0) direction = {1.0, 0.0};
    return std::exp2(log_radius) * 0.5 * (direction / Magnitude(direction));
}

// The best of the points along the step: its multiples while they lead down, else its fractions, the last one turned.
// Where none is lower than `from`, the end of the step.
Descent::Point Descent::Search(const Point& from, Complex step, bool* whole_step) const {
    constexpr Complex kFractions[] = {{0.5, 0.0}, {0.25, 0.0}, {0.2, 0.15}};
    const Point end = At(from.z + step);
    *whole_step = false;
    if (end.height < from.height) {
        Point best = end;
        for (int32_t multiple = 2; multiple <= degree; ++multiple) {
            const Point next = At(from.z + multiple * step);
            if (!(next.height < best.height)) {
                *whole_step = multiple == 2;
                break;
            }
            best = next;
        }
        return best;
    }
    for (const Complex fraction : kFractions) {
        const Point next = At(from.z + fraction * step);
        if (next.height < from.height) return next;
    }
    return end;
}

int32_t Descent::Find(int32_t limit, Complex* root) const {
    constexpr double kSmallestStep = 1e-10;  // relative
    constexpr double kNoise = 1.6e-9;        // of |p|, relative to the constant, by degree
    constexpr double kLongest = 3.0;         // times the step before
    constexpr Complex kBack = {-0.4, -0.3};  // turns a step that leads nowhere, and halves it
    constexpr Complex kAside = {0.8, 0.6};   // turns a step that is too long
    constexpr int32_t kMostPasses = 2000;    // data that overflow may wander without end
    Point point{{0.0, 0.0}, c[0], Modulus(c[0])};
    const double noise = (degree - 1) * point.height * kNoise;
    Complex slope = c[1];
    Complex step = FirstStep();
    bool searching = true;
    int32_t turns = 0;
    for (int32_t pass = 0; pass < kMostPasses; ++pass) {
        bool whole_step = !searching;
        const Point next = searching ? Search(point, step, &whole_step) : At(point.z + step);
        if (!(next.height < point.height)) {
            if ((next.height == point.height && next.height <= noise) ||
                Magnitude(step) <= kSmallestStep * Magnitude(point.z)) {
                *root = point.z;
                return kOk;
            }
            if (turns == std::max(limit, 0)) return kNoConvergence;
            ++turns;
            step = kBack * step;
            searching = true;
            continue;
        }
        turns = 0;
        const double walked = Magnitude(next.z - point.z);
        point = next;
        if (point.height == 0.0 || walked <= kSmallestStep * Magnitude(point.z)) {
            *root = point.z;
            return kOk;
        }
        const Complex slope_before = slope;
        slope = Slope(point.z);
        if (slope == Complex{}) {
            step = kBack * step;
            searching = true;
            continue;
        }
        step = -point.value / slope;
        const double length = Magnitude(step);
        // Ostrowski's condition: Newton's method converges from here.
        searching = !(whole_step && Magnitude(slope - slope_before) * length < 0.5 * Magnitude(slope) * walked);
        if (length > kLongest * walked) step = kLongest * walked / length * (kAside * step);
    }
    return kNoConvergence;
}

// Divides by (z - root), from the highest coefficient down; what remains is left out.
void Deflate(Complex* c, int32_t degree, Complex root) {
    Complex carried = c[degree];
    for (int32_t k = degree - 1; k >= 0; --k) {
        const Complex quotient = carried;
        carried = c[k] + root * carried;
        c[k] = quotient;
    }
}

// Finds one root. The search sees p(2^e z) with the root of least modulus near 1 and the constant near the largest
// coefficient, so that nothing on its way overflows; what underflows is small against the constant.
int32_t FindRoot(const Complex* c, int32_t degree, int32_t limit, Complex* work, Complex* root) {
    *root = {0.0, 0.0};
    if (c[0] == Complex{}) return kOk;
    constexpr std::int64_t kVanishing = -4000;
    const int constant = Exponent(c[0]);
    double least = kInfinity;
    for (int32_t k = 1; k <= degree; ++k)
        if (c[k] != Complex{}) least = std::min(least, static_cast<double>(constant - Exponent(c[k])) / k);
    const int e = static_cast<int>(std::floor(least));
    for (int32_t k = 0; k <= degree; ++k)
        work[k] = Shifted(c[k], static_cast<int>(std::max(std::int64_t{k} * e - constant, kVanishing)));
    const int32_t status = Descent{work, degree}.Find(limit, root);
    *root = Shifted(*root, e);
    return status;
}

// The root of c1^2 - 4 c0 c2, whose terms may overflow or underflow where their root does not.
Complex DiscriminantRoot(const Complex* c) {
    if (c[0] == Complex{}) return c[1];
    const int skew = (Exponent(c[0]) - Exponent(c[2])) / 2;
    int size = Exponent(c[0]) - skew;
    if (c[1] != Complex{}) size = std::max(size, Exponent(c[1]));
    const Complex linear = Shifted(c[1], -size);
    const Complex product = Shifted(c[0], -size - skew) * Shifted(c[2], -size + skew);
    return Shifted(SquareRoot(linear * linear - 4.0 * product), size);
}

// Without the cancellation of the school formula.
void QuadraticRoots(const Complex* c, Complex roots[2]) {
    if (c[0] == Complex{} && c[1] == Complex{}) {
        roots[0] = roots[1] = {0.0, 0.0};
        return;
    }
    const Complex s = DiscriminantRoot(c);
    const Complex plus = c[1] + s;
    const Complex minus = c[1] - s;
    const Complex larger = Magnitude(plus) >= Magnitude(minus) ? plus : minus;
    roots[0] = -0.5 * larger / c[2];
    roots[1] = -2.0 * c[0] / larger;
}

// Multiplies by a power of 2, which moves no root, so that the largest and the smallest coefficient are equally far
// from overflow and underflow; but upwards only as long as deflation keeps its room below overflow.
void Scale(Complex* c, int32_t n) {
    constexpr int kLargest = 960;
    int largest = Exponent(c[n - 1]);
    int smallest = largest;
    for (int32_t k = 0; k < n - 1; ++k) {
        if (c[k] == Complex{}) continue;
        largest = std::max(largest, Exponent(c[k]));
        smallest = std::min(smallest, Exponent(c[k]));
    }
    const int exponent = std::min(-(largest + smallest) / 2, std::max(kLargest - largest, 0));
    for (int32_t k = 0; k < n; ++k) c[k] = Shifted(c[k], exponent);
}

}  // namespace

int32_t MadsenRoots(const Complex* c, int32_t n, int32_t limit, Complex* roots, int32_t* count) {
    if (n < 1) return kEmptyInput;
    if (!std::all_of(c, c + n, IsFinite)) return kBadCoefficient;
    while (n > 0 && c[n - 1] == Complex{}) --n;
    if (n < 2) return kBadCoefficient;
    Scratch<Complex> rest(Count(n));
    Scratch<Complex> work(Count(n));
    if (!rest || !work) return kOutOfMemory;
    *count = n - 1;
    for (; c[0] == Complex{}; ++c, --n) *roots++ = {0.0, 0.0};
    Complex* const first = roots;
    std::copy_n(c, n, rest.data());
    Scale(rest.data(), n);
    int32_t degree = n - 1;
    for (; degree > 2; --degree) {
        if (const int32_t status = FindRoot(rest.data(), degree, limit, work.data(), roots)) return status;
        Deflate(rest.data(), degree, *roots++);
    }
    if (degree == 2) QuadraticRoots(rest.data(), roots);
    if (degree == 1) *roots = -rest[0] / rest[1];
    return std::all_of(first, first + n - 1, IsFinite) ? kOk : kNoConvergence;
}

}  // namespace krnumer
