#include "host/ui/QuestionPanel.h"

#import <AppKit/AppKit.h>

#include <algorithm>

#include <tesselui/tsuidisplay.h>
#include <tesselui/tsuieach.h>
#include <wincompat/winstring.h>

#include "host/text/Unicode.h"
#include "host/ui/Label.h"
#include "host/ui/QuestionLayout.h"
#include "host/ui/SessionEnd.h"
#include "host/ui/Waiting.h"
#include "host/ui/Words.h"
#include "host/ui/platform/Windowing.h"

namespace asking = tessel::asking;
using tessel::Questions;
using tessel::word;

namespace
{
constexpr CGFloat kNarrowestQuestion = 300;
constexpr CGFloat kWidestQuestion = 440;
constexpr CGFloat kAnyHeight = 100000;
constexpr CGFloat kTextPadding = 6; // of a field around its text
constexpr CGFloat kScrollerRoom = 20;
constexpr CGFloat kNarrowestButton = 88;
constexpr CGFloat kButtonRoom = 32; // beside its title
constexpr CGFloat kButtonGap = 8;
constexpr NSTimeInterval kBetweenKeyLooks = 0.1;
NSString* const kDefaultKey = @"\r";
NSString* const kCancelKey = @"\033";

NSString* readableString(const std::wstring& text)
{
    return wcharToNSString(tessel::withReadableBytes(text).c_str());
}

NSTextField* makeWrappedText(NSString* text, CGFloat width)
{
    NSTextField* field = tessel::windowing::makeLabel(text, NSZeroRect);
    [[field cell] setWraps:YES];
    const NSRect needed =
        [[field attributedStringValue] boundingRectWithSize:NSMakeSize(width - kTextPadding, kAnyHeight)
                                                    options:NSStringDrawingUsesLineFragmentOrigin];
    [field setFrameSize:NSMakeSize(width, NSHeight(needed) + kTextPadding)];
    return field;
}

// The beginning shows first.
NSView* scrolled(NSTextField* text, NSSize size)
{
    NSScrollView* frame =
        [[[NSScrollView alloc] initWithFrame:NSMakeRect(0, 0, size.width, size.height)] autorelease];
    [frame setHasVerticalScroller:YES];
    [frame setDrawsBackground:NO];
    [frame setDocumentView:text];
    [text scrollPoint:NSMakePoint(0, [text isFlipped] ? 0 : NSHeight([text frame]))];
    return frame;
}

// The text at this width, or as much of it as the height holds and a scroller beside that.
NSView* makeWords(NSString* text, CGFloat width, asking::Band place)
{
    NSTextField* whole = makeWrappedText(text, width);
    const bool fits = NSHeight([whole frame]) <= place.height;
    NSView* words =
        fits ? whole
             : scrolled(makeWrappedText(text, width - kScrollerRoom), NSMakeSize(width, place.height));
    [words setFrameOrigin:NSMakePoint(asking::kMargin, place.bottom)];
    return words;
}

CGFloat widthOfLine(NSString* text)
{
    NSFont* font = [NSFont systemFontOfSize:tessel::windowing::kControlFontSize];
    return
        [text sizeWithAttributes:[NSDictionary dictionaryWithObject:font forKey:NSFontAttributeName]].width;
}

NSButton* makeAnswerButton(NSString* title, id target, SEL action)
{
    NSButton* button = [[[NSButton alloc] initWithFrame:NSZeroRect] autorelease];
    [button setTitle:title];
    [button setFont:[NSFont systemFontOfSize:tessel::windowing::kControlFontSize]];
    [button setBezelStyle:NSRoundedBezelStyle];
    [button setFrameSize:NSMakeSize(std::max(kNarrowestButton, widthOfLine(title) + kButtonRoom),
                                    asking::kButtonHeight)];
    [button setTarget:target];
    [button setAction:action];
    return button;
}

void moveMiddleOver(NSWindow* window, NSWindow* owner)
{
    if (!owner)
        return [window center];
    const NSRect outer = [owner frame];
    const NSSize size = [window frame].size;
    [window setFrameOrigin:NSMakePoint(NSMidX(outer) - size.width / 2, NSMidY(outer) - size.height / 2)];
}
} // namespace

// Lives as long as its question.
@interface TsQuestionPanel : NSPanel
{
    const tessel::QuestionWindows::Asked* mAsked;
    CGFloat mInside; // between the margins
    NSView* mText;
    NSView* mExplanation;
    NSString* mReason; // why the last answer did not fit; empty at first
    NSTextField* mField;
    NSButton* mChoose;
    NSMutableArray* mAnswers; // buttons, from the right
    NSView* mFirst;           // what has the keyboard first
    BOOL mIsAnswered;
}
- (id)initWithQuestion:(const tessel::QuestionWindows::Asked&)asked;
- (BOOL)run;
@end

