/* Makes a sine, takes its root mean square and counts how its values are spread. */
#include <krnumer/krnumer.h>
#include <krrt/krrt.h>
#include <stdio.h>

int main(void) {
    KrHandle samples = KrrtNewArray(KRRT_DOUBLE, 0);
    KrHandle histogram = KrrtNewArray(KRRT_INT32, 0);
    KrHandle centers = KrrtNewArray(KRRT_DOUBLE, 0);
    int32_t n = 1000, bins = 5, err;
    double amplitude = 2.0, frequency = 0.01, phase = 0.0, rms;

    SineWaveCIN(samples, &n, &amplitude, &frequency, &phase, &err);
    if (err == KRN_OK) RMS_head(samples, &rms, &err);
    if (err == KRN_OK) histgran_head(samples, &bins, histogram, centers, &err);
    if (err != KRN_OK) return 1;

    const int32_t* counts = (const int32_t*)KrrtElements(histogram);
    const double* middles = (const double*)KrrtElements(centers);
    printf("root mean square %.4f\n", rms);
    for (int32_t k = 0; k < bins; ++k) printf("%3d samples around %+.1f\n", counts[k], middles[k]);
    KrrtFree(centers);
    KrrtFree(histogram);
    KrrtFree(samples);
    return 0;
}
