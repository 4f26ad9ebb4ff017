#include "fft/table_slot.h"

#include <cstdlib>
#include <utility>

#include "fft/table.h"
#include "frame/host.h"
#include "frame/status.h"

namespace krnumer {
namespace {

constexpr int32_t kCleanupMode = 2;

int32_t BindFreshSlot(void** slot, int32_t length) {
    auto* record = static_cast<TableSlotRecord*>(std::malloc(sizeof(TableSlotRecord)));
    if (record == nullptr) return kOutOfMemory;
    record->table = CreateTable(length);
    if (record->table == nullptr) {
        std::free(record);
        return kOutOfMemory;
    }
    *slot = record;
    host::HookCleanup(DropSlotTable, record, kCleanupMode);
    return kOk;
}

}  // namespace

// A record that outlives a failed change of its length stays registered for the clean-up, so it must stay alive.
int32_t BindTableSlot(void** slot, int32_t length) {
    if (*slot == nullptr) return BindFreshSlot(slot, length);
    auto* record = static_cast<TableSlotRecord*>(*slot);
    if (record->table != nullptr) {
        if (record->table->length == length) return kOk;
        DestroyTable(std::exchange(record->table, nullptr));
    }
    record->table = CreateTable(length);
    return record->table != nullptr ? kOk : kOutOfMemory;
}

void DropSlotTable(void* data) {
    auto* record = static_cast<TableSlotRecord*>(data);
    if (record->table != nullptr) DestroyTable(record->table);
    std::free(record);
}

}  // namespace krnumer
