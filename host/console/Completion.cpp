#include "host/console/Completion.h"

#include <algorithm>
#include <iterator>
#include <sstream>
#include <utility>

#include "host/commands/CommandTexts.h"
#include "host/commands/TypedLine.h"
#include "host/console/InputAssembler.h"
#include "host/text/Quotes.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
using Names = CompletionSources::Names;

bool isSame(std::wstring_view left, std::wstring_view right, bool caseMatters)
{
    return caseMatters ? left == right : equalIgnoringCase(left, right);
}

bool beginsWith(std::wstring_view name, std::wstring_view beginning, bool caseMatters)
{
    return isSame(name.substr(0, beginning.size()), beginning, caseMatters);
}

// The part of the first name that all names share.
std::wstring sharedBeginning(const Names& names, bool caseMatters)
{
    std::wstring shared = names.front();
    while (
        !std::ranges::all_of(names, [&](const auto& name) { return beginsWith(name, shared, caseMatters); }))
        shared.pop_back();
    return shared;
}

std::optional<Completion> completeName(std::wstring_view beginning, const Names& names)
{
    Completion result;
    result.replaced = beginning.size();
    std::ranges::copy_if(names, std::back_inserter(result.candidates),
                         [&](const auto& name) { return beginsWith(name, beginning, false); });
    if (result.candidates.empty())
        return std::nullopt;
    result.text = sharedBeginning(result.candidates, false);
    if (result.candidates.size() > 1)
        return result;
    result.text += L' ';
    result.candidates.clear();
    return result;
}

// How a path is written down: in a command line or in a string of Lisp.
struct Notation
{
    wchar_t separator = L'/';
    bool caseMatters = true;
    bool isLispString = false;
};

bool needsQuotes(const std::wstring& path)
{
    return path.find_first_of(L" \t\"") != path.npos;
}

// `isWhole`: nothing comes after it.
std::wstring written(const std::wstring& path, const OpenPart& typed, const Notation& notation, bool isWhole)
{
    if (notation.isLispString)
    {
        const std::wstring string = inQuotes(path).substr(1); // the first is typed
        return isWhole ? string : string.substr(0, string.size() - 1);
    }
    if (!typed.typed.starts_with(L'"') && !needsQuotes(path))
        return path + (isWhole ? L" " : L"");
    return isWhole ? asPart(path) + L" " : asOpenPart(path);
}

// A line ends where a name would go on.
bool fitsIntoALine(const std::wstring& name)
{
    return name.find_first_of(L"\n\r") == name.npos;
}

std::vector<Branch> fitting(std::vector<Branch> all, const std::wstring& beginning, const Notation& notation)
{
    const bool showsHidden = beginning.starts_with(L'.') || notation.separator != L'/';
    std::erase_if(all,
                  [&](const Branch& branch)
                  {
                      const bool isHidden = branch.name.starts_with(L'.');
                      return (isHidden && !showsHidden) || !fitsIntoALine(branch.name) ||
                             !beginsWith(branch.name, beginning, notation.caseMatters);
                  });
    return all;
}

std::optional<Completion> completePath(const OpenPart& typed, const Notation& notation,
                                       const std::function<std::vector<Branch>(const std::wstring&)>& list)
{
    const std::size_t end = typed.text.rfind(notation.separator) + 1; // 0 without a separator
    const std::wstring folder = typed.text.substr(0, end);
    const auto branches =
        list ? fitting(list(folder), typed.text.substr(end), notation) : std::vector<Branch>();
    if (branches.empty())
        return std::nullopt;
    Completion result;
    result.replaced = typed.typed.size();
    for (const Branch& branch : branches)
        result.candidates.push_back(branch.name +
                                    (branch.goesOn ? std::wstring(1, notation.separator) : L""));
    const bool isWhole = branches.size() == 1 && !branches.front().goesOn;
    result.text =
        written(folder + sharedBeginning(result.candidates, notation.caseMatters), typed, notation, isWhole);
    if (branches.size() == 1)
        result.candidates.clear();
    return result;
}

std::wstring_view nameOfFile(std::wstring_view path)
{
    return path.substr(path.rfind(L'/') + 1);
}

// Entries are whole paths. Who types no folder may mean a file by its name; then several have nothing in
// common that could take the place of what is typed.
std::optional<Completion> completeEntry(const OpenPart& typed, Names entries)
{
    const bool byName = typed.text.find(L'/') == typed.text.npos;
    std::erase_if(entries,
                  [&](const std::wstring& entry)
                  {
                      const bool fits = beginsWith(entry, typed.text, false) ||
                                        (byName && beginsWith(nameOfFile(entry), typed.text, false));
                      return !fits || !fitsIntoALine(entry);
                  });
    if (entries.empty())
        return std::nullopt;
    Completion result;
    result.replaced = typed.typed.size();
    const bool isWhole = entries.size() == 1;
    const std::wstring shared = sharedBeginning(entries, true);
    const bool goesOn = shared.size() > typed.text.size() && beginsWith(shared, typed.text, false);
    result.text = isWhole || goesOn ? written(shared, typed, {}, isWhole) : std::wstring(typed.typed);
    if (!isWhole)
        result.candidates = std::move(entries);
    return result;
}

