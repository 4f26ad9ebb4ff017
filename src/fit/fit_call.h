// The call that entry points of curve fits share.
#pragma once

#include <cstring>
#include <optional>

#include "fit/model.h"
#include "fit/weights.h"
#include "frame/entry.h"

namespace krnumer {

// What a fit is given; a null handle stands for an argument that the entry point does not have.
struct FitArguments {
    KrHandle y;
    KrHandle x;
    KrHandle w = nullptr;
    KrHandle init = nullptr;
    bool deviations = false;  // w holds standard deviations
};

// A fit with its coefficients. With `residue` the fitted values take the place of the ordinates; without the values of
// the fit are not wanted. A `residue` that is kept is not written by a call that succeeds.
template <int kCoefficients>
class FitCall {
  public:
    FitCall(const FitArguments& arguments, double* const (&coef)[kCoefficients], double* residue = nullptr,
            bool keep_residue = false)
        : FitCall(arguments, coef, std::make_index_sequence<kCoefficients>(), residue, keep_residue) {}

    // Runs the core(data, init, coef, best_fit, residue): `init`, `best_fit` and `residue` are null where there is
    // none or it is not wanted.
    template <class Core>
    int32_t Run(Core&& core) {
        const int32_t n = y_.size();
        if (x_.size() != n || (w_ && !WeightsFit(*w_, n))) return call_.Fail(kSizesDiffer);
        return call_.Run([&]() -> int32_t {
            FitData data{x_.data(), y_.data(), w_ ? OptionalWeights(*w_) : nullptr, n};
            Scratch<double> weights;
            if (deviations_ && data.w != nullptr) {
                if (const int32_t status = WeightsOfDeviations(data.w, n, &weights)) return status;
                data.w = weights.data();
            }
            const double* const init = init_ && init_->size() >= kCoefficients ? init_->data() : nullptr;
            double coef[kCoefficients] = {};
            const int32_t status =
                core(data, init, coef, wants_fit_ ? y_.data() : nullptr, wants_fit_ ? residue_.data() : nullptr);
            if (status < 0) return status;
            for (int j = 0; j < kCoefficients; ++j) *coef_[j] = coef[j];
            const bool ill_sized = init_ && init_->size() != 0 && init_->size() != kCoefficients;
            return status == kOk && ill_sized ? kWarnInitialIgnored : status;
        });
    }

  private:
    template <size_t... j>
    FitCall(const FitArguments& arguments, double* const (&coef)[kCoefficients], std::index_sequence<j...>,
            double* residue, bool keep_residue)
        : wants_fit_(residue != nullptr && !keep_residue),
          deviations_(arguments.deviations),
          y_(call_, arguments.y, wants_fit_ ? Access::kReplaced : Access::kRead),
          x_(call_, arguments.x),
          coef_{{call_, coef[j]}...},
          residue_(call_, residue != nullptr ? residue : &ignored_) {
        if (arguments.w != nullptr) w_.emplace(call_, arguments.w);
        if (arguments.init != nullptr) init_.emplace(call_, arguments.init);
        if (keep_residue && residue != nullptr) std::memcpy(residue_.data(), residue, sizeof(double));
    }

    ByValue call_;
    bool wants_fit_;
    bool deviations_;
    InOut<double> y_;
    In<double> x_;
    std::optional<In<double>> w_;
    std::optional<In<double>> init_;
    Result<double> coef_[kCoefficients];
    double ignored_ = 0.0;
    Result<double> residue_;
};

// Of arguments that are 16 bits wide the upper half is undefined.
inline int32_t Low16Bits(int32_t argument) {
    return argument & 0xFFFF;
}

}  // namespace krnumer
