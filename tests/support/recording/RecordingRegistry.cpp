#include "tests/support/recording/RecordingRegistry.h"

#include <algorithm>
#include <cstring>
#include <cwchar>
#include <iterator>
#include <unordered_map>

#include "host/text/Unicode.h"
#include "tests/support/RecordingHost.h"
#include "tests/support/recording/RecordingLoans.h"

namespace
{
constexpr wchar_t kSeparator = L'\\';
constexpr DWORD kKeyWasMade = 1;
constexpr DWORD kKeyWasThere = 2;

// The path without empty parts.
std::wstring normalised(std::wstring_view path)
{
    std::wstring result;
    for (std::size_t start = 0; start < path.size();)
    {
        const std::size_t end = std::min(path.find(kSeparator, start), path.size());
        if (end != start && !result.empty())
            result += kSeparator;
        result += path.substr(start, end - start);
        start = end + 1;
    }
    return result;
}

const wchar_t* callName(RecordingRegistry::Operation operation)
{
    static constexpr const wchar_t* kNames[] = {L"RegOpenKeyExW",   L"RegCreateKeyEx", L"RegEnumValueW",
                                                L"RegDeleteValueW", L"tsRegGetValue",  L"tsudRegSetString",
                                                L"RegCloseKey",     L"RegFlushKey"};
    return kNames[static_cast<std::size_t>(operation)];
}

void journal(const RecordingRegistry::Call& call)
{
    using Operation = RecordingRegistry::Operation;
    Journal& journal = recordingHost().journal;
    const wchar_t* name = callName(call.operation);
    switch (call.operation)
    {
    case Operation::kEnumerate:
        return journal.add(name, {call.key, call.index});
    case Operation::kWrite:
        return journal.add(name, {call.key, call.valueName, call.data});
    case Operation::kRead:
    case Operation::kDelete:
        return journal.add(name, {call.key, call.valueName});
    default:
        return journal.add(name, {call.key});
    }
}

// Copies the data as `tsRegGetValue` promises: wholly or not at all.
LONG copyData(const std::wstring& text, DWORD* type, void* data, DWORD* size)
{
    if (type)
        *type = REG_SZ;
    if (!size)
        return data ? ERROR_INVALID_PARAMETER : ERROR_SUCCESS;
    const DWORD needed = static_cast<DWORD>((text.size() + 1) * sizeof(wchar_t));
    const bool fits = *size >= needed;
    *size = needed;
    if (!data)
        return ERROR_SUCCESS;
    if (!fits)
        return ERROR_MORE_DATA;
    std::memcpy(data, text.c_str(), needed);
    return ERROR_SUCCESS;
}
} // namespace

struct RecordingRegistry::Key
{
    struct Value
    {
        std::wstring name;
        std::wstring data;
    };

    const Value* find(std::wstring_view name) const
    {
        const auto found = positions.find(tessel::foldCase(name));
        return found == positions.end() ? nullptr : &values[found->second];
    }

    void set(std::wstring_view name, std::wstring_view data)
    {
        const auto [position, isNew] = positions.try_emplace(tessel::foldCase(name), values.size());
        if (isNew)
            values.push_back({std::wstring(name), std::wstring(data)});
        else
            values[position->second].data = data;
    }

    bool erase(std::wstring_view name)
    {
        const auto found = positions.find(tessel::foldCase(name));
        if (found == positions.end())
            return false;
        const std::size_t gone = found->second;
        values.erase(values.begin() + static_cast<std::ptrdiff_t>(gone));
        positions.erase(found);
        for (auto& [folded, position] : positions)
            position -= position > gone ? 1 : 0;
        return true;
    }

    std::vector<Value> values; // in order of creation
    std::unordered_map<std::wstring, std::size_t> positions;
};

RecordingRegistry::RecordingRegistry() = default;
RecordingRegistry::~RecordingRegistry() = default;

void RecordingRegistry::setValue(std::wstring_view key, std::wstring_view name, std::wstring_view data)
{
    findOrMake(normalised(key)).set(name, data);
}

