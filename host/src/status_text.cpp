// What the status codes mean, in words.

#include "krrt/krrt.h"

const char* KrrtStatusText(int32_t status) {
    switch (status) {
        case KRRT_OK:
            return "success";
        case KRRT_BAD_ARGUMENT:
            return "the host was asked for something that it cannot do";
        case KRRT_OUT_OF_MEMORY:
            return "the host has no memory";
#include "status_cases.inc"
        default:
            return "unknown status";
    }
}
