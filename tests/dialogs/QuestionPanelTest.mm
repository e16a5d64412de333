// The window in which an application asks for something, used as a person does.
#include "tests/dialogs/support/DialogTest.h"
#include "tests/dialogs/support/FilePanelTest.h"

#include <tesselui/tsuieach.h>

#include <unistd.h>

#include "host/platform/Pipe.h"
#include "host/ui/QuestionPanel.h"
#include "host/ui/platform/Windowing.h"

using tessel::Questions;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
template <class View> std::vector<View*> viewsIn(NSView* view)
{
    std::vector<View*> found;
    if ([view isKindOfClass:[View class]])
        found.push_back((View*)view);
    for (NSView* inner : tsuiEach<NSView*>([view subviews]))
        for (View* part : viewsIn<View>(inner))
            found.push_back(part);
    return found;
}

// The first step. Without a window manager the keyboard goes nowhere when the last window of the test before
// has closed.
bool hasKeyboard()
{
    [NSApp activateIgnoringOtherApps:YES];
    [[NSApp modalWindow] makeKeyWindow];
    return [NSApp modalWindow] && [NSApp keyWindow] == [NSApp modalWindow];
}

class QuestionPanel : public DialogTest
{
protected:
    QuestionPanel()
    {
        asked.title = L"moon.bundle";
        asked.question.text = L"Size";
        asked.take = [this](const std::wstring& answer) -> tessel::Result<>
        {
            answers.push_back(answer);
            if (answer == fitting)
                return {};
            return tessel::Failure{L"Not \"" + answer + L"\"."};
        };
        asked.isInterrupted = [] { return false; };
    }

    bool ask(std::vector<ModalStep> steps)
    {
        steps.insert(steps.begin(), ModalStep(hasKeyboard));
        const ModalSteps running(std::move(steps));
        return tsuiAskInWindow(asked);
    }

    void askForYesOrNo(const std::optional<std::wstring>& byDefault = std::nullopt)
    {
        asked.question.choices = {L"Yes", L"No"};
        asked.question.byDefault = byDefault;
    }

    static NSWindow* window() { return [NSApp modalWindow]; }
    static NSTextField* field()
    {
        for (NSTextField* part : viewsIn<NSTextField>([window() contentView]))
            if ([part isEditable])
                return part;
        return nil;
    }
    static std::wstring typed()
    {
        NSText* editor = [field() currentEditor];
        return wide(editor ? [editor string] : [field() stringValue]);
    }
    static void type(NSString* letters)
    {
        for (NSUInteger index = 0; index < [letters length]; ++index)
            pressKey(window(), [letters substringWithRange:NSMakeRange(index, 1)]);
    }
    static NSButton* button(const std::wstring& title)
    {
        for (NSButton* part : viewsIn<NSButton>([window() contentView]))
            if (wide([part title]) == title)
                return part;
        return nil;
    }
    static std::vector<std::wstring> labels()
    {
        std::vector<std::wstring> texts;
        for (NSTextField* part : viewsIn<NSTextField>([window() contentView]))
            if (![part isEditable])
                texts.push_back(wide([part stringValue]));
        return texts;
    }
    static bool says(const std::wstring& text)
    {
        const auto shown = labels();
        return std::ranges::find(shown, text) != shown.end();
    }
    static void pressReturn() { pressKey(window(), @"\r"); }
    static void pressEscape() { pressKey(window(), @"\033"); }

    tessel::QuestionWindows::Asked asked;
    std::wstring fitting = L"3";
    std::vector<std::wstring> answers;
};
} // namespace

TEST_F(QuestionPanel, TellsWhoAsksForWhat)
{
    EXPECT_FALSE(ask({[]
                      {
                          EXPECT_EQ(L"moon.bundle", wide([window() title]));
                          EXPECT_THAT(labels(), ElementsAre(L"Size"));
                          EXPECT_EQ(L"", typed());
                      },
                      [] { pressEscape(); }}));
    EXPECT_THAT(answers, IsEmpty());
}

TEST_F(QuestionPanel, TakesWhatIsTypedOverTheDefaultWithReturn)
{
    asked.question.byDefault = L"2.5";
    EXPECT_TRUE(ask({[]
                     {
                         EXPECT_EQ(L"2.5", typed());
                         type(@"3");
                     },
                     [] { pressReturn(); }}));
    EXPECT_THAT(answers, ElementsAre(L"3"));
}

