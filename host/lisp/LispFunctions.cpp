// The functions of the SDK that concern Lisp.
#include <tessel/tsed.h>

#include "host/lisp/LispInterpreter.h"
#include "host/text/CommandLine.h"
#include "host/text/Result.h"
#include "host/text/Running.h"

using tessel::CommandLine;
using tessel::LispInterpreter;
using tessel::running;

namespace
{
tessel::Result<TsResultBuffer*> invoke(const TsResultBuffer* call)
{
    auto* lisp = running<LispInterpreter>();
    if (!lisp)
        return tessel::Failure{};
    auto values = lisp->invoke(call);
    if (auto* commandLine = running<CommandLine>())
        commandLine->tell(values);
    return values;
}
} // namespace

int tsedInvoke(const TsResultBuffer* call, TsResultBuffer** result)
{
    const auto invoked = invoke(call);
    TsResultBuffer* values = invoked ? *invoked : nullptr;
    if (result)
        *result = values;
    else
        tsutRelRb(values); // the caller does not want to know
    return invoked ? TS_NORMAL : TS_ERROR;
}

void qxr_queueexpr(const wchar_t* expression)
{
    auto* lisp = running<LispInterpreter>();
    if (lisp && expression)
        lisp->queue(expression);
}

bool RemovingTsLISP()
{
    const auto* lisp = running<LispInterpreter>();
    return !lisp || lisp->removingTsLisp();
}
