#include "frame/entry.h"
#include "krnumer/window.h"
#include "window/constants.h"
#include "window/named.h"

using namespace krnumer;

namespace {

// Some failures make the constants NaN and some leave them as they came, so the core writes the whole record.
template <class T>
int32_t Scale(KrHandle x, int32_t type, double parameter, KrWindowConstants* record) {
    ByValue call;
    InOut<T> samples(call, x);
    samples.EmptyAs(kElementKind<double>.type_code);
    WindowConstants constants;
    std::memcpy(&constants, record, sizeof constants);
    const int32_t status =
        call.Run([&] { return ScaledWindow(samples.data(), samples.size(), type, parameter, constants); });
    std::memcpy(record, &constants, sizeof constants);
    return status;
}

template <class T>
int32_t Symmetrise(KrHandle x, int32_t type, double parameter) {
    ByValue call;
    InOut<T> samples(call, x);
    return call.Run([&] { return SymmetricWindow(samples.data(), samples.size(), type, parameter); });
}

}  // namespace

int32_t NumWinConstH(KrHandle x, KrWindowConstants* constants) {
    ByValue call;
    In<double> weights(call, x);
    Result<WindowConstants> measured(call, constants);
    return call.Run([&] { return MeasureWindow(weights.data(), weights.size(), *measured); });
}

int32_t ScaledWinH(KrHandle x, int32_t type, double parameter, KrWindowConstants* constants) {
    return Scale<double>(x, type, parameter, constants);
}
int32_t CxScaledWinH(KrHandle x, int32_t type, double parameter, KrWindowConstants* constants) {
    return Scale<Complex>(x, type, parameter, constants);
}

int32_t SymmWinH(KrHandle x, int32_t type, double parameter) {
    return Symmetrise<double>(x, type, parameter);
}
int32_t CxSymmWinH(KrHandle x, int32_t type, double parameter) {
    return Symmetrise<Complex>(x, type, parameter);
}
