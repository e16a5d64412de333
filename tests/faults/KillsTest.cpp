// The real program, killed while an application rewrites both lists: what is stored afterwards is one whole
// writing, and the last that was said to be stored or one after it.
#include <gtest/gtest.h>

#include <csignal>
#include <cstdlib>
#include <random>

#include "tests/e2e/HostProcess.h"
#include "tests/e2e/HostTerminal.h"
#include "tests/support/BusyFor.h"

namespace
{
constexpr int kKills = 50;
constexpr int kDeepKills = 1000;
constexpr int kStoredBefore = 2;

int kills()
{
    return std::getenv("MODRIG_DEEP") ? kDeepKills : kKills;
}

// The last of the numbers that follow the words.
int numberAfter(const std::string& words, const std::string& text)
{
    const std::size_t at = text.rfind(words);
    return at == text.npos ? 0 : std::atoi(&text[at + words.size()]);
}
} // namespace

TEST(KilledWhileRewriting, LeavesBothListsWhole)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    const std::string load = std::string("LOAD ") + REWRITES_LISTS;
    std::mt19937 random(std::random_device{}());
    int stored = 0;
    for (int kill = 1; kill <= kills(); ++kill)
    {
        int acknowledged = 0;
        {
            HostTerminal terminal(session);
            ASSERT_TRUE(terminal.shows("Command: ")) << terminal.screen();
            terminal.type(load + "\rTELLLISTS\rREWRITEFOREVER\r");
            const std::string awaited = "Stored " + std::to_string(stored + kStoredBefore) + ".";
            ASSERT_TRUE(terminal.shows(awaited)) << "kill " << kill << terminal.screen();
            ASSERT_EQ(numberAfter("The lists are of writing ", terminal.screen()), stored) << "kill " << kill;
            busyFor(static_cast<unsigned>(random() % 20'000'000));
            ASSERT_EQ(::kill(terminal.process(), SIGKILL), 0);
            EXPECT_EQ(terminal.waitForEnd(), -SIGKILL);
            acknowledged = numberAfter("Stored ", terminal.screen());
        }
        const auto result = session.run({load, "TELLLISTS"});
        stored = numberAfter("The lists are of writing ", result.output);
        ASSERT_EQ(result.exitStatus, 0) << result.output;
        ASSERT_EQ(result.output.find("egistry"), std::string::npos) << result.output;
        ASSERT_GE(stored, acknowledged) << "kill " << kill;
        ASSERT_GE(acknowledged, kStoredBefore) << "kill " << kill;
    }
}
