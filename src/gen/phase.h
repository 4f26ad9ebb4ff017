// Phases and table positions, brought back into one period.
#pragma once

#include <cmath>

namespace krnumer {

inline constexpr double kFullTurn = 360.0;               // degrees
inline constexpr double kDegree = 0.017453292519943295;  // radians

// A period of a whole number of units below 2^31, and what is left of a value when all whole periods are taken off:
// fmod, lifted into 0 to `length` exclusive. A negative value so small that the lift would round up to `length` counts
// as 0. NaN and infinities leave NaN.
class Period {
  public:
    explicit constexpr Period(double length) : length_(length), inverse_(1.0 / length) {}

    double Remainder(double value) const {
        const double lifted = IsNear(value) ? NearRemainder(value) : Lift(std::fmod(value, length_));
        return lifted >= length_ ? 0.0 : lifted;
    }

    // The same number without a call of fmod, so that loops over it become vector code; only that a lift which rounds
    // up gives `length` itself. Multiples of the period are whole numbers below 2^41 here, and what stays after the
    // subtraction needs no bit that `value` has not got, so all is exact but the lift, which fmod needs as well;
    // whether the nearest multiple or the one beside it is taken off does not matter.
    double NearRemainder(double value) const {
        constexpr double kWholeNumbers = 0x1.8p52;  // leaves no room for a fraction behind what is added to it
        const double periods = (value * inverse_ + kWholeNumbers) - kWholeNumbers;
        return Lift(value - periods * length_);
    }

    static bool IsNear(double value) { return std::fabs(value) < 0x1p40; }

  private:
    double Lift(double remainder) const { return remainder < 0.0 ? remainder + length_ : remainder; }

    double length_, inverse_;
};

}  // namespace krnumer
