// Discrete cosine transform of type II, orthonormal, and sine transform of type I, unnormalised, with their inverses:
//
//     cosine: y[k] = s(k) sum of x[i] cos(pi (2i+1) k / (2n)),  s(0) = sqrt(1/n), s(k) = sqrt(2/n)
//     sine:   y[k] = sum of x[i] sin(pi (i+1) (k+1) / (n+1)),   inverse with the factor 2/(n+1)
//
// Cosine transforms of even length reorder their input (J. Makhoul, IEEE Trans. ASSP 28, 27, 1980); those of odd length
// extend it evenly to 2n, sine transforms oddly to 2(n+1).
#pragma once

#include <cstdint>

#include "fft/fft.h"
#include "frame/complex.h"
#include "frame/numeric.h"
#include "frame/scratch.h"

namespace krnumer {

class LinePlan;

// Transforms a line of as many samples as the plan is for; behind the first `available` ones they are 0. y may be x.
using LineFunction = int32_t(const double* x, int32_t available, double* y, LinePlan& plan);

LineFunction CosineTransform, InverseCosineTransform, SineTransform, InverseSineTransform;

// Length of the table of a transform of n samples; 0 where no int32 is long enough.
int32_t CosineTableLength(int32_t n);
int32_t SineTableLength(int32_t n);

// A transform and what it needs.
struct LineTransform {
    LineFunction* transform;
    int32_t (*table_length)(int32_t n);
    bool turns;  // uses LinePlan::Turn
};

inline constexpr LineTransform kCosine{CosineTransform, CosineTableLength, true};
inline constexpr LineTransform kInverseCosine{InverseCosineTransform, CosineTableLength, true};
inline constexpr LineTransform kSine{SineTransform, SineTableLength, false};
inline constexpr LineTransform kInverseSine{InverseSineTransform, SineTableLength, false};

// A transform of lines of n samples, and what all of them share. The table has the length that the transform needs.
class LinePlan {
  public:
    LinePlan(const LineTransform& line, int32_t n, const qmfft_table* table);

    // False without memory.
    explicit operator bool() const { return work_ && turns_; }

    int32_t Run(const double* x, int32_t available, double* y) { return transform_(x, available, y, *this); }

    int32_t length() const { return length_; }
    const qmfft_table* table() const { return table_; }
    double* work() { return work_.data(); }  // 4 (n + 1) doubles

    // exp(i pi k / (2n)), for k from 0 to n.
    Complex Turn(int32_t k) const {
        if (k <= length_ / 2) return turns_[Count(k)];
        const Complex mirrored = turns_[Count(length_ - k)];
        return {mirrored.im, mirrored.re};
    }

  private:
    LineFunction* transform_;
    int32_t length_;
    const qmfft_table* table_;
    Scratch<double> work_;
    Scratch<Complex> turns_;
};

// Rows, from a matrix of x_rows by x_columns, cut or filled up with zeros, to one of `rows` by the length of the plan;
// y may be x of the same size.
int32_t TransformRows(LinePlan& plan, const double* x, int32_t x_rows, int32_t x_columns, double* y, int32_t rows);

// Columns, from x to y, of as many rows as the plan is for; y may be x.
int32_t TransformColumns(LinePlan& plan, const double* x, double* y, int32_t columns);

}  // namespace krnumer
