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
    for (int32_t i = 0; i < rank; ++i) count *= static_cast<std::size_t>(std::max(dimension(i), 0));
    if (count > room) throw std::length_error("the block is too short for its dimension words");
    return count;
}

KrrtResize ResizeLog::operator[](int32_t i) const {
    KrrtResize call;
    if (KrrtResizeCall(i, &call) == 0) throw std::out_of_range("no such resize");
    return call;
}

namespace {

// Maps doubles to integers in the same order, with 0 and -0 at the same place.
std::int64_t Rank(double x) {
    const auto bits = std::bit_cast<std::int64_t>(x);
    return bits >= 0 ? bits : std::numeric_limits<std::int64_t>::min() - bits;
}

}  // namespace

std::uint64_t UlpDistance(double a, double b) {
    if (std::isnan(a) || std::isnan(b)) return std::numeric_limits<std::uint64_t>::max();
    const auto [low, high] = std::minmax(Rank(a), Rank(b));
    return static_cast<std::uint64_t>(high) - static_cast<std::uint64_t>(low);
}

bool IsNear(double actual, double expected, double relative, double absolute) {
    if (std::isnan(expected)) return std::isnan(actual);
    if (std::isinf(expected)) return actual == expected;
    return std::fabs(actual - expected) <= relative * std::fabs(expected) + absolute;
}

bool IsNear(Complex actual, Complex expected, double relative, double absolute) {
    if (!std::isfinite(expected.re) || !std::isfinite(expected.im)) {
        return IsNear(actual.re, expected.re, relative, absolute) && IsNear(actual.im, expected.im, relative, absolute);
    }
    const double error = std::hypot(actual.re - expected.re, actual.im - expected.im);
    return error <= relative * std::hypot(expected.re, expected.im) + absolute;
}

}  // namespace krnumer
