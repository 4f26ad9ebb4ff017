#include <type_traits>

#include "frame/entry.h"
#include "krnumer/window.h"
#include "window/cosine_sum.h"
#include "window/dolph_chebyshev.h"
#include "window/generated.h"
#include "window/shaped.h"

using namespace krnumer;

namespace {

// Weighs the samples in place. The kernels make all the checks; one that fails costs the caller the samples.
template <class T, class... Parameters>
int32_t Weigh(Call&& call, KrHandle x, int32_t (*kernel)(T*, int32_t, Parameters...),
              std::type_identity_t<Parameters>... parameters) {
    InOut<T> samples(call, x);
    return call.Run([&] { return kernel(samples.data(), samples.size(), parameters...); });
}

template <class T>
int32_t WeighByCosines(KrHandle x, KrHandle coefficients, bool scaled) {
    ByValue call;
    InOut<T> samples(call, x);
    In<double> terms(call, coefficients);
    return call.Run(
        [&] { return CosineSumWindow(samples.data(), samples.size(), terms.data(), terms.size(), scaled); });
}

}  // namespace

int32_t AllCosWinH(KrHandle x, int32_t type, int32_t scaled) {
    return Weigh(ByValue(), x, NamedCosineWindow<double>, type, scaled != 0);
}
int32_t CxAllCosWinH(KrHandle x, int32_t type, int32_t scaled) {
    return Weigh(ByValue(), x, NamedCosineWindow<Complex>, type, scaled != 0);
}

int32_t GenCosWinH(KrHandle x, KrHandle coefficients) {
    return WeighByCosines<double>(x, coefficients, false);
}
int32_t CxGenCosWinH(KrHandle x, KrHandle coefficients) {
    return WeighByCosines<Complex>(x, coefficients, false);
}
int32_t ScaledGenCosWinH(KrHandle x, KrHandle coefficients) {
    return WeighByCosines<double>(x, coefficients, true);
}
int32_t ScaledCxGenCosWinH(KrHandle x, KrHandle coefficients) {
    return WeighByCosines<Complex>(x, coefficients, true);
}

int32_t BartHannWinH(KrHandle x) {
    return Weigh(ByValue(), x, BartlettHanningWindow<double>);
}
int32_t CxBartHannWinH(KrHandle x) {
    return Weigh(ByValue(), x, BartlettHanningWindow<Complex>);
}

int32_t BohmanWinH(KrHandle x) {
    return Weigh(ByValue(), x, BohmanWindow<double>);
}
int32_t CxBohmanWinH(KrHandle x) {
    return Weigh(ByValue(), x, BohmanWindow<Complex>);
}

int32_t ParzenWinH(KrHandle x) {
    return Weigh(ByValue(), x, ParzenWindow<double>);
}
int32_t CxParzenWinH(KrHandle x) {
    return Weigh(ByValue(), x, ParzenWindow<Complex>);
}

int32_t WelchWinH(KrHandle x) {
    return Weigh(ByValue(), x, WelchWindow<double>);
}
int32_t CxWelchWinH(KrHandle x) {
    return Weigh(ByValue(), x, WelchWindow<Complex>);
}

int32_t TriangleWinH(KrHandle x) {
    return Weigh(ByValue(), x, TriangleWindow<double>);
}
int32_t CxTriangleWinH(KrHandle x) {
    return Weigh(ByValue(), x, TriangleWindow<Complex>);
}
int32_t TriangleWin(KrHandle x, int32_t* err) {
    return Weigh(ByReference(err), x, TriangleWindow<double>);
}

int32_t CosTaperedH(KrHandle x, double fraction) {
    return Weigh(ByValue(), x, CosineTaper<double>, fraction);
}
int32_t CxCosTaperedH(KrHandle x, double fraction) {
    return Weigh(ByValue(), x, CosineTaper<Complex>, fraction);
}
int32_t CosTapered(KrHandle x, int32_t* err) {
    return Weigh(ByReference(err), x, CosineTaper<double>, 0.2);
}

int32_t ExpWinH(KrHandle x, double finalValue) {
    return Weigh(ByValue(), x, ExponentialWindow<double>, finalValue);
}
int32_t CxExpWinH(KrHandle x, double finalValue) {
    return Weigh(ByValue(), x, ExponentialWindow<Complex>, finalValue);
}
int32_t ExpWindCIN(KrHandle x, const double* finalValue, int32_t* err) {
    return Weigh(ByReference(err), x, ExponentialWindow<double>, *finalValue);
}

int32_t ForceWinH(KrHandle x, double duty) {
    return Weigh(ByValue(), x, ForceWindow<double>, duty);
}
int32_t CxForceWinH(KrHandle x, double duty) {
    return Weigh(ByValue(), x, ForceWindow<Complex>, duty);
}
int32_t ForceWindCIN(KrHandle x, const double* duty, int32_t* err) {
    return Weigh(ByReference(err), x, ForceWindow<double>, *duty);
}

int32_t KaiserH(KrHandle x, double beta) {
    return Weigh(ByValue(), x, KaiserWindow<double>, beta);
}
int32_t CxKaiserH(KrHandle x, double beta) {
    return Weigh(ByValue(), x, KaiserWindow<Complex>, beta);
}
int32_t Kaiser_Bessel(KrHandle x, const double* beta, int32_t* err) {
    return Weigh(ByReference(err), x, KaiserWindow<double>, *beta);
}

int32_t GaussWinH(KrHandle x, double sigma, int32_t symmetric) {
    return Weigh(ByValue(), x, GaussianWindow<double>, sigma, symmetric != 0);
}
int32_t CxGaussWinH(KrHandle x, double sigma, int32_t symmetric) {
    return Weigh(ByValue(), x, GaussianWindow<Complex>, sigma, symmetric != 0);
}

int32_t DolChebyWinH(KrHandle x, double ratio, int32_t symmetric) {
    return Weigh(ByValue(), x, DolphChebyshevWindow<double>, ratio, symmetric != 0);
}
int32_t CxDolChebyWinH(KrHandle x, double ratio, int32_t symmetric) {
    return Weigh(ByValue(), x, DolphChebyshevWindow<Complex>, ratio, symmetric != 0);
}
