#include "tests/e2e_dialogs/Program.h"

#include <csignal>
#include <fstream>
#include <iterator>
#include <stdexcept>

#include <fcntl.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

#include "tests/e2e_dialogs/Waiting.h"
#include "tests/support/ProgramArguments.h"

Program::Program(std::vector<std::string> arguments, std::vector<std::string> environment,
                 std::filesystem::path output)
    : mOutput(std::move(output))
{
    int input[2];
    if (pipe2(input, O_CLOEXEC) != 0)
        throw std::runtime_error("cannot make a pipe");
    const int printed = open(mOutput.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0644);
    const auto argumentPointers = pointersTo(arguments);
    const auto environmentPointers = pointersTo(environment);
    mProcess = fork();
    if (mProcess == 0)
    {
        prctl(PR_SET_PDEATHSIG, SIGKILL); // a test that is killed leaves no program behind
        dup2(input[0], STDIN_FILENO);
        dup2(printed, STDOUT_FILENO);
        dup2(printed, STDERR_FILENO);
        execvpe(argumentPointers.front(), argumentPointers.data(), environmentPointers.data());
        _exit(127);
    }
    close(input[0]);
    close(printed);
    mInput = input[1];
}

Program::~Program()
{
    closeInput();
    if (mProcess <= 0)
        return;
    kill(mProcess, SIGKILL);
    waitpid(mProcess, nullptr, 0);
}

void Program::type(const std::string& line) const
{
    const std::string text = line + "\n";
    if (write(mInput, text.data(), text.size()) != static_cast<ssize_t>(text.size()))
        throw std::runtime_error("the program does not read: " + line);
}

std::string Program::output() const
{
    std::ifstream file(mOutput);
    return {std::istreambuf_iterator<char>(file), {}};
}

void Program::closeInput()
{
    if (mInput >= 0)
        close(mInput);
    mInput = -1;
}

void Program::signal(int number) const
{
    kill(mProcess, number);
}

std::optional<int> Program::waitForEnd()
{
    int status = 0;
    if (!comesTrue([&] { return waitpid(mProcess, &status, WNOHANG) == mProcess; }))
        return std::nullopt;
    mProcess = -1;
    return WIFEXITED(status) ? WEXITSTATUS(status) : -WTERMSIG(status);
}

bool Program::endsByItself()
{
    closeInput();
    return waitForEnd().has_value();
}
