// One input of the fuzzer: a scene, chosen by the first two bytes, played with arguments varied by the others.
#pragma once

#include <cstdint>
#include <span>
#include <string>

namespace sweep {

// What is wrong with the library's answer; empty when nothing is. The call is played over arrays that move with every
// resize, and again with these at the least alignment: both have to answer alike, with a known status, and to leave
// nothing behind.
std::string Fuzz(std::span<const uint8_t> input);

// The scene that an input plays.
std::string FuzzedScene(std::span<const uint8_t> input);

}  // namespace sweep
