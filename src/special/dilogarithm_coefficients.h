// Tables of the dilogarithm, rounded to doubles, highest power first (S. L. Moshier, Methods and Programs for
// Mathematical Functions, 1989; the Cephes library).
#pragma once

namespace krnumer {

// Several entries a line.
// clang-format off

// Li2(-w) = -w A(w) / B(w) for |w| <= 0.5.
inline constexpr double kDilogarithmA[] = {
    4.6512858607399003e-05, 0.007315890452380947, 0.13384763957830903, 0.8796913117545303, 2.7114985119655346,
    4.256971560081218, 3.297713409852251, 1.0};
inline constexpr double kDilogarithmB[] = {
    0.0006909904889125533, 0.02540437639325444, 0.2829748606025681, 1.4117259775183106, 3.6380053334513707,
    5.03278880143317, 3.547713409852251, 1.0};

// clang-format on

}  // namespace krnumer
