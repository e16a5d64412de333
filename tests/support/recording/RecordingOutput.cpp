#include "tests/support/recording/RecordingOutput.h"

#include <tessel/tsed.h>
#include <tessel/tsformat.h>

#include <sstream>

#include "tests/support/RecordingHost.h"

std::vector<std::wstring> RecordingOutput::lines() const
{
    std::vector<std::wstring> found;
    std::wistringstream text(printed);
    for (std::wstring line; std::getline(text, line);)
        found.push_back(line);
    return found;
}

std::vector<std::wstring> RecordingOutput::boxTexts() const
{
    std::vector<std::wstring> texts;
    for (const Box& box : boxes)
        texts.push_back(box.text);
    return texts;
}

int RecordingOutput::show(const wchar_t* text, unsigned style, void* parent)
{
    recordingHost().journal.add(L"VqHostMessageBox::show", {text, style});
    boxes.push_back({text, style, parent});
    return boxAnswer;
}

VqHostMessageBox* VqHostMessageBox::simple()
{
    return &recordingHost().output;
}

int tsutPrintfArguments(const wchar_t* format, const TsFormatArgument* arguments, std::size_t count)
{
    std::wstring text(tsutFormatArguments(nullptr, 0, format, arguments, count) + 1, L'\0');
    text.resize(tsutFormatArguments(text.data(), text.size(), format, arguments, count));
    recordingHost().journal.add(L"tsutPrintf", {text});
    recordingHost().output.printed += text;
    return static_cast<int>(text.size());
}

bool tsedHelp(const wchar_t* file, const wchar_t* topic, int command)
{
    recordingHost().journal.add(L"tsedHelp", {file, topic, command});
    RecordingOutput& output = recordingHost().output;
    output.helpCalls.push_back(
        {file ? std::optional<std::wstring>(file) : std::nullopt, topic ? topic : L"", command});
    return !output.helpTopics || output.helpTopics->contains(output.helpCalls.back().topic);
}
