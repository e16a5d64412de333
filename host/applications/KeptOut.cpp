#include "host/applications/KeptOut.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <csignal>
#include <ctime>
#include <string_view>

#include "host/applications/ApplicationFiles.h"
#include "host/applications/KeptOutWords.h"
#include "host/platform/RealPath.h"
#include "host/platform/SmallFile.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
using Stage = KeptOutApplication::Stage;

constexpr char kLockName[] = "kept-out.lock";
constexpr std::string_view kHeader = "Tessel keeps these applications out, 1\n";
constexpr std::size_t kFields = 14;
constexpr std::int64_t kNanoseconds = 1'000'000'000;

// The program inside a bundle is the same application as the bundle.
auto findIn(auto& applications, const std::string& path)
{
    const std::string real = realPath(path).native();
    return std::ranges::find_if(applications, [&](const KeptOutApplication& known)
                                { return known.path == path || isWithin(real, known.realPath); });
}

std::string lineOf(const KeptOutApplication& application)
{
    const auto number = [](auto value)
    {
        return std::to_string(static_cast<std::int64_t>(value));
    };
    const std::array<std::string, kFields> fields = {escaped(application.path),
                                                     escaped(application.realPath),
                                                     number(application.stage),
                                                     number(application.since),
                                                     number(application.deed),
                                                     number(application.reason),
                                                     number(application.ending),
                                                     escaped(application.detail),
                                                     std::to_string(application.facts.size),
                                                     number(application.facts.contentTime),
                                                     number(application.facts.statusTime),
                                                     std::to_string(application.facts.inode),
                                                     application.hash ? std::to_string(*application.hash)
                                                                      : std::string("-"),
                                                     "."};
    std::string line;
    for (const std::string& field : fields)
        line += field + (&field == &fields.back() ? '\n' : '\t');
    return line;
}

std::string serialized(const std::vector<KeptOutApplication>& applications)
{
    std::string content(kHeader);
    for (const auto& application : applications)
        content += lineOf(application);
    return content;
}

std::vector<std::string_view> split(std::string_view text, char separator)
{
    std::vector<std::string_view> parts;
    for (std::size_t end = text.find(separator); end != text.npos; end = text.find(separator))
    {
        parts.push_back(text.substr(0, end));
        text.remove_prefix(end + 1);
    }
    parts.push_back(text);
    return parts;
}

template <class Number>
bool parse(std::string_view text, Number& number)
{
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    return error == std::errc() && end == text.data() + text.size();
}

template <class Enumeration>
bool parseEnumeration(std::string_view text, Enumeration last, Enumeration& value)
{
    std::uint32_t number = 0;
    if (!parse(text, number) || number == 0 || number > static_cast<std::uint32_t>(last))
        return false;
    value = static_cast<Enumeration>(number);
    return true;
}

std::optional<KeptOutApplication> parseLine(std::string_view line)
{
    const auto fields = split(line, '\t');
    KeptOutApplication result;
    std::uint64_t hash = 0;
    const bool isWhole =
        fields.size() == kFields && parseEnumeration(fields[2], Stage::kByPerson, result.stage) &&
        parse(fields[3], result.since) &&
        parseEnumeration(fields[4], RunningMarker::Deed::kLispFile, result.deed) &&
        parseEnumeration(fields[5], RunningMarker::Reason::kOnCommand, result.reason) &&
        parse(fields[6], result.ending) && parse(fields[8], result.facts.size) &&
        parse(fields[9], result.facts.contentTime) && parse(fields[10], result.facts.statusTime) &&
        parse(fields[11], result.facts.inode) && (fields[12] == "-" || parse(fields[12], hash));
    if (!isWhole)
        return std::nullopt;
    result.path = unescaped(fields[0]);
    result.realPath = unescaped(fields[1]);
    result.detail = unescaped(fields[7]);
    if (fields[12] != "-")
        result.hash = hash;
    return result;
}

Failure damaged(const std::filesystem::path& file)
{
    return {translated(L"The file {} is damaged; without it Tessel does not know which applications to keep "
                       L"out. Remove it to begin with none.",
                       file)};
}

