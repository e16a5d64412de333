// A Tessel whose library for the network is missing, damaged or of another version, as after an update of a
// Tessel that runs. Everything else goes on. The product is tried in a copy.
#include <gmock/gmock.h>

#include <fstream>

#include "tests/e2e/HostProcess.h"
#include "tests/support/HttpServer.h"

namespace fs = std::filesystem;

using testing::EndsWith;
using testing::HasSubstr;
using testing::Not;

namespace
{
class NetworkLibrary : public testing::Test
{
protected:
    NetworkLibrary()
    {
        fs::copy(fs::path(TESSEL_PROGRAM).parent_path(), copy, fs::copy_options::recursive);
        session.startBy("exec '" + (copy / "Tessel").string() + "' \"$@\"");
        session.alwaysWith({"--safe"});
    }

    std::string address() const
    {
        const std::wstring url = server.url(L"/tool.lsp");
        return std::string(url.begin(), url.end());
    }

    void expectNotFetched(const std::string& reason) const
    {
        const auto result = session.run({"LOAD " + address(), "VERSION"});
        EXPECT_EQ(result.exitStatus, 1);
        EXPECT_THAT(result.output, HasSubstr("\n" + address() + " could not be fetched: " + reason));
        EXPECT_THAT(result.output, EndsWith(", version " MODRIG_VERSION "\n"));
        EXPECT_THAT(result.output, Not(HasSubstr("it runs")));
    }

    HostSession session;
    const fs::path copy = session.folder() / "a copy of Tessel.app";
    const fs::path library = copy / fs::path(NETWORK_LIBRARY).filename();
    HttpServer server{[](const std::string&) -> HttpServer::Answer
                      {
                          return {httpAnswer("200 OK", "(write-line \"it runs\")"), "", {}};
                      }};
};
} // namespace

TEST_F(NetworkLibrary, IsFoundWhereTheProductIsMovedTo)
{
    EXPECT_THAT(session.run({"LOAD " + address()}).output, HasSubstr("\nit runs\n"));
}

TEST_F(NetworkLibrary, ThatIsMissingIsNamedWithTheWayOut)
{
    fs::remove(library);
    expectNotFetched(
        "Tessel's library for the network cannot be used, and Tessel has to be installed again (" +
        library.string() + ": ");
}

TEST_F(NetworkLibrary, ThatIsNoLibraryIsNamedWithTheWayOut)
{
    std::ofstream(library, std::ios::binary) << "Dear Sir or Madam,\n";
    expectNotFetched(
        "Tessel's library for the network cannot be used, and Tessel has to be installed again (" +
        library.string() + ": it is not a shared library)");
}

// The system's linker would end the process by it.
TEST_F(NetworkLibrary, ThatIsCutShortIsNamedWithTheWayOut)
{
    fs::resize_file(library, 4096);
    expectNotFetched(
        "Tessel's library for the network cannot be used, and Tessel has to be installed again (" +
        library.string() + ": the file is cut short)");
}

TEST_F(NetworkLibrary, OfAnotherVersionIsNotUsed)
{
    fs::copy_file(OTHER_NETWORK_LIBRARY, library, fs::copy_options::overwrite_existing);
    expectNotFetched("Tessel's library for the network is of another version, and Tessel has to be started "
                     "again (" +
                     library.string() + ")");
}
