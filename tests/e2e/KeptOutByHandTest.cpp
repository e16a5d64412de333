// A person keeps an application out at starts, and lets it in again.
#include <gmock/gmock.h>

#include <sys/inotify.h>
#include <sys/stat.h>
#include <unistd.h>

#include "tests/e2e/Applications.h"
#include "tests/support/Content.h"

using testing::AllOf;
using testing::ContainsRegex;
using testing::HasSubstr;
using testing::Not;

namespace
{
class KeptOutByHand : public testing::Test
{
protected:
    std::string startSays() const { return session.run({"APPS"}).output; }

    HostSession session;
    std::string good = fixtureModule("Good.zmb");
    std::string lisp = lispFixture("good.lsp");
};

constexpr char kReason[] = "kept out at starts by DISABLE since [0-9]{4}-[0-9]{2}-[0-9]{2} [0-9]{2}:[0-9]{2}";
} // namespace

TEST_F(KeptOutByHand, IsAModuleUntilItIsLetIn)
{
    storeSuite(session, {good, lisp});
    const auto disabled = session.run({"DISABLE Good.zmb"});
    EXPECT_EQ(disabled.exitStatus, 0);
    EXPECT_THAT(disabled.output,
                HasSubstr(good + " is kept out at starts from now on; ENABLE lets it in again.\n"));
    for (int start = 0; start < 3; ++start)
    {
        const std::string said = startSays();
        EXPECT_THAT(said, ContainsRegex("\"" + good + "\" is not loaded: it is " + kReason));
        EXPECT_THAT(said, ContainsRegex("  Good\\.zmb .* " + std::string(kReason) + "\n"));
        EXPECT_THAT(said, AllOf(HasSubstr("good.lsp: loaded"), Not(HasSubstr("message 1"))));
    }
    const auto enabled = session.run({"ENABLE good.zmb"});
    EXPECT_THAT(enabled.output, HasSubstr(good + " is loaded at starts again.\n"));
    EXPECT_THAT(startSays(), AllOf(HasSubstr("Good.zmb: message 1"), Not(HasSubstr("kept out"))));
}

// A pipe that nobody writes into would keep whoever opens it waiting, or be told as no file.
TEST_F(KeptOutByHand, IsNotOpened)
{
    const auto pipe = session.folder() / "pipe.lsp";
    const auto module = session.folder() / "pipe.zmb";
    ASSERT_EQ(mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR), 0);
    ASSERT_EQ(mkfifo(module.c_str(), S_IRUSR | S_IWUSR), 0);
    storeSuite(session, {pipe.string(), module.string()});
    session.run({"DISABLE " + pipe.string(), "DISABLE " + module.string()});
    const int watch = inotify_init1(IN_NONBLOCK | IN_CLOEXEC);
    ASSERT_GE(inotify_add_watch(watch, session.folder().path().c_str(), IN_OPEN), 0);
    const std::string said = startSays();
    EXPECT_THAT(said, ContainsRegex("Cannot load \"" + pipe.string() + "\": it is " + kReason));
    EXPECT_THAT(said, ContainsRegex("\"" + module.string() + "\" is not loaded: it is " + kReason));
    char events[65536];
    const ssize_t count = read(watch, events, sizeof events);
    const std::string opened(events, count > 0 ? static_cast<std::size_t>(count) : 0);
    EXPECT_THAT(opened, Not(HasSubstr("pipe.")));
    close(watch);
}

TEST_F(KeptOutByHand, IsLoadedByHandAndStaysOutAtStarts)
{
    storeSuite(session, {good});
    const auto result = session.run({"DISABLE " + good, "LOAD " + good});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(startSays(), Not(HasSubstr("Good.zmb: message 1")));
    EXPECT_THAT(session.run({"LOAD " + good}).output, HasSubstr("Good.zmb: message 1"));
    EXPECT_THAT(startSays(), Not(HasSubstr("Good.zmb: message 1")));
}

TEST_F(KeptOutByHand, StaysOutWhenItsFileChanges)
{
    const auto file = session.folder().write("mine.lsp", "(write-line \"one\")\n");
    storeSuite(session, {file.string()});
    session.run({"DISABLE " + file.string()});
    session.folder().write("mine.lsp", "(write-line \"another one\")\n");
    EXPECT_THAT(startSays(), Not(HasSubstr("another one\n")));
}

TEST_F(KeptOutByHand, StaysInTheStartupSuite)
{
    storeSuite(session, {good, lisp});
    const std::string list = std::string("REGISTRY LIST ") + kSuiteKey;
    session.alwaysWith({"--safe"});
    const std::string before = session.run({list}).output;
    session.alwaysWith({});
    session.run({"DISABLE " + lisp});
    startSays();
    session.alwaysWith({"--safe"});
    EXPECT_EQ(session.run({list}).output, before);
}

TEST_F(KeptOutByHand, MayBeModrigWhichItsCommandStillLoads)
{
    session.run({"DISABLE Modrig.bundle"});
    EXPECT_THAT(startSays(), Not(HasSubstr(listed(modrigBundle()))));
    const auto result = session.run({"MODRIG", "ENABLE Modrig.bundle"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, HasSubstr("Tessel cannot open a window: there is no display.\n"));
    EXPECT_THAT(startSays(), HasSubstr(listed(modrigBundle())));
}

TEST_F(KeptOutByHand, IsToldWhenItIsNot)
{
    const auto result = session.run({"ENABLE " + good});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("The application \"" + good + "\" is not kept out.\n"));
    EXPECT_THAT(session.run({"DISABLE"}).output, HasSubstr("Usage: DISABLE file\n"));
    EXPECT_THAT(session.run({"ENABLE"}).output, HasSubstr("Usage: ENABLE file\n"));
}

TEST_F(KeptOutByHand, LetsInWhatEndedTheHost)
{
    const std::string bad = deadly(session, "abort");
    storeSuite(session, {bad});
    session.run({});
    EXPECT_EQ(session.run({"ENABLE abort.zmb"}).exitStatus, 0);
    EXPECT_EQ(session.run({"VERSION"}).exitStatus, -SIGABRT) << "it is tried again";
}

TEST_F(KeptOutByHand, FailsWithAWordWhereNothingCanBeStored)
{
    session.run({});
    const auto file = session.profile() / "applications" / "kept-out.new";
    std::filesystem::create_directories(file / "in the way");
    const auto result = session.run({"DISABLE " + good});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("kept-out cannot be written: "));
}
