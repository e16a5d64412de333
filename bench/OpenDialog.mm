#include "bench/OpenDialog.h"

#include <benchmark/benchmark.h>
#include <tesselui/tsuieach.h>
#include <tesselui/tsuifilepanel.h>

#include "bench/Child.h"
#include "bench/Ratios.h"

namespace bench
{
namespace
{
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
} // namespace

OpenDialog::OpenDialog() : mController([[ModrigController alloc] init]), mPanel(tsuiMakeFilePanel())
{
    [mController setupOpenPanel:mPanel];
}

OpenDialog::~OpenDialog()
{
    [mController cleanOpenPanel:mPanel];
    [mController release];
}

NSUInteger OpenDialog::filesShown() const
{
    return rowsOfTableIn([mPanel contentView], [mPanel accessoryView]);
}

NSUInteger OpenDialog::rows(NSString* table) const
{
    return [[[mController valueForKey:table] arrangedObjects] count];
}

void measure(const std::string& name, int usual, std::function<double()> once)
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
        ->Repetitions(repetitions(usual));
}

double secondsInPool(const std::function<void()>& work)
{
    return secondsOf(
        [&]
        {
            NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
            work();
            [pool drain];
        });
}
} // namespace bench
