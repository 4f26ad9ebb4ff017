/* A sine in two blocks without a seam, a ramp, and noise that a seed repeats. */
#include "arrays.h"

int main(void) {
    KrHandle x = Empty();
    const int32_t n = 4;
    const double amplitude = 1.0, frequency = 0.125, start = 0.0, end = 1.5;
    double phase = 22.5;
    int32_t err;

    for (int block = 0; block < 2; ++block) {
        SineWaveCIN(x, &n, &amplitude, &frequency, &phase, &err), Check(err);
        Print("sine", x);
    }
    printf("phase of the next sample: %.1f degrees\n", phase);
    RampPtrn(x, &n, &start, &end, &err), Check(err);
    Print("ramp", x);

    KrRandomState state;
    for (int run = 0; run < 2; ++run) {
        const int32_t anew = 7, onward = -1;
        white(x, &n, &amplitude, run == 0 ? &anew : &onward, &err, &state), Check(err);
        Print(run == 0 ? "noise" : "more noise", x);
    }
    FREE(x);
    return 0;
}
