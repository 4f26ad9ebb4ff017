// Binding to the host. A service is resolved by name at its first use and cached; a process that never needs a
// service needs no host. Two threads may resolve the same service at once: both store the same address, and the
// relaxed atomics make that harmless without a lock.

#include "frame/host.h"

#include <atomic>
#include <cstdio>

#include "frame/module.h"
#include "krnumer/binding.h"

namespace krnumer::host {
namespace {

std::atomic<void*> named_module{nullptr};

struct Service {
    const char* name;
    std::atomic<void*> address{nullptr};
};

Service resize_number_block{"ResizeNumberBlock"};
Service hook_cleanup{"HookCleanup"};
Service drop_block{"DropBlock"};
Service make_block{"MakeBlock"};
Service size_block{"SizeBlock"};

// The module is looked up anew for each service, so that a module named in between counts for the services that
// are not resolved yet.
void* Resolve(Service& service) {
    module::Module module{named_module.load(std::memory_order_relaxed), false};
    if (module.handle == nullptr) module = module::Find();
    if (module.handle == nullptr) module::Fatal("KORVANE.LIB was not called from a Korvane process.");

    void* const address = module::Export(module, service.name);
    if (address == nullptr) {
        char message[300];
        std::snprintf(message, sizeof message, "KORVANE.LIB could not locate \"%s\".", service.name);
        module::Fatal(message);
    }
    service.address.store(address, std::memory_order_relaxed);
    return address;
}

template <class Function>
Function* Bind(Service& service) {
    void* address = service.address.load(std::memory_order_relaxed);
    if (address == nullptr) [[unlikely]]
        address = Resolve(service);
    return reinterpret_cast<Function*>(address);
}

}  // namespace

std::int32_t ResizeNumberBlock(std::int32_t type_code, std::int32_t num_dims, KrHandle* handle,
                               std::int32_t total_elements) {
    using Function = std::int32_t(std::int32_t, std::int32_t, KrHandle*, std::int32_t);
    return Bind<Function>(resize_number_block)(type_code, num_dims, handle, total_elements);
}

void HookCleanup(CleanupProcedure procedure, void* data, std::int32_t mode) {
    using Function = void(CleanupProcedure, void*, std::int32_t);
    Bind<Function>(hook_cleanup)(procedure, data, mode);
}

KrHandle MakeBlock(std::int32_t bytes) {
    using Function = KrHandle(std::int32_t);
    return Bind<Function>(make_block)(bytes);
}

std::int32_t SizeBlock(KrHandle handle, std::int32_t bytes) {
    using Function = std::int32_t(KrHandle, std::int32_t);
    return Bind<Function>(size_block)(handle, bytes);
}

void DropBlock(KrHandle handle) {
    using Function = void(KrHandle);
    Bind<Function>(drop_block)(handle);
}

}  // namespace krnumer::host

void* SetKRRTModule(void* module) {
    krnumer::host::named_module.store(module, std::memory_order_relaxed);
    return module;
}
