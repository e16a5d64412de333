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
constexpr char kResident[] = "resident";
constexpr char kAllocated[] = "allocated";
constexpr char kList[] = "window with nothing but a table";
constexpr char kInFront[] = "window shown with the History in front";

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
    bench::addRatio(
        {measured + " / realpath and a bare controller", measured, bare, most, 1, 1, bench::kProcessorTime,
         "The bare work is `realpath` for each path, and as many ready rows in one call to an array "
         "controller that nothing shows."});
}

void addOpenings()
{
    addOpening(kMany, Files::kThere, 0.3);
    addOpening(kVeryMany, Files::kThere, 0.25);
    addOpening(kMany, Files::kGone, 0.55);
    addOpening(kVeryMany, Files::kGone, 0.35);
    bench::addRatio({"open tables, cost per entry at 100000 / at 10000", opening(kVeryMany, Files::kThere),
                     opening(kMany, Files::kThere), 1.2, kVeryMany, kMany});
}

// A part of this program, in a process of its own.
double inProcess(const std::string& part, std::size_t entries, pid_t display = 0)
{
    return bench::inNewProcess(
        {"-part", part, "-entries", std::to_string(entries), "-server", std::to_string(display)});
}

// Shows what the part names with so many entries. A first one, of an empty History, is not measured: what a
// toolkit does once in a process is not what a window costs.
double showPart(const std::string& part, std::size_t entries, pid_t display)
{
    const auto show = part == kList ? bench::secondsUntilListShown : bench::secondsUntilShown;
    TsUIPersistentStore* settings = [[[TsUIPersistentStore alloc] init] autorelease];
    const long tab = part == kInFront ? ModrigUtils::kHistoryTab : ModrigUtils::kLoadedApplicationsTab;
    [settings putControlInt:kSettingsGroup control:kLastTabSetting value:static_cast<int>(tab)];
    bench::setHistory(0, Files::kThere);
    if (show(display) < 0)
        return -1;
    bench::setHistory(entries, Files::kThere);
    return show(display);
}

std::string showing(const std::string& part, std::size_t entries)
{
    return part + ", History of " + std::to_string(entries);
}

void addShowing(const std::string& part, std::size_t entries, pid_t display)
{
    bench::measure(showing(part, entries), kRepetitions,
                   [=]
                   {
                       bench::makeHistoryFiles(kMany, Files::kThere);
                       return inProcess(part, entries, display);
                   });
}

void addWindow(const std::string& part, double most, pid_t display)
{
    addShowing(part, 0, display);
    addShowing(part, kMany, display);
    bench::addRatio(
        {showing(part, kMany) + " / of 0", showing(part, kMany), showing(part, 0), most, 1, 1,
         bench::kProcessorTime,
         "From the command to the window that is mapped and drawn, the time of the display's process "
         "included. It is the second window of its process."});
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

void addPeer(const std::string& name, const std::string& program, double most, pid_t display)
{
    const std::string own = showing(kList, kMany);
    const std::string peer = name + " of 10000";
    bench::measure(peer, kRepetitions,
                   [=]
                   {
                       return secondsOfProgram("XDG_RUNTIME_DIR='" + bench::workFolder().string() + "' '" +
                                               program + "' '" + fileOfPaths(kMany) + "' " +
                                               std::to_string(display));
                   });
    bench::addRatio(
        {own + " / " + peer, own, peer, most, 1, 1, bench::kProcessorTime,
         "Each in a window of the same size, rows of one height, until it is mapped and drawn. The table "
         "alone looks at the disk, for links, and leaves out what comes twice."});
}

void addPeers(pid_t display)
{
    addShowing(kList, kMany, display);
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
    return part == kResident ? residentBytes() : allocatedBytes() - before;
}

double growth(const std::string& part)
{
    return inProcess(part, kVeryMany) - inProcess(part, 0);
}

void addMemory()
{
    double characters = 0;
    for (std::size_t number = 0; number < kVeryMany; ++number)
        characters += static_cast<double>(bench::historyFile(number, Files::kGone).size());
    bench::addFigure(
        "growth of the process, 100000 of History and the dialog open / bytes of the paths",
        growth(kResident) / (characters * sizeof(wchar_t)), "x", 2.5,
        "What the system counts as resident, the list itself included, less that with an empty History. The "
        "bytes of a path are those in which module and host hand it around, 4 for each character.");
    bench::addFigure(
        "what the dialog allocates for 100000 of History / bytes of the paths in UTF-8",
        growth(kAllocated) / characters, "x", 3.2,
        "By the allocator's count, from before the dialog is opened until it shows, less that with an "
        "empty History.");
}
} // namespace

void addHistoryDialogBenchmarks(pid_t display)
{
    addOpenings();
    addWindow("window shown", 1.5, display);
    addWindow(kInFront, 1.65, display);
    addPeers(display);
    addMemory();
}

int runHistoryPart(const std::string& part, std::size_t entries, pid_t display)
{
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    const bool countsBytes = part == kResident || part == kAllocated;
    const double figure = countsBytes ? bytesOf(part, entries) : showPart(part, entries, display);
    bench::tellSeconds(figure);
    [pool drain];
    return figure < 0 ? EXIT_FAILURE : EXIT_SUCCESS;
}