void RecordingRegistry::makeKey(std::wstring_view key)
{
    findOrMake(normalised(key));
}

void RecordingRegistry::removeValue(std::wstring_view key, std::wstring_view name)
{
    if (Key* found = find(normalised(key)))
        found->erase(name);
}

bool RecordingRegistry::hasKey(std::wstring_view key) const
{
    return find(normalised(key)) != nullptr;
}

std::optional<std::wstring> RecordingRegistry::value(std::wstring_view key, std::wstring_view name) const
{
    const Key* found = find(normalised(key));
    const Key::Value* value = found ? found->find(name) : nullptr;
    return value ? std::optional(value->data) : std::nullopt;
}

std::vector<std::wstring> RecordingRegistry::valueNames(std::wstring_view key) const
{
    std::vector<std::wstring> names;
    if (const Key* found = find(normalised(key)))
        for (const Key::Value& value : found->values)
            names.push_back(value.name);
    return names;
}

std::vector<std::wstring> RecordingRegistry::keys() const
{
    return mKeyPaths;
}

std::size_t RecordingRegistry::openHandles() const
{
    return mOpen.size();
}

void RecordingRegistry::failWhen(Failure failure)
{
    mFailure = std::move(failure);
}

void RecordingRegistry::failAfter(Operation operation, unsigned successes, LONG status)
{
    mFailure = [operation, left = successes, status](const Call& call) mutable -> LONG
    {
        if (call.operation != operation)
            return ERROR_SUCCESS;
        if (left == 0)
            return status;
        --left;
        return ERROR_SUCCESS;
    };
}

std::vector<RecordingRegistry::Call> RecordingRegistry::callsOf(Operation operation) const
{
    std::vector<Call> found;
    std::copy_if(mCalls.begin(), mCalls.end(), std::back_inserter(found),
                 [operation](const Call& call) { return call.operation == operation; });
    return found;
}

LONG RecordingRegistry::open(Call call, HKEY root, const wchar_t* subKey, HKEY* result)
{
    call.operation = Operation::kOpen;
    if (const LONG status = resolve(root, subKey, call.key); status != ERROR_SUCCESS)
        return status;
    if (const LONG status = record(call); status != ERROR_SUCCESS)
        return status;
    if (!find(call.key))
        return ERROR_FILE_NOT_FOUND;
    *result = newHandle(call.key);
    return ERROR_SUCCESS;
}

LONG RecordingRegistry::create(Call call, HKEY root, const wchar_t* subKey, HKEY* result, DWORD* disposition)
{
    call.operation = Operation::kCreate;
    if (const LONG status = resolve(root, subKey, call.key); status != ERROR_SUCCESS)
        return status;
    if (const LONG status = record(call); status != ERROR_SUCCESS)
        return status;
    if (disposition)
        *disposition = find(call.key) ? kKeyWasThere : kKeyWasMade;
    findOrMake(call.key);
    *result = newHandle(call.key);
    return ERROR_SUCCESS;
}

LONG RecordingRegistry::enumerate(Call call, HKEY key, wchar_t* name, DWORD* nameLength, DWORD* type,
                                  BYTE* data, DWORD* dataSize)
{
    const std::wstring* path = openPath(key);
    if (!path)
        return ERROR_INVALID_HANDLE;
    call.operation = Operation::kEnumerate;
    call.key = *path;
    if (const LONG status = record(call); status != ERROR_SUCCESS)
        return status;
    const Key* found = find(*path);
    if (!found || call.index >= found->values.size())
        return ERROR_NO_MORE_ITEMS;
    const Key::Value& value = found->values[call.index];
    if (*nameLength <= value.name.size())
        return ERROR_MORE_DATA;
    std::wmemcpy(name, value.name.c_str(), value.name.size() + 1);
    *nameLength = static_cast<DWORD>(value.name.size());
    return copyData(value.data, type, data, dataSize);
}

