#include "host/lisp/LispMachine.h"

#include <utility>

#include <ecl/ecl.h>
#include <tessel/tsresbuf.h>

#include "host/lisp/LispInterrupter.h"
#include "host/lisp/LispPrimitives.h"
#include "host/lisp/LispSource.h"
#include "host/lisp/LispStart.h"
#include "host/lisp/LispValues.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr int kMostLockHolds = 8;

// A call of Lisp whose arguments are made under protection, too.
struct LispCall
{
    cl_object function = ECL_NIL;
    std::wstring_view text{};
    std::wstring_view name{};               // with COMPILE-TEXT
    const TsResultBuffer* values = nullptr; // with INVOKE
    const Interruption::Wish* wish = nullptr;
};

cl_object apply(const LispCall& call)
{
    if (call.values)
        return cl_funcall(3, call.function, toLisp(call.text), toLisp(call.values->next));
    if (!call.name.empty())
        return cl_funcall(3, call.function, toLisp(call.name), toLisp(call.text));
    return cl_funcall(2, call.function, toLisp(call.text));
}

// NIL when Lisp was left by a jump.
cl_object applyProtected(const LispCall& call)
{
    cl_object volatile value = ECL_NIL;
    const cl_env_ptr environment = ecl_process_env();
    ECL_CATCH_ALL_BEGIN(environment)
    {
        value = apply(call);
    }
    ECL_CATCH_ALL_IF_CAUGHT
    {
        value = ECL_NIL;
    }
    ECL_CATCH_ALL_END;
    return value;
}

// A new user package, and memory up to the limit. Whether it was made.
bool beginSession(const LispSurroundings& surroundings)
{
    volatile bool made = false;
    const cl_env_ptr environment = ecl_process_env();
    ECL_CATCH_ALL_BEGIN(environment)
    {
        cl_funcall(3, lispFunctions().beginSession, surroundings.removingTsLisp ? ECL_T : ECL_NIL,
                   ecl_make_fixnum(static_cast<cl_fixnum>(surroundings.heapBytes)));
        made = true;
    }
    ECL_CATCH_ALL_IF_CAUGHT
    {
    }
    ECL_CATCH_ALL_END;
    return made;
}

// When memory is exhausted while a symbol is made, ECL jumps away with this lock held, and nothing works any
// more.
void releaseForgottenLock()
{
    const cl_env_ptr environment = ecl_process_env();
    ECL_CATCH_ALL_BEGIN(environment)
    {
        // Whoever can have the lock now did not find it held.
        for (int holds = 0; holds < kMostLockHolds; ++holds)
        {
            const bool wasFree = mp_get_rwlock_write(2, cl_core.global_env_lock, ECL_NIL) != ECL_NIL;
            mp_giveup_rwlock_write(cl_core.global_env_lock);
            if (wasFree)
                break;
        }
    }
    ECL_CATCH_ALL_IF_CAUGHT
    {
    }
    ECL_CATCH_ALL_END;
}
// Whether Lisp can take in a new name, without which nothing can be typed.
bool canMakeSymbols()
{
    volatile bool made = false;
    const cl_env_ptr environment = ecl_process_env();
    ECL_CATCH_ALL_BEGIN(environment)
    {
        cl_funcall(1, lispFunctions().makeSymbol);
        made = true;
    }
    ECL_CATCH_ALL_IF_CAUGHT
    {
    }
    ECL_CATCH_ALL_END;
    releaseForgottenLock();
    return made;
}

// Every exhaustion gives Lisp some memory more, which it keeps only while the rest is in use. What the failed
// evaluation has left counts as that until it is collected; by itself the collector, which has just found
// next to nothing, would refuse memory for long before it looks again.
void takeBackReserve(std::size_t heapBytes)
{
    if (cl_core.max_heap_size <= heapBytes)
        return;
    GC_gcollect();
    if (GC_get_heap_size() - GC_get_free_bytes() + kHeapReserve < heapBytes)
        si_set_limit(ecl_make_symbol("HEAP-SIZE", "EXT"), ecl_make_fixnum(static_cast<cl_fixnum>(heapBytes)));
}
} // namespace

struct LispMachine::Session
{
    Session(LispSurroundings given, LispInterrupter& givenInterrupter)
        : surroundings(std::move(given)), interrupter(givenInterrupter)
    {
        connectLispPrimitives(&surroundings, &interrupter);
    }
    ~Session() { connectLispPrimitives(nullptr, nullptr); }
    Session(const Session&) = delete;
    Session& operator=(const Session&) = delete;

