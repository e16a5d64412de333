#include "host/applications/ExceptionGuard.h"

#include <exception>

#include "host/platform/ObjectiveCGuard.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
Result<> catchAnything(const std::function<void()>& call)
{
    try
    {
        const auto returned = catchObjectiveC(call);
        return returned ? returned : Failure{translated(L"an exception: {}", returned.sentence())};
    }
    catch (const std::exception& error)
    {
        return Failure{translated(L"an exception: {}", toWide(error.what()))};
    }
    catch (...)
    {
        return Failure{translated(L"something that is not an error of the standard library")};
    }
}
} // namespace tessel
