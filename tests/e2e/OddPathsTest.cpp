// Applications in folders and under names that are unusual: whatever a file may be called, it is loaded, and
// what is said about it names it as it is.
#include <gtest/gtest.h>

#include "tests/e2e/Applications.h"

namespace fs = std::filesystem;

namespace
{
constexpr std::size_t kLongestFileName = 255;
constexpr std::size_t kLongestStored = 1023; // what can be read back from the registry

struct OddName
{
    const char* test;
    std::string name;
};

// Names the case in the list of tests; without it the name would hold addresses.
void PrintTo(const OddName& odd, std::ostream* stream)
{
    *stream << odd.test;
}

class OddPaths : public testing::TestWithParam<OddName>
{
protected:
    fs::path makeModule(const fs::path& file) const
    {
        fs::create_directories(file.parent_path());
        fs::copy_file(fixtureModule("Good.zmb"), file);
        return file;
    }

    fs::path makeLisp(const fs::path& file) const
    {
        fs::create_directories(file.parent_path());
        fs::copy_file(lispFixture("good.lsp"), file);
        return file;
    }

    // A file in folders within folders, whose whole path has this many bytes.
    fs::path longPath(const std::string& name, std::size_t length) const
    {
        fs::path path = session.folder().path();
        std::size_t missing = length - path.string().size() - 1 - name.size();
        while (missing > 0)
        {
            const std::size_t part = std::min(missing - 1, std::size_t{200});
            path /= std::string(part, 'x');
            missing -= part + 1;
        }
        return path / name;
    }

    HostSession session;
};

std::string labelOf(const testing::TestParamInfo<OddName>& info)
{
    return info.param.test;
}

const std::string kLoadedLisp = std::string("good.lsp: loaded\n");
} // namespace

TEST_P(OddPaths, AreLoadedFromTheStartupSuite)
{
    const fs::path folder = session.folder() / GetParam().name;
    const std::string module = makeModule(folder / (GetParam().name + ".zmb"));
    const std::string lisp = makeLisp(folder / (GetParam().name + ".lsp"));
    const std::string missing = folder / "missing.zmb";
    storeSuite(session, {module, missing, lisp});
    const auto result = session.run({"(good)"});
    EXPECT_EQ(result.output, kBanner + (GetParam().name + ".zmb: message 1\n") + kLoadedLisp + kLispReady +
                                 startSummary({{missing, "No such file or directory."}}) +
                                 "Command: (good)\n42\n" + GetParam().name + ".zmb: message 2\n");
}

TEST_P(OddPaths, AreLoadedAndUnloadedByHand)
{
    session.alwaysWith({"--safe"});
    const fs::path folder = session.folder() / GetParam().name;
    const std::string module = makeModule(folder / (GetParam().name + ".zmb"));
    const std::string lisp = makeLisp(folder / (GetParam().name + ".lsp"));
    const std::string name = GetParam().name + ".zmb";
    const auto result = session.run({"LOAD " + inQuotes(module), "UNLOAD " + inQuotes(module),
                                     "LOAD " + inQuotes(lisp), "LOAD " + inQuotes(folder / "missing.lsp")});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_EQ(result.output, kBanner + ("Command: LOAD " + inQuotes(module) + "\n" + name + ": message 1\n") +
                                 module + " is loaded.\nCommand: UNLOAD " + inQuotes(module) + "\n" + name +
                                 ": message 2\n" + module + " is unloaded.\nCommand: LOAD " + inQuotes(lisp) +
                                 "\n" + kLoadedLisp + lisp + " is loaded.\nCommand: LOAD " +
                                 inQuotes(folder / "missing.lsp") + "\nCannot load \"" +
                                 (folder / "missing.lsp").string() + "\": No such file or directory.\n");
}

INSTANTIATE_TEST_SUITE_P(WithOddNames, OddPaths,
                         testing::Values(OddName{"Blanks", "  two  blanks "},
                                         OddName{"Quotes", "the \"quoted\" 'name'"},
                                         OddName{"PerCentSigns", "100%s %n%n %ls %5000000d %"},
                                         OddName{"Letters", "größe ЖУК 日本語 😀"},
                                         OddName{"Dollars", "$HOME `id` ; & | *"},
                                         OddName{"Brackets", "(setq [x] #{y} #. )"},
                                         OddName{"Dots", "a.b..c.zmb"}, OddName{"Tildes", "~ ~% ~A @x"}),
                         labelOf);

