#include "tests/support/RecordingHost.h"

#include <cwchar>
#include <memory>
#include <utility>

#include "tests/support/recording/RecordingLoans.h"

namespace
{
constexpr const wchar_t* kFirstProfile = L"Default";
}

RecordingHost::RecordingHost()
{
    setProfile(kFirstProfile);
}

void RecordingHost::reset()
{
    recording_loans::forgetAll();
    // Made again in place: the parts keep their addresses, which a module under test may have kept.
    std::destroy_at(this);
    std::construct_at(this);
}

void RecordingHost::setProfile(const std::wstring& name)
{
    mProfile = name;
    const std::wstring profiles = applicationServices.registryRoot + L"\\Profiles";
    if (name.empty())
        registry.removeValue(profiles, L"");
    else
        registry.setValue(profiles, L"", name);
}

std::wstring RecordingHost::moduleKey() const
{
    return applicationServices.registryRoot + L"\\Profiles\\" + mProfile + L"\\Dialogs\\Modrig";
}

RecordingHost& recordingHost()
{
    static RecordingHost host;
    return host;
}

RecordingCaller::RecordingCaller(std::wstring path)
    : mPrevious(std::exchange(recordingHost().loadedModules.applicationName, std::move(path)))
{
}

RecordingCaller::~RecordingCaller()
{
    recordingHost().loadedModules.applicationName = mPrevious;
}

bool copyText(const std::wstring& text, wchar_t* buffer, std::size_t capacity)
{
    if (!buffer || text.size() >= capacity)
        return false;
    std::wmemcpy(buffer, text.c_str(), text.size() + 1);
    return true;
}
