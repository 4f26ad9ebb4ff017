#include "frame/entry.h"
#include "krnumer/stat.h"
#include "stat/moments.h"
#include "stat/order.h"

using namespace krnumer;

namespace {

// One scalar out of one array.
template <class Core>
int32_t Summarise(KrHandle x, double* target, int32_t* err, Core core) {
    ByReference call(err);
    In<double> samples(call, x);
    Result<double> result(call, target);
    return call.Run([&] { return core(samples.data(), samples.size(), result.data()); });
}

}  // namespace

int32_t Mean_head(KrHandle x, double* mean, int32_t* err) {
    return Summarise(x, mean, err, Mean);
}

int32_t Median_head(KrHandle x, double* median, int32_t* err) {
    return Summarise(x, median, err, Median);
}

int32_t RMS_head(KrHandle x, double* rms, int32_t* err) {
    return Summarise(x, rms, err, RootMeanSquare);
}

int32_t Moment_head(KrHandle x, const int32_t* order, double* moment, int32_t* err) {
    return Summarise(x, moment, err, [order](const double* samples, int32_t n, double* result) {
        return Moment(samples, n, *order, result);
    });
}

int32_t MSE_head(KrHandle x, KrHandle y, double* mse, int32_t* err) {
    ByReference call(err);
    In<double> samples(call, x);
    In<double> others(call, y);
    Result<double> result(call, mse);
    return call.Run(
        [&] { return MeanSquareError(samples.data(), samples.size(), others.data(), others.size(), result.data()); });
}
