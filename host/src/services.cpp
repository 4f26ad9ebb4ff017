// The services under the names by which krnumer looks for them.

#include "block.h"
#include "element.h"
#include "settings.h"

namespace krrt {
namespace {

int32_t Resize(int32_t type_code, int32_t num_dims, KrHandle* handle, int32_t total) {
    const std::size_t element_bytes = ElementBytes(type_code);
    if (handle == nullptr || *handle == nullptr || element_bytes == 0 || num_dims < 1 || num_dims > 2 || total < 0) {
        return KRRT_BAD_ARGUMENT;
    }
    const std::size_t word_bytes = static_cast<std::size_t>(num_dims) * sizeof(int32_t);
    const std::size_t bytes = word_bytes + static_cast<std::size_t>(total) * element_bytes;
    return ResizeBlock(*FromHandle(*handle), bytes) ? KRRT_OK : KRRT_OUT_OF_MEMORY;
}

// Both counts see every call, so that neither order depends on the other.
int32_t OrderedResizeFailure(int32_t total) {
    Settings& settings = ThreadSettings();
    const int32_t of_resizes = settings.failures[KRRT_RESIZES].Count();
    const int32_t of_sizings = total > 0 ? settings.failures[KRRT_SIZINGS].Count() : KRRT_OK;
    return of_resizes != KRRT_OK ? of_resizes : of_sizings;
}

int32_t OrderedBlockFailure() {
    return ThreadSettings().failures[KRRT_BLOCKS].Count();
}

}  // namespace
}  // namespace krrt

int32_t ResizeNumberBlock(int32_t typeCode, int32_t numDims, KrHandle* handle, int32_t totalElements) {
    int32_t status = krrt::OrderedResizeFailure(totalElements);
    if (status == KRRT_OK) status = krrt::Resize(typeCode, numDims, handle, totalElements);
    krrt::Log({typeCode, numDims, totalElements, status, handle != nullptr ? *handle : nullptr});
    return status;
}

KrHandle MakeBlock(int32_t bytes) {
    if (krrt::OrderedBlockFailure() != KRRT_OK || bytes < 0) return nullptr;
    krrt::Block* block = krrt::NewBlock(0, static_cast<std::size_t>(bytes));
    return block != nullptr ? &block->start : nullptr;
}

int32_t SizeBlock(KrHandle handle, int32_t bytes) {
    if (const int32_t status = krrt::OrderedBlockFailure(); status != KRRT_OK) return status;
    if (handle == nullptr || bytes < 0) return KRRT_BAD_ARGUMENT;
    return krrt::ResizeBlock(*krrt::FromHandle(handle), static_cast<std::size_t>(bytes)) ? KRRT_OK : KRRT_OUT_OF_MEMORY;
}

void DropBlock(KrHandle handle) {
    krrt::FreeBlock(krrt::FromHandle(handle));
}
