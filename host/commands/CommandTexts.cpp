#include "host/commands/CommandTexts.h"

#include <algorithm>

#include "host/text/DisplayWidth.h"
#include "host/text/Joined.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr auto kSession = Sentence(L"Session");
constexpr auto kApplications = Sentence(L"Applications");
constexpr auto kSettings = Sentence(L"Settings");
constexpr auto kNothing = Sentence<>(L"");
constexpr std::wstring_view kBetweenWays = L" | ";

// What stands for something in the usage of an application, too.
constexpr Sentence<> kThings[] = {Sentence(L"command"), Sentence(L"entry"), Sentence(L"file"),
                                  Sentence(L"folder"),  Sentence(L"key"),   Sentence(L"place"),
                                  Sentence(L"variable")};

std::wstring wordInPersonsLanguage(const std::wstring& word)
{
    const auto* known = std::ranges::find(kThings, word, &Sentence<>::english);
    return known == std::end(kThings) ? word : translated(*known);
}

// Translators know the host's own ones whole.
std::wstring usageInPersonsLanguage(const std::wstring& usage)
{
    const std::wstring whole = inPersonsLanguage(usage);
    if (whole != usage)
        return whole;
    std::wstring result;
    for (std::size_t at = 0; at < usage.size();)
    {
        const std::size_t end = usage.find_first_not_of(L"abcdefghijklmnopqrstuvwxyz", at);
        result += wordInPersonsLanguage(usage.substr(at, end - at));
        at = std::min(end, usage.size());
        if (at < usage.size())
            result += usage[at++];
    }
    return result;
}

// In the order in which HELP lists them.
const std::vector<CommandText>& commandTexts()
{
    static const std::vector<CommandText> texts = {
        {kSession, L"HELP", Sentence(L"[command] | topic | --json"),
         Sentence(L"Lists the commands, or tells how one is typed, or opens a help topic"), L"HELP LOAD"},
        {kSession, L"?", Sentence(L"[command] | topic | --json"), Sentence(L"The same as HELP"), L"? LOAD"},
        {kSession, L"QUIT", kNothing, Sentence(L"Ends the session"), L""},
        {kSession, L"EXIT", kNothing, Sentence(L"Ends the session"), L""},
        {kSession, L"SCRIPT", Sentence(L"file"), Sentence(L"Runs the commands in a file"),
         L"SCRIPT ~/morning.scr"},
        {kSession, L"CD", Sentence(L"[folder]"), Sentence(L"Shows or changes the current folder"),
         L"CD \"~/My drawings\""},
        {kSession, L"VERSION", Sentence(L"[--json]"), Sentence(L"Shows the version"), L""},
        {kApplications, L"LOAD", Sentence(L"file | address"),
         Sentence(L"Loads a compiled module or a Lisp file, also from an address on the net"),
         L"LOAD \"~/my lisp/hilbert.lsp\""},
        {kApplications, L"UNLOAD", Sentence(L"file"), Sentence(L"Unloads a compiled module"),
         L"UNLOAD moon.bundle"},
        {kApplications, L"APPS", Sentence(L"[--json]"),
         Sentence(L"Lists what is loaded, and what could not be"), L""},
        {kApplications, L"DISABLE", Sentence(L"file"),
         Sentence(L"Keeps an application out at starts; it stays in every list"), L"DISABLE moon.bundle"},
        {kApplications, L"ENABLE", Sentence(L"file"),
         Sentence(L"Lets an application in again that was disabled or that ended Tessel"),
         L"ENABLE moon.bundle"},
        {kApplications, L"BISECT", Sentence(L"[START|GOOD|BAD|STOP]"),
         Sentence(L"Finds the application that makes trouble, in a few starts"), L"BISECT START"},
        {kApplications, L"MODRIG", kNothing, Sentence(L"Loads and unloads applications, in a dialog"), L""},
        {kSettings, L"SETVAR", Sentence(L"[variable [value]] | --json"),
         Sentence(L"Shows or sets system variables"), L"SETVAR LISPENABLED 0"},
        {kSettings, L"PROFILE", Sentence(L"[name] | --json"),
         Sentence(L"Shows or changes the current profile"), L"PROFILE Drafting"},
        {kSettings, L"REGISTRY",
         Sentence(
             L"LIST [key] [--json] | GET key [name] [--json] | SET key [name data] | DELETE key [name] | "
             L"EXPORT key file [UTF8] | IMPORT file | RESTORE | RESET"),
         Sentence(L"Shows and changes what is stored, takes it to files and back, mends a damaged registry"),
         L"REGISTRY EXPORT Software\\Tessel ~/tessel.reg UTF8"},
    };
    return texts;
}
} // namespace

std::vector<std::wstring> waysOfTyping(std::wstring_view usage)
{
    std::vector<std::wstring> ways;
    for (std::size_t end = 0; end != usage.npos;)
    {
        end = usage.find(kBetweenWays);
        ways.emplace_back(usage.substr(0, end));
        usage.remove_prefix(end == usage.npos ? 0 : end + kBetweenWays.size());
    }
    return ways;
}

std::vector<std::wstring> usageLines(const std::wstring& name, std::wstring_view usage)
{
    const std::wstring label = translated(L"Usage: ");
    std::vector<std::wstring> lines;
    for (const auto& way : waysOfTyping(usageInPersonsLanguage(std::wstring(usage))))
    {
        std::wstring& line =
            lines.emplace_back(lines.empty() ? label : std::wstring(displayWidth(label), L' '));
        line += name;
        line += way.empty() ? L"" : L" ";
        line += way;
    }
    return lines;
}

std::wstring usageText(const std::wstring& name, std::wstring_view usage)
{
    return joined(usageLines(name, usage), L"\n");
}

const CommandText* findCommandText(std::wstring_view globalName)
{
    const auto found = std::ranges::find_if(commandTexts(), [&](const CommandText& text)
                                            { return equalIgnoringCase(text.name, globalName); });
    return found == commandTexts().end() ? nullptr : &*found;
}
} // namespace tessel
