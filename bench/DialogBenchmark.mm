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

#include "bench/HistoryDialogBenchmark.h"
#include "bench/OpenDialog.h"
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
    const bench::OpenDialog dialog;
    [dialog.controller() setSaveHistory:YES];
    const double seconds =
        bench::secondsInPool([&] { [dialog.controller() loadedAppsTableViewDropFiles:paths atRow:0]; });
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
    const bench::OpenDialog dialog;
    const double seconds = bench::secondsInPool(
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
    const double seconds = bench::secondsInPool(
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
    const bench::OpenDialog dialog;
    [dialog.controller() setSaveHistory:YES];
    NSArray* files = [[dialog.controller() valueForKey:@"historyList"] arrangedObjects];
    const double seconds = bench::secondsInPool(
        [&] { [dialog.controller() loadApps:files successedApps:nil addToStartupSuit:NO]; });
    const bool all = dialog.rows(@"loadedApps") == entries;
    gLoadedAppList.RemoveAll();
    return all ? seconds : -1;
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
    for (const std::size_t files : {kFewFiles, kManyFiles})
        bench::measure(dropping(files), kRepetitions, [files] { return dropFiles(files); });
    const std::string naming = "name the files of a folder of 20000";
    for (const std::size_t files : {kFewListed, kManyListed})
        bench::measure(listing(files), kRepetitions, [files] { return listFolder(files); });
    bench::measure(naming, kRepetitions, [] { return nameFiles(kManyListed); });
    bench::addRatio({listing(kManyListed) + " / naming them", listing(kManyListed), naming, 2.3});
    bench::addRatio({"list, cost per file of 20000 / of 2000", listing(kManyListed), listing(kFewListed), 1.1,
                     kManyListed, kFewListed});
    for (const std::size_t entries : {kSomeRows, kManyRows})
        bench::measure(loading(entries), kRepetitions, [entries] { return loadHistory(entries); });
    bench::addRatio({"drop, cost per file of 50 / of 10", dropping(kManyFiles), dropping(kFewFiles), 1.0,
                     kManyFiles, kFewFiles});
    bench::addRatio({"load the History, cost per row of 5000 / of 500", loading(kManyRows),
                     loading(kSomeRows), 1.05, kManyRows, kSomeRows});
}
} // namespace

int main(int argc, char** argv)
try
{
    std::optional<VirtualDisplay> display;
    if (!std::getenv("DISPLAY"))
        setenv("DISPLAY", display.emplace().name().c_str(), 1);
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    bench::startHost();
    if (!tsuiPrepareWindows())
        return EXIT_FAILURE;
    // -part PART -entries COUNT -server PROCESS: the toolkit takes plain words for documents to open.
    if (argc == 7)
        return runHistoryPart(argv[2], std::strtoul(argv[4], nullptr, 10), std::stoi(argv[6]));
    addBenchmarks();
    addHistoryDialogBenchmarks(display ? display->server() : 0);
    const int missed = bench::runAll();
    [pool drain];
    return missed == 0 ? EXIT_SUCCESS : EXIT_FAILURE;
}
catch (const std::exception& error)
{
    std::cerr << error.what() << '\n';
    return EXIT_FAILURE;
}
