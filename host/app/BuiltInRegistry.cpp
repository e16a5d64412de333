// REGISTRY: looks into the registry and changes it, so that scripts can prepare and inspect what applications
// keep there.
#include <string>

#include "host/app/BuiltIn.h"
#include "host/app/BuiltInSupport.h"
#include "host/app/Parts.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr wchar_t kCommand[] = L"REGISTRY";

// The arguments after the name of what is to be done. A name that is left out is the unnamed value's.
using Arguments = CommandStack::Arguments;

std::wstring at(const Arguments& arguments, std::size_t index)
{
    return index < arguments.size() ? arguments[index] : L"";
}

Failure failureAt(const std::wstring& path, const std::wstring& reason)
{
    return {L"The registry key \"" + path + L"\" " + reason + L"."};
}

// The store's own words are told at the end of the command, which undoes all of it. Why nothing can be stored
// at all is a sentence of its own.
Failure writeFailure(const Registry& registry, const std::wstring& path, const Result<>& written)
{
    const Result<>& canStore = registry.canStore();
    if (canStore)
        return failureAt(path, L"cannot be written: error " + std::to_wstring(written.code()));
    return {failureAt(path, L"cannot be written").sentence + L" " + canStore.sentence()};
}

Result<> list(Parts& parts, const std::wstring& path)
{
    Registry& registry = *parts.registry;
    const auto key = registry.find(path);
    if (key == Registry::kNoKey)
        return failureAt(path, L"does not exist");
    for (const auto& name : registry.subKeys(key))
        sayLine(parts, L"[" + name + L"]");
    for (const auto& value : registry.values(key))
        sayLine(parts, (value.name.empty() ? L"(unnamed)" : value.name) + L" = " + value.data);
    return {};
}

Result<> get(Parts& parts, const std::wstring& path, const std::wstring& name)
{
    const auto data = parts.registry->read(path, name);
    if (!data)
        return failureAt(path, L"has no value \"" + name + L"\"");
    sayLine(parts, *data);
    return {};
}

// A key alone is made; with a name, the value is stored.
Result<> set(Parts& parts, const std::wstring& path, const Arguments& arguments)
{
    Registry& registry = *parts.registry;
    const auto key = registry.create(path, Registry::kRoot);
    Result<> done = key ? Result<>() : key.failure();
    if (key && arguments.size() > 2)
        done = registry.writeValue(*key, at(arguments, 2), at(arguments, 3));
    return done ? done : writeFailure(registry, path, done);
}

// A key alone goes with everything below it; with a name, only the value.
Result<> remove(Parts& parts, const std::wstring& path, const Arguments& arguments)
{
    Registry& registry = *parts.registry;
    const auto key = registry.find(path);
    if (key == Registry::kNoKey)
        return failureAt(path, L"does not exist");
    const Result<> done =
        arguments.size() > 2 ? registry.removeValue(key, at(arguments, 2)) : registry.removeKey(key);
    if (done.code() == ERROR_FILE_NOT_FOUND)
        return failureAt(path, L"has no value \"" + at(arguments, 2) + L"\"");
    return done ? done : writeFailure(registry, path, done);
}

// What is damaged gives way to the copy of what it held.
Result<> restore(Parts& parts)
{
    const auto restored = parts.registry->restoreCopy();
    return restored ? succeed(parts, *restored) : restored.failure();
}

Result<> registryCommand(Parts& parts, const Arguments& arguments)
{
    const std::wstring action = at(arguments, 0);
    const std::wstring path = at(arguments, 1);
    if (equalIgnoringCase(action, L"LIST") && arguments.size() <= 2)
        return list(parts, path);
    if (equalIgnoringCase(action, L"GET") && (arguments.size() == 2 || arguments.size() == 3))
        return get(parts, path, at(arguments, 2));
    if (equalIgnoringCase(action, L"SET") && (arguments.size() == 2 || arguments.size() == 4))
        return set(parts, path, arguments);
    if (equalIgnoringCase(action, L"DELETE") && (arguments.size() == 2 || arguments.size() == 3))
        return remove(parts, path, arguments);
    if (equalIgnoringCase(action, L"RESTORE") && arguments.size() == 1)
        return restore(parts);
    return wrongUsage(parts, kCommand);
}
} // namespace

void addRegistryCommands(Parts& parts)
{
    addBuiltIn(parts,
               {L"Settings", kCommand, L"LIST|GET|SET|DELETE key [name] [data] | RESTORE",
                L"Works on the registry, below HKEY_CURRENT_USER; puts back the copy of a damaged one"},
               registryCommand);
}
} // namespace tessel
