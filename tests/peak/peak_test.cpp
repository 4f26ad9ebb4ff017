// Peaks by parabolas in a sliding window, through the export.

#include <algorithm>
#include <cstring>
#include <fstream>
#include <limits>
#include <sstream>
#include <string>
#include <vector>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/peak.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::IsEmpty;

using Samples = std::vector<double>;

struct Found {
    Samples locations;
    Samples amplitudes;
    Samples second_derivatives;
};

// A detector with its record, state, work block and arrays.
class Detector {
  public:
    Detector(int32_t width, double threshold, int32_t polarity = KRN_PEAKS) {
        record_.width = width;
        record_.threshold = threshold;
        record_.polarity = polarity;
        record_.locations = locations_.handle();
        record_.amplitudes = amplitudes_.handle();
        record_.second_derivatives = second_derivatives_.handle();
    }
    ~Detector() { DropBlock(work_); }
    Detector(const Detector&) = delete;
    Detector& operator=(const Detector&) = delete;

    int32_t Take(const Samples& samples, int32_t flags) {
        HostArray<double> input(samples);
        record_.input = input.handle();
        record_.flags = flags;
        record_.count = -7;
        int32_t err = 77;
        const int32_t status = PeakD(&record_, &state_, &work_, &err);
        EXPECT_EQ(err, status);
        EXPECT_EQ(record_.count, locations_.size());
        EXPECT_EQ(record_.count, amplitudes_.size());
        EXPECT_EQ(record_.count, second_derivatives_.size());
        return status;
    }

    Found found() const { return {locations_.values(), amplitudes_.values(), second_derivatives_.values()}; }
    void SpoilOutputs() {
        for (HostArray<double>* array : {&locations_, &amplitudes_, &second_derivatives_}) ResizeOnce(*array);
    }

    KrPeakRecord& record() { return record_; }
    KrPeakState& state() { return state_; }
    KrHandle& work() { return work_; }

  private:
    static void ResizeOnce(HostArray<double>& array) {
        KrHandle handle = array.handle();
        ResizeNumberBlock(KRRT_DOUBLE, 1, &handle, 2);
        array.SetDimension(0, 2);
    }

    HostArray<double> locations_{1, 2, 3}, amplitudes_{4}, second_derivatives_;
    KrPeakRecord record_{};
    KrPeakState state_{};
    KrHandle work_ = nullptr;
};

constexpr int32_t kWhole = KRN_FIRST_BLOCK | KRN_LAST_BLOCK;

Found FindAll(const Samples& samples, int32_t width, double threshold, int32_t polarity = KRN_PEAKS) {
    const LeakCheck leaks;
    Detector detector(width, threshold, polarity);
    EXPECT_EQ(detector.Take(samples, kWhole), 0);
    EXPECT_EQ(detector.work(), nullptr) << "the work block is freed with the last block";
    return detector.found();
}

Samples Sampled(int32_t n, double (*function)(double)) {
    Samples samples;
    for (int32_t i = 0; i < n; ++i) samples.push_back(function(i));
    return samples;
}

double Hill(double x) {
    return 5.0 - 0.5 * (x - 7.3) * (x - 7.3);
}
double Hollow(double x) {
    return -Hill(x);
}

TEST(PeakD, LayoutOfRecords) {
    EXPECT_EQ(sizeof(KrPeakRecord), 56u);
    EXPECT_EQ(offsetof(KrPeakRecord, threshold), 8u);
    EXPECT_EQ(offsetof(KrPeakRecord, width), 16u);
    EXPECT_EQ(offsetof(KrPeakRecord, polarity), 20u);
    EXPECT_EQ(offsetof(KrPeakRecord, locations), 24u);
    EXPECT_EQ(offsetof(KrPeakRecord, amplitudes), 32u);
    EXPECT_EQ(offsetof(KrPeakRecord, second_derivatives), 40u);
    EXPECT_EQ(offsetof(KrPeakRecord, count), 48u);
    EXPECT_EQ(offsetof(KrPeakRecord, flags), 52u);
}

