#include "fft/vector_rows.h"

#include "fft/vector_targets.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "fft/vector_rows.cpp"
#include "hwy/foreach_target.h"  // IWYU pragma: keep
//
#include "hwy/highway.h"

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {

namespace hn = hwy::HWY_NAMESPACE;

using Tag = hn::ScalableTag<double>;

template <class MoveVector, class MoveOne>
HWY_INLINE void MoveRows(const double* from, ptrdiff_t from_step, double* to, ptrdiff_t to_step, int32_t rows,
                         int32_t count, const MoveVector& move_vector, const MoveOne& move_one) {
    const auto lanes = static_cast<int32_t>(hn::Lanes(Tag()));
    for (; rows > 0; --rows, from += from_step, to += to_step) {
        int32_t i = 0;
        for (; i + lanes <= count; i += lanes) move_vector(from, to, i);
        for (; i < count; ++i) move_one(from, to, i);
    }
}

void Copy(const double* from, ptrdiff_t from_step, double* to, ptrdiff_t to_step, int32_t rows, int32_t count) {
    MoveRows(
        from, from_step, to, to_step, rows, count,
        [](const double* x, double* y, int32_t i) { hn::StoreU(hn::LoadU(Tag(), x + i), Tag(), y + i); },
        [](const double* x, double* y, int32_t i) { y[i] = x[i]; });
}

void Reverse(const double* from, ptrdiff_t from_step, double* to, ptrdiff_t to_step, int32_t rows, int32_t count) {
    const auto lanes = static_cast<int32_t>(hn::Lanes(Tag()));
    MoveRows(
        from, from_step, to, to_step, rows, count,
        [=](const double* x, double* y, int32_t i) {
            hn::StoreU(hn::Reverse(Tag(), hn::LoadU(Tag(), x + i)), Tag(), y + (count - lanes - i));
        },
        [=](const double* x, double* y, int32_t i) { y[count - 1 - i] = x[i]; });
}

void Stream(const double* from, ptrdiff_t from_step, double* to, ptrdiff_t to_step, int32_t rows, int32_t count) {
    MoveRows(
        from, from_step, to, to_step, rows, count,
        [](const double* x, double* y, int32_t i) { hn::Stream(hn::LoadU(Tag(), x + i), Tag(), y + i); },
        [](const double* x, double* y, int32_t i) { y[i] = x[i]; });
}

}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#if HWY_ONCE
namespace krnumer {

HWY_EXPORT(Copy);
HWY_EXPORT(Reverse);
HWY_EXPORT(Stream);

void CopyRows(const double* from, ptrdiff_t from_step, double* to, ptrdiff_t to_step, int32_t rows, int32_t count) {
    HWY_DYNAMIC_DISPATCH(Copy)(from, from_step, to, to_step, rows, count);
}

void ReverseRows(const double* from, ptrdiff_t from_step, double* to, ptrdiff_t to_step, int32_t rows, int32_t count) {
    HWY_DYNAMIC_DISPATCH(Reverse)(from, from_step, to, to_step, rows, count);
}

void StreamRows(const double* from, ptrdiff_t from_step, double* to, ptrdiff_t to_step, int32_t rows, int32_t count) {
    HWY_DYNAMIC_DISPATCH(Stream)(from, from_step, to, to_step, rows, count);
}

void FlushStreams() {
    hwy::FlushStream();
}

}  // namespace krnumer
#endif
