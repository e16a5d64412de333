// The list of the host's file panel, by mouse and keyboard.
#include "tests/dialogs/support/FilePanelTest.h"
#include "tests/dialogs/support/LanguageOfKeys.h"

#include <ctime>
#include <fstream>
#include <set>

#include <sys/inotify.h>
#include <unistd.h>
#include <utime.h>

#include <tesselui/tsuieach.h>
#include <tesselui/tsuifilepanel.h>

using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;

namespace
{
// Takes all that the system has for this user, so that the panel gets none.
class NoWatches
{
public:
    NoWatches()
    {
        for (int taken = inotify_init1(IN_CLOEXEC); taken >= 0; taken = inotify_init1(IN_CLOEXEC))
            mTaken.push_back(taken);
    }
    ~NoWatches()
    {
        for (const int taken : mTaken)
            close(taken);
    }
    NoWatches(const NoWatches&) = delete;
    NoWatches& operator=(const NoWatches&) = delete;

private:
    std::vector<int> mTaken;
};

class FilePanelList : public FilePanelTest
{
protected:
    void writeFiles(std::initializer_list<const char*> names)
    {
        for (const char* name : names)
            mFolder.write(name, "");
    }
    void writeMany(int count)
    {
        for (int number = 100; number < 100 + count; ++number)
            mFolder.write("tool" + std::to_string(number) + ".lsp", "");
    }
    // Chooses a file far down in a list of many, and remembers what shows then.
    void chooseFarDown(const wchar_t* name)
    {
        [table() scrollRowToVisible:150];
        mFirstVisible = firstVisibleRow();
        selectFilesIn(mPanel, {name});
    }
    // So many rows have come in above; nothing else has moved.
    void expectStillThere(const std::string& name, NSInteger newRows = 0)
    {
        EXPECT_EQ(mFirstVisible + newRows, firstVisibleRow());
        EXPECT_THAT(chosen(), ElementsAre(file(name)));
    }
    // In the middle of the year 2001.
    void giveOldDate(const std::string& name)
    {
        constexpr std::time_t kOld = 992'600'000;
        const utimbuf times{kOld, kOld};
        ASSERT_EQ(0, utime((mFolder / name).c_str(), &times));
    }
    // What the row says about its file's date; the text of a row that nobody has looked at is made now.
    std::wstring dateIn(NSInteger row) { return textIn(@"date", row); }
    void openAnotherPanel()
    {
        [mPanel setDelegate:nil];
        [mPanel release];
        mPanel = [tsuiMakeFilePanel() retain];
    }
    CGFloat widthOf(NSString* column) { return [[table() tableColumnWithIdentifier:column] width]; }
    std::wstring textIn(NSString* identifier, NSInteger row)
    {
        NSTableColumn* column = [table() tableColumnWithIdentifier:identifier];
        return wide([[table() dataSource] tableView:table() objectValueForTableColumn:column row:row]);
    }
    void arrow(unichar key, NSUInteger modifiers = 0)
    {
        pressKey(mPanel, [NSString stringWithCharacters:&key length:1], modifiers);
    }
    NSInteger mFirstVisible = 0;
};
} // namespace

TEST_F(FilePanelList, HasFoldersFirstAndNoHiddenFiles)
{
    writeFiles({"b.lsp", "a.lsp", "zoo/inner.lsp", ".hidden.lsp"});
    use({[this]
         {
             EXPECT_THAT(shown(), ElementsAre(L"zoo", L"a.lsp", L"b.lsp"));
             [mPanel setShowsHiddenFiles:YES];
             EXPECT_THAT(shown(), ElementsAre(L"zoo", L".hidden.lsp", L"a.lsp", L"b.lsp"));
         }});
}

