// The frame, tried on entry points made for the purpose.

#include "frame/entry.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

// y = x reversed, total = sum of x. Fails with `wanted` behind the resize when that is negative.
int32_t Reverse(Call& call, KrHandle x, KrHandle y, double* total, int32_t wanted = kOk) {
    In<double> input(call, x);
    Out<double> output(call, y);
    Result<double> sum(call, total);
    if (input.size() < 1) return call.Fail(kEmptyInput);
    if (auto host = output.Resize(input.size())) return call.HostFailure(host);
    return call.Run([&] {
        *sum = 0.0;
        for (int32_t i = 0; i < input.size(); ++i) {
            output.data()[i] = input.data()[input.size() - 1 - i];
            *sum += input.data()[i];
        }
        return wanted;
    });
}

int32_t ReverseByReference(KrHandle x, KrHandle y, double* total, int32_t* err, int32_t wanted = kOk) {
    ByReference call(err);
    return Reverse(call, x, y, total, wanted);
}

int32_t ReverseByValue(KrHandle x, KrHandle y, double* total, int32_t wanted = kOk) {
    ByValue call;
    return Reverse(call, x, y, total, wanted);
}

class Frame : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostArray<double> x_{1, 2, 4};
    HostArray<double> y_{9};
    double total_ = -1.0;
    int32_t err_ = 77;
};

TEST_F(Frame, DeliversByReference) {
    EXPECT_EQ(ReverseByReference(x_.handle(), y_.handle(), &total_, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_EQ(total_, 7.0);
    EXPECT_THAT(y_.values(), ElementsAre(4, 2, 1));
}

TEST_F(Frame, DeliversByValue) {
    EXPECT_EQ(ReverseByValue(x_.handle(), y_.handle(), &total_), 0);
    EXPECT_EQ(total_, 7.0);
    EXPECT_THAT(y_.values(), ElementsAre(4, 2, 1));
}

TEST_F(Frame, ClearsOutputsWhenACheckFails) {
    HostArray<double> none;
    EXPECT_EQ(ReverseByReference(none.handle(), y_.handle(), &total_, &err_), 0);
    EXPECT_EQ(err_, kEmptyInput);
    EXPECT_TRUE(IsQuietNaN(total_));
    EXPECT_THAT(y_.values(), IsEmpty());
    EXPECT_EQ(ReverseByValue(none.handle(), y_.handle(), &total_), kEmptyInput);
}

TEST_F(Frame, ClearsOutputsWhenTheCoreFails) {
    EXPECT_EQ(ReverseByValue(x_.handle(), y_.handle(), &total_, kSingular), kSingular);
    EXPECT_TRUE(IsQuietNaN(total_));
    EXPECT_THAT(y_.values(), IsEmpty());
    EXPECT_THAT(x_.values(), ElementsAre(1, 2, 4));
}

TEST_F(Frame, KeepsResultsUnderAWarning) {
    EXPECT_EQ(ReverseByReference(x_.handle(), y_.handle(), &total_, &err_, kWarnSizesDiffer), 0);
    EXPECT_EQ(err_, kWarnSizesDiffer);
    EXPECT_EQ(total_, 7.0);
    EXPECT_THAT(y_.values(), ElementsAre(4, 2, 1));
}

TEST_F(Frame, HandsOnTheHostsStatus) {
    {
        const FailResize fail(1, 4711);
        EXPECT_EQ(ReverseByReference(x_.handle(), y_.handle(), &total_, &err_), 4711);
    }
    EXPECT_EQ(err_, kOutOfMemory);
    EXPECT_TRUE(IsQuietNaN(total_));
    EXPECT_THAT(y_.values(), IsEmpty());
    const FailResize fail(1, -5);
    EXPECT_EQ(ReverseByValue(x_.handle(), y_.handle(), &total_), -5);
}

TEST_F(Frame, WorksAtTheLeastAlignment) {
    const LeastAlignment least;
    HostArray<double> x{1, 2, 4};
    HostArray<double> y{9};
    EXPECT_EQ(ReverseByValue(x.handle(), y.handle(), &total_), 0);
    EXPECT_THAT(y.values(), ElementsAre(4, 2, 1));
    EXPECT_THAT(x.values(), ElementsAre(1, 2, 4));
}

TEST_F(Frame, StoresScalarsAtAnyAddress) {
    char record[12] = {};
    EXPECT_EQ(ReverseByValue(x_.handle(), y_.handle(), reinterpret_cast<double*>(record + 4)), 0);
    double total;
    std::memcpy(&total, record + 4, sizeof total);
    EXPECT_EQ(total, 7.0);
}

TEST_F(Frame, ReadsAnInputThatIsTheOutputTooFromACopy) {
    for (const bool moving : {false, true}) {
        KrrtMovingBlocks(moving);
        HostArray<double> both{1, 2, 4};
        EXPECT_EQ(ReverseByValue(both.handle(), both.handle(), &total_), 0);
        EXPECT_THAT(both.values(), ElementsAre(4, 2, 1));
    }
    KrrtMovingBlocks(0);
}

// The first output gets the elements of x, the second only its first one.
int32_t Split(KrHandle x, KrHandle whole, KrHandle head) {
    ByValue call;
    In<double> input(call, x);
    Out<double> all(call, whole);
    Out<double> first(call, head);
    if (all.Resize(input.size()) || first.Resize(1)) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        first.data()[0] = input.data()[0];
        for (int32_t i = 0; i < input.size(); ++i) all.data()[i] = input.data()[i];
        return kOk;
    });
}