TEST_F(QuestionPanel, TakesTheDefaultAsItIs)
{
    fitting = file("odd\xFF name.txt");
    asked.question.byDefault = fitting;
    EXPECT_TRUE(ask({[] { [button(L"OK") performClick:nil]; }}));
    EXPECT_THAT(answers, ElementsAre(fitting));
}

TEST_F(QuestionPanel, TakesAnEmptyFieldAsAnEmptyText)
{
    asked.question.byDefault = L"usual";
    fitting.clear();
    EXPECT_TRUE(ask({[]
                     {
                         [field() selectText:nil];
                         pressKey(window(), @"\177");
                     },
                     [] { pressReturn(); }}));
    EXPECT_THAT(answers, ElementsAre(L""));
}

TEST_F(QuestionPanel, SaysWhyAnAnswerDoesNotFitAndLosesNothing)
{
    NSRect before;
    EXPECT_TRUE(ask({[&]
                     {
                         before = [window() frame];
                         type(@"many");
                         pressReturn();
                     },
                     [] { return says(L"Not \"many\"."); },
                     [&]
                     {
                         EXPECT_EQ(L"many", typed());
                         EXPECT_GT(NSHeight([window() frame]), NSHeight(before));
                         EXPECT_EQ(NSMaxY([window() frame]), NSMaxY(before)) << "the upper edge stays";
                         EXPECT_EQ(NSMinX([window() frame]), NSMinX(before));
                         type(@"!");
                         pressReturn();
                     },
                     [] { return says(L"Not \"many!\"."); },
                     []
                     {
                         EXPECT_EQ(2u, labels().size()) << "the reason before has gone";
                         [[field() currentEditor] setString:@"3"];
                         pressReturn();
                     }}));
    EXPECT_THAT(answers, ElementsAre(L"many", L"many!", L"3"));
}

TEST_F(QuestionPanel, GoesBackToItsFieldWhenAButtonHasTheKeyboard)
{
    EXPECT_FALSE(ask({[] { type(@"x"); }, [] { return typed() == L"x"; },
                      []
                      {
                          [window() makeFirstResponder:button(L"OK")];
                          pressKey(window(), @" ");
                      },
                      [this] { return answers.size() == 1; }, [] { type(@"y"); },
                      [] { return typed() == L"xy"; }, [] { pressEscape(); }}));
}

TEST_F(QuestionPanel, HasAButtonForEachChoice)
{
    askForYesOrNo();
    fitting = L"No";
    EXPECT_TRUE(ask({[]
                     {
                         EXPECT_EQ(nil, field());
                         EXPECT_EQ(nil, button(L"OK"));
                         EXPECT_LT(NSMaxX([button(L"Cancel") frame]), NSMinX([button(L"No") frame]));
                         EXPECT_LT(NSMaxX([button(L"No") frame]), NSMinX([button(L"Yes") frame]));
                         [button(L"No") performClick:nil];
                     }}));
    EXPECT_THAT(answers, ElementsAre(L"No"));
}

TEST_F(QuestionPanel, TakesTheChoiceThatIsTheDefaultWithReturn)
{
    for (const wchar_t* choice : {L"Yes", L"No"})
    {
        askForYesOrNo(choice);
        fitting = choice;
        EXPECT_TRUE(ask({[] { pressReturn(); }}));
    }
    EXPECT_THAT(answers, ElementsAre(L"Yes", L"No"));
}

TEST_F(QuestionPanel, HasNoDefaultButtonWithoutADefault)
{
    askForYesOrNo();
    EXPECT_FALSE(ask({[]
                      {
                          EXPECT_EQ(L"", wide([button(L"Yes") keyEquivalent]));
                          EXPECT_EQ(L"", wide([button(L"No") keyEquivalent]));
                      },
                      [] { pressEscape(); }}));
}

TEST_F(QuestionPanel, IsCancelledByItsButtonItsFrameAndFromOutside)
{
    EXPECT_FALSE(ask({[] { [button(L"Cancel") performClick:nil]; }}));
    EXPECT_FALSE(ask({[] { [window() performClose:nil]; }}));
    bool isInterrupted = false;
    asked.isInterrupted = [&] { return isInterrupted; };
    EXPECT_FALSE(ask({[&] { isInterrupted = true; }}));
    EXPECT_THAT(answers, IsEmpty());
}

