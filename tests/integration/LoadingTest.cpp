// Loading by the dialog: what Modrig answers, what the host then has, and what the user is told.
#include "tests/integration/ModrigInHost.h"

#include <gmock/gmock.h>

#include "modrig/lists/Globals.h"

using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Not;

namespace
{
constexpr int kNotLoaded = 0;
constexpr int kLoaded = 1;
constexpr int kIsLoadedAlready = 2;

constexpr char kReady[] = "\nReady. ";

class Loading : public ModrigInHost
{
protected:
    Loading()
    {
        said(); // the start is not the matter here
    }

    int load(const std::filesystem::path& path, bool addToHistory = false, bool addToStartup = false)
    {
        int answer = -1;
        dialog([&] { answer = ModrigUnderTest::load(wide(path), addToHistory, addToStartup); });
        return answer;
    }

    std::filesystem::path lisp(const std::string& name)
    {
        return folder.write(name, "(write-line \"" + name + "\")\n");
    }

    static std::string boxes(const std::filesystem::path& path)
    {
        const std::string name = "Message: “" + path.string() + "” ";
        return name + "is not of a type that can be loaded.\n" + name + "could not be loaded.\n";
    }
};
} // namespace

TEST_F(Loading, OfAModuleIsDoneOnce)
{
    const auto good = module("Good.zmb");
    EXPECT_EQ(load(good), kLoaded);
    EXPECT_EQ(said(), "Good.zmb: message 1\n");
    EXPECT_EQ(load(good), kIsLoadedAlready);
    EXPECT_EQ(said(), "");
    EXPECT_THAT(ModrigUnderTest::loaded(), ElementsAre(wide(good)));
    EXPECT_THAT(ModrigUnderTest::history(), IsEmpty());
}

TEST_F(Loading, OfALispFileIsDoneEachTimeAndListedOnce)
{
    const auto file = lisp("a file.lsp");
    EXPECT_EQ(load(file), kLoaded);
    EXPECT_EQ(said(), std::string("a file.lsp\n") + kReady);
    EXPECT_EQ(load(file, true), kLoaded);
    EXPECT_EQ(said(), std::string("a file.lsp\n") + kReady);
    EXPECT_THAT(ModrigUnderTest::loaded(), ElementsAre(wide(file)));
    EXPECT_THAT(ModrigUnderTest::history(), ElementsAre(wide(file)));
}

TEST_F(Loading, OfWhatTheHostCannotLoadIsToldByTheHostAndByModrig)
{
    const auto letter = folder.write("letter 100%s.zmb", "Dear Sir or Madam,\n");
    EXPECT_EQ(load(letter, true), kNotLoaded);
    EXPECT_EQ(said(), "The application \"" + letter.string() +
                          "\" is not loaded: it is not a shared library.\nMessage: “" + letter.string() +
                          "” could not be loaded.\n");
    EXPECT_THAT(ModrigUnderTest::loaded(), IsEmpty());
    EXPECT_THAT(ModrigUnderTest::history(), IsEmpty());
}

TEST_F(Loading, OfWhatModrigDoesNotLoadIsToldByModrig)
{
    for (const char* path : {"/a/survey.rpk", "/a/plates.mcp", "/a/readme.txt", "/a.b/tool", "tool"})
    {
        EXPECT_EQ(load(path), kNotLoaded);
        EXPECT_EQ(said(), boxes(path));
    }
    EXPECT_THAT(ModrigUnderTest::loaded(), IsEmpty());
}

TEST_F(Loading, OfALispFileThatIsMissingSucceedsAndTheHostTellsLater)
{
    EXPECT_EQ(load("/nowhere/a.lsp"), kLoaded);
    EXPECT_EQ(said(), std::string("Cannot load \"/nowhere/a.lsp\": No such file or directory.\n") + kReady);
    dialog(ModrigUnderTest::populate);
    EXPECT_THAT(ModrigUnderTest::loaded(), IsEmpty()) << "the document does not have it";
}

TEST_F(Loading, OfLispIsRefusedWithoutAWordWhileLispIsOff)
{
    ASSERT_TRUE(type(L"SETVAR LISPENABLED 0"));
    const auto file = lisp("LOUD.LSP");
    for (const std::filesystem::path& path :
         {file, folder / "a.lsp", folder / "a.Qbc", folder / "a.rpk", folder / "a.MCP"})
        EXPECT_EQ(load(path, true, true), kNotLoaded) << path;
    EXPECT_EQ(said(), "");
    EXPECT_THAT(ModrigUnderTest::loaded(), IsEmpty());
    EXPECT_THAT(ModrigUnderTest::history(), IsEmpty());
    EXPECT_EQ(load(module("Good.omp")), kLoaded);
    EXPECT_EQ(said(), "Good.omp: message 1\n");
    ASSERT_TRUE(type(L"SETVAR LISPENABLED 1"));
    EXPECT_EQ(load(file), kLoaded);
    EXPECT_EQ(said(), std::string("LOUD.LSP\n") + kReady);
}

TEST_F(Loading, OfAPathWithQuotesRunsNoneOfIt)
{
    const std::string name = "a\") (write-line \"injected\") (princ \".lsp";
    EXPECT_EQ(load(lisp("plain.lsp")), kLoaded);
    said();
    std::filesystem::copy_file(folder / "plain.lsp", folder / name);
    EXPECT_EQ(load(folder / name), kLoaded);
    EXPECT_EQ(said(), std::string("plain.lsp\n") + kReady);
}

TEST_F(Loading, OfALispFileIsDoneAtOnceWithTheLispEnvironment)
{
    gbOrreryLoaded = true; // as other code of the process sets it
    const auto file = lisp("a file.lsp");
    dialog(
        [&]
        {
            EXPECT_EQ(ModrigUnderTest::load(wide(file), false, false), kLoaded);
            EXPECT_EQ(said(), "a file.lsp\n") << "nothing is queued, not even the prompt";
        });
    EXPECT_EQ(said(), "");
    EXPECT_THAT(ModrigUnderTest::loaded(), ElementsAre(wide(file)));
}

TEST_F(Loading, OfALispFileThatIsMissingFailsWithTheLispEnvironment)
{
    gbOrreryLoaded = true;
    EXPECT_EQ(load("/nowhere/a.lsp", true), kNotLoaded);
    EXPECT_EQ(said(), "Cannot load \"/nowhere/a.lsp\": No such file or directory.\n"
                      "Message: “/nowhere/a.lsp” could not be loaded.\n");
    EXPECT_THAT(ModrigUnderTest::loaded(), IsEmpty());
    EXPECT_THAT(ModrigUnderTest::history(), IsEmpty());
}

TEST_F(Loading, AddsNothingToTheListsFromTheStartupSuite)
{
    const auto good = module("Good.zmb");
    dialog(
        [&]
        {
            ModrigUnderTest::replaceStartup({wide(good)});
            ModrigUnderTest::close();
        });
    options.safe = false; // nothing of a suite is loaded otherwise
    restart();
    loadModrig();
    EXPECT_EQ(said(), "Good.zmb: message 1\n");
    EXPECT_THAT(ModrigUnderTest::startup(), ElementsAre(wide(good)));
    EXPECT_THAT(ModrigUnderTest::history(), IsEmpty());
    EXPECT_THAT(ModrigUnderTest::loaded(), Contains(wide(good)));
    EXPECT_THAT(ModrigUnderTest::loaded(), Not(Contains(wide(MODRIG_UNDER_TEST))));
}
