// DISABLE, ENABLE, BISECT: which applications are loaded at starts.
#include <algorithm>

#include "host/app/BuiltIn.h"
#include "host/app/BuiltInSupport.h"
#include "host/app/Parts.h"

namespace tessel
{
namespace
{
constexpr wchar_t kApplicationsGroup[] = L"Applications";

// The name alone is enough for what is loaded.
std::wstring pathToKeepOut(const Parts& parts, const std::wstring& typed)
{
    const std::wstring module = parts.linker->pathOfModule(typed);
    return module.empty() ? fullPath(parts, typed) : module;
}

// The name alone is enough for what is kept out.
std::wstring pathToLetIn(const Parts& parts, const std::wstring& typed)
{
    const auto& all = parts.keptOut.all();
    const auto named = std::ranges::find_if(
        all, [&](const KeptOutApplication& application)
        { return equalIgnoringCase(toText(toPath(toWide(application.path)).filename()), typed); });
    return named == all.end() ? fullPath(parts, typed) : toWide(named->path);
}

Result<> disable(Parts& parts, const CommandStack::Arguments& arguments)
{
    if (arguments.size() != 1)
        return wrongUsage(parts, L"DISABLE");
    const std::wstring path = pathToKeepOut(parts, arguments.front());
    if (auto kept = parts.keptOut.keepOut(toUtf8(path)); !kept)
        return kept;
    return succeed(parts, path + L" is kept out at starts from now on; ENABLE lets it in again.");
}

Result<> enable(Parts& parts, const CommandStack::Arguments& arguments)
{
    if (arguments.size() != 1)
        return wrongUsage(parts, L"ENABLE");
    const std::wstring path = pathToLetIn(parts, arguments.front());
    if (auto let = parts.keptOut.letIn(toUtf8(path)); !let)
        return let;
    return succeed(parts, path + L" is loaded at starts again.");
}
Result<std::wstring> runBisect(Parts& parts, const std::wstring& word)
{
    if (equalIgnoringCase(word, L"START"))
        return parts.bisecting.begin(parts.admission.suspects());
    if (equalIgnoringCase(word, L"GOOD"))
        return parts.bisecting.answer(true);
    if (equalIgnoringCase(word, L"BAD"))
        return parts.bisecting.answer(false);
    if (equalIgnoringCase(word, L"STOP"))
        return parts.bisecting.stop();
    return word.empty() ? parts.bisecting.tell() : wrongUsage(parts, L"BISECT");
}

Result<> bisect(Parts& parts, const CommandStack::Arguments& arguments)
{
    if (arguments.size() > 1)
        return wrongUsage(parts, L"BISECT");
    const auto said = runBisect(parts, arguments.empty() ? std::wstring() : arguments.front());
    return said ? succeed(parts, *said) : said.failure();
}
} // namespace

void addKeptOutCommands(Parts& parts)
{
    addBuiltIn(parts,
               {kApplicationsGroup, L"DISABLE", L"file",
                L"Keeps an application out at starts; it stays in every list"},
               disable);
    addBuiltIn(parts,
               {kApplicationsGroup, L"ENABLE", L"file",
                L"Lets an application in again that was disabled or that ended Tessel"},
               enable);
    addBuiltIn(parts,
               {kApplicationsGroup, L"BISECT", L"[START|GOOD|BAD|STOP]",
                L"Finds the application that makes trouble, in a few starts"},
               bisect);
}
} // namespace tessel
