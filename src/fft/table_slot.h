// Table slots: a pointer cell of the caller, one per call site, in which the library keeps the table of that site's
// last length, so that calls with one length do no table work.
#pragma once

#include <cstdint>

#include "fft/fft.h"

namespace krnumer {

// What a slot points to: a block from malloc.
struct TableSlotRecord {
    qmfft_table* table;
};

// Makes the slot hold a table of the length; 0, or kOutOfMemory. The first bind of a slot has the host call
// DropSlotTable when the calling instance goes away. Without memory a fresh slot stays null, and one in use loses its
// table until the next bind.
int32_t BindTableSlot(void** slot, int32_t length);

// The table of a bound slot.
inline const qmfft_table* SlotTable(void* const* slot) {
    return static_cast<const TableSlotRecord*>(*slot)->table;
}

// Gives back a slot's record and its table, if any.
void DropSlotTable(void* record);

}  // namespace krnumer
