#include "host/resources/PeResources.h"

#include <algorithm>
#include <optional>
#include <utility>

#include "host/resources/ByteReader.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
// Of the file's headers.
constexpr std::uint16_t kDosMark = 0x5a4d;
constexpr std::size_t kPeOffsetAt = 0x3c;
constexpr std::uint32_t kPeMark = 0x4550;
constexpr std::size_t kOptionalHeaderAt = 24; // from the PE mark
constexpr std::uint16_t kMark32 = 0x10b;
constexpr std::uint16_t kMark64 = 0x20b;
constexpr std::size_t kDirectories32At = 96; // from the optional header
constexpr std::size_t kDirectories64At = 112;
constexpr std::size_t kDirectorySize = 8;
constexpr std::uint32_t kResourceDirectory = 2;
constexpr std::size_t kSectionHeaderSize = 40;

// Of the tree of resources: types, numbers, languages.
constexpr std::size_t kNodeSize = 16;
constexpr std::size_t kEntrySize = 8;
constexpr std::uint32_t kIsNode = 0x80000000;
constexpr std::uint32_t kStringTables = 6;
constexpr unsigned kTextsPerBlock = 16;
constexpr std::size_t kUnitSize = 2; // a UTF-16 code unit

constexpr auto kLibraryCutShort = Sentence(L"the file is cut short");
constexpr auto kNoWindowsLibrary = Sentence(L"it is not a Windows library");
constexpr auto kNoResources = Sentence(L"it holds no resources");
constexpr auto kBadSections = Sentence(L"its table of sections is damaged");
constexpr auto kBadTree = Sentence(L"its resources are damaged");
constexpr auto kBadTexts = Sentence(L"its string tables are damaged");

struct Extent
{
    std::size_t offset = 0;
    std::size_t size = 0;
};

struct Section
{
    std::uint32_t address = 0; // in memory
    std::uint32_t memorySize = 0;
    Extent inFile;
};

struct Headers
{
    std::uint32_t resourceAddress = 0;
    std::uint32_t resourceSize = 0;
    std::size_t sectionsAt = 0;
    unsigned sectionCount = 0;
};

std::size_t directoriesIn(const ByteReader& file, std::size_t optionalHeader)
{
    switch (file.u16(optionalHeader))
    {
    case kMark32:
        return optionalHeader + kDirectories32At;
    case kMark64:
        return optionalHeader + kDirectories64At;
    default:
        throw DamagedFile{kNoWindowsLibrary};
    }
}

Headers headersOf(const ByteReader& file)
{
    if (file.u16(0) != kDosMark)
        throw DamagedFile{kNoWindowsLibrary};
    const std::size_t mark = file.u32(kPeOffsetAt);
    if (file.u32(mark) != kPeMark)
        throw DamagedFile{kNoWindowsLibrary};
    const std::size_t optionalHeader = mark + kOptionalHeaderAt;
    const std::size_t directories = directoriesIn(file, optionalHeader);
    Headers headers;
    headers.sectionCount = file.u16(mark + 6);
    headers.sectionsAt = optionalHeader + file.u16(mark + 20);
    const std::uint32_t directoryCount = file.u32(directories - 4);
    const std::size_t entry = directories + kResourceDirectory * kDirectorySize;
    if (directoryCount <= kResourceDirectory || entry + kDirectorySize > headers.sectionsAt)
        throw DamagedFile{kNoResources};
    headers.resourceAddress = file.u32(entry);
    headers.resourceSize = file.u32(entry + 4);
    if (headers.resourceAddress == 0 || headers.resourceSize == 0)
        throw DamagedFile{kNoResources};
    return headers;
}

Section sectionAt(const ByteReader& file, std::size_t header)
{
    const Section section{
        file.u32(header + 12), file.u32(header + 8), {file.u32(header + 20), file.u32(header + 16)}};
    file.part(section.inFile.offset, section.inFile.size); // the file has to hold all of it
    return section;
}

// Where the file holds the tree of resources: from its root to the end of its section.
Extent resourcesIn(const ByteReader& file, const Headers& headers)
{
    std::optional<Extent> found;
    std::uint64_t freeFrom = 0; // sections follow one another in memory
    for (unsigned i = 0; i < headers.sectionCount; ++i)
    {
        const Section section = sectionAt(file, headers.sectionsAt + i * kSectionHeaderSize);
        if (section.address < freeFrom)
            throw DamagedFile{kBadSections};
        freeFrom = std::uint64_t{section.address} + section.memorySize;
        if (headers.resourceAddress < section.address ||
            headers.resourceAddress - section.address >= section.inFile.size)
            continue;
        const std::size_t distance = headers.resourceAddress - section.address;
        found = {section.inFile.offset + distance, section.inFile.size - distance};
    }
    if (!found || headers.resourceSize > found->size)
        throw DamagedFile{kBadSections};
    return *found;
}

// One node of the tree: its entries are named ones first, then numbered ones in rising order.
class Node
{
public:
    Node(const ByteReader& tree, std::size_t offset)
        : mTree(tree), mEntries(offset + kNodeSize), mNamed(tree.u16(offset + 12)),
          mCount(mNamed + tree.u16(offset + 14))
    {
        tree.part(mEntries, mCount * kEntrySize);
    }

    unsigned firstNumbered() const { return mNamed; }
    unsigned count() const { return mCount; }
    std::uint32_t number(unsigned entry) const { return mTree.u32(mEntries + entry * kEntrySize); }

