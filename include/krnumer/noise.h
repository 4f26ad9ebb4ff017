/*
 * Noise and shuffles from a random state that the caller owns.
 *
 * The generator is that of B. A. Wichmann and I. D. Hill (Algorithm AS 183, Appl. Statist. 31, 188, 1982). A positive
 * `seed` starts its sequence anew, any other lets the state go on: blocks made one after the other with a seed of -1
 * are what one call would have made. A state that was never seeded holds whatever the caller left in it; one that is
 * all 0 stays there and gives 0 in every draw. Two calls at once must not share a state. Calls that fail in their
 * checks, or because the host refuses a size, leave all records as they are.
 */
#ifndef KRNUMER_NOISE_H
#define KRNUMER_NOISE_H

#include <krnumer/types.h>

#pragma pack(push, 1)

/** State of the generator; 12 bytes. */
typedef struct KrRandomState {
    int32_t s1; /**< modulo 30269; negative after a seed that overflows */
    int32_t s2; /**< modulo 30307 */
    int32_t s3; /**< modulo 30323 */
} KrRandomState;

/** The second of two normal deviates, kept for the next sample; 12 bytes. */
typedef struct KrGaussSpare {
    int32_t haveSpare; /**< 0: there is none */
    double spare;      /**< the deviate, before the factor sigma */
} KrGaussSpare;

/** What binomial noise works out of its parameters; 52 bytes, all 0 in the beginning. */
typedef struct KrBinomialCache {
    double lastP;          /**< probability, at most 1/2, of the last call */
    double lastQ;          /**< 1 - lastP */
    double logP;           /**< ln lastP */
    double logQ;           /**< ln lastQ */
    double trials;         /**< trials of the last call */
    double logGammaTrials; /**< ln Gamma(trials + 1) */
    int32_t lastTrials;    /**< trials again; the cache is used while this and lastP agree with the call */
} KrBinomialCache;

#pragma pack(pop)

/**
 * White noise, uniform in -amplitude to amplitude.
 *
 * @param[out]    x          samples, 1-D double; emptied on failure
 * @param[in]     n          number of samples, from 1 on
 * @param[in]     amplitude  bound of the samples
 * @param[in]     seed       above 0 starts the sequence anew
 * @param[out]    err        status: 0; -20003 when `n` is less than 1; -20001 when `x` cannot be sized
 * @param[in,out] state      random state
 * @return                   0, or the host's status when `x` cannot be sized
 */
KRNUMER_API int32_t white(KrHandle x, const int32_t* n, const double* amplitude, const int32_t* seed, int32_t* err,
                          KrRandomState* state);

/**
 * Gaussian noise of mean 0, by the polar method of G. Marsaglia and T. A. Bray (SIAM Rev. 6, 260, 1964).
 *
 * Deviates are drawn in pairs; the second of a pair waits in `spare` for the next sample, across calls too.
 *
 * @param[out]    x      samples, 1-D double; emptied on failure
 * @param[in]     n      number of samples, from 1 on
 * @param[in]     sigma  standard deviation
 * @param[in]     seed   above 0 starts the sequence anew; from 0 on drops the spare
 * @param[out]    err    status: 0; -20003 when `n` is less than 1; -20001 when `x` cannot be sized; -20062 when a
 *                       million draws give no sample, which takes a state that is stuck
 * @param[in,out] state  random state
 * @param[in,out] spare  deviate left over
 * @return               0, or the host's status when `x` cannot be sized
 */
KRNUMER_API int32_t Gauss(KrHandle x, const int32_t* n, const double* sigma, const int32_t* seed, int32_t* err,
                          KrRandomState* state, KrGaussSpare* spare);

/**
 * Noise that is periodic in n: every line of the spectrum has the height `amplitude` and a random phase, but for the
 * mean and, for even n, the highest line, which are 0.
 *
 * @param[in]     n          number of samples, from 1 on
 * @param[in]     amplitude  amplitude of each line
 * @param[in]     seed       above 0 starts the sequence anew
 * @param[out]    x          samples, 1-D double; emptied on failure
 * @param[out]    err        status: 0; -20003 when `n` is less than 1; -20001 without memory or when `x` cannot be
 *                           sized
 * @param[in,out] state      random state
 * @return                   0, or the host's status when `x` cannot be sized
 */
KRNUMER_API int32_t PeriodNoise(const int32_t* n, const double* amplitude, const int32_t* seed, KrHandle x,
                                int32_t* err, KrRandomState* state);

