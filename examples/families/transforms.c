/* The frequency of a short tone, from the lines of its spectrum and between them; a smooth curve in a few cosines. */
#include <math.h>
#include "arrays.h"

int main(void) {
    enum { n = 64, points = 31 };
    const double turn = 2.0 * acos(-1.0);
    KrHandle x = KrrtNewArray(KRRT_DOUBLE, n), spectrum = KrrtNewArray(KRRT_DOUBLE, n);
    KrHandle zoom = KrrtNewArray(KRRT_COMPLEX, 0), cosines = Empty();
    void *lines = NULL, *table = NULL;
    for (int i = 0; i < n; ++i) Elements(x)[i] = Elements(spectrum)[i] = cos(turn * 0.1235 * i);

    Check(SpectrumH(spectrum, &lines));
    int highest = 1;
    for (int k = 1; k < n / 2; ++k)
        if (Elements(spectrum)[k] > Elements(spectrum)[highest]) highest = k;
    printf("highest line: %.4f cycles per sample\n", (double)highest / n);

    const double first = 0.11, step = 0.0005;
    const KrComplex start = {cos(turn * first), sin(turn * first)}, ratio = {cos(turn * step), -sin(turn * step)};
    Check(ChirpZT_head(x, &start, &ratio, points, 1, zoom));
    const KrComplex* z = (const KrComplex*)KrrtElements(zoom);
    highest = 0;
    for (int k = 1; k < points; ++k)
        if (hypot(z[k].re, z[k].im) > hypot(z[highest].re, z[highest].im)) highest = k;
    printf("highest point of the zoom: %.4f\n", first + highest * step);

    for (int i = 0; i < n; ++i) Elements(x)[i] = (i + 0.5) * (n - i - 0.5) / (n * n);
    Check(DCT_1DH(x, cosines, 0, &table));
    printf("cosines of a parabola: %.4f %.4f %.4f\n", Elements(cosines)[0], Elements(cosines)[2], Elements(cosines)[4]);
    FREE(x, spectrum, zoom, cosines);
    return 0;
}
