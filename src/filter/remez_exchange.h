// Best approximation by a sum of cosines in the sense of Chebyshev, on a grid.
#pragma once

#include <cstdint>

#include "frame/scratch.h"

namespace krnumer {

// Where a sum of cosines alpha[0] + alpha[1] cos(2 pi f) + ... is to be near `desired`, the error being multiplied by
// `weight`. In x = cos(2 pi f) it is a polynomial.
struct ApproximationGrid {
    double* x;  // descending
    double* desired;
    double* weight;
    int32_t size;
};

// The second algorithm of Remez, with the exchange of J. H. McClellan, T. W. Parks, L. R. Rabiner, A computer program
// for designing optimum FIR linear phase digital filters, IEEE Trans. Audio Electroacoust. AU-21, 506 (1973).
//
// The error of the best approximation alternates between +deviation and -deviation at one point more than there are
// cosines. A round passes a polynomial through such an alternation at the current points, looks around each point for
// the extremum of the error, and moves the points there.
class RemezExchange {
  public:
    // Points at the most, two spare ones included.
    static constexpr int32_t kMostPoints = 2047;

    RemezExchange(const ApproximationGrid& grid, int32_t cosines) : grid_(grid), cosines_(cosines) {}

    // kOutOfMemory, or kBadBands where the exchange fails or does not end within the rounds.
    int32_t Run(int32_t rounds);

    double deviation() const { return deviation_; }

    // alpha[0] ... alpha[cosines-1] of the best approximation; kOutOfMemory, or kBadBands where weights out of all
    // reason have made numbers of it that are none.
    int32_t Cosines(double* alpha) const;

  private:
    // How a search for a larger error ends. The index at which it ends well is in found_.
    enum class Search : uint8_t { kFound, kAtLimit, kStopped };

    int32_t points() const { return cosines_ + 1; }

    void SpreadPoints();
    bool FormFactors();
    void Interpolate();
    void MovePoints();
    void TakeEnds(int32_t former_first, int32_t former_last);

    double Response(double x) const;
    double Error(int32_t k) const;
    bool Climb(int32_t k, int32_t limit);
    bool SearchUp(int32_t k, int32_t limit);
    Search SearchDown(int32_t k, int32_t limit, bool only_next);

    ApproximationGrid grid_;
    int32_t cosines_;
    Scratch<int32_t> extrema_;  // indices of the points in the grid
    Scratch<double> work_;
    double* x_ = nullptr;       // the points,
    double* factor_ = nullptr;  // their weights in the barycentric formula,
    double* y_ = nullptr;       // and what the polynomial is there

    double deviation_ = 0.0;
    int32_t changes_ = 1;

    // Of the searches: the sign with which errors count, the largest so far, and where it is.
    double sign_ = 1.0;
    double largest_ = 0.0;
    int32_t found_ = 0;
    double largest_at_first_ = 0.0;
    double first_sign_ = 1.0;
};

}  // namespace krnumer
