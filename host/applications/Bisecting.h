// A search for the application that makes trouble, from one start to the next: its suspects and the answers
// so far stand in a file of the profile. See Bisection.
#pragma once

#include <filesystem>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "host/applications/Bisection.h"
#include "host/text/Result.h"

namespace tessel
{
class Bisecting
{
public:
    // Never searches.
    Bisecting() = default;
    // Goes on with what stands in the folder, which is there. `applies`: this session keeps suspects out, and
    // so can be judged.
    Bisecting(std::filesystem::path folder, bool applies);

    // Whether this session is one of the search.
    bool isGoingOn() const { return mApplied.has_value(); }
    // Whether this session keeps the application at that full path out.
    bool keepsOut(const std::string& path) const;
    // All of these, links followed.
    std::vector<std::string> keptOutNow() const;
    // Why a suspect that was to be loaded was not, or that one was loaded which was to stay out, the end of a
    // sentence; empty when all went as planned. A session in which it did not cannot be judged.
    using WhyNotAsPlanned = std::function<std::wstring(const std::string& suspect)>;

    // What a person is to be told at the start, line by line.
    std::vector<std::wstring> sentencesAtStart(const WhyNotAsPlanned& whyNotAsPlanned) const;

    // Each answers what a person is to be told.
    Result<std::wstring> begin(const std::vector<std::string>& suspects);
    Result<std::wstring> answer(bool wasGood, const WhyNotAsPlanned& whyNotAsPlanned);
    Result<std::wstring> stop();
    Result<std::wstring> tell() const;

private:
    struct Search
    {
        std::vector<std::string> suspects; // full paths, links followed
        std::vector<bool> answers;

        Bisection bisection() const { return Bisection(suspects.size(), answers); }
        bool operator==(const Search&) const = default;
    };

    Result<std::optional<Search>> read() const;
    Result<> store(const Search& search) const;
    Result<> forget() const;
    Result<Search> current() const;
    std::wstring whyNotOfThisSession() const;
    static std::wstring verdictIn(const Search& search);
    Result<> checkWentAsPlanned(const WhyNotAsPlanned& whyNotAsPlanned) const;

    std::filesystem::path mFile;
    bool mApplies = false;
    bool mBegunHere = false;
    std::optional<Search> mApplied; // what this session was started with
    Result<> mReadAtStart;
};
} // namespace tessel
