#include "host/lisp/MemoryFaults.h"

#include <functional>

#include <ecl/ecl.h>

namespace tessel
{
namespace
{
// A signal handler can be given nothing. Written once, before the handler is in place.
struct sigaction ecl;
struct sigaction others;

bool isWithinEnvironment(const void* address)
{
    const void* environment = ecl_process_env_unsafe();
    if (!environment)
        return false; // not a thread of Lisp
    const auto* begin = static_cast<const char*>(environment);
    const std::less<> before;
    return !before(address, static_cast<const void*>(begin)) &&
           before(address, static_cast<const void*>(begin + sizeof(cl_env_struct)));
}

void handleFault(int signal, siginfo_t* information, void* context)
{
    if (isWithinEnvironment(information->si_addr))
        ecl.sa_sigaction(signal, information, context);
    else
        // The instruction runs again and faults again, now without us.
        sigaction(signal, &others, nullptr);
}
} // namespace

struct sigaction currentFaultAction()
{
    struct sigaction action;
    sigaction(SIGSEGV, nullptr, &action);
    return action;
}

void shareMemoryFaults(const struct sigaction& previous)
{
    others = previous;
    sigaction(SIGSEGV, nullptr, &ecl);
    struct sigaction shared = ecl;
    shared.sa_sigaction = handleFault;
    shared.sa_flags |= SA_SIGINFO;
    sigaction(SIGSEGV, &shared, nullptr);
}
} // namespace tessel
