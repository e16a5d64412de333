// Standard input as a stream for lines that nobody edits: from a pipe or a file.
//
// The library's own stream waits for input and for nothing else.
#pragma once

#include <array>
#include <streambuf>

#include "host/console/InputSource.h"

namespace tessel
{
// Ends where the input ends, or when the session is to end. The interrupt key stops what runs, not the input.
class PipedInput : public std::streambuf
{
public:
    explicit PipedInput(InputSource source) : mSource(source) {}

protected:
    int_type underflow() override;

private:
    InputSource mSource;
    std::array<char, 4096> mBytes;
};
} // namespace tessel
