// The five services that the library asks of its host. Each is looked up by name at its first use; see host.cpp.
#pragma once

#include <cstdint>

#include "krnumer/types.h"

namespace krnumer::host {

// Makes the block of *handle long enough for total_elements of the kind type_code behind num_dims dimension words.
// May move the block and may store another handle. 0 is success. Dimension words are the caller's to store.
std::int32_t ResizeNumberBlock(std::int32_t type_code, std::int32_t num_dims, KrHandle* handle,
                               std::int32_t total_elements);

// Has procedure(data) called when the calling instance goes away. The library's mode is always 2.
using CleanupProcedure = void (*)(void* data);
void HookCleanup(CleanupProcedure procedure, void* data, std::int32_t mode);

// Blocks of plain bytes: make (null when there is no memory), resize (0 is success), free.
KrHandle MakeBlock(std::int32_t bytes);
std::int32_t SizeBlock(KrHandle handle, std::int32_t bytes);
void DropBlock(KrHandle handle);

}  // namespace krnumer::host
