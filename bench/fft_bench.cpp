// Forward transforms beside FFTW (planned with FFTW_MEASURE), GSL and KissFFT, all on doubles and in one run.
//
// Out of place, the input left alone, at 64-byte boundaries; GSL knows only in place. Real transforms give half-complex
// form, FFTW's and KissFFT's the first half of the spectrum. KissFFT has no real transform of odd length: there its
// complex one stands in.
#include <benchmark/benchmark.h>

#include <algorithm>
#include <complex>
#include <cstdlib>
#include <memory>
#include <random>
#include <string>
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

// Powers of two, other products of small primes, and primes.
constexpr int32_t kLengths[] = {16,     64,      128,     256,  512,   1024, 2048, 4096, 8192, 16384,
                                65536,  262144,  1048576, 100,  120,   360,  500,  1000, 5000, 10000,
                                100000, 1000000, 2187,    3125, 30030, 17,   43,   101,  997,  10007};

enum Kind { kComplexKind, kRealKind };
constexpr const char* kKindNames[] = {"complex transform", "real transform"};

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

template <class Peer>
void Register(Kind kind, int32_t n) {
    const std::string name = std::string(kKindNames[kind]) + "/" + Peer::kName;
    benchmark::RegisterBenchmark(name.c_str(),
                                 [=](benchmark::State& state) {
                                     const Arrays arrays(n);
                                     double* in = arrays.in.get();
                                     double* out = arrays.out.get();
                                     const Peer transform(kind, n, in, out);
                                     for (auto _ : state) {
                                         transform(in, out);
                                         benchmark::ClobberMemory();
                                     }
                                 })
        ->ArgName("n")
        ->Arg(n);
}

const bool kRegistered = [] {
    for (const Kind kind : {kComplexKind, kRealKind}) {
        for (const int32_t n : kLengths) {
            Register<Own>(kind, n);
#if defined(KRNUMER_HAVE_FFTW)
            Register<Fftw>(kind, n);
#endif
#if defined(KRNUMER_HAVE_GSL)
            Register<Gsl>(kind, n);
#endif
#if defined(KRNUMER_HAVE_KISSFFT)
            Register<Kiss>(kind, n);
#endif
        }
    }
    return true;
}();

}  // namespace
}  // namespace krnumer
