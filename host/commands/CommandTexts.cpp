#include "host/commands/CommandTexts.h"

#include <algorithm>

#include "host/text/DisplayWidth.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr wchar_t kSession[] = L"Session";
constexpr wchar_t kApplications[] = L"Applications";
constexpr wchar_t kSettings[] = L"Settings";
constexpr std::wstring_view kBetweenWays = L" | ";
} // namespace

const std::vector<CommandText>& commandTexts()
{
    static const std::vector<CommandText> texts = {
        {kSession, L"HELP", L"[command] | topic | --json",
         L"Lists the commands, or tells how one is typed, or opens a help topic", L"HELP LOAD"},
        {kSession, L"?", L"[command] | topic", L"The same as HELP", L"? LOAD"},
        {kSession, L"QUIT", L"", L"Ends the session", L""},
        {kSession, L"EXIT", L"", L"Ends the session", L""},
        {kSession, L"SCRIPT", L"file", L"Runs the commands in a file", L"SCRIPT ~/morning.scr"},
        {kSession, L"CD", L"[folder]", L"Shows or changes the current folder", L"CD \"~/My drawings\""},
        {kSession, L"VERSION", L"", L"Shows the version", L""},
        {kApplications, L"LOAD", L"file | address",
         L"Loads a compiled module or a Lisp file, also from an address on the net",
         L"LOAD \"~/my lisp/hilbert.lsp\""},
        {kApplications, L"UNLOAD", L"file", L"Unloads a compiled module", L"UNLOAD moon.bundle"},
        {kApplications, L"APPS", L"[--json]", L"Lists what is loaded, and what could not be", L""},
        {kApplications, L"DISABLE", L"file", L"Keeps an application out at starts; it stays in every list",
         L"DISABLE moon.bundle"},
        {kApplications, L"ENABLE", L"file",
         L"Lets an application in again that was disabled or that ended Tessel", L"ENABLE moon.bundle"},
        {kApplications, L"BISECT", L"[START|GOOD|BAD|STOP]",
         L"Finds the application that makes trouble, in a few starts", L"BISECT START"},
        {kApplications, L"MODRIG", L"", L"Loads and unloads applications, in a dialog", L""},
        {kSettings, L"SETVAR", L"[variable [value]] | --json", L"Shows or sets system variables",
         L"SETVAR LISPENABLED 0"},
        {kSettings, L"PROFILE", L"[name] | --json", L"Shows or changes the current profile",
         L"PROFILE Drafting"},
        {kSettings, L"REGISTRY",
         L"LIST [key] [--json] | GET key [name] [--json] | SET key [name data] | DELETE key [name] | "
         L"EXPORT key file [UTF8] | IMPORT file | RESTORE | RESET",
         L"Shows and changes what is stored, takes it to files and back, mends a damaged registry",
         L"REGISTRY EXPORT Software\\Tessel ~/tessel.reg UTF8"},
    };
    return texts;
}

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
    for (const auto& way : waysOfTyping(usage))
        lines.push_back((lines.empty() ? label : std::wstring(displayWidth(label), L' ')) + name +
                        (way.empty() ? L"" : L" ") + way);
    return lines;
}

std::wstring usageText(const std::wstring& name, std::wstring_view usage)
{
    std::wstring text;
    for (const auto& line : usageLines(name, usage))
        text += (text.empty() ? L"" : L"\n") + line;
    return text;
}

const CommandText* findCommandText(std::wstring_view globalName)
{
    const auto found = std::ranges::find_if(commandTexts(), [&](const CommandText& text)
                                            { return equalIgnoringCase(text.name, globalName); });
    return found == commandTexts().end() ? nullptr : &*found;
}
} // namespace tessel
