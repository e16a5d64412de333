#include "modrig/messages/Messages.h"

#include <tessel/tsed.h>
#include <tessel/tsmessagebox.h>
#include <wincompat/winfile.h>

#include <cwchar>

#include "modrig/base/SplitPath.h"
#include "modrig/messages/MessageLine.h"

namespace ModrigUtils
{
namespace
{
constexpr int kDecimal = 10;
constexpr std::size_t kNumberSize = 33;
constexpr std::size_t kHelpTopicSize = 1024;
constexpr unsigned kMessageBoxStyle = MB_OK | MB_ICONEXCLAMATION;

CStdStr MessageText(unsigned id, const CStdStr& subject, const CStdStr& argument)
{
    return subject.IsEmpty() ? CStdStr::OfId(id) : CStdStr::Formatted(id, argument.c_str());
}

// The text is itself the format. The host's formatting prints a conversion without an argument as it stands,
// so that a file called 100%.lsp is named as it is.
void PrintLine(const CStdStr& text)
{
    ModrigCmdlineMessage(text);
    tsutPrintf((text + CStdStr(L"\n")).c_str());
}

const wchar_t* HelpTopic(int topic)
{
    switch (topic)
    {
    case kStartupSuiteHelp:
        return L"startup_suite_dialog";
    case kFileSelectionHelp:
        return L"StandardFileSelectionDialogs";
    default:
        return L"load_unload_applications_dialog";
    }
}
} // namespace

void ModrigCmdlineMessage(const CStdStr& text)
{
    SetDialogMessage(text);
}

void ModrigCmdlineMessage(unsigned id, CStdStr path)
{
    PrintLine(MessageText(id, path, SplitPath(path).FileName()));
}

void ModrigCmdlineMessage(unsigned id, unsigned count)
{
    if (count == 0)
        return;
    wchar_t number[kNumberSize];
    const CStdStr decimal(ms_itow(static_cast<int>(count), number, kDecimal));
    PrintLine(MessageText(id, decimal, decimal));
}

void ModrigCmdlineSummary(unsigned oneId, unsigned manyId, unsigned count, const CStdStr& path)
{
    if (count == 1)
        ModrigCmdlineMessage(oneId, path);
    else
        ModrigCmdlineMessage(manyId, count);
}

void ModrigAfxMessageBox(unsigned id, CStdStr argument)
{
    ModrigAfxMessageBox(MessageText(id, argument, argument));
}

void ModrigAfxMessageBox(const CStdStr& text)
{
    // One button: there is nothing to learn from the answer.
    VqHostMessageBox::simple()->show(text.c_str(), kMessageBoxStyle, nullptr);
}

void OnCommandHelp(int topic)
{
    wchar_t buffer[kHelpTopicSize];
    std::wcsncpy(buffer, HelpTopic(topic), kHelpTopicSize);
    tsedHelp(nullptr, buffer, 0); // the host says so itself when there is no such page
}
} // namespace ModrigUtils
