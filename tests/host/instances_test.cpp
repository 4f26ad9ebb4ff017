// Clean-ups run with the end of the instance that registered them, the latest first.

#include <cstdio>
#include <cstdlib>

#include "support/host_arrays.h"

namespace krnumer {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

constexpr int32_t kAtTheEnd = 2;

// A clean-up that notes its number.
struct Note {
    std::vector<int>* list;
    int number;

    static void Take(void* data) {
        const Note& note = *static_cast<Note*>(data);
        note.list->push_back(note.number);
    }
};

TEST(Instances, RunTheirCleanupsTheLatestFirst) {
    std::vector<int> taken;
    Note notes[] = {{&taken, 1}, {&taken, 2}, {&taken, 3}};
    {
        const HostInstance instance;
        for (Note& note : notes) HookCleanup(Note::Take, &note, kAtTheEnd);
        EXPECT_EQ(instance.pending_cleanups(), 3);
        EXPECT_THAT(taken, IsEmpty());
    }
    EXPECT_THAT(taken, ElementsAre(3, 2, 1));
}

TEST(Instances, CallACleanupOncePerRegistration) {
    std::vector<int> taken;
    Note note{&taken, 1};
    {
        const HostInstance instance;
        HookCleanup(Note::Take, &note, kAtTheEnd);
        HookCleanup(Note::Take, &note, kAtTheEnd);
    }
    EXPECT_THAT(taken, ElementsAre(1, 1));
}

TEST(Instances, DoNotSeeEachOthersCleanups) {
    std::vector<int> taken;
    Note notes[] = {{&taken, 1}, {&taken, 2}, {&taken, 3}};
    KrrtInstance* const first = KrrtOpenInstance();
    KrrtInstance* const second = KrrtOpenInstance();
    ASSERT_NE(first, nullptr);
    ASSERT_NE(second, first);
    KrrtInstance* const former = KrrtUseInstance(first);
    HookCleanup(Note::Take, &notes[0], kAtTheEnd);
    EXPECT_EQ(KrrtUseInstance(second), first);
    EXPECT_EQ(KrrtCurrentInstance(), second);
    HookCleanup(Note::Take, &notes[1], kAtTheEnd);
    HookCleanup(Note::Take, &notes[2], kAtTheEnd);

    KrrtCloseInstance(first);
    EXPECT_THAT(taken, ElementsAre(1));
    EXPECT_EQ(KrrtCurrentInstance(), second);
    EXPECT_EQ(KrrtPendingCleanups(second), 2);
    KrrtCloseInstance(second);
    EXPECT_THAT(taken, ElementsAre(1, 3, 2));
    EXPECT_EQ(KrrtCurrentInstance(), nullptr) << "the default instance takes the place of the one closed";
    KrrtUseInstance(former);
}

TEST(Instances, RunCleanupsThatRegisterOthers) {
    static std::vector<int> taken;
    taken.clear();
    static Note last{&taken, 2};
    const auto register_another = [](void*) {
        taken.push_back(1);
        HookCleanup(Note::Take, &last, kAtTheEnd);
    };
    KrrtInstance* const instance = KrrtOpenInstance();
    KrrtUseInstance(instance);
    HookCleanup(register_another, nullptr, kAtTheEnd);
    KrrtCloseInstance(instance);
    EXPECT_THAT(taken, ElementsAre(1, 2));
}

TEST(Instances, IgnoreARegistrationWithoutProcedure) {
    const HostInstance instance;
    HookCleanup(nullptr, nullptr, kAtTheEnd);
    EXPECT_EQ(instance.pending_cleanups(), 0);
}

TEST(DefaultInstance, IsThereFromTheStartAndStaysOpen) {
    ASSERT_EQ(KrrtCurrentInstance(), nullptr);
    std::vector<int> taken;
    Note notes[] = {{&taken, 1}, {&taken, 2}};
    for (Note& note : notes) {
        HookCleanup(Note::Take, &note, kAtTheEnd);
        EXPECT_EQ(KrrtPendingCleanups(nullptr), 1);
        KrrtCloseInstance(nullptr);
        EXPECT_EQ(KrrtPendingCleanups(nullptr), 0);
    }
    EXPECT_THAT(taken, ElementsAre(1, 2));
}

TEST(DefaultInstanceDeathTest, EndsWithTheProcess) {
    const auto print = [](void* data) { std::fprintf(stderr, "clean-up %s\n", static_cast<const char*>(data)); };
    static char earlier[] = "earlier", later[] = "later";
    EXPECT_EXIT(
        {
            HookCleanup(print, earlier, kAtTheEnd);
            HookCleanup(print, later, kAtTheEnd);
            std::exit(0);
        },
        ::testing::ExitedWithCode(0), "clean-up later\nclean-up earlier");
}

}  // namespace
}  // namespace krnumer
