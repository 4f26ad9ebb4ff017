#include <algorithm>
#include <limits>

#include "frame/entry.h"
#include "krnumer/sigop.h"
#include "sigop/angle_modulation.h"
#include "sigop/calculus.h"
#include "sigop/pulse_parameters.h"
#include "sigop/trigger.h"
#include "sigop/unwrap.h"

using namespace krnumer;

namespace {

template <class Core, class... Parameters>
int32_t InPlace(KrHandle x, int32_t* err, Core core, Parameters... parameters) {
    ByReference call(err);
    InOut<double> samples(call, x);
    return call.Run([&] { return core(samples.data(), samples.size(), parameters...); });
}

template <class Core>
int32_t Modulate(int32_t n, double c, double* angle, double f, double* data, double* peak, double* phase, Core core) {
    AngleModulator modulator{*phase, *peak};
    const double last = core(data, n, c, f, &modulator);
    *peak = modulator.peak;
    *phase = modulator.phase;
    *angle = last;
    return kOk;
}

}  // namespace

int32_t Derivative(KrHandle x, const double* initial, const double* final, const double* dt, int32_t* err) {
    return InPlace(x, err, Differentiate, *initial, *final, *dt);
}

int32_t Integral(KrHandle x, const double* initial, const double* final, const double* dt, int32_t* err) {
    return InPlace(x, err, Integrate, *initial, *final, *dt);
}

int32_t unWrap(KrHandle x, int32_t* err) {
    return InPlace(x, err, UnwrapPhase);
}

int32_t Triggerh(KrHandle x, KrHandle levels, KrHandle previous, KrHandle hysteresis, KrHandle slopes,
                 int32_t maxPerRow, KrHandle found, KrHandle counts, KrHandle flags, KrHandle last, int32_t* err) {
    ByReference call(err);
    InMatrix<double> samples(call, x);
    In<double> level(call, levels);
    In<double> before(call, previous);
    In<double> width(call, hysteresis);
    In<int32_t> slope(call, slopes);
    Out<int32_t> indices(call, found);
    Out<int32_t> hits(call, counts);
    Out<int32_t> any(call, flags);
    Out<double> after(call, last);

    const int32_t channels = std::max(samples.rows(), 0);
    if (std::min({level.size(), before.size(), width.size(), slope.size()}) < channels) return call.Fail(kSizesDiffer);
    const int64_t slots = int64_t{channels} * std::max(maxPerRow, 0);
    if (slots > std::numeric_limits<int32_t>::max()) return call.Fail(kOutOfMemory);
    if (indices.Resize(static_cast<int32_t>(slots)) != 0 || hits.Resize(channels) != 0 || any.Resize(channels) != 0 ||
        after.Resize(channels) != 0) {
        return call.Fail(kOutOfMemory);
    }
    return call.Run([&] {
        FindTriggers(samples.data(), channels, samples.columns(),
                     {level.data(), before.data(), width.data(), slope.data(), maxPerRow},
                     {indices.data(), hits.data(), any.data(), after.data()});
        return kOk;
    });
}

int32_t PulseParameters(KrHandle x, double* top, double* base, double* amplitude, double* delay, double* width,
                        double* slewRate, double* fallTime, double* riseTime, double* overshoot, double* undershoot,
                        int32_t* err) {
    ByReference call(err);
    In<double> samples(call, x);
    PulseMeasures measures{};
    int32_t status = call.Map();
    if (status == kOk) status = MeasurePulse(samples.data(), samples.size(), &measures);
    *top = measures.top;
    *base = measures.base;
    *amplitude = measures.amplitude;
    *delay = measures.delay;
    *width = measures.width;
    *slewRate = measures.slew_rate;
    *fallTime = measures.fall_time;
    *riseTime = measures.rise_time;
    *overshoot = measures.overshoot;
    *undershoot = measures.undershoot;
    return call.Leave(status);
}

int32_t FreqMod(int32_t n, double c, double* angleOut, double f, double* data, double* peak, double* phase) {
    return Modulate(n, c, angleOut, f, data, peak, phase, ModulateFrequency);
}

int32_t PhasMod(int32_t n, double c, double* angleOut, double f, double* data, double* peak, double* phase) {
    return Modulate(n, c, angleOut, f, data, peak, phase, ModulatePhase);
}
