/*
 * Types that cross the boundary between a host and krnumer.
 *
 * Every array belongs to the host. It is a block of memory that starts with one int32 dimension word per
 * dimension and goes on directly with the elements, row after row:
 *
 *     1-D of N elements                    int32 N        elements from byte 4
 *     2-D of R rows and C columns          int32 R, C     elements from byte 8
 *     3-D of P pages, R rows, C columns    int32 P, R, C  elements from byte 12
 *
 * A handle is a pointer to the pointer to that block, so the host may move the block when it is resized. A
 * handle is never null and always leads to a block; an empty array has 0 in all its dimension words. Elements
 * need no stricter alignment than 4 bytes.
 */
#ifndef KRNUMER_TYPES_H
#define KRNUMER_TYPES_H

#include <stdint.h>

#if defined(_WIN32)
#if defined(KRNUMER_BUILD)
#define KRNUMER_EXPORT __declspec(dllexport)
#else
#define KRNUMER_EXPORT __declspec(dllimport)
#endif
#else
#define KRNUMER_EXPORT __attribute__((visibility("default")))
#endif

#if defined(__cplusplus)
#define KRNUMER_API extern "C" KRNUMER_EXPORT
#else
#define KRNUMER_API KRNUMER_EXPORT
#endif

/** A host array: pointer to the pointer to its block. */
typedef struct KrBlock** KrHandle;

/** A complex element or scalar. */
typedef struct KrComplex {
    double re; /**< real part */
    double im; /**< imaginary part */
} KrComplex;

#endif
