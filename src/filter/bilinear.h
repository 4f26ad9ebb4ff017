// From an analogue lowpass prototype to the sections of a digital filter.
#pragma once

#include <cstdint>

namespace krnumer {

// What is asked of a filter, in any unit of frequency.
struct FilterBand {
    double fs;      // sampling frequency
    double fl, fh;  // the two edges; a lowpass or highpass has its cut-off in fl and no fh
    int32_t order;  // of the prototype
    int32_t type;   // a FilterType
};

// A pair of poles of a prototype with cut-off 1, and its zeros on the imaginary axis:
//
//     gain square (s^2 / zero^2 + 1) / (s^2 + 2 damping s + square)
struct PolePair {
    double damping;
    double square;
    double inverse_zero_square = 0.0;  // 1 / zero^2; 0 when there are no zeros
    double gain = 1.0;
};

// Writes sections one after the other: m feedback coefficients a[1] ... a[m], the leading 1 left out, and m + 1
// feedforward coefficients b[0] ... b[m], with m = 2 for lowpass and highpass, m = 4 for filters with two edges.
//
// The frequency transformation of the prototype and the bilinear transform s = (1 - 1/z) / (1 + 1/z) are worked out
// in one (A. G. Constantinides, Proc. IEE 117, 1585, 1970), with edges prewarped by the tangent.
class SectionWriter {
  public:
    SectionWriter(const FilterBand& band, double* a, double* b);

    // The section of a single pole at -real_pole, which has half the order of the others.
    void WriteReal(double real_pole);
    void WritePair(const PolePair& pair);

  private:
    void WriteRealCutoff(double real_pole);
    void WriteRealEdges(double real_pole);
    void WritePairCutoff(const PolePair& pair);
    void WritePairEdges(const PolePair& pair);
    void Advance();

    int32_t type_;
    double lower_;    // tangent of the cut-off or of the lower edge
    double product_;  // of the tangents of both edges
    double width_;    // their difference
    double* a_;
    double* b_;
};

}  // namespace krnumer
