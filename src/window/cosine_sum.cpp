#include "window/cosine_sum.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>
#include <iterator>
#include <numeric>

#include "frame/numeric.h"
#include "frame/pair.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "window/type.h"

namespace krnumer {

namespace {

constexpr double kRectangle[] = {1.0};
constexpr double kHann[] = {0.5, 0.5};
constexpr double kHamming[] = {0.54, 0.46};
constexpr double kBlackmanHarris3[] = {0.42323, 0.49755, 0.07922};
constexpr double kExactBlackman[] = {0.4265907136715391, 0.4965606190885641, 0.07684866723989682};
constexpr double kBlackman[] = {0.42, 0.5, 0.08};
constexpr double kFlatTop[] = {0.215578948, 0.41663158, 0.277263158, 0.083578947, 0.006947368};
constexpr double kBlackmanHarris4[] = {0.35875, 0.48829, 0.14128, 0.01168};
constexpr double kBlackmanHarris7[] = {0.27105140069342415,   0.43329793923448606,  0.21812299954311062,
                                       0.0659254463880309,    0.010811742098372268, 0.0007765848252250934,
                                       1.3887217350903198e-05};
constexpr double kLowSideLobe[] = {0.323215218, 0.471492057, 0.17553428, 0.028497078, 0.001261367};
constexpr double kBlackmanNuttall[] = {0.3635819, 0.4891775, 0.1365995, 0.0106411};

// The terms (-1)^k a[k] cos(2 pi k i / n) of the sum at one position i, as c; s is the sine beside each cosine.
struct TurningTerms {
    std::ptrdiff_t count;
    double* c;
    double* s;
    double* alpha;
    double* beta;
};

// One term, or two neighbours side by side, in registers.
template <class V>
class Turning {
  public:
    Turning() = default;
    Turning(const TurningTerms& terms, std::ptrdiff_t k)
        : c_(Load<V>(terms.c + k)),
          s_(Load<V>(terms.s + k)),
          alpha_(Load<V>(terms.alpha + k)),
          beta_(Load<V>(terms.beta + k)) {}

    void Save(const TurningTerms& terms, std::ptrdiff_t k) const {
        Store(c_, terms.c + k);
        Store(s_, terms.s + k);
    }

    // The step to the next position turns a term by theta = 2 pi k / n, in the form that keeps its precision at small
    // angles: alpha = 2 sin^2(theta / 2), beta = sin(theta) (R. C. Singleton, Comm. ACM 10, 647, 1967).
    V Next() {
        const V turned = c_ - (c_ * alpha_ + s_ * beta_);
        s_ = s_ - (s_ * alpha_ - c_ * beta_);
        return c_ = turned;
    }

