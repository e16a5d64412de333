// The SDK's registry of named services.
#include <string_view>

#include <tessel/tsrx.h>

#include "host/applications/DynamicLinker.h"
#include "host/applications/KeptOutService.h"
#include "host/commands/CommandStack.h"
#include "host/text/Running.h"

namespace tessel
{
namespace
{
class SystemRegistry : public TsRxSysRegistry
{
public:
    TsRxObject* at(const wchar_t* name) const override
    {
        const std::wstring_view wanted = name ? name : L"";
        if (wanted == TSRX_DYNAMIC_LINKER)
            return running<DynamicLinker>();
        if (wanted == TSED_REGISTERED_COMMANDS)
            return running<CommandStack>();
        if (wanted == TSRX_KEPT_OUT)
            return running<KeptOutService>();
        return nullptr;
    }
};
} // namespace
} // namespace tessel

TsRxSysRegistry* tsrxSysRegistry()
{
    static tessel::SystemRegistry registry;
    return &registry;
}
