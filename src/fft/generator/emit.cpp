#include "fft/generator/emit.h"

#include <charconv>
#include <sstream>

#include "fft/generator/composite.h"

namespace krnumer::generator {
namespace {

Spectrum Transform(Program& program, int points) {
    std::vector<Term> samples;
    for (int j = 0; j < points; ++j) samples.push_back(program.Input(j));
    return ShortTransform(program, samples);
}

// The shortest decimal that reads back as the same double.
std::string Literal(double value) {
    char text[40];
    const std::to_chars_result end = std::to_chars(text, text + sizeof text, value);
    std::string literal(text, end.ptr);
    if (literal.find_first_of(".e") == std::string::npos) literal += ".0";
    return literal;
}

// What a program delivers: the single value X[k], or the halves of X[k] and X[r-k].
struct Delivery {
    int k;
    Term a, b;

    bool single() const { return b.node < 0; }
};

std::vector<Delivery> DeliveriesOf(const Spectrum& spectrum) {
    std::vector<Delivery> deliveries;
    for (int k = 0; 2 * k <= spectrum.points; ++k) {
        const Term b = spectrum.imaginary[k];
        // With -B in place of B the two indices of a pair change places.
        deliveries.push_back({b.negative ? spectrum.points - k : k, spectrum.real[k], b});
    }
    return deliveries;
}

class Writer {
  public:
    explicit Writer(const Butterfly& butterfly)
        : nodes_(butterfly.program.nodes()), names_(nodes_.size()), deliveries_(DeliveriesOf(butterfly.spectrum)) {
        for (const Node& node : nodes_) samples_left_ += node.kind == Node::kInput;
    }

    // Samples are read at their first use. Values are delivered as soon as they are known, once all samples are read.
    std::string Body() {
        for (size_t i = 0; i < nodes_.size(); ++i) {
            if (nodes_[i].kind == Node::kInput) continue;
            Write(static_cast<int>(i));
            if (samples_left_ == 0) Deliver();
        }
        return text_.str();
    }

  private:
    const std::string& Name(int i) {
        if (names_[i].empty() && nodes_[i].kind == Node::kInput) {
            names_[i].append("x").append(std::to_string(nodes_[i].a));
            text_ << "        const T " << names_[i] << " = in(" << nodes_[i].a << ");\n";
            --samples_left_;
        }
        return names_[i];
    }

    void Write(int i) {
        const Node& node = nodes_[i];
        const std::string& a = Name(node.a);
        const std::string& b = node.kind == Node::kScale ? Literal(node.factor) : Name(node.b);
        const char* sign = node.kind == Node::kScale ? " * " : node.kind == Node::kAdd ? " + " : " - ";
        names_[i].append("t").append(std::to_string(count_++));
        text_ << "        const T " << names_[i] << " = " << a << sign << b << ";\n";
    }

    bool Known(Term term) const { return !names_[term.node].empty(); }

    void Deliver() {
        for (auto d = deliveries_.begin(); d != deliveries_.end();) {
            if (!Known(d->a) || (!d->single() && !Known(d->b))) {
                ++d;
                continue;
            }
            if (d->single()) {
                text_ << "        out.Single(" << d->k << ", " << Name(d->a.node) << ");\n";
            } else {
                text_ << "        out.Pair(" << d->k << ", " << Name(d->a.node) << ", " << Name(d->b.node) << ");\n";
            }
            d = deliveries_.erase(d);
        }
    }

    const std::vector<Node>& nodes_;
    std::vector<std::string> names_;
    std::vector<Delivery> deliveries_;
    std::ostringstream text_;
    int samples_left_ = 0;
    int count_ = 0;
};

std::string Table(const char* name, double (*entry)(int k)) {
    std::string text = "    static constexpr double ";
    text.append(name).append("[15] = {\n");
    for (int k = 1; k < 16; ++k) text.append("        ").append(Literal(entry(k))).append(",\n");
    return text + "    };\n";
}

// On complex samples size 32 joins its two transforms of size 16 in a loop, with both twiddles from tables.
std::string ComplexBody32() {
    std::string text("\n");
    text += Table("kRe", [](int k) { return static_cast<double>(RootOfUnity(32, k).re); });
    text += Table("kIm", [](int k) { return static_cast<double>(RootOfUnity(32, k).im); });
    text +=
        "\n"
        "    template <class T, class In, class Store>\n"
        "    static KRNUMER_FFT_INLINE void RunComplex(const In& in, const Store& store) {\n"
        "        T even[16], odd[16];\n"
        "        ComplexDft<16, T>([&](int j) KRNUMER_FFT_INLINE_LAMBDA { return in(2 * j); },\n"
        "                          [&](int k, T value) KRNUMER_FFT_INLINE_LAMBDA { even[k] = value; });\n"
        "        ComplexDft<16, T>([&](int j) KRNUMER_FFT_INLINE_LAMBDA { return in(2 * j + 1); },\n"
        "                          [&](int k, T value) KRNUMER_FFT_INLINE_LAMBDA { odd[k] = value; });\n"
        "        store(0, even[0] + odd[0]);\n"
        "        store(16, even[0] - odd[0]);\n"
        "        for (int k = 1; k < 16; ++k) {\n"
        "            const T turned = Rotate(odd[k], kRe[k - 1], kIm[k - 1]);\n"
        "            store(k, even[k] + turned);\n"
        "            store(k + 16, even[k] - turned);\n"
        "        }\n"
        "    }\n";
    return text;
}

}  // namespace

Butterfly::Butterfly(int points) : spectrum(Transform(program, points)) {}

OperationCount Butterfly::ComplexCount() const {
    if (spectrum.points == 32) return 2 * Butterfly(16).ComplexCount() + OperationCount{60, 94};
    return 2 * RealCount() + OperationCount{0, 4 * ((spectrum.points - 1) / 2)};
}

std::string FileName(int points) {
    return "dft" + std::to_string(points) + "-inl.h";
}

std::string FileText(int points) {
    const Butterfly butterfly(points);
    const OperationCount real = butterfly.RealCount(), complex = butterfly.ComplexCount();
    std::ostringstream text;
    text << "// Made by src/fft/generator; do not edit.\n"
         << "// " << points << " points: " << real.multiplications << " multiplications and " << real.additions
         << " additions on real samples, " << complex.multiplications << " and " << complex.additions
         << " on complex ones.\n"
         << "template <>\n"
         << "struct Dft<" << points << "> {\n"
         << "    template <class T, class In, class Out>\n"
         << "    static KRNUMER_FFT_INLINE void Run(const In& in, const Out& out) {\n"
         << Writer(butterfly).Body() << "    }\n";
    if (points == 32) text << ComplexBody32();
    text << "};\n";
    return text.str();
}

}  // namespace krnumer::generator