LONG RecordingRegistry::remove(HKEY key, const wchar_t* name)
{
    const std::wstring* path = openPath(key);
    if (!path)
        return ERROR_INVALID_HANDLE;
    const std::wstring valueName = name ? name : L"";
    const LONG status = record({.operation = Operation::kDelete, .key = *path, .valueName = valueName});
    if (status != ERROR_SUCCESS)
        return status;
    Key* found = find(*path);
    return found && found->erase(valueName) ? ERROR_SUCCESS : ERROR_FILE_NOT_FOUND;
}

LONG RecordingRegistry::flush(HKEY key)
{
    const std::wstring* path = openPath(key);
    if (!path && key != HKEY_CURRENT_USER)
        return ERROR_INVALID_HANDLE;
    return record({.operation = Operation::kFlush, .key = path ? *path : std::wstring()});
}

LONG RecordingRegistry::close(HKEY key)
{
    const std::wstring* path = openPath(key);
    if (!path)
        return key == HKEY_CURRENT_USER ? ERROR_SUCCESS : ERROR_INVALID_HANDLE;
    const LONG status = record({.operation = Operation::kClose, .key = *path});
    if (status != ERROR_SUCCESS)
        return status;
    recording_loans::takeBack(key);
    mOpen.remove_if([path](const std::wstring& open) { return &open == path; });
    return status;
}

LONG RecordingRegistry::read(Call call, HKEY key, const wchar_t* name, DWORD* type, void* data, DWORD* size)
{
    const std::wstring* path = openPath(key);
    if (!path)
        return ERROR_INVALID_HANDLE;
    call.operation = Operation::kRead;
    call.key = *path;
    call.valueName = name ? name : L"";
    if (const LONG status = record(call); status != ERROR_SUCCESS)
        return status;
    const Key* found = find(*path);
    const Key::Value* value = found ? found->find(call.valueName) : nullptr;
    return value ? copyData(value->data, type, data, size) : ERROR_FILE_NOT_FOUND;
}

LONG RecordingRegistry::write(HKEY key, const wchar_t* name, const wchar_t* data)
{
    const std::wstring* path = openPath(key);
    if (!path)
        return ERROR_INVALID_HANDLE;
    const std::wstring valueName = name ? name : L"";
    const std::wstring text = data ? data : L"";
    const LONG status =
        record({.operation = Operation::kWrite, .key = *path, .valueName = valueName, .data = text});
    if (status != ERROR_SUCCESS)
        return status;
    findOrMake(*path).set(valueName, text);
    return ERROR_SUCCESS;
}

RecordingRegistry::Key* RecordingRegistry::find(const std::wstring& path) const
{
    const auto found = mKeys.find(tessel::foldCase(path));
    return found == mKeys.end() ? nullptr : found->second.get();
}

RecordingRegistry::Key& RecordingRegistry::findOrMake(const std::wstring& path)
{
    if (Key* found = find(path))
        return *found;
    if (const std::size_t parent = path.rfind(kSeparator); parent != std::wstring::npos)
        findOrMake(path.substr(0, parent));
    mKeyPaths.push_back(path);
    return *(mKeys[tessel::foldCase(path)] = std::make_unique<Key>());
}

const std::wstring* RecordingRegistry::openPath(HKEY key) const
{
    const auto found =
        std::find_if(mOpen.begin(), mOpen.end(), [key](const std::wstring& open) { return &open == key; });
    return found == mOpen.end() ? nullptr : &*found;
}

LONG RecordingRegistry::resolve(HKEY root, const wchar_t* subKey, std::wstring& path) const
{
    const std::wstring* parent = openPath(root);
    if (!parent && root != HKEY_CURRENT_USER)
        return ERROR_INVALID_HANDLE;
    path = normalised((parent ? *parent : std::wstring()) + kSeparator + (subKey ? subKey : L""));
    return ERROR_SUCCESS;
}

HKEY RecordingRegistry::newHandle(const std::wstring& path)
{
    const HKEY key = &mOpen.emplace_back(path);
    recording_loans::lend(key, "registry key");
    return key;
}

LONG RecordingRegistry::record(Call call)
{
    journal(call);
    mCalls.push_back(call);
    return mFailure ? mFailure(mCalls.back()) : ERROR_SUCCESS;
}
