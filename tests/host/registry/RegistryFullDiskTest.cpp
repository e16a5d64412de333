// A disk that is full: a limit on the size of the files of a child process stands for it.
#include <gmock/gmock.h>

#include <csignal>

#include <sys/resource.h>

#include "host/text/Unicode.h"
#include "tests/host/registry/StoredList.h"
#include "tests/host/support/HostParts.h"
#include "tests/support/ChildProcess.h"
#include "tests/support/Database.h"
#include "tests/support/TemporaryFolder.h"

using tessel::Registry;
using testing::AllOf;
using testing::HasSubstr;
using testing::StartsWith;

namespace
{
bool limitFiles(rlim_t bytes)
{
    std::signal(SIGXFSZ, SIG_IGN); // as the host does: the write fails, and nobody is killed
    rlimit limit = {};
    getrlimit(RLIMIT_FSIZE, &limit);
    limit.rlim_cur = bytes;
    return setrlimit(RLIMIT_FSIZE, &limit) == 0;
}

class FullDisk : public testing::Test
{
protected:
    std::filesystem::path file() const { return folder / "registry.db"; }

    void makeFile(int entries)
    {
        Registry registry(file());
        ASSERT_TRUE(rewriteList(registry, 1, entries));
        ASSERT_TRUE(registry.endOfCommand());
    }

    // Rewrites the list as generation 2 where files may have so many bytes, and tells in one line how it went
    // and which generation the same process reads before and after the command's end.
    std::string rewriteWithin(rlim_t bytes, int entries)
    {
        return askChild(
            [=, this]
            {
                CapturedOutput output;
                Registry registry(file());
                if (generationOf(registry) != 1 || !limitFiles(bytes))
                    return std::string("cannot start");
                std::string answer = rewriteList(registry, 2, entries) ? "written" : "write failed";
                answer += ", reads " + std::to_string(generationOf(registry));
                answer += output.commandLine().tell(registry.endOfCommand()) ? ", stored" : ", undone";
                answer += ", reads " + std::to_string(generationOf(registry));
                return answer + ", said: " + output.text().substr(0, output.text().find('\n'));
            });
    }

    int generationInFile()
    {
        EXPECT_EQ(runSql(file(), "PRAGMA integrity_check"), "ok");
        Registry registry(file());
        return generationOf(registry);
    }

    TemporaryFolder folder;
};
} // namespace

TEST_F(FullDisk, ShowsAtTheWriteAndTheListOfBeforeIsThere)
{
    makeFile(20);
    const std::string answer = rewriteWithin(0, 20);
    EXPECT_THAT(answer, StartsWith("write failed, reads 1, undone, reads 1, said: The registry " +
                                   file().string() + " could not be written: "));
    EXPECT_THAT(
        answer,
        HasSubstr(" could not be written: File too large. What was stored before is unchanged. Lift the"));
    EXPECT_EQ(generationInFile(), 1);
}

TEST_F(FullDisk, StoresAllOrNothingWhereverTheLimitIs)
{
    int stored = 0;
    int failedAtTheWrite = 0;
    int failedAtTheEnd = 0;
    for (rlim_t bytes = 0; bytes < 80'000; bytes += 2500)
    {
        std::filesystem::remove(file());
        makeFile(30);
        const std::string answer = rewriteWithin(bytes, 40);
        if (answer == "written, reads 2, stored, reads 2, said: ")
            ++stored;
        else if (answer.starts_with("write failed, reads 1, undone, reads 1, said: The registry"))
            ++failedAtTheWrite;
        else if (answer.starts_with("written, reads 2, undone, reads 1, said: The registry"))
            ++failedAtTheEnd;
        else
            ADD_FAILURE() << bytes << ": " << answer;
        EXPECT_EQ(generationInFile(), answer.starts_with("written, reads 2, stored") ? 2 : 1) << bytes;
    }
    EXPECT_GT(stored, 0);
    EXPECT_GT(failedAtTheWrite, 0);
    EXPECT_LE(failedAtTheEnd, 5) << "the room for the last page is all that shows as late as that";
}

TEST_F(FullDisk, ShowsAtTheWriteInALongListToo)
{
    constexpr int kEntries = 5000;
    makeFile(kEntries);
    for (const rlim_t bytes : {rlim_t{0}, rlim_t{100'000}, rlim_t{200'000}, rlim_t{400'000}})
    {
        EXPECT_THAT(rewriteWithin(bytes, kEntries),
                    StartsWith("write failed, reads 1, undone, reads 1, said: The registry"))
            << bytes;
        EXPECT_EQ(generationInFile(), 1) << bytes;
    }
    EXPECT_EQ(rewriteWithin(RLIM_INFINITY, kEntries), "written, reads 2, stored, reads 2, said: ");
    EXPECT_EQ(generationInFile(), 2);
}

TEST_F(FullDisk, KeepsAListThatCouldNotBeEmptied)
{
    constexpr int kEntries = 5000;
    makeFile(kEntries);
    const std::string answer = askChild(
        [this]
        {
            Registry registry(file());
            const Registry::Key key = *registry.create(kListKey, Registry::kRoot);
            const auto values = registry.values(key);
            if (!limitFiles(20'000))
                return std::string("cannot start");
            for (const auto& value : values)
                if (!registry.removeValue(key, value.name))
                    break;
            const bool stored = static_cast<bool>(registry.endOfCommand());
            return (stored ? "stored " : "undone ") + std::to_string(generationOf(registry));
        });
    EXPECT_EQ(answer, "undone 1");
    EXPECT_EQ(generationInFile(), 1);
}

TEST_F(FullDisk, IsUsedAgainOnceThereIsRoom)
{
    makeFile(20);
    const std::string answer = askChild(
        [this]
        {
            CapturedOutput output;
            Registry registry(file());
            std::string steps = limitFiles(0) && rewriteList(registry, 2, 20) ? "written" : "failed";
            steps += registry.write(L"A", L"name", L"1") ? ", written" : ", failed";
            steps += registry.endOfCommand() ? ", stored" : ", undone";
            steps += limitFiles(RLIM_INFINITY) && rewriteList(registry, 3, 20) ? ", written" : ", failed";
            return steps + (registry.endOfCommand() ? ", stored" : ", undone");
        });
    EXPECT_EQ(answer, "failed, failed, undone, written, stored");
    EXPECT_EQ(generationInFile(), 3);
    EXPECT_EQ(Registry(file()).find(L"A"), Registry::kNoKey);
}

TEST_F(FullDisk, IsToldWhenANewRegistryCannotBeMade)
{
    for (const rlim_t bytes : {rlim_t{0}, rlim_t{4096}, rlim_t{20'000}})
    {
        const std::string answer = askChild(
            [=, this]
            {
                limitFiles(bytes);
                Registry registry(file());
                return (registry.write(L"A", L"name", L"1") ? "written: " : "not written: ") +
                       tessel::toUtf8(registry.canStore().sentence());
            });
        EXPECT_THAT(answer, AllOf(StartsWith("not written: The registry"), HasSubstr(file().string())))
            << bytes;
        Registry registry(file());
        EXPECT_EQ(registry.canStore().sentence(), L"") << "nothing of it is in the way later";
        std::filesystem::remove(file());
        std::filesystem::remove(file().string() + ".sound");
    }
}
