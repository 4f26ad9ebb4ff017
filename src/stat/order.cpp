#include "stat/order.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <functional>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "stat/quicksort.h"

namespace krnumer {

int32_t SortDoubles(const double* in, int32_t n, int32_t descending, double* out) {
    if (n < 1) return kEmptyInput;
    if (n == 1) return kOk;
    double* first = out != nullptr ? out : const_cast<double*>(in);
    double* last = first + n;
    if (first != in) std::memmove(first, in, Count(n) * sizeof(double));

    const auto is_nan = [](double value) { return std::isnan(value); };
    double* numbers = first;
    if (std::any_of(first, last, is_nan)) {
        numbers = quicksort::Partition(first, last, is_nan);
        std::fill(first, numbers, kQuietNaN);
    }
    if (descending != 0) {
        QuickSort(numbers, last, std::greater<>());
    } else {
        QuickSort(numbers, last, std::less<>());
    }
    return kOk;
}

int32_t Median(const double* x, int32_t n, double* median) {
    if (n < 1) return kEmptyInput;
    Scratch<double> sorted(Count(n));
    if (!sorted) return kOutOfMemory;
    std::copy_n(x, n, sorted.data());
    SortDoubles(sorted.data(), n, 0, nullptr);
    if (std::isnan(sorted[0])) return kHoldsNaN;

    const std::size_t half = Count(n) / 2;
    *median = n % 2 == 0 ? (sorted[half - 1] + sorted[half]) * 0.5 : sorted[half];
    return kOk;
}

int32_t MinMaxIgnoreNaN(const double* x, int32_t n, double* max, int32_t* max_index, double* min, int32_t* min_index) {
    if (n < 1) return kEmptyInput;
    int32_t first = 0;
    while (first < n && std::isnan(x[first])) ++first;
    if (first == n) {
        *max = *min = kQuietNaN;
        *max_index = *min_index = -1;
        return kOk;
    }

    int32_t highest = first;
    int32_t lowest = first;
    double high = x[first];
    double low = x[first];
    for (int32_t i = first + 1; i < n; ++i) {
        if (x[i] > high) {
            high = x[i];
            highest = i;
        }
        if (x[i] < low) {
            low = x[i];
            lowest = i;
        }
    }
    *max = high;
    *max_index = highest;
    *min = low;
    *min_index = lowest;
    return kOk;
}

}  // namespace krnumer