TEST(PeakD, ParabolasAreExactAtEveryWidth) {
    for (int32_t width = 3; width <= 12; ++width) {
        const Found peak = FindAll(Sampled(16, Hill), width, 0.0);
        EXPECT_THAT(peak.locations, AllNear({7.3}, 0.0, 1e-12)) << width;
        EXPECT_THAT(peak.amplitudes, AllNear({5.0}, 0.0, 1e-12));
        EXPECT_THAT(peak.second_derivatives, AllNear({-1.0}, 0.0, 1e-12));
        const Found valley = FindAll(Sampled(16, Hollow), width, 0.0, KRN_VALLEYS);
        EXPECT_THAT(valley.locations, AllNear({7.3}, 0.0, 1e-12)) << width;
        EXPECT_THAT(valley.amplitudes, AllNear({-5.0}, 0.0, 1e-12));
        EXPECT_THAT(valley.second_derivatives, AllNear({1.0}, 0.0, 1e-12));
        EXPECT_THAT(FindAll(Sampled(16, Hill), width, 0.0, KRN_VALLEYS).locations, IsEmpty());
        EXPECT_THAT(FindAll(Sampled(16, Hollow), width, 0.0).locations, IsEmpty());
    }
}

TEST(PeakD, VerticesAnywhereBetweenTwoSamples) {
    for (double vertex = 6.0; vertex <= 8.0; vertex += 1.0 / 64.0) {
        for (const int32_t width : {3, 4, 5, 8}) {
            Samples samples;
            for (int32_t i = 0; i < 16; ++i) samples.push_back(2.0 - (i - vertex) * (i - vertex));
            EXPECT_THAT(FindAll(samples, width, 0.0).locations, AllNear({vertex}, 0.0, 1e-12)) << width;
        }
    }
}

TEST(PeakD, TheThresholdItselfIsNotBeyond) {
    const Samples hill{-4, -1, 0, -1, -4, -9, -16};  // fitted without rounding: the height is 0
    Samples hollow;
    for (const double y : hill) hollow.push_back(-y);
    const double height = FindAll(hill, 3, -1.0).amplitudes.at(0);
    EXPECT_THAT(FindAll(hill, 3, height).locations, IsEmpty());
    EXPECT_EQ(FindAll(hill, 3, std::nextafter(height, -1.0)).locations.size(), 1u);
    const double depth = FindAll(hollow, 3, 1.0, KRN_VALLEYS).amplitudes.at(0);
    EXPECT_THAT(FindAll(hollow, 3, depth, KRN_VALLEYS).locations, IsEmpty());
    EXPECT_EQ(FindAll(hollow, 3, std::nextafter(depth, 1.0), KRN_VALLEYS).locations.size(), 1u);
}

TEST(PeakD, OnlyTheSlopeMakesACandidateOfWideWindows) {
    const Samples hill{-4, -1, 0, -1, -4};
    EXPECT_THAT(FindAll(hill, 5, -10.0).locations, IsEmpty()) << "the first window has none before it";
    EXPECT_THAT(FindAll({-1, 0, -1}, 3, -10.0).locations, AllNear({1.0}, 0.0, 1e-14));
    EXPECT_THAT(FindAll({-2.25, -0.25, -0.25, -2.25}, 4, -10.0).locations, AllNear({1.5}, 0.0, 1e-14));
}

TEST(PeakD, NoPeaksInStraightLines) {
    for (const int32_t width : {3, 4, 5, 9}) {
        EXPECT_THAT(FindAll(Samples(30, 3.0), width, 0.0).locations, IsEmpty());
        EXPECT_THAT(FindAll(Sampled(30, [](double x) { return x; }), width, 0.0).locations, IsEmpty());
        EXPECT_THAT(FindAll(Samples(30, kQuietNaN), width, 0.0).locations, IsEmpty());
        EXPECT_THAT(FindAll(Samples(30, kInfinity), width, 0.0, KRN_VALLEYS).locations, IsEmpty());
    }
}

TEST(PeakD, MorePeaksThanTheListBeginsWith) {
    const Samples wave = Sampled(8000, [](double x) { return std::cos(kPi / 2 * x); });
    const Found peaks = FindAll(wave, 3, 0.0);
    ASSERT_EQ(peaks.locations.size(), 1999u);
    for (std::size_t i = 0; i < peaks.locations.size(); ++i)
        EXPECT_THAT(peaks.locations[i], Near(4.0 * static_cast<double>(i + 1), 0.0, 1e-9));
}

// ---- Reference ----------------------------------------------------------------------------------------------------