  private:
    V c_, s_, alpha_, beta_;
};

// Positions taken together. Each turn waits for the one before through three dependent operations, which bounds the
// speed; several terms side by side fill the wait.
constexpr int kBlock = 16;

// Turns K terms from `first` on by `steps` positions and adds their cosines, term after term, to the weights there.
template <int K>
void AddTurningTerms(const TurningTerms& terms, std::ptrdiff_t first, double* weights, int steps) {
    constexpr bool kOdd = K % 2 == 1;
    std::array<Turning<Pair>, K / 2> pairs;
    std::ptrdiff_t k = first;
    for (Turning<Pair>& pair : pairs) {
        pair = {terms, k};
        k += 2;
    }
    Turning<double> last(terms, first + K - 1);

    for (int j = 0; j < steps; ++j) {
        double weight = weights[j];
        for (Turning<Pair>& pair : pairs) {
            const Pair c = pair.Next();
            weight += c[0];
            weight += c[1];
        }
        if constexpr (kOdd) weight += last.Next();
        weights[j] = weight;
    }

    k = first;
    for (const Turning<Pair>& pair : pairs) {
        pair.Save(terms, k);
        k += 2;
    }
    if constexpr (kOdd) last.Save(terms, k);
}

// By the number of terms, less one.
constexpr decltype(&AddTurningTerms<1>) kAddTurningTerms[] = {AddTurningTerms<1>, AddTurningTerms<2>,
                                                              AddTurningTerms<3>, AddTurningTerms<4>,
                                                              AddTurningTerms<5>, AddTurningTerms<6>};
constexpr std::ptrdiff_t kMostTogether = std::ssize(kAddTurningTerms);

// The weights of the next `steps` positions, each the sum of the terms in their order.
void NextWeights(const TurningTerms& terms, double* weights, int steps) {
    std::fill_n(weights, steps, terms.c[0]);
    for (std::ptrdiff_t first = 1; first < terms.count; first += kMostTogether) {
        const std::ptrdiff_t together = std::min(terms.count - first, kMostTogether);
        kAddTurningTerms[together - 1](terms, first, weights, steps);
    }
}

}  // namespace

std::span<const double> WinCosTerms(std::int32_t type) {
    switch (type) {
        case kWindowRectangle:
            return kRectangle;
        case kWindowHann:
            return kHann;
        case kWindowHamming:
            return kHamming;
        case kWindowBlackmanHarris3:
            return kBlackmanHarris3;
        case kWindowExactBlackman:
            return kExactBlackman;
        case kWindowBlackman:
            return kBlackman;
        case kWindowFlatTop:
            return kFlatTop;
        case kWindowBlackmanHarris4:
            return kBlackmanHarris4;
        case kWindowBlackmanHarris7:
            return kBlackmanHarris7;
        case kWindowLowSideLobe:
            return kLowSideLobe;
        case kWindowBlackmanNuttall:
            return kBlackmanNuttall;
        default:
            return {};
    }
}

template <class T>
std::int32_t CosineSumWindow(T* x, std::int32_t n, const double* a, std::int32_t m, bool scaled) {
    if (n < 1) return kEmptyInput;
    if (n == 1) return kOk;
    if (m < 1) return kEmptyInput;
    if (m == 1 && a[0] == 1.0) return kOk;

    const std::ptrdiff_t count = m;
    Scratch<double> work(4 * Count(m));
    if (!work) return kOutOfMemory;
    const TurningTerms terms{count, work.data(), work.data() + count, work.data() + 2 * count, work.data() + 3 * count};

    const double divisor = scaled ? a[0] : 1.0;
    for (std::ptrdiff_t k = 0; k < count; ++k) {
        const double angle = static_cast<double>(k) * kPi / n;
        const double sine = std::sin(angle);
        terms.c[k] = (k % 2 == 0 ? a[k] : -a[k]) / divisor;
        terms.s[k] = 0.0;
        terms.alpha[k] = 2.0 * sine * sine;
        terms.beta[k] = std::sin(2.0 * angle);
    }
    x[0] *= std::accumulate(terms.c + 1, terms.c + count, terms.c[0]);

    double weights[kBlock];
    for (std::int32_t i = 1; i <= n / 2;) {
        const int steps = std::min(kBlock, n / 2 - i + 1);
        NextWeights(terms, weights, steps);
        for (int j = 0; j < steps; ++j, ++i) {
            x[i] *= weights[j];
            if (i < n - i) x[n - i] *= weights[j];  // the middle of an even length has no partner
        }
    }
    return kOk;
}

template <class T>
std::int32_t NamedCosineWindow(T* x, std::int32_t n, std::int32_t type, bool scaled) {
    if (n < 1) return kEmptyInput;
    const std::span<const double> a = WinCosTerms(type);
    if (a.empty()) return kBadSelector;
    return CosineSumWindow(x, n, a.data(), static_cast<std::int32_t>(a.size()), scaled);
}

template std::int32_t CosineSumWindow(double*, std::int32_t, const double*, std::int32_t, bool);
template std::int32_t CosineSumWindow(Complex*, std::int32_t, const double*, std::int32_t, bool);
template std::int32_t NamedCosineWindow(double*, std::int32_t, std::int32_t, bool);
template std::int32_t NamedCosineWindow(Complex*, std::int32_t, std::int32_t, bool);

}  // namespace krnumer
