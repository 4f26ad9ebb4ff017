// Made by src/fft/generator; do not edit.
// 10 points: 10 multiplications and 36 additions on real samples, 20 and 88 on complex ones.
template <>
struct Dft<10> {
    template <class T, class In, class Out>
    static KRNUMER_FFT_INLINE void Run(const In& in, const Out& out) {
        const T x2 = in(2);
        const T x8 = in(8);
        const T t0 = x2 + x8;
        const T t1 = x2 - x8;
        const T x4 = in(4);
        const T x6 = in(6);
        const T t2 = x4 + x6;
        const T t3 = x4 - x6;
        const T t4 = t0 + t2;
        const T t5 = t0 - t2;
        const T x0 = in(0);
        const T t6 = x0 + t4;
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
        const T t17 = t14 + t15;
        const T x7 = in(7);
        const T x3 = in(3);
        const T t18 = x7 + x3;
        const T t19 = x7 - x3;
        const T x9 = in(9);
        const T x1 = in(1);
        const T t20 = x9 + x1;
        const T t21 = x9 - x1;
        const T t22 = t18 + t20;
        const T t23 = t18 - t20;
        const T x5 = in(5);
        const T t24 = x5 + t22;
        const T t25 = t22 * -1.25;
        const T t26 = t24 + t25;
        const T t27 = t23 * -0.5590169943749475;
        const T t28 = t26 + t27;
        const T t29 = t26 - t27;
        const T t30 = t19 + t21;
        const T t31 = t19 * -1.5388417685876268;
        const T t32 = t21 * -0.36327126400268045;
        const T t33 = t30 * 0.9510565162951535;
        const T t34 = t31 + t33;
        const T t35 = t32 + t33;
        const T t36 = t6 + t24;
        out.Single(0, t36);
        const T t37 = t11 - t29;
        const T t38 = t35 - t17;
        out.Pair(1, t37, t38);
        const T t39 = t10 + t28;
        const T t40 = t16 + t34;
        out.Pair(2, t39, t40);
        const T t41 = t10 - t28;
        const T t42 = t34 - t16;
        out.Pair(3, t41, t42);
        const T t43 = t11 + t29;
        const T t44 = t17 + t35;
        out.Pair(4, t43, t44);
        const T t45 = t6 - t24;
        out.Single(5, t45);
    }
};
