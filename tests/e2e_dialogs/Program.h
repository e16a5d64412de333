// A program that runs beside a test, which may type into it and reads what it prints.
#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <vector>

#include <sys/types.h>

class Program
{
public:
    // Starts it: the first argument is looked for in the PATH. What it prints goes to the file.
    Program(std::vector<std::string> arguments, std::vector<std::string> environment,
            std::filesystem::path output);
    // Ends it, if it still runs.
    ~Program();
    Program(const Program&) = delete;
    Program& operator=(const Program&) = delete;

    // Gives it a line to read.
    void type(const std::string& line) const;

    pid_t process() const { return mProcess; }

    // What it has printed up to now.
    std::string output() const;

    // Sends it a signal.
    void signal(int number) const;

    // Waits until it ends, with its input still open; its exit status (of a program that a signal ended:
    // minus the signal's number), or nothing when it has not ended after the time limit.
    std::optional<int> waitForEnd();

    // Lets it read the end of its input and waits until it ends; false when it has not after the time limit.
    bool endsByItself();

private:
    void closeInput();

    std::filesystem::path mOutput;
    pid_t mProcess = -1;
    int mInput = -1;
};
