/* The weights of a window, what windows cost in noise, and the amplitude of a tone between two lines of a spectrum. */
#include <math.h>
#include "arrays.h"

static double Amplitude(int32_t type) {
    KrHandle x = Empty();
    const int32_t n = 64;
    const double amplitude = 1.0, frequency = 10.4 / 64;
    double phase = 0.0, highest = 0.0;
    KrWindowConstants constants;
    void* slot = NULL;
    int32_t err;
    SineWaveCIN(x, &n, &amplitude, &frequency, &phase, &err), Check(err);
    Check(ScaledWinH(x, type, 0.0, &constants));
    Check(SpectrumH(x, &slot));
    for (int32_t k = 0; k < n; ++k) highest = fmax(highest, Elements(x)[k]);
    FREE(x);
    return 2.0 * sqrt(highest);
}

int main(void) {
    KrHandle weights = DOUBLES(1, 1, 1, 1, 1, 1, 1, 1);
    Check(AllCosWinH(weights, 1, 0));
    Print("Hann", weights);

    const struct {
        const char* name;
        int32_t type;
    } windows[] = {{"rectangle", 0}, {"Hann", 1}, {"flat top", 6}};
    for (int i = 0; i < 3; ++i) {
        KrWindowConstants constants;
        Check(ScaledWinH(weights, windows[i].type, 0.0, &constants));
        printf("%-9s noise bandwidth %.3f bins, gain %.3f, amplitude of the tone %.3f\n", windows[i].name,
               constants.enbw, constants.coherentGain, Amplitude(windows[i].type));
    }
    FREE(weights);
    return 0;
}
