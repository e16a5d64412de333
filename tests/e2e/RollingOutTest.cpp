// What docs/administrators.md tells about many machines, done: the example of rolling out, backup and
// restore.
#include <filesystem>

#include <gmock/gmock.h>

#include <nlohmann/json.hpp>

#include "tests/e2e/Applications.h"
#include "tests/support/ShellCommand.h"

using nlohmann::json;
using testing::EndsWith;
using testing::HasSubstr;
using testing::Not;

namespace
{
class RollingOut : public testing::Test
{
protected:
    std::filesystem::path layout() const { return session.folder() / "etc/tessel"; }

    // Runs the example for this machine, as an administrator would, but below a folder of the test's own.
    CommandOutcome roll(const Paths& suite, bool isPolicy = false) const
    {
        const json variables = {{"tessel_program", TESSEL_PROGRAM},
                                {"tessel_layout", layout().string()},
                                {"tessel_suite", suite},
                                {"tessel_suite_is_policy", isPolicy}};
        const auto file = session.folder().write("variables.json", variables.dump());
        const std::string home = (session.folder() / "home").string();
        std::filesystem::create_directories(home);
        return runCommand("HOME='" + home +
                          "' LC_ALL=C.UTF-8 ANSIBLE_NOCOWS=1 '" ANSIBLE_PLAYBOOK
                          "' -i localhost, -c local -e '@" +
                          file.string() + "' '" + EXAMPLES + "/ansible/tessel.yml'");
    }

    std::string appsOfEverybody()
    {
        session.alwaysWith({"--layout-dir", layout().string()});
        return session.run({"APPS"}).output;
    }

    HostSession session;
};
} // namespace

TEST_F(RollingOut, LaysOutASuiteThatEverybodyLoadsAndChangesNothingTheSecondTime)
{
    const std::string lisp =
        session.folder().write("a \"quoted\" größe.lsp", "(princ \"odd runs\")").string();
    const std::string module = (session.folder() / "back\\slash.omp").string();
    std::filesystem::copy_file(sample("gears.omp"), module);
    const auto first = roll({module, lisp});
    ASSERT_EQ(first.status, 0) << first.output;
    EXPECT_THAT(first.output, Not(HasSubstr("changed=0 ")));
    const auto second = roll({module, lisp});
    EXPECT_EQ(second.status, 0) << second.output;
    EXPECT_THAT(second.output, HasSubstr("changed=0 "));
    const std::string apps = appsOfEverybody();
    EXPECT_THAT(apps, HasSubstr(listed(module)));
    EXPECT_THAT(apps, HasSubstr("odd runs"));
}

TEST_F(RollingOut, MakesItPolicyThatAPersonCannotChange)
{
    ASSERT_EQ(roll({sample("primes.zmb")}).status, 0);
    const auto changed = roll({sample("gears.omp")}, true);
    ASSERT_EQ(changed.status, 0) << changed.output;
    EXPECT_FALSE(std::filesystem::exists(layout() / "suite.reg"));
    EXPECT_THAT(appsOfEverybody(), HasSubstr(listed(sample("gears.omp"))));
    const auto refused = session.start({"--safe", "-c", "SUITE CLEAR"});
    EXPECT_EQ(refused.exitStatus, 1);
    EXPECT_THAT(refused.output, HasSubstr("The administrator has laid down the Startup Suite in " +
                                          (layout() / "policy/suite.reg").string()));
}

// A file that is not understood would not count, and nobody would be told before the next start.
TEST_F(RollingOut, FailsWhenTesselDoesNotSeeWhatWasLaidOut)
{
    session.folder().write("etc/tessel/zzz.reg", suiteInFile({}));
    const auto rolled = roll({sample("primes.zmb")});
    EXPECT_NE(rolled.status, 0);
    EXPECT_THAT(rolled.output, HasSubstr("Assertion failed"));
}

TEST_F(RollingOut, PutsABackupBackAsItWas)
{
    const std::string backup = (session.folder() / "tessel.reg").string();
    const std::string lisp = session.folder().write("a.lsp", "").string();
    const auto saved =
        session.start({"--safe", "-c", "SUITE ADD " + lisp, "-c", "PROFILE Site", "-c", "HISTORY ADD " + lisp,
                       "-c", "REGISTRY EXPORT Software\\Tessel " + backup});
    ASSERT_EQ(saved.exitStatus, 0) << saved.output;
    const auto lost = session.start({"--safe", "-c", "HISTORY CLEAR", "-c", "PROFILE Default", "-c",
                                     "SUITE CLEAR", "-c", "REGISTRY SET Software\\Tessel\\Later name data"});
    ASSERT_EQ(lost.exitStatus, 0) << lost.output;
    const auto restored = session.start(
        {"--safe", "-c", "REGISTRY DELETE Software\\Tessel", "-c", "REGISTRY IMPORT " + backup});
    ASSERT_EQ(restored.exitStatus, 0) << restored.output;
    const auto again =
        session.start({"--safe", "-c", "PROFILE", "-c", "HISTORY LIST", "-c", "PROFILE Default", "-c",
                       "SUITE LIST", "-c", "REGISTRY LIST Software\\Tessel\\Later"});
    EXPECT_THAT(again.output, HasSubstr("Command: PROFILE\nSite\nCommand: HISTORY LIST\n1  " + lisp + "\n"));
    EXPECT_THAT(again.output, HasSubstr("Command: SUITE LIST\n1  " + lisp + "\n"));
    EXPECT_THAT(again.output, EndsWith("\"Software\\Tessel\\Later\" does not exist.\n"));
}
