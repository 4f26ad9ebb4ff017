#include <algorithm>
#include <cstddef>
#include <cstring>
#include <limits>

#include "frame/entry.h"
#include "frame/host.h"
#include "krnumer/peak.h"
#include "peak/quadratic_peaks.h"
#include "peak/threshold_peaks.h"

using namespace krnumer;

static_assert(offsetof(KrPeakRecord, threshold) == sizeof(KrHandle));
static_assert(offsetof(KrPeakRecord, locations) == sizeof(KrHandle) + 16);
static_assert(offsetof(KrPeakRecord, count) == 4 * sizeof(KrHandle) + 16);
static_assert(sizeof(KrPeakRecord) == 4 * sizeof(KrHandle) + 24);
static_assert(sizeof(KrPeakState) == 20 + 4 * sizeof(double*));

namespace {

constexpr int32_t kLeastWidth = 3;
constexpr int32_t kGreatestWidth = 1073741824;

// The caller's block of bytes in which a detector keeps its arrays: a count of 8-byte units, then weights (3 widths),
// window, history and the parabola of the last window.
class WorkBlock {
  public:
    explicit WorkBlock(KrHandle* handle) : handle_(handle) {}

    bool exists() const { return handle_ != nullptr && *handle_ != nullptr; }

    [[nodiscard]] bool Make(int32_t width) {
        const int64_t bytes = Bytes(width);
        if (handle_ == nullptr || bytes > std::numeric_limits<int32_t>::max()) return false;
        if (*handle_ == nullptr) {
            *handle_ = host::MakeBlock(static_cast<int32_t>(bytes));
        } else if (host::SizeBlock(*handle_, static_cast<int32_t>(bytes)) != 0) {
            Drop();
        }
        if (*handle_ == nullptr) return false;
        const int32_t units = Units(width);
        std::memcpy(*reinterpret_cast<char**>(*handle_), &units, sizeof units);
        return true;
    }

    bool HasWidth(int32_t width) const {
        if (width < kLeastWidth || Bytes(width) > std::numeric_limits<int32_t>::max()) return false;
        int32_t units;
        std::memcpy(&units, *reinterpret_cast<char**>(*handle_), sizeof units);
        return units == Units(width);
    }

    void Drop() {
        if (!exists()) return;
        host::DropBlock(*handle_);
        *handle_ = nullptr;
    }

    // At the first aligned place behind the count.
    double* weights() const {
        char* const begin = *reinterpret_cast<char**>(*handle_) + sizeof(int32_t);
        const size_t over = reinterpret_cast<uintptr_t>(begin) % alignof(double);
        return reinterpret_cast<double*>(begin + (over == 0 ? 0 : alignof(double) - over));
    }

  private:
    static int64_t Bytes(int32_t width) { return (40 * int64_t{width} + 36 + 7) / 8 * 8; }
    static int32_t Units(int32_t width) { return static_cast<int32_t>(Bytes(width) / 8); }

    KrHandle* handle_;
};

// Begins or goes on with a signal and finds the peaks of one block of it.
int32_t Detect(const KrPeakRecord& record, const In<double>& samples, KrPeakState* state, WorkBlock* work,
               PeakList* peaks) {
    if (record.width < kLeastWidth || record.width > kGreatestWidth) return kBadSelector;
    if (state == nullptr) return kNoState;
    const bool first_block = (record.flags & KRN_FIRST_BLOCK) != 0;
    if (first_block) {
        if (!work->Make(record.width)) return kOutOfMemory;
    } else {
        if (!work->exists() || !work->HasWidth(state->width)) return kNoState;
        if (state->held < 0 || state->held > state->width) return kNoState;
    }
    const int32_t points = first_block ? record.width : state->width;
    if (samples.size() < std::max(record.width, points)) return kBadWidth;

    const auto width = Count(points);
    double* const weights = work->weights();
    double* const window = weights + 3 * width;
    double* const history = window + width;
    double* const previous = history + width;
    if (first_block) {
        *state = {};
        state->width = points;
        if (const int32_t status = DesignParabolaWeights(points, weights)) return status;
        std::fill_n(previous, 3, 0.0);
    }
    PeakScan scan{.width = state->width,
                  .processed = static_cast<uint32_t>(state->processed),
                  .held = state->held,
                  .rising = state->rising != 0,
                  .previous = {previous[0], previous[1], previous[2]},
                  .weights = weights,
                  .window = window,
                  .history = history};
    const PeakCriteria criteria{.valleys = record.polarity != KRN_PEAKS, .threshold = record.threshold};
    const bool last_block = (record.flags & KRN_LAST_BLOCK) != 0;
    const int32_t status = FindQuadraticPeaks(&scan, samples.data(), samples.size(), criteria, last_block, peaks);
    previous[0] = scan.previous.a0;
    previous[1] = scan.previous.a1;
    previous[2] = scan.previous.a2;
    *state = {.width = scan.width,
              .processed = static_cast<int32_t>(scan.processed),
              .held = scan.held,
              .remaining = 0,
              .rising = scan.rising ? 1 : 0,
              .parts = {weights, window, history, previous}};
    return status;
}

}  // namespace

int32_t PeakD(KrPeakRecord* record, KrPeakState* state, KrHandle* work, int32_t* err) {
    ByReference call(err);
    In<double> samples(call, HandleField{&record->input});
    Out<double> locations(call, HandleField{&record->locations});
    Out<double> amplitudes(call, HandleField{&record->amplitudes});
    Out<double> second_derivatives(call, HandleField{&record->second_derivatives});
    WorkBlock block(work);
    PeakList peaks;

    int32_t status = call.Map();
    if (status == kOk) status = Detect(*record, samples, state, &block, &peaks);
    for (Out<double>* output : {&locations, &amplitudes, &second_derivatives}) {
        if (status == kOk && output->Resize(peaks.count())) status = kOutOfMemory;
    }
    if (status == kOk) status = call.Map();
    if (status == kOk) {
        for (int32_t i = 0; i < peaks.count(); ++i) {
            locations.data()[i] = peaks[i].location;
            amplitudes.data()[i] = peaks[i].amplitude;
            second_derivatives.data()[i] = peaks[i].second_derivative;
        }
    }
    record->count = status == kOk ? peaks.count() : 0;
    if (status != kOk || (record->flags & KRN_LAST_BLOCK) != 0) block.Drop();
    call.Deliver(status);
    return status;
}

int32_t PeakDetector(KrHandle x, const double* threshold, const int32_t* width, KrHandle indices, int32_t* count,
                     int32_t* err) {
    ByReference call(err);
    In<double> samples(call, x);
    Out<double> found(call, indices);  // as the host is told; the indices fill the first half of the area
    *count = 0;
    if (samples.size() < 1) return call.Fail(kEmptyInput);
    if (*width < 1 || *width >= samples.size()) return call.Fail(kBadWidth);
    if (auto host = found.Resize(MostThresholdPeaks(samples.size(), *width))) return call.HostFailure(host);
    if (const int32_t status = call.Map()) return call.Fail(status);
    std::fill_n(found.data(), found.size(), 0.0);
    int32_t peaks = 0;
    FindThresholdPeaks(samples.data(), samples.size(), *threshold, *width, reinterpret_cast<int32_t*>(found.data()),
                       &peaks);
    if (auto host = found.Resize(peaks)) return call.HostFailure(host);
    *count = peaks;
    return call.Leave(kOk);
}
