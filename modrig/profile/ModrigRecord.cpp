#include "modrig/profile/ModrigRecord.h"

#include <tessel/tsappinfo.h>

namespace ModrigUtils
{
bool SetLoadedAtStart(TesselAppInfo& record, bool loadedAtStart)
{
    const unsigned reasons = record.loadReason();
    const unsigned wanted =
        loadedAtStart ? reasons | TSRX_LOAD_AT_HOST_START : reasons & ~TSRX_LOAD_AT_HOST_START;
    record.setLoadReason(wanted);
    return wanted != reasons;
}
} // namespace ModrigUtils
