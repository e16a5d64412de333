// What the Tab key brings in bash, at a terminal, after the name of the program.
#include <gmock/gmock.h>

#include "tests/support/ShellCommand.h"
#include "tests/support/TemporaryFolder.h"

namespace
{
class CompletionOfBash : public testing::Test
{
protected:
    CompletionOfBash()
    {
        folder.write("some_folder/inside", "");
        folder.write("some.lsp", "");
        folder.write("notes.txt", "");
    }

    // The first word that the program would be given. What loads the file for a person has set `extglob`.
    std::string given(const std::string& typed) const
    {
        const auto lines = folder.write("lines", "shopt -s extglob\nsource '" COMPLETION_OF_BASH "'\n"
                                                 "tessel() { echo \"Given: <$1>\"; }\n"
                                                 "tessel " +
                                                     typed + "\t\nexit\n");
        const std::string shown =
            runCommand("cd '" + folder.path().string() +
                       "' && HISTFILE= script -qec 'bash --norc -i' /dev/null <'" + lines.string() + "'")
                .output;
        const std::string before = "Given: <";
        const auto start = shown.rfind(before);
        return start == shown.npos
                   ? shown
                   : shown.substr(start + before.size(), shown.find('>', start) - start - before.size());
    }

    TemporaryFolder folder;
};
} // namespace

TEST_F(CompletionOfBash, BringsAFolderAfterTheSignOfAnOptionThatTakesOne)
{
    EXPECT_EQ(given("--profile-dir=so"), "--profile-dir=some_folder/");
    EXPECT_EQ(given("--layout-dir=some_folder/../so"), "--layout-dir=some_folder/../some_folder/");
}

TEST_F(CompletionOfBash, BringsAnyFileAfterTheSignOfAnOptionThatTakesOne)
{
    EXPECT_EQ(given("--log=no"), "--log=notes.txt");
    EXPECT_EQ(given("--script=no"), "--script=notes.txt");
    EXPECT_EQ(given("--command=no"), "--command=no");
}

TEST_F(CompletionOfBash, BringsWhatCanBeLoadedElsewhere)
{
    EXPECT_EQ(given("some."), "some.lsp");
    EXPECT_EQ(given("no"), "no");
    EXPECT_EQ(given("--layout"), "--layout-dir");
}

// With the sign alone, only one folder could be meant.
TEST_F(CompletionOfBash, BringsTheOnlyFolderAfterTheSignAlone)
{
    EXPECT_EQ(given("--profile-dir="), "--profile-dir=some_folder/");
}
