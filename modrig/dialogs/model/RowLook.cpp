#include "modrig/dialogs/model/RowLook.h"

#include <string>

#include "modrig/dialogs/model/ShownText.h"

namespace ModrigUtils
{
namespace
{
constexpr wchar_t kEllipsis = 0x2026;

CStdStr Beginning(const CStdStr& text, std::size_t length)
{
    return CStdStr(text.Text().substr(0, length) + kEllipsis);
}

RowState StateOfLoaded(const RowFacts& facts)
{
    if (facts.unloadable)
        return RowState::kUsable;
    return facts.isCompiledModule ? RowState::kLocked : RowState::kNeverUnloaded;
}

RowState StateOfListed(const RowFacts& facts)
{
    if (!facts.exists)
        return RowState::kMissing;
    if (facts.isKeptOut)
        return RowState::kKeptOut;
    return facts.hasFailed ? RowState::kFailed : RowState::kUsable;
}
} // namespace

RowState StateOf(TableKind kind, const RowFacts& facts)
{
    return kind == TableKind::kLoadedApplications ? StateOfLoaded(facts) : StateOfListed(facts);
}

const char* ReasonKey(RowState state)
{
    switch (state)
    {
    case RowState::kMissing:
        return "IDS_MODRIG_ROW_MISSING";
    case RowState::kFailed:
        return "IDS_MODRIG_ROW_FAILED";
    case RowState::kLocked:
        return "IDS_MODRIG_ROW_LOCKED";
    case RowState::kNeverUnloaded:
        return "IDS_MODRIG_ROW_NEVER_UNLOADED";
    default:
        return nullptr;
    }
}

CStdStr TipOfRow(const CStdStr& path, const CStdStr& whyKeptOut, RowState state,
                 const std::function<CStdStr(const char*)>& textOf)
{
    const CStdStr shown = ShownText(path);
    if (!whyKeptOut.IsEmpty())
        return shown + CStdStr(L"\n") + whyKeptOut;
    const char* reason = ReasonKey(state);
    return reason ? shown + CStdStr(L"\n") + textOf(reason) : shown;
}

CStdStr Shortened(const CStdStr& text, const std::function<bool(const CStdStr&)>& fits)
{
    if (fits(text))
        return text;
    std::size_t fitting = 0;
    std::size_t tooLong = text.Text().size();
    while (tooLong - fitting > 1)
    {
        const std::size_t middle = fitting + (tooLong - fitting) / 2;
        (fits(Beginning(text, middle)) ? fitting : tooLong) = middle;
    }
    return Beginning(text, fitting);
}
} // namespace ModrigUtils
