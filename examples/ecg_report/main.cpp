// Analyses a recorded electrocardiogram through the exports of the library, the arrays being libkrrt's:
//
//     ecg_report examples/data/ecg.csv report.json

#include <cstdlib>
#include <exception>
#include <fstream>
#include <iostream>
#include <stdexcept>
#include <string>
#include <vector>

#include "sections.h"

namespace {

// One sample per line under a heading.
Recording Load(const char* path) {
    std::ifstream file(path);
    std::string line;
    if (!std::getline(file, line)) throw std::runtime_error(std::string("cannot read ") + path);
    std::vector<double> samples;
    while (std::getline(file, line)) samples.push_back(std::stod(line));
    return {Array<double>(samples), 360.0};
}

Report Analyse(const Recording& ecg) {
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
    if (argc != 3) {
        std::cerr << "usage: ecg_report DATA.csv REPORT.json\n";
        return EXIT_FAILURE;
    }
    try {
        const Report report = Analyse(Load(argv[1]));
        Print(report, std::cout);
        WriteJson(report, argv[2]);
        return EXIT_SUCCESS;
    } catch (const std::exception& error) {
        std::cerr << "ecg_report: " << error.what() << '\n';
        return EXIT_FAILURE;
    }
}
