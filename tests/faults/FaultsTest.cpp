// Every system call that the registry's store makes fails once, and from then on for ever, in the real
// program: the lists are whole afterwards, a person was told, and nothing was overwritten.
#include <gmock/gmock.h>

#include <cerrno>
#include <cstdlib>
#include <fstream>
#include <map>

#include "tests/e2e/HostProcess.h"
#include "tests/support/Content.h"

using testing::AnyOf;
using testing::HasSubstr;
using testing::Not;

namespace
{
constexpr char kBanner[] =
    "Tessel R21, reference host for Modrig. Type HELP for the list of commands, QUIT to leave.\n";
constexpr unsigned kEach = 12; // of these calls each fails; of those after them some do, or all in a deep run
constexpr unsigned kStep = 17;

// Each of the locks that is refused for ever takes the store some seconds of trying.
constexpr const char* kWaitedFor = "fcntl";
constexpr unsigned kWaitingStep = 10;

using Counts = std::map<std::string, unsigned>;

bool isDeep()
{
    return std::getenv("MODRIG_DEEP") != nullptr;
}

class Faults
{
protected:
    Faults()
    {
        mSession.alwaysWith({"--safe", "-c", std::string("LOAD ") + REWRITES_LISTS});
        // Two writings, so that one more is told from one that began with nothing.
        EXPECT_EQ(mSession.run({"REWRITELISTS", "REWRITELISTS"}).exitStatus, 0);
        std::filesystem::copy(mSession.profile(), mSession.folder() / "kept", kAll);
    }

    void putBack()
    {
        std::filesystem::remove_all(mSession.profile());
        std::filesystem::copy(mSession.folder() / "kept", mSession.profile(), kAll);
    }

    HostResult runWith(const std::string& fault)
    {
        mSession.set("LD_PRELOAD", FAULTY_CALLS);
        mSession.set("MODRIG_FAULT", fault);
        const auto result = mSession.run({"TELLLISTS", "REWRITELISTS", "TELLLISTS"});
        for (const char* variable : {"LD_PRELOAD", "MODRIG_FAULT", "MODRIG_FAULT_COUNTS"})
            mSession.set(variable, "");
        return result;
    }

    Counts countCalls()
    {
        const auto file = mSession.folder() / "counts";
        mSession.set("MODRIG_FAULT_COUNTS", file.string());
        const auto result = runWith("");
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        std::ifstream lines(file);
        Counts counts;
        std::string name;
        for (unsigned count = 0; lines >> name >> count;)
            counts[name] = count;
        putBack();
        return counts;
    }

    // Which writing is stored, by a session in which nothing fails and which has nothing else to say.
    int storedWriting()
    {
        const auto result = mSession.run({"TELLLISTS"});
        const std::string start = kBanner + std::string("Command: LOAD ") + REWRITES_LISTS + "\n" +
                                  REWRITES_LISTS +
                                  " is loaded.\nCommand: TELLLISTS\nThe lists are of writing ";
        EXPECT_EQ(result.output.substr(0, start.size()), start);
        return result.output.size() > start.size() ? std::atoi(&result.output[start.size()]) : 0;
    }

    void expectNothingLost(const std::string& fault)
    {
        SCOPED_TRACE(fault);
        const auto result = runWith(fault);
        EXPECT_FALSE(result.timedOut);
        EXPECT_GE(result.exitStatus, 0) << result.output;
        const int stored = storedWriting();
        EXPECT_THAT(stored, AnyOf(2, 3)) << result.output;
        const bool wellRead = result.output.find("The lists are of writing 2.") != std::string::npos &&
                              result.output.find("The lists are of writing 3.") != std::string::npos;
        if (stored == 3 && wellRead)
            return putBack();
        EXPECT_THAT(result.output, HasSubstr("egistry " + (mSession.profile() / "registry.db").string()));
        putBack();
    }

    HostSession mSession;

private:
    static constexpr auto kAll = std::filesystem::copy_options::recursive;
};

class FailingCalls : public Faults, public testing::TestWithParam<std::string>
{
};

// Of the file that becomes the registry's copy.
class FailingParts : public Faults, public testing::Test
{
protected:
    std::string keptCopy() const { return contentOf(mSession.profile() / "registry.db.sound"); }

    // The lists and their copy are stored, whatever happens to the file on its way.
    void expectCopyAfter(const char* variable, const char* value, const std::string& fault)
    {
        const std::string before = keptCopy();
        mSession.set(variable, value);
        const auto result = runWith(fault);
        mSession.set(variable, "");
        EXPECT_FALSE(result.timedOut);
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        EXPECT_THAT(result.output, Not(HasSubstr("egistry")));
        EXPECT_TRUE(keptCopy() != before) << "the old copy stands there";
        EXPECT_EQ(storedWriting(), 3);
        for (const auto& entry : std::filesystem::directory_iterator(mSession.profile()))
            EXPECT_THAT(entry.path().filename().string(), Not(HasSubstr(".tessel-part-")));
    }
};

class FailingLocks : public Faults, public testing::Test
{
};
} // namespace

TEST_P(FailingCalls, LoseNothingAndAreTold)
{
    const std::string kind = GetParam();
    const unsigned calls = countCalls()[kind];
    ASSERT_GT(calls, 0u);
    for (unsigned number = 1; number <= calls; number += number < kEach || isDeep() ? 1 : kStep)
    {
        expectNothingLost(kind + " " + std::to_string(number) + " once");
        if (kind != kWaitedFor || number % kWaitingStep == 1 || isDeep())
            expectNothingLost(kind + " " + std::to_string(number) + " ever");
    }
}

// The store waits for locks, and must not do so for each value.
TEST_F(FailingLocks, EndTheSessionsReadingSoon)
{
    expectNothingLost("fcntl 40 ever " + std::to_string(ENOLCK));
}

TEST_F(FailingParts, AreNotMadeForEverWhereTheSystemCannotSayWhatTheyAre)
{
    expectCopyAfter("MODRIG_FAULT_OF", "/.tessel-part-", "fstat 1 ever");
}

TEST_F(FailingParts, AreMadeAgainWhenSomebodyHasTakenThemForLeftOvers)
{
    expectCopyAfter("MODRIG_FAULT_TAKEN", "1", "");
}

INSTANTIATE_TEST_SUITE_P(OfEachKind, FailingCalls,
                         testing::Values("open", "create", "pread", "write", "pwrite", "fsync", "fdatasync",
                                         "ftruncate", "fcntl", "unlink", "mmap", "munmap", "close", "stat",
                                         "fstat", "rename", "mkostemp"),
                         [](const auto& kind) { return kind.param; });