    // The prelude answers (:DONE . value) or (:FAILED . text).
    Result<cl_object> run(const LispCall& call)
    {
        const std::size_t memoryBefore = cl_core.max_heap_size;
        interrupter.begin();
        if (call.wish && call.wish->isThere())
            interrupter.interrupt();
        cl_object pair = applyProtected(call);
        const bool interrupted = interrupter.hasTakenRequest();
        interrupter.end();
        restoreLispStackLimits();
        flushLispOutput();
        if (!ECL_CONSP(pair))
            return Failure{recover(cl_core.max_heap_size > memoryBefore, interrupted), kLeftByJump};
        if (cl_car(pair) == ecl_make_keyword("DONE"))
            return cl_cdr(pair);
        releaseForgottenLock();
        takeBackReserve(surroundings.heapBytes);
        return Failure{fromLisp(cl_cdr(pair))};
    }

    // After a jump out of everything; answers what is to be told.
    std::wstring recover(bool memoryWasExhausted, bool interrupted)
    {
        releaseForgottenLock();
        if (canMakeSymbols())
        {
            takeBackReserve(surroundings.heapBytes);
            if (memoryWasExhausted)
                return translated(L"the memory for Lisp is exhausted.");
            // A second interrupt can meet the jump that the first one began; what it carried is lost then.
            return interrupted ? translated(L"Lisp was interrupted.")
                               : translated(L"Lisp has given up what it was doing.");
        }
        // The user's symbols fill the memory.
        if (!beginSession(surroundings))
            return translated(L"the memory for Lisp is exhausted; only a new start of the host frees it.");
        return translated(L"the memory for Lisp is exhausted; everything that was defined is forgotten.");
    }

    Result<std::wstring> runForText(const LispCall& call)
    {
        const auto value = run(call);
        return value ? Result<std::wstring>(fromLisp(*value)) : value.failure();
    }

    LispSurroundings surroundings;
    LispInterrupter& interrupter;
};

LispMachine::LispMachine(std::unique_ptr<Session> session) : mSession(std::move(session))
{
}

Result<std::unique_ptr<LispMachine>> LispMachine::start(LispSurroundings surroundings)
{
    if (const Outcome& started = startLisp(); !started)
        return started.failure();
    const auto interrupter = lispInterrupter();
    if (!interrupter)
        return Failure{translated(L"Lisp did not start: {}.", interrupter.sentence())};
    auto session = std::make_unique<Session>(std::move(surroundings), **interrupter);
    if (!beginSession(session->surroundings))
        return Failure{translated(L"Lisp cannot begin a new session.")};
    return std::unique_ptr<LispMachine>(new LispMachine(std::move(session)));
}

LispMachine::~LispMachine() = default;

Result<std::wstring> LispMachine::evaluate(std::wstring_view forms, const Interruption::Wish* wish)
{
    if (findTooDeepForm(forms))
        return Failure{translated(L"The expression is nested more than {} levels deep.", kDeepestNesting)};
    return mSession->runForText({.function = lispFunctions().evaluate, .text = forms, .wish = wish});
}

Result<std::wstring> LispMachine::symbolsBeginning(std::wstring_view beginning)
{
    return mSession->runForText({.function = lispFunctions().symbolsBeginning, .text = beginning});
}

Result<std::wstring> LispMachine::compile(const std::wstring& name, std::wstring_view text)
{
    return mSession->runForText({.function = lispFunctions().compileText, .text = text, .name = name});
}

Result<TsResultBuffer*> LispMachine::call(const TsResultBuffer* call)
{
    if (!call || call->type != TS_STRING || !call->value.string)
        return Failure{translated(L"A Lisp function is called by its name, as the first value of the list.")};
    const auto value =
        mSession->run({.function = lispFunctions().invoke, .text = call->value.string, .values = call});
    return value ? Result<TsResultBuffer*>(resultFromLisp(*value)) : value.failure();
}

void LispMachine::interrupt() noexcept
{
    mSession->interrupter.interrupt();
}

void LispMachine::interruptUntilItEnds() noexcept
{
    mSession->interrupter.interruptUntilItEnds();
}

bool LispMachine::running() const noexcept
{
    return mSession->interrupter.running();
}

unsigned LispMachine::evaluations() const noexcept
{
    return mSession->interrupter.evaluations();
}
} // namespace tessel