TEST_F(FilePanelList, TakesRangesWithShiftAndSingleRowsWithControl)
{
    writeFiles({"a.lsp", "b.lsp", "c.lsp", "d.lsp"});
    use({[this] { clickRow(table(), 0); }, [this] { return chosen().size() == 1; },
         [this] { clickRow(table(), 2, NSShiftKeyMask); }, [this] { return chosen().size() == 3; },
         [this] { clickRow(table(), 1, NSControlKeyMask); }, [this] { return chosen().size() == 2; },
         [this]
         {
             EXPECT_THAT(chosen(), ElementsAre(file("a.lsp"), file("c.lsp")));
             EXPECT_EQ(L"\"a.lsp\" \"c.lsp\"", name());
         }});
}

TEST_F(FilePanelList, TakesOneFileWhereNoMoreAreAllowed)
{
    writeFiles({"a.lsp", "b.lsp"});
    [mPanel setAllowsMultipleSelection:NO];
    use({[this] { clickRow(table(), 0); }, [this] { clickRow(table(), 1, NSShiftKeyMask); },
         [this] { return chosen() == std::vector{file("b.lsp")}; }});
}

TEST_F(FilePanelList, TakesRangesWithShiftAndArrowsAndEverythingWithControlA)
{
    writeFiles({"a.lsp", "b.lsp", "c.lsp"});
    use({[this] { arrow(NSDownArrowFunctionKey); }, [this] { arrow(NSDownArrowFunctionKey, NSShiftKeyMask); },
         [this] {
             return chosen() == std::vector{file("a.lsp"), file("b.lsp")};
         },
         [this] { pressKey(mPanel, @"a", NSControlKeyMask); }, [this] { return chosen().size() == 3; }});
}

TEST_F(FilePanelList, EndsWithTheFileThatIsDoubleClicked)
{
    writeFiles({"a.lsp", "b.lsp"});
    EXPECT_EQ(NSModalResponseOK,
              run({[this] { clickRow(table(), 1); }, [this] { return chosen().size() == 1; },
                   [this] { clickRow(table(), 1, 0, 2); }}));
    EXPECT_THAT(chosen(), ElementsAre(file("b.lsp")));
}

TEST_F(FilePanelList, GoesIntoAFolderByDoubleClickAndByReturn)
{
    writeFiles({"outer/inner/a.lsp"});
    use({[this] { clickRow(table(), 0); }, [this] { clickRow(table(), 0, 0, 2); },
         [this] { return shown() == std::vector<std::wstring>{L"inner"}; },
         [this]
         {
             EXPECT_THAT(chosen(), IsEmpty());
             arrow(NSDownArrowFunctionKey);
         },
         [this]
         {
             EXPECT_THAT(chosen(), IsEmpty()) << "a folder on the way";
             pressKey(mPanel, @"\r");
         },
         [this] { return shown() == std::vector<std::wstring>{L"a.lsp"}; },
         [this] { EXPECT_EQ((mFolder / "outer/inner").wstring(), folder()); }});
}

TEST_F(FilePanelList, GoesUpWithBackspaceAndAltUpToTheFolderThatItCameFrom)
{
    writeFiles({"outer/inner/a.lsp", "outer/another/b.lsp"});
    use({[this] { pressKey(mPanel, @"\177"); }, [this] { return folder() == (mFolder / "outer").wstring(); },
         [this]
         {
             EXPECT_THAT(selectedRows(), ElementsAre(1));
             EXPECT_THAT(chosen(), IsEmpty());
             arrow(NSUpArrowFunctionKey, NSCommandKeyMask);
         },
         [this] { return folder() == mFolder.path().wstring(); }},
        "outer/inner");
}

TEST_F(FilePanelList, GoesToTheRowOfTheFirstLetters)
{
    writeFiles({"alpha.lsp", "beta.lsp", "bravo.lsp"});
    use({[this] { type(@"b"); }, [this] { return name() == L"beta.lsp"; }, [this] { type(@"r"); },
         [this] { return chosen() == std::vector{file("bravo.lsp")}; }});
}

