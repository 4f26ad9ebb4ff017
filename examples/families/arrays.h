/* Arrays of the host for the examples: made of values, printed, freed. A status that is a failure ends the program. */
#ifndef EXAMPLES_ARRAYS_H
#define EXAMPLES_ARRAYS_H

#include <krnumer/krnumer.h>
#include <krrt/krrt.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#define COUNT(...) ((int32_t)(sizeof(__VA_ARGS__) / sizeof(*(__VA_ARGS__))))
#define DOUBLES(...) NewDoubles(COUNT((double[]){__VA_ARGS__}), (double[]){__VA_ARGS__})
#define INTEGERS(...) NewIntegers(COUNT((int32_t[]){__VA_ARGS__}), (int32_t[]){__VA_ARGS__})
#define FREE(...) FreeArrays(COUNT((KrHandle[]){__VA_ARGS__}), (KrHandle[]){__VA_ARGS__})

static inline KrHandle NewDoubles(int32_t n, const double* values) {
    KrHandle array = KrrtNewArray(KRRT_DOUBLE, n);
    memcpy(KrrtElements(array), values, sizeof(double) * (size_t)n);
    return array;
}

static inline KrHandle NewIntegers(int32_t n, const int32_t* values) {
    KrHandle array = KrrtNewArray(KRRT_INT32, n);
    memcpy(KrrtElements(array), values, sizeof(int32_t) * (size_t)n);
    return array;
}

static inline KrHandle NewMatrix(int32_t rows, int32_t columns, const double* values) {
    KrHandle matrix = KrrtNewMatrix(KRRT_DOUBLE, rows, columns);
    memcpy(KrrtElements(matrix), values, sizeof(double) * (size_t)rows * (size_t)columns);
    return matrix;
}

static inline KrHandle Empty(void) {
    return KrrtNewArray(KRRT_DOUBLE, 0);
}

static inline double* Elements(KrHandle array) {
    return (double*)KrrtElements(array);
}

static inline void Print(const char* name, KrHandle array) {
    printf("%s:", name);
    for (int32_t i = 0; i < KrrtSize(array, 0); ++i) printf(" %.4f", Elements(array)[i]);
    printf("\n");
}

static inline void FreeArrays(int32_t n, const KrHandle* arrays) {
    for (int32_t i = 0; i < n; ++i) KrrtFree(arrays[i]);
}

static inline void Check(int32_t status) {
    if (status >= KRN_OK) return;
    fprintf(stderr, "status %d: %s\n", (int)status, KrrtStatusText(status));
    exit(1);
}

#endif
