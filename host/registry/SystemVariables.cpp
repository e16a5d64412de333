#include "host/registry/SystemVariables.h"

#include <tessel/tsed.h>

#include <algorithm>
#include <charconv>
#include <cwchar>
#include <optional>

#include "host/registry/LayeredRegistry.h"
#include "host/text/Running.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
std::vector<SystemVariables::Variable> hostVariables()
{
    using Storage = SystemVariables::Storage;
    return {
        {kLispEnabled, std::int16_t{1}, 0, 1, Storage::kSession,
         Sentence(L"1: applications may load Lisp files; 0: not").english},
        {kRemovingTsLisp, std::int16_t{1}, 0, 1, Storage::kStored,
         Sentence(L"1: compiled and packaged Lisp can be loaded (read at the next start)").english},
        {kSearchPath, std::wstring(), 0, 0, Storage::kStored,
         Sentence(L"Folders to look for files in, separated by ;").english},
        {kTesselVersion, std::wstring(L"R21"), 0, 0, Storage::kReadOnly,
         Sentence(L"The release of this host").english},
    };
}

std::optional<std::int16_t> parseNumber(std::wstring_view text)
{
    const std::string digits = toUtf8(text);
    std::int16_t number = 0;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), number);
    if (error != std::errc() || end != digits.data() + digits.size())
        return std::nullopt;
    return number;
}

// The text as a value of the variable's type and range.
std::optional<SystemVariables::Value> parseFor(const SystemVariables::Variable& variable,
                                               std::wstring_view text)
{
    if (std::holds_alternative<std::wstring>(variable.value))
        return std::wstring(text);
    const auto number = parseNumber(text);
    if (!number || *number < variable.smallest || *number > variable.largest)
        return std::nullopt;
    return *number;
}

std::wstring rangeSentence(const SystemVariables::Variable& variable)
{
    return translated(L"{} takes a whole number from {} to {}.", variable.name, variable.smallest,
                      variable.largest);
}
} // namespace

SystemVariables::SystemVariables(LayeredRegistry* registry, const std::wstring& productRoot)
    : mRegistry(registry), mStorageKey(productRoot + L"\\Variables"), mVariables(hostVariables())
{
    readStored();
}

void SystemVariables::readStored()
{
    if (!mRegistry)
        return;
    for (Variable& variable : mVariables)
    {
        if (variable.storage != Storage::kStored)
            continue;
        const auto stored = mRegistry->read(mStorageKey, variable.name);
        if (const auto value = stored ? parseFor(variable, *stored) : std::nullopt)
            variable.value = *value;
    }
}

const SystemVariables::Variable* SystemVariables::find(std::wstring_view name) const
{
    const auto found =
        std::find_if(mVariables.begin(), mVariables.end(),
                     [name](const Variable& variable) { return equalIgnoringCase(variable.name, name); });
    return found == mVariables.end() ? nullptr : &*found;
}

Result<> SystemVariables::set(std::wstring_view name, std::wstring_view text)
{
    const auto* found = find(name);
    if (!found)
        return Failure{translated(L"There is no variable called \"{}\".", name)};
    if (found->storage == Storage::kReadOnly)
        return Failure{translated(L"{} can only be read.", found->name)};
    const auto value = parseFor(*found, text);
    if (!value)
        return Failure{rangeSentence(*found)};
    Variable& variable = mVariables[static_cast<std::size_t>(found - mVariables.data())];
    variable.value = *value;
    const bool store = variable.storage == Storage::kStored && mRegistry;
    if (store && !mRegistry->write(mStorageKey, variable.name, toText(variable.value)))
        return Failure{
            translated(L"{} is set for this session only: the registry cannot be written.", variable.name)};
    return {};
}

std::int16_t SystemVariables::number(std::wstring_view name) const
{
    const Variable* variable = find(name);
    const auto* value = variable ? std::get_if<std::int16_t>(&variable->value) : nullptr;
    return value ? *value : std::int16_t{0};
}

std::wstring SystemVariables::text(std::wstring_view name) const
{
    const Variable* variable = find(name);
    return variable ? toText(variable->value) : std::wstring();
}

std::wstring toText(const SystemVariables::Value& value)
{
    if (const auto* number = std::get_if<std::int16_t>(&value))
        return std::to_wstring(*number);
    return std::get<std::wstring>(value);
}
} // namespace tessel

int tsedGetVar(const wchar_t* name, TsResultBuffer* result)
{
    const tessel::SystemVariables* variables = tessel::running<tessel::SystemVariables>();
    const auto* variable = variables && name ? variables->find(name) : nullptr;
    if (!variable || !result)
        return TS_ERROR;
    if (const auto* number = std::get_if<std::int16_t>(&variable->value))
    {
        result->type = TS_SHORT;
        result->value.shortNumber = *number;
        return TS_NORMAL;
    }
    const std::wstring& text = std::get<std::wstring>(variable->value);
    result->type = TS_STRING;
    result->value.string = new wchar_t[text.size() + 1];
    std::wmemcpy(result->value.string, text.c_str(), text.size() + 1);
    return TS_NORMAL;
}
