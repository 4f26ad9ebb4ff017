#include "gen/generate.h"
#include "gen/wave.h"
#include "krnumer/gen.h"

using namespace krnumer;

int32_t SineWaveCIN(KrHandle x, const int32_t* n, const double* amplitude, const double* frequency, double* phase,
                    int32_t* err) {
    return Generate(x, n, err, [=](double* y, int32_t size) {  //
        return SineWave(y, size, *amplitude, *frequency, phase);
    });
}

int32_t SquareWaveCIN(KrHandle x, const int32_t* n, const double* amplitude, const double* frequency, double* phase,
                      const double* duty, int32_t* err) {
    return Generate(x, n, err,
                    [=](double* y, int32_t size) { return SquareWave(y, size, *amplitude, *frequency, phase, *duty); });
}

int32_t SawtoothWaveCIN(KrHandle x, const int32_t* n, const double* amplitude, const double* frequency, double* phase,
                        int32_t* err) {
    return Generate(x, n, err,
                    [=](double* y, int32_t size) { return SawtoothWave(y, size, *amplitude, *frequency, phase); });
}

int32_t TriangleWaveCIN(KrHandle x, const int32_t* n, const double* amplitude, const double* frequency, double* phase,
                        int32_t* err) {
    return Generate(x, n, err,
                    [=](double* y, int32_t size) { return TriangleWave(y, size, *amplitude, *frequency, phase); });
}

int32_t ArbitraryWaveCIN(KrHandle x, const int32_t* n, const double* amplitude, const double* frequency, double* phase,
                         KrHandle table, const int32_t* interpolation, int32_t* err) {
    ByReference call(err);
    Out<double> samples(call, x);
    In<double> period(call, table);
    if (*n < 1) return call.Fail(kEmptyInput);
    if (auto host = samples.Resize(*n)) return call.HostFailure(host);
    return call.Run([&] {
        return ArbitraryWave(samples.data(), *n, *amplitude, *frequency, phase, period.data(), period.size(),
                             *interpolation);
    });
}

int32_t ChirpCIN(KrHandle x, const int32_t* n, const double* amplitude, const double* f1, const double* f2,
                 int32_t* err) {
    return Generate(x, n, err, [=](double* y, int32_t size) { return Chirp(y, size, *amplitude, *f1, *f2); });
}
