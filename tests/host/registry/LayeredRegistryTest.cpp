// A person's own registry between what an administrator lays out for everybody.
#include <gmock/gmock.h>
#include <wincompat/winreg.h>

#include "host/registry/LayeredRegistry.h"
#include "host/text/Unicode.h"
#include "tests/host/support/RegistryHost.h"

using tessel::Registry;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

namespace
{
const std::string kFirstLines = "Windows Registry Editor Version 5.00\n\n";

class Layers : public testing::Test
{
protected:
    void layOut(const std::string& file, const std::string& text)
    {
        host.folder().write(file, kFirstLines + text);
        start();
    }
    void start()
    {
        host.layOut({host.folder() / "far", host.folder() / "near"});
        host.open();
    }
    void store(const wchar_t* path, const wchar_t* name, const wchar_t* data)
    {
        EXPECT_TRUE(host.registry().write(path, name, data));
        EXPECT_TRUE(host.registry().endOfCommand());
    }
    std::string read(const wchar_t* path, const wchar_t* name)
    {
        return tessel::toUtf8(host.layered().read(path, name).value_or(L"(none)"));
    }
    std::string own(const wchar_t* path, const wchar_t* name)
    {
        return tessel::toUtf8(host.registry().read(path, name).value_or(L"(none)"));
    }
    std::vector<std::string> listed(const wchar_t* path)
    {
        std::vector<std::string> lines;
        for (const auto& value : host.layered().values(host.layered().find(path)))
            lines.push_back(tessel::toUtf8(value.name + L"=" + value.data) + "@" +
                            value.file.filename().string());
        return lines;
    }
    std::vector<std::string> subKeys(const wchar_t* path)
    {
        std::vector<std::string> names;
        for (const auto& name : host.layered().subKeys(host.layered().find(path)))
            names.push_back(tessel::toUtf8(name));
        return names;
    }
    std::string said() const
    {
        std::string all;
        for (const auto& sentence : host.saidOfLayers())
            all += tessel::toUtf8(sentence) + "\n";
        return all;
    }

    RegistryHost host;
};
} // namespace

TEST_F(Layers, GivesWhatIsLaidOutToWhoHasNothing)
{
    layOut("near/a.reg", "[HKCU\\Soft\\App]\n\"Name\"=\"default\"\n@=\"unnamed\"\n");
    EXPECT_EQ(read(L"soft\\APP", L"name"), "default");
    EXPECT_EQ(read(L"Soft\\App", L""), "unnamed");
    EXPECT_EQ(read(L"Soft\\App", L"other"), "(none)");
    EXPECT_EQ(own(L"Soft\\App", L"Name"), "(none)");
    EXPECT_EQ(host.layered().find(L"Soft\\Other"), Registry::kNoKey);
}

TEST_F(Layers, PutsThePersonsOwnValuesBeforeDefaultsAndAfterPolicy)
{
    layOut("near/a.reg", "[HKCU\\K]\n\"a\"=\"default\"\n\"b\"=\"default\"\n\"c\"=\"default\"\n");
    layOut("near/policy/a.reg", "[HKCU\\K]\n\"c\"=\"policy\"\n\"d\"=\"policy\"\n");
    store(L"K", L"B", L"own");
    store(L"K", L"C", L"own");
    EXPECT_EQ(read(L"K", L"a"), "default");
    EXPECT_EQ(read(L"K", L"b"), "own");
    EXPECT_EQ(read(L"K", L"c"), "policy");
    EXPECT_THAT(listed(L"K"), ElementsAre("B=own@", "c=policy@a.reg", "d=policy@a.reg", "a=default@a.reg"));
}

