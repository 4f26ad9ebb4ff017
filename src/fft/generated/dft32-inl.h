// Made by src/fft/generator; do not edit.
// 32 points: 46 multiplications and 164 additions on real samples, 100 and 390 on complex ones.
template <>
struct Dft<32> {
    template <class T, class In, class Out>
    static KRNUMER_FFT_INLINE void Run(const In& in, const Out& out) {
        const T x0 = in(0);
        const T x16 = in(16);
        const T t0 = x0 + x16;
        const T t1 = x0 - x16;
        const T x2 = in(2);
        const T x18 = in(18);
        const T t2 = x2 + x18;
        const T t3 = x2 - x18;
        const T x4 = in(4);
        const T x20 = in(20);
        const T t4 = x4 + x20;
        const T t5 = x4 - x20;
        const T x6 = in(6);
        const T x22 = in(22);
        const T t6 = x6 + x22;
        const T t7 = x6 - x22;
        const T x8 = in(8);
        const T x24 = in(24);
        const T t8 = x8 + x24;
        const T t9 = x8 - x24;
        const T x10 = in(10);
        const T x26 = in(26);
        const T t10 = x10 + x26;
        const T t11 = x10 - x26;
        const T x12 = in(12);
        const T x28 = in(28);
        const T t12 = x12 + x28;
        const T t13 = x12 - x28;
        const T x14 = in(14);
        const T x30 = in(30);
        const T t14 = x14 + x30;
        const T t15 = x14 - x30;
        const T t16 = t0 + t8;
        const T t17 = t0 - t8;
        const T t18 = t2 + t10;
        const T t19 = t2 - t10;
        const T t20 = t4 + t12;
        const T t21 = t4 - t12;
        const T t22 = t6 + t14;
        const T t23 = t6 - t14;
        const T t24 = t16 + t20;
        const T t25 = t18 + t22;
        const T t26 = t24 + t25;
        const T t27 = t16 - t20;
        const T t28 = t24 - t25;
        const T t29 = t22 - t18;
        const T t30 = t19 - t23;
        const T t31 = t30 * 0.7071067811865476;
        const T t32 = t19 + t23;
        const T t33 = t32 * -0.7071067811865476;
        const T t34 = t17 + t31;
        const T t35 = t17 - t31;
        const T t36 = t33 - t21;
        const T t37 = t21 + t33;
        const T t38 = t5 - t13;
        const T t39 = t38 * 0.7071067811865476;
        const T t40 = t5 + t13;
        const T t41 = t40 * 0.7071067811865476;
        const T t42 = t1 + t39;
        const T t43 = t1 - t39;
        const T t44 = t9 + t41;
        const T t45 = t9 - t41;
        const T t46 = t3 - t15;
        const T t47 = t7 - t11;
        const T t48 = t46 + t47;
        const T t49 = t48 * 0.3826834323650898;
        const T t50 = t46 * 0.541196100146197;
        const T t51 = t49 + t50;
        const T t52 = t47 * 1.3065629648763766;
        const T t53 = t49 - t52;
        const T t54 = t3 + t15;
        const T t55 = t7 + t11;
        const T t56 = t54 + t55;
        const T t57 = t56 * 0.9238795325112867;
        const T t58 = t54 * 0.541196100146197;
        const T t59 = t58 - t57;
        const T t60 = t55 * 1.3065629648763766;
        const T t61 = t60 - t57;
        const T t62 = t42 + t51;
        const T t63 = t42 - t51;
        const T t64 = t43 + t53;
        const T t65 = t43 - t53;
        const T t66 = t59 - t44;
        const T t67 = t44 + t59;
        const T t68 = t45 + t61;
        const T t69 = t61 - t45;
        const T x1 = in(1);
        const T x17 = in(17);
        const T t70 = x1 + x17;
        const T t71 = x1 - x17;
        const T x3 = in(3);
        const T x19 = in(19);
        const T t72 = x3 + x19;
        const T t73 = x3 - x19;
        const T x5 = in(5);
        const T x21 = in(21);
        const T t74 = x5 + x21;
        const T t75 = x5 - x21;
        const T x7 = in(7);
        const T x23 = in(23);
        const T t76 = x7 + x23;
        const T t77 = x7 - x23;
        const T x9 = in(9);
        const T x25 = in(25);
        const T t78 = x9 + x25;
        const T t79 = x9 - x25;
        const T x11 = in(11);
        const T x27 = in(27);
        const T t80 = x11 + x27;
        const T t81 = x11 - x27;
        const T x13 = in(13);
        const T x29 = in(29);
        const T t82 = x13 + x29;
        const T t83 = x13 - x29;
        const T x15 = in(15);
        const T x31 = in(31);
        const T t84 = x15 + x31;
        const T t85 = x15 - x31;
        const T t86 = t70 + t78;
        const T t87 = t70 - t78;
        const T t88 = t72 + t80;
        const T t89 = t72 - t80;
        const T t90 = t74 + t82;
        const T t91 = t74 - t82;
        const T t92 = t76 + t84;
        const T t93 = t76 - t84;
        const T t94 = t86 + t90;
        const T t95 = t88 + t92;
        const T t96 = t94 + t95;
        const T t97 = t86 - t90;
        const T t98 = t94 - t95;
        out.Pair(24, t28, t98);
        const T t99 = t92 - t88;
        const T t100 = t89 - t93;
        const T t101 = t100 * 0.7071067811865476;
        const T t102 = t89 + t93;
        const T t103 = t102 * -0.7071067811865476;
        const T t104 = t87 + t101;
        const T t105 = t87 - t101;
        const T t106 = t103 - t91;
        const T t107 = t91 + t103;
        const T t108 = t75 - t83;
        const T t109 = t108 * 0.7071067811865476;
        const T t110 = t75 + t83;
        const T t111 = t110 * 0.7071067811865476;
        const T t112 = t71 + t109;
        const T t113 = t71 - t109;
        const T t114 = t79 + t111;
        const T t115 = t79 - t111;
        const T t116 = t73 - t85;
        const T t117 = t77 - t81;
        const T t118 = t116 + t117;
        const T t119 = t118 * 0.3826834323650898;
        const T t120 = t116 * 0.541196100146197;
        const T t121 = t119 + t120;
        const T t122 = t117 * 1.3065629648763766;
        const T t123 = t119 - t122;
        const T t124 = t73 + t85;
        const T t125 = t77 + t81;
        const T t126 = t124 + t125;
        const T t127 = t126 * 0.9238795325112867;
        const T t128 = t124 * 0.541196100146197;
        const T t129 = t128 - t127;
        const T t130 = t125 * 1.3065629648763766;
        const T t131 = t130 - t127;
        const T t132 = t112 + t121;
        const T t133 = t112 - t121;
        const T t134 = t113 + t123;
        const T t135 = t113 - t123;
        const T t136 = t129 - t114;
        const T t137 = t114 + t129;
        const T t138 = t115 + t131;
        const T t139 = t131 - t115;
        const T t140 = t26 + t96;
        out.Single(0, t140);
        const T t141 = t26 - t96;
        out.Single(16, t141);
        const T t142 = t136 * 0.19509032201612828;
        const T t143 = t132 * 0.9807852804032304;
        const T t144 = t143 + t142;
        const T t145 = t132 * 0.19509032201612828;
        const T t146 = t136 * 0.9807852804032304;
        const T t147 = t146 - t145;
        const T t148 = t62 + t144;
        const T t149 = t66 + t147;
        out.Pair(1, t148, t149);
        const T t150 = t62 - t144;
        const T t151 = t147 - t66;
        out.Pair(15, t150, t151);
        const T t152 = t106 * 0.3826834323650898;
        const T t153 = t104 * 0.9238795325112867;
        const T t154 = t153 + t152;
        const T t155 = t104 * 0.3826834323650898;
        const T t156 = t106 * 0.9238795325112867;
        const T t157 = t156 - t155;
        const T t158 = t34 + t154;
        const T t159 = t36 + t157;
        out.Pair(2, t158, t159);
        const T t160 = t34 - t154;
        const T t161 = t157 - t36;
        out.Pair(14, t160, t161);
        const T t162 = t138 * 0.5555702330196022;
        const T t163 = t134 * 0.8314696123025452;
        const T t164 = t163 + t162;
        const T t165 = t134 * 0.5555702330196022;
        const T t166 = t138 * 0.8314696123025452;
        const T t167 = t166 - t165;
        const T t168 = t64 + t164;
        const T t169 = t68 + t167;
        out.Pair(3, t168, t169);
        const T t170 = t64 - t164;
        const T t171 = t167 - t68;
        out.Pair(13, t170, t171);
        const T t172 = t97 + t99;
        const T t173 = t172 * 0.7071067811865476;
        const T t174 = t99 - t97;
        const T t175 = t174 * 0.7071067811865476;
        const T t176 = t27 + t173;
        const T t177 = t29 + t175;
        out.Pair(4, t176, t177);
        const T t178 = t27 - t173;
        const T t179 = t175 - t29;
        out.Pair(12, t178, t179);
        const T t180 = t139 * 0.8314696123025452;
        const T t181 = t135 * 0.5555702330196022;
        const T t182 = t181 + t180;
        const T t183 = t135 * 0.8314696123025452;
        const T t184 = t139 * 0.5555702330196022;
        const T t185 = t184 - t183;
        const T t186 = t65 + t182;
        const T t187 = t69 + t185;
        out.Pair(5, t186, t187);
        const T t188 = t65 - t182;
        const T t189 = t185 - t69;
        out.Pair(11, t188, t189);
        const T t190 = t107 * 0.9238795325112867;
        const T t191 = t105 * 0.3826834323650898;
        const T t192 = t191 + t190;
        const T t193 = t105 * 0.9238795325112867;
        const T t194 = t107 * 0.3826834323650898;
        const T t195 = t194 - t193;
        const T t196 = t35 + t192;
        const T t197 = t37 + t195;
        out.Pair(6, t196, t197);
        const T t198 = t35 - t192;
        const T t199 = t195 - t37;
        out.Pair(10, t198, t199);
        const T t200 = t137 * 0.9807852804032304;
        const T t201 = t133 * 0.19509032201612828;
        const T t202 = t201 + t200;
        const T t203 = t133 * 0.9807852804032304;
        const T t204 = t137 * 0.19509032201612828;
        const T t205 = t204 - t203;
        const T t206 = t63 + t202;
        const T t207 = t67 + t205;
        out.Pair(7, t206, t207);
        const T t208 = t63 - t202;
        const T t209 = t205 - t67;
        out.Pair(9, t208, t209);
    }

