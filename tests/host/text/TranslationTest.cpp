// What the host says in other languages, from catalogues that are made for these tests.
#include <gtest/gtest.h>

#include <cstdlib>
#include <string>
#include <vector>

#include "host/text/Translation.h"
#include "tests/support/TemporaryFolder.h"

namespace
{
using tessel::hasPlacesFor;
using tessel::translated;
using tessel::translatedByCount;

constexpr char kHead[] = "msgid \"\"\nmsgstr \"\"\n"
                         "\"Content-Type: text/plain; charset=UTF-8\\n\"\n"
                         "\"Plural-Forms: nplurals=3; plural=n==1 ? 0 : n%10==1 ? 1 : 2;\\n\"\n\n";

class Translation : public testing::Test
{
protected:
    ~Translation() override { tessel::useTranslations({}, {}); }

    void addCatalogue(const std::string& language, const std::string& sentences)
    {
        const std::string name = language + "/LC_MESSAGES/tessel";
        mFolder.write(name + ".po", kHead + sentences);
        const auto file = mFolder / name;
        const std::string made = "msgfmt -o '" + file.string() + ".mo' '" + file.string() + ".po'";
        ASSERT_EQ(std::system(made.c_str()), 0); // NOLINT(cert-env33-c): the names are our own
    }

    void use(const std::vector<std::string>& languages)
    {
        tessel::useTranslations(mFolder.path(), languages);
    }

    TemporaryFolder mFolder;
};

std::wstring greeting()
{
    return translated(L"Good morning");
}

TEST_F(Translation, IsTheEnglishWithoutACatalogue)
{
    use({"de"});
    EXPECT_EQ(greeting(), L"Good morning");
    EXPECT_EQ(translated(L"{} of {} in {}", 1, L"two", std::filesystem::path("/a/b")), L"1 of two in /a/b");
    EXPECT_EQ(translatedByCount(1, L"{} start in {}", L"{} starts in {}", 7), L"1 start in 7");
    EXPECT_EQ(translatedByCount(0, L"{} start in {}", L"{} starts in {}", 7), L"0 starts in 7");
}

TEST_F(Translation, IsThatOfTheFirstLanguageWithACatalogue)
{
    addCatalogue("de", "msgid \"Good morning\"\nmsgstr \"Guten Morgen – schön\"\n");
    addCatalogue("fr", "msgid \"Good morning\"\nmsgstr \"Bonjour\"\n");
    use({"it", "de_AT", "de", "fr"});
    EXPECT_EQ(greeting(), L"Guten Morgen – schön");
    EXPECT_EQ(translated(L"Good evening"), L"Good evening");
    use({"it"});
    EXPECT_EQ(greeting(), L"Good morning");
}

TEST_F(Translation, StopsAtEnglishUnlessThatHasACatalogueOfItsOwn)
{
    addCatalogue("de", "msgid \"Good morning\"\nmsgstr \"Guten Morgen\"\n");
    addCatalogue("en_AU", "msgid \"Good morning\"\nmsgstr \"G'day\"\n");
    use({"en_GB", "de"});
    EXPECT_EQ(greeting(), L"Good morning");
    use({"en", "de"});
    EXPECT_EQ(greeting(), L"Good morning");
    use({"en_AU", "en", "de"});
    EXPECT_EQ(greeting(), L"G'day");
}

TEST_F(Translation, PutsThingsInWhereItsLanguageWantsThem)
{
    addCatalogue("de", "msgid \"{} of {}\"\nmsgstr \"{2}: {1}, {2}\"\n");
    use({"de"});
    EXPECT_EQ(translated(L"{} of {}", L"{2}{}", L"b"), L"b: {2}{}, b");
}

TEST_F(Translation, FollowsThePluralsOfItsLanguage)
{
    addCatalogue("xx", "msgid \"{} start\"\nmsgid_plural \"{} starts\"\n"
                       "msgstr[0] \"{} a\"\nmsgstr[1] \"{} b\"\nmsgstr[2] \"{} c\"\n");
    use({"xx"});
    EXPECT_EQ(translatedByCount(1, L"{} start", L"{} starts"), L"1 a");
    EXPECT_EQ(translatedByCount(21, L"{} start", L"{} starts"), L"21 b");
    EXPECT_EQ(translatedByCount(22, L"{} start", L"{} starts"), L"22 c");
}

TEST_F(Translation, CountsAsMissingWhenItsPlacesDoNotFit)
{
    addCatalogue("de", "msgid \"{} of {}\"\nmsgstr \"{} nur\"\n\n"
                       "msgid \"{} and {}\"\nmsgstr \"{1} und {3}\"\n\n"
                       "msgid \"{} or {}\"\nmsgstr \"{1} oder {}\"\n");
    use({"de"});
    EXPECT_EQ(translated(L"{} of {}", 1, 2), L"1 of 2");
    EXPECT_EQ(translated(L"{} and {}", 1, 2), L"1 and 2");
    EXPECT_EQ(translated(L"{} or {}", 1, 2), L"1 or 2");
}

TEST_F(Translation, LeavesATextOfSomebodyElsesAsItIs)
{
    EXPECT_EQ(tessel::translateAndFill(L"SET {} {} | CLEAR {2}", {}), L"SET {} {} | CLEAR {2}");
    EXPECT_EQ(tessel::translateAndFill(L"SET {}", {L"one", L"two"}), L"SET {}");
}

TEST_F(Translation, OfNothingIsNothing)
{
    addCatalogue("de", "msgid \"Good morning\"\nmsgstr \"Guten Morgen\"\n");
    use({"de"});
    EXPECT_EQ(translated(L""), L"");
}

TEST_F(Translation, GoesOnToTheNextLanguageAfterADamagedCatalogue)
{
    addCatalogue("fr", "msgid \"Good morning\"\nmsgstr \"Bonjour\"\n");
    mFolder.write("de/LC_MESSAGES/tessel.mo", "\xde\x12\x04\x95 and no catalogue");
    use({"de", "fr"});
    EXPECT_EQ(greeting(), L"Bonjour");
}

TEST(Places, AreOneForEachThing)
{
    EXPECT_TRUE(hasPlacesFor(0, L"{ } {0} {a} {10} { {1"));
    EXPECT_TRUE(hasPlacesFor(2, L"{}{}"));
    EXPECT_FALSE(hasPlacesFor(2, L"{}"));
    EXPECT_FALSE(hasPlacesFor(1, L"{} {}"));
}

TEST(Places, HaveAllNumbersOrNone)
{
    EXPECT_TRUE(hasPlacesFor(2, L"{2}{1}{2}"));
    EXPECT_TRUE(hasPlacesFor(9, L"{1}{2}{3}{4}{5}{6}{7}{8}{9}"));
    EXPECT_FALSE(hasPlacesFor(2, L"{2}"));
    EXPECT_FALSE(hasPlacesFor(1, L"{1}{2}"));
    EXPECT_FALSE(hasPlacesFor(2, L"{1}{}"));
}
} // namespace