// A file that is gone counts as unchanged: there is no new version of it to try.
bool isUnchanged(KeptOutApplication& application)
{
    const auto facts = factsOf(application.path);
    if (!facts || *facts == application.facts)
        return true;
    if (!facts->mayBeTheSame(application.facts) || !application.hash)
        return false;
    if (contentHash(application.path) != application.hash)
        return false;
    application.facts = *facts;
    return true;
}

// An application is not to blame when the session was ended from outside while it waited for the person: they
// left Tessel or switched the computer off.
bool isGuilty(const RunningMarker::Leftover& leftover)
{
    const bool fromOutside = leftover.ending == RunningMarker::kVanished ||
                             leftover.ending == RunningMarker::kCalledExit ||
                             leftover.ending == RunningMarker::kEndedByKey || leftover.ending == SIGINT;
    return !leftover.work.path.empty() && !(leftover.work.waitsForPerson && fromOutside);
}

// Several sessions may have ended alike: of what an application has done the last is told, and how many it
// was.
std::vector<std::pair<RunningMarker::Leftover, std::size_t>>
lastOfEach(const std::vector<RunningMarker::Leftover>& leftovers)
{
    std::vector<std::pair<RunningMarker::Leftover, std::size_t>> result;
    for (const auto& leftover : leftovers)
    {
        if (!isGuilty(leftover))
            continue;
        const auto path = realPath(leftover.work.path);
        const auto known = std::ranges::find_if(result, [&](const auto& other)
                                                { return realPath(other.first.work.path) == path; });
        if (known == result.end())
            result.emplace_back(leftover, 1);
        else
            *known = {leftover, known->second + 1};
    }
    return result;
}

// A new version is tried without being asked for.
void forgetChanged(std::vector<KeptOutApplication>& applications)
{
    std::vector<KeptOutApplication> staying;
    for (KeptOutApplication& application : applications)
        if (application.stage == Stage::kByPerson || isUnchanged(application))
            staying.push_back(application);
    applications = std::move(staying);
}

} // namespace

KeptOut::KeptOut(std::filesystem::path folder) : mFile(folder / kFileName)
{
    if (auto known = read())
        mApplications = *std::move(known);
}

Result<KeptOut::Applications> KeptOut::read() const
{
    const auto content = readSmallFile(mFile);
    if (!content)
        return Failure{content.sentence() + L' ' + translated(L"Nothing is kept out in this session.")};
    Applications applications;
    if (!*content)
        return applications;
    if (!(*content)->starts_with(kHeader) || !(*content)->ends_with('\n'))
        return damaged(mFile);
    for (const auto line : linesOf(std::string_view(**content).substr(kHeader.size())))
    {
        auto application = parseLine(line);
        if (!application)
            return damaged(mFile);
        applications.push_back(*std::move(application));
    }
    return applications;
}

Result<> KeptOut::change(const std::function<void(Applications&)>& work)
{
    if (mFile.empty())
        return {};
    const FileLock locked(mFile.parent_path() / kLockName);
    auto applications = read();
    if (!applications)
    {
        work(mApplications); // for this session it holds all the same
        return applications.failure();
    }
    const auto before = serialized(*applications);
    work(*applications);
    mApplications = *std::move(applications);
    const auto after = serialized(mApplications);
    if (before == after)
        return {};
    return locked.held()
               ? replaceSmallFile(mFile, after)
               : Failure{translated(L"What is kept out cannot be stored: {}.", locked.held().sentence())};
}

KeptOut::Start KeptOut::begin(const std::vector<RunningMarker::Leftover>& leftovers, bool givesTrials)
{
    Start start;
    start.stored = change(
        [&](Applications& applications)
        {
            forgetChanged(applications);
            for (const auto& [leftover, sessions] : lastOfEach(leftovers))
            {
                start.sentences.push_back(judge(leftover, sessions, applications));
                mTold.push_back(realPath(leftover.work.path).native());
            }
            if (givesTrials)
                giveTrials(applications);
        });
    return start;
}

void KeptOut::giveTrials(Applications& applications)
{
    for (KeptOutApplication& application : applications)
    {
        if (application.stage == Stage::kOnTrial)
            mTried.push_back(application.path);
        if (application.stage != Stage::kThisTime || wasTold(application))
            continue;
        mTried.push_back(application.path);
        application.stage = Stage::kOnTrial;
        application.hash = contentHash(application.path); // it is about to be opened in any case
    }
}

