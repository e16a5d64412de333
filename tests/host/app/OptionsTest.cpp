#include <gmock/gmock.h>

#include "host/app/Options.h"

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
    const auto parsed = parse({"--profile-dir", "/tmp/größe 1", "--script=tour.script"});
    ASSERT_TRUE(parsed && parsed->options);
    EXPECT_EQ(parsed->options->profileFolder, "/tmp/größe 1");
    EXPECT_EQ(parsed->options->script, "tour.script");
    EXPECT_TRUE(parsed->options->isBatch());
}

TEST(Options, ShowHelpAndVersionWithStatusZero)
{
    const auto help = parse({"--help"});
    ASSERT_TRUE(help);
    EXPECT_FALSE(help->options);
    for (const char* option : {"--profile-dir", "--script", "-c", "--safe", "--version", "status 2"})
        EXPECT_THAT(help->text, HasSubstr(option));
    const auto version = parse({"--version"});
    ASSERT_TRUE(version);
    EXPECT_THAT(version->text, HasSubstr("Tessel R21"));
}

TEST(Options, RefuseWhatTheyDoNotKnow)
{
    for (const std::vector<const char*>& arguments :
         {std::vector{"--unknown"}, std::vector{"word"}, std::vector{"-c"}, std::vector{"--script"}})
    {
        const auto parsed = parse(arguments);
        EXPECT_FALSE(parsed) << arguments.front();
        EXPECT_EQ(parsed.code(), 2) << arguments.front();
        EXPECT_FALSE(parsed.sentence().empty()) << arguments.front();
    }
}
