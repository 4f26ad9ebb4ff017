#include "stat/anova.h"

#include <cmath>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "stat/distribution.h"

namespace krnumer {

namespace {

// Probability of a larger F; NaN for an F that is NaN.
double UpperTail(double f, double n, double m) {
    double p;
    if (FDistribution(f, static_cast<int32_t>(n), static_cast<int32_t>(m), &p) != kOk) return kQuietNaN;
    return 1.0 - p;
}

double Magnitude(int32_t levels) {
    return std::fabs(static_cast<double>(levels));
}

// Sums of the observations of a design over all factors but some. Such a margin is the set of the factors that are kept,
// factor k as bit k; the cells are the margin of all factors, the total that of none. Every sum follows the order of the
// data.
class Design {
  public:
    static constexpr int kMostFactors = 3;

    // n observations are expected to be the product of the levels and r.
    int32_t Read(const double* y, const int32_t* const* levels, int32_t n, int32_t r, const int32_t* counts,
                 int factors) {
        n_ = n;
        cells_ = (1U << factors) - 1;
        for (int k = 0; k < factors; ++k) levels_[k] = static_cast<int32_t>(Magnitude(counts[k]));
        for (unsigned margin = 0; margin <= cells_; ++margin) {
            sizes_[margin] = 1;
            for (int k = 0; k < factors; ++k)
                if (Keeps(margin, k)) sizes_[margin] *= levels_[k];
            if (!sums_[margin].Allocate(Count(sizes_[margin]), Scratch<double>::kZeroed)) return kOutOfMemory;
        }
        Scratch<int32_t> observed(Count(cells()), Scratch<int32_t>::kZeroed);
        if (!observed) return kOutOfMemory;
        for (int32_t i = 0; i < n; ++i) {
            int32_t place[kMargins] = {};
            for (int k = 0; k < factors; ++k) {
                const int32_t level = levels[k][i];
                if (level < 0 || level >= levels_[k]) return kBadLevel;
                for (unsigned margin = 0; margin <= cells_; ++margin)
                    if (Keeps(margin, k)) place[margin] = place[margin] * levels_[k] + level;
            }
            squares_ += y[i] * y[i];
            for (unsigned margin = 0; margin <= cells_; ++margin) sums_[margin][Count(place[margin])] += y[i];
            ++observed[Count(place[cells_])];
        }
        for (int32_t cell = 0; cell < cells(); ++cell)
            if (observed[Count(cell)] != r) return kUnbalanced;
        return kOk;
    }

    double squares() const { return squares_; }
    double correction() const { return SumOfSquares(0); }
    int32_t levels(int factor) const { return levels_[factor]; }
    int32_t cells() const { return sizes_[cells_]; }

    // Sum of the squares of a margin's sums over the number of observations behind each.
    double SumOfSquares(unsigned margin) const {
        double squares = 0.0;
        for (size_t i = 0; i < Count(sizes_[margin]); ++i) squares += sums_[margin][i] * sums_[margin][i];
        return squares / (n_ / sizes_[margin]);
    }

  private:
    static constexpr unsigned kMargins = 1U << kMostFactors;

    static bool Keeps(unsigned margin, int factor) { return (margin >> factor & 1) != 0; }

