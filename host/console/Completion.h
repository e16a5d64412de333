// What the Tab key makes of what is typed before the cursor.
#pragma once

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace tessel
{
struct Completion
{
    std::size_t replaced = 0; // so many characters before the cursor give way to the text
    std::wstring text;
    std::vector<std::wstring> candidates; // the names to choose from when there are several
};

// A file in a folder, or a key in another.
struct Branch
{
    std::wstring name;
    bool goesOn = false; // a path may go on below it
};

// What there is to complete with, asked when it is needed. What is missing completes nothing.
struct CompletionSources
{
    using Names = std::vector<std::wstring>;

    std::function<Names()> commands = {};
    // How the arguments of a command are typed, as in `CommandText`.
    std::function<std::wstring(const std::wstring& command)> usage = {};
    std::function<Names()> variables = {};
    std::function<std::vector<Branch>(const std::wstring& folder)> files = {}; // may begin with ~
    std::function<std::vector<Branch>(const std::wstring& key)> keys = {};
    // Of an application's list, for the command and its arguments before.
    std::function<Names(const Names& parts)> entries = {};
    std::function<Names(const std::wstring& beginning)> lispSymbols = {};
};

// Names compare without regard to case, files with it. What alone fits is completed whole, with a blank after
// it unless a path goes on there; of several, as far as they agree. A file with a blank in its name gets
// quotes. An entry may also be known by the name of its file. `lispBefore`: the lines of a Lisp expression
// that this one goes on. Nothing when nothing fits.
std::optional<Completion> complete(std::wstring_view line, const CompletionSources& sources,
                                   std::wstring_view lispBefore = {});
} // namespace tessel
