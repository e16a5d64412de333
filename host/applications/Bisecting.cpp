#include "host/applications/Bisecting.h"

#include <algorithm>

#include "host/platform/RealPath.h"
#include "host/platform/SmallFile.h"
#include "host/platform/SystemFailure.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr char kFileName[] = "bisection";
constexpr std::string_view kFirstLineOfSearch = "Tessel looks for the culprit, 1";
constexpr char kGood = 'g';
constexpr char kBad = 'b';

// The end of a sentence.
std::wstring startsLeft(const Bisection& bisection)
{
    return translatedByCount(bisection.startsLeft(), L"at most {} start is left",
                             L"at most {} starts are left");
}

std::wstring stillSuspected(const Bisection& bisection)
{
    return translatedByCount(bisection.stillSuspected(), L"{} application is still suspected; {}.",
                             L"{} applications are still suspected; {}.", startsLeft(bisection));
}

bool areAnswers(std::string_view text)
{
    return std::ranges::all_of(text, [](char answer) { return answer == kGood || answer == kBad; });
}
} // namespace

Bisecting::Bisecting(std::filesystem::path folder, bool applies)
    : mFile(folder / kFileName), mApplies(applies)
{
    auto search = read();
    if (!search)
        mReadAtStart = search.failure();
    else if (applies)
        mApplied = *std::move(search);
}

Result<std::optional<Bisecting::Search>> Bisecting::read() const
{
    const auto content = readSmallFile(mFile);
    if (!content)
        return content.failure();
    if (!*content)
        return std::optional<Search>();
    const auto lines = linesOf(**content);
    if (lines.size() < 3 || lines[0] != kFirstLineOfSearch || !areAnswers(lines[1]))
        return Failure{
            translated(L"The file {} is damaged; BISECT STOP ends the search that it is about.", mFile)};
    Search search;
    for (const char answer : lines[1])
        search.answers.push_back(answer == kGood);
    std::transform(lines.begin() + 2, lines.end(), std::back_inserter(search.suspects), unescaped);
    return std::optional(std::move(search));
}

Result<> Bisecting::store(const Search& search) const
{
    std::string content = std::string(kFirstLineOfSearch) + '\n';
    for (const bool wasGood : search.answers)
        content += wasGood ? kGood : kBad;
    content += '\n';
    for (const std::string& suspect : search.suspects)
        content += escaped(suspect) + '\n';
    return replaceSmallFile(mFile, content);
}

Result<> Bisecting::forget() const
{
    std::error_code failed;
    std::filesystem::remove(mFile, failed);
    if (failed)
        return Failure{
            translated(L"The file {} cannot be removed: {}.", mFile, systemFailure(failed.value()).sentence)};
    return {};
}

bool Bisecting::keepsOut(const std::string& path) const
{
    if (!mApplied)
        return false;
    const auto found = std::ranges::find(mApplied->suspects, realPath(path).native());
    return found != mApplied->suspects.end() &&
           !mApplied->bisection().isLoaded(static_cast<std::size_t>(found - mApplied->suspects.begin()));
}

std::vector<std::string> Bisecting::keptOutNow() const
{
    std::vector<std::string> paths;
    if (mApplied)
        std::ranges::copy_if(mApplied->suspects, std::back_inserter(paths),
                             [this](const std::string& suspect) { return keepsOut(suspect); });
    return paths;
}

std::vector<std::wstring> Bisecting::sentencesAtStart(const WhyNotAsPlanned& whyNotAsPlanned) const
{
    if (!mReadAtStart)
        return {mReadAtStart.sentence()};
    if (!mApplied)
        return {};
    std::vector<std::wstring> lines;
    for (const std::string& suspect : keptOutNow())
        lines.push_back(L"  " + toWide(suspect));
    const std::size_t keptOut = lines.size();
    lines.insert(lines.begin(),
                 translatedByCount(mApplied->suspects.size(),
                                   L"BISECT keeps {2} of {1} suspect out at this start:",
                                   L"BISECT keeps {2} of {1} suspects out at this start:", keptOut));
    const auto fair = checkWentAsPlanned(whyNotAsPlanned);
    lines.push_back(
        fair ? translated(L"Type BISECT GOOD when the trouble is gone, BISECT BAD when it is there; {}.",
                          startsLeft(mApplied->bisection()))
             : fair.sentence());
    return lines;
}

