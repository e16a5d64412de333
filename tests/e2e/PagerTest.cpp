// Lists that are longer than the screen.
#include <gmock/gmock.h>

#include "tests/e2e/HostTerminal.h"
#include "tests/support/Content.h"

using testing::HasSubstr;
using testing::Not;

namespace
{
constexpr HostTerminal::Size kLow{100, 10};
constexpr char kLastLine[] = "HELP and a name, such as HELP LOAD, tells how a command is typed.";

class Pager : public testing::Test
{
protected:
    Pager() { session.alwaysWith({"--safe"}); }

    HostSession session;
};
} // namespace

TEST_F(Pager, IsThePersonsOwn)
{
    session.set("PAGER", "sed 's/^/page: /'");
    HostTerminal terminal(session, {}, kLow);
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("HELP\r");
    EXPECT_TRUE(terminal.shows("page:   LOAD ")) << terminal.screen();
    EXPECT_TRUE(terminal.shows(std::string("page: ") + kLastLine)) << terminal.screen();
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("VERSION\r");
    EXPECT_TRUE(terminal.shows("\nTessel R21")) << "what fits is shown without it";
}

TEST_F(Pager, LeavesRoomForThePrompt)
{
    session.set("PAGER", "sed 's/^/page: /'");
    HostTerminal terminal(session, {}, {100, 5});
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("SETVAR\r"); // four lines
    EXPECT_TRUE(terminal.shows("\n  LISPENABLED = 1")) << terminal.screen();
    terminal.resize({100, 4});
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("SETVAR\r");
    EXPECT_TRUE(terminal.shows("page:   LISPENABLED = 1")) << terminal.screen();
}

TEST_F(Pager, IsLeftWithQ)
{
    HostTerminal terminal(session, {}, kLow);
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("HELP\r");
    ASSERT_TRUE(terminal.shows("QUIT")) << terminal.screen();
    ASSERT_TRUE(terminal.shows(":")) << terminal.screen();
    terminal.type("q");
    ASSERT_TRUE(terminal.awaitPrompt());
    EXPECT_THAT(terminal.screen(), Not(HasSubstr(kLastLine)));
    terminal.type("(* 6 7)\r");
    EXPECT_TRUE(terminal.shows("\n42")) << terminal.screen();
    EXPECT_EQ(terminal.quit(), 0);
}

TEST_F(Pager, IsEndedByControlC)
{
    session.set("PAGER", "head -n 1; exec sleep 100");
    HostTerminal terminal(session, {}, kLow);
    ASSERT_TRUE(terminal.awaitPrompt());
    for (int times = 0; times < 4; ++times) // the host would ask after three in vain
    {
        terminal.type("HELP\r");
        ASSERT_TRUE(terminal.shows("Tessel R21")) << terminal.screen();
        terminal.type(kControlC);
        ASSERT_TRUE(terminal.awaitPrompt());
    }
    EXPECT_THAT(terminal.screen(), Not(HasSubstr(kLastLine)));
    terminal.type("(* 6 7)\r");
    EXPECT_TRUE(terminal.shows("\n42")) << terminal.screen();
}

TEST_F(Pager, ThatIsMissingOrFailsLosesNothing)
{
    for (const char* pager : {"no-such-program-at-all", "false", "exit 3", "kill -TERM $$"})
    {
        session.set("PAGER", pager);
        HostTerminal terminal(session, {}, kLow);
        ASSERT_TRUE(terminal.awaitPrompt());
        terminal.type("HELP\r");
        EXPECT_TRUE(terminal.shows("\n  LOAD ")) << pager << terminal.screen();
        EXPECT_TRUE(terminal.shows(kLastLine)) << pager << terminal.screen();
        EXPECT_TRUE(terminal.awaitPrompt());
    }
}

TEST_F(Pager, IsNotNeeded)
{
    session.set("PATH", "/nowhere");
    HostTerminal terminal(session, {}, kLow);
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("HELP\r");
    EXPECT_TRUE(terminal.shows(kLastLine)) << terminal.screen();
    session.startBy("PAGER= exec \"$0\" \"$@\"");
    HostTerminal without(session, {}, kLow);
    ASSERT_TRUE(without.awaitPrompt());
    without.type("HELP\r");
    EXPECT_TRUE(without.shows(kLastLine)) << without.screen();
}

TEST_F(Pager, IsOnlyForPersons)
{
    session.set("PAGER", "sed 's/^/page: /'");
    const auto script = session.folder().write("a.scr", "HELP\n").string();
    HostTerminal batch(session, {"-c", "HELP"}, kLow);
    EXPECT_EQ(batch.waitForEnd(), 0);
    EXPECT_THAT(batch.screen(), Not(HasSubstr("page: ")));
    HostTerminal terminal(session, {}, kLow);
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("SCRIPT " + script + "\r");
    EXPECT_TRUE(terminal.shows(kLastLine)) << terminal.screen();
    EXPECT_THAT(terminal.screen(), Not(HasSubstr("page: ")));
}

TEST_F(Pager, ShowsWhatTheLogKeepsToo)
{
    session.set("PAGER", "cat >/dev/null");
    const auto log = session.folder() / "all.log";
    HostTerminal terminal(session, {"--log", log.string()}, kLow);
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("HELP\r");
    ASSERT_TRUE(terminal.awaitPrompt());
    EXPECT_EQ(terminal.quit(), 0);
    EXPECT_THAT(terminal.screen(), Not(HasSubstr(kLastLine)));
    EXPECT_THAT(contentOf(log), HasSubstr(kLastLine));
}
