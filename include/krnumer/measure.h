/*
 * Waveform measurements: levels, cycles, pulses and transitions of a sampled signal.
 *
 * A measurement context computes what it is asked about a block of samples and remembers it, together with what it
 * had to find on the way, so that many measurements of one block cost little more than one. Contexts are known by
 * identifiers. Several threads may measure at once; calls on the same context run one after the other.
 *
 * Terms are those of IEEE Std 181 on transitions, pulses and related waveforms, with these definitions:
 *
 * - State levels. A histogram of equal bins spans the samples. The high state is the centre of the fullest bin from
 *   bin 0.6 bins (truncated) on upwards, the low state that of the fullest bin from bin 0.4 bins (truncated) on
 *   downwards; of equally full bins it is the outermost. A sample on the upper bound counts in the last bin, a NaN in
 *   the first.
 * - Reference levels. Low, mid and high as given, or as percentages of the amplitude above the low state.
 * - Crossings of the mid level, interpolated between samples. The signal has to leave a band about the level first,
 *   which spans the lesser distance of the outer levels from the middle one to either side; so noise smaller than
 *   that is no crossing. Rising and falling crossings alternate.
 * - Edges between the low and the high level: from the last crossing of the one to the first crossing of the other.
 *   Rising and falling edges alternate.
 * - An edge's stretch, over which its overshoot and undershoot are looked for, reaches from the middle between it and
 *   the edge before to the middle between it and the edge behind, or to the last sample.
 * - Cycle k lies between crossings 2k - 1 and 2k + 1, counted from 1. Pulse k of a polarity is the k-th complete one;
 *   one more crossing has to follow it in the samples. Edges belong together two by two.
 *
 * A block whose samples are all equal has neither crossings nor edges.
 */
#ifndef KRNUMER_MEASURE_H
#define KRNUMER_MEASURE_H

#include <krnumer/types.h>

/** What can be measured. Those marked with * depend on the occurrence. */
enum KrMeasurement {
    KRN_SMALLEST = 0,         /**< smallest sample */
    KRN_LARGEST = 1,          /**< largest sample */
    KRN_RANGE = 2,            /**< largest minus smallest sample */
    KRN_LOW_STATE = 3,        /**< low state level by the histogram */
    KRN_HIGH_STATE = 4,       /**< high state level by the histogram */
    KRN_AMPLITUDE = 5,        /**< high state minus low state */
    KRN_TOP = 6,              /**< high state if its bin holds more than 5 percent of the samples, else the largest */
    KRN_BASE = 7,             /**< low state if its bin holds more than 5 percent of the samples, else the smallest */
    KRN_TOP_TO_BASE = 8,      /**< top minus base */
    KRN_LOW_REFERENCE = 9,    /**< low reference level in the signal's units */
    KRN_MID_REFERENCE = 10,   /**< mid reference level in the signal's units */
    KRN_HIGH_REFERENCE = 11,  /**< high reference level in the signal's units */
    KRN_BAND = 12,            /**< half width of the band about the mid level in the signal's units */
    KRN_RMS = 13,             /**< root mean square of all samples */
    KRN_MEAN = 14,            /**< mean of all samples */
    KRN_PERIOD = 15,          /**< * length of the cycle */
    KRN_FREQUENCY = 16,       /**< * reciprocal of the period */
    KRN_CYCLE_RMS = 17,       /**< * root mean square over the samples nearest to the cycle */
    KRN_CYCLE_MEAN = 18,      /**< * mean over the samples nearest to the cycle */
    KRN_FALL_TIME = 19,       /**< * duration of the falling one of edges 2k - 1 and 2k */
    KRN_RISE_TIME = 20,       /**< * duration of the rising one of edges 2k - 1 and 2k */
    KRN_POSITIVE_WIDTH = 22,  /**< * width of the positive pulse */
    KRN_NEGATIVE_WIDTH = 23,  /**< * width of the negative pulse */
    KRN_DUTY_HIGH = 24,       /**< * part of the cycle above the mid level, 0 to 1 */
    KRN_DUTY_LOW = 25,        /**< * part of the cycle below the mid level, 0 to 1 */
    KRN_UNDERSHOOT = 26,      /**< * undershoot about edge 2k: (low state - smallest) 100 / amplitude */
    KRN_OVERSHOOT = 27,       /**< * overshoot about edge 2k: (largest - high state) 100 / amplitude */
    KRN_NEXT_OVERSHOOT = 28,  /**< * overshoot about edge 2k + 1 */
    KRN_NEXT_UNDERSHOOT = 29, /**< * undershoot about edge 2k + 1 */
    KRN_POSITIVE_CENTER = 30, /**< * centre of the positive pulse on the time axis */
    KRN_NEGATIVE_CENTER = 31, /**< * centre of the negative pulse on the time axis */
    KRN_RISING_SLEW = 32,     /**< * (high - low reference level) / rise time */
    KRN_FALLING_SLEW = 33,    /**< * (high - low reference level) / fall time, positive as well */
    KRN_NO_MEASUREMENT = 34   /**< nothing: 0 */
};

#define KRN_LEVELS_ABSOLUTE 0 /**< reference levels in the signal's units */
#define KRN_LEVELS_PERCENT 1  /**< reference levels in percent of the amplitude, counted from the low state */

