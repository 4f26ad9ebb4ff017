/*
 * Analysis of variance of balanced designs, and the chi-square test of a contingency table.
 *
 * Observations are a 1-D array of double; the level of each factor is a 1-D array of int32 of the same length, from 0
 * to the number of levels - 1. A number of levels with a negative sign marks a random factor. Sums of squares are
 * formed in one pass, total of squares less correction term, and lose digits where the mean is large beside the spread.
 *
 * Every p value is an upper tail. Where mean squares are 0 over 0, F and p are NaN and the status is 0. After a failure
 * every scalar is NaN and a table is empty.
 */
#ifndef KRNUMER_ANOVA_H
#define KRNUMER_ANOVA_H

#include <krnumer/types.h>

/**
 * One-way analysis of variance.
 *
 * @param[in]  y          observations
 * @param[in]  levels     group of each observation, 0 to k - 1
 * @param[in]  k          number of groups, from 2 to n - 1
 * @param[out] ssBetween  sum of squares between groups
 * @param[out] msBetween  mean square between groups, over k - 1
 * @param[out] f          msBetween / msWithin
 * @param[out] p          probability of a larger f
 * @param[out] ssWithin   sum of squares within groups
 * @param[out] msWithin   mean square within groups, over n - k
 * @param[out] ssTotal    total sum of squares
 * @param[out] err        status: 0; -20002 when the arrays differ in length; -20003 when they are empty; -20042 when
 *                        `k` is out of range; -20043 for a group out of range; -20044 for a group without observation;
 *                        -20001 without memory
 * @return                0
 */
KRNUMER_API int32_t Anova1Way_head(KrHandle y, KrHandle levels, const int32_t* k, double* ssBetween, double* msBetween,
                                   double* f, double* p, double* ssWithin, double* msWithin, double* ssTotal,
                                   int32_t* err);

/**
 * Two-way analysis of variance with r observations in every cell.
 *
 * F of A is formed over the mean square of AB when B is random, F of B when A is; all else over that of the error. All
 * p values take the degrees of freedom of the error. Without replications (r = 1) the row AB is 0, so is pAB, and what
 * would be the interaction is the error.
 *
 * @param[in]  y        observations, a b r of them
 * @param[in]  levelsA  level of factor A
 * @param[in]  levelsB  level of factor B
 * @param[in]  r        observations in each cell, from 1 on; from 2 on with a random factor
 * @param[in]  a        levels of A, at least 2 in magnitude; negative for a random factor
 * @param[in]  b        levels of B, likewise
 * @param[out] table    4 rows A, B, AB, error; columns sum of squares, degrees of freedom, mean square, F (0 for the
 *                      error)
 * @param[out] pA       probability of a larger F of A
 * @param[out] pB       probability of a larger F of B
 * @param[out] pAB      probability of a larger F of AB
 * @param[out] err      status: 0; -20002 when the arrays differ in length; -20001 when `table` cannot be sized, or
 *                      without memory; -20045 when a b r is not the length; -20042 for a factor of fewer than 2 levels;
 *                      -20044 when `r` is less than 1; -20043 for a level out of range; -20047 for a cell that does not
 *                      hold `r`; -20048 for a random factor with `r` 1. The first in this order counts
 * @return              0
 */
KRNUMER_API int32_t Anova2Way_head(KrHandle y, KrHandle levelsA, KrHandle levelsB, const int32_t* r, const int32_t* a,
                                   const int32_t* b, KrHandle table, double* pA, double* pB, double* pAB, int32_t* err);

/**
 * Three-way analysis of variance with r observations in every cell.
 *
 * What an effect is tested against follows from the expected mean squares of the restricted model; its p value takes
 * the degrees of freedom of that mean square. Where random factors leave no exact test, F and p are -1.
 *
 * @param[in]  y        observations, a b c r of them
 * @param[in]  levelsA  level of factor A
 * @param[in]  levelsB  level of factor B
 * @param[in]  levelsC  level of factor C
 * @param[in]  r        observations in each cell, from 2 on
 * @param[in]  a        levels of A, at least 2 in magnitude; negative for a random factor
 * @param[in]  b        levels of B, likewise
 * @param[in]  c        levels of C, likewise
 * @param[out] table    8 rows A, B, C, AB, AC, BC, ABC, error; columns sum of squares, degrees of freedom, mean square,
 *                      F (0 for the error)
 * @param[out] pA       probability of a larger F of A
 * @param[out] pB       probability of a larger F of B
 * @param[out] pC       probability of a larger F of C
 * @param[out] pAB      probability of a larger F of AB
 * @param[out] pAC      probability of a larger F of AC
 * @param[out] pBC      probability of a larger F of BC
 * @param[out] pABC     probability of a larger F of ABC
 * @param[out] err      status: 0; -20002 when the arrays differ in length; -20001 when `table` cannot be sized, or
 *                      without memory; -20045 when a b c r is not the length; -20044 when `r` is less than 2; -20042
 *                      for a factor of fewer than 2 levels; -20043 for a level out of range; -20047 for a cell that
 *                      does not hold `r`. The first in this order counts
 * @return              0
 */
KRNUMER_API int32_t ANOVA3Way_head(KrHandle y, KrHandle levelsA, KrHandle levelsB, KrHandle levelsC, const int32_t* r,
                                   const int32_t* a, const int32_t* b, const int32_t* c, KrHandle table, double* pA,
                                   double* pB, double* pC, double* pAB, double* pAC, double* pBC, double* pABC,
                                   int32_t* err);

/**
 * Pearson's chi-square test of the independence of rows and columns.
 *
 * The sum over all cells of (count - E)^2 / E with E = row sum times column sum over the total, on (rows - 1)(columns -
 * 1) degrees of freedom. A row or column of zeros gives a NaN with p = 1 and status 0.
 *
 * @param[in]  counts     2-D int32, at least 2 by 2
 * @param[out] chiSquare  the statistic
 * @param[out] p          probability of a larger one
 * @param[out] err        status: 0; -20056 for a negative dimension; -20055 for fewer than 2 rows or columns; -20056
 *                        for a negative cell; -20001 without memory
 * @return                0
 */
KRNUMER_API int32_t Contingency_head(KrHandle counts, double* chiSquare, double* p, int32_t* err);

#endif