struct Case {
    std::string name;
    Samples samples;
    int32_t width;
    int32_t polarity;
    double threshold;
    Found expected;
};

std::vector<Case> ReadCases() {
    std::vector<std::pair<std::string, Samples>> signals;
    std::ifstream signal_file(KRNUMER_REFERENCE "/signals.txt");
    for (std::string line; std::getline(signal_file, line);) {
        std::istringstream words(line);
        std::string name;
        words >> name;
        signals.emplace_back(name, Samples());
        for (double sample; words >> sample;) signals.back().second.push_back(sample);
    }
    std::vector<Case> cases;
    std::ifstream file(KRNUMER_REFERENCE "/expected.txt");
    for (std::string line; std::getline(file, line);) {
        std::istringstream words(line);
        Case c;
        std::size_t count = 0;
        words >> c.name >> c.width >> c.polarity >> c.threshold >> count;
        for (std::size_t i = 0; i < count; ++i) {
            double location, amplitude, second_derivative;
            words >> location >> amplitude >> second_derivative;
            c.expected.locations.push_back(location);
            c.expected.amplitudes.push_back(amplitude);
            c.expected.second_derivatives.push_back(second_derivative);
        }
        EXPECT_TRUE(words) << line;
        for (const auto& [name, samples] : signals)
            if (name == c.name) c.samples = samples;
        EXPECT_FALSE(c.samples.empty());
        cases.push_back(c);
    }
    EXPECT_GT(cases.size(), 50u);
    return cases;
}

TEST(PeakD, AgreesWithFitsOfAllWindows) {
    for (const Case& c : ReadCases()) {
        SCOPED_TRACE(testing::Message() << c.name << ", width " << c.width << ", polarity " << c.polarity);
        const Found found = FindAll(c.samples, c.width, c.threshold, c.polarity);
        EXPECT_THAT(found.locations, AllNear(c.expected.locations, 1e-9));
        EXPECT_THAT(found.amplitudes, AllNear(c.expected.amplitudes, 1e-9, 1e-10));
        EXPECT_THAT(found.second_derivatives, AllNear(c.expected.second_derivatives, 1e-9, 1e-10));
    }
}

// ---- Signals in blocks --------------------------------------------------------------------------------------------

// All peaks of a signal in blocks of this size, the last one longer, those found on both sides of a boundary once.
Found FindInBlocks(const Samples& samples, int32_t block, const Case& c) {
    const LeakCheck leaks;
    Detector detector(c.width, c.threshold, c.polarity);
    Found all;
    const auto n = static_cast<int32_t>(samples.size());
    for (int32_t begin = 0; begin < n;) {
        const int32_t end = n - begin < 2 * block ? n : begin + block;
        const int32_t flags = (begin == 0 ? KRN_FIRST_BLOCK : 0) | (end == n ? KRN_LAST_BLOCK : 0);
        EXPECT_EQ(detector.Take(Samples(samples.begin() + begin, samples.begin() + end), flags), 0);
        EXPECT_EQ(detector.work() == nullptr, end == n);
        const Found found = detector.found();
        for (std::size_t i = 0; i < found.locations.size(); ++i) {
            if (i == 0 && !all.locations.empty() && found.locations[0] - all.locations.back() < 1.0) {
                const bool replaces = c.polarity == KRN_VALLEYS ? found.amplitudes[0] < all.amplitudes.back()
                                                                : found.amplitudes[0] >= all.amplitudes.back();
                if (!replaces) continue;
                all.locations.pop_back();
                all.amplitudes.pop_back();
                all.second_derivatives.pop_back();
            }
            all.locations.push_back(found.locations[i]);
            all.amplitudes.push_back(found.amplitudes[i]);
            all.second_derivatives.push_back(found.second_derivatives[i]);
        }
        begin = end;
    }
    return all;
}

TEST(PeakD, BlocksGiveThePeaksOfTheWhole) {
    for (const Case& c : ReadCases()) {
        if (c.width < 5) continue;
        const Found whole = FindAll(c.samples, c.width, c.threshold, c.polarity);
        for (const int32_t block : {c.width, c.width + 1, 2 * c.width - 1, 50, 100}) {
            if (block < c.width) continue;
            SCOPED_TRACE(testing::Message() << c.name << ", width " << c.width << ", blocks of " << block);
            const Found parts = FindInBlocks(c.samples, block, c);
            EXPECT_THAT(parts.locations, SameBitsAs(whole.locations));
            EXPECT_THAT(parts.amplitudes, SameBitsAs(whole.amplitudes));
            EXPECT_THAT(parts.second_derivatives, SameBitsAs(whole.second_derivatives));
        }
    }
}

