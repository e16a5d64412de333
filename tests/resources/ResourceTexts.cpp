#include "tests/resources/ResourceTexts.h"

#include <stdexcept>

#include "host/resources/PeResources.h"
#include "tests/resources/SourceText.h"

namespace
{
constexpr unsigned kLargestId = 65535;
}

std::vector<ResourceTexts> readResourceTexts(const std::filesystem::path& module)
{
    const std::string content = readFile(module);
    const auto resources = tessel::PeResources::read({content.begin(), content.end()});
    if (!resources)
        throw std::runtime_error("not a resource module: " + module.string());
    std::vector<ResourceTexts> languages;
    for (const auto language : resources->languages())
    {
        auto& texts = languages.emplace_back(ResourceTexts{language, {}}).texts;
        for (unsigned id = 0; id <= kLargestId; ++id)
            if (std::wstring text = resources->string(id, language); !text.empty())
                texts.emplace(id, std::move(text));
    }
    return languages;
}
