#include <gmock/gmock.h>

#include "host/app/Options.h"
#include "host/text/Unicode.h"

using testing::ElementsAre;
using testing::HasSubstr;

namespace
{
tessel::Result<tessel::ParsedOptions> parse(std::vector<const char*> arguments)
{
    arguments.insert(arguments.begin(), "Tessel");
    return tessel::parseOptions(static_cast<int>(arguments.size()), arguments.data());
}
} // namespace

TEST(Options, AreAnOrdinarySessionWithoutArguments)
{
    const auto parsed = parse({});
    ASSERT_TRUE(parsed && parsed->options);
    EXPECT_TRUE(parsed->options->profileFolder.empty());
    EXPECT_TRUE(parsed->options->layoutFolder.empty());
    EXPECT_FALSE(parsed->options->safe);
    EXPECT_FALSE(parsed->options->isBatch());
}

TEST(Options, TakeCommandsInTheirOrderAndOneArgumentEach)
{
    const auto parsed = parse({"-c", "LOAD \"a b.lsp\"", "-c", "(+ 1 2)", "--safe", "-c", "-x"});
    ASSERT_TRUE(parsed && parsed->options);
    EXPECT_THAT(parsed->options->commands, ElementsAre("LOAD \"a b.lsp\"", "(+ 1 2)", "-x"));
    EXPECT_TRUE(parsed->options->safe);
    EXPECT_TRUE(parsed->options->isBatch());
}

TEST(Options, TakeAProfileFolderAndAScript)
{
    const auto parsed =
        parse({"--profile-dir", "/tmp/größe 1", "--script=tour.script", "--layout-dir", "/tmp"});
    ASSERT_TRUE(parsed && parsed->options);
    EXPECT_EQ(parsed->options->profileFolder, "/tmp/größe 1");
    EXPECT_EQ(parsed->options->layoutFolder, "/tmp");
    EXPECT_EQ(parsed->options->script, "tour.script");
    EXPECT_TRUE(parsed->options->isBatch());
}

TEST(Options, RefuseAProfileFolderWithoutAName)
{
    const auto parsed = parse({"--profile-dir", ""});
    ASSERT_FALSE(parsed);
    EXPECT_EQ(parsed.code(), 2);
    EXPECT_THAT(tessel::toUtf8(parsed.sentence()), HasSubstr("--profile-dir: a folder is wanted"));
    EXPECT_FALSE(parse({"--profile-dir="}));
}

TEST(Options, TakeFilesToLoadInTheirOrderWhereverTheyStand)
{
    const auto parsed = parse({"a b.lsp", "-c", "APPS", "primes.zmb", "--", "--odd.lsp"});
    ASSERT_TRUE(parsed && parsed->options);
    EXPECT_THAT(parsed->options->files, ElementsAre("a b.lsp", "primes.zmb", "--odd.lsp"));
    EXPECT_THAT(parsed->options->commands, ElementsAre("APPS"));
    EXPECT_FALSE(parse({"a.lsp"})->options->isBatch()) << "files alone leave the person at the prompt";
}

TEST(Options, TakeTheDialogAlone)
{
    EXPECT_TRUE(parse({"--modrig"})->options->modrig);
    EXPECT_FALSE(parse({})->options->modrig);
}

TEST(Options, ShowHelpAndVersionWithStatusZero)
{
    const auto help = parse({"--help"});
    ASSERT_TRUE(help);
    EXPECT_FALSE(help->options);
    for (const char* option :
         {"--profile-dir", "--script", "-c", "--safe", "--modrig", "FILE", "--version", "status 2"})
        EXPECT_THAT(help->text, HasSubstr(option));
    const auto version = parse({"--version"});
    ASSERT_TRUE(version);
    EXPECT_THAT(version->text, HasSubstr("Tessel R21"));
}

TEST(Options, RefuseWhatTheyDoNotKnow)
{
    for (const std::vector<const char*>& arguments :
         {std::vector{"--unknown"}, std::vector{"--modrig", "-c", "APPS"},
          std::vector{"--modrig", "--script", "a.script"}, std::vector{"-c"}, std::vector{"--script"}})
    {
        const auto parsed = parse(arguments);
        EXPECT_FALSE(parsed) << arguments.front();
        EXPECT_EQ(parsed.code(), 2) << arguments.front();
        EXPECT_FALSE(parsed.sentence().empty()) << arguments.front();
    }
}
