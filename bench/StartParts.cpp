// What the host cannot start without, one part after the other and nothing else: the registry, Lisp, and the
// Modrig bundle mapped by the platform. Linked with the host's objects, since its library hides its parts.
#include <cstdio>
#include <filesystem>

#include "host/applications/Document.h"
#include "host/applications/ModuleLibrary.h"
#include "host/commands/EndRequest.h"
#include "host/lisp/LispInterpreter.h"
#include "host/registry/Profiles.h"
#include "host/registry/Registry.h"
#include "host/text/CommandLine.h"
#include "host/text/Version.h"

int main(int argc, char** argv)
{
    if (argc != 3)
    {
        std::fputs("usage: bench_start_parts PROFILE-FOLDER BUNDLE\n", stderr);
        return 2;
    }
    std::filesystem::create_directories(argv[1]);
    tessel::CommandLine commandLine([](std::string_view) {});
    tessel::Registry registry(std::filesystem::path(argv[1]) / "registry.db");
    const tessel::Profiles profiles(registry, tessel::kProductRegistryRoot);
    if (!registry.endOfCommand())
        return 1;
    tessel::Document document;
    const tessel::EndRequest endRequest;
    const auto lisp = tessel::LispInterpreter::start({}, commandLine, document, endRequest);
    const auto file = tessel::moduleFileAt(argv[2]);
    if (!lisp || !file)
        return 1;
    const auto bundle = tessel::ModuleLibrary::open(*file, true);
    return bundle && (*bundle)->entryPoint() ? 0 : 1;
}
