#include "krnumer/gen.h"

#include "sweep/sweep.h"

namespace {

constexpr int32_t kSamples = 7;
constexpr double kAmplitude = 2.0;
constexpr double kFrequency = 0.11;

// The waves whose arguments are those of the sine.
template <class Wave>
int32_t PlayWave(sweep::Scene& scene, Wave wave) {
    const KrHandle x = scene.OutDoubles();
    double* phase = scene.State(30.0);
    return scene.Call(wave, x, &kSamples, &kAmplitude, &kFrequency, phase, scene.err());
}

}  // namespace

SWEEP(SineWaveCIN) {
    return PlayWave(scene, SineWaveCIN);
}
SWEEP(SawtoothWaveCIN) {
    return PlayWave(scene, SawtoothWaveCIN);
}
SWEEP(TriangleWaveCIN) {
    return PlayWave(scene, TriangleWaveCIN);
}

SWEEP(SquareWaveCIN) {
    const KrHandle x = scene.OutDoubles();
    double* phase = scene.State(30.0);
    const double duty = 40.0;
    return scene.Call(SquareWaveCIN, x, &kSamples, &kAmplitude, &kFrequency, phase, &duty, scene.err());
}

SWEEP(ArbitraryWaveCIN) {
    const KrHandle x = scene.OutDoubles();
    double* phase = scene.State(30.0);
    const KrHandle table = scene.Doubles({0, 3, 1});
    const int32_t linear = 1;
    return scene.Call(ArbitraryWaveCIN, x, &kSamples, &kAmplitude, &kFrequency, phase, table, &linear, scene.err());
}

SWEEP(ChirpCIN) {
    const KrHandle x = scene.OutDoubles();
    const double f2 = 0.4;
    return scene.Call(ChirpCIN, x, &kSamples, &kAmplitude, &kFrequency, &f2, scene.err());
}

SWEEP(SinePtrn) {
    const KrHandle x = scene.OutDoubles();
    const double phase = 30.0;
    const double cycles = 2.5;
    return scene.Call(SinePtrn, x, &kSamples, &kAmplitude, &phase, &cycles, scene.err());
}

SWEEP(Square) {
    const KrHandle x = scene.OutDoubles();
    const double duty = 40.0;
    const double cycles = 2.5;
    return scene.Call(Square, x, &kSamples, &kAmplitude, &duty, &cycles, scene.err());
}

SWEEP(ImpulsePtrn) {
    const KrHandle x = scene.OutDoubles();
    const int32_t delay = 2;
    return scene.Call(ImpulsePtrn, x, &kSamples, &kAmplitude, &delay, scene.err());
}

SWEEP(PulsePtrn) {
    const KrHandle x = scene.OutDoubles();
    const int32_t delay = 2;
    const int32_t width = 3;
    return scene.Call(PulsePtrn, x, &kSamples, &kAmplitude, &delay, &width, scene.err());
}

SWEEP(SincWave) {
    const KrHandle x = scene.OutDoubles();
    const double delay = 0.5;
    const double dt = 0.25;
    return scene.Call(SincWave, x, &kSamples, &kAmplitude, &delay, &dt, scene.err());
}

SWEEP(RampPtrn) {
    const KrHandle x = scene.OutDoubles();
    const double start = 1.0;
    const double end = 4.0;
    return scene.Call(RampPtrn, x, &kSamples, &start, &end, scene.err());
}

SWEEP(RampPtrn80) {
    const KrHandle x = scene.OutDoubles();
    return scene.Call(RampPtrn80, x, kSamples, 1.0, 4.0, 1);
}

SWEEP(AperiodTriangleH) {
    const KrHandle x = scene.Replaced(scene.Doubles({}));
    return scene.Call(AperiodTriangleH, x, kSamples, kAmplitude, 0.5, 0.25, 1.0, 0.3);
}

SWEEP(GaussMonopulseH) {
    const KrHandle x = scene.Replaced(scene.Doubles({}));
    return scene.Call(GaussMonopulseH, x, kSamples, 0.25, 0.5, 1.0, kAmplitude);
}

SWEEP(GaussPulseH) {
    const KrHandle x = scene.Replaced(scene.Doubles({}));
    return scene.Call(GaussPulseH, x, kSamples, kAmplitude, 0.5, 0.25, 1.0, 0.5, 6.0);
}

SWEEP(PeriodicSincH) {
    const KrHandle x = scene.Replaced(scene.Doubles({}));
    return scene.Call(PeriodicSincH, x, kSamples, kAmplitude, 5, 0.25, 0.5);
}
