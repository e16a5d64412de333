#include <gmock/gmock.h>

#include "host/ui/platform/gnustep/filepanel/Listing.h"
#include "tests/support/TemporaryFolder.h"

using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;
using namespace tessel::filepanel;

namespace
{
std::vector<std::string> namesOf(const std::vector<Entry>& entries)
{
    std::vector<std::string> names;
    for (const Entry& entry : entries)
        names.push_back(entry.name);
    return names;
}

const KindWords kWords{"Mappe", "Paket", "Datei", "Datei (%@)"};

std::string kind(const Entry& entry)
{
    return kindOf(entry, kWords);
}

Entry file(const std::string& name, std::time_t changed = 0)
{
    Entry entry{name, sortKey(name), {}, false, false, changed};
    entry.kind = kind(entry);
    return entry;
}

Entry folder(const std::string& name)
{
    return {name, sortKey(name), kWords.folder, true, false, 0};
}

std::vector<std::string> sorted(std::vector<Entry> entries, Order order)
{
    sortEntries(entries, order);
    return namesOf(entries);
}
} // namespace

TEST(Listing, HoldsTheFilesOfTheFolderAndHiddenOnesWhenAsked)
{
    const TemporaryFolder place;
    place.write("a.lsp", "");
    place.write(".hidden.lsp", "");
    place.write("sub/inside.lsp", "");
    EXPECT_THAT(namesOf(readFolder(place.path(), false)), UnorderedElementsAre("a.lsp", "sub"));
    EXPECT_THAT(namesOf(readFolder(place.path(), true)), UnorderedElementsAre("a.lsp", ".hidden.lsp", "sub"));
    EXPECT_THAT(readFolder(place / "gone", true), IsEmpty());
}

TEST(Listing, KnowsFoldersAndLinksToThem)
{
    const TemporaryFolder place;
    place.write("sub/inside.lsp", "");
    place.write("a.lsp", "");
    std::filesystem::create_symlink(place / "sub", place / "link");
    std::filesystem::create_symlink(place / "gone", place / "broken");
    for (const Entry& entry : readFolder(place.path(), false))
        EXPECT_EQ(entry.name == "sub" || entry.name == "link", entry.isFolder) << entry.name;
}

TEST(Listing, IsSortedByNameWhateverTheCaseAndNumbersByTheirValue)
{
    EXPECT_THAT(sorted({file("b.lsp"), file("file10"), file("A.lsp"), file("file9"), file("file009a")}, {}),
                ElementsAre("A.lsp", "b.lsp", "file9", "file009a", "file10"));
}

TEST(Listing, HasFoldersFirstInEveryOrder)
{
    for (const Column column : {Column::kName, Column::kKind, Column::kDate})
        for (const bool descending : {false, true})
            EXPECT_EQ("zoo", sorted({file("a.lsp"), folder("zoo"), file("b.lsp")}, {column, descending})[0]);
    Entry package = folder("a.bundle");
    package.isPackage = true;
    EXPECT_THAT(sorted({package, folder("zoo")}, {}), ElementsAre("zoo", "a.bundle"));
}

TEST(Listing, IsSortedByKindAndByDateWithNamesAmongEquals)
{
    const std::vector<Entry> files = {file("b.zmb", 5), file("c.lsp", 1), file("a.zmb", 5)};
    EXPECT_THAT(sorted(files, {Column::kKind, false}), ElementsAre("c.lsp", "a.zmb", "b.zmb"));
    EXPECT_THAT(sorted(files, {Column::kDate, false}), ElementsAre("c.lsp", "a.zmb", "b.zmb"));
    EXPECT_THAT(sorted(files, {Column::kDate, true}), ElementsAre("a.zmb", "b.zmb", "c.lsp"));
    EXPECT_THAT(sorted(files, {Column::kName, true}), ElementsAre("c.lsp", "b.zmb", "a.zmb"));
}

TEST(Listing, TurnsItsOrderRoundWithTheSecondClickOnAHeader)
{
    Order order = afterClickOn(Column::kDate, {});
    EXPECT_EQ(Column::kDate, order.column);
    EXPECT_FALSE(order.descending);
    order = afterClickOn(Column::kDate, order);
    EXPECT_TRUE(order.descending);
    EXPECT_FALSE(afterClickOn(Column::kDate, order).descending);
    EXPECT_FALSE(afterClickOn(Column::kName, order).descending);
}

TEST(Listing, NamesKinds)
{
    EXPECT_EQ("Datei (LSP)", kind(file("a.lsp")));
    EXPECT_EQ("Datei (\\xFF)", kind(file("a.\xFF")));
    EXPECT_EQ("file", kindOf(file("a.lsp"), {"", "", "", "file"})) << "of a language that leaves it out";
    EXPECT_EQ("Datei", kind(file("README")));
    EXPECT_EQ("Datei", kind(file(".profile")));
    EXPECT_EQ("Datei", kind(file("a.")));
    EXPECT_EQ("Mappe", kind(folder("sub.lsp")));
    Entry package = folder("a.bundle");
    package.isPackage = true;
    EXPECT_EQ("Paket", kind(package));
}

TEST(Listing, ShowsOddNamesInOneLine)
{
    EXPECT_EQ("a\\nb\\x1B.lsp", shownName("a\nb\x1B.lsp"));
    EXPECT_EQ("Grün.lsp", shownName("Grün.lsp"));
    EXPECT_EQ("bad\\xE9 \\n.lsp", shownName("bad\xE9 \n.lsp"));
    EXPECT_EQ("Grün \\xC3\n\U0001F600", readableName("Grün \xC3\n\U0001F600"));
}

TEST(Listing, FindsTheRowOfTheFirstLettersAndGoesRound)
{
    const std::vector<Entry> files = {file("alpha"), file("beta"), file("Bravo"), file("charlie")};
    EXPECT_EQ(1u, rowBeginningLike(files, "b", 0));
    EXPECT_EQ(2u, rowBeginningLike(files, "b", 2));
    EXPECT_EQ(1u, rowBeginningLike(files, "b", 3));
    EXPECT_EQ(2u, rowBeginningLike(files, "BR", 0));
    EXPECT_EQ(std::nullopt, rowBeginningLike(files, "x", 0));
    EXPECT_EQ(std::nullopt, rowBeginningLike({}, "x", 0));
}

TEST(Listing, KeepsThePlaceOfARowThatGoes)
{
    const std::vector<Entry> before = {file("a"), file("b"), file("c"), file("d")};
    EXPECT_EQ(2u, rowInPlaceOf(before, 1, {file("a"), file("aa"), file("b"), file("d")}));
    EXPECT_EQ(1u, rowInPlaceOf(before, 1, {file("a"), file("c"), file("d")})) << "the next one that is left";
    EXPECT_EQ(0u, rowInPlaceOf(before, 3, {file("a")}));
    EXPECT_EQ(0u, rowInPlaceOf(before, 3, {}));
}

TEST(Listing, NoticesWhatComesIntoItsFolder)
{
    const TemporaryFolder place;
    const auto before = stateOf(place.path());
    EXPECT_EQ(before, stateOf(place.path()));
    std::filesystem::last_write_time(place.path(),
                                     std::filesystem::file_time_type::clock::now() - std::chrono::hours(1));
    EXPECT_NE(before, stateOf(place.path()));
    EXPECT_EQ(std::nullopt, stateOf(place / "gone"));
}
