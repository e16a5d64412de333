#include <gmock/gmock.h>

#include "host/console/Completion.h"

using tessel::Branch;
using tessel::complete;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
using Names = tessel::CompletionSources::Names;

const std::vector<std::wstring> kNames = {L"HELP", L"MODLIST", L"MODRIG", L"Öffnen"};

tessel::CompletionSources namesOnly()
{
    tessel::CompletionSources sources;
    sources.commands = []
    {
        return kNames;
    };
    return sources;
}

// How some commands are typed, a few files, keys, variables and symbols.
class Completions : public testing::Test
{
protected:
    Completions()
    {
        sources.usage = [](const std::wstring& command)
        {
            return command == L"load"  ? L"file | address"
                   : command == L"CD"  ? L"[folder]"
                   : command == L"SET" ? L"[variable [value]]"
                   : command == L"REG" ? L"LIST [key] | EXPORT key file [UTF8] | RESET | RESTORE"
                   : command == L"BI"  ? L"[START|GOOD|BAD|STOP]"
                   : command == L"HE"  ? L"[command] | topic"
                   : command == L"SUI" ? L"LIST | ADD file... | REMOVE entry... | CLEAR [--json]"
                                       : L"";
        };
        sources.variables = []
        {
            return std::vector<std::wstring>{L"LISPENABLED", L"SEARCHPATH"};
        };
        sources.files = [this](const std::wstring& folder)
        {
            asked = folder;
            return folder == L"none/"
                       ? std::vector<Branch>()
                       : std::vector<Branch>{
                             {L".hidden", false},   {L"Gear box.lsp", false},   {L"Moon", true},
                             {L"gears.lsp", false}, {L"plan \"A\".lsp", false}, {L"primes one", true},
                             {L"primes.zmb", false}};
        };
        sources.keys = [this](const std::wstring& key)
        {
            asked = key;
            return std::vector<Branch>{{L"Software", true}, {L"My Settings", false}};
        };
        sources.lispSymbols = [this](const std::wstring& beginning)
        {
            asked = beginning;
            return std::vector<std::wstring>{L"defmacro", L"defun", L"loop"};
        };
    }

    // The line with the completion in its place, and "|" with the candidates.
    std::wstring after(const std::wstring& line, const std::wstring& lispBefore = {}) const
    {
        const auto completion = complete(line, sources, lispBefore);
        if (!completion)
            return L"nothing";
        std::wstring result = line.substr(0, line.size() - completion->replaced) + completion->text;
        for (const auto& candidate : completion->candidates)
            result += L"|" + candidate;
        return result;
    }

    tessel::CompletionSources sources = namesOnly();
    std::wstring asked;
};
} // namespace

TEST(Completion, CompletesTheOnlyNameThatFits)
{
    const auto completion = complete(L"he", namesOnly());
    ASSERT_TRUE(completion);
    EXPECT_EQ(completion->text, L"HELP ");
    EXPECT_EQ(completion->replaced, 2u);
    EXPECT_THAT(completion->candidates, IsEmpty());
}

TEST(Completion, CompletesAsFarAsTheNamesAgree)
{
    const auto completion = complete(L"m", namesOnly());
    ASSERT_TRUE(completion);
    EXPECT_EQ(completion->text, L"MOD");
    EXPECT_THAT(completion->candidates, ElementsAre(L"MODLIST", L"MODRIG"));
}

TEST(Completion, ComparesLettersOfEveryAlphabetWithoutRegardToCase)
{
    const auto completion = complete(L"öFF", namesOnly());
    ASSERT_TRUE(completion);
    EXPECT_EQ(completion->text, L"Öffnen ");
}

TEST(Completion, OffersEveryNameOnAnEmptyLine)
{
    const auto completion = complete(L"", namesOnly());
    ASSERT_TRUE(completion);
    EXPECT_EQ(completion->candidates, kNames);
    EXPECT_EQ(completion->text, L"");
}

TEST(Completion, KnowsNothingWithoutSources)
{
    for (const wchar_t* line : {L"", L"h", L"HELP m", L"(de", L"(load \"m"})
        EXPECT_FALSE(complete(line, {})) << line;
    EXPECT_FALSE(complete(L"x", namesOnly()));
    EXPECT_FALSE(complete(L"HELPX", namesOnly()));
}

