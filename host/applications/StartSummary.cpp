#include "host/applications/StartSummary.h"

#include <algorithm>
#include <map>
#include <string_view>
#include <unordered_set>

#include <tessel/tsmessagebox.h>

#include "host/applications/Admission.h"
#include "host/text/Joined.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
// More would not fit on a small screen; the command line has it all.
constexpr std::size_t kMostInBox = 5;
constexpr std::size_t kLongestInBox = 240;
constexpr std::wstring_view kEndsOfSentences = L".!?…";

using Boxes = std::vector<MessageBox::Box>;
using Texts = std::vector<std::wstring>;

struct Entry
{
    std::wstring file;
    std::wstring why; // a sentence, or the end of one
};

// What stands between quotes in the text of a box, in English or in German; empty when nothing does.
std::wstring quotedIn(const std::wstring& text)
{
    const std::size_t start = text.find_first_of(L"“„");
    if (start == text.npos)
        return {};
    const std::size_t end = text.find(text[start] == L'“' ? L'”' : L'“', start + 1);
    return end == text.npos ? std::wstring() : text.substr(start + 1, end - start - 1);
}

// Boxes that name one of the files. A quoted one is looked up, which thousands of them would feel.
void dropKnown(Boxes& boxes, const std::vector<Entry>& entries)
{
    std::unordered_set<std::wstring> files;
    for (const Entry& entry : entries)
        files.insert(entry.file);
    const auto isKnown = [&](const MessageBox::Box& box)
    {
        const std::wstring quoted = quotedIn(box.text);
        return quoted.empty() ? std::ranges::any_of(files, [&](const std::wstring& file)
                                                    { return box.text.find(file) != file.npos; })
                              : files.contains(quoted);
    };
    std::erase_if(boxes, isKnown);
}

std::vector<Entry> entriesOf(const std::vector<LoadOutcome>& failed)
{
    std::vector<Entry> entries;
    entries.reserve(failed.size());
    for (const LoadOutcome& outcome : failed)
        if (!Admission::isKeptOut(outcome.loaded.code()))
            entries.push_back({outcome.path, outcome.loaded.sentence()});
    return entries;
}

std::wstring lineFor(const Entry& entry)
{
    const bool isEnded =
        !entry.why.empty() && kEndsOfSentences.find(entry.why.back()) != std::wstring_view::npos;
    if (quotedIn(entry.why) == entry.file) // a sentence of its own
        return entry.why;
    return entry.file + L": " + entry.why + (isEnded ? L"" : L".");
}

// As many as fit into a box, each on as many lines as fit.
std::wstring fitted(const Texts& texts)
{
    Texts shown(texts.begin(),
                texts.begin() + static_cast<std::ptrdiff_t>(std::min(texts.size(), kMostInBox)));
    for (std::wstring& text : shown)
        if (text.size() > kLongestInBox)
            text.replace(kLongestInBox - 1, text.npos, 1, L'…');
    if (texts.size() > kMostInBox)
        shown.push_back(translatedByCount(texts.size() - kMostInBox,
                                          L"And {} more: the command line lists them all.",
                                          L"And {} more: the command line lists them all."));
    return joined(shown, L"\n\n");
}

Texts textsOf(const Boxes& boxes)
{
    Texts texts;
    for (const MessageBox::Box& box : boxes)
        texts.push_back(box.text);
    return texts;
}

StartSummary summaryOf(const std::vector<Entry>& entries, const Texts& messages)
{
    Texts texts;
    std::wstring lines = translatedByCount(entries.size(), L"{} application could not be loaded:",
                                           L"{} applications could not be loaded:");
    for (const Entry& entry : entries)
    {
        texts.push_back(lineFor(entry));
        lines += L"\n  " + texts.back();
    }
    for (const std::wstring& message : messages)
    {
        texts.push_back(message);
        lines += L"\n" + message;
    }
    const std::wstring detail = fitted(texts);
    return {{.text = translatedByCount(entries.size(), L"{} application could not be loaded.",
                                       L"{} applications could not be loaded."),
             .detail = detail,
             .style = MB_ICONEXCLAMATION},
            lines,
            detail == joined(texts, L"\n\n")};
}

StartSummary summaryOf(const Boxes& boxes)
{
    const Texts texts = textsOf(boxes);
    MessageBox::Box box = boxes.front();
    if (texts.size() > 1)
        box.text = fitted(texts);
    return {box, joined(texts, L"\n"), box.text == joined(texts, L"\n\n")};
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
    if (!entries.empty())
        return summaryOf(entries, textsOf(others));
    return others.empty() ? std::nullopt : std::optional(summaryOf(others));
}
} // namespace tessel
