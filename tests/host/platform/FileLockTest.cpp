#include "host/platform/SmallFile.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <unistd.h>

#include "tests/support/ChildProcess.h"
#include "tests/support/TemporaryFolder.h"

using tessel::FileLock;

TEST(FileLock, IsNotWaitedForForEver)
{
    const TemporaryFolder folder;
    const auto file = folder.path() / "lock";
    ChildProcess holder(
        [&](int output)
        {
            const FileLock lock(file);
            if (lock.held() && write(output, "held\n", 5) == 5)
                pause();
        });
    ASSERT_EQ(holder.readLine(), "held");
    const FileLock refused(file, std::chrono::milliseconds(50));
    ASSERT_FALSE(refused.held());
    EXPECT_EQ(refused.held().sentence(),
              L"the file " + file.wstring() + L" cannot be locked: another program holds it");
    holder.kill();
}

TEST(FileLock, IsHadWhenTheOtherProgramIsDone)
{
    const TemporaryFolder folder;
    const auto file = folder.path() / "lock";
    ChildProcess holder(
        [&](int output)
        {
            const FileLock lock(file);
            if (lock.held() && write(output, "held\n", 5) == 5)
                usleep(200'000);
        });
    ASSERT_EQ(holder.readLine(), "held");
    EXPECT_TRUE(FileLock(file, std::chrono::minutes(1)).held());
}

TEST(FileLock, SaysWhyItsFileCannotBeOpened)
{
    const TemporaryFolder folder;
    EXPECT_EQ(FileLock(folder.path()).held().sentence(),
              L"the file " + folder.path().wstring() + L" cannot be opened: Is a directory");
}
