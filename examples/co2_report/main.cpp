// Fits the carbon dioxide of the air above Mauna Loa through the exports of the library, the arrays being libkrrt's:
//
//     co2_report examples/data/co2.csv report.json

#include <cstdlib>
#include <exception>
#include <fstream>
#include <iostream>
#include <stdexcept>
#include <string>
#include <vector>

#include "sections.h"

namespace {

// A year and a value per line, under a heading.
Record Load(const char* path) {
    std::ifstream file(path);
    std::string line;
    if (!std::getline(file, line)) throw std::runtime_error(std::string("cannot read ") + path);
    std::vector<double> years, ppm;
    while (std::getline(file, line)) {
        std::size_t comma = 0;
        years.push_back(std::stod(line, &comma));
        ppm.push_back(std::stod(line.substr(comma + 1)));
    }
    return {Array<double>(years), Array<double>(ppm)};
}

Report Analyse(const Record& record) {
    Report report;
    report.title = "Four decades of carbon dioxide";
    report.text = "Monthly means at Mauna Loa, 1959 to 1997: linear and robust fits, and how sure they are.";
    report.source = "C. D. Keeling and T. P. Whorf, Scripps Institution of Oceanography; public data.";
    const SeasonalFit fit(record);
    for (const auto section : {RecordSection, ResidualSection, BlunderSection, BandSection}) {
        report.sections.push_back(section(record, fit));
    }
    return report;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 3) {
        std::cerr << "usage: co2_report DATA.csv REPORT.json\n";
        return EXIT_FAILURE;
    }
    try {
        const Report report = Analyse(Load(argv[1]));
        Print(report, std::cout);
        WriteJson(report, argv[2]);
        return EXIT_SUCCESS;
    } catch (const std::exception& error) {
        std::cerr << "co2_report: " << error.what() << '\n';
        return EXIT_FAILURE;
    }
}
