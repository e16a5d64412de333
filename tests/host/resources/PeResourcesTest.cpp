#include "host/resources/PeResources.h"

#include <algorithm>
#include <cstdio>
#include <filesystem>
#include <random>

#include <LIEF/PE.hpp>
#include <gtest/gtest.h>

#include "tests/support/Content.h"

using tessel::PeResources;
using Bytes = std::vector<std::uint8_t>;

namespace
{
constexpr unsigned kIdsAfterTheLast = 0x10010;
constexpr tessel::LanguageNumber kEnglishTexts = 0x0409;
constexpr tessel::LanguageNumber kGermanTexts = 0x0407;
constexpr tessel::LanguageNumber kFrenchTexts = 0x000c;

Bytes bytesOf(const std::filesystem::path& path)
{
    const std::string content = contentOf(path);
    return {content.begin(), content.end()};
}

Bytes texts()
{
    return bytesOf(TEXTS_DLL);
}

tessel::Result<PeResources> read(Bytes bytes)
{
    return PeResources::read(std::move(bytes));
}

std::wstring whyNot(Bytes bytes)
{
    const auto resources = read(std::move(bytes));
    EXPECT_FALSE(resources);
    return resources.sentence();
}

// Sixteen UTF-16 texts after their lengths.
template <typename Data>
std::map<unsigned, std::u16string> textsIn(const Data& data, unsigned firstId)
{
    std::map<unsigned, std::u16string> result;
    std::size_t at = 0;
    for (unsigned i = 0; i < 16; ++i)
    {
        const auto unit = [&]
        {
            return static_cast<char16_t>(data.at(at) | data.at(at + 1) << 8);
        };
        std::u16string& text = result[firstId + i];
        const std::size_t length = unit();
        for (at += 2; text.size() < length; at += 2)
            text += unit();
    }
    return result;
}

// Every text of a language by an independent reader.
std::map<unsigned, std::u16string> textsByTheOtherReader(const Bytes& bytes, tessel::LanguageNumber language)
{
    std::map<unsigned, std::u16string> result;
    const auto binary = LIEF::PE::Parser::parse(bytes);
    const auto& tables = binary->resources_manager().get_node_type(LIEF::PE::RESOURCE_TYPES::STRING);
    for (const auto& table : tables.childs())
        for (const auto& leaf : table.childs())
            if (leaf.id() == language)
                result.merge(textsIn(dynamic_cast<const LIEF::PE::ResourceData&>(leaf).content(),
                                     (table.id() - 1) * 16));
    return result;
}

std::u16string utf16(const std::wstring& text)
{
    std::u16string result;
    for (const wchar_t character : text)
    {
        const auto point = static_cast<std::uint32_t>(character);
        if (point >= 0x10000)
            result += static_cast<char16_t>(0xd7c0 + (point >> 10));
        result += static_cast<char16_t>(point >= 0x10000 ? 0xdc00 + (point & 0x3ff) : point);
    }
    return result;
}

// Asks for texts of every block, for the last of each: to find it, the reader goes through the whole block. A
// reader that trusted the file would read what is not there.
std::size_t charactersIn(const PeResources& resources)
{
    std::size_t characters = 0;
    for (const auto language : resources.languages())
    {
        for (unsigned last = 15; last < kIdsAfterTheLast; last += 16)
            characters += resources.string(last, language).size();
        for (unsigned id = 0; id < 64; ++id)
            characters += resources.string(id, language).size();
    }
    return characters;
}
void put16(Bytes& bytes, std::size_t at, std::size_t number)
{
    bytes[at] = static_cast<std::uint8_t>(number);
    bytes[at + 1] = static_cast<std::uint8_t>(number >> 8);
}

void put32(Bytes& bytes, std::size_t at, std::size_t number)
{
    put16(bytes, at, number & 0xffff);
    put16(bytes, at + 2, number >> 16);
}

// A library of one section, from its beginning to the tree of its resources, which is empty as yet.
constexpr std::size_t kTreeAt = 0x200;
Bytes libraryWithTree(std::size_t treeSize)
{
    Bytes bytes(kTreeAt + treeSize);
    put16(bytes, 0, 0x5a4d);
    put32(bytes, 0x3c, 0x40);
    put32(bytes, 0x40, 0x4550);
    put16(bytes, 0x46, 1);            // section
    put16(bytes, 0x54, 240);          // size of the optional header
    put16(bytes, 0x58, 0x20b);        // 64 bits
    put32(bytes, 0x58 + 108, 16);     // directories
    put32(bytes, 0x58 + 128, 0x1000); // resources
    put32(bytes, 0x58 + 132, treeSize);
    constexpr std::size_t kSection = 0x58 + 240;
    for (const auto& [field, value] :
         {std::pair<std::size_t, std::size_t>{8, treeSize}, {12, 0x1000}, {16, treeSize}, {20, kTreeAt}})
        put32(bytes, kSection + field, value);
    return bytes;
}

// Hundreds of blocks that all have the same hundreds of languages, which all have the same texts.
Bytes resourcesWithSharedNodes()
{
    constexpr std::size_t kMany = 500;
    constexpr std::size_t kBlocks = 24;
    constexpr std::size_t kLanguages = kBlocks + 16 + kMany * 8;
    constexpr std::size_t kLeaf = kLanguages + 16 + kMany * 8;
    constexpr std::size_t kNode = 0x80000000;
    Bytes bytes = libraryWithTree(kLeaf + 16 + 32);
    const auto entry = [&](std::size_t node, std::size_t index, std::size_t number, std::size_t target)
    {
        put16(bytes, kTreeAt + node + 14, index + 1);
        put32(bytes, kTreeAt + node + 16 + index * 8, number);
        put32(bytes, kTreeAt + node + 20 + index * 8, target);
    };
    entry(0, 0, 6, kNode | kBlocks);
    for (std::size_t i = 0; i < kMany; ++i)
    {
        entry(kBlocks, i, i + 1, kNode | kLanguages);
        entry(kLanguages, i, i + 1, kLeaf);
    }
    put32(bytes, kTreeAt + kLeaf, 0x1000 + kLeaf + 16);
    put32(bytes, kTreeAt + kLeaf + 4, 32);
    return bytes;
}
} // namespace

