// The program's standard output, or where its errors go, and whether all of it has arrived.
#pragma once

#include <string_view>

#include "host/text/Result.h"

namespace tessel
{
class StandardOutput
{
public:
    explicit StandardOutput(int descriptor) : mDescriptor(descriptor) {}

    // Waits until the text is written, whatever signals come meanwhile. After a failure the next text is
    // tried again: a full disk may have room again.
    void write(std::string_view text);

    // Whether all of it has arrived; what the system says about the first failure.
    const Result<>& written() const { return mWritten; }

private:
    int mDescriptor;
    Result<> mWritten;
};
} // namespace tessel