    int32_t n_ = 0;
    unsigned cells_ = 0;
    int32_t levels_[kMostFactors] = {};
    int32_t sizes_[kMargins] = {};
    double squares_ = 0.0;
    Scratch<double> sums_[kMargins];
};

AnovaRow Row(double sum_of_squares, double degrees_of_freedom) {
    return {sum_of_squares, degrees_of_freedom, sum_of_squares / degrees_of_freedom, 0.0};
}

}  // namespace

int32_t AnalyseOneWay(const double* y, const int32_t* level, int32_t n, int32_t levels, OneWayAnova* result) {
    if (n < 1) return kEmptyInput;
    if (levels < 2 || levels >= n) return kTooFewLevels;
    Scratch<double> sums(Count(levels), Scratch<double>::kZeroed);
    Scratch<int32_t> observed(Count(levels), Scratch<int32_t>::kZeroed);
    if (!sums || !observed) return kOutOfMemory;
    double total = 0.0;
    double squares = 0.0;
    for (int32_t i = 0; i < n; ++i) {
        if (level[i] < 0 || level[i] >= levels) return kBadLevel;
        total += y[i];
        squares += y[i] * y[i];
        sums[Count(level[i])] += y[i];
        ++observed[Count(level[i])];
    }

    const double correction = total * total / n;
    double between = 0.0;
    for (size_t k = 0; k < Count(levels); ++k) {
        if (observed[k] == 0) return kEmptyCell;
        between += sums[k] * sums[k] / observed[k];
    }
    result->ss_total = squares - correction;
    result->ss_between = between - correction;
    result->ss_within = result->ss_total - result->ss_between;
    result->ms_between = result->ss_between / (levels - 1);
    result->ms_within = result->ss_within / (n - levels);
    result->f = result->ms_between / result->ms_within;
    result->p = UpperTail(result->f, levels - 1, n - levels);
    return kOk;
}

int32_t AnalyseTwoWays(const double* y, const int32_t* const levels[2], int32_t n, int32_t r, const int32_t counts[2],
                       AnovaRow table[4], double p[3]) {
    if (Magnitude(counts[0]) * Magnitude(counts[1]) * r != n) return kBadDataCount;
    if (Magnitude(counts[0]) < 2.0 || Magnitude(counts[1]) < 2.0) return kTooFewLevels;
    if (r < 1) return kEmptyCell;
    Design design;
    if (const int32_t status = design.Read(y, levels, n, r, counts, 2)) return status;
    const bool a_random = counts[0] < 0;
    const bool b_random = counts[1] < 0;
    if (r == 1 && (a_random || b_random)) return kNoFreedomLeft;

    constexpr unsigned kA = 1;
    constexpr unsigned kB = 2;
    const double correction = design.correction();
    const double ss_total = design.squares() - correction;
    const double ss_cells = design.SumOfSquares(kA | kB) - correction;
    const double ss_a = design.SumOfSquares(kA) - correction;
    const double ss_b = design.SumOfSquares(kB) - correction;
    const double df_a = design.levels(0) - 1;
    const double df_b = design.levels(1) - 1;
    AnovaRow& a = table[0] = Row(ss_a, df_a);
    AnovaRow& b = table[1] = Row(ss_b, df_b);
    AnovaRow& ab = table[2] = {};
    AnovaRow& error = table[3];
    if (r == 1) {
        error = Row(ss_cells - ss_a - ss_b, df_a * df_b);
    } else {
        ab = Row(ss_cells - ss_a - ss_b, df_a * df_b);
        error = Row(ss_total - ss_cells, n - design.cells());
        ab.f = ab.mean_square / error.mean_square;
    }
    a.f = a.mean_square / (b_random ? ab : error).mean_square;
    b.f = b.mean_square / (a_random ? ab : error).mean_square;
    p[0] = UpperTail(a.f, df_a, error.degrees_of_freedom);
    p[1] = UpperTail(b.f, df_b, error.degrees_of_freedom);
    p[2] = r == 1 ? 0.0 : UpperTail(ab.f, ab.degrees_of_freedom, error.degrees_of_freedom);
    return kOk;
}

int32_t AnalyseThreeWays(const double* y, const int32_t* const levels[3], int32_t n, int32_t r, const int32_t counts[3],
                         AnovaRow table[8], double p[7]) {
    const double magnitudes[3] = {Magnitude(counts[0]), Magnitude(counts[1]), Magnitude(counts[2])};
    if (magnitudes[0] * magnitudes[1] * magnitudes[2] * r != n) return kBadDataCount;
    if (r < 2) return kEmptyCell;
    for (const double magnitude : magnitudes)
        if (magnitude < 2.0) return kTooFewLevels;
    Design design;
    if (const int32_t status = design.Read(y, levels, n, r, counts, 3)) return status;

    enum Effect { kA, kB, kC, kAB, kAC, kBC, kABC, kError, kNone };
    constexpr unsigned kMargins[7] = {1, 2, 4, 3, 5, 6, 7};
    double m[7];
    for (int effect = kA; effect <= kABC; ++effect) m[effect] = design.SumOfSquares(kMargins[effect]);

    const double t = design.correction();
    const double df_a = design.levels(0) - 1;
    const double df_b = design.levels(1) - 1;
    const double df_c = design.levels(2) - 1;
    table[kA] = Row(m[kA] - t, df_a);
    table[kB] = Row(m[kB] - t, df_b);
    table[kC] = Row(m[kC] - t, df_c);
    table[kAB] = Row(m[kAB] - m[kA] - m[kB] + t, df_a * df_b);
    table[kAC] = Row(m[kAC] - m[kA] - m[kC] + t, df_a * df_c);
    table[kBC] = Row(m[kBC] - m[kB] - m[kC] + t, df_b * df_c);
    table[kABC] = Row(m[kABC] - m[kAB] - m[kAC] - m[kBC] + m[kA] + m[kB] + m[kC] - t, df_a * df_b * df_c);
    table[kError] = Row(design.squares() - m[kABC], (r - 1.0) * design.cells());

    // What each effect is tested against, by the random factors A, B and C as bits 2, 1 and 0: the mean square that is
    // expected to differ from the effect's own by the effect alone.
    constexpr Effect kDenominators[8][7] = {
        {kError, kError, kError, kError, kError, kError, kError},
        {kAC, kBC, kError, kABC, kError, kError, kError},
        {kAB, kError, kBC, kError, kABC, kError, kError},
        {kNone, kBC, kBC, kABC, kABC, kError, kError},
        {kError, kAB, kAC, kError, kError, kABC, kError},
        {kAC, kNone, kAC, kABC, kError, kABC, kError},
        {kAB, kAB, kNone, kError, kABC, kABC, kError},
        {kNone, kNone, kNone, kABC, kABC, kABC, kError},
    };
    const int random = (counts[0] < 0) * 4 + (counts[1] < 0) * 2 + (counts[2] < 0);
    for (int effect = kA; effect <= kABC; ++effect) {
        const Effect denominator = kDenominators[random][effect];
        if (denominator == kNone) {
            table[effect].f = p[effect] = -1.0;
            continue;
        }
        const AnovaRow& against = table[denominator];
        table[effect].f = table[effect].mean_square / against.mean_square;
        p[effect] = UpperTail(table[effect].f, table[effect].degrees_of_freedom, against.degrees_of_freedom);
    }
    return kOk;
}

int32_t TestContingency(const int32_t* counts, int32_t rows, int32_t columns, double* chi_square, double* p) {
    if (rows < 0 || columns < 0) return kNegativeCell;
    if (rows < 2 || columns < 2) return kTableTooSmall;
    const size_t width = Count(columns);
    const size_t cells = Count(rows) * width;
    for (size_t i = 0; i < cells; ++i)
        if (counts[i] < 0) return kNegativeCell;
    Scratch<double> sums(Count(rows) + width, Scratch<double>::kZeroed);
    if (!sums) return kOutOfMemory;
    double* const row_sums = sums.data();
    double* const column_sums = row_sums + rows;
    double total = 0.0;
    for (size_t i = 0; i < cells; ++i) {
        row_sums[i / width] += counts[i];
        column_sums[i % width] += counts[i];
        total += counts[i];
    }
    double sum = 0.0;
    for (size_t i = 0; i < cells; ++i) {
        const double expected = row_sums[i / width] * column_sums[i % width] / total;
        sum += (counts[i] - expected) * (counts[i] - expected) / expected;
    }
    double lower_tail;
    if (const int32_t status = ChiSquareDistribution(sum, (rows - 1) * (columns - 1), &lower_tail)) return status;
    *chi_square = sum;
    *p = 1.0 - lower_tail;
    return kOk;
}

}  // namespace krnumer