    Node child(unsigned entry) const
    {
        const std::uint32_t target = mTree.u32(mEntries + entry * kEntrySize + 4);
        if ((target & kIsNode) == 0)
            throw DamagedFile{kBadTree};
        return {mTree, target & ~kIsNode};
    }
    // The offset of the description of what hangs here.
    std::size_t leaf(unsigned entry) const
    {
        const std::uint32_t target = mTree.u32(mEntries + entry * kEntrySize + 4);
        if ((target & kIsNode) != 0)
            throw DamagedFile{kBadTree};
        return target;
    }

private:
    const ByteReader& mTree;
    std::size_t mEntries;
    unsigned mNamed;
    unsigned mCount;
};

// The extent, in the tree, of the block that a node of languages holds for one of them.
Extent blockOf(const Node& languages, unsigned entry, const ByteReader& tree, std::uint32_t treeAddress)
{
    const std::size_t leaf = languages.leaf(entry);
    const std::uint32_t address = tree.u32(leaf);
    const std::uint32_t size = tree.u32(leaf + 4);
    if (address < treeAddress)
        throw DamagedFile{kBadTree};
    tree.part(address - treeAddress, size);
    return {address - treeAddress, size};
}

// Sixteen texts, each after its length, have to stand in the block.
void checkTexts(const ByteReader& block)
{
    std::size_t offset = 0;
    for (unsigned i = 0; i < kTextsPerBlock; ++i)
    {
        const std::size_t size = kUnitSize + block.u16(offset) * kUnitSize;
        block.part(offset, size);
        offset += size;
    }
}

// The blocks of texts, by languages and by their numbers, and where each begins in the tree.
class TextTables
{
public:
    using Blocks = std::map<LanguageNumber, std::map<unsigned, std::size_t>>;

    TextTables(std::span<const std::uint8_t> bytes, std::uint32_t treeAddress)
        : mTree(bytes, kBadTree), mTreeAddress(treeAddress)
    {
    }

    Blocks read()
    {
        const Node types(mTree, 0);
        for (unsigned type = types.firstNumbered(); type < types.count(); ++type)
            if (types.number(type) == kStringTables)
                readTables(types.child(type));
        return std::move(mBlocks);
    }

private:
    void readTables(const Node& tables)
    {
        for (unsigned i = tables.firstNumbered(); i < tables.count(); ++i)
        {
            const unsigned number = tables.number(i);
            if (number <= mLastNumber)
                throw DamagedFile{kBadTree};
            mLastNumber = number;
            readLanguages(tables.child(i), number);
        }
    }

    void readLanguages(const Node& languages, unsigned number)
    {
        if (languages.firstNumbered() == languages.count())
            throw DamagedFile{kBadTree};
        for (unsigned i = languages.firstNumbered(); i < languages.count(); ++i)
        {
            const Extent block = blockOf(languages, i, mTree, mTreeAddress);
            countEntry();
            checkTexts({mTree.part(block.offset, block.size), kBadTexts});
            if (!mBlocks[languages.number(i)].emplace(number, block.offset).second)
                throw DamagedFile{kBadTree}; // a language twice
        }
    }

    // Each entry has a place of its own. A tree whose nodes are hung up many times over would take for ever.
    void countEntry()
    {
        if (++mEntries * kEntrySize > mTree.size())
            throw DamagedFile{kBadTree};
    }

    ByteReader mTree;
    std::uint32_t mTreeAddress;
    Blocks mBlocks;
    unsigned mLastNumber = 0;
    std::size_t mEntries = 0;
};

std::size_t beginningOf(const std::map<unsigned, std::size_t>& blocks)
{
    return std::ranges::min_element(blocks, {}, [](const auto& block) { return block.second; })->second;
}

std::vector<LanguageNumber> inOrderOfTheFile(const TextTables::Blocks& blocks)
{
    std::vector<LanguageNumber> languages;
    for (const auto& ofALanguage : blocks)
        languages.push_back(ofALanguage.first);
    std::ranges::stable_sort(languages, {},
                             [&](LanguageNumber language) { return beginningOf(blocks.at(language)); });
    return languages;
}

std::wstring decode(const ByteReader& units)
{
    std::u16string text;
    for (std::size_t at = 0; at < units.size(); at += kUnitSize)
        text += static_cast<char16_t>(units.u16(at));
    return toWide(text);
}
} // namespace

Result<PeResources> PeResources::read(std::vector<std::uint8_t> bytes)
try
{
    const ByteReader file(bytes, kLibraryCutShort);
    const Headers headers = headersOf(file);
    const Extent tree = resourcesIn(file, headers);
    PeResources result;
    result.mBlocks = TextTables(file.part(tree.offset, tree.size), headers.resourceAddress).read();
    result.mLanguages = inOrderOfTheFile(result.mBlocks);
    for (auto& ofALanguage : result.mBlocks)
        for (auto& block : ofALanguage.second)
            block.second += tree.offset;
    result.mBytes = std::move(bytes);
    return result;
}
catch (const DamagedFile& damage)
{
    return Failure{translated(damage.why)};
}

std::wstring PeResources::string(unsigned id, LanguageNumber language) const
{
    const auto blocks = mBlocks.find(language);
    if (blocks == mBlocks.end())
        return {};
    const auto block = blocks->second.find(id / kTextsPerBlock + 1);
    if (block == blocks->second.end())
        return {};
    const ByteReader file(mBytes, kBadTexts); // checked when the file was read: nothing is outside
    std::size_t offset = block->second;
    for (unsigned i = 0; i < id % kTextsPerBlock; ++i)
        offset += kUnitSize + file.u16(offset) * kUnitSize;
    return decode({file.part(offset + kUnitSize, file.u16(offset) * kUnitSize), kBadTexts});
}
} // namespace tessel
