#include "modrig/lists/Globals.h"

#include <dlfcn.h>

#include <array>

#include <gtest/gtest.h>

#include "modrig/types/ApplicationTypes.h"
#include "tests/support/RecordingHost.h"

namespace
{
// The lists in the order in which they were built, and what had been asked of the host by then. Ready before
// the first object of static initialisation.
struct Construction
{
    std::array<const void*, 3> lists{};
    unsigned count = 0;
    unsigned timesAskedBeforeTheFirst = 0;
};
constinit Construction construction;

bool IsGlobalList(const void* object)
{
    return object == &gLoadedAppList || object == &gStartupList || object == &gHistoryList;
}

void NoteConstruction(const void* object)
{
    if (!IsGlobalList(object) || construction.count >= construction.lists.size())
        return;
    if (construction.count == 0)
        construction.timesAskedBeforeTheFirst = RecordingLisp::timesAskedForRemoving();
    construction.lists[construction.count++] = object;
}

// Looks around between static initialisation and the first test.
class BeforeTheFirstTest : public testing::Environment
{
public:
    void SetUp() override
    {
        timesAsked = RecordingLisp::timesAskedForRemoving();
        listsAreEmpty = gLoadedAppList.IsEmpty() && gStartupList.IsEmpty() && gHistoryList.IsEmpty();
        orreryIsLoaded = gbOrreryLoaded;
        resources = hModrigRes;
    }

    unsigned timesAsked = 0;
    bool listsAreEmpty = false;
    bool orreryIsLoaded = true;
    HMODULE resources = nullptr;
};

const auto* const beforeTheFirstTest =
    static_cast<const BeforeTheFirstTest*>(testing::AddGlobalTestEnvironment(new BeforeTheFirstTest));
} // namespace

// The language asks for an object's destruction as soon as its construction is complete: the requests tell
// the order. Each is handed on.
extern "C" int __cxa_atexit(void (*destroy)(void*), void* object, void* library)
{
    NoteConstruction(object);
    using AtExit = int (*)(void (*)(void*), void*, void*);
    static const auto handOn = reinterpret_cast<AtExit>(dlsym(RTLD_NEXT, "__cxa_atexit"));
    return handOn(destroy, object, library);
}

TEST(Globals, AskTheHostTwiceWhetherItRemovesLispBeforeAnythingElseHappens)
{
    EXPECT_EQ(2u, beforeTheFirstTest->timesAsked);
}

TEST(Globals, BuildTheApplicationTypesBeforeTheLists)
{
    EXPECT_EQ(2u, construction.timesAskedBeforeTheFirst);
}

TEST(Globals, BuildTheListsInTheOrderLoadedStartupHistory)
{
    ASSERT_EQ(3u, construction.count);
    EXPECT_EQ(&gLoadedAppList, construction.lists[0]);
    EXPECT_EQ(&gStartupList, construction.lists[1]);
    EXPECT_EQ(&gHistoryList, construction.lists[2]);
}

TEST(Globals, BeginEmptyAndFalse)
{
    EXPECT_TRUE(beforeTheFirstTest->listsAreEmpty);
    EXPECT_FALSE(beforeTheFirstTest->orreryIsLoaded);
    EXPECT_EQ(nullptr, beforeTheFirstTest->resources);
}

TEST(Globals, NameTheEndOfTheDescription)
{
    EXPECT_STREQ(L" Command Module", kpszCmdModule);
}
