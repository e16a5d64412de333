#include "host/applications/Admission.h"

#include "host/applications/KeptOut.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
using Reason = RunningMarker::Reason;
using Stage = KeptOutApplication::Stage;

bool isOfStart(Reason reason)
{
    return reason == Reason::kAtStart || reason == Reason::kForAnother;
}

// A person keeps it out at starts; a command that is typed is a wish of the same person's.
bool keepsOut(const KeptOutApplication& application, Reason reason)
{
    return application.isOut() && (isOfStart(reason) || application.stage != Stage::kByPerson);
}
} // namespace

Result<> Admission::check(const std::wstring& path) const
{
    const Reason reason = mMarker.reason();
    if (reason == Reason::kByHand || (mSafe && !isOfStart(reason)))
        return {};
    if (mSafe)
        return Failure{L"Tessel was started with --safe and loads nothing by itself"};
    const KeptOutApplication* known = mKeptOut.find(toUtf8(path));
    if (known && keepsOut(*known, reason))
        return Failure{L"it is " + reasonOf(*known)};
    return {};
}

std::wstring Admission::whyKeptOut(const std::wstring& path) const
{
    const KeptOutApplication* known = mKeptOut.find(toUtf8(path));
    return known && known->isOut() ? reasonOf(*known) : std::wstring();
}

void Admission::noteLoaded(const std::wstring& path) const
{
    mKeptOut.noteLoaded(toUtf8(path), mMarker.reason() == Reason::kByHand);
}
} // namespace tessel
