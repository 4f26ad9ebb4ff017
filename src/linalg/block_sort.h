// Bubble sort of the diagonal blocks of a Schur form, whose exchanges are made by LAPACK.
#pragma once

#include <algorithm>
#include <cstdint>

namespace krnumer {

// sizes[i] is the size of the block that begins at position i, 1 or 2, and 0 at the second position of a block.
// exchange(i, size) exchanges the block at i with the next one and returns a status; out_of_order(i, j) compares the
// blocks at i and j; rotate(first, middle, last) moves what is kept about the positions along with the blocks.
template <class OutOfOrder, class Exchange, class Rotate>
int32_t SortBlocks(int32_t* sizes, int32_t n, OutOfOrder out_of_order, Exchange exchange, Rotate rotate) {
    for (int32_t end = n - 1; end >= 1; --end) {
        if (sizes[end] == 0) continue;
        for (int32_t i = 0; i < end;) {
            const int32_t size = sizes[i];
            const int32_t next = i + size;
            if (next > end) break;
            if (!out_of_order(i, next)) {
                i = next;
                continue;
            }
            if (const int32_t status = exchange(i, size)) return status;
            const int32_t last = next + sizes[next];
            std::rotate(sizes + i, sizes + next, sizes + last);
            rotate(i, next, last);
            i = last - size;
        }
    }
    return 0;
}

}  // namespace krnumer
