/* The delay of an echo by correlation, a stream reduced by means, and a phase without jumps. */
#include "arrays.h"

int main(void) {
    KrHandle pulse = DOUBLES(1, 3, 2), echo = DOUBLES(0.1, 0.0, 0.2, 0.5, 1.6, 0.9, 0.1, 0.0), correlation = Empty();
    const int32_t direct = 0;
    int32_t err, best = 0;
    Rxy(pulse, echo, correlation, &direct, &err), Check(err);
    for (int32_t k = 1; k < KrrtSize(correlation, 0); ++k)
        if (Elements(correlation)[k] > Elements(correlation)[best]) best = k;
    printf("the echo comes %d samples late\n", (int)(best - (KrrtSize(pulse, 0) - 1)));

    int32_t start = 0, samples = 0;
    double sum = 0.0;
    KrHandle blocks[] = {DOUBLES(1, 2, 3, 4), DOUBLES(5, 6, 7, 8, 9)};
    for (int i = 0; i < 2; ++i) {
        Check(DecimateContinuous_H(blocks[i], 3, 1, &start, i == 0, &samples, &sum));
        Print("means of three", blocks[i]);
    }

    KrHandle phase = DOUBLES(3.0, -3.1, -2.9, 3.1);
    unWrap(phase, &err), Check(err);
    Print("phase", phase);
    FREE(pulse, echo, correlation, blocks[0], blocks[1], phase);
    return 0;
}
