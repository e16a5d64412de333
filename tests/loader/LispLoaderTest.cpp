#include "modrig/loader/ApplicationLoader.h"

#include "modrig/lists/Globals.h"
#include "modrig/messages/MessageIds.h"
#include "tests/support/ModuleTest.h"

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
constexpr const wchar_t* kNewLine = L"(write-line \"\")";
constexpr const wchar_t* kPrompt = L"(prompt \"Command: \")";

class LispLoader : public ModuleTest
{
protected:
    static const std::vector<std::wstring>& queued() { return host().lisp.queued; }

    // Empty when nothing is queued.
    static std::wstring First() { return queued().empty() ? std::wstring() : queued().front(); }

    // The path as it stands in the expression that loads it.
    static std::wstring SafePath(const std::wstring& path)
    {
        host().lisp.queued.clear();
        EXPECT_TRUE(LoadLispFile(CStdStr(path), 1, 0));
        const std::wstring before = L"(load \"";
        const std::wstring after = L"\")";
        const std::wstring expression = First();
        if (!expression.starts_with(before) || !expression.ends_with(after))
        {
            ADD_FAILURE() << "no load expression: " << testing::PrintToString(expression);
            return {};
        }
        return expression.substr(before.size(), expression.size() - before.size() - after.size());
    }
};
} // namespace

TEST_F(LispLoader, QueuesTheLoadThenALineFeedThenThePrompt)
{
    EXPECT_TRUE(LoadLispFile(L"/a/tool.lsp", 1, 0));
    EXPECT_THAT(queued(), ElementsAre(L"(load \"/a/tool.lsp\")", kNewLine, kPrompt));
    EXPECT_THAT(host().lisp.invoked, IsEmpty());
    EXPECT_TRUE(gLoadedAppList.IsEmpty());
}

TEST_F(LispLoader, LoadsAllPartsWhereTheHostKnowsHow)
{
    EXPECT_TRUE(LoadLispFile(L"C:\\a\\tool.qbc", 1, 1));
    EXPECT_THAT(queued(),
                ElementsAre(L"(progn (_INTERNAL-LOAD-ALL-FILE \"C:/a/tool.qbc\" nil T T nil)(princ))",
                            kNewLine, kPrompt));
    host().lisp.queued.clear();
    EXPECT_TRUE(LoadLispFile(L"/a/tool.lsp", 1, -1)) << "any flag but 0 is yes";
    EXPECT_TRUE(First().starts_with(L"(progn"));
}

TEST_F(LispLoader, LoadsPlainlyWhereTheHostDoesNotKnowHow)
{
    host().lisp.removing = false;
    EXPECT_TRUE(LoadLispFile(L"/a/tool.lsp", 1, 1));
    EXPECT_THAT(queued(), ElementsAre(L"(load \"/a/tool.lsp\")", kNewLine, kPrompt));
}

TEST_F(LispLoader, AnswersTrueAsSoonAsTheExpressionsAreQueued)
{
    host().lisp.setEvaluation(L"(load \"/a/missing.lsp\")", [] { FAIL() << "nobody has run the queue"; });
    EXPECT_TRUE(LoadLispFile(L"/a/missing.lsp", 1, 0));
}

TEST_F(LispLoader, TurnsBackslashesOfADrivePathIntoSlashesWithoutAPrefix)
{
    EXPECT_EQ(L"C:/apps/x/tool.lsp", SafePath(L"C:\\apps\\x\\tool.lsp"));
    EXPECT_EQ(L"/apps/tool.lsp", SafePath(L"/apps/tool.lsp"));
    EXPECT_EQ(L"/apps/tool.lsp", SafePath(L"\\apps\\tool.lsp"));
}

TEST_F(LispLoader, KeepsTheTwoBackslashesOfANetworkPathAndPutsTwoMoreInFront)
{
    EXPECT_EQ(L"\\\\\\\\server/apps/tool.lsp", SafePath(L"\\\\server\\apps\\tool.lsp"));
}