TEST(PeakD, AWindowWaitsForTheSampleBehindIt) {
    // The slope turns in the window about sample 8, which is the last of the first ten samples at width 5.
    const Samples hill = Sampled(16, Hill);
    Detector detector(5, 0.0);
    EXPECT_EQ(detector.Take(Samples(hill.begin(), hill.begin() + 10), KRN_FIRST_BLOCK), 0);
    EXPECT_THAT(detector.found().locations, IsEmpty());
    EXPECT_EQ(detector.Take(Samples(hill.begin() + 10, hill.end()), KRN_LAST_BLOCK), 0);
    EXPECT_THAT(detector.found().locations, AllNear({7.3}, 0.0, 1e-12));
}

TEST(PeakD, AFirstBlockOfOneWindowOnlyFillsTheHistory) {
    const Samples hill = Sampled(16, Hill);
    Detector detector(5, 0.0);
    EXPECT_EQ(detector.Take(Samples(hill.begin(), hill.begin() + 5), KRN_FIRST_BLOCK), 0);
    EXPECT_EQ(detector.state().held, 5);
    EXPECT_EQ(detector.state().processed, 0);
    EXPECT_EQ(detector.Take(Samples(hill.begin() + 5, hill.begin() + 10), 0), 0);
    EXPECT_EQ(detector.state().processed, 5);
    EXPECT_EQ(detector.Take(Samples(hill.begin() + 10, hill.end()), KRN_LAST_BLOCK), 0);
    EXPECT_THAT(detector.found().locations, AllNear({7.3}, 0.0, 1e-12));
}

TEST(PeakD, DuplicatesAreSeenWithinACallOnly) {
    const Samples hill = Sampled(16, Hill);
    Detector detector(3, 0.0);
    EXPECT_EQ(detector.Take(Samples(hill.begin(), hill.begin() + 9), KRN_FIRST_BLOCK), 0);
    EXPECT_THAT(detector.found().locations, IsEmpty());
    EXPECT_EQ(detector.Take(Samples(hill.begin() + 9, hill.begin() + 12), 0), 0);
    const auto first = detector.found().locations;
    EXPECT_THAT(first, AllNear({7.3}, 0.0, 1e-12));
}

TEST(PeakD, KeepsItsWorkInABlockOfTheHost) {
    const LeakCheck leaks;
    const Samples hill = Sampled(16, Hill);
    {
        Detector detector(7, 0.0);
        EXPECT_EQ(detector.Take(hill, KRN_FIRST_BLOCK), 0);
        ASSERT_NE(detector.work(), nullptr);
        EXPECT_EQ(KrrtBytes(detector.work()), 40u * 7 + 40);
        int32_t units;
        std::memcpy(&units, KrrtElements(detector.work()), sizeof units);
        EXPECT_EQ(units, (40 * 7 + 40) / 8);
        const KrHandle former = detector.work();
        detector.record().width = 9;
        EXPECT_EQ(detector.Take(hill, KRN_FIRST_BLOCK), 0) << "a new signal takes the block over";
        EXPECT_EQ(detector.work(), former);
        EXPECT_EQ(KrrtBytes(detector.work()), 40u * 9 + 40);
        EXPECT_THAT(detector.found().locations, AllNear({7.3}, 0.0, 1e-12));
        EXPECT_EQ(detector.Take(hill, KRN_LAST_BLOCK), 0);
        EXPECT_EQ(detector.work(), nullptr);
    }
}

TEST(PeakD, WorksAtTheLeastAlignment) {
    const LeastAlignment least;
    const Case c{"", Sampled(100, [](double x) { return std::sin(x); }), 6, KRN_PEAKS, 0.5, {}};
    const Found whole = FindAll(c.samples, 6, 0.5);
    EXPECT_EQ(whole.locations.size(), 15u);
    EXPECT_THAT(FindInBlocks(c.samples, 17, c).locations, SameBitsAs(whole.locations));
}

// ---- Failures -----------------------------------------------------------------------------------------------------

