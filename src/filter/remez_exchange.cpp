#include "filter/remez_exchange.h"

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"

namespace krnumer {

int32_t RemezExchange::Run(int32_t rounds) {
    constexpr double kSettled = 1e-9;
    // With fewer points in the grid than are needed, some would coincide.
    if (grid_.size < points()) return kBadBands;
    if (!extrema_.Allocate(Count(points())) || !work_.Allocate(3 * Count(points()))) return kOutOfMemory;
    x_ = work_.data();
    factor_ = x_ + points();
    y_ = factor_ + points();
    SpreadPoints();

    double previous = -1.0;
    for (; rounds > 0 && (changes_ != 0 || std::fabs(deviation_ - previous) >= kSettled); --rounds) {
        previous = deviation_;
        if (!FormFactors()) return kBadBands;
        Interpolate();
        if (!(deviation_ >= previous && deviation_ < kInfinity)) return kBadBands;
        const int32_t first = extrema_[0];
        const int32_t last = extrema_[Count(cosines_)];
        MovePoints();
        TakeEnds(first, last);
    }
    return rounds > 0 ? kOk : kBadBands;
}

// Equally by index, the first and the last at the ends.
void RemezExchange::SpreadPoints() {
    for (int32_t j = 0; j < points(); ++j)
        extrema_[Count(j)] = static_cast<int32_t>(int64_t{j} * (grid_.size - 1) / cosines_);
}

// factor[i] = 1 / product of (x[i] - x[j]) over the other points, up to a power of 2 that all have in common; false
// when points coincide.
bool RemezExchange::FormFactors() {
    // Neighbours by their index lie close together. Taking the points in strides keeps the products in range, and so
    // does the factor 2: on an interval of length 2, the product of the distances to n points is about 2^-n.
    constexpr int32_t kPointsPerStride = 15;
    const int32_t stride = (points() - 1) / kPointsPerStride + 1;
    for (int32_t i = 0; i < points(); ++i) x_[i] = grid_.x[extrema_[Count(i)]];
    for (int32_t i = 0; i < points(); ++i) {
        double product = 1.0;
        for (int32_t start = 0; start < stride; ++start) {
            for (int32_t j = start; j < points(); j += stride)
                if (j != i) product *= 2.0 * (x_[i] - x_[j]);
        }
        if (product == 0.0) return false;
        factor_[i] = 1.0 / product;
    }
    return true;
}

// The deviation for which a polynomial can take the values desired +- deviation / weight, in turn, at all points.
void RemezExchange::Interpolate() {
    double numerator = 0.0;
    double denominator = 0.0;
    for (int32_t i = 0; i < points(); ++i) {
        const int32_t k = extrema_[Count(i)];
        const double alternating = i % 2 == 0 ? factor_[i] : -factor_[i];
        numerator += factor_[i] * grid_.desired[k];
        denominator += alternating / grid_.weight[k];
    }
    const double deviation = numerator / denominator;
    for (int32_t i = 0; i < points(); ++i) {
        const int32_t k = extrema_[Count(i)];
        y_[i] = grid_.desired[k] - (i % 2 == 0 ? deviation : -deviation) / grid_.weight[k];
    }
    first_sign_ = deviation > 0.0 ? -1.0 : 1.0;
    deviation_ = std::fabs(deviation);
}

// The polynomial through the points, by the barycentric formula.
double RemezExchange::Response(double x) const {
    double numerator = 0.0;
    double denominator = 0.0;
    for (int32_t i = 0; i < points(); ++i) {
        const double distance = x - x_[i];
        if (distance == 0.0) return y_[i];
        const double term = factor_[i] / distance;
        numerator += term * y_[i];
        denominator += term;
    }
    return numerator / denominator;
}

double RemezExchange::Error(int32_t k) const {
    return sign_ * grid_.weight[k] * (Response(grid_.x[k]) - grid_.desired[k]);
}

// From k up to the limit, as long as the error does not fall.
bool RemezExchange::Climb(int32_t k, int32_t limit) {
    bool climbed = false;
    for (double error; k < limit && (error = Error(k)) >= largest_; ++k) {
        largest_ = error;
        found_ = k;
        climbed = true;
    }
    return climbed;
}

// From behind k up to the first error above the largest so far, and on from there.
bool RemezExchange::SearchUp(int32_t k, int32_t limit) {
    while (++k < limit) {
        const double error = Error(k);
        if (!(error > largest_)) continue;
        largest_ = error;
        found_ = k;
        Climb(k + 1, limit);
        return true;
    }
    return false;
}

// The same downward. With `only_next` it ends at the first error that is not above the largest so far.
RemezExchange::Search RemezExchange::SearchDown(int32_t k, int32_t limit, bool only_next) {
    while (--k > limit) {
        double error = Error(k);
        if (error > largest_) {
            do {
                largest_ = error;
                found_ = k;
            } while (--k > limit && (error = Error(k)) >= largest_);
            return Search::kFound;
        }
        if (only_next) return Search::kStopped;
    }
    return Search::kAtLimit;
}

// Moves each point to an extremum of the error between the points beside it.
void RemezExchange::MovePoints() {
    changes_ = 0;
    int32_t low = -1;
    sign_ = first_sign_;
    for (int32_t j = 0; j < points(); ++j) {
        if (j > 0) sign_ = -sign_;
        int32_t& point = extrema_[Count(j)];
        const int32_t high = j < cosines_ ? extrema_[Count(j + 1)] : grid_.size;
        largest_ = deviation_;
        if (Climb(point + 1, high)) {
            low = point = found_;
            ++changes_;
        } else if (const Search down = SearchDown(point, low, changes_ != 0); down == Search::kFound) {
            low = point;
            point = found_;
            ++changes_;
        } else if (down != Search::kStopped && changes_ != 0) {
            low = point;
            ++changes_;
        } else if (down != Search::kStopped && SearchUp(point + 1, high)) {
            low = point = found_;
            changes_ = 1;
        } else {
            low = point;
        }
        if (j == 0) largest_at_first_ = largest_;
    }
}

// A larger error outside the points becomes a point at one end, and the point at the other end goes. At the upper end
// only the last point of the grid is tried.
void RemezExchange::TakeEnds(int32_t former_first, int32_t former_last) {
    constexpr double kClearly = 1.00001;
    const double last_sign = sign_;
    int32_t* const first = extrema_.data();
    int32_t* const last = first + cosines_;

    sign_ = -first_sign_;
    largest_ *= kClearly;
    const bool below = SearchUp(-1, std::min(former_first, *first));
    const int32_t found_below = found_;

    sign_ = -last_sign;
    largest_ = std::max(largest_, largest_at_first_) * kClearly;
    const bool above = SearchDown(grid_.size, std::max(former_last, *last), true) == Search::kFound;

    if (below) {
        std::copy_backward(first, last, last + 1);
        *first = found_below;
    } else if (above) {
        std::copy(first + 1, last + 1, first);
        *last = found_;
    }
    if (below || above) ++changes_;
}

// The sum of cosines is known by as many of its values, at equal steps of the frequency.
int32_t RemezExchange::Cosines(double* alpha) const {
    constexpr double kSamePoint = 1e-6;
    const int32_t period = 2 * cosines_ - 1;
    Scratch<double> work(Count(period) + Count(cosines_));
    if (!work) return kOutOfMemory;
    double* const cosine = work.data();  // cos(2 pi i / period)
    double* const response = cosine + period;
    for (int32_t i = 0; i < period; ++i) cosine[i] = std::cos(2.0 * kPi * i / period);

    int32_t point = 0;
    for (int32_t j = 0; j < cosines_; ++j) {
        const double x = cosine[j];
        while (point < cosines_ && x_[point] - x >= kSamePoint) ++point;
        response[j] = std::fabs(x_[point] - x) < kSamePoint ? y_[point] : Response(x);
    }
    for (int32_t k = 0; k < cosines_; ++k) {
        double sum = 0.0;
        for (int32_t j = 1; j < cosines_; ++j) sum += response[j] * cosine[int64_t{j} * k % period];
        alpha[k] = (response[0] + 2.0 * sum) * (k == 0 ? 1.0 : 2.0) / period;
        if (!std::isfinite(alpha[k])) return kBadBands;
    }
    return kOk;
}

}  // namespace krnumer