TEST_F(FilePanelList, TellsItsDelegateOfEveryChoiceAlsoOfTheSameAgain)
{
    writeFiles({"a.lsp"});
    int before = 0;
    use({[&]
         {
             before = mListener->told;
             clickRow(table(), 0);
         },
         [&] { return mListener->told == before + 1; }, [&] { clickRow(table(), 0); },
         [&] { return mListener->told == before + 2; }});
}

TEST_F(FilePanelList, IsSortedByItsHeaders)
{
    writeFiles({"b.omp", "a.zmb", "c.lsp"});
    use({[this]
         {
             NSTableColumn* kind = [table() tableColumnWithIdentifier:@"kind"];
             [[table() delegate] tableView:table() didClickTableColumn:kind];
             EXPECT_THAT(shown(), ElementsAre(L"c.lsp", L"b.omp", L"a.zmb"));
             [[table() delegate] tableView:table() didClickTableColumn:kind];
             EXPECT_THAT(shown(), ElementsAre(L"a.zmb", L"b.omp", L"c.lsp"));
         }});
}

TEST_F(FilePanelList, KeepsFolderSelectionAndPlaceWhenItsDelegateIsAskedAgain)
{
    writeMany(200);
    use({[this]
         {
             chooseFarDown(L"tool249.lsp");
             mListener->hidden = @"tool12";
             const int told = mListener->told;
             [mPanel validateVisibleColumns];
             EXPECT_EQ(190u, shown().size());
             expectStillThere("tool249.lsp", -10);
             EXPECT_EQ(told, mListener->told) << "nothing has changed";
             mListener->hidden = @"tool24";
             [mPanel validateVisibleColumns];
             EXPECT_THAT(chosen(), IsEmpty());
             EXPECT_EQ(L"", name());
             EXPECT_EQ(told + 1, mListener->told);
         }});
}

TEST_F(FilePanelList, AsksItsDelegateAgainWhenItIsSentAwayAndBack)
{
    writeMany(200);
    use({[this]
         {
             chooseFarDown(L"tool250.lsp");
             mListener->hidden = @"tool299";
             [mPanel setDirectory:@"/"];
             [mPanel setDirectory:in("")];
         },
         [this] { return shown().size() == 199; }, [this] { expectStillThere("tool250.lsp"); }});
}

TEST_F(FilePanelList, ShowsWhatComesIntoTheFolderAndKeepsItsPlace)
{
    writeMany(200);
    use({[this]
         {
             chooseFarDown(L"tool250.lsp");
             mFolder.write("a-new-one.lsp", "");
         },
         [this] { return shown().size() == 201; }, [this] { expectStillThere("tool250.lsp", 1); }});
}

TEST_F(FilePanelList, ShowsNewDatesOfFilesAndKeepsItsPlace)
{
    writeMany(200);
    use({[this]
         {
             chooseFarDown(L"tool250.lsp");
             EXPECT_NE(L"2001", dateIn(150).substr(0, 4));
             giveOldDate("tool250.lsp");
         },
         [this] { return dateIn(150).starts_with(L"2001-"); }, [this] { expectStillThere("tool250.lsp"); }});
}

TEST_F(FilePanelList, PutsAFileWhereItsNewDateBelongs)
{
    writeFiles({"a.lsp", "b.lsp", "c.lsp"});
    use({[this]
         {
             [[table() delegate] tableView:table()
                       didClickTableColumn:[table() tableColumnWithIdentifier:@"date"]];
             selectFilesIn(mPanel, {L"c.lsp"});
             giveOldDate("c.lsp");
         },
         [this] { return shown().front() == L"c.lsp"; },
         [this]
         {
             EXPECT_THAT(chosen(), ElementsAre(file("c.lsp")));
             EXPECT_THAT(selectedRows(), ElementsAre(0));
         }});
}

