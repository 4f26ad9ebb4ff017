#include <string>

#include "krnumer/status.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

TEST(StatusText, IsTheMeaningInThePublicHeader) {
    EXPECT_STREQ(KrrtStatusText(KRN_OK), "success");
    EXPECT_STREQ(KrrtStatusText(KRN_BAD_DUTY), "the duty cycle is not positive");
    EXPECT_STREQ(KrrtStatusText(KRN_BAD_ORDER), "an order or a count is less than 1; a polynomial is constant");
    EXPECT_STREQ(KrrtStatusText(KRN_LAPACK_ERROR), "LAPACK reported an argument or internal error");
    EXPECT_STREQ(KrrtStatusText(KRN_WARN_INACCURATE), "the matrix function is inaccurate");
}

TEST(StatusText, CoversTheHostItself) {
    EXPECT_STREQ(KrrtStatusText(KRRT_OUT_OF_MEMORY), "the host has no memory");
    EXPECT_STREQ(KrrtStatusText(-1), "unknown status");
}

TEST(StatusText, IsOneLineThroughout) {
    int known = 0;
    for (int32_t status = -21000; status <= 21000; ++status) {
        const std::string text = KrrtStatusText(status);
        EXPECT_FALSE(text.empty()) << status;
        EXPECT_EQ(text.find_first_of("\n*<>"), std::string::npos) << text;
        known += text != "unknown status";
    }
    EXPECT_GT(known, 90);
}

}  // namespace
}  // namespace krnumer
