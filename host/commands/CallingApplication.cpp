#include "host/commands/CallingApplication.h"

#include <algorithm>

#include <tessel/tsed.h>
#include <tessel/tsedcommands.h>

#include "host/text/Running.h"
#include "host/text/Unicode.h"

namespace tessel
{
CallingApplication::Scope::Scope(CallingApplication& calls, const std::wstring& path, Deed deed,
                                 const std::wstring& detail, CommandCall* command)
    : mCalls(calls), mMark(calls.mMarker, deed, toUtf8(path), toUtf8(detail))
{
    mCalls.mCalled.push_back({path, command});
}

const std::wstring& CallingApplication::path() const
{
    static const std::wstring none;
    return mCalled.empty() ? none : mCalled.back().path;
}

CommandCall* CallingApplication::command() const
{
    return mCalled.empty() ? nullptr : mCalled.back().command;
}

bool CallingApplication::isAtWork(std::wstring_view path) const
{
    return std::ranges::find(mCalled, path, &Called::path) != mCalled.end();
}
} // namespace tessel

const wchar_t* tsedGetAppName()
{
    const auto* calls = tessel::running<tessel::CallingApplication>();
    return calls ? calls->path().c_str() : L"";
}

TsResultBuffer* tsedCommandArguments()
{
    const auto* calls = tessel::running<tessel::CallingApplication>();
    const auto* command = calls ? calls->command() : nullptr;
    TsResultBuffer* list = nullptr;
    TsResultBuffer** end = &list;
    if (!command)
        return nullptr;
    for (const std::wstring& argument : command->arguments)
    {
        *end = tsutBuildList({TsRbValue::String(argument.c_str())});
        end = &(*end)->next;
    }
    return list;
}

void tsedFailCommand(const wchar_t* sentence)
{
    const auto* calls = tessel::running<tessel::CallingApplication>();
    if (auto* command = calls ? calls->command() : nullptr)
        command->failure = sentence ? sentence : L"";
}
