#include "measure/transitions.h"

namespace krnumer::measure {

namespace {

bool Passes(const Signal& signal, int32_t i, double level) {
    return (signal[i] - level) * (signal[i + 1] - level) <= 0.0;
}

Passage PassageAt(const Signal& signal, int32_t i, double level) {
    const double fall = signal[i] - signal[i + 1];
    const double fraction = (signal[i] - level) / (fall == 0.0 ? 1.0 : fall);
    return {i, (fraction + i) * signal.dt() + signal.t0()};
}

}  // namespace

void CrossingList::Extend(const Signal& signal, double level, double band, int64_t wanted) {
    for (; position_ < signal.count() - 1 && size() < wanted; ++position_) {
        const double sample = signal[position_];
        if (sample >= level + band && state_ != State::kHigh) {
            state_ = State::kHigh;
            armed_ = true;
        } else if (sample <= level - band && state_ != State::kLow) {
            state_ = State::kLow;
            armed_ = true;
        }
        if (armed_ && Passes(signal, position_, level)) {
            crossings_.push_back({PassageAt(signal, position_, level).time, state_ == State::kLow});
            armed_ = false;
        }
    }
}

void CrossingList::Clear() {
    crossings_.clear();
    position_ = 0;
    state_ = State::kUnknown;
    armed_ = false;
}

void EdgeList::Extend(const Signal& signal, double lower, double upper, int64_t wanted) {
    for (; position_ < signal.count() - 1 && size() < wanted; ++position_) {
        const double sample = signal[position_];
        if (sample >= upper) {
            state_ = State::kHigh;
        } else if (sample <= lower) {
            state_ = State::kLow;
        }
        if (state_ == State::kUnknown) continue;
        if (Passes(signal, position_, lower)) {
            pending_.lower = PassageAt(signal, position_, lower);
            passed_lower_ = true;
        }
        if (Passes(signal, position_, upper)) {
            pending_.upper = PassageAt(signal, position_, upper);
            passed_upper_ = true;
        }
        if (!passed_lower_ || !passed_upper_) continue;
        pending_.rising = state_ == State::kLow;
        // A plateau right on two levels that coincide passes both at every sample: it is one edge.
        if (edges_.empty() || edges_.back().rising != pending_.rising) edges_.push_back(pending_);
        passed_lower_ = passed_upper_ = false;
    }
}

void EdgeList::Clear() {
    edges_.clear();
    passed_lower_ = passed_upper_ = false;
    position_ = 0;
    state_ = State::kUnknown;
}

}  // namespace krnumer::measure
