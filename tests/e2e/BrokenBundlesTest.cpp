// Bundles with a broken description, at every place where a person meets them: loaded by hand, from the
// Startup Suite, by the records of the host. One sentence each, and the
// host goes on.
#include <fstream>

#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"

namespace fs = std::filesystem;

using testing::EndsWith;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

namespace
{
struct Broken
{
    const char* name;
    const char* description;
    const char* reason; // how the sentence about it goes on
};

constexpr Broken kBroken[] = {
    {"list", "{ NSExecutable = (Good); }", "its description has no text for the name of its program.\n"},
    {"table", "{ NSExecutable = { a = b; }; }", "its description has no text for the name of its program.\n"},
    {"outside", "{ NSExecutable = \"../Good.bundle/Good\"; }",
     "its description names the program \"../Good.bundle/Good\", which leads out of the bundle.\n"},
    {"letter", "Dear { Sir or Madam", "its description \""},
    {"empty", "", "its description \""},
    {"missing", "{ NSExecutable = Gone; }", "its program \""},
};

class BrokenBundles : public testing::Test
{
protected:
    BrokenBundles()
    {
        for (const Broken& broken : kBroken)
        {
            fs::copy(fixtureModule("Good.bundle"), pathOf(broken), fs::copy_options::recursive);
            session.folder().write(fs::path(pathOf(broken)) / "Resources" / "Info-gnustep.plist",
                                   broken.description);
        }
    }

    std::string pathOf(const Broken& broken) const
    {
        return session.folder() / (broken.name + std::string(".bundle"));
    }

    static std::string refusal(const std::string& path, const Broken& broken)
    {
        return "The application \"" + path + "\" is not loaded: " + broken.reason;
    }

    // Everything that was said is about one of them, or is in the list of other lines.
    static void expectNoOtherLines(const std::string& output, const std::vector<std::string>& others)
    {
        std::istringstream lines(output);
        for (std::string line; std::getline(lines, line);)
        {
            const bool isTold = line.starts_with("The application \"") && line.ends_with(".");
            const bool isKnown = std::ranges::any_of(others, [&](const std::string& other)
                                                     { return line.starts_with(other); });
            EXPECT_TRUE(isTold || isKnown) << line;
        }
    }

    // Each of them was refused, and the good module before them and the one after them were loaded.
    void expectOneRefusalEach(const HostResult& result) const
    {
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        for (const Broken& broken : kBroken)
            EXPECT_THAT(result.output, HasSubstr("\n  " + pathOf(broken) + ": " + broken.reason));
        EXPECT_THAT(result.output, HasSubstr("Good.zmb: message 1\n"));
        EXPECT_THAT(result.output, HasSubstr("Good.omp: message 1\n"));
        expectNoOtherLines(result.output, {"Tessel R21", "Command: ", "Good.",
                                           "Message: 6 applications could not be loaded:", "  /"});
        EXPECT_THAT(result.output, Not(HasSubstr("is not loaded: "))) << "each is told once";
    }

    HostSession session;
};
} // namespace

TEST_F(BrokenBundles, DescribedForMachinesAloneTakeNeitherMemoryNorTime)
{
    const std::string path = session.folder() / "machine.bundle";
    fs::copy(fixtureModule("Good.bundle"), path, fs::copy_options::recursive);
    session.folder().write(fs::path(path) / "Resources" / "Info-gnustep.plist",
                           std::string("\0\6\1\3\0\0\0\0\0", 9));
    const HostResult result = session.run({"LOAD \"" + path + "\""});
    EXPECT_FALSE(result.timedOut);
    EXPECT_THAT(result.output, HasSubstr("is not loaded: its description \""));
    EXPECT_THAT(result.output,
                EndsWith("it is no property list that a person or a tool for bundles writes.\n"));
}

TEST_F(BrokenBundles, AreToldWhenTheyAreLoadedByHand)
{
    session.alwaysWith({"--safe"});
    for (const Broken& broken : kBroken)
    {
        const auto result = session.run({"LOAD " + pathOf(broken), "LOAD " + fixtureModule("Good.zmb")});
        EXPECT_EQ(result.exitStatus, 1) << result.output;
        EXPECT_THAT(result.output, StartsWith(kBanner + ("Command: LOAD " + pathOf(broken) + "\n") +
                                              refusal(pathOf(broken), broken)));
        EXPECT_THAT(result.output, HasSubstr(fixtureModule("Good.zmb") + " is loaded.\n"));
        expectNoOtherLines(result.output,
                           {"Tessel R21", "Command: ", "Good.zmb: ", fixtureModule("Good.zmb")});
    }
}

TEST_F(BrokenBundles, InTheStartupSuiteCostOneEntryEach)
{
    Paths suite = {fixtureModule("Good.zmb")};
    for (const Broken& broken : kBroken)
        suite.push_back(pathOf(broken));
    suite.push_back(fixtureModule("Good.omp"));
    storeSuite(session, suite);
    const auto result = session.run({"VERSION"});
    expectOneRefusalEach(result);
    EXPECT_THAT(result.output, EndsWith("Tessel R21, reference host for Modrig, version " MODRIG_VERSION "\n"
                                        "Good.omp: message 2\nGood.zmb: message 2\n"));
}

