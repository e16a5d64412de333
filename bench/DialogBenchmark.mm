// Opening the dialog's tables with a long History, and dropping many files on one: real windows over the real
// host. Without a display the program starts one of its own.
#include <benchmark/benchmark.h>
#include <tessel/tsrxlinker.h>
#include <tesselui/tsuidisplay.h>
#include <tesselui/tsuieach.h>
#include <tesselui/tsuifilepanel.h>

#include <cstdlib>
#include <exception>
#include <filesystem>
#include <fstream>
#include <functional>
#include <iostream>
#include <optional>
#include <string>

#include "bench/Child.h"
#include "bench/Ratios.h"
#include "bench/Session.h"
#include "modrig/lists/Globals.h"
#include "tests/dialogs/support/VirtualDisplay.h"

#import <AppKit/AppKit.h>

#import "modrig/dialogs/ModrigController.h"
#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/Paths.h"

namespace
{
constexpr std::size_t kFewEntries = 1'000;
constexpr std::size_t kManyEntries = 10'000;
constexpr std::size_t kFewFiles = 10;
constexpr std::size_t kManyFiles = 50;
constexpr std::size_t kFewListed = 2'000;
constexpr std::size_t kManyListed = 20'000;
constexpr std::size_t kSomeRows = 500;
constexpr std::size_t kManyRows = 5'000;
constexpr int kRepetitions = 15;

void fillHistory(std::size_t count)
{
    gHistoryList.RemoveAll();
    for (std::size_t i = 0; i < count; ++i)
        gHistoryList.AddTail(L"/home/user/Applications/library" + std::to_wstring(i / 100) + L"/tool" +
                             std::to_wstring(i) + L".lsp");
}

// Of the first table that is not in the accessory view; 0 without one.
NSUInteger rowsOfTableIn(NSView* view, NSView* accessory)
{
    if ([view isKindOfClass:[NSTableView class]])
        return static_cast<NSUInteger>([(NSTableView*)view numberOfRows]);
    for (NSView* inner : tsuiEach<NSView*>([view subviews]))
        if (const NSUInteger rows = inner == accessory ? 0 : rowsOfTableIn(inner, accessory))
            return rows;
    return 0;
}

// The main dialog in its panel, set up as for a run, without the run.
class OpenDialog
{
public:
    OpenDialog() : mController([[ModrigController alloc] init]), mPanel(tsuiMakeFilePanel())
    {
        [mController setupOpenPanel:mPanel];
    }
    ~OpenDialog()
    {
        [mController cleanOpenPanel:mPanel];
        [mController release];
    }
    OpenDialog(const OpenDialog&) = delete;
    OpenDialog& operator=(const OpenDialog&) = delete;

