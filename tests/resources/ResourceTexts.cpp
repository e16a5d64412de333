#include "tests/resources/ResourceTexts.h"

#include <stdexcept>

#include "host/resources/PeResources.h"
#include "tests/resources/SourceText.h"

namespace
{
constexpr unsigned kLargestId = 65535;
}

std::map<unsigned, std::wstring> readResourceTexts(const std::filesystem::path& module)
{
    const std::string content = readFile(module);
    const auto resources = tessel::PeResources::read({content.begin(), content.end()});
    if (!resources)
        throw std::runtime_error("not a resource module: " + module.string());
    std::map<unsigned, std::wstring> texts;
    for (unsigned id = 0; id <= kLargestId; ++id)
        if (std::wstring text = resources->string(id); !text.empty())
            texts.emplace(id, std::move(text));
    return texts;
}
