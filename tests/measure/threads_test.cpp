// Threads that measure in one context and in many, while others create, clear and destroy.

#include <atomic>
#include <thread>

#include "frame/status.h"
#include "measure/measuring.h"

namespace krnumer {
namespace {

constexpr int kThreads = 4;
constexpr int kRounds = 200;

template <class Body>
void InThreads(Body body) {
    std::vector<std::thread> threads;
    for (int i = 0; i < kThreads; ++i) threads.emplace_back([=] { body(i); });
    for (std::thread& thread : threads) thread.join();
}

Block Wave(int32_t period) {
    Block block;
    for (int32_t i = 0; i < 40 * period; ++i) block.samples.push_back(i / period % 2 == 0 ? 1.0 : 3.0);
    return block;
}

TEST(MeasurementThreads, EachInItsContext) {
    InThreads([](int thread) {
        Block block = Wave(3 + thread);
        for (int round = 0; round < kRounds; ++round) {
            const NewContext context;
            block.occurrence = 1 + round % 15;
            EXPECT_EQ(Fetch(context.id(), KRN_PERIOD, block).value, 2.0 * (3 + thread));
            EXPECT_EQ(Fetch(context.id(), KRN_CYCLE_MEAN, block).value, 2.0);
            EXPECT_EQ(Fetch(-1, KRN_DUTY_HIGH, block).value, 0.5);
        }
    });
}

TEST(MeasurementThreads, AllInOneContext) {
    const NewContext context;
    const int32_t id = context.id();
    InThreads([id](int thread) {
        Block block = Wave(5);
        for (int round = 0; round < kRounds; ++round) {
            block.occurrence = 1 + (round + thread) % 15;
            EXPECT_EQ(Fetch(id, KRN_PERIOD, block).value, 10.0);
            EXPECT_EQ(Fetch(id, KRN_DUTY_LOW, block).value, 0.5);
            if (round % 16 == thread) {
                EXPECT_EQ(measurements_clear(id), 0);
            }
        }
    });
}

// A context that is destroyed while it measures ends after it.
TEST(MeasurementThreads, DestroyedWhileMeasuring) {
    std::atomic<uint32_t> current{0};
    const auto expect_known_or_gone = [](int32_t status) { EXPECT_TRUE(status == 0 || status == kUnknownContext); };
    InThreads([&](int thread) {
        Block block = Wave(50);
        for (int round = 0; round < kRounds; ++round) {
            if (thread == 0) {
                uint32_t id = 0;
                EXPECT_EQ(measurements_create(&id), 0);
                const uint32_t former = current.exchange(id);
                if (former != 0) {
                    EXPECT_EQ(measurements_destroy(static_cast<int32_t>(former)), 0);
                }
            } else {
                expect_known_or_gone(Fetch(static_cast<int32_t>(current.load()), KRN_RISING_SLEW, block).status);
            }
        }
    });
    EXPECT_EQ(measurements_destroy(static_cast<int32_t>(current.load())), 0);
}

}  // namespace
}  // namespace krnumer
