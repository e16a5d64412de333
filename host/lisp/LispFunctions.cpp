// The functions of the SDK that concern Lisp.
#include <tessel/tsed.h>

#include "host/lisp/LispInterpreter.h"
#include "host/text/Running.h"

using tessel::LispInterpreter;
using tessel::running;

int tsedInvoke(const TsResultBuffer* call, TsResultBuffer** result)
{
    TsResultBuffer* values = nullptr;
    auto* lisp = running<LispInterpreter>();
    const int status = lisp ? lisp->invoke(call, &values) : TS_ERROR;
    if (result)
        *result = values;
    else
        tsutRelRb(values); // the caller does not want to know
    return status;
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
