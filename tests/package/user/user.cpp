// The same from C++: the headers have to be C++ as well.
#include <krnumer/krnumer.h>
#include <krrt/krrt.h>

int main() {
    KrHandle samples = KrrtNewArray(KRRT_COMPLEX, 3);
    auto* first = static_cast<KrComplex*>(KrrtElements(samples));
    const bool zeroed = first->re == 0.0 && first->im == 0.0;
    KrrtFree(samples);
    return zeroed && SetKRRTModule(nullptr) == nullptr ? 0 : 1;
}
