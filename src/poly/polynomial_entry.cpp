#include <algorithm>

#include "frame/entry.h"
#include "krnumer/polynomial.h"
#include "poly/evaluation.h"
#include "poly/gcd.h"
#include "poly/guessed_roots.h"

using namespace krnumer;

int32_t PolyEv(KrHandle x, KrHandle coef, int32_t* err) {
    ByReference call(err);
    InOut<double> values(call, x);
    In<double> coefficients(call, coef);
    return call.Run(
        [&] { return EvaluatePowers(values.data(), values.count(), coefficients.data(), coefficients.size()); });
}

int32_t EvPoly2D(KrHandle x, KrHandle coef, int32_t* err) {
    ByReference call(err);
    InOutMatrix<double> values(call, x);
    In<double> coefficients(call, coef);
    return call.Run(
        [&] { return EvaluatePowers(values.data(), values.count(), coefficients.data(), coefficients.size()); });
}

int32_t PolyRootsNtBst_head(KrHandle coef, KrHandle newtonGuesses, int32_t newtonLimit, double newtonTol,
                            KrHandle pairGuesses, int32_t pairLimit, double pairTol, KrHandle roots) {
    ByValue call;
    In<double> coefficients(call, coef);
    In<double> guesses(call, newtonGuesses);
    In<Complex> pairs(call, pairGuesses);
    Out<Complex> found(call, roots);
    if (coefficients.size() < 1) return call.Fail(kWarnEmptyPolynomial);  // a warning that leaves nothing behind
    // A malformed array of guesses holds none: its count must not take from the room of the other's roots.
    const int32_t real_count = std::max(guesses.size(), 0);
    const int32_t pair_count = std::max(pairs.size(), 0);
    if (found.Resize(WrappingAdd(real_count, pair_count))) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        return RootsFromGuesses(coefficients.data(), coefficients.size(), guesses.data(), real_count, newtonLimit,
                                newtonTol, pairs.data(), pair_count, pairLimit, pairTol, found.data());
    });
}

namespace {

template <class T>
int32_t Gcd(KrHandle p, KrHandle q, double tol, KrHandle gcd, KrHandle p_cofactor, KrHandle q_cofactor,
            int32_t want_cofactors) {
    ByValue call;
    In<T> first(call, p);
    In<T> second(call, q);
    Out<T> divisor(call, gcd);
    Out<T> first_rest(call, p_cofactor);
    Out<T> second_rest(call, q_cofactor);
    Polynomial<T> g;
    Polynomial<T> u;
    Polynomial<T> v;
    int32_t status = call.Map();
    if (status == kOk) status = PolyGCDCore(first.data(), first.size(), second.data(), second.size(), tol, &g, &u, &v);
    if (status != kOk) return call.Fail(status);
    const auto deliver = [](Out<T>& to, const Polynomial<T>& from) {
        if (to.Resize(from.size)) return false;
        to.Fill(from.coefficients.data());
        return true;
    };
    const bool delivered =
        deliver(divisor, g) && (want_cofactors != 1 || (deliver(first_rest, u) && deliver(second_rest, v)));
    return delivered ? call.Deliver(kOk) : call.Fail(kOutOfMemory);
}

}  // namespace

int32_t PolyGCD_H(KrHandle p, KrHandle q, double tol, KrHandle gcd, KrHandle pCofactor, KrHandle qCofactor,
                  int32_t wantCofactors) {
    return Gcd<double>(p, q, tol, gcd, pCofactor, qCofactor, wantCofactors);
}
int32_t CxPolyGCD_H(KrHandle p, KrHandle q, double tol, KrHandle gcd, KrHandle pCofactor, KrHandle qCofactor,
                    int32_t wantCofactors) {
    return Gcd<Complex>(p, q, tol, gcd, pCofactor, qCofactor, wantCofactors);
}
