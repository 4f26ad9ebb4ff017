/* A lowpass of 50 Hz at work on tones of 10 and 200 Hz, which come in blocks. */
#include <math.h>
#include "arrays.h"

int main(void) {
    KrHandle a = Empty(), b = Empty(), state = Empty(), x = Empty();
    const double fs = 1000.0, cutoff = 50.0, unused = 0.0, amplitude = sqrt(2.0);
    const int32_t order = 4, lowpass = 0, sections = 0, n = 500;
    int32_t err;

    BWCoefs(&fs, &cutoff, &unused, &order, &lowpass, a, b, &err), Check(err);
    printf("%d sections\n", (int)(KrrtSize(a, 0) / 2));
    for (int tone = 0; tone < 2; ++tone) {
        const double hertz = tone == 0 ? 10.0 : 200.0, frequency = hertz / fs;
        double phase = 0.0;
        for (uint8_t goOn = 0; goOn < 2; ++goOn) {
            double rms;
            SineWaveCIN(x, &n, &amplitude, &frequency, &phase, &err), Check(err);
            IIR_Filter2(x, &sections, a, b, state, &goOn, &err), Check(err);
            RMS_head(x, &rms, &err), Check(err);
            printf("%5.0f Hz, %s block: %.4f\n", hertz, goOn ? "second" : "first", rms);
        }
    }
    FREE(a, b, state, x);
    return 0;
}
