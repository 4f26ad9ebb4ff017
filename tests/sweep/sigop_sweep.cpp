#include "krnumer/sigop.h"

#include <vector>

#include "sweep/sweep.h"

namespace {

using krnumer::Complex;
using sweep::Scene;

const std::vector<double> kReal{1, -2, 3.5, 4, -5, 0.5, 7};
const std::vector<double> kKernel{0.5, -1, 2};
const std::vector<Complex> kComplex{{1, -1}, {2, 0}, {3, 1}, {4, 4}, {5, -2}, {6, 0}};
const std::vector<Complex> kComplexKernel{{0.5, 1}, {-1, 0}, {2, -3}};

constexpr int32_t kDirect = 0;
constexpr int32_t kFrequencyDomain = 1;

}  // namespace

namespace {

int32_t PlayConvolution(Scene& scene, int32_t algorithm) {
    const KrHandle x = scene.Doubles(kReal);
    const KrHandle y = scene.Doubles(kKernel);
    const KrHandle z = scene.OutDoubles();
    return scene.Call(Convolution, x, y, z, &algorithm, scene.err());
}

int32_t PlayComplexConvolution(Scene& scene, int32_t algorithm, int32_t correlate) {
    const KrHandle x = scene.Complexes(kComplex);
    const KrHandle y = scene.Complexes(kComplexKernel);
    const KrHandle z = scene.OutComplexes();
    return scene.Call(CxConvolution, x, y, z, algorithm, correlate, 1);
}

int32_t PlayCorrelation(Scene& scene, int32_t algorithm, const std::vector<double>& second) {
    const KrHandle x = scene.Doubles(kReal);
    const KrHandle y = second.empty() ? x : scene.Doubles(second);
    const KrHandle z = scene.OutDoubles();
    return scene.Call(Rxy80, x, y, z, &algorithm, 2, scene.err());
}

// A failure while computing leaves the dimensions.
int32_t PlayPlanes(Scene& scene, int32_t part, int32_t algorithm) {
    const KrHandle x = scene.Matrix(3, 3, {1, 2, 3, 4, -5, 6, 7, 8, 9});
    const KrHandle y = scene.Matrix(2, 2, {1, -1, 2, 0.5});
    const KrHandle z = scene.OutMatrix(sweep::OnFailure::kOther);
    return scene.Call(Convolve_2DH, x, y, z, part, algorithm);
}

int32_t PlayComplexPlanes(Scene& scene, int32_t part, int32_t algorithm) {
    const KrHandle x = scene.ComplexMatrix(3, 2, {{1, 2}, {3, 4}, {-5, 6}, {7, 8}, {9, 0}, {2, -3}});
    const KrHandle y = scene.ComplexMatrix(2, 1, {{1, -1}, {2, 0.5}});
    const KrHandle z = scene.OutComplexMatrix(sweep::OnFailure::kOther);
    return scene.Call(CxConvolve_2DH, x, y, z, part, algorithm);
}

}  // namespace

