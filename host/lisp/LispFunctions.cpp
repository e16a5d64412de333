// The functions of the SDK that concern Lisp.
#include <tessel/tsed.h>

#include "host/Services.h"
#include "host/lisp/LispInterpreter.h"

using tessel::services;

int tsedInvoke(const TsResultBuffer* call, TsResultBuffer** result)
{
    TsResultBuffer* values = nullptr;
    const int status = services().lisp ? services().lisp->invoke(call, &values) : TS_ERROR;
    if (result)
        *result = values;
    else
        tsutRelRb(values); // the caller does not want to know
    return status;
}

void qxr_queueexpr(const wchar_t* expression)
{
    if (services().lisp && expression)
        services().lisp->queue(expression);
}

bool RemovingTsLISP()
{
    return services().removingTsLisp;
}