    static constexpr double kRe[15] = {
        0.9807852804032304,
        0.9238795325112867,
        0.8314696123025452,
        0.7071067811865476,
        0.5555702330196022,
        0.3826834323650898,
        0.19509032201612828,
        4.237045877651919e-32,
        -0.19509032201612828,
        -0.3826834323650898,
        -0.5555702330196022,
        -0.7071067811865476,
        -0.8314696123025452,
        -0.9238795325112867,
        -0.9807852804032304,
    };
    static constexpr double kIm[15] = {
        -0.19509032201612828,
        -0.3826834323650898,
        -0.5555702330196022,
        -0.7071067811865476,
        -0.8314696123025452,
        -0.9238795325112867,
        -0.9807852804032304,
        -1.0,
        -0.9807852804032304,
        -0.9238795325112867,
        -0.8314696123025452,
        -0.7071067811865476,
        -0.5555702330196022,
        -0.3826834323650898,
        -0.19509032201612828,
    };

    template <class T, class In, class Store>
    static KRNUMER_FFT_INLINE void RunComplex(const In& in, const Store& store) {
        T even[16], odd[16];
        ComplexDft<16, T>([&](int j) KRNUMER_FFT_INLINE_LAMBDA { return in(2 * j); },
                          [&](int k, T value) KRNUMER_FFT_INLINE_LAMBDA { even[k] = value; });
        ComplexDft<16, T>([&](int j) KRNUMER_FFT_INLINE_LAMBDA { return in(2 * j + 1); },
                          [&](int k, T value) KRNUMER_FFT_INLINE_LAMBDA { odd[k] = value; });
        store(0, even[0] + odd[0]);
        store(16, even[0] - odd[0]);
        for (int k = 1; k < 16; ++k) {
            const T turned = Rotate(odd[k], kRe[k - 1], kIm[k - 1]);
            store(k, even[k] + turned);
            store(k + 16, even[k] - turned);
        }
    }
};
