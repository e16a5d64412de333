#include "host/app/WindowQuestions.h"

#include <utility>

#include "host/app/WindowsLibrary.h"

namespace tessel
{
namespace
{
using HasOpenWindow = bool (*)();
using AskInWindow = bool (*)(const QuestionWindows::Asked& asked);
} // namespace

WindowQuestions::WindowQuestions(std::filesystem::path libraryFolder)
    : mLibraryFolder(std::move(libraryFolder))
{
}

bool WindowQuestions::areOpen() const
{
    const auto hasOpenWindow =
        findWindowsFunction<HasOpenWindow>(mLibraryFolder, "tsuiHasOpenWindow", RTLD_NOLOAD);
    return hasOpenWindow && hasOpenWindow();
}

bool WindowQuestions::ask(const Asked& asked) const
{
    const auto askInWindow = findWindowsFunction<AskInWindow>(mLibraryFolder, "tsuiAskInWindow", RTLD_NOLOAD);
    return askInWindow && askInWindow(asked);
}
} // namespace tessel
