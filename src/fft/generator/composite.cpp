#include "fft/generator/composite.h"

#include "fft/generator/prime.h"

namespace krnumer::generator {
namespace {

LongReal Cosine(int k, int n) {
    return RootOfUnity(n, k).re;
}

LongReal Sine(int k, int n) {
    return -RootOfUnity(n, k).im;
}

Spectrum Transform2(Program& p, std::span<const Term> x) {
    Spectrum y(2);
    y.real = {p.Add(x[0], x[1]), p.Subtract(x[0], x[1])};
    return y;
}

Spectrum Transform4(Program& p, std::span<const Term> x) {
    Spectrum y(4);
    const Term even = p.Add(x[0], x[2]);
    const Term odd = p.Add(x[1], x[3]);
    y.real = {p.Add(even, odd), p.Subtract(x[0], x[2]), p.Subtract(even, odd)};
    y.imaginary[1] = p.Subtract(x[3], x[1]);
    return y;
}

// Sums and differences of samples half the length apart.
struct Folded {
    std::vector<Term> sums, differences;

    Folded(Program& p, std::span<const Term> x) {
        const size_t half = x.size() / 2;
        for (size_t j = 0; j < half; ++j) {
            sums.push_back(p.Add(x[j], x[j + half]));
            differences.push_back(p.Subtract(x[j], x[j + half]));
        }
    }
};

// The even-indexed part of a spectrum is the transform of the sums.
Spectrum EvenPart(Program& p, const Folded& folded) {
    const Spectrum half = ShortTransform(p, folded.sums);
    Spectrum y(2 * half.points);
    for (int k = 0; 2 * k <= half.points; ++k) {
        y.real[2 * k] = half.real[k];
        y.imaginary[2 * k] = half.imaginary[k];
    }
    return y;
}

// S. Winograd, On computing the discrete Fourier transform, Math. Comp. 32, 1978, as are the two that follow.
Spectrum Transform8(Program& p, std::span<const Term> x) {
    const Folded folded(p, x);
    const std::vector<Term>& d = folded.differences;
    Spectrum y = EvenPart(p, folded);
    const LongReal root_half = Cosine(1, 8);
    const Term a = p.Scale(root_half, p.Subtract(d[1], d[3]));
    const Term b = p.Scale(-root_half, p.Add(d[1], d[3]));
    y.real[1] = p.Add(d[0], a);
    y.real[3] = p.Subtract(d[0], a);
    y.imaginary[1] = p.Subtract(b, d[2]);
    y.imaginary[3] = p.Add(d[2], b);
    return y;
}

Spectrum Transform16(Program& p, std::span<const Term> x) {
    const Folded folded(p, x);
    const std::vector<Term>& d = folded.differences;
    Spectrum y = EvenPart(p, folded);
    const LongReal root_half = Cosine(1, 8), cosine = Cosine(1, 16), sine = Sine(1, 16);
    const Term a = p.Scale(root_half, p.Subtract(d[2], d[6]));
    const Term b = p.Scale(root_half, p.Add(d[2], d[6]));
    const Term re_plus = p.Add(d[0], a), re_minus = p.Subtract(d[0], a);
    const Term im_plus = p.Add(d[4], b), im_minus = p.Subtract(d[4], b);

    const Term e = p.Subtract(d[1], d[7]), f = p.Subtract(d[3], d[5]);
    const Term m = p.Scale(sine, p.Add(e, f));
    const Term y1 = p.Add(m, p.Scale(cosine - sine, e));
    const Term y3 = p.Subtract(m, p.Scale(cosine + sine, f));

    const Term g = p.Add(d[1], d[7]), h = p.Add(d[3], d[5]);
    const Term n = p.Scale(cosine, p.Add(g, h));
    const Term minus_z1 = p.Subtract(p.Scale(cosine - sine, g), n);
    const Term minus_z3 = p.Subtract(p.Scale(cosine + sine, h), n);

    y.real[1] = p.Add(re_plus, y1);
    y.real[7] = p.Subtract(re_plus, y1);
    y.real[3] = p.Add(re_minus, y3);
    y.real[5] = p.Subtract(re_minus, y3);
    y.imaginary[1] = p.Subtract(minus_z1, im_plus);
    y.imaginary[7] = p.Add(im_plus, minus_z1);
    y.imaginary[3] = p.Add(im_minus, minus_z3);
    y.imaginary[5] = p.Subtract(minus_z3, im_minus);
    return y;
}

Spectrum Transform9(Program& p, std::span<const Term> x) {
    std::vector<Term> s(5), d(5);
    for (int j = 1; j <= 4; ++j) {
        s[j] = p.Add(x[j], x[9 - j]);
        d[j] = p.Subtract(x[j], x[9 - j]);
    }
    Spectrum y(9);

    // x0 + s3 is recovered from X[0], which the short form treats as a product of its own.
    const Term total = p.Add(p.Add(s[1], s[2]), s[4]);
    y.real[0] = p.Add(p.Add(x[0], s[3]), total);
    const Term m1 = p.Scale(1.5, s[3]);
    const Term m2 = p.Scale(0.5, total);
    const Term base = p.Subtract(p.Subtract(y.real[0], m2), m2);
    const Term v = p.Subtract(base, m1);
    y.real[3] = p.Subtract(base, m2);

    const Term p1 = p.Subtract(s[1], s[4]), p2 = p.Subtract(s[2], s[4]);
    const Term shared = p.Scale(Cosine(2, 9), p.Add(p1, p2));
    const Term a1 = p.Add(p.Scale(Cosine(1, 9) - Cosine(2, 9), p1), shared);
    const Term a2 = p.Add(p.Scale(Cosine(4, 9) - Cosine(2, 9), p2), shared);
    y.real[1] = p.Add(v, a1);
    y.real[2] = p.Add(v, a2);
    y.real[4] = p.Subtract(p.Subtract(v, a1), a2);

    const Term f1 = p.Add(d[1], d[2]), f2 = p.Add(d[4], d[2]);
    const Term crossed = p.Scale(-Sine(4, 9), p.Add(f1, f2));
    const Term b1 = p.Add(p.Scale(Sine(4, 9) - Sine(1, 9), f1), crossed);
    const Term b4 = p.Add(p.Scale(Sine(4, 9) - Sine(7, 9), f2), crossed);
    const Term w = p.Scale(-Sine(3, 9), d[3]);
    y.imaginary[1] = p.Add(w, b1);
    y.imaginary[4] = p.Add(w, b4);
    y.imaginary[2] = p.Subtract(p.Add(b1, b4), w);
    y.imaginary[3] = p.Scale(-Sine(3, 9), p.Add(p.Subtract(d[1], d[2]), d[4]));
    return y;
}

// Twice an odd size by the prime-factor mapping: no twiddles. I. J. Good, J. R. Statist. Soc. B 20, 1958.
Spectrum TransformTwiceOdd(Program& p, std::span<const Term> x) {
    const int r = static_cast<int>(x.size());
    const int q = r / 2;
    std::vector<Term> even_samples, odd_samples;
    for (int j = 0; j < q; ++j) {
        even_samples.push_back(x[2 * j]);
        odd_samples.push_back(x[(2 * j + q) % r]);
    }
    const Spectrum even = ShortTransform(p, even_samples);
    const Spectrum odd = ShortTransform(p, odd_samples);
    Spectrum y(r);
    for (int k = 0; k <= q; ++k) {
        const int index = k % q;
        const bool minus = k % 2 != 0;
        const Term re = odd.Real(index);
        y.real[k] = p.Add(even.Real(index), minus ? -re : re);
        if (index == 0) continue;
        const Term im = odd.Imaginary(index);
        y.imaginary[k] = p.Add(even.Imaginary(index), minus ? -im : im);
    }
    return y;
}

// Two transforms of size 16 joined by one pass of radix 2 with its twiddles written out.
Spectrum Transform32(Program& p, std::span<const Term> x) {
    std::vector<Term> even_samples, odd_samples;
    for (size_t j = 0; j < 16; ++j) {
        even_samples.push_back(x[2 * j]);
        odd_samples.push_back(x[2 * j + 1]);
    }
    const Spectrum even = ShortTransform(p, even_samples);
    const Spectrum odd = ShortTransform(p, odd_samples);
    Spectrum y(32);
    y.real[0] = p.Add(even.real[0], odd.real[0]);
    y.real[16] = p.Subtract(even.real[0], odd.real[0]);
    y.real[8] = even.real[8];
    y.imaginary[8] = -odd.real[8];
    for (int k = 1; k < 8; ++k) {
        const Term re = odd.real[k], im = odd.imaginary[k];
        const LongReal c = Cosine(k, 32), s = Sine(k, 32);
        Term t_re, t_im;
        if (k == 4) {
            t_re = p.Scale(c, p.Add(re, im));
            t_im = p.Scale(c, p.Subtract(im, re));
        } else {  // products as arguments would be written in an order of the compiler's choice
            const Term s_im = p.Scale(s, im), c_re = p.Scale(c, re);
            t_re = p.Add(c_re, s_im);
            const Term s_re = p.Scale(s, re), c_im = p.Scale(c, im);
            t_im = p.Subtract(c_im, s_re);
        }
        y.real[k] = p.Add(even.real[k], t_re);
        y.imaginary[k] = p.Add(even.imaginary[k], t_im);
        y.real[16 - k] = p.Subtract(even.real[k], t_re);
        y.imaginary[16 - k] = p.Subtract(t_im, even.imaginary[k]);
    }
    return y;
}

}  // namespace

Spectrum ShortTransform(Program& program, std::span<const Term> x) {
    switch (x.size()) {
        case 2:
            return Transform2(program, x);
        case 4:
            return Transform4(program, x);
        case 8:
            return Transform8(program, x);
        case 9:
            return Transform9(program, x);
        case 10:
        case 14:
        case 18:
            return TransformTwiceOdd(program, x);
        case 16:
            return Transform16(program, x);
        case 32:
            return Transform32(program, x);
        default:
            return PrimeTransform(program, x);
    }
}

}  // namespace krnumer::generator
