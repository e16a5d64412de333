#include "host/applications/KeptOutWords.h"

#include "host/text/DayAndTime.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
using Reason = RunningMarker::Reason;

bool isByPerson(const KeptOutApplication& application)
{
    return application.stage == KeptOutApplication::Stage::kByPerson;
}

std::wstring dayOf(const KeptOutApplication& application)
{
    return dayAndTimeInWords(application.since);
}

std::wstring deedOf(const KeptOutApplication& application)
{
    return wordsFor(application.deed, toWide(application.detail));
}

std::wstring wishOf(const KeptOutApplication& application)
{
    switch (application.reason)
    {
    case Reason::kAtStart:
        return translated(L"loaded at the start");
    case Reason::kForAnother:
        return translated(L"loaded from the Startup Suite");
    case Reason::kOnCommand:
        return translated(L"loaded on command");
    case Reason::kByHand:
        break;
    }
    return translated(L"asked for by hand");
}

std::wstring endingOf(const KeptOutApplication& application)
{
    return wordsForEnding(application.ending);
}

// One place of a sentence, for either reason.
struct Wording
{
    Sentence<1> byPerson; // since when
    Sentence<4> afterEnd; // when it ended Tessel, at what, who wanted it, how
};

std::wstring said(const KeptOutApplication& application, const Wording& wording)
{
    if (isByPerson(application))
        return translated(wording.byPerson, dayOf(application));
    return translated(wording.afterEnd, dayOf(application), deedOf(application), wishOf(application),
                      endingOf(application));
}
} // namespace

std::wstring reasonOf(const KeptOutApplication& application)
{
    return said(application, {Sentence<1>(L"kept out at starts by DISABLE since {}"),
                              Sentence<4>(L"kept out because it ended Tessel on {} {} ({}): {}")});
}

std::wstring clauseOfReason(const KeptOutApplication& application)
{
    return said(application, {Sentence<1>(L"it is kept out at starts by DISABLE since {}"),
                              Sentence<4>(L"it is kept out because it ended Tessel on {} {} ({}): {}")});
}

std::wstring predicateOfReason(const KeptOutApplication& application)
{
    return said(application, {Sentence<1>(L"is kept out at starts by DISABLE since {}"),
                              Sentence<4>(L"is kept out because it ended Tessel on {} {} ({}): {}")});
}

std::wstring sentenceOfReason(const KeptOutApplication& application)
{
    return said(application,
                {Sentence<1>(L"This application is kept out at starts by DISABLE since {}."),
                 Sentence<4>(L"This application is kept out because it ended Tessel on {} {} ({}): {}.")});
}

std::wstring whatItDid(const KeptOutApplication& application, std::size_t sessions)
{
    const std::wstring done =
        translated(L"The application \"{}\" ended Tessel on {} {} ({}): {}.", toWide(application.path),
                   dayOf(application), deedOf(application), wishOf(application), endingOf(application));
    if (sessions == 1)
        return done;
    return done + L' ' +
           translatedByCount(sessions, L"It has ended {} session.", L"It has ended {} sessions.");
}

std::wstring isTriedOnceMore(const KeptOutApplication& application)
{
    return translated(L"The application \"{}\" is tried once more: it ended Tessel on {} {} ({}): {}.",
                      toWide(application.path), dayOf(application), deedOf(application), wishOf(application),
                      endingOf(application));
}
} // namespace tessel
