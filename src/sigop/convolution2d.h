// Linear convolution and cross-correlation of planes, by definition or through the spectrum.
//
// Full size is rx + ry - 1 rows by cx + cy - 1 columns. Elements lie row after row; outputs may not overlap inputs.
#pragma once

#include <cstdint>

#include "frame/complex.h"
#include "sigop/convolution.h"

namespace krnumer {

// Which part of the full convolution is kept.
enum ConvolutionOutput : int32_t {
    kFullOutput = 0,
    kSameOutput = 1,   // rx by cx, from row ry / 2 and column cy / 2 on
    kValidOutput = 2,  // rx - ry + 1 by cx - cy + 1: where y lies within x
};

struct PlaneSize {
    int32_t rows, columns;
};

// Size of the part that is kept; below 1 where nothing is, or where no int32 is large enough.
constexpr PlaneSize OutputSize(PlaneSize x, PlaneSize y, int32_t output_size) {
    switch (output_size) {
        case kSameOutput:
            return x;
        case kValidOutput:
            return {x.rows - y.rows + 1, x.columns - y.columns + 1};
        default:
            return {FullLength(x.rows, y.rows), FullLength(x.columns, y.columns)};
    }
}

// kEmptyInput where a dimension is below 1, kBadSelector for an algorithm that is none. The valid part asks for
// rx >= ry and cx >= cy of real planes, for rx >= cx and ry >= cy of complex ones: kBadDimension.
int32_t Convolve2DReal(const double* x, int32_t rx, int32_t cx, const double* y, int32_t ry, int32_t cy, double* z,
                       int32_t output_size, int32_t algorithm);
int32_t Convolve2DComplex(const Complex* x, int32_t rx, int32_t cx, const Complex* y, int32_t ry, int32_t cy,
                          Complex* z, int32_t output_size, int32_t algorithm);

// The full convolution of x, reversed along both axes and conjugated, with y.
int32_t Correlate2DReal(const double* x, int32_t rx, int32_t cx, const double* y, int32_t ry, int32_t cy, double* z,
                        int32_t algorithm);
int32_t Correlate2DComplex(const Complex* x, int32_t rx, int32_t cx, const Complex* y, int32_t ry, int32_t cy,
                           Complex* z, int32_t algorithm);

}  // namespace krnumer