TEST_F(Layers, PutsLaterFoldersAndFilesBeforeEarlierOnes)
{
    host.folder().write("near/10.reg", kFirstLines +
                                           "[HKCU\\K]\n\"a\"=\"near 10\"\n\"b\"=\"near 10\"\n\"gone\"=\"x\"\n"
                                           "[HKCU\\K\\Gone\\Below]\n");
    host.folder().write("near/20.REG",
                        kFirstLines + "[HKCU\\K]\n\"b\"=\"near 20\"\n\"gone\"=-\n[-HKCU\\K\\Gone]\n");
    host.folder().write("near/30.txt", "no registry file");
    layOut("far/99.reg", "[HKCU\\K]\n\"A\"=\"far\"\n\"b\"=\"far\"\n\"c\"=\"far\"\n");
    EXPECT_THAT(listed(L"K"), ElementsAre("A=near 10@10.reg", "b=near 20@20.REG", "c=far@99.reg"));
    EXPECT_THAT(subKeys(L"K"), IsEmpty());
    EXPECT_EQ(said(), "");
}

TEST_F(Layers, HaveAnotherMarkAsSoonAsTheySayAnythingElse)
{
    start();
    EXPECT_EQ(host.layered().markOfLayers(), 0u);
    const auto markOf = [this](const std::string& data)
    {
        layOut("near/a.reg", "[HKCU\\K]\n\"a\"=\"" + data + "\"\n");
        return host.layered().markOfLayers();
    };
    const auto first = markOf("1");
    EXPECT_NE(first, 0u);
    EXPECT_NE(markOf("2"), first);
    EXPECT_EQ(markOf("1"), first);
    std::filesystem::create_directories(host.folder() / "near/policy");
    std::filesystem::rename(host.folder() / "near/a.reg", host.folder() / "near/policy/a.reg");
    start();
    EXPECT_NE(host.layered().markOfLayers(), first) << "policy is something else";
}

TEST_F(Layers, ListsTheKeysOfEveryLayerOnce)
{
    layOut("near/a.reg", "[HKCU\\K\\One]\n[HKCU\\K\\two]\n[HKCU\\K\\Three\\Deep]\n");
    layOut("near/policy/a.reg", "[HKCU\\K\\Four]\n");
    store(L"K\\Two", L"x", L"y");
    EXPECT_THAT(subKeys(L"K"), ElementsAre("Two", "Four", "One", "Three"));
}

TEST_F(Layers, WritesThePersonsOwnOnly)
{
    layOut("near/a.reg", "[HKCU\\K]\n\"a\"=\"default\"\n");
    EXPECT_TRUE(host.layered().write(L"K", L"a", L"mine"));
    EXPECT_EQ(read(L"K", L"a"), "mine");
    EXPECT_EQ(own(L"K", L"a"), "mine");
    const auto key = host.layered().find(L"K");
    EXPECT_TRUE(host.layered().removeValue(key, L"a"));
    EXPECT_EQ(read(L"K", L"a"), "default");
    EXPECT_EQ(host.layered().removeValue(key, L"a").code(), ERROR_FILE_NOT_FOUND);
    EXPECT_TRUE(host.layered().removeKey(key));
    EXPECT_EQ(read(L"K", L"a"), "default");
    EXPECT_TRUE(host.layered().removeKey(key)) << "of which nothing is the person's";
    EXPECT_EQ(said(), "");
}

TEST_F(Layers, TellsOnceOfAKeyThatWhatThePolicyLaysDownStays)
{
    layOut("near/policy/a.reg",
           "[HKCU\\K]\n\"a\"=\"policy\"\n\"b\"=\"policy\"\n[HKCU\\L]\n\"a\"=\"policy\"\n");
    EXPECT_TRUE(host.layered().write(L"K", L"a", L"policy"));
    EXPECT_EQ(said(), "") << "nothing differs";
    EXPECT_TRUE(host.layered().write(L"K", L"a", L"mine"));
    EXPECT_TRUE(host.layered().write(L"k", L"b", L"mine"));
    EXPECT_EQ(said(), "Values of \"K\" are laid down by the administrator, in " +
                          (host.folder() / "near/policy/a.reg").string() +
                          ": what is changed in them does not count.\n");
    EXPECT_TRUE(host.layered().write(L"L", L"a", L"mine"));
    EXPECT_THAT(said(), HasSubstr("\"L\""));
    EXPECT_EQ(read(L"K", L"a"), "policy");
    EXPECT_EQ(own(L"K", L"a"), "mine") << "it counts again once the policy has gone";
}

