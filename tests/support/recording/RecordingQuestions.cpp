#include "tests/support/recording/RecordingQuestions.h"

#include <tessel/tsask.h>
#include <tessel/tssession.h>
#include <wincompat/winfile.h>

#include "host/messages/Answers.h"
#include "tests/support/RecordingHost.h"

namespace
{
std::optional<std::wstring> defaultText(const wchar_t* byDefault)
{
    return byDefault ? std::optional<std::wstring>(byDefault) : std::nullopt;
}

std::wstring fullPathOf(const std::wstring& path)
{
    return path.starts_with(L'/') ? path : recordingHost().files.currentFolderNow() + L"/" + path;
}

bool pathHasRoom(const wchar_t* byDefault, std::size_t capacity)
{
    return !byDefault || fullPathOf(tessel::pathIn(byDefault)).size() < capacity;
}

bool isFile(const std::wstring& path)
{
    const DWORD attributes = recordingHost().files.attributes(path);
    return attributes != INVALID_FILE_ATTRIBUTES && (attributes & FILE_ATTRIBUTE_DIRECTORY) == 0;
}
} // namespace

int RecordingQuestions::ask(const std::wstring& question, const std::optional<std::wstring>& byDefault,
                            const std::function<bool(const std::wstring&)>& take)
{
    asked.push_back(question);
    defaults.push_back(byDefault.value_or(L""));
    const auto answer = nextAnswer(byDefault);
    return answer && take(*answer) ? TSASK_ANSWERED : TSASK_CANCELLED;
}

std::optional<std::wstring> RecordingQuestions::nextAnswer(const std::optional<std::wstring>& byDefault)
{
    if (answers.empty())
        return byDefault;
    tsrxBeforeWaiting(false);
    const auto answer = answers.front();
    answers.pop_front();
    return answer && byDefault && tessel::trimmed(*answer).empty() ? byDefault : answer;
}

int tsaskText(const wchar_t* question, const wchar_t* byDefault, wchar_t* answer, std::size_t capacity)
{
    if (!question || !answer || capacity == 0 || defaultText(byDefault).value_or(L"").size() >= capacity)
        return TSASK_INVALID;
    return recordingHost().questions.ask(question, defaultText(byDefault),
                                         [&](const std::wstring& text)
                                         { return copyText(text, answer, capacity); });
}

int tsaskNumber(const wchar_t* question, const double* byDefault, double* answer)
{
    if (!question || !answer)
        return TSASK_INVALID;
    const auto shown = byDefault ? std::optional(tessel::asText(*byDefault)) : std::nullopt;
    return recordingHost().questions.ask(question, shown,
                                         [&](const std::wstring& text)
                                         {
                                             const auto number = tessel::numberIn(text);
                                             *answer = number.value_or(*answer);
                                             return number.has_value();
                                         });
}

int tsaskYesOrNo(const wchar_t* question, const bool* byDefault, bool* answer)
{
    if (!question || !answer)
        return TSASK_INVALID;
    const auto shown = byDefault ? std::optional(tessel::asText(*byDefault)) : std::nullopt;
    return recordingHost().questions.ask(question, shown,
                                         [&](const std::wstring& text)
                                         {
                                             const auto yes = tessel::yesOrNoIn(text);
                                             *answer = yes.value_or(*answer);
                                             return yes.has_value();
                                         });
}

int tsaskFile(const wchar_t* question, const wchar_t* byDefault, bool mustExist, wchar_t* path,
              std::size_t capacity)
{
    if (!question || !path || capacity == 0 || !pathHasRoom(byDefault, capacity))
        return TSASK_INVALID;
    return recordingHost().questions.ask(question, defaultText(byDefault),
                                         [&](const std::wstring& text)
                                         {
                                             const std::wstring typed = tessel::pathIn(text);
                                             const std::wstring full = fullPathOf(typed);
                                             return !typed.empty() && (!mustExist || isFile(full)) &&
                                                    copyText(full, path, capacity);
                                         });
}
