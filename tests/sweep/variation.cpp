#include "sweep/variation.h"

#include <algorithm>
#include <bit>
#include <cstring>
#include <limits>

#include "krrt/krrt.h"

namespace sweep {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNotANumber = std::numeric_limits<double>::quiet_NaN();
constexpr int32_t kLeast = std::numeric_limits<int32_t>::min(), kMost = std::numeric_limits<int32_t>::max();

constexpr double kNumbers[] = {
    0.0,
    -0.0,
    1.0,
    -1.0,
    0.5,
    -0.5,
    2.0,
    3.0,
    1e-9,
    -1e-9,
    1e9,
    -1e9,
    1e-300,
    5e-324,
    -5e-324,
    1e300,
    -1e300,
    1.7e308,
    -1.7e308,
    kInfinity,
    -kInfinity,
    kNotANumber,
    0.1,
    10.0,
    100.0,
    1e5,
    2147483647,
    2147483648,
    -2147483649.0,
    1.0000000000000002,
    0.9999999999999999,
};
constexpr int32_t kIntegers[] = {
    0,   1,   -1,  2,    3,    4,     5,     7,     8,      15,        16,         17, 31, 64,
    100, 255, 256, 1000, 4096, 65535, 65536, kMost, kLeast, kMost - 1, kLeast + 1, -2, -3, -100,
};

// The longest side of a varied array of one, two and three dimensions.
constexpr int32_t kSides[] = {100, 24, 9};

enum Filling { kAsTheyWere, kOneByOne, kRandom, kMixed, kRising, kConstant, kWholeNumbers, kFillings };

}  // namespace

uint64_t ElementBytes(int32_t type_code) {
    switch (type_code) {
        case KRRT_UINT8:
            return 1;
        case KRRT_DOUBLE:
            return 8;
        case KRRT_COMPLEX:
            return 16;
        default:
            return 4;
    }
}

double Variation::Of(double value) {
    const uint8_t how = Byte();
    if (how == 0) return value;
    if (how <= std::size(kNumbers)) return kNumbers[how - 1];
    if (how < 96) return value * (how - 64) / 16.0;
    if (how < 160) return how - 128;
    if (how < 224) return value + (how - 192) / 32.0;
    uint64_t bits = 0;
    for (int i = 0; i < 8; ++i) bits = bits << 8 | Byte();
    return std::bit_cast<double>(bits);
}

int32_t Variation::Of(int32_t value) {
    const uint8_t how = Byte();
    if (how == 0) return value;
    if (how <= std::size(kIntegers)) return kIntegers[how - 1];
    if (how < 240) return how - 96;
    return (how - 240) << 8 | Byte();
}

void Variation::Resize(std::vector<int32_t>* dimensions) {
    const int32_t longest = kSides[dimensions->size() - 1];
    for (int32_t& dimension : *dimensions) {
        const uint8_t how = Byte();
        if (how == 255)
            dimension = longest;
        else if (how > 0)
            dimension = (how - 1) % longest;
    }
    // An array without elements has no size in any direction.
    if (std::ranges::count(*dimensions, 0) > 0) std::ranges::fill(*dimensions, 0);
}

uint64_t Variation::Random() {
    random_ = random_ * 6364136223846793005u + 1442695040888963407u;
    return random_ >> 11;
}

std::vector<char> Variation::Elements(int32_t type_code, const void* elements, uint64_t original, uint64_t count) {
    const auto filling = static_cast<Filling>(Byte() % kFillings);
    const uint64_t bytes = ElementBytes(type_code);
    const uint8_t seed = filling == kAsTheyWere ? 0 : Byte();
    random_ = seed;
    std::vector<char> result(bytes * count);
    const auto Next = [&](double was, uint64_t i) -> double {
        switch (filling) {
            case kOneByOne:
                return Of(was);
            case kMixed:
                return Random() % 8 == 0 ? kNumbers[Random() % std::size(kNumbers)] : was;
            case kRandom:
                return static_cast<double>(Random()) * 0x1p-52 - 1.0;
            case kRising:
                return static_cast<double>(i) * 0.25 - seed;
            case kWholeNumbers:
                return static_cast<double>(Random() % 7) - 3.0;
            case kConstant:
                return seed < std::size(kNumbers) ? kNumbers[seed] : seed - 128;
            default:
                return was;
        }
    };
    const auto Fill = [&]<class T>(T, uint64_t words) {
        for (uint64_t i = 0; i < words; ++i) {
            T value{};
            const uint64_t period = original * (words / std::max<uint64_t>(count, 1));
            if (period > 0) std::memcpy(&value, static_cast<const char*>(elements) + i % period * sizeof(T), sizeof(T));
            if constexpr (sizeof(T) == 8) {
                value = Next(value, i);
            } else if (filling == kOneByOne) {
                value = Of(value);
            } else if (filling != kAsTheyWere) {
                value = static_cast<T>(Random() % 32);
            }
            std::memcpy(result.data() + i * sizeof(T), &value, sizeof(T));
        }
    };
    switch (type_code) {
        case KRRT_UINT8:
            Fill(uint8_t{}, count);
            break;
        case KRRT_DOUBLE:
            Fill(double{}, count);
            break;
        case KRRT_COMPLEX:
            Fill(double{}, 2 * count);
            break;
        default:
            Fill(int32_t{}, count);
    }
    return result;
}

}  // namespace sweep
