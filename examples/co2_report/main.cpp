// Fits the carbon dioxide of the air above Mauna Loa through the exports of the library, the arrays being libkrrt's:
//
//     co2_report examples/data/co2.csv report.json

#include <istream>
#include <string>
#include <vector>

#include "sections.h"

namespace {

// A year and a value per line.
Record Load(std::istream& file) {
    std::string line;
    std::vector<double> years, ppm;
    while (std::getline(file, line)) {
        std::size_t comma = 0;
        years.push_back(std::stod(line, &comma));
        ppm.push_back(std::stod(line.substr(comma + 1)));
    }
    return {Array<double>(years), Array<double>(ppm)};
}

Report Analyse(std::istream& file) {
    const Record record = Load(file);
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
    return RunReport(argc, argv, Analyse);
}
