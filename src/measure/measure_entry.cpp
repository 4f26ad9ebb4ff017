#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstring>
#include <limits>
#include <new>

#include "frame/status.h"
#include "krnumer/measure.h"
#include "measure/store.h"

using namespace krnumer;
using namespace krnumer::measure;

static_assert(sizeof(KrLevels) == 26 && offsetof(KrLevels, units) == 24);
static_assert(sizeof(KrStateMethod) == 8 && offsetof(KrStateMethod, bins) == 4);
static_assert(sizeof(KrMarkers) == 48 && sizeof(Markers) == 48);

namespace {

constexpr int32_t kSingleCall = -1;

Store store;

// Exceptions end here: the caller may not be C++ at all.
template <class Body>
int32_t Guarded(Body&& body) noexcept {
    try {
        return body();
    } catch (const std::bad_alloc&) {
        return kMeasurementOutOfMemory;
    } catch (...) {
        return kExceptionCaught;
    }
}

template <class Value>
void Deliver(const Value& value, void* target) {
    std::memcpy(target, &value, sizeof value);
}

// Cycles are counted by their first crossing, and every second crossing begins one.
int32_t CountedOccurrence(Kind kind, int32_t occurrence) {
    switch (kind) {
        case Kind::kPeriod:
        case Kind::kFrequency:
        case Kind::kCycleRms:
        case Kind::kCycleMean:
        case Kind::kDutyHigh:
        case Kind::kDutyLow:
            break;
        default:
            return occurrence;
    }
    using Limits = std::numeric_limits<int32_t>;
    return static_cast<int32_t>(std::clamp<int64_t>(2 * int64_t{occurrence} - 1, Limits::min(), Limits::max()));
}

}  // namespace

int32_t measurements_create(uint32_t* id) {
    if (id == nullptr) return kNullResult;
    return Guarded([&] {
        Deliver(store.Create(), id);
        return kOk;
    });
}

int32_t measurements_fetch(int32_t id, int32_t selector, const KrLevels* levels, const KrStateMethod* method,
                           int32_t occurrence, double t0, double dt, const double* samples, int32_t count,
                           double* result, KrMarkers* box) {
    if (levels == nullptr || method == nullptr) return kNullRecord;
    const double margin = std::min(levels->high - levels->mid, levels->mid - levels->low);
    if (margin < 0.0) return kLevelsOutOfOrder;
    if (result == nullptr) return kNullResult;
    if (box == nullptr) return kNullMarkers;
    if (samples == nullptr) return kNoSamples;
    Deliver(0.0, result);
    const Kind kind{selector};
    if (kind == Kind::kNothing) return kOk;

    return Guarded([&] {
        const Parameters parameters{margin,        levels->low,  levels->mid,    levels->high,
                                    levels->units, method->bins, method->method, CountedOccurrence(kind, occurrence)};
        const Signal signal(samples, count, t0, dt);
        Reading reading;
        int32_t status;
        if (id == kSingleCall) {
            status = Context().Fetch(parameters, kind, signal, &reading);
        } else {
            const auto context = store.Find(static_cast<uint32_t>(id));
            if (context == nullptr) return kUnknownContext;
            status = context->Fetch(parameters, kind, signal, &reading);
        }
        if (status == kOk && !std::isfinite(reading.value)) return kResultNotFinite;
        Deliver(reading.value, result);
        if (status == kOk) Deliver(reading.markers, box);
        return status;
    });
}

int32_t measurements_clear(int32_t id) {
    return Guarded([&] {
        const auto context = store.Find(static_cast<uint32_t>(id));
        if (context == nullptr) return kUnknownContext;
        context->Clear();
        return kOk;
    });
}

int32_t measurements_destroy(int32_t id) {
    return Guarded([&] { return store.Remove(static_cast<uint32_t>(id)) != nullptr ? kOk : kUnknownContext; });
}
