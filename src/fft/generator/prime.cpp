#include "fft/generator/prime.h"

#include <numeric>
#include <utility>

namespace krnumer::generator {
namespace {

// A prime power q = p^e that divides r - 1 exactly: one axis of the index space.
struct Axis {
    int prime, exponent, length;
};

int Power(int base, int exponent) {
    return exponent == 0 ? 1 : base * Power(base, exponent - 1);
}

// The power of two first, then the odd primes ascending.
std::vector<Axis> AxesOf(int n) {
    std::vector<Axis> axes;
    for (int prime = 2; n > 1; ++prime) {
        Axis axis{prime, 0, 1};
        for (; n % prime == 0; n /= prime) {
            ++axis.exponent;
            axis.length *= prime;
        }
        if (axis.exponent > 0) axes.push_back(axis);
    }
    return axes;
}

int LeastPrimitiveRoot(int r) {
    for (int root = 2;; ++root) {
        int order = 1;
        for (int power = root % r; power != 1; power = power * root % r) ++order;
        if (order == r - 1) return root;
    }
}

// An array of several dimensions, the last one adjacent.
template <class T>
struct Array {
    std::vector<int> shape;
    std::vector<T> values;

    explicit Array(std::vector<int> dimensions)
        : shape(std::move(dimensions)),
          values(static_cast<size_t>(std::accumulate(shape.begin(), shape.end(), 1, std::multiplies<>()))) {}

