// Analyses a recorded electrocardiogram through the exports of the library, the arrays being libkrrt's:
//
//     ecg_report examples/data/ecg.csv report.json

#include <istream>
#include <string>
#include <vector>

#include "sections.h"

namespace {

// One sample per line.
Recording Load(std::istream& file) {
    std::string line;
    std::vector<double> samples;
    while (std::getline(file, line)) samples.push_back(std::stod(line));
    return {Array<double>(samples), 360.0};
}

Report Analyse(std::istream& file) {
    const Recording ecg = Load(file);
    Report report;
    report.title = "A minute of an electrocardiogram";
    report.text =
        "The figures on this page come from the exported functions of krnumer, called from C++ with the arrays of its "
        "small host.";
    report.source =
        "Record 208 of the MIT-BIH Arrhythmia Database, lead MLII, from 19:35 on; PhysioNet, Open Data Commons "
        "Attribution License 1.0. G. B. Moody and R. G. Mark, IEEE Eng. in Med. and Biol. 20(3):45-50 (2001); A. L. "
        "Goldberger et al., Circulation 101(23):e215-e220 (2000).";
    for (const auto section : {SignalSection, StatisticsSection, WavesSection, WindowsSection, SpectrumSection,
                               RhythmSection, FilterSection, BeatSection, MeasurementSection}) {
        report.sections.push_back(section(ecg));
    }
    return report;
}

}  // namespace

int main(int argc, char** argv) {
    return RunReport(argc, argv, Analyse);
}