class PeakFailure : public testing::Test {
  protected:
    // A detector in the middle of a signal, whose next block fails.
    void ExpectFailure(const Samples& samples, int32_t flags, int32_t expected) {
        EXPECT_EQ(detector_.Take(samples, flags), expected);
        EXPECT_THAT(detector_.found().locations, IsEmpty());
        EXPECT_EQ(detector_.work(), nullptr);
    }
    void Begin() {
        EXPECT_EQ(detector_.Take(hill_, KRN_FIRST_BLOCK), 0);
        EXPECT_NE(detector_.work(), nullptr);
        detector_.SpoilOutputs();
    }

    LeakCheck leaks_;
    Samples hill_ = Sampled(16, Hill);
    Detector detector_{5, 0.0};
};

TEST_F(PeakFailure, WidthOutOfRange) {
    for (const int32_t width :
         {2, 0, -1, 1073741825, std::numeric_limits<int32_t>::max(), std::numeric_limits<int32_t>::min()}) {
        detector_.record().width = width;
        ExpectFailure(hill_, KRN_FIRST_BLOCK, kBadSelector);
        ExpectFailure({}, 0, kBadSelector);
        detector_.record().width = 5;
        Begin();
        detector_.record().width = width;
        ExpectFailure(hill_, 0, kBadSelector);
    }
}

TEST_F(PeakFailure, NoState) {
    ExpectFailure(hill_, 0, kNoState);
    ExpectFailure(hill_, KRN_LAST_BLOCK, kNoState);
    ExpectFailure({}, 0, kNoState);
    int32_t err = 77;
    HostArray<double> input(hill_);
    detector_.record().input = input.handle();
    detector_.record().flags = KRN_FIRST_BLOCK;
    EXPECT_EQ(PeakD(&detector_.record(), nullptr, &detector_.work(), &err), kNoState);
}

TEST_F(PeakFailure, StateOfAnotherDetector) {
    for (const int32_t width : {0, -1, 3, 6, 1073741824, std::numeric_limits<int32_t>::min()}) {
        Begin();
        detector_.state().width = width;
        ExpectFailure(hill_, 0, kNoState);
    }
    for (const int32_t held : {-1, 6, std::numeric_limits<int32_t>::max()}) {
        Begin();
        detector_.state().held = held;
        ExpectFailure(hill_, 0, kNoState);
    }
}

TEST_F(PeakFailure, TooFewSamples) {
    ExpectFailure({1, 2, 3, 4}, KRN_FIRST_BLOCK, kBadWidth);
    ExpectFailure({}, KRN_FIRST_BLOCK, kBadWidth);
    Begin();
    const KrPeakState before = detector_.state();
    ExpectFailure({1, 2, 3, 4}, KRN_FIRST_BLOCK, kBadWidth);  // no signal begins
    EXPECT_EQ(std::memcmp(&detector_.state(), &before, sizeof before), 0);
    Begin();
    ExpectFailure({1, 2, 3, 4}, 0, kBadWidth);
    Begin();
    detector_.record().width = 3;  // what counts is the window that the signal began with
    ExpectFailure({1, 2, 3, 4}, 0, kBadWidth);
}

TEST_F(PeakFailure, NoWorkBlock) {
    const auto refuse = [this](const Samples& samples) {
        const FailBlock refused;
        ExpectFailure(samples, KRN_FIRST_BLOCK, kOutOfMemory);
    };
    refuse(hill_);
    refuse({1, 2});  // before the samples are counted
    Begin();
    refuse(hill_);
}

TEST_F(PeakFailure, AWorkBlockBeyondTheHostsIntegers) {
    for (const int32_t width : {53687092, 1073741824}) {
        detector_.record().width = width;
        ExpectFailure(hill_, KRN_FIRST_BLOCK, kOutOfMemory);
        detector_.record().width = 5;
        Begin();
        detector_.record().width = width;
        ExpectFailure(hill_, KRN_FIRST_BLOCK, kOutOfMemory);
    }
}

TEST_F(PeakFailure, RefusedOutputs) {
    for (int32_t nth = 1; nth <= 3; ++nth) {
        const FailResize refused(nth, 4711);
        ExpectFailure(hill_, KRN_FIRST_BLOCK, kOutOfMemory);
        EXPECT_TRUE(refused.happened());
    }
}

}  // namespace
}  // namespace krnumer
