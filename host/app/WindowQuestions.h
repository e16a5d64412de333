// Questions of applications in windows, from the library of the host's windows.
#pragma once

#include <filesystem>

#include "host/messages/Questions.h"

namespace tessel
{
class WindowQuestions : public QuestionWindows
{
public:
    // The library stands in that folder. It is not loaded for this: where it is not there, no window is open.
    explicit WindowQuestions(std::filesystem::path libraryFolder);

    bool areOpen() const override;
    bool ask(const Asked& asked) const override;

private:
    std::filesystem::path mLibraryFolder;
};
} // namespace tessel
