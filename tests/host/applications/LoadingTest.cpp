#include "host/messages/MessageBox.h"
#include "tests/host/support/HostWithModules.h"

#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <gmock/gmock.h>
#include <tessel/tsed.h>
#include <tessel/tsversion.h>

using testing::EndsWith;
using testing::HasSubstr;
using testing::StartsWith;

class Loading : public HostWithModules
{
};

TEST_F(Loading, SendsMessage1ToAPlainLibraryOfEitherKindAndToABundle)
{
    for (const char* name : {"Good.zmb", "Good.omp", "Good.bundle", "Classes.bundle"})
    {
        const auto path = fixture(name);
        EXPECT_TRUE(load(path));
        EXPECT_THAT(output(), StartsWith(name + std::string(": message 1\n")));
    }
    EXPECT_EQ(names(), L"Good.zmb Good.omp Good.bundle Classes.bundle ");
}

TEST_F(Loading, LetsAClassInABundleFindTheBundlesTexts)
{
    EXPECT_TRUE(load(std::filesystem::path(FIXTURE_MODULES) / "Classes.bundle"));
    EXPECT_EQ(output(), "Classes.bundle: message 1\nGrüße aus dem Bündel\n");
}

TEST_F(Loading, TakesNamesThatAreNoText)
{
    const auto place = mFolder / "r\xE9pertoire";
    std::filesystem::create_directory(place);
    std::filesystem::copy(std::filesystem::path(FIXTURE_MODULES) / "Good.zmb", place / "odd\xFF.zmb");
    std::filesystem::copy(std::filesystem::path(FIXTURE_MODULES) / "Classes.bundle", place / "odd\xFE.bundle",
                          std::filesystem::copy_options::recursive);
    EXPECT_TRUE(load(place / "odd\xFF.zmb"));
    EXPECT_TRUE(load(place / "odd\xFE.bundle"));
    EXPECT_EQ(output(), "odd\\xFF.zmb: message 1\nodd\\xFE.bundle: message 1\nGrüße aus dem Bündel\n");
    EXPECT_TRUE(unload(place / "odd\xFE.bundle"));
    EXPECT_TRUE(unload(place / "odd\xFF.zmb"));
    EXPECT_EQ(names(), L"");
}

TEST_F(Loading, TellsEachApplicationItsOwnPathAndTheOuterOneAgainAfterwards)
{
    fixture("Good.zmb");
    EXPECT_TRUE(load(fixture("LoadsAnother.zmb")));
    EXPECT_EQ(output(), "LoadsAnother.zmb: message 1\nGood.zmb: message 1\nLoadsAnother.zmb: message 1\n");
    EXPECT_STREQ(tsedGetAppName(), L"");
    EXPECT_EQ(names(), L"Good.zmb LoadsAnother.zmb ");
}

TEST_F(Loading, AnswersTrueAtOnceForAFileThatIsLoadedHoweverItsPathIsSpelled)
{
    const auto path = fixture("Good.zmb");
    const auto bundle = fixture("Good.bundle");
    std::filesystem::create_symlink(path, mFolder / "link.zmb");
    std::filesystem::create_symlink(bundle, mFolder / "link.bundle");
    std::filesystem::create_hard_link(path, mFolder / "hard.zmb");
    load(path);
    load(bundle);
    output();
    for (const auto& other :
         {path, bundle, mFolder / "link.zmb", mFolder / "link.bundle", mFolder / "hard.zmb",
          mFolder / "." / "Good.zmb", mFolder / "Good.bundle" / ".." / "Good.zmb", mFolder / "Good.bundle/",
          mFolder / "Good.bundle" / "Good"})
        EXPECT_TRUE(load(other)) << other;
    EXPECT_EQ(output(), "");
    EXPECT_EQ(names(), L"Good.zmb Good.bundle ");
}

TEST_F(Loading, ExplainsAFailureInTheBoxThatNamesTheFile)
{
    std::wstring detail;
    mShowBox = [&](const tessel::MessageBox::Box& shown)
    {
        detail = shown.detail;
        return IDOK;
    };
    const auto path = mFolder / "missing.zmb";
    EXPECT_FALSE(load(path));
    const std::string said = output();
    mMessageBox.show((tessel::toWide(path.native()) + L" was not loaded.").c_str(), MB_OK, nullptr);
    EXPECT_FALSE(detail.empty());
    EXPECT_EQ(said,
              "The application \"" + path.native() + "\" is not loaded: " + tessel::toUtf8(detail) + "\n");
}

