#include "host/console/InputAssembler.h"

#include <algorithm>
#include <utility>

namespace tessel
{
namespace
{
constexpr std::wstring_view kBlanksInALine = L" \t\r";

std::wstring_view withoutLeadingBlanks(std::wstring_view text)
{
    return text.substr(std::min(text.find_first_not_of(kBlanksInALine), text.size()));
}
} // namespace

bool isLisp(std::wstring_view text)
{
    return withoutLeadingBlanks(text).starts_with(L'(');
}

std::optional<std::wstring> InputAssembler::add(std::wstring_view line)
{
    const auto content = withoutLeadingBlanks(line);
    if (!isOpen() && (content.empty() || content.starts_with(L';')))
        return std::nullopt;
    if (!isOpen() && !isLisp(line))
        return std::wstring(line);
    const std::wstring added = (isOpen() ? L"\n" : L"") + std::wstring(line);
    mText += added;
    mScanner.take(added);
    if (mScanner.isOpen())
        return std::nullopt;
    mScanner = {};
    return std::exchange(mText, {});
}

void InputAssembler::discard()
{
    mText.clear();
    mScanner = {};
}
} // namespace tessel
