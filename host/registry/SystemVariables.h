// The host's system variables: a table with types, ranges and what they are for.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "host/text/Result.h"

namespace tessel
{
class LayeredRegistry;

class SystemVariables
{
public:
    using Value = std::variant<std::int16_t, std::wstring>;

    enum class Storage
    {
        kSession, // starts again with the host
        kStored,  // kept in the registry
        kReadOnly
    };

    struct Variable
    {
        std::wstring name;
        Value value;
        std::int16_t smallest = 0; // of a number
        std::int16_t largest = 0;
        Storage storage = Storage::kSession;
        std::wstring purpose; // one line of English, which translators know
    };

    // The host's own variables, stored ones as the registry has them below the product's root. A stored value
    // that does not fit is passed over. Without a registry nothing is stored.
    SystemVariables(LayeredRegistry* registry, const std::wstring& productRoot);

    const std::vector<Variable>& all() const { return mVariables; }

    // Null for an unknown name. Case does not matter.
    const Variable* find(std::wstring_view name) const;

    // Sets a variable from what a person typed.
    Result<> set(std::wstring_view name, std::wstring_view text);

    std::int16_t number(std::wstring_view name) const;
    std::wstring text(std::wstring_view name) const;

private:
    void readStored();

    LayeredRegistry* mRegistry;
    std::wstring mStorageKey;
    std::vector<Variable> mVariables;
};

// A value as a person reads it.
std::wstring toText(const SystemVariables::Value& value);

inline constexpr const wchar_t* kLispEnabled = L"LISPENABLED";
inline constexpr const wchar_t* kRemovingTsLisp = L"REMOVINGTSLISP";
inline constexpr const wchar_t* kSearchPath = L"SEARCHPATH";
inline constexpr const wchar_t* kTesselVersion = L"TESSELVERSION";
} // namespace tessel
