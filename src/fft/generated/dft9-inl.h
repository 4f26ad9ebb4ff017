// Made by src/fft/generator; do not edit.
// 9 points: 10 multiplications and 36 additions on real samples, 20 and 88 on complex ones.
template <>
struct Dft<9> {
    template <class T, class In, class Out>
    static KRNUMER_FFT_INLINE void Run(const In& in, const Out& out) {
        const T x1 = in(1);
        const T x8 = in(8);
        const T t0 = x1 + x8;
        const T t1 = x1 - x8;
        const T x2 = in(2);
        const T x7 = in(7);
        const T t2 = x2 + x7;
        const T t3 = x2 - x7;
        const T x3 = in(3);
        const T x6 = in(6);
        const T t4 = x3 + x6;
        const T t5 = x3 - x6;
        const T x4 = in(4);
        const T x5 = in(5);
        const T t6 = x4 + x5;
        const T t7 = x4 - x5;
        const T t8 = t0 + t2;
        const T t9 = t8 + t6;
        const T x0 = in(0);
        const T t10 = x0 + t4;
        const T t11 = t10 + t9;
        out.Single(0, t11);
        const T t12 = t4 * 1.5;
        const T t13 = t9 * 0.5;
        const T t14 = t11 - t13;
        const T t15 = t14 - t13;
        const T t16 = t15 - t12;
        const T t17 = t15 - t13;
        const T t18 = t0 - t6;
        const T t19 = t2 - t6;
        const T t20 = t18 + t19;
        const T t21 = t20 * 0.17364817766693036;
        const T t22 = t18 * 0.5923962654520477;
        const T t23 = t22 + t21;
        const T t24 = t19 * -1.1133407984528387;
        const T t25 = t24 + t21;
        const T t26 = t16 + t23;
        const T t27 = t16 + t25;
        const T t28 = t16 - t23;
        const T t29 = t28 - t25;
        const T t30 = t1 + t3;
        const T t31 = t7 + t3;
        const T t32 = t30 + t31;
        const T t33 = t32 * -0.3420201433256687;
        const T t34 = t30 * -0.3007674663608706;
        const T t35 = t34 + t33;
        const T t36 = t31 * 1.3268278963378768;
        const T t37 = t36 + t33;
        const T t38 = t5 * -0.8660254037844386;
        const T t39 = t38 + t35;
        out.Pair(1, t26, t39);
        const T t40 = t38 + t37;
        out.Pair(4, t29, t40);
        const T t41 = t35 + t37;
        const T t42 = t41 - t38;
        out.Pair(2, t27, t42);
        const T t43 = t1 - t3;
        const T t44 = t43 + t7;
        const T t45 = t44 * -0.8660254037844386;
        out.Pair(3, t17, t45);
    }
};
