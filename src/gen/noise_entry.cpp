#include "gen/generate.h"
#include "gen/noise.h"
#include "gen/riffle.h"
#include "krnumer/noise.h"

using namespace krnumer;

namespace {

// The caller's record, packed and at any address, as the core's own for as long as the core runs.
class State {
  public:
    explicit State(KrRandomState* record) : record_(record), state_{record->s1, record->s2, record->s3} {}
    State(const State&) = delete;
    State& operator=(const State&) = delete;
    ~State() { *record_ = {state_.s1, state_.s2, state_.s3}; }

    operator RandomState&() { return state_; }

  private:
    KrRandomState* record_;
    RandomState state_;
};

// The newer generators: parameters first, then the count, then the size.
template <class T, class Core>
int32_t GenerateNoise(KrHandle x, int32_t n, bool parameters_fit, KrRandomState* record, Core core) {
    ByValue call;
    Out<T> samples(call, x);
    if (!parameters_fit) return call.Fail(kBadSelector);
    if (n < 1) return call.Fail(kEmptyInput);
    if (samples.Resize(n)) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        State state(record);
        return core(samples.data(), state);
    });
}

template <class T>
int32_t RiffleArray(KrHandle x, KrHandle indices, int32_t seed, KrRandomState* record) {
    ByValue call;
    InOut<T> elements(call, x);
    Out<int32_t> origins(call, indices);
    const int32_t n = elements.size();
    if (n < 1) return call.Fail(kEmptyInput);
    const int32_t former = origins.size();
    if (const int32_t host = origins.Resize(n)) {
        // A positive status is no failure here as long as the elements have a place.
        if (host < 0 || former < n) return call.Fail(kOutOfMemory);
        origins.Declare(n);
    }
    return call.Run([&] {
        State state(record);
        return Riffle<T>(elements.data(), origins.data(), n, seed, state);
    });
}

}  // namespace

int32_t white(KrHandle x, const int32_t* n, const double* amplitude, const int32_t* seed, int32_t* err,
              KrRandomState* state) {
    return Generate(x, n, err, [=](double* y, int32_t size) {
        State current(state);
        return WhiteNoise(y, size, *amplitude, *seed, current);
    });
}

int32_t Gauss(KrHandle x, const int32_t* n, const double* sigma, const int32_t* seed, int32_t* err,
              KrRandomState* state, KrGaussSpare* spare) {
    return Generate(x, n, err, [=](double* y, int32_t size) {
        State current(state);
        GaussSpare kept{spare->haveSpare, spare->spare};
        const int32_t status = GaussianNoise(y, size, *sigma, *seed, current, kept);
        *spare = {kept.have_spare, kept.spare};
        return status;
    });
}

int32_t PeriodNoise(const int32_t* n, const double* amplitude, const int32_t* seed, KrHandle x, int32_t* err,
                    KrRandomState* state) {
    return Generate(x, n, err, [=](double* y, int32_t size) {
        State current(state);
        return PeriodicNoise(y, size, *amplitude, *seed, current);
    });
}

int32_t BinomialNoiseH(KrHandle x, int32_t n, int32_t trials, double p, int32_t seed, KrRandomState* state,
                       KrBinomialCache* cache) {
    const bool parameters_fit = trials >= 0 && p >= 0.0 && p <= 1.0;
    return GenerateNoise<uint32_t>(x, n, parameters_fit, state, [=](uint32_t* y, RandomState& current) {
        BinomialCache kept{cache->lastP,  cache->lastQ,          cache->logP,      cache->logQ,
                           cache->trials, cache->logGammaTrials, cache->lastTrials};
        const int32_t status = BinomialNoise(y, n, trials, p, seed, current, kept);
        *cache = {kept.last_p, kept.last_q,           kept.log_p,      kept.log_q,
                  kept.trials, kept.log_gamma_trials, kept.last_trials};
        return status;
    });
}

int32_t GammaNoiseH(KrHandle x, int32_t n, int32_t order, int32_t seed, KrRandomState* state) {
    return GenerateNoise<double>(x, n, order >= 1, state, [=](double* y, RandomState& current) {
        return GammaNoise(y, n, order, seed, current);
    });
}

int32_t PoissonNoiseH(KrHandle x, int32_t n, double mean, int32_t seed, KrRandomState* state) {
    return GenerateNoise<double>(x, n, !(mean < 0.0), state, [=](double* y, RandomState& current) {
        return PoissonNoise(y, n, mean, seed, current);
    });
}

int32_t RiffleArrayDBL_head(KrHandle x, KrHandle indices, int32_t seed, KrRandomState* state) {
    return RiffleArray<double>(x, indices, seed, state);
}
int32_t RiffleArrayCDB_head(KrHandle x, KrHandle indices, int32_t seed, KrRandomState* state) {
    return RiffleArray<Complex>(x, indices, seed, state);
}
int32_t RiffleArrayInt_head(KrHandle x, KrHandle indices, int32_t seed, KrRandomState* state) {
    return RiffleArray<int32_t>(x, indices, seed, state);
}

int32_t RiffleIntNum_head(KrHandle x, int32_t n, int32_t seed, KrRandomState* state) {
    return GenerateNoise<int32_t>(x, n, true, state, [=](int32_t* numbers, RandomState& current) {
        return RiffleNumbers(numbers, n, seed, current);
    });
}