TEST_F(Frame, LetsTheLaterOfTwoOutputsHaveTheArray) {
    EXPECT_EQ(Split(x_.handle(), y_.handle(), y_.handle()), 0);
    EXPECT_THAT(y_.values(), ElementsAre(1)) << "the array has the size of the later one, and nothing ran past it";
    EXPECT_EQ(Split(x_.handle(), x_.handle(), x_.handle()), 0);
    EXPECT_THAT(x_.values(), ElementsAre(1));
}

// Every sample becomes weight[0] times itself, also the weight where it is the same array.
int32_t Weigh(KrHandle x, KrHandle weight) {
    ByValue call;
    InOut<double> samples(call, x);
    In<double> weights(call, weight);
    return call.Run([&] {
        for (int32_t i = 0; i < samples.size(); ++i) samples.data()[i] *= weights.data()[0];
        return kOk;
    });
}

TEST_F(Frame, ReadsAnInputThatIsReplacedFromACopy) {
    HostArray<double> x{2, 3};
    EXPECT_EQ(Weigh(x.handle(), x.handle()), 0);
    EXPECT_THAT(x.values(), ElementsAre(4, 6));
    const LeastAlignment least;
    HostArray<double> z{2, 3};
    EXPECT_EQ(Weigh(z.handle(), z.handle()), 0);
    EXPECT_THAT(z.values(), ElementsAre(4, 6));
}

// Copies x to y, which is empty from the start.
int32_t CopyIntoCleared(KrHandle x, KrHandle y) {
    ByValue call;
    In<double> input(call, x);
    Out<double> output(call, y);
    if (output.Clear()) return call.Fail(kOutOfMemory);
    if (input.size() < 1) return call.Fail(kEmptyInput);
    if (output.Resize(input.size())) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        for (int32_t i = 0; i < input.size(); ++i) output.data()[i] = input.data()[i];
        return kOk;
    });
}

TEST_F(Frame, ClearsAnOutputFirst) {
    const ResizeLog resizes;
    EXPECT_EQ(CopyIntoCleared(x_.handle(), y_.handle()), 0);
    EXPECT_THAT(y_.values(), ElementsAre(1, 2, 4));
    ASSERT_EQ(resizes.size(), 2);
    EXPECT_EQ(resizes[0].totalElements, 0);
    EXPECT_EQ(CopyIntoCleared(x_.handle(), x_.handle()), 0) << "the elements are put aside";
    EXPECT_THAT(x_.values(), ElementsAre(1, 2, 4));
    EXPECT_EQ(CopyIntoCleared(HostArray<double>().handle(), y_.handle()), kEmptyInput);
    EXPECT_THAT(y_.values(), IsEmpty());
}

// Drops all samples but the first `count`, after the core has doubled them.
int32_t DoubleHead(KrHandle x, int32_t count, int32_t status = kOk, Access access = Access::kReplaced) {
    ByValue call;
    InOut<double> samples(call, x, access);
    if (call.Map()) return call.Fail(kOutOfMemory);
    for (int32_t i = 0; i < samples.size(); ++i) samples.data()[i] *= 2.0;
    if (status < 0) return call.Fail(status);
    if (auto host = samples.Resize(count)) return call.HostFailure(host);
    return call.Deliver(kOk);
}

