// Continued fractions by the forward recurrence of their convergents' numerators and denominators.
#pragma once

#include <cmath>

#include "frame/numeric.h"

namespace krnumer {

class ContinuedFraction {
  public:
    // Starts from the last two convergents, p_before / q_before and p / q.
    ContinuedFraction(double p_before, double q_before, double p, double q, double value)
        : p_before_(p_before), q_before_(q_before), p_(p), q_(q), value_(value) {}

    // Goes one level down: ... + a / (b + ...).
    void Append(double a, double b) {
        const double p = p_ * b + p_before_ * a;
        const double q = q_ * b + q_before_ * a;
        p_before_ = p_;
        q_before_ = q_;
        p_ = p;
        q_ = q;
    }

    // Takes the last convergent for the value; the relative change that this makes, or 1 where there is none to take.
    double Update() {
        const double convergent = p_ / q_;
        if (q_ == 0.0 || convergent == 0.0) return 1.0;
        const double change = std::abs((value_ - convergent) / convergent);
        value_ = convergent;
        return change;
    }

    // A common factor of all four does not change the value.
    void KeepFromOverflow() {
        if (std::abs(p_) > kBig) Scale(1.0 / kBig);
    }
    void KeepInRange() {
        if (std::abs(q_) + std::abs(p_) > kBig) Scale(1.0 / kBig);
        if (std::abs(q_) < kEpsilon || std::abs(p_) < kEpsilon) Scale(kBig);
    }

    double value() const { return value_; }

  private:
    static constexpr double kBig = 144115188075855872.0;  // 2^57

    void Scale(double factor) {
        p_before_ *= factor;
        q_before_ *= factor;
        p_ *= factor;
        q_ *= factor;
    }

    double p_before_, q_before_, p_, q_;
    double value_;
};

}  // namespace krnumer
