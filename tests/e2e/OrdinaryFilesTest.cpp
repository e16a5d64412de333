// Files that a person names, and that may be anything; and output that cannot be written.
#include <gmock/gmock.h>

#include <sys/stat.h>

#include "tests/e2e/HostTerminal.h"
#include "tests/support/Content.h"

namespace fs = std::filesystem;

using testing::AllOf;
using testing::EndsWith;
using testing::HasSubstr;

namespace
{
class Script : public testing::Test
{
protected:
    // By the option and by the command: neither waits for a writer, nor reads without an end.
    void expectRefused(const fs::path& script, const std::string& reason)
    {
        const std::string sentence = "The script " + script.string() + " cannot be read: " + reason + ".\n";
        for (const HostResult& result : {session.start({"--script", script.string()}),
                                         session.run({"SCRIPT \"" + script.string() + "\"", "VERSION"})})
        {
            EXPECT_FALSE(result.timedOut) << script;
            EXPECT_EQ(result.exitStatus, 1) << result.output;
            EXPECT_THAT(result.output, HasSubstr(sentence));
        }
    }

    HostSession session;
};

// Runs the commands with a shell's redirection of the host's output, errors aside; answers its status.
HostResult runInto(HostSession& session, const std::string& redirection,
                   const std::vector<std::string>& arguments)
{
    session.startBy("exec \"$0\" \"$@\" " + redirection);
    return session.start(arguments);
}
} // namespace

TEST_F(Script, ThatIsAPipeIsRefused)
{
    const fs::path pipe = session.folder() / "pipe";
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    expectRefused(pipe, "it is not an ordinary file");
}

TEST_F(Script, ThatIsADeviceIsRefused)
{
    expectRefused("/dev/zero", "it is not an ordinary file");
}

TEST_F(Script, ThatIsAFolderIsRefused)
{
    expectRefused(session.folder().path(), "it is a folder, not a file");
}

TEST_F(Script, OfNoSensibleSizeIsRefused)
{
    const fs::path script = session.folder().write("large.script", "VERSION\n");
    fs::resize_file(script, (32u << 20) + 1);
    expectRefused(script, "it is larger than 32 MB");
}

TEST_F(Script, MayBeEmptyOrALink)
{
    EXPECT_EQ(session.start({"--script", session.folder().write("empty.script", "").string()}).exitStatus, 0);
    fs::create_symlink(session.folder().write("real.script", "(+ 40 2)\n"), session.folder() / "link.script");
    const auto result = session.start({"--script", (session.folder() / "link.script").string()});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_THAT(result.output, EndsWith("\n42\n"));
}

TEST(Output, ThatCannotBeWrittenGivesAStatusThatTellsSo)
{
    HostSession session;
    const std::vector<std::vector<std::string>> calls = {{"-c", "VERSION"}, {"--version"}, {"--help"}, {}};
    for (const auto& arguments : calls)
    {
        const auto result = runInto(session, ">/dev/full", arguments);
        EXPECT_EQ(result.exitStatus, 1);
        EXPECT_EQ(result.output,
                  "Tessel: some of the output could not be written: No space left on device.\n");
    }
}

TEST(Output, ThatIsClosedGivesAStatusThatTellsSoAndLandsInNoFile)
{
    HostSession session;
    const std::vector<std::string> call = {"-c", R"(REGISTRY SET Software\Trial name kept)"};
    EXPECT_EQ(runInto(session, ">&-", call).exitStatus, 1);
    EXPECT_EQ(runInto(session, "<&- >&- 2>&-", call).exitStatus, 1);
    EXPECT_EQ(runInto(session, "<&-", call).exitStatus, 0);
    for (const auto& entry : fs::recursive_directory_iterator(session.profile()))
        EXPECT_FALSE(entry.is_regular_file() &&
                     contentOf(entry.path()).find("reference host") != std::string::npos)
            << entry.path();
}

TEST(Output, ThatCannotBeWrittenLeavesAWorseStatusAlone)
{
    HostSession session;
    EXPECT_EQ(runInto(session, ">/dev/full", {"--nonsense"}).exitStatus, 2);
}

TEST(Output, ThatCannotBeWrittenDoesNotKeepAnythingFromBeingDone)
{
    HostSession session;
    EXPECT_EQ(runInto(session, ">/dev/full", {"-c", R"(REGISTRY SET Software\Trial name kept)"}).exitStatus,
              1);
    EXPECT_THAT(runInto(session, "", {"-c", R"(REGISTRY GET Software\Trial name)"}).output,
                EndsWith("\nkept\n"));
}
