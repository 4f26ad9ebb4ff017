// Made by src/fft/generator; do not edit.
// 3 points: 2 multiplications and 4 additions on real samples, 4 and 12 on complex ones.
template <>
struct Dft<3> {
    template <class T, class In, class Out>
    static KRNUMER_FFT_INLINE void Run(const In& in, const Out& out) {
        const T x1 = in(1);
        const T x2 = in(2);
        const T t0 = x1 + x2;
        const T t1 = x1 - x2;
        const T x0 = in(0);
        const T t2 = x0 + t0;
        out.Single(0, t2);
        const T t3 = t0 * -1.5;
        const T t4 = t2 + t3;
        const T t5 = t1 * 0.8660254037844386;
        out.Pair(2, t4, t5);
    }
};