Result<> Bisecting::checkWentAsPlanned(const WhyNotAsPlanned& whyNotAsPlanned) const
{
    for (const std::string& suspect : mApplied->suspects)
        if (const std::wstring why = whyNotAsPlanned(suspect); !why.empty())
            return Failure{
                keepsOut(suspect)
                    ? translated(L"This session cannot be judged: \"{}\", which was to stay out, {}. Start "
                                 L"Tessel again; BISECT STOP ends the search.",
                                 toWide(suspect), why)
                    : translated(L"This session cannot be judged: \"{}\", which was to be loaded, {}. ENABLE "
                                 L"lets in what is kept out; BISECT STOP ends the search.",
                                 toWide(suspect), why)};
    return {};
}

Result<std::wstring> Bisecting::begin(const std::vector<std::string>& suspects)
{
    if (suspects.empty())
        return Failure{translated(
            L"There is nothing to search among: no application was loaded by itself in this session.")};
    Search search;
    std::ranges::transform(suspects, std::back_inserter(search.suspects),
                           [](const std::string& path) { return realPath(path).native(); });
    if (auto stored = store(search); !stored)
        return stored.failure();
    mReadAtStart = {};
    mApplied.reset();
    mBegunHere = true;
    return translatedByCount(
        suspects.size(), L"BISECT searches among {} application; {}. Start Tessel again.",
        L"BISECT searches among {} applications; {}. Start Tessel again.", startsLeft(search.bisection()));
}

Result<Bisecting::Search> Bisecting::current() const
{
    auto search = read();
    if (!search)
        return search.failure();
    if (!*search)
        return Failure{translated(L"No search is going on; BISECT START begins one.")};
    return **std::move(search);
}

std::wstring Bisecting::whyNotOfThisSession() const
{
    if (!mApplies)
        return translated(L"it was started with --safe, and no suspect is tried then");
    return mBegunHere ? translated(L"the search has begun in it, and nothing was kept out of its start")
                      : translated(L"the search has gone on since it was started");
}

std::wstring Bisecting::verdictIn(const Search& search)
{
    const Bisection bisection = search.bisection();
    switch (bisection.verdict())
    {
    case Bisection::Verdict::kFound:
        return translated(L"BISECT has found it: \"{}\" makes the trouble. DISABLE keeps it out at starts.",
                          toWide(search.suspects[bisection.culprit()]));
    case Bisection::Verdict::kNone:
        return search.suspects.size() == 1
                   ? translated(L"BISECT says that it is none of them: the trouble is there when the only "
                                L"suspect is kept out.")
                   : translated(L"BISECT says that it is none of them: the trouble is there when all of the "
                                L"{} suspects are kept out.",
                                search.suspects.size());
    case Bisection::Verdict::kTogether:
        return translated(L"BISECT says that none of them does it alone: several are needed together.");
    case Bisection::Verdict::kOpen:
        break;
    }
    return stillSuspected(bisection) + L' ' + translated(L"Start Tessel again.");
}

Result<std::wstring> Bisecting::answer(bool wasGood, const WhyNotAsPlanned& whyNotAsPlanned)
{
    auto search = current();
    if (!search)
        return search.failure();
    if (mApplied != *search)
        return Failure{translated(L"This session cannot be judged: {}. Start Tessel again, without --safe.",
                                  whyNotOfThisSession())};
    if (auto fair = checkWentAsPlanned(whyNotAsPlanned); !fair)
        return fair.failure();
    search->answers.push_back(wasGood);
    const bool isOpen = search->bisection().verdict() == Bisection::Verdict::kOpen;
    if (auto stored = isOpen ? store(*search) : forget(); !stored)
        return stored.failure();
    return verdictIn(*search);
}

Result<std::wstring> Bisecting::stop()
{
    if (auto forgotten = forget(); !forgotten)
        return forgotten.failure();
    mApplied.reset();
    return translated(L"BISECT keeps nothing out any more.");
}

Result<std::wstring> Bisecting::tell() const
{
    const auto search = current();
    if (!search)
        return search.failure();
    return stillSuspected(search->bisection());
}
} // namespace tessel
