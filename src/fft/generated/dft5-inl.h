// Made by src/fft/generator; do not edit.
// 5 points: 5 multiplications and 13 additions on real samples, 10 and 34 on complex ones.
template <>
struct Dft<5> {
    template <class T, class In, class Out>
    static KRNUMER_FFT_INLINE void Run(const In& in, const Out& out) {
        const T x1 = in(1);
        const T x4 = in(4);
        const T t0 = x1 + x4;
        const T t1 = x1 - x4;
        const T x2 = in(2);
        const T x3 = in(3);
        const T t2 = x2 + x3;
        const T t3 = x2 - x3;
        const T t4 = t0 + t2;
        const T t5 = t0 - t2;
        const T x0 = in(0);
        const T t6 = x0 + t4;
        out.Single(0, t6);
        const T t7 = t4 * -1.25;
        const T t8 = t6 + t7;
        const T t9 = t5 * -0.5590169943749475;
        const T t10 = t8 + t9;
        const T t11 = t8 - t9;
        const T t12 = t1 + t3;
        const T t13 = t1 * -1.5388417685876268;
        const T t14 = t3 * -0.36327126400268045;
        const T t15 = t12 * 0.9510565162951535;
        const T t16 = t13 + t15;
        out.Pair(2, t10, t16);
        const T t17 = t14 + t15;
        out.Pair(4, t11, t17);
    }
};
