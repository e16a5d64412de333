#include "tests/integration/ModrigUnderTest.h"

#include <algorithm>
#include <utility>

#include "modrig/lists/Globals.h"
#include "modrig/lists/History.h"
#include "modrig/loader/ApplicationLoader.h"
#include "modrig/loader/LoadedApplications.h"
#include "modrig/loader/StartupSuite.h"
#include "modrig/messages/MessageLine.h"
#include "modrig/module/DialogBridge.h"
#include "modrig/module/EntryPoint.h"
#include "modrig/types/FileValidation.h"

namespace ModrigUnderTest
{
namespace
{
std::function<void()> duringDialog;
Paths shownOnMessageLine;

Paths contentOf(const CStringList& list)
{
    Paths result;
    for (const CStdStr& path : list)
        result.push_back(path.Text());
    return result;
}

void replace(CStringList& list, const Paths& paths)
{
    list.RemoveAll();
    for (const std::wstring& path : paths)
        list.AddTail(path);
}
} // namespace

void playDialog(std::function<void()> actions)
{
    duringDialog = std::move(actions);
}

Paths messageLine()
{
    return std::exchange(shownOnMessageLine, {});
}

Paths loaded()
{
    return contentOf(gLoadedAppList);
}

Paths startup()
{
    return contentOf(gStartupList);
}

Paths history()
{
    return contentOf(gHistoryList);
}

void replaceStartup(const Paths& paths)
{
    replace(gStartupList, paths);
}

void replaceHistory(const Paths& paths)
{
    replace(gHistoryList, paths);
}

void populate()
{
    ModrigUtils::PopulateLoadedApps();
}

int load(const std::wstring& path, bool addToHistory, bool addToStartup)
{
    return ModrigUtils::PerformModrig(path, addToHistory, addToStartup ? 1 : 0, ModrigUtils::kReportFailure);
}

namespace
{
std::vector<std::size_t> unloadRows(const std::vector<ModrigUtils::UnloadCandidate>& rows)
{
    std::vector<std::size_t> unloaded;
    ModrigUtils::UnloadApplications(rows, [&](std::size_t index) { unloaded.push_back(index); });
    return unloaded;
}
} // namespace

std::vector<std::size_t> unload(const Paths& selection)
{
    std::vector<ModrigUtils::UnloadCandidate> rows;
    for (const std::wstring& path : selection)
        rows.push_back({path, mayBeUnloaded(path)});
    return unloadRows(rows);
}

std::vector<std::size_t> unloadAsListedUnloadable(const Paths& selection)
{
    std::vector<ModrigUtils::UnloadCandidate> rows;
    for (const std::wstring& path : selection)
        rows.push_back({path, true});
    return unloadRows(rows);
}

bool mayBeUnloaded(const std::wstring& path)
{
    return ModrigUtils::IsAppUnloadAble(path);
}

void close()
{
    ModrigUtils::WriteStartupFilesToRegistry();
    ModrigUtils::WriteHistoryFilesToRegistry();
    ModrigUtils::updateRegistry();
}

bool isLoaded(const std::wstring& path)
{
    return ModrigUtils::ApplicationIsLoaded(path);
}

DWORD findFile(std::wstring& path)
{
    CStdStr rewritten(path);
    const DWORD attributes = ModrigUtils::ValidateFileExists(rewritten);
    path = rewritten.Text();
    return attributes;
}

void fetch(std::wstring& path)
{
    CStdStr rewritten(path);
    ModrigUtils::ValidateURLFile(rewritten, nullptr);
    path = rewritten.Text();
}

bool isTemporaryInternetFile(const std::wstring& path)
{
    return ModrigUtils::IsTempInternetFile(path);
}
} // namespace ModrigUnderTest

namespace ModrigUtils
{
void SetDialogMessage(const CStdStr& text)
{
    ModrigUnderTest::shownOnMessageLine.push_back(text.Text());
}

void RunModrigDialog()
{
    if (ModrigUnderTest::duringDialog)
        ModrigUnderTest::duringDialog();
}
} // namespace ModrigUtils
