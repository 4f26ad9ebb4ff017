// What all waveform measurements share: the signal they read, the parameters they are asked with, and the object that
// computes one value once.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <cstring>

namespace krnumer::measure {

// The measurements by the numbers under which a caller asks for them. The rest of the numbers has none.
enum class Kind : int32_t {
    kSmallest,
    kLargest,
    kRange,
    kLowState,
    kHighState,
    kAmplitude,
    kTop,
    kBase,
    kTopToBase,
    kLowReference,
    kMidReference,
    kHighReference,
    kBand,
    kRms,
    kMean,
    kPeriod,
    kFrequency,
    kCycleRms,
    kCycleMean,
    kFallTime,
    kRiseTime,
    kPositiveWidth = 22,
    kNegativeWidth,
    kDutyHigh,
    kDutyLow,
    kUndershoot,
    kOvershoot,
    kNextOvershoot,
    kNextUndershoot,
    kPositiveCenter,
    kNegativeCenter,
    kRisingSlew,
    kFallingSlew,
    kNothing
};

// Samples on the time axis of their caller. They are read wherever they stand, aligned or not.
class Signal {
  public:
    Signal(const double* samples, int32_t count, double t0, double dt)
        : bytes_(reinterpret_cast<const unsigned char*>(samples)), count_(count), t0_(t0), dt_(dt) {}

    double operator[](int32_t i) const {
        double sample;
        std::memcpy(&sample, bytes_ + static_cast<size_t>(i) * sizeof sample, sizeof sample);
        return sample;
    }
    int32_t count() const { return count_; }
    double t0() const { return t0_; }
    double dt() const { return dt_; }
    double end() const { return t0_ + count_ * dt_; }

  private:
    const unsigned char* bytes_;
    int32_t count_;
    double t0_;
    double dt_;
};

// How the levels of a signal are given, and which stretch of it is asked for.
struct Parameters {
    enum Units : int32_t { kAbsolute, kPercent };
    enum StateMethod : int32_t { kHistogram, kExtremes, kHistogramOrExtremes };

    double margin;  // the lesser of the distances of the outer levels from the middle one
    double low;
    double mid;
    double high;
    int32_t units;
    int32_t bins;
    int32_t state_method;
    int32_t occurrence;  // for what is measured over a cycle: the number of the cycle's first crossing

    bool operator==(const Parameters&) const = default;
};

// Where a host draws the value into the signal: a left and a right time, and what the measurement adds.
using Markers = std::array<double, 6>;

struct Reading {
    double value = 0.0;
    Markers markers{};
};

class Graph;

// One measurement of a graph. It asks the graph for the others that it builds on.
class Measurement {
  public:
    Measurement(Graph& graph, Kind kind) : graph_(graph), kind_(kind) {}
    Measurement(const Measurement&) = delete;
    Measurement& operator=(const Measurement&) = delete;
    virtual ~Measurement() = default;

    // The reading kept from before, or else a new one. A failure keeps nothing.
    int32_t Evaluate(const Signal& signal, Reading* reading) {
        if (!computed_) {
            if (const int32_t status = Compute(signal, reading)) return status;
            Store(*reading);
        }
        *reading = kept_;
        return 0;
    }

    // Takes a reading that another measurement came by.
    void Store(const Reading& reading) {
        kept_ = reading;
        computed_ = true;
    }
    void Clear() { computed_ = false; }

  protected:
    virtual int32_t Compute(const Signal& signal, Reading* reading) = 0;

    Graph& graph() const { return graph_; }
    Kind kind() const { return kind_; }
    bool computed() const { return computed_; }
    const Reading& kept() const { return kept_; }

  private:
    Graph& graph_;
    Kind kind_;
    bool computed_ = false;
    Reading kept_;
};

}  // namespace krnumer::measure
