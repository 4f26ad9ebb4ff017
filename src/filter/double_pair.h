// Two doubles in one register, with arithmetic element by element. Every 64-bit processor has such registers, so code
// that uses them needs no choice at run time.
#pragma once

namespace krnumer {

#if defined(__GNUC__)
using DoublePair = double __attribute__((vector_size(16)));
#else
struct DoublePair {
    double elements[2];

    double operator[](int i) const { return elements[i]; }
    friend DoublePair operator+(DoublePair a, DoublePair b) { return {a[0] + b[0], a[1] + b[1]}; }
    friend DoublePair operator-(DoublePair a, DoublePair b) { return {a[0] - b[0], a[1] - b[1]}; }
    friend DoublePair operator*(DoublePair a, DoublePair b) { return {a[0] * b[0], a[1] * b[1]}; }
};
#endif

}  // namespace krnumer