    int stride(size_t axis) const {
        int product = 1;
        for (size_t i = axis + 1; i < shape.size(); ++i) product *= shape[i];
        return product;
    }
};

template <class T>
std::vector<int> WithLength(const Array<T>& array, size_t axis, int length) {
    std::vector<int> shape = array.shape;
    shape[axis] = length;
    return shape;
}

// Calls visit(offset in an array whose axis has length_a, the same for length_b) for every column along the axis.
template <class T, class Visit>
void ForEachColumn(const Array<T>& array, size_t axis, int length_a, int length_b, Visit visit) {
    const int stride = array.stride(axis);
    const int outer = static_cast<int>(array.values.size()) / (stride * array.shape[axis]);
    for (int i = 0; i < outer; ++i)
        for (int j = 0; j < stride; ++j) visit(i * stride * length_a + j, i * stride * length_b + j);
}

// Applies a map of columns, from length shape[axis] to another length.
template <class T, class Map>
Array<T> MapAxis(const Array<T>& array, size_t axis, int length, Map map) {
    Array<T> result(WithLength(array, axis, length));
    const int stride = array.stride(axis);
    ForEachColumn(array, axis, array.shape[axis], length, [&](int from, int to) {
        std::vector<T> column;
        for (int i = 0; i < array.shape[axis]; ++i) column.push_back(array.values[from + i * stride]);
        const std::vector<T> mapped = map(column);
        for (int i = 0; i < length; ++i) result.values[to + i * stride] = mapped[i];
    });
    return result;
}

// ---- Reduction modulo the cyclotomic polynomials of one axis ----

// Residues of z^q - 1 modulo the polynomials of p^0, p^1, ..., p^e.
std::vector<Array<Term>> Reduce(Program& program, const Array<Term>& array, size_t axis, int prime, int exponent) {
    if (exponent == 0) return {array};
    const int step = Power(prime, exponent - 1);
    const Array<Term> sums = MapAxis(array, axis, step, [&](const std::vector<Term>& y) {
        std::vector<Term> sum(y.begin(), y.begin() + step);
        for (int i = step; i < prime * step; ++i) sum[i % step] = program.Add(sum[i % step], y[i]);
        return sum;
    });
    const int degree = (prime - 1) * step;
    const Array<Term> differences = MapAxis(array, axis, degree, [&](const std::vector<Term>& y) {
        std::vector<Term> difference;
        for (int i = 0; i < degree; ++i) difference.push_back(program.Subtract(y[i], y[i % step + degree]));
        return difference;
    });
    std::vector<Array<Term>> parts = Reduce(program, sums, axis, prime, exponent - 1);
    parts.push_back(differences);
    return parts;
}

// The transpose of Reduce.
Array<Term> Expand(Program& program, std::span<const Array<Term>> parts, size_t axis, int prime, int exponent) {
    if (exponent == 0) return parts[0];
    const int step = Power(prime, exponent - 1);
    const int degree = (prime - 1) * step;
    const Array<Term> sums = Expand(program, parts.first(parts.size() - 1), axis, prime, exponent - 1);
    const Array<Term>& differences = parts.back();
    Array<Term> result(WithLength(sums, axis, prime * step));
    const int stride = sums.stride(axis);
    ForEachColumn(sums, axis, step, prime * step, [&](int from, int to) {
        const int outer = from / (stride * step);
        const int offset = outer * stride * degree + from % stride;
        for (int i = 0; i < step; ++i) {
            const Term z = sums.values[from + i * stride];
            Term last = z;
            for (int j = i; j < degree; j += step) {
                const Term e = differences.values[offset + j * stride];
                result.values[to + j * stride] = program.Add(z, e);
                last = program.Subtract(last, e);
            }
            result.values[to + (i + degree) * stride] = last;
        }
    });
    return result;
}

// Splits an array along all axes; the parts of the last axis follow each other.
std::vector<Array<Term>> ReduceAll(Program& program, const Array<Term>& array, std::span<const Axis> axes,
                                   size_t axis = 0) {
    if (axis == axes.size()) return {array};
    std::vector<Array<Term>> all;
    for (const Array<Term>& part : Reduce(program, array, axis, axes[axis].prime, axes[axis].exponent)) {
        for (Array<Term>& block : ReduceAll(program, part, axes, axis + 1)) all.push_back(std::move(block));
    }
    return all;
}

Array<Term> ExpandAll(Program& program, std::span<const Array<Term>> blocks, std::span<const Axis> axes,
                      size_t axis = 0) {
    if (axis == axes.size()) return blocks[0];
    const size_t parts = static_cast<size_t>(axes[axis].exponent) + 1;
    const size_t each = blocks.size() / parts;
    std::vector<Array<Term>> expanded;
    for (size_t i = 0; i < parts; ++i)
        expanded.push_back(ExpandAll(program, blocks.subspan(i * each, each), axes, axis + 1));
    return Expand(program, expanded, axis, axes[axis].prime, axes[axis].exponent);
}

// ---- Short products ----

// Products of polynomials of 2 and 3 coefficients by evaluation at 0, infinity and 1; at 0, 1, -1, 2 and infinity.
int ProductsOf(int size) {
    return 2 * size - 1;
}

std::vector<Term> Evaluate(Program& p, const std::vector<Term>& v) {
    if (v.size() == 2) return {v[0], v[1], p.Add(v[0], v[1])};
    const Term sum = p.Add(v[1], v[2]);
    const Term difference = p.Subtract(v[2], v[1]);
    const Term at_one = p.Add(v[0], sum);
    const Term at_minus_one = p.Add(v[0], difference);
    const Term at_two = p.Add(p.Add(p.Add(sum, sum), difference), at_one);
    return {v[0], at_one, at_minus_one, at_two, v[2]};
}

std::vector<Term> EvaluateTransposed(Program& p, const std::vector<Term>& y) {
    if (y.size() == 3) return {p.Add(y[0], y[2]), p.Add(y[1], y[2])};
    const Term ones = p.Add(y[1], y[3]);
    const Term a = p.Add(p.Add(y[3], y[3]), ones);
    const Term b = p.Add(y[3], y[2]);
    return {p.Add(p.Add(y[0], ones), y[2]), p.Subtract(a, b), p.Add(p.Add(y[4], a), b)};
}

// The transposed interpolation that belongs to them, for the constants.
std::vector<LongReal> Interpolate(const std::vector<LongReal>& f) {
    if (f.size() == 3) return {f[0] - f[1], f[2] - f[1], f[1]};
    const LongReal half = 0.5, third = LongReal(1.0) / 3.0, sixth = LongReal(1.0) / 6.0, two = 2.0;
    return {f[0] - half * f[1] - f[2] + half * f[3], f[1] + half * f[2] - half * f[3],
            half * f[2] - third * f[1] - sixth * f[3], sixth * (f[3] - f[1]), two * f[1] - f[2] - two * f[3] + f[4]};
}

// How the degree of a cyclotomic polynomial is split into sizes of short products, 3 before 2: each split widens the
// array for those that follow, and the products of size 3 are the dearer ones.
std::vector<int> SplitDegree(int degree) {
    std::vector<int> sizes;
    for (int size : {3, 2})
        for (; degree % size == 0; degree /= size) sizes.push_back(size);
    return sizes;
}

std::vector<int> SplitShape(const std::vector<int>& shape) {
    std::vector<int> sizes;
    for (int degree : shape)
        for (int size : SplitDegree(degree)) sizes.push_back(size);
    return sizes;
}

// Axes in the order of evaluation, those of size 3 first.
std::vector<size_t> EvaluationOrder(const std::vector<int>& sizes) {
    std::vector<size_t> order;
    for (int size : {3, 2})
        for (size_t axis = 0; axis < sizes.size(); ++axis)
            if (sizes[axis] == size) order.push_back(axis);
    return order;
}

// ---- Constants ----

// Coefficient j of the primitive idempotent that belongs to p^k on an axis of length p^e, times p^e: exact in integers.
int Idempotent(const Axis& axis, int k, int j) {
    int value = j % Power(axis.prime, k) == 0 ? Power(axis.prime, k) : 0;
    if (k > 0 && j % Power(axis.prime, k - 1) == 0) value -= Power(axis.prime, k - 1);
    return value;
}

// Index space of r - 1: positions are tuples, the last axis adjacent.
class Positions {
  public:
    Positions(int r, const std::vector<Axis>& axes) : axes_(axes), samples_(static_cast<size_t>(r - 1)) {
        const int root = LeastPrimitiveRoot(r);
        int sample = 1;
        for (int exponent = 0; exponent < r - 1; ++exponent) {
            samples_[Flat(exponent)] = sample;
            sample = sample * root % r;
        }
        root_ = root;
        points_ = r;
    }

