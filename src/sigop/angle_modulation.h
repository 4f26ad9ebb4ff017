// Frequency and phase modulation of a sine carrier, block by block.
#pragma once

#include <cstdint>

namespace krnumer {

// A modulator between two blocks. The angle of the carrier is c times the phase.
struct AngleModulator {
    double phase;
    double peak;  // largest message so far: replaced by a sample whose integer part is larger in magnitude
};

// Replaces n samples of a message by the carrier that it modulates in frequency: the phase advances by 2 pi (f + x[i])
// and is then moved by its period 2 pi / c, down if it has reached it and up otherwise. Gives the last angle in
// degrees.
double ModulateFrequency(double* x, int32_t n, double c, double f, AngleModulator* modulator);

// The same, in phase: the phase advances by 2 pi f, and x[i] degrees are added to the angle. Gives the last angle in
// degrees plus the last sample of the output.
double ModulatePhase(double* x, int32_t n, double c, double f, AngleModulator* modulator);

}  // namespace krnumer
