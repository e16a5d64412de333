#include "tests/resources/StringsFile.h"

#import <Foundation/Foundation.h>

namespace
{
// The parser raises when it meets what it does not understand. Every kind of exception is caught as `id`: the
// runtime of GNUstep cannot tell them apart in this language.
NSDictionary* parse(NSString* text)
{
    @try
    {
        return [text propertyListFromStringsFileFormat];
    }
    @catch (id)
    {
        return nil;
    }
}
} // namespace

std::optional<std::map<std::string, std::string>> readStringsFile(const std::filesystem::path& file)
{
    NSAutoreleasePool* pool = [NSAutoreleasePool new];
    std::optional<std::map<std::string, std::string>> texts;
    NSString* content = [NSString stringWithContentsOfFile:[NSString stringWithUTF8String:file.c_str()]
                                                  encoding:NSUTF8StringEncoding
                                                     error:nullptr];
    if (NSDictionary* table = parse(content))
    {
        texts.emplace();
        NSEnumerator* keys = [table keyEnumerator];
        while (NSString* key = [keys nextObject])
            texts->emplace([key UTF8String], [[table objectForKey:key] UTF8String]);
    }
    [pool release];
    return texts;
}
