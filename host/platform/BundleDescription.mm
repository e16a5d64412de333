#include "host/platform/BundleDescription.h"

#import <Foundation/Foundation.h>
#include <wincompat/winstring.h>

#include <algorithm>
#include <filesystem>

#include "host/platform/DescriptionPlaces.h"
#include "host/platform/ObjectiveCGuard.h"
#include "host/platform/RegularFile.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
// Descriptions have some thousand bytes and some dozen lists.
constexpr std::uint64_t kMostBytes = 1U << 20U;
constexpr std::ptrdiff_t kMostLists = 10000;    // one in the other, they take half of a small stack
constexpr std::string_view kBeginnings = "({<"; // of a list, a table, an element

// The toolkit's own older format, for machines alone: some bytes of it may ask for all memory there is, or
// for more time than anybody has.
bool isForMachines(const std::string& content)
{
    return content.front() == 0 || content.front() == 1;
}

Result<std::string> contentOf(const RegularFile& file)
{
    if (!file.opened())
        return file.opened().failure();
    if (file.size() > kMostBytes)
        return Failure{translated(L"it is too large for a description")};
    std::string content(file.size(), '\0');
    if (!file.read(0, content.data(), content.size()))
        return Failure{translated(L"it cannot be read to its end")};
    if (isForMachines(content))
        return Failure{translated(L"it is no property list that a person or a tool for bundles writes")};
    const auto beginsList = [](char character)
    { return kBeginnings.find(character) != std::string_view::npos; };
    if (std::ranges::count_if(content, beginsList) > kMostLists)
        return Failure{translated(L"it holds too many lists for a description")};
    return content;
}

Result<> checkList(const std::string& content)
{
    NSData* data = [NSData dataWithBytes:content.data() length:content.size()];
    NSError* error = nil;
    const id description = [NSPropertyListSerialization propertyListWithData:data
                                                                     options:NSPropertyListImmutable
                                                                      format:nullptr
                                                                       error:&error];
    if (description)
        return [description isKindOfClass:[NSDictionary class]]
                   ? Result<>()
                   : Failure{translated(L"it is no table of names and values")};
    NSString* why = [error localizedDescription];
    return Failure{why ? translated(L"it is no property list ({})", NSStringToWstring(why))
                       : translated(L"it is no property list")};
}

Result<> checkFile(const RegularFile& file)
{
    const auto content = contentOf(file);
    if (!content)
        return content.failure();
    Result<> checked;
    const auto returned = catchObjectiveC([&] { checked = checkList(*content); });
    return returned ? checked : Failure{translated(L"it is no property list ({})", returned.sentence())};
}
} // namespace

Result<> checkDescription(const std::string& folder)
{
    for (const std::string& place : descriptionPlaces())
    {
        const std::string path = std::filesystem::path(folder) / place;
        const RegularFile file(path);
        if (file.opened().code() == kNothingThere)
            continue;
        const auto checked = checkFile(file);
        return checked ? checked
                       : Failure{translated(L"its description \"{}\" cannot be used: {}", toWide(path),
                                            checked.sentence())};
    }
    return {};
}
} // namespace tessel
