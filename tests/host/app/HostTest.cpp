// The host in the test's own process, as tests of the parts use it. The program's own tests are in tests/e2e.
#include <gmock/gmock.h>

#include <tessel/tsed.h>
#include <tessel/tshostservices.h>
#include <tessel/tsrxlinker.h>

#include "host/app/Host.h"
#include "tests/support/TemporaryFolder.h"

using testing::IsSupersetOf;
using testing::StartsWith;

namespace
{
class HostInProcess : public testing::Test
{
protected:
    tessel::HostOptions options(const char* profile = "profile")
    {
        return {.profileFolder = folder / profile,
                .safe = true,
                .output = [this](std::string_view text)
                {
                    output += text;
                }};
    }

    TemporaryFolder folder;
    std::string output;
};
} // namespace

TEST_F(HostInProcess, RunsLinesFromItsStartToItsEnd)
{
    tessel::Host host(options());
    ASSERT_TRUE(host.start()) << output;
    EXPECT_EQ(output, "");
    EXPECT_TRUE(host.run(L"VERSION"));
    EXPECT_EQ(output, "Tessel R21, reference host for Modrig, version " MODRIG_VERSION "\n");
    EXPECT_FALSE(host.isEnding());
    EXPECT_TRUE(host.run(L"quit"));
    EXPECT_TRUE(host.isEnding());
    EXPECT_FALSE(host.run(L"NOSUCH"));
}

TEST_F(HostInProcess, OffersItsServicesWhileItRuns)
{
    EXPECT_EQ(tsdbHostApplicationServices(), nullptr);
    tessel::Host host(options());
    ASSERT_TRUE(host.start()) << output;
    EXPECT_NE(TsRxDynamicLinker::cast(tsrxSysRegistry()->at(L"DynamicLinker")), nullptr);
    EXPECT_EQ(TsRxDynamicLinker::cast(tsrxSysRegistry()->at(L"TESSEL_REGISTERED_COMMANDS")), nullptr);
    EXPECT_EQ(tsrxSysRegistry()->at(L"dynamiclinker"), nullptr);
    EXPECT_EQ(tsrxSysRegistry()->at(nullptr), nullptr);
    host.end();
    EXPECT_EQ(tsrxSysRegistry()->at(L"DynamicLinker"), nullptr);
    EXPECT_EQ(tsdbHostApplicationServices(), nullptr);
}

TEST_F(HostInProcess, EvaluatesQueuedLispWhenTheLineIsDone)
{
    tessel::Host host(options());
    ASSERT_TRUE(host.start()) << output;
    qxr_queueexpr(L"(princ \"queued\")");
    EXPECT_EQ(output, "");
    EXPECT_TRUE(host.run(L"VERSION"));
    EXPECT_EQ(output, "Tessel R21, reference host for Modrig, version " MODRIG_VERSION "\nqueued");
}

TEST_F(HostInProcess, StoresWhatALineWrote)
{
    {
        tessel::Host host(options());
        ASSERT_TRUE(host.start()) << output;
        EXPECT_TRUE(host.run(L"REGISTRY SET Software\\Trial name kept"));
    }
    tessel::Host host(options());
    ASSERT_TRUE(host.start()) << output;
    EXPECT_TRUE(host.run(L"REGISTRY GET Software\\Trial name"));
    EXPECT_EQ(output, "kept\n");
}

TEST_F(HostInProcess, IsOneAtATime)
{
    tessel::Host first(options());
    ASSERT_TRUE(first.start()) << output;
    tessel::Host second(options("other"));
    EXPECT_FALSE(second.start());
    EXPECT_EQ(output, "Another session runs in this process already.\n");
    EXPECT_TRUE(first.run(L"VERSION"));
}

TEST_F(HostInProcess, KnowsWhatCanBeCompleted)
{
    tessel::Host host(options());
    ASSERT_TRUE(host.start()) << output;
    EXPECT_THAT(host.completionSources().commands(), IsSupersetOf({L"HELP", L"LOAD", L"SETVAR"}));
}

TEST_F(HostInProcess, ReadsTheLispSettingBeforeAnythingElse)
{
    {
        tessel::Host host(options());
        ASSERT_TRUE(host.start()) << output;
        EXPECT_TRUE(RemovingTsLISP());
        EXPECT_TRUE(host.run(L"SETVAR REMOVINGTSLISP 0"));
        EXPECT_TRUE(RemovingTsLISP()); // the answer does not change while the host runs
    }
    tessel::Host host(options());
    ASSERT_TRUE(host.start()) << output;
    EXPECT_FALSE(RemovingTsLISP());
}

TEST_F(HostInProcess, SaysThatTheProfileFolderCannotBeMade)
{
    folder.write("profile", "a file");
    tessel::Host host(options());
    EXPECT_FALSE(host.start());
    EXPECT_THAT(output,
                StartsWith("The profile folder " + (folder / "profile").string() + " cannot be made: "));
}
