// The description file of a bundle, with any content: it is refused with a reason, or the program that it
// names is one inside of the bundle. Nothing that the toolkit makes of it comes out as an exception.
#include <fstream>
#include <string>

#include <sys/resource.h>

#include "host/platform/AutoreleasePool.h"
#include "host/platform/Bundle.h"
#include "host/platform/BundleDescription.h"
#include "tests/fuzz/FuzzHost.h"

namespace
{
namespace fs = std::filesystem;

// The toolkit keeps every bundle that it has seen for good, so that not each input can have one of its own.
constexpr unsigned kInputsForABundle = 32;

// A description of some bytes must not take all that the machine has.
constexpr long kMemoryForAll = 1 << 20; // in kilobytes

long mostMemory()
{
    rusage usage = {};
    getrusage(RUSAGE_SELF, &usage);
    return usage.ru_maxrss;
}

// Without the words of the toolkit about the place of a fault.
std::wstring kindOf(const std::wstring& sentence)
{
    return sentence.substr(0, sentence.find_first_of(L"0123456789\"("));
}

fs::path write(const fs::path& bundle, const std::uint8_t* data, std::size_t size)
{
    fs::create_directories(bundle / "Resources");
    std::ofstream(bundle / "Resources/Info-gnustep.plist", std::ios::binary)
        .write(reinterpret_cast<const char*>(data), static_cast<std::streamsize>(size));
    std::ofstream(bundle / "moon") << "a program";
    return bundle;
}

void checkProgram(const fs::path& bundle)
{
    const auto program = tessel::programOfBundle(bundle.string());
    note(kindOf(program.sentence()));
    if (!program)
        return require(!program.sentence().empty());
    require(fs::exists(*program));
    require(fs::canonical(*program).string().starts_with(fs::canonical(bundle).string() + "/"));
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const tessel::AutoreleasePool pool;
    static unsigned inputs = 0;
    static const fs::path same = fuzzFolder() / "Same.bundle";
    const auto checked = tessel::checkDescription(write(same, data, size).string());
    note(kindOf(checked.sentence()));
    require(static_cast<bool>(checked) == checked.sentence().empty());
    require(mostMemory() < kMemoryForAll);
    if (++inputs % kInputsForABundle != 0)
        return 0;
    const fs::path own = write(fuzzFolder() / (std::to_string(inputs) + ".bundle"), data, size);
    checkProgram(own);
    fs::remove_all(own);
    return 0;
}
