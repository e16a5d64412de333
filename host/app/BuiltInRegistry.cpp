// REGISTRY: looks into the registry and changes it, so that scripts can prepare and inspect what applications
// keep there.
#include <filesystem>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "host/app/BuiltIn.h"
#include "host/app/BuiltInSupport.h"
#include "host/app/Parts.h"
#include "host/app/RegistryTransfer.h"
#include "host/text/Json.h"
#include "host/text/Translation.h"
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

// With what the store has to say: of what failed in this command, which is over, or why nothing can be read
// or stored at all.
Failure withReason(Registry& registry, const std::wstring& whatFailed)
{
    const std::wstring reason = registry.takeReason();
    return {whatFailed + (reason.empty() ? L"" : L" " + reason)};
}

Failure notWritten(Registry& registry, const std::wstring& path)
{
    return withReason(registry, translated(L"The registry key \"{}\" cannot be written.", path));
}

// What was not found may only not have been readable.
Failure notFound(Registry& registry, const std::wstring& path, const std::wstring& sentence)
{
    return registry.mayHaveMissed()
               ? withReason(registry, translated(L"The registry key \"{}\" cannot be read.", path))
               : Failure{sentence};
}

Failure notReadToItsEnd(Registry& registry, const std::wstring& path)
{
    return withReason(registry, translated(L"The registry key \"{}\" cannot be read to its end.", path));
}

std::wstring doesNotExist(const std::wstring& path)
{
    return translated(L"The registry key \"{}\" does not exist.", path);
}

std::wstring hasNoValue(const std::wstring& path, const std::wstring& name)
{
    return translated(L"The registry key \"{}\" has no value \"{}\".", path, name);
}

Result<> list(Parts& parts, const std::wstring& path)
{
    LayeredRegistry& registry = *parts.layered;
    const auto key = registry.find(path);
    if (key == Registry::kNoKey)
        return notFound(registry.own(), path, doesNotExist(path));
    std::vector<std::wstring> lines;
    for (const auto& name : registry.subKeys(key))
        lines.push_back(L"[" + name + L"]");
    for (const auto& value : registry.values(key))
        lines.push_back((value.name.empty() ? translated(L"(unnamed)") : value.name) + L" = " + value.data +
                        (value.file.empty() ? L"" : L"    " + translated(L"(from {})", value.file)));
    parts.commandLine->show(lines);
    if (registry.own().readFailed())
        return notReadToItsEnd(registry.own(), path);
    return {};
}

Result<> get(Parts& parts, const std::wstring& path, const std::wstring& name)
{
    const auto data = parts.layered->read(path, name);
    if (!data)
        return notFound(*parts.registry, path, hasNoValue(path, name));
    sayLine(parts, *data);
    return {};
}

Result<> listForPrograms(Parts& parts, const std::wstring& path)
{
    LayeredRegistry& registry = *parts.layered;
    const auto key = registry.find(path);
    if (key == Registry::kNoKey)
        return notFound(registry.own(), path, doesNotExist(path));
    Json values = Json::array();
    for (const auto& value : registry.values(key))
        values.push_back({{"name", json::text(value.name)},
                          {"data", json::text(value.data)},
                          {"file", value.file.empty() ? Json() : json::text(toText(value.file))}});
    const auto keys = registry.subKeys(key);
    if (registry.own().readFailed())
        return notReadToItsEnd(registry.own(), path);
    return succeed(
        parts,
        json::written({{"key", json::text(path)}, {"keys", json::listOfTexts(keys)}, {"values", values}}));
}

Result<> getForPrograms(Parts& parts, const std::wstring& path, const std::wstring& name)
{
    const auto data = parts.layered->read(path, name);
    if (!data)
        return notFound(*parts.registry, path, hasNoValue(path, name));
    return succeed(
        parts,
        json::written({{"key", json::text(path)}, {"name", json::text(name)}, {"data", json::text(*data)}}));
}

// A key alone is made; with a name, the value is stored.
Result<> set(Parts& parts, const std::wstring& path, const Arguments& arguments)
{
    LayeredRegistry& registry = *parts.layered;
    const auto key = registry.create(path, Registry::kRoot);
    Result<> done = key ? Result<>() : key.failure();
    if (key && arguments.size() > 2)
        done = registry.writeValue(*key, at(arguments, 2), at(arguments, 3));
    return done ? done : notWritten(registry.own(), path);
}

