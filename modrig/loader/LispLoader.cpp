// The Lisp road of the loader: expressions for the host's interpreter.
#include <tessel/tsed.h>

#include <algorithm>

#include "modrig/base/SplitPath.h"
#include "modrig/lists/Globals.h"
#include "modrig/loader/ApplicationLoader.h"
#include "modrig/messages/MessageIds.h"

namespace ModrigUtils
{
namespace
{
// A network path begins with two backslashes among its first characters.
constexpr std::size_t kNetworkPrefixWindow = 4;
constexpr int kNetworkPrefixBackslashes = 2;

CStdStr ConcatenateLisp(const wchar_t* before, const CStdStr& middle, const wchar_t* after)
{
    return CStdStr(before) + middle + CStdStr(after);
}

// Where slashes are rewritten from: after the second backslash among the first four characters, or from the
// head. The two are counted, not looked for side by side: a path with backslashes at 1 and 3 counts as well.
std::size_t EndOfNetworkPrefix(const std::wstring& path)
{
    int backslashes = 0;
    for (std::size_t i = 0; i < std::min(path.size(), kNetworkPrefixWindow); ++i)
        if (path[i] == L'\\' && ++backslashes == kNetworkPrefixBackslashes)
            return i + 1;
    return 0;
}

// A double quote would end the Lisp string early and let the rest of a file's name run as code. One after a
// backslash that escapes it already is left alone: one more would escape the backslash instead.
std::wstring EscapeQuotes(const std::wstring& text)
{
    std::wstring escaped;
    bool afterEscape = false;
    for (const wchar_t character : text)
    {
        if (character == L'"' && !afterEscape)
            escaped += L'\\';
        escaped += character;
        afterEscape = character == L'\\' && !afterEscape;
    }
    return escaped;
}

// The path as it stands inside a Lisp string: forward slashes, and for a network path its backslashes,
// doubled by two more in front for the reader.
CStdStr LispSafePath(const CStdStr& path)
{
    std::wstring text = path.Text();
    const std::size_t from = EndOfNetworkPrefix(text);
    std::replace(text.begin() + static_cast<std::ptrdiff_t>(from), text.end(), L'\\', L'/');
    text = EscapeQuotes(text);
    return from == 0 ? CStdStr(text) : CStdStr(L"\\\\" + text);
}

CStdStr LoadExpression(const CStdStr& path, bool loadAll)
{
    const CStdStr safePath = LispSafePath(path);
    if (loadAll && RemovingTsLISP())
        return ConcatenateLisp(L"(progn (_INTERNAL-LOAD-ALL-FILE \"", safePath, L"\" nil T T nil)(princ))");
    return ConcatenateLisp(L"(load \"", safePath, L"\")");
}

// The interpreter runs the three in this order when the host is idle; nobody waits for what they answer.
void QueueWithPrompt(const CStdStr& expression)
{
    qxr_queueexpr(expression.c_str());
    qxr_queueexpr(L"(write-line \"\")");
    const CStdStr prompt = CStdStr::OfId(ModrigMessages::kLispPrompt);
    CStdStr promptExpression;
    promptExpression.Fmt(L"(prompt \"%s \")", prompt.c_str());
    qxr_queueexpr(promptExpression.c_str());
}

// The road of the Lisp development environment, which takes the path as it is.
bool InvokeQzLoad(const CStdStr& path)
{
    TsResultBuffer* call = tsutBuildList({TsRbValue::String(L"qz-load"), TsRbValue::String(path.c_str()),
                                          TsRbValue::Short(0), TsRbValue::Short(0)});
    TsResultBuffer* result = nullptr;
    const int status = tsedInvoke(call, &result);
    tsutRelRb(call);
    tsutRelRb(result);
    return status == TS_NORMAL;
}
} // namespace

bool LoadLispFile(CStdStr path, signed char load, signed char loadAll)
{
    const SplitPath split(path);
    if (!load && !split.HasExtension(L".rpk"))
        return false;
    // Without the host's support the unloading of a packaged application falls through to loading it, on
    // purpose: such a host replaces a package by loading it again.
    if (!load && RemovingTsLISP())
    {
        QueueWithPrompt(
            ConcatenateLisp(L"(qz-unload-rpk \"", CStdStr(EscapeQuotes(std::wstring(split.Name()))), L"\")"));
        return true;
    }
    if (gbOrreryLoaded)
        return InvokeQzLoad(path);
    QueueWithPrompt(LoadExpression(path, loadAll != 0));
    return true;
}
} // namespace ModrigUtils