TEST_F(OddPaths, OfFourThousandCharactersAreLoadedByHand)
{
    session.alwaysWith({"--safe"});
    const std::string module = makeModule(longPath("Good.zmb", 4000));
    const std::string lisp = makeLisp(longPath("good.lsp", 4000));
    const auto result = session.run({"LOAD " + module, "LOAD " + lisp, "(good)"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_EQ(result.output, kBanner + ("Command: LOAD " + module + "\nGood.zmb: message 1\n") + module +
                                 " is loaded.\nCommand: LOAD " + lisp + "\n" + kLoadedLisp + lisp +
                                 " is loaded.\nCommand: (good)\n42\nGood.zmb: message 2\n");
}

TEST_F(OddPaths, OfFourThousandCharactersThatAreMissingAreTold)
{
    session.alwaysWith({"--safe"});
    for (const std::size_t length : {4000u, 9000u})
    {
        const std::string module = longPath("missing.zmb", length);
        const auto result = session.run({"LOAD " + module, "VERSION"});
        const std::string reason = length > 4095 ? "File name too long" : "No such file or directory";
        EXPECT_EQ(result.output,
                  kBanner + ("Command: LOAD " + module + "\n") + linkerRefuses(module, reason) +
                      "Command: VERSION\nTessel R21, reference host for Modrig, version " MODRIG_VERSION
                      "\n");
    }
}

TEST_F(OddPaths, AsLongAsCanBeReadBackAreLoadedFromTheStartupSuite)
{
    const std::string module = makeModule(longPath("Good.zmb", kLongestStored));
    const std::string lisp = makeLisp(longPath("good.lsp", kLongestStored));
    storeSuite(session, {module, lisp});
    EXPECT_EQ(session.run({"(good)"}).output, kBanner + ("Good.zmb: message 1\n" + kLoadedLisp) + kLispReady +
                                                  "Command: (good)\n42\nGood.zmb: message 2\n");
}

// The Suite ends where its next value cannot be read, as at a gap.
TEST_F(OddPaths, OfFourThousandCharactersEndTheStartupSuite)
{
    const std::string module = makeModule(longPath("Good.omp", 4000));
    storeSuite(session, {lispFixture("good.lsp"), module, fixtureModule("Good.zmb")});
    const auto result = session.run({"VERSION"});
    EXPECT_EQ(result.output,
              kBanner + kLoadedLisp + kLispReady +
                  "Command: VERSION\nTessel R21, reference host for Modrig, version " MODRIG_VERSION "\n");
}

TEST_F(OddPaths, WithTheLongestFileNameAreLoadedFromTheStartupSuite)
{
    const std::string name = std::string(kLongestFileName - 4, 'n') + ".zmb";
    storeSuite(session, {makeModule(session.folder() / name)});
    EXPECT_EQ(session.run({"VERSION"}).output,
              kBanner + (name + ": message 1\nCommand: VERSION\n") +
                  "Tessel R21, reference host for Modrig, version " MODRIG_VERSION "\n" + name +
                  ": message 2\n");
}

TEST(AQuoteThatIsNotClosed, IsToldAndReachesToTheEndOfTheLine)
{
    const HostSession session;
    const std::string file = session.folder().write("two words.lsp", "(princ \"loaded\")\n").string();
    const std::string told =
        "The last quote in the line is not closed. What follows it was taken as \"" + file + "\".\n";
    const auto open = session.start({"--safe", "-c", "LOAD \"" + file});
    EXPECT_EQ(open.exitStatus, 0);
    EXPECT_NE(open.output.find(told), std::string::npos) << open.output;
    EXPECT_NE(open.output.find("\nloaded"), std::string::npos) << open.output;
    const auto closed = session.start({"--safe", "-c", "LOAD \"" + file + "\""});
    EXPECT_EQ(closed.output.find("quote"), std::string::npos) << closed.output;
}
