// The dialog in the real host, as a person uses it: commands typed at a terminal, mouse and keyboard on a
// desktop.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include <gmock/gmock.h>

#include "tests/e2e/HostTerminal.h"
#include "tests/ui/e2e/Desktop.h"

inline constexpr char kDialogTitle[] = "Load/Unload Applications";
inline constexpr char kSuiteTitle[] = "Startup Suite";
inline constexpr char kAlertTitle[] = "Alert";
inline constexpr char kModuleKey[] = R"(Software\Tessel\R21\Profiles\Default\Dialogs\Modrig)";
inline constexpr char kSettingsKey[] = R"(Software\Tessel\R21\Profiles\Default\DialogSettings\Modrig)";

// Places in the dialog, from the upper left corner of its inside. They follow from the layout (Modrig.xib)
// and from the panel around it at its first size.
namespace places
{
inline constexpr Point kFileTypes = {235, 390};
inline constexpr Point kAddToHistory = {383, 390};
inline constexpr Point kLoad = {676, 391};
inline constexpr Point kLoadedTab = {106, 426};
inline constexpr Point kHistoryTab = {219, 426};
inline constexpr Point kUnload = {470, 646};
inline constexpr Point kHistoryLoad = {72, 646};
inline constexpr Point kHistoryAdd = {206, 646};
inline constexpr Point kHistoryRemove = {470, 646};
inline constexpr Point kStartupSuiteBox = {636, 540};
inline constexpr Point kContents = {636, 635};
inline constexpr Point kHelp = {50, 750};
inline constexpr Point kClose = {705, 750};
inline constexpr Point kCloseButtonOfFrame = {739, -10};

// Row 0 is the first.
inline constexpr Point row(int index)
{
    return {72, 479 + 18 * index};
}
inline constexpr Point belowRows()
{
    return {200, 600};
}
// A file in the folder that the panel shows, in the order of their names.
inline constexpr Point fileInPanel(int index)
{
    return {570, 106 + 15 * index};
}
inline constexpr Point fileType(int index)
{
    return {160, 390 + 26 * index};
}
// In the Startup Suite's window.
inline constexpr Point kSuiteAdd = {31, 331};
inline constexpr Point kSuiteRemove = {67, 331};
inline constexpr Point suiteRow(int index)
{
    return {60, 83 + 18 * index};
}
} // namespace places

class DialogByHand : public testing::Test
{
protected:
    void SetUp() override;
    void TearDown() override;

    // A copy of a sample, or a small Lisp file, in the folder that the dialog opens in.
    std::filesystem::path sample(const std::string& name);
    std::filesystem::path lispFile(const std::string& name);
    std::filesystem::path brokenModule(const std::string& name);

    // A value of the registry, with the host not running; what is not stored is an empty text.
    void store(const std::string& key, const std::string& name, const std::string& data);
    std::string stored(const std::string& key, const std::string& name);
    void storeHistory(const std::vector<std::filesystem::path>& files);

    void startHost();
    void type(const std::string& command);
    bool says(const std::string& text) { return mTerminal->shows(text); }
    void quit();

    void openDialog();
    void closeDialog();
    // Answers the message box that is to come.
    void answerAlert(const std::string& picture);
    Point inDialog(Point place) const { return mDialog + place; }
    void click(Point place) { mDesktop->click(inDialog(place)); }
    void clickToo(Point place) { mDesktop->clickToo(inDialog(place)); }
    void picture(const std::string& name) { mDesktop->picture(name); }

    std::filesystem::path folder() const { return mSession->folder().path() / "work"; }

    std::unique_ptr<Desktop> mDesktop;
    std::unique_ptr<HostSession> mSession;
    std::unique_ptr<HostTerminal> mTerminal;
    Point mDialog;
};
