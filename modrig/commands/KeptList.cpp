#include "modrig/commands/KeptList.h"

#include <tessel/tsed.h>
#include <wincompat/winfile.h>

#include <algorithm>
#include <cwchar>
#include <functional>
#include <string>
#include <utility>

#include "modrig/base/SplitPath.h"
#include "modrig/commands/CommandTexts.h"
#include "modrig/lists/FileIntake.h"
#include "modrig/lists/Globals.h"
#include "modrig/lists/StartupOrder.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/profile/ProfileRegistry.h"
#include "modrig/types/ApplicationTypes.h"
#include "modrig/types/FileValidation.h"

namespace ModrigUtils
{
namespace
{
constexpr std::size_t kLongestPath = 1023; // what can be read back
constexpr std::size_t kPlaceSize = 1024;
constexpr std::size_t kReasonSize = 8192;
constexpr std::size_t kLongestTyped = 8192;

CStdStr Decimal(std::size_t number)
{
    return CStdStr(std::to_wstring(number));
}

CStdStr FileNameOf(const CStdStr& path)
{
    return SplitPath(path).FileName();
}

CStdStr Summary(unsigned oneText, unsigned manyText, const std::vector<CStdStr>& paths)
{
    return paths.size() == 1 ? CStdStr::Formatted(oneText, FileNameOf(paths.front()).c_str())
                             : CStdStr::Formatted(manyText, Decimal(paths.size()).c_str());
}

// In the one way in which the lists have it. What no path is known for is looked for as it was typed.
CStdStr WholePath(const CStdStr& typed)
{
    wchar_t path[kLongestTyped] = {};
    return tsedTypedPath(typed.c_str(), path, kLongestTyped) == TS_NORMAL ? CStdStr(std::wstring(path))
                                                                          : typed;
}

bool IsNumber(const CStdStr& typed)
{
    const std::wstring& text = typed.Text();
    return !text.empty() && std::all_of(text.begin(), text.end(),
                                        [](wchar_t digit) { return digit >= L'0' && digit <= L'9'; });
}

// Why what stands there can never be loaded, whatever it holds.
CStdStr WhyNoApplication(const CStdStr& path, DWORD attributes)
{
    const bool isBundle = path.AfterLastDot().EqualsNoCase(CStdStr(L"bundle"));
    const bool isFolder = (attributes & FILE_ATTRIBUTE_DIRECTORY) != 0;
    if ((attributes & FILE_ATTRIBUTE_DEVICE) != 0)
        return CStdStr::Formatted(ModrigMessages::kFileIsNotOrdinary, path.c_str());
    if (isFolder != isBundle)
        return CStdStr::Formatted(isFolder ? ModrigMessages::kFileIsFolder : ModrigMessages::kBundleIsFile,
                                  path.c_str());
    return {};
}

// Why a file cannot join a list; otherwise the path becomes the one that it is found at.
CStdStr WhyRefused(const KeptList& list, CStdStr& path)
{
    if (path.IsEmpty())
        return CStdStr::OfId(ModrigMessages::kNothingNamed);
    if (!FindExtension(path.AfterLastDot()))
        return CStdStr::Formatted(ModrigMessages::kCannotLoadFile, path.c_str());
    const DWORD attributes = ValidateFileExists(path);
    if (attributes == INVALID_FILE_ATTRIBUTES)
        return CStdStr::Formatted(ModrigMessages::kFileNotThere, path.c_str());
    if (CStdStr refused = WhyNoApplication(path, attributes); !refused.IsEmpty())
        return refused;
    if (path.Text().size() > kLongestPath)
        return CStdStr::Formatted(ModrigMessages::kPathTooLong, path.c_str());
    if (list.isLoadedAtStart && IsTempInternetFile(path))
        return CStdStr::Formatted(ModrigMessages::kTemporaryInternetFile, path.c_str());
    return {};
}

bool Holds(const CStringList& files, const CStdStr& path)
{
    return std::any_of(files.begin(), files.end(),
                       [&path](const CStdStr& entry) { return entry.EqualsNoCase(path); });
}

// What was typed twice is one file.
void NoteOnce(std::vector<CStdStr>& paths, CStdStr path)
{
    if (std::none_of(paths.begin(), paths.end(),
                     [&path](const CStdStr& noted) { return noted.EqualsNoCase(path); }))
        paths.push_back(std::move(path));
}

// As it is kept: as it was typed, or by the whole path. Empty where it is not.
CStdStr EntryFor(const KeptList& list, const CStdStr& typed)
{
    for (const CStdStr& path : {typed, WholePath(typed)})
        if (Holds(list.files, path))
            return path;
    return {};
}

CStdStr NotInList(const KeptList& list, const CStdStr& typed)
{
    if (typed.IsEmpty())
        return CStdStr::OfId(ModrigMessages::kNothingNamed);
    if (IsNumber(typed))
        return CStdStr::Formatted(ModrigMessages::kPlaceIsNoFile, typed.c_str(),
                                  CStdStr::OfId(list.inText).c_str());
    return CStdStr::Formatted(ModrigMessages::kNotInList, WholePath(typed).c_str(),
                              CStdStr::OfId(list.inText).c_str());
}

// What the administrator has laid down of a list, while this is there.
class LaidDownValues
{
public:
    explicit LaidDownValues(const StoredListNames& names) : mPath(SubKeyOf(names))
    {
        mIsOpen = RegOpenKeyExW(HKEY_CURRENT_USER, mPath.c_str(), 0, KEY_READ, &mKey) == ERROR_SUCCESS;
    }
    ~LaidDownValues()
    {
        if (mIsOpen)
            RegCloseKey(mKey);
    }
    LaidDownValues(const LaidDownValues&) = delete;
    LaidDownValues& operator=(const LaidDownValues&) = delete;