std::optional<std::wstring> KeptOut::takeTrialSentence(const std::string& path)
{
    const KeptOutApplication* known = find(path);
    if (!known || known->stage != Stage::kOnTrial || !mTrialsTold.insert(known->path).second)
        return std::nullopt;
    return isTriedOnceMore(*known);
}

bool KeptOut::wasTold(const KeptOutApplication& application) const
{
    return std::ranges::any_of(mTold,
                               [&](const std::string& path) { return isWithin(path, application.realPath); });
}

std::wstring KeptOut::judge(const RunningMarker::Leftover& leftover, std::size_t sessions,
                            Applications& applications)
{
    KeptOutApplication guilty;
    guilty.path = leftover.work.path;
    guilty.realPath = realPath(guilty.path).native();
    guilty.since = leftover.work.since;
    guilty.deed = leftover.work.deed;
    guilty.reason = leftover.work.reason;
    guilty.ending = leftover.ending;
    guilty.detail = leftover.work.detail;
    const std::wstring done = whatItDid(guilty, sessions) + L' ';
    const auto known = findIn(applications, guilty.path);
    // A person's wish stands as it was said.
    if (known != applications.end() && known->stage == Stage::kByPerson)
        return done + translated(L"It stays kept out at starts, until you let it in (ENABLE).");
    const auto facts = factsOf(guilty.path);
    if (facts && facts->statusTime / kNanoseconds > guilty.since)
        return done + translated(L"Its file is another one by now, and is tried.");
    guilty.facts = facts.value_or(FileFacts());
    // One that has not been tried since still gets its trial.
    if (known == applications.end() || known->stage == Stage::kThisTime)
    {
        if (known != applications.end())
            applications.erase(known);
        applications.push_back(guilty);
        return done +
               translated(L"It is not loaded by itself at this start; the next one lets it in once more.");
    }
    guilty.hash = known->hash;
    guilty.stage = Stage::kForGood;
    *known = guilty;
    return done + translated(L"It is not loaded by itself any more, until you load it by hand or let it in "
                             L"(ENABLE), or its file changes.");
}

const KeptOutApplication* KeptOut::find(const std::string& path) const
{
    if (mApplications.empty())
        return nullptr;
    const auto found = findIn(mApplications, path);
    return found == mApplications.end() ? nullptr : &*found;
}

Result<> KeptOut::keepOut(const std::string& path)
{
    if (path.empty())
        return Failure{translated(L"An application without a path cannot be kept out.")};
    if (auto checked = checkIsApplication(path); !checked)
        return checked;
    return change(
        [&](Applications& applications)
        {
            auto known = findIn(applications, path);
            if (known == applications.end())
                known = applications.insert(known, KeptOutApplication{});
            *known = {};
            known->path = path;
            known->realPath = realPath(path).native();
            known->stage = Stage::kByPerson;
            known->since = std::time(nullptr);
        });
}

Result<> KeptOut::letIn(const std::string& path)
{
    bool found = false;
    auto changed = change(
        [&](Applications& applications)
        {
            const auto known = findIn(applications, path);
            found = known != applications.end();
            if (found)
                applications.erase(known);
        });
    if (changed && !found)
        return Failure{translated(L"The application \"{}\" is not kept out.", toWide(path))};
    return changed;
}

void KeptOut::noteLoaded(const std::string& path, bool byHand)
{
    const KeptOutApplication* known = find(path);
    if (!known || known->stage == Stage::kByPerson)
        return;
    const std::string stored = known->path;
    mTried.push_back(stored);
    // What cannot be stored now is no worse than it was: it is tried or loaded by hand again.
    if (byHand)
        static_cast<void>(letIn(stored));
}

void KeptOut::noteGoodEnd()
{
    if (mTried.empty())
        return;
    static_cast<void>(change(
        [this](Applications& applications)
        {
            std::erase_if(applications,
                          [this](const KeptOutApplication& application)
                          {
                              return application.stage == Stage::kOnTrial &&
                                     std::ranges::find(mTried, application.path) != mTried.end();
                          });
        }));
}
} // namespace tessel
