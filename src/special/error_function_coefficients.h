// Tables of the error function, rounded to doubles, highest power first (S. L. Moshier, Methods and Programs for
// Mathematical Functions, 1989; the Cephes library).
#pragma once

namespace krnumer {

// Several entries a line.
// clang-format off

// erf(x) = x T(x^2) / U(x^2) for |x| <= 1, U monic.
inline constexpr double kErfT[] = {
    9.604973739870516, 90.02601972038427, 2232.005345946843, 7003.325141128051, 55592.30130103949};
inline constexpr double kErfU[] = {
    1.0, 33.56171416475031, 521.3579497801527, 4594.323829709801, 22629.000061389095, 49267.39426086359};

// e^(x^2) erfc(x) = P(x) / Q(x) for 1 <= x < 8, Q monic.
inline constexpr double kErfCP[] = {
    2.461969814735305e-10, 0.5641895648310689, 7.463210564422699, 48.63719709856814, 196.5208329560771,
    526.4451949954773, 934.5285271719576, 1027.5518868951572, 557.5353353693994};
inline constexpr double kErfCQ[] = {
    1.0, 13.228195115474499, 86.70721408859897, 354.9377788878199, 975.7085017432055, 1823.9091668790973,
    2246.3376081871097, 1656.6630919416134, 557.5353408177277};

// e^(x^2) erfc(x) = R(x) / S(x) for x >= 8, S monic.
inline constexpr double kErfCR[] = {
    0.5641895835477551, 1.275366707599781, 5.019050422511805, 6.160210979930536, 7.4097426995044895,
    2.9788666537210022};
inline constexpr double kErfCS[] = {
    1.0, 2.2605286322011726, 9.396035249380015, 12.048953980809666, 17.08144507475659, 9.608968090632859,
    3.369076451000815};

// clang-format on

}  // namespace krnumer