    ModrigController* controller() const { return mController; }
    NSOpenPanel* panel() const { return mPanel; }
    NSUInteger filesShown() const { return rowsOfTableIn([mPanel contentView], [mPanel accessoryView]); }
    NSUInteger rows(NSString* table) const
    {
        return [[[mController valueForKey:table] arrangedObjects] count];
    }

private:
    ModrigController* mController;
    NSOpenPanel* mPanel;
};

// Runs `once` again and again; it answers the seconds of what it measures, negative when that went wrong.
void measure(const std::string& name, std::function<double()> once)
{
    const auto run = [once = std::move(once), name](benchmark::State& state)
    {
        for (auto iteration : state)
        {
            static_cast<void>(iteration);
            NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
            const double seconds = once();
            [pool drain];
            if (seconds < 0)
                state.SkipWithError((name + ": the table does not hold what it should").c_str());
            state.SetIterationTime(seconds);
        }
    };
    benchmark::RegisterBenchmark(name.c_str(), run)
        ->UseManualTime()
        ->Iterations(1)
        ->Repetitions(kRepetitions);
}

// In a pool of its own: giving back what the work has left behind is part of its cost.
double secondsInPool(const std::function<void()>& work)
{
    return bench::secondsOf(
        [&]
        {
            NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
            work();
            [pool drain];
        });
}

// What opening does for the History's table, in a dialog that has opened without one.
double openTable(std::size_t entries)
{
    gHistoryList.RemoveAll();
    const OpenDialog dialog;
    fillHistory(entries);
    const double seconds = secondsInPool([&] { [dialog.controller() populateHistoryList]; });
    return dialog.rows(@"historyList") == entries ? seconds : -1;
}

NSMutableArray* readyRows(std::size_t entries)
{
    fillHistory(entries);
    NSMutableArray* rows = [NSMutableArray array];
    for (NSString* path : tsuiEach<NSString*>(ModrigUtils::StringsFromPaths(gHistoryList)))
        [rows addObject:[[[ModrigFilePath alloc] initWithFilePathName:path] autorelease]];
    return rows;
}

NSArrayController* bareController()
{
    return [[[NSArrayController alloc] initWithContent:[NSMutableArray array]] autorelease];
}

// One by one, as the entries of the History come; nothing shows them.
double giveToBareController(std::size_t entries)
{
    NSArray* rows = readyRows(entries);
    NSArrayController* bare = bareController();
    const double seconds = secondsInPool(
        [&]
        {
            for (ModrigFilePath* row : tsuiEach<ModrigFilePath*>(rows))
                [bare addObject:row];
        });
    return [[bare arrangedObjects] count] == entries ? seconds : -1;
}

NSTableView* boundTable(NSArrayController* rows)
{
    NSTableView* table = [[[NSTableView alloc] initWithFrame:NSMakeRect(0, 0, 400, 200)] autorelease];
    for (NSString* key : {@"fileName", @"filePath"})
    {
        NSTableColumn* column = [[[NSTableColumn alloc] initWithIdentifier:key] autorelease];
        [table addTableColumn:column];
        [column bind:NSValueBinding
               toObject:rows
            withKeyPath:[@"arrangedObjects." stringByAppendingString:key]
                options:nil];
    }
    return table;
}

// All in one call, to the rows of a table with two columns that are bound to them.
double giveToBoundController(std::size_t entries)
{
    NSArray* rows = readyRows(entries);
    NSArrayController* bare = bareController();
    NSTableView* table = boundTable(bare);
    const double seconds = secondsInPool([&] { [bare addObjects:rows]; });
    const bool all = static_cast<std::size_t>([table numberOfRows]) == entries;
    for (NSTableColumn* column : tsuiEach<NSTableColumn*>([table tableColumns]))
        [column unbind:NSValueBinding];
    return all ? seconds : -1;
}

// Paths of modules that nothing has loaded.
NSArray* modulePaths(std::size_t count)
{
    const auto folder = bench::folderOfModules("dropped", count);
    NSMutableArray* paths = [NSMutableArray array];
    for (std::size_t i = 0; i < count; ++i)
        [paths addObject:ModrigUtils::StringFromPath(CStdStr(bench::wide(bench::moduleIn(folder, i))))];
    return paths;
}

void unload(NSArray* paths)
{
    TsRxDynamicLinker* linker = TsRxDynamicLinker::cast(tsrxSysRegistry()->at(TSRX_DYNAMIC_LINKER));
    for (const CStdStr& path : ModrigUtils::PathsFromStrings(paths))
        linker->unloadModule(path.c_str(), true);
    gLoadedAppList.RemoveAll();
}

// A drop on the table of loaded applications, with a row for each file in both tables.
double dropFiles(std::size_t files)
{
    gHistoryList.RemoveAll();
    NSArray* paths = modulePaths(files);
    const OpenDialog dialog;
    [dialog.controller() setSaveHistory:YES];
    const double seconds =
        secondsInPool([&] { [dialog.controller() loadedAppsTableViewDropFiles:paths atRow:0]; });
    const bool all = dialog.rows(@"loadedApps") == files && dialog.rows(@"historyList") == files;
    unload(paths);
    return all ? seconds : -1;
}

// A folder of so many Lisp files, made when it is not there yet.
NSString* folderOfFiles(std::size_t count)
{
    const auto folder = bench::workFolder() / ("listed" + std::to_string(count));
    if (std::filesystem::create_directories(folder))
        for (std::size_t i = 0; i < count; ++i)
            std::ofstream(folder / ("tool" + std::to_string(i) + ".lsp")).put('(');
    return ModrigUtils::StringFromPath(CStdStr(bench::wide(folder)));
}

// Shows the folder in the dialog's panel, which asks the controller about every file.
double listFolder(std::size_t files)
{
    NSString* folder = folderOfFiles(files);
    const OpenDialog dialog;
    const double seconds = secondsInPool(
        [&]
        {
            [dialog.panel() setDirectory:folder];
            [dialog.panel() URLs];
        });
    return dialog.filesShown() == files ? seconds : -1;
}

// What the toolkit takes to name the files of the folder and to tell the folders among them.
double nameFiles(std::size_t files)
{
    NSString* folder = folderOfFiles(files);
    NSFileManager* manager = [NSFileManager defaultManager];
    std::size_t found = 0;
    const double seconds = secondsInPool(
        [&]
        {
            BOOL isFolder = NO;
            for (NSString* name : tsuiEach<NSString*>([manager contentsOfDirectoryAtPath:folder
                                                                                   error:nullptr]))
                if ([manager fileExistsAtPath:[folder stringByAppendingPathComponent:name]
                                  isDirectory:&isFolder])
                    ++found;
        });
    return found == files ? seconds : -1;
}

std::string listing(std::size_t files)
{
    return "list a folder of " + std::to_string(files) + " files";
}

// Load with all rows of the History selected, each of which gets a row among the loaded applications.
double loadHistory(std::size_t entries)
{
    fillHistory(entries);
    gLoadedAppList.RemoveAll();
    const OpenDialog dialog;
    [dialog.controller() setSaveHistory:YES];
    NSArray* files = [[dialog.controller() valueForKey:@"historyList"] arrangedObjects];
    const double seconds =
        secondsInPool([&] { [dialog.controller() loadApps:files successedApps:nil addToStartupSuit:NO]; });
    const bool all = dialog.rows(@"loadedApps") == entries;
    gLoadedAppList.RemoveAll();
    return all ? seconds : -1;
}

std::string opening(std::size_t entries)
{
    return "open tables, History of " + std::to_string(entries);
}

std::string dropping(std::size_t files)
{
    return "drop " + std::to_string(files) + " files";
}

std::string loading(std::size_t entries)
{
    return "load " + std::to_string(entries) + " rows of the History";
}

void addBenchmarks()
{
    const std::string bare = "give 10000 rows to a bare array controller";
    const std::string bound = "give 10000 rows to one that a table is bound to";
    for (const std::size_t entries : {kFewEntries, kManyEntries})
        measure(opening(entries), [entries] { return openTable(entries); });
    measure(bare, [] { return giveToBareController(kManyEntries); });
    measure(bound, [] { return giveToBoundController(kManyEntries); });
    for (const std::size_t files : {kFewFiles, kManyFiles})
        measure(dropping(files), [files] { return dropFiles(files); });
    const std::string naming = "name the files of a folder of 20000";
    for (const std::size_t files : {kFewListed, kManyListed})
        measure(listing(files), [files] { return listFolder(files); });
    measure(naming, [] { return nameFiles(kManyListed); });
    bench::addRatio({listing(kManyListed) + " / naming them", listing(kManyListed), naming, 3});
    bench::addRatio({"list, cost per file of 20000 / of 2000", listing(kManyListed), listing(kFewListed), 2,
                     kManyListed, kFewListed});
    for (const std::size_t entries : {kSomeRows, kManyRows})
        measure(loading(entries), [entries] { return loadHistory(entries); });
    bench::addRatio({opening(kManyEntries) + " / bare array controller", opening(kManyEntries), bare, 2});
    bench::addRatio(
        {opening(kManyEntries) + " / the same with a table bound", opening(kManyEntries), bound, 2});
    bench::addRatio({"open tables, cost per entry at 10000 / at 1000", opening(kManyEntries),
                     opening(kFewEntries), 1.5, kManyEntries, kFewEntries});
    bench::addRatio({"drop, cost per file of 50 / of 10", dropping(kManyFiles), dropping(kFewFiles), 1.5,
                     kManyFiles, kFewFiles});
    bench::addRatio({"load the History, cost per row of 5000 / of 500", loading(kManyRows),
                     loading(kSomeRows), 1.5, kManyRows, kSomeRows});
}
} // namespace

int main()
try
{
    std::optional<VirtualDisplay> display;
    if (!std::getenv("DISPLAY"))
        setenv("DISPLAY", display.emplace().name().c_str(), 1);
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    bench::startHost();
    if (!tsuiPrepareWindows())
        return EXIT_FAILURE;
    addBenchmarks();
    const int missed = bench::runAll();
    [pool drain];
    return missed == 0 ? EXIT_SUCCESS : EXIT_FAILURE;
}
catch (const std::exception& error)
{
    std::cerr << error.what() << '\n';
    return EXIT_FAILURE;
}