TEST_F(Completions, OfACommandMayFollowBlanks)
{
    EXPECT_EQ(after(L"  he"), L"  HELP ");
    EXPECT_EQ(after(L"\"he"), L"nothing") << "a name is typed without quotes";
}

TEST_F(Completions, OfFilesKnowTheirCase)
{
    EXPECT_EQ(after(L"load g"), L"load gears.lsp ");
    EXPECT_EQ(after(L"load M"), L"load Moon/");
    EXPECT_EQ(after(L"load m"), L"nothing");
    EXPECT_EQ(after(L"load none/x"), L"nothing");
}

TEST_F(Completions, OfFilesLookIntoTheFolderThatIsTyped)
{
    EXPECT_EQ(after(L"load ~/a/b/ge"), L"load ~/a/b/gears.lsp ");
    EXPECT_EQ(asked, L"~/a/b/");
    EXPECT_EQ(after(L"load /M"), L"load /Moon/");
    EXPECT_EQ(asked, L"/");
}

TEST_F(Completions, OfFilesPutBlanksIntoQuotes)
{
    EXPECT_EQ(after(L"load G"), L"load \"Gear box.lsp\" ");
    EXPECT_EQ(after(L"load \"G"), L"load \"Gear box.lsp\" ");
    EXPECT_EQ(after(L"load \"g"), L"load \"gears.lsp\" ") << "with a quote of the person's own";
    EXPECT_EQ(after(L"load pl"), L"load \"plan \"\"A\"\".lsp\" ");
    EXPECT_EQ(after(L"load \"plan \"\"A"), L"load \"plan \"\"A\"\".lsp\" ");
    EXPECT_EQ(after(L"load \"primes o"), L"load \"primes one/") << "a path goes on there";
    EXPECT_EQ(after(L"load \"a b/\"ge"), L"load \"a b/gears.lsp\" ");
}

TEST_F(Completions, OfSeveralFilesGoAsFarAsTheyAgree)
{
    EXPECT_EQ(after(L"load p"), L"load p|plan \"A\".lsp|primes one/|primes.zmb");
    EXPECT_EQ(after(L"load pr"), L"load primes|primes one/|primes.zmb");
}

TEST_F(Completions, LeaveHiddenFilesOutUnlessTheirDotIsTyped)
{
    EXPECT_EQ(after(L"load ."), L"load .hidden ");
    EXPECT_EQ(after(L"load Mo"), L"load Moon/");
    EXPECT_EQ(complete(L"load ", sources)->candidates.size(), 6u);
}

TEST_F(Completions, LeaveOutNamesThatNoLineCanHold)
{
    sources.files = [](const std::wstring&)
    {
        return std::vector<Branch>{
            {L"two\nlines.lsp", false}, {L"two\rreturns.lsp", false}, {L"two.lsp", false}};
    };
    sources.entries = [](const Names&)
    {
        return Names{L"/two\nlines.lsp", L"/two.lsp"};
    };
    EXPECT_EQ(after(L"load t"), L"load two.lsp ");
    EXPECT_EQ(after(L"(load \"t"), L"(load \"two.lsp\"");
    EXPECT_EQ(after(L"SUI REMOVE /t"), L"SUI REMOVE /two.lsp ");
}

TEST_F(Completions, OfFoldersLeaveFilesOut)
{
    EXPECT_EQ(after(L"CD "), L"CD |Moon/|primes one/");
    EXPECT_EQ(after(L"CD g"), L"nothing");
}

TEST_F(Completions, OfArgumentsFollowTheWaysOfTypingTheCommand)
{
    EXPECT_EQ(after(L"REG "), L"REG |LIST|EXPORT|RESET|RESTORE");
    EXPECT_EQ(after(L"REG e"), L"REG EXPORT ");
    EXPECT_EQ(after(L"REG res"), L"REG RES|RESET|RESTORE");
    EXPECT_EQ(after(L"REG export Software ge"), L"REG export Software gears.lsp ");
    EXPECT_EQ(after(L"REG EXPORT Software x.reg u"), L"REG EXPORT Software x.reg UTF8 ");
    EXPECT_EQ(after(L"REG EXPORT Software x.reg UTF8 "), L"nothing");
    EXPECT_EQ(after(L"REG RESET "), L"nothing");
    EXPECT_EQ(after(L"BI st"), L"BI ST|START|STOP");
    EXPECT_EQ(after(L"BI START "), L"nothing");
    EXPECT_EQ(after(L"UNKNOWN "), L"nothing");
    EXPECT_EQ(after(L"SUI CLEAR -"), L"SUI CLEAR --json ");
    EXPECT_EQ(after(L"SUI ADD one two ge"), L"SUI ADD one two gears.lsp ") << "it can be repeated";
}

