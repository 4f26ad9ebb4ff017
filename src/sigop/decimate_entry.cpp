#include <bit>

#include "frame/entry.h"
#include "krnumer/sigop.h"
#include "sigop/decimate.h"

using namespace krnumer;

namespace {

template <class T>
int32_t DecimateBlock(Call&& call, KrHandle x, int32_t factor, bool averaging) {
    InOut<T> samples(call, x);
    int32_t count = 0;
    int32_t status = call.Map();
    if (status == kOk) status = Decimate(samples.data(), samples.size(), factor, averaging, &count);
    if (status == kOk && samples.Resize(count) != 0) status = kOutOfMemory;
    return call.Deliver(status);
}

template <class T, class Sum>
int32_t DecimateStream(KrHandle x, int32_t factor, int32_t averaging, int32_t* start, int32_t reset,
                       int32_t* partial_count, Sum* partial_sum) {
    ByValue call;
    InOut<T> samples(call, x);
    DecimationStream<T> stream{*start, *partial_count, std::bit_cast<T>(*partial_sum)};
    int32_t count = 0;
    int32_t status = call.Map();
    if (status == kOk) {
        status =
            DecimateContinuous(samples.data(), samples.size(), factor, averaging != 0, reset != 0, &stream, &count);
    }
    if (status != kOk) return call.Fail(status);
    *start = stream.start;
    *partial_count = stream.partial_count;
    *partial_sum = std::bit_cast<Sum>(stream.partial_sum);
    if (count < 1) {
        samples.Empty();
        return call.Leave(kOk);
    }
    if (samples.Resize(count) != 0) return call.Fail(kOutOfMemory);
    return call.Leave(kOk);
}

}  // namespace

int32_t DecimateCIN(KrHandle x, const int32_t* factor, const uint8_t* averaging, int32_t* err) {
    return DecimateBlock<double>(ByReference(err), x, *factor, *averaging != 0);
}
int32_t CxDecimate_H(KrHandle x, int32_t factor, int32_t averaging) {
    return DecimateBlock<Complex>(ByValue(), x, factor, averaging != 0);
}

int32_t DecimateContinuous_H(KrHandle x, int32_t factor, int32_t averaging, int32_t* start, int32_t reset,
                             int32_t* partialCount, double* partialSum) {
    return DecimateStream<double>(x, factor, averaging, start, reset, partialCount, partialSum);
}
int32_t CxDecimateContinuous_H(KrHandle x, int32_t factor, int32_t averaging, int32_t* start, int32_t reset,
                               int32_t* partialCount, KrComplex* partialSum) {
    return DecimateStream<Complex>(x, factor, averaging, start, reset, partialCount, partialSum);
}