TEST_F(FilePanelList, FollowsAFolderThatComesBack)
{
    writeFiles({"outer/inner/a.lsp"});
    use({[this]
         {
             std::filesystem::remove_all(mFolder / "outer/inner");
             mFolder.write("outer/inner/b.lsp", "");
         },
         [this] { return shown() == std::vector<std::wstring>{L"b.lsp"}; },
         [this] { mFolder.write("outer/inner/c.lsp", ""); },
         [this] {
             return shown() == std::vector<std::wstring>{L"b.lsp", L"c.lsp"};
         },
         [this] { std::filesystem::rename(mFolder / "outer", mFolder / "elsewhere"); },
         [this] { return folder() == mFolder.path().wstring(); }},
        "outer/inner");
}

// As on the folders of other computers.
TEST_F(FilePanelList, LooksForChangesWhereNobodyTellsOfThem)
{
    const NoWatches none;
    writeFiles({"a.lsp"});
    use({[this] { mFolder.write("b.lsp", ""); },
         [this] {
             return shown() == std::vector<std::wstring>{L"a.lsp", L"b.lsp"};
         },
         [this] { giveOldDate("a.lsp"); }, [this] { return dateIn(0).starts_with(L"2001-"); }});
}

TEST_F(FilePanelList, ShowsTheNearestFolderWhenItsOwnIsGone)
{
    writeFiles({"outer/inner/a.lsp"});
    use({[this] { std::filesystem::remove_all(mFolder / "outer/inner"); },
         [this] { return folder() == (mFolder / "outer").wstring(); }},
        "outer/inner");
}

TEST_F(FilePanelList, FindsAFolderWhileThoseOnTheWayChange)
{
    writeFiles({"outer/inner/a.lsp"});
    use({[this]
         {
             mFolder.write("outer/one-more", "");
             [mPanel setDirectory:in("outer/inner")];
             EXPECT_THAT(chosen(), IsEmpty());
             EXPECT_THAT(shown(), ElementsAre(L"a.lsp"));
         }});
}

TEST_F(FilePanelList, GoesIntoTheHostsOwnPackage)
{
    NSString* host = [[NSBundle mainBundle] bundlePath];
    const std::wstring hostName = wide([host lastPathComponent]);
    [mPanel setDirectory:[host stringByDeletingLastPathComponent]];
    const ModalSteps running({[&] { selectFilesIn(mPanel, {hostName.c_str()}); },
                              [&]
                              {
                                  EXPECT_THAT(chosen(), ElementsAre(wide(host)));
                                  pressKey(mPanel, @"\r");
                              },
                              [&] { return folder() == wide(host); }, [&] { [mPanel cancel:nil]; }});
    [mPanel runModal];
}

TEST_F(FilePanelList, TakesAnyOtherPackageForAFile)
{
    writeFiles({"tool.bundle/tool"});
    EXPECT_EQ(NSModalResponseOK, run({[this] { selectFilesIn(mPanel, {L"tool.bundle"}); },
                                      [this] { pressKey(mPanel, @"\r"); }}));
    EXPECT_THAT(chosen(), ElementsAre((mFolder / "tool.bundle").wstring()));
}

TEST_F(FilePanelList, LivesWithOddNames)
{
    writeFiles({"new\nline.lsp", "q\"uote #%41?.lsp"});
    std::ofstream((mFolder / "bad\xE9.lsp").string()).put('x');
    use({[this]
         {
             EXPECT_THAT(shown(), ElementsAre(L"bad\\xE9.lsp", L"new\\nline.lsp", L"q\"uote #%41?.lsp"));
             [table() selectAll:nil];
             EXPECT_THAT(chosen(), ElementsAre(file("bad\xE9.lsp"), (mFolder / "new\nline.lsp").wstring(),
                                               (mFolder / "q\"uote #%41?.lsp").wstring()));
         }});
}

