#include "tests/dialogs/support/DialogTest.h"

#import <tesselui/TsOCFileFilter.h>

#import "modrig/dialogs/ModrigArrayController.h"
#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

#include "modrig/messages/MessageIds.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class Bridge : public DialogTest
{
protected:
    static ModrigArrayController* makeTable()
    {
        return [[[ModrigArrayController alloc] initWithContent:[NSMutableArray array]] autorelease];
    }
    static std::vector<std::wstring> extensionsOf(TsOCFileFilter* filter)
    {
        std::vector<std::wstring> extensions;
        for (NSUInteger index = 0; index < [[filter fileExtensions] count]; ++index)
            extensions.push_back(wide([[filter fileExtensions] objectAtIndex:index]));
        return extensions;
    }
    static std::vector<std::wstring> descriptionsOf(NSArray* filters)
    {
        std::vector<std::wstring> descriptions;
        for (NSUInteger index = 0; index < [filters count]; ++index)
            descriptions.push_back(wide([[filters objectAtIndex:index] description]));
        return descriptions;
    }
};
} // namespace

TEST_F(Bridge, HoldsTheOpenDialogAndLetsItGo)
{
    EXPECT_EQ(nil, [TsOCModrigUtil getModrigController]);
    ModrigController* first = [[ModrigController alloc] init];
    const NSUInteger count = [first retainCount];
    [TsOCModrigUtil setModrigController:first];
    EXPECT_EQ(first, [TsOCModrigUtil getModrigController]);
    EXPECT_EQ(count + 1, [first retainCount]);
    [TsOCModrigUtil setModrigController:first];
    EXPECT_EQ(count + 1, [first retainCount]);
    [TsOCModrigUtil setModrigController:nil];
    EXPECT_EQ(nil, [TsOCModrigUtil getModrigController]);
    EXPECT_EQ(count, [first retainCount]);
    [first release];
}

TEST_F(Bridge, AddsNoRowForAPathThatDiffersInCaseOnly)
{
    ModrigArrayController* table = makeTable();
    [TsOCModrigUtil addPathName:@"/a/B.LSP" toArrayController:table];
    [TsOCModrigUtil addPathName:@"/A/b.lsp" toArrayController:table];
    EXPECT_THAT(rowsOf(table), ElementsAre(L"/a/B.LSP"));
}

TEST_F(Bridge, AddsNoRowForALinkToAFileThatHasOne)
{
    file("real.lsp");
    std::filesystem::create_symlink(mFolder / "real.lsp", mFolder / "link.lsp");
    ModrigArrayController* table = makeTable();
    [TsOCModrigUtil addPathName:path("real.lsp") toArrayController:table];
    [TsOCModrigUtil addPathName:path("link.lsp") toArrayController:table];
    EXPECT_THAT(rowsOf(table), ElementsAre(file("real.lsp")));
}

TEST_F(Bridge, MakesTheRowFromTheResolvedPath)
{
    file("real.lsp");
    std::filesystem::create_symlink(mFolder / "real.lsp", mFolder / "link.lsp");
    ModrigArrayController* table = makeTable();
    [TsOCModrigUtil addPathName:path("link.lsp") toArrayController:table];
    EXPECT_EQ(L"real.lsp", wide([[[table arrangedObjects] objectAtIndex:0] fileName]));
}

TEST_F(Bridge, AddsPathsByTheEqualityOfRows)
{
    // The same letter in one character and in two, as file systems hand it out.
    NSString* whole = @"/a/Caf\u00e9.lsp";
    NSString* parts = @"/a/CAFE\u0301.lsp";
    ModrigFilePath* wholeRow = [[[ModrigFilePath alloc] initWithFilePathName:whole] autorelease];
    ModrigFilePath* partsRow = [[[ModrigFilePath alloc] initWithFilePathName:parts] autorelease];
    ASSERT_TRUE([wholeRow isEqual:partsRow]);
    ModrigArrayController* table = makeTable();
    [TsOCModrigUtil addPathName:whole toArrayController:table];
    [TsOCModrigUtil addPathName:parts toArrayController:table];
    EXPECT_EQ(1u, [[table arrangedObjects] count]);
    [table removeObjects:[NSArray arrayWithObject:partsRow]];
    EXPECT_EQ(0u, [[table arrangedObjects] count]);
}

