/* What a C program sees of the installed library: the headers, the library, and a host. */
#include <krnumer/krnumer.h>
#include <krrt/krrt.h>
#include <stdio.h>

int main(void) {
    KrHandle samples = KrrtNewArray(KRRT_DOUBLE, 3);
    if (samples == NULL || KrrtSize(samples, 0) != 3 || SetKRRTModule(NULL) != NULL) return 1;
    KrrtFree(samples);
    return KRN_OUT_OF_MEMORY == -20001 ? 0 : 1;
}
