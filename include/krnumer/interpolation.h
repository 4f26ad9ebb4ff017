/*
 * Interpolation by polynomials, rational functions and splines, smoothing splines, and the removal of outliers.
 *
 * A table is a pair of 1-D arrays of double, y before x, of the same length.
 */
#ifndef KRNUMER_INTERPOLATION_H
#define KRNUMER_INTERPOLATION_H

#include <krnumer/types.h>

/**
 * Value at x0 of the polynomial of degree n - 1 through all points, by Neville's scheme (W. H. Press et al., Numerical
 * Recipes, 1986, 3.1).
 *
 * @param[in]  y              ordinates
 * @param[in]  x              abscissas, all different, in any order
 * @param[in]  x0             where
 * @param[out] value          the value; NaN on failure
 * @param[out] errorEstimate  the last correction, 0 for a single point; NaN on failure
 * @param[out] err            status: 0; -20002 when `x` and `y` differ in length; -20003 when they are empty; -20049
 *                            when two abscissas are equal, even where x0 is a point of the table; -20001 without memory
 * @return                    0
 */
KRNUMER_API int32_t PolyInterp_head(KrHandle y, KrHandle x, const double* x0, double* value, double* errorEstimate,
                                    int32_t* err);

/**
 * Value at x0 of the diagonal rational function through all points (R. Bulirsch and J. Stoer, Numer. Math. 6, 413,
 * 1964).
 *
 * A small number, 1e-10, is added to some differences to keep quotients from 0/0, and limits the accuracy.
 *
 * @param[in]  y              ordinates
 * @param[in]  x              abscissas, in any order
 * @param[in]  x0             where; at a point of the table the value is that of the first such point, the estimate 0
 * @param[out] value          the value; NaN on failure
 * @param[out] errorEstimate  the last correction, 0 for a single point; NaN on failure
 * @param[out] err            status: 0; -20002 when `x` and `y` differ in length; -20003 when they are empty; -20050
 *                            when the function has a pole at x0; -20001 without memory
 * @return                    0
 */
KRNUMER_API int32_t RatInterp_head(KrHandle y, KrHandle x, const double* x0, double* value, double* errorEstimate,
                                   int32_t* err);

/**
 * Second derivatives at its points of the cubic spline through a table, for SpInterp_head.
 *
 * @param[in]  y           ordinates
 * @param[in]  x           abscissas, ascending or descending
 * @param[in]  slopeFirst  slope at the first point; from 9.9e29 on the end is natural, of second derivative 0
 * @param[in]  slopeLast   slope at the last point, likewise
 * @param[out] y2          second derivatives, 1-D double; that of a single point is 0. Emptied on failure
 * @param[out] err         status: 0; -20002 when `x` and `y` differ in length; -20003 when they are empty; -20049 when
 *                         two of three neighbouring abscissas are equal (a table of two points is not looked at);
 *                         -20001 without memory or when `y2` cannot be sized
 * @return                 0, or the host's status when `y2` cannot be sized
 */
KRNUMER_API int32_t Spline_head(KrHandle y, KrHandle x, const double* slopeFirst, const double* slopeLast, KrHandle y2,
                                int32_t* err);

/**
 * Value at x0 of a cubic spline. Outside the table the pieces at its ends go on.
 *
 * @param[in]  y      ordinates
 * @param[in]  x      abscissas, ascending or descending
 * @param[in]  y2     second derivatives from Spline_head
 * @param[in]  x0     where
 * @param[out] value  the value; NaN on failure
 * @param[out] err    status: 0; -20003 when an array has no block or all are empty; -20002 when they differ in length;
 *                    -20049 when the two abscissas about x0 are equal
 * @return            0
 */
KRNUMER_API int32_t SpInterp_head(KrHandle y, KrHandle x, KrHandle y2, const double* x0, double* value, int32_t* err);

/**
 * Cubic smoothing spline: the values f(x[i]) of the function that minimises
 * p sum of w[i] (y[i] - f(x[i]))^2 + (1 - p) integral of lambda(x) f''(x)^2 (C. H. Reinsch, Numer. Math. 10, 177,
 * 1967).
 *
 * @param[in,out] y             ordinates; the smoothed values on return, emptied on failure
 * @param[in]     x             ascending abscissas; empty for 0, 1, 2, ...
 * @param[in]     w             weights, counted by magnitude; empty for 1 throughout
 * @param[in]     smoothWeight  lambda on each of the n - 1 intervals, counted by magnitude; empty for 1 throughout
 * @param[in]     balance       p: 1 leaves y, smaller smooths harder, 0 gives the regression line; any value outside 0
 *                              to 1 asks for 8 / (8 + s^3) with s the range of x over n
 * @param[out]    residue       p sum of (y[i] - f(x[i]))^2, without the weights, plus the second term; NaN on failure
 * @return                      0; -20002 when the arrays do not match; -20006 for fewer than two points; -20049 when x
 *                              does not ascend (with p = 1: repeats); -20141 for a weight of 0; -20008 for 3 to 6
 *                              points, which the band solver does not take, unless p is 1; -20041 when the equations
 *                              are singular; -20001 without memory. Two points stay as they are, with residue 0
 */
KRNUMER_API int32_t CubicSplineFit_head(KrHandle y, KrHandle x, KrHandle w, KrHandle smoothWeight, double balance,
                                        double* residue);

/**
 * Takes points out of a data set by their indices.
 *
 * @param[in]  y        ordinates
 * @param[in]  x        abscissas
 * @param[in]  w        weights, or empty
 * @param[in]  indices  points to remove, 1-D int32; repeated ones count once
 * @param[out] yOut     ordinates of the points that stay, in their order
 * @param[out] xOut     their abscissas
 * @param[out] wOut     their weights; empty without weights
 * @param[out] mask     1 for each point removed, 0 for the others, 1-D uint8
 * @return              0; -20003 when `y` is empty; -20002 when the arrays differ in length; -20003 when `indices` is
 *                      empty; -20017 for an index that is no point; -20001 when an output cannot be sized. All outputs
 *                      are emptied by a failure
 */
KRNUMER_API int32_t RmvOutlierIndx_head(KrHandle y, KrHandle x, KrHandle w, KrHandle indices, KrHandle yOut,
                                        KrHandle xOut, KrHandle wOut, KrHandle mask);

/**
 * Takes the points out of a data set that lie on or outside bounds. A coordinate that is NaN lies inside.
 *
 * @param[in]  y         ordinates
 * @param[in]  x         abscissas
 * @param[in]  w         weights, or empty
 * @param[in]  range     bounds in pairs, in either order within a pair
 * @param[in]  selector  0: a pair for y; 1: a pair for x; 2: a pair for x and one for y. The low 16 bits count
 * @param[out] yOut      ordinates of the points that stay, in their order
 * @param[out] xOut      their abscissas
 * @param[out] wOut      their weights; empty without weights
 * @param[out] removed   indices of the points removed, ascending, 1-D int32
 * @return               0; -20003 when `y` is empty; -20002 when the arrays differ in length; -20003 when `range` is
 *                       empty; -20061 for another `selector`; -20006 for fewer than 2 bounds, -20069 for fewer than 4
 *                       with selector 2; -20068 when a bound is NaN; -20001 without memory or when an output cannot be
 *                       sized. All outputs are emptied by a failure
 */
KRNUMER_API int32_t RmvOutlierRng_head(KrHandle y, KrHandle x, KrHandle w, KrHandle range, int32_t selector,
                                       KrHandle yOut, KrHandle xOut, KrHandle wOut, KrHandle removed);

#endif