TEST_F(Frame, KeepsWhatWasWrittenBeforeAResize) {
    EXPECT_EQ(DoubleHead(x_.handle(), 2), 0);
    EXPECT_THAT(x_.values(), ElementsAre(2, 4));
    const LeastAlignment least;
    HostArray<double> x{1, 2, 4};
    EXPECT_EQ(DoubleHead(x.handle(), 2), 0);
    EXPECT_THAT(x.values(), ElementsAre(2, 4));
}

TEST_F(Frame, LeavesArraysThatAFailureKeeps) {
    const LeastAlignment least;
    HostArray<double> x{1, 2, 4};
    EXPECT_EQ(DoubleHead(x.handle(), 2, kSingular, Access::kReplacedKept), kSingular);
    EXPECT_THAT(x.values(), ElementsAre(2, 4, 8)) << "the core's work stays, at every alignment";
    EXPECT_EQ(DoubleHead(x.handle(), 2, kSingular), kSingular);
    EXPECT_THAT(x.values(), IsEmpty());
}

TEST_F(Frame, RefusesMoreElementsThanAnInt32Counts) {
    ByValue call;
    HostMatrix<double> m;
    OutMatrix<double> matrix(call, m.handle());
    EXPECT_EQ(matrix.Resize(65536, 65536), kOutOfMemory);
    EXPECT_EQ(matrix.Resize(-1, 2), kOutOfMemory);
    EXPECT_EQ(matrix.Resize(2, 3), 0);
    EXPECT_EQ(m.rows(), 2);
    EXPECT_EQ(m.columns(), 3);
}

TEST_F(Frame, SeesThreeDimensions) {
    HostCube<double> cube(1, 2, 2, {1, 2, 3, 4});
    ByValue call;
    In<double, 3> elements(call, cube.handle());
    ASSERT_EQ(call.Map(), 0);
    EXPECT_EQ(elements.pages(), 1);
    EXPECT_EQ(elements.rows(), 2);
    EXPECT_EQ(elements.columns(), 2);
    EXPECT_EQ(elements.data()[3], 4.0);
}

TEST_F(Frame, EmptiesInTheOrderOfDeclaration) {
    HostArray<int32_t> first{1};
    HostMatrix<Complex> second(1, 1, {{1, 1}});
    const ResizeLog log;
    ByValue call;
    Out<int32_t> a(call, first.handle());
    OutMatrix<Complex> b(call, second.handle());
    InOut<double> c(call, x_.handle());
    c.EmptyAs(13);
    EXPECT_EQ(call.Fail(kBadSelector), kBadSelector);
    ASSERT_EQ(log.size(), 3);
    EXPECT_EQ(log[0].typeCode, 3);
    EXPECT_EQ(log[1].typeCode, 13);
    EXPECT_EQ(log[1].numDims, 2);
    EXPECT_EQ(log[2].typeCode, 13);
    EXPECT_EQ(second.rows(), 0);
    EXPECT_EQ(second.columns(), 0);
}

TEST_F(Frame, LeavesEverythingWhereAskedTo) {
    ByReference call(&err_);
    EXPECT_EQ(err_, 0) << "cleared before anything else";
    Out<double> y(call, y_.handle());
    Result<double> total(call, &total_);
    EXPECT_EQ(call.Leave(kEmptyInput), 0);
    EXPECT_EQ(err_, kEmptyInput);
    EXPECT_THAT(y_.values(), ElementsAre(9));
    EXPECT_EQ(total_, -1.0);
}

#pragma pack(push, 1)
struct Record {
    uint8_t flag;
    KrHandle array;
};
#pragma pack(pop)

TEST_F(Frame, ReachesArraysThroughPackedRecords) {
    HostArray<double> inner{1, 2};
    Record record{1, inner.handle()};
    {
        ByValue call;
        InOut<double> array(call, HandleField{&record.array});
        ASSERT_EQ(array.Resize(3), 0);
        ASSERT_EQ(call.Map(), 0);
        array.data()[2] = 5.0;
    }
    EXPECT_THAT(inner.values(), ElementsAre(1, 2, 5));
}

TEST_F(Frame, NaNsEveryPartOfARecordOfScalars) {
    Complex value{1, 2};
    ByValue call;
    Result<Complex> result(call, &value);
    EXPECT_EQ(call.Fail(kSingular), kSingular);
    EXPECT_TRUE(IsQuietNaN(value.re));
    EXPECT_TRUE(IsQuietNaN(value.im));
}

}  // namespace
}  // namespace krnumer
