#include "host/applications/KeptOutWords.h"

#include "host/text/DayAndTime.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
using Deed = RunningMarker::Deed;
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
    switch (application.deed)
    {
    case Deed::kEntryPoint:
        return translated(L"while its entry point ran");
    case Deed::kUnloading:
        return translated(L"while it was being unloaded");
    case Deed::kCommand:
        return translated(L"while its command \"{}\" ran", toWide(application.detail));
    case Deed::kLispFile:
        return translated(L"while its Lisp ran");
    case Deed::kLoading:
        break;
    }
    return translated(L"while it was being loaded");
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
    return translated(wordsForEnding(application.ending));
}
} // namespace

std::wstring reasonOf(const KeptOutApplication& application)
{
    if (isByPerson(application))
        return translated(L"kept out at starts by DISABLE since {}", dayOf(application));
    return translated(L"kept out because it ended Tessel on {} {} ({}): {}", dayOf(application),
                      deedOf(application), wishOf(application), endingOf(application));
}

std::wstring clauseOfReason(const KeptOutApplication& application)
{
    if (isByPerson(application))
        return translated(L"it is kept out at starts by DISABLE since {}", dayOf(application));
    return translated(L"it is kept out because it ended Tessel on {} {} ({}): {}", dayOf(application),
                      deedOf(application), wishOf(application), endingOf(application));
}

std::wstring predicateOfReason(const KeptOutApplication& application)
{
    if (isByPerson(application))
        return translated(L"is kept out at starts by DISABLE since {}", dayOf(application));
    return translated(L"is kept out because it ended Tessel on {} {} ({}): {}", dayOf(application),
                      deedOf(application), wishOf(application), endingOf(application));
}

std::wstring sentenceOfReason(const KeptOutApplication& application)
{
    if (isByPerson(application))
        return translated(L"This application is kept out at starts by DISABLE since {}.", dayOf(application));
    return translated(L"This application is kept out because it ended Tessel on {} {} ({}): {}.",
                      dayOf(application), deedOf(application), wishOf(application), endingOf(application));
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
