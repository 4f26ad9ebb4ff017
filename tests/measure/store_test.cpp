// Identifiers of contexts.

#include "measure/store.h"

#include <gtest/gtest.h>

namespace krnumer::measure {
namespace {

TEST(MeasurementStore, CountsIdentifiersUp) {
    Store store;
    EXPECT_EQ(store.Create(), 1112u);
    EXPECT_EQ(store.Create(), 1113u);
    EXPECT_NE(store.Remove(1113), nullptr);
    EXPECT_EQ(store.Create(), 1114u) << "an identifier is not used again";
}

TEST(MeasurementStore, StartsAgainBehindTheGreatestIdentifier) {
    Store store(0xFFFFFFFD);
    EXPECT_EQ(store.Create(), 0xFFFFFFFDu);
    EXPECT_EQ(store.Create(), 0xFFFFFFFEu);
    EXPECT_EQ(store.Create(), 1u);
    EXPECT_EQ(store.Create(), 2u);
}

TEST(MeasurementStore, PassesIdentifiersInUse) {
    Store store(1, 4);
    for (uint32_t id = 1; id <= 4; ++id) EXPECT_EQ(store.Create(), id);
    const auto first = store.Find(1);
    EXPECT_NE(store.Remove(3), nullptr);
    EXPECT_EQ(store.Create(), 3u);
    EXPECT_EQ(store.Find(1), first);
}

TEST(MeasurementStore, FindsWhatItHolds) {
    Store store;
    const uint32_t id = store.Create();
    const auto context = store.Find(id);
    ASSERT_NE(context, nullptr);
    EXPECT_EQ(store.Find(id + 1), nullptr);
    EXPECT_EQ(store.Find(0), nullptr);
    EXPECT_EQ(store.Find(0xFFFFFFFF), nullptr);
    EXPECT_EQ(store.Remove(id), context);
    EXPECT_EQ(store.Remove(id), nullptr);
    EXPECT_EQ(store.Find(id), nullptr);
}

}  // namespace
}  // namespace krnumer::measure