TEST(PeResources, GivesEveryTextAsItWasWritten)
{
    const auto resources = read(texts());
    ASSERT_TRUE(resources);
    EXPECT_EQ(resources->string(1, kEnglishTexts), L"Load/Unload Applications");
    EXPECT_EQ(resources->string(2, kEnglishTexts), L"%s \"quoted\" 100%% \\ tab\there");
    EXPECT_EQ(resources->string(15, kEnglishTexts), L"Größe, çà, Ελλάδα");
    EXPECT_EQ(resources->string(16, kEnglishTexts), L"漢字とかな");
    EXPECT_EQ(resources->string(51, kEnglishTexts), L"\U0001F600 and \U0001F680\U0001F680");
    EXPECT_EQ(resources->string(65535, kEnglishTexts), L"the last");
    EXPECT_EQ(resources->string(4000, kEnglishTexts).size(), 600U);
}

TEST(PeResources, GivesNothingForIdsThatAreNotThere)
{
    const auto resources = read(texts());
    ASSERT_TRUE(resources);
    for (const unsigned id : {0U, 3U, 17U, 50U, 52U, 9999U, 65534U, 65536U, 65537U, 0xffffffffU})
        EXPECT_EQ(resources->string(id, kEnglishTexts), L"") << id;
}

TEST(PeResources, AgreesWithAnotherReaderAboutEveryTextOfEveryLanguage)
{
    const auto resources = read(texts());
    ASSERT_TRUE(resources);
    for (const auto language : {kEnglishTexts, kGermanTexts, kFrenchTexts})
    {
        const auto others = textsByTheOtherReader(texts(), language);
        EXPECT_GE(others.size(), 16U);
        for (unsigned id = 0; id < kIdsAfterTheLast; ++id)
        {
            const auto other = others.find(id);
            ASSERT_EQ(utf16(resources->string(id, language)), other == others.end() ? u"" : other->second)
                << id;
        }
    }
}

