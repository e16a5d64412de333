#include "host/applications/KeptOutWords.h"

#include <csignal>
#include <utility>

#include <gtest/gtest.h>

#include "host/text/DayAndTime.h"
#include "host/text/Unicode.h"

namespace
{
using tessel::KeptOutApplication;
using tessel::RunningMarker;
using Deed = RunningMarker::Deed;
using Reason = RunningMarker::Reason;

KeptOutApplication guilty()
{
    KeptOutApplication application;
    application.path = "/a/tool.zmb";
    application.deed = Deed::kEntryPoint;
    application.reason = Reason::kAtStart;
    application.ending = SIGSEGV;
    return application;
}

KeptOutApplication unwanted()
{
    KeptOutApplication application = guilty();
    application.stage = KeptOutApplication::Stage::kByPerson;
    return application;
}

std::wstring day()
{
    return tessel::toWide(tessel::dayAndTime(0));
}

std::wstring ended()
{
    return L"ended Tessel on " + day() +
           L" while its entry point ran (loaded at the start): memory fault (SIGSEGV)";
}

// What stands after the day.
std::wstring afterDay(const KeptOutApplication& application)
{
    const std::wstring start = L"kept out because it ended Tessel on " + day();
    const std::wstring reason = reasonOf(application);
    EXPECT_TRUE(reason.starts_with(start));
    return reason.substr(start.size());
}
} // namespace

TEST(KeptOutWords, SayWhyInEveryPlaceOfASentence)
{
    EXPECT_EQ(reasonOf(guilty()), L"kept out because it " + ended());
    EXPECT_EQ(clauseOfReason(guilty()), L"it is kept out because it " + ended());
    EXPECT_EQ(predicateOfReason(guilty()), L"is kept out because it " + ended());
    EXPECT_EQ(sentenceOfReason(guilty()), L"This application is kept out because it " + ended() + L".");
}

TEST(KeptOutWords, SayThatItIsAPersonsWishInEveryPlaceOfASentence)
{
    const std::wstring wish = L"kept out at starts by DISABLE since " + day();
    EXPECT_EQ(reasonOf(unwanted()), wish);
    EXPECT_EQ(clauseOfReason(unwanted()), L"it is " + wish);
    EXPECT_EQ(predicateOfReason(unwanted()), L"is " + wish);
    EXPECT_EQ(sentenceOfReason(unwanted()), L"This application is " + wish + L".");
}

TEST(KeptOutWords, SayWhatItDidAndHowOften)
{
    EXPECT_EQ(whatItDid(guilty(), 1), L"The application \"/a/tool.zmb\" " + ended() + L".");
    EXPECT_EQ(whatItDid(guilty(), 2),
              L"The application \"/a/tool.zmb\" " + ended() + L". It has ended 2 sessions.");
    EXPECT_EQ(isTriedOnceMore(guilty()),
              L"The application \"/a/tool.zmb\" is tried once more: it " + ended() + L".");
}

TEST(KeptOutWords, NameEveryDeed)
{
    const std::pair<Deed, std::wstring> deeds[] = {{Deed::kLoading, L"while it was being loaded"},
                                                   {Deed::kEntryPoint, L"while its entry point ran"},
                                                   {Deed::kUnloading, L"while it was being unloaded"},
                                                   {Deed::kCommand, L"while its command \"TURN\" ran"},
                                                   {Deed::kLispFile, L"while its Lisp ran"}};
    KeptOutApplication application = guilty();
    application.detail = "TURN";
    for (const auto& [deed, words] : deeds)
    {
        application.deed = deed;
        EXPECT_EQ(afterDay(application), L" " + words + L" (loaded at the start): memory fault (SIGSEGV)");
    }
}

TEST(KeptOutWords, NameEveryWayToBeAskedFor)
{
    const std::pair<Reason, std::wstring> reasons[] = {
        {Reason::kByHand, L"asked for by hand"},
        {Reason::kAtStart, L"loaded at the start"},
        {Reason::kForAnother, L"loaded from the Startup Suite"},
        {Reason::kOnCommand, L"loaded on command"}};
    KeptOutApplication application = guilty();
    application.ending = SIGUSR1;
    for (const auto& [reason, words] : reasons)
    {
        application.reason = reason;
        EXPECT_EQ(afterDay(application), L" while its entry point ran (" + words + L"): a signal");
    }
}
