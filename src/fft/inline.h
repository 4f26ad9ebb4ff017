// What compilers have to be told, each in its own words.
//
// Forced inlining: a butterfly is one long block only if everything it calls dissolves in it, whatever the compiler
// thinks of the size of the result.
#pragma once

#if defined(_MSC_VER) && !defined(__clang__)
#define KRNUMER_FFT_INLINE __forceinline
#define KRNUMER_FFT_INLINE_LAMBDA
#define KRNUMER_FFT_NOINLINE __declspec(noinline)
#define KRNUMER_FFT_UNROLL
#define KRNUMER_FFT_RESTRICT __restrict
#else
#define KRNUMER_FFT_INLINE inline __attribute__((always_inline))
#define KRNUMER_FFT_INLINE_LAMBDA __attribute__((always_inline))
#define KRNUMER_FFT_NOINLINE __attribute__((noinline))
#define KRNUMER_FFT_RESTRICT __restrict__
#if defined(__clang__)
#define KRNUMER_FFT_UNROLL _Pragma("clang loop unroll(full)")
#else
#define KRNUMER_FFT_UNROLL _Pragma("GCC unroll 64")
#endif
#endif
