#pragma once

namespace krnumer {

struct AiryFunctions {
    double ai, bi;
    double ai_prime, bi_prime;
};

// The Airy functions of x and their derivatives.
AiryFunctions Airy(double x);

}  // namespace krnumer
