#include "host/lisp/LispStart.h"

#include <algorithm>
#include <memory>
#include <string_view>

#include <sys/resource.h>

#include "host/lisp/LispInterrupter.h"
#include "host/lisp/LispMachine.h"
#include "host/lisp/LispPrimitives.h"
#include "host/lisp/LispValues.h"
#include "host/lisp/MemoryFaults.h"
#include "host/lisp/Prelude.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
// With ECL's own 2048 a deep recursion through UNWIND-PROTECT answers wrongly instead of failing.
constexpr cl_fixnum kFrameStackSize = 65536;
// ECL counts on the stack that the process began with. What it does not watch, such as EQUAL on deep lists,
// may use more: as much as the system keeps free below the main thread's stack.
constexpr rlim_t kStackBytes = rlim_t{112} << 20;
// What an error may use when the stack has run out. ECL's own 32 KB are not always enough for its handlers.
constexpr cl_fixnum kStackReserve = cl_fixnum{512} << 10;

void setSignalOptions()
{
    // Signals are the program's. ECL keeps the one that interrupts a thread of Lisp, and the memory fault
    // that goes with it.
    for (const int option : {ECL_OPT_TRAP_SIGFPE, ECL_OPT_TRAP_SIGINT, ECL_OPT_TRAP_SIGILL,
                             ECL_OPT_TRAP_SIGBUS, ECL_OPT_TRAP_SIGPIPE, ECL_OPT_SIGNAL_HANDLING_THREAD})
        ecl_set_option(option, 0);
    ecl_set_option(ECL_OPT_TRAP_SIGSEGV, 1);
    ecl_set_option(ECL_OPT_TRAP_INTERRUPT_SIGNAL, 1);
}

void raiseStackLimit()
{
    rlimit limit{};
    if (getrlimit(RLIMIT_STACK, &limit) != 0 || limit.rlim_cur >= kStackBytes)
        return;
    limit.rlim_cur = std::min(kStackBytes, limit.rlim_max);
    // Without the slack Lisp works just as well, short of such lists.
    static_cast<void>(setrlimit(RLIMIT_STACK, &limit));
}

cl_object functionNamed(const char* name)
{
    return cl_symbol_function(_ecl_intern(name, ecl_find_package("TESSEL-HOST")));
}

// Reads and evaluates the prelude; NIL, or the text of its error.
cl_object evaluatePrelude(cl_object text)
{
    cl_object evaluateAll =
        cl_eval(ecl_read_from_cstring("(lambda (text)"
                                      " (handler-case (with-input-from-string (forms text)"
                                      "                (let ((*package* *package*))"
                                      "                 (loop (let ((form (read forms nil forms)))"
                                      "                        (when (eq form forms) (return nil))"
                                      "                        (eval form)))))"
                                      "  (serious-condition (condition) (princ-to-string condition))))"));
    return cl_funcall(2, evaluateAll, text);
}

// What ECL runs must not jump over C++ objects: the functions that are called under its protection have none.
cl_object startPrelude(std::wstring_view prelude)
{
    cl_object volatile fault = ecl_make_keyword("UNFINISHED");
    const cl_env_ptr environment = ecl_process_env();
    ECL_CATCH_ALL_BEGIN(environment)
    {
        cl_eval(ecl_read_from_cstring("(make-package \"TESSEL-HOST\" :use '(\"COMMON-LISP\"))"));
        defineLispPrimitives();
        fault = evaluatePrelude(toLisp(prelude));
    }
    ECL_CATCH_ALL_IF_CAUGHT
    {
    }
    ECL_CATCH_ALL_END;
    return fault;
}

Result<LispFunctions> boot()
{
    setSignalOptions();
    const cl_fixnum usualFrameStackSize = ecl_get_option(ECL_OPT_FRAME_STACK_SIZE);
    ecl_set_option(ECL_OPT_FRAME_STACK_SIZE, kFrameStackSize);
    ecl_set_option(ECL_OPT_C_STACK_SAFETY_AREA, kStackReserve);
    ecl_set_option(ECL_OPT_HEAP_SIZE, kLispHeapBytes);
    ecl_set_option(ECL_OPT_HEAP_SAFETY_AREA, kHeapReserve);
    const auto faultAction = currentFaultAction();
    static char name[] = "tessel";
    static char* arguments[] = {name, nullptr};
    cl_boot(1, arguments);
    // Other threads do with less: the large one takes a good part of Lisp's memory.
    ecl_set_option(ECL_OPT_FRAME_STACK_SIZE, usualFrameStackSize);
    shareMemoryFaults(faultAction);
    // ECL would write some of its troubles to the terminal, past the host.
    cl_core.error_output = cl_make_broadcast_stream(0);
    raiseStackLimit();
    cl_object fault = startPrelude(toWide(lispPrelude()));
    if (fault != ECL_NIL)
        return Failure{translated(L"Lisp did not start: {}", fromLisp(fault))};
    return LispFunctions{functionNamed("BEGIN-SESSION"),   functionNamed("EVALUATE"),
                         functionNamed("INVOKE"),          functionNamed("SYMBOLS-BEGINNING"),
                         functionNamed("COMPILE-TEXT"),    functionNamed("INTERRUPTED"),
                         functionNamed("MAKE-USER-SYMBOL")};
}

// The garbage collector knows the thread and the function by other ways.
LispInterrupter::Ways waysToInterrupt()
{
    cl_object const thread = ecl_process_env()->own_process;
    cl_object const interrupted = lispFunctions().interrupted;
    return {.begin = [] { ecl_import_current_thread(ECL_NIL, ECL_NIL); },
            .send = [=] { mp_interrupt_process(thread, interrupted); },
            .end =
                []
            {
                ecl_release_current_thread();
            }};
}
} // namespace

const Result<LispFunctions>& startLisp()
{
    static const Result<LispFunctions> started = boot();
    return started;
}

const LispFunctions& lispFunctions()
{
    return *startLisp();
}

Result<LispInterrupter*> lispInterrupter()
{
    static std::unique_ptr<LispInterrupter> interrupter;
    if (interrupter)
        return interrupter.get();
    auto started = LispInterrupter::start(waysToInterrupt());
    if (!started)
        return started.failure();
    interrupter = *std::move(started);
    return interrupter.get();
}
} // namespace tessel
