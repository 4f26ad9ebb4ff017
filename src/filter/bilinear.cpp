#include "filter/bilinear.h"

#include <cmath>

#include "filter/filter_type.h"
#include "frame/numeric.h"

namespace krnumer {

SectionWriter::SectionWriter(const FilterBand& band, double* a, double* b)
    : type_(band.type), lower_(std::tan(kPi * band.fl / band.fs)), product_(0.0), width_(0.0), a_(a), b_(b) {
    if (!HasTwoEdges(type_)) return;
    const double upper = std::tan(kPi * band.fh / band.fs);
    product_ = upper * lower_;
    width_ = upper - lower_;
}

void SectionWriter::WriteReal(double real_pole) {
    HasTwoEdges(type_) ? WriteRealEdges(real_pole) : WriteRealCutoff(real_pole);
    Advance();
}

void SectionWriter::WritePair(const PolePair& pair) {
    HasTwoEdges(type_) ? WritePairEdges(pair) : WritePairCutoff(pair);
    Advance();
}

void SectionWriter::Advance() {
    const int32_t order = HasTwoEdges(type_) ? 4 : 2;
    a_ += order;
    b_ += order + 1;
}

void SectionWriter::WriteRealCutoff(double real_pole) {
    const double t = type_ == kLowpass ? real_pole * lower_ : lower_ / real_pole;
    const double divisor = 1.0 + t;
    a_[0] = -(1.0 - t) / divisor;
    a_[1] = 0.0;
    b_[0] = (type_ == kLowpass ? t : 1.0) / divisor;
    b_[1] = type_ == kLowpass ? b_[0] : -b_[0];
    b_[2] = 0.0;
}

void SectionWriter::WriteRealEdges(double real_pole) {
    const double p = product_;
    const double w = type_ == kBandpass ? real_pole * width_ : width_ / real_pole;
    const double divisor = p + 1.0 + w;
    a_[0] = -2.0 * (1.0 - p) / divisor;
    a_[1] = (p + 1.0 - w) / divisor;
    a_[2] = a_[3] = 0.0;
    if (type_ == kBandpass) {
        b_[0] = w / divisor;
        b_[1] = 0.0;
        b_[2] = -b_[0];
    } else {
        b_[0] = b_[2] = (1.0 + p) / divisor;
        b_[1] = a_[0];
    }
    b_[3] = b_[4] = 0.0;
}

void SectionWriter::WritePairCutoff(const PolePair& pair) {
    const double square = lower_ * lower_;
    const double zeros = pair.inverse_zero_square;
    const bool low = type_ == kLowpass;
    const double e = 2.0 * (low ? pair.damping : pair.damping / pair.square) * lower_;
    const double f = low ? pair.square * square : square / pair.square;
    const double divisor = 1.0 + f + e;
    a_[0] = -2.0 * (1.0 - f) / divisor;
    a_[1] = (1.0 + f - e) / divisor;

    // The numerator has a constant, which is what is left at s = 0, and a share of s^2, which is left at infinity.
    const double gain = pair.gain / divisor;
    const double constant = low ? pair.square * square : zeros * square;
    const double curved = low ? pair.square * zeros : 1.0;
    b_[0] = b_[2] = (constant + curved) * gain;
    b_[1] = 2.0 * (constant - curved) * gain;
}

void SectionWriter::WritePairEdges(const PolePair& pair) {
    const double p = product_;
    const double square = width_ * width_;
    const double zeros = pair.inverse_zero_square;
    const bool pass = type_ == kBandpass;
    const double e = 2.0 * (pass ? pair.damping : pair.damping / pair.square) * width_;
    const double c = pass ? pair.square * square : square / pair.square;
    const double q = 2.0 * p + c;
    const double divisor = e + e * p + (q + p * p + 1.0);
    const double odd = 4.0 - 4.0 * p * p;
    const double damped = 2.0 * e - 2.0 * e * p;
    a_[0] = -(damped + odd) / divisor;
    a_[1] = -(2.0 * q - 6.0 * p * p - 6.0) / divisor;
    a_[2] = -(odd - damped) / divisor;
    a_[3] = (q + p * p + 1.0 - e - e * p) / divisor;

    // The numerator is a share of (s^2 + p)^2, whose zeros lie in the middle of the band, and a share of s^2, whose
    // zeros lie at both ends of the spectrum.
    const double gain = pair.gain / divisor;
    const double middle = pass ? pair.square * zeros : 1.0;
    const double ends = pass ? c : zeros * square;
    b_[0] = b_[4] = (middle * (2.0 * p + p * p + 1.0) + ends) * gain;
    b_[1] = b_[3] = 4.0 * (middle * p * p - middle) * gain;
    b_[2] = (middle * (6.0 - 4.0 * p + 6.0 * p * p) - 2.0 * ends) * gain;
}

}  // namespace krnumer
