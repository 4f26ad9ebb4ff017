#include "support/host_arrays.h"

#include <algorithm>
#include <new>
#include <stdexcept>

namespace krnumer {

HostBlock::HostBlock(KrHandle handle) : handle_(handle) {
    if (handle == nullptr) throw std::bad_alloc();
}

bool HostBlock::empty() const {
    for (int32_t i = 0; i < KrrtRank(handle_); ++i) {
        if (dimension(i) != 0) return false;
    }
    return true;
}

std::size_t HostBlock::Count(std::size_t element_bytes) const {
    const int32_t rank = KrrtRank(handle_);
    const std::size_t room = (KrrtBytes(handle_) - static_cast<std::size_t>(rank) * sizeof(int32_t)) / element_bytes;
    std::size_t count = 1;
    for (int32_t i = 0; i < rank; ++i) {
        if (dimension(i) <= 0) return 0;
        count = std::min(count, room + 1) * static_cast<std::size_t>(dimension(i));  // no product overflows
    }
    if (count > room) throw std::length_error("the block is too short for its dimension words");
    return count;
}

KrrtResize ResizeLog::operator[](int32_t i) const {
    KrrtResize call;
    if (KrrtResizeCall(i, &call) == 0) throw std::out_of_range("no such resize");
    return call;
}

}  // namespace krnumer
