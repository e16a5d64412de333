#include "host/applications/ExceptionGuard.h"

#include <exception>

#include "host/platform/ObjectiveCGuard.h"
#include "host/text/Unicode.h"

namespace tessel
{
Result<> catchAnything(const std::function<void()>& call)
{
    constexpr wchar_t kException[] = L"an exception: ";
    try
    {
        const auto returned = catchObjectiveC(call);
        return returned ? returned : Failure{kException + returned.sentence()};
    }
    catch (const std::exception& error)
    {
        return Failure{kException + toWide(error.what())};
    }
    catch (...)
    {
        return Failure{L"something that is not an error of the standard library"};
    }
}
} // namespace tessel
