#include <gmock/gmock.h>

#include "host/app/Options.h"

using testing::ElementsAre;
using testing::HasSubstr;

namespace
{
tessel::ParsedOptions parse(std::vector<const char*> arguments)
{
    arguments.insert(arguments.begin(), "Tessel");
    return tessel::parseOptions(static_cast<int>(arguments.size()), arguments.data());
}
} // namespace

TEST(Options, AreAnOrdinarySessionWithoutArguments)
{
    const auto parsed = parse({});
    ASSERT_TRUE(parsed.options);
    EXPECT_TRUE(parsed.options->profileFolder.empty());
    EXPECT_FALSE(parsed.options->safe);
    EXPECT_FALSE(parsed.options->isBatch());
}

TEST(Options, TakeCommandsInTheirOrderAndOneArgumentEach)
{
    const auto parsed = parse({"-c", "LOAD \"a b.lsp\"", "-c", "(+ 1 2)", "--safe", "-c", "-x"});
    ASSERT_TRUE(parsed.options);
    EXPECT_THAT(parsed.options->commands, ElementsAre("LOAD \"a b.lsp\"", "(+ 1 2)", "-x"));
    EXPECT_TRUE(parsed.options->safe);
    EXPECT_TRUE(parsed.options->isBatch());
}

TEST(Options, TakeAProfileFolderAndAScript)
{
    const auto parsed = parse({"--profile-dir", "/tmp/größe 1", "--script=tour.script"});
    ASSERT_TRUE(parsed.options);
    EXPECT_EQ(parsed.options->profileFolder, "/tmp/größe 1");
    EXPECT_EQ(parsed.options->script, "tour.script");
    EXPECT_TRUE(parsed.options->isBatch());
}

TEST(Options, ShowHelpAndVersionWithStatusZero)
{
    const auto help = parse({"--help"});
    EXPECT_FALSE(help.options);
    EXPECT_EQ(help.exitStatus, 0);
    for (const char* option : {"--profile-dir", "--script", "-c", "--safe", "--version", "status 2"})
        EXPECT_THAT(help.text, HasSubstr(option));
    const auto version = parse({"--version"});
    EXPECT_EQ(version.exitStatus, 0);
    EXPECT_THAT(version.text, HasSubstr("Tessel R21"));
}

TEST(Options, RefuseWhatTheyDoNotKnow)
{
    for (const std::vector<const char*>& arguments :
         {std::vector{"--unknown"}, std::vector{"word"}, std::vector{"-c"}, std::vector{"--script"}})
    {
        const auto parsed = parse(arguments);
        EXPECT_FALSE(parsed.options) << arguments.front();
        EXPECT_EQ(parsed.exitStatus, 2) << arguments.front();
        EXPECT_FALSE(parsed.text.empty()) << arguments.front();
    }
}
