// A sample extension module (.bundle): several commands, texts in a resource module of its own, and a lock
// that keeps it from being unloaded.
#include <tessel/tsed.h>
#include <tessel/tsedcommands.h>
#include <tessel/tsformat.h>
#include <tessel/tsrxlinker.h>
#include <wincompat/winres.h>

#include <cmath>
#include <ctime>

#include "MoonPhase.h"
#include "MoonTexts.h"

namespace
{
constexpr const wchar_t* kGroup = L"MOON";
constexpr int kTextSize = 256;

void* theApplication = nullptr; // what the host knows this module by, from load to unload
HMODULE theTexts = nullptr;

struct Text
{
    explicit Text(unsigned id) { loadStringFromWin32ResourceDLL(theTexts, id, characters, kTextSize); }
    wchar_t characters[kTextSize];
};

void printLine(unsigned id)
{
    tsutPrintf(L"%s\n", Text(id).characters);
}

void showMoon()
{
    const double phase = moon::phaseAt(std::time(nullptr));
    const Text name(moon::kFirstPhaseName + moon::phaseIndex(phase));
    tsutPrintf(L"%s\n", moon::picture(phase).c_str());
    tsutPrintf(Text(moon::kTonight).characters, name.characters, std::lround(moon::litPart(phase) * 100),
               std::lround(phase * moon::kDaysOfMonth));
    tsutPrintf(L"\n");
}

void setLocked(bool locked)
{
    TsRxDynamicLinker* linker = TsRxDynamicLinker::cast(tsrxSysRegistry()->at(TSRX_DYNAMIC_LINKER));
    if (linker && linker->setApplicationLocked(theApplication, locked))
        printLine(locked ? moon::kLocked : moon::kUnlocked);
}

void lockMoon()
{
    setLocked(true);
}

void unlockMoon()
{
    setLocked(false);
}

TsEdCommandStack* commands()
{
    return TsEdCommandStack::cast(tsrxSysRegistry()->at(TSED_REGISTERED_COMMANDS));
}

bool addCommand(const wchar_t* name, TsEdCommandHandler handler, unsigned description)
{
    if (commands()->addCommand(kGroup, name, name, 0, handler) != TSED_COMMAND_OK)
        return false;
    tsedDescribeCommand(kGroup, name, Text(description).characters);
    return true;
}

void giveBack()
{
    if (commands())
        commands()->removeGroup(kGroup);
    if (theTexts)
        FreeLibrary(theTexts);
    theTexts = nullptr;
    theApplication = nullptr;
}

int load(void* application)
{
    theApplication = application;
    theTexts = LoadLibrary(L"MoonRes.dll");
    if (theTexts && commands() && addCommand(L"MOONPHASE", showMoon, moon::kShowsTheMoon) &&
        addCommand(L"LOCKMOON", lockMoon, moon::kLocksTheModule) &&
        addCommand(L"UNLOCKMOON", unlockMoon, moon::kUnlocksTheModule))
    {
        printLine(moon::kGreeting);
        return TSRX_RET_OK;
    }
    giveBack(); // a load that fails leaves nothing behind
    return TSRX_RET_ERROR;
}
} // namespace

extern "C" TESSEL_EXPORT int tsrxEntryPoint(unsigned message, void* application)
{
    if (message == TSRX_MSG_LOAD)
        return load(application);
    if (message == TSRX_MSG_UNLOAD)
        giveBack();
    return TSRX_RET_OK;
}
