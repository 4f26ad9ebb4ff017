#include <algorithm>

#include "filter/median_filter.h"
#include "filter/savitzky_golay.h"
#include "filter/zero_phase.h"
#include "frame/entry.h"
#include "krnumer/filter.h"

using namespace krnumer;

namespace {

int32_t CheckFit(int32_t order, int32_t frame, const In<double>& weights) {
    if (order < 1) return kBadCoefficient;
    if (frame <= order) return kUnderdetermined;
    return weights.size() > 0 && weights.size() != frame ? kSizesDiffer : kOk;
}

const double* DataOrNull(const In<double>& array) {
    return array.size() > 0 ? array.data() : nullptr;
}

// A state that is used. One of another length holds nothing of use.
class State {
  public:
    State(Call& call, KrHandle handle, bool keep) : array_(call, handle), keep_(keep) {}

    int32_t Fit(int32_t length) {
        used_ = true;
        if (array_.size() == length) return kOk;
        keep_ = false;
        return array_.Resize(length);
    }

    double* Prepared() {
        if (used_ && !keep_) std::fill_n(array_.data(), array_.size(), 0.0);
        return array_.data();
    }

  private:
    InOut<double> array_;
    bool keep_;
    bool used_ = false;
};

}  // namespace

int32_t MedianFilterCIN(KrHandle x, const int32_t* rank, int32_t* err) {
    ByReference call(err);
    InOut<double> signal(call, x);
    return call.Run([&] { return MedianFilter(signal.data(), signal.size(), *rank, *rank); });
}

int32_t MedianFilter81_H(KrHandle x, int32_t left, int32_t right) {
    ByValue call;
    InOut<double> signal(call, x);
    return call.Run([&] { return MedianFilter(signal.data(), signal.size(), left, right); });
}

int32_t SavitzkyGolayCoefH(int32_t order, int32_t frame, KrHandle weights, int32_t wantDifferentiators,
                           KrHandle smoothing, KrHandle differentiators) {
    ByValue call;
    In<double> importance(call, weights);
    OutMatrix<double> fits(call, smoothing), derivatives(call, differentiators);
    if (const int32_t status = CheckFit(order, frame, importance)) return call.Fail(status);
    if (fits.Resize(frame, frame)) return call.Fail(kOutOfMemory);
    const bool wanted = wantDifferentiators != 0;
    if (wanted && derivatives.Resize(order + 1, frame)) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        return SavitzkyGolayMatrices(order, frame, DataOrNull(importance), fits.data(),
                                     wanted ? derivatives.data() : nullptr);
    });
}

int32_t SavitzkyGolayFiltH(KrHandle x, int32_t order, int32_t frame, KrHandle weights, KrHandle y) {
    ByValue call;
    In<double> signal(call, x), importance(call, weights);
    Out<double> smoothed(call, y);
    if (const int32_t status = CheckFit(order, frame, importance)) return call.Fail(status);
    if (signal.size() < 0) return call.Fail(kBadDimension);
    if (smoothed.Resize(signal.size())) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        return SavitzkyGolayFilter(signal.data(), signal.size(), order, frame, DataOrNull(importance), smoothed.data());
    });
}

int32_t zeroPhaseFiltH(KrHandle x, KrHandle a, KrHandle b, KrHandle forwardState1, KrHandle forwardState2,
                       KrHandle reverseState1, KrHandle reverseState2, int32_t keepState) {
    ByValue call;
    InOut<double> signal(call, x, Access::kReplacedKept);
    In<double> feedback(call, a), feedforward(call, b);
    const bool keep = keepState != 0;
    State forward1(call, forwardState1, keep), forward2(call, forwardState2, keep);
    State reverse1(call, reverseState1, keep), reverse2(call, reverseState2, keep);
    if (signal.size() < 1) return call.Leave(kEmptyInput);
    const int32_t na = std::max(feedback.size(), 0), nb = feedforward.size();
    if (na < 1 && nb < 1) return call.Leave(kOk);
    if (nb < 1) return call.Fail(kBadDimension);
    if (forward1.Fit(nb - 1) || forward2.Fit(nb - 1)) return call.Fail(kOutOfMemory);
    if (na > 0 && (reverse1.Fit(na - 1) || reverse2.Fit(na - 1))) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        const ZeroPhaseFilter filter{DataOrNull(feedback),
                                     na,
                                     feedforward.data(),
                                     nb,
                                     {forward1.Prepared(), forward2.Prepared()},
                                     {reverse1.Prepared(), reverse2.Prepared()}};
        return FilterBothWays(filter, signal.data(), signal.size());
    });
}
