// Instances and the clean-ups that end with them.

#include <cstdlib>
#include <mutex>
#include <new>
#include <utility>

#include "block.h"

namespace krrt {
namespace {

struct Cleanup {
    void (*procedure)(void*);
    void* data;
    Cleanup* earlier;
};

}  // namespace
}  // namespace krrt

struct KrrtInstance {
    krrt::Cleanup* latest;
    int32_t pending;
};

namespace krrt {
namespace {

// Guards the lists of all instances; never held while a clean-up runs.
std::mutex lists;
constinit KrrtInstance default_instance{};
constinit thread_local KrrtInstance* current = nullptr;

KrrtInstance& Resolve(KrrtInstance* instance) {
    return instance != nullptr ? *instance : default_instance;
}

template <class T>
T* New(T value) {
    Memory memory = Memory::Allocate(sizeof(T));
    return memory.base != nullptr ? new (memory.base) T(value) : nullptr;
}

template <class T>
void Delete(T* object) {
    Memory{reinterpret_cast<std::byte*>(object), sizeof(T)}.Free();
}

Cleanup* TakeLatest(KrrtInstance& instance) {
    const std::lock_guard lock(lists);
    Cleanup* cleanup = instance.latest;
    if (cleanup != nullptr) {
        instance.latest = cleanup->earlier;
        --instance.pending;
    }
    return cleanup;
}

// One at a time, because a clean-up may register another.
void RunCleanups(KrrtInstance& instance) {
    while (Cleanup* cleanup = TakeLatest(instance)) {
        cleanup->procedure(cleanup->data);
        Delete(cleanup);
    }
}

// Registered with the first clean-up rather than at load time: exit handlers run in reverse, and this one has to
// come before those of the library that the clean-ups belong to.
void EndDefaultInstanceAtExit() {
    static std::once_flag once;
    std::call_once(once, [] { std::atexit([] { RunCleanups(default_instance); }); });
}

}  // namespace
}  // namespace krrt

void HookCleanup(void (*procedure)(void*), void* data, [[maybe_unused]] int32_t mode) {
    if (procedure == nullptr) return;
    krrt::Cleanup* cleanup = krrt::New(krrt::Cleanup{procedure, data, nullptr});
    if (cleanup == nullptr) return;
    KrrtInstance& instance = krrt::Resolve(krrt::current);
    if (&instance == &krrt::default_instance) krrt::EndDefaultInstanceAtExit();
    const std::lock_guard lock(krrt::lists);
    cleanup->earlier = std::exchange(instance.latest, cleanup);
    ++instance.pending;
}

KrrtInstance* KrrtOpenInstance() {
    return krrt::New(KrrtInstance{});
}

void KrrtCloseInstance(KrrtInstance* instance) {
    krrt::RunCleanups(krrt::Resolve(instance));
    if (instance == nullptr) return;
    if (krrt::current == instance) krrt::current = nullptr;
    krrt::Delete(instance);
}

KrrtInstance* KrrtUseInstance(KrrtInstance* instance) {
    return std::exchange(krrt::current, instance);
}

KrrtInstance* KrrtCurrentInstance() {
    return krrt::current;
}

int32_t KrrtPendingCleanups(KrrtInstance* instance) {
    const std::lock_guard lock(krrt::lists);
    return krrt::Resolve(instance).pending;
}