TEST_F(Loading, LoadsWhatIsBuiltWithThisSdkOrAnEarlierOne)
{
    for (const char* name : {"SameSdk.zmb", "LastMajor.zmb"})
        EXPECT_TRUE(load(fixture(name))) << output();
    EXPECT_EQ(names(), L"SameSdk.zmb LastMajor.zmb ");
}

TEST_F(Loading, RefusesWhatIsBuiltWithANewerSdkBeforeTheSystemsLinkerNamesAFunction)
{
    const std::string major = std::to_string(TESSEL_SDK_VERSION_MAJOR);
    const std::string next = std::to_string(TESSEL_SDK_VERSION_MAJOR + 1);
    const std::string minor = "." + std::to_string(TESSEL_SDK_VERSION_MINOR);
    const std::string nextMinor = "." + std::to_string(TESSEL_SDK_VERSION_MINOR + 1);
    for (const auto& [name, version] :
         {std::pair("NextMajor.zmb", next + ".0"), std::pair("NextMinor.zmb", major + nextMinor)})
    {
        const auto path = fixture(name);
        EXPECT_FALSE(load(path));
        EXPECT_EQ(output(), "The application \"" + path.native() +
                                "\" is not loaded: it is built for version " + version +
                                " of the SDK, and this Tessel has " + major + minor +
                                "; it needs a newer Tessel, or to be built with the SDK of this one.\n");
    }
}

TEST_F(Loading, TakesARelativePathFromTheCurrentFolder)
{
    const auto path = fixture("Good.zmb");
    const auto before = std::filesystem::current_path();
    std::filesystem::current_path(mFolder.path());
    EXPECT_TRUE(load("Good.zmb"));
    std::filesystem::current_path(before);
    ASSERT_EQ(mLinker.loadedModules().size(), 1U);
    EXPECT_EQ(mLinker.loadedModules()[0].path, tessel::toWide(path.native()));
}

TEST_F(Loading, StillKnowsALoadedApplicationWhoseFileHasBeenRemovedOrReplaced)
{
    const auto path = fixture("Good.zmb");
    load(path);
    output();
    std::filesystem::remove(path);
    EXPECT_TRUE(load(path));
    fixture("Good.zmb");
    EXPECT_TRUE(load(path));
    EXPECT_EQ(output(), "");
}

TEST_F(Loading, SaysInWordsWhatStandsInTheFilesPlace)
{
    std::filesystem::create_directory(mFolder / "folder.zmb");
    std::filesystem::create_directory(mFolder / "hollow.bundle");
    ASSERT_EQ(mkfifo((mFolder / "pipe.zmb").c_str(), 0600), 0);
    mFolder.write("empty.zmb", "");
    mFolder.write("text.zmb", "Once upon a time there was a file that was long enough to hold a header of "
                              "any kind, and yet it held nothing of the sort.");
    mFolder.write("file.bundle", "not a folder");
    std::filesystem::copy("/bin/true", mFolder / "program.zmb");
    const std::pair<const char*, const char*> cases[] = {
        {"nothing.zmb", "No such file or directory"},
        {"nothing.bundle", "No such file or directory"},
        {"folder.zmb", "it is a folder, not a file"},
        {"hollow.bundle", "the bundle holds no program for this system"},
        {"file.bundle", "it is a file, and a bundle is a folder"},
        {"pipe.zmb", "it is not an ordinary file"},
        {"empty.zmb", "the file is empty"},
        {"text.zmb", "it is not a shared library"},
        {"program.zmb", "it is a program, not a shared library"}};
    for (const auto& [name, whyNot] : cases)
    {
        EXPECT_FALSE(load(mFolder / name));
        EXPECT_EQ(output(), notLoaded(mFolder / name, whyNot));
    }
    EXPECT_EQ(names(), L"");
}

TEST_F(Loading, ChecksTheProgramInABundleToo)
{
    const auto bundle = fixture("Classes.bundle");
    std::filesystem::resize_file(bundle / "Classes", 5000);
    EXPECT_FALSE(load(bundle));
    EXPECT_EQ(output(), notLoaded(bundle, "its program \"" + (bundle / "Classes").string() +
                                              "\" cannot be used, since the file is cut short"));
}

