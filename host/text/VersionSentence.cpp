#include "host/text/Translation.h"
#include "host/text/Version.h"

namespace tessel
{
std::wstring programSentence()
{
    return translated(L"Tessel R21, reference host for Modrig");
}

std::wstring versionSentence()
{
    return translated(L"{}, version {}", programSentence(), toWide(version()));
}
} // namespace tessel
