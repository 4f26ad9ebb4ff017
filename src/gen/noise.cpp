#include "gen/noise.h"

#include <cmath>

#include "fft/fft.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "special/gamma.h"

namespace krnumer {

namespace {

// Uniform draws for one sample. A state can be stuck at 0, where a rejection loop would never end.
class Draws {
  public:
    explicit Draws(RandomState& state) : state_(state) {}

    double operator()() {
        --left_;
        return RandomUniform(state_);
    }
    bool exhausted() const { return left_ <= 0; }

  private:
    RandomState& state_;
    int32_t left_ = 1000000;
};

// Fills y with the samples that sample(draws) makes, each with its own budget of draws.
template <class T, class Sample>
int32_t Fill(T* y, int32_t n, RandomState& state, Sample sample) {
    for (int32_t i = 0; i < n; ++i) {
        Draws draws(state);
        y[i] = static_cast<T>(sample(draws));
        if (draws.exhausted()) return kNoConvergence;
    }
    return kOk;
}

// Multiplies uniforms until the product is no longer above `limit`; how many it took, less one.
double EventsWithin(double limit, Draws& draws) {
    double events = -1.0;
    double product = 1.0;
    do {
        events += 1.0;
        product *= draws();
    } while (product > limit && !draws.exhausted());
    return events;
}

// A whole number from a Lorentzian of the given center and half width, where in_range says it is one of the
// distribution's; `y` is the tangent that it came from.
template <class InRange>
double LorentzianCount(double center, double width, Draws& draws, InRange in_range, double* y) {
    double count;
    do {
        *y = std::tan(kPi * draws());
        count = width * *y + center;
    } while (!in_range(count) && !draws.exhausted());
    return std::floor(count);
}

double FewTrials(int32_t trials, double p, RandomState& state) {
    int32_t successes = 0;
    for (int32_t i = 0; i < trials; ++i) successes += RandomUniform(state) < p;
    return successes;
}

double RareSuccesses(int32_t trials, double mean, RandomState& state) {
    const double limit = std::exp(-mean);
    double product = 1.0;
    for (int32_t successes = 0; successes < trials; ++successes) {
        product *= RandomUniform(state);
        if (product < limit) return successes;
    }
    RandomUniform(state);  // the last draw is made, whatever it gives
    return trials;
}

double ManyTrials(double mean, const BinomialCache& cache, Draws& draws) {
    const double width = std::sqrt(2.0 * mean * cache.last_q);
    const auto in_range = [&](double count) { return !(count < 0.0 || count >= cache.trials + 1.0); };
    for (;;) {
        double y;
        const double count = LorentzianCount(mean, width, draws, in_range, &y);
        const double rest = cache.trials - count;
        const double accepted = 1.2 * width * (1.0 + y * y) *
                                std::exp(cache.log_gamma_trials - LnGamma(count + 1.0) - LnGamma(rest + 1.0) +
                                         count * cache.log_p + rest * cache.log_q);
        if (!(draws() > accepted) || draws.exhausted()) return count;
    }
}

double ManyEvents(double order, Draws& draws) {
    const double mode = order - 1.0;
    const double width = std::sqrt(2.0 * mode + 1.0);
    for (;;) {
        double v1;
        double v2;
        do {
            v1 = 2.0 * draws() - 1.0;
            v2 = 2.0 * draws() - 1.0;
        } while (v1 * v1 + v2 * v2 > 1.0 && !draws.exhausted());
        const double y = v2 / v1;
        const double x = width * y + mode;
        if (draws.exhausted()) return x;
        if (x <= 0.0) continue;
        const double accepted = (1.0 + y * y) * std::exp(mode * std::log(x / mode) - width * y);
        if (!(draws() > accepted)) return x;
    }
}

}  // namespace

int32_t WhiteNoise(double* y, int32_t n, double amplitude, int32_t seed, RandomState& state) {
    if (n < 1) return kEmptyInput;
    Seed(state, seed);
    const double range = 2.0 * amplitude;
    RandomState local = state;
    for (int32_t i = 0; i < n; ++i) y[i] = (RandomUniform(local) - 0.5) * range;
    state = local;
    return kOk;
}

int32_t GaussianNoise(double* y, int32_t n, double sigma, int32_t seed, RandomState& state, GaussSpare& spare) {
    if (n < 1) return kEmptyInput;
    Seed(state, seed);
    if (seed >= 0) spare = {};
    RandomState local = state;
    const int32_t status = Fill(y, n, local, [&](Draws& draws) {
        if (spare.have_spare != 0) {
            spare.have_spare = 0;
            return spare.spare * sigma;
        }
        double x1;
        double x2;
        double square;
        do {
            x1 = 2.0 * draws() - 1.0;
            x2 = 2.0 * draws() - 1.0;
            square = x1 * x1 + x2 * x2;
        } while ((square >= 1.0 || square == 0.0) && !draws.exhausted());
        const double factor = std::sqrt(-2.0 * std::log(square) / square);
        spare.spare = factor * x1;
        spare.have_spare = 1;
        return factor * x2 * sigma;
    });
    state = local;
    return status;
}

int32_t PeriodicNoise(double* y, int32_t n, double amplitude, int32_t seed, RandomState& state) {
    if (n < 1) return kEmptyInput;
    Scratch<double> spectrum(Count(n), Scratch<double>::kZeroed);
    if (!spectrum) return kOutOfMemory;
    Seed(state, seed);
    for (int32_t k = 1; k <= (n - 1) / 2; ++k) {
        const double phase = RandomInt15(state);  // whole radians spread evenly enough over the circle
        spectrum[Count(k)] = std::cos(phase) * n * amplitude * 0.5;
        spectrum[Count(n - k)] = std::sin(phase) * n * amplitude * 0.5;
    }
    if (n == 1) {
        y[0] = 0.0;
        return kOk;
    }
    const HeldTable table(n);
    if (!table) return kOutOfMemory;
    return InverseRealFFT(table.get(), spectrum.data(), y, 1, 1, n);
}

int32_t BinomialNoise(uint32_t* y, int32_t n, int32_t trials, double p, int32_t seed, RandomState& state,
                      BinomialCache& cache) {
    if (trials < 0 || !(p >= 0.0 && p <= 1.0)) return kBadSelector;
    if (n < 1) return kEmptyInput;
    constexpr int32_t kFewTrials = 25;
    Seed(state, seed);
    const double rarer = p <= 0.5 ? p : 1.0 - p;
    const double mean = trials * rarer;
    if (trials >= kFewTrials && mean >= 1.0) {
        if (cache.last_trials != trials) {
            cache.trials = trials;
            cache.log_gamma_trials = LnGamma(cache.trials + 1.0);
            cache.last_trials = trials;
        }
        if (cache.last_p != rarer) {
            cache.last_p = rarer;
            cache.last_q = 1.0 - rarer;
            cache.log_p = std::log(rarer);
            cache.log_q = std::log(cache.last_q);
        }
    }
    return Fill(y, n, state, [&](Draws& draws) {
        const double rare = trials < kFewTrials ? FewTrials(trials, rarer, state)
                            : mean < 1.0        ? RareSuccesses(trials, mean, state)
                                                : ManyTrials(mean, cache, draws);
        return SaturateToInt32(rarer != p ? trials - rare : rare);
    });
}

int32_t GammaNoise(double* y, int32_t n, int32_t order, int32_t seed, RandomState& state) {
    if (order < 1) return kBadSelector;
    if (n < 1) return kEmptyInput;
    constexpr int32_t kLeastForRejection = 6;
    Seed(state, seed);
    return Fill(y, n, state, [&](Draws& draws) {
        if (order >= kLeastForRejection) return ManyEvents(order, draws);
        double product = 1.0;
        for (int32_t i = 0; i < order; ++i) product *= draws();
        return -std::log(product);
    });
}

int32_t PoissonNoise(double* y, int32_t n, double mean, int32_t seed, RandomState& state) {
    if (mean < 0.0) return kBadSelector;
    if (n < 1) return kEmptyInput;
    constexpr double kLeastForRejection = 12.0;
    Seed(state, seed);
    if (mean < kLeastForRejection) {
        const double limit = std::exp(-mean);
        return Fill(y, n, state, [limit](Draws& draws) { return EventsWithin(limit, draws); });
    }
    const double width = std::sqrt(2.0 * mean);
    const double log_mean = std::log(mean);
    const double peak = mean * log_mean - LnGamma(mean + 1.0);
    return Fill(y, n, state, [&](Draws& draws) {
        for (;;) {
            double t;
            const double count = LorentzianCount(
                mean, width, draws, [](double candidate) { return !(candidate < 0.0); }, &t);
            const double accepted = 0.9 * (1.0 + t * t) * std::exp(count * log_mean - LnGamma(count + 1.0) - peak);
            if (!(draws() > accepted) || draws.exhausted()) return count;
        }
    });
}

}  // namespace krnumer
