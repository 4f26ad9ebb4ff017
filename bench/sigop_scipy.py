"""Times of scipy.signal, to stand beside what sigop_bench measures.

Run with Python 3 and SciPy: python3 sigop_scipy.py
"""

import time

import numpy as np
import scipy.signal


def seconds(run):
    run()
    calls, start = 0, time.process_time()
    while calls < 3 or time.process_time() - start < 0.3:
        run()
        calls += 1
    return (time.process_time() - start) / calls


image, kernel = np.ones((512, 512)), np.ones((31, 31))
direct = seconds(lambda: scipy.signal.convolve2d(image, kernel))
spectral = seconds(lambda: scipy.signal.fftconvolve(image, kernel))
print(f"{'Planes/direct':30s}{direct * 1e3:10.1f} ms")
print(f"{'Planes/frequency_domain':30s}{spectral * 1e3:10.1f} ms")

x = 1.5 + np.sin(0.7 * np.arange(14700))
for name, signal in (("double", x), ("Complex", x + 1j * x)):
    per_block = seconds(lambda: scipy.signal.resample_poly(signal, 160, 147))
    print(f"{'Rational<' + name + '>':30s}{16000 / per_block / 1e6:10.1f} M outputs/s")
