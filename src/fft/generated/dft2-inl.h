// Made by src/fft/generator; do not edit.
// 2 points: 0 multiplications and 2 additions on real samples, 0 and 4 on complex ones.
template <>
struct Dft<2> {
    template <class T, class In, class Out>
    static KRNUMER_FFT_INLINE void Run(const In& in, const Out& out) {
        const T x0 = in(0);
        const T x1 = in(1);
        const T t0 = x0 + x1;
        out.Single(0, t0);
        const T t1 = x0 - x1;
        out.Single(1, t1);
    }
};
