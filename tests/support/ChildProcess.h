// A process of its own for what would trouble the test's: limits, another user, a violent end.
#pragma once

#include <functional>
#include <string>

#include <sys/types.h>

// A child that runs the function. It is killed, if it still runs, and waited for at the end of the scope.
class ChildProcess
{
public:
    // `work` is given a file descriptor whose other end `readLine` reads.
    explicit ChildProcess(const std::function<void(int)>& work);
    ~ChildProcess();
    ChildProcess(const ChildProcess&) = delete;
    ChildProcess& operator=(const ChildProcess&) = delete;

    // The next line that the child wrote, without its end; empty when it has ended.
    std::string readLine() const;
    void kill();

private:
    pid_t mProcess = 0;
    int mOutput = -1;
};

// Runs the function in a child and answers its answer, which must be one line.
std::string askChild(const std::function<std::string()>& question);
