// Made by src/fft/generator; do not edit.
// 4 points: 0 multiplications and 6 additions on real samples, 0 and 16 on complex ones.
template <>
struct Dft<4> {
    template <class T, class In, class Out>
    static KRNUMER_FFT_INLINE void Run(const In& in, const Out& out) {
        const T x0 = in(0);
        const T x2 = in(2);
        const T t0 = x0 + x2;
        const T x1 = in(1);
        const T x3 = in(3);
        const T t1 = x1 + x3;
        const T t2 = t0 + t1;
        out.Single(0, t2);
        const T t3 = x0 - x2;
        const T t4 = t0 - t1;
        out.Single(2, t4);
        const T t5 = x3 - x1;
        out.Pair(1, t3, t5);
    }
};
