// Loads that take long: what is seen and what can be done meanwhile.
#include "tests/dialogs/support/DialogTest.h"

#include <chrono>

#include <GNUstepGUI/GSDisplayServer.h>
#include <X11/extensions/Xfixes.h>

#import "modrig/dialogs/ModrigArrayController.h"
#import "modrig/dialogs/ModrigFilePath.h"

#include "modrig/messages/MessageIds.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
using std::chrono::milliseconds;

class LongLoading : public OpenDialogTest
{
protected:
    // What the host does while it loads the file.
    void whileLoading(const std::string& name, std::function<void()> function)
    {
        host().linker.setEntryPoint(file(name),
                                    [function = std::move(function)](unsigned, void*)
                                    {
                                        function();
                                        return TSRX_RET_OK;
                                    });
    }
    static void beBusyFor(milliseconds time)
    {
        const auto end = std::chrono::steady_clock::now() + time;
        while (std::chrono::steady_clock::now() < end)
            ;
    }

    static std::string cursorOnTheScreen()
    {
        auto* display = static_cast<Display*>([GSCurrentServer() serverDevice]);
        XSync(display, False);
        XFixesCursorImage* image = XFixesGetCursorImage(display);
        const std::string name = image->name ? image->name : "";
        XFree(image);
        return name;
    }
    void movePointerIntoTheWindow()
    {
        [mPanel orderFront:nil];
        auto* display = static_cast<Display*>([GSCurrentServer() serverDevice]);
        const auto window = reinterpret_cast<Window>(
            [GSCurrentServer() windowDevice:static_cast<int>([mPanel windowNumber])]);
        XMapRaised(display, window);
        XWarpPointer(display, None, window, 0, 0, 0, 0, 60, 60);
    }
};
} // namespace

TEST_F(LongLoading, IsStoppedBetweenTwoFilesByEscape)
{
    open();
    whileLoading("one.zmb",
                 [this]
                 {
                     pressKey(mPanel, @"\033");
                     beBusyFor(milliseconds(60));
                 });
    load({"one.zmb", "two.zmb", "three.zmb"});
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("one.zmb")));
    EXPECT_FALSE(host().linker.isLoaded(file("two.zmb")));
    EXPECT_EQ(L"Stopped: 1 of 3 files were loaded.", message());
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(LongLoading, GoesOnWhenAnotherKeyIsPressed)
{
    open();
    whileLoading("one.zmb",
                 [this]
                 {
                     pressKey(mPanel, @"x");
                     beBusyFor(milliseconds(60));
                 });
    load({"one.zmb", "two.zmb"});
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("one.zmb"), file("two.zmb")));
    EXPECT_EQ(Message(ModrigMessages::kManyLoaded, L"2"), message());
}

TEST_F(LongLoading, SaysAfterASecondHowFarItIs)
{
    open();
    std::vector<std::wstring> said;
    whileLoading("one.zmb", [] { beBusyFor(milliseconds(100)); });
    whileLoading("two.zmb",
                 [&]
                 {
                     said.push_back(message());
                     beBusyFor(milliseconds(950));
                 });
    whileLoading("three.zmb", [&] { said.push_back(message()); });
    load({"one.zmb", "two.zmb", "three.zmb"});
    EXPECT_THAT(said, ElementsAre(L"", L"2 of 3 files are loaded. Escape stops."));
    EXPECT_EQ(Message(ModrigMessages::kManyLoaded, L"3"), message());
}

TEST_F(LongLoading, ShowsAnHourglassFromItsFirstFileToItsLast)
{
    open();
    movePointerIntoTheWindow();
    std::vector<std::string> cursors;
    for (const char* name : {"one.zmb", "two.zmb"})
        whileLoading(name, [&] { cursors.push_back(cursorOnTheScreen()); });
    load({"one.zmb", "two.zmb"});
    EXPECT_THAT(cursors, ElementsAre("watch", "watch"));
    EXPECT_NE("watch", cursorOnTheScreen());
}

// Counts how often it is compared.
@interface ComparedRow : NSObject
@end

namespace
{
int gComparisons = 0;
}

@implementation ComparedRow

- (NSUInteger)hash
{
    return reinterpret_cast<NSUInteger>(self) / sizeof(id);
}

- (BOOL)isEqual:(id)other
{
    ++gComparisons;
    return self == other;
}

@end

namespace
{
class TableRows : public testing::Test
{
protected:
    void SetUp() override
    {
        mPool = [[NSAutoreleasePool alloc] init];
        mRows = [[[ModrigArrayController alloc] initWithContent:[NSMutableArray array]] autorelease];
    }
    void TearDown() override { [mPool drain]; }

    static id row() { return [[[ComparedRow alloc] init] autorelease]; }

    NSAutoreleasePool* mPool = nil;
    ModrigArrayController* mRows = nil;
};
} // namespace

TEST_F(TableRows, AreFoundWithoutComparingEachOfThem)
{
    NSMutableArray* many = [NSMutableArray array];
    for (int index = 0; index < 500; ++index)
        [many addObject:row()];
    [mRows addObjects:many];
    ASSERT_FALSE([mRows holds:row()]);
    gComparisons = 0;
    for (int index = 0; index < 100; ++index)
    {
        id added = row();
        ASSERT_FALSE([mRows holds:added]);
        [mRows addObject:added];
        ASSERT_TRUE([mRows holds:added]);
    }
    EXPECT_LT(gComparisons, 5'000);
}

TEST_F(TableRows, AreNoLongerFoundWhenTheyHaveBeenRemoved)
{
    NSArray* three = [NSArray arrayWithObjects:row(), row(), row(), nil];
    [mRows addObjects:three];
    ASSERT_TRUE([mRows holds:[three objectAtIndex:1]]);
    [mRows removeObject:[three objectAtIndex:1]];
    EXPECT_FALSE([mRows holds:[three objectAtIndex:1]]);
    EXPECT_TRUE([mRows holds:[three objectAtIndex:2]]);
}

TEST_F(TableRows, ThatComeAllAtOnceAreFound)
{
    id first = row();
    [mRows addObject:first];
    ASSERT_TRUE([mRows holds:first]);
    NSArray* others = [NSArray arrayWithObjects:row(), row(), nil];
    [mRows setContent:[NSMutableArray arrayWithArray:others]];
    EXPECT_TRUE([mRows holds:[others objectAtIndex:1]]);
    EXPECT_FALSE([mRows holds:first]);
}
