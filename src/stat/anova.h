// Analysis of variance of balanced designs with fixed and random factors (H. Scheffe, The Analysis of Variance, 1959),
// and the chi-square test of a contingency table.
//
// Sums of squares come from one pass over the data, total of squares less correction term: where the mean is large
// beside the spread, few digits are left. Levels run from 0 to the number of levels - 1.
#pragma once

#include <cstdint>

namespace krnumer {

struct OneWayAnova {
    double ss_between, ms_between, f, p, ss_within, ms_within, ss_total;
};

// -20003 where n < 1, -20042 unless 2 <= levels < n, -20043 for a level out of range, -20044 for an empty group.
int32_t AnalyseOneWay(const double* y, const int32_t* level, int32_t n, int32_t levels, OneWayAnova* result);

// A row of the table of an analysis.
struct AnovaRow {
    double sum_of_squares, degrees_of_freedom, mean_square, f;
};

// Rows A, B, AB, error; p values of the first three. A negative number of levels marks a random factor. All p values
// stand on the degrees of freedom of the error, whatever F was formed over.
// -20045 unless a b r = n, -20042 for a factor of one level, -20044 where r < 1, -20043 for a level out of range,
// -20047 for an unbalanced design, -20048 for a random factor without replications.
int32_t AnalyseTwoWays(const double* y, const int32_t* const levels[2], int32_t n, int32_t r, const int32_t counts[2],
                       AnovaRow table[4], double p[3]);

// Rows A, B, C, AB, AC, BC, ABC, error; p values of the first seven. F and p are -1 where the random factors leave no
// exact test. -20045 unless a b c r = n, -20044 where r < 2, -20042, -20043 and -20047 as above.
int32_t AnalyseThreeWays(const double* y, const int32_t* const levels[3], int32_t n, int32_t r, const int32_t counts[3],
                         AnovaRow table[8], double p[7]);

// Pearson's chi-square and its upper tail. -20056 for a negative dimension, -20055 for fewer than 2 rows or columns,
// -20056 for a negative cell. A row or column of zeros makes chi_square NaN.
int32_t TestContingency(const int32_t* counts, int32_t rows, int32_t columns, double* chi_square, double* p);

}  // namespace krnumer