TEST_F(Layers, SaysWhichFileDoesNotCountAndTakesTheOthers)
{
    host.folder().write("near/bad.reg", "damaged");
    std::filesystem::create_directories(host.folder() / "near/policy/folder.reg");
    layOut("near/good.reg", "[HKCU\\K]\n\"a\"=\"default\"\n");
    EXPECT_EQ(read(L"K", L"a"), "default");
    ASSERT_EQ(host.layered().sentences().size(), 2U);
    EXPECT_EQ(tessel::toUtf8(host.layered().sentences()[0]),
              "The values for everybody in " + (host.folder() / "near/bad.reg").string() +
                  " do not count: in line 1 \"Windows Registry Editor Version 5.00\" is missing.");
    EXPECT_THAT(tessel::toUtf8(host.layered().sentences()[1]),
                HasSubstr("policy/folder.reg do not count: it is "));
}

TEST_F(Layers, IsWhatTheCallsOfApplicationsSee)
{
    layOut("near/a.reg", "[HKCU\\K]\n\"a\"=\"default\"\n");
    layOut("near/policy/a.reg", "[HKCU\\K\\Deep]\n\"p\"=\"policy\"\n");
    HKEY key = nullptr;
    ASSERT_EQ(RegOpenKeyExW(HKEY_CURRENT_USER, L"K", 0, KEY_READ, &key), ERROR_SUCCESS);
    HKEY deep = nullptr;
    ASSERT_EQ(RegOpenKeyExW(key, L"Deep", 0, KEY_READ, &deep), ERROR_SUCCESS);
    wchar_t data[20] = {};
    DWORD size = sizeof data;
    EXPECT_EQ(tsRegGetValue(deep, L"P", 0, nullptr, data, &size), ERROR_SUCCESS);
    EXPECT_EQ(std::wstring(data), L"policy");
    EXPECT_EQ(tsudRegSetString(key, L"a", L"mine"), ERROR_SUCCESS);
    size = sizeof data;
    EXPECT_EQ(tsRegGetValue(key, L"a", 0, nullptr, data, &size), ERROR_SUCCESS);
    EXPECT_EQ(std::wstring(data), L"mine");
    EXPECT_EQ(RegCloseKey(deep), ERROR_SUCCESS);
    EXPECT_EQ(RegCloseKey(deep), ERROR_INVALID_HANDLE);
    EXPECT_EQ(RegCloseKey(key), ERROR_SUCCESS);
    EXPECT_EQ(RegOpenKeyExW(HKEY_CURRENT_USER, L"No", 0, KEY_READ, &key), ERROR_FILE_NOT_FOUND);
}

TEST_F(Layers, TellsApplicationsWhatIsLaidDownAndWhere)
{
    layOut("near/a.reg", "[HKCU\\K]\n\"a\"=\"default\"\n");
    layOut("near/policy/a.reg", "[HKCU\\K]\n\"p\"=\"policy\"\n");
    HKEY key = nullptr;
    ASSERT_EQ(RegOpenKeyExW(HKEY_CURRENT_USER, L"K", 0, KEY_READ, &key), ERROR_SUCCESS);
    wchar_t place[300] = L"before";
    EXPECT_FALSE(tsRegIsLaidDown(key, L"a", place, 300));
    EXPECT_STREQ(place, L"before");
    EXPECT_TRUE(tsRegIsLaidDown(key, L"P", place, 300));
    EXPECT_EQ(tessel::toUtf8(place), (host.folder() / "near/policy/a.reg").string());
    EXPECT_TRUE(tsRegIsLaidDown(key, L"p", place, 4));
    EXPECT_EQ(tessel::toUtf8(place), (host.folder() / "near/policy/a.reg").string().substr(0, 3));
    EXPECT_TRUE(tsRegIsLaidDown(key, L"p", nullptr, 0));
    EXPECT_EQ(RegCloseKey(key), ERROR_SUCCESS);
    EXPECT_FALSE(tsRegIsLaidDown(key, L"p", nullptr, 0));
}

