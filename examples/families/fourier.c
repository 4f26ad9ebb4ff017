/* The spectrum of a cosine of three cycles upon a constant, and the way back. */
#include <math.h>
#include "arrays.h"

int main(void) {
    enum { n = 12 };
    KrHandle x = KrrtNewArray(KRRT_DOUBLE, n), spectrum = KrrtNewArray(KRRT_COMPLEX, 0), back = Empty();
    void *forward = NULL, *inverse = NULL;
    for (int i = 0; i < n; ++i) Elements(x)[i] = 2.0 + cos(2.0 * acos(-1.0) * 3.0 * i / n);

    Check(ReQMFFTH(x, spectrum, &forward));
    const KrComplex* lines = (const KrComplex*)KrrtElements(spectrum);
    for (int k = 0; k < n; ++k) {
        const double magnitude = hypot(lines[k].re, lines[k].im);
        if (magnitude > 1e-9) printf("line %d: %.4f\n", k, magnitude / n);
    }
    Check(InvReQMFFTH(spectrum, back, &inverse));
    double error = 0.0;
    for (int i = 0; i < n; ++i) error = fmax(error, fabs(Elements(back)[i] - Elements(x)[i]));
    printf("back within 1e-14: %s\n", error < 1e-14 ? "yes" : "no");
    FREE(x, spectrum, back);
    return 0;
}
