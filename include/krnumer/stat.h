/*
 * Statistics: mean, median, modes, moments, mean squares and histograms.
 *
 * Data are 1-D arrays of double. Sums run in index order, so the last digits do not depend on the machine.
 */
#ifndef KRNUMER_STAT_H
#define KRNUMER_STAT_H

#include <krnumer/types.h>

/**
 * Arithmetic mean, (x[0] + ... + x[n-1]) / n, as a running sum.
 *
 * @param[in]  x     samples; a NaN among them gives NaN
 * @param[out] mean  the mean; NaN on failure
 * @param[out] err   status: 0, or -20003 when `x` is empty
 * @return           0
 */
KRNUMER_API int32_t Mean_head(KrHandle x, double* mean, int32_t* err);

/**
 * Median: the middle one of the sorted samples, or half the sum of the two in the middle.
 *
 * @param[in]  x       samples
 * @param[out] median  the median; NaN on failure
 * @param[out] err     status: 0; -20003 when `x` is empty; -20104 when a sample is NaN; -20001 without memory for a
 *                     copy
 * @return             0
 */
KRNUMER_API int32_t Median_head(KrHandle x, double* median, int32_t* err);

/**
 * Modes: the values, or the bins of a histogram, that occur most often.
 *
 * With `intervals` below 1 the modes are values: samples are equal when they differ by at most 2^-52 of the first of
 * their run in the sorted data. With `intervals` from 1 on they are the centers of the fullest of that many bins of
 * equal width between the smallest and the largest sample; NaNs are left out of the extrema. What occurs once is no
 * mode. Samples that all agree to 2^-52 have the one mode that they are, a single sample has none.
 *
 * @param[in]  x          samples
 * @param[in]  intervals  bins, or less than 1 for modes of exact values
 * @param[out] modes      the modes in ascending order, 1-D double. Where there is none, the array is not touched and
 *                        keeps what the caller left in it; emptied on failure, but left as it came when the host
 *                        refuses the size
 * @return                0; -20003 when `x` is empty; -20001 without memory for a copy or the bins; the host's status
 *                        when `modes` cannot be sized
 */
KRNUMER_API int32_t ModeH(KrHandle x, int32_t intervals, KrHandle modes);

/**
 * Central moment, the mean of (x[i] - mean)^order, the power by repeated multiplication.
 *
 * The first moment is computed like any other: it is rounding noise about 0.
 *
 * @param[in]  x       samples
 * @param[in]  order   order of the moment, from 1 on
 * @param[out] moment  the moment; NaN on failure
 * @param[out] err     status: 0; -20003 when `x` is empty; -20021 when `order` is less than 1
 * @return             0
 */
KRNUMER_API int32_t Moment_head(KrHandle x, const int32_t* order, double* moment, int32_t* err);

/**
 * Mean square error, the mean of (x[i] - y[i])^2 over the common length.
 *
 * A square is formed as (y - 2x) y + x x. It cancels where x and y agree in more than half of their digits.
 *
 * @param[in]  x    samples
 * @param[in]  y    samples to compare with
 * @param[out] mse  the mean square; NaN on failure
 * @param[out] err  status: 0; the warning 20004, with the result, when the lengths differ and the shorter was used;
 *                  -20003 when `x` or `y` is empty
 * @return          0
 */
KRNUMER_API int32_t MSE_head(KrHandle x, KrHandle y, double* mse, int32_t* err);

/**
 * Root mean square, sqrt((x[0]^2 + ... + x[n-1]^2) / n).
 *
 * @param[in]  x    samples
 * @param[out] rms  the root mean square; NaN on failure
 * @param[out] err  status: 0, or -20003 when `x` is empty
 * @return          0
 */
KRNUMER_API int32_t RMS_head(KrHandle x, double* rms, int32_t* err);

#pragma pack(push, 1)

/** An interval of a general histogram; an element of an array without padding, 20 bytes. */
typedef struct KrInterval {
    double lower;      /**< lower end */
    double upper;      /**< upper end */
    int32_t inclusion; /**< ends that belong to it: 0 lower only, 1 upper only, 2 both, 3 neither; else all is inside */
} KrInterval;

/** Samples that a general histogram could not place. */
typedef struct KrOutOfRange {
    int32_t outside; /**< samples in no interval */
    int32_t below;   /**< samples below the first interval */
    int32_t above;   /**< samples above the last interval */
} KrOutOfRange;

#pragma pack(pop)

/**
 * General histogram: how many samples lie in each of the caller's intervals.
 *
 * Intervals are expected in ascending order and may overlap, when a sample counts in each that it lies in. A sample
 * below the first interval is looked at no further, even if a later one holds it. A NaN counts as below. Without
 * intervals the histogram is empty and all counters are 0.
 *
 * @param[in]  x          samples
 * @param[in]  bins       intervals, 1-D KrInterval
 * @param[out] histogram  samples in each interval, 1-D int32. A failure resizes it to no elements but leaves its
 *                        dimension word as it is
 * @param[out] counters   samples in no interval; all 0 on failure
 * @param[out] err        status: 0; -20001 on any failure: an empty `x`, a negative number of intervals, no memory
 * @return                0
 */
KRNUMER_API int32_t GenHistH(KrHandle x, KrHandle bins, KrHandle histogram, KrOutOfRange* counters, int32_t* err);

/**
 * Histogram over bins of equal width from the smallest to the largest sample.
 *
 * A bin holds its lower end, the last one both ends. A NaN counts in the last bin; it also takes over the minimum
 * until the next number does, so NaNs can change the bounds.
 *
 * @param[in]  x          samples
 * @param[in]  bins       number of bins, from 1 on
 * @param[out] histogram  samples in each bin, 1-D int32; emptied on failure
 * @param[out] centers    middles of the bins, 1-D double; emptied on failure
 * @param[out] err        status: 0; -20003 when `x` is empty or `bins` less than 1; -20101 when the smallest sample is
 *                        not below the largest; -20001 when an output cannot be sized
 * @return                0, or the host's status when an output cannot be sized
 */
KRNUMER_API int32_t histgran_head(KrHandle x, const int32_t* bins, KrHandle histogram, KrHandle centers, int32_t* err);

#endif
