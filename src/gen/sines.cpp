// The loops are plain C++ without a branch; they are compiled once for every kind of vector unit that the machine may
// have, and no kind rounds differently from another.
#include "gen/sines.h"

#include <bit>
#include <cmath>

#include "frame/vector_targets.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "gen/sines.cpp"
#include <hwy/foreach_target.h>
#include <hwy/highway.h>

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {
namespace {

// Up to here the number of quarter turns has 23 bits, and its products with the parts of pi / 2, of 30 bits, are exact.
constexpr double kFar = 1.3e7;
constexpr double kQuarterTurn[] = {0x1.921fb54p+0, 0x1.10b46118p-30, 0x1.313198ap-61, 0x1.701b839a25205p-92};
constexpr double kPerQuarterTurn = 0x1.45f306dc9c883p-1;

// Takes the exact difference a - b apart: `a` becomes the rounded one, and what it lacks is added to `rest`. Source:
// D. E. Knuth, The Art of Computer Programming, vol. 2, section 4.2.2.
HWY_INLINE void Subtract(double& a, double b, double& rest) {
    const double difference = a - b;
    const double lost = difference - a;
    rest += (a - (difference - lost)) - (b + lost);
    a = difference;
}

// c[0] + c[1] z + c[2] z^2 + ...
template <int kCount>
HWY_INLINE double Polynomial(const double (&c)[kCount], double z) {
    double sum = c[kCount - 1];
    for (int k = kCount - 2; k >= 0; --k) sum = sum * z + c[k];
    return sum;
}

// sin(x + quarters pi / 2) of a near x: x less the nearest number of quarter turns (W. J. Cody and W. Waite, Software
// Manual for the Elementary Functions, 1980) in two doubles, and the Taylor series of sine or cosine. The first two
// terms are taken in two doubles: square and cube of the coarse part of the angle, which has 17 bits, are exact.
template <int64_t quarters>
HWY_INLINE double NearSine(double x) {
    constexpr double kSine[] = {1.0 / 120,        -1.0 / 5040,          1.0 / 362880,         -1.0 / 39916800,
                                1.0 / 6227020800, -1.0 / 1307674368000, 1.0 / 355687428096000};
    constexpr double kCosine[] = {-1.0 / 720,      1.0 / 40320,        -1.0 / 3628800,
                                  1.0 / 479001600, -1.0 / 87178291200, 1.0 / 20922789888000};
    constexpr double kToInteger = 0x1.8p52;  // a sum with this keeps the nearest integer in its last bits
    const double shifted = x * kPerQuarterTurn + kToInteger;
    const double turns = shifted - kToInteger;
    const int64_t quadrant = std::bit_cast<int64_t>(shifted) + quarters;

    double angle = x - turns * kQuarterTurn[0];
    double rest = 0.0;
    Subtract(angle, turns * kQuarterTurn[1], rest);
    Subtract(angle, turns * kQuarterTurn[2], rest);
    rest -= turns * kQuarterTurn[3];
    const double head = angle + rest;
    const double tail = rest - (head - angle);

    const double coarse = std::bit_cast<double>(std::bit_cast<int64_t>(head) & ~int64_t{0xFFFFFFFFF});
    const double fine = head - coarse;
    const double square = coarse * coarse;
    const double square_rest = fine * (head + coarse);
    const double z = square + square_rest;
    const double cube_rest = fine * square + head * square_rest;

    const double cube = square * coarse;
    const double third = cube * (-1.0 / 6.0);
    const double lost = (cube + 4.0 * third) + 2.0 * third;  // by rounding, six times
    const double two = head + third;
    const double two_rest = third - (two - head) - (lost + cube_rest) * (1.0 / 6.0);
    const double level = 1.0 - 0.5 * square;
    const double fourth = square * square * (1.0 / 24.0);
    const double three = level + fourth;
    const double three_rest = fourth - (three - level) + ((1.0 - level) - 0.5 * square);
    const double square_terms = square_rest * ((square + z) * (1.0 / 24.0) - 0.5);

    // Of -0.0 the head is 0.0, and the angle is not.
    const double sine = std::copysign(two + (two_rest + (z * z * head * Polynomial(kSine, z) + tail * three)), angle);
    const double cosine = three + (three_rest + (z * z * z * Polynomial(kCosine, z) + (square_terms - two * tail)));
    const int64_t odd = -(quadrant & 1);
    const int64_t magnitude = (std::bit_cast<int64_t>(cosine) & odd) | (std::bit_cast<int64_t>(sine) & ~odd);
    return std::bit_cast<double>(magnitude ^ (quadrant & 2) << 62);
}

template <int64_t quarters, class Any>
HWY_INLINE void Evaluate(const double* x, int32_t n, double* y, Any any) {
    bool near = true;
    for (int32_t i = 0; i < n; ++i) near &= std::fabs(x[i]) <= kFar;
    if (near) {
        for (int32_t i = 0; i < n; ++i) y[i] = NearSine<quarters>(x[i]);
    } else {
        for (int32_t i = 0; i < n; ++i) y[i] = std::fabs(x[i]) <= kFar ? NearSine<quarters>(x[i]) : any(x[i]);
    }
}

void SinesOf(const double* x, int32_t n, double* y) {
    Evaluate<0>(x, n, y, [](double angle) { return std::sin(angle); });
}
void CosinesOf(const double* x, int32_t n, double* y) {
    Evaluate<1>(x, n, y, [](double angle) { return std::cos(angle); });
}

}  // namespace
}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#if HWY_ONCE
namespace krnumer {

HWY_EXPORT(SinesOf);
HWY_EXPORT(CosinesOf);

void Sines(const double* x, int32_t n, double* y) {
    HWY_DYNAMIC_DISPATCH(SinesOf)(x, n, y);
}
void Cosines(const double* x, int32_t n, double* y) {
    HWY_DYNAMIC_DISPATCH(CosinesOf)(x, n, y);
}

}  // namespace krnumer
#endif
