// A compiled application with the behaviour that the build names.
#include "tests/contract/modules/Behaviours.h"

extern "C" TESSEL_EXPORT int tsrxEntryPoint(unsigned message, void* application)
{
    return contract_modules::CONTRACT_MODULE(message, application);
}
