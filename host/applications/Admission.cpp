#include "host/applications/Admission.h"

#include <algorithm>
#include <utility>

#include "host/applications/Bisecting.h"
#include "host/applications/KeptOut.h"
#include "host/applications/KeptOutWords.h"
#include "host/platform/RealPath.h"
#include "host/text/CommandLine.h"
#include "host/text/Translation.h"
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

Result<> Admission::check(const std::wstring& path)
{
    const Reason reason = mMarker.reason();
    if (reason == Reason::kForAnother)
        noteCarrier();
    if (reason == Reason::kByHand || (mSafe && !isOfStart(reason)))
        return {};
    if (mSafe)
        return refuseInSafety();
    const std::string file = toUtf8(path);
    const KeptOutApplication* known = mKeptOut.find(file);
    if (known && keepsOut(*known, reason))
        return Failure{clauseOfReason(*known),
                       isOfStart(reason) && mKeptOut.wasTold(*known) ? kAlreadyTold : kKeptOut};
    if (isOfStart(reason))
        mAskedFor.push_back(file);
    if (isOfStart(reason) && mBisecting.keepsOut(file))
        return Failure{translated(L"it is kept out at this start by BISECT"), kAlreadyTold};
    if (known)
        sayWhenOnTrial(file);
    return {};
}

// One sentence for all: each of them would say the same.
Failure Admission::refuseInSafety()
{
    if (!std::exchange(mSafetyTold, true))
        mCommandLine.say(translated(L"Tessel was started with --safe and loads nothing by itself: APPS lists "
                                    L"what would have been loaded now, LOAD loads it by hand."));
    return {translated(L"Tessel was started with --safe and loads nothing by itself"), kAlreadyTold};
}

void Admission::sayWhenOnTrial(const std::string& path)
{
    if (const auto sentence = mKeptOut.takeTrialSentence(path))
        mCommandLine.say(*sentence);
}

void Admission::noteCarrier()
{
    RunningMarker::AtWork work{};
    if (isOfStart(mMarker.reason()) && mMarker.innermost(work) && !mCarriers.contains(work.path))
        mCarriers.emplace(work.path);
}

std::vector<std::string> Admission::suspects() const
{
    std::vector<std::string> result;
    for (const std::string& path : mAskedFor)
        if (!mCarriers.contains(path) && std::ranges::find(result, path) == result.end())
            result.push_back(path);
    return result;
}

std::wstring Admission::whyKeptOut(const std::wstring& path) const
{
    const KeptOutApplication* known = mKeptOut.find(toUtf8(path));
    if (known && known->isOut())
        return sentenceOfReason(*known);
    return mBisecting.keepsOut(toUtf8(path))
               ? translated(L"This application is kept out at this start by BISECT.")
               : L"";
}

std::wstring Admission::whyOut(const std::string& path) const
{
    const KeptOutApplication* known = mBisecting.keepsOut(path) ? nullptr : mKeptOut.find(path);
    return known && known->isOut() ? predicateOfReason(*known) : L"";
}

std::function<std::wstring(const std::string&)> Admission::whyNotAsPlanned() const
{
    std::set<std::string> letIn;
    for (const std::string& path : mAskedFor)
        letIn.insert(realPath(path).native());
    return [this, letIn = std::move(letIn)](const std::string& path) -> std::wstring
    {
        if (mBisecting.keepsOut(path))
            return mLoadedAllTheSame.contains(path) ? translated(L"was loaded all the same") : L"";
        if (letIn.contains(path))
            return {};
        const std::wstring reason = whyOut(path);
        return reason.empty() ? translated(L"was kept out of this start or not asked for") : reason;
    };
}

void Admission::noteLoaded(const std::wstring& path)
{
    const std::string file = toUtf8(path);
    if (mBisecting.keepsOut(file))
        mLoadedAllTheSame.insert(realPath(file).native());
    mKeptOut.noteLoaded(file, mMarker.reason() == Reason::kByHand);
}
} // namespace tessel
