// Two doubles in one register, that are added and multiplied side by side. Every 64-bit processor has such registers, so
// code that uses them needs no choice at run time.
#pragma once

#include <cstring>

namespace krnumer {

#if defined(__GNUC__)

typedef double Pair __attribute__((vector_size(2 * sizeof(double))));

#else

struct Pair {
    double lanes[2];

    double operator[](int i) const { return lanes[i]; }
    friend Pair operator+(Pair a, Pair b) { return {{a[0] + b[0], a[1] + b[1]}}; }
    friend Pair operator-(Pair a, Pair b) { return {{a[0] - b[0], a[1] - b[1]}}; }
    friend Pair operator*(Pair a, Pair b) { return {{a[0] * b[0], a[1] * b[1]}}; }
};

#endif

// A lone double or a pair of neighbours, at any address of a double.
template <class V>
V Load(const double* from) {
    V value;
    std::memcpy(&value, from, sizeof value);
    return value;
}

template <class V>
void Store(V value, double* to) {
    std::memcpy(to, &value, sizeof value);
}

}  // namespace krnumer