SWEEP(Convolution) {
    return PlayConvolution(scene, kFrequencyDomain);
}
SWEEP_MORE(Convolution, direct) {
    return PlayConvolution(scene, kDirect);
}
SWEEP(CxConvolution) {
    return PlayComplexConvolution(scene, kFrequencyDomain, 0);
}
SWEEP_MORE(CxConvolution, direct) {
    return PlayComplexConvolution(scene, kDirect, 0);
}
SWEEP_MORE(CxConvolution, correlation) {
    return PlayComplexConvolution(scene, kFrequencyDomain, 1);
}
SWEEP(Rxy) {
    const KrHandle x = scene.Doubles(kReal);
    const KrHandle y = scene.Doubles(kKernel);
    const KrHandle z = scene.OutDoubles();
    return scene.Call(Rxy, x, y, z, &kFrequencyDomain, scene.err());
}
SWEEP(Rxy80) {
    return PlayCorrelation(scene, kFrequencyDomain, kKernel);
}
SWEEP_MORE(Rxy80, direct) {
    return PlayCorrelation(scene, kDirect, kKernel);
}
SWEEP_MORE(Rxy80, with_itself) {
    return PlayCorrelation(scene, kFrequencyDomain, {});
}
SWEEP(AutoCorrelation) {
    const KrHandle x = scene.Replaced(scene.Doubles(kReal));
    return scene.Call(AutoCorrelation, x, scene.err());
}
SWEEP(AutoCorrelation80) {
    const KrHandle x = scene.Replaced(scene.Doubles(kReal));
    return scene.Call(AutoCorrelation80, x, 1, scene.err());
}
SWEEP(Deconvolution) {
    const KrHandle x = scene.Replaced(scene.Doubles(kReal));
    const KrHandle y = scene.Doubles(kKernel);
    scene.SurvivesRefusedAllocation();  // the tables of the transform
    return scene.Call(Deconvolution, x, y, scene.err());
}
SWEEP(Convolve_2DH) {
    return PlayPlanes(scene, 0, kFrequencyDomain);
}
SWEEP_MORE(Convolve_2DH, direct_valid) {
    return PlayPlanes(scene, 2, kDirect);
}
SWEEP(CxConvolve_2DH) {
    return PlayComplexPlanes(scene, 1, kFrequencyDomain);
}
SWEEP_MORE(CxConvolve_2DH, direct_valid) {
    return PlayComplexPlanes(scene, 2, kDirect);
}
SWEEP(Correlation_2DH) {
    const KrHandle x = scene.Matrix(2, 3, {1, 2, 3, 4, -5, 6});
    const KrHandle y = scene.Matrix(2, 2, {1, -1, 2, 0.5});
    const KrHandle z = scene.OutMatrix();
    return scene.Call(Correlation_2DH, x, y, z, kFrequencyDomain);
}
SWEEP(CxCorrelation_2DH) {
    const KrHandle x = scene.ComplexMatrix(2, 2, {{1, 2}, {3, 4}, {-5, 6}, {7, 8}});
    const KrHandle y = scene.ComplexMatrix(1, 2, {{1, -1}, {2, 0.5}});
    const KrHandle z = scene.OutComplexMatrix();
    return scene.Call(CxCorrelation_2DH, x, y, z, kDirect);
}

SWEEP(Derivative) {
    const KrHandle x = scene.Replaced(scene.Doubles(kReal));
    const double initial = 1, final = 2, dt = 0.5;
    return scene.Call(Derivative, x, &initial, &final, &dt, scene.err());
}
SWEEP(Integral) {
    const KrHandle x = scene.Replaced(scene.Doubles(kReal));
    const double initial = 1, final = 2, dt = 0.5;
    return scene.Call(Integral, x, &initial, &final, &dt, scene.err());
}
SWEEP(unWrap) {
    const KrHandle x = scene.Replaced(scene.Doubles({0, 4, 8, 1}));
    return scene.Call(unWrap, x, scene.err());
}
SWEEP(Triggerh) {
    const KrHandle x = scene.Matrix(2, 4, {0, 2, 0, 2, 3, 0, 3, 0});
    const KrHandle levels = scene.Doubles({1, 1}), previous = scene.Doubles({0, 0});
    const KrHandle hysteresis = scene.Doubles({0.5, 0.5}), slopes = scene.Integers({1, 0});
    const KrHandle found = scene.OutIntegers(), counts = scene.OutIntegers(), flags = scene.OutIntegers();
    const KrHandle last = scene.OutDoubles();
    return scene.Call(Triggerh, x, levels, previous, hysteresis, slopes, 2, found, counts, flags, last, scene.err());
}
// Begins above the middle, so that it is mirrored; a failure makes the measures 0.
SWEEP(PulseParameters) {
    const KrHandle x = scene.Doubles({5, 5, 5, 1, 0, 0, 2, 5, 5});
    double* m = scene.Numbers(10, sweep::OnFailure::kOther);
    return scene.Call(PulseParameters, x, m, m + 1, m + 2, m + 3, m + 4, m + 5, m + 6, m + 7, m + 8, m + 9,
                      scene.err());
}
SWEEP(FreqMod) {
    double* state = scene.Numbers(6, sweep::OnFailure::kOther);
    return scene.Call([&] { return FreqMod(3, 1.0, state, 0.1, state + 1, state + 4, state + 5); });
}
SWEEP(PhasMod) {
    double* state = scene.Numbers(6, sweep::OnFailure::kOther);
    return scene.Call([&] { return PhasMod(3, 1.0, state, 0.1, state + 1, state + 4, state + 5); });
}

