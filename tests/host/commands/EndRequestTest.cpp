#include "host/commands/EndRequest.h"

#include <thread>

#include <poll.h>
#include <sys/ioctl.h>

#include <gtest/gtest.h>

using tessel::EndRequest;

TEST(EndRequest, OfSeveralThreadsAtOnceIsOne)
{
    for (int round = 0; round < 200; ++round)
    {
        EndRequest request;
        std::thread one([&] { request.make(); });
        std::thread other([&] { request.make(); });
        pollfd waiting = {request.descriptor(), POLLIN, 0};
        EXPECT_EQ(poll(&waiting, 1, -1), 1);
        one.join();
        other.join();
        EXPECT_TRUE(request.isMade());
        int bytes = 0;
        EXPECT_EQ(ioctl(request.descriptor(), FIONREAD, &bytes), 0);
        EXPECT_EQ(bytes, 1);
    }
}
