// Moving sums that go on from block to block, for filters before a decimation (E. B. Hogenauer, IEEE Trans. ASSP 29,
// 155, 1981). Neither divides by its window.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <utility>

#include "frame/numeric.h"

namespace krnumer {

// Several moving sums side by side, so that the additions of one do not wait for those of another.
template <class T, std::size_t... kStages>
void NextMovingSums(std::index_sequence<kStages...>, T* x, int32_t n, int32_t window, int32_t position, T* sums,
                    T* history) {
    T sum[] = {sums[kStages]...};
    for (int32_t i = 0; i < n; position = 0) {
        const int32_t end = i + std::min(n - i, window - position);
        for (T* ring = history + position; i < end; ++i, ++ring) {
            T value = x[i];
            const auto pass = [&value](T& oldest, T& running) {
                const T change = value - oldest;
                oldest = value;
                value = running += change;
            };
            (pass(ring[kStages * Count(window)], sum[kStages]), ...);
            x[i] = value;
        }
    }
    ((sums[kStages] = sum[kStages]), ...);
}

// Runs x[0..n) through `stages` moving sums of width `window`, one after the other, in place. `sums` holds the sum of
// each stage, a row of `history` its last inputs as a ring, in which `index` is the position of the next one; a
// position of `window` counts as 0. What a sum has once taken in leaves it by subtraction only, so a NaN stays.
template <class T>
void CascadedMovingSums(T* x, int32_t n, int32_t stages, int32_t window, T* sums, T* history, int32_t* index) {
    if (n < 1 || window < 1) return;
    const int32_t first = *index < window ? *index : 0;
    const auto run = [&](auto together) {
        NextMovingSums(together, x, n, window, first, sums, history);
        sums += together.size();
        history += together.size() * Count(window);
    };
    for (; stages >= 4; stages -= 4) run(std::make_index_sequence<4>());
    if (stages == 3) run(std::make_index_sequence<3>());
    if (stages == 2) run(std::make_index_sequence<2>());
    if (stages == 1) run(std::make_index_sequence<1>());
    *index = static_cast<int32_t>((std::int64_t{first} + n) % window);
}

// Sums x[0..n) in blocks of `width` samples, from 2 on; the sums take the place of the first samples, and their number
// is returned. `sum` and `count`, below `width`, are those of the block that is still open.
template <class T>
int32_t DecimatedMovingSums(T* x, int32_t n, int32_t width, T* sum, int32_t* count) {
    const auto outputs = static_cast<int32_t>((std::int64_t{*count} + n) / width);
    T open = *sum;
    int32_t held = *count;
    int32_t next = 0;
    for (int32_t k = 0; k < outputs; ++k) {
        for (; held < width; ++held) open += x[next++];
        x[k] = open;
        open = T{};
        held = 0;
    }
    for (; next < n; ++held) open += x[next++];
    *sum = open;
    *count = held;
    return outputs;
}

}  // namespace krnumer
