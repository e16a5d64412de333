#include "host/commands/CommandTexts.h"

#include <algorithm>

#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr wchar_t kSession[] = L"Session";
constexpr wchar_t kApplications[] = L"Applications";
constexpr wchar_t kSettings[] = L"Settings";
} // namespace

const std::vector<CommandText>& commandTexts()
{
    static const std::vector<CommandText> texts = {
        {kSession, L"HELP", L"[command]\ntopic",
         L"Lists the commands, or tells how one is typed, or opens a help topic", L"HELP LOAD"},
        {kSession, L"?", L"[command]\ntopic", L"The same as HELP", L"? LOAD"},
        {kSession, L"QUIT", L"", L"Ends the session", L""},
        {kSession, L"EXIT", L"", L"Ends the session", L""},
        {kSession, L"SCRIPT", L"file", L"Runs the commands in a file", L"SCRIPT ~/morning.scr"},
        {kSession, L"CD", L"[folder]", L"Shows or changes the current folder", L"CD \"~/My drawings\""},
        {kSession, L"VERSION", L"", L"Shows the version", L""},
        {kApplications, L"LOAD", L"file\naddress",
         L"Loads a compiled module or a Lisp file, also from an address on the net",
         L"LOAD \"~/my lisp/hilbert.lsp\""},
        {kApplications, L"UNLOAD", L"file", L"Unloads a compiled module", L"UNLOAD moon.bundle"},
        {kApplications, L"APPS", L"", L"Lists what is loaded, and what could not be", L""},
        {kApplications, L"DISABLE", L"file", L"Keeps an application out at starts; it stays in every list",
         L"DISABLE moon.bundle"},
        {kApplications, L"ENABLE", L"file",
         L"Lets an application in again that was disabled or that ended Tessel", L"ENABLE moon.bundle"},
        {kApplications, L"BISECT", L"[START|GOOD|BAD|STOP]",
         L"Finds the application that makes trouble, in a few starts", L"BISECT START"},
        {kApplications, L"MODRIG", L"", L"Loads and unloads applications, in a dialog", L""},
        {kSettings, L"SETVAR", L"[variable [value]]", L"Shows or sets system variables",
         L"SETVAR LISPENABLED 0"},
        {kSettings, L"PROFILE", L"[name]", L"Shows or changes the current profile", L"PROFILE Drafting"},
        {kSettings, L"REGISTRY",
         L"LIST [key]\nGET key [name]\nSET key [name data]\nDELETE key [name]\nEXPORT key file [UTF8]\n"
         L"IMPORT file\nRESTORE\nRESET",
         L"Shows and changes what is stored, takes it to files and back, mends a damaged registry",
         L"REGISTRY EXPORT Software\\Tessel ~/tessel.reg UTF8"},
    };
    return texts;
}

const CommandText* findCommandText(std::wstring_view globalName)
{
    const auto found = std::ranges::find_if(commandTexts(), [&](const CommandText& text)
                                            { return equalIgnoringCase(text.name, globalName); });
    return found == commandTexts().end() ? nullptr : &*found;
}
} // namespace tessel
