#include "report.h"

#include <algorithm>
#include <cstdlib>
#include <exception>
#include <fstream>
#include <iomanip>
#include <iostream>
#include <nlohmann/json.hpp>
#include <ostream>
#include <sstream>
#include <stdexcept>

NLOHMANN_DEFINE_TYPE_NON_INTRUSIVE(Series, kind, name, x, y, upper)
NLOHMANN_DEFINE_TYPE_NON_INTRUSIVE(Plot, title, x_label, y_label, series)
NLOHMANN_DEFINE_TYPE_NON_INTRUSIVE(Value, name, value, unit)
NLOHMANN_DEFINE_TYPE_NON_INTRUSIVE(Table, title, columns, rows)
NLOHMANN_DEFINE_TYPE_NON_INTRUSIVE(Section, title, text, values, tables, plots)
NLOHMANN_DEFINE_TYPE_NON_INTRUSIVE(Report, title, text, source, sections)

Series Line(const std::string& name, std::span<const double> samples, double step, double start) {
    Series series{"line", name, {}, {samples.begin(), samples.end()}};
    for (std::size_t i = 0; i < samples.size(); ++i) series.x.push_back(start + static_cast<double>(i) * step);
    return series;
}

Series Line(const std::string& name, std::span<const double> x, std::span<const double> y) {
    return {"line", name, {x.begin(), x.end()}, {y.begin(), y.end()}};
}

Series Points(const std::string& name, std::span<const double> x, std::span<const double> y) {
    return {"points", name, {x.begin(), x.end()}, {y.begin(), y.end()}};
}

Series Columns(const std::string& name, std::span<const double> centers, std::span<const int32_t> counts) {
    return {"columns", name, {centers.begin(), centers.end()}, {counts.begin(), counts.end()}};
}

Series Band(const std::string& name, std::span<const double> x, std::span<const double> lower,
            std::span<const double> upper) {
    return {"band", name, {x.begin(), x.end()}, {lower.begin(), lower.end()}, {upper.begin(), upper.end()}};
}

Series Mark(const std::string& name, double x) {
    return {"mark", name, {x}, {}};
}

Series Level(const std::string& name, double y) {
    return {"level", name, {}, {y}};
}

std::string Number(double value, int digits) {
    std::ostringstream text;
    text << std::fixed << std::setprecision(digits) << value;
    return text.str();
}

namespace {

void Print(const Table& table, std::ostream& out) {
    std::vector<int> widths;
    for (const std::string& column : table.columns) widths.push_back(static_cast<int>(column.size()));
    for (const auto& row : table.rows) {
        for (std::size_t i = 0; i < row.size(); ++i) widths[i] = std::max(widths[i], static_cast<int>(row[i].size()));
    }
    const auto print_row = [&](const std::vector<std::string>& row) {
        for (std::size_t i = 0; i < row.size(); ++i) {
            out << "  " << (i == 0 ? std::left : std::right) << std::setw(widths[i]) << row[i];
        }
        out << '\n';
    };
    out << "\n  " << table.title << '\n';
    print_row(table.columns);
    for (const auto& row : table.rows) print_row(row);
}

}  // namespace

void Print(const Report& report, std::ostream& out) {
    out << report.title << '\n';
    for (const Section& section : report.sections) {
        out << '\n' << section.title << '\n';
        for (const Value& value : section.values) {
            out << "  " << std::left << std::setw(34) << value.name << std::right << std::setw(12) << value.value << ' '
                << value.unit << '\n';
        }
        for (const Table& table : section.tables) Print(table, out);
    }
}

void WriteJson(const Report& report, const std::string& path) {
    std::ofstream file(path);
    file << nlohmann::json(report);
    if (!file.flush()) throw std::runtime_error("cannot write " + path);
}

int RunReport(int argc, char** argv, Report (*analyse)(std::istream& data)) {
    if (argc != 3) {
        std::cerr << "usage: " << argv[0] << " DATA.csv REPORT.json\n";
        return EXIT_FAILURE;
    }
    try {
        std::ifstream file(argv[1]);
        std::string heading;
        if (!std::getline(file, heading)) throw std::runtime_error(std::string("cannot read ") + argv[1]);
        const Report report = analyse(file);
        Print(report, std::cout);
        WriteJson(report, argv[2]);
        return EXIT_SUCCESS;
    } catch (const std::exception& error) {
        std::cerr << argv[0] << ": " << error.what() << '\n';
        return EXIT_FAILURE;
    }
}
