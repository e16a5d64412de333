#include <array>
#include <string>

#include <tessel/tsed.h>
#include <tessel/tsformat.h>
#include <tessel/tsrx.h>
#include <wincompat/winfile.h>
#include <wincompat/winres.h>

namespace
{
constexpr std::size_t kTextSize = 256;

void sayText()
{
    std::array<wchar_t, kTextSize> text = {};
    const HMODULE texts = LoadLibrary(L"OutsideRes.dll");
    loadStringFromWin32ResourceDLL(texts, 20, text.data(), text.size());
    FreeLibrary(texts);
    tsutPrintf(L"%s\n", text.data());
}

void sayResource()
{
    const std::wstring file = std::wstring(tsedGetAppName()) + L"/Resources/shapes.txt";
    const bool isThere = GetFileAttributesW(file.c_str()) != INVALID_FILE_ATTRIBUTES;
    tsutPrintf(L"shapes.txt is %s\n", isThere ? L"there" : L"missing");
}
} // namespace

extern "C" TESSEL_EXPORT int tsrxEntryPoint(unsigned message, void*)
{
    if (message != TSRX_MSG_LOAD)
        return TSRX_RET_OK;
    sayText();
    sayResource();
    return TSRX_RET_OK;
}
