#include "host/applications/StartSummary.h"

#include <algorithm>
#include <iterator>
#include <map>
#include <string_view>

#include <tessel/tsmessagebox.h>

namespace tessel
{
namespace
{
// More would not fit on a small screen.
constexpr std::size_t kMostInBox = 8;
constexpr std::wstring_view kEndsOfSentences = L".!?…";

using Boxes = std::vector<MessageBox::Box>;

struct Entry
{
    std::wstring file;
    std::wstring why; // a sentence, or the end of one
};

// What stands between quotes in the text of a box; empty when nothing does.
std::wstring quotedIn(const std::wstring& text)
{
    const std::size_t start = text.find(L'“');
    const std::size_t end = text.find(L'”', start);
    return end == text.npos ? std::wstring() : text.substr(start + 1, end - start - 1);
}

bool names(const MessageBox::Box& box, const Entry& entry)
{
    return box.text.find(entry.file) != std::wstring::npos;
}

void dropKnown(Boxes& boxes, const std::vector<Entry>& entries)
{
    std::erase_if(
        boxes, [&](const MessageBox::Box& box)
        { return std::ranges::any_of(entries, [&](const Entry& entry) { return names(box, entry); }); });
}

std::vector<Entry> entriesOf(const std::vector<LoadOutcome>& failed)
{
    std::vector<Entry> entries;
    for (const LoadOutcome& outcome : failed)
        entries.push_back({outcome.path, outcome.loaded.sentence()});
    return entries;
}

std::wstring lineFor(const Entry& entry)
{
    const bool isEnded =
        !entry.why.empty() && kEndsOfSentences.find(entry.why.back()) != std::wstring_view::npos;
    return entry.file + L": " + entry.why + (isEnded ? L"" : L".");
}

std::wstring joined(const std::vector<std::wstring>& texts, const std::wstring& between)
{
    std::wstring result;
    for (const std::wstring& text : texts)
        result += (result.empty() ? L"" : between) + text;
    return result;
}

std::wstring countOf(std::size_t applications)
{
    return applications == 1 ? L"1 application could not be loaded"
                             : std::to_wstring(applications) + L" applications could not be loaded";
}

std::wstring detailOf(const std::vector<Entry>& entries, const std::vector<std::wstring>& messages)
{
    std::vector<std::wstring> paragraphs;
    for (const Entry& entry : entries)
        if (paragraphs.size() < kMostInBox)
            paragraphs.push_back(lineFor(entry));
    if (entries.size() > kMostInBox)
        paragraphs.push_back(L"And " + std::to_wstring(entries.size() - kMostInBox) +
                             L" more: the command line has told of all of them, and APPS lists them.");
    std::ranges::copy(messages, std::back_inserter(paragraphs));
    return joined(paragraphs, L"\n\n");
}

std::wstring linesOf(const std::vector<Entry>& entries, const std::vector<std::wstring>& messages)
{
    std::wstring lines = countOf(entries.size()) + L":";
    for (const Entry& entry : entries)
        lines += L"\n  " + lineFor(entry);
    for (const std::wstring& message : messages)
        lines += L"\n" + message;
    return lines;
}
} // namespace

void noteRefusedFiles(const Boxes& boxes, LoadOutcomes& outcomes)
{
    std::map<std::wstring, std::wstring> firstWords;
    for (const MessageBox::Box& box : boxes)
    {
        const std::wstring file = quotedIn(box.text);
        const auto [first, isFirst] = firstWords.try_emplace(file, box.text);
        if (!file.empty() && !isFirst && !outcomes.of(file))
            outcomes.note(file, Failure{first->second}, LoadOutcomes::Clock::now());
    }
}

std::optional<StartSummary> summarize(const std::vector<LoadOutcome>& failed, const Boxes& boxes)
{
    Boxes others = boxes;
    const std::vector<Entry> entries = entriesOf(failed);
    dropKnown(others, entries);
    std::vector<std::wstring> messages;
    for (const MessageBox::Box& box : others)
        messages.push_back(box.text);
    if (!entries.empty())
        return StartSummary{{.text = countOf(entries.size()) + L".",
                             .detail = detailOf(entries, messages),
                             .style = MB_ICONEXCLAMATION},
                            linesOf(entries, messages)};
    if (others.empty())
        return std::nullopt;
    MessageBox::Box box = others.front();
    box.text = joined(messages, L"\n\n");
    return StartSummary{box, joined(messages, L"\n")};
}
} // namespace tessel
