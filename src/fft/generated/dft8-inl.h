// Made by src/fft/generator; do not edit.
// 8 points: 2 multiplications and 20 additions on real samples, 4 and 52 on complex ones.
template <>
struct Dft<8> {
    template <class T, class In, class Out>
    static KRNUMER_FFT_INLINE void Run(const In& in, const Out& out) {
        const T x0 = in(0);
        const T x4 = in(4);
        const T t0 = x0 + x4;
        const T t1 = x0 - x4;
        const T x1 = in(1);
        const T x5 = in(5);
        const T t2 = x1 + x5;
        const T t3 = x1 - x5;
        const T x2 = in(2);
        const T x6 = in(6);
        const T t4 = x2 + x6;
        const T t5 = x2 - x6;
        const T x3 = in(3);
        const T x7 = in(7);
        const T t6 = x3 + x7;
        const T t7 = x3 - x7;
        const T t8 = t0 + t4;
        const T t9 = t2 + t6;
        const T t10 = t8 + t9;
        out.Single(0, t10);
        const T t11 = t0 - t4;
        const T t12 = t8 - t9;
        out.Single(4, t12);
        const T t13 = t6 - t2;
        out.Pair(2, t11, t13);
        const T t14 = t3 - t7;
        const T t15 = t14 * 0.7071067811865476;
        const T t16 = t3 + t7;
        const T t17 = t16 * -0.7071067811865476;
        const T t18 = t1 + t15;
        const T t19 = t1 - t15;
        const T t20 = t17 - t5;
        out.Pair(1, t18, t20);
        const T t21 = t5 + t17;
        out.Pair(3, t19, t21);
    }
};
