// Modrig's lists in the host's real registry: a list comes back as it was stored, whatever its entries are,
// and of a list that somebody else has written, whatever it holds, something sensible is read.
#include <algorithm>
#include <memory>
#include <string>
#include <vector>

#include "host/app/Host.h"
#include "host/text/Unicode.h"
#include "modrig/lists/ListMembership.h"
#include "modrig/lists/StoredList.h"
#include "modrig/profile/ProfileRegistry.h"
#include "tests/fuzz/FuzzHost.h"

namespace
{
using ModrigUtils::kStoredHistory;

constexpr std::size_t kLongestEntry = 1023;

struct Session
{
    std::unique_ptr<tessel::Host> host = start();

    static std::unique_ptr<tessel::Host> start()
    {
        tessel::HostOptions options;
        options.profileFolder = fuzzFolder() / "profile";
        options.safe = true;
        options.output = [](std::string_view) {
        };
        auto started = std::make_unique<tessel::Host>(options);
        require(started->start());
        return started;
    }

    // A line of its own ends the one that wrote, so that all of it is stored.
    void endLine() const { require(host->run(L"VERSION")); }
};

// What stands between zeros.
std::vector<std::wstring> textsIn(const std::uint8_t* data, std::size_t size)
{
    std::vector<std::wstring> texts;
    const std::string bytes(data, data + size);
    for (std::size_t begin = 0; begin < bytes.size();)
    {
        const std::size_t end = std::min(bytes.find('\0', begin), bytes.size());
        texts.push_back(tessel::toWide(bytes.substr(begin, end - begin)));
        begin = end + 1;
    }
    return texts;
}

std::vector<std::wstring> contentOf(const CStringList& list)
{
    std::vector<std::wstring> content;
    for (const CStdStr& entry : list)
        content.push_back(entry.Text());
    return content;
}

std::vector<std::wstring> readBack()
{
    CStringList list;
    std::size_t appended = 0;
    ModrigUtils::ReadStoredList(kStoredHistory, list, [&](const CStdStr&) { ++appended; });
    require(appended == list.GetCount());
    return contentOf(list);
}

void checkOwnList(const Session& session, const std::vector<std::wstring>& texts)
{
    CStringList list;
    for (const std::wstring& text : texts)
        if (!text.empty() && text.size() <= kLongestEntry &&
            !ModrigUtils::FoundinSpecificList(CStdStr(text), list))
            list.AddTail(CStdStr(text));
    ModrigUtils::WriteStoredList(kStoredHistory, list);
    session.endLine();
    require(readBack() == contentOf(list));
}

// Names and data in turn; the first text is the count.
void checkForeignList(const Session& session, const std::vector<std::wstring>& texts)
{
    ModrigUtils::WriteStoredList(kStoredHistory, {});
    const CStdStr key =
        ModrigUtils::GetModrigProfileRegKey() + CStdStr(L"\\") + CStdStr(kStoredHistory.subKey);
    const auto write = [&key](const std::wstring& name, const std::wstring& data)
    {
        static_cast<void>(
            ModrigUtils::WriteModrigRegString(HKEY_CURRENT_USER, key, CStdStr(name), CStdStr(data)));
    };
    if (!texts.empty())
        write(kStoredHistory.count, texts.front());
    for (std::size_t index = 1; index + 1 < texts.size(); index += 2)
        write(texts[index], texts[index + 1]);
    session.endLine();
    const auto read = readBack();
    note(std::to_wstring(read.size()));
    for (const std::wstring& entry : read)
        require(std::ranges::find(texts, entry) != texts.end());
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    static const Session session;
    if (size == 0)
        return 0;
    const auto texts = textsIn(data + 1, size - 1);
    if (data[0] % 2 == 0)
        checkOwnList(session, texts);
    else
        checkForeignList(session, texts);
    return 0;
}