@implementation TsQuestionPanel

- (const Questions::Question&)question
{
    return mAsked->question;
}

- (void)addAnswer:(NSString*)title action:(SEL)action isDefault:(BOOL)isDefault
{
    NSButton* button = makeAnswerButton(title, self, action);
    [button setTag:static_cast<NSInteger>([mAnswers count])];
    if (isDefault)
        [button setKeyEquivalent:kDefaultKey];
    if (isDefault || !mFirst)
        mFirst = button;
    [mAnswers addObject:button];
}

// A button for each that can be chosen, or one for what is typed.
- (void)makeAnswers
{
    mAnswers = [[NSMutableArray alloc] init];
    for (const std::wstring& choice : [self question].choices)
        [self addAnswer:readableString(choice)
                 action:@selector(onChoice:)
              isDefault:[self question].byDefault == choice];
    if ([mAnswers count] == 0)
        [self addAnswer:word(@"OK") action:@selector(onOK:) isDefault:YES];
    [self addAnswer:word(@"CANCEL") action:@selector(onCancel:) isDefault:NO];
    [[mAnswers lastObject] setKeyEquivalent:kCancelKey];
    for (NSButton* button : tsuiEach<NSButton*>([[mAnswers reverseObjectEnumerator] allObjects]))
        [[self contentView] addSubview:button];
}

- (void)makeField
{
    if (![self question].choices.empty())
        return;
    mField = [[[NSTextField alloc] initWithFrame:NSZeroRect] autorelease];
    [mField setFont:[NSFont systemFontOfSize:tessel::windowing::kControlFontSize]];
    [mField setStringValue:wcharToNSString([self question].byDefault.value_or(L"").c_str())];
    [[mField cell] setScrollable:YES];
    [[self contentView] addSubview:mField];
    mFirst = mField;
    if ([self question].file == Questions::File::kNone)
        return;
    mChoose = makeAnswerButton(word(@"CHOOSE_FILE"), self, @selector(onChoose:));
    [[self contentView] addSubview:mChoose];
}

- (CGFloat)widthOfAnswers
{
    CGFloat width = -kButtonGap;
    for (NSButton* button : tsuiEach<NSButton*>(mAnswers))
        width += NSWidth([button frame]) + kButtonGap;
    return width;
}

- (void)placeAnswersAt:(CGFloat)bottom
{
    CGFloat right = asking::kMargin + mInside;
    for (NSButton* button : tsuiEach<NSButton*>(mAnswers))
    {
        right -= NSWidth([button frame]);
        [button setFrameOrigin:NSMakePoint(right, bottom)];
        right -= kButtonGap;
    }
}

- (void)placeFieldAt:(CGFloat)bottom
{
    CGFloat width = mInside;
    if (mChoose)
    {
        width -= NSWidth([mChoose frame]) + kButtonGap;
        [mChoose setFrameOrigin:NSMakePoint(asking::kMargin + width + kButtonGap,
                                            bottom - (asking::kButtonHeight - asking::kFieldHeight) / 2)];
    }
    [mField setFrame:NSMakeRect(asking::kMargin, bottom, width, asking::kFieldHeight)];
}

- (NSView*)replace:(NSView*)view by:(NSView*)words
{
    [view removeFromSuperview];
    [[self contentView] addSubview:words positioned:NSWindowBelow relativeTo:nil];
    return words;
}

// The upper edge stays, if the lower one is still on the screen then.
- (void)growTo:(CGFloat)height
{
    const NSRect frame = [self frame];
    NSRect wanted = [self frameRectForContentRect:NSMakeRect(0, 0, mInside + 2 * asking::kMargin, height)];
    wanted.origin.x = NSMinX(frame);
    wanted.origin.y = std::max(NSMinY([[self screen] visibleFrame]), NSMaxY(frame) - NSHeight(wanted));
    [self setFrame:wanted display:NO];
}

- (void)placeParts
{
    NSString* text = readableString([self question].text);
    const asking::Wanted wanted{NSHeight([makeWrappedText(text, mInside) frame]),
                                [mReason length] ? NSHeight([makeWrappedText(mReason, mInside) frame]) : 0,
                                mField != nil};
    const NSRect highest = [self contentRectForFrameRect:[[NSScreen mainScreen] visibleFrame]];
    const asking::QuestionLayout layout = asking::layoutOf(wanted, NSHeight(highest));
    [self growTo:layout.height];
    mText = [self replace:mText by:makeWords(text, mInside, layout.text)];
    if ([mReason length])
        mExplanation = [self replace:mExplanation by:makeWords(mReason, mInside, layout.explanation)];
    [self placeFieldAt:layout.field.bottom];
    [self placeAnswersAt:layout.buttons.bottom];
    [[self contentView] setNeedsDisplay:YES];
}

