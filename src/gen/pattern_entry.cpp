#include "gen/generate.h"
#include "gen/pattern.h"
#include "krnumer/gen.h"

using namespace krnumer;

int32_t SinePtrn(KrHandle x, const int32_t* n, const double* amplitude, const double* phase, const double* cycles,
                 int32_t* err) {
    return Generate(x, n, err,
                    [=](double* y, int32_t size) { return SinePattern(y, size, *amplitude, *phase, *cycles); });
}

int32_t Square(KrHandle x, const int32_t* n, const double* amplitude, const double* duty, const double* cycles,
               int32_t* err) {
    ByReference call(err);
    Out<double> pattern(call, x);
    if (*n < 1) return call.Fail(kEmptyInput);
    // The checks do not stop: the later one has priority, and a refused size has it over both.
    int32_t status = kOk;
    if (*duty <= 0.0) status = kBadDuty;
    if (*n / 2 < *cycles || *cycles <= 0.0) status = kBadCycles;
    if (auto host = pattern.Resize(*n)) return call.HostFailure(host);
    if (status != kOk) return call.Fail(status);
    return call.Run([&] { return SquarePattern(pattern.data(), *n, *amplitude, *duty, *cycles); });
}

int32_t ImpulsePtrn(KrHandle x, const int32_t* n, const double* amplitude, const int32_t* delay, int32_t* err) {
    return Generate(x, n, err, [=](double* y, int32_t size) { return ImpulsePattern(y, size, *amplitude, *delay); });
}

int32_t PulsePtrn(KrHandle x, const int32_t* n, const double* amplitude, const int32_t* delay, const int32_t* width,
                  int32_t* err) {
    return Generate(x, n, err,
                    [=](double* y, int32_t size) { return PulsePattern(y, size, *amplitude, *delay, *width); });
}

int32_t SincWave(KrHandle x, const int32_t* n, const double* amplitude, const double* delay, const double* dt,
                 int32_t* err) {
    return Generate(x, n, err, [=](double* y, int32_t size) { return SincPattern(y, size, *amplitude, *delay, *dt); });
}

int32_t RampPtrn80(KrHandle x, int32_t n, double start, double end, int32_t option) {
    ByValue call;
    Out<double> ramp(call, x);
    if (option == 0 && n < 2 && !(n == 1 && start == end)) return call.Fail(kFewerThanTwo);
    if (n < 1) return call.Fail(kNoSample);
    if (ramp.Resize(n)) return call.Fail(kOutOfMemory);
    return call.Run([&] { return RampPattern(ramp.data(), n, start, end, option); });
}

int32_t RampPtrn(KrHandle x, const int32_t* n, const double* start, const double* end, int32_t* err) {
    return ByReference(err).Leave(RampPtrn80(x, *n, *start, *end, 0));
}
