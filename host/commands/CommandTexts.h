// What is said of the commands that come with the host: the one table behind HELP, `Usage:` and the Tab key.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace tessel
{
struct CommandText
{
    const wchar_t* group;
    const wchar_t* name; // the global one
    // How the arguments can be typed, a way a line; empty: there are none. Capitals are typed as they stand
    // (of several with bars between them, one), small letters stand for something, and what is in brackets
    // can be left out. The Tab key knows `command`, `file`, `folder`, `key` and `variable`.
    const wchar_t* usage;
    const wchar_t* summary; // one line
    const wchar_t* example; // the whole line; empty where the name says it all
};

// In the order in which HELP lists them.
const std::vector<CommandText>& commandTexts();

// Null where the host has nothing to say of a command. The name in any case.
const CommandText* findCommandText(std::wstring_view globalName);
} // namespace tessel
