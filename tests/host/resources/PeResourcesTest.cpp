#include "host/resources/PeResources.h"

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

// Every text of the file by an independent reader: a block holds sixteen UTF-16 texts after their lengths.
std::map<unsigned, std::u16string> textsByTheOtherReader(const Bytes& bytes)
{
    std::map<unsigned, std::u16string> result;
    const auto binary = LIEF::PE::Parser::parse(bytes);
    const auto& tables = binary->resources_manager().get_node_type(LIEF::PE::RESOURCE_TYPES::STRING);
    for (const auto& table : tables.childs())
    {
        const auto& data = dynamic_cast<const LIEF::PE::ResourceData&>(*table.childs().begin()).content();
        std::size_t at = 0;
        for (unsigned i = 0; i < 16; ++i)
        {
            const auto unit = [&]
            {
                return static_cast<char16_t>(data.at(at) | data.at(at + 1) << 8);
            };
            std::u16string& text = result[(table.id() - 1) * 16 + i];
            const std::size_t length = unit();
            for (at += 2; text.size() < length; at += 2)
                text += unit();
        }
    }
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
    for (unsigned last = 15; last < kIdsAfterTheLast; last += 16)
        characters += resources.string(last).size();
    for (unsigned id = 0; id < 64; ++id)
        characters += resources.string(id).size();
    return characters;
}
} // namespace

TEST(PeResources, GivesEveryTextAsItWasWritten)
{
    const auto resources = read(texts());
    ASSERT_TRUE(resources);
    EXPECT_EQ(resources->string(1), L"Load/Unload Applications");
    EXPECT_EQ(resources->string(2), L"%s \"quoted\" 100%% \\ tab\there");
    EXPECT_EQ(resources->string(15), L"Größe, çà, Ελλάδα");
    EXPECT_EQ(resources->string(16), L"漢字とかな");
    EXPECT_EQ(resources->string(51), L"\U0001F600 and \U0001F680\U0001F680");
    EXPECT_EQ(resources->string(65535), L"the last");
    EXPECT_EQ(resources->string(4000).size(), 600U);
}

TEST(PeResources, GivesNothingForIdsThatAreNotThere)
{
    const auto resources = read(texts());
    ASSERT_TRUE(resources);
    for (const unsigned id : {0U, 3U, 17U, 50U, 52U, 9999U, 65534U, 65536U, 65537U, 0xffffffffU})
        EXPECT_EQ(resources->string(id), L"") << id;
}

TEST(PeResources, AgreesWithAnotherReaderAboutEveryText)
{
    const auto resources = read(texts());
    ASSERT_TRUE(resources);
    const auto others = textsByTheOtherReader(texts());
    EXPECT_GE(others.size(), 7U);
    for (unsigned id = 0; id < kIdsAfterTheLast; ++id)
    {
        const auto other = others.find(id);
        ASSERT_EQ(utf16(resources->string(id)), other == others.end() ? u"" : other->second) << id;
    }
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
            ASSERT_LE(resources ? resources->string(1).size() : 0, whole.size()) << offset;
        }
}
