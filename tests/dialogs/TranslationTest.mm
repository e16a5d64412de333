// Whether all that a person reads in the windows comes from texts that are translated: in a language whose
// words are their keys, a text that the code holds stands out.
#include "tests/dialogs/support/DialogTest.h"
#include "tests/dialogs/support/Events.h"
#include "tests/dialogs/support/LanguageOfKeys.h"

#include <algorithm>

#import <tesselui/TsOCOpenFileDialog.h>
#include <tesselui/tsuieach.h>
#include <tesselui/tsuitexts.h>

#import "modrig/dialogs/ModrigStartupSuitController.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

using testing::Contains;
using testing::IsEmpty;
using testing::SizeIs;

namespace
{
using TextsOfAWindow = std::set<std::wstring>;

bool isWritten(const std::wstring& text)
{
    return std::ranges::any_of(text, [](wchar_t letter) { return std::iswalpha(std::wint_t(letter)); });
}

// Those that neither come by a key nor stand in the layout. A sign may follow the key.
TextsOfAWindow notTranslated(const TextsOfAWindow& texts, const TextsOfAWindow& layout = {})
{
    TextsOfAWindow result;
    for (const std::wstring& text : texts)
        if (const bool hasKey = text.starts_with(L'<') && text.find(L'>') != text.npos;
            isWritten(text) && !hasKey && !layout.contains(text))
            result.insert(text);
    return result;
}

NSMenu* menuOn(NSTableView* table)
{
    const NSPoint place = [table convertPoint:NSMakePoint(10, 10) toView:nil];
    return [table menuForEvent:[NSEvent mouseEventWithType:NSRightMouseDown
                                                  location:place
                                             modifierFlags:0
                                                 timestamp:0
                                              windowNumber:[[table window] windowNumber]
                                                   context:nil
                                               eventNumber:0
                                                clickCount:1
                                                  pressure:1]];
}

TextsOfAWindow textsOfMenu(NSMenu* menu)
{
    TextsOfAWindow texts;
    for (NSMenuItem* item : tsuiEach<NSMenuItem*>([menu itemArray]))
        if (![item isSeparatorItem])
            texts.insert(wide([item title]));
    return texts;
}

class Translation : public OpenDialogTest
{
};
} // namespace

TEST_F(Translation, IsMissedWhereATextStandsInTheCode)
{
    EXPECT_THAT(notTranslated({L"<OPEN>", L"<NAME>  \u2191", L"+", L"Load", L"Up"}, {L"Load"}),
                testing::ElementsAre(L"Up"));
    NSButton* button = [[[NSButton alloc] initWithFrame:NSZeroRect] autorelease];
    [button setTitle:@"Open"];
    [button setToolTip:@"Opens"];
    EXPECT_THAT(textsIn(button), testing::ElementsAre(L"Open", L"Opens"));
}

TEST_F(Translation, CoversTheMainDialog)
{
    const LanguageOfKeys language;
    open();
    for (const NSInteger tab : {0, 1})
    {
        [mController setTabViewSelectedIndex:tab];
        const auto texts = textsIn([mPanel contentView]);
        EXPECT_THAT(texts, Contains(L"<IDS_MODRIG_CLOSE_BUTTON>"));
        EXPECT_THAT(texts, Contains(L"<IDS_MODRIG_LSP_APPS>"));
        EXPECT_THAT(texts, Contains(L"<HIDDEN_FILES>"));
        EXPECT_THAT(notTranslated(texts, textsOfLayout(@"Modrig")), IsEmpty());
    }
}

TEST_F(Translation, CoversTheMenusOfRows)
{
    fill(gHistoryList, {"a.lsp"});
    loadedModule("module.zmb");
    const LanguageOfKeys language;
    open();
    for (NSTableView* table : {loadedTable(), historyTable()})
    {
        const auto texts = textsOfMenu(menuOn(table));
        EXPECT_THAT(texts, SizeIs(testing::Ge(3U)));
        EXPECT_THAT(notTranslated(texts), IsEmpty());
    }
}

TEST_F(Translation, CoversTheStartupSuite)
{
    const LanguageOfKeys language;
    open();
    ModrigStartupSuitController* suite = [[[ModrigStartupSuitController alloc] init] autorelease];
    ASSERT_TRUE([suite window]);
    [suite doInit];
    const auto layout = textsOfLayout(@"ModrigStartupSuit");
    EXPECT_THAT(notTranslated(textsIn([[suite window] contentView]), layout), IsEmpty());
    EXPECT_THAT(layout, Contains(wide([[suite window] title])));
    [suite doClean];
}

TEST_F(Translation, CoversTheAddPanel)
{
    const LanguageOfKeys language;
    NSMutableArray* filters = [NSMutableArray array];
    [TsOCModrigUtil populateModrigFileFilter:filters];
    TsOCOpenFileDialog* dialog = [[[TsOCOpenFileDialog alloc] init] autorelease];
    [dialog setInitialPath:path("folder")];
    [dialog setFileFilters:filters];
    TextsOfAWindow texts;
    const ModalSteps steps(
        {[&] { texts = textsIn([[NSApp modalWindow] contentView]); }, [] { [NSApp stopModal]; }});
    [dialog runModal];
    EXPECT_THAT(texts, Contains(L"<SHOW>"));
    EXPECT_THAT(notTranslated(texts), IsEmpty());
}

TEST_F(Translation, CoversMessageBoxes)
{
    const LanguageOfKeys language;
    open();
    TextsOfAWindow texts;
    lookAtMessageBox(L"1", L"2", [&](NSView* box) { texts = textsIn(box); });
    EXPECT_THAT(texts, testing::ElementsAre(L"1", L"2", L"<OK>"));
}

// As if a translation were not finished.
TEST_F(Translation, FallsBackToEnglishWhereATextIsMissing)
{
    mFolder.write("texts.bundle/Resources/de.lproj/Words.strings", "\"ONE\" = \"eins\";\n");
    mFolder.write("texts.bundle/Resources/en.lproj/Words.strings",
                  "\"ONE\" = \"one\";\n\"TWO\" = \"two\";\n");
    NSBundle* bundle = [NSBundle bundleWithPath:path("texts.bundle")];
    for (NSString* language : {@"de", @"en"})
        ASSERT_TRUE([bundle pathForResource:@"Words"
                                     ofType:@"strings"
                                inDirectory:nil
                            forLocalization:language]);
    EXPECT_EQ(L"two", wide(tsuiTextOf(bundle, @"TWO", @"Words")));
    EXPECT_EQ(L"THREE", wide(tsuiTextOf(bundle, @"THREE", @"Words")));
    EXPECT_EQ(wide([bundle localizedStringForKey:@"ONE" value:@"" table:@"Words"]),
              wide(tsuiTextOf(bundle, @"ONE", @"Words")));
}
