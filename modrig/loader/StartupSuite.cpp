#include "modrig/loader/StartupSuite.h"

#include "modrig/lists/Globals.h"
#include "modrig/lists/StoredList.h"
#include "modrig/loader/ApplicationLoader.h"
#include "modrig/loader/LoadedApplications.h"
#include "modrig/types/ApplicationTypes.h"

namespace ModrigUtils
{
namespace
{
// A compiled module is asked for once; a Lisp file is evaluated again at every start. Whatever else stands in
// the Suite goes to the loader too, which says what is wrong with it.
void LoadStartupApplication(const CStdStr& path)
{
    if (!path.HasDot())
        return;
    if (FileTypeOfPath(path) == kCompiledModule && ApplicationIsLoaded(path))
        return;
    // What became of it the loader has told the user; the next application is loaded in any case.
    static_cast<void>(PerformModrig(path, kDoNotAddToHistory, kLoadAll, kReportFailure));
}
} // namespace

void InitializeStartupFiles()
{
    gbOrreryLoaded = false;
    ReadStoredList(kStoredStartupSuite, gStartupList, LoadStartupApplication);
}

void WriteStartupFilesToRegistry()
{
    WriteStoredList(kStoredStartupSuite, gStartupList);
}
} // namespace ModrigUtils