TEST_F(Loading, PassesOnTheSystemLinkersOwnWords)
{
    const auto unresolved = fixture("Unresolved.zmb");
    EXPECT_FALSE(load(unresolved));
    EXPECT_EQ(output(), notLoaded(unresolved, "undefined symbol: aFunctionThatNobodyHas"));
    const auto dependent = fixture("MissingDependency.zmb");
    EXPECT_FALSE(load(dependent));
    EXPECT_EQ(output(), notLoaded(dependent, "libfixture_absent.so: cannot open shared object file: No such "
                                             "file or directory"));
    EXPECT_FALSE(isMapped(unresolved));
}

TEST_F(Loading, FindsAMissingFunctionInABundleWithObjectiveCBeforeItRuns)
{
    for (const char* name : {"UnresolvedClasses.bundle", "ReadOnlyUnresolved.bundle"})
    {
        const auto bundle = fixture(name);
        EXPECT_FALSE(load(bundle));
        EXPECT_EQ(output(), notLoaded(bundle, "undefined symbol: aFunctionThatNobodyHas"));
    }
}

TEST_F(Loading, NamesAMissingFunctionAsItStandsInTheSource)
{
    for (const char* name : {"UnresolvedMember.zmb", "UnresolvedMember.bundle"})
    {
        const auto path = fixture(name);
        EXPECT_FALSE(load(path));
        EXPECT_EQ(output(), notLoaded(path, "undefined symbol: moon::phaseOf(wchar_t const*, int)"));
    }
}

TEST_F(Loading, LeavesFunctionsToTheirFirstCallWhenAskedTo)
{
    const auto path = tessel::toWide(fixture("Unresolved.zmb").native());
    // In a process of its own: message 2 calls the missing function, and with it ends the process.
    const pid_t child = fork();
    if (child == 0)
    {
        const bool loaded = mLinker.loadModule(path.c_str(), true, false);
        _exit(loaded && output() == "Unresolved.zmb: message 1\n" ? 0 : 1);
    }
    int status = 0;
    ASSERT_EQ(waitpid(child, &status, 0), child);
    EXPECT_TRUE(WIFEXITED(status));
    EXPECT_EQ(WEXITSTATUS(status), 0);
}

TEST_F(Loading, SaysWhichBundleStandsInTheWayOfAnotherWithTheSameIdentifier)
{
    const auto first = fixture("Identified.bundle", "first/Identified.bundle");
    const auto second = fixture("Identified.bundle", "second/Identified.bundle");
    EXPECT_TRUE(load(first));
    output();
    EXPECT_FALSE(load(second));
    EXPECT_EQ(output(), notLoaded(second, "the bundle \"" + first.native() + "\" has the same identifier"));
}

TEST_F(Loading, RefusesALibraryWithoutAnEntryPointAndOneWhoseEntryPointFails)
{
    const std::pair<const char*, const char*> cases[] = {
        {"NoEntry.zmb", "it has no entry point \"tsrxEntryPoint\""},
        {"Throws.zmb", "its entry point threw an exception: the coffee is cold"},
        {"ThrowsNumber.omp", "its entry point threw something that is not an error of the standard library"},
        {"Raises.bundle", "its entry point threw an exception: NSInvalidArgumentException: the tea is cold"}};
    for (const auto& [name, whyNot] : cases)
    {
        const auto path = fixture(name);
        EXPECT_FALSE(load(path));
        EXPECT_EQ(output(), notLoaded(path, whyNot));
        EXPECT_EQ(isMapped(path), false) << path;
    }
    EXPECT_EQ(names(), L"");
    EXPECT_STREQ(tsedGetAppName(), L"");
}

TEST_F(Loading, RefusesWhatThrowsWhileItIsBeingMappedNowAndLater)
{
    const std::pair<const char*, const char*> cases[] = {
        {"ThrowsInMapping.zmb", "the ruler is broken"},
        {"ThrowsInMapping.bundle", "the ruler is broken"},
        {"ThrowsWithClasses.bundle", "the ruler is broken"},
        {"RaisesInMapping.bundle", "NSInternalInconsistencyException: the kettle is empty"}};
    for (const auto& [name, why] : cases)
    {
        const auto path = fixture(name);
        EXPECT_FALSE(load(path));
        EXPECT_EQ(
            output(),
            notLoaded(path, std::string("while it was being mapped, its code threw an exception: ") + why));
        EXPECT_FALSE(load(path));
        EXPECT_EQ(output(),
                  notLoaded(path, "it threw an exception before while it was being mapped, and what is "
                                  "in memory of it since cannot be used"));
        EXPECT_TRUE(load(
            fixture("Classes.bundle", std::filesystem::path(std::string("with ") + name) / "After.bundle")))
            << output();
        EXPECT_THAT(output(), StartsWith("After.bundle: message 1\nGrüße aus dem Bündel\n"));
    }
}

