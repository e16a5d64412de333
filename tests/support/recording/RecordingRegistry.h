// The registry in memory. It keeps every promise of <wincompat/winreg.h> until a test tells it to fail.
//
// Keys are given by their path below HKEY_CURRENT_USER ("Software\\Tessel\\R21\\Profiles"), names and paths
// in any case. What a test prepares or asks here is neither journaled nor made to fail.
#pragma once

#include <functional>
#include <list>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include <wincompat/winreg.h>

class RecordingRegistry
{
public:
    enum class Operation
    {
        kOpen,
        kCreate,
        kEnumerate,
        kDelete,
        kRead,
        kWrite,
        kClose,
        kFlush
    };

    // One call of the registry functions.
    struct Call
    {
        Operation operation = Operation::kOpen;
        std::wstring key = {};       // the path below HKEY_CURRENT_USER, spelt as the caller opened it
        std::wstring valueName = {}; // where the call names a value
        std::wstring data = {};      // where the call writes
        DWORD access = 0;            // where the call opens or creates
        DWORD index = 0;             // where the call enumerates

        // What callers mostly leave out, as the call was given it.
        DWORD reserved = 0;
        std::optional<std::wstring> keyClass = {};
        DWORD options = 0;
        bool hasSecurity = false;
        bool asksForDisposition = false;
        DWORD type = 0;           // where the call reads
        DWORD size = 0;           // of the buffer: characters of a name, bytes of data
        bool asksForData = false; // where the call enumerates: type, data or size of the value too
    };

    RecordingRegistry();
    ~RecordingRegistry();

    // Makes the key, its parents and the value. An empty name is the key's unnamed value.
    void setValue(std::wstring_view key, std::wstring_view name, std::wstring_view data);
    void makeKey(std::wstring_view key);
    void removeValue(std::wstring_view key, std::wstring_view name);

    bool hasKey(std::wstring_view key) const;
    std::optional<std::wstring> value(std::wstring_view key, std::wstring_view name) const;
    std::vector<std::wstring> valueNames(std::wstring_view key) const; // in order of creation
    std::vector<std::wstring> keys() const;                            // full paths, in order of creation

    // Handles that were opened and not closed yet.
    std::size_t openHandles() const;

    // Asked before each call: any answer but ERROR_SUCCESS is the call's result, and nothing happens.
    // Remember that a caller may go on enumerating until it hears ERROR_NO_MORE_ITEMS.
    using Failure = std::function<LONG(const Call&)>;
    void failWhen(Failure failure);

    // The first `successes` calls of that kind from now on go their way, all later ones fail.
    void failAfter(Operation operation, unsigned successes, LONG status = ERROR_WRITE_FAULT);

    // Sentences about a registry of which nothing is certain. What calls find there is up to `failWhen`.
    std::optional<std::wstring> whyUnreadable;

    // All calls in order, with their arguments; failed ones included.
    const std::vector<Call>& calls() const { return mCalls; }
    std::vector<Call> callsOf(Operation operation) const;

    // What the SDK's functions do. Where there is a `call`, it brings the arguments that are only remembered.
    LONG open(Call call, HKEY root, const wchar_t* subKey, HKEY* result);
    LONG create(Call call, HKEY root, const wchar_t* subKey, HKEY* result, DWORD* disposition);
    LONG enumerate(Call call, HKEY key, wchar_t* name, DWORD* nameLength, DWORD* type, BYTE* data,
                   DWORD* dataSize);
    LONG remove(HKEY key, const wchar_t* name);
    LONG close(HKEY key);
    LONG flush(HKEY key);
    LONG read(Call call, HKEY key, const wchar_t* name, DWORD* type, void* data, DWORD* size);
    LONG write(HKEY key, const wchar_t* name, const wchar_t* data);

private:
    struct Key;

    Key* find(const std::wstring& path) const;
    Key& findOrMake(const std::wstring& path);
    const std::wstring* openPath(HKEY key) const;
    LONG resolve(HKEY root, const wchar_t* subKey, std::wstring& path) const;
    HKEY newHandle(const std::wstring& path);
    LONG record(Call call);

    std::map<std::wstring, std::unique_ptr<Key>> mKeys; // by folded path
    std::vector<std::wstring> mKeyPaths;
    std::list<std::wstring> mOpen; // the path behind each handle
    std::vector<Call> mCalls;
    Failure mFailure;
};
