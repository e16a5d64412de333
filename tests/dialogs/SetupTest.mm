// The order in which the dialog is put together, and taken apart.
#include "tests/dialogs/support/DialogTest.h"

#include <map>

#import "modrig/dialogs/NSSavePanel+ModrigRuntime.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

using testing::ElementsAre;

namespace
{
std::vector<std::string> gCalls;
// What stood when each of them came.
std::map<std::string, bool> gPanelWasReady;
} // namespace

@interface NotingDialog : ModrigController
@end

@implementation NotingDialog

- (void)note:(const char*)call
{
    gCalls.emplace_back(call);
    NSOpenPanel* panel = [self valueForKey:@"mOpenPanel"];
    gPanelWasReady[call] = panel && [panel delegate] == (id)self && [panel allowsMultipleSelection] &&
                           [[panel okButton] isHidden] && [panel accessoryView] == [self view] &&
                           [[self valueForKey:@"helpButton"] superview] == [[panel okButton] superview] &&
                           [[panel title] isEqual:@"Load"] &&
                           [[panel directory] isEqual:[[NSBundle mainBundle] bundlePath]];
}

- (void)populateFileTypes
{
    [self note:"file types"];
    [super populateFileTypes];
}

- (void)onFileTypesChanged:(id)sender
{
    [self note:sender ? "filtered for somebody" : "filtered"];
    [super onFileTypesChanged:sender];
}

- (void)populateLoadedApplications
{
    [self note:"loaded applications"];
    [super populateLoadedApplications];
}

- (void)populateHistoryList
{
    [self note:"history"];
    [super populateHistoryList];
}

- (void)onInit
{
    [self note:"open"];
    [super onInit];
}

- (void)onFinish
{
    gCalls.emplace_back("close");
    gPanelWasReady["close"] = [self valueForKey:@"mOpenPanel"] != nil;
    [super onFinish];
}

@end

namespace
{
class Setup : public OpenDialogTest
{
protected:
    void SetUp() override
    {
        OpenDialogTest::SetUp();
        gCalls.clear();
        gPanelWasReady.clear();
    }
};
} // namespace

TEST_F(Setup, FillsTheTablesOnceThePanelStandsAndOpensLast)
{
    openWith([[NotingDialog alloc] init]);
    EXPECT_THAT(gCalls, ElementsAre("file types", "filtered", "loaded applications", "history", "open"));
    for (const auto& [call, ready] : gPanelWasReady)
        EXPECT_TRUE(ready) << call;
}

TEST_F(Setup, GivesUpThePanelBeforeItCloses)
{
    openWith([[NotingDialog alloc] init]);
    gCalls.clear();
    close();
    EXPECT_THAT(gCalls, ElementsAre("close"));
    EXPECT_FALSE(gPanelWasReady["close"]);
}
