#include "host/messages/MessageBox.h"

#include <algorithm>
#include <cwctype>
#include <utility>

#include "host/text/CommandLine.h"
#include "host/text/Running.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
// On the command line it is the end of a sentence; in the box it stands alone. What begins with a word begins
// with a capital there; names stay as they are.
std::wstring asSentence(std::wstring text)
{
    const std::wstring word = text.substr(0, text.find(L' '));
    const auto isLetter = [](wchar_t character)
    {
        return std::iswalpha(static_cast<std::wint_t>(character)) != 0;
    };
    if (!word.empty() && std::ranges::all_of(word, isLetter))
        text.front() = static_cast<wchar_t>(std::towupper(static_cast<std::wint_t>(text.front())));
    return text;
}
} // namespace

MessageBox::MessageBox(CommandLine& commandLine, Presenter presenter)
    : mCommandLine(commandLine), mPresenter(std::move(presenter))
{
}

void MessageBox::explain(const std::wstring& path, const std::wstring& why)
{
    mNote = {path, why, false};
}

void MessageBox::passOver(const std::wstring& path)
{
    mNote = {path, {}, true};
}

// What is not used now is about something else than the box after it.
MessageBox::FileNote MessageBox::takeNoteFor(const std::wstring& text)
{
    FileNote note = std::exchange(mNote, {});
    return !note.path.empty() && text.find(note.path) != std::wstring::npos ? note : FileNote();
}

void MessageBox::collect()
{
    mCollected.emplace();
}

std::vector<MessageBox::Box> MessageBox::takeCollected()
{
    return std::exchange(mCollected, std::nullopt).value_or(std::vector<Box>());
}

void MessageBox::show(const Box& box, const std::wstring& lines, bool linesToo)
{
    if (linesToo || present(box) == 0)
        sayMessage(lines);
    if (linesToo)
        static_cast<void>(present(box)); // nothing depends on the button
}

int MessageBox::present(const Box& box) const
{
    return mPresenter ? mPresenter(box) : 0;
}

void MessageBox::sayMessage(const std::wstring& text)
{
    mCommandLine.say(translated(L"Message: {}", text));
}

int MessageBox::show(const wchar_t* text, unsigned style, void* parent)
{
    const std::wstring message = text ? text : L"";
    const FileNote note = takeNoteFor(message);
    if (note.needsNoBox)
        return IDOK;
    const Box box{message, asSentence(note.why), style, parent};
    if (mCollected && !parent)
        mCollected->push_back(box);
    else if (const int answer = present(box))
        return answer;
    else
        sayMessage(message);
    return IDOK; // every style begins with the button OK
}
} // namespace tessel

VqHostMessageBox* VqHostMessageBox::simple()
{
    // Never null, not even while the host starts or ends.
    static tessel::CommandLine nowhere([](std::string_view) {});
    static tessel::MessageBox withoutHost(nowhere);
    auto* running = tessel::running<tessel::MessageBox>();
    return running ? running : &withoutHost;
}
