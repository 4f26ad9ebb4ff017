// SortDoubles beside std::sort. Every sort of a round sees other data of its kind, for a branch predictor learns by
// heart what it sees twice.

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cmath>
#include <random>
#include <string>
#include <vector>

#include "frame/numeric.h"
#include "stat/order.h"
#include "stat/quicksort.h"
#include "support/quicksort_killer.h"

namespace krnumer {
namespace {

using Samples = std::vector<double>;

const auto kOwnSort = [](int32_t* first, int32_t* last, auto before) {
    quicksort::Sort(first, last, before, quicksort::MostLevels(last - first));
};
const auto kStandardSort = [](int32_t* first, int32_t* last, auto before) { std::sort(first, last, before); };

struct Kind {
    const char* name;
    Samples (*make)(int32_t n, std::mt19937_64& random);
};

template <class Value>
Samples Generate(int32_t n, Value value) {
    Samples samples(Count(n));
    for (int32_t i = 0; i < n; ++i) samples[Count(i)] = value(i);
    return samples;
}

double Uniform(std::mt19937_64& random) {
    return std::uniform_real_distribution<>()(random);
}

const Kind kKinds[] = {
    {"random", [](int32_t n, std::mt19937_64& r) { return Generate(n, [&](int32_t) { return Uniform(r); }); }},
    {"sorted", [](int32_t n, std::mt19937_64&) { return Generate(n, [](int32_t i) { return i; }); }},
    {"reversed", [](int32_t n, std::mt19937_64&) { return Generate(n, [](int32_t i) { return -i; }); }},
    {"constant", [](int32_t n, std::mt19937_64&) { return Generate(n, [](int32_t) { return 3.0; }); }},
    {"ten values",
     [](int32_t n, std::mt19937_64& r) { return Generate(n, [&](int32_t) { return static_cast<double>(r() % 10); }); }},
    {"half NaN",
     [](int32_t n, std::mt19937_64& r) {
         return Generate(n, [&](int32_t) { return r() % 2 == 0 ? kQuietNaN : Uniform(r); });
     }},
    {"few NaN",
     [](int32_t n, std::mt19937_64& r) {
         return Generate(n, [&](int32_t) { return r() % 100 == 0 ? kQuietNaN : Uniform(r); });
     }},
    {"nearly sorted",
     [](int32_t n, std::mt19937_64& r) { return Generate(n, [&](int32_t i) { return i + 20.0 * Uniform(r); }); }},
    {"sorted with tail",
     [](int32_t n, std::mt19937_64& r) {
         return Generate(n, [&](int32_t i) { return i < n / 10 * 9 ? i : n * Uniform(r); });
     }},
    {"organ pipe",
     [](int32_t n, std::mt19937_64&) { return Generate(n, [=](int32_t i) { return std::min(i, n - i); }); }},
    {"sine", [](int32_t n, std::mt19937_64&) { return Generate(n, [](int32_t i) { return std::sin(0.01 * i); }); }},
    {"worst for krnumer", [](int32_t n, std::mt19937_64&) { return QuicksortKiller(n, kOwnSort).values(); }},
    {"worst for std::sort", [](int32_t n, std::mt19937_64&) { return QuicksortKiller(n, kStandardSort).values(); }},
};

template <class Sort>
void SortMany(benchmark::State& state, const Kind& kind, Sort sort) {
    constexpr int32_t kElements = 100000;
    const auto n = static_cast<int32_t>(state.range(0));
    const std::size_t arrays = Count(kElements / n);
    std::mt19937_64 random(1);
    Samples unsorted;
    while (unsorted.size() < arrays * Count(n)) {
        const Samples one = kind.make(n, random);
        unsorted.insert(unsorted.end(), one.begin(), one.end());
    }
    for (auto _ : state) {
        state.PauseTiming();
        Samples samples = unsorted;
        state.ResumeTiming();
        for (std::size_t i = 0; i < arrays; ++i) sort(samples.data() + i * Count(n), n);
        benchmark::DoNotOptimize(samples.data());
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations() * static_cast<int64_t>(unsorted.size()));
}

// What a caller of std::sort has to do about NaN first is part of the comparison.
void StandardSort(double* first, int32_t n) {
    double* numbers = std::partition(first, first + n, [](double x) { return std::isnan(x); });
    std::sort(numbers, first + n);
}

const bool kRegistered = [] {
    for (const Kind& kind : kKinds) {
        for (const int32_t n : {100, 100000}) {
            const std::string name = std::string("sort, ") + kind.name;
            benchmark::RegisterBenchmark(
                (name + "/krnumer").c_str(),
                [&kind](benchmark::State& state) {
                    SortMany(state, kind, [](double* x, int32_t size) { SortDoubles(x, size, 0, nullptr); });
                })
                ->ArgName("n")
                ->Arg(n);
            benchmark::RegisterBenchmark((name + "/std::sort").c_str(),
                                         [&kind](benchmark::State& state) { SortMany(state, kind, StandardSort); })
                ->ArgName("n")
                ->Arg(n);
        }
    }
    return true;
}();

}  // namespace
}  // namespace krnumer
