// Straight-line programs: what a butterfly computes, as a list of additions and of products with constants.
//
// A program works on any kind of number that can be added and scaled by a double: on doubles it is the butterfly of
// real samples, on complex numbers or on vectors of columns it is that of those. What it delivers for each pair of
// conjugate indices k and r - k are the two halves A and B of X[k] = A + iB, X[r-k] = A - iB.
#pragma once

#include <vector>

#include "fft/generator/long_real.h"

namespace krnumer::generator {

// A value of a program. Signs are carried along and cost nothing: a sum of -a and b is b - a.
struct Term {
    int node = -1;
    bool negative = false;

    friend Term operator-(Term a) { return {a.node, !a.negative}; }
};

struct Node {
    enum Kind { kInput, kAdd, kSubtract, kScale };

    Kind kind;
    int a;                // operand; the index of the sample for an input
    int b = -1;           // second operand of sum and difference
    double factor = 0.0;  // of a product
};

struct OperationCount {
    int multiplications = 0;
    int additions = 0;

    friend bool operator==(const OperationCount&, const OperationCount&) = default;
    friend OperationCount operator+(OperationCount a, OperationCount b) {
        return {a.multiplications + b.multiplications, a.additions + b.additions};
    }
    friend OperationCount operator-(OperationCount a, OperationCount b) {
        return {a.multiplications - b.multiplications, a.additions - b.additions};
    }
    friend OperationCount operator*(int times, OperationCount a) {
        return {times * a.multiplications, times * a.additions};
    }
};

// The halves of a spectrum of r points: X[k] = real[k] + i imaginary[k] for k = 0 .. r/2.
struct Spectrum {
    int points;
    std::vector<Term> real;
    std::vector<Term> imaginary;

    explicit Spectrum(int r) : points(r), real(r / 2 + 1), imaginary(r / 2 + 1) {}

    // The halves at any index, the upper ones by conjugation.
    Term Real(int k) const { return real[2 * k <= points ? k : points - k]; }
    Term Imaginary(int k) const { return 2 * k <= points ? imaginary[k] : -imaginary[points - k]; }
};

class Program {
  public:
    Term Input(int sample) { return Append({Node::kInput, sample}); }

    Term Add(Term a, Term b) {
        if (a.negative && b.negative) return -Append({Node::kAdd, a.node, b.node});
        if (a.negative) return Append({Node::kSubtract, b.node, a.node});
        if (b.negative) return Append({Node::kSubtract, a.node, b.node});
        return Append({Node::kAdd, a.node, b.node});
    }
    Term Subtract(Term a, Term b) { return Add(a, -b); }
    Term Scale(LongReal factor, Term a) {
        return {Append({Node::kScale, a.node, -1, static_cast<double>(factor)}).node, a.negative};
    }

    const std::vector<Node>& nodes() const { return nodes_; }

    OperationCount Count() const {
        OperationCount count;
        for (const Node& node : nodes_) {
            count.multiplications += node.kind == Node::kScale;
            count.additions += node.kind == Node::kAdd || node.kind == Node::kSubtract;
        }
        return count;
    }

  private:
    Term Append(const Node& node) {
        nodes_.push_back(node);
        return {static_cast<int>(nodes_.size()) - 1, false};
    }

    std::vector<Node> nodes_;
};

}  // namespace krnumer::generator
