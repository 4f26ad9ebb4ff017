#!/usr/bin/env python3
"""Makes noise_states.csv and noise_samples.csv.

The integer sequence and all generators are written out once more here, in Python's unbounded integers (reduced to 32
bits where the generator's words wrap) and with ln Gamma from mpmath, from the published descriptions: Wichmann and Hill
(AS 183), the polar method, and the rejection methods of Numerical Recipes, chapter 7.
"""
import csv
import math
import os

import mpmath

FOLDER = os.path.dirname(os.path.abspath(__file__))


def int32(value):
    value &= 0xFFFFFFFF
    return value - (1 << 32) if value >= 1 << 31 else value


def remainder(value, modulus):
    return int(math.fmod(value, modulus))


class Generator:
    def __init__(self, seed):
        self.s = [seed, int32(seed * 8191) & 0x3FFF, 0]
        self.s[2] = int32(self.s[1] * 8191) & 0x3FFF
        self.spare = None

    def step(self):
        factors = (171, 172, 170)
        moduli = (30269, 30307, 30323)
        self.s = [remainder(int32(s * f), m) for s, f, m in zip(self.s, factors, moduli)]
        reciprocals = (3.3037100664045725e-05, 3.2995677566238825e-05, 3.297826732183491e-05)
        return self.s[0] * reciprocals[0] + self.s[1] * reciprocals[1] + self.s[2] * reciprocals[2]

    def uniform(self):
        v = self.step()
        return v - math.floor(v)

    def white(self, amplitude):
        return (self.uniform() - 0.5) * (2 * amplitude)

    def gauss(self, sigma):
        if self.spare is None:
            while True:
                x = 2 * self.uniform() - 1
                y = 2 * self.uniform() - 1
                r = x * x + y * y
                if r < 1 and r != 0:
                    break
            f = math.sqrt(-2 * math.log(r) / r)
            self.spare = f * x
            return f * y * sigma
        value, self.spare = self.spare, None
        return value * sigma

    def binomial(self, trials, p):
        pp = p if p <= 0.5 else 1 - p
        am = trials * pp
        if trials < 25:
            count = sum(self.uniform() < pp for _ in range(trials))
        elif am < 1:
            g, t, count = math.exp(-am), 1.0, trials
            for j in range(trials + 1):
                t *= self.uniform()
                if t < g:
                    count = j
                    break
        else:
            q = 1 - pp
            sq = math.sqrt(2 * am * q)
            lgamma = lambda v: float(mpmath.loggamma(v))
            while True:
                y = math.tan(math.pi * self.uniform())
                em = sq * y + am
                if em < 0 or em >= trials + 1:
                    continue
                em = math.floor(em)
                t = 1.2 * sq * (1 + y * y) * math.exp(lgamma(trials + 1) - lgamma(em + 1) - lgamma(trials - em + 1)
                                                      + em * math.log(pp) + (trials - em) * math.log(q))
                if self.uniform() <= t:
                    break
            count = em
        return trials - count if pp != p else count

    def gamma(self, order):
        if order < 6:
            product = 1.0
            for _ in range(order):
                product *= self.uniform()
            return -math.log(product)
        while True:
            while True:
                v1 = 2 * self.uniform() - 1
                v2 = 2 * self.uniform() - 1
                if v1 * v1 + v2 * v2 <= 1:
                    break
            y = v2 / v1
            am = order - 1
            s = math.sqrt(2 * am + 1)
            x = s * y + am
            if x <= 0:
                continue
            e = (1 + y * y) * math.exp(am * math.log(x / am) - s * y)
            if self.uniform() <= e:
                return x

    def poisson(self, mean):
        if mean < 12:
            g, em, t = math.exp(-mean), -1, 1.0
            while True:
                em += 1
                t *= self.uniform()
                if t <= g:
                    return em
        sq, al = math.sqrt(2 * mean), math.log(mean)
        g = mean * al - float(mpmath.loggamma(mean + 1))
        while True:
            y = math.tan(math.pi * self.uniform())
            em = sq * y + mean
            if em < 0:
                continue
            em = math.floor(em)
            t = 0.9 * (1 + y * y) * math.exp(em * al - float(mpmath.loggamma(em + 1)) - g)
            if self.uniform() <= t:
                return em


def main():
    with open(os.path.join(FOLDER, 'noise_states.csv'), 'w', newline='') as f:
        rows = csv.writer(f)
        for seed in (1, 42, 20000000, 2147483647):
            generator = Generator(seed)
            for _ in range(1000):
                generator.step()
                rows.writerow([seed] + generator.s)
    with open(os.path.join(FOLDER, 'noise_samples.csv'), 'w', newline='') as f:
        rows = csv.writer(f)
        kinds = [('white', (2.5,)), ('gauss', (1.5,)), ('binomial', (10, 0.3)), ('binomial', (24, 0.7)),
                 ('binomial', (1000, 0.0005)), ('binomial', (100, 0.4)), ('binomial', (5000, 0.9)), ('gamma', (1,)),
                 ('gamma', (5,)), ('gamma', (6,)), ('gamma', (40,)), ('poisson', (0.5,)), ('poisson', (11.9,)),
                 ('poisson', (12.0,)), ('poisson', (700.0,))]
        for kind, parameters in kinds:
            for seed in (7, 31337):
                generator = Generator(seed)
                samples = [getattr(generator, kind)(*parameters) for _ in range(40)]
                rows.writerow([kind, *(list(parameters) + [0])[:2], seed, *map(repr, samples)])


if __name__ == '__main__':
    main()
