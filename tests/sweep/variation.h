// Turns bytes into variations of a scene's arguments: other sizes, other elements, other numbers, now and then the
// same array twice. A zero byte, and the end of the bytes, leave things as the scene has them, so that short inputs
// stay near a call that succeeds.
#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace sweep {

uint64_t ElementBytes(int32_t type_code);

class Variation {
  public:
    explicit Variation(std::span<const uint8_t> bytes) : bytes_(bytes) {}

    double Of(double value);
    int32_t Of(int32_t value);
    uint8_t Of(uint8_t value) { return Byte() == 0 ? value : last_; }
    uint16_t Of(uint16_t value) { return static_cast<uint16_t>(Of(int32_t{value})); }

    // One of `count`; the first without bytes.
    size_t Choice(size_t count) { return Byte() % count; }

    void Resize(std::vector<int32_t>* dimensions);

    // The bytes of `count` elements made of the `original` ones of a scene.
    std::vector<char> Elements(int32_t type_code, const void* elements, uint64_t original, uint64_t count);

  private:
    uint8_t Byte() {
        last_ = 0;
        if (!bytes_.empty()) {
            last_ = bytes_.front();
            bytes_ = bytes_.subspan(1);
        }
        return last_;
    }
    uint64_t Random();

    std::span<const uint8_t> bytes_;
    uint8_t last_ = 0;
    uint64_t random_ = 0;
};

}  // namespace sweep
