#include <algorithm>

#include "filter/cascade.h"
#include "filter/direct_form.h"
#include "frame/entry.h"
#include "krnumer/filter.h"

using namespace krnumer;

namespace {

// The one value of `init` by which a filter goes on from the states it is given.
constexpr uint8_t kContinue = 1;

// Gives a state its length. One that had another length holds nothing of use, and the filter starts anew.
template <class T>
int32_t Fit(InOut<T>& state, int32_t length, bool* reset) {
    if (state.size() == length) return kOk;
    *reset = true;
    return state.Resize(length);
}

template <class T>
void Clear(InOut<T>& state) {
    std::fill_n(state.data(), state.size(), T{});
}

// Both states; without feedback the reverse state is left alone.
template <class Input, class Output>
int32_t FitBoth(InOut<Input>& forward, InOut<Output>& reverse, int32_t na, int32_t nb, bool* reset) {
    if (const int32_t host = Fit(forward, nb - 1, reset)) return host;
    return na > 0 ? Fit(reverse, na - 1, reset) : kOk;
}

template <class Input, class Coefficient, class Output, class Source, class Target>
int32_t RunDirectForm(Call& call, Source& source, Target& target, const In<Coefficient>& feedback,
                      const In<Coefficient>& feedforward, InOut<Input>& forward, InOut<Output>& reverse, bool reset) {
    return call.Run([&] {
        const int32_t na = feedback.size();
        if (reset) Clear(forward);
        if (reset && na > 0) Clear(reverse);
        return DirectFormFilter(source.data(), source.size(), na > 0 ? feedback.data() : nullptr, na,
                                feedforward.data(), feedforward.size(), forward.data(), reverse.data(), target.data());
    });
}

template <class Signal, class Coefficient>
int32_t FilterInPlace(KrHandle x, KrHandle a, KrHandle b, KrHandle forward_state, KrHandle reverse_state,
                      const uint8_t* init, int32_t* err) {
    ByReference call(err);
    InOut<Signal> signal(call, x);
    In<Coefficient> feedback(call, a), feedforward(call, b);
    InOut<Signal> forward(call, forward_state), reverse(call, reverse_state);
    if (signal.size() < 1) return call.Leave(kEmptyInput);
    if (feedback.size() < 1 && feedforward.size() < 1) return call.Leave(kOk);
    if (feedforward.size() < 1) return call.Fail(kBadDimension);
    bool reset = *init != kContinue;
    if (auto host = FitBoth(forward, reverse, feedback.size(), feedforward.size(), &reset))
        return call.HostFailure(host);
    return RunDirectForm(call, signal, signal, feedback, feedforward, forward, reverse, reset);
}

template <class Signal>
int32_t FilterBySections(KrHandle x, const int32_t* structure, KrHandle a, KrHandle b, KrHandle state,
                         const uint8_t* init, int32_t* err) {
    ByReference call(err);
    InOut<Signal> signal(call, x);
    In<double> feedback(call, a), feedforward(call, b);
    InOut<Signal> memory(call, state);
    if (signal.size() < 1) return call.Leave(kEmptyInput);
    if (*structure != 0 && *structure != 1) return call.Leave(kBadSelector);
    const int32_t na = std::max(feedback.size(), 0), nb = std::max(feedforward.size(), 0);
    if (na < 1 && nb < 1) return call.Leave(kOk);
    if (na < 1 || nb < 1) return call.Fail(kBadDimension);

    const int32_t section_order = *structure == 0 ? 2 : 4;
    bool reset = *init != kContinue;
    if (auto host = Fit(memory, na / section_order * section_order, &reset)) return call.HostFailure(host);
    return call.Run([&] {
        Cascade<Signal> cascade{*structure == 0 ? na : na / 2,
                                reset,
                                feedback.data(),
                                na,
                                feedforward.data(),
                                nb,
                                memory.data(),
                                memory.size()};
        return CascadeFilter(signal.data(), signal.size(), &cascade);
    });
}

}  // namespace

int32_t IIR_Filter(KrHandle x, KrHandle a, KrHandle b, KrHandle forwardState, KrHandle reverseState,
                   const uint8_t* init, int32_t* err) {
    return FilterInPlace<double, double>(x, a, b, forwardState, reverseState, init, err);
}

int32_t CxSigIIR_Filter(KrHandle x, KrHandle a, KrHandle b, KrHandle forwardState, KrHandle reverseState,
                        const uint8_t* init, int32_t* err) {
    return FilterInPlace<Complex, double>(x, a, b, forwardState, reverseState, init, err);
}

int32_t CxIIR_Filter_H(KrHandle x, KrHandle a, KrHandle b, KrHandle forwardState, KrHandle reverseState,
                       const uint8_t* init, int32_t* err) {
    return FilterInPlace<Complex, Complex>(x, a, b, forwardState, reverseState, init, err);
}

int32_t CxIIRReSig_Filter_H(KrHandle x, KrHandle y, KrHandle a, KrHandle b, KrHandle forwardState,
                            KrHandle reverseState, const uint8_t* init) {
    ByValue call;
    In<double> signal(call, x);
    Out<Complex> filtered(call, y);
    In<Complex> feedback(call, a), feedforward(call, b);
    InOut<double> forward(call, forwardState);
    InOut<Complex> reverse(call, reverseState);
    if (signal.size() < 1) {
        filtered.Empty();
        return call.Leave(kEmptyInput);
    }
    if (feedback.size() < 1 && feedforward.size() < 1) return call.Leave(kOk);
    if (feedforward.size() < 1) return call.Fail(kBadDimension);
    if (filtered.Resize(signal.size())) return call.Fail(kOutOfMemory);
    bool reset = *init != kContinue;
    if (FitBoth(forward, reverse, feedback.size(), feedforward.size(), &reset)) return call.Fail(kOutOfMemory);
    return RunDirectForm(call, signal, filtered, feedback, feedforward, forward, reverse, reset);
}

int32_t IIR_Filter2(KrHandle x, const int32_t* structure, KrHandle a, KrHandle b, KrHandle state, const uint8_t* init,
                    int32_t* err) {
    return FilterBySections<double>(x, structure, a, b, state, init, err);
}

int32_t CxSigIIR_Filter2(KrHandle x, const int32_t* structure, KrHandle a, KrHandle b, KrHandle state,
                         const uint8_t* init, int32_t* err) {
    return FilterBySections<Complex>(x, structure, a, b, state, init, err);
}
