// Forward transforms beside FFTW (planned with FFTW_MEASURE), GSL and KissFFT, all on doubles and in one run. Behind
// the figures of the single transforms stands a table of times, ratios and geometric means.
//
// Out of place, the input left alone, at 64-byte boundaries; GSL knows only in place. Real transforms give half-complex
// form, FFTW's and KissFFT's the first half of the spectrum. KissFFT has no real transform of odd length: there its
// complex one stands in.
#include <benchmark/benchmark.h>

#include <algorithm>
#include <cmath>
#include <complex>
#include <cstdio>
#include <cstdlib>
#include <map>
#include <memory>
#include <random>
#include <string>
#include <utility>
#include <vector>

#include "fft/fft.h"
#include "frame/numeric.h"

#if defined(KRNUMER_HAVE_FFTW)
#include <fftw3.h>
#endif
#if defined(KRNUMER_HAVE_GSL)
#include <gsl/gsl_fft_complex.h>
#include <gsl/gsl_fft_real.h>
#endif
#if defined(KRNUMER_HAVE_KISSFFT)
#include <kissfft.hh>
#endif

namespace krnumer {
namespace {

constexpr int32_t kLengths[] = {16,    64,     100,    120,     128,     256,  360,  500,   512,   1000,
                                1024,  2048,   2187,   3125,    4096,    5000, 8192, 10000, 16384, 30030,
                                65536, 100000, 262144, 1000000, 1048576, 17,   43,   101,   997,   10007};

enum Kind { kComplexKind, kRealKind };
constexpr const char* kKindNames[] = {"complex", "real"};

// Room for n complex numbers at a cache line.
class Buffer {
  public:
    explicit Buffer(int32_t n)
        : values_(static_cast<double*>(std::aligned_alloc(64, (Count(n) * 2 * sizeof(double) + 63) / 64 * 64))) {
        std::fill_n(values_.get(), 2 * Count(n), 0.0);
    }
    double* get() const { return values_.get(); }

  private:
    struct Free {
        void operator()(double* values) const { std::free(values); }
    };
    std::unique_ptr<double, Free> values_;
};

struct Arrays {
    explicit Arrays(int32_t n) : in(n), out(n) {
        std::mt19937_64 random(1);
        std::uniform_real_distribution<double> uniform(-1.0, 1.0);
        for (size_t i = 0; i < 2 * Count(n); ++i) in.get()[i] = uniform(random);
    }
    Buffer in, out;
};

// Each peer prepares a transform of one length and then runs it from in to out.

class Own {
  public:
    static constexpr const char* kName = "krnumer";
    Own(Kind kind, int32_t n, double*, double*) : kind_(kind), n_(n), table_(n) {}
    void operator()(double* in, double* out) const {
        if (kind_ == kComplexKind) {
            ComplexFFT(table_.get(), in, in + 1, out, out + 1, 2, 2, n_);
        } else {
            RealFFT(table_.get(), in, out, 1, 1, n_);
        }
    }

  private:
    Kind kind_;
    int32_t n_;
    HeldTable table_;
};

#if defined(KRNUMER_HAVE_FFTW)
class Fftw {
  public:
    static constexpr const char* kName = "FFTW";
    Fftw(Kind kind, int32_t n, double* in, double* out) {
        const std::vector<double> kept(in, in + 2 * Count(n));  // planning writes to both
        auto* spectrum = reinterpret_cast<fftw_complex*>(out);
        plan_ = kind == kComplexKind
                    ? fftw_plan_dft_1d(n, reinterpret_cast<fftw_complex*>(in), spectrum, FFTW_FORWARD, FFTW_MEASURE)
                    : fftw_plan_dft_r2c_1d(n, in, spectrum, FFTW_MEASURE);
        std::copy(kept.begin(), kept.end(), in);
    }
    Fftw(const Fftw&) = delete;
    Fftw& operator=(const Fftw&) = delete;
    ~Fftw() { fftw_destroy_plan(plan_); }
    void operator()(double*, double*) const { fftw_execute(plan_); }

  private:
    fftw_plan plan_;
};
#endif

#if defined(KRNUMER_HAVE_GSL)
// Zeros stay zeros, however often they are transformed in place.
class Gsl {
  public:
    static constexpr const char* kName = "GSL";
    Gsl(Kind kind, int32_t n, double*, double* out) : kind_(kind), n_(Count(n)) {
        std::fill_n(out, 2 * n_, 0.0);
        if (kind == kComplexKind) {
            complex_table_.reset(gsl_fft_complex_wavetable_alloc(n_));
            complex_space_.reset(gsl_fft_complex_workspace_alloc(n_));
        } else {
            real_table_.reset(gsl_fft_real_wavetable_alloc(n_));
            real_space_.reset(gsl_fft_real_workspace_alloc(n_));
        }
    }
    void operator()(double*, double* out) const {
        if (kind_ == kComplexKind) {
            gsl_fft_complex_forward(out, 1, n_, complex_table_.get(), complex_space_.get());
        } else {
            gsl_fft_real_transform(out, 1, n_, real_table_.get(), real_space_.get());
        }
    }

