#include <algorithm>

#include "fit/robust.h"
#include "stat/quicksort.h"

namespace krnumer {

namespace {

struct Weighed {
    double value;
    double weight;
};

// The value at which the weights, added in ascending order, reach half their sum; the last one where they never do.
double WeightedMedian(Weighed* points, int32_t count) {
    QuickSort(points, points + count, [](const Weighed& a, const Weighed& b) { return a.value < b.value; });
    double half = 0.0;
    for (int32_t i = 0; i < count; ++i) half += points[i].weight;
    half *= 0.5;
    double sum = 0.0;
    for (int32_t i = 0; i < count; ++i) {
        sum += points[i].weight;
        if (sum >= half) return points[i].value;
    }
    return points[count - 1].value;
}

double MeanAbsResidual(const FitData& data, const double* coef, double* values) {
    EvaluateModel(LineModel{}, coef, data.x, data.n, values);
    return FitMeanAbsResidual(values, data.y, data.w, data.n);
}

}  // namespace

int32_t LeastAbsoluteLine(const FitData& data, double tol, double msetol, double* coef, int32_t* steps,
                          double* best_fit, double* residue) {
    if (data.n < 2) return kFewerThanTwo;
    const int32_t budget = *steps;
    AbsoluteSearch<2> search;
    auto& [current, residual] = search.current;
    int32_t t = 0;
    if (data.n == 2) {
        LineThroughBoth(data, current);
        residual = 1.0;  // by convention
        search.Start();
    } else {
        if (const int32_t status = LineFitter{}.Fit(data, nullptr, 0.0, 0, current)) return status;
        if (std::count(data.x, data.x + data.n, 0.0) > 1) return kTableTooSmall;
        Scratch<double> values(Count(data.n));
        Scratch<Weighed> points(Count(data.n));
        if (!values || !points) return kOutOfMemory;
        residual = MeanAbsResidual(data, current, values.data());
        search.Start();
        while (t < budget && !search.Settled(RelativeTolerance(tol), SquaredErrorFloor(msetol))) {
            search.previous = search.current;
            int32_t count = 0;
            for (int32_t i = 0; i < data.n; ++i) {  // a point at x = 0 says nothing about the slope
                const double x = data.x[i];
                if (x != 0.0) points[Count(count++)] = {(data.y[i] - current[1]) / x, std::fabs(x * WeightOf(data, i))};
            }
            current[0] = WeightedMedian(points.data(), count);
            for (int32_t i = 0; i < data.n; ++i)
                points[Count(i)] = {data.y[i] - current[0] * data.x[i], WeightOf(data, i)};
            current[1] = WeightedMedian(points.data(), data.n);
            residual = MeanAbsResidual(data, current, values.data());
            ++t;
            if (std::isnan(current[0]) && std::isnan(current[1])) t = budget;  // for good
        }
    }
    *steps = t;
    const auto& least = search.Least();
    std::copy_n(least.coef, 2, coef);
    if (best_fit == nullptr || residue == nullptr) return kOk;
    EvaluateModel(LineModel{}, coef, data.x, data.n, best_fit);
    *residue = least.residue;
    return kOk;
}

}  // namespace krnumer