// What is laid out for everybody is not the person's to remove.
std::wstring whyMissing(Parts& parts, const std::wstring& path, const std::optional<std::wstring>& name)
{
    const bool isLaidOut =
        name ? parts.layered->read(path, *name).has_value() : parts.layered->find(path) != Registry::kNoKey;
    if (isLaidOut)
        return name
                   ? translated(
                         L"The registry key \"{}\" has the value \"{}\" from the administrator, which stays.",
                         path, *name)
                   : translated(L"The registry key \"{}\" is laid out by the administrator and stays.", path);
    return name ? hasNoValue(path, *name) : doesNotExist(path);
}

// A key alone goes with everything below it; with a name, only the value.
Result<> remove(Parts& parts, const std::wstring& path, const Arguments& arguments)
{
    Registry& registry = *parts.registry;
    const auto name = arguments.size() > 2 ? std::optional(at(arguments, 2)) : std::nullopt;
    const auto key = registry.find(path);
    if (key == Registry::kNoKey)
        return notFound(registry, path, whyMissing(parts, path, name));
    const Result<> done = name ? registry.removeValue(key, *name) : registry.removeKey(key);
    if (done.code() == ERROR_FILE_NOT_FOUND)
        return notFound(registry, path, whyMissing(parts, path, name));
    return done ? done : notWritten(registry, path);
}

Result<> tell(Parts& parts, const Result<std::wstring>& done)
{
    return done ? confirm(parts, *done) : done.failure();
}

bool isUtf8(const std::wstring& word)
{
    return equalIgnoringCase(word, L"UTF8") || equalIgnoringCase(word, L"UTF-8");
}

Result<> exportTo(Parts& parts, const std::wstring& path, const Arguments& arguments)
{
    const auto form = arguments.size() > 3 ? RegistryTextForm::kUtf8 : RegistryTextForm::kUtf16;
    std::error_code currentFolderIsGone;
    return tell(parts,
                exportRegistry(*parts.registry, path,
                               std::filesystem::absolute(typedPath(at(arguments, 2)), currentFolderIsGone),
                               form));
}

Result<> importFrom(Parts& parts, const std::wstring& file)
{
    const auto imported = importRegistry(*parts.registry, toPath(fullPath(parts, file)));
    if (imported)
        parts.registryNews.noteChange();
    return tell(parts, imported);
}

// What is damaged gives way to the copy of what it held.
Result<> restore(Parts& parts)
{
    return tell(parts, parts.registry->restoreCopy());
}

// What is damaged and has no sound copy gives way to an empty one.
Result<> reset(Parts& parts)
{
    return tell(parts, parts.registry->beginEmpty());
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
    if (equalIgnoringCase(action, L"EXPORT") &&
        (arguments.size() == 3 || (arguments.size() == 4 && isUtf8(at(arguments, 3)))))
        return exportTo(parts, path, arguments);
    if (equalIgnoringCase(action, L"IMPORT") && arguments.size() == 2)
        return importFrom(parts, path);
    if (equalIgnoringCase(action, L"RESTORE") && arguments.size() == 1)
        return restore(parts);
    if (equalIgnoringCase(action, L"RESET") && arguments.size() == 1)
        return reset(parts);
    return wrongUsage(parts, kCommand);
}
Result<> registryListing(Parts& parts, const Arguments& arguments)
{
    const std::wstring action = at(arguments, 0);
    if (equalIgnoringCase(action, L"LIST") && arguments.size() <= 2)
        return listForPrograms(parts, at(arguments, 1));
    if (equalIgnoringCase(action, L"GET") && (arguments.size() == 2 || arguments.size() == 3))
        return getForPrograms(parts, at(arguments, 1), at(arguments, 2));
    return wrongUsage(parts, kCommand);
}
} // namespace

void addRegistryCommands(Parts& parts)
{
    addBuiltIn(parts, kCommand, registryCommand);
    parts.commands->addListing(kCommand, std::bind_front(registryListing, std::ref(parts)));
}
} // namespace tessel
