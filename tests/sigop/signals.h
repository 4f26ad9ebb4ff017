// Signals of the tests: random ones, golden ones from files, and exact sums to compare with.
#pragma once

#include <cstdint>
#include <map>
#include <random>
#include <string>
#include <type_traits>
#include <vector>

#include "frame/complex.h"

namespace krnumer {

template <class T>
int32_t Size(const std::vector<T>& x) {
    return static_cast<int32_t>(x.size());
}

// The same in every run and on every machine.
class RandomSignals {
  public:
    explicit RandomSignals(uint64_t seed = 20240613) : engine_(seed) {}

    double Between(double low, double high) {
        return low + (high - low) * (static_cast<double>(engine_() >> 11) * 0x1p-53);
    }
    int32_t Integer(int32_t least, int32_t most) {
        return least + static_cast<int32_t>(engine_() % static_cast<uint64_t>(most - least + 1));
    }

    // Samples of modulus up to about 1.
    template <class T>
    std::vector<T> Samples(int32_t n) {
        std::vector<T> x(static_cast<size_t>(n));
        for (T& sample : x) {
            if constexpr (std::is_same_v<T, Complex>) {
                sample = {Between(-1, 1), Between(-1, 1)};
            } else {
                sample = Between(-1, 1);
            }
        }
        return x;
    }

  private:
    std::mt19937_64 engine_;
};

// Signals by name from <file>.txt in tests/reference/sigop: a name and its numbers in a line.
class Golden {
  public:
    explicit Golden(const std::string& file);

    // Throws std::out_of_range when there is none of the name.
    const std::vector<double>& Reals(const std::string& name) const { return signals_.at(name); }
    std::vector<Complex> Complexes(const std::string& name) const;
    std::vector<int32_t> Integers(const std::string& name) const;
    double Number(const std::string& name) const { return Reals(name).at(0); }

    // Names up to their first dot, each once: all, or those that begin with the prefix. Throws std::out_of_range when
    // there is none.
    std::vector<std::string> Cases(const std::string& prefix = "") const;

    template <class T>
    std::vector<T> Get(const std::string& name) const {
        if constexpr (std::is_same_v<T, Complex>) {
            return Complexes(name);
        } else {
            return Reals(name);
        }
    }

  private:
    std::map<std::string, std::vector<double>> signals_;
};

// Sum of products in long double, rounded once.
template <class T>
class ExactSum {
  public:
    void Add(double a, double b) { re_ += static_cast<long double>(a) * b; }
    void Add(Complex a, Complex b) {
        re_ += static_cast<long double>(a.re) * b.re - static_cast<long double>(a.im) * b.im;
        im_ += static_cast<long double>(a.re) * b.im + static_cast<long double>(a.im) * b.re;
    }
    void Add(double a, Complex b) { Add(Complex{a, 0.0}, b); }
    T value() const {
        if constexpr (std::is_same_v<T, Complex>) {
            return {static_cast<double>(re_), static_cast<double>(im_)};
        } else {
            return static_cast<double>(re_);
        }
    }

  private:
    long double re_ = 0.0L;
    long double im_ = 0.0L;
};

}  // namespace krnumer
