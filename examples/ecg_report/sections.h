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

// A statistic that is one number of an array, and the central moment of an order.
double Statistic(int32_t (*statistic)(KrHandle, double*, int32_t*), const char* name, const Array<double>& x);
double Moment(const Array<double>& x, int32_t order);

// The recording less its baseline, a running median, in mV.
Array<double> WithoutBaseline(const Recording& ecg);
// And filtered until nothing but a hill for each beat is left.
Array<double> BeatsAlone(const Recording& ecg);

Section SignalSection(const Recording& ecg);
Section StatisticsSection(const Recording& ecg);
Section WavesSection(const Recording& ecg);
Section WindowsSection(const Recording& ecg);
Section SpectrumSection(const Recording& ecg);
Section RhythmSection(const Recording& ecg);
Section FilterSection(const Recording& ecg);
Section BeatSection(const Recording& ecg);
Section MeasurementSection(const Recording& ecg);
