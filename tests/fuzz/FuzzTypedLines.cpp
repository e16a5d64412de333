// Lines as they are typed: commands with their arguments, and Lisp forms over several lines.
#include <cstdint>
#include <cstdlib>
#include <string>

#include "host/commands/CallingApplication.h"
#include "host/commands/CommandRunner.h"
#include "host/commands/CommandStack.h"
#include "host/commands/TypedLine.h"
#include "host/console/InputAssembler.h"
#include "host/text/CommandLine.h"
#include "host/text/LispScanner.h"
#include "host/text/Unicode.h"

namespace
{
void require(bool condition)
{
    if (!condition)
        std::abort();
}

// A line that is made of a line's parts has the same parts.
void checkParts(const std::wstring& line)
{
    const auto parts = tessel::splitLine(line);
    std::wstring again;
    for (const std::wstring& part : parts)
        again += tessel::asPart(part) + L" ";
    require(tessel::splitLine(again) == parts);
}

void checkForms(const std::wstring& forms)
{
    tessel::LispScanner scanner;
    scanner.take(forms);
    require(!scanner.isOpen());
}

void runCommand(const std::wstring& line)
{
    static std::string said;
    static tessel::CommandLine commandLine([](std::string_view text) { said += text; });
    static tessel::CallingApplication calls;
    static tessel::CommandStack stack(calls);
    static tessel::CommandRunner runner(stack, commandLine, calls);
    const bool isBlank = tessel::splitLine(line).empty();
    said.clear();
    require(runner.run(line) == isBlank); // there are no commands
    require(said.empty() == isBlank && (isBlank || said.ends_with(" Type HELP for the list of commands.\n")));
}

void check(const std::wstring& input)
{
    if (tessel::isLisp(input))
        return checkForms(input);
    checkParts(input);
    runCommand(input);
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::wstring text = tessel::toWide(std::string(data, data + size));
    tessel::InputAssembler input;
    for (std::size_t begin = 0; begin <= text.size();)
    {
        const std::size_t end = std::min(text.find(L'\n', begin), text.size());
        if (const auto whole = input.add(std::wstring_view(text).substr(begin, end - begin)))
            check(*whole);
        begin = end + 1;
    }
    require(!input.isOpen() || text.find(L'(') != text.npos);
    input.discard();
    require(!input.isOpen());
    return 0;
}
