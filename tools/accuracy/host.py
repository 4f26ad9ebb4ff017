"""The exports with the arrays of the host that is built beside them."""

import ctypes

import numpy as np

CODES = {np.dtype(np.int32): 3, np.dtype(np.float64): 10, np.dtype(np.complex128): 13}


class Library:
    def __init__(self, build):
        self.host = ctypes.CDLL(str(build / "host" / "libkrrt.so"), mode=ctypes.RTLD_GLOBAL)
        self.exports = ctypes.CDLL(str(build / "src" / "libkrnumer.so"))
        for create in (self.host.KrrtNewArray, self.host.KrrtNewMatrix, self.host.KrrtElements):
            create.restype = ctypes.c_void_p

    def array(self, values=(), dtype=float):
        """A 1-D or 2-D array of the host."""
        values = np.ascontiguousarray(values, dtype)
        create = self.host.KrrtNewMatrix if values.ndim == 2 else self.host.KrrtNewArray
        handle = ctypes.c_void_p(create(CODES[values.dtype], *values.shape))
        ctypes.memmove(self.elements(handle), values.ctypes.data, values.nbytes)
        return handle

    def elements(self, handle):
        return ctypes.c_void_p(self.host.KrrtElements(handle))

    def values(self, handle, dtype=float):
        """What an array holds now."""
        shape = [self.host.KrrtSize(handle, axis) for axis in range(self.host.KrrtRank(handle))]
        out = np.empty(shape, dtype)
        ctypes.memmove(out.ctypes.data, self.elements(handle), out.nbytes)
        return out
