// One command of the command stack. The SDK knows it by name only.
#pragma once

#include <functional>
#include <string>
#include <vector>

#include <tessel/tsedcommands.h>

#include "host/text/Result.h"

class TsEdCommand
{
public:
    std::wstring group;
    std::wstring globalName;
    std::wstring localName;
    std::wstring owner; // the path of the application that registered it; empty for the host's own
    TsEdCommandHandler handler = nullptr;
    TsEdEntries entries = nullptr; // what the Tab key offers for them
    std::wstring summary;          // one line, or empty
    std::wstring usage;            // as in `CommandText`
    std::wstring example;          // the whole line, or empty

    // The host's own commands have this instead of a handler.
    using BuiltIn = std::function<tessel::Result<>(const std::vector<std::wstring>& arguments)>;
    BuiltIn builtIn;
    BuiltIn listing; // what answers programs, if anything does
};
