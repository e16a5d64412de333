#include "host/applications/Bisecting.h"

#include <algorithm>

#include "host/platform/RealPath.h"
#include "host/platform/SmallFile.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr char kFileName[] = "bisection";
constexpr std::string_view kFirstLine = "Tessel looks for the culprit, 1";
constexpr char kGood = 'g';
constexpr char kBad = 'b';

std::wstring counted(std::size_t count, const wchar_t* one, const wchar_t* many)
{
    return std::to_wstring(count) + (count == 1 ? one : many);
}

std::wstring startsLeft(const Bisection& bisection)
{
    return L"at most " + counted(bisection.startsLeft(), L" start is", L" starts are") + L" left";
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
    if (lines.size() < 3 || lines[0] != kFirstLine || !areAnswers(lines[1]))
        return Failure{L"The file " + toWide(mFile.string()) +
                       L" is damaged; BISECT STOP ends the search that it is about."};
    Search search;
    for (const char answer : lines[1])
        search.answers.push_back(answer == kGood);
    std::transform(lines.begin() + 2, lines.end(), std::back_inserter(search.suspects), unescaped);
    return std::optional(std::move(search));
}

Result<> Bisecting::store(const Search& search) const
{
    std::string content = std::string(kFirstLine) + '\n';
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
        return Failure{L"The file " + toWide(mFile.string()) + L" cannot be removed: " +
                       toWide(failed.message()) + L"."};
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
    lines.insert(lines.begin(), L"BISECT keeps " + std::to_wstring(lines.size()) + L" of " +
                                    counted(mApplied->suspects.size(), L" suspect", L" suspects") +
                                    L" out at this start:");
    const auto fair = checkWentAsPlanned(whyNotAsPlanned);
    lines.push_back(fair ? L"Type BISECT GOOD when the trouble is gone, BISECT BAD when it is there; " +
                               startsLeft(mApplied->bisection()) + L"."
                         : fair.sentence());
    return lines;
}

Result<> Bisecting::checkWentAsPlanned(const WhyNotAsPlanned& whyNotAsPlanned) const
{
    for (const std::string& suspect : mApplied->suspects)
        if (const std::wstring why = whyNotAsPlanned(suspect); !why.empty())
            return Failure{L"This session cannot be judged: \"" + toWide(suspect) + L"\", which was to " +
                           (keepsOut(suspect) ? L"stay out, " + why + L". Start Tessel again"
                                              : L"be loaded, " + why + L". ENABLE lets in what is kept out") +
                           L"; BISECT STOP ends the search."};
    return {};
}

Result<std::wstring> Bisecting::begin(const std::vector<std::string>& suspects)
{
    if (suspects.empty())
        return Failure{
            L"There is nothing to search among: no application was loaded by itself in this session."};
    Search search;
    std::ranges::transform(suspects, std::back_inserter(search.suspects),
                           [](const std::string& path) { return realPath(path).native(); });
    if (auto stored = store(search); !stored)
        return stored.failure();
    mReadAtStart = {};
    mApplied.reset();
    mBegunHere = true;
    return L"BISECT searches among " + counted(suspects.size(), L" application", L" applications") + L"; " +
           startsLeft(search.bisection()) + L". Start Tessel again.";
}

Result<Bisecting::Search> Bisecting::current() const
{
    auto search = read();
    if (!search)
        return search.failure();
    if (!*search)
        return Failure{L"No search is going on; BISECT START begins one."};
    return **std::move(search);
}

std::wstring Bisecting::whyNotOfThisSession() const
{
    if (!mApplies)
        return L"it was started with --safe, and no suspect is tried then.";
    return mBegunHere ? L"the search has begun in it, and nothing was kept out of its start."
                      : L"the search has gone on since it was started.";
}

Result<std::wstring> Bisecting::answer(bool wasGood, const WhyNotAsPlanned& whyNotAsPlanned)
{
    auto search = current();
    if (!search)
        return search.failure();
    if (mApplied != *search)
        return Failure{L"This session cannot be judged: " + whyNotOfThisSession() +
                       L" Start Tessel again, without --safe."};
    if (auto fair = checkWentAsPlanned(whyNotAsPlanned); !fair)
        return fair.failure();
    search->answers.push_back(wasGood);
    const Bisection bisection = search->bisection();
    const bool isOpen = bisection.verdict() == Bisection::Verdict::kOpen;
    if (auto stored = isOpen ? store(*search) : forget(); !stored)
        return stored.failure();
    switch (bisection.verdict())
    {
    case Bisection::Verdict::kFound:
        return L"BISECT has found it: \"" + toWide(search->suspects[bisection.culprit()]) +
               L"\" makes the trouble. DISABLE keeps it out at starts.";
    case Bisection::Verdict::kNone:
        return L"BISECT says that it is none of them: the trouble is there when " +
               (search->suspects.size() == 1
                    ? std::wstring(L"the only suspect is")
                    : L"all of the " + std::to_wstring(search->suspects.size()) + L" suspects are") +
               L" kept out.";
    case Bisection::Verdict::kTogether:
        return std::wstring(L"BISECT says that none of them does it alone: several are needed together.");
    case Bisection::Verdict::kOpen:
        break;
    }
    return counted(bisection.stillSuspected(), L" application is", L" applications are") +
           L" still suspected; " + startsLeft(bisection) + L". Start Tessel again.";
}

Result<std::wstring> Bisecting::stop()
{
    if (auto forgotten = forget(); !forgotten)
        return forgotten.failure();
    mApplied.reset();
    return std::wstring(L"BISECT keeps nothing out any more.");
}

Result<std::wstring> Bisecting::tell() const
{
    const auto search = current();
    if (!search)
        return search.failure();
    return counted(search->bisection().stillSuspected(), L" application is", L" applications are") +
           L" still suspected; " + startsLeft(search->bisection()) + L".";
}
} // namespace tessel
