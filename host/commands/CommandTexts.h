// What is said of the commands that come with the host: the one table behind HELP, `Usage:` and the Tab key.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "host/text/Translation.h"

namespace tessel
{
struct CommandText
{
    Sentence<> group;
    const wchar_t* name; // the global one
    // How the arguments can be typed; empty: there are none. Between several ways stands " | ". Small letters
    // stand for something, all else is typed as it stands (of several with bars between them, one); what is
    // in brackets can be left out, and what ends with dots be repeated. The Tab key knows `command`, `entry`,
    // `file`, `folder`, `key` and `variable`.
    Sentence<> usage;
    Sentence<> summary;     // one line
    const wchar_t* example; // the whole line; empty where the name says it all
};

// Each way of typing the arguments.
std::vector<std::wstring> waysOfTyping(std::wstring_view usage);

// The command with each way of typing it, a line each, the first after "Usage: ".
std::vector<std::wstring> usageLines(const std::wstring& name, std::wstring_view usage);
std::wstring usageText(const std::wstring& name, std::wstring_view usage);

// Null where the host has nothing to say of a command. The name in any case.
const CommandText* findCommandText(std::wstring_view globalName);
} // namespace tessel