TEST_F(LispLoader, CountsTwoBackslashesAmongTheFirstFourCharactersWhereverTheyStand)
{
    EXPECT_EQ(L"\\\\a\\b\\c/tool.lsp", SafePath(L"a\\b\\c\\tool.lsp"));
    EXPECT_EQ(L"\\\\\\ab\\c/tool.lsp", SafePath(L"\\ab\\c\\tool.lsp"));
    EXPECT_EQ(L"\\\\ab\\\\c/tool.lsp", SafePath(L"ab\\\\c\\tool.lsp"));
    EXPECT_EQ(L"\\\\\\b\\/tool.lsp", SafePath(L"\\b\\\\tool.lsp"));
}

TEST_F(LispLoader, CountsNoBackslashAfterTheFirstFourCharacters)
{
    EXPECT_EQ(L"a/bc/tool.lsp", SafePath(L"a\\bc\\tool.lsp"));
    EXPECT_EQ(L"abc//tool.lsp", SafePath(L"abc\\\\tool.lsp"));
}

TEST_F(LispLoader, RewritesThirdAndFourthBackslashesAtTheHead)
{
    EXPECT_EQ(L"\\\\\\\\//tool.lsp", SafePath(L"\\\\\\\\tool.lsp"));
}

TEST_F(LispLoader, TakesPathsShorterThanTheWindow)
{
    EXPECT_EQ(L"", SafePath(L""));
    EXPECT_EQ(L"/", SafePath(L"\\"));
    EXPECT_EQ(L"\\\\\\\\", SafePath(L"\\\\"));
    EXPECT_EQ(L"\\\\\\a\\", SafePath(L"\\a\\"));
}

TEST_F(LispLoader, KeepsBlanksPerCentSignsAndLettersOfAnyScript)
{
    EXPECT_EQ(L"/a b/100%s%n%%.lsp", SafePath(L"/a b/100%s%n%%.lsp"));
    EXPECT_EQ(L"C:/ä/чертёж.lsp", SafePath(L"C:\\ä\\чертёж.lsp"));
    host().lisp.queued.clear();
    EXPECT_TRUE(LoadLispFile(L"/a/100%s%n%%.lsp", 1, 1));
    EXPECT_EQ(L"(progn (_INTERNAL-LOAD-ALL-FILE \"/a/100%s%n%%.lsp\" nil T T nil)(princ))", First());
}

TEST_F(LispLoader, KeepsADoubleQuoteInANameFromEndingTheLispText)
{
    EXPECT_EQ(L"/a/x\\\").lsp", SafePath(L"/a/x\").lsp"));
    EXPECT_EQ(L"C:/a/\\\"q\\\".lsp", SafePath(L"C:\\a\\\"q\".lsp"));
}

TEST_F(LispLoader, EscapesADoubleQuoteOnceWhenABackslashThatIsKeptEscapesItAlready)
{
    EXPECT_EQ(L"\\\\\\\"\\x.lsp", SafePath(L"\\\"\\x.lsp"));
    EXPECT_EQ(L"\\\\/\\\"\\x.lsp", SafePath(L"/\\\"\\x.lsp"));
    EXPECT_EQ(L"\\\\\\a\\\"x.lsp", SafePath(L"\\a\\\"x.lsp"));
    EXPECT_EQ(L"\\\\\\\\\\\"x.lsp", SafePath(L"\\\\\"x.lsp"));
}

TEST_F(LispLoader, QueuesAPathOf4000CharactersWhole)
{
    const std::wstring path = LongPath(4000, L"tool.lsp");
    EXPECT_EQ(path, SafePath(path));
    host().lisp.queued.clear();
    EXPECT_TRUE(LoadLispFile(CStdStr(path), 1, 1));
    EXPECT_EQ(L"(progn (_INTERNAL-LOAD-ALL-FILE \"" + path + L"\" nil T T nil)(princ))", First());
}

