#include "sweep/sweep.h"

#include <gtest/gtest.h>

#include <fstream>
#include <set>

#include "frame/status.h"
#include "krnumer/krnumer.h"

namespace sweep {
namespace {

constexpr int32_t kHostRefusal = 4711;
constexpr int32_t kMostFailures = 200;  // a scene needs far fewer resizes and allocations; an endless loop does not

class ExportSweep : public testing::TestWithParam<Entry> {
  protected:
    void SetUp() override {
        Played();  // what the library keeps from its first call on is not left behind by the later ones
        blocks_ = KrrtLiveBlocks();
        allocations_ = LiveAllocations();
        stale_ = KrrtStaleWrites();
    }
    void TearDown() override {
        KrrtLeastAlignment(0);
        KrrtMovingBlocks(0);
        KrrtFail(KRRT_SIZINGS, 0, 0);
        KrrtCloseInstance(nullptr);
        EXPECT_EQ(KrrtLiveBlocks(), blocks_) << "blocks of the host were left behind";
        EXPECT_EQ(LiveAllocations(), allocations_) << "memory was left behind";
        EXPECT_EQ(KrrtStaleWrites(), stale_) << "a block was written to after it had moved";
    }

    // Plays the scene and gives its results.
    std::string Played() {
        Scene scene;
        GetParam().play(scene);
        EXPECT_GE(scene.status(), scene.undisturbed_status()) << "a scene shows a call that succeeds";
        const std::string results = scene.Results();
        KrrtCloseInstance(nullptr);
        return results;
    }

    void RefuseAllocations() {
        const std::string undisturbed = Played();
        for (int32_t nth = 1; nth <= kMostFailures; ++nth) {
            Scene scene(nth);
            GetParam().play(scene);
            const bool refused = ArmedAllocator::refused();
            SCOPED_TRACE("allocation " + std::to_string(nth) + " refused, status " + std::to_string(scene.status()));
            if (!refused) {
                EXPECT_EQ(scene.Results(), undisturbed);
                return;
            }
            if (scene.status() >= 0) {
                EXPECT_TRUE(scene.survives_refusal()) << "succeeded without its memory";
            } else {
                EXPECT_EQ(scene.status(), scene.refusal_status());
                EXPECT_EQ(scene.NotCleared(), "");
            }
            KrrtCloseInstance(nullptr);
            EXPECT_EQ(LiveAllocations(), allocations_) << "memory was left behind";
        }
        FAIL() << "allocates without end";
    }

    int64_t blocks_, allocations_, stale_;
};

TEST_P(ExportSweep, GivesTheSameResultsAtTheLeastAlignment) {
    const std::string aligned = Played();
    KrrtLeastAlignment(1);
    EXPECT_EQ(Played(), aligned);
}

TEST_P(ExportSweep, GivesTheSameResultsWhenBlocksMove) {
    const std::string in_place = Played();
    KrrtMovingBlocks(1);
    EXPECT_EQ(Played(), in_place);
}

TEST_P(ExportSweep, ReportsEveryRefusedResize) {
    const std::string undisturbed = Played();
    for (int32_t nth = 1; nth <= kMostFailures; ++nth) {
        KrrtFail(KRRT_SIZINGS, nth, kHostRefusal);
        Scene scene;
        GetParam().play(scene);
        SCOPED_TRACE("resize " + std::to_string(nth) + " refused, status " + std::to_string(scene.status()));
        if (KrrtFailurePending(KRRT_SIZINGS) != 0) {
            KrrtFail(KRRT_SIZINGS, 0, 0);
            EXPECT_EQ(scene.Results(), undisturbed);
            return;
        }
        if (scene.survives_resize()) {
            EXPECT_EQ(scene.status(), krnumer::kOk);
        } else {
            EXPECT_TRUE(scene.status() == krnumer::kOutOfMemory || scene.status() == kHostRefusal);
        }
        EXPECT_EQ(scene.NotCleared(), "");
        KrrtCloseInstance(nullptr);
    }
    FAIL() << "resizes without end";
}

TEST_P(ExportSweep, ReportsEveryRefusedAllocation) {
    RefuseAllocations();
}

TEST_P(ExportSweep, ReportsEveryRefusedAllocationAtTheLeastAlignment) {
    KrrtLeastAlignment(1);
    RefuseAllocations();
}

TEST_P(ExportSweep, TouchesNothingOfMalformedArrays) {
    for (const int32_t size : {-1, -2, INT32_MIN}) {
        Malformed malformed{0, size, true};
        for (; malformed.met; ++malformed.array) {
            malformed.met = false;
            Scene scene(&malformed);
            GetParam().play(scene);
            KrrtCloseInstance(nullptr);
        }
    }
}

INSTANTIATE_TEST_SUITE_P(All, ExportSweep, testing::ValuesIn(Entries()),
                         [](const auto& entry) { return entry.param.scene_name; });

// The binding has no arrays; its tests stand with the frame.
TEST(ExportSweepList, HoldsEveryExport) {
    std::set<std::string> missing;
    std::ifstream names(KRNUMER_EXPORTED_NAMES);
    for (std::string name; names >> name;) missing.insert(name);
    ASSERT_FALSE(missing.empty());
    missing.erase("SetKRRTModule");
    for (const Entry& entry : Entries()) missing.erase(entry.export_name);
    EXPECT_EQ(missing, std::set<std::string>{});
}

}  // namespace
}  // namespace sweep