/**
 * Binomial noise: successes among `trials` draws with probability p.
 *
 * Below 25 trials they are counted one by one, with fewer than one rare outcome expected the Poisson limit is taken,
 * and else candidates from a Lorentzian are rejected (W. H. Press et al., Numerical Recipes, 1986, 7.3).
 *
 * @param[out]    x       samples, 1-D uint32; emptied on failure
 * @param[in]     n       number of samples, from 1 on
 * @param[in]     trials  draws per sample, from 0 on
 * @param[in]     p       probability of success, 0 to 1
 * @param[in]     seed    above 0 starts the sequence anew
 * @param[in,out] state   random state
 * @param[in,out] cache   kept between calls
 * @return                0; -20061 when `trials` is negative or `p` outside 0 to 1 or NaN; -20003 when `n` is less than
 *                        1; -20001 when `x` cannot be sized; -20062 when a million draws give no sample
 */
KRNUMER_API int32_t BinomialNoiseH(KrHandle x, int32_t n, int32_t trials, double p, int32_t seed, KrRandomState* state,
                                   KrBinomialCache* cache);

/**
 * Gamma noise: the waiting time for `order` events of unit rate.
 *
 * Below order 6 the negative logarithm of a product of uniforms, else candidates from a Lorentzian are rejected
 * (J. H. Ahrens and U. Dieter, Computing 12, 223, 1974).
 *
 * @param[out]    x      samples, 1-D double; emptied on failure
 * @param[in]     n      number of samples, from 1 on
 * @param[in]     order  events to wait for, from 1 on
 * @param[in]     seed   above 0 starts the sequence anew
 * @param[in,out] state  random state
 * @return               0; -20061 when `order` is less than 1; -20003 when `n` is less than 1; -20001 when `x` cannot
 *                       be sized; -20062 when a million draws give no sample, which takes a state that is stuck
 */
KRNUMER_API int32_t GammaNoiseH(KrHandle x, int32_t n, int32_t order, int32_t seed, KrRandomState* state);

/**
 * Poisson noise: number of events where `mean` are expected.
 *
 * @param[out]    x      samples, 1-D double of whole numbers; emptied on failure
 * @param[in]     n      number of samples, from 1 on
 * @param[in]     mean   expected number, from 0 on; NaN gives NaN
 * @param[in]     seed   above 0 starts the sequence anew
 * @param[in,out] state  random state
 * @return               0; -20061 when `mean` is below 0; -20003 when `n` is less than 1; -20001 when `x` cannot be
 *                       sized; -20062 when a million draws give no sample
 */
KRNUMER_API int32_t PoissonNoiseH(KrHandle x, int32_t n, double mean, int32_t seed, KrRandomState* state);

/**
 * Shuffles an array of double. Each element in turn changes places with one drawn from the whole array, which does not
 * give all orders the same probability.
 *
 * @param[in,out] x        elements, 1-D double; emptied on failure
 * @param[out]    indices  where each element came from, 1-D int32; emptied on failure
 * @param[in]     seed     above 0 starts the sequence anew
 * @param[in,out] state    random state
 * @return                 0; -20003 when `x` is empty; -20001 when `indices` cannot be sized. A positive status of the
 *                         host counts as success where `indices` is long enough as it came
 */
KRNUMER_API int32_t RiffleArrayDBL_head(KrHandle x, KrHandle indices, int32_t seed, KrRandomState* state);

/** RiffleArrayDBL_head of an array of complex double. */
KRNUMER_API int32_t RiffleArrayCDB_head(KrHandle x, KrHandle indices, int32_t seed, KrRandomState* state);

/** RiffleArrayDBL_head of an array of int32. */
KRNUMER_API int32_t RiffleArrayInt_head(KrHandle x, KrHandle indices, int32_t seed, KrRandomState* state);

/**
 * Shuffles the numbers 0 to n - 1 in the manner of RiffleArrayDBL_head.
 *
 * @param[out]    x      the numbers, 1-D int32; emptied on failure
 * @param[in]     n      how many, from 1 on
 * @param[in]     seed   above 0 starts the sequence anew
 * @param[in,out] state  random state
 * @return               0; -20003 when `n` is less than 1; -20001 when `x` cannot be sized
 */
KRNUMER_API int32_t RiffleIntNum_head(KrHandle x, int32_t n, int32_t seed, KrRandomState* state);

#endif
