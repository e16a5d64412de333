// The functions of the SDK that ask.
#include <tessel/tsask.h>

#include <algorithm>
#include <filesystem>

#include "host/messages/Answers.h"
#include "host/messages/Questions.h"
#include "host/text/Running.h"
#include "host/text/Unicode.h"

namespace
{
using tessel::Failure;
using tessel::Questions;
using tessel::Result;

int ask(const Questions::Question& question, const Questions::Taker& take)
{
    auto* questions = tessel::running<Questions>();
    return questions && questions->ask(question, take) ? TSASK_ANSWERED : TSASK_CANCELLED;
}

std::optional<std::wstring> orNothing(const wchar_t* text)
{
    return text ? std::optional<std::wstring>(text) : std::nullopt;
}

Result<> copyInto(const std::wstring& text, wchar_t* buffer, std::size_t capacity)
{
    if (text.size() >= capacity)
        return Failure{L"This is too long: at most " + std::to_wstring(capacity - 1) +
                       L" characters can be taken."};
    *std::ranges::copy(text, buffer).out = L'\0';
    return {};
}

// The full path, of a file that is there if it has to be.
Result<std::wstring> fileAt(const std::wstring& typed, bool mustExist)
{
    const std::filesystem::path path = tessel::toUtf8(typed);
    if (path.empty())
        return Failure{L"This is no name of a file."};
    std::error_code failed;
    if (mustExist && !std::filesystem::is_regular_file(path, failed))
        return Failure{L"There is no file " + typed + L"."};
    const auto full = std::filesystem::absolute(path, failed);
    if (failed)
        return Failure{L"The current folder is gone: name the whole path."};
    return tessel::toWide(full.lexically_normal().native());
}
} // namespace

int tsaskText(const wchar_t* question, const wchar_t* byDefault, wchar_t* answer, std::size_t capacity)
{
    if (!question || !answer || capacity == 0)
        return TSASK_INVALID;
    return ask({question, {}, orNothing(byDefault)},
               [&](const std::wstring& text) { return copyInto(text, answer, capacity); });
}

int tsaskNumber(const wchar_t* question, const double* byDefault, double* answer)
{
    if (!question || !answer)
        return TSASK_INVALID;
    const auto shownDefault = byDefault ? std::optional(tessel::asText(*byDefault)) : std::nullopt;
    return ask({question, {}, shownDefault},
               [&](const std::wstring& text) -> Result<>
               {
                   const auto number = tessel::numberIn(text);
                   if (!number)
                       return Failure{L"This is no number: \"" + text + L"\"."};
                   *answer = *number;
                   return {};
               });
}

int tsaskYesOrNo(const wchar_t* question, const bool* byDefault, bool* answer)
{
    if (!question || !answer)
        return TSASK_INVALID;
    const auto shownDefault = byDefault ? std::optional(tessel::asText(*byDefault)) : std::nullopt;
    return ask({question, tessel::asText(true) + L"/" + tessel::asText(false), shownDefault},
               [&](const std::wstring& text) -> Result<>
               {
                   const auto yes = tessel::yesOrNoIn(text);
                   if (!yes)
                       return Failure{L"This is neither yes nor no: \"" + text + L"\"."};
                   *answer = *yes;
                   return {};
               });
}

int tsaskFile(const wchar_t* question, const wchar_t* byDefault, bool mustExist, wchar_t* path,
              std::size_t capacity)
{
    if (!question || !path || capacity == 0)
        return TSASK_INVALID;
    return ask({question, {}, orNothing(byDefault)},
               [&](const std::wstring& text) -> Result<>
               {
                   const auto file = fileAt(tessel::pathIn(text), mustExist);
                   return file ? copyInto(*file, path, capacity) : file.failure();
               });
}
