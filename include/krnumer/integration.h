/*
 * Integration of samples on a uniform grid by the closed Newton-Cotes rules.
 *
 * The samples are divided into panels of one, two, three or four intervals, and each is integrated by the polynomial
 * through its samples. Where the intervals do not fill the last panel, those left over are integrated by the rule
 * whose panel they fill: one by the trapezoid, two by Simpson's rule, three by the 3/8 rule. On full panels the rules
 * are exact for polynomials up to degree 1, 3, 3 and 5 (Abramowitz and Stegun, Handbook of Mathematical Functions,
 * 25.4).
 *
 * | Rule | Name               | Least number of samples |
 * |------|--------------------|-------------------------|
 * | 0    | trapezoid          | 2                       |
 * | 1    | Simpson's rule     | 3                       |
 * | 2    | Simpson's 3/8 rule | 4                       |
 * | 3    | Boole's rule       | 5                       |
 *
 * A step counts by its absolute value.
 */
#ifndef KRNUMER_INTEGRATION_H
#define KRNUMER_INTEGRATION_H

#include <krnumer/types.h>

/**
 * Integral of samples on a line.
 *
 * @param[in]  y         samples, 1-D double
 * @param[in]  dt        distance of two samples
 * @param[in]  rule      0 to 3, see above
 * @param[out] integral  the integral; NaN on failure
 * @param[out] err       status: 0, or the first that applies of -20003 when `y` is empty; -20061 when there is no such
 *                       rule; -20008 when `y` has fewer samples than the rule needs
 * @return               0
 */
KRNUMER_API int32_t NumerIntegration_head(KrHandle y, const double* dt, const int32_t* rule, double* integral,
                                          int32_t* err);

/**
 * Integral of samples on a rectangle: of every row along the columns, then of these integrals along the rows.
 *
 * @param[in]  y         samples, 2-D double
 * @param[in]  steps     distances, 1-D double: of two columns, of two rows
 * @param[in]  rule      0 to 3, see above; its low 16 bits count
 * @param[out] integral  the integral; NaN on failure
 * @return               0, or the first that applies of -20008 when `y` has fewer than 3 rows or columns; -20006 when
 *                       `steps` has fewer than 2 elements; -20061 when there is no such rule; -20008 when the rule
 *                       needs more rows or columns; -20001 without memory
 */
KRNUMER_API int32_t NumerIntegration2D_head(KrHandle y, KrHandle steps, int32_t rule, double* integral);

/**
 * Integral of samples in a box: of every page as a rectangle, then of these integrals along the pages.
 *
 * @param[in]  y         samples, 3-D double: pages of rows of columns
 * @param[in]  steps     distances, 1-D double: of two columns, of two rows, of two pages
 * @param[in]  rule      0 to 3, see above; its low 16 bits count
 * @param[out] integral  the integral; NaN on failure
 * @return               0, or the first that applies of -20008 when `y` has fewer than 3 pages, rows or columns; -20007
 *                       when `steps` has fewer than 3 elements; -20061 when there is no such rule; -20008 when the rule
 *                       needs more pages, rows or columns; -20001 without memory
 */
KRNUMER_API int32_t NumerIntegration3D_head(KrHandle y, KrHandle steps, int32_t rule, double* integral);

#endif