TEST_F(QuestionPanel, IsNotOpenedOnceTheSessionIsToEnd)
{
    const auto request = tessel::openPipe();
    ASSERT_TRUE(request);
    ASSERT_EQ(1, write(request->input.number(), "", 1));
    host().session.endRequest = request->output.number();
    bool isOpened = false;
    asked.isInterrupted = [&] { return isOpened = true; };
    EXPECT_FALSE(tsuiAskInWindow(asked));
    EXPECT_FALSE(isOpened);
}

TEST_F(QuestionPanel, StandsInTheMiddleOfTheWindowThatItIsOver)
{
    EXPECT_FALSE(tsuiHasOpenWindow());
    NSWindow* owner = [[[NSWindow alloc] initWithContentRect:NSMakeRect(200, 250, 700, 500)
                                                   styleMask:NSTitledWindowMask
                                                     backing:NSBackingStoreBuffered
                                                       defer:NO] autorelease];
    [owner setReleasedWhenClosed:NO];
    const ModalSteps steps({[&]
                            {
                                EXPECT_TRUE(tsuiHasOpenWindow());
                                tsuiAskInWindow(asked);
                            },
                            [&]
                            {
                                EXPECT_NE(owner, window());
                                EXPECT_NEAR(NSMidX([owner frame]), NSMidX([window() frame]), 2);
                                EXPECT_NEAR(NSMidY([owner frame]), NSMidY([window() frame]), 2);
                                pressEscape();
                            },
                            [&]
                            {
                                if (window() != owner)
                                    return false;
                                [NSApp stopModal];
                                return true;
                            }});
    [NSApp runModalForWindow:owner];
    [owner orderOut:nil];
}

TEST_F(QuestionPanel, LetsAnotherQuestionComeBetween)
{
    NSWindow* outer = nil;
    bool innerAnswered = false;
    EXPECT_FALSE(ask({[&]
                      {
                          outer = window();
                          type(@"half");
                      },
                      [] { return typed() == L"half"; },
                      [&]
                      {
                          auto inner = asked;
                          inner.question.text = L"Between";
                          innerAnswered = tsuiAskInWindow(inner);
                      },
                      []
                      {
                          EXPECT_THAT(labels(), ElementsAre(L"Between"));
                          type(@"3");
                          pressReturn();
                      },
                      [&] { return window() == outer; },
                      []
                      {
                          EXPECT_EQ(L"half", typed());
                          pressEscape();
                      }}));
    EXPECT_TRUE(innerAnswered);
    EXPECT_THAT(answers, ElementsAre(L"3"));
}

TEST_F(QuestionPanel, IsPartOfTheActionThatAsks)
{
    host().session.waits.clear();
    ask({[] { pressEscape(); }});
    EXPECT_THAT(host().session.waits, testing::Each(false));
    EXPECT_GE(host().session.waits.size(), 1u);
}

namespace
{
// Where the window asks for a file.
class FileQuestion : public QuestionPanel
{
protected:
    FileQuestion() { asked.question.file = Questions::File::kThere; }

    // From the button to what is done in the panel that it opens, and the question again.
    std::vector<ModalStep> inPanel(const std::vector<ModalStep>& steps)
    {
        std::vector<ModalStep> all = {[this]
                                      {
                                          mQuestion = window();
                                          [button(L"Choose…") performClick:nil];
                                      },
                                      [this] { return window() != mQuestion; }};
        all.insert(all.end(), steps.begin(), steps.end());
        all.push_back(ModalStep([this] { return window() == mQuestion; }));
        return all;
    }
    static NSOpenPanel* panel() { return (NSOpenPanel*)window(); }

    NSWindow* mQuestion = nil;
};
} // namespace

TEST_F(FileQuestion, TakesTheFileOfThePanelIntoItsField)
{
    const std::wstring chosen = file("there.txt");
    file("other.txt");
    fitting = chosen;
    asked.question.byDefault = file("folder/../other.txt").substr(0, chosen.rfind(L'/'));
    auto steps = inPanel({[] { selectFilesIn(panel(), {L"there.txt"}); }, [] { pressReturn(); }});
    steps.push_back(ModalStep([&] { return typed() == chosen; }));
    steps.push_back(ModalStep([] { pressReturn(); }));
    EXPECT_TRUE(ask(steps));
    EXPECT_THAT(answers, ElementsAre(chosen));
}

