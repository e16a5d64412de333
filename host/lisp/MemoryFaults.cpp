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
// Ours in two forms: a full stack has no room for a handler, which then needs another stack; and what ECL
// does about its own fault may be to run Lisp, which does not work anywhere but on the stack that it knows.
struct sigaction onOtherStack;
struct sigaction onLispStack;

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

bool isLisps(const siginfo_t& information)
{
    return information.si_code > 0 && isWithinEnvironment(information.si_addr);
}

// The instruction runs again and faults again; what somebody has sent does not come by itself.
void leaveTo(const struct sigaction& next, int signal, const siginfo_t& information)
{
    sigaction(signal, &next, nullptr);
    if (information.si_code <= 0)
        raise(signal);
}

void handleOnLispStack(int signal, siginfo_t* information, void* context)
{
    if (!isLisps(*information))
        return leaveTo(others, signal, *information);
    sigaction(signal, &onOtherStack, nullptr); // before: ECL may not come back
    ecl.sa_sigaction(signal, information, context);
}

void handleOnOtherStack(int signal, siginfo_t* information, void*)
{
    leaveTo(isLisps(*information) ? onLispStack : others, signal, *information);
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
    onLispStack = ecl;
    onLispStack.sa_sigaction = handleOnLispStack;
    onLispStack.sa_flags |= SA_SIGINFO;
    onLispStack.sa_flags &= ~SA_ONSTACK;
    onOtherStack = onLispStack;
    onOtherStack.sa_sigaction = handleOnOtherStack;
    onOtherStack.sa_flags |= SA_ONSTACK;
    sigaction(SIGSEGV, &onOtherStack, nullptr);
}
} // namespace tessel
