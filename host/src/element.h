#pragma once

#include <cstddef>
#include <cstdint>

#include "krrt/krrt.h"

namespace krrt {

// 0 for a code that names no element.
constexpr std::size_t ElementBytes(int32_t type_code) {
    switch (type_code) {
        case KRRT_INT32:
            return sizeof(int32_t);
        case KRRT_UINT8:
            return sizeof(uint8_t);
        case KRRT_UINT32:
            return sizeof(uint32_t);
        case KRRT_DOUBLE:
            return sizeof(double);
        case KRRT_COMPLEX:
            return sizeof(KrComplex);
        default:
            return 0;
    }
}

}  // namespace krrt
