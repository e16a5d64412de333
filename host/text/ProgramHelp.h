// The words in a program's help that come from the library which parses its arguments.
#pragma once

namespace CLI
{
class App;
}

namespace tessel
{
// Once all options are declared. What the library says of wrong arguments stays as it is.
void translateHelp(CLI::App& app);
} // namespace tessel
