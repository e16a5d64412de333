#include "tests/dialogs/support/FilePanelTest.h"

#include <tesselui/tsuieach.h>
#include <tesselui/tsuifilepanel.h>

@implementation PanelListener

- (BOOL)panel:(id)panel shouldShowFilename:(NSString*)path
{
    ++asked;
    return !hidden || [[path lastPathComponent] rangeOfString:hidden].location == NSNotFound;
}

- (void)panelSelectionDidChange:(id)panel
{
    ++told;
}

@end

void FilePanelTest::SetUp()
{
    DialogTest::SetUp();
    mPanel = [tsuiMakeFilePanel() retain];
    mListener = [[PanelListener alloc] init];
    [mPanel setDelegate:(id)mListener];
    [mPanel setAllowsMultipleSelection:YES];
}

void FilePanelTest::TearDown()
{
    [mPanel setDelegate:nil];
    [mPanel release];
    [mListener release];
    DialogTest::TearDown();
}

NSInteger FilePanelTest::run(std::vector<ModalStep> steps, const std::string& inFolder)
{
    [mPanel setDirectory:in(inFolder)];
    const ModalSteps running(std::move(steps));
    return [mPanel runModal];
}

void FilePanelTest::use(std::vector<ModalStep> steps, const std::string& inFolder)
{
    steps.push_back(ModalStep([this] { [mPanel cancel:nil]; }));
    EXPECT_EQ(NSModalResponseCancel, run(std::move(steps), inFolder));
}

std::vector<std::wstring> FilePanelTest::chosen()
{
    std::vector<std::wstring> paths;
    for (NSURL* url : tsuiEach<NSURL*>([mPanel URLs]))
        paths.push_back(wide([url path]));
    return paths;
}

std::wstring FilePanelTest::name()
{
    NSText* editor = [nameField(mPanel) currentEditor];
    return wide(editor ? [editor string] : [nameField(mPanel) stringValue]);
}

std::vector<NSUInteger> FilePanelTest::selectedRows()
{
    std::vector<NSUInteger> indexes;
    NSIndexSet* set = rows();
    for (NSUInteger row = [set firstIndex]; row != NSNotFound; row = [set indexGreaterThanIndex:row])
        indexes.push_back(row);
    return indexes;
}

NSInteger FilePanelTest::firstVisibleRow()
{
    return [table() rowAtPoint:[table() visibleRect].origin];
}

namespace
{
NSButton* buttonIn(NSView* view, NSString* title)
{
    if ([view isKindOfClass:[NSButton class]] && [[(NSButton*)view title] isEqual:title])
        return (NSButton*)view;
    for (NSView* inner : tsuiEach<NSView*>([view subviews]))
        if (NSButton* found = buttonIn(inner, title))
            return found;
    return nil;
}
} // namespace

NSButton* FilePanelTest::button(const std::wstring& title)
{
    return buttonIn([mPanel contentView], text(title));
}

void FilePanelTest::type(NSString* letters)
{
    for (NSUInteger index = 0; index < [letters length]; ++index)
        pressKey(mPanel, [letters substringWithRange:NSMakeRange(index, 1)]);
}