    bool Have(const CStdStr& name) const
    {
        return mIsOpen && tsRegIsLaidDown(mKey, name.c_str(), nullptr, 0);
    }

    // The place of what counts instead of the data; empty when the data would count.
    CStdStr PlaceOfOther(const CStdStr& name, const CStdStr& data) const
    {
        wchar_t place[kPlaceSize] = {};
        if (!mIsOpen || !tsRegIsLaidDown(mKey, name.c_str(), place, kPlaceSize))
            return {};
        CStdStr counts;
        const bool isTheSame = ReadModrigRegString(HKEY_CURRENT_USER, mPath, name, counts) && counts == data;
        return isTheSame ? CStdStr() : CStdStr(std::wstring(place));
    }

private:
    const CStdStr mPath;
    HKEY mKey = nullptr;
    bool mIsOpen = false;
};

bool LeadsToAFile(const CStdStr& typed)
{
    return GetFileAttributesW(WholePath(typed).c_str()) != INVALID_FILE_ATTRIBUTES;
}

// Typed without its quotes, a name with blanks comes as several. `isMeant` knows it again.
CStdStr HintAtQuotes(const std::vector<CStdStr>& typed, const std::function<bool(const CStdStr&)>& isMeant)
{
    for (auto first = typed.begin(); first != typed.end(); ++first)
    {
        std::wstring name = first->Text();
        for (auto next = first + 1; next != typed.end() && name.size() <= kLongestPath; ++next)
        {
            name += L" " + next->Text();
            if (isMeant(CStdStr(name)))
                return CStdStr(L"\n") + CStdStr::Formatted(ModrigMessages::kQuotesNeeded, name.c_str());
        }
    }
    return {};
}

// What the host says of a value that it may have missed; empty when it is what was read.
CStdStr WhyMissed(const CStdStr& key, const CStdStr& name)
{
    wchar_t reason[kReasonSize]; // looked at only where it is filled: to clear it takes longer than to ask
    const bool mayBeMissed = tsRegMayHaveMissed(key.c_str(), name.c_str(), reason, kReasonSize);
    return mayBeMissed ? CStdStr(std::wstring(reason)) : CStdStr();
}

// Of a list of which so many entries were read. It ends at its first gap, and what cannot be read looks like
// one.
CStdStr WhyMissed(const StoredListNames& names, long entriesRead)
{
    const CStdStr key = SubKeyOf(names);
    CStdStr count;
    CStdStr missed = WhyMissed(key, CStdStr(names.count));
    if (!missed.IsEmpty() || !ReadModrigRegString(HKEY_CURRENT_USER, key, CStdStr(names.count), count))
        return missed;
    const long last = std::min(std::wcstol(count.c_str(), nullptr, 10), entriesRead + 1);
    for (long number = 1; missed.IsEmpty() && number <= last; ++number)
        missed = WhyMissed(key, EntryName(names, number));
    return missed;
}
} // namespace

const KeptList& KeptStartupSuite()
{
    using namespace ModrigMessages;
    static const KeptList list{L"suite",
                               kStoredStartupSuite,
                               gStartupList,
                               kStartupSuiteName,
                               kInStartupSuite,
                               kOneAddedToStartupSuite,
                               kManyAddedToStartupSuite,
                               kOneRemovedFromSuite,
                               kManyRemovedFromSuite,
                               true};
    return list;
}

const KeptList& KeptHistory()
{
    using namespace ModrigMessages;
    static const KeptList list{L"history",
                               kStoredHistory,
                               gHistoryList,
                               kHistoryName,
                               kInHistory,
                               kOneAddedToHistory,
                               kManyAddedToHistory,
                               kOneRemovedFromHistory,
                               kManyRemovedFromHistory,
                               false};
    return list;
}

CStdStr ReadKept(const KeptList& list)
{
    const long entriesRead = ReadStoredList(list.names, list.files, [](const CStdStr&) {});
    const CStdStr missed = WhyMissed(list.names, entriesRead);
    return missed.IsEmpty() ? missed
                            : CStdStr::Formatted(ModrigMessages::kListNotRead,
                                                 CStdStr::OfId(list.inText).c_str(), missed.c_str());
}

Change AddFiles(const KeptList& list, const std::vector<CStdStr>& typed)
{
    if (typed.size() > kMaxFilesAtOnce)
        return {CStdStr::Formatted(ModrigMessages::kTooManyAdded, Decimal(kMaxFilesAtOnce).c_str(),
                                   Decimal(typed.size()).c_str(), CStdStr::OfId(list.nameText).c_str())};
    std::vector<CStdStr> paths;
    for (const CStdStr& file : typed)
    {
        CStdStr path = WholePath(file);
        if (const CStdStr refused = WhyRefused(list, path); !refused.IsEmpty())
            return {refused + HintAtQuotes(typed, LeadsToAFile)};
        NoteOnce(paths, std::move(path));
    }
    for (const CStdStr& path : paths)
        static_cast<void>(list.files.AddTailUnlessHeld(path)); // what is there already counts as added
    return {{}, Summary(list.oneAdded, list.manyAdded, paths)};
}

Change RemoveFiles(const KeptList& list, const std::vector<CStdStr>& typed)
{
    std::vector<CStdStr> paths;
    for (const CStdStr& file : typed)
    {
        CStdStr path = EntryFor(list, file);
        if (path.IsEmpty())
            return {NotInList(list, file) + HintAtQuotes(typed, [&list](const CStdStr& name)
                                                         { return !EntryFor(list, name).IsEmpty(); })};
        NoteOnce(paths, std::move(path));
    }
    for (const CStdStr& path : paths)
        static_cast<void>(list.files.RemoveFirstNoCase(path)); // each is in it
    return {{}, Summary(list.oneRemoved, list.manyRemoved, paths)};
}

Change RemoveAllFiles(const KeptList& list)
{
    const std::vector<CStdStr> paths(list.files.begin(), list.files.end());
    list.files.RemoveAll();
    if (paths.empty())
        return {{}, CStdStr::Formatted(ModrigMessages::kListIsEmpty, CStdStr::OfId(list.inText).c_str())};
    return {{}, Summary(list.oneRemoved, list.manyRemoved, paths)};
}

Change MoveFile(const CStdStr& typed, const CStdStr& place)
{
    const KeptList& suite = KeptStartupSuite();
    const CStdStr path = EntryFor(suite, typed);
    if (path.IsEmpty())
        return {NotInList(suite, typed)};
    const bool fits = place.Text().size() < 10; // into the number
    const std::size_t number = fits && IsNumber(place) ? std::stoul(place.Text()) : 0;
    const std::vector<CStdStr> entries(suite.files.begin(), suite.files.end());
    if (number < 1 || number > entries.size())
        return {
            CStdStr::Formatted(ModrigMessages::kNoSuchPlace, place.c_str(), Decimal(entries.size()).c_str())};
    static_cast<void>(MoveInStartupSuite(path, entries[number - 1])); // both are in it
    return {{},
            CStdStr::Formatted(ModrigMessages::kMoved, FileNameOf(path).c_str(), Decimal(number).c_str())};
}

CStdStr LaidDownInstead(const KeptList& list)
{
    const LaidDownValues laidDown(list.names);
    CStdStr place = laidDown.PlaceOfOther(CStdStr(list.names.count), Decimal(list.files.GetCount()));
    long number = 0;
    for (auto entry = list.files.begin(); place.IsEmpty() && entry != list.files.end(); ++entry)
        place = laidDown.PlaceOfOther(EntryName(list.names, ++number), *entry);
    return place;
}

std::vector<bool> WhichAreLaidDown(const KeptList& list)
{
    const LaidDownValues laidDown(list.names);
    std::vector<bool> entries;
    for (long number = 1; number <= static_cast<long>(list.files.GetCount()); ++number)
        entries.push_back(laidDown.Have(EntryName(list.names, number)));
    return entries;
}
} // namespace ModrigUtils