SWEEP(DecimateCIN) {
    const KrHandle x = scene.Replaced(scene.Doubles(kReal));
    const int32_t factor = 2;
    const uint8_t averaging = 1;
    return scene.Call(DecimateCIN, x, &factor, &averaging, scene.err());
}
SWEEP(CxDecimate_H) {
    const KrHandle x = scene.Replaced(scene.Complexes(kComplex));
    return scene.Call(CxDecimate_H, x, 2, 0);
}
SWEEP(DecimateContinuous_H) {
    const KrHandle x = scene.Replaced(scene.Doubles(kReal));
    int32_t* start = scene.Integer(0);
    int32_t* count = scene.Integer(0);
    double* sum = scene.State(0);
    return scene.Call(DecimateContinuous_H, x, 3, 1, start, 1, count, sum);
}
SWEEP(CxDecimateContinuous_H) {
    const KrHandle x = scene.Replaced(scene.Complexes(kComplex));
    int32_t* start = scene.Integer(1);
    int32_t* count = scene.Integer(0);
    auto* sum = scene.ComplexNumber(sweep::OnFailure::kOther);
    return scene.Call(CxDecimateContinuous_H, x, 2, 1, start, 1, count, sum);
}

namespace {

template <class Export>
int32_t PlayRational(Scene& scene, Export resample, KrHandle x, KrHandle history, KrHandle y) {
    const KrHandle filter = scene.Doubles({0.1, 0.2, 0.4, 0.2, 0.1});
    int32_t* start = scene.Integer(1);
    int32_t* count = scene.Integer(3);
    return scene.Call(resample, x, 3, 2, 1, start, filter, history, count, y);
}

}  // namespace

SWEEP(RationalResample_H) {
    const KrHandle x = scene.Doubles(kReal), history = scene.OutDoubles(), y = scene.OutDoubles();
    return PlayRational(scene, RationalResample_H, x, history, y);
}
SWEEP(CxRationalResample_H) {
    const KrHandle x = scene.Complexes(kComplex), history = scene.OutComplexes(), y = scene.OutComplexes();
    return PlayRational(scene, CxRationalResample_H, x, history, y);
}
SWEEP(RationalResampleMultiCh_H) {
    const KrHandle x = scene.Matrix(2, 3, {1, 2, 3, 4, 5, 6}), history = scene.OutMatrix(), y = scene.OutMatrix();
    return PlayRational(scene, RationalResampleMultiCh_H, x, history, y);
}
SWEEP(CxRationalResampleMCh_H) {
    const KrHandle x = scene.ComplexMatrix(2, 2, {{1, 2}, {3, 4}, {5, 6}, {7, 8}});
    const KrHandle history = scene.OutComplexMatrix(), y = scene.OutComplexMatrix();
    return PlayRational(scene, CxRationalResampleMCh_H, x, history, y);
}

namespace {

const std::vector<double> kTable{0, 0.5, 1, 0.5, 0};

// The state's arrays stay with the caller, whatever happens.
template <class Export>
int32_t PlayConstant(Scene& scene, Export resample, KrHandle x, KrHandle history, KrHandle y) {
    KrResampleState state{};
    state.history = history;
    state.taps = scene.OutDoubles(sweep::OnFailure::kOther);
    const KrResampleSpec spec{0.75, 0, 0.5, scene.Doubles(kTable), 2};
    int32_t* count = scene.Integer(0);
    return scene.Call(resample, x, &state, &spec, 1, y, count, 1);
}

}  // namespace

SWEEP(Resample_Const) {
    const KrHandle x = scene.Doubles(kReal), history = scene.OutDoubles(sweep::OnFailure::kOther);
    return PlayConstant(scene, Resample_Const, x, history, scene.OutDoubles());
}
SWEEP(CxResample_Const) {
    const KrHandle x = scene.Complexes(kComplex), history = scene.OutComplexes(sweep::OnFailure::kOther);
    return PlayConstant(scene, CxResample_Const, x, history, scene.OutComplexes());
}
SWEEP(Resample_Variable) {
    const KrHandle x = scene.Doubles(kReal), times = scene.Replaced(scene.Doubles({0.5, 1.75, 3, 9}));
    const KrVariableResampleSpec spec{0, 1, scene.Doubles(kTable), 2};
    double* last_time = scene.State(-0.5);
    int32_t *count = scene.Integer(0), *consumed = scene.Integer(0);
    return scene.Call(Resample_Variable, x, times, &spec, last_time, count, consumed);
}
SWEEP(CxResample_Variable) {
    const KrHandle x = scene.Complexes(kComplex), times = scene.Replaced(scene.Doubles({0.5, 1.75, 3, 9}));
    const KrHandle y = scene.OutComplexes();
    const KrVariableResampleSpec spec{1, 0, scene.Doubles(kTable), 2};
    double* last_time = scene.State(-0.5);
    int32_t *count = scene.Integer(0), *consumed = scene.Integer(0);
    return scene.Call(CxResample_Variable, x, times, &spec, y, last_time, count, consumed);
}
