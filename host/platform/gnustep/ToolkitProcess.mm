#include "host/platform/gnustep/ToolkitProcess.h"

#import <Foundation/Foundation.h>

#include <wincompat/winstring.h>

#include <algorithm>
#include <fstream>
#include <iterator>

#include <unistd.h>

#include <objc/runtime.h>

#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
// Stands where the toolkit looks for itself.
void lookNowhere(id, SEL)
{
}

std::vector<std::string> arguments()
{
    std::ifstream file("/proc/self/cmdline", std::ios::binary);
    std::vector<std::string> words;
    for (std::string word; std::getline(file, word, '\0');)
        words.push_back(word);
    return words;
}

// Every text as one that the toolkit can read, and where each begins, with a null at the end.
class ReadableTexts
{
public:
    explicit ReadableTexts(const std::vector<std::string>& texts)
    {
        for (const std::string& text : texts)
            mTexts.emplace_back([wcharToNSString(toWide(text).c_str()) UTF8String]);
        for (std::string& text : mTexts)
            mPointers.push_back(text.data());
        mPointers.push_back(nullptr);
    }

    char** pointers() { return mPointers.data(); }
    int count() const { return static_cast<int>(mTexts.size()); }

private:
    std::vector<std::string> mTexts;
    std::vector<char*> mPointers;
};
} // namespace

std::vector<std::string> currentEnvironment()
{
    std::vector<std::string> result;
    for (char** variable = environ; *variable; ++variable)
        result.emplace_back(*variable);
    return result;
}

std::vector<std::string> environmentWith(const std::string& variable, const std::string& value)
{
    std::vector<std::string> result = currentEnvironment();
    const std::string start = variable + "=";
    std::erase_if(result, [&](const std::string& other) { return other.starts_with(start); });
    result.push_back(start + value);
    return result;
}

void tellToolkitOfProcess(const std::vector<std::string>& environment)
{
    method_setImplementation(class_getClassMethod(objc_getClass("NSProcessInfo"), @selector(initialize)),
                             reinterpret_cast<IMP>(reinterpret_cast<void*>(lookNowhere)));
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    ReadableTexts words(arguments());
    ReadableTexts variables(environment);
    [NSProcessInfo initializeWithArguments:words.pointers()
                                     count:words.count()
                               environment:variables.pointers()];
    [pool drain];
}
} // namespace tessel
