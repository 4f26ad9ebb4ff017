#include "frame/entry.h"
#include "gen/pulse_shape.h"
#include "krnumer/gen.h"

using namespace krnumer;

namespace {

// Has core(time, samples, n, delay, dt) fill the array. An array that holds elements is taken for an axis of time, on
// which delay and interval are 0; the cores refuse that interval, so samples come out of an empty array only.
template <class Core>
int32_t PulseShape(KrHandle x, int32_t n, double delay, double dt, Core core) {
    ByValue call;
    InOut<double> samples(call, x);
    if (samples.size() > 0)
        return call.Run([&] { return core(samples.data(), samples.data(), samples.size(), 0.0, 0.0); });
    if (n < 1) return call.Fail(kEmptyInput);
    if (auto host = samples.Resize(n)) return call.HostFailure(host);
    return call.Run([&] { return core(nullptr, samples.data(), n, delay, dt); });
}

}  // namespace

int32_t AperiodTriangleH(KrHandle x, int32_t n, double amplitude, double delay, double dt, double width, double skew) {
    return PulseShape(x, n, delay, dt, [=](const double* time, double* y, int32_t size, double t0, double step) {
        return AperiodicTriangle(time, y, size, amplitude, t0, step, width, skew);
    });
}

int32_t GaussMonopulseH(KrHandle x, int32_t n, double dt, double delay, double fc, double amplitude) {
    return PulseShape(x, n, delay, dt, [=](const double* time, double* y, int32_t size, double t0, double step) {
        return GaussianMonopulse(time, y, size, step, t0, fc, amplitude);
    });
}

int32_t GaussPulseH(KrHandle x, int32_t n, double amplitude, double delay, double dt, double fc, double bandwidth,
                    double attenuation) {
    return PulseShape(x, n, delay, dt, [=](const double* time, double* y, int32_t size, double t0, double step) {
        return GaussianPulse(time, y, size, amplitude, t0, step, fc, bandwidth, attenuation);
    });
}

int32_t PeriodicSincH(KrHandle x, int32_t n, double amplitude, int32_t order, double dt, double delay) {
    return PulseShape(x, n, delay, dt, [=](const double* time, double* y, int32_t size, double t0, double step) {
        return PeriodicSinc(time, y, size, amplitude, order, step, t0);
    });
}
