// The program's standard output, and whether all of it has arrived.
#pragma once

#include <string_view>

namespace tessel
{
class StandardOutput
{
public:
    // Waits until the text is written, whatever signals come meanwhile. After a failure the next text is
    // tried again: a full disk may have room again.
    void write(std::string_view text);

    bool isWhole() const { return mError == 0; }

    // What the system says about the first failure.
    const char* whyNot() const;

private:
    int mError = 0;
};
} // namespace tessel
