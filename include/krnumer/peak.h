/*
 * Peak detection: vertices of parabolas fitted to a sliding window, and runs of samples above a threshold.
 */
#ifndef KRNUMER_PEAK_H
#define KRNUMER_PEAK_H

#include <krnumer/types.h>

#define KRN_PEAKS 0   /**< polarity: maxima above the threshold */
#define KRN_VALLEYS 1 /**< polarity: minima below the threshold */

#define KRN_FIRST_BLOCK 1 /**< flag: a signal begins */
#define KRN_LAST_BLOCK 4  /**< flag: the signal ends with this block */

#pragma pack(push, 1)

/** What PeakD reads and gives; without padding, 56 bytes. */
typedef struct KrPeakRecord {
    KrHandle input;              /**< in: the samples of this block, 1-D double */
    double threshold;            /**< in: the amplitude that a peak has to exceed, or a valley to stay below */
    int32_t width;               /**< in: samples of the window, 3 to 1073741824 */
    int32_t polarity;            /**< in: KRN_PEAKS or KRN_VALLEYS */
    KrHandle locations;          /**< out: positions in samples from the begin of the signal, 1-D double */
    KrHandle amplitudes;         /**< out: heights of the parabolas at their vertices, 1-D double */
    KrHandle second_derivatives; /**< out: their second derivatives, per sample squared, 1-D double */
    int32_t count;               /**< out: number of peaks; 0 on failure */
    int32_t flags;               /**< in: KRN_FIRST_BLOCK and KRN_LAST_BLOCK */
} KrPeakRecord;

/** A detector between two calls of PeakD, to be kept and not to be changed by the caller; 52 bytes. */
typedef struct KrPeakState {
    int32_t width;     /**< samples of the window */
    int32_t processed; /**< windows looked at since the begin of the signal, modulo 2^32 */
    int32_t held;      /**< samples kept in the work block */
    int32_t remaining; /**< samples of the last block that are still to be taken in; 0 between calls */
    int32_t rising;    /**< 1 when the slope was positive in the last window */
    double* parts[4];  /**< the work block's weights, window, history and last fit; they are not read */
} KrPeakState;

#pragma pack(pop)

/**
 * Peaks and valleys of a signal that arrives in blocks, by least-squares parabolas in a sliding window.
 *
 * A parabola a0 + a1 x + a2 x^2, with x = 0 in its middle, is fitted to each window. It is a candidate where the slope
 * in the middle has another sign than in the window before; with windows of 3 and 4 samples, wherever it is bent the
 * right way. A slope of at most 1e-10 has the sign of a2. The vertex has to lie in the middle half of the window, and
 * its height beyond the threshold; |2 a2| has to be at least 1e-10. Where the vertex lies more than half a sample
 * before the middle, the fit of the window before is taken if its vertex is nearer to its middle. Two vertices less
 * than one sample apart are one peak: the later stands for it when it is not lower (for valleys: when it is lower).
 *
 * A window is looked at when the sample behind it has come, or with the last block. From width 5 on, a signal divided
 * into blocks thus has the peaks of the whole, except that one at a boundary can be found in both blocks. With width
 * 5 and more the first window only tells the slope it begins with.
 *
 * A signal begins with KRN_FIRST_BLOCK, which creates the work block, or resizes one left over, and ends with
 * KRN_LAST_BLOCK, which frees it and clears its handle. Any failure does so too, empties the three outputs and ends
 * the signal.
 *
 * @param[in,out] record  samples, parameters and results
 * @param[in,out] state   the detector; set by the first block
 * @param[in,out] work    handle of the host's block of bytes for the detector, null before the first block. The host
 *                        leaves it in place between calls
 * @param[out]    err     status, as returned
 * @return                0, or the first that applies of -20061 when `width` is out of range; -20001 when the work
 *                        block cannot be had; -20064 when a signal goes on without its state or work block; -20013 when
 *                        the block has fewer samples than `width`; -20001 without memory for the peaks or the outputs
 */
KRNUMER_API int32_t PeakD(KrPeakRecord* record, KrPeakState* state, KrHandle* work, int32_t* err);

/**
 * Begins of all runs of `width` or more samples at or above a threshold.
 *
 * @param[in]  x          samples, 1-D double
 * @param[in]  threshold  least height
 * @param[in]  width      least length of a run, 1 to one less than the length of `x`
 * @param[out] indices    positions of the first samples. The host is asked for doubles (type code 10), but the elements
 *                        are int32, from the start of the element area on, and the other half of it is 0; emptied on
 *                        failure
 * @param[out] count      number of runs; 0 on failure
 * @param[out] err        status: 0; -20003 when `x` is empty; -20013 when `width` is out of range; -20001 when
 *                        `indices` cannot be sized
 * @return                0, or the host's status when `indices` cannot be sized
 */
KRNUMER_API int32_t PeakDetector(KrHandle x, const double* threshold, const int32_t* width, KrHandle indices,
                                 int32_t* count, int32_t* err);

#endif
