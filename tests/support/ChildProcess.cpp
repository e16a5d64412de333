#include "tests/support/ChildProcess.h"

#include <csignal>
#include <stdexcept>

#include <sys/wait.h>
#include <unistd.h>

ChildProcess::ChildProcess(const std::function<void(int)>& work)
{
    int ends[2];
    if (pipe(ends) != 0)
        throw std::runtime_error("no pipe");
    mProcess = fork();
    if (mProcess < 0)
        throw std::runtime_error("no child process");
    if (mProcess == 0)
    {
        close(ends[0]);
        work(ends[1]);
        _exit(0); // the parent's objects are not the child's to destroy
    }
    close(ends[1]);
    mOutput = ends[0];
}

ChildProcess::~ChildProcess()
{
    kill();
    close(mOutput);
}

std::string ChildProcess::readLine() const
{
    std::string line;
    char character = 0;
    while (read(mOutput, &character, 1) == 1 && character != '\n')
        line += character;
    return line;
}

void ChildProcess::kill()
{
    if (mProcess <= 0)
        return;
    ::kill(mProcess, SIGKILL);
    waitpid(mProcess, nullptr, 0);
    mProcess = 0;
}

std::string askChild(const std::function<std::string()>& question)
{
    const ChildProcess child(
        [&question](int output)
        {
            const std::string answer = question() + "\n";
            if (write(output, answer.data(), answer.size()) < 0)
                _exit(1);
        });
    return child.readLine();
}