  private:
    template <auto free>
    struct Free {
        void operator()(auto* space) const { free(space); }
    };
    Kind kind_;
    size_t n_;
    std::unique_ptr<gsl_fft_complex_wavetable, Free<gsl_fft_complex_wavetable_free>> complex_table_;
    std::unique_ptr<gsl_fft_complex_workspace, Free<gsl_fft_complex_workspace_free>> complex_space_;
    std::unique_ptr<gsl_fft_real_wavetable, Free<gsl_fft_real_wavetable_free>> real_table_;
    std::unique_ptr<gsl_fft_real_workspace, Free<gsl_fft_real_workspace_free>> real_space_;
};
#endif

#if defined(KRNUMER_HAVE_KISSFFT)
class Kiss {
  public:
    static constexpr const char* kName = "KissFFT";
    Kiss(Kind kind, int32_t n, double*, double*)
        : real_(kind == kRealKind && n % 2 == 0), transform_(Count(real_ ? n / 2 : n), false) {}
    void operator()(double* in, double* out) const {
        auto* spectrum = reinterpret_cast<std::complex<double>*>(out);
        if (real_) {
            transform_.transform_real(in, spectrum);
        } else {
            transform_.transform(reinterpret_cast<std::complex<double>*>(in), spectrum);
        }
    }

  private:
    bool real_;
    kissfft<double> transform_;
};
#endif

std::string Name(Kind kind, int32_t n, const char* peer) {
    return std::string(kKindNames[kind]) + "/" + std::to_string(n) + "/" + peer;
}

template <class Peer>
void Register(Kind kind, int32_t n) {
    benchmark::RegisterBenchmark(Name(kind, n, Peer::kName).c_str(), [=](benchmark::State& state) {
        const Arrays arrays(n);
        double* in = arrays.in.get();
        double* out = arrays.out.get();
        const Peer transform(kind, n, in, out);
        for (auto _ : state) {
            transform(in, out);
            benchmark::ClobberMemory();
        }
    });
}

void RegisterAll(std::vector<const char*>& peers) {
    const auto add = [&]<class Peer>(std::type_identity<Peer>) {
        peers.push_back(Peer::kName);
        return [](Kind kind, int32_t n) { Register<Peer>(kind, n); };
    };
    std::vector<void (*)(Kind, int32_t)> all{add(std::type_identity<Own>())};
#if defined(KRNUMER_HAVE_FFTW)
    all.push_back(add(std::type_identity<Fftw>()));
#endif
#if defined(KRNUMER_HAVE_GSL)
    all.push_back(add(std::type_identity<Gsl>()));
#endif
#if defined(KRNUMER_HAVE_KISSFFT)
    all.push_back(add(std::type_identity<Kiss>()));
#endif
    for (const Kind kind : {kComplexKind, kRealKind})
        for (const int32_t n : kLengths)
            for (const auto registration : all) registration(kind, n);
}

// Remembers the least time of every transform, over the repetitions if there are any.
class TableReporter : public benchmark::ConsoleReporter {
  public:
    void ReportRuns(const std::vector<Run>& runs) override {
        for (const Run& run : runs) {
            if (run.run_type != Run::RT_Iteration || run.error_occurred) continue;
            const double ns = run.GetAdjustedCPUTime();
            const auto [at, fresh] = least_.try_emplace(run.run_name.function_name, ns);
            if (!fresh) at->second = std::min(at->second, ns);
        }
        ConsoleReporter::ReportRuns(runs);
    }

    // Times of all that were measured, their ratios to the library's own, and the library's time per n log2 n.
    void PrintTable(Kind kind, const std::vector<const char*>& all) const {
        const auto time = [&](int32_t n, const char* peer) {
            const auto at = least_.find(Name(kind, n, peer));
            return at == least_.end() ? 0.0 : at->second;
        };
        std::vector<const char*> peers;
        std::copy_if(all.begin(), all.end(), std::back_inserter(peers), [&](const char* peer) {
            return std::any_of(std::begin(kLengths), std::end(kLengths),
                               [&](int32_t n) { return time(n, peer) > 0.0; });
        });
        if (peers.empty()) return;
        std::printf("\n%-8s", kKindNames[kind]);
        for (const char* peer : peers) std::printf("%12s", (std::string(peer) + " ns").c_str());
        for (size_t p = 1; p < peers.size(); ++p) std::printf("%10s", (std::string("/") + peers[p]).c_str());
        std::printf("%14s\n", "ns/(n log2 n)");
        std::vector<double> logarithms(peers.size());
        int32_t lengths = 0;
        for (const int32_t n : kLengths) {
            if (std::any_of(peers.begin(), peers.end(), [&](const char* peer) { return time(n, peer) == 0.0; }))
                continue;
            ++lengths;
            const double own = time(n, peers[0]);
            std::printf("%-8d", n);
            for (const char* peer : peers) std::printf("%12.1f", time(n, peer));
            for (size_t p = 1; p < peers.size(); ++p) {
                const double ratio = own / time(n, peers[p]);
                std::printf("%10.2f", ratio);
                logarithms[p] += std::log(ratio);
            }
            std::printf("%14.3f\n", own / (n * std::log2(n)));
        }
        if (lengths == 0 || peers.size() == 1) return;
        std::printf("%-*s", static_cast<int>(8 + 12 * peers.size()), "geometric mean");
        for (size_t p = 1; p < peers.size(); ++p) std::printf("%10.2f", std::exp(logarithms[p] / lengths));
        std::printf("\n");
    }

  private:
    std::map<std::string, double> least_;
};

int Main(int argc, char** argv) {
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    std::vector<const char*> peers;
    RegisterAll(peers);
    TableReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    for (const Kind kind : {kComplexKind, kRealKind}) reporter.PrintTable(kind, peers);
    benchmark::Shutdown();
    return 0;
}

}  // namespace
}  // namespace krnumer

int main(int argc, char** argv) {
    return krnumer::Main(argc, argv);
}
