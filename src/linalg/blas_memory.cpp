// OpenBLAS takes its work buffers from one table. Its serial build changes the table without a lock, although nothing
// keeps several threads from calling it: two of them may get the same buffer, and then their results are wrong. The
// linker leads every request for a buffer here (--wrap), where it waits for its turn; the work itself goes on side by
// side.

#include <mutex>

// NOLINTBEGIN(bugprone-reserved-identifier): the names are the linker's
extern "C" {

void* __real_blas_memory_alloc(int position);
void __real_blas_memory_free(void* buffer);
void* __wrap_blas_memory_alloc(int position);
void __wrap_blas_memory_free(void* buffer);
}

namespace {

std::mutex table_mutex;

}  // namespace

void* __wrap_blas_memory_alloc(int position) {
    const std::lock_guard lock(table_mutex);
    return __real_blas_memory_alloc(position);
}

void __wrap_blas_memory_free(void* buffer) {
    const std::lock_guard lock(table_mutex);
    __real_blas_memory_free(buffer);
}
// NOLINTEND(bugprone-reserved-identifier)