TEST_F(LispLoader, TakesThePromptFromTheTexts)
{
    host().resources.setText(kResourceModuleName, ModrigMessages::kLispPrompt, L"100%s>");
    EXPECT_TRUE(LoadLispFile(L"/a/tool.lsp", 1, 0));
    ASSERT_FALSE(queued().empty());
    EXPECT_EQ(L"(prompt \"100%s> \")", queued().back());
    host().resources.removeText(kResourceModuleName, ModrigMessages::kLispPrompt);
    EXPECT_TRUE(LoadLispFile(L"/a/tool.lsp", 1, 0));
    EXPECT_EQ(L"(prompt \" \")", queued().back());
}

TEST_F(LispLoader, UnloadsNoPlainLispFileAndSaysNothing)
{
    for (const wchar_t* path : {L"/a/tool.lsp", L"/a/tool.qbc", L"/a/tool", L"/a.rpk/tool"})
        EXPECT_FALSE(LoadLispFile(path, 0, 0)) << path;
    gbOrreryLoaded = true;
    EXPECT_FALSE(LoadLispFile(L"/a/tool.lsp", 0, 1));
    EXPECT_THAT(host().journal.entries(), IsEmpty());
}

TEST_F(LispLoader, UnloadsAPackageByItsNameWithoutFolderAndExtension)
{
    EXPECT_TRUE(LoadLispFile(L"C:\\a.b\\My tool.v2.RPK", 0, 0));
    EXPECT_THAT(queued(), ElementsAre(L"(qz-unload-rpk \"My tool.v2\")", kNewLine, kPrompt));
}

TEST_F(LispLoader, UnloadsAPackageByItsNameAlsoWithTheLispEnvironment)
{
    gbOrreryLoaded = true;
    EXPECT_TRUE(LoadLispFile(L"/a/tool.rpk", 0, 0));
    EXPECT_EQ(L"(qz-unload-rpk \"tool\")", First());
    EXPECT_THAT(host().lisp.invoked, IsEmpty());
}

TEST_F(LispLoader, LoadsAPackageThatIsToBeUnloadedWhereTheHostCannotUnloadIt)
{
    host().lisp.removing = false;
    EXPECT_TRUE(LoadLispFile(L"C:\\a\\tool.rpk", 0, 1));
    EXPECT_THAT(queued(), ElementsAre(L"(load \"C:/a/tool.rpk\")", kNewLine, kPrompt));
    gbOrreryLoaded = true;
    EXPECT_TRUE(LoadLispFile(L"C:\\a\\tool.rpk", 0, 1));
    EXPECT_EQ(1u, host().lisp.invoked.size());
}

TEST_F(LispLoader, InvokesTheLispEnvironmentWithThePathAsItIsAndQueuesNothing)
{
    gbOrreryLoaded = true;
    EXPECT_TRUE(LoadLispFile(L"\\\\server\\a\\100%s \"x\".lsp", 1, 1));
    using Value = RecordingValue;
    ASSERT_EQ(1u, host().lisp.invoked.size());
    EXPECT_THAT(host().lisp.invoked.front(),
                ElementsAre(Value::String(L"qz-load"), Value::String(L"\\\\server\\a\\100%s \"x\".lsp"),
                            Value::Short(0), Value::Short(0)));
    EXPECT_THAT(queued(), IsEmpty());
}

TEST_F(LispLoader, AnswersWhetherTheLispEnvironmentEndedNormally)
{
    gbOrreryLoaded = true;
    for (const int status : {5101, 0, 1, -1})
    {
        host().lisp.invokeStatus = status;
        EXPECT_FALSE(LoadLispFile(L"/a/tool.lsp", 1, 0)) << status;
    }
    host().lisp.invokeStatus = 5100;
    EXPECT_TRUE(LoadLispFile(L"/a/tool.lsp", 1, 0));
}

TEST_F(LispLoader, ReleasesWhatTheLispEnvironmentAnswers)
{
    gbOrreryLoaded = true;
    host().lisp.setFunction(L"qz-load", [](const auto&)
                            { return RecordingLisp::Values{RecordingValue::String(L"done")}; });
    EXPECT_TRUE(LoadLispFile(L"/a/tool.lsp", 1, 0)) << "the leak checker has the last word";
}
