#include "tests/dialogs/support/DialogTest.h"

#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/ModrigFolderPath.h"

#include <wincompat/winstring.h>

#include <filesystem>
#include <set>

#include "modrig/messages/MessageIds.h"

@interface SpecialFilePath : ModrigFilePath
@end

@implementation SpecialFilePath
@end

// Some toolkits make no string of what is no text.
@interface HalvesOfCharacters : NSString
@end

@implementation HalvesOfCharacters

- (NSUInteger)length
{
    return 5;
}

- (unichar)characterAtIndex:(NSUInteger)index
{
    constexpr unichar kHalves[] = {0xDE00, 'a', 0xD83D, 'b', 0xD83D};
    return kHalves[index];
}

@end

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class FilePath : public DialogTest
{
protected:
    static ModrigFilePath* make(NSString* path)
    {
        return [[[ModrigFilePath alloc] initWithFilePathName:path] autorelease];
    }
};
} // namespace

TEST_F(FilePath, KeepsEveryCharacterOfItsPath)
{
    const std::wstring name = L"\u00FC \u4E2D \U0001F600 100%.lsp";
    EXPECT_EQ(name, wide([make(wcharToNSString((L"/none/" + name).c_str())) fileName]));
    EXPECT_EQ(L"/none/" + name, [make(wcharToNSString((L"/none/" + name).c_str())) path].Text());
}

TEST_F(FilePath, KeepsPathsOfEveryLength)
{
    for (std::size_t length = 1; length < 600; ++length)
    {
        const std::wstring path = L"/" + std::wstring(length, L'x') + L".lsp";
        EXPECT_EQ(path, wide(wcharToNSString(path.c_str())));
        EXPECT_EQ(path, [make(wcharToNSString(path.c_str())) path].Text());
    }
    EXPECT_EQ(L"", wide(wcharToNSString(L"")));
    EXPECT_EQ(nil, wcharToNSString(nullptr));
}

TEST_F(FilePath, KeepsBytesThatAreNoText)
{
    const std::wstring odd = file("r\xE9pertoire/odd\xFF.lsp");
    EXPECT_EQ(odd, [make(text(odd)) path].Text());
    EXPECT_EQ(L"odd\U0010FEFF.lsp", wide([make(text(odd)) fileName]));
    EXPECT_EQ((mFolder.path().wstring() + L"/r\U0010FEE9pertoire"), wide([make(text(odd)) filePath]));
}

TEST_F(FilePath, ReplacesWhatIsHalfACharacter)
{
    NSString* halves = [[[HalvesOfCharacters alloc] init] autorelease];
    EXPECT_EQ(L"\uFFFDa\uFFFDb\uFFFD", NSStringToWstring(halves));
    EXPECT_EQ(L"", NSStringToWstring(nil));
}

TEST_F(FilePath, TakesAPathApart)
{
    ModrigFilePath* row = make(path("tool.lsp"));
    EXPECT_EQ(file("tool.lsp"), wide([row filePathName]));
    EXPECT_EQ(L"tool.lsp", wide([row fileName]));
    EXPECT_EQ(mFolder.path().wstring(), wide([row filePath]));
}

TEST_F(FilePath, ResolvesLinksInTheFullPathOnly)
{
    file("real.lsp");
    std::filesystem::create_directory(mFolder / "links");
    std::filesystem::create_symlink(mFolder / "real.lsp", mFolder / "links/link.lsp");
    ModrigFilePath* row = make(path("links/link.lsp"));
    EXPECT_EQ(file("real.lsp"), wide([row filePathName]));
    EXPECT_EQ(L"link.lsp", wide([row fileName]));
    EXPECT_EQ((mFolder / "links").wstring(), wide([row filePath]));
}

