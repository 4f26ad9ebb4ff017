#include "filter/equiripple.h"

#include <cmath>

#include "filter/remez_exchange.h"
#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"

namespace krnumer {
namespace {

constexpr int32_t kDefaultIterations = 100;
constexpr int32_t kGridDensity = 16;  // grid points per cosine

// The response of a filter is a sum of cosines times a factor, the fold, which depends on the symmetry and the parity
// of the number of taps.
struct Shape {
    FirClass fir_class;
    int32_t taps;

    bool symmetric() const { return fir_class == kMultiband; }
    bool odd() const { return taps % 2 != 0; }
    int32_t cosines() const { return taps / 2 + (symmetric() && odd() ? 1 : 0); }
    double spacing() const { return 0.5 / (kGridDensity * cosines()); }

    double Fold(double f) const {
        if (symmetric()) return odd() ? 1.0 : std::cos(kPi * f);
        return std::sin((odd() ? 2.0 : 1.0) * kPi * f);
    }
    bool FoldVanishesAtHalf() const { return symmetric() != odd(); }
};

int32_t CheckBands(const FirBand* bands, int32_t count, double fs) {
    for (int32_t i = 0; i < count; ++i) {
        const FirBand& band = bands[i];
        if (!(band.low >= 0.0 && band.high >= 0.0 && band.weight > 0.0 && band.desired >= 0.0)) return kBadFrequency;
    }
    if (bands[count - 1].high > fs / 2.0) return kCutoffAboveNyquist;
    for (int32_t i = 0; i < count; ++i) {
        if (!(bands[i].low < bands[i].high)) return kBadFrequency;
        if (i > 0 && !(bands[i - 1].high < bands[i].low)) return kBadFrequency;
    }
    return kOk;
}

// Whether the bands, with edges from `first` to `last` in cycles per sample, suit a filter of this shape.
int32_t CheckShape(const Shape& shape, double first, double last, double last_desired) {
    constexpr double kTolerance = 0.001;
    constexpr double kOfDifferentiator = 0.01;
    if (shape.symmetric()) {
        if (first != 0.0 || !(0.5 - last <= kTolerance)) return kBadBands;
        return !shape.odd() && last_desired != 0.0 ? kEvenLength : kOk;
    }
    // Where the fold vanishes, there is no response to be had.
    const bool differentiator = shape.fir_class == kDifferentiator;
    if (!differentiator && !(first >= kTolerance)) return kBadBands;
    const double gap = differentiator ? kOfDifferentiator : kTolerance;
    return shape.odd() && !(0.5 - last >= gap) ? kBadBands : kOk;
}

// Fills the grid with the bands, up to the room that `Room` asks for, and gives its size. Desired values and weights
// are those of the sum of cosines.
class GridMaker {
  public:
    GridMaker(const Shape& shape, double fs, const ApproximationGrid& grid) : shape_(shape), fs_(fs), grid_(grid) {}

    // Points of a band stand a spacing apart; one more each for the first, the last and the rounding.
    static size_t Room(const Shape& shape, int32_t bands) {
        return Count(kGridDensity) * Count(shape.cosines()) + 3 * Count(bands);
    }

    int32_t Make(const FirBand* bands, int32_t count) {
        const double spacing = shape_.spacing();
        for (int32_t i = 0; i < count; ++i) {
            double low = bands[i].low / fs_;
            const double high = bands[i].high / fs_;
            if (i == 0 && !shape_.symmetric() && low < spacing) low = spacing;
            // The last point that is not above the edge is moved there.
            int32_t steps = 0;
            for (; low + (steps + 1) * spacing <= high; ++steps) Add(low + steps * spacing, bands[i]);
            Add(high, bands[i]);
        }
        if (shape_.FoldVanishesAtHalf() && last_ > 0.5 - spacing) --grid_.size;
        return grid_.size;
    }

  private:
    void Add(double f, const FirBand& band) {
        constexpr double kNothing = 0.0001;
        double desired = band.desired;
        double weight = band.weight;
        if (shape_.fir_class == kDifferentiator) {
            desired *= f;
            if (band.desired >= kNothing) weight /= f;
        }
        const double fold = shape_.Fold(f);
        grid_.x[grid_.size] = std::cos(2.0 * kPi * f);
        grid_.desired[grid_.size] = desired / fold;
        grid_.weight[grid_.size] = weight * fold;
        ++grid_.size;
        last_ = f;
    }

    Shape shape_;
    double fs_;
    ApproximationGrid grid_;
    double last_ = 0.0;
};

// The fold worked into the sum of cosines gives the impulse response. `alpha` has two zeros behind it.
void FormTaps(const Shape& shape, const double* alpha, double* h) {
    const int32_t n = shape.cosines();
    const int32_t shift = shape.symmetric() || !shape.odd() ? 1 : 2;
    const bool folded = !(shape.symmetric() && shape.odd());
    const double mirrored = shape.symmetric() ? 1.0 : -1.0;
    // Products of cosines with the fold are sums and differences of neighbours, those beyond the last being 0.
    for (int32_t k = n - 1; k >= 0; --k) {
        double tap = alpha[k] / 2.0;
        if (folded) tap = ((k == 0 ? 2.0 * alpha[0] : alpha[k]) + mirrored * alpha[k + shift]) / 4.0;
        const int32_t i = n - 1 - k;
        h[i] = tap;
        h[shape.taps - 1 - i] = mirrored * tap;
    }
    if (shape.odd()) h[shape.taps / 2] = shape.symmetric() ? alpha[0] : 0.0;
}

}  // namespace

int32_t EquirippleDesign(int32_t taps, double fs, const FirBand* bands, int32_t band_count, FirClass fir_class,
                         int32_t max_iterations, double* h, double* ripple) {
    if (max_iterations < 1) max_iterations = kDefaultIterations;
    if (taps < 3) return kBadBands;
    if (band_count < 1) return kEmptyInput;
    if (!(fs > 0.0)) return kBadFrequency;
    if (const int32_t status = CheckBands(bands, band_count, fs)) return status;
    const Shape shape{fir_class, taps};
    const FirBand& last = bands[band_count - 1];
    if (const int32_t status = CheckShape(shape, bands[0].low / fs, last.high / fs, last.desired)) return status;
    const int32_t cosines = shape.cosines();
    if (cosines + 2 > RemezExchange::kMostPoints) return kOutOfMemory;

    const size_t room = GridMaker::Room(shape, band_count);
    Scratch<double> work(3 * room);
    Scratch<double> alpha(Count(cosines) + 2, Scratch<double>::kZeroed);
    if (!work || !alpha) return kOutOfMemory;
    ApproximationGrid grid{work.data(), work.data() + room, work.data() + 2 * room, 0};
    grid.size = GridMaker(shape, fs, grid).Make(bands, band_count);

    RemezExchange exchange(grid, cosines);
    if (const int32_t status = exchange.Run(max_iterations - 1)) return status;
    if (const int32_t status = exchange.Cosines(alpha.data())) return status;
    FormTaps(shape, alpha.data(), h);
    *ripple = exchange.deviation();
    return kOk;
}

}  // namespace krnumer
