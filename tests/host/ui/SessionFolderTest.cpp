#include "host/ui/platform/gnustep/SessionFolder.h"

#include <gtest/gtest.h>

#include <csignal>
#include <memory>

#include <sys/wait.h>
#include <unistd.h>

#include "tests/support/TemporaryFolder.h"

namespace fs = std::filesystem;
using tessel::windowing::SessionFolder;

namespace
{
class SessionFolders : public testing::Test
{
protected:
    // What a session that was killed leaves.
    fs::path leave(const std::string& name) const
    {
        mFolder.write(fs::path(name) / "in it", "");
        return mFolder / name;
    }

    TemporaryFolder mFolder;
};
} // namespace

TEST_F(SessionFolders, AreForTheirUserOnly)
{
    const SessionFolder session(mFolder.path());
    ASSERT_TRUE(fs::is_directory(session.path()));
    EXPECT_EQ(session.path().parent_path(), mFolder.path());
    EXPECT_EQ(fs::status(session.path()).permissions(), fs::perms::owner_all);
}

TEST_F(SessionFolders, GoWithAllThatIsInThem)
{
    auto session = std::make_unique<SessionFolder>(mFolder.path());
    const fs::path path = session->path();
    fs::create_directory(path / "more");
    session.reset();
    EXPECT_FALSE(fs::exists(path));
}

TEST_F(SessionFolders, StayWhileTheirSessionsLive)
{
    const SessionFolder first(mFolder.path());
    const SessionFolder second(mFolder.path());
    EXPECT_NE(first.path(), second.path());
    EXPECT_TRUE(fs::exists(first.path()));
    EXPECT_TRUE(fs::exists(second.path()));
}

TEST_F(SessionFolders, OfAKilledSessionAreRemovedByTheNext)
{
    const pid_t killed = fork();
    if (killed == 0)
    {
        const SessionFolder session(mFolder.path());
        fs::create_symlink(session.path(), mFolder / "of the killed");
        raise(SIGKILL);
    }
    waitpid(killed, nullptr, 0);
    const fs::path path = fs::read_symlink(mFolder / "of the killed");
    ASSERT_TRUE(fs::exists(path));
    const SessionFolder next(mFolder.path());
    EXPECT_FALSE(fs::exists(path));
}

TEST_F(SessionFolders, AreToldFromOtherThings)
{
    const fs::path left = leave("tessel-left");
    const fs::path other = leave("other");
    fs::create_directory_symlink(other, mFolder / "tessel-link");
    mFolder.write("tessel-file", "");
    const SessionFolder session(mFolder.path());
    EXPECT_FALSE(fs::exists(left));
    EXPECT_TRUE(fs::exists(other / "in it"));
    EXPECT_TRUE(fs::exists(mFolder / "tessel-link"));
    EXPECT_TRUE(fs::exists(mFolder / "tessel-file"));
}

TEST_F(SessionFolders, AreNoneWhereNoneCanBeMade)
{
    const SessionFolder session(mFolder / "missing");
    EXPECT_TRUE(session.path().empty());
}