TEST_F(Completions, OfEntriesOfferThoseOfTheListAndNoFiles)
{
    Names entries = {L"/a b/moon.lsp", L"/home/gears.lsp", L"/home/gear.zmb"};
    sources.entries = [&](const Names& parts)
    {
        asked = parts.back();
        return entries;
    };
    EXPECT_EQ(after(L"SUI REMOVE "), L"SUI REMOVE /|/a b/moon.lsp|/home/gears.lsp|/home/gear.zmb");
    EXPECT_EQ(asked, L"REMOVE");
    EXPECT_EQ(after(L"SUI remove /h"), L"SUI remove /home/gear|/home/gears.lsp|/home/gear.zmb");
    EXPECT_EQ(after(L"SUI REMOVE /home/gears"), L"SUI REMOVE /home/gears.lsp ");
    EXPECT_EQ(after(L"SUI REMOVE /a"), L"SUI REMOVE \"/a b/moon.lsp\" ");
    EXPECT_EQ(after(L"SUI REMOVE one MO"), L"SUI REMOVE one \"/a b/moon.lsp\" ") << "by its name";
    EXPECT_EQ(after(L"SUI REMOVE g"), L"SUI REMOVE g|/home/gears.lsp|/home/gear.zmb");
    EXPECT_EQ(after(L"SUI REMOVE \"g"), L"SUI REMOVE \"g|/home/gears.lsp|/home/gear.zmb");
    EXPECT_EQ(after(L"SUI REMOVE x"), L"nothing");
    EXPECT_EQ(after(L"SUI REMOVE home"), L"nothing");
    entries.clear();
    EXPECT_EQ(after(L"SUI REMOVE "), L"nothing");
    sources.entries = {};
    EXPECT_EQ(after(L"SUI REMOVE /"), L"nothing");
}

TEST_F(Completions, OfKeysKnowWhereAPathGoesOn)
{
    EXPECT_EQ(after(L"REG LIST soft"), L"REG LIST Software\\");
    EXPECT_EQ(after(L"REG LIST a\\My"), L"REG LIST \"a\\My Settings\" ");
    EXPECT_EQ(asked, L"a\\");
}

TEST_F(Completions, OfVariablesAndCommandsAsArguments)
{
    EXPECT_EQ(after(L"SET l"), L"SET LISPENABLED ");
    EXPECT_EQ(after(L"SET LISPENABLED "), L"nothing");
    EXPECT_EQ(after(L"HE mod"), L"HE MOD|MODLIST|MODRIG");
}

TEST_F(Completions, OfLispSymbols)
{
    EXPECT_EQ(after(L"(def"), L"(def|defmacro|defun");
    EXPECT_EQ(after(L"(mapcar #'lo"), L"(mapcar #'loop ");
    EXPECT_EQ(asked, L"lo");
    EXPECT_EQ(after(L"("), L"nothing") << "there are a thousand";
    EXPECT_EQ(after(L"lo", L"(progn"), L"loop ");
    EXPECT_EQ(after(L"lo"), L"nothing") << "no command";
}

TEST_F(Completions, OfFilesInAStringOfLisp)
{
    EXPECT_EQ(after(L"(load \"G"), L"(load \"Gear box.lsp\"");
    EXPECT_EQ(after(L"(load \"Mo"), L"(load \"Moon/");
    EXPECT_EQ(after(L"(load \"pl"), L"(load \"plan \\\"A\\\".lsp\"");
    EXPECT_EQ(after(L"(list \"a\" lo"), L"(list \"a\" loop ");
    EXPECT_EQ(after(L"lo", L"(f ; isn't \"that\n"), L"loop ") << "a quote in a comment";
    EXPECT_EQ(after(L"ge", L"(princ \"begun"), L"nothing") << "the string begins on another line";
}
