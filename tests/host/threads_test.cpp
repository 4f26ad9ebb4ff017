// Threads use the host at once: each with its own settings and instance, on counts that they share.

#include <atomic>
#include <thread>

#include "support/host_arrays.h"

namespace krnumer {
namespace {

constexpr int kThreads = 4;

template <class Work>
void InThreads(Work work) {
    std::vector<std::thread> threads;
    for (int i = 0; i < kThreads; ++i) threads.emplace_back(work, i);
    for (std::thread& thread : threads) thread.join();
}

TEST(Threads, StartWithTheDefaults) {
    const LeastAlignment misaligned;
    const MovingBlocks moving;
    const FailResize failure;
    KrrtInstance* const instance = KrrtOpenInstance();
    KrrtInstance* const former = KrrtUseInstance(instance);
    std::thread([] {
        EXPECT_EQ(KrrtLeastAlignment(0), 0);
        EXPECT_EQ(KrrtMovingBlocks(0), 0);
        EXPECT_EQ(KrrtFailurePending(KRRT_SIZINGS), 0);
        EXPECT_EQ(KrrtResizeCount(), 0);
        EXPECT_EQ(KrrtCurrentInstance(), nullptr);
    }).join();
    KrrtUseInstance(former);
    KrrtCloseInstance(instance);
}

TEST(Threads, KeepTheirSettingsToThemselves) {
    const LeakCheck leaks;
    InThreads([](int thread) {
        KrrtLeastAlignment(thread % 2);
        for (int32_t round = 1; round <= 200; ++round) {
            HostArray<double> x(round);
            KrHandle handle = x.handle();
            const ResizeLog log;
            const FailResize failure(2, 100 + thread);
            EXPECT_EQ(ResizeNumberBlock(KRRT_DOUBLE, 1, &handle, 2 * round), KRRT_OK);
            EXPECT_EQ(ResizeNumberBlock(KRRT_DOUBLE, 1, &handle, 3 * round), 100 + thread);
            EXPECT_EQ(log.size(), 2);
            EXPECT_EQ(reinterpret_cast<uintptr_t>(KrrtElements(handle)) % 8, thread % 2 == 1 ? 4U : 0U);
            EXPECT_EQ(x.values(), std::vector<double>(static_cast<std::size_t>(round)));
        }
    });
}

TEST(Threads, ShareOneCountOfLiveBlocks) {
    const LeakCheck leaks;
    std::vector<KrHandle> arrays(kThreads);
    InThreads([&arrays](int thread) { arrays[static_cast<std::size_t>(thread)] = KrrtNewArray(KRRT_DOUBLE, 10); });
    EXPECT_EQ(KrrtLiveBlocks(), leaks.live_before() + kThreads);
    InThreads([&arrays](int thread) { KrrtFree(arrays[static_cast<std::size_t>(thread)]); });
}

TEST(Threads, RegisterWithOneInstanceAtOnce) {
    constexpr int kEach = 500;
    static std::atomic<int> cleaned;
    cleaned = 0;
    KrrtInstance* const instance = KrrtOpenInstance();
    InThreads([instance](int) {
        KrrtUseInstance(instance);
        for (int i = 0; i < kEach; ++i) HookCleanup([](void*) { ++cleaned; }, nullptr, 2);
    });
    EXPECT_EQ(KrrtPendingCleanups(instance), kThreads * kEach);
    KrrtCloseInstance(instance);
    EXPECT_EQ(cleaned, kThreads * kEach);
}

}  // namespace
}  // namespace krnumer
