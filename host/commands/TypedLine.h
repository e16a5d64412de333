// A line as it is typed: a command and its arguments, split at blanks. Double quotes keep blanks together and
// are taken away. Within them a doubled quote stands for one, so that a file with a quote in its name can be
// named. A quote that is not closed reaches to the end of the line.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace tessel
{
// The part that a line ends in: no blank comes after it.
struct OpenPart
{
    std::wstring_view typed; // as it stands in the line; empty where a blank, or nothing, does
    std::wstring text;       // without its quotes
    bool isInQuotes = false; // its last quote is not closed
};

struct TypedLine
{
    std::vector<std::wstring> parts; // those before
    OpenPart last;

    // As a command gets them.
    std::vector<std::wstring> allParts() const;
};

// `typed` looks into the line.
TypedLine takeApart(std::wstring_view line);

// All of its parts at once.
std::vector<std::wstring> splitLine(std::wstring_view line);

// Whether the command in the line is asked to answer a program, as one JSON document: by --json at its end.
bool isForPrograms(std::wstring_view line);
inline constexpr wchar_t kForPrograms[] = L"--json";

// The text so quoted that in a line it is one part, whatever stands in it.
std::wstring asPart(std::wstring_view text);
// The same without the quote at the end: more may follow.
std::wstring asOpenPart(std::wstring_view text);
} // namespace tessel
