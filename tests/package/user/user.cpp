// The headers and the libraries from C++: the mean of what the host's array holds.
#include <krnumer/krnumer.h>
#include <krrt/krrt.h>

int main() {
    KrHandle samples = KrrtNewArray(KRRT_DOUBLE, 2);
    static_cast<double*>(KrrtElements(samples))[1] = 5.0;
    double mean = 0.0;
    int32_t err = KRN_EMPTY_INPUT;
    Mean_head(samples, &mean, &err);
    KrrtFree(samples);
    return err == KRN_OK && mean == 2.5 ? 0 : 1;
}
