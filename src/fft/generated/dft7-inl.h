// Made by src/fft/generator; do not edit.
// 7 points: 8 multiplications and 30 additions on real samples, 16 and 72 on complex ones.
template <>
struct Dft<7> {
    template <class T, class In, class Out>
    static KRNUMER_FFT_INLINE void Run(const In& in, const Out& out) {
        const T x1 = in(1);
        const T x6 = in(6);
        const T t0 = x1 + x6;
        const T t1 = x1 - x6;
        const T x4 = in(4);
        const T x3 = in(3);
        const T t2 = x4 + x3;
        const T t3 = x4 - x3;
        const T x2 = in(2);
        const T x5 = in(5);
        const T t4 = x2 + x5;
        const T t5 = x2 - x5;
        const T t6 = t0 + t2;
        const T t7 = t6 + t4;
        const T t8 = t0 - t4;
        const T t9 = t2 - t4;
        const T x0 = in(0);
        const T t10 = x0 + t7;
        out.Single(0, t10);
        const T t11 = t7 * -1.1666666666666667;
        const T t12 = t10 + t11;
        const T t13 = t8 + t9;
        const T t14 = t8 * -0.6784479339461047;
        const T t15 = t9 * 0.8460107358150479;
        const T t16 = t13 * -0.055854267289647735;
        const T t17 = t14 + t16;
        const T t18 = t15 + t16;
        const T t19 = t12 + t17;
        const T t20 = t12 - t17;
        const T t21 = t12 + t18;
        const T t22 = t20 - t18;
        const T t23 = t1 + t3;
        const T t24 = t23 + t5;
        const T t25 = t1 - t5;
        const T t26 = t3 - t5;
        const T t27 = t24 * 0.44095855184409843;
        const T t28 = t25 + t26;
        const T t29 = t25 * -1.4088116512993818;
        const T t30 = t26 * -0.1930964297137938;
        const T t31 = t28 * 0.5339693603377251;
        const T t32 = t29 + t31;
        const T t33 = t30 + t31;
        const T t34 = t27 + t32;
        out.Pair(3, t19, t34);
        const T t35 = t27 - t32;
        const T t36 = t27 + t33;
        out.Pair(5, t21, t36);
        const T t37 = t35 - t33;
        out.Pair(6, t22, t37);
    }
};
