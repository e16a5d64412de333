// A person keeps an application out at starts, and lets it in again.
#include <chrono>
#include <csignal>
#include <fstream>
#include <thread>

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
    EXPECT_THAT(enabled.output, HasSubstr(good + " is not kept out at starts any more.\n"));
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

// Everything that is loaded lies somewhere below the root: a path that is none must not keep all of it out.
TEST_F(KeptOutByHand, IsNothingWithoutAPath)
{
    const auto disabled = session.run({R"(DISABLE "")"});
    EXPECT_EQ(disabled.exitStatus, 1);
    EXPECT_THAT(disabled.output, HasSubstr("Usage: DISABLE file\n"));
    EXPECT_THAT(session.run({R"(ENABLE "")"}).output, HasSubstr("Usage: ENABLE file\n"));
    EXPECT_THAT(startSays(), AllOf(HasSubstr(listed(modrigBundle())), Not(HasSubstr("kept out"))));
}

TEST_F(KeptOutByHand, IsNothingWhereTheListHoldsAnEmptyPath)
{
    session.run({"DISABLE " + good});
    const auto file = session.profile() / "applications" / "kept-out";
    std::string content = contentOf(file);
    for (auto at = content.find(good); at != content.npos; at = content.find(good))
        content.erase(at, good.size());
    std::ofstream(file) << content;
    EXPECT_THAT(startSays(), HasSubstr(listed(modrigBundle())));
}

TEST_F(KeptOutByHand, IsNoFolder)
{
    const auto folder = session.folder() / "apps";
    std::filesystem::create_directory(folder);
    const auto result = session.run({"DISABLE " + folder.string(), "DISABLE /"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("\"" + folder.string() + "\" is a folder and no application.\n"));
    EXPECT_THAT(result.output, HasSubstr("\"/\" is a folder and no application.\n"));
    EXPECT_THAT(startSays(), Not(HasSubstr("kept out")));
}

TEST_F(KeptOutByHand, IsNoFileOfAnotherKind)
{
    const std::string letter = session.folder().write("letter.txt", "Dear Sir or Madam,\n").string();
    const std::string bundle = session.folder().write("letter.bundle", "Dear Sir or Madam,\n").string();
    const auto result = session.run({"DISABLE " + letter, "DISABLE " + bundle});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output,
                HasSubstr("\n\"" + letter +
                          "\" is no application: Tessel loads bundles, shared libraries (.zmb, "
                          ".omp) and Lisp (.lsp, .qbc).\n"));
    EXPECT_THAT(result.output, HasSubstr("\n\"" + bundle + "\" is a file and no bundle.\n"));
    EXPECT_THAT(startSays(), Not(HasSubstr("kept out")));
}

TEST_F(KeptOutByHand, IsASharedLibraryWhateverItsName)
{
    const auto library = session.folder() / "tool.so.1";
    std::filesystem::copy_file(good, library);
    EXPECT_EQ(session.run({"DISABLE " + library.string()}).exitStatus, 0);
}

TEST_F(KeptOutByHand, IsAnEntryOfTheSuiteByItsNameInASafeSession)
{
    storeSuite(session, {good, lisp});
    session.alwaysWith({"--safe"});
    const auto result = session.run({"DISABLE Good.zmb", "DISABLE nothing.zmb"});
    EXPECT_THAT(result.output, HasSubstr("\n" + good + " is kept out at starts from now on;"));
    EXPECT_THAT(result.output, HasSubstr("nothing.zmb\" that could be kept out.\n"));
    session.alwaysWith({});
    EXPECT_THAT(startSays(), AllOf(HasSubstr("good.lsp: loaded"), Not(HasSubstr("message 1"))));
}

TEST_F(KeptOutByHand, IsListedAsItIsNowOnceItIsLetIn)
{
    storeSuite(session, {good});
    session.run({"DISABLE " + good});
    const std::string said = session.run({"ENABLE Good.zmb", "APPS"}).output;
    const std::string apps = said.substr(said.find("Command: APPS"));
    EXPECT_THAT(apps, HasSubstr(listed(good, "was kept out of this start and is let in by now")));
    EXPECT_THAT(apps, Not(HasSubstr("DISABLE")));
}

