// The functions of the SDK that ask.
#include <tessel/tsask.h>

#include <filesystem>

#include "host/messages/Answers.h"
#include "host/messages/Questions.h"
#include "host/text/CallersBuffer.h"
#include "host/text/Running.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace
{
using tessel::Failure;
using tessel::hasRoom;
using tessel::Questions;
using tessel::Result;
using tessel::translated;
using tessel::translatedByCount;

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
    if (tessel::copyWhole(text, buffer, capacity))
        return {};
    return Failure{translatedByCount(capacity - 1, L"This is too long: at most {} character can be taken.",
                                     L"This is too long: at most {} characters can be taken.")};
}

// The person's own words, or the English ones, which scripts have.
std::optional<bool> yesOrNo(const std::wstring& text)
{
    const auto inOwnWords = tessel::yesOrNoIn(text, translated(L"Yes"), translated(L"No"));
    return inOwnWords ? inOwnWords : tessel::yesOrNoIn(text);
}

// The full path, of a file that is there if it has to be.
Result<std::wstring> fileAt(const std::wstring& typed, bool mustExist)
{
    const std::filesystem::path path = tessel::toUtf8(typed);
    if (path.empty())
        return Failure{translated(L"This is no name of a file.")};
    std::error_code failed;
    if (mustExist && std::filesystem::is_directory(path, failed))
        return Failure{translated(L"\"{}\" is a folder and no file.", typed)};
    if (mustExist && !std::filesystem::is_regular_file(path, failed))
        return Failure{translated(L"There is no file \"{}\".", typed)};
    const auto full = std::filesystem::absolute(path, failed);
    if (failed)
        return Failure{translated(L"The current folder is gone: name the whole path.")};
    return tessel::toWide(full.lexically_normal().native());
}

// A default that has no room is refused each time that it is taken: the person is not bothered with it.
bool pathHasRoom(const std::wstring& byDefault, std::size_t capacity)
{
    const auto file = fileAt(tessel::pathIn(byDefault), false);
    return !file || hasRoom(*file, capacity);
}
} // namespace

int tsaskText(const wchar_t* question, const wchar_t* byDefault, wchar_t* answer, std::size_t capacity)
{
    if (!question || !answer || capacity == 0 || (byDefault && !hasRoom(byDefault, capacity)))
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
                       return Failure{translated(L"This is no number: \"{}\".", text)};
                   *answer = *number;
                   return {};
               });
}

int tsaskYesOrNo(const wchar_t* question, const bool* byDefault, bool* answer)
{
    if (!question || !answer)
        return TSASK_INVALID;
    const std::wstring yesInWords = translated(L"Yes");
    const std::wstring noInWords = translated(L"No");
    const auto shownDefault = byDefault ? std::optional(*byDefault ? yesInWords : noInWords) : std::nullopt;
    return ask({question, {yesInWords, noInWords}, shownDefault},
               [&](const std::wstring& text) -> Result<>
               {
                   const auto yes = yesOrNo(text);
                   if (!yes)
                       return Failure{translated(L"This is neither yes nor no: \"{}\".", text)};
                   *answer = *yes;
                   return {};
               });
}

int tsaskFile(const wchar_t* question, const wchar_t* byDefault, bool mustExist, wchar_t* path,
              std::size_t capacity)
{
    if (!question || !path || capacity == 0 || (byDefault && !pathHasRoom(byDefault, capacity)))
        return TSASK_INVALID;
    const auto which = mustExist ? Questions::File::kThere : Questions::File::kThereOrNew;
    return ask({question, {}, orNothing(byDefault), which},
               [&](const std::wstring& text) -> Result<>
               {
                   const auto file = fileAt(tessel::pathIn(text), mustExist);
                   return file ? copyInto(*file, path, capacity) : file.failure();
               });
}