TEST_F(FilePath, IsEmptyAndNotUnloadableForNil)
{
    ModrigFilePath* row = make(nil);
    EXPECT_EQ(nil, [row filePathName]);
    EXPECT_EQ(nil, [row fileName]);
    EXPECT_EQ(nil, [row filePath]);
    EXPECT_FALSE([row unloadable]);
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(FilePath, IsUnloadableForAModuleThatIsNotLocked)
{
    EXPECT_TRUE([make(text(loadedModule("tool.zmb"))) unloadable]);
    host().linker.setLocked(file("locked.zmb"));
    EXPECT_FALSE([make(path("locked.zmb")) unloadable]);
    EXPECT_FALSE([make(path("tool.lsp")) unloadable]);
}

TEST_F(FilePath, KeepsWhatItFoundWhenItWasMade)
{
    ModrigFilePath* row = make(text(loadedModule("tool.zmb")));
    host().linker.setLocked(file("tool.zmb"));
    EXPECT_TRUE([row unloadable]);
}

TEST_F(FilePath, AsksAboutThePathAsItWasGiven)
{
    std::filesystem::create_symlink(mFolder / "real", mFolder / "link.zmb");
    host().linker.setLocked((mFolder / "link.zmb").wstring());
    EXPECT_FALSE([make(path("link.zmb")) unloadable]);
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(FilePath, OfAFolderIsMadeWithoutAWord)
{
    host().linker.setLocked((mFolder / "locked.zmb").wstring());
    const auto unloadable = [this](const char* name) -> bool
    { return [[[[ModrigFolderPath alloc] initWithFilePathName:path(name)] autorelease] unloadable]; };
    EXPECT_TRUE(unloadable("folder"));
    EXPECT_TRUE(unloadable("free.zmb"));
    EXPECT_FALSE(unloadable("locked.zmb"));
    EXPECT_FALSE(unloadable("folder.d"));
    EXPECT_THAT(boxes(), IsEmpty());
    make(@"/none/folder");
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/none/folder")));
}

TEST_F(FilePath, EqualsAPathInOtherLetterCase)
{
    EXPECT_TRUE([make(@"/X/y.qbc") isEqual:make(@"/x/Y.QBC")]);
    EXPECT_EQ([make(@"/X/y.qbc") hash], [make(@"/x/Y.QBC") hash]);
    EXPECT_FALSE([make(@"/X/y.qbc") isEqual:make(@"/x/z.qbc")]);
}

TEST_F(FilePath, EqualsNoOtherKindOfObject)
{
    EXPECT_FALSE([make(@"/x/y.qbc") isEqual:@"/x/y.qbc"]);
    EXPECT_FALSE([make(@"/x/y.qbc") isEqual:nil]);
    EXPECT_FALSE([make(@"/x/y.qbc") isEqual:make(nil)]);
}

TEST_F(FilePath, EqualsOneOfASubclassThatDoesNotEqualItInTurn)
{
    ModrigFilePath* special = [[[SpecialFilePath alloc] initWithFilePathName:@"/x/y.qbc"] autorelease];
    EXPECT_TRUE([make(@"/X/Y.qbc") isEqual:special]);
    EXPECT_FALSE([special isEqual:make(@"/X/Y.qbc")]);
    EXPECT_TRUE([special isEqual:special]);
}

TEST_F(FilePath, HasTheHashOfEveryPathThatItEquals)
{
    int equal = 0;
    // Beyond, the toolkit fails to make capitals.
    for (unichar character = 0x20; character < 0x1F80; ++character)
    {
        NSString* name = [NSString stringWithCharacters:&character length:1];
        ModrigFilePath* row = make([@"/x/b" stringByAppendingString:name]);
        NSString* others[] = {
            [name lowercaseString], [name uppercaseString], [name decomposedStringWithCanonicalMapping]};
        for (NSString* other : others)
        {
            ModrigFilePath* twin = make([@"/x/b" stringByAppendingString:other]);
            if (![row isEqual:twin])
                continue;
            ++equal;
            ASSERT_EQ([row hash], [twin hash]) << "U+" << std::hex << character;
        }
    }
    EXPECT_LT(0x1F80, equal);
}

TEST_F(FilePath, HasAHashThatTellsMostPathsApart)
{
    std::set<NSUInteger> hashes;
    for (int number = 0; number < 1000; ++number)
        hashes.insert([make([NSString stringWithFormat:@"/none/tool%d.zmb", number]) hash]);
    EXPECT_LT(990u, hashes.size());
}
