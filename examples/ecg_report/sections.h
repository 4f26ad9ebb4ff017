// The chapters of the analysis, one file each. A new one is a function here, a file beside the others and a line in
// main.cpp.
#pragma once

#include <span>
#include <string>

#include "array.h"
#include "report.h"

struct Recording {
    Array<double> millivolt;
    double rate;  // samples per second

    double seconds() const { return static_cast<double>(millivolt.size()) / rate; }
    std::size_t SampleAt(double time) const { return static_cast<std::size_t>(time * rate); }

    // The samples between two times in seconds.
    std::span<const double> Between(double from, double to) const {
        return millivolt.values().subspan(SampleAt(from), SampleAt(to) - SampleAt(from));
    }
};

Section SignalSection(const Recording& ecg);
Section StatisticsSection(const Recording& ecg);
Section WavesSection(const Recording& ecg);
Section WindowsSection(const Recording& ecg);
Section RhythmSection(const Recording& ecg);
