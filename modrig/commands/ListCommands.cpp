#include "modrig/commands/ListCommands.h"

#include <tessel/tsedcommands.h>
#include <wincompat/winfile.h>
#include <wincompat/winreg.h>

#include <vector>

#include "modrig/commands/CommandTexts.h"
#include "modrig/commands/JsonText.h"
#include "modrig/commands/KeptList.h"
#include "modrig/commands/ModrigInSession.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/messages/ResourceOverride.h"

namespace ModrigUtils
{
namespace
{
using Texts = std::vector<CStdStr>;

Texts TypedArguments()
{
    Texts arguments;
    TsResultBuffer* list = tsedCommandArguments();
    for (const TsResultBuffer* value = list; value; value = value->next)
        arguments.emplace_back(value->value.string);
    tsutRelRb(list);
    return arguments;
}

void Print(const std::wstring& line)
{
    tsutPrintf(L"%s\n", line.c_str());
}

bool IsThere(const CStdStr& path)
{
    return GetFileAttributesW(path.c_str()) != INVALID_FILE_ATTRIBUTES;
}

std::wstring TrueOrFalse(bool value)
{
    return value ? L"true" : L"false";
}

void PrintAsText(const KeptList& list)
{
    const std::vector<bool> isLaidDown = WhichAreLaidDown(list);
    std::size_t place = 0;
    for (const CStdStr& path : list.files)
    {
        ++place;
        CStdStr line = CStdStr(std::to_wstring(place)) + CStdStr(L"  ") + path;
        if (!IsThere(path))
            line = line + CStdStr::OfId(ModrigMessages::kEntryNotThere);
        if (isLaidDown[place - 1])
            line = line + CStdStr::OfId(ModrigMessages::kEntryLaidDown);
        Print(line.Text());
    }
    if (list.files.IsEmpty())
        Print(CStdStr::Formatted(ModrigMessages::kListIsEmpty, CStdStr::OfId(list.inText).c_str()).Text());
}

void PrintAsJson(const KeptList& list)
{
    std::wstring text = L"{\"list\": " + InJson(list.token) + L", \"files\": [";
    const std::vector<bool> isLaidDown = WhichAreLaidDown(list);
    std::size_t place = 0;
    for (const CStdStr& path : list.files)
    {
        ++place;
        text += std::wstring(place == 1 ? L"" : L", ") + L"{\"place\": " + std::to_wstring(place) +
                L", \"path\": " + InJson(path.Text()) + L", \"isThere\": " + TrueOrFalse(IsThere(path)) +
                L", \"isLaidDown\": " + TrueOrFalse(isLaidDown[place - 1]) + L"}";
    }
    Print(text + L"]}");
}

// Empty when it is stored, and Modrig will read it.
CStdStr Store(const KeptList& list, bool& modrigWaits)
{
    if (CStdStr reason = WhyNobodyCanChange(list); !reason.IsEmpty())
        return reason;
    const ModrigOutOfService modrig;
    if (!modrig.succeeded())
        return CStdStr::Formatted(ModrigMessages::kModrigStays, CStdStr::OfId(list.nameText).c_str());
    modrigWaits = modrig.waitsForItsCommand();
    if (!StoreList(list.names, list.files))
        return CStdStr::OfId(ModrigMessages::kListNotStored);
    if (list.isLoadedAtStart)
        UpdateRecordOfModrig(!list.files.IsEmpty());
    if (RegFlushKey(HKEY_CURRENT_USER) != ERROR_SUCCESS)
        return CStdStr::OfId(ModrigMessages::kListNotStored);
    return {};
}

struct Request
{
    std::wstring action;
    Texts files;
    bool asJson = false;
};

Request RequestOf(const Texts& arguments)
{
    Request request;
    if (arguments.empty())
        return request;
    request.action = arguments.front().Text();
    request.files.assign(arguments.begin() + 1, arguments.end());
    request.asJson = !request.files.empty() && request.files.back() == CStdStr(L"--json");
    if (request.asJson)
        request.files.pop_back();
    return request;
}

bool Is(const Request& request, const wchar_t* action, bool takesFiles)
{
    return CStdStr(request.action).EqualsNoCase(action) && request.files.empty() != takesFiles;
}

// The request, done to the list in memory; nothing when it is not one of the command's.
std::optional<Change> Apply(const KeptList& list, const Request& request)
{
    if (Is(request, L"LIST", false))
        return Change();
    if (Is(request, L"CLEAR", false))
        return RemoveAllFiles(list);
    if (Is(request, L"ADD", true))
        return AddFiles(list, request.files);
    if (Is(request, L"REMOVE", true))
        return RemoveFiles(list, request.files);
    if (Is(request, L"MOVE", true) && request.files.size() == 2 && list.isLoadedAtStart)
        return MoveFile(request.files[0], request.files[1]);
    return std::nullopt;
}

void Tell(const KeptList& list, const Request& request, const Change& change, bool modrigWaits)
{
    if (request.asJson)
        return PrintAsJson(list);
    if (Is(request, L"LIST", false))
        return PrintAsText(list);
    Print(change.told.Text());
    if (modrigWaits)
        Print(CStdStr::OfId(ModrigMessages::kModrigIsOut).Text());
}

void Run(const KeptList& list)
{
    const CTemporaryResourceOverride texts(CTemporaryResourceOverride::m_hInstanceDefault);
    const Request request = RequestOf(TypedArguments());
    const CStdStr unread = ReadKept(list);
    const Texts before(list.files.begin(), list.files.end());
    const auto change = Apply(list, request);
    if (!change)
        return tsedFailCommand(nullptr);
    if (!unread.IsEmpty())
        return tsedFailCommand(unread.c_str());
    if (!change->refused.IsEmpty())
        return tsedFailCommand(change->refused.c_str());
    bool modrigWaits = false;
    const bool isChanged = Texts(list.files.begin(), list.files.end()) != before;
    if (const CStdStr reason = isChanged ? Store(list, modrigWaits) : CStdStr(); !reason.IsEmpty())
        return tsedFailCommand(reason.c_str());
    Tell(list, request, *change, modrigWaits);
}

// What cannot be read is told by the command.
TsResultBuffer* Entries(const KeptList& list)
{
    static_cast<void>(ReadKept(list));
    TsResultBuffer* entries = nullptr;
    TsResultBuffer** end = &entries;
    for (const CStdStr& path : list.files)
    {
        *end = tsutBuildList({TsRbValue::String(path.c_str())});
        end = &(*end)->next;
    }
    return entries;
}
} // namespace

void RunSuite()
{
    Run(KeptStartupSuite());
}

void RunHistory()
{
    Run(KeptHistory());
}

TsResultBuffer* SuiteEntries()
{
    return Entries(KeptStartupSuite());
}

TsResultBuffer* HistoryEntries()
{
    return Entries(KeptHistory());
}
} // namespace ModrigUtils
