// The generated butterflies and how they deliver. Included once inside the namespace of each kind of arithmetic: plain
// numbers, and the vectors of every instruction set.
//
// A butterfly Dft<r>::Run<T>(in, out) reads its samples as in(j) and writes nothing before it has read them all. T is
// any number that can be added and scaled by a double. out.Single(k, v) delivers X[k], and out.Pair(k, a, b) the halves
// of X[k] = a + ib and X[r-k] = a - ib.

template <int r>
struct Dft;

// Half-complex form of real samples: real parts at 0 .. r/2, the imaginary part of X[k] at r - k.
template <int r, class Store>
struct HalfComplex {
    const Store& store;

    template <class T>
    KRNUMER_FFT_INLINE void Single(int k, T value) const {
        store(k, value);
    }
    template <class T>
    KRNUMER_FFT_INLINE void Pair(int k, T a, T b) const {
        if (2 * k < r) {
            store(k, a);
            store(r - k, b);
        } else {
            store(r - k, a);
            store(k, -b);
        }
    }
};

// All values of complex samples.
template <int r, class Store>
struct FullSpectrum {
    const Store& store;

    template <class T>
    KRNUMER_FFT_INLINE void Single(int k, T value) const {
        store(k, value);
    }
    template <class T>
    KRNUMER_FFT_INLINE void Pair(int k, T a, T b) const {
        store(k, AddI(a, b));
        store(r - k, SubtractI(a, b));
    }
};

// Transforms r real samples in(j) into half-complex form, store(q, value).
template <int r, class T, class In, class Store>
KRNUMER_FFT_INLINE void RealDft(const In& in, const Store& store) {
    Dft<r>::template Run<T>(in, HalfComplex<r, Store>{store});
}

// Transforms r complex samples in(j), store(k, value).
template <int r, class T, class In, class Store>
KRNUMER_FFT_INLINE void ComplexDft(const In& in, const Store& store) {
    if constexpr (r == 32) {
        Dft<r>::template RunComplex<T>(in, store);
    } else {
        Dft<r>::template Run<T>(in, FullSpectrum<r, Store>{store});
    }
}

#include "fft/generated/dft10-inl.h"
#include "fft/generated/dft11-inl.h"
#include "fft/generated/dft13-inl.h"
#include "fft/generated/dft14-inl.h"
#include "fft/generated/dft16-inl.h"
#include "fft/generated/dft17-inl.h"
#include "fft/generated/dft18-inl.h"
#include "fft/generated/dft19-inl.h"
#include "fft/generated/dft2-inl.h"
#include "fft/generated/dft29-inl.h"
#include "fft/generated/dft3-inl.h"
#include "fft/generated/dft31-inl.h"
#include "fft/generated/dft32-inl.h"
#include "fft/generated/dft37-inl.h"
#include "fft/generated/dft4-inl.h"
#include "fft/generated/dft41-inl.h"
#include "fft/generated/dft43-inl.h"
#include "fft/generated/dft5-inl.h"
#include "fft/generated/dft7-inl.h"
#include "fft/generated/dft8-inl.h"
#include "fft/generated/dft9-inl.h"
