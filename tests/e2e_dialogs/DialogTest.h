// The real host with its dialog open, in a throwaway profile, on a display of its own.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/e2e/HostProcess.h"
#include "tests/e2e_dialogs/Places.h"
#include "tests/e2e_dialogs/Program.h"
#include "tests/e2e_dialogs/Screen.h"
#include "tests/e2e_dialogs/Waiting.h"

inline constexpr char kDialog[] = "Load/Unload Applications";
inline constexpr char kSuiteDialog[] = "Startup Suite";
inline constexpr char kAddPanel[] = "Add to Startup Suite";
inline constexpr char kMessageBox[] = "Tessel";
inline constexpr char kDialogsKey[] = R"(Software\Tessel\R21\Profiles\Default\Dialogs\Modrig)";
inline constexpr char kSettingsKey[] = R"(Software\Tessel\R21\Profiles\Default\DialogSettings\Modrig)";

inline constexpr Place kDragButton{50, 30}; // in the window that files are dragged from

class DialogTest : public testing::Test
{
protected:
    explicit DialogTest(DisplayKind kind = {});

    // The folder that the dialog opens in, and what lies there: Lisp that prints "<name> runs".
    std::filesystem::path files() const { return mSession.folder() / "files"; }
    std::string writeLisp(const std::string& name) const;
    std::string copySample(const std::string& name) const;
    std::vector<std::string> writeManyLisp(int count) const;
    // A file that looks like a module and is none.
    std::string writeBroken(const std::string& name = "broken.zmb") const;

    // Runs commands in a host that loads nothing, before or after the one with the dialog.
    std::string runQuietly(const std::vector<std::string>& commands) const;
    void setSetting(const std::string& name, const std::string& value) const;
    // A setting of the toolkit, as the profile keeps it.
    void setToolkitSetting(const std::string& name, const std::string& value) const;
    void storeHistory(const std::vector<std::string>& paths) const;
    void storeSuite(const std::vector<std::string>& paths) const;
    // The stored list as REGISTRY LIST shows it.
    std::string stored(const std::string& list) const;
    std::string storedSetting(const std::string& name) const;

    // Starts the host, and types MODRIG into it.
    void open();
    // The same with these files in the History, which is in front.
    void openWithHistory(const std::vector<std::string>& paths);
    // Types MODRIG into the running host once more.
    void openAgain();
    // Closes the dialog by Escape; answers what the host printed up to its end, with APPS asked last.
    std::string closeAndEnd();
    std::string end();

    void click(Place place) const { mScreen.click(mDialog, place); }
    void press(const std::string& key, int times = 1) const;
    std::string look(Place place) const { return mScreen.look(mDialog, place); }
    // Waits until the place does not look as before.
    bool changes(Place place, const std::string& before) const;
    // Selects the file in a row of the list and presses Load; it has to be this one, and to be loaded.
    void loadFile(int row, const std::string& name) const;
    // Presses Load for a file in a row of the list that a message box is about.
    void loadBroken(int row) const;
    // Opens the dialog with a message box over it, about a file that is no module; answers the box.
    std::string openMessageBox();
    // Opens the Startup Suite over the dialog, with the mouse.
    void openSuite();
    // Types a name into the name field, which is empty so far.
    void typeName(const std::string& name) const;
    // Takes a picture, <test>-<step>.png, when the environment asks for one of every step.
    void shoot(const std::string& step) const;
    // What is on the screen when a test has failed: <test>-failed.png.
    void TearDown() override;
    // Waits until the host has printed the text.
    bool prints(const std::string& text) const;
    // Waits for a message box and ends it.
    void dismissMessageBox() const;

    // Drags the files from a program of another toolkit to a place in the dialog. That program lives until
    // the effect has been waited for.
    void dragFiles(const std::vector<std::string>& paths, Place place,
                   const std::function<void()>& effect) const;
    // The program that files are dragged from, at the left upper edge of the screen.
    std::unique_ptr<Program> dragSource(const std::vector<std::string>& paths) const;
    std::string dragWindow() const;

    Screen mScreen;
    HostSession mSession;
    std::unique_ptr<Program> mHost;
    std::string mDialog;
    std::string mSuite;
};

// What loading a file of `writeLisp` says on the way.
std::string wasLoaded(const std::string& name);
// The name and the folder of a path, as APPS lists them.
std::string listedIn(const std::string& name, const std::filesystem::path& folder);