- (id)initWithQuestion:(const tessel::QuestionWindows::Asked&)asked
{
    self = [super initWithContentRect:NSMakeRect(0, 0, kWidestQuestion, asking::kButtonHeight)
                            styleMask:NSTitledWindowMask | NSClosableWindowMask
                              backing:NSBackingStoreBuffered
                                defer:NO];
    if (!self)
        return nil;
    mAsked = &asked;
    mReason = @"";
    [self setTitle:readableString(asked.title)];
    [self setReleasedWhenClosed:NO];
    [self makeAnswers];
    [self makeField];
    const CGFloat line = widthOfLine(readableString(asked.question.text)) + kTextPadding + 1;
    const CGFloat wanted = mField ? kWidestQuestion : std::max(line, [self widthOfAnswers]);
    mInside = std::clamp(wanted, kNarrowestQuestion, std::max(kWidestQuestion, [self widthOfAnswers]));
    [self placeParts];
    [self recalculateKeyViewLoop];
    [self setInitialFirstResponder:mFirst];
    return self;
}

- (void)dealloc
{
    [mAnswers release];
    [mReason release];
    [super dealloc];
}

- (NSString*)typedAnswer
{
    NSText* editor = [mField currentEditor];
    return editor ? [editor string] : [mField stringValue];
}

- (void)type:(NSString*)answer
{
    [mField abortEditing];
    [mField setStringValue:answer];
    [self makeFirstResponder:mField];
    [[mField currentEditor] setSelectedRange:NSMakeRange([answer length], 0)];
}

- (void)take:(const std::wstring&)answer
{
    const auto taken = mAsked->take(answer);
    mIsAnswered = static_cast<bool>(taken);
    if (taken)
        return [NSApp stopModal];
    [mReason release];
    mReason = [readableString(taken.sentence()) copy];
    [self placeParts];
    if (mField && ![mField currentEditor])
        [self type:[self typedAnswer]];
}

- (void)onOK:(id)sender
{
    [self take:NSStringToWstring([self typedAnswer])];
}

- (void)onChoice:(id)sender
{
    [self take:[self question].choices[static_cast<std::size_t>([sender tag])]];
}

- (void)onCancel:(id)sender
{
    [NSApp stopModalWithCode:NSModalResponseCancel];
}

- (void)onChoose:(id)sender
{
    NSString* path = [[self typedAnswer] stringByExpandingTildeInPath];
    NSString* here = [[NSFileManager defaultManager] currentDirectoryPath];
    NSString* whole = [path isAbsolutePath] ? path : [here stringByAppendingPathComponent:path];
    BOOL isFolder = NO;
    [[NSFileManager defaultManager] fileExistsAtPath:whole isDirectory:&isFolder];
    NSString* chosen = tessel::windowing::chooseFile(
        isFolder ? whole : [whole stringByDeletingLastPathComponent],
        isFolder ? @"" : [whole lastPathComponent], [self question].file == Questions::File::kThereOrNew);
    if (chosen)
        [self type:chosen];
}

- (BOOL)windowShouldClose:(id)sender
{
    [self onCancel:sender];
    return NO;
}

// A file panel over this window is cancelled first.
- (void)look:(NSTimer*)timer
{
    if (mAsked->isInterrupted())
        tessel::cancelFrontWindow();
}

- (BOOL)run
{
    NSTimer* looks = [NSTimer timerWithTimeInterval:kBetweenKeyLooks
                                             target:self
                                           selector:@selector(look:)
                                           userInfo:nil
                                            repeats:YES];
    [[NSRunLoop currentRunLoop] addTimer:looks forMode:NSModalPanelRunLoopMode];
    [[NSRunLoop currentRunLoop] addTimer:looks forMode:NSEventTrackingRunLoopMode];
    moveMiddleOver(self, [NSApp modalWindow]);
    [NSApp runModalForWindow:self];
    [looks invalidate];
    [self orderOut:nil];
    return mIsAnswered;
}

@end

bool tsuiHasOpenWindow()
{
    return [NSApp modalWindow] != nil;
}

bool tsuiAskInWindow(const tessel::QuestionWindows::Asked& asked)
{
    // Who dropped a file from another program is still in front of that one's window.
    if (tessel::sessionIsToEnd() || !tsuiPrepareWindows())
        return false;
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    const tessel::Question withinAnAction;
    TsQuestionPanel* panel = [[TsQuestionPanel alloc] initWithQuestion:asked];
    const bool answered = [panel run];
    [panel release];
    [pool drain];
    return answered;
}
