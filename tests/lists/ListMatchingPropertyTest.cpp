// The lists answer by an index. Here they are held against plain walks, written straight from the rule, over
// random lists.
#include <wincompat/winfile.h>

#include <algorithm>
#include <random>
#include <string>
#include <vector>

#include <gtest/gtest.h>
#include <unicode/uchar.h>

#include "modrig/lists/ListMembership.h"

namespace
{
using PathList = std::vector<std::wstring>;

wchar_t Fold(wchar_t character)
{
    return static_cast<wchar_t>(u_foldCase(static_cast<UChar32>(character), U_FOLD_CASE_DEFAULT));
}

bool SameText(const std::wstring& left, const std::wstring& right)
{
    return std::equal(left.begin(), left.end(), right.begin(), right.end(),
                      [](wchar_t a, wchar_t b) { return Fold(a) == Fold(b); });
}

struct Parts
{
    std::wstring folder; // drive and directory
    std::wstring name;   // file name and extension
    std::wstring extension;
    bool tooLong = false;
};

Parts PartsOf(const std::wstring& path)
{
    wchar_t drive[3] = {};
    wchar_t directory[1024] = {};
    wchar_t name[256] = {};
    wchar_t extension[256] = {};
    const int status = _wsplitpath_s(path.c_str(), drive, 3, directory, 1024, name, 256, extension, 256);
    return {std::wstring(drive) + directory, std::wstring(name) + extension, extension, status != 0};
}

// From the head, entry by entry.
bool WalkFinds(const std::wstring& path, const PathList& list)
{
    const Parts target = PartsOf(path);
    for (const std::wstring& text : list)
    {
        const Parts entry = PartsOf(text);
        if (entry.tooLong || target.tooLong)
        {
            if (SameText(text, path))
                return true;
            continue;
        }
        const bool byNameAlone = SameText(entry.extension, L"bundle") || SameText(entry.extension, L".omp");
        if (SameText(entry.name, target.name) && (byNameAlone || SameText(entry.folder, target.folder)))
            return true;
    }
    return false;
}

void WalkRemoves(const std::wstring& path, PathList& list)
{
    const auto first = std::find_if(list.begin(), list.end(),
                                    [&path](const std::wstring& entry) { return SameText(entry, path); });
    if (first != list.end())
        list.erase(first);
}

// PathList of few parts, so that a list holds the same application often, in many spellings.
class RandomPaths
{
public:
    explicit RandomPaths(unsigned seed) : mRandom(seed) {}

    std::wstring Next() { return Any(kDrives) + Any(kFolders) + Any(kNames) + Any(kExtensions); }
    unsigned Below(unsigned end) { return static_cast<unsigned>(mRandom() % end); }

private:
    const std::wstring& Any(const PathList& choices) { return choices[mRandom() % choices.size()]; }

    static const PathList kDrives;
    static const PathList kFolders;
    static const PathList kNames;
    static const PathList kExtensions;

    std::mt19937 mRandom;
};

// The Kelvin sign is a letter K that is not ASCII and folds to one that is.
const PathList RandomPaths::kDrives = {L"", L"", L"", L"C:", L"c:", L"K:", L"k:", L"\u212A:", L"CC:"};
const PathList RandomPaths::kFolders = {L"",
                                        L"/",
                                        L"\\",
                                        L"/apps/",
                                        L"/APPS/",
                                        L"\\apps\\",
                                        L"/apps\\",
                                        L"/äpfel.d/",
                                        L"/ÄPFEL.D/",
                                        L"\\\\server\\σας\\",
                                        L"\\\\SERVER\\ΣΑΣ\\",
                                        L"/" + std::wstring(1100, L'f') + L"/"};
const PathList RandomPaths::kNames = {L"",      L"tool",   L"TOOL",   L"Tööl",
                                      L"tÖÖL",  L"straße", L"STRAẞE", L"to.ol",
                                      L"TO.OL", L"tool ",  L"100%s",  std::wstring(300, L'n')};
const PathList RandomPaths::kExtensions = {
    L"",     L".",    L".omp", L".OMP",   L".Omp", L".bundle", L".BUNDLE",
    L".lsp", L".LSP", L"omp",  L"bundle", L".om",  L".oMp ",   L"." + std::wstring(300, L'x')};

CStdStr Text(const std::wstring& text)
{
    return CStdStr(text);
}

void ExpectSameEntries(const PathList& expected, const CStringList& list)
{
    ASSERT_EQ(expected.size(), list.GetCount());
    auto entry = list.begin();
    for (const std::wstring& text : expected)
        ASSERT_EQ(text, (entry++)->Text());
}

class ListMatching : public testing::TestWithParam<unsigned>
{
};
} // namespace

TEST_P(ListMatching, AnswersLikeAPlainWalkWhateverIsAppendedAndRemoved)
{
    RandomPaths random(GetParam());
    PathList expected;
    CStringList list;
    int found = 0;
    int missed = 0;
    for (int step = 0; step < 3000; ++step)
    {
        const std::wstring path = random.Next();
        const unsigned action = random.Below(100);
        if (action < 30)
        {
            expected.push_back(path);
            list.AddTail(Text(path));
        }
        else if (action < 55)
        {
            WalkRemoves(path, expected);
            ModrigUtils::RemoveInSpecificList(Text(path), list);
            ExpectSameEntries(expected, list);
        }
        else if (action == 99 && random.Below(10) == 0)
        {
            expected.clear();
            list.RemoveAll();
        }
        const std::wstring asked = random.Next();
        const bool walkFinds = WalkFinds(asked, expected);
        ASSERT_EQ(walkFinds, ModrigUtils::FoundinSpecificList(Text(asked), list))
            << "step " << step << ", asked for " << testing::PrintToString(asked);
        ++(walkFinds ? found : missed);
    }
    EXPECT_GT(found, 100);
    EXPECT_GT(missed, 100);
}

TEST_P(ListMatching, FindsAndRemovesEveryEntryOfALargeList)
{
    RandomPaths random(GetParam() + 1000);
    PathList expected;
    CStringList list;
    for (int i = 0; i < 400; ++i)
    {
        expected.push_back(random.Next());
        list.AddTail(Text(expected.back()));
    }
    while (!expected.empty())
    {
        const std::wstring path = expected[random.Below(static_cast<unsigned>(expected.size()))];
        ASSERT_TRUE(ModrigUtils::FoundinSpecificList(Text(path), list));
        WalkRemoves(path, expected);
        ModrigUtils::RemoveInSpecificList(Text(path), list);
        ExpectSameEntries(expected, list);
    }
    EXPECT_TRUE(list.IsEmpty());
}

INSTANTIATE_TEST_SUITE_P(RandomLists, ListMatching, testing::Range(1u, 9u));