TEST_F(Loading, TakesBackWhatAnApplicationRegisteredBeforeItAnsweredAnError)
{
    const auto path = fixture("Answers3.zmb");
    EXPECT_FALSE(load(path));
    EXPECT_EQ(output(), "Answers3.zmb: message 1\n" + notLoaded(path, "its entry point answered 3"));
    EXPECT_EQ(names(), L"");
    EXPECT_TRUE(mCommands.names().empty());
    EXPECT_FALSE(isMapped(path));
    EXPECT_FALSE(load(path));
    EXPECT_EQ(output(), "Answers3.zmb: message 1\n" + notLoaded(path, "its entry point answered 3"));
}

TEST_F(Loading, KeepsSilentWhenNotAskedToSay)
{
    const auto path = tessel::toWide((mFolder / "nothing.zmb").native());
    EXPECT_FALSE(mLinker.loadModule(path.c_str(), false, true));
    EXPECT_FALSE(mLinker.unloadModule(path.c_str(), false));
    EXPECT_FALSE(mLinker.loadModule(nullptr, false, true));
    EXPECT_EQ(output(), "");
}

TEST_F(Loading, NeverSendsASecondLoadMessageWhileTheFirstIsRunning)
{
    const auto path = fixture("LoadsItself.zmb");
    EXPECT_TRUE(load(path));
    EXPECT_EQ(output(), "LoadsItself.zmb: message 1\n" +
                            notLoaded(path, "its load message is still running, and it has not registered "
                                            "itself") +
                            notUnloaded(path, "it is at work") +
                            "before 0, registered 1, after 1, unloaded 0\n");
    EXPECT_EQ(names(), L"LoadsItself.zmb ");
}

TEST_F(Loading, KnowsNoApplicationBehindAnUnknownHandle)
{
    int something = 0;
    EXPECT_FALSE(mLinker.registerApplication(&something));
    EXPECT_FALSE(mLinker.registerApplication(nullptr));
    EXPECT_FALSE(mLinker.setApplicationLocked(&something, true));
}

TEST_F(Loading, TakesWhateverCharactersAPathMayHold)
{
    for (const char* name : {"with a blank.zmb", "'single' \"double\".zmb", "100%s%n.zmb", "Größe-漢字-😀.zmb",
                             "line\nbreak.zmb", "back\\slash.zmb"})
    {
        const auto path = fixture("Good.zmb", std::filesystem::path("folder " + std::string(name)) / name);
        EXPECT_TRUE(load(path));
        EXPECT_EQ(output(), name + std::string(": message 1\n"));
        EXPECT_TRUE(unload(path));
        EXPECT_EQ(output(), name + std::string(": message 2\n"));
        std::filesystem::resize_file(path, 3000);
        EXPECT_FALSE(load(path));
        EXPECT_EQ(output(), notLoaded(path, "the file is cut short"));
    }
}

TEST_F(Loading, TakesAPathOfFourThousandCharactersAndSaysThatALongerOneIsTooLong)
{
    constexpr std::size_t kLong = 4000;
    const std::string file = "/Good.zmb";
    std::string folder = mFolder.path().native();
    while (folder.size() + file.size() < kLong)
        folder += "/" + std::string(std::min<std::size_t>(200, kLong - folder.size() - file.size() - 1), 'x');
    const auto path = fixture("Good.zmb", folder + file);
    ASSERT_EQ(path.native().size(), kLong);
    EXPECT_TRUE(load(path));
    EXPECT_EQ(output(), "Good.zmb: message 1\n");
    const std::filesystem::path tooLong = folder + "/" + std::string(200, 'y') + file;
    EXPECT_FALSE(load(tooLong));
    EXPECT_EQ(output(), notLoaded(tooLong, "File name too long"));
}
