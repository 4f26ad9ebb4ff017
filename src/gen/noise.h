// Noise of n samples (at least 1) from the caller's random state. A positive seed starts the state's sequence anew,
// any other lets it go on; block after block then gives what one call would.
#pragma once

#include <cstdint>

#include "gen/random.h"

namespace krnumer {

// The method that draws normal deviates makes two at a time; this keeps the second.
struct GaussSpare {
    int32_t have_spare;
    double spare;
};

// What binomial noise works out of its parameters, kept from call to call.
struct BinomialCache {
    double last_p, last_q;  // the probability, at most 1/2, and 1 less it
    double log_p, log_q;
    double trials;
    double log_gamma_trials;  // ln Gamma(trials + 1)
    int32_t last_trials;
};

// Uniform in -amplitude to amplitude.
int32_t WhiteNoise(double* y, int32_t n, double amplitude, int32_t seed, RandomState& state);

// Normal with standard deviation sigma, by the polar method of G. Marsaglia and T. A. Bray (SIAM Rev. 6, 260, 1964). A
// seed of 0 or more drops the spare.
int32_t GaussianNoise(double* y, int32_t n, double sigma, int32_t seed, RandomState& state, GaussSpare& spare);

// Periodic in n: all lines of the spectrum but the mean and the highest have the height `amplitude` and a random phase.
int32_t PeriodicNoise(double* y, int32_t n, double amplitude, int32_t seed, RandomState& state);

// Successes among `trials` draws of probability p. Few trials are counted one by one; a mean below 1 takes the Poisson
// limit; the rest is rejection from a Lorentzian (W. H. Press et al., Numerical Recipes, 1986, 7.3).
int32_t BinomialNoise(uint32_t* y, int32_t n, int32_t trials, double p, int32_t seed, RandomState& state,
                      BinomialCache& cache);

// Waiting time for `order` events of unit rate: the logarithm of a product below order 6, rejection from a Lorentzian
// above (J. H. Ahrens and U. Dieter, Computing 12, 223, 1974).
int32_t GammaNoise(double* y, int32_t n, int32_t order, int32_t seed, RandomState& state);

// Number of events where `mean` are expected: a product of uniforms below 12, rejection from a Lorentzian above.
int32_t PoissonNoise(double* y, int32_t n, double mean, int32_t seed, RandomState& state);

}  // namespace krnumer
