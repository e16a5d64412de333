#include "bench/HistoryDialogBenchmark.h"

#include <cstdio>
#include <cstdlib>
#include <limits.h>
#include <vector>

#import <AppKit/AppKit.h>

#include "bench/HistoryFiles.h"
#include "bench/OpenDialog.h"
#include "bench/Ratios.h"
#include "modrig/lists/Globals.h"

#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/Paths.h"

using bench::Files;

namespace
{
constexpr std::size_t kMany = 10'000;
constexpr std::size_t kVeryMany = 100'000;
constexpr int kRepetitions = 15;

// What opening does for the History's table, in a dialog that has opened without one.
double openTable(std::size_t entries, Files files)
{
    const std::vector<std::string> paths = bench::historyFiles(entries, files);
    gHistoryList.RemoveAll();
    const bench::OpenDialog dialog;
    bench::setHistory(paths);
    const double seconds = bench::secondsInPool([&] { [dialog.controller() populateHistoryList]; });
    return dialog.rows(@"historyList") == entries ? seconds : -1;
}

NSMutableArray* readyRows(const std::vector<std::string>& paths)
{
    NSMutableArray* rows = [NSMutableArray array];
    for (const std::string& path : paths)
        [rows addObject:[[[ModrigFilePath alloc]
                            initWithFilePathName:[NSString stringWithUTF8String:path.c_str()]] autorelease]];
    return rows;
}

// The least that opening can do: the file system's own word on each path, and the rows, all in one call, to a
// controller that nothing shows.
double resolveAndGive(std::size_t entries, Files files)
{
    const std::vector<std::string> paths = bench::historyFiles(entries, files);
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

std::string nameOf(std::size_t entries, Files files)
{
    return std::to_string(entries) + (files == Files::kThere ? "" : " that are gone");
}

std::string opening(std::size_t entries, Files files)
{
    return "open tables, History of " + nameOf(entries, files);
}

void addOpening(std::size_t entries, Files files, double most)
{
    const std::string bare = "realpath, bare controller, " + nameOf(entries, files);
    bench::measure(opening(entries, files), kRepetitions, [=] { return openTable(entries, files); });
    bench::measure(bare, kRepetitions, [=] { return resolveAndGive(entries, files); });
    bench::addRatio({opening(entries, files) + " / realpath, bare controller", opening(entries, files), bare,
                     most});
}
} // namespace

void addHistoryDialogBenchmarks()
{
    addOpening(kMany, Files::kThere, 1.3);
    addOpening(kVeryMany, Files::kThere, 1.3);
    addOpening(kMany, Files::kGone, 1.3);
    addOpening(kVeryMany, Files::kGone, 1.3);
    bench::addRatio({"open tables, cost per entry at 100000 / at 10000", opening(kVeryMany, Files::kThere),
                     opening(kMany, Files::kThere), 1.2, kVeryMany, kMany});
}

int runHistoryPart(const std::string& part, std::size_t entries)
{
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    double figure = -1;
    if (part == "open")
        figure = openTable(entries, Files::kThere);
    else if (part == "open-gone")
        figure = openTable(entries, Files::kGone);
    else if (part == "bare")
        figure = resolveAndGive(entries, Files::kThere);
    else if (part == "bare-gone")
        figure = resolveAndGive(entries, Files::kGone);
    std::printf("%.9f\n", figure);
    [pool drain];
    return figure < 0 ? EXIT_FAILURE : EXIT_SUCCESS;
}