bool isKind(const std::wstring& word)
{
    return word.front() >= L'a' && word.front() <= L'z';
}

// What may stand in one place of a command: words that are typed as they are, and kinds of things.
struct Expected
{
    Names words;
    Names kinds;

    bool has(const wchar_t* kind) const { return std::ranges::find(kinds, kind) != kinds.end(); }
};

// "[START|GOOD]" is START and GOOD, "file..." a file.
Names wordsOfPlace(std::wstring place)
{
    std::erase_if(place, [](wchar_t character)
                  { return character == L'[' || character == L']' || character == L'.'; });
    Names words;
    std::wistringstream choices(place);
    for (std::wstring word; std::getline(choices, word, L'|');)
        if (!word.empty())
            words.push_back(word);
    return words;
}

bool canStandThere(const std::wstring& part, const Names& words)
{
    return std::ranges::any_of(words, [&](const auto& word)
                               { return isKind(word) || equalIgnoringCase(word, part); });
}

// The next place of a way; one that can be repeated stays the next one.
bool takePlace(std::wistringstream& places, std::wstring& place)
{
    return place.ends_with(L"...") || places >> place;
}

void addExpected(Expected& expected, const std::wstring& way, const Names& arguments)
{
    std::wistringstream places(way);
    std::wstring place;
    for (const std::wstring& argument : arguments)
        if (!takePlace(places, place) || !canStandThere(argument, wordsOfPlace(place)))
            return;
    if (takePlace(places, place))
        for (const std::wstring& word : wordsOfPlace(place))
            (isKind(word) ? expected.kinds : expected.words).push_back(word);
}

Expected expectedAfter(const Names& parts, const CompletionSources& sources)
{
    Expected expected;
    const Names arguments(parts.begin() + 1, parts.end());
    for (const std::wstring& way : waysOfTyping(sources.usage ? sources.usage(parts.front()) : L""))
        addExpected(expected, way, arguments);
    return expected;
}

void append(Names& names, const std::function<Names()>& more)
{
    if (more)
        std::ranges::move(more(), std::back_inserter(names));
}

std::optional<Completion> completeArgument(const TypedLine& split, const CompletionSources& sources)
{
    Expected expected = expectedAfter(split.parts, sources);
    if (expected.has(L"file") || expected.has(L"folder"))
        return completePath(split.last, {},
                            [&](const std::wstring& folder)
                            {
                                auto files = sources.files ? sources.files(folder) : std::vector<Branch>();
                                if (!expected.has(L"file"))
                                    std::erase_if(files, [](const Branch& file) { return !file.goesOn; });
                                return files;
                            });
    if (expected.has(L"entry") && sources.entries)
        return completeEntry(split.last, sources.entries(split.parts));
    if (expected.has(L"key"))
        return completePath(split.last, {L'\\', false}, sources.keys);
    if (expected.has(L"command"))
        append(expected.words, sources.commands);
    if (expected.has(L"variable"))
        append(expected.words, sources.variables);
    return split.last.typed == split.last.text ? completeName(split.last.text, expected.words) : std::nullopt;
}

// Where the string begins that the Lisp text ends in; after its quote.
std::optional<std::size_t> openString(std::wstring_view text)
{
    std::optional<std::size_t> start;
    for (std::size_t at = 0; at < text.size(); ++at)
        if (text[at] == L'\\')
            ++at;
        else if (text[at] == L'"')
            start = start ? std::nullopt : std::optional(at + 1);
        else if (!start && text[at] == L';') // to the end of the line
            at = std::min(text.find(L'\n', at), text.size());
    return start;
}

std::wstring withoutBackslashes(std::wstring_view string)
{
    std::wstring result;
    for (std::size_t at = 0; at < string.size(); ++at)
    {
        at += string[at] == L'\\' && at + 1 < string.size() ? 1 : 0;
        result += string[at];
    }
    return result;
}

std::optional<Completion> completeLisp(std::wstring_view text, std::size_t startOfLine,
                                       const CompletionSources& sources)
{
    if (const auto start = openString(text))
        return *start < startOfLine
                   ? std::nullopt
                   : completePath({text.substr(*start), withoutBackslashes(text.substr(*start))},
                                  {.isLispString = true}, sources.files);
    const auto symbol = text.substr(text.find_last_of(L" \t\n()'`,\"#@") + 1);
    if (symbol.empty() || !sources.lispSymbols)
        return std::nullopt;
    return completeName(symbol, sources.lispSymbols(std::wstring(symbol)));
}
} // namespace

std::optional<Completion> complete(std::wstring_view line, const CompletionSources& sources,
                                   std::wstring_view lispBefore)
{
    if (!lispBefore.empty() || isLisp(line))
        return completeLisp(std::wstring(lispBefore) + L"\n" + std::wstring(line), lispBefore.size() + 1,
                            sources);
    const TypedLine split = takeApart(line);
    if (!split.parts.empty())
        return completeArgument(split, sources);
    return sources.commands && split.last.typed == split.last.text
               ? completeName(split.last.text, sources.commands())
               : std::nullopt;
}
} // namespace tessel