// The tree has them by their numbers, by which French would be the first.
TEST(PeResources, NamesTheLanguagesInTheOrderOfTheScript)
{
    const auto resources = read(texts());
    ASSERT_TRUE(resources);
    EXPECT_EQ(resources->languages(), std::vector({kEnglishTexts, kGermanTexts, kFrenchTexts}));
}

TEST(PeResources, GivesTheTextsOfOneLanguageOnly)
{
    const auto resources = read(texts());
    ASSERT_TRUE(resources);
    EXPECT_EQ(resources->string(1, kGermanTexts), L"Anwendungen laden/entladen");
    EXPECT_EQ(resources->string(2, kGermanTexts), L"");  // in a block that has others
    EXPECT_EQ(resources->string(16, kGermanTexts), L""); // in no block
    EXPECT_EQ(resources->string(1, 0x0c07), L"");        // no text of Austria's own
    EXPECT_EQ(resources->string(5, kFrenchTexts), L"Délier");
}

TEST(PeResources, RefusesALanguageThatStandsThereTwice)
{
    Bytes damaged = texts();
    const Bytes german = {0x07, 0x04, 0, 0};
    const Bytes english = {0x09, 0x04, 0, 0};
    const auto found = std::search(damaged.begin(), damaged.end(), german.begin(), german.end());
    ASSERT_NE(found, damaged.end());
    std::copy(english.begin(), english.end(), found);
    EXPECT_EQ(whyNot(damaged), L"its resources are damaged");
}

// Were it read, a file of a megabyte could name the same texts billions of times.
TEST(PeResources, RefusesATreeWhoseEntriesShareTheirPlaces)
{
    EXPECT_EQ(whyNot(resourcesWithSharedNodes()), L"its resources are damaged");
}

TEST(PeResources, SaysInWordsWhatIsWrong)
{
    EXPECT_EQ(whyNot({}), L"the file is cut short");
    EXPECT_EQ(whyNot({'M', 'Z'}), L"the file is cut short");
    EXPECT_EQ(whyNot(bytesOf("/proc/self/exe")), L"it is not a Windows library");
    EXPECT_EQ(whyNot(bytesOf(EMPTY_DLL)), L"it holds no resources");
}

TEST(PeResources, TakesAFileWithResourcesButWithoutTexts)
{
    const auto resources = read(bytesOf(NO_TEXTS_DLL));
    ASSERT_TRUE(resources);
    EXPECT_EQ(charactersIn(*resources), 0U);
}

TEST(PeResources, RefusesEveryBeginningOfAFile)
{
    const Bytes whole = texts();
    for (std::size_t length = 0; length < whole.size(); ++length)
        ASSERT_EQ(whyNot(Bytes(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length))),
                  L"the file is cut short")
            << length << " of " << whole.size();
}

TEST(PeResources, RefusesOrAnswersWhateverIsChangedInAFile)
{
    const Bytes whole = texts();
    std::mt19937 random(7);
    std::size_t refused = 0;
    for (int attempt = 0; attempt < 2000; ++attempt)
    {
        Bytes damaged = whole;
        for (std::size_t changes = 1 + random() % 8; changes > 0; --changes)
            damaged[random() % damaged.size()] = static_cast<std::uint8_t>(random());
        const auto resources = read(std::move(damaged));
        if (resources)
            EXPECT_LE(charactersIn(*resources), whole.size() * 16);
        else
        {
            EXPECT_NE(resources.sentence(), L"");
            ++refused;
        }
    }
    EXPECT_GT(refused, 100U);
}

// The first 1,024 bytes hold the headers and the tree: there every byte counts.
TEST(PeResources, RefusesOrAnswersForEveryValueOfEveryHeaderByte)
{
    const Bytes whole = texts();
    for (std::size_t offset = 0; offset < 1024; ++offset)
        for (const int value : {0x00, 0x01, 0x7f, 0x80, 0xff})
        {
            Bytes damaged = whole;
            damaged[offset] = static_cast<std::uint8_t>(value);
            const auto resources = read(std::move(damaged));
            ASSERT_EQ(static_cast<bool>(resources), resources.sentence().empty()) << offset;
            ASSERT_LE(resources ? resources->string(1, kEnglishTexts).size() : 0, whole.size()) << offset;
        }
}
