// The five services as krnumer calls them.

#include "support/host_arrays.h"

namespace krnumer {
namespace {

using ::testing::ElementsAre;

TEST(Resize, KeepsContentsUpToTheLesserSize) {
    HostArray<double> x{1, 2, 3};
    KrHandle handle = x.handle();
    ASSERT_EQ(ResizeNumberBlock(KRRT_DOUBLE, 1, &handle, 1000), KRRT_OK);
    EXPECT_EQ(handle, x.handle());
    EXPECT_THAT(x.values(), ElementsAre(1, 2, 3));
}

}  // namespace
}  // namespace krnumer