TEST_F(KeptOutByHand, IsListedWithWhatElseIsWrongWithIt)
{
    const auto broken = session.folder().write("broken.lsp", "(").string();
    storeSuite(session, {broken});
    const std::string said = session.run({"DISABLE broken.lsp", "APPS"}).output;
    const std::string apps = said.substr(said.find("Command: APPS"));
    EXPECT_THAT(apps, ContainsRegex("  broken\\.lsp .* " + std::string(kReason) + "\n"));
    EXPECT_THAT(apps, ContainsRegex("  broken\\.lsp .* line 1: "));
}

TEST_F(KeptOutByHand, IsNothingThatIsNotThere)
{
    const auto result = session.run({"DISABLE " + session.folder().path().string() + "/nothere.zmb"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("There is no application \"" + session.folder().path().string() +
                                         "/nothere.zmb\" that could be kept out.\n"));
    EXPECT_THAT(startSays(), Not(HasSubstr("kept out")));
}

TEST_F(KeptOutByHand, MayBeModrigByNameWhileItIsNotLoaded)
{
    session.alwaysWith({"--safe"});
    const auto result = session.run({"DISABLE Modrig.bundle"});
    EXPECT_THAT(result.output, HasSubstr("\n" + modrigBundle() + " is kept out at starts from now on;"));
    session.alwaysWith({});
    EXPECT_THAT(startSays(), Not(HasSubstr(listed(modrigBundle()))));
}

TEST_F(KeptOutByHand, MayBeANamedFileThatCouldNotBeLoaded)
{
    const auto file = session.folder().write("broken.lsp", "(");
    storeSuite(session, {file.string()});
    const auto result = session.run({"DISABLE broken.lsp"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, HasSubstr("\n" + file.string() + " is kept out at starts from now on;"));
}

namespace
{
// Two files of one name, with the second in the current folder.
class KeptOutNamesakes : public KeptOutByHand
{
protected:
    void SetUp() override
    {
        const auto folder = session.folder() / "here";
        std::filesystem::create_directory(folder);
        std::filesystem::copy_file(lisp, first);
        std::filesystem::copy_file(lisp, second);
        session.startBy("cd '" + folder.string() + "' && exec \"$0\" \"$@\"");
    }

    std::string first = session.folder() / "same.lsp";
    std::string second = session.folder() / "here" / "same.lsp";
    std::string both = "Several applications are called \"same.lsp\"; type the whole path of one:\n  " +
                       first + "\n  " + second + "\n";
};
} // namespace

TEST_F(KeptOutNamesakes, AreToldApartWhenOneIsToBeKeptOut)
{
    storeSuite(session, {first});
    const auto result = session.run({"DISABLE same.lsp"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr(both));
    EXPECT_THAT(startSays(), Not(HasSubstr("kept out")));
}

TEST_F(KeptOutNamesakes, AreToldApartWhenOneIsToBeLetIn)
{
    session.run({"DISABLE " + first, "DISABLE " + second});
    const auto result = session.run({"ENABLE same.lsp"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr(both));
    EXPECT_EQ(session.run({"ENABLE " + second}).exitStatus, 0);
    EXPECT_THAT(session.run({"ENABLE same.lsp"}).output,
                HasSubstr("\n" + first + " is not kept out at starts any more.\n"));
}

// It was wished for: nothing has gone wrong.
TEST_F(KeptOutByHand, IsToldInOneLineAndNotAsAFailure)
{
    storeSuite(session, {good, lisp});
    session.run({"DISABLE " + good, "DISABLE " + lisp});
    const std::string said = session.run({"APPS"}).output;
    const std::string start = said.substr(0, said.find("Command: "));
    EXPECT_THAT(start, AllOf(Not(HasSubstr("could not be loaded")), Not(HasSubstr("Message: "))));
    EXPECT_EQ(start.find(good), start.rfind(good)) << start;
    EXPECT_EQ(start.find(lisp), start.rfind(lisp)) << start;
    const std::string apps = said.substr(start.size());
    EXPECT_THAT(apps, ContainsRegex("  Good\\.zmb .* " + std::string(kReason) + "\n"));
    EXPECT_THAT(apps, ContainsRegex("  good\\.lsp .* " + std::string(kReason) + "\n"));
}

TEST_F(KeptOutByHand, LeavesOnlyTheOthersAsFailures)
{
    const std::string missing = session.folder().path().string() + "/missing.zmb";
    storeSuite(session, {good, missing});
    session.run({"DISABLE " + good});
    EXPECT_THAT(startSays(), AllOf(HasSubstr("Message: 1 application could not be loaded:\n  " + missing),
                                   Not(HasSubstr("“" + good + "”"))));
}

TEST_F(KeptOutByHand, FailsWithAWordWhereNothingCanBeStored)
{
    session.startBy("ulimit -f 0; exec \"$0\" \"$@\"");
    const auto result = session.run({"DISABLE " + good});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("kept-out cannot be written: File too large.\n"));
}

TEST_F(KeptOutByHand, LeavesNothingOfAKilledSessionBeside)
{
    const auto part = session.folder().write("profile/applications/.tessel-part-AbCdEf", "half of it");
    session.run({"DISABLE " + good});
    EXPECT_FALSE(std::filesystem::exists(part));
    const auto file = session.profile() / "applications" / "kept-out";
    EXPECT_EQ(static_cast<unsigned>(std::filesystem::status(file).permissions()), 0600u);
}

namespace
{
class KeptOutByHandThatEndsTheHost : public KeptOutByHand
{
protected:
    void SetUp() override
    {
        storeSuite(session, {bad, good});
        ASSERT_EQ(session.start({"--safe", "-c", "DISABLE " + bad}).exitStatus, 0);
    }

    void expectItIsOnlyKeptOut(const std::string& named) const
    {
        const auto result = session.run({"APPS"});
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        const std::string start = result.output.substr(0, result.output.find("Command: "));
        EXPECT_THAT(start, HasSubstr("The application \"" + named + "\" ended Tessel "));
        EXPECT_THAT(
            start,
            HasSubstr(
                " (asked for by hand): it stopped at an error of its own (SIGABRT). It stays kept out at "
                "starts, until you let it in (ENABLE).\n"));
        EXPECT_EQ(start.find("abort"), start.rfind("abort")) << "said once: " << start;
        EXPECT_THAT(result.output.substr(start.size()), ContainsRegex("  abort\\.zmb .* " + since + "\n"));
    }

    std::string bad = deadly(session, "abort");
    std::string since = kReason;
};
} // namespace

TEST_F(KeptOutByHandThatEndsTheHost, StaysAsThePersonWishedWhateverElseIsDone)
{
    EXPECT_EQ(session.run({"LOAD " + bad}).exitStatus, -SIGABRT);
    expectItIsOnlyKeptOut(bad);
    std::filesystem::last_write_time(bad, std::filesystem::last_write_time(bad) + std::chrono::seconds(1));
    for (int start = 0; start < 3; ++start)
    {
        const auto result = session.run({"VERSION"});
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        EXPECT_THAT(result.output, ContainsRegex("\"" + bad + "\" is not loaded: it is " + since));
        EXPECT_THAT(result.output, Not(HasSubstr("tried")));
    }
    EXPECT_EQ(session.run({"ENABLE abort.zmb"}).exitStatus, 0);
    EXPECT_EQ(session.run({"VERSION"}).exitStatus, -SIGABRT);
}

// Nothing is tried of what a person keeps out.
TEST_F(KeptOutByHandThatEndsTheHost, IsNotTriedWhenItsFileWasReplacedMeanwhile)
{
    EXPECT_EQ(session.run({"LOAD " + bad}).exitStatus, -SIGABRT);
    std::this_thread::sleep_for(std::chrono::milliseconds(1100)); // ends are known to the second
    std::filesystem::permissions(bad, std::filesystem::perms::owner_all);
    expectItIsOnlyKeptOut(bad);
}

TEST_F(KeptOutByHandThatEndsTheHost, IsKnownByALinkToIt)
{
    const auto link = session.folder() / "link.zmb";
    std::filesystem::create_symlink(bad, link);
    session.run({"ENABLE " + bad, "DISABLE " + link.string()});
    EXPECT_EQ(session.run({"LOAD " + bad}).exitStatus, -SIGABRT);
    expectItIsOnlyKeptOut(bad);
}

TEST_F(KeptOutByHandThatEndsTheHost, IsKeptOutSinceThePersonSaidSo)
{
    const auto file = session.profile() / "applications" / "kept-out";
    std::string content = contentOf(file);
    const auto at = content.find("\t4\t") + 3;
    content.replace(at, content.find('\t', at) - at, "86400");
    std::ofstream(file) << content;
    EXPECT_EQ(session.run({"LOAD " + bad}).exitStatus, -SIGABRT);
    since = "kept out at starts by DISABLE since 1970-01-02 [0-9:]+";
    expectItIsOnlyKeptOut(bad);
}
