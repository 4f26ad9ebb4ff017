// Arrays as a program makes and reads them.

#include <cstring>
#include <initializer_list>
#include <limits>

#include "block.h"
#include "element.h"

namespace krrt {
namespace {

// The product of `factor` and `count`, or the largest size, which no allocation can satisfy.
std::size_t Product(std::size_t factor, std::size_t count) {
    constexpr std::size_t kMost = std::numeric_limits<std::size_t>::max() / 2;
    return count == 0 || factor <= kMost / count ? factor * count : kMost;
}

KrHandle NewArray(std::size_t element_bytes, std::initializer_list<int32_t> sizes) {
    if (element_bytes == 0) return nullptr;
    std::size_t bytes = element_bytes;
    for (const int32_t size : sizes) {
        if (size < 0) return nullptr;
        bytes = Product(bytes, static_cast<std::size_t>(size));
    }
    bytes += sizes.size() * sizeof(int32_t);
    Block* block = NewBlock(static_cast<int32_t>(sizes.size()), bytes);
    if (block == nullptr) return nullptr;
    std::memset(block->Start(), 0, bytes);
    std::memcpy(block->Start(), sizes.begin(), block->WordBytes());
    return &block->start;
}

// Where the dimension word stands, or null when the block has none of that number.
std::byte* SizeWord(KrHandle handle, int32_t dimension) {
    if (dimension < 0 || dimension >= KrrtRank(handle)) return nullptr;
    return FromHandle(handle)->Start() + sizeof(int32_t) * static_cast<std::size_t>(dimension);
}

}  // namespace
}  // namespace krrt

KrHandle KrrtNewArray(int32_t typeCode, int32_t size) {
    return krrt::NewArray(krrt::ElementBytes(typeCode), {size});
}

KrHandle KrrtNewMatrix(int32_t typeCode, int32_t rows, int32_t columns) {
    return krrt::NewArray(krrt::ElementBytes(typeCode), {rows, columns});
}

KrHandle KrrtNewCube(int32_t typeCode, int32_t pages, int32_t rows, int32_t columns) {
    return krrt::NewArray(krrt::ElementBytes(typeCode), {pages, rows, columns});
}

KrHandle KrrtNewRecords(int32_t recordBytes, int32_t count) {
    return recordBytes > 0 ? krrt::NewArray(static_cast<std::size_t>(recordBytes), {count}) : nullptr;
}

void KrrtFree(KrHandle handle) {
    krrt::FreeBlock(krrt::FromHandle(handle));
}

int32_t KrrtRank(KrHandle handle) {
    return handle != nullptr ? krrt::FromHandle(handle)->rank : 0;
}

int32_t KrrtSize(KrHandle handle, int32_t dimension) {
    int32_t size = 0;
    if (const std::byte* word = krrt::SizeWord(handle, dimension)) std::memcpy(&size, word, sizeof size);
    return size;
}

void KrrtSetSize(KrHandle handle, int32_t dimension, int32_t size) {
    if (std::byte* word = krrt::SizeWord(handle, dimension)) std::memcpy(word, &size, sizeof size);
}

void* KrrtElements(KrHandle handle) {
    if (handle == nullptr) return nullptr;
    const krrt::Block& block = *krrt::FromHandle(handle);
    return block.Start() + block.WordBytes();
}

uint64_t KrrtBytes(KrHandle handle) {
    return handle != nullptr ? krrt::FromHandle(handle)->bytes : 0;
}
