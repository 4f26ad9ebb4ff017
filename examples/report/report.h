// What the analysis found, as plain data: sections of figures, tables and plots. It is printed as text and written as
// JSON, of which tools/report makes the page; a new section needs nothing new in either.
#pragma once

#include <cstdint>
#include <iosfwd>
#include <span>
#include <string>
#include <vector>

// One curve of a plot.
struct Series {
    std::string kind;  // "line", "points", "columns", "band" from y to upper, "mark", a vertical line at each x, or
                       // "level", a horizontal one at each y
    std::string name;
    std::vector<double> x, y;
    std::vector<double> upper = {};
};

// Samples at the equal distance `step` from `start` on.
Series Line(const std::string& name, std::span<const double> samples, double step = 1.0, double start = 0.0);
Series Line(const std::string& name, std::span<const double> x, std::span<const double> y);
Series Points(const std::string& name, std::span<const double> x, std::span<const double> y);
Series Columns(const std::string& name, std::span<const double> centers, std::span<const int32_t> counts);
Series Band(const std::string& name, std::span<const double> x, std::span<const double> lower,
            std::span<const double> upper);
Series Mark(const std::string& name, double x);
Series Level(const std::string& name, double y);

struct Plot {
    std::string title;
    std::string x_label;
    std::string y_label;
    std::vector<Series> series;
};

struct Value {
    std::string name;
    double value;
    std::string unit;
};

struct Table {
    std::string title;
    std::vector<std::string> columns;
    std::vector<std::vector<std::string>> rows;
};

struct Section {
    std::string title;
    std::string text;
    std::vector<Value> values;
    std::vector<Table> tables;
    std::vector<Plot> plots;
};

struct Report {
    std::string title;
    std::string text;
    std::string source;
    std::vector<Section> sections;
};

// A number with the given digits after the point.
std::string Number(double value, int digits);

void Print(const Report& report, std::ostream& out);
void WriteJson(const Report& report, const std::string& path);

// The main program of every report: opens argv[1] behind its heading line, prints the report to standard output and
// writes it to argv[2].
int RunReport(int argc, char** argv, Report (*analyse)(std::istream& data));