// Who replaces all values removes them one by one: those that cannot go would never end.
// As an application stores a list: all that it had goes, and all that it holds is written.
TEST_F(Layers, LeaveThePersonsOwnAsItWasWhereAnApplicationWritesWhatCountedBefore)
{
    const auto rewrite = [this](std::vector<std::pair<const wchar_t*, const wchar_t*>> values)
    {
        HKEY key = nullptr;
        EXPECT_EQ(RegCreateKeyEx(HKEY_CURRENT_USER, L"K", 0, nullptr, 0, KEY_WRITE, nullptr, &key, nullptr),
                  ERROR_SUCCESS);
        wchar_t name[20] = {};
        for (DWORD length = 20;
             RegEnumValueW(key, 0, name, &length, nullptr, nullptr, nullptr, nullptr) == ERROR_SUCCESS;
             length = 20)
            EXPECT_EQ(RegDeleteValueW(key, name), ERROR_SUCCESS);
        for (const auto& [valueName, data] : values)
            EXPECT_EQ(tsudRegSetString(key, valueName, data), ERROR_SUCCESS);
        EXPECT_EQ(RegCloseKey(key), ERROR_SUCCESS);
        EXPECT_TRUE(host.layered().endOfCommand());
    };
    layOut("near/a.reg", "[HKCU\\K]\n\"n\"=\"1\"\n\"a\"=\"default\"\n");
    rewrite({{L"a", L"default"}, {L"N", L"1"}});
    EXPECT_EQ(own(L"K", L"a") + own(L"K", L"n"), "(none)(none)");
    rewrite({{L"n", L"1"}, {L"a", L"mine"}});
    EXPECT_EQ(own(L"K", L"a") + own(L"K", L"n"), "mine1");
    rewrite({{L"n", L"1"}, {L"a", L"default"}});
    EXPECT_EQ(own(L"K", L"a") + own(L"K", L"n"), "default1") << "that was somebody's wish";
    rewrite({{L"n", L"1"}});
    EXPECT_EQ(own(L"K", L"a") + own(L"K", L"n"), "(none)1");
    rewrite({{L"n", L"1"}, {L"a", L"mine"}});
    layOut("near/policy/a.reg", "[HKCU\\K]\n\"n\"=\"1\"\n\"a\"=\"policy\"\n");
    rewrite({{L"n", L"1"}, {L"a", L"policy"}});
    EXPECT_EQ(own(L"K", L"a") + own(L"K", L"n"), "mine1");
    EXPECT_EQ(said(), "");
}

TEST_F(Layers, IsGoneThroughByIndexInThePersonsOwnValues)
{
    layOut("near/a.reg", "[HKCU\\K]\n\"a\"=\"default\"\n");
    HKEY key = nullptr;
    ASSERT_EQ(RegOpenKeyExW(HKEY_CURRENT_USER, L"K", 0, KEY_READ, &key), ERROR_SUCCESS);
    wchar_t name[20] = {};
    DWORD length = 20;
    EXPECT_EQ(RegEnumValueW(key, 0, name, &length, nullptr, nullptr, nullptr, nullptr), ERROR_NO_MORE_ITEMS);
    store(L"K", L"mine", L"1");
    length = 20;
    EXPECT_EQ(RegEnumValueW(key, 0, name, &length, nullptr, nullptr, nullptr, nullptr), ERROR_SUCCESS);
    EXPECT_EQ(std::wstring(name), L"mine");
    EXPECT_EQ(RegDeleteValueW(key, name), ERROR_SUCCESS);
    EXPECT_EQ(RegEnumValueW(key, 0, name, &length, nullptr, nullptr, nullptr, nullptr), ERROR_NO_MORE_ITEMS);
    EXPECT_EQ(RegDeleteValueW(key, L"a"), ERROR_FILE_NOT_FOUND);
    EXPECT_EQ(RegCloseKey(key), ERROR_SUCCESS);
}