TEST_F(FilePanelList, TakesEveryWordFromTheTableOfItsLanguage)
{
    const LanguageOfKeys language;
    writeFiles({"a.lsp", "b", "c.bundle/c", "d/d"});
    openAnotherPanel();
    std::set<std::wstring> texts;
    use({[&]
         {
             texts = textsIn([mPanel contentView]);
             for (NSInteger row = 0; row < 4; ++row)
                 texts.insert(textIn(@"kind", row));
         }});
    EXPECT_THAT(texts, UnorderedElementsAre(L"<UP>", L"<HOME>", L"<RECENT>", L"<RECENT_TIP>",
                                            L"<NAME_COLUMN>  \u2191", L"<KIND_COLUMN>", L"<DATE_COLUMN>",
                                            L"<FOLDER>", L"<PACKAGE>", L"<FILE>", L"<FILE_OF_KIND>",
                                            L"<NAME_FIELD>", L"<HIDDEN_FILES>", L"<OPEN>", L"<CANCEL>"));
}

TEST_F(FilePanelList, SpeaksEnglish)
{
    writeFiles({"a.lsp", "b", "c.bundle/c", "d/d"});
    use({[this]
         {
             for (const wchar_t* title : {L"Up", L"Home", L"Hidden files", L"Open", L"Cancel"})
                 EXPECT_TRUE(button(title)) << title;
             EXPECT_EQ(L"Folder", textIn(@"kind", 0));
             EXPECT_EQ(L"LSP file", textIn(@"kind", 1));
             EXPECT_EQ(L"File", textIn(@"kind", 2));
             EXPECT_EQ(L"Package", textIn(@"kind", 3));
         }});
}

TEST_F(FilePanelList, RemembersWhetherHiddenFilesShow)
{
    writeFiles({".hidden.lsp"});
    use({[this]
         {
             EXPECT_THAT(shown(), IsEmpty());
             [button(L"Hidden files") performClick:nil];
         },
         [this] { return shown().size() == 1; }});
    openAnotherPanel();
    use({[this]
         {
             EXPECT_THAT(shown(), ElementsAre(L".hidden.lsp"));
             [button(L"Hidden files") performClick:nil];
         },
         [this] { return shown().empty(); }});
    openAnotherPanel();
    use({[this] { EXPECT_THAT(shown(), IsEmpty()); }});
}

TEST_F(FilePanelList, RemembersItsColumnsWhichAlwaysFillIt)
{
    const CGFloat name = widthOf(@"name");
    const CGFloat kind = widthOf(@"kind");
    const CGFloat date = widthOf(@"date");
    const auto isFull = [this]
    {
        return widthOf(@"name") + widthOf(@"kind") + widthOf(@"date") ==
               NSWidth([[[table() enclosingScrollView] contentView] bounds]);
    };
    EXPECT_TRUE(isFull());
    use({[&]
         {
             [[table() tableColumnWithIdentifier:@"name"] setWidth:name - 50];
             EXPECT_EQ(kind + 50, widthOf(@"kind")) << "the next column takes it";
             EXPECT_EQ(date, widthOf(@"date"));
             [[table() tableColumnWithIdentifier:@"kind"] setWidth:kind + 30];
             EXPECT_EQ(name - 50, widthOf(@"name"));
             EXPECT_EQ(date + 20, widthOf(@"date"));
             [[table() tableColumnWithIdentifier:@"name"] setWidth:2000];
             EXPECT_EQ(60, widthOf(@"kind")) << "none gets lost";
             EXPECT_EQ(date + 20, widthOf(@"date"));
             EXPECT_TRUE(isFull());
             [[table() tableColumnWithIdentifier:@"name"] setWidth:widthOf(@"name") - 70];
         }});
    openAnotherPanel();
    EXPECT_EQ(130, widthOf(@"kind"));
    EXPECT_EQ(date + 20, widthOf(@"date"));
    EXPECT_TRUE(isFull());
}