TEST_F(Bridge, OffersSixFiltersInTheirOrderWhateverIsStored)
{
    host().registry.setValue(host().moduleKey(), L"FileFilter", L"Lisp source (*.lsp)");
    NSMutableArray* filters = [NSMutableArray arrayWithObject:@"kept"];
    [TsOCModrigUtil populateModrigFileFilter:filters];
    ASSERT_EQ(7u, [filters count]);
    EXPECT_EQ(L"kept", wide([filters objectAtIndex:0]));
    EXPECT_THAT(extensionsOf([filters objectAtIndex:1]),
                ElementsAre(L"bundle", L"zmb", L"lsp", L"omp", L"qbc", L"rpk", L"mcp"));
    EXPECT_THAT(extensionsOf([filters objectAtIndex:2]), ElementsAre(L"bundle"));
    EXPECT_THAT(extensionsOf([filters objectAtIndex:3]), ElementsAre(L"zmb"));
    EXPECT_THAT(extensionsOf([filters objectAtIndex:4]), ElementsAre(L"lsp"));
    EXPECT_THAT(extensionsOf([filters objectAtIndex:5]), ElementsAre(L"omp"));
    EXPECT_THAT(extensionsOf([filters objectAtIndex:6]), ElementsAre(L"qbc"));
}

TEST_F(Bridge, DescribesEachFilterByTheTextThatBelongsToItsExtensions)
{
    NSMutableArray* filters = [NSMutableArray array];
    [TsOCModrigUtil populateModrigFileFilter:filters];
    EXPECT_THAT(descriptionsOf(filters),
                ElementsAre(L"All Tessel applications", L"Extension modules (*.bundle)",
                            L"Core modules (*.zmb)", L"Lisp source (*.lsp)",
                            L"Object-database modules (*.omp)", L"Compiled Lisp (*.qbc)"));
}

TEST_F(Bridge, AnswersTheKeyForATextThatIsMissing)
{
    EXPECT_EQ(L"Close", wide([TsOCModrigUtil modrigLoadString:@"IDS_MODRIG_CLOSE_BUTTON"]));
    EXPECT_EQ(L"IDS_MODRIG_MISSING", wide([TsOCModrigUtil modrigLoadString:@"IDS_MODRIG_MISSING"]));
}

TEST_F(Bridge, PassesTheQuestionsAboutAFileOn)
{
    EXPECT_TRUE([TsOCModrigUtil isValidFileForModrig:@"/a/tool.lsp"]);
    EXPECT_FALSE([TsOCModrigUtil isValidFileForModrig:@"/a/text.txt"]);
    EXPECT_FALSE([TsOCModrigUtil isValidFileForModrig:@"/a/tool"]);
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/a/tool")));
    EXPECT_EQ(file("tool.lsp"), wide([TsOCModrigUtil validateFileExists:path("tool.lsp")]));
    EXPECT_EQ(nil, [TsOCModrigUtil validateFileExists:@"/gone/missing.lsp"]);
    host().internet.urlsOfLocalFiles[L"/tmp/net.lsp"] = L"http://example.org/net.lsp";
    EXPECT_TRUE([TsOCModrigUtil isTempInternetFile:@"/tmp/net.lsp"]);
    EXPECT_FALSE([TsOCModrigUtil isTempInternetFile:@"/tmp/tool.lsp"]);
}

TEST_F(Bridge, AnswersThePathAtWhichAFileWasFound)
{
    host().files.found[L"tool.lsp"] = file("elsewhere/tool.lsp");
    EXPECT_EQ(file("elsewhere/tool.lsp"), wide([TsOCModrigUtil validateFileExists:@"/gone/tool.lsp"]));
}
