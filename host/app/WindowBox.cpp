#include "host/app/WindowBox.h"

#include <utility>

#include "host/app/WindowsLibrary.h"
#include "host/applications/Admission.h"
#include "host/messages/platform/Desktop.h"

namespace tessel
{
namespace
{
constexpr char kShowBox[] = "tsuiShowMessageBox";
constexpr char kCanShowWindows[] = "tsuiCanShowWindows";
constexpr char kExpectSomebody[] = "tsuiExpectSomebody";

using ShowBox = int (*)(const wchar_t* text, const wchar_t* detail, unsigned style, void* parent);
using CanShowWindows = bool (*)();
using ExpectSomebody = void (*)();

// Without a display nothing is found, and the library is not loaded.
template <class Function>
Function findAtDisplay(const std::filesystem::path& libraryFolder, const char* name)
{
    return hasDisplay() ? findWindowsFunction<Function>(libraryFolder, name) : nullptr;
}
} // namespace

bool canShowWindows(const std::filesystem::path& libraryFolder)
{
    const auto ask = findAtDisplay<CanShowWindows>(libraryFolder, kCanShowWindows);
    return ask && ask();
}

void expectSomebodyAtTheDisplay(const std::filesystem::path& libraryFolder)
{
    if (const auto expect = findAtDisplay<ExpectSomebody>(libraryFolder, kExpectSomebody))
        expect();
}

MessageBox::Presenter windowBoxes(const std::filesystem::path& libraryFolder)
{
    return [libraryFolder](const MessageBox::Box& box)
    {
        static const auto showBox = findAtDisplay<ShowBox>(libraryFolder, kShowBox);
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
