// What stands installed, below a folder that it was not built for.
#include <memory>

#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"
#include "tests/e2e_dialogs/Screen.h"
#include "tests/packages/Packages.h"

namespace fs = std::filesystem;
using testing::HasSubstr;
using testing::Not;

namespace
{
class Installed : public testing::Test
{
protected:
    Installed()
    {
        const auto unpacked = runCommand("dpkg-deb -x '" + packageFile("tessel").string() + "' '" +
                                         (session.folder() / "before").string() + "'");
        EXPECT_EQ(unpacked.status, 0) << unpacked.output;
        standIn(session.folder() / "before");
    }

    // Where it is from now on.
    void standIn(const fs::path& folder)
    {
        root = folder;
        session.startBy("exec " + asOrdinaryUser() + "'" + (root / "usr/bin/tessel").string() + "' \"$@\"");
    }

    // The folder of the test is the tester's alone from the beginning.
    void giveToOrdinaryUser() const
    {
        if (geteuid() != 0)
            return; // the tester is one
        const auto given = runCommand("chown -R 65534:65534 '" + session.folder().path().string() + "'");
        EXPECT_EQ(given.status, 0) << given.output;
    }

    fs::path library(const std::string& name) const { return root / "usr/" LIBRARIES "/tessel" / name; }

    HostSession session;
    fs::path root;
};
} // namespace

TEST_F(Installed, RunsForAnOrdinaryUser)
{
    giveToOrdinaryUser();
    const std::string primes = library("samples/primes.zmb");
    const std::string bundle = library("Tessel.app/PlugIns/Modrig.bundle");
    const auto result = session.run({"APPS", "LOAD " + inQuotes(primes), "HELP startup_suite_dialog"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, HasSubstr("Command: APPS\n" + listed(bundle)));
    EXPECT_THAT(result.output, HasSubstr(kPrimes + primes + " is loaded.\n"));
    EXPECT_THAT(result.output,
                HasSubstr(library("Tessel.app/Resources/help/startup_suite_dialog.html").string()));
}

TEST_F(Installed, HasTheCommandsOfModrigsLists)
{
    giveToOrdinaryUser();
    const std::string primes = library("samples/primes.zmb");
    const auto stored =
        session.start({"--safe", "-c", "SUITE ADD " + inQuotes(primes), "-c", "HISTORY LIST"});
    EXPECT_EQ(stored.exitStatus, 0);
    EXPECT_THAT(stored.output, HasSubstr("primes.zmb was added to the Startup Suite.\nCommand: HISTORY LIST\n"
                                         "There is nothing in the History list.\n"));
    EXPECT_THAT(session.run({"HELP"}).output, HasSubstr(kPrimes));
}

TEST_F(Installed, CompilesLisp)
{
    const auto source = session.folder().write("hello.lsp", "(write-line \"hello\")\n").string();
    const auto compiled = runCommand("'" + (root / "usr/bin/tesselc").string() + "' '" + source + "'");
    EXPECT_EQ(compiled.status, 0) << compiled.output;
    EXPECT_TRUE(fs::is_regular_file(session.folder() / "hello.qbc"));
}

TEST_F(Installed, GoesOnAfterItWasMovedWithTheSuiteOfBefore)
{
    const std::string lisp = session.folder().write("suite.lsp", "(write-line \"suite runs\")\n").string();
    giveToOrdinaryUser();
    storeSuite(session, {lisp});
    EXPECT_THAT(session.run({"APPS"}).output, HasSubstr("suite runs"));
    const std::string before = library("Tessel.app/PlugIns/Modrig.bundle");
    fs::rename(root, session.folder() / "after");
    standIn(session.folder() / "after");
    const std::string after = library("Tessel.app/PlugIns/Modrig.bundle");
    const std::string told =
        "The application \"TesselModrig\" is " + after + " now; " + before + " is not there any more.\n";
    const auto first = session.run({"APPS"});
    EXPECT_THAT(first.output, HasSubstr(kBanner + told + "suite runs"));
    EXPECT_THAT(first.output, HasSubstr("Command: APPS\n" + listed(after)));
    const auto second = session.run({"APPS"});
    EXPECT_THAT(second.output, HasSubstr(std::string(kBanner) + "suite runs")) << "told once";
    EXPECT_THAT(second.output, HasSubstr("Command: APPS\n" + listed(after)));
}

TEST_F(Installed, OpensItsDialog)
{
    const Screen screen;
    session.set("DISPLAY", screen.display());
    session.startBy("exec '" + (root / "usr/bin/tessel").string() + "' \"$@\"");
    Program host(session.commandLine({"--modrig"}), session.environment(), session.folder() / "output.txt");
    ASSERT_FALSE(screen.waitForActive("Load/Unload Applications").empty()) << host.output();
    screen.key("Escape");
    EXPECT_THAT(host.waitForEnd(), testing::Optional(0));
    EXPECT_EQ(host.output(), "");
}