TEST_F(BrokenBundles, InTheRecordsCostOneApplicationEach)
{
    std::vector<std::string> commands;
    const auto record = [&](const std::string& name, const std::string& path)
    {
        const std::string key = R"(REGISTRY SET Software\Tessel\R21\Applications\)" + name;
        commands.push_back(key + " Module " + inQuotes(path));
        commands.push_back(key + " LoadReasons 2");
    };
    record("First", fixtureModule("Good.zmb"));
    for (const Broken& broken : kBroken)
        record(broken.name, pathOf(broken));
    record("Last", fixtureModule("Good.omp"));
    auto arguments = byArguments(commands);
    arguments.emplace_back("--safe");
    ASSERT_EQ(session.start(arguments).exitStatus, 0);
    const auto result = session.run({"VERSION"});
    expectOneRefusalEach(result);
}

namespace
{
// A bundle whose program is a link.
class BundlesWithLinks : public testing::Test
{
protected:
    BundlesWithLinks()
    {
        fs::copy(fixtureModule("Good.bundle"), bundle, fs::copy_options::recursive);
        fs::create_directories(inner.parent_path());
        fs::rename(program, inner);
    }

    std::string loading(const fs::path& path) const { return session.run({"LOAD " + path.string()}).output; }

    std::string refusal(const fs::path& leadsTo) const
    {
        return "\"" + bundle.string() + "\" is not loaded: its program \"" + program.string() +
               "\" leads out of the bundle, to \"" + leadsTo.string() + "\".\n";
    }

    HostSession session;
    fs::path bundle = session.folder() / "linked.bundle";
    fs::path program = bundle / "Good";
    fs::path inner = bundle / "Versions" / "A" / "Good";
    fs::path outside = session.folder() / "outside";
};
} // namespace

TEST_F(BundlesWithLinks, AreLoadedWhereTheirProgramLiesWithin)
{
    fs::create_directory_symlink("A", bundle / "Versions" / "Current");
    fs::create_symlink("Versions/Current/Good", program);
    EXPECT_THAT(loading(bundle), HasSubstr(bundle.string() + " is loaded.\n"));
}

TEST_F(BundlesWithLinks, MayBeReachedByALinkThemselves)
{
    fs::rename(inner, program);
    const fs::path link = session.folder() / "by link.bundle";
    fs::create_directory_symlink(bundle, link);
    const auto result = session.run({"LOAD \"" + link.string() + "\""});
    EXPECT_THAT(result.output, HasSubstr(link.string() + " is loaded.\n"));
}

TEST_F(BundlesWithLinks, AreRefusedWhereTheirProgramLiesElsewhere)
{
    fs::rename(inner, outside);
    fs::create_symlink(outside, program);
    EXPECT_THAT(loading(bundle), HasSubstr(refusal(outside)));
    // A neighbour whose name goes on where the bundle's ends is elsewhere too.
    const fs::path neighbour = bundle.string() + ".old";
    fs::create_directory(neighbour);
    fs::rename(outside, neighbour / "Good");
    fs::remove(program);
    fs::create_symlink("../linked.bundle.old/Good", program);
    EXPECT_THAT(loading(bundle), HasSubstr(refusal(neighbour / "Good")));
}

TEST_F(BundlesWithLinks, AreRefusedWhereAFolderOnTheWayLeadsElsewhere)
{
    session.folder().write("linked.bundle/Resources/Info-gnustep.plist",
                           "{ NSExecutable = \"inner/Good\"; }");
    fs::create_directory(outside);
    fs::rename(inner, outside / "Good");
    fs::create_directory_symlink(outside, bundle / "inner");
    program = bundle / "inner" / "Good";
    EXPECT_THAT(loading(bundle), HasSubstr(refusal(outside / "Good")));
}

TEST_F(BrokenBundles, WithABadProgramAreToldWithItsName)
{
    const fs::path bundle = session.folder() / "bad.bundle";
    fs::copy(fixtureModule("Good.bundle"), bundle, fs::copy_options::recursive);
    std::string program;
    for (const auto& entry : fs::directory_iterator(bundle))
        if (entry.is_regular_file())
            program = entry.path();
    std::ofstream(program) << "Dear Sir or Madam,\n";
    EXPECT_THAT(session.run({"LOAD " + bundle.string()}).output,
                HasSubstr("The application \"" + bundle.string() + "\" is not loaded: its program \"" +
                          program + "\" cannot be used, since it is not a shared library.\n"));
}

TEST_F(BrokenBundles, ThatAreFilesAreTold)
{
    const std::string file = session.folder().write("postcard.bundle", "Dear Sir or Madam,\n");
    EXPECT_THAT(session.run({"LOAD " + file}).output,
                HasSubstr("\"" + file + "\" is not loaded: it is a file, and a bundle is a folder.\n"));
}
