#include "sweep/fuzz.h"

#include <algorithm>

#include "sweep/sweep.h"

namespace sweep {
namespace {

constexpr uint64_t kHostBytes = uint64_t{1} << 20;     // of one array; the thousands of rows of some scenes have to fit
constexpr uint64_t kScratchBytes = uint64_t{1} << 21;  // of one allocation; a copy of any array has to fit
constexpr int32_t kFirstStatus = -20999, kLastStatus = -20000;

// The place of a scene does not change when others join: it comes from the name alone (FNV-1a).
uint16_t Place(const std::string& name) {
    uint32_t hash = 2166136261u;
    for (const char c : name) hash = (hash ^ static_cast<uint8_t>(c)) * 16777619u;
    return static_cast<uint16_t>(hash >> 16 ^ hash);
}

// The scene at the place of the first two bytes, or the next behind it.
const Entry& Chosen(std::span<const uint8_t> input) {
    static const std::vector<Entry> scenes = [] {
        std::vector<Entry> all = Entries();
        std::ranges::sort(all, {},
                          [](const Entry& entry) { return std::pair(Place(entry.scene_name), entry.scene_name); });
        return all;
    }();
    const auto place = static_cast<uint16_t>((input.empty() ? 0 : input[0]) << 8 | (input.size() < 2 ? 0 : input[1]));
    const auto found = std::ranges::lower_bound(scenes, place, {}, [](const Entry& e) { return Place(e.scene_name); });
    return found == scenes.end() ? scenes.front() : *found;
}

struct Answer {
    std::string results;
    int32_t status;
};

Answer AnswerOf(const Entry& entry, std::span<const uint8_t> bytes) {
    Variation variation(bytes);
    Scene scene(&variation);
    entry.play(scene);
    KrrtCloseInstance(nullptr);
    return {scene.Results(), scene.status()};
}

}  // namespace

std::string FuzzedScene(std::span<const uint8_t> input) {
    return Chosen(input).scene_name;
}

std::string Fuzz(std::span<const uint8_t> input) {
    const Entry& entry = Chosen(input);
    const auto bytes = input.subspan(std::min<size_t>(2, input.size()));
    KrrtBlockLimit(kHostBytes);
    KrrtMovingBlocks(1);  // fresh elements, which some calls leave as they are, are the same every time then
    const AllocationLimit limit(kScratchBytes);
    const Answer plain = AnswerOf(entry, bytes);
    // Counted from here, for the library keeps a little from the first call of its kind on.
    const int64_t blocks = KrrtLiveBlocks(), allocations = LiveAllocations(), stale = KrrtStaleWrites();
    KrrtLeastAlignment(1);
    const Answer moved = AnswerOf(entry, bytes);
    KrrtLeastAlignment(0);
    KrrtMovingBlocks(0);
    KrrtBlockLimit(0);

    const bool known = plain.status >= 0 || (kFirstStatus <= plain.status && plain.status <= kLastStatus);
    if (!known) return "unknown status " + std::to_string(plain.status);
    if (plain.results != moved.results)
        return "arrays at the least alignment give other results: " + plain.results + " and " + moved.results;
    if (KrrtLiveBlocks() != blocks) return "blocks of the host were left behind";
    if (LiveAllocations() != allocations) return "memory was left behind";
    if (KrrtStaleWrites() != stale) return "a block was written to after it had moved";
    return {};
}

}  // namespace sweep