TEST_F(FilePanelList, RemembersTheFoldersThatWereUsed)
{
    writeFiles({"one/a.lsp", "two/b.lsp"});
    use({}, "one");
    use({}, "two");
    use({[this]
         {
             NSPopUpButton* recent = nil;
             for (NSView* row : {[[[mPanel contentView] subviews] objectAtIndex:0]})
                 recent = [[row subviews] lastObject];
             EXPECT_EQ((mFolder / "two").wstring(), wide([recent itemTitleAtIndex:1]));
             EXPECT_EQ((mFolder / "one").wstring(), wide([recent itemTitleAtIndex:2]));
             [recent selectItemAtIndex:2];
             [NSApp sendAction:[recent action] to:[recent target] from:recent];
             EXPECT_EQ((mFolder / "one").wstring(), folder());
         }});
}

TEST_F(FilePanelList, AsksItsDelegateOnceWhenThatAndTheWayAwayAndBackComeTogether)
{
    writeMany(20);
    int turns = 0;
    use({[this]
         {
             mListener->asked = 0;
             [mPanel validateVisibleColumns];
             [mPanel setDirectory:@"/"];
             [mPanel setDirectory:in("")];
         },
         [&] { return ++turns > 3; }, [this] { EXPECT_EQ(20, mListener->asked); }});
}

TEST_F(FilePanelList, ReadsTheFolderAgainWithF5)
{
    writeFiles({"a.lsp", "b.lsp"});
    use({[this]
         {
             mListener->hidden = @"a.lsp";
             arrow(NSF5FunctionKey);
         },
         [this] { return shown() == std::vector<std::wstring>{L"b.lsp"}; }});
}

TEST_F(FilePanelList, GoesToTheFoldersOnItsButtons)
{
    writeFiles({"outer/inner/a.lsp"});
    use({[this]
         {
             ASSERT_TRUE(button(L"outer") && button(L"inner") && button(L"/"));
             [button(L"outer") performClick:nil];
             EXPECT_EQ((mFolder / "outer").wstring(), folder());
             EXPECT_FALSE(button(L"inner"));
             [button(L"Up") performClick:nil];
             EXPECT_EQ(mFolder.path().wstring(), folder());
             [button(L"Home") performClick:nil];
             EXPECT_EQ(wide(NSHomeDirectory()), folder());
             [button(L"/") performClick:nil];
             EXPECT_EQ(L"/", folder());
         }},
        "outer/inner");
}

TEST_F(FilePanelList, ShowsHiddenFilesWithItsSwitch)
{
    writeFiles({".hidden.lsp"});
    use({[this]
         {
             [button(L"Hidden files") performClick:nil];
             EXPECT_THAT(shown(), ElementsAre(L".hidden.lsp"));
             [button(L"Hidden files") performClick:nil];
             EXPECT_THAT(shown(), IsEmpty());
         }});
}

TEST_F(FilePanelList, IsReachedByTabInTheOrderOfReading)
{
    use({[this]
         {
             [mPanel makeFirstResponder:table()];
             [mPanel selectNextKeyView:nil];
             EXPECT_TRUE([nameField(mPanel) currentEditor] != nil);
             [mPanel selectKeyViewFollowingView:nameField(mPanel)];
             EXPECT_EQ(button(L"Hidden files"), [mPanel firstResponder]);
             [mPanel selectNextKeyView:nil];
             EXPECT_EQ(button(L"Cancel"), [mPanel firstResponder]);
             [mPanel selectNextKeyView:nil];
             EXPECT_EQ(button(L"Up"), [mPanel firstResponder]) << "Open is disabled";
             [mPanel selectNextKeyView:nil];
             EXPECT_EQ(button(L"Home"), [mPanel firstResponder]);
         }});
}

TEST_F(FilePanelList, StaysWithinTheScreen)
{
    NSView* tall = [[[NSView alloc] initWithFrame:NSMakeRect(0, 0, 700, 3000)] autorelease];
    [mPanel setAccessoryView:tall];
    use({[this]
         {
             const NSRect screen = [[NSScreen mainScreen] visibleFrame];
             EXPECT_LE(NSHeight([mPanel frame]), NSHeight(screen));
         }});
}
