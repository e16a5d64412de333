#include "bench/HistoryDialogBenchmark.h"

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <vector>

#include <limits.h>
#include <malloc.h>
#include <unistd.h>

#import <AppKit/AppKit.h>
#import <tesselui/TsUIPersistentStore.h>

#include "bench/Child.h"
#include "bench/HistoryFiles.h"
#include "bench/OpenDialog.h"
#include "bench/Ratios.h"
#include "bench/Session.h"
#include "bench/ShownWindow.h"
#include "modrig/dialogs/Settings.h"
#include "modrig/dialogs/model/ShownTab.h"

#import "modrig/dialogs/ModrigFilePath.h"

using bench::Files;

namespace
{
constexpr std::size_t kMany = 10'000;
constexpr std::size_t kVeryMany = 100'000;
constexpr int kRepetitions = 15;

// What opening does for the History's table, in a dialog that has opened without one.
double openTable(std::size_t entries, Files files)
{
    bench::makeHistoryFiles(entries, files);
    bench::setHistory(0, files);
    const bench::OpenDialog dialog;
    bench::setHistory(entries, files);
    const double seconds = bench::secondsInPool([&] { [dialog.controller() populateHistoryList]; });
    return dialog.rows(@"historyList") == entries ? seconds : -1;
}

NSMutableArray* readyRows(const std::vector<std::string>& paths)
{
    NSMutableArray* rows = [NSMutableArray array];
    for (const std::string& path : paths)
    {
        NSString* text = [NSString stringWithUTF8String:path.c_str()];
        [rows addObject:[[[ModrigFilePath alloc] initWithFilePathName:text] autorelease]];
    }
    return rows;
}

std::vector<std::string> historyPaths(std::size_t entries, Files files)
{
    bench::makeHistoryFiles(entries, files);
    std::vector<std::string> paths;
    for (std::size_t number = 0; number < entries; ++number)
        paths.push_back(bench::historyFile(number, files));
    return paths;
}

// The file system's own word on each path, and the rows, all in one call, to a controller that nothing shows.
double resolveAndGive(std::size_t entries, Files files)
{
    const std::vector<std::string> paths = historyPaths(entries, files);
    NSMutableArray* rows = readyRows(paths);
    NSArrayController* bare =
        [[[NSArrayController alloc] initWithContent:[NSMutableArray array]] autorelease];
    std::size_t there = 0;
    const double seconds = bench::secondsInPool(
        [&]
        {
            char resolved[PATH_MAX];
            for (const std::string& path : paths)
                there += realpath(path.c_str(), resolved) != nullptr;
            [bare addObjects:rows];
        });
    const bool asExpected = there == (files == Files::kThere ? entries : 0);
    return asExpected && [[bare arrangedObjects] count] == entries ? seconds : -1;
}

std::string opening(std::size_t entries, Files files)
{
    return "open tables, History of " + std::to_string(entries) +
           (files == Files::kThere ? "" : " that are gone");
}

void addOpening(std::size_t entries, Files files, double most)
{
    const std::string measured = opening(entries, files);
    const std::string bare = "bare: " + measured;
    bench::measure(measured, kRepetitions, [=] { return openTable(entries, files); });
    bench::measure(bare, kRepetitions, [=] { return resolveAndGive(entries, files); });
    bench::addRatio({measured + " / realpath and a bare controller", measured, bare, most, 1, 1,
                     bench::kProcessorTime,
                     "The bare work is `realpath` for each path, and as many ready rows in one call to an array "
                     "controller that nothing shows."});
}

void addOpenings()
{
    addOpening(kMany, Files::kThere, 0.25);
    addOpening(kVeryMany, Files::kThere, 0.25);
    addOpening(kMany, Files::kGone, 0.4);
    addOpening(kVeryMany, Files::kGone, 0.4);
    bench::addRatio({"open tables, cost per entry at 100000 / at 10000", opening(kVeryMany, Files::kThere),
                     opening(kMany, Files::kThere), 1.2, kVeryMany, kMany});
}

double showWindow(std::size_t entries, long tab, pid_t display)
{
    TsUIPersistentStore* settings = [[[TsUIPersistentStore alloc] init] autorelease];
    [settings putControlInt:kSettingsGroup control:kLastTabSetting value:static_cast<int>(tab)];
    bench::makeHistoryFiles(entries, Files::kThere);
    bench::setHistory(entries, Files::kThere);
    return bench::secondsUntilShown(display);
}

void addWindow(const std::string& name, long tab, double most, pid_t display)
{
    const std::string empty = name + ", History of 0";
    const std::string many = name + ", History of " + std::to_string(kMany);
    bench::measure(empty, kRepetitions, [=] { return showWindow(0, tab, display); });
    bench::measure(many, kRepetitions, [=] { return showWindow(kMany, tab, display); });
    bench::addRatio({many + " / of 0", many, empty, most, 1, 1, bench::kProcessorTime,
                     "From the command to the window that is mapped and drawn, the time of the display's process "
                     "included."});
}

// Their paths, one to a line.
std::string fileOfPaths(std::size_t entries)
{
    const std::string name = (bench::workFolder() / "paths").string();
    std::ofstream file(name);
    for (const std::string& path : historyPaths(entries, Files::kThere))
        file << path << '\n';
    return name;
}

double secondsOfProgram(const std::string& command)
{
    std::FILE* output = popen(command.c_str(), "r");
    double seconds = -1;
    const bool told = output && std::fscanf(output, "%lf", &seconds) == 1;
    const bool endedWell = output && pclose(output) == 0;
    return told && endedWell ? seconds : -1;
}

double showList(std::size_t entries, pid_t display)
{
    bench::makeHistoryFiles(entries, Files::kThere);
    bench::setHistory(entries, Files::kThere);
    return bench::secondsUntilListShown(display);
}

void addPeer(const std::string& name, const std::string& program, double most, pid_t display)
{
    const std::string own = "window with nothing but a table, History of 10000";
    const std::string peer = name + " of 10000";
    bench::measure(peer, kRepetitions,
                   [=]
                   {
                       return secondsOfProgram("XDG_RUNTIME_DIR='" + bench::workFolder().string() + "' '" +
                                               program + "' '" + fileOfPaths(kMany) + "' " +
                                               std::to_string(display));
                   });
    bench::addRatio({own + " / " + peer, own, peer, most, 1, 1, bench::kProcessorTime,
                     "Each in a window of the same size, rows of one height, until it is mapped and drawn. Of all "
                     "of them the table alone looks at the disk, for links."});
}

void addPeers(pid_t display)
{
    bench::measure("window with nothing but a table, History of 10000", kRepetitions,
                   [=] { return showList(kMany, display); });
    addPeer("Qt list view", QT_LIST, 1.1, display);
    addPeer("GTK tree view", GTK_LIST, 0.9, display);
}

// Bytes that the process has in memory, by the system's count.
double residentBytes()
{
    long pages = 0;
    std::ifstream("/proc/self/statm") >> pages >> pages;
    return static_cast<double>(pages) * static_cast<double>(sysconf(_SC_PAGESIZE));
}

double allocatedBytes()
{
    const struct mallinfo2 counts = mallinfo2();
    return static_cast<double>(counts.uordblks + counts.hblkhd);
}

// The whole process while the dialog is open, or what is allocated since before it was opened.
double bytesOf(const std::string& part, std::size_t entries)
{
    bench::setHistory(entries, Files::kGone);
    const double before = allocatedBytes();
    const bench::OpenDialog dialog;
    [dialog.panel() orderFront:nil];
    [dialog.panel() display];
    if (dialog.rows(@"historyList") != entries)
        return -1;
    return part == "resident" ? residentBytes() : allocatedBytes() - before;
}

double growth(const std::string& part)
{
    const auto bytes = [&](std::size_t entries)
    { return bench::inNewProcess({"-part", part, "-entries", std::to_string(entries)}); };
    return bytes(kVeryMany) - bytes(0);
}

void addMemory()
{
    double characters = 0;
    for (std::size_t number = 0; number < kVeryMany; ++number)
        characters += static_cast<double>(bench::historyFile(number, Files::kGone).size());
    bench::addFigure(
        "growth of the process, 100000 of History and the dialog open / bytes of the paths",
        growth("resident") / (characters * sizeof(wchar_t)), "x", 2.5,
        "What the system counts as resident, the list itself included, less that with an empty History. The "
        "bytes of a path are those in which module and host hand it around, 4 for each character.");
    bench::addFigure("what the dialog allocates for 100000 of History / bytes of the paths in UTF-8",
                     growth("allocated") / characters, "x", 3.2,
                     "By the allocator's count, from before the dialog is opened until it shows, less that with an "
                     "empty History.");
}
} // namespace

void addHistoryDialogBenchmarks(pid_t display)
{
    addOpenings();
    addWindow("window shown", ModrigUtils::kLoadedApplicationsTab, 1.45, display);
    addWindow("window shown with the History in front", ModrigUtils::kHistoryTab, 1.5, display);
    addPeers(display);
    addMemory();
}

int runHistoryPart(const std::string& part, std::size_t entries)
{
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    const double bytes = bytesOf(part, entries);
    bench::tellSeconds(bytes);
    [pool drain];
    return bytes < 0 ? EXIT_FAILURE : EXIT_SUCCESS;
}
