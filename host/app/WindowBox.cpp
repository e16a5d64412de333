#include "host/app/WindowBox.h"

#include <utility>

#include <dlfcn.h>

#include "host/applications/Admission.h"
#include "host/messages/platform/Desktop.h"

namespace tessel
{
namespace
{
constexpr char kLibrary[] = TESSEL_WINDOWS_LIBRARY; // the file's name on this platform
constexpr char kShowBox[] = "tsuiShowMessageBox";
constexpr char kCanShowWindows[] = "tsuiCanShowWindows";

using ShowBox = int (*)(const wchar_t* text, const wchar_t* detail, unsigned style, void* parent);
using CanShowWindows = bool (*)();

// Null when it cannot be found. Kept loaded to the end: a toolkit cannot be taken out of a process.
template <typename Function>
Function findFunction(const std::filesystem::path& library, const char* name)
{
    void* windows = dlopen(library.c_str(), RTLD_NOW | RTLD_LOCAL);
    return windows ? reinterpret_cast<Function>(dlsym(windows, name)) : nullptr;
}
} // namespace

bool canShowWindows(const std::filesystem::path& libraryFolder)
{
    const auto ask =
        hasDisplay() ? findFunction<CanShowWindows>(libraryFolder / kLibrary, kCanShowWindows) : nullptr;
    return ask && ask();
}

MessageBox::Presenter windowBoxes(const std::filesystem::path& libraryFolder)
{
    return [library = libraryFolder / kLibrary](const MessageBox::Box& box)
    {
        static const ShowBox showBox = hasDisplay() ? findFunction<ShowBox>(library, kShowBox) : nullptr;
        return showBox ? showBox(box.text.c_str(), box.detail.c_str(), box.style, box.parent) : 0;
    };
}

MessageBox::Presenter quietWhenSafe(MessageBox::Presenter show, const Admission& admission)
{
    return [show = std::move(show), &admission](const MessageBox::Box& box)
    {
        return admission.isSafe() && admission.marker().reason() == RunningMarker::Reason::kForAnother
                   ? 0
                   : show(box);
    };
}
} // namespace tessel
