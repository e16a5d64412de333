// Sends messages to the entry point of the Modrig that the host has loaded, and tells the answers.
#include <string>

#include <tessel/tsed.h>
#include <tessel/tsedcommands.h>
#include <tessel/tsformat.h>
#include <tessel/tsrxlinker.h>

#include <dlfcn.h>

namespace
{
constexpr unsigned kUnknownMessage = 7;
constexpr std::size_t kLongestPath = 1024;

using EntryPoint = int (*)(unsigned message, void* application);

// The program inside of the bundle. Nothing is loaded: it must be there already.
EntryPoint entryPointOfModrig()
{
    wchar_t bundle[kLongestPath] = {};
    if (tsedGetModuleFileName(L"Modrig.bundle", bundle, kLongestPath) != 0)
        return nullptr;
    const std::wstring wide = std::wstring(bundle) + L"/"
                                                     L"" MODRIG_PROGRAM;
    const std::string program(wide.begin(), wide.end()); // the tests' own folders are plain letters
    void* library = dlopen(program.c_str(), RTLD_NOLOAD | RTLD_LAZY);
    return library ? reinterpret_cast<EntryPoint>(dlsym(library, "tsrxEntryPoint")) : nullptr;
}

void send(unsigned message)
{
    if (const EntryPoint entryPoint = entryPointOfModrig())
        tsutPrintf(L"Modrig answered %d.\n", entryPoint(message, nullptr));
    else
        tsutPrintf(L"There is no Modrig.\n");
}

void add(const wchar_t* name, TsEdCommandHandler handler)
{
    auto* commands = TsEdCommandStack::cast(tsrxSysRegistry()->at(TSED_REGISTERED_COMMANDS));
    commands->addCommand(L"ASKSMODRIG", name, name, 0, handler);
}
} // namespace

extern "C" TESSEL_EXPORT int tsrxEntryPoint(unsigned message, void*)
{
    if (message != TSRX_MSG_LOAD)
        return TSRX_RET_OK;
    add(L"SENDLOAD", [] { send(TSRX_MSG_LOAD); });
    add(L"SENDUNLOAD", [] { send(TSRX_MSG_UNLOAD); });
    add(L"SENDSEVEN", [] { send(kUnknownMessage); });
    return TSRX_RET_OK;
}