TEST_F(FileQuestion, KeepsWhatWasTypedWhenThePanelIsCancelled)
{
    asked.question.byDefault = file("there.txt");
    auto steps = inPanel({[&]
                          {
                              EXPECT_THAT(filesShownIn(panel()), ElementsAre(L"there.txt"));
                              EXPECT_EQ(L"there.txt", typed()) << "the name field begins with it";
                          },
                          [] { pressEscape(); }});
    steps.push_back(ModalStep(
        [&]
        {
            EXPECT_EQ(asked.question.byDefault, typed());
            pressEscape();
        }));
    EXPECT_FALSE(ask(steps));
}

TEST_F(FileQuestion, IsCancelledTogetherWithItsPanel)
{
    bool isInterrupted = false;
    asked.isInterrupted = [&] { return isInterrupted; };
    EXPECT_FALSE(ask({[&]
                      {
                          mQuestion = window();
                          [button(L"Choose…") performClick:nil];
                      },
                      [&] { return window() != mQuestion; }, [&] { isInterrupted = true; }}));
}

TEST_F(FileQuestion, BeginsInTheFolderOfWhatIsTyped)
{
    file("sub/inner.txt");
    asked.question.byDefault = file("sub/missing.txt").substr(0, file("sub/inner.txt").rfind(L'/')) + L"/new";
    auto steps = inPanel(
        {[&] { EXPECT_EQ(L"sub", wide([[panel() directory] lastPathComponent])); }, [] { pressEscape(); }});
    steps.push_back(ModalStep([] { pressEscape(); }));
    EXPECT_FALSE(ask(steps));
}

namespace
{
class FileChoice : public FilePanelTest
{
protected:
    static NSOpenPanel* running() { return (NSOpenPanel*)[NSApp modalWindow]; }

    // What is chosen when the name that the panel opens with is replaced and Return pressed; after that, the
    // steps.
    std::wstring choose(NSString* typedName, bool mayBeNew, std::vector<ModalStep> steps = {})
    {
        steps.insert(steps.begin(), {hasKeyboard, [=] { typeNameInto(running(), typedName); },
                                     [] { pressKey(running(), @"\r"); }});
        const ModalSteps choosing(steps);
        return wide(tessel::windowing::chooseFile(in(""), @"usual.txt", mayBeNew));
    }
};
} // namespace

TEST_F(FileChoice, IsThatOfAFileThatIsThere)
{
    const std::wstring there = file("there.txt");
    EXPECT_EQ(there, choose(@"there.txt", false));
    EXPECT_EQ(there, choose(@"there.txt", true));
}

TEST_F(FileChoice, MayBeThatOfANewFileWhoseNameIsTheBeginningOfAnother)
{
    const std::wstring longer = file("newer.txt");
    const std::wstring folder = longer.substr(0, longer.rfind(L'/'));
    EXPECT_EQ(folder + L"/new", choose(@"new", true));
    EXPECT_EQ(folder + L"/b c.txt", choose(@"b c.txt", true));
}

TEST_F(FileChoice, BeginsInTheNameFieldForANewName)
{
    const ModalSteps steps({hasKeyboard, []
                            {
                                EXPECT_EQ(L"usual.txt", wide([[nameField(running()) currentEditor] string]));
                                pressKey(running(), @"\r");
                            }});
    const std::wstring chosen = wide(tessel::windowing::chooseFile(in(""), @"usual.txt", true));
    EXPECT_TRUE(chosen.ends_with(L"/usual.txt")) << testing::PrintToString(chosen);
}

TEST_F(FileChoice, OfWhatIsNotThereIsToldAndNotTaken)
{
    const ModalStep cancel([] { pressKey(running(), @"\033"); });
    const ModalStep isTold([] { return boxes().size() == 1; });
    EXPECT_EQ(L"", choose(@"new.txt", false, {isTold, cancel}));
    EXPECT_THAT(boxes(), ElementsAre(L"There is no file \"" + wide(in("new.txt")) + L"\"."));
}

TEST_F(FileChoice, IsToldOfANewNameInAFolderThatIsNotThere)
{
    const ModalStep cancel([] { pressKey(running(), @"\033"); });
    const ModalStep isTold([] { return boxes().size() == 1; });
    EXPECT_EQ(L"", choose(@"nowhere/new.txt", true, {isTold, cancel}));
    EXPECT_THAT(boxes(), ElementsAre(L"There is no file \"" + wide(in("nowhere/new.txt")) + L"\"."));
}
