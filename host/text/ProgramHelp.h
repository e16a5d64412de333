// What the library that parses a program's arguments says of itself, in the person's language.
#pragma once

namespace CLI
{
class App;
}

namespace tessel
{
// The words in the help, and the sentences about wrong arguments. Once all options are declared.
void translateHelp(CLI::App& app);
} // namespace tessel
