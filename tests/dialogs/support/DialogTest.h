// What the tests of the dialogs share: the module's lists and texts over a recording host, real files in a
// folder of their own, and dialogs that are opened, used and closed.
#pragma once

#include "tests/support/ModuleTest.h"

#include <functional>
#include <memory>
#include <vector>

#include "modrig/lists/Globals.h"
#include "tests/support/TemporaryFolder.h"

#import <AppKit/AppKit.h>

#import "modrig/dialogs/ModrigController.h"

#include "modrig/dialogs/model/ShownTab.h"

using ModrigUtils::kHistoryTab;
using ModrigUtils::kLoadedApplicationsTab;

// Places in the list of file types.
inline constexpr NSUInteger kAllFileTypes = 0;
inline constexpr NSUInteger kBundleFileType = 1;
inline constexpr NSUInteger kLispFileType = 3;

std::wstring wide(NSString* text);
NSString* text(const std::wstring& wide);

class DialogTest : public ModuleTest
{
protected:
    void SetUp() override;
    void TearDown() override;

    // The path of a file of the test's folder, written when it is new.
    std::wstring file(const std::string& name);
    NSString* path(const std::string& name);
    NSArray* paths(std::initializer_list<std::string> names);

    // A module that the host has loaded.
    std::wstring loadedModule(const std::string& name);

    // Puts files of the test's folder into a list: those, or more than a table shows at once.
    void fill(CStringList& list, std::initializer_list<std::string> names);
    void fillWithMany(CStringList& list);
    static constexpr int kMany = 60;

    TemporaryFolder mFolder;

private:
    NSAutoreleasePool* mPool = nil;
};

class ModalStep;

// The main dialog in its panel, set up as for a run, without the run.
class OpenDialogTest : public DialogTest
{
protected:
    void TearDown() override;

    // Opens the dialog with what the lists hold now.
    void open();
    // The same with a controller of a test's own, which is given away.
    void openWith(ModrigController* controller);
    void close();
    // Puts it on the screen, as while it runs.
    void show();
    // Opens and shows it with the files in its History, which is in front.
    void openHistory(std::initializer_list<std::string> names);
    // Runs the dialog; after the steps it is cancelled.
    void runDialog(std::vector<ModalStep> steps);

    ModrigController* mController = nil;
    NSOpenPanel* mPanel = nil;

    NSArrayController* loadedApps() { return [mController valueForKey:@"loadedApps"]; }
    NSArrayController* historyList() { return [mController valueForKey:@"historyList"]; }
    NSTableView* loadedTable() { return [mController valueForKey:@"loadedAppsTableView"]; }
    NSTableView* historyTable() { return [mController valueForKey:@"historyListTableView"]; }
    NSArrayController* fileTypes() { return [mController valueForKey:@"fileTypes"]; }
    // The paths of what Load will load.
    std::vector<std::wstring> selectedFiles();
    // What the message line says.
    std::wstring message() { return wide([mController message]); }

    // What the user does.
    void select(NSTableView* table, std::initializer_list<NSUInteger> rows);
    // As if the panel had reported the files as selected.
    void selectFiles(std::initializer_list<std::string> names);
    // The same, and then Load.
    void load(std::initializer_list<std::string> names);
    // In the list of file types, at this place.
    void chooseFileType(NSUInteger place);

    // Shows a message box over the dialog, which is over when what it consists of was looked at.
    void lookAtMessageBox(const wchar_t* text, const wchar_t* detail, std::function<void(NSView* box)> look);
};

// The paths of the rows of a table.
std::vector<std::wstring> rowsOf(NSArrayController* rows);
// The selected ones.
std::vector<std::wstring> selectionOf(NSArrayController* rows);

// One thing that a user does while a window runs modally. A step that answers false is not ready: what it
// waits for is still to come, and it is asked again.
class ModalStep
{
public:
    template <class Function> ModalStep(Function function)
    {
        if constexpr (std::is_same_v<bool, decltype(function())>)
            mRun = function;
        else
            mRun = [function]
            {
                function();
                return true;
            };
    }
    bool run() const { return mRun(); }

private:
    std::function<bool()> mRun;
};

// Runs the steps, one after another, inside the modal run that is going on then. Steps that nothing runs are
// a failure of the test, reported when the object goes; a step that never gets ready ends the program.
class ModalSteps
{
public:
    explicit ModalSteps(std::vector<ModalStep> steps);
    ~ModalSteps();
    ModalSteps(const ModalSteps&) = delete;
    ModalSteps& operator=(const ModalSteps&) = delete;

private:
    const std::vector<ModalStep> mSteps;
    id mRunner;
};

// The panel of the main dialog that is running.
NSOpenPanel* runningPanel();

// The parts of a file panel.
NSTableView* fileTable(NSOpenPanel* panel);
NSTextField* nameField(NSOpenPanel* panel);
// What its table shows in its first column.
std::vector<std::wstring> filesShownIn(NSOpenPanel* panel);
// Selects the files of these names in its table, as the keyboard does.
void selectFilesIn(NSOpenPanel* panel, std::initializer_list<const wchar_t*> names);
// Types into its name field in place of what stands there.
void typeNameInto(NSOpenPanel* panel, NSString* name);

// A click of the mouse on a row of a table that shows.
void clickRow(NSTableView* table, NSInteger row, NSUInteger modifiers = 0, NSInteger clicks = 1);

// A key, as the window that has the keyboard gets it.
void pressKey(NSWindow* window, NSString* characters, NSUInteger modifiers = 0);

// A panel that answers these as what is selected in it.
id panelWithSelected(NSArray* paths);

// A drag of files, as a drop target sees it.
id<NSDraggingInfo> dragOf(NSArray* paths);
// The same with the pointer there, in the view's coordinates.
id<NSDraggingInfo> dragOver(NSView* view, NSPoint place, NSArray* paths);
