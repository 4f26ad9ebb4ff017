// An allocator for the whole test program that counts what the library takes and can refuse it.
#pragma once

#include <cstdint>

namespace sweep {

// While armed, the calling thread's allocations are counted and the refused one fails. Host arrays do not take part:
// the host allocates them by other means.
class ArmedAllocator {
  public:
    // Refuses the nth allocation from now; 0 refuses none.
    explicit ArmedAllocator(int32_t refused);
    ~ArmedAllocator();
    ArmedAllocator(const ArmedAllocator&) = delete;
    ArmedAllocator& operator=(const ArmedAllocator&) = delete;

    static int32_t allocations();  // of the last armed stretch
    static bool refused();         // whether the last armed stretch met its refusal
};

// While one exists, armed stretches of this thread get no block longer than its bytes.
class AllocationLimit {
  public:
    explicit AllocationLimit(uint64_t bytes);
    ~AllocationLimit();
    AllocationLimit(const AllocationLimit&) = delete;
    AllocationLimit& operator=(const AllocationLimit&) = delete;
};

// Blocks that armed stretches of this thread took and nobody has freed since.
int64_t LiveAllocations();

}  // namespace sweep
