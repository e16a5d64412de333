#include "host/text/Running.h"

#include <gtest/gtest.h>

using tessel::Owned;
using tessel::Published;
using tessel::running;

namespace
{
struct Part
{
    explicit Part(int given) : number(given) {}
    ~Part() { runningAtTheEnd = running<Part>(); }
    Part(const Part&) = delete;
    Part& operator=(const Part&) = delete;

    int number;
    static inline const Part* runningAtTheEnd = nullptr;
};
} // namespace

TEST(RunningPart, IsFoundAsLongAsItIsPublished)
{
    Part part(1);
    EXPECT_EQ(running<Part>(), nullptr);
    {
        const Published<Part> published(part);
        EXPECT_EQ(running<Part>(), &part);
        EXPECT_EQ(published->number, 1);
        EXPECT_EQ(&*published, &part);
    }
    EXPECT_EQ(running<Part>(), nullptr);
}

TEST(RunningPart, ComesBackWhenTheOneThatTookItsPlaceGoes)
{
    const Owned<Part> first(1);
    {
        const Owned<Part> second(2);
        EXPECT_EQ(running<Part>(), &*second);
    }
    EXPECT_EQ(running<Part>(), &*first);
}

TEST(RunningPart, IsWithdrawnBeforeItGoes)
{
    {
        const Owned<Part> owned(1);
        Part::runningAtTheEnd = running<Part>();
        ASSERT_EQ(Part::runningAtTheEnd, &*owned);
    }
    EXPECT_EQ(Part::runningAtTheEnd, nullptr);
}

TEST(RunningPart, IsOneOfItsKind)
{
    const Owned<Part> part(1);
    EXPECT_EQ(running<int>(), nullptr);
}
