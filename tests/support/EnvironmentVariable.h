// The environment of a test.
#pragma once

#include <cstdlib>
#include <optional>
#include <string>

// A variable of the environment, as long as this lasts.
class EnvironmentVariable
{
public:
    EnvironmentVariable(const char* name, const std::string& value) : mName(name)
    {
        if (const char* before = std::getenv(name))
            mBefore = before;
        setenv(name, value.c_str(), 1);
    }
    ~EnvironmentVariable()
    {
        if (mBefore)
            setenv(mName, mBefore->c_str(), 1);
        else
            unsetenv(mName);
    }
    EnvironmentVariable(const EnvironmentVariable&) = delete;
    EnvironmentVariable& operator=(const EnvironmentVariable&) = delete;

private:
    const char* mName;
    std::optional<std::string> mBefore;
};