    // The sample at a position of the input, and the one that the output has there.
    int Input(int position) const { return samples_[position]; }
    int Output(int position) const { return samples_[position] * root_ % points_; }

    const std::vector<Axis>& axes() const { return axes_; }
    int points() const { return points_; }

    // Position whose coordinate on every axis is that of the exponent modulo the length.
    size_t Flat(int exponent) const {
        int flat = 0;
        for (const Axis& axis : axes_) flat = flat * axis.length + exponent % axis.length;
        return static_cast<size_t>(flat);
    }

  private:
    std::vector<Axis> axes_;
    std::vector<int> samples_;
    int root_, points_;
};

// w(position) = W^(sample that the output has there), the first row of the matrix.
Array<LongComplex> MatrixRow(const Positions& positions) {
    std::vector<int> shape;
    for (const Axis& axis : positions.axes()) shape.push_back(axis.length);
    Array<LongComplex> row(shape);
    for (size_t i = 0; i < row.values.size(); ++i)
        row.values[i] = RootOfUnity(positions.points(), positions.Output(static_cast<int>(i)));
    return row;
}

// The constants of the block that belongs to the divisors p^k of every axis, in the order of its products.
Array<LongReal> BlockConstants(const Positions& positions, const std::vector<int>& divisors, bool imaginary) {
    const std::vector<Axis>& axes = positions.axes();
    Array<LongComplex> f = MatrixRow(positions);
    std::vector<int> degrees;
    for (size_t a = 0; a < axes.size(); ++a) {
        const Axis& axis = axes[a];
        const int k = divisors[a];
        const int degree = k == 0 ? 1 : Power(axis.prime, k - 1) * (axis.prime - 1);
        degrees.push_back(degree);
        f = MapAxis(f, a, 2 * degree - 1, [&](const std::vector<LongComplex>& w) {
            std::vector<LongComplex> column;
            for (int t = 0; t < 2 * degree - 1; ++t) {
                LongComplex sum{0.0, 0.0};
                for (int j = 0; j < axis.length; ++j)
                    sum = sum + LongReal(Idempotent(axis, k, j)) * w[(j + t) % axis.length];
                column.push_back((LongReal(1.0) / LongReal(axis.length)) * sum);
            }
            return column;
        });
    }

    // Exponents 0 .. 2 d - 2 of each axis become digits 0 .. 2 s - 2 of its short products.
    std::vector<int> sizes, counts, weights;
    for (size_t a = 0; a < axes.size(); ++a) {
        int weight = degrees[a];
        for (int size : SplitDegree(degrees[a])) {
            weight /= size;
            sizes.push_back(size);
            counts.push_back(ProductsOf(size));
            weights.push_back(weight * f.stride(a));
        }
    }
    Array<LongReal> constants(counts);
    for (size_t i = 0; i < constants.values.size(); ++i) {
        int offset = 0;
        int rest = static_cast<int>(i);
        for (size_t digit = sizes.size(); digit-- > 0; rest /= counts[digit])
            offset += rest % counts[digit] * weights[digit];
        constants.values[i] = imaginary ? f.values[offset].im : f.values[offset].re;
    }
    for (size_t axis = 0; axis < sizes.size(); ++axis) constants = MapAxis(constants, axis, counts[axis], Interpolate);
    return constants;
}

// One block through its short products: evaluation, constants, transposed evaluation.
Array<Term> Multiply(Program& program, const Array<Term>& block, const Array<LongReal>& constants) {
    const std::vector<int> sizes = SplitShape(block.shape);
    const std::vector<size_t> order = EvaluationOrder(sizes);
    Array<Term> values(sizes);
    values.values = block.values;
    for (size_t axis : order)
        values = MapAxis(values, axis, ProductsOf(sizes[axis]),
                         [&](const std::vector<Term>& column) { return Evaluate(program, column); });
    for (size_t i = 0; i < values.values.size(); ++i)
        values.values[i] = program.Scale(constants.values[i], values.values[i]);
    for (size_t i = order.size(); i-- > 0;)
        values = MapAxis(values, order[i], sizes[order[i]],
                         [&](const std::vector<Term>& column) { return EvaluateTransposed(program, column); });
    Array<Term> result(block.shape);
    result.values = values.values;
    return result;
}

// The divisors of every block in the order of ReduceAll.
std::vector<std::vector<int>> DivisorsOf(std::span<const Axis> axes) {
    std::vector<std::vector<int>> all{{}};
    for (const Axis& axis : axes) {
        std::vector<std::vector<int>> longer;
        for (const std::vector<int>& shorter : all) {
            for (int k = 0; k <= axis.exponent; ++k) {
                longer.push_back(shorter);
                longer.back().push_back(k);
            }
        }
        all = std::move(longer);
    }
    return all;
}

// One half of the matrix: even for the sums of samples that lead to the real parts, odd for their differences. Half of
// the first axis is left of either; the odd half is a residue modulo z^(q/2) + 1 already and not reduced along it.
// `constant(total)` stands in for the product with the block that holds the sum of all values, in the even half.
template <class Constant>
Array<Term> Convolve(Program& program, const Positions& positions, const Array<Term>& values, bool odd,
                     Constant constant) {
    std::vector<Axis> axes = positions.axes();
    axes[0].exponent = odd ? 0 : axes[0].exponent - 1;
    std::vector<Array<Term>> blocks = ReduceAll(program, values, axes);
    std::vector<std::vector<int>> divisors = DivisorsOf(axes);
    for (size_t i = 0; i < blocks.size(); ++i) {
        if (odd) divisors[i][0] = positions.axes()[0].exponent;
        if (i == 0 && !odd) {
            blocks[0].values[0] = constant(blocks[0].values[0]);
        } else {
            blocks[i] = Multiply(program, blocks[i], BlockConstants(positions, divisors[i], odd));
        }
    }
    return ExpandAll(program, blocks, axes);
}

}  // namespace

Spectrum PrimeTransform(Program& program, std::span<const Term> x) {
    const int r = static_cast<int>(x.size());
    const Positions positions(r, AxesOf(r - 1));
    std::vector<int> half_shape;
    for (const Axis& axis : positions.axes()) half_shape.push_back(axis.length);
    half_shape[0] /= 2;

    // Positions half of the first axis apart hold x[j] and x[r-j].
    Array<Term> sums(half_shape), differences(half_shape);
    const int pairs = (r - 1) / 2;
    for (int i = 0; i < pairs; ++i) {
        const Term a = x[positions.Input(i)];
        const Term b = x[positions.Input(i + pairs)];
        sums.values[i] = program.Add(a, b);
        differences.values[i] = program.Subtract(a, b);
    }

    Spectrum spectrum(r);
    const Array<Term> real = Convolve(program, positions, sums, false, [&](Term total) {
        spectrum.real[0] = program.Add(x[0], total);
        return program.Add(spectrum.real[0], program.Scale(LongReal(-r) / LongReal(r - 1), total));
    });
    const Array<Term> imaginary = Convolve(program, positions, differences, true, [](Term total) { return total; });
    for (int i = 0; i < pairs; ++i) {
        const int k = positions.Output(i);
        const bool upper = 2 * k > r;
        spectrum.real[upper ? r - k : k] = real.values[i];
        spectrum.imaginary[upper ? r - k : k] = upper ? -imaginary.values[i] : imaginary.values[i];
    }
    return spectrum;
}

}  // namespace krnumer::generator