/* State levels that percentages refer to. */
#define KRN_STATES_BY_HISTOGRAM 0 /**< low state and amplitude */
#define KRN_STATES_BY_EXTREMES 1  /**< smallest sample and range */
#define KRN_STATES_BY_EITHER 2    /**< base, and top minus base */

#pragma pack(push, 1)

/** Reference levels, in order: high is not below mid, mid not below low. */
typedef struct KrLevels {
    double high;
    double mid;
    double low;
    int16_t units; /**< KRN_LEVELS_ABSOLUTE or KRN_LEVELS_PERCENT */
} KrLevels;

/** How state levels are found. */
typedef struct KrStateMethod {
    int32_t method; /**< KRN_STATES_BY_..., for levels in percent */
    int32_t bins;   /**< bins of the histogram, from 1 on where one is needed */
} KrStateMethod;

/**
 * Where a measurement lies in the signal, for drawing. What is not named is 0.
 *
 * | Measurement      | left                          | right   | values                                             |
 * |------------------|-------------------------------|---------|----------------------------------------------------|
 * | 0, 1, 9 to 14    | t0                            | t0      | t0 + count dt, value                               |
 * | 2, 5, 8          | t0                            | t0      | t0 + count dt, lower and upper level               |
 * | 3, 4             | t0                            | t0      | t0 + count dt, bottom, centre and top of the bin   |
 * | 6, 7             |                               |         | as the state or the extreme that they are          |
 * | 15 to 18, 24, 25 | begin of the cycle            | its end | mid level, twice                                   |
 * | 22, 23, 30, 31   | begin of the pulse            | its end | mid level, twice                                   |
 * | 19, 20, 32, 33   | begin of the edge             | its end | levels at begin and end                            |
 * | 26 to 29         | begin of the edge's stretch   | its end | time and height of the extreme sample, state level |
 */
typedef struct KrMarkers {
    double left;
    double right;
    double values[4];
} KrMarkers;

#pragma pack(pop)

/**
 * Creates a measurement context, to be ended by measurements_destroy.
 *
 * @param[out] id  its identifier: 1112 for the first context, then counting up; after 4294967294 comes 1. Not written
 *                 on failure
 * @return         0; -20311 without memory; -20330 when `id` is null; -20327 when the system refuses a lock
 */
KRNUMER_API int32_t measurements_create(uint32_t* id);

/**
 * Measures a block of samples.
 *
 * The context keeps what it computes until it is asked with other levels, another method or another occurrence (that
 * of a cycle k counts as 2k - 1), or until measurements_clear. Samples, count, t0 and dt are not compared: before
 * another block is measured with the same parameters, the context has to be cleared.
 *
 * @param[in]  id          context, or -1 for one that lasts for this call only
 * @param[in]  selector    what to measure, see KrMeasurement
 * @param[in]  levels      reference levels
 * @param[in]  method      how state levels are found
 * @param[in]  occurrence  k, the number of the cycle, pulse or pair of edges, from 1 on
 * @param[in]  t0          time of the first sample
 * @param[in]  dt          sampling interval
 * @param[in]  samples     the signal
 * @param[in]  count       number of samples
 * @param[out] result      the value. On failure 0, but not written where an argument is null or the levels are out of
 *                         order; the high reference level with -20326
 * @param[out] box         markers of the value; not written on failure, nor for KRN_NO_MEASUREMENT
 * @return                 0, or the first that applies of:
 *                         -20331 `levels` or `method` is null;
 *                         -20313 the levels are out of order;
 *                         -20330 `result` is null;
 *                         -20329 `box` is null;
 *                         -20312 `samples` is null;
 *                         -20321 the context is unknown (neither this nor what follows for KRN_NO_MEASUREMENT);
 *                         -20315 `dt` is not positive;
 *                         -20312 `count` is less than 1;
 *                         -20325 unknown measurement;
 *                         -20323 `occurrence` is less than 1 where it matters;
 *                         -20314 unknown units; -20316 unknown method, for levels in percent;
 *                         -20317 fewer than 1 bin; -20309 flat signal, for a histogram;
 *                         -20310 fewer crossings or edges than wanted;
 *                         -20319 no period: not positive, or less than half a sample for an average;
 *                         -20326 a transition without duration has no slew rate;
 *                         -20318 the value is not finite;
 *                         and at any point -20311 without memory; -20327 when the system refuses a lock
 */
KRNUMER_API int32_t measurements_fetch(int32_t id, int32_t selector, const KrLevels* levels,
                                       const KrStateMethod* method, int32_t occurrence, double t0, double dt,
                                       const double* samples, int32_t count, double* result, KrMarkers* box);

/**
 * Lets a context forget what it has computed. To be called before another block of samples is measured.
 *
 * @param[in] id  context
 * @return        0; -20321 when it is unknown; -20327 when the system refuses a lock
 */
KRNUMER_API int32_t measurements_clear(int32_t id);

/**
 * Ends a context. A measurement that another thread is still taking with it comes to its end first.
 *
 * @param[in] id  context
 * @return        0; -20321 when it is unknown; -20327 when the system refuses a lock
 */
KRNUMER_API int32_t measurements_destroy(int32_t id);

#endif
